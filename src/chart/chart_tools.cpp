#include "chart/chart_tools.h"

#include "platform/text.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <limits>

namespace kori::chart {

int ToolFrame::BarIndexAt(double x) const {
    return static_cast<int>(std::floor((x - PlotLeft) / Spacing()));
}

double DateToX(const ToolFrame& f, std::string_view date) {
    if (!f.Bars) return 0;
    for (int i = 0; i <= f.LastBar && i < static_cast<int>(f.Bars->size()); ++i)
        if ((*f.Bars)[static_cast<std::size_t>(i)].DateText() >= date) return f.XOfBar(i);
    return 0;
}

std::optional<TrendRecord> MakeTrendRecord(const ToolFrame& f, double x1, double y1, double x2,
                                           double y2) {
    if (x1 == x2 && y1 == y2) return std::nullopt;
    if (x2 < x1) {
        std::swap(x1, x2);
        std::swap(y1, y2);
    }
    // An end dragged beyond the plot is held just past its right edge.
    const double limit = f.PlotRight + 10;
    if (x2 > limit) {
        y2 = y1 + (y2 - y1) * (limit - x1) / (x2 - x1);
        x2 = limit;
    }
    auto dateAt = [&](double x) -> std::optional<std::string> {
        const int i = f.BarIndexAt(x);
        if (!f.Bars || i < 0) return std::nullopt;
        if (i > f.LastBar) {
            std::string beyond = "X";
            beyond += std::to_string(static_cast<long>(std::lround(x)));
            return beyond;
        }
        return std::string((*f.Bars)[static_cast<std::size_t>(i)].DateText());
    };
    const auto a = dateAt(x1);
    const auto b = dateAt(x2);
    if (!a || !b || a->front() == 'X' || platform::Trim(*a).empty()) return std::nullopt;
    TrendRecord r;
    r.Period = f.ChartPeriod;
    r.DateA = *a;
    r.PriceA = static_cast<float>(f.YToPrice(y1));
    r.DateB = *b;
    r.PriceB = static_cast<float>(f.YToPrice(y2));
    if (r.PriceA == 0) return std::nullopt;
    return r;
}

std::vector<TrendEnds> ReplayTrendlines(const ToolFrame& f,
                                        const std::vector<TrendRecord>& records) {
    std::vector<TrendEnds> out;
    if (!f.Bars || f.LastBar < 0) return out;
    const std::string firstDate((*f.Bars)[0].DateText());
    double top = f.PlotTop - 20, bottom = f.PlotBottom + 20;
    if (top > bottom) std::swap(top, bottom); // upside-down charts run the other way
    for (std::size_t i = 0; i < records.size(); ++i) {
        const TrendRecord& r = records[i];
        if (r.Period != f.ChartPeriod || platform::Trim(r.DateA).empty() || r.DateA < firstDate)
            continue;
        const double xA = DateToX(f, r.DateA);
        if (xA == 0) continue;
        double xB = 0;
        if (!r.DateB.empty() && std::isdigit(static_cast<unsigned char>(r.DateB[0]))) {
            xB = DateToX(f, r.DateB);
        } else if (!r.DateB.empty() && r.DateB[0] == 'X') {
            xB = platform::Val(r.DateB.substr(1));
            if (!(xB < f.PlotRight + 10)) continue;
        } else {
            continue;
        }
        if (r.PriceA == 0) continue;
        const double yA = std::floor(f.PriceToY(r.PriceA));
        const double yB = std::floor(f.PriceToY(r.PriceB));
        if (!(f.PlotLeft < xA && xB < f.PlotRight + 10)) continue;
        if (yA < top || yA > bottom || yB < top || yB > bottom) continue;
        out.push_back({static_cast<int>(i) + 1, xA, yA, xB, yB});
    }
    return out;
}

int NearestTrendline(const std::vector<TrendEnds>& ends, double x, double y) {
    int best = -1;
    double bestDistance = std::numeric_limits<double>::max();
    for (std::size_t i = 0; i < ends.size(); ++i) {
        const auto& e = ends[i];
        // Distance from the point to the segment.
        const double dx = e.xB - e.xA, dy = e.yB - e.yA;
        const double len2 = dx * dx + dy * dy;
        double t = len2 > 0 ? ((x - e.xA) * dx + (y - e.yA) * dy) / len2 : 0;
        t = std::clamp(t, 0.0, 1.0);
        const double px = e.xA + t * dx - x, py = e.yA + t * dy - y;
        const double d = px * px + py * py;
        if (d < bestDistance) {
            bestDistance = d;
            best = static_cast<int>(i);
        }
    }
    return best;
}

std::vector<FibLevel> FibonacciLevels(double startPrice, double endPrice) {
    const double rise = endPrice - startPrice;
    if (rise < 0) return {};
    return {{endPrice - 0.38 * rise, "38%    ", 20},
            {endPrice - 0.5 * rise, "50%    ", 21},
            {endPrice - 0.62 * rise, "62%    ", 20}};
}

std::vector<Segment> FibonacciLines(const ToolFrame& f, double x,
                                    const std::vector<FibLevel>& levels) {
    std::vector<Segment> out;
    const double x2 = std::min(x + 150, f.PlotRight);
    for (const auto& l : levels) {
        const double y = f.PriceToY(l.Price);
        out.push_back({x, y, x2, y, l.PaletteEntry, 'D'});
    }
    return out;
}

std::vector<Segment> GannFan(const ToolFrame& f, double x, double y, bool rising) {
    std::vector<Segment> out;
    if (x < f.PlotLeft || x > f.PlotRight || y < std::min(f.PlotTop, f.PlotBottom) ||
        y > std::max(f.PlotTop, f.PlotBottom))
        return out;
    const double spacing = f.Spacing();
    const struct {
        double n;
        int entry;
    } fans[] = {{8, 16}, {4, 16}, {3, 16}, {2, 45}, {1, 45}, {0.5, 45}};
    for (const auto& fan : fans) {
        const double slope = fan.n / spacing; // y units per x unit
        const double dir = rising ? -1.0 : 1.0;
        const double yRight = y + dir * slope * (f.PlotRight - x);
        double ex, ey;
        if (yRight >= f.PlotTop && yRight <= f.PlotBottom) {
            ex = f.PlotRight;
            ey = yRight;
        } else {
            ey = rising ? f.PlotTop : f.PlotBottom;
            // Two-point form through the clicked point and the edge it meets.
            ex = x + (ey - y) / (dir * slope);
        }
        out.push_back({x, y, ex, ey, fan.entry, 'H'});
    }
    return out;
}

std::string AddCalendarPeriods(std::string_view date, char period, int count) {
    using namespace std::chrono;
    if (date.size() < 8) return std::string(date);
    const int yy = static_cast<int>(platform::Val(date.substr(0, 4)));
    const unsigned mm = static_cast<unsigned>(platform::Val(date.substr(4, 2)));
    const unsigned dd = static_cast<unsigned>(platform::Val(date.substr(6, 2)));
    year_month_day ymd{year{yy}, month{mm}, day{dd}};
    if (!ymd.ok()) return std::string(date);
    if (period == 'M') {
        ymd += months{count};
        if (!ymd.ok()) ymd = ymd.year() / ymd.month() / last; // the 31st of a short month
    } else {
        ymd = year_month_day{sys_days{ymd} + days{period == 'W' ? 7 * count : count}};
    }
    char buf[16];
    std::snprintf(buf, sizeof buf, "%04d%02u%02u", static_cast<int>(ymd.year()),
                  static_cast<unsigned>(ymd.month()), static_cast<unsigned>(ymd.day()));
    return buf;
}

std::vector<double> FibTimeLines(const ToolFrame& f, int fromBar, bool calendar) {
    std::vector<double> out;
    if (!f.Bars || fromBar < 0 || fromBar > f.LastBar) return out;
    const std::string from((*f.Bars)[static_cast<std::size_t>(fromBar)].DateText());
    for (int a = 1, b = 2; a < 100000; std::tie(a, b) = std::pair{b, a + b}) {
        double x;
        if (calendar) {
            x = DateToX(f, AddCalendarPeriods(from, f.ChartPeriod, a));
            if (x == 0) break;
        } else {
            x = f.XOfBar(fromBar + a);
        }
        if (x > f.PlotRight) break;
        if (out.empty() || out.back() != x) out.push_back(x);
    }
    return out;
}

} // namespace kori::chart
