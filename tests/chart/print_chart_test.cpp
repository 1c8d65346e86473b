#include "chart/print_chart.h"
#include "player_rig.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::chart {
namespace {

using Strings = std::vector<std::string>;

class StatusLog : public platform::Progress {
public:
    void SetStatus(std::string_view text) override { texts.emplace_back(text); }
    void SetRange(long long) override {}
    void SetValue(long long) override {}
    Strings texts;
};

// A4 at 600 dots an inch: 2.4 twips a dot, so a print scale of 1.5 makes 4 dots a chart unit.
struct PaperRig {
    platform::Palette palette = test::PlayerPalette();
    platform::ChartFonts fonts = test::PlayerFonts(true);
    platform::RecordingPrinter printer;
    StatusLog status;
    PrintSettings settings;
    PaperJob job{printer, palette, fonts, 600, 400, &status, "Ready", nullptr};

    PaperRig() {
        settings.PageLeft = -100;
        settings.PageTop = -200;
    }
    PlayOutcome Print(std::string stream) {
        auto reader = StreamReader::FromText(std::move(stream));
        return PlayOnPaper(reader, job, settings);
    }
};

TEST(PaperPlayer, PlaysEveryLetterByThePaperRules) {
    PaperRig rig;
    rig.settings.PrintOrientation = 2;
    rig.settings.PrintLineWidth = 5;
    ASSERT_EQ(rig.Print("T,8.25,10.5,20.25,A  B,255\r\n"
                        "S,12,5,6,Ti tle,65280\r\n"
                        "Z,10,7,8,Em,16711680\r\n"
                        "B,1,2,3,4,11\r\nF,1,2,3,4,12\r\nC,1,2,3,4,13\r\nX,1,2,3,4,14\r\n"
                        "H,1,2,3,4,15\r\nL,1,2,3,4,16\r\nM,1,2,3,4,17\r\n"
                        "D,1,2,3,4,18\r\nE,1,2,3,4,19\r\nV,1,2,3,4,20\r\n"
                        "P,5,6,21\r\nK,5,6,22\r\n"),
              PlayOutcome::Played);
    EXPECT_EQ(rig.printer.calls(), (Strings{"Orientation 2",
                                            "Origin -100,-200",
                                            "Style solid",
                                            "Width 1",
                                            "Text 42,81 size 8.25 bold #255 [A  B]",
                                            "Text 20,24 size 12 #65280 [Title]",
                                            "Style solid",
                                            "Width 1",
                                            "Text 28,32 size 10 bold italic #16711680 [Em]",
                                            "Width 1",
                                            "Box 4,8,12,16 #11",
                                            "FilledBox 4,8,12,16 #12",
                                            "FilledBox 4,8,12,16 #13",
                                            "Width 1",
                                            "Width 1",
                                            "FilledBox 4,8,12,16 #14",
                                            "Width 1",
                                            "Width 5",
                                            "Style solid",
                                            "Line 4,8,12,16 #15",
                                            "Width 1",
                                            "Width 1",
                                            "Style solid",
                                            "Line 4,8,12,16 #16",
                                            "Width 1",
                                            "Style solid",
                                            "Line 4,8,12,16 #17",
                                            "Width 1",
                                            "Style dash",
                                            "Line 4,8,12,16 #18",
                                            "Style solid",
                                            "Width 1",
                                            "Style dash",
                                            "Line 4,8,12,16 #19",
                                            "Style solid",
                                            "Width 1",
                                            "Style dot",
                                            "Line 4,8,12,16 #20",
                                            "Style solid",
                                            "Width 5",
                                            "Line 20,24,20,24 #21",
                                            "Width 1",
                                            "Width 3",
                                            "Line 20,24,20,24 #22",
                                            "Width 1",
                                            "EndDoc"}));
    EXPECT_EQ(rig.status.texts, (Strings{"PRINTING - WAIT", "Ready"}));
}

TEST(PaperPlayer, FirstPrintCentresAndLaterPrintsKeepTheOrigin) {
    PaperRig rig;
    rig.settings.PageLeft = 0;
    rig.settings.PageTop = 0;
    // Chart 600 x 400 units is 2400 x 1600 dots on a 4961 x 7016 page.
    rig.Print("L,0,0,600,400,1\r\n");
    EXPECT_EQ(rig.printer.calls()[0], "Origin -1280,-2708"); // -1280.5 rounds to even
    EXPECT_EQ(rig.settings.PageLeft, -1280);
    EXPECT_EQ(rig.settings.PageTop, -2708);

    rig.settings.PrintOrientation = 2;
    platform::RecordingPrinter again;
    PaperJob job{again, rig.palette, rig.fonts, 600, 400};
    auto reader = StreamReader::FromText("L,0,0,600,400,1\r\n");
    PlayOnPaper(reader, job, rig.settings);
    EXPECT_EQ(again.calls()[1], "Origin -1280,-2708");
}

TEST(PaperPlayer, LineWidthOutsideOneToTenPrintsAtTwo) {
    for (std::int16_t width : {0, 11}) {
        PaperRig rig;
        rig.settings.PrintLineWidth = width;
        rig.Print("H,1,1,2,2,5\r\n");
        EXPECT_EQ(rig.printer.calls()[3], "Width 2") << width;
        EXPECT_EQ(rig.settings.PrintLineWidth, 2);
    }
}

TEST(PaperPlayer, ColourRule) {
    const platform::Palette pal = test::PlayerPalette();
    PrintSettings s;
    // Colour printer, whites kept as whites were asked for: every colour stays but the pale.
    for (char letter : std::string("TSZBLMDEVHPKCFX")) {
        EXPECT_EQ(PrintColourOf(letter, 255, s, pal), 255u) << letter;
        EXPECT_EQ(PrintColourOf(letter, 1015, s, pal), 1000u) << letter; // entry 15
        EXPECT_EQ(PrintColourOf(letter, 1007, s, pal), 1000u) << letter; // entry 7
        EXPECT_EQ(PrintColourOf(letter, platform::Rgb(250, 250, 240), s, pal), 1000u) << letter;
    }
    // White as black: text and thin lines go black, heavy lines, fills and dots keep colour.
    s.PrintColourLines = 1;
    for (char letter : std::string("TSZBLMDEV"))
        EXPECT_EQ(PrintColourOf(letter, 255, s, pal), 1000u) << letter;
    for (char letter : std::string("HPKCFX")) {
        EXPECT_EQ(PrintColourOf(letter, 255, s, pal), 255u) << letter;
        EXPECT_EQ(PrintColourOf(letter, 1015, s, pal), 1000u) << letter;
    }
    s.PrintColour = 0;
    EXPECT_EQ(PrintColourOf('H', 1015, s, pal), 1000u);
    EXPECT_EQ(PrintColourOf('F', 255, s, pal), 1000u);

    EXPECT_TRUE(NearWhite(platform::Rgb(192, 192, 192)));
    EXPECT_FALSE(NearWhite(platform::Rgb(255, 255, 0))); // yellow is a colour, not paper
    EXPECT_FALSE(NearWhite(platform::Rgb(191, 255, 255)));

    PaperRig rig;
    rig.settings.PrintColour = 0;
    rig.Print("T,8,1,1,a,255\r\nF,1,1,2,2,77\r\n");
    EXPECT_EQ(rig.printer.calls()[3], "Text 4,4 size 8 bold #1000 [a]");
    EXPECT_EQ(rig.printer.calls()[4], "FilledBox 4,4,8,8 #1000");
}

TEST(PaperPlayer, BoldOptionAndEmptyTexts) {
    PaperRig rig;
    rig.fonts.Bold1 = false;
    rig.settings.PrintBold = true;
    rig.Print("T,8,1,1,   ,5\r\nT,8,1,1,a,5\r\nZ,8,1,1,b,5\r\nT,8,1,1,c,5\r\n");
    EXPECT_EQ(
        rig.printer.calls(),
        (Strings{"Origin -100,-200", "Style solid", "Width 1", "Text 4,4 size 8 bold #5 [a]",
                 "Text 4,4 size 8 bold italic #5 [b]", "Text 4,4 size 8 bold #5 [c]", "EndDoc"}));
    // Without the option, text after a "Z" prints plain even when font 1 is bold.
    PaperRig plain;
    plain.Print("Z,8,1,1,b,5\r\nT,8,1,1,c,5\r\n");
    EXPECT_EQ(plain.printer.calls()[4], "Text 4,4 size 8 #5 [c]");
}

TEST(PaperPlayer, FailurePrintsWhatIsThereAndAnEmptyStreamABlankPage) {
    PaperRig rig;
    EXPECT_EQ(rig.Print("L,1,1,2,2,5\r\nL,1,2,3,4,5,6\r\nL,3,3,4,4,5\r\n"), PlayOutcome::Malformed);
    EXPECT_EQ(rig.printer.calls(), (Strings{"Origin -100,-200", "Style solid", "Width 1", "Width 1",
                                            "Style solid", "Line 4,4,8,8 #5", "EndDoc"}));
    PaperRig blank;
    EXPECT_EQ(blank.Print(""), PlayOutcome::NothingPlayed);
    EXPECT_EQ(blank.printer.calls().back(), "EndDoc");
    EXPECT_EQ(blank.status.texts.back(), "Ready");
}

TEST(PaperPlayer, SettingsFromTheIniFile) {
    test::TempRoot root;
    platform::IniFile ini(root.path() / "Kori.ini");
    const PrintSettings d = LoadPrintSettings(ini);
    EXPECT_EQ(d.PrintScale, 1.5f);
    EXPECT_EQ(d.PrintLineWidth, 2);
    EXPECT_EQ(d.PageLeft, 0);
    EXPECT_EQ(d.PrintOrientation, 0);
    ini.Write("Charts", "EFact", "2");
    ini.Write("Charts", "Line Width", "4");
    ini.Write("ChtPage", "Orient", "2");
    ini.Write("ChtPage", "PPTop", "-300");
    ini.Write("ChtPage", "PPLft", "-150");
    const PrintSettings s = LoadPrintSettings(ini);
    EXPECT_EQ(s.PrintScale, 2.0f);
    EXPECT_EQ(s.PrintLineWidth, 4);
    EXPECT_EQ(s.PrintOrientation, 2);
    EXPECT_EQ(s.PageTop, -300);
    EXPECT_EQ(s.PageLeft, -150);
}

} // namespace
} // namespace kori::chart
