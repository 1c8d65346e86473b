#pragma once
// Text exports of the library: the closing prices of one day for a list, and the records of a
// security or a list over a date range, as CSV or as day files in the download format, so that
// an export reads back in unchanged.
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/status.h"
#include "store/price_file.h"
#include "store/security_walk.h"

#include <filesystem>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

// A price as the shortest decimal text that reads back to the same 32-bit value.
std::string PriceText(float v);

struct ClosesExport {
    platform::Status Status;
    std::string Date; // the day exported, "yyyymmdd"
    std::string Csv;  // "Code,Name,Date,Close,Volume" and one line a security
    int Lines = 0;
    int NotTraded = 0; // securities with no record on that day
    bool Cancelled = false;
};

// Closing prices of `date` ("yyyymmdd"; empty: the latest date of the list's securities).
ClosesExport ExportCloses(const store::SecurityList& list, std::string_view date,
                          platform::Progress& progress);

struct DateRange {
    std::string From; // "yyyymmdd", empty: from the first record
    std::string To;   // "yyyymmdd", empty: to the last record
    bool Holds(std::string_view date) const {
        return (From.empty() || date >= From) && (To.empty() || date <= To);
    }
};

// One security's records in the range as CSV: "Date,Open,High,Low,Close,Volume", dates as
// yyyy-mm-dd; with `withCode` a first column "Code".
std::string HistoryCsv(std::string_view code, const std::vector<store::PriceRecord>& records,
                       const DateRange& range, bool withCode);

// Day files: every date of the range, one file a day named DDMMMYY.D, each line
// "code,yyyymmdd,open,high,low,close,volume,0" in the order the securities came.
class DayFiles {
public:
    void Add(std::string_view code, const std::vector<store::PriceRecord>& records,
             const DateRange& range);
    // Writes the files into `folder` (made when missing); the names written.
    platform::Status WriteTo(const std::filesystem::path& folder,
                             std::vector<std::string>* written = nullptr) const;
    std::size_t days() const { return m_lines.size(); }

private:
    std::map<std::string, std::string> m_lines; // by date, the lines of that day
};

struct DataExport {
    platform::Status Status;
    std::string Csv; // CSV output
    DayFiles Days;   // day-file output
    int Securities = 0;
    bool Cancelled = false;
    platform::Issues Skipped; // securities of a list whose price file could not be read
};

// The records of one security (`code`) or, with `code` empty, of the securities of `list`, in
// the range: CSV (a list's with a Code column) or, with `dayFiles`, day files.
DataExport ExportData(const store::SecurityList& list, std::string_view code,
                      const DateRange& range, bool dayFiles, platform::Progress& progress);

// The name of the day file of a date: "20080115" -> "15JAN08.D".
std::string DayFileName(std::string_view yyyymmdd);

} // namespace kori::maint
