#pragma once
// The colours window's model: click a colour, then the chart items that are to take it. Each
// item of the window stands for the palette entries the chart really draws that item in, which
// are not the entries in the order the window lists the items.
#include "platform/palette.h"
#include "platform/status.h"

#include <array>
#include <string>
#include <string_view>
#include <vector>

namespace kori::app {

struct ColourItem {
    std::string_view Name;    // as the window shows it
    std::vector<int> Entries; // palette entries the item sets; the first is its swatch
    bool Drawn = true;        // false: no chart routine draws in these entries yet
};

// The items in the order the window shows them.
const std::vector<ColourItem>& ColourItems();
// The item of a name; nullptr when there is none.
const ColourItem* FindColourItem(std::string_view name);

class ColourForm {
public:
    explicit ColourForm(const platform::Palette& table) : m_table(table) {}

    const platform::Palette& table() const { return m_table; }
    int selected() const { return m_selected; }
    const std::string& scheme() const { return m_scheme; }

    // A palette swatch (0 to 15) is clicked.
    void PickColour(int colour);
    // An item is clicked: its entries take the colour picked. False (nothing changes) when no
    // colour was picked yet.
    bool PaintItem(std::size_t item);
    // The colour an item's swatch shows: the colour the chart draws the item in.
    platform::Colour ItemColour(std::size_t item) const;

    // "Default BLACK", "Default WHITE", "Default BLUE": the scheme is applied (and written to
    // koriclr.dat); it becomes the scheme "SAVE DEFAULT COLOURS" writes.
    platform::Status ApplyScheme(std::string_view scheme, const std::string& systemFolder);

private:
    platform::Palette m_table;
    int m_selected = -1;
    std::string m_scheme = "Black";
};

} // namespace kori::app
