#include "chart/scale.h"

#include <gtest/gtest.h>

#include <cmath>

using namespace kori::chart;

namespace {
void ExpectScale(float high, float low, float base, float ceiling, float step, int count) {
    SCOPED_TRACE(testing::Message() << "high " << high << " low " << low);
    const ChartScale s = AutoScale(high, low);
    EXPECT_FLOAT_EQ(s.ChartBase, base);
    EXPECT_FLOAT_EQ(s.ChartCeiling, ceiling);
    EXPECT_FLOAT_EQ(s.GridStep, step);
    EXPECT_EQ(s.GridCount, count);
}
} // namespace

TEST(AutoScale, OrdinaryRangesWidenAndRound) {
    // Top: 120 x 1.02 = 122.4 -> n 12, 120 >= 120 so 13 -> 130. Bottom: 100.5 x 0.99 = 99.495
    // -> n 995 -> 99.5, then x 0.99 again = 98.505 -> 98.5: a low just over 100 gives about 99.
    ExpectScale(120, 100.5f, 98.5f, 130, 5, 6);
    // 1234 x 1.02 -> 1260; 1000 x 0.99 = 990 -> n 99 -> 990; over 600 both go to hundreds:
    // base 900, ceiling (12 + 1) x 100. Range 400 -> step 400 \ 10 = 40.
    ExpectScale(1234, 1000, 900, 1300, 40, 10);
    // Flat prices: the range is opened by 5% each way first: 5.25 -> 5.4 -> 5.4 x 1.02 = 5.5;
    // 4.75 -> 4.7 -> 4.653 -> 4.7. Range 0.8 -> step 0.05.
    ExpectScale(5, 5, 4.7f, 5.5f, 0.05f, 16);
}

TEST(AutoScale, HighBetween85And100WithNarrowRangeIsNotWidened) {
    // f = 1 at both ends: 90 -> 90.1, 88 -> 87.9; range 2.2 -> step 0.2, 11 lines.
    ExpectScale(90, 88, 87.9f, 90.1f, 0.2f, 11);
    // Range of 4 or more: the ordinary factor applies twice (90 x 1.02 = 91.8 -> 91.8 x 1.02
    // = 93.636 -> 93.6).
    const ChartScale wide = AutoScale(90, 86);
    EXPECT_FLOAT_EQ(wide.ChartCeiling, 93.6f);
}

TEST(AutoScale, TinyPrices) {
    // 0.004: top 0.05 x 1.05 x 1.2 = 0.063; low 0.002 x 0.95 x 0.9 -> 0.002 -> rounds to 0 at
    // the 0.005 grid -> 0.001.
    ExpectScale(0.004f, 0.002f, 0.001f, 0.063f, 0.005f, 12);
}

TEST(AutoScale, NegativeValuesGoToTens) {
    // -5 x 0.99 = -4.95; -20 x 1.01 = -20.2; then floor to tens: -30 and -10.
    ExpectScale(-5, -20, -30, -10, 1, 20);
}

TEST(AutoScale, NoPricesAtAllGivesAnInvertedScaleAndNoGrid) {
    // A window of zero prices leaves the load's starting values: highest 0, lowest 100000.
    const ChartScale s = AutoScale(0, 100000);
    EXPECT_FLOAT_EQ(s.ChartBase, 94000);
    EXPECT_FLOAT_EQ(s.ChartCeiling, 0.063f);
    EXPECT_EQ(s.GridStep, 0);
    EXPECT_EQ(s.GridCount, 0);
}

TEST(GridStep, TableRowsAndTheirEdges) {
    struct Case {
        float range, step;
        int count;
    } cases[] = {
        {0.10f, 0.005f, 20}, {0.11f, 0.02f, 5}, {0.5f, 0.02f, 25}, {0.51f, 0.05f, 10},
        {1, 0.05f, 20},      {1.01f, 0.1f, 10}, {3, 0.2f, 15},     {3.5f, 0.3f, 11},
        {4.5f, 0.4f, 11},    {7, 0.5f, 14},     {15, 1, 15},       {40, 5, 8},
        {60, 10, 6},         {100, 15, 6},      {157.3f, 15, 10},  {1234, 120, 10},
        {0, 0, 0},           {-3, 0, 0},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.range);
        const GridSteps g = ComputeGridStep(0, c.range);
        EXPECT_FLOAT_EQ(g.GridStep, c.step);
        EXPECT_EQ(g.GridCount, c.count);
    }
}

TEST(GridStep, RangeIsRoundedToTwoDecimalsFirst) {
    // 0.105 prints as 0.105 and rounds up to 0.11: the second row, not the first.
    EXPECT_FLOAT_EQ(ComputeGridStep(0, 0.105f).GridStep, 0.02f);
    // 0.104 rounds to 0.10: the first row.
    EXPECT_FLOAT_EQ(ComputeGridStep(0, 0.104f).GridStep, 0.005f);
}

TEST(ManualScale, EitherEndZeroMeansNoScale) {
    EXPECT_FALSE(ManualScale(0, 10).has_value());
    EXPECT_FALSE(ManualScale(5, 0).has_value());
    const auto s = ManualScale(5, 10);
    ASSERT_TRUE(s.has_value());
    EXPECT_EQ(s->ChartBase, 5);
    EXPECT_EQ(s->ChartCeiling, 10);
    EXPECT_EQ(ManualScaleMessage("BHP   "),
              "BHP MANUAL SCALING has been selected but there are no chart scale definitions in "
              "the Name File for BHP\n"
              "Use <Change Scales> in the Set Defaults window or add these scales directly to the "
              "Name File\n"
              "Do not use 0(zero) as chart base or ceiling\n"
              "OTHERWISE USE AUTOMATIC SCALING");
}

TEST(PriceMap, ArithmeticRoundsHalvesToEvenAndRoundTrips) {
    PriceMap m;
    ASSERT_TRUE(m.Prepare(false, false, 10, 20, 100, 600)); // 0.02 a unit
    EXPECT_EQ(m.PriceToY(10), 600);
    EXPECT_EQ(m.PriceToY(20), 100);
    EXPECT_EQ(m.PriceToY(15), 350);
    EXPECT_NEAR(m.YToPrice(350), 15.0, 1e-6); // UnitsPerY is a 32-bit 0.02
    for (int y = 100; y <= 600; y += 7)
        EXPECT_EQ(m.PriceToY(m.YToPrice(y)), y);

    PriceMap unit;
    ASSERT_TRUE(unit.Prepare(false, false, 0, 500, 0, 500));
    EXPECT_EQ(unit.PriceToY(2.5), 498); // 497.5 -> even
    EXPECT_EQ(unit.PriceToY(3.5), 496); // 496.5 -> even
}

TEST(PriceMap, UpsideDownRunsTheOtherWay) {
    PriceMap m;
    ASSERT_TRUE(m.Prepare(false, false, 10, 20, 600, 100));
    EXPECT_EQ(m.PriceToY(10), 100);
    EXPECT_EQ(m.PriceToY(20), 600);
}

TEST(PriceMap, LogarithmicFloorsAndKeepsTheZeroAndNegativeStandIns) {
    PriceMap m;
    // LogBase ln 2, LogFactor -400 / ln 100 = -86.8589.
    ASSERT_TRUE(m.Prepare(true, false, 2, 200, 0, 400));
    EXPECT_EQ(m.PriceToY(2), 400);
    EXPECT_EQ(m.PriceToY(50), 120);  // 400 - 3.218876 x 86.8589 = 120.41
    EXPECT_EQ(m.PriceToY(150), 24);  // 24.99 floors to 24
    EXPECT_EQ(m.PriceToY(0), 260);   // ln 10 stands in: 260.21
    EXPECT_EQ(m.PriceToY(-20), 393); // ln 10 / ln 20 stands in: 393.44
    for (int y = 10; y <= 400; y += 13)
        EXPECT_NEAR(m.PriceToY(m.YToPrice(y + 0.5)), y, 0);
    EXPECT_NEAR(m.YToPrice(m.PriceToY(50)), 50, 50 * 0.012);
}

TEST(PriceMap, DegenerateScalesAreRefusedNotDividedBy) {
    PriceMap m;
    EXPECT_FALSE(m.Prepare(false, false, 5, 5, 100, 600));  // equal ends
    EXPECT_FALSE(m.Prepare(false, false, 5, 10, 300, 300)); // no height
    EXPECT_FALSE(m.Prepare(true, false, 0, 10, 100, 600));  // log of 0
    EXPECT_FALSE(m.Prepare(true, false, -5, 10, 100, 600)); // log of a negative
    EXPECT_FALSE(m.Prepare(true, false, 5, 5, 100, 600));   // log with equal ends
    EXPECT_FALSE(m.Prepare(true, false, 5, -10, 100, 600)); // bar chart: no log of the ceiling
}

TEST(PriceMap, LineChartCeilingOfZeroKeepsTheFactorOfTheChartBefore) {
    PriceMap m;
    ASSERT_TRUE(m.Prepare(true, true, 2, 200, 0, 400));
    const double factor = m.LogFactor();
    ASSERT_TRUE(m.Prepare(true, true, 2, 0, 0, 400));
    EXPECT_DOUBLE_EQ(m.LogFactor(), factor);
    EXPECT_EQ(m.PriceToY(50), 120);
    // A negative ceiling maps through ln 10 / ln(-ceiling).
    ASSERT_TRUE(m.Prepare(true, true, 2, -20, 0, 400));
    EXPECT_DOUBLE_EQ(m.LogFactor(), -400 / (std::log(10.0) / std::log(20.0) - std::log(2.0)));
    PriceMap fresh;
    EXPECT_FALSE(fresh.Prepare(true, true, 2, 0, 0, 400)) << "no factor to keep on a first chart";
}
