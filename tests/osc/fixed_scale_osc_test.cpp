// RSI, stochastic/FX and Williams %R: the 0-to-100 oscillators.
#include "osc/rsi.h"
#include "osc/stoch_fx.h"
#include "osc/williams_holy_grail.h"
#include "osc_test_bars.h"

#include <gtest/gtest.h>

#include <vector>

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

// P = 3: the window of bar i is the two pairs (i-3, i-2) and (i-2, i-1); bar i's own close
// takes no part.
//   closes 10 11 12 11 13 13 14 15 12 10 9
//   i=3: +1 +1, no fall       -> nothing yet
//   i=4: +1 -1   RS 1         -> 50 (bar 4's own rise to 13 is not in it)
//   i=5: -1 +2   RS 2         -> 100 - 100/3 = 66.67
//   i=6: +2 =0, i=7: =0 +1    -> no fall: stays 66.67
//   i=8: +1 +1                -> stays
//   i=9: +1 -3   RS 1/3       -> 25
//   i=10: -3 -2  RS 0         -> 0
TEST(RsiCompute, ShiftedWindowHeldLevelAndFullFall) {
    const auto r = ComputeRSI(CloseBars({10, 11, 12, 11, 13, 13, 14, 15, 12, 10, 9}), 3).rsi;
    for (int i = 0; i <= 3; ++i)
        EXPECT_FALSE(r[static_cast<std::size_t>(i)]) << i;
    EXPECT_FLOAT_EQ(*r[4], 50.0f);
    EXPECT_NEAR(*r[5], 66.6667f, 1e-4);
    EXPECT_EQ(*r[6], *r[5]);
    EXPECT_EQ(*r[7], *r[5]);
    EXPECT_EQ(*r[8], *r[5]);
    EXPECT_FLOAT_EQ(*r[9], 25.0f);
    EXPECT_FLOAT_EQ(*r[10], 0.0f);
}

// Zero close at bar 2, P = 3:
//   i=3: (10,11) +1, (11,0) a fall of the whole 11  -> RS 1/11 -> 100 - 100/(12/11) = 8.33
//   i=4: (11,0) -11, (0,12) dropped                 -> RS 0 -> 0
//   i=5: (0,12) dropped, (12,13) +1, no fall        -> stays 0
TEST(RsiCompute, ZeroCloseDropsOnlyThePairItOpens) {
    const auto r = ComputeRSI(CloseBars({10, 11, 0, 12, 13, 14}), 3).rsi;
    EXPECT_NEAR(*r[3], 8.3333f, 1e-4);
    EXPECT_FLOAT_EQ(*r[4], 0.0f);
    EXPECT_FLOAT_EQ(*r[5], 0.0f);
}

TEST(RsiCompute, NothingForPeriodZeroOneOrBeyondTheChart) {
    const auto bars = CloseBars({10, 12, 11, 13, 12, 14});
    EXPECT_EQ(Computed(ComputeRSI(bars, 0).rsi), 0);
    EXPECT_EQ(Computed(ComputeRSI(bars, 1).rsi), 0); // no differences in the window
    EXPECT_EQ(Computed(ComputeRSI(bars, 6).rsi), 0); // at most P bars
    EXPECT_EQ(Computed(ComputeRSI(bars, 5).rsi), 1);
}

// K = 2, D = 2, RecordType 4. The window is bars i-2..i (K + 1 bars), from i = 3.
//   bars (H L C): 10 8 9 | 13 9 10 | 12 10 11 | 12 9 10 | 13 11 12 | 14 12 14
//   i=3: bars 1-3 Hi 13 Lo 9: (10-9)/4 -> 25   (a K-bar window would give 33)
//   i=4: bars 2-4 Hi 13 Lo 9: 3/4      -> 75
//   i=5: bars 3-5 Hi 14 Lo 9: 5/5      -> 100
//   %D ring of (C-Lo, Hi-Lo): i=3 (1,4) -> 25; i=4 (1+3)/(4+4) -> 50; i=5 (3+5)/(4+5) -> 89
//   slow: mean of the last 2 %D from i = K + D = 4: (25+50)/2 = 37.5 -> 38; (50+89)/2 -> 70
TEST(StochCompute, InclusiveWindowAndBothSmoothings) {
    const auto bars =
        HlcBars({{10, 8, 9}, {13, 9, 10}, {12, 10, 11}, {12, 9, 10}, {13, 11, 12}, {14, 12, 14}});
    const StochResult r = ComputeStochFX(bars, 2, 2, true, 4);
    for (int i = 0; i <= 2; ++i)
        EXPECT_FALSE(r.k[static_cast<std::size_t>(i)]) << i;
    EXPECT_EQ(*r.k[3], 25);
    EXPECT_EQ(*r.k[4], 75);
    EXPECT_EQ(*r.k[5], 100);
    EXPECT_EQ(*r.d[3], 25);
    EXPECT_EQ(*r.d[4], 50);
    EXPECT_EQ(*r.d[5], 89);
    EXPECT_EQ(*r.slowd[3], 12); // (25 + an unfilled 0) / 2 = 12.5, to even
    EXPECT_EQ(*r.slowd[4], 38);
    EXPECT_EQ(*r.slowd[5], 70);

    const StochResult fast = ComputeStochFX(bars, 2, 0, false, 4);
    EXPECT_EQ(*fast.k[4], 75);
    EXPECT_EQ(Computed(fast.d), 0); // D = 0: one line only
    EXPECT_EQ(Computed(fast.slowd), 0);
}

// The same bars as a RecordType 3 series use closes: i=3 closes 10 11 10 -> (10-10)/1 -> 0.
// A zero high on a RecordType 4 bar falls back to its close.
TEST(StochCompute, ClosesStandInForHighAndLow) {
    const auto bars = HlcBars({{10, 8, 9}, {13, 9, 10}, {12, 10, 11}, {12, 9, 10}});
    EXPECT_EQ(*ComputeStochFX(bars, 2, 0, false, 3).k[3], 0);
    // Bar 1 has no high: window 1-3 takes its close 10, so Hi 12, Lo 9: (10-9)/3 -> 33.
    auto noHigh = bars;
    noHigh.ChartBars[1].High = 0;
    EXPECT_EQ(*ComputeStochFX(noHigh, 2, 0, false, 4).k[3], 33);
}

// The second smoothing is computed at every bar after K, unfilled ring places counting 0.
// A steady rise with high = close + 1 and low = close - 1.5 gives %K = %D = 11.5 / 12.5 = 92
// at every bar from 11 (K = 10, D = 5); the slow line is then 92 x n / 5 for n = 1 to 5.
TEST(StochCompute, SlowSmoothingFromTheFirstBarAfterK) {
    store::ChartSeries s;
    for (int c = 10; c <= 30; ++c) {
        store::ChartBar b;
        b.Open = b.Close = static_cast<float>(c);
        b.High = b.Close + 1.0f;
        b.Low = b.Close - 1.5f;
        s.ChartBars.push_back(b);
    }
    s.LastBar = static_cast<std::int16_t>(s.ChartBars.size() - 1);
    const StochResult r = ComputeStochFX(s, 10, 5, true, 4);
    EXPECT_FALSE(r.slowd[10]);
    EXPECT_EQ(*r.d[11], 92);
    const std::vector<std::int32_t> expected{18, 37, 55, 74, 92, 92};
    for (std::size_t j = 0; j < expected.size(); ++j)
        EXPECT_EQ(*r.slowd[11 + j], expected[j]) << 11 + j;
}

// The window's high starts at 0 and its low at 100000, and those take part: on a closes-only
// series of negative totals -20, -40, -76, -18 (K 2, D 2) the high stays 0.
//   bar 3: window -20 -40 -76: Hi 0 Lo -76, close -76 -> %K 0, ring (0, 76)
//   bar 4: window -40 -76 -18: Hi 0 Lo -76 -> 58 / 76 -> %K 76; %D 58 / 152 -> 38
TEST(StochCompute, StartingHighAndLowTakePart) {
    const auto bars = CloseBars({-10, -20, -40, -76, -18});
    const StochResult r = ComputeStochFX(bars, 2, 2, false, 3);
    EXPECT_EQ(*r.k[3], 0);
    EXPECT_EQ(*r.k[4], 76);
    EXPECT_EQ(*r.d[4], 38);
    // A window of prices above 100000 keeps its low at 100000 in the same way.
    const auto high = CloseBars({200000, 200000, 200200, 200100}); // 100100 / 100200
    EXPECT_EQ(*ComputeStochFX(high, 2, 0, false, 3).k[3], 100);
}

// A window with no range: %K = (close - low) x 100 = 0, and %D the same by 100 x DiffSum.
TEST(StochCompute, FlatWindowAndShortCharts) {
    const auto flat = CloseBars({5, 5, 5, 5});
    const StochResult r = ComputeStochFX(flat, 1, 2, false, 4);
    EXPECT_EQ(*r.k[2], 0);
    EXPECT_EQ(*r.d[3], 0);
    EXPECT_EQ(Computed(ComputeStochFX(flat, 3, 2, false, 4).k), 0); // no bar above K
    EXPECT_EQ(Computed(ComputeStochFX(flat, 0, 2, false, 4).k), 0);
}

// P = 3: %R = (Hi - close) / (Hi - Lo) x 100 over bars i-2..i, zeros skipped, from bar P
// (bar 2's window is full, but the routine starts one bar later).
//   bars (H L C): 10 8 9 | 12 9 11 | 11 10 10 | 13 11 12 | 0 0 12
//   i=3: Hi 13 Lo 9: 1/4 -> 25
//   i=4: bar 4's zeros skipped, Hi 13 Lo 10: 1/3 -> 33.33
TEST(WilliamsCompute, RawPercentOfTheWindow) {
    const auto bars = HlcBars({{10, 8, 9}, {12, 9, 11}, {11, 10, 10}, {13, 11, 12}, {0, 0, 12}});
    const auto r = ComputeWilliams(bars, 3, 4).r;
    EXPECT_FALSE(r[2]);
    EXPECT_FLOAT_EQ(*r[3], 25.0f);
    EXPECT_NEAR(*r[4], 33.3333f, 1e-4);
    // Closes only: i=3 closes 11 10 12 -> (12-12)/2 -> 0; highs and lows 1 play no part in
    // closes 9 12 10 11: i=3 -> (12-11)/2 -> 50.
    EXPECT_FLOAT_EQ(*ComputeWilliams(bars, 3, 2).r[3], 0.0f);
    const auto closes = HlcBars({{1, 1, 9}, {1, 1, 12}, {1, 1, 10}, {1, 1, 11}});
    EXPECT_FLOAT_EQ(*ComputeWilliams(closes, 3, 2).r[3], 50.0f);
}

TEST(WilliamsCompute, WindowsWithoutRangeAreSkipped) {
    const auto bars = HlcBars({{10, 8, 9}, {12, 9, 11}, {11, 10, 10}});
    EXPECT_EQ(Computed(ComputeWilliams(bars, 1, 3).r), 0); // one close: no range
    EXPECT_EQ(Computed(ComputeWilliams(bars, 1, 4).r), 2); // one bar's high and low, from bar 1
    EXPECT_EQ(Computed(ComputeWilliams(bars, 4, 4).r), 0);
    EXPECT_EQ(Computed(ComputeWilliams(CloseBars({4, 4, 4}), 2, 4).r), 0);
}
