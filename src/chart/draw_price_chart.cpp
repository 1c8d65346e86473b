#include "chart/draw_price_chart.h"
#include "store/name_record.h"

#include "chart/draw_bars.h"
#include "chart/draw_frame.h"
#include "chart/draw_labels.h"

namespace kori::chart {

namespace {

constexpr std::string_view kChartDisplay = "Chart Display";

void TakeLoadResults(Chart& c, const ChartRequest& r) {
    const store::LoadResults& res = c.Series.Results;
    c.MaxHigh = res.HighestPrice;
    c.MinLow = res.LowestPrice;
    c.MaxVolume = res.HighestVolume;
    c.MinVolume = res.LowestVolume;
    c.AvgVolume = res.AverageVolume;
    c.HasVolume = r.ShowVolume && res.VolumesPresent;
}

void TakePanels(Chart& c, const PlotGeometry& g, bool upsideDown) {
    const Panels p = LayOutPanels(g, c.HasVolume, upsideDown);
    c.PlotLeft = g.PlotLeft;
    c.PlotRight = g.PlotRight;
    c.PlotTop = p.PlotTop;
    c.PlotBottom = p.PlotBottom;
    c.VolTop = p.VolTop;
    c.VolBottom = p.VolBottom;
    c.TitleTop = p.TitleTop;
}

platform::Status TakeScale(Chart& c, const DrawInputs& in, platform::Dialogs& dialogs) {
    ScaleEnds ends;
    if (in.Defaults.AutoScale) {
        ends = AutoScaleEnds(c.MaxHigh, c.MinLow);
    } else if (const auto manual = ManualScale(in.Name.Base, in.Name.Top)) {
        ends = *manual;
    } else {
        c.ChartBase = c.ChartCeiling = 0;
        c.Failed = true;
        dialogs.Beep();
        const std::string text = ManualScaleMessage(in.Name.Code);
        dialogs.MsgBox(text, kChartDisplay);
        return platform::Status::Error(text);
    }
    c.ChartBase = ends.ChartBase;
    c.ChartCeiling = ends.ChartCeiling;
    const GridSteps g = ComputeGridStep(c.ChartBase, c.ChartCeiling);
    c.GridStep = g.GridStep;
    c.GridCount = g.GridCount;
    return platform::Status::Ok();
}

} // namespace

char EffectiveStyle(const ChartRequest& r, const ChartName& name) {
    if (store::IsCloseOnly(name.RecordType)) return 'L';
    const char s = r.ChartStyle;
    if (s == 'b' || s == 'B') return 'B';
    if (s == 'c' || s == 'C') return 'C';
    if (s == 'p' || s == 'P') return 'P';
    return 'L';
}

platform::Status SettleLoadedChart(Chart& c, const DrawInputs& in, const PlotGeometry& g,
                                   platform::Dialogs& dialogs) {
    const ChartRequest& r = in.Request;
    c.Failed = false;
    c.Style = EffectiveStyle(r, in.Name);
    c.BarSpacing = r.BarSpacing == 0 ? std::int16_t{2} : r.BarSpacing;
    TakeLoadResults(c, r);
    TakePanels(c, g, r.UpsideDown);
    if (auto s = TakeScale(c, in, dialogs); !s) return s;
    c.Logarithmic = c.Style == 'L' ? in.Defaults.LogLine : in.Defaults.LogBars;
    if (c.Logarithmic && c.ChartBase <= 0) {
        dialogs.MsgBox(kLogRefusalText, kLogRefusalTitle);
        return platform::Status::Error(std::string(kLogRefusalText));
    }
    if (!c.Map.Prepare(c.Logarithmic, c.Style == 'L', c.ChartBase, c.ChartCeiling, c.PlotTop,
                       c.PlotBottom))
        return platform::Status::Error("The chart has no usable price scale.");
    if (c.HasVolume) {
        VolumeScaleInputs v;
        v.Logarithmic = in.Defaults.LogVolume;
        v.LimitHeight = in.Defaults.LimitVolumeHeight;
        v.VolTop = c.VolTop;
        v.VolBottom = c.VolBottom;
        v.PlotTop = c.PlotTop;
        v.MinVolume = c.MinVolume;
        v.MaxVolume = c.MaxVolume;
        v.AvgVolume = c.AvgVolume;
        v.VolumeMultiple = c.Style == 'L' ? std::int16_t{3} : in.Defaults.VolumeMultiple;
        c.Volumes.Prepare(v);
    }
    c.BarCloseY.assign(static_cast<std::size_t>(std::max<int>(c.LastBar(), -1) + 10), 0);
    return platform::Status::Ok();
}

void DrawPriceChart(Chart& c, const DrawInputs& in, platform::Surface& surface) {
    ChartPainter p(c, in, surface);
    DrawHeading(p);
    DrawGrid(p);
    DrawBars(p);
    DrawTrailingLabels(p);
}

platform::Status DrawLoadedChart(Chart& c, const DrawInputs& in, const PlotGeometry& g,
                                 platform::Dialogs& dialogs, platform::Surface& surface) {
    if (auto s = SettleLoadedChart(c, in, g, dialogs); !s) return s;
    const ChartRequest& r = in.Request;
    if (r.ChartSlot < 2 && !(r.SplitMode && r.SplitHalf == 2)) {
        surface.SetBackColour(in.Palette[17]);
        surface.Clear();
    }
    surface.SetLineWidth(1);
    DrawPriceChart(c, in, surface);
    return platform::Status::Ok();
}

} // namespace kori::chart
