#pragma once
// What the mouse tools of the chart window compute: trendlines to and from their records,
// Fibonacci retracement levels and time lines, Gann fans. Pure geometry over the numbers of
// the chart in hand; the window draws the results and writes them to the streams.
#include "store/chart_bars.h"
#include "store/trendline_file.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace kori::chart {

using store::TrendRecord;

struct ToolFrame {
    double PlotLeft = 0, PlotRight = 0, PlotTop = 0, PlotBottom = 0;
    int BarSpacing = 1;
    bool UpsideDown = false;
    char ChartPeriod = 'A';
    const std::vector<store::ChartBar>* Bars = nullptr;
    int LastBar = -1;
    std::function<double(double)> PriceToY; // price -> y by the scale in force
    std::function<double(double)> YToPrice; // y -> price

    int Spacing() const { return BarSpacing == 0 ? 1 : BarSpacing; }
    // Index of the bar under x (may lie beyond the last bar or before the first).
    int BarIndexAt(double x) const;
    double XOfBar(int index) const { return PlotLeft + index * static_cast<double>(Spacing()); }
};

struct Segment {
    double x1, y1, x2, y2;
    int PaletteEntry;
    char Letter; // stream letter it goes out as
};

// x of the first bar on or after `date` ("yyyymmdd"); 0 when there is none.
double DateToX(const ToolFrame& f, std::string_view date);

// A line drawn with the mouse, as its record; nullopt when the two ends are the same point.
std::optional<TrendRecord> MakeTrendRecord(const ToolFrame& f, double x1, double y1, double x2,
                                           double y2);

struct TrendEnds {
    int RecordNumber; // 1-based place in the .TND file
    double xA, yA, xB, yB;
};
// Lines of the file to draw on this chart, by the replay rules.
std::vector<TrendEnds> ReplayTrendlines(const ToolFrame& f,
                                        const std::vector<TrendRecord>& records);
// The line nearest to a click, or -1 when there are none.
int NearestTrendline(const std::vector<TrendEnds>& ends, double x, double y);

struct FibLevel {
    double Price;
    const char* StatusText;
    int PaletteEntry;
};
// The three retracement levels from start to end; none when the rise is negative.
std::vector<FibLevel> FibonacciLevels(double startPrice, double endPrice);
// The dotted lines of the levels, from the x of the second click.
std::vector<Segment> FibonacciLines(const ToolFrame& f, double x,
                                    const std::vector<FibLevel>& levels);

// Six lines of a Gann fan from a click; empty outside the plot.
std::vector<Segment> GannFan(const ToolFrame& f, double x, double y, bool rising);

// x positions of Fibonacci time lines from a bar: counts of trading bars, or of calendar days,
// weeks or months (by the chart's period) from the bar's date.
std::vector<double> FibTimeLines(const ToolFrame& f, int fromBar, bool calendar);

// Adds `count` days, weeks or months (by period 'A', 'W', 'M') to a "yyyymmdd" date.
std::string AddCalendarPeriods(std::string_view date, char period, int count);

} // namespace kori::chart
