#pragma once
// Momentum ("MOM") and Rate of Change ("ROC"): the change over P bars, in cents as a 32-bit
// integer, or as a whole per cent of the CURRENT close in a 16-bit integer. A bar where either
// close is 0 repeats the figure before it.
#include "osc/osc_series.h"

namespace kori::osc {

struct MomentumResult {
    Series<std::int32_t> mom; // from bar P + 1
};
struct RocResult {
    Series<std::int16_t> roc; // from bar P + 1
};

MomentumResult ComputeMomentum(const store::ChartSeries& series, std::int16_t period);
RocResult ComputeROC(const store::ChartSeries& series, std::int16_t period);

} // namespace kori::osc
