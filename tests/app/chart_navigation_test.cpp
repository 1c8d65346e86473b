#include "app/chart_navigation.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

using namespace kori;

namespace {

chart::Chart ChartOf(std::vector<store::ChartBar> bars) {
    chart::Chart c;
    c.PlotLeft = 50;
    c.PlotRight = 400;
    c.BarSpacing = 4;
    c.Series.ChartBars = std::move(bars);
    c.Series.LastBar = static_cast<std::int16_t>(c.Series.ChartBars.size() - 1);
    return c;
}

store::ChartBar Bar(const char* date, float o, float h, float l, float cl, std::int32_t v) {
    store::ChartBar b;
    b.SetDate(date);
    b.Open = o;
    b.High = h;
    b.Low = l;
    b.Close = cl;
    b.Volume = v;
    return b;
}

} // namespace

TEST(ChartWalk, NextAndPreviousWrapAtBothEndsOfAList) {
    test::SampleSession s;
    chart::ChartRequest r;
    r.ListMode = 2; // "Banks and Finance": HBK IRB JNS KST LMT
    app::ChartWalk walk(s.session);
    ASSERT_TRUE(walk.Open(r));
    ASSERT_EQ(walk.Count(), 5);
    r.ListPosition = 4;
    EXPECT_EQ(app::StepChart(walk, r, 1)->TrimmedCode(), "LMT");
    EXPECT_EQ(app::StepChart(walk, r, 1)->TrimmedCode(), "HBK");
    EXPECT_EQ(r.ListPosition, 1);
    EXPECT_EQ(app::StepChart(walk, r, -1)->TrimmedCode(), "LMT");
    EXPECT_EQ(r.ListPosition, 5);
    EXPECT_EQ(app::StepChart(walk, r, 0)->TrimmedCode(), "LMT");
    // The list's entries lead to the name file's records.
    EXPECT_EQ(walk.NameRecordNumberAt(1), 12);
}

TEST(ChartWalk, AMissingNameFileIsReportedAndTheFullListIsEmpty) {
    test::SampleSession s;
    std::filesystem::remove(s.session.folders.DataFolder + "Names.dat");
    chart::ChartRequest r;
    app::ChartWalk walk(s.session);
    EXPECT_FALSE(walk.Open(r));
    EXPECT_EQ(walk.Count(), 0);
    EXPECT_FALSE(app::StepChart(walk, r, 1));
}

TEST(CursorReadout, NamesTheBarUnderTheCursor) {
    const auto c = ChartOf({Bar("20240102", 1.0f, 1.1f, 0.95f, 1.0f, 1000),
                            Bar("20240103", 1.0f, 1.3f, 1.1f, 1.2f, 2000),
                            Bar("20240104", 1.25f, 1.255f, 0.8f, 1.25f, 12345)});
    // Bars sit at 50, 54, 58; x = 59 is nearest the third. "#####.00#" has no leading zero.
    EXPECT_EQ(app::CursorReadout(c, 59, false),
              (std::vector<std::string>{"Date  04/01/2024", "Open  1.25", "High  1.255", "Low  .80",
                                        "Close  1.25", "Vol  12345"}));
    EXPECT_EQ(app::CursorReadout(c, 51, true),
              (std::vector<std::string>{"Date  02/01/2024", "Close  1.00", "Vol  1000"}));
    EXPECT_TRUE(app::CursorReadout(c, 30, false).empty());
    EXPECT_TRUE(app::CursorReadout(c, 70, false).empty());
    EXPECT_EQ(app::ReadoutPrice(0), "");
}

TEST(CursorReadout, RiseAndFallFromTheBarWhereTheButtonWentDown) {
    const auto c = ChartOf({Bar("20240102", 1.0f, 1.1f, 0.95f, 1.0f, 1000),
                            Bar("20240103", 1.0f, 1.3f, 1.1f, 1.2f, 2000),
                            Bar("20240104", 1.25f, 1.5f, 0.8f, 1.25f, 3000)});
    // From the first bar (close 1.00) to the third: highest high 1.50, lowest low 0.80.
    EXPECT_EQ(app::RiseFallReadout(c, 50, 58),
              (std::vector<std::string>{"Rise  .50", "Fall  .20", "Total  .25", "Vol  6000"}));
    // Dragging left works from the same first close.
    EXPECT_EQ(app::RiseFallReadout(c, 54, 50),
              (std::vector<std::string>{"Rise  .10", "Fall  .25", "Total  -.20", "Vol  3000"}));
}

TEST(CursorReadout, DayCountsBetweenTwoBarsInBarsAndCalendarDays) {
    // Friday, Monday, Tuesday: two bars apart, four days apart.
    const auto c = ChartOf({Bar("20240105", 1, 1, 1, 1, 0), Bar("20240108", 1, 1, 1, 1, 0),
                            Bar("20240109", 1, 1, 1, 1, 0)});
    EXPECT_EQ(app::DayCountReadout(c, 58, 50),
              (std::vector<std::string>{"Trading days  2", "Calendar days  4"}));
    EXPECT_EQ(app::DayCountReadout(c, 54, 54),
              (std::vector<std::string>{"Trading days  0", "Calendar days  0"}));
    EXPECT_TRUE(app::DayCountReadout(c, 10, 54).empty());
}
