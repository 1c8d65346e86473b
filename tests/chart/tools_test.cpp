#include "chart/chart_tools.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::chart;
using kori::store::ChartBar;

namespace {
// Ten daily bars from 2 Nov 2026 (weekdays), plot 100..300 wide, spacing 10, y = 500 - 10 * price.
struct Frame {
    std::vector<ChartBar> bars;
    ToolFrame f;
    Frame() {
        const char* dates[] = {"20261102", "20261103", "20261104", "20261105", "20261106",
                               "20261109", "20261110", "20261111", "20261112", "20261113"};
        for (const char* d : dates) {
            ChartBar b;
            b.SetDate(d);
            b.Close = 10;
            bars.push_back(b);
        }
        f.PlotLeft = 100;
        f.PlotRight = 300;
        f.PlotTop = 50;
        f.PlotBottom = 450;
        f.BarSpacing = 10;
        f.ChartPeriod = 'A';
        f.Bars = &bars;
        f.LastBar = 9;
        f.PriceToY = [](double p) { return 500 - 10 * p; };
        f.YToPrice = [](double y) { return (500 - y) / 10; };
    }
};
} // namespace

TEST(ChartTools, ATrendlineKeepsDatesAndPricesAndHoldsAFarEndJustPastThePlot) {
    Frame t;
    EXPECT_FALSE(MakeTrendRecord(t.f, 120, 300, 120, 300)) << "two distinct ends are needed";
    auto r = MakeTrendRecord(t.f, 120, 400, 150, 300);
    ASSERT_TRUE(r);
    EXPECT_EQ(r->DateA, "20261104");
    EXPECT_EQ(r->DateB, "20261109");
    EXPECT_FLOAT_EQ(r->PriceA, 10);
    EXPECT_FLOAT_EQ(r->PriceB, 20);
    // Dragged to x 400: held at 310, beyond the last bar, so stored as an x position.
    r = MakeTrendRecord(t.f, 100, 400, 400, 100);
    ASSERT_TRUE(r);
    EXPECT_EQ(r->DateB, "X310");
    EXPECT_FLOAT_EQ(r->PriceB, (500 - (400 - 300 * 210.0 / 300)) / 10);
}

TEST(ChartTools, ReplayShowsOnlyThisPeriodAndLinesStillInView) {
    Frame t;
    const std::vector<TrendRecord> recs = {
        {0, 'A', "20261103", 10, "20261110", 20}, // drawn
        {0, 'W', "20261103", 10, "20261110", 20}, // weekly: not on a daily chart
        {0, 'A', "20261030", 10, "20261110", 20}, // left end scrolled off: not drawn at all
        {0, 'A', "20261103", 10, "X309", 20},     // within 10 of the right edge: drawn
        {0, 'A', "20261103", 10, "X311", 20},     // beyond: skipped
        {0, 'A', "20261103", 0, "20261110", 20},  // no price: skipped
        {0, 'A', "20261103", 10, "20261110", 50}, // far above the plot: skipped
    };
    const auto ends = ReplayTrendlines(t.f, recs);
    ASSERT_EQ(ends.size(), 2u);
    EXPECT_EQ(ends[0].RecordNumber, 1);
    EXPECT_DOUBLE_EQ(ends[0].xA, 110);
    EXPECT_DOUBLE_EQ(ends[0].xB, 160);
    EXPECT_DOUBLE_EQ(ends[0].yB, 300);
    EXPECT_EQ(ends[1].RecordNumber, 4);
    EXPECT_EQ(NearestTrendline(ends, 300, 300), 1);
}

TEST(ChartTools, FibonacciLevelsAndAZeroRiseDrawsThreeLinesOnOnePrice) {
    auto levels = FibonacciLevels(10, 20);
    ASSERT_EQ(levels.size(), 3u);
    EXPECT_DOUBLE_EQ(levels[0].Price, 16.2);
    EXPECT_DOUBLE_EQ(levels[1].Price, 15);
    EXPECT_DOUBLE_EQ(levels[2].Price, 13.8);
    EXPECT_EQ(std::string(levels[1].StatusText), "50%    ");
    EXPECT_TRUE(FibonacciLevels(20, 10).empty());
    levels = FibonacciLevels(12, 12);
    ASSERT_EQ(levels.size(), 3u);
    EXPECT_EQ(levels[0].Price, levels[2].Price);
    Frame t;
    const auto lines = FibonacciLines(t.f, 200, levels);
    EXPECT_DOUBLE_EQ(lines[0].x2, 300) << "capped at the plot's right edge";
    EXPECT_EQ(lines[0].Letter, 'D');
}

TEST(ChartTools, GannFanEndsAtTheRightEdgeOrTheTop) {
    Frame t;
    EXPECT_TRUE(GannFan(t.f, 50, 200, true).empty());
    const auto fan = GannFan(t.f, 200, 400, true);
    ASSERT_EQ(fan.size(), 6u);
    // Slope 8/10: the right edge is 100 units away, where y = 400 - 80 = 320 is inside the plot.
    EXPECT_DOUBLE_EQ(fan[0].x2, 300);
    EXPECT_DOUBLE_EQ(fan[0].y2, 320);
    EXPECT_EQ(fan[0].PaletteEntry, 16);
    EXPECT_EQ(fan[5].PaletteEntry, 45);
    // From y 100 the same slope meets the top (y 50) after 62.5 units, before the right edge.
    const auto steep = GannFan(t.f, 200, 100, true);
    EXPECT_DOUBLE_EQ(steep[0].y2, 50);
    EXPECT_DOUBLE_EQ(steep[0].x2, 200 + 50 / 0.8);
}

TEST(ChartTools, FibonacciTimeLinesByTradingBarsAndCalendarDays) {
    Frame t;
    EXPECT_EQ(FibTimeLines(t.f, 0, false), (std::vector<double>{110, 120, 130, 150, 180, 230}));
    // Calendar days from Mon 2 Nov: +1 Tue, +2 Wed, +3 Thu, +5 Sat -> Mon 9th, +8 Tue 10th.
    EXPECT_EQ(FibTimeLines(t.f, 0, true), (std::vector<double>{110, 120, 130, 150, 160}));
    EXPECT_EQ(AddCalendarPeriods("20260131", 'M', 1), "20260228");
    EXPECT_EQ(AddCalendarPeriods("20261230", 'W', 1), "20270106");
}
