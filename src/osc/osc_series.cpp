#include "osc/osc_series.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace kori::osc {

namespace {

template <class Int> Int Saturate(double v) {
    constexpr double lo = static_cast<double>(std::numeric_limits<Int>::min());
    constexpr double hi = static_cast<double>(std::numeric_limits<Int>::max());
    if (std::isnan(v)) return 0;
    return static_cast<Int>(std::clamp(v, lo, hi));
}

template <class Pick>
std::vector<float> WindowPick(std::span<const float> x, int width, Pick pick) {
    const int n = static_cast<int>(x.size());
    std::vector<float> out(x.begin(), x.end());
    for (int k = 1; k < width; ++k)
        for (int i = k; i < n; ++i)
            out[static_cast<std::size_t>(i)] =
                pick(out[static_cast<std::size_t>(i)], x[static_cast<std::size_t>(i - k)]);
    return out;
}

} // namespace

int BarCount(const store::ChartSeries& series) {
    const int held = static_cast<int>(series.ChartBars.size());
    return std::clamp(series.LastBar + 1, 0, held);
}

std::vector<float> Closes(const store::ChartSeries& series) {
    std::vector<float> c(static_cast<std::size_t>(BarCount(series)));
    for (std::size_t i = 0; i < c.size(); ++i)
        c[i] = series.ChartBars[i].Close;
    return c;
}

std::int16_t RoundToInt16(double v) {
    return Saturate<std::int16_t>(std::nearbyint(v));
}
std::int32_t RoundToInt32(double v) {
    return Saturate<std::int32_t>(std::nearbyint(v));
}
std::int16_t TruncToInt16(double v) {
    return Saturate<std::int16_t>(std::trunc(v));
}

std::vector<float> WindowSums(std::span<const float> x, int width) {
    const int n = static_cast<int>(x.size());
    std::vector<float> out(x.size(), 0.0f);
    // Term k of bar i is x[i - k]; the oldest term (largest k) goes in first.
    for (int k = std::min(width, n) - 1; k >= 0; --k) {
        const float* src = x.data();
        float* dst = out.data() + k;
        const int count = n - k;
        for (int i = 0; i < count; ++i)
            dst[i] += src[i];
    }
    return out;
}

std::vector<float> WindowMax(std::span<const float> x, int width) {
    return WindowPick(x, width, [](float a, float b) { return b > a ? b : a; });
}

std::vector<float> WindowMin(std::span<const float> x, int width) {
    return WindowPick(x, width, [](float a, float b) { return b < a ? b : a; });
}

float SumInOrder(std::span<const float> x, int first, int last) {
    float sum = 0.0f;
    for (int i = first; i <= last; ++i)
        sum += x[static_cast<std::size_t>(i)];
    return sum;
}

} // namespace kori::osc
