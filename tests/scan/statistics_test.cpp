#include "platform/files.h"
#include "scan/statistics.h"
#include "scan_rig.h"

#include <gtest/gtest.h>

using namespace kori::scan;
using kori::test::RecordingProgress;
using kori::test::RigSecurity;
using kori::test::TempRoot;
using kori::test::WriteRig;

namespace {

RigSecurity Moved(const char* code, float prev, float last, std::int32_t volume = 500) {
    RigSecurity s{code, {prev, last}};
    s.Volumes = {500, volume};
    return s;
}

std::vector<std::string> CodesOf(const std::vector<MoverRow>& rows) {
    std::vector<std::string> out;
    for (const auto& r : rows)
        out.push_back(r.Code);
    return out;
}

} // namespace

TEST(MarketStatistics, CountersAndMoversOfTheLastDay) {
    TempRoot root;
    WriteRig(root, {Moved("UPA", 1.00f, 1.10f),      // +10%
                    Moved("UPB", 2.00f, 3.00f),      // +50%
                    Moved("DNA", 4.00f, 3.00f),      // -25%
                    Moved("DNB", 1.00f, 0.99f),      // -1%
                    Moved("FLAT", 1.00f, 1.00f),     // steady
                    Moved("IDLE", 1.00f, 2.00f, 1),  // volume 1: untraded, prices aside
                    Moved("NEW", 0.00f, 1.00f),      // a rise from 0: counted, no row
                    {"ONE", {1.0f}},                 // one record: nothing counted
                    Moved("UPAWOA", 1.00f, 1.20f)}); // a warrant, +20%
    MarketStatistics stats;
    RecordingProgress progress;
    ASSERT_TRUE(stats.Check(root.folder(), "ALL", progress).ok());
    const auto& c = stats.Counters();
    EXPECT_EQ(c.Rises, 4);
    EXPECT_EQ(c.Falls, 2);
    EXPECT_EQ(c.Steady, 1);
    EXPECT_EQ(c.Traded, 7);
    EXPECT_EQ(c.Untraded, 1);
    // Greatest rise at the top, greatest fall at the end.
    EXPECT_EQ(CodesOf(stats.Movers()),
              (std::vector<std::string>{"UPB", "UPAWOA", "UPA", "DNB", "DNA"}));
    const MoverRow& top = stats.Movers().front();
    EXPECT_DOUBLE_EQ(top.Percent, 0.5);
    EXPECT_EQ(top.Latest, "3.00");
    EXPECT_EQ(top.Previous, "2.00");
    EXPECT_EQ(top.Name, "Name of UPB");
    EXPECT_DOUBLE_EQ(stats.Movers().back().Percent, -0.25);
    EXPECT_EQ(progress.statuses,
              (std::vector<std::string>{"Checking Statistics", "SORTING STATISTICS", "COMPLETED"}));

    ASSERT_TRUE(stats.Check(root.folder(), "NW", progress).ok());
    EXPECT_EQ(CodesOf(stats.Movers()), (std::vector<std::string>{"UPB", "UPA", "DNB", "DNA"}));
    ASSERT_TRUE(stats.Check(root.folder(), "WO", progress).ok());
    EXPECT_EQ(CodesOf(stats.Movers()), (std::vector<std::string>{"UPAWOA"}));
    EXPECT_EQ(stats.Counters().Traded, 1);
}

TEST(MarketStatistics, DisplayBlocksAreCutToTheMoversAndNeedNoNewWalk) {
    TempRoot root;
    WriteRig(root, {Moved("AAA", 1.0f, 1.1f), Moved("BBB", 1.0f, 0.8f), Moved("CCC", 1.0f, 1.3f)});
    MarketStatistics stats;
    RecordingProgress progress;
    ASSERT_TRUE(stats.Check(root.folder(), "ALL", progress).ok());
    std::filesystem::remove_all(root.path()); // "&Update Statistics" reads no file
    auto d = stats.Display("");               // empty: 20, cut to the 3 movers
    EXPECT_EQ(d.TopCount, 3);
    EXPECT_EQ(CodesOf(d.Rises), (std::vector<std::string>{"CCC", "AAA", "BBB"}));
    EXPECT_EQ(CodesOf(d.Falls), (std::vector<std::string>{"BBB", "AAA", "CCC"}));
    d = stats.Display("1");
    EXPECT_EQ(CodesOf(d.Rises), (std::vector<std::string>{"CCC"}));
    EXPECT_EQ(CodesOf(d.Falls), (std::vector<std::string>{"BBB"}));
}

TEST(MarketStatistics, NoNameFile) {
    TempRoot root;
    MarketStatistics stats;
    RecordingProgress progress;
    const auto s = stats.Check(root.folder(), "ALL", progress);
    EXPECT_EQ(s.message(), "There is no Name File ");
    EXPECT_FALSE(stats.HasRows());
}

TEST(MarketStatistics, ShellSortOrdersByValueNotByText) {
    std::vector<MoverRow> rows;
    for (double p : {0.05, -0.5, 0.125, 1.5, -0.0625, 0.3, 10.0, -2.0})
        rows.push_back({"X", "", p, "", ""});
    SortMovers(rows);
    std::vector<double> got;
    for (const auto& r : rows)
        got.push_back(r.Percent);
    EXPECT_EQ(got, (std::vector<double>{10.0, 1.5, 0.3, 0.125, 0.05, -0.0625, -0.5, -2.0}));
    EXPECT_EQ(PercentKey(0.125).size(), 12u);
}

TEST(ADTotals, RecomputedFromTheBaseTwiceGivesTheSameFile) {
    TempRoot root;
    RigSecurity ad{"ADV", {1050, 0, 7}, 3};
    ad.Highs = {400, 300, 250}; // advances
    ad.Lows = {350, 320, 200};  // declines
    WriteRig(root, {ad});
    const auto file = root.path() / "ADV.WDT";
    double base = 0;
    ASSERT_TRUE(ADBaseValue(file, base).ok());
    EXPECT_DOUBLE_EQ(base, 1000); // 1050 + 350 - 400
    std::int32_t total = 0;
    ASSERT_TRUE(CheckADTotals(file, base, total).ok());
    EXPECT_EQ(total, 1080); // 1000 + 50 - 20 + 50
    std::vector<kori::store::PriceRecord> recs;
    ASSERT_TRUE(kori::store::PriceFile(file).ReadAll(recs).ok());
    EXPECT_FLOAT_EQ(recs[0].Close, 1050);
    EXPECT_FLOAT_EQ(recs[1].Close, 1030);
    EXPECT_FLOAT_EQ(recs[2].Close, 1080);
    EXPECT_FLOAT_EQ(recs[1].Open, 0);
    const std::string once = root.Read("ADV.WDT");
    ASSERT_TRUE(ADBaseValue(file, base).ok());
    ASSERT_TRUE(CheckADTotals(file, base, total).ok());
    EXPECT_EQ(root.Read("ADV.WDT"), once);
    EXPECT_EQ(ADCheckedMessage(file, total), " Checked ADV.WDT\nCumulative Total at end is 1080");
}

TEST(ADTotals, EmptyFileAndAFailedWriteLeaveTheFileAsItWas) {
    TempRoot root;
    root.Write("ADV.WDT", "");
    double base = 0;
    EXPECT_EQ(ADBaseValue(root.path() / "ADV.WDT", base).message(),
              "There are no records for ADV.WDT");
    RigSecurity ad{"ADX", {10, 20}, 3};
    ad.Highs = {5, 5};
    ad.Lows = {1, 1};
    WriteRig(root, {ad});
    const std::string before = root.Read("ADX.WDT");
    std::int32_t total = 0;
    {
        kori::platform::ScopedWriteFailure fail(30);
        EXPECT_FALSE(CheckADTotals(root.path() / "ADX.WDT", 0, total).ok());
    }
    EXPECT_EQ(root.Read("ADX.WDT"), before);
    EXPECT_EQ(AdvanceDeclineCodes(root.folder()), (std::vector<std::string>{"ADX"}));
}
