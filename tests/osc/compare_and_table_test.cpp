// RMO and RMX against a comparison file, Jones Holy Grail, and the one entry point.
#include "osc/compare_osc.h"
#include "osc/osc_compute.h"
#include "osc/stoch_fx.h"
#include "osc/williams_holy_grail.h"
#include "osc_test_bars.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori;
using namespace kori::osc;
using test::CloseBars;

namespace {
template <class T> int Computed(const Series<T>& s) {
    int n = 0;
    for (const auto& v : s)
        n += v.has_value();
    return n;
}
int Computed(const OscTable& t) {
    int n = 0;
    for (const auto& v : t.values)
        n += v.has_value();
    return n;
}
} // namespace

// Walked from the end: security closes 1 2 0 4 5, comparison 100 200 300 800 (shorter).
//   entry 4: 800 / 500 = 1.6; entry 3: 300 / 400 = .75; entry 2: close 0, skipped;
//   entry 1: 100 / 200 = .5; entry 0: the comparison has run out.
//   P = 2 over the ratios taken: entry 3 (.5 + .75) / 2 - .75 = -.125;
//   entry 4 (.75 + 1.6) / 2 - 1.6 = -.425
TEST(RmoCompute, WalksBackFromTheEndAndSkipsZeroRatios) {
    const auto security = CloseBars({1, 2, 0, 4, 5});
    const auto reference = CloseBars({100, 200, 300, 800});
    const auto all = ComputeRMO(security, reference, 2, 1, 5).value;
    EXPECT_EQ(Computed(all), 2);
    EXPECT_FLOAT_EQ(*all[3], -0.125f);
    EXPECT_FLOAT_EQ(*all[4], -0.425f);
    // A chart from record 3 shows entries 2 to 4 as its bars 0 to 2.
    const auto shown = ComputeRMO(security, reference, 2, 3, 3).value;
    EXPECT_FALSE(shown[0]);
    EXPECT_FLOAT_EQ(*shown[1], -0.125f);
    EXPECT_FLOAT_EQ(*shown[2], -0.425f);
    EXPECT_EQ(Computed(ComputeRMO(security, reference, 4, 1, 5).value), 0);
    EXPECT_EQ(Computed(ComputeRMO(security, reference, 0, 1, 5).value), 0);
}

// Chart closes 2 4 5 8 (LastBar 3), comparison 10 20 100 200 0 400: records 3 to 6 go with
// bars 0 to 3. Ratios .5 .5 0 .5 (a zero reference is still a ratio).
//   bar 1: mean .5 - .5 = 0 (at the mean: the middle); bar 2: .25 - 0; bar 3: .25 - .5
TEST(RmxCompute, PairsTheLastComparisonRecordsWithTheBars) {
    const auto chart = CloseBars({2, 4, 5, 8});
    const auto r = ComputeRMX(chart, CloseBars({10, 20, 100, 200, 0, 400}), 2).value;
    EXPECT_FALSE(r[0]);
    EXPECT_FLOAT_EQ(*r[1], 0.0f);
    EXPECT_FLOAT_EQ(*r[2], 0.25f);
    EXPECT_FLOAT_EQ(*r[3], -0.25f);
    // A comparison shorter than the chart pairs from its first record with bar 0:
    // 200/200 = 1, 400/400 = 1 -> bar 1: 0; bars 2 and 3 have no record.
    const auto shorter = ComputeRMX(chart, CloseBars({200, 400}), 2).value;
    EXPECT_EQ(Computed(shorter), 1);
    EXPECT_FLOAT_EQ(*shorter[1], 0.0f);
    // A zero close on the chart drops its step: bar 3 then rings with bars 0 and 1.
    auto gap = chart;
    gap.ChartBars[2].Close = 0;
    const auto g = ComputeRMX(gap, CloseBars({10, 20, 100, 200, 300, 400}), 2).value;
    EXPECT_FALSE(g[2]);
    EXPECT_FLOAT_EQ(*g[3], 0.0f);
}

TEST(CompareFile, CodeFromAFolderPathEndingInWdt) {
    test::TempRoot root;
    root.Write("sub/xao.wdt", "x");
    root.Write("sub/XJO.txt", "x");
    const std::string dosPath = root.path().string() + "\\sub\\XAO.WDT";
    const CompareFile found = ResolveCompareFile(dosPath);
    EXPECT_EQ(found.CompareCode, "XAO");
    EXPECT_EQ(found.Path, root.path() / "sub" / "xao.wdt");
    EXPECT_EQ(ResolveCompareFile((root.path() / "sub/XJO.txt").string()).CompareCode, "");

    platform::ScriptedDialogs dialogs;
    EXPECT_EQ(ResolveCompareFile((root.path() / "sub/NONE.WDT").string(), dialogs).CompareCode, "");
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].title, "RMX/RMO Compare file");
    EXPECT_EQ(dialogs.shown()[0].text,
              "RMX/RMO Compare file path/file details are invalid. Reset details in Chart "
              "Defaults available from the Chart Select window");

    // A file that exists but is named without a folder gives no code.
    const auto cwd = std::filesystem::current_path();
    std::filesystem::current_path(root.path() / "sub");
    const std::string code = ResolveCompareFile("xao.wdt").CompareCode;
    std::filesystem::current_path(cwd);
    EXPECT_EQ(code, "");
}

// P = 2, closes 3 6 9 6 3 6; 3-bar means from bar 2: 6 7 6 5.
//   col0: 3 6 (closes: no mean yet), 3 -1 -3 1
//   col1 from bar 1: 4.5 4.5 1 -2 -1        col2 from bar 2: 4.5 2.75 -.5 -1.5
TEST(HolyGrailCompute, DetrendedCloseAndItsMeans) {
    const HolyGrailResult r = ComputeHolyGrail(CloseBars({3, 6, 9, 6, 3, 6}), 2);
    const float col0[] = {3, 6, 3, -1, -3, 1};
    for (std::size_t i = 0; i < 6; ++i)
        EXPECT_FLOAT_EQ(*r.col0[i], col0[i]) << i;
    EXPECT_FALSE(r.col1[0]);
    const float col1[] = {4.5f, 4.5f, 1, -2, -1};
    for (std::size_t i = 1; i < 6; ++i)
        EXPECT_FLOAT_EQ(*r.col1[i], col1[i - 1]) << i;
    EXPECT_FALSE(r.col2[1]);
    const float col2[] = {4.5f, 2.75f, -0.5f, -1.5f};
    for (std::size_t i = 2; i < 6; ++i)
        EXPECT_FLOAT_EQ(*r.col2[i], col2[i - 2]) << i;
    EXPECT_EQ(Computed(ComputeHolyGrail(CloseBars({3, 6, 9, 6, 3, 6}), 5).col0), 0);
}

TEST(ComputeOscillator, ColumnsPeriodsAndIdentifiers) {
    const auto bars = CloseBars({10, 11, 12, 11, 13, 12, 14, 15, 13, 12, 14, 16});
    OscDef def;
    def.StochK = 2;
    def.StochD = 2;
    def.FXFW = 3;
    def.FXXW = 1;
    def.RocPW = 2;
    OscInputs in;
    in.SlowStochastic = true;

    const auto sto = ComputeOscillator("STO", bars, def, in);
    ASSERT_TRUE(sto);
    EXPECT_EQ(sto->columns, (std::vector<std::string>{"k", "d", "slowd"}));
    ASSERT_EQ(sto->RowCount(), 12u);
    const StochResult direct = ComputeStochFX(bars, 2, 2, true, 4);
    EXPECT_EQ(sto->Row(5)[2], std::optional<double>(*direct.slowd[5]));

    in.ChartPeriod = "W";
    const auto rf = ComputeOscillator("R/F", bars, def, in); // weekly keys, FX always fast
    ASSERT_TRUE(rf);
    EXPECT_EQ(rf->columns, (std::vector<std::string>{"roc", "k", "d"}));
    EXPECT_EQ(rf->Row(11)[1], std::optional<double>(*ComputeStochFX(bars, 3, 1, false, 4).k[11]));
    EXPECT_TRUE(rf->Row(3)[0]);

    // MACD stops on a daily key of 0 even on a weekly chart; an unknown period code has none.
    def.Md1W = 2, def.Md2W = 3, def.Md3W = 2;
    EXPECT_EQ(Computed(*ComputeOscillator("MACD", bars, def, in)), 0);
    def.Md1 = 12, def.Md2 = 26, def.Md3 = 9;
    EXPECT_GT(Computed(*ComputeOscillator("MACD", bars, def, in)), 0);
    in.ChartPeriod = "Q";
    EXPECT_EQ(OscPeriodsFor(def, "MACD", "Q"), (std::vector<std::int16_t>{0, 0, 0}));
    EXPECT_EQ(Computed(*ComputeOscillator("MACD", bars, def, in)), 0);

    // Unset periods compute nothing but keep a row a bar; OBV has no period.
    in.ChartPeriod = "A";
    const auto rsi = ComputeOscillator("RSI", bars, def, in);
    EXPECT_EQ(rsi->RowCount(), 12u);
    EXPECT_EQ(Computed(*rsi), 0);
    EXPECT_EQ(ComputeOscillator("OBV", bars, def, in)->columns[0], "obv");
    EXPECT_FALSE(ComputeOscillator("PARA", bars, def, in));

    // RMO and RMX without a comparison series compute nothing.
    def.RmxP = 2;
    EXPECT_EQ(Computed(*ComputeOscillator("RMX", bars, def, in)), 0);
    const auto reference = CloseBars({5, 5, 5, 5, 5, 5, 5, 5, 5, 5, 5, 5});
    in.CompareFile = &reference;
    EXPECT_EQ(Computed(*ComputeOscillator("RMX", bars, def, in)), 11);
}
