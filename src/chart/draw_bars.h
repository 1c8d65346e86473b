#pragma once
// The bar loop: each bar in its style and colour, its volume line, note mark, ten-bar trace
// point and date tick; then the stop-loss read-out on the screen.
#include "chart/draw_context.h"

#include <cstdint>

namespace kori::chart {

// y of one bar's prices (smaller is higher).
struct BarYs {
    std::int16_t High = 0, Open = 0, Low = 0, Close = 0;
};

struct BarClass {
    int Entry = pal::Bars;        // palette entry of this bar
    bool PivotOnPrevious = false; // the bar before is redrawn as a pivot point
};

// Reversal colours of a bar from the one or two bars before it (null when there are none).
// Later tests override earlier ones; a pivot colours the previous bar and leaves this one plain.
BarClass ClassifyBar(const BarYs& bar, const BarYs* prev, const BarYs* prev2);

void DrawBars(ChartPainter& p);

} // namespace kori::chart
