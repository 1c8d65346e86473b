// Pixel rules of the raster surface on tiny pictures, worked out by hand, and its PNG.
#include "raster/raster_surface.h"

#include <libdeflate.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace kori::raster {
namespace {

using platform::LineStyle;
using platform::Rgb;

// One text row per picture row: '#' where the pixel is black, '.' where it stayed white.
std::vector<std::string> Rows(const RasterSurface& s, int w, int h) {
    std::vector<std::string> rows;
    for (int y = 0; y < h; ++y) {
        std::string row;
        for (int x = 0; x < w; ++x)
            row += (s.PixelAt(x, y) & 0xFFFFFF) == 0 ? '#' : '.';
        rows.push_back(row);
    }
    return rows;
}

TEST(RasterLines, OnePixelLinesTakeTheirPixelsFromBothEnds) {
    RasterSurface s(12, 8);
    s.Line(1, 1, 6, 1, 0);         // both end pixels in
    s.Line(9.7, 2.3, 9.7, 5.3, 0); // a fraction keeps the pixel it lies in
    s.Line(2, 3, 6, 5, 0);         // two columns a row, from the end it starts at
    EXPECT_EQ(Rows(s, 12, 8), (std::vector<std::string>{
                                  "............",
                                  ".######.....",
                                  ".........#..",
                                  "..##.....#..",
                                  "....##...#..",
                                  "......#..#..",
                                  "............",
                                  "............",
                              }));
}

TEST(RasterLines, EitherDirectionGivesTheSamePixels) {
    RasterSurface ahead(16, 10), back(16, 10);
    ahead.Line(1, 1, 14, 8, 0);
    back.Line(14, 8, 1, 1, 0);
    EXPECT_EQ(Rows(ahead, 16, 10), Rows(back, 16, 10));
}

TEST(RasterLines, DashesAndDotsCountFromTheFirstPoint) {
    RasterSurface s(24, 4);
    s.SetLineStyle(LineStyle::Dash); // five on, three off
    s.Line(1, 0, 22, 0, 0);
    s.Line(22, 1, 1, 1, 0);
    s.SetLineStyle(LineStyle::Dot); // one on, two off
    s.Line(1, 2, 22, 2, 0);
    EXPECT_EQ(Rows(s, 24, 3), (std::vector<std::string>{
                                  ".#####...#####...#####..",
                                  "..#####...#####...#####.",
                                  ".#..#..#..#..#..#..#..#.",
                              }));
}

TEST(RasterLines, WideLinesHaveRoundEnds) {
    RasterSurface s(16, 9);
    s.SetLineWidth(3);
    s.Line(4, 5, 12, 5, 0);
    EXPECT_EQ(Rows(s, 16, 9), (std::vector<std::string>{
                                  "................",
                                  "................",
                                  "................",
                                  "................",
                                  "...##########...",
                                  "...##########...",
                                  "....########....",
                                  "................",
                                  "................",
                              }));
}

TEST(RasterBoxes, OutlinesFillsAndPoints) {
    RasterSurface s(10, 8);
    s.Box(6, 4, 1, 1, 0);         // corners either way round
    s.FilledBox(8, 6, 7.5, 5, 0); // halves round up
    s.Point(0.4, 6.6, 0);
    EXPECT_EQ(Rows(s, 10, 8), (std::vector<std::string>{
                                  "..........",
                                  ".######...",
                                  ".#....#...",
                                  ".#....#...",
                                  ".######...",
                                  "........#.",
                                  "........#.",
                                  "#.........",
                              }));
}

TEST(RasterBoxes, ClearAndDrawingOutsideThePicture) {
    RasterSurface s(4, 3);
    s.SetBackColour(Rgb(10, 20, 30));
    s.Clear();
    EXPECT_EQ(s.PixelAt(3, 2), 0xFF0A141Eu); // stored as 0xFFRRGGBB
    s.Line(-50, 1, 50, 1, Rgb(255, 0, 0));
    s.FilledBox(-9, -9, -2, 99, 0);
    s.Point(40, 40, 0);
    EXPECT_EQ(s.PixelAt(0, 1), 0xFFFF0000u);
    EXPECT_EQ(s.PixelAt(3, 1), 0xFFFF0000u);
    EXPECT_EQ(s.PixelAt(0, 0), 0xFF0A141Eu);
}

TEST(RasterDots, LargeDotsAreSmoothedAndCentred) {
    RasterSurface s(9, 9);
    s.SetLineWidth(4);
    s.Line(4.5, 4.5, 4.5, 4.5, 0); // radius 2 about the middle of pixel (4, 4)
    EXPECT_EQ(s.PixelAt(4, 4), 0xFF000000u);
    EXPECT_EQ(s.PixelAt(4, 3), 0xFF000000u);
    EXPECT_EQ(s.PixelAt(0, 4), 0xFFFFFFFFu);
    EXPECT_EQ(s.PixelAt(2, 2), 0xFFFFFFFFu);           // its nearest corner is 2.12 from the middle
    const std::uint32_t edge = s.PixelAt(3, 2) & 0xFF; // partly covered: grey
    EXPECT_GT(edge, 0x20u);
    EXPECT_LT(edge, 0xF0u);
    EXPECT_EQ(s.PixelAt(3, 2), s.PixelAt(5, 6)); // round, so alike on both sides
}

TEST(RasterText, ArialHasItsTwinsMetricsAndDrawsBelowThePosition) {
    RasterSurface s(120, 40);
    s.SetFontName("Arial");
    s.SetFontSize(8.25); // 11 pixels
    // Ascent 1854 and descent 434 of 2048 units, in 64ths of a pixel.
    EXPECT_DOUBLE_EQ(s.TextHeight("x"), (637 + 149) / 64.0);
    // W is 1933 units wide and 1 is 1139: advances are cut, not rounded, to 64ths.
    EXPECT_DOUBLE_EQ(s.TextWidth("W1"), (664 + 391) / 64.0);
    s.SetFontBold(true);
    EXPECT_GT(s.TextWidth("Karoo"), 0);
    s.SetTextPosition(10, 5);
    s.PrintText("HH");
    int inked = 0, above = 0;
    for (int y = 0; y < 40; ++y)
        for (int x = 0; x < 120; ++x)
            if ((s.PixelAt(x, y) & 0xFF) < 0x80) (y < 5 ? above : inked) += 1;
    EXPECT_EQ(above, 0);
    EXPECT_GT(inked, 20);
}

TEST(RasterPng, DecodesToThePixels) {
    RasterSurface s(7, 5);
    s.SetBackColour(Rgb(1, 2, 3));
    s.Clear();
    s.Line(0, 2, 6, 2, Rgb(200, 100, 50));
    std::string png;
    ASSERT_TRUE(s.EncodePng(png));
    ASSERT_EQ(png.substr(1, 3), "PNG");
    // IHDR at 8, pHYs after it, then IDAT: its zlib stream holds each row as filter byte
    // "up" and three bytes a pixel, less the row above.
    const auto idat = png.find("IDAT");
    ASSERT_NE(idat, std::string::npos);
    const auto* len = reinterpret_cast<const unsigned char*>(png.data() + idat - 4);
    const std::size_t size = (std::size_t{len[0]} << 24) | (len[1] << 16) | (len[2] << 8) | len[3];
    std::vector<unsigned char> rows(5 * (7 * 3 + 1));
    libdeflate_decompressor* d = libdeflate_alloc_decompressor();
    std::size_t got = 0;
    ASSERT_EQ(
        libdeflate_zlib_decompress(d, png.data() + idat + 4, size, rows.data(), rows.size(), &got),
        LIBDEFLATE_SUCCESS);
    libdeflate_free_decompressor(d);
    ASSERT_EQ(got, rows.size());
    EXPECT_EQ(rows[0], 2);
    EXPECT_EQ(rows[1], 1);
    EXPECT_EQ(rows[2], 2);
    EXPECT_EQ(rows[3], 3);
    EXPECT_EQ(rows[22 + 1], 0);   // row 1 equals row 0
    EXPECT_EQ(rows[44 + 1], 199); // row 2: 200 - 1
    EXPECT_EQ(rows[44 + 2], 98);
    EXPECT_EQ(rows[66 + 1], static_cast<unsigned char>(1 - 200));
}

} // namespace
} // namespace kori::raster
