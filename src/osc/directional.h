#pragma once
// Directional Movement ("DM"): +DI and -DI as plain rolling means of the day-ratios DM / TR,
// DX from them, and an ADX whose two weights are both (1 - a).
#include "osc/osc_series.h"

namespace kori::osc {

struct DirectionalResult {
    Series<std::int16_t> pdi, mdi; // from bar P, when the ring of day-ratios is full
    Series<std::int16_t> dx;       // from bar P
    Series<std::int16_t> adx;      // from bar P + X + 1, after the seed
};

// A period of 0 works as 10.
DirectionalResult ComputeDirectional(const store::ChartSeries& series, std::int16_t period,
                                     std::int16_t adxPeriod);

} // namespace kori::osc
