#pragma once
// The built chart: the bars on it, the window of records they came from, the chart numbers
// every later drawing routine (overlays, tools, oscillators) reads, and the stream it writes.
#include "chart/scale.h"
#include "chart/stream_writer.h"
#include "chart/volume_scale.h"
#include "store/chart_bars.h"

#include <cstdint>
#include <string>
#include <vector>

namespace kori::chart {

// The name record's fields a chart needs.
struct ChartName {
    std::string Code;            // up to 6 characters
    std::string Name;            // 35 characters
    std::string OtherDetails;    // 15 characters
    std::int16_t RecordType = 4; // 1..3 close only (drawn as a line), 4 decimals, 5 whole numbers
    float Base = 0;              // manual scale ends; 0 means none
    float Top = 0;
    std::int16_t PercentBandUp = 5;
    std::int16_t PercentBandDown = 5;
    float PFIncrement = 0; // point-and-figure box value; 0 means automatic
};

struct Chart {
    store::ChartSeries Series; // ChartBars, LastBar and the results of the load
    std::int16_t FirstRecord = 0;
    std::int16_t LastRecord = 0;

    // Area in its own units (widened in scroll mode) and the chart numbers.
    double AreaWidth = 0, AreaHeight = 0;
    std::int16_t PlotLeft = 0, PlotRight = 0, PlotTop = 0, PlotBottom = 0;
    std::int16_t VolTop = 0, VolBottom = 0;
    std::int16_t TitleTop = 0;      // PlotTop before an upside-down swap: headings go by it
    std::int16_t SidePanelLeft = 0; // left edge of a swing or point-and-figure panel, else 0
    float ChartBase = 0, ChartCeiling = 0, GridStep = 0;
    std::int16_t GridCount = 0;
    float MaxHigh = 0, MinLow = 0;
    std::int32_t MinVolume = 0, MaxVolume = 0, AvgVolume = 0;
    bool HasVolume = false; // a volume panel is drawn

    // What the build settled: the style drawn (types 1 to 3 always 'L') and the scale kind.
    char Style = 'B';
    bool Logarithmic = false;
    std::int16_t BarSpacing = 2;

    std::vector<std::int16_t> BarCloseY; // y of each close; sized LastBar + 10
    float ChartLastClose = 0;
    bool Failed = false; // the last build stopped on a failure

    bool RedrawOnly = false; // a repaint: nothing goes to the stream
    StreamWriter Stream;
    PriceMap Map;
    VolumeMap Volumes;

    std::vector<store::ChartBar>& ChartBars() { return Series.ChartBars; }
    const std::vector<store::ChartBar>& ChartBars() const { return Series.ChartBars; }
    std::int16_t LastBar() const { return Series.LastBar; }

    // The one way from a price to y and back, for every routine that draws on the prices.
    std::int16_t PriceToY(double value) const { return Map.PriceToY(value); }
    double YToPrice(double y) const { return Map.YToPrice(y); }
};

} // namespace kori::chart
