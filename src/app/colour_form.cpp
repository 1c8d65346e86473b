#include "app/colour_form.h"

#include "app/colour_table.h"

namespace kori::app {

namespace {

// Where the chart draws each item of the window, in the window's order. The entries come from
// the drawing routines: the frame in 16, the cleared plot in 17, bars in 18, the ten-bar trace
// of closes in 19, the averages in 20 and 21, volume bars in 22, trendlines in 23, note marks in
// 24, the heading in 26, labels in 27, down candles in 28, the reversals in 29 to 33, year
// lines in 34, the price and date grid in 35, the oscillators' up and down series in 38 and 40,
// bands in 41, the two groups of multiple averages in 43 and 44, the oscillator lines in 45 to
// 48. The moving grid, MACD and volatility items hold entries no routine draws in yet.
struct Where {
    int Entry;
    bool Drawn;
};
constexpr std::array<Where, kRoleCount> kWhere = {{
    {17, true},  // Background
    {26, true},  // Chart title
    {27, true},  // Scales / text
    {16, true},  // Border
    {18, true},  // Chart lines
    {28, true},  // Candle / P&F down
    {20, true},  // Average 1
    {21, true},  // Average 2
    {19, true},  // Average 3: the ten-bar trace of the closes
    {22, true},  // Volume bars
    {23, true},  // Trendlines
    {24, true},  // Adjustments: the note marks of adjusted records
    {25, false}, // Moving grid
    {35, true},  // Fixed grid lines
    {29, true},  // Reversal
    {30, true},  // Key reversal
    {31, true},  // Hook reversal
    {32, true},  // Open-close rev
    {33, true},  // Pivot point
    {45, true},  // Oscillator Line 1
    {46, true},  // Oscillator Line 2
    {47, true},  // Oscillator Line 3
    {48, true},  // Oscillator Line 4
    {38, true},  // Osc/Indicator UP
    {40, true},  // Osc/Indicator DOWN
    {41, true},  // Bands
    {42, false}, // MACD
    {36, false}, // Volatility 1
    {37, false}, // Volatility 2
    {43, true},  // MMA (Short)
    {44, true},  // MMA (Long)
    {34, true},  // End of year marker
}};

} // namespace

const std::vector<ColourItem>& ColourItems() {
    static const std::vector<ColourItem> items = [] {
        std::vector<ColourItem> out;
        const auto& names = ColourRoleNames();
        for (std::size_t i = 0; i < names.size(); ++i)
            out.push_back({names[i], {kWhere[i].Entry}, kWhere[i].Drawn});
        return out;
    }();
    return items;
}

const ColourItem* FindColourItem(std::string_view name) {
    for (const auto& item : ColourItems())
        if (item.Name == name) return &item;
    return nullptr;
}

void ColourForm::PickColour(int colour) {
    if (colour >= 0 && colour < static_cast<int>(platform::kStandardColours.size()))
        m_selected = colour;
}

bool ColourForm::PaintItem(std::size_t item) {
    if (m_selected < 0 || item >= ColourItems().size()) return false;
    for (int entry : ColourItems()[item].Entries)
        m_table[static_cast<std::size_t>(entry)] = m_table[static_cast<std::size_t>(m_selected)];
    return true;
}

platform::Colour ColourForm::ItemColour(std::size_t item) const {
    return m_table[static_cast<std::size_t>(ColourItems().at(item).Entries.front())];
}

platform::Status ColourForm::ApplyScheme(std::string_view scheme, const std::string& systemFolder) {
    m_scheme = std::string(scheme);
    return ApplyColourScheme(scheme, systemFolder, m_table);
}

} // namespace kori::app
