#pragma once
// Lines over the bars of a single chart, drawn after the bar loop: the two moving averages or
// the twelve multiple averages (on the close y, not on prices), percentage or Bollinger bands,
// and the parabolic stop when that is the oscillator in view.
#include "chart/draw_context.h"

#include <cstdint>
#include <vector>

namespace kori::chart {

namespace pal {
inline constexpr int Average1 = 20, Average2 = 21, Bands = 41, MMAShort = 43, MMALong = 44;
}

// The averages walk `yArray` from index 0, the first bar standing at left + spacing. A period
// of 0 or less, or one longer than the bars, draws nothing. `which` 1 streams "L", 2 "H".
void SimpleAverageLine(ChartPainter& p, int period, int barCount,
                       const std::vector<std::int16_t>& yArray, int entry, double left,
                       double spacing, int which);
void ExponentialAverageLine(ChartPainter& p, int period, int barCount,
                            const std::vector<std::int16_t>& yArray, int entry, double left,
                            double spacing, int which);

void DrawMMA(ChartPainter& p);
// Both band routines overwrite a zero close in ChartBars with the close before it.
void DrawPercentBands(ChartPainter& p);
void DrawBollinger(ChartPainter& p);

// Period of the Bollinger bands by chart period, 21 outside 1 to 100.
std::int16_t BollingerPeriod(const ChartDefaults& d, char chartPeriod);

// The whole set in its order, on single charts that are not point and figure.
void DrawChartOverlays(ChartPainter& p);

} // namespace kori::chart
