#include "maint/text_export.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <charconv>

namespace kori::maint {

std::string PriceText(float v) {
    char buffer[32];
    const auto r = std::to_chars(buffer, buffer + sizeof buffer, v);
    return std::string(buffer, r.ptr);
}

namespace {

std::string CsvField(std::string_view s) {
    if (s.find_first_of(",\"\n") == std::string_view::npos) return std::string(s);
    std::string q = "\"";
    for (const char c : s) {
        if (c == '"') q += '"';
        q += c;
    }
    return q + "\"";
}

std::string IsoDate(std::string_view d) {
    return std::string(d.substr(0, 4)) + "-" + std::string(d.substr(4, 2)) + "-" +
           std::string(d.substr(6, 2));
}

// The record of `date` near the end of a file: the last records are read first, as exports
// are nearly always of recent days, and the whole file only when the date lies further back.
// The record of `date` in a price file of `count` records: the last weeks first, where an export
// of a recent day finds it in one read; the rest of the file only when the date is older.
// `bytes` is reused from file to file.
std::optional<store::PriceRecord> RecordOn(const std::filesystem::path& file, int count,
                                           std::string_view date, std::string& bytes) {
    constexpr int kTail = 64;
    auto search = [&](int first, int last) -> std::optional<store::PriceRecord> {
        if (!store::ReadPriceRecords(file, first, last, bytes)) return std::nullopt;
        for (int i = last - first; i >= 0; --i) {
            const char* rec =
                bytes.data() + static_cast<std::size_t>(i) * store::PriceRecord::kSize;
            if (std::string_view(rec, date.size()) == date) return store::PriceRecord::Decode(rec);
        }
        return std::nullopt;
    };
    if (count < 1) return std::nullopt;
    const int first = std::max(1, count - kTail + 1);
    if (auto r = search(first, count)) return r;
    if (first == 1 || bytes.size() < store::PriceRecord::kSize) return std::nullopt;
    // The tail starts before the date: had the file held it, the tail would have.
    if (std::string_view(bytes.data(), date.size()) < date) return std::nullopt;
    return search(1, first - 1);
}

const char* const kMonths[] = {"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                               "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};

} // namespace

ClosesExport ExportCloses(const store::SecurityList& list, std::string_view date,
                          platform::Progress& progress) {
    ClosesExport out;
    out.Date = std::string(date);
    if (out.Date.empty()) {
        progress.SetStatus("Finding the latest date");
        const auto walk = store::ForEachSecurity(list, progress, [&](const store::WalkItem& it) {
            store::PriceFile f(it.PriceFile);
            store::PriceRecord last;
            if (f.Open() && f.Count() > 0 && f.Read(f.Count(), last) &&
                platform::IsValidDateText(last.Date) && last.Date > out.Date)
                out.Date = last.Date;
            return store::WalkStep::Continue;
        });
        out.Status = walk.Status;
        out.Cancelled = walk.Cancelled;
        if (!out.Status || out.Cancelled) return out;
        if (out.Date.empty()) {
            out.Status = platform::Status::Error("No security of the list has a dated record");
            return out;
        }
    } else if (!platform::IsValidDateText(out.Date)) {
        out.Status = platform::Status::Error("Not a date: " + out.Date);
        return out;
    }
    out.Csv = "Code,Name,Date,Close,Volume\n";
    progress.SetStatus("Writing the closing prices");
    std::string bytes;
    const auto walk = store::ForEachSecurity(list, progress, [&](const store::WalkItem& it) {
        const auto r = RecordOn(it.PriceFile, it.PriceRecords, out.Date, bytes);
        if (!r || r->Close == 0) {
            ++out.NotTraded;
            return store::WalkStep::Continue;
        }
        out.Csv += CsvField(it.Name.TrimmedCode()) + "," + CsvField(platform::Trim(it.Name.Name)) +
                   "," + IsoDate(r->Date) + "," + PriceText(r->Close) + "," +
                   std::to_string(r->Volume) + "\n";
        ++out.Lines;
        return store::WalkStep::Continue;
    });
    out.Status = walk.Status;
    out.Cancelled = walk.Cancelled;
    return out;
}

std::string HistoryCsv(std::string_view code, const std::vector<store::PriceRecord>& records,
                       const DateRange& range, bool withCode) {
    std::string csv =
        withCode ? "Code,Date,Open,High,Low,Close,Volume\n" : "Date,Open,High,Low,Close,Volume\n";
    const std::string prefix = withCode ? CsvField(code) + "," : "";
    for (const auto& r : records) {
        if (!platform::IsValidDateText(r.Date) || !range.Holds(r.Date)) continue;
        csv += prefix + IsoDate(r.Date) + "," + PriceText(r.Open) + "," + PriceText(r.High) + "," +
               PriceText(r.Low) + "," + PriceText(r.Close) + "," + std::to_string(r.Volume) + "\n";
    }
    return csv;
}

DataExport ExportData(const store::SecurityList& list, std::string_view code,
                      const DateRange& range, bool dayFiles, platform::Progress& progress) {
    DataExport out;
    auto add = [&](const std::string& c, const std::filesystem::path& path, bool withCode) {
        std::vector<store::PriceRecord> records;
        if (auto s = store::PriceFile(path).ReadAll(records); !s) return s;
        if (dayFiles) {
            out.Days.Add(c, records, range);
        } else {
            auto part = HistoryCsv(c, records, range, withCode);
            out.Csv += out.Csv.empty() ? part : part.substr(part.find('\n') + 1);
        }
        ++out.Securities;
        return platform::Status::Ok();
    };
    if (!code.empty()) {
        platform::Status why;
        const auto found = store::FindCode(list.DataFolder, code, why);
        if (!why)
            out.Status = why;
        else if (!found)
            out.Status = platform::Status::Error("No File For That Name");
        else
            out.Status = add(found->Record.TrimmedCode(), found->CurrentFile, false);
        return out;
    }
    const auto walk = store::ForEachSecurity(list, progress, [&](const store::WalkItem& it) {
        if (auto s = add(it.Name.TrimmedCode(), it.PriceFile, true); !s)
            out.Skipped.push_back(
                {platform::Severity::Warning, s.message(), it.PriceFile.filename().string(), 0});
        return store::WalkStep::Continue;
    });
    out.Status = walk.Status;
    out.Cancelled = walk.Cancelled;
    out.Skipped.insert(out.Skipped.end(), walk.Issues.begin(), walk.Issues.end());
    return out;
}

std::string DayFileName(std::string_view d) {
    const auto date = platform::ParseDateText(d);
    if (!date) return {};
    char name[16];
    std::snprintf(name, sizeof name, "%02d%s%02d.D", date->day, kMonths[date->month - 1],
                  date->year % 100);
    return name;
}

void DayFiles::Add(std::string_view code, const std::vector<store::PriceRecord>& records,
                   const DateRange& range) {
    for (const auto& r : records) {
        if (!platform::IsValidDateText(r.Date) || !range.Holds(r.Date)) continue;
        m_lines[r.Date] += std::string(code) + "," + r.Date + "," + PriceText(r.Open) + "," +
                           PriceText(r.High) + "," + PriceText(r.Low) + "," + PriceText(r.Close) +
                           "," + std::to_string(r.Volume) + ",0\n";
    }
}

platform::Status DayFiles::WriteTo(const std::filesystem::path& folder,
                                   std::vector<std::string>* written) const {
    if (!platform::CreateFolderPath(folder))
        return platform::Status::Error("Cannot make the folder " + folder.string());
    for (const auto& [date, lines] : m_lines) {
        const std::string name = DayFileName(date);
        if (auto s = platform::WriteFileAtomic(folder / name, lines); !s) return s;
        if (written) written->push_back(name);
    }
    return platform::Status::Ok();
}

} // namespace kori::maint
