#pragma once
// The price scale: automatic ends from the highest and lowest price, manual ends from the name
// record, the gridline step, and the mapping between price and y (arithmetic or logarithmic).
// All arithmetic is in 32-bit floats where the result depends on it.
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kori::chart {

struct ScaleEnds {
    float ChartBase = 0;
    float ChartCeiling = 0;
};

struct GridSteps {
    float GridStep = 0; // 0 when the range fits no row: no gridlines
    std::int16_t GridCount = 0;
};

struct ChartScale {
    float ChartBase = 0;
    float ChartCeiling = 0;
    float GridStep = 0;
    std::int16_t GridCount = 0;
};

// Automatic scale ends from MaxHigh and MinLow, with every rounding rule of the builder.
ScaleEnds AutoScaleEnds(float high, float low);
// Gridline step and count for a pair of ends.
GridSteps ComputeGridStep(float chartBase, float chartCeiling);
// Both at once: what the `kori scale` command shows.
ChartScale AutoScale(float high, float low);
// Ends from the name record's Base and Top; none when either is 0.
std::optional<ScaleEnds> ManualScale(float base, float top);

inline constexpr std::string_view kLogRefusalTitle = "Negative Values";
inline constexpr std::string_view kLogRefusalText =
    "You cannot display a Logarithmic chart when there are NEGATIVE values. Display the chart "
    "as an Arithmetic chart.";
// The four-line message of a manual scale with no ends in the name file.
std::string ManualScaleMessage(std::string_view code);

// Price <-> y on the price panel. PlotTop may lie below PlotBottom on an upside-down chart.
class PriceMap {
public:
    // False when the scale is degenerate (no height, equal ends, a log of 0 or less): every
    // mapping would divide by zero, so the build stops there.
    bool Prepare(bool logarithmic, bool lineChart, float chartBase, float chartCeiling,
                 std::int16_t plotTop, std::int16_t plotBottom);

    // A point-and-figure chart maps whole boxes: `cellSize` units a box of `boxValue` from the
    // base. Prepare() goes back to the price scale.
    void PreparePointFigure(float chartBase, float boxValue, std::int16_t plotBottom,
                            std::int16_t cellSize);

    std::int16_t PriceToY(double value) const;
    double YToPrice(double y) const;

    bool logarithmic() const { return m_log; }
    float UnitsPerY() const { return m_unitsPerY; }
    double LogBase() const { return m_logBase; }
    double LogFactor() const { return m_logFactor; }

private:
    bool m_log = false;
    float m_base = 0;
    std::int16_t m_top = 0, m_bottom = 0;
    float m_unitsPerY = 0;
    double m_logBase = 0;
    // Kept from one chart to the next: a line chart with a ceiling of 0 reuses it.
    double m_logFactor = 0;
    float m_boxValue = 0; // above 0: point and figure
    std::int16_t m_cellSize = 0;
};

// A 16-bit coordinate from a computed one: held inside the type, NaN to `fallback`.
std::int16_t ToY16(double v, std::int16_t fallback);

} // namespace kori::chart
