#pragma once
// One entry point for every oscillator's computation, for exports and scans: the series of an
// identifier as named columns, one row a bar, with no value where the routine computed none.
#include "osc/osc_series.h"
#include "osc/osc_settings.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::osc {

struct OscInputs {
    std::string ChartPeriod = "A"; // "A" daily; "W", "M" take the weekly keys
    std::int16_t RecordType = 4;   // of the security (1 to 3: closes only)
    bool SlowStochastic = false;   // "STO" only
    // RMO and RMX: every record of the comparison file (zero closes as they stand). Without
    // it they compute nothing, as when the comparison file is missing.
    const store::ChartSeries* CompareFile = nullptr;
    // RMO: every record of the security's own file, and the record of chart bar 0. Without
    // it the chart's bars stand for the whole file.
    const store::ChartSeries* SecurityFile = nullptr;
    std::int16_t FirstRecord = 1;
};

struct OscTable {
    std::vector<std::string> columns;
    std::vector<std::vector<std::optional<double>>> rows; // one a bar, 0 to LastBar
};

// The periods of an identifier for the chart period, in the order of its settings keys.
std::vector<std::int16_t> OscPeriodsFor(const OscDef& def, std::string_view oscName,
                                        std::string_view chartPeriod);

// nullopt for an identifier that has no computation here ("PARA", "PARAV" or unknown).
std::optional<OscTable> ComputeOscillator(std::string_view oscName,
                                          const store::ChartSeries& series, const OscDef& def,
                                          const OscInputs& inputs);

} // namespace kori::osc
