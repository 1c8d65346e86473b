#include "osc/macd_coppock_elder.h"
#include "store/name_record.h"

namespace kori::osc {

namespace {

float Alpha(int n) {
    return 2.0f / static_cast<float>(n + 1);
}

// Mean of the n values ending at `last`, added in order.
float MeanEndingAt(std::span<const float> x, int n, int last) {
    return SumInOrder(x, last - n + 1, last) / static_cast<float>(n);
}

void CopyFrom(Series<float>& out, const std::vector<float>& values, int first) {
    for (std::size_t i = static_cast<std::size_t>(first); i < values.size(); ++i)
        out[i] = values[i];
}

// Raw Coppock figure of bar i: the two rates of change over n and n - 1 bars.
float CoppockRaw(std::span<const float> c, int i, int n) {
    const float now = c[static_cast<std::size_t>(i)];
    const float old = c[static_cast<std::size_t>(i - n)];
    const float nearer = c[static_cast<std::size_t>(i - n + 1)];
    if (now == 0 || old == 0 || nearer == 0) return 0.0f;
    const float r1 = (now - old) / old * 100.0f;
    const float r2 = (now - nearer) / nearer * 100.0f;
    return r1 + r2;
}

} // namespace

std::vector<float> SmoothSeries(std::span<const float> src, int n, int first, float seed) {
    std::vector<float> out(src.size(), 0.0f);
    if (first < 0 || first >= static_cast<int>(src.size())) return out;
    const float a = Alpha(n);
    out[static_cast<std::size_t>(first)] = seed;
    for (std::size_t i = static_cast<std::size_t>(first) + 1; i < src.size(); ++i)
        out[i] = a * src[i] + (1.0f - a) * out[i - 1];
    return out;
}

MacdResult ComputeMACD(const store::ChartSeries& series, std::int16_t p1, std::int16_t p2,
                       std::int16_t p3) {
    const int n = BarCount(series);
    MacdResult r;
    r.ema1.assign(static_cast<std::size_t>(n), std::nullopt);
    r.ema2 = r.macd = r.signal = r.ema1;
    if (p1 <= 0 || p2 <= 0 || p3 <= 0 || n < p1) return r;

    const std::vector<float> c = Closes(series);
    const int first0 = p1 - 1;
    const std::vector<float> col0 = SmoothSeries(c, p1, first0, MeanEndingAt(c, p1, first0));
    CopyFrom(r.ema1, col0, first0);
    const int first1 = p1 + p2 - 1;
    if (first1 >= n) return r;
    const std::vector<float> col1 = SmoothSeries(c, p2, first1, MeanEndingAt(c, p2, first1));
    std::vector<float> col2(c.size(), 0.0f);
    for (int i = first1; i < n; ++i) {
        const auto u = static_cast<std::size_t>(i);
        col2[u] = col0[u] - col1[u];
    }
    CopyFrom(r.ema2, col1, first1);
    CopyFrom(r.macd, col2, first1);
    const int first3 = first1 + p3;
    if (first3 >= n) return r;
    // The signal's seed adds P3 + 1 values and divides by P3.
    const float seed = SumInOrder(col2, first1, first3) / static_cast<float>(p3);
    CopyFrom(r.signal, SmoothSeries(col2, p3, first3, seed), first3);
    return r;
}

CoppockResult ComputeCoppock(const store::ChartSeries& series, std::int16_t period) {
    const int count = BarCount(series);
    CoppockResult r;
    r.coppock.assign(static_cast<std::size_t>(count), std::nullopt);
    const int n = period;
    if (n <= 0 || count < 2 || 2 * n >= count) return r;

    const std::vector<float> c = Closes(series);
    const float a = Alpha(n);
    // The seed: the ring of the first n raw figures after bar n, summed in a 32-bit integer
    // rounded at each step, over n, rounded to 16 bits.
    std::int32_t ringSum = 0;
    for (int i = n + 1; i <= 2 * n; ++i)
        ringSum = RoundToInt32(static_cast<double>(ringSum) + CoppockRaw(c, i, n));
    std::int16_t smooth = RoundToInt16(static_cast<double>(ringSum) / n);
    r.coppock[static_cast<std::size_t>(2 * n)] = smooth;
    for (int i = 2 * n + 1; i < count; ++i) {
        smooth = RoundToInt16(a * CoppockRaw(c, i, n) + (1.0f - a) * static_cast<float>(smooth));
        r.coppock[static_cast<std::size_t>(i)] = smooth;
    }
    return r;
}

ElderRayResult ComputeElderRay(const store::ChartSeries& series, std::int16_t period,
                               std::int16_t recordType) {
    const int count = BarCount(series);
    ElderRayResult r;
    r.bull.assign(static_cast<std::size_t>(count), std::nullopt);
    r.bear = r.bull;
    const int n = period;
    if (n <= 0 || count < n) return r;

    const std::vector<float> c = Closes(series);
    const std::vector<float> ave = SmoothSeries(c, n, n - 1, MeanEndingAt(c, n, n - 1));
    for (int i = n - 1; i < count; ++i) {
        const auto u = static_cast<std::size_t>(i);
        const store::ChartBar& b = series.ChartBars[u];
        const bool closeOnly = store::IsCloseOnly(recordType);
        r.bull[u] = (closeOnly ? b.Close : b.High) - ave[u];
        r.bear[u] = (closeOnly ? b.Close : b.Low) - ave[u];
    }
    return r;
}

} // namespace kori::osc
