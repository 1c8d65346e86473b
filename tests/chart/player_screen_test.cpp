#include "chart/screen_player.h"
#include "player_rig.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::chart {
namespace {

using Strings = std::vector<std::string>;

struct ScreenRig {
    test::TempRoot root;
    platform::Palette palette = test::PlayerPalette();
    platform::ChartFonts fonts = test::PlayerFonts(true);
    platform::ScriptedDialogs dialogs;
    test::FontNotingSurface area{600, 400};

    bool Show(std::string_view stream) {
        const auto path = root.Write("saved.cht", stream);
        return ShowSavedChart(path, area, palette, fonts, dialogs);
    }
};

TEST(ScreenPlayer, PlaysEveryLetterByTheScreenRules) {
    ScreenRig rig;
    ASSERT_TRUE(rig.Show("T,8.25,10.5,20.25,A  B,255\r\n"
                         "S,12,5,6,Ti tle,65280\r\n"
                         "Z,10,7,8,Em,16711680\r\n"
                         "B,1,2,3,4,11\r\nF,1,2,3,4,12\r\nC,1,2,3,4,13\r\nX,1,2,3,4,14\r\n"
                         "H,1,2,3,4,15\r\nL,1,2,3,4,16\r\nM,1,2,3,4,17\r\n"
                         "D,1,2,3,4,18\r\nE,1,2,3,4,19\r\nV,1,2,3,4,20\r\n"
                         "P,5,6,21\r\nK,5,6,22\r\n"));
    EXPECT_EQ(rig.area.calls(), (Strings{"Width 1",
                                         "Clear #1017",
                                         "Text 10.5,20.25 size 8.25 bold #255 [A  B]",
                                         "Text 5,6 size 12 #65280 [Title]",
                                         "Style solid",
                                         "Text 7,8 size 10 bold italic #16711680 [Em]",
                                         "Box 1,2,3,4 #11",
                                         "FilledBox 1,2,3,4 #12",
                                         "FilledBox 1,2,3,4 #13",
                                         "Line 1,2,3,4 #15",
                                         "Line 1,2,3,4 #16",
                                         "Line 1,2,3,4 #17",
                                         "Style dash",
                                         "Line 1,2,3,4 #18",
                                         "Style solid",
                                         "Style dash",
                                         "Line 1,2,3,4 #19",
                                         "Style solid",
                                         "Width 1",
                                         "Style dot",
                                         "Line 1,2,3,4 #20",
                                         "Style solid",
                                         "Point 5,6 #21"}));
    EXPECT_EQ(rig.area.fonts, (Strings{"Font One", "Font Two", "Font One"}));
    // "Z" leaves bold off even though font 1 is bold; "S" put font 1 back.
    EXPECT_FALSE(rig.area.bold());
    EXPECT_FALSE(rig.area.italic());
    EXPECT_EQ(rig.area.fontName(), "Font One");
    EXPECT_TRUE(rig.dialogs.messages().empty());
}

TEST(ScreenPlayer, RoundsShapesButKeepsTextPositionsAndRestoresTheLabelColour) {
    ScreenRig rig;
    ASSERT_TRUE(rig.Show("l,10.5,11.5,-2.5,3.49,7\r\nb,0.5,1.5,2.5,3.5,8\r\np,4.5,5.51,9\r\n"
                         "t,8.25,3.75,4.5,lower  case,77\r\n"));
    EXPECT_EQ(rig.area.calls(),
              (Strings{"Width 1", "Clear #1017", "Line 10,12,-2,3 #7", "Box 0,2,2,4 #8",
                       "Point 4,6 #9", "Text 3.75,4.5 size 8.25 bold #77 [lowercase]"}));
    EXPECT_EQ(rig.area.foreColour(), 1027u);
}

TEST(ScreenPlayer, EmptyTitleTextDrawsNothingButStillCounts) {
    ScreenRig rig;
    EXPECT_TRUE(rig.Show("S,12,5,6,   ,65280\r\n"));
    EXPECT_EQ(rig.area.calls(), (Strings{"Width 1", "Clear #1017"}));
    EXPECT_TRUE(rig.dialogs.messages().empty());
}

TEST(ScreenPlayer, FormatMessageForStreamsThatShowNothingOrBreak) {
    const std::pair<const char*, const char*> cases[] = {
        {"", "empty file"},
        {"Q,1,2,3,4,5\r\nW,1\r\n\r\n", "only unknown letters"},
        {"X,1,2,3,4,5\r\nK,1,2,3\r\n", "only paper letters"},
        {"L,1,2,3,4,5\r\nT,8.25,1,2,Hello, world,255\r\nL,5,6,7,8,9\r\n", "comma in text"},
        {"L,1,2,40000,4,5\r\n", "coordinate beyond 16 bits"},
    };
    for (const auto& [stream, what] : cases) {
        ScreenRig rig;
        EXPECT_FALSE(rig.Show(stream)) << what;
        ASSERT_EQ(rig.dialogs.shown().size(), 1u) << what;
        EXPECT_EQ(rig.dialogs.shown()[0].text, kFormatInvalidText) << what;
        EXPECT_EQ(rig.dialogs.shown()[0].title, "Show Saved Chart") << what;
    }
}

TEST(ScreenPlayer, WhatWasDrawnBeforeABadLineStays) {
    ScreenRig rig;
    EXPECT_FALSE(rig.Show("L,1,2,3,4,5\r\nT,8.25,1,2,a,b,255\r\nL,5,6,7,8,9\r\n"));
    EXPECT_EQ(rig.area.calls(), (Strings{"Width 1", "Clear #1017", "Line 1,2,3,4 #5"}));
}

TEST(ScreenPlayer, OneValidLineAmongUnknownOnesShowsNoMessage) {
    ScreenRig rig;
    EXPECT_TRUE(rig.Show("Q,1\r\nP,1,2,3\r\n?\r\n"));
    EXPECT_TRUE(rig.dialogs.messages().empty());
}

TEST(ScreenPlayer, MissingFileShowsTheFormatMessage) {
    ScreenRig rig;
    EXPECT_FALSE(ShowSavedChart(rig.root.path() / "gone.cht", rig.area, rig.palette, rig.fonts,
                                rig.dialogs));
    EXPECT_EQ(rig.dialogs.messages(), (Strings{kFormatInvalidText}));
}

} // namespace
} // namespace kori::chart
