#pragma once
// The parabolic stop over the bars ("PARA"), or over the close line ("PARAV"): a dot a bar in
// the colour of the direction (none beyond the plot's frame), and on "PARA" the last stop
// written in the top row, right-aligned to the plot.
#include "chart/draw_context.h"

#include <optional>
#include <vector>

namespace kori::chart {

namespace pal {
inline constexpr int ParabolicUp = 38, ParabolicDown = 40, ParabolicTextUp = 45,
                     ParabolicTextDown = 46;
}

struct ParabolicBar {
    double High = 0, Low = 0;
};

struct ParabolicPoint {
    int Bar = 0;     // index into the series
    double Stop = 0; // in the series' own units
    char Direction = 'U';
};

// The stop of each bar from the one after the start bar on; empty when the direction search
// never settles (fewer than a handful of new extremes, or fewer than two bars).
std::vector<ParabolicPoint> ComputeParabolic(const std::vector<ParabolicBar>& bars);

void DrawParabolic(ChartPainter& p, bool onAverage);

// The y of the last stop's text: the row of the trailing labels.
double ParabolicTextY(const ChartRequest& r, const Chart& c);

// "0.000" below 0.2, "0.00" otherwise.
std::string ParabolicStopText(double stop);

} // namespace kori::chart
