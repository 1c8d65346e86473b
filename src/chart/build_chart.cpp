#include "chart/build_chart.h"

#include "chart/draw_price_chart.h"
#include "chart/geometry.h"
#include "chart/overlays.h"
#include "chart/point_figure.h"

#include <cmath>

namespace kori::chart {

namespace {

// Busy pointer on for the build; stream closed and pointer back on every way out.
class BuildScope {
public:
    BuildScope(platform::Dialogs& d, Chart& c) : m_d(d), m_c(c) { m_d.SetBusy(true); }
    ~BuildScope() {
        (void)m_c.Stream.Close();
        m_d.SetBusy(false);
    }
    BuildScope(const BuildScope&) = delete;
    BuildScope& operator=(const BuildScope&) = delete;

private:
    platform::Dialogs& m_d;
    Chart& m_c;
};

DrawInputs InputsOf(const ChartBuild& b, PriceSource& source) {
    return DrawInputs{b.Request, b.Defaults,  b.Name,          b.Palette,
                      b.Fonts,   b.PrintBold, b.VolumeDivisor, &source};
}

platform::Status OpenStream(Chart& c, const ChartRequest& r, const std::filesystem::path& path) {
    c.Stream.RedrawOnly = c.RedrawOnly;
    // A repaint leaves the stream as it is; otherwise a new chart starts it afresh and the
    // later charts of a page or split are added to it.
    if (c.RedrawOnly || path.empty()) return platform::Status::Ok();
    const bool append = r.ChartSlot >= 2 || (r.SplitMode && r.SplitHalf == 2);
    return c.Stream.Open(path, append);
}

platform::Status LoadWindow(Chart& c, const ChartBuild& b, PriceSource& source, char style,
                            PlotGeometry& g) {
    const std::int16_t count = source.RecordCount();
    if (count < 1) {
        const std::string text = "No Data for " + source.FileName();
        b.Dialogs.MsgBox(text, "Chart Display");
        return platform::Status::Error(text);
    }
    const ChartRequest& r = b.Request;
    WindowInputs w;
    w.AreaWidth = c.AreaWidth;
    w.PlotLeft = g.PlotLeft;
    w.BlankRight = b.Defaults.BlankRight;
    w.BarSpacing = r.BarSpacing == 0 ? std::int16_t{2} : r.BarSpacing;
    w.ChartStyle = style;
    w.ChartPeriod = r.ChartPeriod;
    w.WeeksFactor = b.Defaults.WeeksFactor;
    w.ScrollMode = r.ScrollMode;
    w.ZoomFactor = b.Defaults.Zoom / 100.0;
    w.SwingPanel = r.SwingPanel;
    w.RecordCount = count;
    w.ByFinishDate = r.ByFinishDate;
    w.FinishDate = r.FinishDate;
    const RecordWindow win =
        ComputeRecordWindow(w, [&source](std::int16_t rec) { return source.DateOf(rec); });
    c.FirstRecord = win.FirstRecord;
    c.LastRecord = win.LastRecord;
    c.SidePanelLeft = win.SidePanelLeft;
    if (win.AreaWidth != c.AreaWidth) {
        c.AreaWidth = win.AreaWidth;
        g.PlotRight = PlotRightFor(c.AreaWidth);
    }
    const store::SeriesRequest load{c.FirstRecord, c.LastRecord, r.ChartPeriod, r.ShowVolume,
                                    b.Name.RecordType};
    return source.Load(load, c.Series);
}

platform::Status BuildOneChart(Chart& c, const ChartBuild& b, PriceSource& source,
                               platform::Surface& surface) {
    BuildScope scope(b.Dialogs, c);
    c.Failed = false;
    const char style = EffectiveStyle(b.Request, b.Name);
    if (auto s = OpenStream(c, b.Request, b.StreamPath); !s) return s;
    c.AreaWidth = surface.ScaleWidth();
    c.AreaHeight = surface.ScaleHeight();
    PlotGeometry g = ComputePlotGeometry(c.AreaWidth, c.AreaHeight, b.Request);
    if (auto s = LoadWindow(c, b, source, style, g); !s) return s;
    const DrawInputs in = InputsOf(b, source);
    if (style == 'P') {
        if (auto s = DrawPointFigureChart(c, in, g, b.Dialogs, surface); !s) return s;
    } else {
        if (auto s = DrawLoadedChart(c, in, g, b.Dialogs, surface); !s) return s;
        ChartPainter painter(c, in, surface);
        DrawChartOverlays(painter);
    }
    if (b.DrawOverlays) b.DrawOverlays(c, surface);
    if (b.Page && !b.Page->Known)
        WorkOutPrinterMargins(*b.Page, c.AreaWidth, c.AreaHeight, b.Defaults.PrintScale);
    // A chart whose stream is torn cannot be printed, saved or played: the build failed.
    if (c.RedrawOnly || b.StreamPath.empty()) return platform::Status::Ok();
    return c.Stream.Close();
}

// The request carries the lower security's period for this half only; the upper half's stays
// in force for the chart window.
platform::Status BuildLowerHalf(Chart& c, const ChartBuild& b, const SplitLowerHalf& lower,
                                platform::Surface& surface) {
    ChartRequest& r = b.Request;
    const char period = r.ChartPeriod;
    r.ChartPeriod = lower.ChartPeriod;
    const ChartBuild half{
        r,           b.Defaults,      *lower.Name, b.Palette,      b.Fonts, b.Dialogs, b.StreamPath,
        b.PrintBold, b.VolumeDivisor, b.Page,      b.DrawOverlays, nullptr};
    const platform::Status s = BuildOneChart(c, half, *lower.Source, surface);
    r.ChartPeriod = period;
    return s;
}

} // namespace

void WorkOutPrinterMargins(PrinterPage& page, double areaWidth, double areaHeight,
                           float printScale) {
    if (!(page.Width > 0 && page.Height > 0)) return;
    auto scale16 = [printScale](double twips) {
        const double v = std::nearbyint(twips * static_cast<double>(printScale));
        return std::fmin(std::fmax(v, -32768.0), 32767.0);
    };
    const double chartW = areaWidth * scale16(page.TwipsPerPixelX);
    const double chartH = (areaHeight + page.SecondPanelHeight) * scale16(page.TwipsPerPixelY);
    page.PageTop = static_cast<std::int32_t>(std::nearbyint(-(page.Height - chartH) / 2));
    page.PageLeft = static_cast<std::int32_t>(std::nearbyint(-(page.Width - chartW) / 2));
    page.Known = true;
}

platform::Status BuildChart(Chart& chart, const ChartBuild& build, PriceSource& source,
                            platform::Surface& surface) {
    ChartRequest& r = build.Request;
    platform::Status s = BuildOneChart(chart, build, source, surface);
    if (!s || !r.SplitMode || r.SplitHalf != 1) {
        if (r.SplitMode && r.SplitHalf == 2) {
            r.SplitMode = false;
            r.SplitHalf = 1;
        }
        return s;
    }
    r.SplitHalf = 2;
    if (build.Lower && build.Lower->Name && build.Lower->Source) {
        s = BuildLowerHalf(chart, build, *build.Lower, surface);
    } else {
        s = BuildOneChart(chart, build, source, surface);
    }
    r.SplitMode = false;
    r.SplitHalf = 1;
    return s;
}

} // namespace kori::chart
