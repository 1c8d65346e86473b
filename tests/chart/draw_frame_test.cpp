#include "chart/draw_frame.h"
#include "chart_test_rig.h"

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {
// Text field of each price label line ("T" at font 1's size 8, right of the plot).
std::vector<std::string> PriceLabels(const std::vector<std::string>& lines) {
    std::vector<std::string> out;
    for (const auto& l : Starting(lines, "T, 8, ")) {
        std::vector<std::string> f;
        std::size_t start = 0;
        for (std::size_t i = 0; i <= l.size(); ++i)
            if (i == l.size() || l[i] == ',') {
                f.push_back(l.substr(start, i - start));
                start = i + 1;
            }
        if (f.size() == 6 && f[2] != " 20") out.push_back(f[4]);
    }
    return out;
}
} // namespace

TEST(DrawHeading, TitleOtherDetailsAndSecondLine) {
    ChartRig r;
    r.name.OtherDetails = "ORD";
    r.Add("20240304", 15, 20, 12.5f, 17);
    ASSERT_TRUE(r.Build().ok());
    const auto lines = r.Lines();
    ASSERT_GE(lines.size(), 4u);
    EXPECT_EQ(lines[0], "T, 8.25, 20, 2,BHP       BHP GROUP" + std::string(26, ' ') + ", 26");
    // Under the title (2 + 12); in the stream with fifteen blanks ahead.
    EXPECT_EQ(lines[1],
              "T, 8.25, 20, 14," + std::string(15, ' ') + "ORD" + std::string(12, ' ') + ", 26");
    EXPECT_EQ(lines[2], "T, 8.25, 7, 112,DAILY - ARITHMETIC -, 26");
    EXPECT_EQ(lines[3], "B, 4, 130, 354, 950, 16");
    EXPECT_TRUE(HasRun(r.Calls(), {"Text 7,112 size 8 bold #26 [DAILY - ARITHMETIC -]"}));

    r.printBold = true; // the title at font 1's size, two blanks after the code
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(r.Lines()[0], "T, 8, 20, 2,BHP     BHP GROUP" + std::string(26, ' ') + ", 26");
}

TEST(DrawHeading, PagesAndSplitsShowTheCodeAlone) {
    ChartRig r;
    r.request.ChartSlot = 3;
    r.Add("20240304", 15, 20, 12.5f, 17);
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(r.Lines().front(), "T, 9.75, 120, 2,BHP, 26");
}

TEST(HeadingLine, PeriodScaleUpsideDownBandsAndAverages) {
    ChartRequest q;
    ChartName n;
    q.ChartPeriod = 'W';
    q.UpsideDown = true;
    q.ChartBands = 1;
    n.PercentBandUp = 0; // outside 1 to 100: 5
    n.PercentBandDown = 10;
    EXPECT_EQ(HeadingLine(q, n, true, false), "WEEKLY - LOGARITHMIC -" + std::string(20, ' ') +
                                                  "UPSIDE-DOWN CHART" + std::string(6, ' ') +
                                                  "Percentage Bands  & 5%    - 10%");
    ChartRequest a;
    EXPECT_EQ(HeadingLine(a, n, true, true), "DAILY - LOGARITHMIC - ");
    a.ChartPeriod = 'M';
    a.AverageName1 = "10 Day Average";
    EXPECT_EQ(HeadingLine(a, n, false, true), "MONTHLY - ARITHMETIC -      10 Day Average");
}

TEST(DrawGrid, TicksAndLabelsOfEachGridline) {
    ChartRig r;
    r.Add("20240304", 15, 20, 12.5f, 17);
    ASSERT_TRUE(r.Build().ok());
    // Range 82: step 15, five intervals; labels right-aligned at 354 + 45.
    EXPECT_TRUE(HasRun(r.Lines(), {"L, 354, 950, 358, 950, 16", "T, 8, 375, 944,10.00, 27",
                                   "L, 354, 800, 358, 800, 16", "T, 8, 375, 794,25.00, 27"}));
    EXPECT_EQ(PriceLabels(r.Lines()),
              (std::vector<std::string>{"10.00", "25.00", "40.00", "55.00", "70.00", "85.00"}));
    r.printBold = true;
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(HasRun(r.Lines(), {"L, 354, 950, 358, 950, 16", "T, 8, 375, 938,10.00, 27"}));
}

TEST(DrawGrid, LabelThinning) {
    ChartRig r;
    r.Add("20240304", 15, 20, 12.5f, 17);
    r.name.Top = 22; // 12 intervals of 1: all labels to n = 6, then every second
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(PriceLabels(r.Lines()),
              (std::vector<std::string>{"10.00", "11.00", "12.00", "13.00", "14.00", "15.00",
                                        "16.00", "18.00", "20.00", "22.00"}));
    r.name.Top = 23; // 13 intervals: every second from the first
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(PriceLabels(r.Lines()), (std::vector<std::string>{"10.00", "12.00", "14.00", "16.00",
                                                                "18.00", "20.00", "22.00"}));
    bool skip = false;
    EXPECT_TRUE(LabelShows(0, 12, skip));
    EXPECT_TRUE(LabelShows(1, 12, skip));
}

TEST(DrawGrid, PriceGridHalfStepsAndVerticalGrid) {
    ChartRig r;
    r.defaults.ShowPriceGrid = true;
    r.defaults.MidGrid = 1;
    r.defaults.VerticalGridSpace = 15; // every 150 units
    r.Add("20240304", 15, 20, 12.5f, 17);
    ASSERT_TRUE(r.Build().ok());
    // At n = 1 (y 800): the line across, then the half step at 17.5 (y 875).
    EXPECT_TRUE(HasRun(r.Lines(), {"T, 8, 375, 794,25.00, 27", "V, 5, 800, 354, 800, 35",
                                   "V, 5, 875, 354, 875, 35"}));
    EXPECT_TRUE(HasRun(r.Lines(), {"V, 155, 130, 155, 950, 35", "V, 305, 130, 305, 950, 35",
                                   "H, 5, 850, 5, 925, 18"}));
}

TEST(PriceLabel, Patterns) {
    EXPECT_EQ(PriceLabel(12.5f, 5, 4), "12.50");
    EXPECT_EQ(PriceLabel(1.125f, 0.1f, 4), "1.125");
    EXPECT_EQ(PriceLabel(1234.4f, 300, 5), "1234");
    EXPECT_EQ(PriceLabel(0.15f, 5, 5), ".15") << "0 to 0.2 always shows decimals";
    EXPECT_EQ(PriceLabel(0.001f, 0.06f, 4), ".001");
}

TEST(DrawGrid, BaseOf0Point001CountsAsZeroAfterTheFirstLine) {
    ChartRig r;
    r.defaults.AutoScale = true;
    r.Add("20240304", 0.003f, 0.004f, 0.002f, 0.003f); // scale 0.001 to 0.063, step 0.005
    ASSERT_TRUE(r.Build().ok());
    const auto labels = PriceLabels(r.Lines());
    ASSERT_GE(labels.size(), 3u);
    EXPECT_EQ(labels[0], ".001");
    EXPECT_EQ(labels[1], ".005");
    EXPECT_EQ(labels[2], ".01");
}
