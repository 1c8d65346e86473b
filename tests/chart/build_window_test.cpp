#include "chart/geometry.h"

#include <gtest/gtest.h>

#include <cstdio>

using namespace kori::chart;

namespace {
WindowInputs Daily(std::int16_t count) {
    WindowInputs w;
    w.AreaWidth = 1000; // PlotRight 990 - 42 = 948: 943 columns
    w.RecordCount = count;
    return w;
}
std::string DateOfRecord(std::int16_t rec) {
    // Record n is day n of 2024, as a date text that grows with n.
    char buf[16];
    std::snprintf(buf, sizeof buf, "2024%04d", static_cast<int>(rec));
    return buf;
}
} // namespace

TEST(PlotGeometry, ShareOfTheArea) {
    ChartRequest r;
    PlotGeometry g = ComputePlotGeometry(1000, 700, r);
    EXPECT_EQ(g.PlotLeft, 5);
    EXPECT_EQ(g.PlotRight, 948);
    EXPECT_EQ(g.PlotTop, 91);     // 13%
    EXPECT_EQ(g.PlotBottom, 665); // 95%
    r.SecondPanelShowing = true;
    EXPECT_EQ(ComputePlotGeometry(1000, 700, r).PlotTop, 70);
    r.SplitMode = true;
    g = ComputePlotGeometry(1000, 700, r);
    EXPECT_EQ(g.PlotTop, 10);
    EXPECT_EQ(g.PlotBottom, 322);
    r.SplitHalf = 2;
    g = ComputePlotGeometry(1000, 700, r);
    EXPECT_EQ(g.PlotTop, 357);
    EXPECT_EQ(g.PlotBottom, 665);
}

TEST(PlotGeometry, VolumePanelAndUpsideDown) {
    const PlotGeometry g = ComputePlotGeometry(1000, 700, ChartRequest{});
    Panels p = LayOutPanels(g, false, false);
    EXPECT_EQ(p.PlotBottom, 665);
    EXPECT_EQ(p.VolTop, 665);
    EXPECT_EQ(p.VolBottom, 665);
    p = LayOutPanels(g, true, false);
    EXPECT_EQ(p.VolBottom, 665);
    EXPECT_EQ(p.VolTop, 551); // a fifth of 574
    EXPECT_EQ(p.PlotBottom, 547);
    p = LayOutPanels(g, true, true);
    EXPECT_EQ(p.PlotTop, 547);
    EXPECT_EQ(p.PlotBottom, 91);
    EXPECT_EQ(p.TitleTop, 91) << "titles keep the top from before the swap";
    EXPECT_EQ(p.VolTop, 551);
}

TEST(RecordWindow, BarsThatFitByPeriod) {
    WindowInputs w = Daily(1000);
    // 943 / 2 = 471.5, rounded to even: 472 records back from the last.
    RecordWindow r = ComputeRecordWindow(w, nullptr);
    EXPECT_EQ(r.LastRecord, 1000);
    EXPECT_EQ(r.FirstRecord, 528);
    w.BlankRight = 43; // 900 columns
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 550);

    w = Daily(5000);
    w.ChartPeriod = 'W'; // 4.75 x 943 / 2 = 2239.6 -> 2240
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 2760);
    w.WeeksFactor = 5.3f; // outside 4 to 5.25: 4.75 stands
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 2760);
    w.WeeksFactor = 5; // 5 x 943 / 2 = 2357.5 -> 2358
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 2642);
    w.ChartPeriod = 'M'; // 20 x 943 / 2 = 9430
    w.RecordCount = 20000;
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 10570);
    w.RecordCount = 3000;
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 1) << "raised to the first record";
}

TEST(RecordWindow, FinishDateEndsAtTheFirstRecordOnOrAfterIt) {
    WindowInputs w = Daily(1000);
    w.ByFinishDate = true;
    w.FinishDate = "20240700";
    RecordWindow r = ComputeRecordWindow(w, DateOfRecord);
    EXPECT_EQ(r.LastRecord, 700);
    EXPECT_EQ(r.FirstRecord, 228);
    w.FinishDate = "20240700 ";
    EXPECT_EQ(ComputeRecordWindow(w, DateOfRecord).LastRecord, 701) << "on or after";
    w.FinishDate = "20250101";
    EXPECT_EQ(ComputeRecordWindow(w, DateOfRecord).LastRecord, 1000) << "past the end";
    w.FinishDate = "20230101";
    r = ComputeRecordWindow(w, DateOfRecord);
    EXPECT_EQ(r.LastRecord, 1);
    EXPECT_EQ(r.FirstRecord, 1);
}

TEST(RecordWindow, ScrollModeWidensTheArea) {
    WindowInputs w = Daily(5000);
    w.ScrollMode = true;
    // First pass 2100 / 2 = 1050 bars: area 1050 x 2 + 120 = 2220; PlotRight 2197 - 42 = 2155,
    // 2150 columns: 1075 bars.
    RecordWindow r = ComputeRecordWindow(w, nullptr);
    EXPECT_EQ(r.AreaWidth, 2220);
    EXPECT_EQ(r.FirstRecord, 3925);
    w.ZoomFactor = 1.5; // 3330 wide: PlotRight 3296 - 42 = 3254, 3249 columns: 1624.5 -> 1624
    r = ComputeRecordWindow(w, nullptr);
    EXPECT_EQ(r.AreaWidth, 3330);
    EXPECT_EQ(r.FirstRecord, 3376);
}

TEST(RecordWindow, SidePanelTakesItsShare) {
    WindowInputs w = Daily(1000);
    w.SwingPanel = SidePanel::XPointAuto; // 65% of 943 = 612 columns: 306 bars
    RecordWindow r = ComputeRecordWindow(w, nullptr);
    EXPECT_EQ(r.FirstRecord, 694);
    EXPECT_EQ(r.SidePanelLeft, 647);
    w.SwingPanel = SidePanel::Other; // 471 columns: 235.5 -> 236 bars
    r = ComputeRecordWindow(w, nullptr);
    EXPECT_EQ(r.FirstRecord, 764);
    EXPECT_EQ(r.SidePanelLeft, 506);
}

TEST(RecordWindow, PointAndFigureAndDegenerateAreas) {
    WindowInputs w = Daily(30000);
    w.ChartStyle = 'P';
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 1);
    w = Daily(30000);
    w.AreaWidth = 10; // no columns at all: the last record alone
    const RecordWindow r = ComputeRecordWindow(w, nullptr);
    EXPECT_EQ(r.FirstRecord, 30000);
    EXPECT_EQ(r.LastRecord, 30000);
    w.AreaWidth = 1000;
    w.BarSpacing = 0; // stands for 2
    EXPECT_EQ(ComputeRecordWindow(w, nullptr).FirstRecord, 30000 - 472);
}
