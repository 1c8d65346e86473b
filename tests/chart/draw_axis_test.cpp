#include "chart/draw_labels.h"
#include "chart_test_rig.h"

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {
// Seven bars 20 units apart (x 5, 25, ..., 125) across a month, a year and a month again.
void AddDates(ChartRig& r) {
    r.request.BarSpacing = 20;
    for (const char* d :
         {"20231128", "20231129", "20231201", "20231204", "20240102", "20240103", "20240201"})
        r.Add(d, 15, 20, 12.5f, 17);
}
} // namespace

TEST(DateAxis, DailyTicksMonthLettersYearLinesAndLabels) {
    ChartRig r;
    AddDates(r);
    ASSERT_TRUE(r.Build().ok());
    const auto lines = r.Lines();
    // December at x 45: column 6 is 5 past column 1 of the first bar.
    EXPECT_TRUE(HasRun(lines, {"L, 45, 950, 45, 955, 27", "T, 8.25, 45, 952,D, 27"}));
    // The new year: tick, the year line (dashed on paper, in the label colour), the year.
    EXPECT_TRUE(HasRun(
        lines, {"L, 85, 950, 85, 955, 27", "D, 85, 130, 85, 952, 27", "T, 8.25, 85, 952,24, 27"}));
    EXPECT_TRUE(HasRun(lines, {"L, 125, 950, 125, 955, 27", "T, 8.25, 125, 952,F, 27"}));
    EXPECT_EQ(Starting(lines, "D,").size(), 1u);
    // On the screen the year line is dotted, in the year-line colour.
    EXPECT_TRUE(HasRun(r.Calls(), {"Style dot", "Line 85,130,85,952 #34", "Style solid"}));
}

TEST(DateAxis, CloseMonthsGetNoTick) {
    ChartRig r;
    AddDates(r);
    r.request.BarSpacing = 10; // December at x 25: column 3, only 2 past the first
    ASSERT_TRUE(r.Build().ok());
    const auto lines = r.Lines();
    for (const auto& l : lines)
        EXPECT_EQ(l.find(",D, 27"), std::string::npos) << l;
    EXPECT_TRUE(HasRun(lines, {"L, 45, 950, 45, 955, 27", "D, 45, 130, 45, 952, 27"}))
        << "a new year always ticks";
}

TEST(DateAxis, WeeklyChartsMarkYearsOnly) {
    ChartRig r;
    AddDates(r);
    r.request.ChartPeriod = 'W';
    ASSERT_TRUE(r.Build().ok());
    const auto lines = r.Lines();
    std::vector<std::string> axis;
    for (const auto& l : lines)
        if (l.find(", 955, 27") != std::string::npos || l.find(", 952,") != std::string::npos)
            axis.push_back(l);
    EXPECT_EQ(axis,
              (std::vector<std::string>{"L, 85, 950, 85, 955, 27", "T, 8.25, 85, 952,24, 27"}));
    EXPECT_TRUE(Starting(lines, "D,").empty());
}

TEST(TrailingLabels, LastDateClosingPriceAndStamp) {
    ChartRig r;
    AddDates(r);
    r.source.Records[5].Close = 15;
    const std::vector<std::string> tail = {"T, 8.25, 380, 2,Last date processed 01-02-24, 27",
                                           "T, 8.25, 380, 20,Closing Price : 17.00  (15.00), 27",
                                           "Z, 7, 269.4, 120,KORI\xA0"
                                           "Charting, 27"}; // 354 - 30 - 13 x 4.2
    ASSERT_TRUE(r.Build().ok());
    auto lines = r.Lines();
    ASSERT_GE(lines.size(), 3u);
    EXPECT_EQ(std::vector<std::string>(lines.end() - 3, lines.end()), tail);
    EXPECT_EQ(r.chart.ChartLastClose, 17);
    EXPECT_TRUE(HasRun(r.Calls(), {"Text 269.4,120 size 7 bold italic #27 [KORI Charting]"}));

    r.printBold = true; // the labels stay off paper; the stamp moves and grows
    ASSERT_TRUE(r.Build().ok());
    lines = r.Lines();
    EXPECT_EQ(lines.back(), "Z, 8, 249.4, 110,KORI\xA0"
                            "Charting, 27");
    for (const auto& l : lines)
        EXPECT_EQ(l.find("Closing"), std::string::npos);
    EXPECT_TRUE(HasRun(r.Calls(), {"Text 380,20 size 8 #27 [Closing Price : 17.00  (15.00)]"}));
}

TEST(TrailingLabels, Texts) {
    EXPECT_EQ(LastDateText("20240201"), "Last date processed 01-02-24");
    EXPECT_EQ(ClosingPriceText(17, 15.125f, 4), "Closing Price : 17.00  (15.125)");
    EXPECT_EQ(ClosingPriceText(1234.5f, 1200, 5), "Closing Price : 1235  (1200)");
    EXPECT_EQ(ClosingPriceText(0.5f, 0.25f, 1), "Closing Price : .50  (.25)");
}
