#include "osc/atr_volatility_obv.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace kori::osc {

namespace {

std::optional<Money> ToMoney(float v) {
    return Money::FromDouble(v);
}

// The largest of the bar's range and the two gaps to the close before, the range taking ties;
// the gaps keep their sign. False when a price cannot be held in currency (not a number, or
// beyond its range), rather than a wrapped-around value.
bool TrueRange(const store::ChartBar& bar, const store::ChartBar& before, Money& out) {
    const float a = bar.High - bar.Low;
    const float b = before.Close - bar.Low;
    const float c = bar.High - before.Close;
    if (std::isnan(a) || std::isnan(b) || std::isnan(c)) return false;
    // The conversion keeps order, so the largest price converts to the largest currency.
    return Money::TryFromDouble(std::max({a, b, c}), out);
}

// The routine's first scale stops it when every non-zero true range is the same.
bool HasSpread(const Series<Money>& tr) {
    bool any = false;
    std::int64_t hi = 0, lo = 0;
    for (const auto& v : tr) {
        if (!v || v->raw() == 0) continue;
        const std::int64_t raw = v->raw();
        hi = any ? std::max(hi, raw) : raw;
        lo = any ? std::min(lo, raw) : raw;
        any = true;
    }
    return !any || hi != lo;
}

std::int32_t AddVolume(std::int32_t obv, std::int64_t volume) {
    const std::int64_t sum = obv + volume;
    return static_cast<std::int32_t>(std::clamp<std::int64_t>(
        sum, std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::max()));
}

} // namespace

AtrResult ComputeATR(const store::ChartSeries& series, std::int16_t period) {
    const int n = BarCount(series);
    AtrResult r;
    r.tr.assign(static_cast<std::size_t>(n), std::nullopt);
    r.atr = r.tr;
    const int p = period;
    if (p <= 0) return r;
    // The average stops at the first bar whose true range cannot be held in currency.
    // Values are kept in plain locals and stored once: copying optionals through the loop
    // costs more than the arithmetic.
    std::size_t usable = r.tr.size();
    for (std::size_t i = 1; i < r.tr.size(); ++i) {
        Money tr;
        if (!TrueRange(series.ChartBars[i], series.ChartBars[i - 1], tr)) {
            usable = i;
            break;
        }
        r.tr[i].emplace(tr);
    }
    r.NoSpread = !HasSpread(r.tr);
    if (r.NoSpread || usable <= static_cast<std::size_t>(p)) return r;

    // Bars 1 to P fill the buffer; its mean is taken in float and back to currency.
    float sum = 0.0f;
    for (std::size_t i = 1; i <= static_cast<std::size_t>(p); ++i)
        sum += r.tr[i]->ToFloat();
    const auto first = ToMoney(sum / static_cast<float>(p));
    if (!first) return r;
    Money atr = *first;
    for (std::size_t i = static_cast<std::size_t>(p) + 1; i < usable; ++i) {
        const Money before = atr;
        const auto scaled = atr.Times(p);
        if (!scaled) break;
        const auto total = r.tr[i]->Plus(*scaled);
        if (!total) break;
        atr = *total->DividedBy(std::int64_t{p} + 1); // p + 1 > 0
        if (before.raw() != 0) r.atr[i].emplace(atr);
    }
    return r;
}

VolatilityResult ComputeVolatility(const store::ChartSeries& series, std::int16_t period) {
    const int n = BarCount(series);
    VolatilityResult r;
    r.figure.assign(static_cast<std::size_t>(n), std::nullopt);
    r.mean = r.figure;
    if (period <= 0) return r;

    std::vector<float> figures(static_cast<std::size_t>(n), 0.0f);
    float v = 0.0f; // a bar without a positive close keeps the last figure
    for (std::size_t i = 0; i < figures.size(); ++i) {
        const store::ChartBar& b = series.ChartBars[i];
        if (b.Close > 0) v = (b.High - b.Low) / b.Close * 100.0f;
        if (v > 0)
            figures[i] = v;
        else if (i > 0)
            figures[i] = 1.0f;
        if (figures[i] != 0) r.figure[i] = figures[i];
    }
    const std::vector<float> sums = WindowSums(figures, period);
    int counted = 0;
    for (std::size_t i = 0; i < figures.size(); ++i) {
        if (figures[i] == 0) continue;
        if (++counted >= period) r.mean[i] = sums[i] / static_cast<float>(period);
    }
    return r;
}

ObvResult ComputeOBV(const store::ChartSeries& series) {
    const int n = BarCount(series);
    ObvResult r;
    r.obv.assign(static_cast<std::size_t>(n), std::nullopt);
    if (n <= 2) return r;

    std::int32_t obv = 100000;
    std::int32_t hi = 0;
    std::int32_t lo = 200000;
    for (std::size_t i = 1; i < r.obv.size(); ++i) {
        const store::ChartBar& b = series.ChartBars[i];
        const float before = series.ChartBars[i - 1].Close;
        if (b.Close == 0 || before == 0) continue;
        if (b.Close != before) {
            obv = AddVolume(obv, b.Close > before ? b.Volume : -std::int64_t{b.Volume});
            hi = std::max(hi, obv);
            lo = std::min(lo, obv);
        }
        r.obv[i] = obv;
    }
    // The values stay as stored (100000 on each bar): only the panel says there is no volume.
    r.NoVolumeData = obv == 100000 && hi == 100000 && lo == 100000;
    return r;
}

} // namespace kori::osc
