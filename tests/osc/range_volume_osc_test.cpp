// ATR, Volatility, OBV and Directional Movement: the oscillators of ranges and volume.
#include "osc/atr_volatility_obv.h"
#include "osc/directional.h"
#include "osc_test_bars.h"

#include <gtest/gtest.h>

#include <limits>

using namespace kori;
using namespace kori::osc;
using test::CloseBars;
using test::HlcBars;

namespace {
template <class T> int Computed(const Series<T>& s) {
    int n = 0;
    for (const auto& v : s)
        n += v.has_value();
    return n;
}
Money M(double v) {
    return *Money::FromDouble(v);
}
} // namespace

// P = 2. Bars (H L C) and true ranges:
//   10 9 9.5 | 10.5 9.5 10 (1) | 11 10.5 10.8 (gap to 11: 1) | 10.9 10.2 10.3 (0.7)
//   10.3 9.3 9.4 (1) | 9.6 9.4 9.5 (0.2)
//   bar 2: mean (1 + 1) / 2 = 1, not stored
//   bar 3: (0.7 + 1 x 2) / 3 = 0.9       (a P divisor would give 0.85)
//   bar 4: (1 + 0.9 x 2) / 3 = 0.9333
//   bar 5: (0.2 + 0.9333 x 2) / 3 = 2.0666 / 3 = 0.6889 in ten-thousandths
TEST(AtrCompute, FourDecimalsAndThePPlusOneDivisor) {
    const auto bars = HlcBars({{10, 9, 9.5f},
                               {10.5f, 9.5f, 10},
                               {11, 10.5f, 10.8f},
                               {10.9f, 10.2f, 10.3f},
                               {10.3f, 9.3f, 9.4f},
                               {9.6f, 9.4f, 9.5f}});
    const AtrResult r = ComputeATR(bars, 2);
    EXPECT_FALSE(r.tr[0]);
    EXPECT_EQ(*r.tr[2], M(1));
    EXPECT_EQ(*r.tr[3], M(0.7));
    EXPECT_EQ(*r.tr[5], M(0.2));
    EXPECT_FALSE(r.atr[2]); // the seed bar itself is not stored
    EXPECT_EQ(r.atr[3]->raw(), 9000);
    EXPECT_EQ(r.atr[4]->raw(), 9333);
    EXPECT_EQ(r.atr[5]->raw(), 6889);
}

TEST(AtrCompute, NoAverageWithoutSpreadOrBars) {
    const auto same = HlcBars({{11, 10, 10.5f}, {11, 10, 10.5f}, {11, 10, 10.5f}, {11, 10, 10.5f}});
    const AtrResult flat = ComputeATR(same, 2);
    EXPECT_TRUE(flat.NoSpread); // every true range is 1
    EXPECT_EQ(Computed(flat.tr), 3);
    EXPECT_EQ(Computed(flat.atr), 0);

    const auto bars = HlcBars({{10, 9, 9.5f}, {10.5f, 9.5f, 10}, {11, 10, 10.8f}});
    EXPECT_EQ(Computed(ComputeATR(bars, 2).atr), 0); // P or fewer bars after the first
    EXPECT_EQ(Computed(ComputeATR(bars, 0).tr), 0);
}

// A high of 1e30 cannot be held in currency: that bar has no true range and the average
// stops there, rather than showing a wrapped-around figure.
TEST(AtrCompute, PricesBeyondCurrencyStopTheAverage) {
    auto bars = HlcBars({{10, 9, 9.5f},
                         {10.5f, 9.5f, 10},
                         {11, 10.5f, 10.8f},
                         {10.9f, 10.2f, 10.3f},
                         {10.3f, 9.3f, 9.4f},
                         {9.6f, 9.4f, 9.5f}});
    bars.ChartBars[4].High = 1e30f;
    const AtrResult r = ComputeATR(bars, 2);
    EXPECT_EQ(r.atr[3]->raw(), 9000);
    EXPECT_FALSE(r.tr[4]);
    EXPECT_FALSE(r.atr[4]);
    EXPECT_FALSE(r.atr[5]);
    bars.ChartBars[2].Close = std::numeric_limits<float>::quiet_NaN();
    EXPECT_EQ(Computed(ComputeATR(bars, 2).atr), 0); // bar 3's gap to a NaN close
}

// P = 2. Bars (H L C) and figures (H - L) / C x 100:
//   10 10 10 -> 0: bar 0 has none       11 9 10 -> 20       10.5 9.5 10 -> 10
//   0 0 0 -> close 0 keeps 10           10 10 10 -> 0: a later bar reads 1
//   9 10 10 -> -10: reads 1
//   means of the last 2 from the second figure: 15, 10, 5.5, 1
TEST(VolatilityCompute, FiguresAndMeans) {
    const auto bars = HlcBars(
        {{10, 10, 10}, {11, 9, 10}, {10.5f, 9.5f, 10}, {0, 0, 0}, {10, 10, 10}, {9, 10, 10}});
    const VolatilityResult r = ComputeVolatility(bars, 2);
    EXPECT_FALSE(r.figure[0]);
    EXPECT_FLOAT_EQ(*r.figure[1], 20.0f);
    EXPECT_FLOAT_EQ(*r.figure[3], 10.0f);
    EXPECT_FLOAT_EQ(*r.figure[4], 1.0f);
    EXPECT_FLOAT_EQ(*r.figure[5], 1.0f);
    EXPECT_FALSE(r.mean[1]);
    EXPECT_FLOAT_EQ(*r.mean[2], 15.0f);
    EXPECT_FLOAT_EQ(*r.mean[3], 10.0f);
    EXPECT_FLOAT_EQ(*r.mean[4], 5.5f);
    EXPECT_FLOAT_EQ(*r.mean[5], 1.0f);
    EXPECT_EQ(Computed(ComputeVolatility(bars, 0).figure), 0);
    EXPECT_EQ(Computed(ComputeVolatility(bars, 6).mean), 0); // only five figures
}

// Closes 10 11 11 10 0 12 13 with volumes 100 to 700:
//   bar 1 rise +200 -> 100200; bar 2 unchanged -> 100200; bar 3 fall -400 -> 99800
//   bars 4 and 5 touch the zero close: no value; bar 6 rise +700 -> 100500
TEST(ObvCompute, RunningVolumeAroundAZeroClose) {
    const auto bars = HlcBars({{10, 10, 10},
                               {11, 11, 11},
                               {11, 11, 11},
                               {10, 10, 10},
                               {0, 0, 0},
                               {12, 12, 12},
                               {13, 13, 13}},
                              {100, 200, 300, 400, 500, 600, 700});
    const ObvResult r = ComputeOBV(bars);
    EXPECT_FALSE(r.NoVolumeData);
    EXPECT_FALSE(r.obv[0]);
    EXPECT_EQ(*r.obv[1], 100200);
    EXPECT_EQ(*r.obv[2], 100200);
    EXPECT_EQ(*r.obv[3], 99800);
    EXPECT_FALSE(r.obv[4]);
    EXPECT_FALSE(r.obv[5]);
    EXPECT_EQ(*r.obv[6], 100500);
}

// Without volume the panel says "No Volume Data", but the values the routine stored for each
// bar (100000 from bar 1) stand, so an export shows them.
TEST(ObvCompute, NoVolumeDataAndTooFewBars) {
    const ObvResult none = ComputeOBV(CloseBars({10, 11, 10, 12}));
    EXPECT_TRUE(none.NoVolumeData);
    EXPECT_FALSE(none.obv[0]);
    for (std::size_t i = 1; i < none.obv.size(); ++i)
        EXPECT_EQ(none.obv[i], 100000) << i;
    const ObvResult two = ComputeOBV(HlcBars({{10, 10, 10}, {11, 11, 11}}, {5, 5}));
    EXPECT_FALSE(two.NoVolumeData);
    EXPECT_EQ(Computed(two.obv), 0);
}

// P = 2, X = 2. Bars (H L C), up/down moves, true range, day-ratios:
//   b1 11 9 10      up 1 down -1         TR 2    d+ .5
//   b2 11.5 8.5 9   up .5 = down .5: 0   TR 3    -
//   b3 11 7 8       down 1.5             TR 4    d- .375
//   b4 12 8 11.5    up 1                 TR 4    d+ .25
//   b5 11.75 8.5 10 inside day: both <0  TR 3.25 -
//   b6 14 10 13     up 2.25              TR 4    d+ .5625
//   b7 13.5 9.5 10  down .5              TR 4    d- .125
//   b8 14.5 10.5 14 up 1                 TR 4.5 (to the close before)  d+ .2222
// +DI/-DI = integer part of the 2-bar mean ratio x 100, DX = |a / b| x 100:
//   b2 25/0 DX 100; b3 0/18 DX 100; b4 12/18 DX 6/30 -> 20; b5 12/0 100; b6 28/0 100;
//   b7 28/6 DX 22/34 -> 64; b8 11/6 DX 5/17 -> 29
// ADX, keep = 1 - 2/3: seed at bar 4 = (100 + 20) / 2 = 60, Run = 20 (not stored);
//   b5 (100 + 20) / 3 = 40; b6 (100 + 40) / 3 = 46.67 -> 47; b7 (64 + 46.67) / 3 -> 37;
//   b8 (29 + 36.89) / 3 = 21.96 -> 22
TEST(DirectionalCompute, RatioMeansAndTheHeavyAdx) {
    const auto bars = HlcBars({{10, 8, 9},
                               {11, 9, 10},
                               {11.5f, 8.5f, 9},
                               {11, 7, 8},
                               {12, 8, 11.5f},
                               {11.75f, 8.5f, 10},
                               {14, 10, 13},
                               {13.5f, 9.5f, 10},
                               {14.5f, 10.5f, 14}});
    const DirectionalResult r = ComputeDirectional(bars, 2, 2);
    EXPECT_FALSE(r.pdi[1]);
    const std::int16_t pdi[] = {25, 0, 12, 12, 28, 28, 11};
    const std::int16_t mdi[] = {0, 18, 18, 0, 0, 6, 6};
    const std::int16_t dx[] = {100, 100, 20, 100, 100, 64, 29};
    for (std::size_t i = 2; i <= 8; ++i) {
        EXPECT_EQ(*r.pdi[i], pdi[i - 2]) << i;
        EXPECT_EQ(*r.mdi[i], mdi[i - 2]) << i;
        EXPECT_EQ(*r.dx[i], dx[i - 2]) << i;
    }
    EXPECT_FALSE(r.adx[4]);
    EXPECT_EQ(*r.adx[5], 40);
    EXPECT_EQ(*r.adx[6], 47);
    EXPECT_EQ(*r.adx[7], 37);
    EXPECT_EQ(*r.adx[8], 22);
}

TEST(DirectionalCompute, ZeroPeriodsWorkAsTenAndShortChartsComputeNothing) {
    store::ChartSeries bars;
    for (int i = 0; i < 30; ++i) {
        store::ChartBar b;
        b.High = static_cast<float>(20 + (i * 7) % 5);
        b.Low = b.High - static_cast<float>(1 + i % 3);
        b.Close = b.Low + 0.5f;
        bars.ChartBars.push_back(b);
    }
    bars.LastBar = 29;
    const DirectionalResult zero = ComputeDirectional(bars, 0, 0);
    const DirectionalResult ten = ComputeDirectional(bars, 10, 10);
    EXPECT_EQ(zero.adx, ten.adx);
    EXPECT_EQ(zero.pdi, ten.pdi);
    EXPECT_EQ(Computed(ten.pdi), 20);
    EXPECT_EQ(Computed(ten.adx), 9); // bars 21 to 29

    bars.LastBar = 9; // fewer than P + 1 bars
    EXPECT_EQ(Computed(ComputeDirectional(bars, 10, 10).pdi), 0);
}
