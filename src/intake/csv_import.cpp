#include "intake/csv_import.h"

#include "intake/download_line.h"

#include "platform/csv_line.h"
#include "platform/date_entry.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/record_file.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cmath>
#include <limits>
#include <map>
#include <optional>
#include <sstream>

namespace kori::intake {

namespace fs = std::filesystem;
using platform::Trim;

namespace {

constexpr std::array<const char*, 6> kColumns = {"Date", "Open", "High", "Low", "Close", "Volume"};
enum Col { DateCol, OpenCol, HighCol, LowCol, CloseCol, VolumeCol };

bool AllDigits(std::string_view s) {
    return !s.empty() && std::all_of(s.begin(), s.end(), [](char c) {
        return std::isdigit(static_cast<unsigned char>(c));
    });
}

// yyyy-mm-dd, yyyymmdd or d/m/yyyy to "yyyymmdd"; nullopt when it is none of them or no date.
std::optional<std::string> CsvDate(std::string_view text) {
    const std::string t = Trim(text);
    std::string out;
    if (t.size() == 10 && t[4] == '-' && t[7] == '-') {
        out = t.substr(0, 4) + t.substr(5, 2) + t.substr(8, 2);
    } else if (t.size() == 8 && AllDigits(t)) {
        out = t;
    } else {
        const auto a = t.find('/'), b = t.find('/', a == std::string::npos ? a : a + 1);
        if (a == std::string::npos || b == std::string::npos) return std::nullopt;
        const std::string d = t.substr(0, a), m = t.substr(a + 1, b - a - 1), y = t.substr(b + 1);
        if (d.empty() || d.size() > 2 || m.empty() || m.size() > 2 || y.size() != 4 ||
            !AllDigits(d) || !AllDigits(m) || !AllDigits(y))
            return std::nullopt;
        out = y + (m.size() == 1 ? "0" : "") + m + (d.size() == 1 ? "0" : "") + d;
    }
    if (!AllDigits(out) || !platform::IsValidDateText(out)) return std::nullopt;
    return out;
}

std::string Quoted(std::string_view s) {
    return "\"" + std::string(s) + "\"";
}

// A figure of a line: a number, else the fault.
std::optional<std::string> Figure(const std::string& text, const char* what, float& out) {
    if (!platform::IsNumber(text))
        return std::string("the ") + what + " " + Quoted(Trim(text)) + " is not a number";
    out = static_cast<float>(platform::Val(text));
    return std::nullopt;
}

std::optional<std::string> ShareCount(const std::string& text, std::int32_t& out) {
    if (Trim(text).empty()) {
        out = 0;
        return std::nullopt;
    }
    const double v = platform::IsNumber(text) ? platform::Val(text) : -1;
    if (v < 0 || v > std::numeric_limits<std::int32_t>::max())
        return "the volume " + Quoted(Trim(text)) + " is not a share count";
    out = static_cast<std::int32_t>(std::llround(v));
    return std::nullopt;
}

std::vector<std::string> Lines(std::string_view text) {
    std::vector<std::string> lines;
    std::istringstream in{std::string(text)};
    for (std::string line; std::getline(in, line);) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        lines.push_back(line);
    }
    return lines;
}

std::string ShownDate(const std::string& yyyymmdd) {
    return platform::DateTextToDisplay(yyyymmdd);
}

std::string LimitMessage(const std::string& code, std::size_t records) {
    return code + " would hold " + std::to_string(records) +
           " records; a price file holds at most 32767";
}

// The records of an existing price file; a file whose length is not a whole number of records
// is refused, since rewriting it would drop what the count leaves out.
platform::Status ReadOnFile(const fs::path& path, std::vector<store::PriceRecord>& out) {
    out.clear();
    if (!platform::FileExists(path)) return platform::Status::Ok();
    if (platform::FileSizeOr0(path) % store::PriceRecord::kSize != 0)
        return platform::Status::Error(path.filename().string() +
                                       " is damaged: its length is not a whole number of records");
    return store::PriceFile(path).ReadAll(out);
}

std::string Summary(const MergeCount& c) {
    return std::to_string(c.Added) + " added, " + std::to_string(c.Replaced) + " replaced, " +
           std::to_string(c.Kept) + " already on file";
}

} // namespace

CsvHistory ReadCsvHistory(std::string_view text) {
    CsvHistory h;
    const auto lines = Lines(text);
    std::size_t headerAt = 0;
    while (headerAt < lines.size() && Trim(lines[headerAt]).empty())
        ++headerAt;
    if (headerAt == lines.size()) {
        h.Error = "The file has no header row";
        return h;
    }
    const std::string& header = lines[headerAt];
    const char sep =
        platform::CountSeparators(header, ';') > 0 && platform::CountSeparators(header, ',') == 0
            ? ';'
            : ',';
    std::array<int, kColumns.size()> at;
    at.fill(-1);
    const auto names = platform::SplitQuoted(header, sep);
    for (std::size_t i = 0; i < names.size(); ++i)
        for (std::size_t c = 0; c < kColumns.size(); ++c)
            if (at[c] < 0 && platform::EqualsNoCase(Trim(names[i]), kColumns[c]))
                at[c] = static_cast<int>(i);
    for (std::size_t c = 0; c < kColumns.size(); ++c)
        if (at[c] < 0 && c != VolumeCol) {
            h.Error = std::string("The column ") + kColumns[c] + " is missing from the header row";
            h.ErrorLine = static_cast<int>(headerAt) + 1;
            return h;
        }
    const int needed = *std::max_element(at.begin(), at.end()) + 1;

    std::vector<int> lineOf; // the line of each record, for the duplicate message
    for (std::size_t n = headerAt + 1; n < lines.size(); ++n) {
        if (Trim(lines[n]).empty()) continue;
        const int lineNo = static_cast<int>(n) + 1;
        const auto fail = [&h, lineNo](std::string why) {
            h.Error = "Line " + std::to_string(lineNo) + ": " + why;
            h.ErrorLine = lineNo;
            h.Records.clear();
            return h;
        };
        const auto f = platform::SplitQuoted(lines[n], sep);
        if (static_cast<int>(f.size()) < needed)
            return fail("there are " + std::to_string(f.size()) + " fields where the header has " +
                        std::to_string(names.size()));
        const auto field = [&f, &at](Col c) {
            return at[c] < 0 ? std::string() : f[static_cast<std::size_t>(at[c])];
        };
        store::PriceRecord r;
        const auto date = CsvDate(field(DateCol));
        if (!date) return fail(Quoted(Trim(field(DateCol))) + " is not a date");
        r.Date = *date;
        for (const auto& [col, value] : {std::pair{OpenCol, &r.Open}, std::pair{HighCol, &r.High},
                                         std::pair{LowCol, &r.Low}, std::pair{CloseCol, &r.Close}})
            if (auto why = Figure(field(col), kColumns[col], *value)) return fail(*why);
        if (auto why = ShareCount(field(VolumeCol), r.Volume)) return fail(*why);
        h.Records.push_back(r);
        lineOf.push_back(lineNo);
    }
    // Date order, then a date twice is refused with both lines named.
    std::vector<std::size_t> order(h.Records.size());
    for (std::size_t i = 0; i < order.size(); ++i)
        order[i] = i;
    std::stable_sort(order.begin(), order.end(), [&h](std::size_t a, std::size_t b) {
        return h.Records[a].Date < h.Records[b].Date;
    });
    std::vector<store::PriceRecord> sorted;
    sorted.reserve(order.size());
    for (std::size_t i = 0; i < order.size(); ++i) {
        if (i > 0 && h.Records[order[i]].Date == h.Records[order[i - 1]].Date) {
            const int second = std::max(lineOf[order[i]], lineOf[order[i - 1]]);
            const int first = std::min(lineOf[order[i]], lineOf[order[i - 1]]);
            h.Error = "Line " + std::to_string(second) + ": the date " +
                      ShownDate(h.Records[order[i]].Date) + " is already on line " +
                      std::to_string(first);
            h.ErrorLine = second;
            h.Records.clear();
            return h;
        }
        sorted.push_back(h.Records[order[i]]);
    }
    h.Records = std::move(sorted);
    return h;
}

std::vector<store::PriceRecord> MergeHistory(const std::vector<store::PriceRecord>& onFile,
                                             const std::vector<store::PriceRecord>& incoming,
                                             bool replace, MergeCount& count) {
    count = {};
    std::vector<store::PriceRecord> out = onFile;
    std::map<std::string, std::size_t> byDate;
    for (std::size_t i = 0; i < out.size(); ++i)
        byDate.emplace(out[i].Date, i);
    for (const auto& r : incoming) {
        const auto it = byDate.find(r.Date);
        if (it == byDate.end()) {
            byDate.emplace(r.Date, out.size());
            out.push_back(r);
            ++count.Added;
        } else if (replace) {
            auto& old = out[it->second];
            old.Open = r.Open;
            old.High = r.High;
            old.Low = r.Low;
            old.Close = r.Close;
            old.Volume = r.Volume;
            ++count.Replaced;
        } else {
            ++count.Kept;
        }
    }
    std::stable_sort(
        out.begin(), out.end(),
        [](const store::PriceRecord& a, const store::PriceRecord& b) { return a.Date < b.Date; });
    count.Total = static_cast<int>(out.size());
    return out;
}

store::NameRecord NewNameRecord(std::string_view code, std::string_view name,
                                std::int16_t recordType, bool dayFile) {
    store::NameRecord n;
    n.Status = 0;
    n.Code = Trim(store::PadCode(code));
    n.Name = Trim(name);
    n.RecordType = recordType;
    n.Category = dayFile ? NewEquityCategory(n.Code) : std::int16_t{1};
    n.Base = n.Top = n.PFIncrement = 0;
    n.ScaleStep = 0.05f;
    return n;
}

ImportReport ImportCsvFile(const fs::path& csvFile, std::string_view dataFolder,
                           const ImportOptions& options) {
    ImportReport report;
    const auto refuse = [&report](std::string why) {
        report.Message = std::move(why);
        return report;
    };
    if (!store::IsValidCode(options.Code))
        return refuse("Not a valid security code: " + Quoted(options.Code));
    const std::string code = Trim(store::PadCode(options.Code));
    if (options.Name.find(',') != std::string::npos)
        return refuse("The name must not hold a comma");
    if (Trim(options.Name).size() > 35) return refuse("The name is longer than 35 characters");
    if (options.RecordType < 1 || options.RecordType > 5)
        return refuse("The record type must be 1 to 5");
    if (!fs::is_directory(fs::path(std::string(dataFolder))))
        return refuse("The data folder " + std::string(dataFolder) + " does not exist");
    const auto text = platform::ReadWholeFile(csvFile);
    if (!text) return refuse("Cannot read " + csvFile.string());
    const auto history = ReadCsvHistory(*text);
    if (!history.Error.empty()) return refuse(history.Error + "; nothing was written");
    if (history.Records.empty())
        return refuse("There are no records in " + csvFile.filename().string());
    report.Read = static_cast<int>(history.Records.size());

    platform::Status why;
    const auto found = store::FindCode(dataFolder, code, why);
    if (!why) return refuse(why.message());
    const auto path = store::PriceFile::PathFor(dataFolder, code);
    std::vector<store::PriceRecord> onFile;
    if (auto s = ReadOnFile(path, onFile); !s) return refuse(s.message());
    const bool existed = platform::FileExists(path);
    auto merged = MergeHistory(onFile, history.Records, options.Replace, report.Count);
    if (merged.size() > static_cast<std::size_t>(store::kMaxRecords))
        return refuse(LimitMessage(code, merged.size()));

    if (!existed || report.Count.Added > 0 || report.Count.Replaced > 0) {
        store::PriceFile file(path);
        if (auto s = file.WriteAll(merged); !s) return refuse(s.message());
        report.Securities = 1;
    }
    if (!found) {
        store::NameFile names(store::NameFile::PathIn(dataFolder));
        if (auto s = names.Open(); !s) return refuse(code + ".WDT written, but " + s.message());
        if (auto s = names.Append(NewNameRecord(code, options.Name, options.RecordType, false)); !s)
            return refuse(code +
                          ".WDT written, but the name file could not take it: " + s.message());
        report.NewNames = 1;
    }
    report.Ok = true;
    report.Message = code + ": " + std::to_string(report.Read) + " records read; " +
                     Summary(report.Count) + "; " + std::to_string(report.Count.Total) +
                     " on file" + (found ? "" : "; new in the name file");
    return report;
}

namespace {

bool IsDayFile(const fs::path& p) {
    static const std::array<const char*, 10> kExtensions = {".d",   ".dx",  ".dix", ".dov", ".dsu",
                                                            ".dsf", ".dop", ".dls", ".dlx", ".dlf"};
    const std::string ext = platform::Lower(p.extension().string());
    return std::find(kExtensions.begin(), kExtensions.end(), ext) != kExtensions.end();
}

struct DayLine {
    store::PriceRecord Record;
    double Spare = 0;
    std::string OptType; // options only
    std::string Where;   // file and line, for messages
};

// One line of a day file; the fault when it is not one.
std::optional<std::string> ReadDayLine(const std::string& line, std::string& code, DayLine& out) {
    // The same reading of a line as the update makes: commas counted in the raw line, fields
    // split with quotes honoured, the code as it arrives.
    const int commas = CountCommas(line);
    if (commas != 7 && commas != 8)
        return "an incorrect number of fields in the record (7 commas for 8 fields, 8 for an "
               "option)";
    const auto f = SplitFields(line);
    if (f.size() < static_cast<std::size_t>(commas) + 1)
        return "an incorrect number of fields in the record";
    code = ArrivalCode(f[0]);
    if (code.empty()) return std::nullopt; // a blank code skips the record
    if (!store::IsValidCode(code)) return "the code " + Quoted(code) + " cannot name a file";
    const std::string date = Trim(f[1]);
    if (!AllDigits(date) || !platform::IsValidDateText(date))
        return Quoted(date) + " is not a date";
    out.Record.Date = date;
    const std::array<std::pair<const char*, float*>, 4> prices = {
        std::pair{"open", &out.Record.Open}, std::pair{"high", &out.Record.High},
        std::pair{"low", &out.Record.Low}, std::pair{"close", &out.Record.Close}};
    for (std::size_t i = 0; i < prices.size(); ++i)
        if (auto why = Figure(f[i + 2], prices[i].first, *prices[i].second)) return why;
    if (auto why = ShareCount(f[6], out.Record.Volume)) return why;
    const std::string spare = Trim(f[7]);
    if (!spare.empty() && !platform::IsNumber(spare))
        return "the spare field " + Quoted(spare) + " is not a number";
    out.Spare = platform::Val(spare);
    if (commas == 8) out.OptType = platform::Upper(Trim(f[8]));
    return std::nullopt;
}

} // namespace

ImportReport ImportDayFiles(const fs::path& folder, std::string_view dataFolder, bool replace) {
    ImportReport report;
    const auto refuse = [&report](std::string why) {
        report.Message = std::move(why);
        return report;
    };
    std::error_code ec;
    if (!fs::is_directory(folder, ec))
        return refuse("The folder " + folder.string() + " does not exist");
    if (!fs::is_directory(fs::path(std::string(dataFolder)), ec))
        return refuse("The data folder " + std::string(dataFolder) + " does not exist");
    std::vector<fs::path> files;
    for (const auto& e : fs::directory_iterator(folder, ec))
        if (e.is_regular_file(ec) && IsDayFile(e.path())) files.push_back(e.path());
    std::sort(files.begin(), files.end());
    if (files.empty()) return refuse("There are no day files in " + folder.string());

    // Every line of every file read and checked first.
    std::map<std::string, std::vector<DayLine>> byCode;
    for (const auto& file : files) {
        const auto text = platform::ReadWholeFile(file);
        if (!text) return refuse("Cannot read " + file.string());
        const auto lines = Lines(*text);
        for (std::size_t n = 0; n < lines.size(); ++n) {
            if (Trim(lines[n]).empty()) continue;
            const std::string where = file.filename().string() + ", line " + std::to_string(n + 1);
            std::string code;
            DayLine d;
            if (auto why = ReadDayLine(lines[n], code, d))
                return refuse(where + ": " + *why + "; nothing was written");
            if (code.empty()) continue;
            d.Where = where;
            byCode[code].push_back(std::move(d));
            ++report.Read;
        }
    }
    if (byCode.empty())
        return refuse("There are no records in the day files of " + folder.string());

    std::vector<store::NameRecord> names;
    store::NameFile nameFile(store::NameFile::PathIn(dataFolder));
    if (platform::FileExists(nameFile.path()))
        if (auto s = nameFile.ReadAll(names); !s) return refuse(s.message());
    std::map<std::string, bool> known;
    for (const auto& n : names)
        known[n.TrimmedCode()] = true;
    if (names.size() + byCode.size() > static_cast<std::size_t>(store::kMaxRecords)) {
        std::size_t fresh = 0;
        for (const auto& [code, lines] : byCode)
            fresh += known.count(code) ? 0 : 1;
        if (names.size() + fresh > static_cast<std::size_t>(store::kMaxRecords))
            return refuse("The name file would hold " + std::to_string(names.size() + fresh) +
                          " records; it holds at most 32767");
    }

    struct Planned {
        std::string Code;
        std::vector<store::PriceRecord> Records;
        bool Write = false;
        std::optional<store::NameRecord> NewName;
    };
    std::vector<Planned> plan;
    for (auto& [code, lines] : byCode) {
        std::stable_sort(lines.begin(), lines.end(), [](const DayLine& a, const DayLine& b) {
            return a.Record.Date < b.Record.Date;
        });
        std::vector<store::PriceRecord> incoming;
        for (std::size_t i = 0; i < lines.size(); ++i) {
            if (i > 0 && lines[i].Record.Date == lines[i - 1].Record.Date)
                return refuse(code + " has two lines for " + ShownDate(lines[i].Record.Date) +
                              " (" + lines[i - 1].Where + " and " + lines[i].Where +
                              "); nothing was written");
            incoming.push_back(lines[i].Record);
            // The spare field corrects the day before's volume; an option's is its days to expiry.
            if (i > 0 && lines[i].OptType.empty() && lines[i].Spare != 0)
                incoming[i - 1].Volume = static_cast<std::int32_t>(std::llround(lines[i].Spare));
        }
        Planned p;
        p.Code = code;
        const auto path = store::PriceFile::PathFor(dataFolder, code);
        std::vector<store::PriceRecord> onFile;
        if (auto s = ReadOnFile(path, onFile); !s)
            return refuse(s.message() + "; nothing was written");
        MergeCount count;
        p.Records = MergeHistory(onFile, incoming, replace, count);
        if (p.Records.size() > static_cast<std::size_t>(store::kMaxRecords))
            return refuse(LimitMessage(code, p.Records.size()) + "; nothing was written");
        p.Write = !platform::FileExists(path) || count.Added > 0 || count.Replaced > 0;
        if (!known.count(code)) {
            auto n = NewNameRecord(code, "", 4, true);
            const auto& first = lines.front();
            if (!first.OptType.empty()) {
                // An option's details: "0", the type and the expiry (date + days) as d/m/yy.
                const auto serial = platform::DaySerial(first.Record.Date);
                const auto expiry = serial ? platform::DateTextFromSerial(
                                                 *serial + static_cast<std::int32_t>(first.Spare))
                                           : std::nullopt;
                n.OtherDetails =
                    "0" + first.OptType + (expiry ? platform::DateTextToEntry(*expiry) : "");
            }
            p.NewName = n;
        }
        report.Count.Added += count.Added;
        report.Count.Replaced += count.Replaced;
        report.Count.Kept += count.Kept;
        report.Count.Total += count.Total;
        plan.push_back(std::move(p));
    }

    if (auto s = nameFile.Open(); !s) return refuse(s.message());
    for (const auto& p : plan) {
        const auto stopped = [&report, &p](const std::string& why) {
            report.Message = "Stopped at " + p.Code + ": " + why + "; " +
                             std::to_string(report.Securities) +
                             " securities were written before it";
            return report;
        };
        if (p.Write) {
            store::PriceFile file(store::PriceFile::PathFor(dataFolder, p.Code));
            if (auto s = file.WriteAll(p.Records); !s) return stopped(s.message());
            ++report.Securities;
        }
        if (p.NewName) {
            if (auto s = nameFile.Append(*p.NewName); !s) return stopped(s.message());
            ++report.NewNames;
        }
    }
    report.Ok = true;
    report.Message = std::to_string(files.size()) +
                     " day files read: " + std::to_string(report.Read) + " records for " +
                     std::to_string(plan.size()) + " securities; " + Summary(report.Count) + "; " +
                     std::to_string(report.NewNames) + " new in the name file";
    return report;
}

} // namespace kori::intake
