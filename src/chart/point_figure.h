#pragma once
// Point-and-figure charts: columns of rising and falling boxes by closes only, with a box
// value that follows the range, the security's own increment, or the user's answer to the box
// dialog on a manual scale.
#include "chart/draw_context.h"
#include "chart/geometry.h"
#include "platform/dialogs.h"
#include "platform/status.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace kori::chart {

namespace pf {
inline constexpr std::int16_t BoxHalf = 2;
inline constexpr std::int16_t CellSize = 2 * BoxHalf + 2;
inline constexpr float MinimumBox = 0.003f;
inline constexpr std::string_view DialogTitle = "Point and Figure";
inline constexpr int Wipe = 17, MonthBox = 27, FallingBox = 28;
// Rows a chart can hold in its 16-bit coordinates.
inline constexpr int MaxRows = 32767 / CellSize;
} // namespace pf

// Boxes in a reversal from the request's spacing: 2 to 6, anything else 2.
std::int16_t PFReversal(std::int16_t barSpacing);

// (ceiling - base) / rows, kept to three decimals.
float AutoBoxValue(float chartBase, float chartCeiling, int rows);

// The box dialog: the proposal is shown, the user types a value or asks for automatic (blank
// or "A"). Text that is not a number is refused with a message and asked again; cancel keeps
// the automatic value.
float AskBoxValue(platform::Dialogs& dialogs, float proposal);

// One box the column logic adds. Column counts from 1.
struct PFBox {
    int Column = 0;
    int Row = 0;
    bool Rising = true;
    bool First = false; // the very first box of the run
};

// The column logic over closes, without drawing: a box is reported through `onBox`, and a move
// to a new column through `onColumn` before the box that opens it.
class PFColumns {
public:
    PFColumns(float chartBase, float boxValue, std::int16_t reversal)
        : m_base(chartBase), m_box(boxValue), m_reversal(reversal) {}

    std::function<void(const PFBox&)> onBox;
    std::function<void(int column, int bar)> onColumn; // a reversal opens column `column`

    // Feeds the close of bar `bar`; a close of 0 is skipped.
    void Close(float close, int bar);

    int Columns() const { return m_column; }
    float LastBox() const { return m_lastBox; }

private:
    void Move(float close, int bar, bool rising);
    void Add(bool rising);
    int RowOf(float price) const;

    float m_base, m_box;
    std::int16_t m_reversal;
    float m_lastBox = 0;
    char m_direction = 'N';
    int m_stage = 0;
    int m_boxesInColumn = 0;
    int m_column = 0;
};

// Bar index that opened each column (index 0 is column 1), by a counting pass.
std::vector<int> CountColumns(const std::vector<float>& closes, float chartBase, float boxValue,
                              std::int16_t reversal);

// Whether boxes of this value can step through the closes (zeros and non-numbers aside):
// nothing when they can; otherwise the largest price, when a box is below the float's
// precision there or the range needs more rows than a chart holds.
std::optional<float> PFRangeProblem(const std::vector<float>& closes, float boxValue);

// Label of a price line of the chart.
std::string PFLabel(float value, std::int16_t recordType);

// Draws a point-and-figure chart of the loaded bars (panels and scale not yet settled).
platform::Status DrawPointFigureChart(Chart& c, const DrawInputs& in, const PlotGeometry& g,
                                      platform::Dialogs& dialogs, platform::Surface& surface);

} // namespace kori::chart
