#pragma once
// The oscillators built on the exponential moving average seeded by a plain mean: MACD,
// Coppock (kept in whole numbers) and Elder Ray.
#include "osc/osc_series.h"

namespace kori::osc {

struct MacdResult {
    Series<float> ema1;   // from bar P1 - 1
    Series<float> ema2;   // from bar P1 + P2 - 1
    Series<float> macd;   // ema1 - ema2, from bar P1 + P2 - 1
    Series<float> signal; // from bar P1 + P2 + P3 - 1
};
struct CoppockResult {
    Series<std::int16_t> coppock; // from bar 2n, where the seed stands
};
struct ElderRayResult {
    Series<float> bull, bear; // from bar n - 1
};

// The average: a = 2 / (n + 1); from `first` on out[i] = a x src[i] + (1 - a) x out[i - 1],
// with out[first] = seed. Bars before `first` hold 0. In 32-bit floats.
std::vector<float> SmoothSeries(std::span<const float> src, int n, int first, float seed);

// Any period 0 computes nothing (the chart also stops when a daily MACD key is 0).
MacdResult ComputeMACD(const store::ChartSeries& series, std::int16_t p1, std::int16_t p2,
                       std::int16_t p3);
CoppockResult ComputeCoppock(const store::ChartSeries& series, std::int16_t period);
ElderRayResult ComputeElderRay(const store::ChartSeries& series, std::int16_t period,
                               std::int16_t recordType);

} // namespace kori::osc
