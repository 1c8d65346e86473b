#pragma once
// Heading, frame, price and volume scales, and the fixed grid: everything painted before the
// bars.
#include "chart/draw_context.h"

#include <string>

namespace kori::chart {

void DrawHeading(ChartPainter& p);
// `DrawGrid`: frames, volume divisions, price ticks and labels, price and vertical grid.
void DrawGrid(ChartPainter& p);

// The second heading line: period, scale kind, upside-down mark, bands or averages.
std::string HeadingLine(const ChartRequest& r, const ChartName& name, bool logarithmic,
                        bool lineChart);
// Label of a volume division, short enough for the room between the plot and the "VOL"
// letters: whole shares below 10000, then thousands ("K"), millions ("M"), billions ("G").
std::string VolumeLabel(double volume);
// Label of a price gridline.
std::string PriceLabel(float value, float range, std::int16_t recordType);
// Whether the label of gridline n shows, and the flip of the thinning switch after it.
bool LabelShows(int n, int gridCount, bool& skip);

} // namespace kori::chart
