#include "raster/raster_surface.h"

#include "platform/files.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace kori::raster {

namespace {

constexpr int kDotsPerMeter96 = 3780; // 96 dots an inch

std::uint32_t ToPixel(platform::Colour c) {
    return 0xFF000000u | (static_cast<std::uint32_t>(platform::Red(c)) << 16) |
           (static_cast<std::uint32_t>(platform::Green(c)) << 8) |
           static_cast<std::uint32_t>(platform::Blue(c));
}

// Positions in 1/64 pixel, as the line rules count them.
long Fixed(double v) {
    return std::lround(v * 64);
}

long RoundHalfUp(double v) {
    return static_cast<long>(std::floor(v + 0.5));
}

// Dash patterns in 1/64 pixel along the line: on, off, on, off...
struct DashPattern {
    int parts[2] = {0, 0};
    int length = 0;
};

DashPattern PatternOf(platform::LineStyle style) {
    if (style == platform::LineStyle::Dash) return {{5 * 64, 3 * 64}, 8 * 64};
    if (style == platform::LineStyle::Dot) return {{1 * 64, 2 * 64}, 3 * 64};
    return {};
}

} // namespace

RasterSurface::RasterSurface(int width, int height)
    : m_width(std::max(width, 1)), m_height(std::max(height, 1)) {
    const std::size_t count =
        static_cast<std::size_t>(m_width) * static_cast<std::size_t>(m_height);
    m_buffer.Reserve(count * sizeof(std::uint32_t));
    m_pixels = reinterpret_cast<std::uint32_t*>(m_buffer.data());
    if (m_pixels != nullptr) std::fill(m_pixels, m_pixels + count, 0xFFFFFFFFu);
}

void RasterSurface::Blend(int x, int y, std::uint32_t pixel, int alpha) {
    if (alpha <= 0 || x < 0 || y < 0 || x >= m_width || y >= m_height) return;
    std::uint32_t& at = m_pixels[Index(x, y)];
    if (alpha >= 255) {
        at = pixel;
        return;
    }
    std::uint32_t out = 0xFF000000u;
    for (int shift = 0; shift <= 16; shift += 8) {
        const int s = static_cast<int>((pixel >> shift) & 0xFF);
        const int d = static_cast<int>((at >> shift) & 0xFF);
        const int v = (s * alpha + d * (255 - alpha) + 127) / 255;
        out |= static_cast<std::uint32_t>(v) << shift;
    }
    at = out;
}

// Pixels x1..x2-1 by y1..y2-1, cut to the picture.
void RasterSurface::FillPixels(long x1, long y1, long x2, long y2, std::uint32_t pixel) {
    x1 = std::max(x1, 0L);
    y1 = std::max(y1, 0L);
    x2 = std::min(x2, static_cast<long>(m_width));
    y2 = std::min(y2, static_cast<long>(m_height));
    if (m_pixels == nullptr) return;
    for (long y = y1; y < y2; ++y) {
        std::uint32_t* row = m_pixels + Index(0, static_cast<int>(y));
        std::fill(row + x1, row + std::max(x1, x2), pixel);
    }
}

void RasterSurface::Clear() {
    FillPixels(0, 0, m_width, m_height, ToPixel(m_back));
}

// A one-pixel line steps along its longer axis one pixel at a time, from half a pixel before
// its start to half a pixel past its end (square ends), and takes on the shorter axis the
// pixel that holds the line where it crosses the middle of the step. A broken line counts its
// pattern from the first point, however the line runs.
void RasterSurface::ThinLine(double x1, double y1, double x2, double y2, std::uint32_t pixel) {
    if (m_pixels == nullptr) return;
    const long fx1 = Fixed(x1), fy1 = Fixed(y1), fx2 = Fixed(x2), fy2 = Fixed(y2);
    const bool alongY = std::labs(fx2 - fx1) < std::labs(fy2 - fy1);
    long m1 = alongY ? fy1 : fx1, n1 = alongY ? fx1 : fy1;
    long m2 = alongY ? fy2 : fx2, n2 = alongY ? fx2 : fy2;
    const bool reversed = m1 > m2;
    if (reversed) {
        std::swap(m1, m2);
        std::swap(n1, n2);
    }
    const long long step = m2 == m1 ? 0 : (static_cast<long long>(n2 - n1) * 65536) / (m2 - m1);
    long long n = static_cast<long long>(n1) * 1024; // 1/65536 pixel
    m1 -= 32;
    n -= step / 2;
    m2 += 32;
    const long first = (m1 + 32) >> 6;
    const long end = (m2 + 32) >> 6;
    n += ((first * 64 + 32 - m1) * step) >> 6;

    const DashPattern pattern = PatternOf(m_style);
    for (long m = first; m < end; ++m, n += step) {
        if (pattern.length > 0) {
            // The pattern starts on the pixel of the first point, whichever way the line runs.
            const long from = reversed ? end - 1 - m : m - first;
            if ((from * 64) % pattern.length >= pattern.parts[0]) continue;
        }
        const long minor = static_cast<long>(n >> 16);
        if (alongY)
            Plot(static_cast<int>(minor), static_cast<int>(m), pixel);
        else
            Plot(static_cast<int>(m), static_cast<int>(minor), pixel);
    }
}

// A wide line is the band of its width with round ends; a pixel is in when its centre is.
void RasterSurface::WideLine(double x1, double y1, double x2, double y2, std::uint32_t pixel) {
    const double r = m_lineWidth / 2.0;
    const double dx = x2 - x1, dy = y2 - y1;
    const double length2 = dx * dx + dy * dy;
    const int left = static_cast<int>(std::floor(std::min(x1, x2) - r)) - 1;
    const int right = static_cast<int>(std::ceil(std::max(x1, x2) + r)) + 1;
    const int top = static_cast<int>(std::floor(std::min(y1, y2) - r)) - 1;
    const int bottom = static_cast<int>(std::ceil(std::max(y1, y2) + r)) + 1;
    for (int y = std::max(top, 0); y <= std::min(bottom, m_height - 1); ++y) {
        // A centre on the lower edge is in, on the upper edge out.
        const double cy = y + 0.5 - 1e-6;
        for (int x = std::max(left, 0); x <= std::min(right, m_width - 1); ++x) {
            const double cx = x + 0.5 - 1e-6;
            double t = length2 > 0 ? ((cx - x1) * dx + (cy - y1) * dy) / length2 : 0;
            t = std::clamp(t, 0.0, 1.0);
            const double ex = x1 + t * dx - cx, ey = y1 + t * dy - cy;
            if (ex * ex + ey * ey < r * r) Plot(x, y, pixel);
        }
    }
}

// A zero-length line is a dot as wide as the pen: the large dots of the paper, with smoothed
// edges (each pixel covered by the share of its 16 x 16 samples inside the circle).
void RasterSurface::Dot(double x, double y, std::uint32_t pixel) {
    if (m_lineWidth <= 1) {
        Plot(static_cast<int>(RoundHalfUp(x)), static_cast<int>(RoundHalfUp(y)), pixel);
        return;
    }
    const double r = m_lineWidth / 2.0;
    for (int py = static_cast<int>(std::floor(y - r)); py <= static_cast<int>(std::ceil(y + r));
         ++py)
        for (int px = static_cast<int>(std::floor(x - r)); px <= static_cast<int>(std::ceil(x + r));
             ++px) {
            int inside = 0;
            for (int sy = 0; sy < 16; ++sy)
                for (int sx = 0; sx < 16; ++sx) {
                    const double ex = px + (sx + 0.5) / 16 - x, ey = py + (sy + 0.5) / 16 - y;
                    if (ex * ex + ey * ey <= r * r) ++inside;
                }
            Blend(px, py, pixel, (inside * 255 + 128) / 256);
        }
}

void RasterSurface::Line(double x1, double y1, double x2, double y2, platform::Colour c) {
    if (x1 == x2 && y1 == y2) return Dot(x1, y1, ToPixel(c));
    if (m_lineWidth > 1) return WideLine(x1, y1, x2, y2, ToPixel(c));
    ThinLine(x1, y1, x2, y2, ToPixel(c));
}

void RasterSurface::Box(double x1, double y1, double x2, double y2, platform::Colour c) {
    const double left = std::min(x1, x2), right = std::max(x1, x2);
    const double top = std::min(y1, y2), bottom = std::max(y1, y2);
    Line(left, top, right, top, c);
    Line(right, top, right, bottom, c);
    Line(right, bottom, left, bottom, c);
    Line(left, bottom, left, top, c);
}

// Both corners lie inside the filled area; edges fall on the nearest pixel boundary.
void RasterSurface::FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) {
    const double left = std::min(x1, x2), top = std::min(y1, y2);
    const double right = std::max(x1, x2) + 1, bottom = std::max(y1, y2) + 1;
    FillPixels(RoundHalfUp(left), RoundHalfUp(top), RoundHalfUp(right), RoundHalfUp(bottom),
               ToPixel(c));
}

void RasterSurface::Point(double x, double y, platform::Colour c) {
    Plot(static_cast<int>(RoundHalfUp(x)), static_cast<int>(RoundHalfUp(y)), ToPixel(c));
}

void RasterSurface::SetFontName(std::string_view name) {
    if (name == m_fontName) return;
    m_fontName = name;
    m_font.reset();
}

void RasterSurface::SetFontSize(double points) {
    points = std::max(points, 1.0);
    if (points == m_fontSize) return;
    m_fontSize = points;
    m_font.reset();
}

void RasterSurface::SetFontBold(bool bold) {
    if (bold == m_bold) return;
    m_bold = bold;
    m_font.reset();
}

void RasterSurface::SetFontItalic(bool italic) {
    if (italic == m_italic) return;
    m_italic = italic;
    m_font.reset();
}

// Points at 96 dots an inch, to the nearest whole pixel as the desktop sizes its fonts.
GlyphFont* RasterSurface::Font() {
    if (!m_font) {
        const int pixels = std::max(1, static_cast<int>(RoundHalfUp(m_fontSize * 96.0 / 72.0)));
        m_font = GlyphFont::Open(m_fontName, m_bold, m_italic, pixels);
    }
    return m_font.get();
}

void RasterSurface::PrintText(std::string_view text) {
    GlyphFont* font = Font();
    if (font == nullptr) return;
    const std::uint32_t pixel = ToPixel(m_fore);
    long pen = Fixed(m_textX);
    const long baseline = RoundHalfUp(m_textY + font->ascent() / 64.0);
    unsigned char before = 0;
    for (const char ch : text) {
        const auto byte = static_cast<unsigned char>(ch);
        if (before != 0) pen += font->Kerning(before, byte);
        before = byte;
        const int phase = static_cast<int>((pen & 63) >> 4);
        const Glyph& g = font->Get(byte, phase);
        const long left = (pen >> 6) + g.left;
        const long top = baseline - g.top;
        for (int y = 0; y < g.rows; ++y)
            for (int x = 0; x < g.width; ++x)
                Blend(static_cast<int>(left + x), static_cast<int>(top + y), pixel,
                      g.coverage[static_cast<std::size_t>(y * g.width + x)]);
        pen += g.advance;
    }
    m_textY += TextHeight(text);
}

double RasterSurface::TextWidth(std::string_view text) {
    GlyphFont* font = Font();
    if (font == nullptr) return 0;
    long width = 0;
    unsigned char before = 0;
    for (const char ch : text) {
        const auto byte = static_cast<unsigned char>(ch);
        if (before != 0) width += font->Kerning(before, byte);
        width += font->Advance(byte);
        before = byte;
    }
    return width / 64.0;
}

double RasterSurface::TextHeight(std::string_view) {
    GlyphFont* font = Font();
    return font == nullptr ? 0 : (font->ascent() + font->descent()) / 64.0;
}

PixelRows RasterSurface::Rows() const {
    return {m_pixels, m_width, m_height, static_cast<std::size_t>(m_width), kDotsPerMeter96};
}

bool RasterSurface::EncodePng(std::string& bytes) const {
    bytes.clear();
    return EncodeOpaquePng(Rows(), bytes);
}

platform::Status RasterSurface::SavePng(const std::filesystem::path& path) const {
    std::string bytes;
    if (!EncodePng(bytes))
        return platform::Status::Error("Cannot make a picture for " + path.string());
    return platform::WriteFileAtomic(path, bytes);
}

} // namespace kori::raster
