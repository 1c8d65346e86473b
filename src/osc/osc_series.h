#pragma once
// Shared pieces of the oscillator computations: the per-bar series type, where "no value"
// marks a bar the routine computed nothing for, the rounding rules of the original number
// types, and window sums that keep the order of the original's re-added windows.
#include "store/chart_bars.h"

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

namespace kori::osc {

template <class T> using Series = std::vector<std::optional<T>>;

// Bars 0 to LastBar that the series really holds.
int BarCount(const store::ChartSeries& series);
std::vector<float> Closes(const store::ChartSeries& series);

// Round to nearest, ties to even, into the integer widths of the routines. A result the
// width cannot hold stops at its limit instead of wrapping.
std::int16_t RoundToInt16(double v);
std::int32_t RoundToInt32(double v);
// Integer part (toward zero) into 16 bits, with the same limits.
std::int16_t TruncToInt16(double v);

// out[i] = x[i - width + 1] + ... + x[i], added oldest first from 0 in 32-bit floats, as a
// window re-added at every bar gives it; values before bar 0 count as 0. The bars are
// worked side by side so that each keeps its own order of addition.
std::vector<float> WindowSums(std::span<const float> x, int width);
// Largest and smallest of the same windows (bars before 0 are left out).
std::vector<float> WindowMax(std::span<const float> x, int width);
std::vector<float> WindowMin(std::span<const float> x, int width);

// Plain sum of x[first..last] in order, in 32-bit floats.
float SumInOrder(std::span<const float> x, int first, int last);

} // namespace kori::osc
