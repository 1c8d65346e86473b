#include "chart/overlays.h"
#include "chart/parabolic.h"
#include "chart_test_rig.h"

#include <algorithm>

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {

// Bars whose closes stand at the given y on the rig's scale; high and low 1 either side.
void AddCloses(ChartRig& r, const std::vector<int>& ys) {
    int day = 1;
    for (int y : ys) {
        const float c = ChartRig::P(y);
        r.Add("202403" + std::string(day < 10 ? "0" : "") + std::to_string(day), c, c + 1, c - 1,
              c);
        ++day;
    }
}

// Stream lines ending in palette entry `entry`.
std::vector<std::string> InEntry(const std::vector<std::string>& lines, char letter, int entry) {
    std::vector<std::string> out;
    const std::string tail = ", " + std::to_string(entry);
    for (const auto& l : lines)
        if (!l.empty() && l[0] == letter && l.size() > tail.size() &&
            l.compare(l.size() - tail.size(), tail.size(), tail) == 0)
            out.push_back(l);
    return out;
}

} // namespace

TEST(Averages, SimpleAndExponentialOnTheCloseY) {
    {
        // Period 3: mean of 900, 890, 880 is 890 at bar 2 (x 25), then 880 at bar 3 (x 35).
        ChartRig r;
        r.request.AvOne = true;
        r.defaults.MAPeriod1Daily = 3;
        AddCloses(r, {900, 890, 880, 870});
        ASSERT_TRUE(r.Build().ok());
        EXPECT_EQ(InEntry(r.Lines(), 'L', pal::Average1),
                  (std::vector<std::string>{"L, 25, 890, 35, 880, 20"}));
    }
    {
        // Exponential, k = 0.5: seeded with 890, then 861 x 0.5 + 890 x 0.5 = 875.5, held as
        // 876; the next step starts from the rounded 876: 861 x 0.5 + 876 x 0.5 = 868.5 -> 868.
        ChartRig r;
        r.request.AvOne = true;
        r.defaults.MAPeriod1Daily = 3;
        r.defaults.MAExponential = true;
        AddCloses(r, {900, 890, 880, 861, 861});
        ASSERT_TRUE(r.Build().ok());
        EXPECT_EQ(InEntry(r.Lines(), 'L', pal::Average1),
                  (std::vector<std::string>{"L, 25, 890, 35, 876, 20", "L, 35, 876, 45, 868, 20"}));
    }
    {
        // Average 2 streams heavy ("H"); an average longer than the bars draws nothing.
        ChartRig r;
        r.request.AvOne = r.request.AvTwo = true;
        r.defaults.MAPeriod1Daily = 10;
        r.defaults.MAPeriod2Daily = 2;
        AddCloses(r, {900, 880, 860});
        ASSERT_TRUE(r.Build().ok());
        EXPECT_TRUE(InEntry(r.Lines(), 'L', pal::Average1).empty());
        EXPECT_EQ(InEntry(r.Lines(), 'H', pal::Average2),
                  (std::vector<std::string>{"H, 15, 890, 25, 870, 21"}));
    }
}

TEST(Averages, SelectionByMMAAndOscillator) {
    {
        // Multiple averages replace the two; periods out of 1 to 500 are skipped.
        ChartRig r;
        r.request.AvOne = true;
        r.request.MMAOn = true;
        r.defaults.MAPeriod1Daily = 2;
        r.defaults.MMAPeriods = {2, 0, 600, 50, 50, 50, 3, 50, 50, 50, 50, 50};
        AddCloses(r, {900, 880, 860});
        ASSERT_TRUE(r.Build().ok());
        EXPECT_TRUE(InEntry(r.Lines(), 'L', pal::Average1).empty());
        EXPECT_EQ(InEntry(r.Lines(), 'L', pal::MMAShort),
                  (std::vector<std::string>{"L, 15, 890, 25, 870, 43"}));
        EXPECT_TRUE(InEntry(r.Lines(), 'L', pal::MMALong).empty()); // period 3 starts at bar 2
    }
    for (const char* osc : {"PARA", "MACD"}) {
        ChartRig r;
        r.request.AvOne = true;
        r.request.AutoOsc = true;
        r.request.AutoOscCode = osc;
        r.defaults.ClassicMACD = false;
        r.defaults.MAPeriod1Daily = 2;
        AddCloses(r, {900, 880, 860});
        ASSERT_TRUE(r.Build().ok());
        EXPECT_TRUE(InEntry(r.Lines(), 'L', pal::Average1).empty()) << osc;
    }
}

TEST(Bands, PercentBandsOverwriteAZeroClose) {
    ChartRig r;
    r.request.ChartBands = 1;
    for (int d = 1; d <= 11; ++d)
        r.Add("202403" + std::string(d < 10 ? "0" : "") + std::to_string(d), 50, 51, 49,
              d == 5 ? 0.0f : 50.0f);
    ASSERT_TRUE(r.Build().ok());
    // The zero close took the close before it, and stays so for later readers.
    EXPECT_EQ(r.chart.ChartBars()[4].Close, 50);
    // Mean 50 over ten closes: 52.5 (y 525) and 47.5 (y 575); first point at bar 9 less 1.
    EXPECT_EQ(InEntry(r.Lines(), 'L', pal::Bands),
              (std::vector<std::string>{"L, 94, 525, 105, 525, 41", "L, 94, 575, 105, 575, 41"}));
    // Dotted on the screen.
    EXPECT_TRUE(HasRun(r.Calls(), {"Style dot", "Line 94,525,105,525 #41"}));
}

TEST(Bands, BollingerPopulationDeviation) {
    ChartRig r;
    r.request.ChartBands = 2;
    r.defaults.BollingerDaily = 2;
    r.Add("20240301", 40, 41, 39, 40);
    r.Add("20240302", 50, 51, 49, 50);
    r.Add("20240303", 50, 51, 49, 50);
    ASSERT_TRUE(r.Build().ok());
    // 40 and 50: mean 45, deviation sqrt(25) x 2 = 10: 55 (y 500) and 35 (y 700); then 50, 50.
    EXPECT_EQ(InEntry(r.Lines(), 'L', pal::Bands),
              (std::vector<std::string>{"L, 14, 500, 25, 550, 41", "L, 14, 700, 25, 550, 41"}));
    ChartDefaults d;
    d.BollingerDaily = 0;
    d.BollingerLong = 100;
    EXPECT_EQ(BollingerPeriod(d, 'A'), 21);
    EXPECT_EQ(BollingerPeriod(d, 'W'), 100);
}

TEST(Parabolic, RisesTowardsTheBarsHighThenFlips) {
    const std::vector<ParabolicBar> bars = {{10, 9},      {11, 10},   {12, 11},  {13, 12},
                                            {12.5, 11.5}, {9.2, 8.0}, {8.5, 7.5}};
    const auto pts = ComputeParabolic(bars);
    // Four new highs settle "U" at bar 3; the walk starts at the low bar 0 with stop 9.
    ASSERT_EQ(pts.size(), 6u);
    EXPECT_EQ(pts[0].Bar, 1);
    EXPECT_NEAR(pts[0].Stop, 9.04, 1e-9);
    EXPECT_NEAR(pts[1].Stop, 9.1584, 1e-9);
    EXPECT_NEAR(pts[2].Stop, 9.388896, 1e-9);
    // Towards the bar's high 12.5, not the extreme 13.
    EXPECT_NEAR(pts[3].Stop, 9.388896 + (12.5 - 9.388896) * 0.08, 1e-9);
    EXPECT_EQ(pts[3].Direction, 'U');
    // The high 9.2 falls below the stop: down from the extreme 13.
    EXPECT_EQ(pts[4].Direction, 'D');
    EXPECT_NEAR(pts[4].Stop, 13, 1e-9);
    EXPECT_NEAR(pts[5].Stop, 13 + (7.5 - 13) * 0.02, 1e-9);
    EXPECT_EQ(ParabolicStopText(0.15), "0.150");
    EXPECT_EQ(ParabolicStopText(1.5), "1.50");
}

TEST(Parabolic, TooFewBarsDrawNothing) {
    EXPECT_TRUE(ComputeParabolic({}).empty());
    EXPECT_TRUE(ComputeParabolic({{10, 9}}).empty());
    ChartRig r;
    r.request.AutoOsc = true;
    r.request.AutoOscCode = "PARA";
    AddCloses(r, {900});
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(Starting(r.Lines(), "K,").empty());
}

TEST(Parabolic, DotsAndLastStopOnTheChart) {
    ChartRig r;
    r.request.AutoOsc = true;
    r.request.AutoOscCode = "PARA";
    const std::vector<std::pair<float, float>> hl = {
        {50, 40}, {52, 42}, {54, 44}, {56, 46}, {58, 48}};
    int d = 1;
    for (auto [h, l] : hl)
        r.Add("2024030" + std::to_string(d++), l, h, l, h - 1);
    ASSERT_TRUE(r.Build().ok());
    // Stop 40 + (52 - 40) x 0.02 = 40.24 at bar 1: y = 950 - 302.4 -> 648 (rounded by the map).
    const auto k = Starting(r.Lines(), "K,");
    ASSERT_EQ(k.size(), 4u);
    EXPECT_EQ(k[0], "K, 15, 648, 38");
    const auto t = Starting(r.Lines(), "T, 8.25, ");
    EXPECT_TRUE(std::any_of(t.begin(), t.end(), [](const std::string& l) {
        return l.find("Parabolic last stop : ") != std::string::npos && l.ends_with(", 45");
    }));
}
