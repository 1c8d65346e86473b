#include "chart/parabolic.h"

#include "platform/number_format.h"

#include <algorithm>

namespace kori::chart {

namespace {

constexpr double kNoLow = 100000;

struct Search {
    char Direction = 'N';
    int HighBar = -1, LowBar = -1;
};

// New highs and new lows from the first bar until one side has made more than three.
Search FindDirection(const std::vector<ParabolicBar>& bars) {
    Search s;
    double topHigh = 0, topLow = kNoLow;
    int highs = 0, lows = 0;
    char state = 'N';
    for (std::size_t i = 0; i < bars.size(); ++i) {
        const ParabolicBar& b = bars[i];
        char latest = 'N';
        if (b.High > topHigh) {
            topHigh = b.High;
            ++highs;
            s.HighBar = static_cast<int>(i);
            latest = 'U';
        }
        if (b.Low < topLow) {
            topLow = b.Low;
            ++lows;
            s.LowBar = static_cast<int>(i);
            latest = 'D';
        }
        if (i == 0) continue;
        if (state == 'N') state = latest;
        if (state == 'U') {
            if (highs > 1) lows = 0;
            if (highs > 3) {
                s.Direction = 'U';
                return s;
            }
        } else if (state == 'D') {
            if (lows > 1) highs = 0;
            if (lows > 3) {
                s.Direction = 'D';
                return s;
            }
        }
    }
    return s;
}

struct Walk {
    char Direction;
    double Stop;
    double HighExt, LowExt;
    double Accel = 0;

    void FlipDown() {
        Direction = 'D';
        Stop = HighExt;
        LowExt = HighExt;
        Accel = 0;
    }
    void FlipUp() {
        Direction = 'U';
        Stop = LowExt;
        HighExt = 0;
        LowExt = kNoLow;
        Accel = 0;
    }
    void Speed() {
        if (Accel < 0.18) Accel += 0.02;
    }

    // The extreme follows the bar first, so a flip on this bar starts from it.
    void Up(const ParabolicBar& b, const ParabolicBar& prev) {
        if (b.High > HighExt) HighExt = b.High;
        if (b.High < Stop) return FlipDown();
        Speed();
        // The stop closes on the bar's own high, not on the extreme.
        Stop += (b.High - Stop) * Accel;
        if (Stop > b.High) return FlipDown();
        if (Stop > b.Low) {
            const double bound = b.Low < prev.Low ? b.Low : prev.Low;
            Stop += (bound - Stop) * Accel;
            // Still inside the bar after the pull towards the lows: the rise is over.
            if (Stop > b.Low) FlipDown();
        }
    }

    void Down(const ParabolicBar& b, const ParabolicBar& prev) {
        if (b.Low < LowExt) LowExt = b.Low;
        if (b.Low > Stop) return FlipUp();
        Speed();
        Stop += (b.Low - Stop) * Accel;
        if (Stop < b.Low) return FlipUp();
        if (Stop < b.High) {
            const double bound = b.High > prev.High ? b.High : prev.High;
            Stop += (bound - Stop) * Accel;
            if (Stop < b.High) FlipUp();
        }
    }
};

} // namespace

std::vector<ParabolicPoint> ComputeParabolic(const std::vector<ParabolicBar>& bars) {
    std::vector<ParabolicPoint> out;
    const Search s = FindDirection(bars);
    if (s.Direction == 'N') return out;
    const int start = s.Direction == 'U' ? s.LowBar : s.HighBar;
    if (start < 0 || start >= static_cast<int>(bars.size())) return out;
    const ParabolicBar& first = bars[static_cast<std::size_t>(start)];
    const double stop = s.Direction == 'U' ? first.Low : first.High;
    Walk w{s.Direction, stop, s.Direction == 'U' ? stop : 0, s.Direction == 'U' ? kNoLow : stop};
    for (std::size_t i = static_cast<std::size_t>(start) + 1; i < bars.size(); ++i) {
        if (w.Direction == 'U')
            w.Up(bars[i], bars[i - 1]);
        else
            w.Down(bars[i], bars[i - 1]);
        out.push_back({static_cast<int>(i), w.Stop, w.Direction});
    }
    return out;
}

double ParabolicTextY(const ChartRequest& r, const Chart& c) {
    return r.SplitMode && r.SplitHalf == 2 ? c.TitleTop + 2.0 : 2.0;
}

std::string ParabolicStopText(double stop) {
    return platform::Format(stop, stop < 0.2 ? "0.000" : "0.00", platform::ZeroSign::Dropped);
}

void DrawParabolic(ChartPainter& p, bool onAverage) {
    const Chart& c = p.chart;
    const auto& chartBars = c.ChartBars();
    const int last = std::min<int>(c.LastBar(), static_cast<int>(chartBars.size()) - 1);
    // On the close line the "prices" are the close y turned so that up is larger.
    const double turn = c.PlotBottom;
    std::vector<ParabolicBar> bars;
    for (int i = 0; i <= last; ++i) {
        const auto& b = chartBars[static_cast<std::size_t>(i)];
        if (onAverage) {
            const double v = turn - c.BarCloseY[static_cast<std::size_t>(i)];
            bars.push_back({v, v});
        } else {
            bars.push_back({b.High, b.Low});
        }
    }
    const auto points = ComputeParabolic(bars);
    p.screen.SetLineWidth(2);
    for (const ParabolicPoint& pt : points) {
        if (!onAverage && pt.Stop <= 0) continue;
        const double x = c.PlotLeft + static_cast<double>(pt.Bar) * c.BarSpacing;
        const double y = onAverage ? ToY16(turn - pt.Stop, 0) : c.PriceToY(pt.Stop);
        if (!p.InPlot(x, y)) continue; // a stop beyond the scale
        const platform::Colour col =
            p.Col(pt.Direction == 'U' ? pal::ParabolicUp : pal::ParabolicDown);
        p.screen.Point(x, y, col);
        p.stream.Dot('K', x, y, col);
    }
    p.screen.SetLineWidth(1);
    if (onAverage || points.empty() || points.back().Bar != last) return;
    const ParabolicPoint& end = points.back();
    if (end.Stop <= 0) return;
    const std::string text = "Parabolic last stop : " + ParabolicStopText(end.Stop);
    const int entry = end.Direction == 'U' ? pal::ParabolicTextUp : pal::ParabolicTextDown;
    TextFont f = p.Font1(false);
    f.Size = 8.25;
    // The margin right of the plot holds the price labels and is far narrower than the text:
    // at the stop's y it would print over them and the last bars. It stands right-aligned to
    // the plot in the top row, beside the trailing labels, where nothing else prints.
    const double x = c.PlotRight - p.Width(text, f);
    const double y = ParabolicTextY(p.in.Request, c);
    p.ScreenText(x, y, text, entry, f);
    p.stream.Text('T', 8.25, x, y, text, p.Col(entry));
}

} // namespace kori::chart
