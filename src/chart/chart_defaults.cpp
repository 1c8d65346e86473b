#include "chart/chart_defaults.h"

#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace kori::chart {

namespace {
constexpr std::string_view kCharts = "Charts";
constexpr std::string_view kChartForms = "ChartForms";
constexpr std::string_view kAdjustments = "Adjustments";

bool ReadBool(const platform::IniFile& ini, std::string_view key, bool whenUnknown) {
    const std::string v = ini.Read(kCharts, key);
    if (v == platform::kUnknown) return whenUnknown;
    return platform::EqualsNoCase(platform::Trim(v), "True");
}

std::int32_t IniInt32(const std::string& text) {
    const double v = std::nearbyint(platform::Val(text));
    if (!(v >= std::numeric_limits<std::int32_t>::min()))
        return std::numeric_limits<std::int32_t>::min();
    if (!(v <= std::numeric_limits<std::int32_t>::max()))
        return std::numeric_limits<std::int32_t>::max();
    return static_cast<std::int32_t>(v);
}

std::int16_t ReadInt16(const platform::IniFile& ini, std::string_view section,
                       std::string_view key) {
    return IniInt16(ini.Read(section, key));
}

std::int16_t ReadPeriod(const platform::IniFile& ini, std::string_view key, std::int16_t def) {
    const std::string v = ini.Read(kCharts, key);
    return v == platform::kUnknown ? def : IniInt16(v);
}

std::array<std::int16_t, 12> ParseMMA(const std::string& text) {
    if (text == platform::kUnknown) return kDefaultMMAPeriods;
    std::array<std::int16_t, 12> out{};
    std::size_t start = 0;
    for (std::size_t i = 0; i < out.size() && start <= text.size(); ++i) {
        const std::size_t comma = std::min(text.find(',', start), text.size());
        out[i] = IniInt16(text.substr(start, comma - start));
        start = comma + 1;
    }
    return out;
}

std::string Number(double v) {
    return platform::Trim(platform::Str(v));
}
std::string Single(float v) {
    return platform::Trim(platform::StrSingle(v));
}
const char* Bool(bool b) {
    return b ? "True" : "False";
}

void LoadAverages(const platform::IniFile& ini, ChartDefaults& d) {
    d.MAPeriod1Daily = ReadPeriod(ini, "Av1D", d.MAPeriod1Daily);
    d.MAPeriod2Daily = ReadPeriod(ini, "Av2D", d.MAPeriod2Daily);
    d.MAPeriod1Long = ReadPeriod(ini, "Av1W", d.MAPeriod1Long);
    d.MAPeriod2Long = ReadPeriod(ini, "Av2W", d.MAPeriod2Long);
    d.MA1On = ReadBool(ini, "AvOne", false);
    d.MA2On = ReadBool(ini, "AvTwo", false);
    d.MAExponential = ReadBool(ini, "AvCalc", false);
}

void LoadScales(const platform::IniFile& ini, ChartDefaults& d) {
    d.AutoScale = ReadBool(ini, "ScMethod", true);
    d.LogBars = ReadBool(ini, "BCCalTp", false);
    d.LogLine = ReadBool(ini, "LCalTp", false);
    d.LogVolume = ReadBool(ini, "VCalTp", false);
    d.LimitVolumeHeight = ReadBool(ini, "CutVols", false);
    d.ShowOscSettings = ReadBool(ini, "ShowOsc", false);
    d.ClassicMACD = !ReadBool(ini, "NoClassicMACD", false);
    d.MMAPeriods = ParseMMA(ini.Read(kCharts, "MMASet"));
    const std::string comp = ini.Read(kCharts, "CompFile");
    d.CompFile = comp == platform::kUnknown ? "" : comp;
    const auto bollinger = [&ini](std::string_view key) {
        const std::int16_t n = IniInt16(ini.Read("OscDef", key));
        return n >= 1 && n <= 100 ? n : std::int16_t{21};
    };
    d.BollingerDaily = bollinger("BBA");
    d.BollingerLong = bollinger("BBW");
}

void LoadWindowKeys(const platform::IniFile& ini, ChartDefaults& d) {
    const std::string efact = ini.Read(kCharts, "EFact");
    const float scale = static_cast<float>(platform::Val(efact));
    d.PrintScale = (efact == platform::kUnknown || !(scale > 0)) ? 1.5f : scale;
    d.PrintLineWidth = ReadInt16(ini, kCharts, "Line Width");
    if (d.PrintLineWidth < 1 || d.PrintLineWidth > 10) d.PrintLineWidth = 2;
    d.BlankRight = ReadInt16(ini, kCharts, "DBlank");
    d.VerticalGridSpace = platform::Val(ini.Read(kCharts, "VGSpace"));
    d.MidGrid = platform::Val(ini.Read(kCharts, "MidGrid"));
    d.ShowPriceGrid = ReadBool(ini, "Grid", false);
    // The upper bound sits inside the lower bound's branch, so a stored 4 or 5 stands.
    d.VolumeMultiple = ReadInt16(ini, kCharts, "VHeight");
    if (d.VolumeMultiple < 1) {
        d.VolumeMultiple = 1;
        if (d.VolumeMultiple > 3) d.VolumeMultiple = 3;
    }
    d.WeeksFactor = static_cast<float>(platform::Val(ini.Read(kCharts, "WeekFactor")));
    if (d.WeeksFactor < 4.0f || d.WeeksFactor > 5.2f) d.WeeksFactor = 4.75f;
    d.StopLossOn = ReadBool(ini, "StopLoss", false);
    d.StopPercent = static_cast<float>(platform::Val(ini.Read(kCharts, "SL Percent")));
    d.StopPercentOn = d.StopPercent > 0;
    d.ChartW = IniInt32(ini.Read(kCharts, "Cw"));
    d.ChartH = IniInt32(ini.Read(kCharts, "Ch"));
    d.ScreenW = IniInt32(ini.Read(kCharts, "SW"));
    d.ScreenH = IniInt32(ini.Read(kCharts, "SH"));
    d.Zoom = ReadInt16(ini, kChartForms, "Zoom");
    if (d.Zoom < 50 || d.Zoom > 200) d.Zoom = 100;
    d.Divs = ReadInt16(ini, kAdjustments, "Divs");
}
} // namespace

std::int16_t IniInt16(const std::string& text) {
    const double v = std::nearbyint(platform::Val(text));
    if (!(v >= -32768.0)) return -32768;
    if (!(v <= 32767.0)) return 32767;
    return static_cast<std::int16_t>(v);
}

ChartDefaults LoadChartDefaults(const platform::IniFile& ini) {
    ChartDefaults d;
    LoadAverages(ini, d);
    LoadScales(ini, d);
    LoadWindowKeys(ini, d);
    return d;
}

void SaveChartDefaults(platform::IniFile& ini, const ChartDefaults& d) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    ini.Write(kCharts, "Av1D", Number(d.MAPeriod1Daily));
    ini.Write(kCharts, "Av2D", Number(d.MAPeriod2Daily));
    ini.Write(kCharts, "Av1W", Number(d.MAPeriod1Long));
    ini.Write(kCharts, "Av2W", Number(d.MAPeriod2Long));
    ini.Write(kCharts, "AvOne", Bool(d.MA1On));
    ini.Write(kCharts, "AvTwo", Bool(d.MA2On));
    ini.Write(kCharts, "AvCalc", Bool(d.MAExponential));
    ini.Write(kCharts, "ScMethod", Bool(d.AutoScale));
    ini.Write(kCharts, "BCCalTp", Bool(d.LogBars));
    ini.Write(kCharts, "LCalTp", Bool(d.LogLine));
    ini.Write(kCharts, "VCalTp", Bool(d.LogVolume));
    ini.Write(kCharts, "CutVols", Bool(d.LimitVolumeHeight));
    ini.Write(kCharts, "ShowOsc", Bool(d.ShowOscSettings));
    ini.Write(kCharts, "NoClassicMACD", Bool(!d.ClassicMACD));
    std::string mma;
    for (std::size_t i = 0; i < d.MMAPeriods.size(); ++i) {
        if (i > 0) mma += ',';
        mma += Number(d.MMAPeriods[i]);
    }
    ini.Write(kCharts, "MMASet", mma);
    ini.Write(kCharts, "CompFile", d.CompFile);
    ini.Write(kCharts, "EFact", Single(d.PrintScale));
    ini.Write(kCharts, "Line Width", Number(d.PrintLineWidth));
    ini.Write(kCharts, "DBlank", Number(d.BlankRight));
    ini.Write(kCharts, "VGSpace", Number(d.VerticalGridSpace));
    ini.Write(kCharts, "MidGrid", Number(d.MidGrid));
    ini.Write(kCharts, "Grid", Bool(d.ShowPriceGrid));
    ini.Write(kCharts, "VHeight", Number(d.VolumeMultiple));
    ini.Write(kCharts, "WeekFactor", Single(d.WeeksFactor));
    ini.Write(kCharts, "StopLoss", Bool(d.StopLossOn));
    ini.Write(kCharts, "SL Percent", Single(d.StopPercentOn ? d.StopPercent : 0.0f));
    ini.Write(kCharts, "Cw", Number(d.ChartW));
    ini.Write(kCharts, "Ch", Number(d.ChartH));
    ini.Write(kCharts, "SW", Number(d.ScreenW));
    ini.Write(kCharts, "SH", Number(d.ScreenH));
    ini.Write(kChartForms, "Zoom", Number(d.Zoom));
    ini.Write(kAdjustments, "Divs", Number(d.Divs));
}

void LoadChartRequestSettings(const platform::IniFile& ini, ChartRequest& r) {
    const std::string type = platform::Upper(platform::Trim(ini.Read(kCharts, "Type")));
    if (type == "UNKNOWN")
        r.ChartStyle = 'B';
    else if (type == "B" || type == "C" || type == "P")
        r.ChartStyle = type[0];
    else
        r.ChartStyle = 'L';
    const std::string period = platform::Upper(platform::Trim(ini.Read(kCharts, "Period")));
    r.ChartPeriod = (period == "W" || period == "M") ? period[0] : 'A';
    const std::int16_t bands = ReadInt16(ini, kCharts, "Bands");
    r.ChartBands = (bands == 1 || bands == 2) ? bands : 0;
    const std::int16_t spacing = ReadInt16(ini, kCharts, "Spacing");
    r.BarSpacing = (spacing <= 0 || spacing > 10) ? 2 : spacing;
    r.AvOne = ReadBool(ini, "AvOne", false);
    r.AvTwo = ReadBool(ini, "AvTwo", false);
}

void SaveChartRequestSettings(platform::IniFile& ini, const ChartRequest& r) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    ini.Write(kCharts, "Type", std::string(1, r.ChartStyle));
    ini.Write(kCharts, "Period", std::string(1, r.ChartPeriod));
    ini.Write(kCharts, "Spacing", Number(r.BarSpacing));
    ini.Write(kCharts, "Bands", Number(r.ChartBands));
    ini.Write(kCharts, "AutoOsc", Bool(r.AutoOsc));
    ini.Write(kCharts, "List", Number(r.ListMode));
    ini.Write(kCharts, "AvOne", Bool(r.AvOne));
    ini.Write(kCharts, "AvTwo", Bool(r.AvTwo));
}

} // namespace kori::chart
