#pragma once
// The chart area as a picture of its own without any windowing library: one chart unit one
// pixel, drawn by the same pixel rules as the desktop's chart area so that a picture made here
// and a screenshot of the program agree. Lines one pixel wide are aliased; large dots are
// smoothed; text is smoothed grey, in the font the desktop would pick.
#include "platform/status.h"
#include "platform/surface.h"
#include "raster/glyph_font.h"
#include "raster/large_buffer.h"
#include "raster/png.h"

#include <filesystem>
#include <memory>
#include <string>

namespace kori::raster {

class RasterSurface : public platform::Surface {
public:
    RasterSurface(int width, int height);

    void Clear() override;
    void SetBackColour(platform::Colour c) override { m_back = c; }
    void SetLineWidth(int width) override { m_lineWidth = width < 1 ? 1 : width; }
    void SetLineStyle(platform::LineStyle style) override { m_style = style; }
    void SetForeColour(platform::Colour c) override { m_fore = c; }
    void Line(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void Box(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void Point(double x, double y, platform::Colour c) override;
    void SetFontName(std::string_view name) override;
    void SetFontSize(double points) override;
    void SetFontBold(bool bold) override;
    void SetFontItalic(bool italic) override;
    void SetTextPosition(double x, double y) override {
        m_textX = x;
        m_textY = y;
    }
    void PrintText(std::string_view text) override;
    double TextWidth(std::string_view text) override;
    double TextHeight(std::string_view text) override;
    double ScaleWidth() const override { return m_width; }
    double ScaleHeight() const override { return m_height; }

    // Pixels as 0xFFRRGGBB, row after row.
    std::uint32_t PixelAt(int x, int y) const { return m_pixels[Index(x, y)]; }
    PixelRows Rows() const;
    bool EncodePng(std::string& bytes) const;
    platform::Status SavePng(const std::filesystem::path& path) const;

private:
    std::size_t Index(int x, int y) const {
        return static_cast<std::size_t>(y) * static_cast<std::size_t>(m_width) +
               static_cast<std::size_t>(x);
    }
    void Plot(int x, int y, std::uint32_t pixel) {
        if (x >= 0 && y >= 0 && x < m_width && y < m_height) m_pixels[Index(x, y)] = pixel;
    }
    void Blend(int x, int y, std::uint32_t pixel, int alpha);
    void FillPixels(long x1, long y1, long x2, long y2, std::uint32_t pixel);
    void ThinLine(double x1, double y1, double x2, double y2, std::uint32_t pixel);
    void WideLine(double x1, double y1, double x2, double y2, std::uint32_t pixel);
    void Dot(double x, double y, std::uint32_t pixel);
    GlyphFont* Font();

    int m_width, m_height;
    LargeBuffer m_buffer;
    std::uint32_t* m_pixels = nullptr;
    platform::Colour m_back = 0xFFFFFF;
    platform::Colour m_fore = 0;
    int m_lineWidth = 1;
    platform::LineStyle m_style = platform::LineStyle::Solid;
    std::string m_fontName = "Arial";
    double m_fontSize = 8.25;
    bool m_bold = false, m_italic = false;
    std::shared_ptr<GlyphFont> m_font; // for the settings above; null until text needs it
    double m_textX = 0, m_textY = 0;
};

} // namespace kori::raster
