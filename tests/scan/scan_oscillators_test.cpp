#include "osc/rsi.h"
#include "scan/scan_oscillators.h"

#include <gtest/gtest.h>

#include <random>

using namespace kori::scan;

namespace {

// Bars whose high and low stand at the close, held from bar 0.
DailyTail Bars(std::vector<float> closes) {
    DailyTail t;
    t.BarCount = static_cast<int>(closes.size());
    t.High = t.Low = closes;
    t.Volume.assign(closes.size(), 1000);
    t.Close = std::move(closes);
    return t;
}

std::string IndicationOf(ScanOsc osc, std::vector<float> closes, int period) {
    const OscReading r = ReadOscillator(osc, Bars(std::move(closes)), period, false);
    if (r.Outcome != OscOutcome::Positions) return "(none)";
    return std::string(Indication(r.Positions));
}

} // namespace

TEST(ScanIndication, EachRowOfTheTableOnItsBorders) {
    // OB line 47, OS line 96 (the stochastic's); a smaller position is a higher value.
    auto ind = [](int cur, int prev) { return std::string(Indication({cur, prev, 47, 96})); };
    EXPECT_EQ(ind(47, 48), "Cut OB UP");
    EXPECT_EQ(ind(47, 47), "OB");
    EXPECT_EQ(ind(96, 95), "Cut OS DN");
    EXPECT_EQ(ind(96, 96), "OS");
    EXPECT_EQ(ind(48, 47), "Cut OB DN");
    EXPECT_EQ(ind(95, 96), "Cut OS UP");
    EXPECT_EQ(ind(48, 95), "");
}

TEST(ScanIndication, KeptOnlyWhenABoxAsksForIt) {
    const IndicationChoice ob{true, false, false, false}, cutOB{false, false, true, false};
    const IndicationChoice os{false, true, false, false}, cutOS{false, false, false, true};
    EXPECT_TRUE(Kept("Cut OB UP", ob));
    EXPECT_TRUE(Kept("Cut OB UP", cutOB));
    EXPECT_TRUE(Kept("OB", ob));
    EXPECT_FALSE(Kept("OB", cutOB));
    EXPECT_TRUE(Kept("Cut OS DN", os));
    EXPECT_TRUE(Kept("Cut OS DN", cutOS));
    EXPECT_FALSE(Kept("OS", cutOS));
    EXPECT_FALSE(Kept("Cut OB DN", ob));
    EXPECT_TRUE(Kept("Cut OB DN", cutOB));
    EXPECT_FALSE(Kept("Cut OS UP", os));
    EXPECT_TRUE(Kept("Cut OS UP", cutOS));
}

TEST(ScanStochastic, EveryIndicationFromHandWorkedWindows) {
    // K = 2: windows of three bars; v 100 stands at 22, 50 at 72, 0 at 121.
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 10, 20, 15, 20}, 2), "Cut OB UP");
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 10, 10, 20, 20}, 2), "OB");
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 10, 20, 15, 10}, 2), "Cut OS DN");
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {20, 20, 20, 20, 10, 10}, 2), "OS");
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 10, 10, 20, 15}, 2), "Cut OB DN");
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {20, 20, 20, 20, 10, 15}, 2), "Cut OS UP");
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 10, 20, 15, 17.5f}, 2), "");
    // No range: v = 100 x (close - Lo) = 0, so a flat market reads oversold.
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 10, 10, 10, 10}, 2), "OS");
    // The bar before the last must be above K.
    EXPECT_EQ(IndicationOf(ScanOsc::Stochastic, {10, 10, 20, 20}, 2), "(none)");
}

TEST(ScanStochastic, LinesAndPositionsAsTheTableGivesThem) {
    const auto r = ReadOscillator(ScanOsc::Stochastic, Bars({10, 10, 10, 20, 15, 20}), 2, false);
    ASSERT_EQ(r.Outcome, OscOutcome::Positions);
    EXPECT_EQ(r.Positions.OBLine, 47);
    EXPECT_EQ(r.Positions.OSLine, 96);
    EXPECT_EQ(r.Positions.Cur, 22);  // round(121 - 99)
    EXPECT_EQ(r.Positions.Prev, 72); // round(121 - 49.5), half to even
}

TEST(ScanStochastic, UsesHighsAndLowsOfBarsButClosesOfLines) {
    DailyTail t = Bars({10, 10, 10, 10, 10, 15});
    t.High = {10, 10, 10, 20, 10, 15};
    // With bars: window 3..5 has Hi 20, Lo 10 and close 15: v 50 (72); bar 4 window 2..4:
    // v 0 (121). As a close-only series the high of 20 is not seen: Hi 15, v 100.
    auto r = ReadOscillator(ScanOsc::Stochastic, t, 2, false);
    EXPECT_EQ(r.Positions.Cur, 72);
    EXPECT_EQ(Indication(r.Positions), "Cut OS UP");
    r = ReadOscillator(ScanOsc::Stochastic, t, 2, true);
    EXPECT_EQ(r.Positions.Cur, 22);
}

TEST(ScanWilliams, MeanOfThreePositionsAndBarsWithoutRangePassedOver) {
    // P = 2: a close up gives R 0 (13), down R 100 (131). Positions 131, 13, 13, 13: the mean
    // goes from 52 to 13.
    EXPECT_EQ(IndicationOf(ScanOsc::Williams, {10, 11, 10, 11, 12, 13}, 2), "Cut OB UP");
    // A last bar without range adds nothing: both means are 13.
    EXPECT_EQ(IndicationOf(ScanOsc::Williams, {10, 11, 10, 11, 12, 13, 13}, 2), "OB");
    // 13, 131, 131, 131: from 92 to 131, over the line at 119.
    EXPECT_EQ(IndicationOf(ScanOsc::Williams, {10, 11, 12, 11, 10, 9}, 2), "Cut OS DN");
    // Fewer than three positions before the last bar: nothing to say.
    EXPECT_EQ(IndicationOf(ScanOsc::Williams, {10, 11, 12, 13}, 2), "(none)");
    EXPECT_EQ(IndicationOf(ScanOsc::Williams, {10, 11, 10, 11, 12, 13}, 0), "(none)");
    const auto r = ReadOscillator(ScanOsc::Williams, Bars({10, 11, 10, 11, 12, 13}), 2, false);
    EXPECT_EQ(r.Positions.OBLine, 25);
    EXPECT_EQ(r.Positions.OSLine, 119);
}

TEST(ScanRateOfChange, SymmetricScaleFromTheExtremes) {
    // P = 1: values 0, 0, 0, 50; Hi 50 and Lo -50 after the scale is made symmetric.
    const auto r = ReadOscillator(ScanOsc::ROC, Bars({10, 10, 10, 10, 20}), 1, false);
    ASSERT_EQ(r.Outcome, OscOutcome::Positions);
    EXPECT_EQ(r.Positions.Cur, 13);     // round(131 - 100 x 1.18)
    EXPECT_EQ(r.Positions.Prev, 72);    // round(131 - 50 x 1.18)
    EXPECT_EQ(r.Positions.OBLine, 25);  // value 40: round(131 - 90 x 1.18)
    EXPECT_EQ(r.Positions.OSLine, 119); // value -40
    EXPECT_EQ(Indication(r.Positions), "Cut OB UP");
    // A fall of the whole: -100 of the current close.
    EXPECT_EQ(IndicationOf(ScanOsc::ROC, {20, 20, 20, 20, 10}, 1), "Cut OS DN");
    // A flat market: Hi and Lo 0, no unit, no indication.
    EXPECT_EQ(IndicationOf(ScanOsc::ROC, {20, 20, 20, 20, 20}, 1), "(none)");
    EXPECT_EQ(IndicationOf(ScanOsc::ROC, {10, 10, 10, 10, 20}, 0), "(none)");
}

TEST(ScanRateOfChange, ReachesBackToTheFirstBarOfTheFile) {
    DailyTail t = Bars({10, 10, 10, 10, 20});
    t.First = 1;
    t.BarCount = 6;
    EXPECT_EQ(ReadOscillator(ScanOsc::ROC, t, 1, false).Outcome, OscOutcome::NeedMore);
}

TEST(ScanMomentum, ChangeInCentsOnTheRocPeriod) {
    // P = 3: the first bar counts 0, the next is +10 x 100: the top of the scale.
    EXPECT_EQ(IndicationOf(ScanOsc::MM, {10, 20, 30, 30, 30}, 3), "Cut OB UP");
    // P = 1 over the same closes: 1000 two bars back, then 0, 0: both at 72.
    EXPECT_EQ(IndicationOf(ScanOsc::MM, {10, 20, 30, 30, 30}, 1), "");
}

TEST(ScanRsi, FigureOfTheWindowBeforeTheBarHeldWithoutAFall) {
    // P = 3: two pairs a window. Bar 3: a fall of 0.1 only, RSI 0 (131); bar 4: fall 0.1 and
    // rise 2.1, RS 21, RSI 95.45 (17).
    EXPECT_EQ(IndicationOf(ScanOsc::RSI, {10, 10, 9.9f, 12, 14}, 3), "Cut OB UP");
    // Bar 3: RSI 95.45 (17); bar 4: rise 2.1, fall 4, RSI 34.43 (90).
    EXPECT_EQ(IndicationOf(ScanOsc::RSI, {10, 9.9f, 12, 8, 7}, 3), "Cut OB DN");
    // RSI 50 (72) at bar 3, then windows of rises only keep it: no indication, not 100.
    EXPECT_EQ(IndicationOf(ScanOsc::RSI, {10, 9, 10, 11, 12, 13}, 3), "");
    // Falls only: RSI 0 twice.
    EXPECT_EQ(IndicationOf(ScanOsc::RSI, {10, 10, 10.1f, 8, 7, 6}, 3), "OS");
    // No window with a fall at all: no figure.
    EXPECT_EQ(IndicationOf(ScanOsc::RSI, {10, 11, 12, 13, 14, 15}, 3), "(none)");
    const auto r = ReadOscillator(ScanOsc::RSI, Bars({10, 10, 9.9f, 12, 14}), 3, false);
    EXPECT_EQ(r.Positions.OBLine, 48);
    EXPECT_EQ(r.Positions.OSLine, 95);
}

TEST(ScanRsi, PeriodZeroMeansTwentyOne) {
    std::vector<float> closes;
    for (int i = 0; i < 22; ++i)
        closes.push_back(i % 2 ? 10.0f : 9.0f);
    // 22 bars: enough for P = 3, not for the bar before the last with P = 21.
    EXPECT_NE(IndicationOf(ScanOsc::RSI, closes, 3), "(none)");
    EXPECT_EQ(IndicationOf(ScanOsc::RSI, closes, 0), "(none)");
    closes.push_back(10);
    EXPECT_NE(IndicationOf(ScanOsc::RSI, closes, 0), "(none)");
}

TEST(ScanRsi, WindowFigureIsTheChartsFigure) {
    std::mt19937 rng(7);
    std::uniform_real_distribution<float> step(-0.5f, 0.5f);
    kori::store::ChartSeries s;
    std::vector<float> closes;
    float c = 10;
    for (int i = 0; i < 300; ++i) {
        c = std::max(0.0f, c + step(rng));
        if (i % 37 == 5) c = 0; // a no-trade close now and then
        kori::store::ChartBar b;
        b.Close = c;
        s.ChartBars.push_back(b);
        closes.push_back(c);
        if (c == 0) c = 10;
    }
    s.LastBar = 299;
    const auto chart = kori::osc::ComputeRSI(s, 14);
    for (std::size_t i = 14; i < closes.size(); ++i) {
        const auto f = kori::osc::RsiWindowFigure(closes, 14, i);
        if (f) EXPECT_EQ(*f, *chart.rsi[i]) << "bar " << i;
    }
}
