#pragma once
// Fonts for the raster surface through FreeType: a family name and bold/italic found as the
// desktop's font configuration finds them ("Arial" becomes its metric twin), at a whole pixel
// size. Metrics are kept in 1/64 pixel as the desktop's own text layout keeps them, so that a
// chart measured here lays out as it does on the screen.
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace kori::raster {

struct Glyph {
    int left = 0, top = 0; // bitmap origin from the pen position, y up
    int width = 0, rows = 0;
    std::vector<std::uint8_t> coverage; // rows x width, 0..255
    int advance = 0;                    // 1/64 pixel, unhinted
};

class GlyphFont {
public:
    // Null when no font file can be found or read.
    static std::shared_ptr<GlyphFont> Open(const std::string& family, bool bold, bool italic,
                                           int pixelSize);
    ~GlyphFont();
    GlyphFont(const GlyphFont&) = delete;
    GlyphFont& operator=(const GlyphFont&) = delete;

    int ascent() const { return m_ascent; } // 1/64 pixel
    int descent() const { return m_descent; }
    // One byte of stream text (Latin-1); `phase` is the quarter pixel the pen stands at.
    const Glyph& Get(unsigned char ch, int phase);
    int Advance(unsigned char ch) { return Get(ch, 0).advance; }
    // Pair kerning between two bytes, 1/64 pixel.
    int Kerning(unsigned char left, unsigned char right);

private:
    struct Impl;
    explicit GlyphFont(std::unique_ptr<Impl> impl);
    std::unique_ptr<Impl> m_impl;
    int m_ascent = 0, m_descent = 0;
};

} // namespace kori::raster
