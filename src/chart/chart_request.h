#pragma once
// The chart request: what chart selection asks for and what the chart window changes while a
// chart is on show. The builder reads it; it never writes it except to finish a split.
#include "chart/swing_method.h"

#include <cstdint>
#include <string>

namespace kori::chart {

struct ChartRequest {
    // Filled by chart selection (fields marked * are also changed by the chart window).
    char ChartStyle = 'B';        // * 'B' bar, 'C' candlestick, 'L' line, 'P' point and figure
    char ChartPeriod = 'A';       // * 'A' daily, 'W' weekly, 'M' monthly
    std::int16_t BarSpacing = 2;  // * units between bars (reversal count on 'P')
    std::int16_t ChartBands = 0;  // * 0 none, 1 percentage bands, 2 Bollinger bands
    bool AutoOsc = false;         // * an oscillator is drawn with the chart
    std::string AutoOscCode;      // * "RSI", "MACD", "STO", ...
    bool AutoOscSlow = false;     // "STO" means the slow form
    bool AvOne = false;           // moving average 1 on
    bool AvTwo = false;           // moving average 2 on
    std::int16_t AvOnePeriod = 0; // periods in use (daily or weekly pair by period)
    std::int16_t AvTwoPeriod = 0;
    bool ShowVolume = true;    // * a volume panel is wanted
    bool ByFinishDate = false; // * the chart ends at FinishDate, not at the last record
    std::string FinishDate;    // * "yyyymmdd"
    std::int16_t ListMode = 1; // 1 full list, 2..11 lists A..K, 12 list Z
    std::string ListName;
    std::int16_t ListPosition = 1; // * 1-based place in the list of the security in hand

    // State of the chart window that the build reads.
    bool UpsideDown = false;         // high prices at the bottom
    bool ShowReversals = false;      // reversal colours on bar charts
    bool DateGrid = false;           // vertical grid on the date ticks
    bool ScrollMode = false;         // the area is widened to scroll through the history
    bool SecondPanelShowing = false; // the oscillator panel (Picture2) is showing
    SidePanel SwingPanel = SidePanel::None;
    std::int16_t ChartSlot = 0; // 0 single chart, else place on a multi-chart page
    bool SplitMode = false;     // two charts on one area
    std::int16_t SplitHalf = 1; // 1 upper, 2 lower
    // Names of the two overlay averages for the heading; "unknown" leaves one out.
    std::string AverageName1 = "unknown";
    std::string AverageName2 = "unknown";
    // Overlays the chart window turns on and off.
    bool MMAOn = false;   // twelve averages replace the two
    bool PFAuto = false;  // point-and-figure box value follows the range on show
    bool SwingOn = false; // swing lines drawn with the bars
    chart::SwingMethod SwingMethod = chart::SwingMethod::Norm;
    float SwingValue = 0; // days (XDay) or points (XPoint); 0 takes 3 or 9
};

} // namespace kori::chart
