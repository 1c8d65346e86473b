#include "osc/osc_draw.h"

#include "osc/atr_volatility_obv.h"
#include "osc/compare_osc.h"
#include "osc/directional.h"
#include "osc/macd_coppock_elder.h"
#include "osc/momentum_roc.h"
#include "osc/osc_compute.h"
#include "osc/osc_identifiers.h"
#include "osc/rsi.h"
#include "osc/stoch_fx.h"
#include "osc/williams_holy_grail.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <new>
#include <stdexcept>

namespace kori::osc {

namespace {

using platform::Str;

std::vector<std::int16_t> Periods(const OscDef& d, std::string_view name, char period) {
    return OscPeriodsFor(d, name, std::string(1, period));
}

double Round(double v) {
    return std::nearbyint(v);
}

template <class T> double ValueOr(const Series<T>& s, int i, double none) {
    const auto& v = s[static_cast<std::size_t>(i)];
    if (!v) return none;
    if constexpr (std::is_same_v<T, Money>)
        return v->ToDouble();
    else
        return static_cast<double>(*v);
}

template <class T> bool Has(const Series<T>& s, int i) {
    return i >= 0 && static_cast<std::size_t>(i) < s.size() && s[static_cast<std::size_t>(i)];
}

double BarX(const chart::Chart& c, const OscPanel& panel, int i) {
    return panel.OscLeft + static_cast<double>(i) * c.BarSpacing;
}

// A polyline drawn segment by segment from the previous point.
struct Pen {
    double x = 0, y = 0;
    bool down = false;
    void MoveTo(double nx, double ny) {
        x = nx;
        y = ny;
        down = true;
    }
};

// The mean of the last `n` chart positions, rounded: the averaged lines of ROC, RMO and RMX
// are averages of positions, not of values.
class PositionRing {
public:
    explicit PositionRing(int n) : m_n(n) {}
    // Takes y; true with the mean once the ring is full.
    bool Add(double y, double& mean) {
        if (m_n <= 0) return false;
        m_ring.push_back(y);
        if (static_cast<int>(m_ring.size()) > m_n) m_ring.erase(m_ring.begin());
        if (static_cast<int>(m_ring.size()) < m_n) return false;
        double sum = 0;
        for (double v : m_ring)
            sum += v;
        mean = Round(sum / m_n);
        return true;
    }

private:
    int m_n;
    std::vector<double> m_ring;
};

} // namespace

// ---- RSI ----

void OscRSI(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s) {
    const std::int16_t p = Periods(d, "RSI", period)[0];
    if (p == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel,
                      "Relative Strength Index Oscillator (" + TitleNumber(p) + " Period)");
    const FixedScale sc = MakeFixedScale(panel);
    if (sc.Unit == 0) return;
    const double top = panel.OscTop + 10;
    ReferenceLine(pt, panel, Round(top + 0.3 * sc.Span), "70%");
    ReferenceLine(pt, panel, Round(top + 0.7 * sc.Span), "30%");
    ReferenceLine(pt, panel, Round(top + 0.5 * sc.Span), "50%");

    const RsiResult r = ComputeRSI(c.Series, p);
    // A bar without a figure leaves the line where it was; the first three points are never
    // joined, which keeps the placeholder point at y 0 off the chart.
    double y = 0;
    Pen pen;
    int points = 0;
    for (int i = p - 1; i <= c.LastBar(); ++i) {
        if (Has(r.rsi, i)) y = sc.Y(panel, ValueOr(r.rsi, i, 0));
        const double x = BarX(c, panel, i);
        if (points > 2) pt.Line('H', pen.x, pen.y, x, y, oscpal::Line1);
        pen.MoveTo(x, y);
        ++points;
    }
}

// ---- Stochastic and FX ----

namespace {

// A small arrow near the top of the price chart at the bar: buy ("BB") points up to y 40,
// sell ("SS") down to y 48; at the last bar the bell sounds as well.
void StochMark(OscPainter& pt, const chart::Chart& c, int bar, bool buy, bool lastBar) {
    const double x = c.PlotLeft + static_cast<double>(bar) * c.BarSpacing;
    const platform::Colour colour = pt.Col(buy ? 10 : 12);
    const double tip = buy ? 40 : 48, wing = buy ? 43 : 45, tail = buy ? 52 : 36;
    pt.PriceLine('L', x, tail, x, tip, colour);
    pt.PriceLine('L', x - 3, wing, x, tip, colour);
    pt.PriceLine('L', x + 3, wing, x, tip, colour);
    if (lastBar) pt.in().Dialogs.Beep();
}

} // namespace

void OscStochFX(chart::Chart& c, std::string_view oscName, const OscDef& d, char period,
                const OscDrawInputs& in, platform::Surface& s, bool secondOsc) {
    const bool sto = oscName == "STO";
    const bool pair = oscName == "R/F";
    const auto periods = Periods(d, sto ? "STO" : "FX", period);
    const std::int16_t k = periods[0], dp = periods[1];
    if (k == 0) return;
    const bool slow = sto && in.SlowStochastic;
    const bool inverted = !sto && d.FXRev;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, secondOsc, true);
    std::string title;
    if (sto)
        title = std::string(slow ? "SLOW Stochastic Oscillator (K=" : "Stochastic Oscillator (K=") +
                TitleNumber(k) + " Period  D=" + TitleNumber(dp) + " Period)";
    else
        title = "FX Oscillator (F=" + TitleNumber(k) + " Period  X=" + TitleNumber(dp) + " Period)";
    DrawFrameAndTitle(pt, panel, title);

    const double base = panel.OscBottom - 20;
    const double span = base - (panel.OscTop + 20);
    if (span == 0) return;
    const double per = 100 / span;
    auto yOf = [&](double v) { return Round(base - v / per); };
    if (!panel.SecondOsc) {
        ReferenceLine(pt, panel, yOf(25), inverted ? " 75%" : " 25%");
        ReferenceLine(pt, panel, yOf(75), inverted ? " 25%" : " 75%");
    }
    const int c1 = pair ? oscpal::PairLine1 : oscpal::Line1;
    const int c2 = pair ? oscpal::PairLine2 : oscpal::Line2;
    const bool secondLine = !(pair && !d.RFAve);

    const StochResult r = ComputeStochFX(c.Series, k, dp, slow, in.RecordType);
    const bool signals = sto && in.ShowStochSignals && dp > 0;
    const double y20 = yOf(20), y90 = yOf(90);
    std::vector<std::int16_t> zones(signals ? static_cast<std::size_t>(c.LastBar() + 1) : 0, 0);
    double py1 = 0, py2 = 0, py3 = 0;
    for (int i = k + 1; i <= c.LastBar(); ++i) {
        const double x = BarX(c, panel, i), px = x - c.BarSpacing;
        double kv = ValueOr(r.k, i, 0), dv = ValueOr(r.d, i, 0);
        if (inverted) {
            kv = 100 - kv;
            dv = 100 - dv;
        }
        const double y1 = yOf(kv);
        const double y2 = dp > 0 ? yOf(dv) : 0;
        double y3 = 0;
        if (!slow) {
            if (py1 != 0) pt.Line('L', px, py1, x, y1, c1);
            if (secondLine && dp > 0 && py2 != 0) pt.Line('D', px, py2, x, y2, c2);
        } else {
            if (dp > 0 && py2 != 0) pt.Line('L', px, py2, x, y2, c1);
            if (!pair && dp > 0) {
                y3 = yOf(ValueOr(r.slowd, i, 0));
                if (i > k + dp && py3 != 0) pt.Line('D', px, py3, x, y3, c2);
            }
        }
        if (signals) {
            // The zone of the second line: 3 well under the 20% line, 1 over the 90% line.
            const double y = slow ? y3 : y2;
            const std::int16_t zone = y > y20 + 3 ? 3 : y < y90 ? 1 : 2;
            const std::int16_t before = zones[static_cast<std::size_t>(i - 1)];
            zones[static_cast<std::size_t>(i)] = zone;
            if (zone == 2 && (before == 1 || before == 3))
                StochMark(pt, c, i, before == 3, i == c.LastBar());
        }
        py1 = y1;
        py2 = y2;
        py3 = y3;
    }
}

// ---- Momentum and Rate of Change ----

namespace {

void DrawChangePanel(chart::Chart& c, const OscDrawInputs& in, platform::Surface& s,
                     const std::string& title, std::string_view zeroLabel, std::int16_t p,
                     std::int16_t a, bool drawAverage, const std::vector<double>& values) {
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel, title);
    double hi = -100, lo = 10000;
    for (double v : values) {
        hi = std::max(hi, v);
        lo = std::min(lo, v);
    }
    const SymmetricScale sc = MakeSymmetricScale(panel, hi, lo);
    if (sc.Per == 0) return;
    ReferenceLine(pt, panel, Round(sc.Y(panel, 0)), zeroLabel, 30);
    ReferenceLine(pt, panel, Round(sc.Y(panel, Round(0.8 * sc.Hi))), "+80%", 30);
    ReferenceLine(pt, panel, Round(sc.Y(panel, Round(0.8 * sc.Lo))), "-80%", 30);

    PositionRing ring(a);
    Pen line, avg;
    int averaged = 0;
    for (int i = 0; i <= c.LastBar(); ++i) {
        const double x = BarX(c, panel, i);
        const double y = Round(sc.Y(panel, values[static_cast<std::size_t>(i)]));
        if (i > p && line.down) pt.Line('H', line.x, line.y, x, y, oscpal::Line1);
        line.MoveTo(x, y);
        double ay = 0;
        if (a > 0 && ring.Add(y, ay)) {
            ++averaged;
            if (drawAverage && averaged > 1 && avg.down)
                pt.Line('L', avg.x, avg.y, x, ay, oscpal::Line2);
            avg.MoveTo(x, ay);
        }
    }
}

template <class T> std::vector<double> Repeated(const Series<T>& s, int bars) {
    std::vector<double> v(static_cast<std::size_t>(std::max(bars, 0)), 0.0);
    for (int i = 0; i < bars; ++i)
        v[static_cast<std::size_t>(i)] = ValueOr(s, i, 0);
    return v;
}

} // namespace

void OscROC(chart::Chart& c, std::string_view oscName, const OscDef& d, char period,
            const OscDrawInputs& in, platform::Surface& s) {
    const auto periods = Periods(d, "ROC", period);
    const std::int16_t p = periods[0], a = periods[1];
    if (p == 0) return;
    const bool pairWithoutAverage = oscName == "R/F" && !d.RFAve;
    std::string title = "Rate of Change Oscillator (" + TitleNumber(p) + " Period)";
    if (!pairWithoutAverage) title += "  " + TitleNumber(a) + " Ave";
    const RocResult r = ComputeROC(c.Series, p);
    DrawChangePanel(c, in, s, title, "  0%", p, a, !pairWithoutAverage,
                    Repeated(r.roc, c.LastBar() + 1));
}

void OscMomentum(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                 platform::Surface& s) {
    const std::int16_t p = Periods(d, "MOM", period)[0];
    if (p == 0) return;
    // No setting feeds an average of momentum: its title always says 0.
    const std::string title =
        "Momentum Oscillator (" + TitleNumber(p) + " Period)  " + TitleNumber(0) + " Ave";
    const MomentumResult r = ComputeMomentum(c.Series, p);
    DrawChangePanel(c, in, s, title, "0%", p, 0, false, Repeated(r.mom, c.LastBar() + 1));
}

// ---- MACD, Coppock, Elder Ray ----

void OscMACD(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
             platform::Surface& s) {
    const auto periods = Periods(d, "MACD", period);
    const int p1 = periods[0], p2 = periods[1], p3 = periods[2];
    if (p1 == 0 || p2 == 0 || p3 == 0 || c.LastBar() < 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel,
                      "MACD ( " + TitleNumber(p1) + " / " + TitleNumber(p2) + " / " +
                          TitleNumber(p3) + "  Period )  ");
    const MacdResult r = ComputeMACD(c.Series, periods[0], periods[1], periods[2]);
    const int last = c.LastBar();
    float hiH = 0, loH = 10000;
    for (int i = p1 + p2 + p3 - 1; i <= last; ++i) {
        if (!Has(r.macd, i) || !Has(r.signal, i)) continue;
        const float h =
            *r.macd[static_cast<std::size_t>(i)] - *r.signal[static_cast<std::size_t>(i)];
        hiH = std::max(hiH, h);
        loH = std::min(loH, h);
    }
    if (loH < -hiH)
        hiH = -loH;
    else
        loH = -hiH;
    const double height = (panel.OscBottom - 10) - (panel.OscTop + 10);
    const double per = height == 0 ? 0 : (hiH - loH) / height;
    if (per == 0) return;
    const double mid = Round((panel.OscBottom - panel.OscTop) / 2.0);
    const double zeroWidth = pt.Width("0.0");
    pt.Text(panel.OscRight + (30 - zeroWidth), mid - 6, "0.0", oscpal::Text);
    pt.Line('L', panel.OscRight + (30 - zeroWidth) + 2, mid, panel.OscRight, mid, oscpal::Frame);
    for (double v : {double(hiH), 0.5 * hiH, double(loH), 0.5 * loH}) {
        const double y = (panel.OscBottom - 10) - (v - loH) / per;
        ReferenceLine(pt, panel, y, platform::Format(v, "####.00", platform::ZeroSign::Dropped));
    }

    const bool classic =
        !d.NoClassicMACD && platform::Upper(in.TargetName) != "ANAL" && in.PriceSurface != nullptr;
    // The fast average by another road and the slow one, on the price chart.
    const platform::Colour fastColour = pt.Col(9); // light blue
    bool prevOk = false;
    double pFast = 0, pSlow = 0, px = 0;
    for (int i = 0; i <= last; ++i) {
        const double x = BarX(c, panel, i);
        if (classic && i >= p1 + p2 - 1 && Has(r.macd, i) && Has(r.signal, i) && Has(r.ema2, i)) {
            const float c2 = *r.macd[static_cast<std::size_t>(i)];
            const float c3 = *r.signal[static_cast<std::size_t>(i)];
            const float e2 = *r.ema2[static_cast<std::size_t>(i)];
            const double fast = e2 + c2, slowLine = e2 + c3;
            if (c2 != 0 && c3 != 0 && fast > 0 && slowLine > 0) {
                const double cx = c.PlotLeft + static_cast<double>(i) * c.BarSpacing;
                const double yf = c.PriceToY(fast), ys = c.PriceToY(slowLine);
                if (prevOk) {
                    pt.PriceLine('L', px, c.PriceToY(pFast), cx, yf, fastColour);
                    const int entry = slowLine > fast ? oscpal::Series1 : oscpal::Series2;
                    pt.PriceLine('L', px, c.PriceToY(pSlow), cx, ys, pt.Col(entry));
                    if ((pSlow > pFast) != (slowLine > fast))
                        pt.PriceLine('L', cx, ys - 4, cx, ys + 4, pt.Col(oscpal::Text));
                }
                prevOk = true;
                pFast = fast;
                pSlow = slowLine;
                px = cx;
            } else {
                prevOk = false;
            }
        }
        if (i >= p1 + p2 + p3 && Has(r.macd, i) && Has(r.signal, i)) {
            const double h =
                *r.macd[static_cast<std::size_t>(i)] - *r.signal[static_cast<std::size_t>(i)];
            const double y = (panel.OscBottom - 10) - (mid + h / per - 10);
            pt.Line('H', x, mid, x, y, oscpal::Line1);
        }
    }
}

namespace {

// The scale of Coppock and Jones Holy Grail: the width is Hi, or Hi - Lo when Lo is
// below zero, over the height inside a margin of a tenth of the panel.
struct MarginScale {
    double Margin = 0, Height = 0, Per = 0, Lo = 0;
    double Y(const OscPanel& panel, double v) const {
        return Round((panel.OscBottom - Margin) - (v - Lo) / Per);
    }
};

MarginScale MakeMarginScale(const OscPanel& panel, double hi, double lo) {
    MarginScale m;
    const double width = lo < 0 ? hi - lo : hi;
    m.Lo = lo;
    m.Margin = (panel.OscBottom - panel.OscTop) / 100.0 * 10;
    m.Height = Round(panel.OscBottom - m.Margin - (panel.OscTop + m.Margin));
    m.Per = m.Height == 0 ? 0 : width / m.Height;
    return m;
}

void MarginReferenceLines(OscPainter& pt, const OscPanel& panel, const MarginScale& m,
                          const std::string& hiLabel, const std::string& loLabel,
                          const std::string& zeroLabel) {
    const double zeroY = m.Y(panel, 0);
    auto label = [&](double y, const std::string& text) {
        pt.Text(panel.OscRight + (25 - pt.Width(text)), y, text, oscpal::Text);
    };
    label(panel.OscTop + 14, hiLabel);
    label(panel.OscBottom - 26, loLabel);
    label(zeroY - 6, zeroLabel);
    ReferenceLine(pt, panel, panel.OscTop + 20, "");
    ReferenceLine(pt, panel, panel.OscBottom - 20, "");
    ReferenceLine(pt, panel, zeroY, "");
}

} // namespace

void OscCoppock(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                platform::Surface& s) {
    const std::int16_t n = Periods(d, "COP", period)[0];
    if (n == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel, "Coppock    " + TitleNumber(n) + " Period");
    if (c.LastBar() < 1) return;
    const CoppockResult r = ComputeCoppock(c.Series, n);
    double hi = 0, lo = 100000;
    for (const auto& v : r.coppock)
        if (v) {
            hi = std::max(hi, double(*v));
            lo = std::min(lo, double(*v));
        }
    const MarginScale m = MakeMarginScale(panel, hi, lo);
    if (m.Per == 0) return;
    MarginReferenceLines(pt, panel, m, Str(hi), Str(lo), "0");
    // This routine steps after its test: bar 1 stands at OscLeft.
    Pen pen;
    for (int i = 1; i <= c.LastBar(); ++i) {
        const double x = panel.OscLeft + static_cast<double>(i - 1) * c.BarSpacing;
        const double v = ValueOr(r.coppock, i, 0);
        if (v == 0) continue;
        const double y = m.Y(panel, v);
        if (i > n + 2 && pen.down) pt.Line('H', pen.x, pen.y, x, y, oscpal::Line1);
        pen.MoveTo(x, y);
    }
}

void OscElderRay(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                 platform::Surface& s) {
    const std::int16_t n = Periods(d, "ERY", period)[0];
    if (n == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel, "Elder Ray ( " + TitleNumber(n) + "  Period )  ");
    const ElderRayResult r = ComputeElderRay(c.Series, n, in.RecordType);
    double hiBull = -1000, loBull = 1000, hiBear = -1000, loBear = 1000;
    for (int i = 0; i <= c.LastBar(); ++i) {
        if (Has(r.bull, i)) {
            hiBull = std::max(hiBull, ValueOr(r.bull, i, 0));
            loBull = std::min(loBull, ValueOr(r.bull, i, 0));
        }
        if (Has(r.bear, i)) {
            hiBear = std::max(hiBear, ValueOr(r.bear, i, 0));
            loBear = std::min(loBear, ValueOr(r.bear, i, 0));
        }
    }
    MakeSymmetric(hiBull, loBull);
    MakeSymmetric(hiBear, loBear);
    const double half = (panel.OscBottom - panel.OscTop) / 2.0;
    if (half == 0) return;
    const double perBull = (hiBull - loBull) / half, perBear = (hiBear - loBear) / half;
    if (perBull == 0 || perBear == 0) return;
    const double midY = panel.OscTop + half;
    pt.Line('L', panel.OscLeft + pt.Width("Bull") + 2, midY, panel.OscRight, midY, oscpal::Frame);
    const double bullZero = Round(0.3 * (panel.OscBottom - panel.OscTop));
    const double bearZero = Round(0.75 * (panel.OscBottom - panel.OscTop));
    pt.Text(panel.OscLeft + 1, bullZero - 6, "Bull", oscpal::Text);
    pt.Text(panel.OscLeft + 1, bearZero - 6, "Bear", oscpal::Text);
    const double zw = pt.Width("0.0");
    pt.Text(panel.OscRight + (25 - zw), bullZero - 6, "0.0", oscpal::Text);
    pt.Text(panel.OscRight + (25 - zw), bearZero - 6, "0.0", oscpal::Text);
    for (int i = n; i <= c.LastBar(); ++i) {
        const double x = BarX(c, panel, i);
        if (Has(r.bull, i))
            pt.Line('H', x, bullZero, x, bullZero - ValueOr(r.bull, i, 0) / perBull,
                    oscpal::Series1);
        if (Has(r.bear, i))
            pt.Line('H', x, bearZero, x, bearZero - ValueOr(r.bear, i, 0) / perBear,
                    oscpal::Series2);
    }
}

// ---- ATR, Volatility, OBV ----

namespace {

std::string AtrPattern(double step) {
    if (step <= 0.5) return "0.0000";
    if (step >= 0.51 && step <= 3) return "0.000";
    if (step > 3 && step <= 10) return "0.00";
    return "0";
}

} // namespace

void OscATR(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s) {
    const std::int16_t p = Periods(d, "ATR", period)[0];
    if (p == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    const std::string title = "Average True Range (" + TitleNumber(p) + " Period)";
    DrawFrameAndTitle(pt, panel, title);
    const double span = (panel.OscBottom - 10) - (panel.OscTop + 10);
    const AtrResult r = ComputeATR(c.Series, p);
    if (r.NoSpread || span == 0) return;
    double hi = -100000, lo = 100000;
    bool any = false;
    for (int i = 1; i <= c.LastBar(); ++i)
        if (Has(r.atr, i)) {
            const double v = ValueOr(r.atr, i, 0);
            hi = std::max(hi, v);
            lo = std::min(lo, v);
            any = true;
        }
    if (!any) return;
    const double per = (hi - lo) / (panel.OscBottom - panel.OscTop - 20);
    const double step = (hi - lo) / 5;
    const std::string pattern = AtrPattern(step);
    const double titleWidth = pt.Width(title);
    for (int k = 1; k <= 5; ++k) {
        const double y = span / 5 * k + panel.OscTop + 10;
        pt.Line('L', k == 1 ? panel.OscLeft + titleWidth + 10 : panel.OscLeft, y, panel.OscRight, y,
                oscpal::Frame);
        const std::string label =
            platform::Format(hi - step * k, pattern, platform::ZeroSign::Dropped);
        pt.Text(c.PlotRight + 5 + (40 - pt.Width(label)), y - 6, label, oscpal::Text);
    }
    double lastAtr = 0;
    Pen pen;
    for (int i = 1; i <= c.LastBar(); ++i) {
        if (!Has(r.atr, i)) continue;
        lastAtr = ValueOr(r.atr, i, 0);
        if (per == 0) continue;
        const double x = BarX(c, panel, i);
        const double y = (panel.OscBottom - 10) - (lastAtr - lo) / per;
        if (i > p + 3 && pen.down) pt.Line('H', pen.x, pen.y, x, y, oscpal::Line1);
        pen.MoveTo(x, y);
    }
    const std::string last = "Last ATR " + Str(lastAtr);
    pt.Text(panel.OscRight - (pt.Width(last) + 20), panel.OscTop + 2, last, oscpal::Text);
}

void OscVolatility(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                   platform::Surface& s) {
    const std::int16_t p = Periods(d, "VTY", period)[0];
    if (p == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel, "Volatility (" + TitleNumber(p) + " Period)");
    const FixedScale fx = MakeFixedScale(panel);
    const double top = panel.OscTop + 10;
    ReferenceLine(pt, panel, Round(top + 0.2 * fx.Span), "80%");
    ReferenceLine(pt, panel, Round(top + 0.8 * fx.Span), "20%");
    ReferenceLine(pt, panel, Round(top + 0.5 * fx.Span), "50%");

    const VolatilityResult r = ComputeVolatility(c.Series, p);
    // Only a real, positive figure sets the range; the 1 that stands in for none does not.
    double hi = -100000, lo = 100000;
    float v = 0;
    for (int i = 0; i <= c.LastBar(); ++i) {
        const auto& b = c.ChartBars()[static_cast<std::size_t>(i)];
        if (b.Close > 0) v = (b.High - b.Low) / b.Close * 100;
        if (v > 0) {
            hi = std::max(hi, double(v));
            lo = std::min(lo, double(v));
        }
    }
    const double height = (panel.OscBottom - 10) - (panel.OscTop + 10);
    if (height == 0 || hi < lo) return;
    const double per = (hi - lo) / height;
    if (per == 0) return;
    const double floor = panel.OscBottom - 10;
    double pmx = 0, pmy = 0;
    for (int i = 0; i <= c.LastBar(); ++i) {
        const double x = BarX(c, panel, i);
        if (Has(r.figure, i)) {
            const double y = floor - (ValueOr(r.figure, i, 0) - lo) / per;
            if (y <= floor) pt.Line('H', x, floor, x, y, oscpal::Line1);
        }
        const double mean = ValueOr(r.mean, i, 0);
        double my = 0;
        if (mean != 0) {
            my = floor - (mean - lo) / per;
            if (pmy != 0) pt.Line('L', pmx, pmy, x, my, oscpal::Line2);
        }
        pmx = x;
        pmy = my;
    }
}

void OscOBV(chart::Chart& c, const OscDrawInputs& in, platform::Surface& s, bool secondOsc) {
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, secondOsc);
    const std::string title = "On-Balance Volume (base 10000)";
    DrawFrameAndTitle(pt, panel, title);
    if (c.LastBar() <= 1) return;
    const ObvResult r = ComputeOBV(c.Series);
    if (r.NoVolumeData) {
        pt.Text(panel.OscLeft + 2, panel.OscLeft + (secondOsc ? 250 : 2), panel.OscTop + 30,
                "No Volume Data", oscpal::Text);
        return;
    }
    double hi = 0, lo = 200000;
    for (const auto& v : r.obv)
        if (v) {
            hi = std::max(hi, double(*v));
            lo = std::min(lo, double(*v));
        }
    const double margin = (panel.OscBottom - panel.OscTop) / 100.0 * 10;
    const double per = (panel.OscBottom - margin - (panel.OscTop + margin)) / 100;
    const double titleWidth = pt.Width(title);
    for (int g = 0; g <= 100; g += 25) {
        const double y = panel.OscTop + margin + per * g;
        const double x1 = g == 0 ? panel.OscLeft + titleWidth + 10 : panel.OscLeft;
        if (g == 25 || g == 75)
            pt.Dashed(x1, y, panel.OscRight, y, oscpal::Frame);
        else
            pt.Line('L', x1, y, panel.OscRight, y, oscpal::Frame);
        const double figure = (lo + (100 - g) / 100.0 * (hi - lo)) / 10 / 1000;
        const std::string label =
            platform::Format(figure, "##.#", platform::ZeroSign::Dropped) + "k";
        pt.Text(panel.OscRight + (30 - pt.Width(label)), y - 6, label, oscpal::Text);
    }
    const double rows = Round(panel.OscBottom - panel.OscTop - 2 * margin);
    if (rows == 0 || hi == lo) return;
    const double range = (hi - lo) / rows;
    Pen pen;
    for (int i = 1; i <= c.LastBar(); ++i) {
        const double v = ValueOr(r.obv, i, 0);
        if (v == 0) continue;
        // Steps after its test: bar 1 stands at OscLeft.
        const double x = panel.OscLeft + static_cast<double>(i - 1) * c.BarSpacing;
        const double y = (panel.OscBottom - margin) - (v - lo) / range;
        if (pen.down)
            pt.Line('H', pen.x, pen.y, x, y, y < pen.y ? oscpal::Series1 : oscpal::Series2);
        pen.MoveTo(x, y);
    }
}

// ---- Directional Movement ----

void OscDirectional(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                    platform::Surface& s) {
    auto periods = Periods(d, "DM", period);
    // A period of 0 works as 10 here.
    const std::int16_t p = periods[0] == 0 ? std::int16_t{10} : periods[0];
    const std::int16_t x = periods[1] == 0 ? std::int16_t{10} : periods[1];
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    const std::string title = "Directional Movement ( " + TitleNumber(p) + " period )    ADX " +
                              TitleNumber(x) + " period";
    DrawFrameAndTitle(pt, panel, title);
    // Paper sets the title wider than the screen measures it: the legend keeps clear of both.
    double lx = panel.OscLeft + 2 + pt.Width(title) * 1.25 + 12;
    for (auto [text, entry] :
         {std::pair{"+DI ", oscpal::Series1}, std::pair{"-DI ", oscpal::Series2},
          std::pair{"ADX ", oscpal::Line1}}) {
        pt.Text(lx, panel.OscTop + 2, text, entry);
        lx += pt.Width(text) + 6;
    }
    const DirectionalResult r = ComputeDirectional(c.Series, p, x);
    double top = 0, adxHi = 0, adxLo = 32767;
    for (int i = p + 1; i <= c.LastBar(); ++i) {
        top = std::max({top, ValueOr(r.pdi, i, 0), ValueOr(r.mdi, i, 0)});
        const double a = ValueOr(r.adx, i, 0);
        if (a != 0) {
            adxHi = std::max(adxHi, a);
            adxLo = std::min(adxLo, a);
        }
    }
    if (adxHi < adxLo) adxHi = adxLo = 0;
    const double height = (panel.OscBottom - 10) - (panel.OscTop + 10);
    if (height == 0) return;
    const double perDI = top / height;
    double perADX = (adxHi - adxLo) / height;
    if (perADX == 0) perADX = 1;
    if (perDI == 0) return;
    const double floor = panel.OscBottom - 10;
    auto yDI = [&](double v) { return floor - v / perDI; };
    auto yADX = [&](double v) { return floor - (v - adxLo) / perADX; };
    for (int i = p + 1; i <= c.LastBar(); ++i) {
        const double bx = BarX(c, panel, i), px = bx - c.BarSpacing;
        if (!Has(r.pdi, i)) continue;
        const double yp = yDI(ValueOr(r.pdi, i, 0)), ym = yDI(ValueOr(r.mdi, i, 0));
        if (i > p + 1 && Has(r.pdi, i - 1)) {
            pt.Line('H', px, yDI(ValueOr(r.pdi, i - 1, 0)), bx, yp, oscpal::Series1);
            pt.Line('L', px, yDI(ValueOr(r.mdi, i - 1, 0)), bx, ym, oscpal::Series2);
        }
        if (d.FillIn) {
            if (yp < ym)
                pt.Line('L', bx, yp, bx, ym, oscpal::Series1);
            else
                pt.Line('V', bx, yp, bx, ym, oscpal::Series2);
        }
        if (i > p + 1 + x && Has(r.adx, i) && Has(r.adx, i - 1))
            pt.Line('H', px, yADX(ValueOr(r.adx, i - 1, 0)), bx, yADX(ValueOr(r.adx, i, 0)),
                    oscpal::Line1);
    }
}

// ---- Williams %R and Jones Holy Grail ----

void OscWilliams(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                 platform::Surface& s) {
    const std::int16_t p = Periods(d, "WMS", period)[0];
    if (p == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel, "Williams %R Oscillator (" + TitleNumber(p) + " Period)");
    const FixedScale sc = MakeFixedScale(panel);
    if (sc.Unit == 0) return;
    const double y0 = panel.OscTop + 10;
    ReferenceLine(pt, panel, Round(y0 + 0.1 * sc.Span), "o/b");
    ReferenceLine(pt, panel, Round(y0 + 0.9 * sc.Span), "o/s");
    const WilliamsResult r = ComputeWilliams(c.Series, p, in.RecordType);
    // The panel shows a three-bar mean of the positions, never the bare %R.
    PositionRing ring(3);
    int averages = 0;
    Pen pen;
    for (int i = p; i <= c.LastBar(); ++i) {
        if (!Has(r.r, i)) continue;
        const double y = Round(y0 + ValueOr(r.r, i, 0) * sc.Unit);
        double ave = 0;
        if (!ring.Add(y, ave)) continue;
        ++averages;
        const double x = BarX(c, panel, i);
        if (averages > 2 && pen.down) pt.Line('H', pen.x, pen.y, x, ave, oscpal::Line1);
        pen.MoveTo(x, ave);
    }
}

void OscHolyGrail(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                  platform::Surface& s) {
    const std::int16_t p = Periods(d, "JHG", period)[0];
    if (p == 0) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel, "Jones Holy Grail    " + TitleNumber(p) + " Period");
    if (c.LastBar() <= p) return;
    const HolyGrailResult r = ComputeHolyGrail(c.Series, p);
    double hi = 0, lo = 200000;
    for (const auto& v : r.col1)
        if (v && *v != 0) {
            hi = std::max(hi, double(*v));
            lo = std::min(lo, double(*v));
        }
    const MarginScale m = MakeMarginScale(panel, hi, lo);
    if (m.Per == 0) return;
    MarginReferenceLines(pt, panel, m, platform::Format(hi, "0.000", platform::ZeroSign::Dropped),
                         platform::Format(lo, "0.000", platform::ZeroSign::Dropped), "0");
    Pen one, two;
    for (int i = p + 1; i <= c.LastBar(); ++i) {
        const double x = BarX(c, panel, i);
        if (ValueOr(r.col0, i, 0) == 0) continue;
        if (Has(r.col1, i)) {
            const double y1 = m.Y(panel, ValueOr(r.col1, i, 0));
            if (i > p + 3 + 2 && one.down && one.x > panel.OscLeft)
                pt.Line('H', one.x, one.y, x, y1, oscpal::Line1);
            one.MoveTo(x, y1);
        }
        if (Has(r.col2, i)) {
            const double y2 = m.Y(panel, ValueOr(r.col2, i, 0));
            if (i > 2 * p + 3 + 2 && two.down) pt.Line('L', two.x, two.y, x, y2, oscpal::Line2);
            two.MoveTo(x, y2);
        }
    }
}

// ---- RMO and RMX ----

void OscRMO(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s) {
    const auto periods = Periods(d, "RMO", period);
    const std::int16_t p = periods[0], a = periods[1];
    if (p == 0 || in.CompareFile == nullptr || in.CompareCode.empty()) return;
    OscPainter pt(c, in, s);
    const OscPanel panel = SetOscPanel(pt, false);
    DrawFrameAndTitle(pt, panel,
                      "RMO Oscillator (" + TitleNumber(p) + " Period)   Compared to " +
                          in.CompareCode + "   " + TitleNumber(a) + " Ave");
    const double mid = panel.OscTop + (panel.OscBottom - panel.OscTop) / 2 + 1;
    ReferenceLine(pt, panel, mid, "");
    pt.Line('L', panel.OscLeft, panel.OscTop + 25, panel.OscRight, panel.OscTop + 25,
            oscpal::Frame);
    pt.Text(panel.OscRight + 15, panel.OscTop + 25 - 6, " +80", oscpal::Text);
    pt.Line('L', panel.OscLeft, panel.OscBottom - 25, panel.OscRight, panel.OscBottom - 25,
            oscpal::Frame);
    pt.Text(panel.OscRight + 15, panel.OscBottom - 25 - 6, " -80", oscpal::Text);

    const bool whole = in.SecurityFile != nullptr;
    const CompareResult r = ComputeRMO(whole ? *in.SecurityFile : c.Series, *in.CompareFile, p,
                                       whole ? c.FirstRecord : std::int16_t{1}, c.LastBar() + 1);
    const double height = panel.OscBottom - 20 - (panel.OscTop + 20);
    double hi = -100000, lo = 100000;
    PositionRing ring(a);
    Pen line, avg;
    for (int i = 0; i <= c.LastBar(); ++i) {
        const double v = ValueOr(r.value, i, 0);
        if (v == 0) continue;
        // The range grows as the line goes: earlier points keep the scale they had.
        hi = std::max(hi, v);
        lo = std::min(lo, v);
        const double per = height == 0 ? 0 : (hi - lo) / height;
        if (hi == 0 || lo == 0 || per == 0) continue;
        const double x = panel.OscLeft + static_cast<double>(i - 1) * c.BarSpacing;
        const double y = Round((panel.OscBottom - 20) - (v - lo) / per);
        if (line.down) pt.Line('H', line.x, line.y, x, y, oscpal::Line1);
        line.MoveTo(x, y);
        double ay = 0;
        if (ring.Add(y, ay)) {
            if (avg.down && avg.y != 0) pt.Line('L', avg.x, avg.y, x, ay, oscpal::Line2);
            avg.MoveTo(x, ay);
        }
    }
}

void OscRMX(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s) {
    const auto periods = Periods(d, "RMX", period);
    const std::int16_t p = periods[0], a = periods[1];
    if (p == 0 || in.CompareFile == nullptr || in.CompareCode.empty()) return;
    OscPainter pt(c, in, s);
    OscPanel panel = SetOscPanel(pt, false);
    panel.OscLeft = 1;
    const CompareResult r = ComputeRMX(c.Series, *in.CompareFile, p);
    double hi = 0, lo = 100000;
    double lastValue = 0;
    for (const auto& v : r.value)
        if (v) {
            hi = std::max(hi, double(*v));
            lo = std::min(lo, double(*v));
            lastValue = *v;
        }
    const double height = panel.OscBottom - panel.OscTop - 40;
    const double per = height == 0 || hi <= lo ? 0 : (hi - lo) / height;
    const std::string titleStart = "RMX Oscillator (" + TitleNumber(p) + " Period)   Compared to " +
                                   in.CompareCode + "   " + TitleNumber(a) + " Ave";
    if (per == 0) {
        DrawFrameAndTitle(pt, panel, titleStart);
        return;
    }
    auto yOf = [&](double v) { return (panel.OscBottom - 20) - (v - lo) / per; };
    // The last ratio's distance from the middle line, for the title.
    const double lastY = Round(yOf(lastValue));
    const double centerValue = lastY < 120 ? 120 - lastY : -(lastY - 120);

    pt.Dotted(panel.OscLeft, yOf(hi), panel.OscRight, yOf(hi), oscpal::Frame);
    pt.Dotted(panel.OscLeft, yOf(lo), panel.OscRight, yOf(lo), oscpal::Frame);
    ReferenceLine(pt, panel, yOf(0.8 * hi), "o/b");
    ReferenceLine(pt, panel, yOf(0.8 * lo), "o/s");
    for (double share : {0.2, 0.4, 0.6, 1.0}) {
        pt.Line('L', panel.OscLeft, yOf(share * hi), panel.OscLeft - 4, yOf(share * hi),
                oscpal::Frame);
        pt.Line('L', panel.OscLeft, yOf(share * lo), panel.OscLeft - 4, yOf(share * lo),
                oscpal::Frame);
    }
    PositionRing ring(a);
    Pen line, avg;
    int averages = 0;
    for (int i = 0; i <= c.LastBar(); ++i) {
        const double v = ValueOr(r.value, i, 0);
        if (v == 0) continue;
        const double x = BarX(c, panel, i);
        const double y = Round(yOf(v));
        if (i >= p && line.down) pt.Line('H', line.x, line.y, x, y, oscpal::Line1);
        line.MoveTo(x, y);
        double ay = 0;
        if (ring.Add(y, ay)) {
            ++averages;
            if (i >= p && averages > a && avg.down)
                pt.Line('L', avg.x, avg.y, x, ay, oscpal::Line2);
            avg.MoveTo(x, ay);
        }
    }
    // The middle line, where a ratio equals its own mean, dotted from bar 2 on; it stands at
    // the same height at every bar, so one line carries it.
    const double centerY = Round(yOf(0));
    if (c.LastBar() >= 3 && centerY > panel.OscTop && centerY < panel.OscBottom)
        pt.Dotted(BarX(c, panel, 2), centerY, BarX(c, panel, c.LastBar()), centerY, oscpal::Frame);
    // Frame and title come last on this panel.
    DrawFrameAndTitle(pt, panel,
                      titleStart + "           CenterLine = " +
                          platform::Format(lastValue, "0.00", platform::ZeroSign::Dropped) + "  (" +
                          Str(centerValue) + ")");
}

// ---- Dispatch ----

OscOutcome ShowOscillator(chart::Chart& chart, std::string_view oscName, char chartPeriod,
                          const OscDef& def, const OscDrawInputs& in, platform::Surface& panel) {
    const std::string name = platform::Trim(oscName);
    const OscIdentifier* id = FindOscIdentifier(name);
    if (id == nullptr) return OscOutcome::Unknown;
    if (id->OnPriceChart) return OscOutcome::OnPriceChart;
    if (name == "RMO" && chartPeriod != 'A') {
        in.Dialogs.MsgBox("RMO only available on Daily Charts", "RMO");
        return OscOutcome::DailyOnly;
    }
    if (name != "OBV" && name != "DM") {
        const auto periods = Periods(def, name, chartPeriod);
        if (periods.empty() || periods[0] == 0) return OscOutcome::NotSet;
    }
    // Directional Movement works a period of 0 as 10, so it is validated as such.
    OscDef checked = def;
    if (name == "DM")
        for (std::int16_t OscDef::*f : {&OscDef::DMA, &OscDef::DMW, &OscDef::DMXA, &OscDef::DMXW})
            if (checked.*f == 0) checked.*f = 10;
    // The comparison file of RMO and RMX was resolved by the caller, which says when it is
    // missing; only the periods are checked here.
    const std::string column(1, chartPeriod);
    if (!CheckOscSettings(checked, name, column, in.TargetName, in.Dialogs, false))
        return OscOutcome::NotValid;
    if (const auto problem = NegativePeriodProblem(checked, name, column)) {
        in.Dialogs.MsgBox(problem->text, problem->title);
        return OscOutcome::NotValid;
    }
    try {
        id->Draw(chart, def, chartPeriod, in, panel);
    } catch (const std::bad_alloc&) {
        (void)chart.Stream.Close();
        ShowOscFailure(in.Dialogs, 480, "");
        return OscOutcome::Failed;
    } catch (const std::exception& e) {
        (void)chart.Stream.Close();
        ShowOscFailure(in.Dialogs, 5, e.what());
        return OscOutcome::Failed;
    }
    return OscOutcome::Drawn;
}

} // namespace kori::osc
