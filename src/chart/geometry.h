#pragma once
// Where a chart goes on its area, and which price records fall on it.
#include "chart/chart_request.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace kori::chart {

struct PlotGeometry {
    std::int16_t PlotLeft = 0, PlotRight = 0, PlotTop = 0, PlotBottom = 0;
};

// The price panel on an area of width x height, before any volume panel or upside-down swap.
PlotGeometry ComputePlotGeometry(double width, double height, const ChartRequest& r);

struct Panels {
    std::int16_t PlotTop = 0, PlotBottom = 0, VolTop = 0, VolBottom = 0;
    std::int16_t TitleTop = 0; // PlotTop before the swap
};
// Takes the bottom fifth of the plot for volumes when they show (the price panel ends a few
// units above it), then swaps PlotTop and PlotBottom for an upside-down chart. Without
// volumes the volume panel is the line at the plot's bottom, where the date axis hangs.
Panels LayOutPanels(const PlotGeometry& g, bool showVolume, bool upsideDown);

struct WindowInputs {
    double AreaWidth = 0;
    std::int16_t PlotLeft = 5;
    std::int16_t BlankRight = 0;
    std::int16_t BarSpacing = 2;
    char ChartStyle = 'B';
    char ChartPeriod = 'A';
    float WeeksFactor = 4.75f;
    bool ScrollMode = false;
    double ZoomFactor = 1; // display scale of the chart window: Zoom / 100
    SidePanel SwingPanel = SidePanel::None;
    std::int16_t RecordCount = 0;
    bool ByFinishDate = false;
    std::string FinishDate;
};

struct RecordWindow {
    std::int16_t FirstRecord = 1;
    std::int16_t LastRecord = 0;
    double AreaWidth = 0;           // widened in scroll mode
    std::int16_t SidePanelLeft = 0; // 0 without a side panel
};

// `dateOf(record)` gives the "yyyymmdd" of a price record, read only for a finish date.
RecordWindow ComputeRecordWindow(const WindowInputs& in,
                                 const std::function<std::string(std::int16_t)>& dateOf);

// PlotRight for an area width: 99% of it less the room for the price labels.
std::int16_t PlotRightFor(double width);

// A rectangle in chart units, Top above Bottom on the screen whatever the chart's way up.
struct PlotRect {
    double Left = 0, Top = 0, Right = 0, Bottom = 0;
};
struct ClippedLine {
    double X1 = 0, Y1 = 0, X2 = 0, Y2 = 0;
};
// The part of a line inside the frame (edges included); nullopt when none of it is.
std::optional<ClippedLine> ClipToFrame(const PlotRect& f, double x1, double y1, double x2,
                                       double y2);

} // namespace kori::chart
