#pragma once
// The chart palette (entries 0 to 48: sixteen standard colours, then the chart roles) and the
// two chart fonts. Filled from koriclr.dat and Kori.ini by the session; read by every drawing
// routine, which cites palette entries by number.
#include "platform/surface.h"

#include <array>
#include <string>

namespace kori::platform {

inline constexpr int kPaletteSize = 49;
using Palette = std::array<Colour, kPaletteSize>;

// The sixteen standard colours: 0 black, 1 blue, 2 green, 3 cyan, 4 red, 5 magenta, 6 brown,
// 7 white, 8 grey, 9 light blue, 10 light green, 11 light cyan, 12 light red, 13 light magenta,
// 14 yellow, 15 bright white.
inline constexpr std::array<Colour, 16> kStandardColours = {
    Rgb(0, 0, 0),       Rgb(0, 0, 128),   Rgb(0, 128, 0),   Rgb(0, 128, 128),
    Rgb(128, 0, 0),     Rgb(128, 0, 128), Rgb(128, 128, 0), Rgb(192, 192, 192),
    Rgb(128, 128, 128), Rgb(0, 0, 255),   Rgb(0, 255, 0),   Rgb(0, 255, 255),
    Rgb(255, 0, 0),     Rgb(255, 0, 255), Rgb(255, 255, 0), Rgb(255, 255, 255)};

struct ChartFonts {
    std::string Font1 = "Arial"; // chart text
    double Size1 = 8;
    bool Bold1 = false;
    std::string Font2 = "Arial"; // scales and titles
    double Size2 = 8;
};

} // namespace kori::platform
