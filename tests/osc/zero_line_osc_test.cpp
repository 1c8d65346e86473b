// Momentum, Rate of Change, MACD, Coppock and Elder Ray: the oscillators that swing about 0.
#include "osc/macd_coppock_elder.h"
#include "osc/momentum_roc.h"
#include "osc_test_bars.h"

#include <gtest/gtest.h>

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
} // namespace

// P = 2, closes 10 12 15 0 16 20 12; values from bar P + 1 = 3.
//   i=3: close 0 -> the figure before: 0       i=4: 16 against 15: mom +100, roc 1/16 -> 6
//   i=5: 3 bars back is 0 -> repeats 100 / 6   i=6: 12 against 16: mom -400, roc -4/12 -> -33
// (a rate against the old close would give 7 and -25.)
TEST(MomentumRocCompute, ChangeAgainstCurrentCloseAndHeldFigures) {
    const auto bars = CloseBars({10, 12, 15, 0, 16, 20, 12});
    const auto mom = ComputeMomentum(bars, 2).mom;
    const auto roc = ComputeROC(bars, 2).roc;
    EXPECT_FALSE(mom[2]); // bar P is not computed
    EXPECT_FALSE(roc[2]);
    EXPECT_EQ(*mom[3], 0);
    EXPECT_EQ(*roc[3], 0);
    EXPECT_EQ(*mom[4], 100);
    EXPECT_EQ(*roc[4], 6);
    EXPECT_EQ(*mom[5], 100);
    EXPECT_EQ(*roc[5], 6);
    EXPECT_EQ(*mom[6], -400);
    EXPECT_EQ(*roc[6], -33);
}

TEST(MomentumRocCompute, MomentumIsInCentsAndShortChartsComputeNothing) {
    // 2.5 - 1.25 = 1.25 -> 125 cents; 3.125 - 2.5 = 0.625 -> 62.5 -> 62 (ties to even)
    const auto mom = ComputeMomentum(CloseBars({1.25f, 2.5f, 3.125f}), 1).mom;
    EXPECT_EQ(*mom[2], 62);
    EXPECT_EQ(Computed(ComputeMomentum(CloseBars({1, 2, 3}), 2).mom), 0);
    EXPECT_EQ(Computed(ComputeROC(CloseBars({1, 2, 3}), 0).roc), 0);
}

// P1 = 2, P2 = 3, P3 = 2 on closes 1 2 3 4 6 8 8 10.
//   ema1: seed at bar 1 = (1+2)/2 = 1.5, a = 2/3: 2.5, 3.5, 5.1667, 7.0556, 7.6852, 9.2284
//   ema2: seed at bar P1+P2-1 = 4 = mean of closes 2..4 = 13/3, a = 1/2: 6.1667, 7.0833, 8.5417
//   macd from bar 4: 0.8333, 0.8889, 0.6019, 0.6867
//   signal: seed at bar 6 = (0.8333 + 0.8889 + 0.6019) / 2 = 1.1620 (three values over P3),
//           bar 7: 2/3 x 0.6867 + 1/3 x 1.1620 = 0.8452
TEST(MacdCompute, SeedsAndTheSignalQuirk) {
    const auto bars = CloseBars({1, 2, 3, 4, 6, 8, 8, 10});
    const MacdResult r = ComputeMACD(bars, 2, 3, 2);
    EXPECT_FALSE(r.ema1[0]);
    EXPECT_FLOAT_EQ(*r.ema1[1], 1.5f);
    EXPECT_NEAR(*r.ema1[7], 9.22840f, 1e-4);
    EXPECT_FALSE(r.ema2[3]);
    EXPECT_NEAR(*r.ema2[4], 4.33333f, 1e-4);
    EXPECT_NEAR(*r.ema2[7], 8.54167f, 1e-4);
    EXPECT_FALSE(r.macd[3]);
    EXPECT_NEAR(*r.macd[4], 0.83333f, 1e-4);
    EXPECT_NEAR(*r.macd[6], 0.60185f, 1e-4);
    EXPECT_FALSE(r.signal[5]);
    EXPECT_NEAR(*r.signal[6], 1.16204f, 1e-4);
    EXPECT_NEAR(*r.signal[7], 0.84516f, 1e-4);
}

TEST(MacdCompute, ShortChartsAndZeroPeriods) {
    const auto bars = CloseBars({1, 2, 3, 4, 6, 8});
    const MacdResult r = ComputeMACD(bars, 2, 3, 2);
    EXPECT_EQ(Computed(r.ema1), 5);
    EXPECT_EQ(Computed(r.macd), 2);
    EXPECT_EQ(Computed(r.signal), 0); // shorter than P1 + P2 + P3 - 1 bars
    EXPECT_EQ(Computed(ComputeMACD(bars, 2, 0, 2).ema1), 0);
    EXPECT_EQ(Computed(ComputeMACD(bars, 7, 3, 2).ema1), 0);
}

// n = 2, a = 2/3, closes 10 10 11 12 12 13 10.
//   raw i=3: (12-10)/10 + (12-11)/11 = 20 + 9.0909;  i=4: (12-11)/11 + 0 = 9.0909
//   seed at bar 2n = 4: sum rounded at each step: 29, then 38.09 -> 38; 38/2 -> 19
//   i=5: raw 8.3333 + 8.3333; round(2/3 x 16.667 + 1/3 x 19) = round(17.44) -> 17
//   i=6: raw -16.667 - 23.077; round(2/3 x -39.744 + 1/3 x 17) = round(-20.83) -> -21
TEST(CoppockCompute, WholeNumberSmoothing) {
    const auto r = ComputeCoppock(CloseBars({10, 10, 11, 12, 12, 13, 10}), 2).coppock;
    for (int i = 0; i <= 3; ++i)
        EXPECT_FALSE(r[static_cast<std::size_t>(i)]) << i;
    EXPECT_EQ(*r[4], 19);
    EXPECT_EQ(*r[5], 17);
    EXPECT_EQ(*r[6], -21);
}

TEST(CoppockCompute, LowMovesStayAtZeroAndShortChartsComputeNothing) {
    // Rises of a tenth of a per cent: every raw figure is below 0.5, so all stays 0.
    const auto low = ComputeCoppock(CloseBars({100, 100.1f, 100.2f, 100.3f, 100.4f, 100.5f}), 2);
    EXPECT_EQ(Computed(low.coppock), 2);
    EXPECT_EQ(*low.coppock[4], 0);
    EXPECT_EQ(*low.coppock[5], 0);
    // n = 3, closes 10 10 10 10 0 12 12: raw i=4 0 (its close is 0), i=5 (12-10)/10 x 2 = 40,
    // i=6 0 because the close n - 1 bars back is 0. Seed at bar 6: 40 / 3 -> 13.
    const auto gap = ComputeCoppock(CloseBars({10, 10, 10, 10, 0, 12, 12}), 3).coppock;
    EXPECT_EQ(*gap[6], 13);
    EXPECT_EQ(Computed(ComputeCoppock(CloseBars({1, 2, 3, 4}), 2).coppock), 0);
    EXPECT_EQ(Computed(ComputeCoppock(CloseBars({1, 2, 3, 4, 5}), 0).coppock), 0);
}

// n = 3, a = 1/2. Bars (H L C): 11 9 10 | 12 10 11 | 13 11 12 | 15 12 14
//   bar 2: average 11: bull 13 - 11 = 2, bear 11 - 11 = 0
//   bar 3: average 0.5 x 14 + 0.5 x 11 = 12.5: bull 2.5, bear -0.5
//   closes only (RecordType 3): both close - average: 1, then 1.5
TEST(ElderRayCompute, BullAndBearPower) {
    const auto bars = HlcBars({{11, 9, 10}, {12, 10, 11}, {13, 11, 12}, {15, 12, 14}});
    const ElderRayResult r = ComputeElderRay(bars, 3, 4);
    EXPECT_FALSE(r.bull[1]);
    EXPECT_FLOAT_EQ(*r.bull[2], 2.0f);
    EXPECT_FLOAT_EQ(*r.bear[2], 0.0f);
    EXPECT_FLOAT_EQ(*r.bull[3], 2.5f);
    EXPECT_FLOAT_EQ(*r.bear[3], -0.5f);
    const ElderRayResult c = ComputeElderRay(bars, 3, 3);
    EXPECT_FLOAT_EQ(*c.bull[2], 1.0f);
    EXPECT_FLOAT_EQ(*c.bear[3], 1.5f);
    EXPECT_EQ(Computed(ComputeElderRay(bars, 5, 4).bull), 0);
    // A type below 4 that is not 1 to 3 has no highs and lows either: closes, as for type 3.
    EXPECT_FLOAT_EQ(*ComputeElderRay(bars, 3, 0).bear[3], 1.5f);
}
