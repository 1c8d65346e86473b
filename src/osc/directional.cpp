#include "osc/directional.h"

#include <cmath>
#include <cstdlib>

namespace kori::osc {

namespace {

struct DayRatios {
    std::vector<float> plus, minus; // +DM / TR and -DM / TR of each bar from 1
};

float LargestAbs(float a, float b, float c) {
    float m = std::fabs(a);
    if (std::fabs(b) > m) m = std::fabs(b);
    if (std::fabs(c) > m) m = std::fabs(c);
    return m;
}

DayRatios Ratios(const store::ChartSeries& s, int n) {
    DayRatios r{std::vector<float>(static_cast<std::size_t>(n), 0.0f),
                std::vector<float>(static_cast<std::size_t>(n), 0.0f)};
    for (std::size_t i = 1; i < r.plus.size(); ++i) {
        const store::ChartBar& b = s.ChartBars[i];
        const store::ChartBar& prev = s.ChartBars[i - 1];
        const float up = b.High - prev.High;
        const float down = prev.Low - b.Low;
        float plusDM = 0.0f, minusDM = 0.0f;
        if (up != down && up > 0 && up > down) plusDM = up;
        if (up != down && down > 0 && down > up) minusDM = down;
        const float tr = LargestAbs(b.High - b.Low, b.High - prev.Close, b.Low - prev.Close);
        if (tr != 0) {
            r.plus[i] = plusDM / tr;
            r.minus[i] = minusDM / tr;
        }
    }
    return r;
}

std::int16_t Dx(std::int16_t pdi, std::int16_t mdi) {
    const auto a = static_cast<std::int16_t>(pdi - mdi);
    const auto b = static_cast<std::int16_t>(pdi + mdi);
    const std::int16_t dx =
        b != 0 ? TruncToInt16(static_cast<float>(a) / static_cast<float>(b) * 100.0f)
               : TruncToInt16(a * 100);
    return static_cast<std::int16_t>(std::abs(dx));
}

// ADX: a plain mean of X DX values as seed, then Run = (1 - a) x DX + (1 - a) x Run.
void Adx(DirectionalResult& r, int p, int x, int n) {
    const float keep = 1.0f - 2.0f / static_cast<float>(x + 1);
    const int seedBar = p + x;
    if (seedBar >= n) return;
    std::int32_t sum = 0;
    for (int i = seedBar - x + 1; i <= seedBar; ++i)
        sum += *r.dx[static_cast<std::size_t>(i)];
    float run = keep * (static_cast<float>(sum) / static_cast<float>(x));
    for (int i = seedBar + 1; i < n; ++i) {
        const auto u = static_cast<std::size_t>(i);
        run = keep * static_cast<float>(*r.dx[u]) + keep * run;
        r.adx[u] = RoundToInt16(run);
    }
}

} // namespace

DirectionalResult ComputeDirectional(const store::ChartSeries& series, std::int16_t period,
                                     std::int16_t adxPeriod) {
    const int n = BarCount(series);
    DirectionalResult r;
    r.pdi.assign(static_cast<std::size_t>(n), std::nullopt);
    r.mdi = r.dx = r.adx = r.pdi;
    const int p = period == 0 ? 10 : period;
    const int x = adxPeriod == 0 ? 10 : adxPeriod;
    if (p < 0 || x < 0 || n <= p) return r;

    const DayRatios ratios = Ratios(series, n);
    // The ring of the last P ratios fills at bar P (its first bar is 1).
    const std::vector<float> plusSums = WindowSums(ratios.plus, p);
    const std::vector<float> minusSums = WindowSums(ratios.minus, p);
    for (int i = p; i < n; ++i) {
        const auto u = static_cast<std::size_t>(i);
        const std::int16_t pdi = TruncToInt16(plusSums[u] / static_cast<float>(p) * 100.0f);
        const std::int16_t mdi = TruncToInt16(minusSums[u] / static_cast<float>(p) * 100.0f);
        r.pdi[u] = pdi;
        r.mdi[u] = mdi;
        r.dx[u] = Dx(pdi, mdi);
    }
    Adx(r, p, x, n);
    return r;
}

} // namespace kori::osc
