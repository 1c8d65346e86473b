#pragma once
// The data check: every history of a list or a folder read once and held against what a sound
// daily history looks like. Each finding is one row of the report (code, name, date, what,
// detail) so that the user can open the chart or the record it points at.
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "platform/status.h"
#include "store/name_record.h"
#include "store/price_file.h"
#include "store/security_walk.h"

#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

struct DataCheckSettings {
    int GapWeekdays = 10;         // a run of more weekdays than this without a record
    int StoppedWeekdays = 10;     // last record this many weekdays before the library's latest
    double MoveAlertPercent = 35; // an overnight move beyond this, with no adjustment near it
};

// The settings as the window store keeps them between checks; a value that does not read as
// a number in its range keeps the default.
DataCheckSettings LoadDataCheckSettings(const platform::SettingsStore& store);
void SaveDataCheckSettings(platform::SettingsStore& store, const DataCheckSettings& settings);

// What a finding says, in the words of the report.
namespace finding {
inline constexpr std::string_view NotADate = "Date is not a date";
inline constexpr std::string_view OutOfOrder = "Date out of order";
inline constexpr std::string_view Duplicated = "Date duplicated";
inline constexpr std::string_view Weekend = "Record on a weekend";
inline constexpr std::string_view NotANumber = "Price is not a number";
inline constexpr std::string_view ZeroPrice = "Zero or negative price";
inline constexpr std::string_view HighBelowLow = "High below low";
inline constexpr std::string_view OpenOutside = "Open outside the day's range";
inline constexpr std::string_view CloseOutside = "Close outside the day's range";
inline constexpr std::string_view NegativeVolume = "Negative volume";
inline constexpr std::string_view Gap = "Gap in the history";
inline constexpr std::string_view Stopped = "Stopped trading";
inline constexpr std::string_view MissedAdjustment = "Probable missed adjustment";
inline constexpr std::string_view Damaged = "File damaged";
} // namespace finding

struct Finding {
    std::string Code;
    std::string Name;
    std::string Date; // "yyyymmdd" as the record holds it; empty for the file as a whole
    int Record = 0;   // 1-based; 0 for the file as a whole
    std::string What;
    std::string Detail;

    friend bool operator==(const Finding&, const Finding&) = default;
};

// Weekdays (Monday to Friday) strictly between two dates; 0 when either is not a date or they
// are in the wrong order.
int WeekdaysBetween(std::string_view fromDate, std::string_view toDate);

// The findings of one history, oldest record first, all but the stopped-trading rule, which
// needs the whole library's latest date (`StoppedTrading` below).
std::vector<Finding> CheckHistory(const store::NameRecord& name,
                                  const std::vector<store::PriceRecord>& records,
                                  const DataCheckSettings& settings);

// The last valid date of a history; empty when it has none.
std::string LastValidDate(const std::vector<store::PriceRecord>& records);

// The stopped-trading finding of a security whose last valid date is `lastDate`, when the
// library's latest is more than the setting's weekdays later.
std::vector<Finding> StoppedTrading(const store::NameRecord& name, std::string_view lastDate,
                                    int lastRecord, std::string_view libraryLatest,
                                    const DataCheckSettings& settings);

struct DataCheckResult {
    platform::Status Status;
    std::vector<Finding> Findings; // in walk order, a security's findings by record
    std::string LatestDate;        // the library's latest valid date
    int Checked = 0;
    bool Cancelled = false;
};

// Walks the list once, reading each price file whole. Files the walk cannot use (missing,
// empty, broken length, over the record limit) become findings too, so the report is whole.
DataCheckResult CheckLibrary(const store::SecurityList& list, const DataCheckSettings& settings,
                             platform::Progress& progress);

// The report as CSV with a header row: Code,Name,Date,Record,Finding,Detail.
std::string FindingsCsv(const std::vector<Finding>& findings);

} // namespace kori::maint
