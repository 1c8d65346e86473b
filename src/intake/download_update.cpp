#include "intake/download_update.h"

#include "intake/download_list.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "store/security_walk.h"

#include <algorithm>
#include <cmath>
#include <fcntl.h>
#include <map>
#include <optional>
#include <sys/stat.h>
#include <unistd.h>

namespace kori::intake {

namespace fs = std::filesystem;
using platform::Answer;
using platform::Buttons;
using platform::Status;
using platform::Trim;
using platform::Upper;
using platform::Val;
using store::NameRecord;
using store::PriceRecord;

std::string_view StateName(FileState state) {
    switch (state) {
    case FileState::Normal:
        return "normal";
    case FileState::Insert:
        return "insert";
    case FileState::Replace:
        return "replace";
    case FileState::Cancelled:
        return "cancelled";
    }
    return "normal";
}

const std::array<Segment, 8>& Segments() {
    static const std::array<Segment, 8> segments = {{
        {"INDICES ", ".dix", kIndicesFolder, 5, "X", ""},
        {"OVERSEAS ", ".dov", kOverseasFolder, 4, "V",
         "Overseas folder has not been set. Use Folder Locations to set the folder."},
        {"EQUITIES ", ".dsu", kStocksFolder, 4, "S",
         "Australian Stocks folder has not been set. Use Folder Locations to set the folder."},
        {"FUTURES ", ".dsf", kFuturesFolder, 4, "F",
         "Futures folder has not been set. Use Folder Locations to set the folder. "},
        {"OPTIONS ", ".dop", kOptionsFolder, 4, "P",
         "Options folder has not been set. Use Folder Locations to set the folder. "},
        {"UK STOCKS ", ".dls", kUkStocksFolder, 4, "S",
         "UK Stocks folder has not been set. Use Folder Locations to set the folder. "},
        {"UK INDICES ", ".dlx", kUkIndicesFolder, 5, "X",
         "UK Indices folder has not been set. Use Folder Locations to set the folder. "},
        {"LIFFE FUTURES ", ".dlf", kLiffeFolder, 5, "F",
         "Liffe Futures folder has not been set. Use Folder Locations to set the folder. "},
    }};
    return segments;
}

namespace {

// A record's date as a number: eight digits read directly, anything else as Val reads it.
double DateNumber(std::string_view date) {
    if (date.size() >= 8) {
        double v = 0;
        bool digits = true;
        for (std::size_t i = 0; i < 8 && digits; ++i) {
            digits = date[i] >= '0' && date[i] <= '9';
            v = v * 10 + (date[i] - '0');
        }
        if (digits && (date.size() == 8 || date[8] == ' ')) return v;
    }
    return Val(date);
}

// The first `count` records of a price file as bytes, in one read.
// The records of a price file from record `From` to the last, read further back on demand: an
// insert near the end reads and rewrites only the part from its place on.
struct FileTail {
    const fs::path& Path;
    int Count;
    int From;          // 1-based; Count + 1 while nothing is read
    std::string Bytes; // records From..Count

    // Reads back to record `n` (at least doubling what is held, so a long walk reads the file
    // a few times at most). False on a read error.
    bool Reach(int n) {
        if (n >= From || Count == 0) return true;
        const int held = Count - From + 1;
        const int start = std::max(1, std::min(n, From - std::max(held, 64)));
        std::string more(static_cast<std::size_t>(From - start) * 50, '\0');
        const int fd = ::open(Path.c_str(), O_RDONLY | O_CLOEXEC);
        if (fd < 0) return false;
        std::size_t done = 0;
        const off_t at = static_cast<off_t>(start - 1) * 50;
        while (done < more.size()) {
            const ssize_t r =
                ::pread(fd, more.data() + done, more.size() - done, at + static_cast<off_t>(done));
            if (r <= 0) break;
            done += static_cast<std::size_t>(r);
        }
        ::close(fd);
        if (done != more.size()) return false;
        Bytes.insert(0, more);
        From = start;
        return true;
    }
    // Offset in Bytes of record `n` (held).
    std::size_t At(int n) const { return static_cast<std::size_t>(n - From) * 50; }
};

std::string Right(std::string_view s, std::size_t n) {
    return std::string(s.size() > n ? s.substr(s.size() - n) : s);
}

// "d/m/yy" of a date text, as the options' details hold their expiry.
std::string ShortDate(const std::string& yyyymmdd) {
    const auto d = platform::ParseDateText(yyyymmdd);
    if (!d) return {};
    const int yy = d->year % 100;
    return std::to_string(d->day) + "/" + std::to_string(d->month) + "/" + (yy < 10 ? "0" : "") +
           std::to_string(yy);
}

// The serial of a "d/m/yy" text; two-digit years 0 to 29 are of this century.
std::optional<std::int32_t> ShortDateSerial(std::string_view text) {
    const std::string t = Trim(text);
    const auto first = t.find('/');
    const auto second = first == std::string::npos ? first : t.find('/', first + 1);
    if (second == std::string::npos) return std::nullopt;
    const int day = static_cast<int>(Val(t.substr(0, first)));
    const int month = static_cast<int>(Val(t.substr(first + 1, second - first - 1)));
    int year = static_cast<int>(Val(t.substr(second + 1)));
    if (year < 100) year = ShortDateYear(year);
    return platform::DaySerial(platform::DateText({year, month, day}));
}

std::string CommaProblemText(const std::string& path, std::string_view line, bool options) {
    return " There is a problem with " + path +
           "\n There is an incorrect number of fields in the record"
           "\n There should be 7 commas seperating 8 fields\n" +
           (options ? " code,date,open,high,low,close,vol,days,OptType"
                    : " code,date,open,high,low,close,vol,spare") +
           "\nMAKE SURE THE DOWNLOADED DATA IS SET UP FOR KORI FORMAT"
           "\n The first incorrect record found was \n" +
           std::string(line) + "\n\nCorrect and retry";
}

// Service 4's clean-up: blank lines are dropped through IData.tmp. The file is rewritten only
// when there is one to drop.
Status DropBlankLines(const fs::path& path, std::string& text) {
    std::string kept;
    bool dropped = false;
    for (const auto line : SplitLines(text)) {
        if (Trim(line).empty()) {
            dropped = true;
            continue;
        }
        kept.append(line);
        kept += "\r\n";
    }
    if (!dropped) return Status::Ok();
    if (auto s = platform::WriteFileAtomic(path, kept, {"IData.tmp", ""}); !s) return s;
    text = std::move(kept);
    return Status::Ok();
}

// Step 5 of the check: how `newDate` stands against a security's file.
FileState StateAgainst(const fs::path& priceFile, std::int16_t count, double newDate,
                       std::string& text) {
    store::PriceFile pf(priceFile);
    if (!pf.Open()) return FileState::Normal;
    PriceRecord last;
    if (!pf.Read(count, last)) return FileState::Normal;
    const double lastDate = Val(last.Date);
    if (newDate > lastDate) return FileState::Normal;
    if (newDate == lastDate) {
        text = " There is already data on file with this date\n  New data will replace the old "
               "data";
        return FileState::Replace;
    }
    std::vector<PriceRecord> all;
    if (!pf.ReadAll(all)) return FileState::Normal;
    for (int i = static_cast<int>(all.size()) - 2; i >= 0; --i) {
        const double d = Val(all[static_cast<std::size_t>(i)].Date);
        if (d > newDate) continue;
        if (d == newDate) {
            text = " There is already data on file for this date\n  New data will replace the "
                   "old data";
            return FileState::Replace;
        }
        text = " There is already data on file LATER than this date\n This procedure will "
               "insert the data in the correct position \n The update will take a little "
               "longer than usual";
        return FileState::Insert;
    }
    return FileState::Normal;
}

} // namespace

CheckResult CheckDownloadFile(const fs::path& path, const CheckInput& input,
                              platform::Dialogs& dialogs, platform::Progress& progress) {
    CheckResult r;
    r.SkipPrompt = input.SkipPrompt;
    progress.SetStatus(" Checking file format - wait");
    const std::string shown = path.string();
    const auto size = platform::FileSizeOr0(path);
    if (size < 8) {
        std::string text = "There is no data in " + shown + "\n";
        if (input.DataService == 1 && size == 0)
            text += "Use Convert Mainfile Data routine in KORI/Zevot Download to reprocess data";
        else if (input.DataService == 3)
            text += "Use Unzip/Convert Data in KORI Downloader to reprocess";
        dialogs.MsgBox(text, "Data Update");
        r.State = FileState::Cancelled;
        r.EmptyFile = true;
        r.Error = "There is no data in " + shown;
        return r;
    }
    auto content = platform::ReadWholeFile(path);
    if (!content) {
        r.State = FileState::Cancelled;
        r.Error = "Cannot read " + shown;
        dialogs.MsgBox(r.Error, "Download Data Update");
        return r;
    }
    if (input.DataService == 4) {
        if (auto s = DropBlankLines(path, *content); !s) {
            r.State = FileState::Cancelled;
            r.Error = s.message();
            dialogs.MsgBox(r.Error, "Download Data Update");
            return r;
        }
    }
    const auto lines = SplitLines(*content);
    if (lines.size() > static_cast<std::size_t>(store::kMaxRecords)) {
        r.State = FileState::Cancelled;
        r.Error = shown + " holds " + std::to_string(lines.size()) +
                  " lines; a day file can hold at most 32767.";
        dialogs.MsgBox(r.Error, "Download Data Update");
        return r;
    }
    // The whole file is read before anything is written: one bad line stops it all.
    const int commas = input.OptionsFile ? 8 : 7;
    r.Lines.reserve(lines.size());
    for (const auto line : lines) {
        if (CountCommas(line) != commas) {
            r.State = FileState::Cancelled;
            r.Error = CommaProblemText(shown, line, input.OptionsFile);
            dialogs.MsgBox(r.Error, "Download Data Update");
            return r;
        }
        r.Lines.push_back(ParseDownloadLine(line));
        const auto& d = r.Lines.back();
        // A date that is not yyyymmdd would put the file out of order for good.
        if (!ArrivalCode(d.Code).empty() && !IsEightDigitDate(d.Date)) {
            r.State = FileState::Cancelled;
            r.Error = " There is a problem with " + shown +
                      "\n The date of a record is not 8 digits (yyyymmdd)"
                      "\n The first incorrect record found was \n" +
                      std::string(line) + "\n\nCorrect and retry";
            dialogs.MsgBox(r.Error, "Download Data Update");
            return r;
        }
    }

    // The decision rests on one security that is on file.
    std::string seek;
    if (input.Segment == "INDICES ") seek = "XAO";
    if (input.Segment == "OVERSEAS ") seek = "DJIEZ";
    std::string text;
    for (std::size_t i = 0; i < r.Lines.size(); ++i) {
        const auto& d = r.Lines[i];
        const std::string code = ArrivalCode(d.Code);
        if (!seek.empty() && !platform::EqualsNoCase(code, seek)) continue;
        if (code.empty()) {
            r.StartLine = i + 1;
            break;
        }
        const auto priceFile = store::PriceFile::PathFor(input.TargetFolder, code);
        std::int16_t count = 0;
        if (priceFile.empty() || !platform::FileHasData(priceFile) ||
            !store::CountRecords(priceFile, PriceRecord::kSize, count) || count < 1)
            continue;
        r.State = StateAgainst(priceFile, count, Val(d.Date), text);
        break;
    }
    if (r.State == FileState::Replace && input.DataService == 3) {
        r.IntraDay = !input.DateStem.empty() && Upper(Trim(input.IntraDay)) == input.DateStem;
        if (r.IntraDay) r.SkipPrompt = true;
    }
    if (input.Segment == "EQUITIES " && input.SharedStocksIndices && !r.IntraDay)
        r.SkipPrompt = true;
    if (r.State != FileState::Normal && !r.SkipPrompt) {
        const Answer a =
            dialogs.MsgBox(text, input.TargetFolder + input.Segment, Buttons::OkCancel);
        if (a != Answer::Ok) r.State = FileState::Cancelled;
    }
    return r;
}

InsertPosition FindInsertPosition(const std::vector<double>& dates, double newDate,
                                  FileState state) {
    return FindInsertPosition(
        static_cast<int>(dates.size()),
        [&](int n) { return dates[static_cast<std::size_t>(n - 1)]; }, newDate, state);
}

InsertPosition FindInsertPosition(int count, const std::function<double(int)>& dateAt,
                                  double newDate, FileState state) {
    bool laterRecordSeen = false;
    for (int i = count; i >= 1; --i) {
        const double d = dateAt(i);
        if (newDate < d) {
            if (i == 1) return {1, false};
            laterRecordSeen = true;
        } else if (newDate == d) {
            if (state == FileState::Replace) return {i, true};
            laterRecordSeen = true;
        } else {
            // Later than record 1 goes ahead of it: the rule as the files have always had it.
            if (i == 1) return {1, false};
            if (i == count) return {count + 1, false};
            if (laterRecordSeen) return {i + 1, false};
        }
    }
    // Equal to record 1 in an insert: the new record goes ahead of it.
    return {1, false};
}

namespace {

// One run over one or more files of a day.
class DownloadRun {
public:
    DownloadRun(UpdateSettings& settings, const UpdateHost& host, const UpdateHooks& hooks,
                std::string updateDate)
        : m_s(settings), m_host(host), m_hooks(hooks), m_updateDate(std::move(updateDate)) {}

    RunResult Run(const std::string& fileName, bool moreFilesFollow);

private:
    enum class Next { Go, EndRun };
    struct Target {
        std::string Folder;
        std::string Segment; // label, empty outside the bundle service
        std::int16_t RecordType = 4;
        std::string Letter;
        bool Options = false;
    };

    void Status(std::string_view text) { m_host.Progress.SetStatus(text); }
    void LoadUpdateList();
    Next UpdateFromFile(const fs::path& path, const Target& target);
    // False when a file error stopped the update.
    bool ApplyDownloadRecord(const DownloadLine& d, const std::string& code, const Target& target,
                             SegmentResult& seg);
    bool CreateSecurity(const DownloadLine& d, const std::string& code, const Target& target,
                        fs::path& path, SegmentResult& seg);
    bool Fail(const std::string& message);
    bool Filtered(const std::string& code) const;
    // Names.dat of the target folder: codes and record types, read once a target.
    const std::map<std::string, std::int16_t>& NameTypes(const std::string& folder);

    UpdateSettings& m_s;
    const UpdateHost& m_host;
    const UpdateHooks& m_hooks;
    std::string m_updateDate;
    RunResult m_result;
    std::set<std::string> m_updateList;
    bool m_intraDay = false;
    bool m_skipPrompt = false;
    bool m_sharedStocksIndices = false;
    FileState m_state = FileState::Normal;
    std::string m_stem;
    // The record type the next record is written by: the name record read last.
    std::int16_t m_recordType = 4;
    std::string m_namesFolder;
    std::map<std::string, std::int16_t> m_names;
};

void DownloadRun::LoadUpdateList() {
    const auto text = platform::ReadWholeFile(platform::ResolveIn(m_s.SystemFolder, "Update.Lst"));
    if (!text) return;
    for (const auto line : SplitLines(*text)) {
        const auto fields = SplitFields(line);
        const std::string code = Upper(Trim(fields.empty() ? "" : fields[0]));
        if (!code.empty()) m_updateList.insert(code);
    }
}

bool DownloadRun::Filtered(const std::string& code) const {
    if (m_s.DataService < 2 || m_s.DataService > 5) return false;
    if (!m_s.UpdateAll) return m_updateList.count(code) == 0;
    if (m_s.NoWarrants && code.size() == 6)
        return std::string_view("WIEXSD").find(code[3]) != std::string_view::npos;
    return false;
}

const std::map<std::string, std::int16_t>& DownloadRun::NameTypes(const std::string& folder) {
    if (m_namesFolder == folder) return m_names;
    m_names.clear();
    m_namesFolder = folder;
    std::vector<NameRecord> names;
    store::NameFile nf(store::NameFile::PathIn(folder));
    if (nf.ReadAll(names))
        for (const auto& n : names)
            m_names.emplace(n.TrimmedCode(), n.RecordType);
    return m_names;
}

bool DownloadRun::Fail(const std::string& message) {
    m_host.Dialogs.MsgBox(message, "Downloaded Data");
    m_result.Failed = true;
    return false;
}

bool DownloadRun::ApplyDownloadRecord(const DownloadLine& d, const std::string& code,
                                      const Target& target, SegmentResult& seg) {
    // The exact name first (one stat); the case-blind search only when it is not there.
    fs::path path = target.Folder + code + ".WDT";
    struct stat st {};
    if (::stat(path.c_str(), &st) != 0) {
        path = store::PriceFile::PathFor(target.Folder, code);
        if (::stat(path.c_str(), &st) != 0) {
            if (!CreateSecurity(d, code, target, path, seg)) return false;
            st.st_size = 0;
        }
    }
    if (m_s.DataService == 1) {
        const auto& names = NameTypes(target.Folder);
        if (const auto it = names.find(code); it != names.end()) m_recordType = it->second;
    }
    const long long whole = static_cast<long long>(st.st_size) / 50;
    if (whole > store::kMaxRecords) {
        const std::string text = path.filename().string() + " holds " + std::to_string(whole) +
                                 " records; a file can hold at most 32767. " + code +
                                 " was not updated.";
        m_host.Dialogs.MsgBox(text, "Downloaded Data");
        m_result.Issues.push_back({platform::Severity::Error, text, path.filename().string(), 0});
        return true;
    }
    const int count = static_cast<int>(whole);
    const bool searched = m_state == FileState::Insert || m_state == FileState::Replace;
    const bool correctVolume = !target.Options && d.Spare != 0;
    const bool rerunLevels = m_recordType == 3 && searched;

    // The file's records from where the new one goes, read only when it does not simply go on
    // the end.
    FileTail tail{path, count, count + 1, {}};
    bool readFailed = false;
    auto reach = [&](int n) {
        if (!tail.Reach(n)) readFailed = true;
        return !readFailed;
    };
    auto dateAt = [&](int n) {
        return reach(n) ? DateNumber({tail.Bytes.data() + tail.At(n), 8}) : 0.0;
    };
    auto cannotRead = [&] { return Fail("Cannot read " + path.string()); };

    double level = 0; // the running advance/decline total
    if (m_recordType == 3 && count > 0) {
        if (!reach(count)) return cannotRead();
        level = PriceRecord::Decode(tail.Bytes.data() + tail.At(count)).Close;
    }
    InsertPosition at{count + 1, false};
    if (searched && count > 0) {
        at = FindInsertPosition(count, dateAt, DateNumber(d.Date), m_state);
        if (readFailed) return cannotRead();
    }
    if (!at.Overwrite && count >= store::kMaxRecords) {
        const std::string text = path.filename().string() +
                                 " holds 32767 records; a file can hold at most 32767. " + code +
                                 " was not updated.";
        m_host.Dialogs.MsgBox(text, "Downloaded Data");
        m_result.Issues.push_back({platform::Severity::Error, text, path.filename().string(), 0});
        return true;
    }

    PriceRecord rec;
    rec.Date = d.Date;
    switch (m_recordType) {
    case 2:
        rec.Open = d.Open, rec.High = d.High, rec.Low = d.Low, rec.Close = d.Close;
        break;
    case 3:
        rec.High = d.High, rec.Low = d.Low;
        rec.Close = static_cast<float>(level + d.High - d.Low);
        rec.Volume = d.Volume;
        break;
    default:
        rec.Open = d.Open, rec.High = d.High, rec.Low = d.Low, rec.Close = d.Close;
        rec.Volume = d.Volume;
    }
    rec.Flag = m_intraDay ? "I" : " ";
    const auto encoded = rec.Encode();

    const bool correctHere = correctVolume && at.Position > 1;
    if (!at.Overwrite && at.Position == count + 1 && !correctHere && !rerunLevels) {
        // The everyday case: one record at the end, one write.
        if (auto s = platform::AppendToFile(path, {encoded.data(), encoded.size()}); !s)
            return Fail(s.message());
        ++seg.Records;
        return true;
    }
    // From the record before the new one: the volume correction and the running level read it.
    if (count > 0 && !reach(std::max(1, std::min(count, at.Position - 1)))) return cannotRead();
    std::string& bytes = tail.Bytes;
    const std::size_t pos = tail.At(at.Position);
    if (at.Overwrite)
        bytes.replace(pos, 50, encoded.data(), encoded.size());
    else
        bytes.insert(pos, encoded.data(), encoded.size());
    if (correctHere) {
        auto before = PriceRecord::Decode(bytes.data() + pos - 50);
        before.Volume = static_cast<std::int32_t>(
            std::clamp(std::nearbyint(d.Spare), -2147483648.0, 2147483647.0));
        const auto b = before.Encode();
        bytes.replace(pos - 50, 50, b.data(), b.size());
    }
    const std::size_t records = static_cast<std::size_t>(tail.From - 1) + bytes.size() / 50;
    if (rerunLevels && records > 1) {
        double running = at.Position > 1 ? PriceRecord::Decode(bytes.data() + pos - 50).Close : 0;
        for (std::size_t at50 = pos; at50 < bytes.size(); at50 += 50) {
            auto r = PriceRecord::Decode(bytes.data() + at50);
            r.Close = static_cast<float>(running + r.High - r.Low);
            running = r.Close;
            const auto b = r.Encode();
            bytes.replace(at50, 50, b.data(), b.size());
        }
    }
    const auto keep = static_cast<std::uint64_t>(tail.From - 1) * 50;
    if (auto s = platform::ReplaceFileFrom(path, keep, bytes); !s) return Fail(s.message());
    ++seg.Records;
    return true;
}

bool DownloadRun::CreateSecurity(const DownloadLine& d, const std::string& code,
                                 const Target& target, fs::path& path, SegmentResult& seg) {
    Status(" Created record for " + code);
    path = target.Folder + code + ".WDT";
    const auto& names = NameTypes(target.Folder);
    // A name record left by an update that stopped before its price file stays the one.
    if (names.count(code) == 0) {
        NameRecord n;
        n.Code = code;
        n.RecordType = (m_s.DataService == 3 && target.RecordType == 5) ? 5 : 4;
        n.Id = Upper(target.Letter);
        n.Category = target.Segment == "EQUITIES " ? NewEquityCategory(code) : std::int16_t{1};
        if (target.Options)
            n.OtherDetails =
                "0" + d.OptType +
                ShortDate(platform::DateTextFromSerial(platform::DaySerial(d.Date).value_or(0) +
                                                       static_cast<std::int32_t>(d.Spare))
                              .value_or(""));
        const auto namesPath = store::NameFile::PathIn(target.Folder);
        std::int16_t nameCount = 0;
        if (auto s = store::CountRecords(namesPath, NameRecord::kSize, nameCount); !s)
            return Fail(s.message());
        if (nameCount >= store::kMaxRecords)
            return Fail(namesPath.string() + " holds 32767 records; " + code + " cannot be added.");
        const auto bytes = n.Encode();
        if (auto s = platform::AppendToFile(namesPath, {bytes.data(), bytes.size()}); !s)
            return Fail(s.message());
        m_names.emplace(code, n.RecordType);
        m_recordType = n.RecordType;
    }
    if (auto s = platform::AppendToFile(path, {}); !s) return Fail(s.message());
    ++seg.NewSecurities;
    return true;
}

DownloadRun::Next DownloadRun::UpdateFromFile(const fs::path& path, const Target& target) {
    auto& progress = m_host.Progress;
    const std::string shown = path.string();
    Status(target.Folder + " Updating  " + Right(shown, 11));
    SegmentResult seg;
    seg.File = path.filename().string();
    seg.Segment = target.Segment;
    std::int16_t names = 0;
    if (auto s =
            store::CountRecords(store::NameFile::PathIn(target.Folder), NameRecord::kSize, names);
        !s) {
        Fail(s.message());
        return Next::EndRun;
    }
    if (!platform::FileExists(path)) {
        m_host.Dialogs.MsgBox("File does not exist", "Update");
        return Next::EndRun;
    }

    CheckInput in;
    in.DataService = m_s.DataService;
    in.Segment = target.Segment;
    in.TargetFolder = target.Folder;
    in.OptionsFile = target.Options;
    in.SharedStocksIndices = m_sharedStocksIndices;
    in.DateStem = Right(m_stem, 7);
    in.SkipPrompt = m_skipPrompt;
    if (m_host.Store) in.IntraDay = m_host.Store->Get("IntraDay", "");
    const CheckResult check = CheckDownloadFile(path, in, m_host.Dialogs, progress);
    m_state = check.State;
    m_skipPrompt = check.SkipPrompt;
    if (check.State == FileState::Replace && m_s.DataService == 3) m_intraDay = check.IntraDay;
    seg.State = check.State;
    if (!check.Error.empty())
        m_result.Issues.push_back({platform::Severity::Error, check.Error, seg.File, 0});
    if (check.State == FileState::Cancelled) {
        m_result.Files.push_back(seg);
        return m_s.DataService == 3 ? Next::Go : Next::EndRun;
    }

    const auto& lines = check.Lines;
    progress.SetRange(static_cast<long long>(lines.size()));
    Status(" Data OK - updating");
    int sinceYield = 0;
    std::string dayDate;
    for (std::size_t i = check.StartLine; i < lines.size(); ++i) {
        progress.SetValue(static_cast<long long>(i + 1));
        if (++sinceYield > m_s.RefreshFreq) {
            sinceYield = 0;
            progress.Yield();
        }
        if (progress.Cancelled()) {
            m_result.Stopped = true;
            m_result.Files.push_back(seg);
            return Next::EndRun;
        }
        DownloadLine d = lines[i];
        dayDate = d.Date;
        if (m_s.DataService == 4 && m_s.VolumeDivisor != 1 && m_s.VolumeDivisor != 0)
            d.Volume /= m_s.VolumeDivisor;
        const std::string code = ArrivalCode(d.Code);
        if (code.empty()) continue;
        if (!store::IsValidCode(code)) {
            m_result.Issues.push_back({platform::Severity::Warning,
                                       "Invalid Code " + code + " skipped", seg.File,
                                       static_cast<int>(i + 1)});
            continue;
        }
        if (Filtered(code)) continue;
        if (!ApplyDownloadRecord(d, code, target, seg)) {
            m_result.Files.push_back(seg);
            return Next::EndRun;
        }
    }

    const bool fill = !check.EmptyFile && check.State == FileState::Normal;
    if (m_s.DataService != 3) {
        const std::string name = shown;
        if (!name.empty() && (name.back() == 'D' || name.back() == 'd')) {
            const fs::path renamed = name + "X";
            std::error_code ec;
            const auto old = platform::ResolvePath(renamed);
            if (fs::exists(old, ec)) fs::remove(old, ec);
            fs::rename(path, renamed, ec);
            if (!ec) seg.RenamedTo = renamed.filename().string();
        }
    }
    const bool fillHere = m_s.DataService == 3 ? (target.Letter == "S" || target.Letter == "F" ||
                                                  target.Letter == "P")
                                               : m_s.DataService != 1;
    if (fill && fillHere && !dayDate.empty()) {
        progress.SetStatus(" Checking stocks not traded");
        const FillResult f =
            FillNoTradeDays(target.Folder, dayDate, m_updateDate, target.Options, progress);
        seg.Fillers = f.Fillers;
        if (f.Cancelled) m_result.Stopped = true;
        if (!f.Status) {
            Fail(f.Status.message());
            m_result.Files.push_back(seg);
            return Next::EndRun;
        }
    }
    m_result.Files.push_back(seg);
    return m_result.Stopped ? Next::EndRun : Next::Go;
}

RunResult DownloadRun::Run(const std::string& fileName, bool moreFilesFollow) {
    // Thousands of price files may be rewritten: each is still written beside and renamed, so a
    // kill leaves it old or new, but the flush to disk is left to the system's write-back.
    const platform::ScopedSyncDeferral deferral(m_s.DataFolder, false);
    if (m_s.RefreshFreq < 10 || m_s.RefreshFreq > 200) {
        m_s.RefreshFreq = 50;
        if (m_host.Ini) (void)m_host.Ini->Write("Download", "RefreshFreq", "50");
    }
    if (m_s.DataService >= 2 && m_s.DataService <= 5 && !m_s.UpdateAll) LoadUpdateList();

    const fs::path path = platform::ResolveIn(m_s.DownloadFolder, fileName);
    const std::string pathText = path.string();
    m_stem = (path.parent_path() / path.stem()).string();
    std::string adjustFolder = m_s.DataFolder;
    m_result.CurrentDataFolder = m_s.DataFolder;
    bool ended = false;
    if (m_s.DataService == 3) {
        const auto& f = m_s.SegmentFolders;
        if (std::all_of(f.begin(), f.end(), [](const std::string& s) { return Trim(s).empty(); })) {
            m_host.Dialogs.MsgBox("Separate data folders for data have not been defined. Select "
                                  "Folder Locations option and define data folders.",
                                  "Data Folders");
            return m_result;
        }
        m_sharedStocksIndices =
            !Trim(f[kStocksFolder]).empty() && platform::FolderWithSlash(f[kStocksFolder]) ==
                                                   platform::FolderWithSlash(f[kIndicesFolder]);
        for (const auto& segment : Segments()) {
            const auto file = platform::ResolvePath(m_stem + std::string(segment.Extension));
            if (!platform::FileExists(file)) continue;
            const std::string folder = Trim(f[segment.Folder]);
            if (folder.empty()) {
                if (!segment.FolderText.empty())
                    m_host.Dialogs.MsgBox(segment.FolderText, "Data Folders");
                continue;
            }
            Status("Updating " + std::string(segment.Label));
            Target t{platform::FolderWithSlash(folder), std::string(segment.Label),
                     segment.RecordType, std::string(segment.Letter), segment.Label == "OPTIONS "};
            if (UpdateFromFile(file, t) == Next::EndRun) {
                ended = true;
                break;
            }
        }
        if (!ended) {
            std::error_code ec;
            fs::remove(platform::ResolvePath(m_stem + ".d"), ec);
            adjustFolder = platform::FolderWithSlash(Trim(f[kStocksFolder]));
            m_result.CurrentDataFolder = adjustFolder;
            Status("Updated");
        }
    } else {
        Status("Updating ");
        ended = UpdateFromFile(path, Target{m_s.DataFolder, "", 4, "", false}) == Next::EndRun;
    }

    // Finish.
    m_result.LastState = m_state;
    if (m_result.Failed || m_result.Stopped) return m_result;
    if (!moreFilesFollow) Status(" Data files updated with " + pathText);
    if (m_s.DataService == 1 || m_s.DataService == 3) {
        if (m_hooks.UpdateAdjustmentsList)
            m_hooks.UpdateAdjustmentsList(adjustFolder, Right(m_stem, 7));
        if (!m_intraDay) {
            if (m_hooks.RefreshSecurityDetails) m_hooks.RefreshSecurityDetails();
            if (m_hooks.RefreshSecurityProperties) m_hooks.RefreshSecurityProperties();
        }
    }
    if (!moreFilesFollow) {
        m_result.RemoveItem = m_state != FileState::Cancelled;
        Status("FINISHED");
    }
    return m_result;
}

} // namespace

RunResult RunDownloadUpdate(UpdateSettings& settings, const UpdateHost& host,
                            const UpdateHooks& hooks, const std::string& fileName,
                            const std::string& updateDate, bool moreFilesFollow) {
    DownloadRun run(settings, host, hooks, updateDate);
    return run.Run(fileName, moreFilesFollow);
}

FillResult FillNoTradeDays(const std::string& folder, const std::string& dayDate,
                           const std::string& updateDate, bool optionsFile,
                           platform::Progress& progress) {
    FillResult result;
    progress.SetStatus("Checking no-trades");
    const double day = DateNumber(dayDate);
    const auto updateSerial = platform::DaySerial(updateDate);
    store::NameFile names(store::NameFile::PathIn(folder));
    bool namesOpen = false;
    const auto walk =
        store::ForEachSecurity({folder, 0}, progress, [&](const store::WalkItem& item) {
            if (item.Name.Category > 89) return store::WalkStep::Continue;
            if (optionsFile) {
                const std::string aux = Trim(item.Name.OtherDetails);
                auto at = aux.find('P');
                if (at == std::string::npos) at = aux.find('C');
                std::optional<std::string> newName;
                if (at == std::string::npos) {
                    newName = "DETAILS INCOMPLETE - CHECK";
                } else {
                    const auto expiry = ShortDateSerial(aux.substr(at + 1));
                    if (expiry && updateSerial && *expiry - *updateSerial < 1)
                        newName = "**EXPIRED**";
                }
                if (newName) {
                    NameRecord n = item.Name;
                    n.Name = *newName;
                    if (!namesOpen) {
                        if (result.Status = names.Open(); !result.Status)
                            return store::WalkStep::Stop;
                        namesOpen = true;
                    }
                    if (result.Status = names.Write(item.NameRecordNumber, n); !result.Status)
                        return store::WalkStep::Stop;
                    return store::WalkStep::Continue;
                }
            }
            if (item.Name.RecordType != 4) return store::WalkStep::Continue;
            // A full file was refused by the update itself; the fill passes it by.
            const int count = item.PriceRecords;
            if (count < 1 || count >= store::kMaxRecords) return store::WalkStep::Continue;
            std::array<char, 50> lastBytes{};
            struct stat st {};
            const int fd = ::open(item.PriceFile.c_str(), O_RDONLY | O_CLOEXEC);
            const bool read =
                fd >= 0 && ::fstat(fd, &st) == 0 &&
                ::pread(fd, lastBytes.data(), 50, static_cast<off_t>(count - 1) * 50) == 50;
            if (fd >= 0) ::close(fd);
            if (!read) {
                result.Status = Status::Error("Cannot read " + item.PriceFile.string());
                return store::WalkStep::Stop;
            }
            // A file ending in part of a record (reported by the walk) takes nothing on its end.
            if (st.st_size % 50 != 0) return store::WalkStep::Continue;
            const PriceRecord last = PriceRecord::Decode(lastBytes.data());
            if (day <= DateNumber(last.Date)) return store::WalkStep::Continue;
            progress.SetStatus(" Checking " + item.Name.TrimmedCode());
            PriceRecord filler;
            filler.Date = dayDate;
            filler.Open = filler.High = filler.Low = filler.Close = last.Close;
            const auto b = filler.Encode();
            if (result.Status = platform::AppendToFile(item.PriceFile, {b.data(), b.size()});
                !result.Status)
                return store::WalkStep::Stop;
            ++result.Fillers;
            return store::WalkStep::Continue;
        });
    if (!walk.Status) result.Status = walk.Status;
    result.Cancelled = walk.Cancelled;
    return result;
}

} // namespace kori::intake
