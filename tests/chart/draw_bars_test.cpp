#include "chart/draw_bars.h"
#include "chart_test_rig.h"

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {
// Open 15, high 20, low 12.5, close 17: y 900, 850, 925, 880.
void AddUpBar(ChartRig& r, const char* date = "20240305") {
    r.Add(date, 15, 20, 12.5f, 17);
}
} // namespace

TEST(DrawBars, TicksByBarSpacing) {
    {
        ChartRig r;
        r.request.BarSpacing = 3;
        AddUpBar(r);
        ASSERT_TRUE(r.Build().ok());
        // Screen ticks 3 long; paper ticks 1.5 long.
        EXPECT_TRUE(HasRun(r.Lines(), {"H, 5, 850, 5, 925, 18", "H, 3.5, 900, 5, 900, 18",
                                       "H, 5, 880, 6.5, 880, 18"}));
        EXPECT_TRUE(HasRun(
            r.Calls(), {"Line 5,850,5,925 #18", "Line 2,900,5,900 #18", "Line 5,880,8,880 #18"}));
        EXPECT_TRUE(Starting(r.Lines(), "P,").empty());
    }
    {
        ChartRig r;
        r.request.BarSpacing = 2;
        AddUpBar(r);
        ASSERT_TRUE(r.Build().ok());
        EXPECT_TRUE(HasRun(r.Lines(), {"H, 5, 850, 5, 925, 18", "P, 4, 900, 18", "P, 6, 880, 18"}));
        EXPECT_TRUE(HasRun(r.Calls(), {"Point 4,900 #18", "Point 6,880 #18"}));
    }
    {
        ChartRig r;
        r.request.BarSpacing = 1;
        AddUpBar(r);
        ASSERT_TRUE(r.Build().ok());
        EXPECT_TRUE(HasRun(r.Lines(), {"H, 5, 850, 5, 925, 18",
                                       "T, 8.25, 380, 2,Last date processed 05-03-24, 27"}))
            << "no ticks: the trailing labels follow the bar";
    }
}

TEST(DrawBars, CandlesAreSolidOnScreenAndUpCandlesHollowOnPaper) {
    ChartRig r;
    r.request.ChartStyle = 'C';
    AddUpBar(r, "20240304");
    r.Add("20240305", 17, 20, 12.5f, 15); // down: close below open
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(HasRun(r.Lines(), {"H, 5, 850, 5, 925, 18", "B, 3.5, 900, 6.5, 880, 18",
                                   "H, 15, 850, 15, 925, 18", "C, 13.5, 880, 16.5, 900, 28"}));
    EXPECT_TRUE(HasRun(r.Calls(), {"Line 5,850,5,925 #18", "FilledBox 4,900,6,880 #18",
                                   "Line 15,850,15,925 #18", "FilledBox 14,880,16,900 #28"}));
}

TEST(DrawBars, LineChartsJoinTheClosesAndSkipBarsWithNoHigh) {
    ChartRig r;
    r.request.ChartStyle = 'B';
    r.name.RecordType = 1; // close only: always a line
    r.Add("20240304", 0, 20, 0, 17);
    r.Add("20240305", 0, 0, 0, 16); // no high: no column, its close y copied from the bar before
    r.Add("20240306", 0, 20, 0, 15);
    ASSERT_TRUE(r.Build().ok());
    const auto h = Starting(r.Lines(), "H,");
    ASSERT_EQ(h.size(), 1u);
    EXPECT_EQ(h[0], "H, 5, 880, 25, 900, 18");
    ASSERT_EQ(r.chart.BarCloseY.size(), 12u); // LastBar + 10
    EXPECT_EQ(r.chart.BarCloseY[0], 880);
    EXPECT_EQ(r.chart.BarCloseY[1], 880);
    EXPECT_EQ(r.chart.BarCloseY[2], 900);
    EXPECT_EQ(r.chart.Style, 'L');
}

TEST(ClassifyBar, ReversalKindsInOrder) {
    const BarYs prev{100, 110, 120, 115}; // high, open, low, close as y
    // Outside bar closing above the previous high.
    EXPECT_EQ(ClassifyBar({95, 100, 125, 98}, &prev, nullptr).Entry, pal::KeyReversal);
    // New high, close under the previous close but above the previous low.
    EXPECT_EQ(ClassifyBar({95, 100, 118, 117}, &prev, nullptr).Entry, pal::Reversal);
    // Inside bar; mid-points 110 and 110; the close crosses from above to below.
    EXPECT_EQ(ClassifyBar({102, 108, 118, 105}, &prev, nullptr).Entry, pal::HookReversal);
    EXPECT_EQ(ClassifyBar({102, 108, 118, 110}, &prev, nullptr).Entry, pal::Bars)
        << "a close on the mid-point never matches";
    // Whole bar above the previous high with the open above the close.
    EXPECT_EQ(ClassifyBar({85, 90, 98, 95}, &prev, nullptr).Entry, pal::OpenCloseReversal);
    EXPECT_EQ(ClassifyBar({85, 90, 98, 95}, nullptr, nullptr).Entry, pal::Bars) << "first bar";
    // Previous bar a peak, close under both earlier lows: the previous bar takes the colour.
    const BarYs prev2{105, 110, 125, 115};
    const BarYs peak{100, 110, 120, 110};
    const BarClass c = ClassifyBar({103, 105, 130, 126}, &peak, &prev2);
    EXPECT_TRUE(c.PivotOnPrevious);
    EXPECT_EQ(c.Entry, pal::Bars);
}

TEST(DrawBars, PivotRedrawsThePreviousBarOnTheScreenOnly) {
    ChartRig r;
    r.request.ShowReversals = true;
    r.Add("20240304", ChartRig::P(110), ChartRig::P(105), ChartRig::P(125), ChartRig::P(115));
    r.Add("20240305", ChartRig::P(110), ChartRig::P(100), ChartRig::P(120), ChartRig::P(110));
    r.Add("20240306", ChartRig::P(105), ChartRig::P(103), ChartRig::P(130), ChartRig::P(126));
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(HasRun(r.Calls(), {"Line 15,120,15,100 #33", "Line 25,103,25,130 #18"}));
    for (const auto& l : r.Lines())
        EXPECT_EQ(l.find(", 33"), std::string::npos) << l;
}

TEST(DrawBars, StopLossIsColouredAndReadOutOnTheScreenOnly) {
    ChartRig r;
    r.defaults.StopLossOn = true;
    r.defaults.StopPercentOn = true;
    r.defaults.StopPercent = 10;
    AddUpBar(r, "20240304");
    r.Add("20240305", 14, 22, 12, 18); // outside bar: stop 0.9 x 12 = 10.8 from x 15
    r.Add("20240306", 15, 21, 13, 19);
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(HasRun(r.Lines(), {"H, 15, 830, 15, 930, 28"}));
    EXPECT_TRUE(HasRun(r.Lines(), {"H, 25, 840, 25, 920, 18"}));
    EXPECT_TRUE(HasRun(r.Calls(), {"Line 15,942,354,942 #10",
                                   "Text 234,30 size 8 #10 [Current Stop Loss : 10.80]"}));
    for (const auto& l : r.Lines())
        EXPECT_EQ(l.find("Stop"), std::string::npos) << l;

    r.Add("20240307", 11, 12, 10, 10); // closes under the stop
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(HasRun(r.Lines(), {"H, 35, 930, 35, 950, 11"}));
    EXPECT_TRUE(HasRun(r.Calls(), {"Text 258,30 size 8 #13 [PREVIOUS STOP BROKEN]"}));
}

TEST(DrawBars, NotesMarkTheBarAndReachPaperOnlyWithoutBoldPrint) {
    ChartRig r;
    AddUpBar(r, "20240304");
    r.Add("20240305", 15, 20, 12.5f, 17, 0, "1 for 2 issue");
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(
        HasRun(r.Lines(), {"V, 15, 130, 15, 950, 24", "T, 8.25, 15, 132,1 for 2 issue , 24"}));
    EXPECT_TRUE(HasRun(r.Calls(), {"Style dot", "Line 15,130,15,950 #24", "Style solid",
                                   "Text 15,132 size 8 #24 [1 for 2 issue]"}));
    r.printBold = true;
    ASSERT_TRUE(r.Build().ok());
    for (const auto& l : r.Lines())
        EXPECT_EQ(l.find("issue"), std::string::npos) << l;
}

TEST(DrawBars, TenBarTraceSimpleAndExponential) {
    ChartRig r;
    r.request.AvOne = true;
    // Closes 11..20 (y 940..850), then 30 (y 750).
    for (int i = 0; i < 10; ++i) {
        const float c = static_cast<float>(11 + i);
        r.Add("202403" + std::to_string(10 + i), c, c + 1, c - 1, c);
    }
    r.Add("20240320", 30, 31, 29, 30);
    ASSERT_TRUE(r.Build().ok());
    // Mean of 940..850 is 895 at the tenth bar (x 95); then (930..850 + 750) / 10 = 876.
    EXPECT_EQ(Starting(r.Lines(), "P,"),
              (std::vector<std::string>{"P, 95, 895, 19", "P, 105, 876, 19"}));
    r.defaults.MAExponential = true;
    ASSERT_TRUE(r.Build().ok());
    // 750 x 2 / 11 + 895 x 9 / 11 = 868.6.
    EXPECT_EQ(Starting(r.Lines(), "P,"),
              (std::vector<std::string>{"P, 95, 895, 19", "P, 105, 869, 19"}));
    r.request.AutoOsc = true;
    r.request.AutoOscCode = "MACD";
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(Starting(r.Lines(), "P,").empty()) << "no trace beside a classic MACD chart";
}

TEST(DrawBars, FlatVolumeDrawsBarsAThirdHigh) {
    ChartRig r;
    r.request.ShowVolume = true;
    r.Add("20240304", 15, 20, 12.5f, 17, 1000);
    r.Add("20240305", 15, 20, 12.5f, 17, 1000);
    ASSERT_TRUE(r.Build().ok());
    // Volume panel 786..950; lowest 1, highest and mean 3000; height 950 - 786 x 1.03 = 140;
    // 999 / (2999 / 140) = 46.6 -> y 903.
    EXPECT_EQ(r.chart.VolTop, 786);
    EXPECT_EQ(r.chart.VolBottom, 950);
    EXPECT_EQ(r.chart.PlotBottom, 782);
    const auto lines = r.Lines();
    EXPECT_TRUE(HasRun(lines, {"B, 4, 786, 354, 950, 16"}));
    EXPECT_TRUE(HasRun(lines, {"H, 5, 950, 5, 903, 22"}));
    EXPECT_TRUE(HasRun(lines, {"H, 15, 950, 15, 903, 22"}));
    // Divisions of 41: the bottom one labelled with the lowest volume, then 1 + 41 x 21.42.
    EXPECT_TRUE(HasRun(lines, {"S, 8, 379.2, 946,1, 27", "V, 354, 909, 356, 909, 24",
                               "S, 8, 369.6, 905,879, 27"}));
    EXPECT_TRUE(HasRun(
        lines, {"S, 8, 395.6, 827,V, 27", "S, 8, 395.6, 868,O, 27", "S, 8, 395.6, 909,L, 27"}));
}

TEST(VolumeMap, LimitsLogarithmAndDegenerateVolumes) {
    VolumeScaleInputs in;
    in.VolTop = 500;
    in.VolBottom = 600;
    in.PlotTop = 100;
    in.MinVolume = 100;
    in.MaxVolume = 10000;
    in.AvgVolume = 1000;
    VolumeMap m;
    ASSERT_TRUE(m.Prepare(in)); // height 600 - 515 = 85; 900 / 85 a unit
    EXPECT_FALSE(m.VolumeToY(0).has_value());
    EXPECT_EQ(m.VolumeToY(1000), 515);
    EXPECT_EQ(m.VolumeToY(3000), 326) << "full height reaches into the prices";
    EXPECT_EQ(m.VolumeToY(100000), 100) << "past the top of the area: PlotTop";
    in.LimitHeight = true;
    ASSERT_TRUE(m.Prepare(in));
    EXPECT_EQ(m.VolumeToY(3000), 500);
    in.LimitHeight = false;
    in.Logarithmic = true; // -100 / ln 100 a unit of ln
    ASSERT_TRUE(m.Prepare(in));
    EXPECT_EQ(m.VolumeToY(500), 565);
    EXPECT_EQ(m.VolumeToY(2000), 534);
    in.MaxVolume = in.MinVolume;
    EXPECT_FALSE(m.Prepare(in)) << "no spread of volumes";
    EXPECT_FALSE(m.VolumeToY(500).has_value());
    in.Logarithmic = false;
    in.VolTop = 600; // no panel height
    EXPECT_FALSE(m.Prepare(in));
}
