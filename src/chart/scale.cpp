#include "chart/scale.h"

#include "platform/number_format.h"
#include "platform/text.h"

#include <cmath>

namespace kori::chart {

namespace {

float RoundTo(float v, double unitsPerOne) {
    return static_cast<float>(std::nearbyint(static_cast<double>(v) * unitsPerOne) / unitsPerOne);
}
float Round(float v) {
    return std::nearbyint(v);
}
float Floor(float v) {
    return std::floor(v);
}

// Upper end. `f` is the widening factor, which the lower end keeps when the low is 0.
void UpperEnd(float& hi, float& lo, float& f) {
    if (85 < hi && hi < 100 && hi - lo < 4) {
        f = 1;
    } else {
        if (hi - lo < 0.15f) {
            if (hi < 0.01f) hi = 0.05f;
            hi = hi * 1.05f;
            lo = lo * 0.95f;
        }
        // Sequential tests: a high between 0.19 and 0.2 ends with the second factor.
        if (hi > 0.19f) f = 1.02f;
        if (0 < hi && hi < 0.2f) f = 1.2f;
        if (hi < 0) f = 0.99f;
    }
    const float t = hi * f;
    if (t > 100) {
        float n = Round(t / 10);
        if (hi >= 10 * n) n = n + 1;
        hi = 10 * n;
    } else if (t >= 1) {
        float n = Round(t / 0.1f);
        if (0.1f * n <= hi) n = n + 1;
        hi = 0.1f * n;
        hi = RoundTo(hi * f, 10); // the factor goes on a second time
    } else if (t > 0.99f) {
        // stays
    } else {
        hi = RoundTo(t, 1000);
    }
}

void LowerEnd(float hi, float& lo, float& f) {
    if (85 < lo && lo < 100 && hi - lo < 4) {
        f = 1;
    } else {
        if (lo > 0.19f) f = 0.99f;
        if (0 < lo && lo < 0.2f) f = 0.9f;
        if (lo < 0) f = 1.01f;
    }
    const float t = lo * f;
    if (t > 100) {
        float n = Round(t / 10);
        if (lo <= 10 * n) n = n - 1;
        lo = 10 * n;
    } else if (t > 1) {
        float n = Round(t / 0.1f);
        if (0.1f * n >= lo) n = n - 1;
        lo = 0.1f * n;
        lo = RoundTo(lo * f, 10);
    } else {
        lo = RoundTo(t, 1000);
    }
    if (lo == 0) lo = 0.005f;
}

void LargeAndNegative(float& hi, float& lo) {
    if (!(lo > 600 || lo < 0)) return;
    if (-100 < lo && lo < -10)
        lo = Floor(lo / 10) * 10;
    else if (-10 <= lo && lo < 0) { /* stays */
    } else
        lo = Floor(lo / 100) * 100;

    if (-100 < hi && hi < 0)
        hi = Floor(hi / 10) * 10;
    else if (0.5f < hi && hi < 100)
        hi = Floor(hi / 10) * 10;
    else if (0 < hi && hi <= 0.5f) { /* stays */
    } else
        hi = (Floor(hi / 100) + 1) * 100;
}

std::int16_t ToInt16(double v) {
    if (!(v >= -32768.0)) return -32768;
    if (!(v <= 32767.0)) return 32767;
    return static_cast<std::int16_t>(v);
}

float StepForRange(float range) {
    struct Row {
        float from, to, step;
    };
    static constexpr Row kRows[] = {{0.1001f, 0.5f, 0.02f}, {0.5001f, 1, 0.05f}, {1.0001f, 2, 0.1f},
                                    {2.0001f, 3, 0.2f},     {3.0001f, 4, 0.3f},  {4.0001f, 5, 0.4f},
                                    {5.0001f, 10, 0.5f},    {10.0001f, 20, 1},   {20.0001f, 50, 5},
                                    {50.0001f, 80, 10},     {80.0001f, 100, 15}};
    if (range > 0 && range < 0.11f) return 0.005f;
    for (const Row& r : kRows)
        if (range >= r.from && range <= r.to) return r.step;
    return 0;
}

} // namespace

ScaleEnds AutoScaleEnds(float high, float low) {
    float hi = high, lo = low, f = 0;
    UpperEnd(hi, lo, f);
    LowerEnd(hi, lo, f);
    LargeAndNegative(hi, lo);
    if (lo < 2) {
        lo = Round(lo / 0.005f) * 0.005f;
        if (lo == 0) lo = 0.001f;
    }
    if (lo == 0) lo = 0.001f;
    return {lo, hi};
}

GridSteps ComputeGridStep(float chartBase, float chartCeiling) {
    // The range goes through the two-decimal label format and back.
    float range = static_cast<float>(platform::Val(platform::FormatSingle(
        chartCeiling - chartBase, "#####0.00", platform::ZeroSign::Dropped)));
    float step = 0;
    if (range > 100) {
        range = range < 1000 ? Floor(range / 10) * 10 : Floor(range / 100) * 100;
        const double whole = std::nearbyint(static_cast<double>(range));
        step = static_cast<float>(std::trunc(whole / 10));
    } else {
        step = StepForRange(range);
    }
    GridSteps g;
    g.GridStep = step;
    g.GridCount = step > 0 ? ToInt16(std::floor(range / step)) : 0;
    return g;
}

ChartScale AutoScale(float high, float low) {
    const ScaleEnds e = AutoScaleEnds(high, low);
    const GridSteps g = ComputeGridStep(e.ChartBase, e.ChartCeiling);
    return {e.ChartBase, e.ChartCeiling, g.GridStep, g.GridCount};
}

std::optional<ScaleEnds> ManualScale(float base, float top) {
    if (base == 0 || top == 0) return std::nullopt;
    return ScaleEnds{base, top};
}

std::string ManualScaleMessage(std::string_view code) {
    const std::string c = platform::Trim(code);
    return c +
           " MANUAL SCALING has been selected but there are no chart scale definitions in the "
           "Name File for " +
           c +
           "\nUse <Change Scales> in the Set Defaults window or add these scales directly to "
           "the Name File\nDo not use 0(zero) as chart base or ceiling\nOTHERWISE USE "
           "AUTOMATIC SCALING";
}

std::int16_t ToY16(double v, std::int16_t fallback) {
    if (std::isnan(v)) return fallback;
    return ToInt16(v);
}

bool PriceMap::Prepare(bool logarithmic, bool lineChart, float chartBase, float chartCeiling,
                       std::int16_t plotTop, std::int16_t plotBottom) {
    m_log = logarithmic;
    m_boxValue = 0;
    m_base = chartBase;
    m_top = plotTop;
    m_bottom = plotBottom;
    if (!logarithmic) {
        m_unitsPerY = (chartCeiling - chartBase) / static_cast<float>(plotBottom - plotTop);
        return std::isfinite(m_unitsPerY) && m_unitsPerY != 0;
    }
    if (!(chartBase > 0)) return false;
    m_logBase = std::log(static_cast<double>(chartBase));
    double lnCeiling = 0;
    if (lineChart && chartCeiling < 0) {
        lnCeiling = std::log(10.0) / std::log(-static_cast<double>(chartCeiling));
    } else if (lineChart && chartCeiling == 0) {
        // The ceiling becomes 0.0001 and the factor of the chart before stands.
        return std::isfinite(m_logFactor) && m_logFactor != 0;
    } else {
        lnCeiling = std::log(static_cast<double>(chartCeiling));
    }
    m_logFactor = static_cast<double>(plotTop - plotBottom) / (lnCeiling - m_logBase);
    return std::isfinite(m_logFactor) && m_logFactor != 0;
}

void PriceMap::PreparePointFigure(float chartBase, float boxValue, std::int16_t plotBottom,
                                  std::int16_t cellSize) {
    m_log = false;
    m_base = chartBase;
    m_bottom = plotBottom;
    m_boxValue = boxValue;
    m_cellSize = cellSize;
}

std::int16_t PriceMap::PriceToY(double value) const {
    if (m_boxValue > 0) {
        const double boxes = std::nearbyint((value - m_base) / static_cast<double>(m_boxValue));
        return ToY16(m_bottom - m_cellSize * boxes, m_bottom);
    }
    if (!m_log) {
        const float y =
            static_cast<float>(m_bottom) - (static_cast<float>(value) - m_base) / m_unitsPerY;
        return ToY16(std::nearbyint(static_cast<double>(y)), m_bottom);
    }
    // Values of 0 and below have no logarithm; these stand-ins are part of the chart.
    double lnValue;
    if (value < 0)
        lnValue = std::log(10.0) / std::log(-value);
    else if (value == 0)
        lnValue = std::log(10.0);
    else
        lnValue = std::log(value);
    return ToY16(std::floor(m_bottom + (lnValue - m_logBase) * m_logFactor), m_bottom);
}

double PriceMap::YToPrice(double y) const {
    if (m_boxValue > 0) {
        const std::int16_t boxes = ToY16(std::floor((m_bottom - y) / m_cellSize), 0);
        return boxes * static_cast<double>(m_boxValue) + static_cast<double>(m_base);
    }
    if (!m_log)
        return static_cast<double>(m_base) + (m_bottom - y) * static_cast<double>(m_unitsPerY);
    return std::exp(m_logBase + (y - m_bottom) / m_logFactor);
}

} // namespace kori::chart
