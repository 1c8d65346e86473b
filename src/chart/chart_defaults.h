#pragma once
// Chart defaults: the [Charts] keys of Kori.ini (and the few chart keys kept in other sections)
// with each reader's default and bounds. Applied to every new chart; the chart window may
// override a copy for the chart in hand.
#include "chart/chart_request.h"
#include "platform/ini_file.h"

#include <array>
#include <cstdint>
#include <string>

namespace kori::chart {

inline constexpr std::array<std::int16_t, 12> kDefaultMMAPeriods = {3,  5,  8,  10, 12, 15,
                                                                    30, 35, 40, 45, 50, 60};

struct ChartDefaults {
    // Averages.
    std::int16_t MAPeriod1Daily = 10; // "Av1D"
    std::int16_t MAPeriod2Daily = 30; // "Av2D"
    std::int16_t MAPeriod1Long = 10;  // "Av1W"
    std::int16_t MAPeriod2Long = 30;  // "Av2W"
    bool MA1On = false;               // "AvOne"
    bool MA2On = false;               // "AvTwo"
    bool MAExponential = false;       // "AvCalc"
    // Scales.
    bool AutoScale = true;          // "ScMethod": unknown scales by itself
    bool LogBars = false;           // "BCCalTp"
    bool LogLine = false;           // "LCalTp"
    bool LogVolume = false;         // "VCalTp"
    bool LimitVolumeHeight = false; // "CutVols"
    bool ShowOscSettings = false;   // "ShowOsc"
    bool ClassicMACD = true;        // "NoClassicMACD", stored inverted
    std::array<std::int16_t, 12> MMAPeriods = kDefaultMMAPeriods; // "MMASet"
    std::int16_t BollingerDaily = 21; // [OscDef] "BBA", 21 outside 1 to 100
    std::int16_t BollingerLong = 21;  // [OscDef] "BBW"
    std::string CompFile;             // "CompFile": RMO/RMX compare file
    // Keys of the chart window's section.
    float PrintScale = 1.5f;               // "EFact"
    std::int16_t PrintLineWidth = 2;       // "Line Width", 1 to 10
    std::int16_t BlankRight = 0;           // "DBlank"
    double VerticalGridSpace = 0;          // "VGSpace": 0 turns the vertical grid off
    double MidGrid = 0;                    // "MidGrid": price grid at half steps when not 0
    bool ShowPriceGrid = false;            // "Grid"
    std::int16_t VolumeMultiple = 1;       // "VHeight"
    float WeeksFactor = 4.75f;             // "WeekFactor"
    bool StopLossOn = false;               // "StopLoss"
    bool StopPercentOn = false;            // "SL Percent" above 0
    float StopPercent = 0;                 // "SL Percent"
    std::int32_t ChartW = 0, ChartH = 0;   // "Cw", "Ch": printer chart size
    std::int32_t ScreenW = 0, ScreenH = 0; // "SW", "SH": the screen they relate to
    std::int16_t Zoom = 100;               // [ChartForms] "Zoom": display scale in per cent
    std::int16_t Divs = 0;                 // [Adjustments] "Divs": divisions of a multi-chart page
};

// Reads every key in the order of the tables; absent keys take the defaults above.
ChartDefaults LoadChartDefaults(const platform::IniFile& ini);
void SaveChartDefaults(platform::IniFile& ini, const ChartDefaults& d);

// The chart selection keys of [Charts]: "Type", "Period", "Bands", "Spacing", "AvOne", "AvTwo".
void LoadChartRequestSettings(const platform::IniFile& ini, ChartRequest& r);
// Writes "Type", "Period", "Spacing", "Bands", "AutoOsc", "List", "AvOne", "AvTwo".
void SaveChartRequestSettings(platform::IniFile& ini, const ChartRequest& r);

// Number of the ini text as a 16-bit integer: rounded to nearest, held inside the type.
std::int16_t IniInt16(const std::string& text);

} // namespace kori::chart
