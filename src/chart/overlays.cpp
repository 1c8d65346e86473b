#include "chart/overlays.h"

#include "chart/parabolic.h"

#include <cmath>

namespace kori::chart {

namespace {

std::int16_t Round16(double v) {
    return ToY16(std::nearbyint(v), 0);
}

// The ring of the averages: sum held as a 32-bit integer, oldest value dropped once full.
struct YRing {
    explicit YRing(int period) : values(static_cast<std::size_t>(period), 0), size(period) {}
    void Take(std::int16_t y) {
        const auto slot = static_cast<std::size_t>(count % size);
        if (count >= size) sum -= values[slot];
        values[slot] = y;
        sum += y;
        ++count;
    }
    bool Full() const { return count >= size; }
    std::int16_t Mean() const {
        return Round16(static_cast<float>(sum) / static_cast<float>(size));
    }
    std::vector<std::int16_t> values;
    int size;
    int count = 0;
    std::int32_t sum = 0;
};

// Segment joining each point to the one before; the first point only sets the start.
struct Polyline {
    ChartPainter& p;
    int entry;
    char letter;
    bool started = false;
    double lastX = 0, lastY = 0;

    void To(double x, double y) {
        if (started) p.PlotLine(letter, lastX, lastY, x, y, entry);
        started = true;
        lastX = x;
        lastY = y;
    }
};

bool AverageFits(int period, int barCount, const std::vector<std::int16_t>& yArray) {
    return period >= 1 && barCount >= period && static_cast<std::size_t>(barCount) <= yArray.size();
}

char LetterOf(int which) {
    return which == 2 ? 'H' : 'L';
}

void AverageLine(ChartPainter& p, int period, int barCount, const std::vector<std::int16_t>& yArray,
                 int entry, double left, double spacing, int which, bool exponential) {
    if (!AverageFits(period, barCount, yArray)) return;
    YRing ring(period);
    Polyline line{p, entry, LetterOf(which)};
    const float k = 2.0f / (static_cast<float>(period) + 1);
    std::int16_t y = 0;
    double x = left;
    for (int i = 0; i < barCount; ++i) {
        x += spacing;
        const std::int16_t v = yArray[static_cast<std::size_t>(i)];
        const bool seeded = ring.Full();
        ring.Take(v);
        if (!ring.Full()) continue;
        if (!exponential || !seeded)
            y = ring.Mean();
        else
            y = Round16(static_cast<float>(v) * k + static_cast<float>(y) * (1 - k));
        line.To(x, y);
    }
}

// Closes of the bars on the chart, a zero close taking the one before it in ChartBars.
void FillZeroCloses(Chart& c) {
    auto& bars = c.ChartBars();
    const int last = std::min<int>(c.LastBar(), static_cast<int>(bars.size()) - 1);
    for (int i = 1; i <= last; ++i) {
        auto& b = bars[static_cast<std::size_t>(i)];
        if (b.Close == 0) b.Close = bars[static_cast<std::size_t>(i - 1)].Close;
    }
}

std::int16_t BandY(const Chart& c, float price) {
    return price == 0 ? std::int16_t{0} : c.PriceToY(price);
}

// Both band kinds: a ring of closes, a centre and a spread per bar, two dotted or solid
// lines streamed as "L".
template <typename Ends> void DrawBands(ChartPainter& p, int period, bool dotted, Ends ends) {
    Chart& c = p.chart;
    FillZeroCloses(c);
    const auto& bars = c.ChartBars();
    const int last = std::min<int>(c.LastBar(), static_cast<int>(bars.size()) - 1);
    std::vector<float> ring(static_cast<std::size_t>(period), 0);
    int count = 0;
    bool started = false;
    double lastX = 0;
    std::int16_t lastUp = 0, lastDown = 0;
    if (dotted) p.screen.SetLineStyle(platform::LineStyle::Dot);
    const platform::Colour col = p.Col(pal::Bands);
    for (int i = 0; i <= last; ++i) {
        const double x = c.PlotLeft + static_cast<double>(i) * c.BarSpacing;
        ring[static_cast<std::size_t>(count % period)] = bars[static_cast<std::size_t>(i)].Close;
        ++count;
        if (count < period) continue;
        const auto [upper, lower] = ends(ring);
        const std::int16_t up = BandY(c, upper), down = BandY(c, lower);
        if (!started) {
            started = true;
            lastX = x - 1;
        } else {
            p.PlotLine('L', lastX, lastUp, x, up, col);
            p.PlotLine('L', lastX, lastDown, x, down, col);
            lastX = x;
        }
        lastUp = up;
        lastDown = down;
    }
    if (dotted) p.screen.SetLineStyle(platform::LineStyle::Solid);
}

float MeanOf(const std::vector<float>& ring) {
    float sum = 0;
    for (float v : ring)
        sum += v;
    return sum / static_cast<float>(ring.size());
}

bool ParabolicInView(const ChartRequest& r) {
    return r.AutoOsc && (r.AutoOscCode == "PARA" || r.AutoOscCode == "PARAV");
}

} // namespace

void SimpleAverageLine(ChartPainter& p, int period, int barCount,
                       const std::vector<std::int16_t>& yArray, int entry, double left,
                       double spacing, int which) {
    AverageLine(p, period, barCount, yArray, entry, left, spacing, which, false);
}

void ExponentialAverageLine(ChartPainter& p, int period, int barCount,
                            const std::vector<std::int16_t>& yArray, int entry, double left,
                            double spacing, int which) {
    AverageLine(p, period, barCount, yArray, entry, left, spacing, which, true);
}

void DrawMMA(ChartPainter& p) {
    const Chart& c = p.chart;
    const auto& periods = p.in.Defaults.MMAPeriods;
    const int barCount = c.LastBar() + 1;
    for (std::size_t n = 0; n < periods.size(); ++n) {
        const int period = periods[n];
        if (period < 1 || period > 500) continue;
        const int entry = n < 6 ? pal::MMAShort : pal::MMALong;
        AverageLine(p, period, barCount, c.BarCloseY, entry, c.PlotLeft - c.BarSpacing,
                    c.BarSpacing, 1, p.in.Defaults.MAExponential);
    }
}

void DrawPercentBands(ChartPainter& p) {
    const float up = p.in.Name.PercentBandUp >= 1 && p.in.Name.PercentBandUp <= 100
                         ? p.in.Name.PercentBandUp
                         : 5;
    const float down = p.in.Name.PercentBandDown >= 1 && p.in.Name.PercentBandDown <= 100
                           ? p.in.Name.PercentBandDown
                           : 5;
    DrawBands(p, 10, true, [up, down](const std::vector<float>& ring) {
        const float mean = MeanOf(ring);
        return std::pair<float, float>{(up / 100 + 1) * mean, (100 - down) * mean / 100};
    });
}

std::int16_t BollingerPeriod(const ChartDefaults& d, char chartPeriod) {
    const std::int16_t n = chartPeriod == 'A' ? d.BollingerDaily : d.BollingerLong;
    return n >= 1 && n <= 100 ? n : std::int16_t{21};
}

void DrawBollinger(ChartPainter& p) {
    constexpr float kWidth = 2;
    DrawBands(p, BollingerPeriod(p.in.Defaults, p.in.Request.ChartPeriod), false,
              [](const std::vector<float>& ring) {
                  const float mean = MeanOf(ring);
                  float squares = 0;
                  for (float v : ring)
                      squares += (mean - v) * (mean - v);
                  const float deviation =
                      std::sqrt(squares / static_cast<float>(ring.size())) * kWidth;
                  return std::pair<float, float>{mean + deviation, mean - deviation};
              });
}

void DrawChartOverlays(ChartPainter& p) {
    const Chart& c = p.chart;
    const ChartRequest& r = p.in.Request;
    const ChartDefaults& d = p.in.Defaults;
    if (r.ChartSlot != 0 || c.Style == 'P' || c.LastBar() < 0) return;
    const int barCount = c.LastBar() + 1;
    const double left = c.PlotLeft - c.BarSpacing;
    if (r.MMAOn) {
        DrawMMA(p);
    } else if (!(r.AutoOsc &&
                 (r.AutoOscCode == "PARA" || (r.AutoOscCode == "MACD" && !d.ClassicMACD)))) {
        const bool daily = r.ChartPeriod == 'A';
        const int period1 = daily ? d.MAPeriod1Daily : d.MAPeriod1Long;
        const int period2 = daily ? d.MAPeriod2Daily : d.MAPeriod2Long;
        const auto line = d.MAExponential ? ExponentialAverageLine : SimpleAverageLine;
        if (r.AvOne) line(p, period1, barCount, c.BarCloseY, pal::Average1, left, c.BarSpacing, 1);
        if (r.AvTwo) line(p, period2, barCount, c.BarCloseY, pal::Average2, left, c.BarSpacing, 2);
    }
    if (r.ChartBands == 1)
        DrawPercentBands(p);
    else if (r.ChartBands == 2)
        DrawBollinger(p);
    if (ParabolicInView(r)) DrawParabolic(p, r.AutoOscCode == "PARAV");
}

} // namespace kori::chart
