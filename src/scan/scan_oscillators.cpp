#include "scan/scan_oscillators.h"

#include "osc/rsi.h"

#include <algorithm>
#include <cmath>

namespace kori::scan {

namespace {

int Round(double v) {
    return static_cast<int>(std::nearbyint(v));
}

// Stochastic: the fast line of the K + 1 bars' range.
int StochasticPosition(float v) {
    return Round(121 - static_cast<double>(v) * 0.99);
}

std::optional<float> StochasticValue(const DailyTail& b, int k, int bar, bool closeOnly) {
    float hi = 0, lo = 100000;
    for (int j = bar - k; j <= bar; ++j) {
        const float high = b.HighAt(j), low = b.LowAt(j), close = b.CloseAt(j);
        if (high != 0 && !closeOnly)
            hi = std::max(hi, high);
        else if (close != 0)
            hi = std::max(hi, close);
        if (low != 0 && !closeOnly)
            lo = std::min(lo, low);
        else if (close != 0)
            lo = std::min(lo, close);
    }
    const float close = b.CloseAt(bar);
    const float range = hi - lo;
    if (range == 0) return 100.0f * (close - lo);
    return static_cast<float>(std::nearbyint(100.0f * (close - lo) / range));
}

OscReading StochasticOf(const DailyTail& b, int k, bool closeOnly) {
    const int last = b.Last();
    if (k < 1 || last - 1 <= k) return {};
    if (last - 1 - k < b.First) return {OscOutcome::NeedMore, {}};
    OscReading r{OscOutcome::Positions, {}};
    r.Positions.Cur = StochasticPosition(*StochasticValue(b, k, last, closeOnly));
    r.Positions.Prev = StochasticPosition(*StochasticValue(b, k, last - 1, closeOnly));
    r.Positions.OBLine = StochasticPosition(75);
    r.Positions.OSLine = StochasticPosition(25);
    return r;
}

// Williams %R on closes only: the position of a bar, or none when its window has no range.
std::optional<int> WilliamsPosition(const DailyTail& b, int p, int bar) {
    float hi = 0, lo = 100000;
    for (int j = bar - p + 1; j <= bar; ++j) {
        const float c = b.CloseAt(j);
        if (c == 0) continue;
        hi = std::max(hi, c);
        lo = std::min(lo, c);
    }
    if (hi == 0 || hi - lo == 0) return std::nullopt;
    const float r = 100.0f * (hi - b.CloseAt(bar)) / (hi - lo);
    return Round(13 + static_cast<double>(r) * 1.18);
}

// The position used is the whole-number mean of the last three positions; the last and the
// previous bar each take the mean as it stood after them. Walks back from the last bar.
OscReading Williams(const DailyTail& b, int p) {
    const int last = b.Last();
    if (p < 1) return {};
    int values[4];
    int bars[4];
    int found = 0;
    int beforeLast = 0; // values found at bars before the last
    for (int bar = last; bar >= p && beforeLast < 3; --bar) {
        if (bar - p + 1 < b.First) return {OscOutcome::NeedMore, {}};
        const auto pos = WilliamsPosition(b, p, bar);
        if (!pos) continue;
        values[found] = *pos;
        bars[found] = bar;
        ++found;
        if (bar < last) ++beforeLast;
    }
    if (beforeLast < 3) return {};
    auto mean = [&](int from) {
        return Round((values[from] + values[from + 1] + values[from + 2]) / 3.0);
    };
    OscReading r{OscOutcome::Positions, {}};
    const bool lastHasOne = bars[0] == last;
    r.Positions.Cur = mean(0);
    r.Positions.Prev = lastHasOne ? mean(1) : mean(0);
    r.Positions.OBLine = Round(13 + 118 * 0.1);
    r.Positions.OSLine = Round(13 + 118 * 0.9);
    return r;
}

// Rate of change and momentum over the whole file, on a scale made symmetric about zero.
OscReading ChangeOsc(const DailyTail& b, int p, bool momentum) {
    const int last = b.Last();
    if (p < 1 || last - 1 < p) return {};
    if (b.First > 0) return {OscOutcome::NeedMore, {}};
    float v = 0, hi = -100, lo = 10000, prev = 0;
    for (int i = p; i <= last; ++i) {
        // The first bar counts with 0; later ones take their change when both closes exist.
        if (i > p) {
            const float now = b.CloseAt(i), then = b.CloseAt(i - p);
            if (now != 0 && then != 0) {
                const float d = now - then;
                v = momentum ? d * 100.0f : d / now * 100.0f;
            }
        }
        hi = std::max(hi, v);
        lo = std::min(lo, v);
        if (i == last - 1) prev = v;
    }
    if (-hi > lo)
        hi = -lo;
    else
        lo = -hi;
    const float unit = (hi - lo) / 118.0f;
    if (unit == 0 || 0.8f * hi > 32766 || 0.8f * lo < -32766) return {};
    auto position = [&](float value) { return Round(131 - (value - lo) / unit); };
    OscReading r{OscOutcome::Positions, {}};
    r.Positions.Cur = position(v);
    r.Positions.Prev = position(prev);
    r.Positions.OBLine = position(static_cast<float>(std::nearbyint(0.8f * hi)));
    r.Positions.OSLine = position(static_cast<float>(std::nearbyint(0.8f * lo)));
    return r;
}

// The RSI of a bar as the line holds it: its own window's figure, or the last figure before
// it when its window has no fall.
OscReading Rsi(const DailyTail& b, int p) {
    if (p == 0) p = 21;
    const int last = b.Last();
    if (p < 1 || last - 1 < p) return {};
    const std::span<const float> closes(b.Close);
    const auto figure = [&](int bar) {
        return osc::RsiWindowFigure(closes, static_cast<std::int16_t>(p),
                                    static_cast<std::size_t>(bar - b.First));
    };
    std::optional<float> cur, prev;
    for (int bar = last; bar >= p; --bar) {
        if (bar - p < b.First) return {OscOutcome::NeedMore, {}};
        const auto f = figure(bar);
        if (!f) continue;
        if (!cur) cur = f;
        if (bar < last) {
            prev = f;
            break;
        }
    }
    if (!cur || !prev) return {};
    auto position = [](float v) { return Round(131 - static_cast<double>(v) * 1.19); };
    OscReading r{OscOutcome::Positions, {}};
    r.Positions.Cur = position(*cur);
    r.Positions.Prev = position(*prev);
    r.Positions.OBLine = Round(12 + 119 * 0.3);
    r.Positions.OSLine = Round(12 + 119 * 0.7);
    return r;
}

} // namespace

std::string_view OscColumn(ScanOsc osc) {
    switch (osc) {
    case ScanOsc::Stochastic:
        return "STO";
    case ScanOsc::Williams:
        return "WMS";
    case ScanOsc::ROC:
        return "ROC";
    case ScanOsc::MM:
        return "MM";
    case ScanOsc::RSI:
        return "RSI";
    }
    return "";
}

int OscBarsWanted(ScanOsc osc, int period) {
    switch (osc) {
    case ScanOsc::Stochastic:
        return period + 2;
    case ScanOsc::Williams:
        return period + 8;
    case ScanOsc::ROC:
    case ScanOsc::MM:
        return 0;
    case ScanOsc::RSI:
        return (period == 0 ? 21 : period) + 8;
    }
    return 0;
}

OscReading ReadOscillator(ScanOsc osc, const DailyTail& bars, int period, bool closeOnly) {
    switch (osc) {
    case ScanOsc::Stochastic:
        return StochasticOf(bars, period, closeOnly);
    case ScanOsc::Williams:
        return Williams(bars, period);
    case ScanOsc::ROC:
        return ChangeOsc(bars, period, false);
    case ScanOsc::MM:
        return ChangeOsc(bars, period, true);
    case ScanOsc::RSI:
        return Rsi(bars, period);
    }
    return {};
}

std::string_view Indication(const OscPositions& p) {
    const bool curOB = p.Cur <= p.OBLine, curOS = p.Cur >= p.OSLine;
    const bool prevOB = p.Prev <= p.OBLine, prevOS = p.Prev >= p.OSLine;
    if (curOB) return prevOB ? "OB" : "Cut OB UP";
    if (curOS) return prevOS ? "OS" : "Cut OS DN";
    if (prevOB) return "Cut OB DN";
    if (prevOS) return "Cut OS UP";
    return "";
}

bool Kept(std::string_view indication, const IndicationChoice& c) {
    if (indication == "Cut OB UP") return c.OB || c.CutOB;
    if (indication == "OB") return c.OB;
    if (indication == "Cut OS DN") return c.OS || c.CutOS;
    if (indication == "OS") return c.OS;
    if (indication == "Cut OB DN") return c.CutOB;
    if (indication == "Cut OS UP") return c.CutOS;
    return false;
}

} // namespace kori::scan
