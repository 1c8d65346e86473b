#pragma once
// What every drawing target must do, whatever it draws on. Each implementation instantiates
// these tests with a ContractSubject<T> that makes one and says how to see what it drew:
//
//   ContractSubject();                    a fresh target
//   platform::Surface& surface();         (printers: platform::Printer& surface())
//   static std::optional<std::pair<double, double>> MadeSize();  the area it was made with
//   static constexpr bool kClearErases;   whether a clear takes away what was drawn before
//   bool Shows(const Drawn&);             whether the drawing holds it; asked after all drawing
//   FontState Font();                     only where the target lets the font be read back
//   Printers also: int Pages(); bool Whole();   asked after EndDoc
#include "platform/printer.h"
#include "platform/surface.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <utility>

namespace kori::test {

enum class Mark { Clear, Line, Box, FilledBox, Point, Text };

// One thing drawn: its corners (a point and a text use the first) and its colour.
struct Drawn {
    Mark mark;
    int x1, y1, x2, y2;
    platform::Colour colour;
};

struct FontState {
    std::string name;
    double size;
    bool bold;
    bool italic;
    bool operator==(const FontState&) const = default;
};

template <class T> struct ContractSubject;

template <class T> class SurfaceContract : public testing::Test {
protected:
    ContractSubject<T> subject;
};
TYPED_TEST_SUITE_P(SurfaceContract);

TYPED_TEST_P(SurfaceContract, AreaIsPositiveAndTheSizeItWasMade) {
    auto& s = this->subject.surface();
    EXPECT_GT(s.ScaleWidth(), 0);
    EXPECT_GT(s.ScaleHeight(), 0);
    if (const auto size = ContractSubject<TypeParam>::MadeSize()) {
        EXPECT_DOUBLE_EQ(s.ScaleWidth(), size->first);
        EXPECT_DOUBLE_EQ(s.ScaleHeight(), size->second);
    }
}

TYPED_TEST_P(SurfaceContract, TextMeasuresGrowWithTextAndFont) {
    auto& s = this->subject.surface();
    s.SetFontName("Arial");
    s.SetFontSize(10);
    EXPECT_DOUBLE_EQ(s.TextWidth(""), 0);
    const double two = s.TextWidth("ab");
    const double four = s.TextWidth("abcd");
    const double eight = s.TextWidth("abcdefgh");
    EXPECT_GT(two, 0);
    EXPECT_GT(four, two);
    EXPECT_GT(eight, four);
    const double height10 = s.TextHeight("Xg");
    EXPECT_GT(height10, 0);
    EXPECT_GT(s.TextWidth("Xg"), 0);

    s.SetFontSize(20);
    EXPECT_GT(s.TextHeight("Xg"), height10);
    EXPECT_GT(s.TextWidth("abcd"), four);

    const double regular = s.TextWidth("Bold Wide Text 123");
    s.SetFontBold(true);
    EXPECT_GE(s.TextWidth("Bold Wide Text 123"), regular - 1e-9);
    s.SetFontBold(false);
    EXPECT_NEAR(s.TextWidth("Bold Wide Text 123"), regular, 1e-9);
}

// Everything lies inside a 200 x 120 area, the smallest any subject makes.
TYPED_TEST_P(SurfaceContract, ShapesDrawnInsideTheAreaAreSeen) {
    auto& s = this->subject.surface();
    const auto white = platform::Rgb(255, 255, 255);
    const Drawn clear{Mark::Clear, 0, 0, 0, 0, white};
    const Drawn line{Mark::Line, 10, 10, 60, 10, platform::Rgb(0, 255, 0)};
    const Drawn box{Mark::Box, 80, 20, 120, 60, platform::Rgb(0, 0, 255)};
    const Drawn filled{Mark::FilledBox, 20, 40, 50, 70, platform::Rgb(255, 0, 0)};
    const Drawn point{Mark::Point, 150, 100, 0, 0, platform::Rgb(255, 0, 255)};
    const Drawn text{Mark::Text, 130, 20, 0, 0, platform::Rgb(0, 0, 0)};
    s.SetBackColour(white);
    s.Clear();
    s.SetLineWidth(1);
    s.SetLineStyle(platform::LineStyle::Solid);
    s.Line(line.x1, line.y1, line.x2, line.y2, line.colour);
    s.Box(box.x1, box.y1, box.x2, box.y2, box.colour);
    s.FilledBox(filled.x1, filled.y1, filled.x2, filled.y2, filled.colour);
    s.Point(point.x1, point.y1, point.colour);
    s.SetFontName("Arial");
    s.SetFontSize(12);
    s.SetForeColour(text.colour);
    s.SetTextPosition(text.x1, text.y1);
    s.PrintText("Hj");

    auto& see = this->subject;
    EXPECT_TRUE(see.Shows(clear));
    EXPECT_TRUE(see.Shows(line));
    EXPECT_TRUE(see.Shows(box));
    EXPECT_TRUE(see.Shows(filled));
    EXPECT_TRUE(see.Shows(point));
    EXPECT_TRUE(see.Shows(text));
    // Nothing was drawn in yellow: an observer that sees everything sees nothing.
    EXPECT_FALSE(see.Shows({Mark::FilledBox, 20, 40, 50, 70, platform::Rgb(255, 255, 0)}));
    EXPECT_FALSE(see.Shows({Mark::Line, 10, 10, 60, 10, platform::Rgb(255, 255, 0)}));
}

TYPED_TEST_P(SurfaceContract, ClearFillsWithTheBackColour) {
    auto& s = this->subject.surface();
    const Drawn before{Mark::FilledBox, 20, 20, 60, 60, platform::Rgb(255, 0, 0)};
    s.SetBackColour(platform::Rgb(255, 255, 255));
    s.Clear();
    s.FilledBox(before.x1, before.y1, before.x2, before.y2, before.colour);
    s.SetBackColour(platform::Rgb(0, 255, 255));
    s.Clear();
    EXPECT_TRUE(this->subject.Shows({Mark::Clear, 0, 0, 0, 0, platform::Rgb(0, 255, 255)}));
    if constexpr (ContractSubject<TypeParam>::kClearErases)
        EXPECT_FALSE(this->subject.Shows(before));
}

TYPED_TEST_P(SurfaceContract, FontSettingsReadBackWhereTheyCanBeRead) {
    if constexpr (requires(ContractSubject<TypeParam> & c) { c.Font(); }) {
        auto& s = this->subject.surface();
        s.SetFontName("Courier New");
        s.SetFontSize(11.5);
        s.SetFontBold(true);
        s.SetFontItalic(true);
        EXPECT_EQ(this->subject.Font(), (FontState{"Courier New", 11.5, true, true}));
        s.SetFontName("Arial");
        s.SetFontSize(8.25);
        s.SetFontBold(false);
        s.SetFontItalic(false);
        EXPECT_EQ(this->subject.Font(), (FontState{"Arial", 8.25, false, false}));
    } else {
        GTEST_SKIP() << "this target keeps its font to itself";
    }
}

REGISTER_TYPED_TEST_SUITE_P(SurfaceContract, AreaIsPositiveAndTheSizeItWasMade,
                            TextMeasuresGrowWithTextAndFont, ShapesDrawnInsideTheAreaAreSeen,
                            ClearFillsWithTheBackColour, FontSettingsReadBackWhereTheyCanBeRead);

template <class T> class PrinterContract : public testing::Test {
protected:
    ContractSubject<T> subject;
};
TYPED_TEST_SUITE_P(PrinterContract);

TYPED_TEST_P(PrinterContract, PageIsPositiveAndTurnsWithTheOrientation) {
    platform::Printer& p = this->subject.surface();
    p.SetOrientation(platform::kPortrait);
    EXPECT_EQ(p.Orientation(), platform::kPortrait);
    const double width = p.Width(), height = p.Height();
    EXPECT_GT(width, 0);
    EXPECT_GT(height, width); // every paper we print on stands taller than wide
    EXPECT_DOUBLE_EQ(p.ScaleWidth(), width);
    EXPECT_DOUBLE_EQ(p.ScaleHeight(), height);
    EXPECT_GT(p.TwipsPerPixelX(), 0);
    EXPECT_GT(p.TwipsPerPixelY(), 0);

    p.SetOrientation(platform::kLandscape);
    EXPECT_EQ(p.Orientation(), platform::kLandscape);
    EXPECT_NEAR(p.Width(), height, 1);
    EXPECT_NEAR(p.Height(), width, 1);
    EXPECT_DOUBLE_EQ(p.ScaleWidth(), p.Width());
    p.SetOrientation(platform::kPortrait);
    EXPECT_NEAR(p.Width(), width, 1);
}

TYPED_TEST_P(PrinterContract, EndDocMakesAWholeOnePageDocument) {
    platform::Printer& p = this->subject.surface();
    p.SetBackColour(platform::Rgb(255, 255, 255));
    p.Clear();
    p.Line(100, 100, 900, 900, platform::Rgb(255, 0, 0));
    ASSERT_TRUE(p.EndDoc());
    EXPECT_TRUE(this->subject.Whole());
    EXPECT_EQ(this->subject.Pages(), 1);
}

TYPED_TEST_P(PrinterContract, NewPageAddsAPage) {
    platform::Printer& p = this->subject.surface();
    for (int page = 0; page < 3; ++page) {
        if (page > 0) p.NewPage();
        p.FilledBox(100, 100, 200, 200, platform::Rgb(0, 0, 255));
        // A new page has the whole paper again.
        EXPECT_GT(p.ScaleWidth(), 200);
        EXPECT_GT(p.ScaleHeight(), 200);
    }
    ASSERT_TRUE(p.EndDoc());
    EXPECT_TRUE(this->subject.Whole());
    EXPECT_EQ(this->subject.Pages(), 3);
}

TYPED_TEST_P(PrinterContract, LandscapePageStaysLandscapeOnceBegun) {
    platform::Printer& p = this->subject.surface();
    p.SetOrientation(platform::kLandscape);
    const double width = p.Width();
    p.Line(0, 0, 10, 10, platform::Rgb(0, 0, 0)); // begins the page
    EXPECT_DOUBLE_EQ(p.ScaleWidth(), width);
    EXPECT_GT(p.ScaleWidth(), p.ScaleHeight());
    ASSERT_TRUE(p.EndDoc());
    EXPECT_TRUE(this->subject.Whole());
}

REGISTER_TYPED_TEST_SUITE_P(PrinterContract, PageIsPositiveAndTurnsWithTheOrientation,
                            EndDocMakesAWholeOnePageDocument, NewPageAddsAPage,
                            LandscapePageStaysLandscapeOnceBegun);

} // namespace kori::test
