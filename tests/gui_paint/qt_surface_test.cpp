#include "chart/print_chart.h"
#include "chart/screen_player.h"
#include "gui/paint/pdf_printer.h"
#include "gui/paint/qt_surface.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <QFontInfo>

#include <gtest/gtest.h>

namespace kori::gui {
namespace {

using platform::Rgb;

QRgb At(const QImage& image, int x, int y) {
    return image.pixel(x, y) & 0xFFFFFF;
}
constexpr QRgb kRed = 0xFF0000, kGreen = 0x00FF00, kBlue = 0x0000FF, kBlack = 0;

TEST(QtSurface, ShapesLandOnThePixelsTheyName) {
    ImageSurface s(100, 60);
    s.SetBackColour(Rgb(0, 0, 0));
    s.Clear();
    s.FilledBox(20, 15, 10, 10, Rgb(255, 0, 0)); // corners either way round, both filled
    s.Line(30, 5, 60, 5, Rgb(0, 255, 0));
    s.Box(70, 20, 90, 40, Rgb(0, 0, 255));
    s.Point(5, 50, Rgb(0, 255, 0));
    s.SetLineStyle(platform::LineStyle::Dash);
    s.Line(0, 57, 99, 57, Rgb(255, 0, 0));
    const QImage& img = s.Finish();

    EXPECT_EQ(At(img, 10, 10), kRed);
    EXPECT_EQ(At(img, 20, 15), kRed);
    EXPECT_EQ(At(img, 21, 15), kBlack);
    EXPECT_EQ(At(img, 45, 5), kGreen);
    EXPECT_EQ(At(img, 45, 6), kBlack);
    EXPECT_EQ(At(img, 70, 30), kBlue);
    EXPECT_EQ(At(img, 90, 30), kBlue);
    EXPECT_EQ(At(img, 80, 30), kBlack); // an outline only
    EXPECT_EQ(At(img, 5, 50), kGreen);
    int on = 0;
    for (int x = 0; x < 100; ++x)
        on += At(img, x, 57) == kRed;
    EXPECT_GT(on, 40); // dashes of 5 with gaps of 3
    EXPECT_LT(on, 80);
}

TEST(QtSurface, ArialResolvesAndTextHangsBelowItsPosition) {
    ImageSurface s(200, 80);
    s.SetBackColour(Rgb(0, 0, 0));
    s.Clear();
    s.SetFontName("Arial");
    s.SetFontSize(18); // 24 pixels at 96 dots an inch
    EXPECT_EQ(QFontInfo(s.font()).family(), "Liberation Sans");
    EXPECT_NEAR(s.TextHeight("H"), 24 * 1.149, 1.5);
    EXPECT_GT(s.TextWidth("HHHH"), 3.5 * s.TextWidth("H"));
    s.SetForeColour(Rgb(255, 255, 255));
    s.SetTextPosition(40, 20);
    s.PrintText("H");
    const QImage& img = s.Finish();
    int top = 80, left = 200;
    for (int y = 0; y < 80; ++y)
        for (int x = 0; x < 200; ++x)
            if (qGray(img.pixel(x, y)) > 128) {
                top = std::min(top, y);
                left = std::min(left, x);
            }
    EXPECT_GE(top, 20);
    EXPECT_LT(top, 30);
    EXPECT_GE(left, 40);
    EXPECT_LT(left, 46);
}

TEST(QtSurface, SavedChartPlaysOntoAnImage) {
    test::TempRoot root;
    const auto path = root.Write("a.cht", "F,10,10,20,20,255\r\nX,30,30,40,40,255\r\n");
    platform::Palette palette{};
    palette[17] = Rgb(0, 0, 255);
    platform::ScriptedDialogs dialogs;
    ImageSurface area(50, 50);
    ASSERT_TRUE(chart::ShowSavedChart(path, area, palette, {}, dialogs));
    const QImage& img = area.Finish();
    EXPECT_EQ(At(img, 15, 15), kRed);
    EXPECT_EQ(At(img, 35, 35), kBlue); // "X" is for paper
    const auto png = root.path() / "a.png";
    ASSERT_TRUE(SavePng(img, png));
    EXPECT_EQ(platform::ReadWholeFile(png)->substr(1, 3), "PNG");
}

TEST(PdfPrinter, A4PagesInDotsAndAWholeDocument) {
    test::TempRoot root;
    const auto path = root.path() / "chart.pdf";
    PdfPrinter printer(path);
    EXPECT_NEAR(printer.Width(), 4961, 4); // 210 x 297 mm at 600 dots an inch
    EXPECT_NEAR(printer.Height(), 7016, 4);
    EXPECT_DOUBLE_EQ(printer.TwipsPerPixelX(), 2.4);
    printer.SetOrientation(platform::kLandscape);
    EXPECT_NEAR(printer.Width(), 7016, 4);
    EXPECT_NEAR(printer.Height(), 4961, 4);

    printer.SetScaleOrigin(-100, -100);
    printer.SetLineWidth(3);
    printer.Line(0, 0, 400, 400, Rgb(255, 0, 0));
    printer.SetFontSize(8.25);
    EXPECT_NEAR(printer.TextHeight("x"), 8.25 / 72 * 600 * 1.149, 8); // points at 600 dots
    printer.NewPage();
    EXPECT_FALSE(platform::FileExists(path)); // not before the document is whole
    ASSERT_TRUE(printer.EndDoc());
    const auto pdf = platform::ReadWholeFile(path);
    ASSERT_TRUE(pdf);
    EXPECT_TRUE(pdf->starts_with("%PDF"));
    EXPECT_NE(pdf->find("/Count 2"), std::string::npos);
    // The document and nothing beside it: no scratch file stays behind.
    EXPECT_EQ(test::FilesIn(root.path()), std::vector<std::string>{"chart.pdf"});
}

TEST(PdfPrinter, PaperPlayerPrintsAPage) {
    test::TempRoot root;
    const auto path = root.path() / "chart.pdf";
    {
        PdfPrinter printer(path);
        const platform::Palette palette{};
        const platform::ChartFonts fonts;
        chart::PrintSettings settings;
        const chart::PaperJob job{printer, palette, fonts, 1000, 700};
        auto reader = chart::StreamReader::FromText("T,8.25,10,10,Hello,0\r\nK,50,50,0\r\n");
        EXPECT_EQ(chart::PlayOnPaper(reader, job, settings), chart::PlayOutcome::Played);
        // 1000 x 700 units at 4 dots a unit, centred on the page.
        EXPECT_EQ(settings.PageLeft, -(static_cast<int>(printer.Width()) - 4000) / 2);
    }
    EXPECT_TRUE(platform::FileHasData(path));
}

} // namespace
} // namespace kori::gui
