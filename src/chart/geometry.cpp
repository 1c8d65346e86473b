#include "chart/geometry.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace kori::chart {

namespace {

// Whole part of a product of the area's size, held in 16 bits.
std::int16_t Part(double size, int numerator) {
    const double v = std::trunc(size * numerator / 100);
    return static_cast<std::int16_t>(std::clamp(v, -32768.0, 32767.0));
}

std::int16_t Clamp16(long v) {
    return static_cast<std::int16_t>(std::clamp(v, -32768L, 32767L));
}

struct Pass {
    float daysPerBar;
    std::int16_t spacing;
    std::int16_t last;
    std::int16_t FirstFor(long columns) const {
        float needed = std::nearbyint(daysPerBar * static_cast<float>(columns) / spacing);
        if (!(needed >= 0)) needed = 0; // no room: the window is the last record alone
        const double first = static_cast<double>(last) - static_cast<double>(needed);
        return first < 1 ? std::int16_t{1} : static_cast<std::int16_t>(first);
    }
};

float DaysPerBar(char period, float weeksFactor) {
    if (period == 'W') return (weeksFactor < 4.0f || weeksFactor > 5.25f) ? 4.75f : weeksFactor;
    if (period == 'M') return 20;
    return 1;
}

std::int16_t FinishRecord(const WindowInputs& in,
                          const std::function<std::string(std::int16_t)>& dateOf) {
    if (!in.ByFinishDate || !dateOf) return in.RecordCount;
    for (std::int16_t rec = 1; rec <= in.RecordCount && rec > 0; ++rec)
        if (dateOf(rec) >= in.FinishDate) return rec;
    return in.RecordCount;
}

} // namespace

std::int16_t PlotRightFor(double width) {
    return Clamp16(Part(width, 99) - 42L);
}

PlotGeometry ComputePlotGeometry(double width, double height, const ChartRequest& r) {
    PlotGeometry g;
    g.PlotTop = Part(height, r.SecondPanelShowing ? 10 : 13);
    g.PlotBottom = Part(height, 95);
    if (r.SplitMode && r.SplitHalf == 1) {
        g.PlotTop = 10;
        g.PlotBottom = Part(height, 46);
    } else if (r.SplitMode && r.SplitHalf == 2) {
        g.PlotTop = Part(height, 51);
    }
    g.PlotLeft = 5;
    g.PlotRight = PlotRightFor(width);
    return g;
}

Panels LayOutPanels(const PlotGeometry& g, bool showVolume, bool upsideDown) {
    Panels p;
    p.TitleTop = g.PlotTop;
    p.PlotTop = g.PlotTop;
    p.PlotBottom = g.PlotBottom;
    p.VolTop = p.VolBottom = g.PlotBottom;
    if (showVolume) {
        const int share = (g.PlotBottom - g.PlotTop) / 5;
        p.VolTop = Clamp16(g.PlotBottom - share);
        p.PlotBottom = Clamp16(p.VolTop - 4L);
    }
    if (upsideDown) std::swap(p.PlotTop, p.PlotBottom);
    return p;
}

std::optional<ClippedLine> ClipToFrame(const PlotRect& f, double x1, double y1, double x2,
                                       double y2) {
    // Liang-Barsky: the line as p(t) = start + t * (end - start), t from 0 to 1, cut by the
    // four edges in turn.
    const double dx = x2 - x1, dy = y2 - y1;
    double t0 = 0, t1 = 1;
    const double p[4] = {-dx, dx, -dy, dy};
    const double q[4] = {x1 - f.Left, f.Right - x1, y1 - f.Top, f.Bottom - y1};
    for (int i = 0; i < 4; ++i) {
        if (p[i] == 0) {
            if (q[i] < 0) return std::nullopt; // parallel to this edge and outside it
            continue;
        }
        const double t = q[i] / p[i];
        if (p[i] < 0)
            t0 = std::max(t0, t);
        else
            t1 = std::min(t1, t);
        if (t0 > t1) return std::nullopt;
    }
    // Whole ends stay exactly as given; cut ends fall on the edge.
    ClippedLine s{x1, y1, x2, y2};
    if (t0 > 0) {
        s.X1 = x1 + t0 * dx;
        s.Y1 = y1 + t0 * dy;
    }
    if (t1 < 1) {
        s.X2 = x1 + t1 * dx;
        s.Y2 = y1 + t1 * dy;
    }
    return s;
}

RecordWindow ComputeRecordWindow(const WindowInputs& in,
                                 const std::function<std::string(std::int16_t)>& dateOf) {
    RecordWindow w;
    w.AreaWidth = in.AreaWidth;
    w.LastRecord = FinishRecord(in, dateOf);
    if (in.ChartStyle == 'P') {
        // Point and figure takes the whole file; its own cut drops the oldest columns.
        w.FirstRecord = 1;
        return w;
    }
    const Pass pass{DaysPerBar(in.ChartPeriod, in.WeeksFactor),
                    in.BarSpacing > 0 ? in.BarSpacing : std::int16_t{2}, w.LastRecord};
    if (in.ScrollMode) {
        const std::int16_t first = pass.FirstFor(2100);
        w.AreaWidth = static_cast<double>(w.LastRecord - first) * pass.spacing + 120;
        if (in.ZoomFactor != 1) w.AreaWidth *= in.ZoomFactor;
        w.FirstRecord = pass.FirstFor(PlotRightFor(w.AreaWidth) - in.PlotLeft - in.BlankRight);
        return w;
    }
    long columns = PlotRightFor(in.AreaWidth) - in.PlotLeft - in.BlankRight;
    if (in.SwingPanel != SidePanel::None) {
        columns = in.SwingPanel == SidePanel::XPointAuto ? columns * 65 / 100 : columns / 2;
        w.SidePanelLeft = Clamp16(in.PlotLeft + columns + 30);
    }
    w.FirstRecord = pass.FirstFor(columns);
    return w;
}

} // namespace kori::chart
