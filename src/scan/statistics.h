#pragma once
// Statistics ("Top Movers by Percentage"): how the last day went for the securities of the name
// file, with the largest percentage rises and falls; and ADTotals, which recomputes the
// cumulative line of an advance-decline series from its base value.
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/status.h"
#include "scan/scan_common.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace kori::scan {

// The filter words of the options: "ALL", "3" (codes of three characters), "NW" (shorter than
// six), "WO" (six exactly).
bool StatisticsTakes(std::string_view filterWord, std::string_view code);

struct MoverRow {
    std::string Code;
    std::string Latest;   // "0.00#"
    double Percent = 0;   // a fraction, to four decimal places
    std::string Previous; // "0.00#"
    std::string Name;     // filled by the last pass over the name file
};

struct MarketCounters {
    std::int32_t Rises = 0, Falls = 0, Steady = 0, Traded = 0, Untraded = 0;
};

// The 12-character text a percentage is kept as for the sort.
std::string PercentKey(double percent);
// Shell sort on the keys by their value, greatest first; gaps 2^k - 1 halved each pass.
void SortMovers(std::vector<MoverRow>& rows);

struct MoversDisplay {
    int TopCount = 0;            // after it was cut to the number of movers
    std::vector<MoverRow> Rises; // i-th from the top of the sorted list
    std::vector<MoverRow> Falls; // i-th from the end
};

class MarketStatistics {
public:
    // The walk over Names.dat ("Checking Statistics"), then the sort ("SORTING STATISTICS")
    // and the name pass. An error when there is no name file ("There is no Name File ").
    platform::Status Check(std::string_view dataFolder, std::string_view filterWord,
                           platform::Progress& progress);
    bool HasRows() const { return m_checked; }
    const MarketCounters& Counters() const { return m_counters; }
    const std::vector<MoverRow>& Movers() const { return m_rows; }
    const platform::Issues& Issues() const { return m_issues; }
    bool Cancelled() const { return m_cancelled; }
    // The blocks for a "Top" text (empty: 20); "&Update Statistics" calls this alone.
    MoversDisplay Display(std::string_view topText) const;

private:
    bool m_checked = false;
    bool m_cancelled = false;
    MarketCounters m_counters;
    std::vector<MoverRow> m_rows;
    platform::Issues m_issues;
};

inline constexpr std::string_view kNoNameFile = "There is no Name File ";
inline constexpr std::string_view kStatisticsTitle = "Statistics";

// ---- Advance-decline totals ----
inline constexpr std::string_view kADIntro =
    "This procedure checks Advance/Decline cumulative totals.(record type 3).";
inline constexpr std::string_view kADTitle = "Advance/Decline";

// The codes of RecordType 3 in Names.dat, in file order.
std::vector<std::string> AdvanceDeclineCodes(std::string_view dataFolder);
// Close + Low - High of the first record: the line's value before that day. An error (with the
// message "There are no records for " and the file name) for a file with no records.
platform::Status ADBaseValue(const std::filesystem::path& priceFile, double& base);
// "Check Totals": from the base as a 32-bit integer, each record's close becomes the running
// total of advances less declines and its open 0; the file is rewritten whole. `total` is the
// total at the end.
platform::Status CheckADTotals(const std::filesystem::path& priceFile, double base,
                               std::int32_t& total);
// " Checked <file>" a line break and "Cumulative Total at end is <total>".
std::string ADCheckedMessage(const std::filesystem::path& priceFile, std::int32_t total);

} // namespace kori::scan
