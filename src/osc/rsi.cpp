#include "osc/rsi.h"

namespace kori::osc {

namespace {

// Moves of the pair (close j - 1, close j), kept at j. A pair whose first close is 0 (no
// trade) is dropped; a 0 as second close is a fall of the whole first close.
void PairMoves(std::span<const float> c, std::vector<float>& up, std::vector<float>& down) {
    for (std::size_t j = 1; j < c.size(); ++j) {
        const float a = c[j - 1];
        const float b = c[j];
        if (a == 0) continue;
        if (a < b) up[j] = b - a;
        if (a > b) down[j] = a - b;
    }
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
        // A sum is above 0 exactly when a move of its kind was counted.
        const float aveUp = upSums[w] > 0 ? upSums[w] / p : 0.0f;
        const float aveDown = downSums[w] > 0 ? downSums[w] / p : 0.0f;
        if (aveDown != 0) {
            const float rs = aveUp / aveDown;
            if (rs + 1.0f != 0) held = 100.0f - 100.0f / (1.0f + rs);
        }
        r.rsi[static_cast<std::size_t>(i)] = held;
    }
    return r;
}

} // namespace kori::osc
