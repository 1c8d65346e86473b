#pragma once
// RMO and RMX: the ratio of a reference close (the comparison file, usually the All Ordinaries
// Index) to the security's close x 100, against the mean of its last P ratios. Both walk the
// two series by position, not by date.
#include "osc/osc_series.h"
#include "platform/dialogs.h"

#include <filesystem>
#include <string>
#include <string_view>

namespace kori::osc {

// The comparison file named by CompFile: `CompareCode` is empty when the path does not name
// an existing ".WDT" file inside a folder. Loading its records is the caller's business.
struct CompareFile {
    std::string CompareCode;
    std::filesystem::path Path; // the file as found on disk, whatever the case of its name
};
CompareFile ResolveCompareFile(std::string_view compFile);
// The same, showing "RMX/RMO Compare file path/file details are invalid. ..." on failure.
CompareFile ResolveCompareFile(std::string_view compFile, platform::Dialogs& dialogs);

struct CompareResult {
    Series<float> value; // Mean - ratio, from the first full ring of P ratios
};

// RMO works on every record of both files (`securityFile` and `compareFile` hold records 1 to
// the count as bars, zero closes as they stand) and gives the figures of the chart's bars:
// bar j is record `firstRecord` + j, for `chartBars` bars.
CompareResult ComputeRMO(const store::ChartSeries& securityFile,
                         const store::ChartSeries& compareFile, std::int16_t period,
                         std::int16_t firstRecord, int chartBars);

// RMX pairs the chart's bars from 0 with the comparison records from NC - LastBar (at least
// record 1) on.
CompareResult ComputeRMX(const store::ChartSeries& chart, const store::ChartSeries& compareFile,
                         std::int16_t period);

} // namespace kori::osc
