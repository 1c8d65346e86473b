#include "osc/momentum_roc.h"

namespace kori::osc {

namespace {

// Walks the bars after P; `figure` turns (close now, close P bars ago) into the bar's value.
template <class T, class Figure>
Series<T> HeldChange(const store::ChartSeries& series, std::int16_t period, Figure figure) {
    const int n = BarCount(series);
    Series<T> out(static_cast<std::size_t>(n));
    if (period <= 0) return out;
    const std::vector<float> c = Closes(series);
    T last = 0; // bars up to P hold 0, and a missing price repeats the last figure
    for (int i = period + 1; i < n; ++i) {
        const float now = c[static_cast<std::size_t>(i)];
        const float then = c[static_cast<std::size_t>(i - period)];
        if (now != 0 && then != 0) last = figure(now, then);
        out[static_cast<std::size_t>(i)] = last;
    }
    return out;
}

} // namespace

MomentumResult ComputeMomentum(const store::ChartSeries& series, std::int16_t period) {
    return {HeldChange<std::int32_t>(
        series, period, [](float now, float then) { return RoundToInt32((now - then) * 100.0f); })};
}

RocResult ComputeROC(const store::ChartSeries& series, std::int16_t period) {
    return {HeldChange<std::int16_t>(series, period, [](float now, float then) {
        return RoundToInt16((now - then) / now * 100.0f);
    })};
}

} // namespace kori::osc
