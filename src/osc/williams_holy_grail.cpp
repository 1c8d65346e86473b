#include "osc/williams_holy_grail.h"
#include "store/name_record.h"

namespace kori::osc {

WilliamsResult ComputeWilliams(const store::ChartSeries& series, std::int16_t period,
                               std::int16_t recordType) {
    const int n = BarCount(series);
    WilliamsResult result;
    result.r.assign(static_cast<std::size_t>(n), std::nullopt);
    if (period <= 0 || n <= period) return result;

    // Zeros are skipped: a bar without a figure stands as the starting value, which never wins.
    const bool closeOnly = store::IsCloseOnly(recordType);
    std::vector<float> hiC(static_cast<std::size_t>(n), -100000.0f);
    std::vector<float> loC(static_cast<std::size_t>(n), 100000.0f);
    for (std::size_t j = 0; j < hiC.size(); ++j) {
        const store::ChartBar& b = series.ChartBars[j];
        const float high = closeOnly ? b.Close : b.High;
        const float low = closeOnly ? b.Close : b.Low;
        if (high != 0) hiC[j] = high;
        if (low != 0) loC[j] = low;
    }
    const std::vector<float> hi = WindowMax(hiC, period);
    const std::vector<float> lo = WindowMin(loC, period);
    // The first bar is P, though the window of bar P - 1 would already be full.
    for (std::size_t i = static_cast<std::size_t>(period); i < hi.size(); ++i) {
        const float range = hi[i] - lo[i];
        if (hi[i] == 0 || range == 0) continue;
        result.r[i] = (hi[i] - series.ChartBars[i].Close) / range * 100.0f;
    }
    return result;
}

HolyGrailResult ComputeHolyGrail(const store::ChartSeries& series, std::int16_t period) {
    const int n = BarCount(series);
    HolyGrailResult r;
    r.col0.assign(static_cast<std::size_t>(n), std::nullopt);
    r.col1 = r.col2 = r.col0;
    const int p = period;
    if (p <= 0 || n - 1 <= p) return r;

    const std::vector<float> c = Closes(series);
    std::vector<float> col0(c.size());
    for (std::size_t i = 0; i < c.size(); ++i) {
        const float mean3 = i >= 2 ? (c[i - 2] + c[i - 1] + c[i]) / 3.0f : 0.0f;
        col0[i] = c[i] - mean3;
        r.col0[i] = col0[i];
    }
    const std::vector<float> sums1 = WindowSums(col0, p);
    std::vector<float> col1(c.size(), 0.0f);
    for (std::size_t i = static_cast<std::size_t>(p) - 1; i < c.size(); ++i) {
        col1[i] = sums1[i] / static_cast<float>(p);
        r.col1[i] = col1[i];
    }
    // The second mean counts its P values from the first bar of the first (P - 1) on.
    const std::vector<float> sums2 = WindowSums(col1, p);
    for (std::size_t i = 2 * static_cast<std::size_t>(p) - 2; i < c.size(); ++i)
        r.col2[i] = sums2[i] / static_cast<float>(p);
    return r;
}

} // namespace kori::osc
