#include "store/name_editor.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/editor_cells.h"
#include "store/name_file.h"
#include "store/shell_sort.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstring>
#include <fstream>
#include <sstream>

namespace kori::store {

using platform::Status;
using platform::Trim;
namespace nt = name_text;

std::vector<std::string> NameGridHeaders() {
    return {"Rec",
            "Code",
            "Type",
            "Cat.",
            "Industy\nClass",
            "GICS\nSector",
            "Name    (displayed on chart)",
            "Other\nDetails",
            "Base",
            "Top",
            "PF Inc",
            "Id"};
}

namespace {

// A whole number from `low` to `high` written in the cell, or nullopt.
std::optional<long> WholeIn(std::string_view text, long low, long high) {
    const auto v = CellNumber(text);
    if (!v || *v != std::floor(*v) || *v < static_cast<double>(low) ||
        *v > static_cast<double>(high))
        return std::nullopt;
    return static_cast<long>(*v);
}

std::int16_t Int16Of(const std::string& text) {
    const double v = platform::Val(text);
    if (!std::isfinite(v) || v < -32768 || v > 32767) return 0;
    return static_cast<std::int16_t>(v);
}

float FloatOf(const std::string& text) {
    if (const auto v = CellNumber(text)) return static_cast<float>(*v);
    return static_cast<float>(platform::Val(text));
}

std::string IntText(int v) {
    return std::to_string(v);
}

} // namespace

CellRule CheckNameCell(int column, const std::string& text) {
    const std::string t = Trim(text);
    switch (column) {
    case kNameCode:
        return {true, platform::Upper(text), {}, {}};
    case kNameType:
        if (t.empty() || WholeIn(t, 1, 5)) return {true, t, {}, {}};
        return {false, text, std::string(nt::kTypeRange), std::string(nt::kTypeTitle)};
    case kNameCat:
        if (t.empty() || WholeIn(t, 0, 99)) return {true, t, {}, {}};
        return {false, text, std::string(nt::kCategoryRange), std::string(nt::kCategoryTitle)};
    case kNameIndustry:
        if (t.empty()) return {true, t, {}, {}};
        if (const auto v = WholeIn(t, 0, 999))
            return {true, platform::Format(static_cast<double>(*v), "000"), {}, {}};
        return {false, text, std::string(nt::kClassRange), std::string(nt::kClassTitle)};
    case kNameName:
    case kNameOther:
        if (text.find(',') != std::string::npos)
            return {false, text, std::string(nt::kNoCommas), std::string(nt::kNameTitle)};
        return {true, text, {}, {}};
    case kNameBase:
    case kNameTop:
    case kNamePFInc:
        if (t.empty() || CellNumber(t)) return {true, t, {}, {}};
        return {false, text, "Base, Top and PF Inc must be numeric", std::string(nt::kNameTitle)};
    case kNameId:
        return {true, platform::Upper(t), {}, {}};
    default:
        return {true, text, {}, {}};
    }
}

TextRow NameRowOf(const NameRecord& r, int recordNumber) {
    TextRow row(kNameAllColumns);
    row[kNameRec] = IntText(recordNumber);
    row[kNameCode] = Trim(r.Code);
    row[kNameType] = IntText(r.RecordType);
    row[kNameCat] = IntText(r.Category);
    row[kNameIndustry] = r.IndustryClass;
    row[kNameGics] = r.GicsSector;
    row[kNameName] = Trim(r.Name);
    row[kNameOther] = Trim(r.OtherDetails);
    row[kNameBase] = CellFloat(r.Base);
    row[kNameTop] = CellFloat(r.Top);
    row[kNamePFInc] = CellFloat(r.PFIncrement);
    row[kNameId] = Trim(r.Id);
    row[kNameStatus] = IntText(r.Status);
    row[kNameScaleStep] = CellFloat(r.ScaleStep);
    row[kNameBandUp] = IntText(r.PercentBandUp);
    row[kNameBandDown] = IntText(r.PercentBandDown);
    row[kNameBollingerPeriod] = IntText(r.BollingerPeriod);
    row[kNameBollingerWidth] = IntText(r.BollingerWidth);
    row[kNameReserved] = r.Reserved;
    return row;
}

NameRecord NameRecordOf(const TextRow& in) {
    TextRow row = in;
    row.resize(kNameAllColumns);
    NameRecord r;
    r.Status = Int16Of(row[kNameStatus]);
    r.Code = platform::Upper(Trim(row[kNameCode]));
    r.RecordType = Int16Of(row[kNameType]);
    r.Category = Int16Of(row[kNameCat]);
    r.IndustryClass = row[kNameIndustry];
    r.GicsSector = row[kNameGics];
    r.Name = Trim(row[kNameName]);
    r.OtherDetails = Trim(row[kNameOther]);
    r.Base = FloatOf(row[kNameBase]);
    r.Top = FloatOf(row[kNameTop]);
    r.PFIncrement = FloatOf(row[kNamePFInc]);
    r.Id = Trim(row[kNameId]);
    // A row added in the grid carries no hidden fields: it gets those of a new entry.
    r.ScaleStep = Trim(row[kNameScaleStep]).empty() ? 0.05f : FloatOf(row[kNameScaleStep]);
    r.PercentBandUp = Int16Of(row[kNameBandUp]);
    r.PercentBandDown = Int16Of(row[kNameBandDown]);
    r.BollingerPeriod = Int16Of(row[kNameBollingerPeriod]);
    r.BollingerWidth = Int16Of(row[kNameBollingerWidth]);
    r.Reserved = row[kNameReserved];
    return r;
}

std::optional<RowRefusal> CheckNameRows(const std::vector<TextRow>& rows) {
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const TextRow& row = rows[i];
        const std::string code = row.size() > kNameCode ? Trim(row[kNameCode]) : "";
        const std::string type = row.size() > kNameType ? Trim(row[kNameType]) : "";
        const int r = static_cast<int>(i);
        if (!type.empty() && code.empty())
            return RowRefusal{r, kNameCode, std::string(nt::kCodeMissing),
                              std::string(nt::kFileTitle)};
        if (!code.empty() && !WholeIn(type, 1, 5))
            return RowRefusal{r, kNameType, std::string(nt::kTypeMissing),
                              std::string(nt::kFileTitle)};
        // A code that cannot name a price file is refused here too, before anything is written.
        if (!code.empty() && !IsValidCode(code))
            return RowRefusal{r, kNameCode, "Invalid Code", std::string(nt::kFileTitle)};
    }
    return std::nullopt;
}

std::vector<NameRecord> NameRecordsToSave(const std::vector<TextRow>& rows) {
    std::vector<NameRecord> out;
    out.reserve(rows.size());
    for (const TextRow& row : rows) {
        if (row.size() <= kNameCode || Trim(row[kNameCode]).empty()) continue;
        NameRecord r = NameRecordOf(row);
        r.Status = 0;
        out.push_back(std::move(r));
    }
    return out;
}

Status SaveNameFile(std::string_view dataFolder, const std::vector<NameRecord>& records) {
    NameFile file(NameFile::PathIn(dataFolder));
    return file.WriteAll(records, {"Names.dat.new", "names.bak"});
}

namespace {

// The key text of an order from the fields it reads.
NameSortKey MakeKey(std::string_view code, std::string_view industry, std::string_view gics,
                    std::int16_t category, std::int16_t type, NameSortOrder order) {
    std::string text;
    switch (order) {
    case NameSortOrder::Code:
        text = Trim(code);
        break;
    case NameSortOrder::Industry:
        text = Trim(industry) + Trim(code);
        break;
    case NameSortOrder::Gics:
        text = Trim(gics) + Trim(code);
        break;
    case NameSortOrder::Category: {
        char lead[8];
        // "000" of the category, as the format gives a number of up to three digits.
        if (category >= 0 && category <= 999)
            std::snprintf(lead, sizeof lead, "%03d", static_cast<int>(category));
        else
            std::snprintf(lead, sizeof lead, "%s", platform::Format(category, "000").c_str());
        text = std::string(lead) + std::to_string(type) + Trim(code);
        break;
    }
    }
    NameSortKey key;
    key.fill(' ');
    std::memcpy(key.data(), text.data(), std::min(text.size(), key.size()));
    return key;
}

struct KeyEntry {
    NameSortKey Key;
    std::size_t Index;
};

void SortKeys(std::vector<KeyEntry>& keys) {
    ShellSort(keys, [](const KeyEntry& a, const KeyEntry& b) {
        return std::memcmp(a.Key.data(), b.Key.data(), a.Key.size()) < 0;
    });
}

std::int16_t Int16At(const char* p) {
    return static_cast<std::int16_t>(static_cast<unsigned char>(p[0]) |
                                     (static_cast<unsigned char>(p[1]) << 8));
}

} // namespace

NameSortKey SortKeyOf(const NameRecord& r, NameSortOrder order) {
    return MakeKey(r.Code, r.IndustryClass, r.GicsSector, r.Category, r.RecordType, order);
}

std::vector<NameRecord> SortNameRecords(const std::vector<NameRecord>& records,
                                        NameSortOrder order) {
    std::vector<KeyEntry> keys;
    keys.reserve(records.size());
    for (std::size_t i = 0; i < records.size(); ++i)
        if (records[i].Status != 1) keys.push_back({SortKeyOf(records[i], order), i});
    SortKeys(keys);
    std::vector<NameRecord> out;
    out.reserve(keys.size());
    for (const KeyEntry& e : keys)
        out.push_back(records[e.Index]);
    return out;
}

namespace {

// A scratch file of the editor: written whole, no back-up; it holds nothing the user keeps.
Status WriteScratch(const std::filesystem::path& path, const std::string& bytes) {
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    if (!out.write(bytes.data(), static_cast<std::streamsize>(bytes.size())) || !out.flush())
        return Status::Error("Cannot write " + path.string());
    return Status::Ok();
}

// The sort on the records as the scratch file holds them: keys read from their fields in
// place, whole records copied in key order, those with `Status` 1 left out.
std::string SortedRecordBytes(const std::string& bytes, NameSortOrder order) {
    constexpr std::size_t size = NameRecord::kSize;
    const std::size_t n = bytes.size() / size;
    std::vector<KeyEntry> keys;
    keys.reserve(n);
    for (std::size_t i = 0; i < n; ++i) {
        const char* p = bytes.data() + i * size;
        if (Int16At(p) == 1) continue;
        keys.push_back(
            {MakeKey({p + 2, 6}, {p + 87, 3}, {p + 90, 4}, Int16At(p + 84), Int16At(p + 8), order),
             i});
    }
    SortKeys(keys);
    std::string out;
    out.reserve(keys.size() * size);
    for (const KeyEntry& e : keys)
        out.append(bytes, e.Index * size, size);
    return out;
}

} // namespace

Status SortNamesThroughFiles(std::string_view dataFolder, const std::vector<NameRecord>& records,
                             NameSortOrder order, platform::Progress& progress,
                             std::vector<NameRecord>& sorted) {
    if (records.size() > static_cast<std::size_t>(kMaxRecords))
        return Status::Error("The name file can hold at most 32767 records.");
    const auto wk2 = platform::ResolveIn(dataFolder, "Temp.WK2");
    const auto wk1 = platform::ResolveIn(dataFolder, "Temp.Wk1");
    progress.SetRange(100);
    std::string bytes;
    bytes.reserve(records.size() * NameRecord::kSize);
    for (const auto& r : records) {
        const auto b = r.Encode();
        bytes.append(b.data(), b.size());
    }
    if (auto s = WriteScratch(wk2, bytes); !s) return s;
    progress.SetValue(40);
    const auto fromFile = platform::ReadWholeFile(wk2);
    if (!fromFile) return Status::Error("Cannot read " + wk2.string());
    if (auto s = WriteScratch(wk1, SortedRecordBytes(*fromFile, order)); !s) return s;
    progress.SetValue(60);
    std::error_code ec;
    std::filesystem::rename(wk1, wk2, ec);
    if (ec) return Status::Error("Cannot replace " + wk2.string() + ": " + ec.message());
    progress.SetValue(95);
    return NameFile(wk2).ReadAll(sorted);
}

bool RowsInCodeOrder(const std::vector<TextRow>& rows) {
    for (std::size_t i = 1; i < rows.size(); ++i)
        if (Trim(rows[i][kNameCode]) < Trim(rows[i - 1][kNameCode])) return false;
    return true;
}

namespace {
template <typename Pred> int RemoveRowsIf(std::vector<TextRow>& rows, Pred pred) {
    const auto before = rows.size();
    rows.erase(std::remove_if(rows.begin(), rows.end(), pred), rows.end());
    return static_cast<int>(before - rows.size());
}
} // namespace

int RemoveDuplicateCodes(std::vector<TextRow>& rows) {
    if (rows.empty()) return 0;
    std::vector<TextRow> kept;
    kept.reserve(rows.size());
    kept.push_back(std::move(rows[0]));
    int removed = 0;
    for (std::size_t i = 1; i < rows.size(); ++i) {
        if (platform::Upper(Trim(rows[i][kNameCode])) ==
            platform::Upper(Trim(kept.back()[kNameCode]))) {
            ++removed;
            continue;
        }
        kept.push_back(std::move(rows[i]));
    }
    rows = std::move(kept);
    return removed;
}

int RemoveWarrantRows(std::vector<TextRow>& rows) {
    return RemoveRowsIf(rows, [](const TextRow& r) {
        const auto cat = CellNumber(r[kNameCat]);
        return Trim(r[kNameCode]).size() == 6 && cat && *cat >= 80 && *cat <= 89;
    });
}

void WriteNoWarrantKeys(platform::IniFile& ini) {
    platform::IniFile::Batch batch(ini);
    (void)ini.Write("Download", "NoWarrants", "true");
    (void)ini.Write("Download", "UpdateAll ", "false");
}

int RemoveExpiredOptionRows(std::vector<TextRow>& rows) {
    return RemoveRowsIf(rows, [](const TextRow& r) { return Trim(r[kNameOther]) == nt::kExpired; });
}

void CleanOptionalDetails(std::vector<TextRow>& rows) {
    for (TextRow& r : rows)
        r[kNameBase] = r[kNameTop] = r[kNamePFInc] = "";
}

std::string TitleCase(std::string_view text) {
    std::string out(text);
    bool wordStart = true;
    for (char& c : out) {
        const auto u = static_cast<unsigned char>(c);
        if (c == ' ') {
            wordStart = true;
            continue;
        }
        c = static_cast<char>(wordStart ? std::toupper(u) : std::tolower(u));
        wordStart = false;
    }
    return out;
}

void TitleCaseNames(std::vector<TextRow>& rows) {
    for (TextRow& r : rows)
        r[kNameName] = TitleCase(r[kNameName]);
}

namespace {

// A word of an option's name that is its expiry: d/m/yy, d/m/yyyy, yyyymmdd or ddMMMyy.
std::optional<platform::CivilDate> ExpiryOf(const std::string& word) {
    int d = 0, m = 0, y = 0;
    char tail = 0;
    if (std::sscanf(word.c_str(), "%d/%d/%d%c", &d, &m, &y, &tail) == 3) {
        if (y < 100) y += 2000;
    } else if (word.size() == 8 && platform::IsValidDateText(word)) {
        return platform::ParseDateText(word);
    } else if (word.size() == 7 && std::isdigit(static_cast<unsigned char>(word[0])) &&
               std::isdigit(static_cast<unsigned char>(word[5]))) {
        static const char* months[] = {"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                                       "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};
        const std::string mon = platform::Upper(word.substr(2, 3));
        for (int i = 0; i < 12; ++i)
            if (mon == months[i]) m = i + 1;
        d = std::atoi(word.substr(0, 2).c_str());
        y = 2000 + std::atoi(word.substr(5, 2).c_str());
    } else {
        return std::nullopt;
    }
    if (m < 1 || m > 12 || d < 1 || y < 1 || y > 9999 || d > platform::DaysInMonth(y, m))
        return std::nullopt;
    return platform::CivilDate{y, m, d};
}

} // namespace

std::optional<std::string> OptionDetailsFromName(std::string_view name) {
    std::istringstream words{std::string(name)};
    std::string date, strike, kind;
    for (std::string w; words >> w;) {
        const std::string up = platform::Upper(w);
        if (up == "CALL") {
            kind = "OC";
        } else if (up == "PUT") {
            kind = "OP";
        } else if (auto e = ExpiryOf(w); e && date.empty()) {
            date = std::to_string(e->day) + "/" + std::to_string(e->month) + "/" +
                   platform::Format(e->year % 100, "00");
        } else if (const auto v = CellNumber(w); v && strike.empty()) {
            strike = platform::Format(*v, "0.####"); // no trailing zeros: the field is short
            if (strike.back() == '.') strike.pop_back();
        }
    }
    if (kind.empty()) return std::nullopt;
    const auto join = [](std::initializer_list<const std::string*> parts) {
        std::string out;
        for (const std::string* part : parts) {
            if (part->empty()) continue;
            if (!out.empty()) out += ' ';
            out += *part;
        }
        return out;
    };
    // The strike goes when all three do not fit the 15 characters of the field.
    std::string out = join({&date, &strike, &kind});
    if (out.size() > 15) out = join({&date, &kind});
    return out;
}

int RefreshOptionDetails(std::vector<TextRow>& rows) {
    int changed = 0;
    for (TextRow& r : rows)
        if (const auto details = OptionDetailsFromName(r[kNameName]);
            details && *details != r[kNameOther]) {
            r[kNameOther] = *details;
            ++changed;
        }
    return changed;
}

int UpdateNamesFromMaster(std::vector<TextRow>& rows,
                          const std::map<std::string, std::string>& master) {
    int changed = 0;
    for (TextRow& r : rows) {
        const auto it = master.find(Trim(r[kNameCode]));
        if (it == master.end()) continue;
        std::string name = it->second;
        std::erase(name, ',');
        name = Trim(name.substr(0, NameRecord::kNameWidth));
        if (name.empty() || name == r[kNameName]) continue;
        r[kNameName] = name;
        ++changed;
    }
    return changed;
}

int CopyClassFromUnderlying(std::vector<TextRow>& rows) {
    std::map<std::string, std::string> classes;
    for (const TextRow& r : rows)
        if (const std::string code = Trim(r[kNameCode]); code.size() == 3)
            classes.emplace(code, Trim(r[kNameIndustry]));
    int changed = 0;
    for (TextRow& r : rows) {
        const std::string code = Trim(r[kNameCode]);
        if (code.size() <= 3) continue;
        const auto it = classes.find(code.substr(0, 3));
        if (it == classes.end() || it->second.empty() || it->second == Trim(r[kNameIndustry]))
            continue;
        r[kNameIndustry] = it->second;
        ++changed;
    }
    return changed;
}

int UpdateGicsSectors(std::vector<TextRow>& rows,
                      const std::map<std::string, std::string>& sectors) {
    int changed = 0;
    for (TextRow& r : rows) {
        const auto it = sectors.find(Trim(r[kNameCode]));
        if (it == sectors.end()) continue;
        const std::string digits = Trim(it->second);
        if (digits.empty() || digits.size() > 4 ||
            !std::all_of(digits.begin(), digits.end(),
                         [](unsigned char c) { return std::isdigit(c) != 0; }) ||
            platform::Val(digits) == 0)
            continue;
        const std::string sector = platform::Format(platform::Val(digits), "0000");
        if (sector == Trim(r[kNameGics])) continue;
        r[kNameGics] = sector;
        ++changed;
    }
    return changed;
}

std::optional<std::int16_t> CategoryAnswer(std::string_view text) {
    if (const auto v = WholeIn(text, 0, 99)) return static_cast<std::int16_t>(*v);
    return std::nullopt;
}

std::optional<std::int16_t> RecordTypeAnswer(std::string_view text) {
    if (const auto v = WholeIn(text, 4, 5)) return static_cast<std::int16_t>(*v);
    return std::nullopt;
}

std::string DeleteRowsQuestion(int first, int last) {
    if (first == last)
        return std::string(delete_text::kRow) + std::to_string(first) +
               std::string(delete_text::kRowEnd);
    return std::string(delete_text::kItems) + std::to_string(first) +
           std::string(delete_text::kTo) + std::to_string(last);
}

} // namespace kori::store
