#include "platform/svg_surface.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::platform {
namespace {

bool Has(const std::string& doc, std::string_view part) {
    return doc.find(part) != std::string::npos;
}

TEST(SvgSurface, WritesShapesWithColoursWidthsAndStyles) {
    SvgSurface s(300, 200);
    s.SetBackColour(Rgb(0, 0, 0));
    s.Line(1, 1, 5, 5, Rgb(0, 255, 0)); // wiped by the clear below
    s.Clear();
    s.SetLineWidth(2);
    s.SetLineStyle(LineStyle::Dash);
    s.Line(10, 20, 30, 20, Rgb(255, 0, 0));
    s.SetLineStyle(LineStyle::Dot);
    s.SetLineWidth(1);
    s.Line(0, 5, 9, 5, Rgb(1, 2, 3));
    s.SetLineStyle(LineStyle::Solid);
    s.Box(40, 50, 10, 20, Rgb(0, 0, 255));
    s.FilledBox(5, 6, 7, 9, Rgb(255, 255, 0));
    s.SetLineWidth(3);
    s.Line(100, 100, 100, 100, Rgb(0, 0, 255)); // a zero-length line is a dot of the pen
    const std::string doc = s.Document();

    EXPECT_TRUE(doc.starts_with("<?xml"));
    EXPECT_TRUE(Has(doc, "width=\"300\" height=\"200\" viewBox=\"0 0 300 200\""));
    EXPECT_TRUE(doc.ends_with("</svg>\n"));
    EXPECT_FALSE(Has(doc, "#00ff00"));
    EXPECT_TRUE(Has(doc, "<rect x=\"0\" y=\"0\" width=\"300\" height=\"200\" fill=\"#000000\"/>"));
    EXPECT_TRUE(Has(doc, "<line x1=\"10\" y1=\"20\" x2=\"30\" y2=\"20\" stroke=\"#ff0000\" "
                         "stroke-width=\"2\" stroke-dasharray=\"10,6\"/>"));
    EXPECT_TRUE(Has(doc, "stroke=\"#010203\" stroke-width=\"1\" stroke-dasharray=\"1,2\"/>"));
    EXPECT_TRUE(Has(doc, "<rect x=\"10\" y=\"20\" width=\"30\" height=\"30\" fill=\"none\" "
                         "stroke=\"#0000ff\" stroke-width=\"1\"/>"));
    EXPECT_TRUE(Has(doc, "<rect x=\"5\" y=\"6\" width=\"3\" height=\"4\" fill=\"#ffff00\"/>"));
    EXPECT_TRUE(
        Has(doc, "<rect x=\"98.5\" y=\"98.5\" width=\"3\" height=\"3\" fill=\"#0000ff\"/>"));
}

TEST(SvgSurface, TextStandsWithItsTopLeftAtThePositionAndIsEscaped) {
    SvgSurface s(300, 200);
    s.SetFontName("Arial");
    s.SetFontSize(12); // 16 units
    s.SetFontBold(true);
    s.SetForeColour(Rgb(255, 255, 255));
    s.SetTextPosition(10, 20);
    s.PrintText("A  <b> & \xA3"
                "5");
    s.SetFontBold(false);
    s.SetFontItalic(true);
    s.PrintText("next");
    const std::string doc = s.Document();
    EXPECT_TRUE(Has(doc, "<text x=\"10\" y=\"34.48\" font-family=\"Arial\" font-size=\"16\" "
                         "font-weight=\"bold\" fill=\"#ffffff\" xml:space=\"preserve\">"
                         "A  &lt;b&gt; &amp; \xC2\xA3"
                         "5</text>"));
    // The next print goes one line lower.
    EXPECT_TRUE(Has(doc, "<text x=\"10\" y=\"52.864\" font-family=\"Arial\" font-size=\"16\" "
                         "font-style=\"italic\""));
    EXPECT_NEAR(s.TextWidth("A1"), (667 + 556) / 1000.0 * 16, 1e-9);
    EXPECT_NEAR(s.TextHeight("x"), 1.149 * 16, 1e-9);
}

TEST(SvgSurface, SavesTheDocument) {
    test::TempRoot root;
    SvgSurface s(10, 10);
    s.Clear();
    ASSERT_TRUE(s.Save(root.path() / "a.svg"));
    EXPECT_EQ(root.Read("a.svg"), s.Document());
}

} // namespace
} // namespace kori::platform
