#include "osc/osc_series.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace kori::osc {

namespace {

constexpr int kQueueWidth = 48;

template <class Int> Int Saturate(double v) {
    constexpr double lo = static_cast<double>(std::numeric_limits<Int>::min());
    constexpr double hi = static_cast<double>(std::numeric_limits<Int>::max());
    if (std::isnan(v)) return 0;
    return static_cast<Int>(std::clamp(v, lo, hi));
}

// Sliding extreme; `better(a, b)` is true when a beats b. An extreme does not depend on the
// order the values are compared in: narrow windows compare term by term across all bars (which
// the compiler vectorises), wide ones keep a queue of candidate places and make one pass.
template <class Better>
std::vector<float> WindowPick(std::span<const float> x, int width, Better better) {
    std::vector<float> out(x.begin(), x.end());
    if (width <= kQueueWidth) {
        for (std::size_t k = 1; k < static_cast<std::size_t>(std::max(width, 1)); ++k)
            for (std::size_t i = k; i < x.size(); ++i)
                out[i] = better(x[i - k], out[i]) ? x[i - k] : out[i];
        return out;
    }
    std::vector<std::size_t> queue(x.size());
    std::size_t head = 0;
    std::size_t tail = 0;
    const auto w = static_cast<std::size_t>(width);
    for (std::size_t i = 0; i < x.size(); ++i) {
        while (tail > head && !better(x[queue[tail - 1]], x[i]))
            --tail;
        queue[tail++] = i;
        if (queue[head] + w <= i) ++head;
        out[i] = x[queue[head]];
    }
    return out;
}

// Bars are summed in blocks small enough to stay in the first-level cache through all the
// terms of their windows.
constexpr int kSumBlock = 2048;

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
    for (int block = 0; block < n; block += kSumBlock) {
        const int end = std::min(n, block + kSumBlock);
        // Term k of bar i is x[i - k]; the oldest term (largest k) goes in first.
        for (int k = std::min(width, end) - 1; k >= 0; --k) {
            const int from = std::max(block, k);
            float* dst = out.data() + from;
            const float* src = x.data() + (from - k);
            const int count = end - from;
            for (int i = 0; i < count; ++i)
                dst[i] += src[i];
        }
    }
    return out;
}

std::vector<float> WindowMax(std::span<const float> x, int width) {
    return WindowPick(x, width, [](float a, float b) { return a > b; });
}

std::vector<float> WindowMin(std::span<const float> x, int width) {
    return WindowPick(x, width, [](float a, float b) { return a < b; });
}

float SumInOrder(std::span<const float> x, int first, int last) {
    float sum = 0.0f;
    for (int i = first; i <= last; ++i)
        sum += x[static_cast<std::size_t>(i)];
    return sum;
}

} // namespace kori::osc
