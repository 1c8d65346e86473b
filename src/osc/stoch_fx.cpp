#include "osc/stoch_fx.h"
#include "store/name_record.h"

#include <algorithm>

namespace kori::osc {

namespace {

struct Extremes {
    std::vector<float> hi, lo; // per window ending at each bar
};

// Each bar's candidate for the window's high and low: the high and low of a bar that has
// them, else a non-zero close; a zero is never taken. The window's high starts at 0 and its low
// at 100000, and those starting values take part: a window of negative totals keeps a high of 0.
Extremes WindowExtremes(const store::ChartSeries& s, int n, int width, std::int16_t recordType) {
    std::vector<float> hiC(static_cast<std::size_t>(n), 0.0f);
    std::vector<float> loC(static_cast<std::size_t>(n), 100000.0f);
    for (std::size_t j = 0; j < hiC.size(); ++j) {
        const store::ChartBar& b = s.ChartBars[j];
        const bool closeOnly = store::IsCloseOnly(recordType);
        if (b.High != 0 && !closeOnly)
            hiC[j] = b.High;
        else if (b.Close != 0)
            hiC[j] = b.Close;
        if (b.Low != 0 && !closeOnly)
            loC[j] = b.Low;
        else if (b.Close != 0)
            loC[j] = b.Close;
    }
    Extremes ex{WindowMax(hiC, width), WindowMin(loC, width)};
    for (float& h : ex.hi)
        h = std::max(h, 0.0f);
    for (float& l : ex.lo)
        l = std::min(l, 100000.0f);
    return ex;
}

std::int32_t Percent(float part, float whole) {
    return whole != 0 ? RoundToInt32(part / whole * 100.0f) : RoundToInt32(part * 100.0f);
}

} // namespace

StochResult ComputeStochFX(const store::ChartSeries& series, std::int16_t periodK,
                           std::int16_t periodD, bool slowStochastic, std::int16_t recordType) {
    const int n = BarCount(series);
    StochResult r;
    r.k.assign(static_cast<std::size_t>(n), std::nullopt);
    r.d = r.k;
    r.slowd = r.k;
    if (periodK <= 0 || n <= periodK + 1) return r;

    const int first = periodK + 1;
    const Extremes ex = WindowExtremes(series, n, periodK + 1, recordType);
    std::vector<float> diff(static_cast<std::size_t>(n), 0.0f);
    std::vector<float> range(static_cast<std::size_t>(n), 0.0f);
    for (int i = first; i < n; ++i) {
        const auto u = static_cast<std::size_t>(i);
        diff[u] = series.ChartBars[u].Close - ex.lo[u];
        range[u] = ex.hi[u] - ex.lo[u];
        r.k[u] = Percent(diff[u], range[u]);
    }
    if (periodD <= 0) return r;

    // The ring of the last D pairs starts empty: bars before the first count as 0.
    const std::vector<float> diffSums = WindowSums(diff, periodD);
    const std::vector<float> rangeSums = WindowSums(range, periodD);
    std::int64_t ringSum = 0;
    for (int i = first; i < n; ++i) {
        const auto u = static_cast<std::size_t>(i);
        const std::int32_t dpct = Percent(diffSums[u], rangeSums[u]);
        r.d[u] = dpct;
        if (!slowStochastic) continue;
        ringSum += dpct;
        if (i - periodD >= first) ringSum -= *r.d[static_cast<std::size_t>(i - periodD)];
        // Every bar after K has its second smoothing; only the drawing waits for a full ring.
        r.slowd[u] = RoundToInt32(static_cast<double>(ringSum) / periodD);
    }
    return r;
}

} // namespace kori::osc
