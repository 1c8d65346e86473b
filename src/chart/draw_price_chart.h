#pragma once
// The second half of a build: with the bars loaded, settle the panels and the scale, refuse
// what cannot be drawn, and paint heading, grid, bars and trailing labels.
#include "chart/chart.h"
#include "chart/draw_context.h"
#include "chart/geometry.h"
#include "platform/dialogs.h"
#include "platform/status.h"
#include "platform/surface.h"

namespace kori::chart {

// Panels, scale and mapping for the loaded `c.Series`. A manual scale with no ends and a
// logarithmic scale over 0 or less show their messages; a degenerate scale stops quietly.
// Nothing is drawn when this fails.
platform::Status SettleLoadedChart(Chart& c, const DrawInputs& in, const PlotGeometry& g,
                                   platform::Dialogs& dialogs);

// Heading, frame and grid, bars, trailing labels, in that order, on a settled chart.
void DrawPriceChart(Chart& c, const DrawInputs& in, platform::Surface& surface);

// Both, with the area cleared first unless this chart shares its area with one drawn before.
platform::Status DrawLoadedChart(Chart& c, const DrawInputs& in, const PlotGeometry& g,
                                 platform::Dialogs& dialogs, platform::Surface& surface);

// The style drawn: securities of types 1 to 3 carry a close only and are always a line.
char EffectiveStyle(const ChartRequest& r, const ChartName& name);

} // namespace kori::chart
