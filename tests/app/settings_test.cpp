#include "app/settings.h"
#include "app/window_position.h"
#include "platform/ini_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::app;
using kori::platform::IniFile;
using kori::test::TempRoot;

namespace {
struct IniCase : ::testing::Test {
    TempRoot root;
    IniFile ini{root.path() / "Kori.ini"};
    void Set(const char* section, const char* key, const char* value) {
        ASSERT_TRUE(ini.Write(section, key, value));
    }
};
} // namespace

TEST_F(IniCase, ZoomOutsideFiftyToTwoHundredReadsAsOneHundred) {
    EXPECT_EQ(ReadZoom(ini), 100); // unset
    for (auto [text, expected] : {std::pair{"49", 100},
                                  {"50", 50},
                                  {"200", 200},
                                  {"201", 100},
                                  {"150.5", 150},
                                  {"junk", 100}}) {
        Set("ChartForms", "Zoom", text);
        EXPECT_EQ(ReadZoom(ini), expected) << text;
    }
}

TEST_F(IniCase, DownloadNumbersKeepTheirLimits) {
    DownloadSettings d = ReadDownloadSettings(ini);
    EXPECT_EQ(d.DataService, 0);
    EXPECT_EQ(d.RefreshFreq, 8);
    EXPECT_EQ(d.VolumeDivisor, 1);
    for (auto [text, expected] : {std::pair{"5", 8}, {"10", 10}, {"200", 200}, {"201", 8}}) {
        Set("Download", "RefreshFreq", text);
        EXPECT_EQ(ReadDownloadSettings(ini).RefreshFreq, expected) << text;
    }
    for (auto [text, expected] : {std::pair{"1000", 1000},
                                  {"10000", 10000},
                                  {"10", 10},
                                  {"5", 1},
                                  {"100000", 1},
                                  {"0", 1}}) {
        Set("Download", "Volume divisor", text);
        EXPECT_EQ(ReadDownloadSettings(ini).VolumeDivisor, expected) << text;
    }
    Set("Download", "DataService", "3");
    EXPECT_EQ(ReadDownloadSettings(ini).DataService, 3);
}

TEST_F(IniCase, DownloadBooleansEachHaveTheirOwnFallback) {
    DownloadSettings d = ReadDownloadSettings(ini);
    EXPECT_FALSE(d.DownloadNew);
    EXPECT_TRUE(d.UpdateAll);
    EXPECT_FALSE(d.NoWarrants);
    EXPECT_FALSE(d.InternetAccess);

    Set("Download", "DownloadNew", "True");
    Set("Download", "UpdateAll", "False");
    Set("Download", "NoWarrants", "true");
    Set("Download", "Internet Access", "-1");
    d = ReadDownloadSettings(ini);
    EXPECT_TRUE(d.DownloadNew);
    EXPECT_FALSE(d.UpdateAll);
    EXPECT_TRUE(d.NoWarrants);
    EXPECT_TRUE(d.InternetAccess);

    Set("Download", "DownloadNew", "yes");
    Set("Download", "UpdateAll", "no");
    Set("Download", "NoWarrants", "1");
    Set("Download", "Internet Access", "1"); // only true itself counts
    d = ReadDownloadSettings(ini);
    EXPECT_FALSE(d.DownloadNew);
    EXPECT_TRUE(d.UpdateAll);
    EXPECT_FALSE(d.NoWarrants);
    EXPECT_FALSE(d.InternetAccess);
}

TEST_F(IniCase, DownloadProgramFoldersOnlyForServicesOneAndThree) {
    Set("Download", "In", "/srv/in/");
    Set("Download", "Out", "/srv/out/");
    Set("Download", "DataService", "2");
    EXPECT_EQ(ReadDownloadSettings(ini).In, "");
    Set("Download", "DataService", "3");
    const auto d = ReadDownloadSettings(ini);
    EXPECT_EQ(d.In, "/srv/in/");
    EXPECT_EQ(d.Out, "/srv/out/");
    EXPECT_EQ(d.System, ""); // unset reads "unknown", held as no folder
}

TEST_F(IniCase, ScaleFontSizeDefaultSlipsOntoTheChartFontSize) {
    FontSettings f = ReadFontSettings(ini);
    EXPECT_EQ(f.CFont, "Arial");
    EXPECT_EQ(f.CFontSize, "8");
    EXPECT_EQ(f.SFont, "Arial");
    EXPECT_EQ(f.SFontSize, "unknown"); // never defaulted to "6"

    Set("Chart Fonts", "CFont", "Liberation Sans");
    Set("Chart Fonts", "CFontSize", "10");
    f = ReadFontSettings(ini);
    EXPECT_EQ(f.CFontSize, "10"); // a set chart size stays as read
    EXPECT_EQ(f.SFontSize, "unknown");
    const auto fonts = f.ToChartFonts();
    EXPECT_EQ(fonts.Font1, "Liberation Sans");
    EXPECT_EQ(fonts.Size1, 10);
    EXPECT_EQ(fonts.Size2, kori::platform::ChartFonts{}.Size2);

    Set("Chart Fonts", "SFontSize", "7");
    EXPECT_EQ(ReadFontSettings(ini).SFontSize, "7");
    EXPECT_EQ(ReadFontSettings(ini).ToChartFonts().Size2, 7);
}

TEST_F(IniCase, AdjustmentPageAndListSettingsReadBackWhatWasWritten) {
    EXPECT_FALSE(ReadAdjustmentSettings(ini).NoShortNames);
    Set("Adjustments", "NoShortNames", "yes"); // only the words count
    EXPECT_FALSE(ReadAdjustmentSettings(ini).NoShortNames);
    WriteAdjustmentSettings(ini, {3, true});
    EXPECT_EQ(ReadAdjustmentSettings(ini).Divs, 3);
    EXPECT_TRUE(ReadAdjustmentSettings(ini).NoShortNames);

    WritePageSettings(ini, {1440, 720, 0.5f, 1.25f, 2});
    const auto p = ReadPageSettings(ini);
    EXPECT_EQ(p.PPTop, 1440);
    EXPECT_EQ(p.PPLft, 720);
    EXPECT_EQ(p.PPBot, 0.5f);
    EXPECT_EQ(p.PPRht, 1.25f);
    EXPECT_EQ(p.Orient, 2);

    WriteSubListSettings(ini, {4, 3});
    EXPECT_EQ(ReadSubListSettings(ini).Last, 4);
    EXPECT_EQ(ReadSubListSettings(ini).Columns, 3);
    Set("Adjustments", "Divs", "40000"); // beyond 16 bits
    EXPECT_EQ(ReadAdjustmentSettings(ini).Divs, 0);
}

TEST(WindowPosition, TextOfFourNumbers) {
    const auto p = ParseWindowPosition("120, 45,9045,6645");
    ASSERT_TRUE(p.has_value());
    EXPECT_EQ(p->left, 120);
    EXPECT_EQ(p->top, 45);
    EXPECT_EQ(p->width, 9045);
    EXPECT_EQ(p->height, 6645);
    EXPECT_EQ(FormatWindowPosition(*p), "120,45,9045,6645");
    EXPECT_FALSE(ParseWindowPosition("1,2,3").has_value());
    EXPECT_FALSE(ParseWindowPosition("").has_value());

    TempRoot root;
    kori::platform::SettingsStore store(root.path() / "settings.ini");
    EXPECT_FALSE(LoadWindowPosition(store, "Main").has_value());
    SaveWindowPosition(store, "Main", {-10, 0, 800, 600});
    EXPECT_EQ(store.Get("Main", ""), "-10,0,800,600");
    EXPECT_EQ(LoadWindowPosition(store, "Main")->left, -10);
}
