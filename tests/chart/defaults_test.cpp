#include "chart/chart_defaults.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::chart;
using kori::platform::IniFile;

namespace {
struct Ini {
    kori::test::TempRoot root;
    IniFile ini{root.path() / "Kori.ini"};
    void Set(std::string_view key, std::string_view value, std::string_view section = "Charts") {
        ini.Write(section, key, value);
    }
};
} // namespace

TEST(ChartDefaults, NewInstallationReadsTheDefaults) {
    Ini f;
    const ChartDefaults d = LoadChartDefaults(f.ini);
    EXPECT_TRUE(d.AutoScale) << "ScMethod unknown scales by itself";
    EXPECT_TRUE(d.ClassicMACD) << "NoClassicMACD unknown reads False";
    EXPECT_FALSE(d.LogBars);
    EXPECT_FALSE(d.StopLossOn);
    EXPECT_FALSE(d.StopPercentOn);
    EXPECT_EQ(d.StopPercent, 0);
    EXPECT_EQ(d.Zoom, 100);
    EXPECT_EQ(d.VolumeMultiple, 1);
    EXPECT_FLOAT_EQ(d.WeeksFactor, 4.75f);
    EXPECT_EQ(d.PrintLineWidth, 2);
    EXPECT_FLOAT_EQ(d.PrintScale, 1.5f);
    EXPECT_EQ(d.BlankRight, 0);
    EXPECT_EQ(d.MMAPeriods, kDefaultMMAPeriods);
    EXPECT_EQ(d.CompFile, "");
}

TEST(ChartDefaults, BoundsOfTheWindowKeys) {
    Ini f;
    auto zoom = [&](const char* v) {
        f.Set("Zoom", v, "ChartForms");
        return LoadChartDefaults(f.ini).Zoom;
    };
    EXPECT_EQ(zoom("49"), 100);
    EXPECT_EQ(zoom("50"), 50);
    EXPECT_EQ(zoom("200"), 200);
    EXPECT_EQ(zoom("201"), 100);

    auto week = [&](const char* v) {
        f.Set("WeekFactor", v);
        return LoadChartDefaults(f.ini).WeeksFactor;
    };
    EXPECT_FLOAT_EQ(week("5.2"), 5.2f);
    EXPECT_FLOAT_EQ(week("5.21"), 4.75f);
    EXPECT_FLOAT_EQ(week("4"), 4.0f);
    EXPECT_FLOAT_EQ(week("3.99"), 4.75f);

    auto vheight = [&](const char* v) {
        f.Set("VHeight", v);
        return LoadChartDefaults(f.ini).VolumeMultiple;
    };
    EXPECT_EQ(vheight("0"), 1);
    EXPECT_EQ(vheight("2"), 2);
    EXPECT_EQ(vheight("5"), 5) << "the upper bound is only tested inside the lower one";

    auto width = [&](const char* v) {
        f.Set("Line Width", v);
        return LoadChartDefaults(f.ini).PrintLineWidth;
    };
    EXPECT_EQ(width("0"), 2);
    EXPECT_EQ(width("10"), 10);
    EXPECT_EQ(width("11"), 2);
}

TEST(ChartDefaults, BooleansAndInvertedKeys) {
    Ini f;
    f.Set("ScMethod", "False");
    f.Set("NoClassicMACD", "True");
    f.Set("BCCalTp", "True");
    f.Set("CutVols", "true");
    f.Set("SL Percent", "7.5");
    f.Set("MMASet", "1,2,3");
    const ChartDefaults d = LoadChartDefaults(f.ini);
    EXPECT_FALSE(d.AutoScale);
    EXPECT_FALSE(d.ClassicMACD);
    EXPECT_TRUE(d.LogBars);
    EXPECT_TRUE(d.LimitVolumeHeight);
    EXPECT_TRUE(d.StopPercentOn);
    EXPECT_FLOAT_EQ(d.StopPercent, 7.5f);
    const std::array<std::int16_t, 12> mma = {1, 2, 3, 0, 0, 0, 0, 0, 0, 0, 0, 0};
    EXPECT_EQ(d.MMAPeriods, mma);
}

TEST(ChartDefaults, SaveThenLoadGivesTheSameDefaults) {
    Ini f;
    ChartDefaults d;
    d.MAPeriod1Daily = 15;
    d.MAPeriod2Long = 40;
    d.MA2On = true;
    d.MAExponential = true;
    d.AutoScale = false;
    d.LogLine = true;
    d.LogVolume = true;
    d.ClassicMACD = false;
    d.MMAPeriods[11] = 99;
    d.CompFile = "/data/XAO.WDT";
    d.PrintScale = 1.25f;
    d.PrintLineWidth = 4;
    d.BlankRight = 30;
    d.VerticalGridSpace = 10;
    d.MidGrid = 1;
    d.ShowPriceGrid = true;
    d.VolumeMultiple = 3;
    d.WeeksFactor = 4.5f;
    d.StopLossOn = true;
    d.StopPercentOn = true;
    d.StopPercent = 12.5f;
    d.ChartW = 9000;
    d.ScreenH = 768;
    d.Zoom = 150;
    d.Divs = 4;
    SaveChartDefaults(f.ini, d);
    EXPECT_EQ(f.ini.Read("Charts", "NoClassicMACD"), "True");
    EXPECT_EQ(f.ini.Read("Charts", "ScMethod"), "False");
    EXPECT_EQ(f.ini.Read("Charts", "WeekFactor"), "4.5");

    const ChartDefaults r = LoadChartDefaults(IniFile(f.ini.path()));
    EXPECT_EQ(r.MAPeriod1Daily, 15);
    EXPECT_EQ(r.MAPeriod2Long, 40);
    EXPECT_TRUE(r.MA2On);
    EXPECT_FALSE(r.MA1On);
    EXPECT_TRUE(r.MAExponential);
    EXPECT_FALSE(r.AutoScale);
    EXPECT_TRUE(r.LogLine);
    EXPECT_TRUE(r.LogVolume);
    EXPECT_FALSE(r.ClassicMACD);
    EXPECT_EQ(r.MMAPeriods, d.MMAPeriods);
    EXPECT_EQ(r.CompFile, d.CompFile);
    EXPECT_FLOAT_EQ(r.PrintScale, 1.25f);
    EXPECT_EQ(r.PrintLineWidth, 4);
    EXPECT_EQ(r.BlankRight, 30);
    EXPECT_EQ(r.VerticalGridSpace, 10);
    EXPECT_EQ(r.MidGrid, 1);
    EXPECT_TRUE(r.ShowPriceGrid);
    EXPECT_EQ(r.VolumeMultiple, 3);
    EXPECT_FLOAT_EQ(r.WeeksFactor, 4.5f);
    EXPECT_TRUE(r.StopLossOn);
    EXPECT_FLOAT_EQ(r.StopPercent, 12.5f);
    EXPECT_EQ(r.ChartW, 9000);
    EXPECT_EQ(r.ScreenH, 768);
    EXPECT_EQ(r.Zoom, 150);
    EXPECT_EQ(r.Divs, 4);
}

TEST(ChartRequestSettings, StyleAndSpacingRules) {
    Ini f;
    ChartRequest r;
    r.BarSpacing = 7;
    LoadChartRequestSettings(f.ini, r);
    EXPECT_EQ(r.ChartStyle, 'B');
    EXPECT_EQ(r.ChartPeriod, 'A');
    EXPECT_EQ(r.BarSpacing, 2);
    EXPECT_EQ(r.ChartBands, 0);

    auto spacing = [&](const char* v) {
        f.Set("Spacing", v);
        LoadChartRequestSettings(f.ini, r);
        return r.BarSpacing;
    };
    EXPECT_EQ(spacing("0"), 2);
    EXPECT_EQ(spacing("-1"), 2);
    EXPECT_EQ(spacing("11"), 2);
    EXPECT_EQ(spacing("10"), 10);

    f.Set("Type", "X");
    f.Set("Period", "M");
    LoadChartRequestSettings(f.ini, r);
    EXPECT_EQ(r.ChartStyle, 'L') << "any other style is a line";
    EXPECT_EQ(r.ChartPeriod, 'M');

    r.ChartStyle = 'C';
    r.AvTwo = true;
    SaveChartRequestSettings(f.ini, r);
    ChartRequest back;
    LoadChartRequestSettings(f.ini, back);
    EXPECT_EQ(back.ChartStyle, 'C');
    EXPECT_TRUE(back.AvTwo);
    EXPECT_EQ(f.ini.Read("Charts", "List"), "1");
}
