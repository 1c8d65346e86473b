#pragma once
// Stochastic ("STO", fast and slow) and FX: one calculation on an inclusive window of K + 1
// bars, with whole-number %K, first smoothing %D and, in the slow form, second smoothing.
#include "osc/osc_series.h"

namespace kori::osc {

struct StochResult {
    Series<std::int32_t> k; // %K, from bar K + 1
    Series<std::int32_t> d; // first smoothing, from bar K + 1 when D > 0 (ring filling)
    Series<std::int32_t>
        slowd; // slow form with D > 0: from bar K + 1 (unfilled ring places count 0)
};

// `recordType` 1 to 3 takes the closes for the window's extremes. The values are the computed
// figures; showing FX upside down (100 - value) is a matter of the panel.
StochResult ComputeStochFX(const store::ChartSeries& series, std::int16_t periodK,
                           std::int16_t periodD, bool slowStochastic, std::int16_t recordType);

} // namespace kori::osc
