#pragma once
// Price histories brought in from outside: a CSV file of one security's days (the export of a
// spreadsheet or a web site), or a folder of day files in the download format for a first
// load. Everything is read and checked before anything is written; each price file is then
// rewritten whole beside the old one, and a new security gets one record appended to
// Names.dat.
#include "platform/status.h"
#include "store/name_record.h"
#include "store/price_file.h"

#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::intake {

// A CSV history read: records in date order, or the first fault with its line number.
struct CsvHistory {
    std::vector<store::PriceRecord> Records;
    std::string Error; // empty when the file was read
    int ErrorLine = 0; // 1-based line of the fault; 0 when it is not one line's
};

// Reads a history with a header row naming the columns Date, Open, High, Low, Close and Volume
// in any order and any case (other columns, an adjusted close say, are ignored; Volume may be
// missing and then reads 0). Fields are split at commas or, when the header has semicolons
// and no commas, at semicolons; a field may stand in double quotes. Dates are yyyy-mm-dd,
// yyyymmdd or d/m/yyyy. A date twice is refused.
CsvHistory ReadCsvHistory(std::string_view text);

// How existing records and new ones meet: new dates are added; a date already on file is left
// alone, or with `Replace` takes the new figures (keeping its adjustment factor and note).
struct MergeCount {
    int Added = 0, Replaced = 0, Kept = 0, Total = 0;
};
std::vector<store::PriceRecord> MergeHistory(const std::vector<store::PriceRecord>& onFile,
                                             const std::vector<store::PriceRecord>& incoming,
                                             bool replace, MergeCount& count);

// The name record of a security new to the library: type as given (4 unless said), category
// by the rule for new codes of the exchange's day files when `dayFile`, else 1; the fixed
// fields as every new entry has them.
store::NameRecord NewNameRecord(std::string_view code, std::string_view name,
                                std::int16_t recordType, bool dayFile);

struct ImportOptions {
    std::string Code;
    std::string Name;
    std::int16_t RecordType = 4;
    bool Replace = false;
};

struct ImportReport {
    bool Ok = false;
    std::string Message; // the fault, or a summary
    int Securities = 0;  // price files written
    int NewNames = 0;    // records appended to Names.dat
    int Read = 0;        // records read from the input
    MergeCount Count;    // summed over the securities
};

// One CSV file into the security `options.Code` of `dataFolder`.
ImportReport ImportCsvFile(const std::filesystem::path& csvFile, std::string_view dataFolder,
                           const ImportOptions& options);

// Every day file (.d, .dx and the market segments' extensions) of `folder`, one line a
// security as code,date,open,high,low,close,vol,spare (options: then OptType, `spare` being
// the days to expiry), into `dataFolder`. A line with the wrong number of fields or a bad
// figure stops the load before anything is written.
ImportReport ImportDayFiles(const std::filesystem::path& folder, std::string_view dataFolder,
                            bool replace);

} // namespace kori::intake
