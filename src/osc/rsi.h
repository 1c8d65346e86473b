#pragma once
// Relative Strength Index ("RSI"): a window re-added at every bar that ends one bar before the
// bar in hand, holds P - 1 differences and is divided by the full period P.
#include "osc/osc_series.h"

namespace kori::osc {

struct RsiResult {
    // From bar P on, the figure the line stands at: a bar whose window has no fall keeps the
    // last figure. Nothing before the first window with a fall.
    Series<float> rsi;
};

RsiResult ComputeRSI(const store::ChartSeries& series, std::int16_t period);

// The figure of one bar from its own window alone (closes[i - P] .. closes[i - 1], P - 1
// pairs added oldest first), for the scans that need the last bars only; nullopt when the
// window holds no fall (the line would keep its earlier level). `i` must be at least P.
std::optional<float> RsiWindowFigure(std::span<const float> closes, std::int16_t period,
                                     std::size_t i);

} // namespace kori::osc
