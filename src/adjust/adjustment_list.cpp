#include "adjust/adjustment_list.h"

#include "adjust/adjustment.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/rounding.h"
#include "platform/text.h"
#include "store/chart_list_relink.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <set>
#include <system_error>

namespace kori::adjust {

namespace fs = std::filesystem;
using platform::Status;
using platform::Trim;

// ---- The list file -------------------------------------------------------------------------

std::string ListItem::Field(std::size_t n) const {
    return n >= 1 && n <= Fields.size() ? Fields[n - 1] : std::string();
}

void ListItem::SetField(std::size_t n, std::string value) {
    if (n < 1 || n > kMaxFields) return;
    if (Fields.size() < n) Fields.resize(n);
    Fields[n - 1] = std::move(value);
}

std::string ListItem::Line() const {
    std::string line;
    for (std::size_t i = 0; i < Fields.size(); ++i) {
        if (i > 0) line += ',';
        line += Fields[i];
    }
    return line;
}

ListItem ParseListLine(std::string_view line) {
    ListItem item;
    std::size_t pos = 0;
    while (true) {
        if (item.Fields.size() + 1 == kMaxFields) {
            item.Fields.emplace_back(line.substr(pos));
            break;
        }
        const std::size_t comma = line.find(',', pos);
        item.Fields.emplace_back(line.substr(pos, comma - pos));
        if (comma == std::string_view::npos) break;
        pos = comma + 1;
    }
    return item;
}

int ActionRank(std::string_view action) {
    static constexpr std::array<std::string_view, 7> kOrder = {"NI", "NC", "DC", "SP",
                                                               "BI", "PC", "DI"};
    const std::string a = Trim(action);
    for (std::size_t i = 0; i < kOrder.size(); ++i)
        if (a == kOrder[i]) return static_cast<int>(i) + 1;
    return 8;
}

void SortByRank(std::vector<ListItem>& items) {
    std::stable_sort(items.begin(), items.end(), [](const ListItem& a, const ListItem& b) {
        return ActionRank(a.Action()) < ActionRank(b.Action());
    });
}

namespace {

fs::path ListPath(std::string_view folder) {
    return platform::ResolveIn(folder, kListFile);
}

std::vector<std::string> Lines(std::string_view text) {
    std::vector<std::string> lines;
    std::size_t pos = 0;
    while (pos < text.size()) {
        std::size_t end = text.find('\n', pos);
        if (end == std::string_view::npos) end = text.size();
        std::string line(text.substr(pos, end - pos));
        pos = end + 1;
        if (!line.empty() && line.back() == '\r') line.pop_back();
        if (!Trim(line).empty()) lines.push_back(std::move(line));
    }
    return lines;
}

std::string JoinLines(const std::vector<std::string>& lines, std::size_t from = 0) {
    std::string text;
    for (std::size_t i = from; i < lines.size(); ++i)
        text += lines[i] + "\r\n";
    return text;
}

} // namespace

Status ReadAdjustmentList(std::string_view folder, std::vector<ListItem>& items) {
    items.clear();
    const fs::path path = ListPath(folder);
    if (!platform::FileExists(path)) return Status::Ok();
    const auto text = platform::ReadWholeFile(path);
    if (!text) return Status::Error("Cannot read " + path.string());
    for (const auto& line : Lines(*text))
        items.push_back(ParseListLine(line));
    return Status::Ok();
}

Status WriteAdjustmentList(std::string_view folder, const std::vector<ListItem>& items) {
    std::string text;
    for (const auto& item : items)
        text += item.Line() + "\r\n";
    return platform::WriteFileAtomic(ListPath(folder), text, {std::string(kListScratch), ""});
}

// ---- Filling the list ----------------------------------------------------------------------

const std::array<BulletinKind, 6>& BulletinKinds() {
    static const std::array<BulletinKind, 6> kinds = {{{".Asx.Btn", ".Asx.Btx", true},
                                                       {".Sfe.Btn", ".Sfe.Btx", false},
                                                       {".Wcm.Btn", ".Wcm.Btx", false},
                                                       {".Btn", ".Btx", false},
                                                       {".Lsx.Btn", ".Lsx.Btx", false},
                                                       {".Lif.Btn", ".Lif.Btx", false}}};
    return kinds;
}

bool HasOptionsLibrary(std::string_view optionsFolder) {
    const std::string folder = Trim(optionsFolder);
    if (folder.empty()) return false;
    std::string upper = platform::Upper(folder);
    std::replace(upper.begin(), upper.end(), '/', '\\');
    if (upper.ends_with("\\KORIWIN\\DATA\\")) return false;
    std::int16_t count = 0;
    const fs::path names = store::NameFile::PathIn(folder);
    if (!platform::FileExists(names)) return false;
    if (!store::CountRecords(names, store::NameRecord::kSize, count)) return false;
    return count > 10;
}

namespace {

bool Undefined(std::string_view folder) {
    const std::string f = Trim(folder);
    return f.empty() || platform::EqualsNoCase(f, "unknown");
}

} // namespace

Status UpdateAdjustmentsList(std::string_view folder, std::string_view dateStem,
                             const ListSettings& s, platform::Progress& progress, ListUpdate& out) {
    out = ListUpdate{};
    if (Undefined(s.In) || Undefined(s.Out)) return Status::Ok();
    progress.SetStatus(kCheckingList);

    BulletinOptions options;
    options.DateStem = platform::Upper(dateStem);
    options.OptionsLibrary = HasOptionsLibrary(s.OptionsFolder);
    options.NoWarrants = s.NoWarrants;
    options.NoShortNames = s.NoShortNames;
    options.Divs = s.Divs;
    const std::string dataFolder(folder);
    options.HasPriceFile = [&dataFolder](std::string_view code) {
        const auto path = store::PriceFile::PathFor(dataFolder, Trim(code));
        return !path.empty() && platform::FileExists(path);
    };

    const std::string stem(dateStem);
    const fs::path list = ListPath(folder);
    for (const auto& kind : BulletinKinds()) {
        const fs::path input = platform::ResolveIn(s.In, stem + std::string(kind.Input));
        const fs::path copy = platform::ResolveIn(s.Out, stem + std::string(kind.Copy));
        if (!platform::FileExists(input) || platform::FileExists(copy)) continue;
        if (platform::FileSizeOr0(input) == 0) continue;
        const auto text = platform::ReadWholeFile(input);
        if (!text) return Status::Error("Cannot read " + input.string());
        options.WarrantFilter = kind.WarrantFilter;
        const auto kept = FilterBulletin(*text, options);
        // The lines go in before the copy is made: a run stopped between the two filters the
        // bulletin again rather than losing it.
        if (!kept.empty()) {
            if (auto st = platform::AppendToFile(list, JoinLines(kept)); !st) return st;
            out.LinesAdded += static_cast<int>(kept.size());
            out.NewItems = true;
        }
        if (auto st = platform::WriteFileAtomic(copy, *text); !st) return st;
        ++out.BulletinsFiltered;
    }

    // A long list keeps its newest lines.
    if (platform::FileExists(list)) {
        const auto text = platform::ReadWholeFile(list);
        if (!text) return Status::Error("Cannot read " + list.string());
        const auto lines = Lines(*text);
        if (lines.size() >= kTrimAt) {
            if (auto st = platform::WriteFileAtomic(list, JoinLines(lines, lines.size() - kTrimTo),
                                                    {std::string(kListScratch), ""});
                !st)
                return st;
            out.Trimmed = true;
        }
    }
    return Status::Ok();
}

// ---- Carrying the items out ----------------------------------------------------------------

double PowerOfTen(int power) {
    power = std::clamp(power, -4, 4);
    return std::pow(10.0, power);
}

std::string FolderForItem(const MakeSettings& s, const ListItem& item) {
    if (s.DataService != 3) return s.DataFolder;
    const std::string tag = Trim(item.Field(3));
    std::size_t index = 0; // a date stem or an unknown tag: Australian stocks
    if (tag == "OPT")
        index = 4;
    else if (tag == "IDX")
        index = 1;
    else if (tag == "SFE")
        index = 2;
    else if (tag == "OVS")
        index = 3;
    else if (tag == "LSE")
        index = 5;
    else if (tag == "LSX")
        index = 6;
    else if (tag == "LIF")
        index = 7;
    return Trim(s.Folders[index]).empty() ? std::string() : s.Folders[index];
}

namespace {

constexpr std::array<std::string_view, 12> kMonths = {"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                                                      "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};

// "ddMMMyy" (years in this century) as "yyyymmdd"; empty for any other form.
std::string StemDate(std::string_view stem) {
    if (stem.size() != 7) return {};
    const std::string day(stem.substr(0, 2)), month = platform::Upper(stem.substr(2, 3)),
                                              year(stem.substr(5, 2));
    if (!std::all_of(day.begin(), day.end(), [](char c) { return c >= '0' && c <= '9'; }) ||
        !std::all_of(year.begin(), year.end(), [](char c) { return c >= '0' && c <= '9'; }))
        return {};
    const auto m = std::find(kMonths.begin(), kMonths.end(), month);
    if (m == kMonths.end()) return {};
    const int d = std::stoi(day);
    if (d < 1 || d > 31) return {};
    char text[32];
    std::snprintf(text, sizeof text, "20%s%02d%02d", year.c_str(),
                  static_cast<int>(m - kMonths.begin()) + 1, d);
    return text;
}

fs::path OldPath(std::string_view folder, std::string_view code) {
    return platform::ResolveIn(folder, Trim(code) + ".Old");
}

// The price file of a code when it exists; empty otherwise (also for a code that cannot name a
// file).
fs::path ExistingPriceFile(std::string_view folder, std::string_view code) {
    const auto path = store::PriceFile::PathFor(folder, Trim(code));
    return !path.empty() && platform::FileExists(path) ? path : fs::path();
}

Status RenameOver(const fs::path& from, const fs::path& to) {
    std::error_code ec;
    fs::rename(from, to, ec);
    if (ec) return Status::Error("Cannot rename " + from.string() + " to " + to.string());
    return Status::Ok();
}

Status ReadRecords(const fs::path& path, std::vector<store::PriceRecord>& recs) {
    store::PriceFile file(path);
    return file.ReadAll(recs);
}

// The record a factor applies to: the last one before the effective date. 0 when none from
// record 2 up qualifies.
int RecordBefore(const std::vector<store::PriceRecord>& recs, std::string_view date) {
    for (int i = static_cast<int>(recs.size()); i >= 1; --i) {
        const std::string_view d = recs[static_cast<std::size_t>(i) - 1].Date;
        if (d > date) continue;
        const int chosen = d == date ? i - 1 : i;
        return chosen >= 2 ? chosen : 0;
    }
    return 0;
}

Status SetNameStatus9(std::string_view folder, int recordNumber) {
    store::NameFile names(store::NameFile::PathIn(folder));
    if (auto st = names.Open(); !st) return st;
    store::NameRecord rec;
    if (auto st = names.Read(recordNumber, rec); !st) return st;
    rec.Status = 9;
    return names.Write(recordNumber, rec);
}

Status NewListing(std::string_view folder, const ListItem& item, std::string& message) {
    const std::string code = Trim(item.Code()), name = Trim(item.Field(6));
    if (code.empty() || name.empty() || !store::IsValidCode(code)) return Status::Ok();
    const std::string shortField = item.Field(7).substr(0, 3);
    Status why;
    const auto found = store::FindCode(folder, code, why);
    if (!why) return why;
    const std::string text = "Adding " + code + " " + name + " to Name File";
    store::NameFile names(store::NameFile::PathIn(folder));
    if (auto st = names.Open(); !st) return st;
    if (found) {
        store::NameRecord rec = found->Record;
        rec.Name = name.substr(0, 35);
        rec.IndustryClass = shortField;
        if (auto st = names.Write(found->RecordNumber, rec); !st) return st;
        message = text;
        return Status::Ok();
    }
    if (ExistingPriceFile(folder, code).empty()) return Status::Ok();
    store::NameRecord rec;
    rec.Code = store::PadCode(code);
    rec.Name = name.substr(0, 35);
    rec.IndustryClass = shortField;
    rec.Category = 0;
    rec.RecordType = 4;
    rec.OtherDetails = " ";
    rec.Base = 0;
    rec.Top = 0;
    rec.PFIncrement = 0;
    rec.ScaleStep = 0.05f;
    if (auto st = names.Append(rec); !st) return st;
    message = text;
    return Status::Ok();
}

Status CodeChange(std::string_view folder, const ListItem& item, std::string& message,
                  bool& nameFileChanged) {
    const std::string oldCode = Trim(item.Code()), newCode = Trim(item.Field(7));
    const fs::path oldFile = ExistingPriceFile(folder, oldCode);
    if (oldFile.empty() || !store::IsValidCode(newCode)) return Status::Ok();
    Status why;
    const auto oldName = store::FindCode(folder, oldCode, why);
    if (!why) return why;
    const auto newName = store::FindCode(folder, newCode, why);
    if (!why) return why;
    const fs::path newFile = ExistingPriceFile(folder, newCode);
    const std::string text = "Name Change :" + oldCode + "to  " + newCode;

    if (newName && !newFile.empty()) {
        const std::string date = ListDate(item.Field(6));
        if (date.empty()) return Status::Ok();
        std::vector<store::PriceRecord> before, after;
        if (auto st = ReadRecords(oldFile, before); !st) return st;
        if (auto st = ReadRecords(newFile, after); !st) return st;
        // The name record first: a run stopped after the files moved then needs nothing more.
        if (oldName)
            if (auto st = SetNameStatus9(folder, oldName->RecordNumber); !st) return st;
        if (before.size() > 1) {
            // Old history before the date, then the new code's records from it.
            std::vector<store::PriceRecord> merged;
            for (const auto& r : before)
                if (std::string_view(r.Date) < date) merged.push_back(r);
            for (const auto& r : after)
                if (std::string_view(r.Date) >= date) merged.push_back(r);
            if (merged.size() > static_cast<std::size_t>(store::kMaxRecords))
                return Status::Error("The merged history of " + newCode + " would pass " +
                                     std::to_string(store::kMaxRecords) + " records");
            const fs::path temp = platform::ResolveIn(folder, "tempdata.wdt");
            store::PriceFile tempFile(temp);
            if (auto st = tempFile.WriteAll(merged); !st) return st;
            // The new code's file is replaced by a rename, so it is always whole; its old
            // content is kept as <code>.Old first.
            const auto newBytes = platform::ReadWholeFile(newFile);
            if (!newBytes) return Status::Error("Cannot read " + newFile.string());
            if (auto st = platform::WriteFileAtomic(OldPath(folder, newCode), *newBytes); !st)
                return st;
            if (auto st = RenameOver(temp, newFile); !st) return st;
            if (auto st = RenameOver(oldFile, OldPath(folder, oldCode)); !st) return st;
        }
        nameFileChanged = true;
        message = text;
        return Status::Ok();
    }

    // The new code is not in the library: the history and its name record take the new code.
    // The name record first, as above.
    if (oldName) {
        store::NameFile names(store::NameFile::PathIn(folder));
        if (auto st = names.Open(); !st) return st;
        store::NameRecord rec = oldName->Record;
        rec.Code = store::PadCode(newCode);
        if (auto st = names.Write(oldName->RecordNumber, rec); !st) return st;
    }
    const fs::path target = store::PriceFile::PathFor(folder, newCode);
    if (!newFile.empty())
        if (auto st = RenameOver(newFile, OldPath(folder, newCode)); !st) return st;
    if (auto st = RenameOver(oldFile, target); !st) return st;
    nameFileChanged = true;
    message = text;
    return Status::Ok();
}

Status Delisting(std::string_view folder, const ListItem& item, std::string& message,
                 bool& nameFileChanged) {
    const std::string code = Trim(item.Code());
    const fs::path file = ExistingPriceFile(folder, code);
    if (file.empty()) return Status::Ok();
    Status why;
    const auto name = store::FindCode(folder, code, why);
    if (!why) return why;
    if (name)
        if (auto st = SetNameStatus9(folder, name->RecordNumber); !st) return st;
    if (auto st = RenameOver(file, OldPath(folder, code)); !st) return st;
    nameFileChanged = true;
    message = "Removal :" + code;
    return Status::Ok();
}

// BI, SP and DI: the factor on the record before the effective date, prices to four decimals,
// volumes as they are.
Status Issue(const MakeSettings& s, std::string_view folder, const ListItem& item,
             std::string& message) {
    const std::string code = Trim(item.Code()), action = Trim(item.Action());
    const fs::path file = ExistingPriceFile(folder, code);
    const std::string date = ListDate(item.Field(6));
    if (file.empty() || date.empty()) return Status::Ok();

    float factor = 0;
    std::string note;
    std::vector<store::PriceRecord> recs;
    int index = 0;
    if (action == "DI") {
        const auto amount = platform::Money::FromDouble(platform::Val(item.Field(9)) / 100);
        if (!amount || amount->ToDouble() <= 0) return Status::Ok();
        if (auto st = ReadRecords(file, recs); !st) return st;
        index = RecordBefore(recs, date);
        if (index == 0) return Status::Ok();
        const float close = recs[static_cast<std::size_t>(index) - 1].Close;
        if (close <= 0) return Status::Ok();
        factor = SixDecimalFactor(
            platform::RoundHalfEven(1.0 - amount->ToDouble() / static_cast<double>(close), 4));
        // A dividend at or above the close would wipe the history out.
        if (!(factor > 0)) return Status::Ok();
        note = "dv" + MoneyText(*amount);
    } else {
        const auto a = platform::Money::FromDouble(platform::Val(item.Field(7)));
        const auto b = platform::Money::FromDouble(platform::Val(item.Field(8)));
        if (!a || !b) return Status::Ok();
        const double av = a->ToDouble(), bv = b->ToDouble();
        if ((av == 0 && bv == 0) || av + bv == 0 || av == 0) return Status::Ok();
        factor = SixDecimalFactor(platform::RoundHalfEven(bv / (av + bv), 4));
        if (!(factor > 0) || !std::isfinite(factor)) return Status::Ok();
        note = av < 0 ? "ss" : "bi";
        if (auto st = ReadRecords(file, recs); !st) return st;
        index = RecordBefore(recs, date);
        if (index == 0) return Status::Ok();
    }
    // An item carried out before a run was stopped is not applied twice.
    const auto& chosen = recs[static_cast<std::size_t>(index) - 1];
    // A dividend's factor is worked out on a close it changes, so its note (with the amount)
    // is what tells it has been applied.
    if (Trim(chosen.AdjDesc) == note && (action == "DI" || chosen.AdjFactor == factor))
        return Status::Ok();

    AdjustmentJob job;
    job.DataFolder = std::string(folder);
    job.ChtMiscFolder = s.ChtMiscFolder;
    job.Code = code;
    job.AdjRecord = index;
    job.AdjFactor = factor;
    job.AdjNote = note;
    job.NoteColour = s.NoteColour;
    job.Volumes = VolumeRule::Unscaled;
    Applied applied;
    if (auto st = ApplyAdjustment(job, applied); !st) return st;
    if (action != "DI") (void)ScaleTrendLines(s.ChtMiscFolder, code, factor, applied.Date);
    message = "Adjustment :" + code + "  " + note;
    return Status::Ok();
}

double VolumeScale(const MakeSettings& s, const ListItem& item) {
    const std::string tag = Trim(item.Field(3));
    if (tag == "OVS" && s.OverseasVolumeScale) return s.OverseasVolumeScale(Trim(item.Code()));
    if ((tag == "IDX" || tag == "OVS") && s.MarketVolumeScale) return s.MarketVolumeScale(tag);
    return 1;
}

Status PriceCorrection(const MakeSettings& s, std::string_view folder, const ListItem& item,
                       std::string& message) {
    const std::string code = Trim(item.Code()), values = platform::Upper(item.Field(7));
    const fs::path file = ExistingPriceFile(folder, code);
    const std::string date = ListDate(item.Field(6));
    if (file.empty() || date.empty() || values.find(':') == std::string::npos) return Status::Ok();
    std::vector<store::PriceRecord> recs;
    if (auto st = ReadRecords(file, recs); !st) return st;
    auto rec = std::find_if(recs.begin(), recs.end(),
                            [&](const auto& r) { return std::string_view(r.Date) == date; });
    if (rec == recs.end()) return Status::Ok();
    bool changed = false;
    for (std::size_t i = 0; i + 1 < values.size(); ++i) {
        if (values[i + 1] != ':') continue;
        const std::string number = Trim(values.substr(i + 2));
        if (number.empty() || !platform::IsNumber(number.substr(0, number.find(' ')))) continue;
        const double v = platform::Val(number);
        const float price = static_cast<float>(platform::RoundHalfEven(v * 0.01, 4));
        switch (values[i]) {
        case 'O':
            rec->Open = price;
            break;
        case 'H':
            rec->High = price;
            break;
        case 'L':
            rec->Low = price;
            break;
        case 'C':
            rec->Close = price;
            break;
        case 'V': {
            const auto volume = platform::CLng(v * VolumeScale(s, item));
            if (!volume) return Status::Error("The corrected volume of " + code + " is too big");
            rec->Volume = *volume;
            break;
        }
        default:
            continue;
        }
        changed = true;
    }
    if (!changed) return Status::Ok();
    store::PriceFile out(file);
    if (auto st = out.WriteAll(recs, {"Temp.Wk1", ""}); !st) return st;
    message = "Price Correction :" + code;
    return Status::Ok();
}

void RemoveOldFiles(std::string_view folder) {
    std::error_code ec;
    for (const auto& entry : fs::directory_iterator(fs::path(std::string(folder)), ec)) {
        if (!entry.is_regular_file(ec)) continue;
        if (platform::EqualsNoCase(entry.path().extension().string(), ".old"))
            fs::remove(entry.path(), ec);
    }
}

// Names.dat without the records the run finished with, its old content kept as Names.bak.
Status CompactNameFile(std::string_view folder) {
    store::NameFile names(store::NameFile::PathIn(folder));
    std::vector<store::NameRecord> recs;
    if (auto st = names.ReadAll(recs); !st) return st;
    std::erase_if(recs, [](const auto& r) { return r.Status == 9; });
    return names.WriteAll(recs, {"TempName.dat", "Names.bak"});
}

} // namespace

std::string ListDate(std::string_view text) {
    const std::string t = Trim(text);
    if (t.size() == 7) return StemDate(t);
    if (t.size() == 8 && platform::IsValidDateText(t)) return t;
    return {};
}

Status RunItem(const MakeSettings& s, const ListItem& item, std::string_view folder,
               std::string& message, bool& nameFileChanged) {
    message.clear();
    const std::string action = Trim(item.Action());
    if (action == "NI" || action == "NL") return NewListing(folder, item, message);
    if (action == "NC") return CodeChange(folder, item, message, nameFileChanged);
    if (action == "DC") return Delisting(folder, item, message, nameFileChanged);
    if (action == "BI" || action == "SP" || action == "DI") return Issue(s, folder, item, message);
    if (action == "PC") return PriceCorrection(s, folder, item, message);
    return Status::Ok(); // EN and actions this system does not know: nothing to do
}

Status MakeAdjustments(const MakeSettings& s, std::vector<ListItem>& items,
                       platform::Progress& progress, MakeReport& report) {
    report = MakeReport{};
    if (items.empty()) return Status::Ok();
    std::string staleBefore;
    if (const auto today = platform::DaySerial(s.Today))
        staleBefore = platform::DateTextFromSerial(*today - 15).value_or("");

    std::set<std::string> compact; // folders whose name file gained status-9 records
    // Hundreds of histories rewritten: each still beside-and-rename, so a stop leaves every file
    // old or new, with one flush of the disk at the end instead of one a file.
    const platform::ScopedSyncDeferral oneFlush(fs::path(s.DataFolder));
    Status result = Status::Ok();
    for (std::size_t row = 0; row < items.size(); ++row) {
        auto& item = items[row];
        if (s.OnRow) s.OnRow(row);
        const std::string action = Trim(item.Action());
        progress.SetStatus("Checking " + Trim(item.Code()));
        if (Trim(item.Indicator()) == "Y") {
            const std::string folder = FolderForItem(s, item);
            if (folder.empty()) continue;
            std::string message;
            bool nameFileChanged = false;
            result = RunItem(s, item, folder, message, nameFileChanged);
            if (!result) break;
            // Any code change or delisting, done now or by a run that was stopped, leaves
            // records of status 9 behind.
            if (nameFileChanged || action == "NC" || action == "DC") compact.insert(folder);
            if (!message.empty()) report.Messages.push_back(message);
            ++report.ItemsRun;
            item.SetField(5, "D");
        } else if ((action == "NI" || action == "NL") && !staleBefore.empty()) {
            const std::string stem = StemDate(Trim(item.Field(3)));
            if (!stem.empty() && stem < staleBefore) item.SetField(5, "D");
        }
        progress.Yield();
    }

    // A run that failed leaves the list file as it was: every handler finds the work it
    // already did, so the same list run again finishes the job, the compaction included.
    if (!result) return result;
    for (const auto& folder : compact) {
        if (auto st = CompactNameFile(folder); !st) return st;
        report.NameFileCompacted = true;
        progress.SetStatus(store::kRelinkStatus);
        if (const auto relinked = store::RelinkChartLists(folder, progress); !relinked.Status)
            return relinked.Status;
    }
    const auto before = items.size();
    std::erase_if(items, [](const ListItem& i) { return Trim(i.Indicator()) == "D"; });
    report.ItemsRemoved = static_cast<int>(before - items.size());
    if (auto st = WriteAdjustmentList(s.DataFolder, items); !st) return st;
    RemoveOldFiles(s.DataFolder);
    for (const auto& folder : compact)
        RemoveOldFiles(folder);
    return Status::Ok();
}

} // namespace kori::adjust
