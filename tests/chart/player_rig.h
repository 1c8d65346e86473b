#pragma once
// Shared by the player tests: a palette whose entries read as 1000 + their number, fonts with
// names of their own, and a recording surface that also notes the font of every text.
#include "platform/palette.h"
#include "platform/surface.h"

#include <string>
#include <vector>

namespace kori::test {

inline platform::Palette PlayerPalette() {
    platform::Palette p{};
    for (std::size_t i = 0; i < p.size(); ++i)
        p[i] = static_cast<platform::Colour>(1000 + i);
    return p;
}

inline platform::ChartFonts PlayerFonts(bool bold1) {
    platform::ChartFonts f;
    f.Font1 = "Font One";
    f.Size1 = 9;
    f.Bold1 = bold1;
    f.Font2 = "Font Two";
    f.Size2 = 7;
    return f;
}

class FontNotingSurface : public platform::RecordingSurface {
public:
    using RecordingSurface::RecordingSurface;
    void PrintText(std::string_view text) override {
        fonts.push_back(fontName());
        RecordingSurface::PrintText(text);
    }
    std::vector<std::string> fonts;
};

} // namespace kori::test
