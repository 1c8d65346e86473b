#include "osc/rsi.h"

namespace kori::osc {

namespace {

// The move of the pair (a, b). A pair whose first close is 0 (no trade) is dropped; a 0 as
// second close is a fall of the whole first close.
void PairMove(float a, float b, float& up, float& down) {
    if (a == 0) return;
    if (a < b) up = b - a;
    if (a > b) down = a - b;
}

// Moves of the pair (close j - 1, close j), kept at j.
void PairMoves(std::span<const float> c, std::vector<float>& up, std::vector<float>& down) {
    for (std::size_t j = 1; j < c.size(); ++j)
        PairMove(c[j - 1], c[j], up[j], down[j]);
}

// The figure of averages of a window, nullopt when it holds no fall.
std::optional<float> Figure(float upSum, float downSum, float p) {
    // A sum is above 0 exactly when a move of its kind was counted.
    const float aveUp = upSum > 0 ? upSum / p : 0.0f;
    const float aveDown = downSum > 0 ? downSum / p : 0.0f;
    if (aveDown == 0) return std::nullopt;
    const float rs = aveUp / aveDown;
    if (rs + 1.0f == 0) return std::nullopt;
    return 100.0f - 100.0f / (1.0f + rs);
}

} // namespace

RsiResult ComputeRSI(const store::ChartSeries& series, std::int16_t period) {
    const int n = BarCount(series);
    RsiResult r;
    r.rsi.assign(static_cast<std::size_t>(n), std::nullopt);
    if (period <= 0 || n <= period) return r;

    const std::vector<float> c = Closes(series);
    std::vector<float> up(c.size(), 0.0f);
    std::vector<float> down(c.size(), 0.0f);
    PairMoves(c, up, down);
    // The window of bar i is the P - 1 pairs ending at the pair (i - 2, i - 1).
    const std::vector<float> upSums = WindowSums(up, period - 1);
    const std::vector<float> downSums = WindowSums(down, period - 1);

    const float p = period;
    std::optional<float> held;
    for (int i = period; i < n; ++i) {
        const auto w = static_cast<std::size_t>(i - 1);
        if (const auto f = Figure(upSums[w], downSums[w], p)) held = f;
        r.rsi[static_cast<std::size_t>(i)] = held;
    }
    return r;
}

std::optional<float> RsiWindowFigure(std::span<const float> closes, std::int16_t period,
                                     std::size_t i) {
    const auto p = static_cast<std::size_t>(period);
    if (period <= 0 || i < p || i >= closes.size()) return std::nullopt;
    float upSum = 0, downSum = 0;
    for (std::size_t j = i - p + 1; j < i; ++j) {
        float up = 0, down = 0;
        PairMove(closes[j - 1], closes[j], up, down);
        upSum += up;
        downSum += down;
    }
    return Figure(upSum, downSum, static_cast<float>(period));
}

} // namespace kori::osc
