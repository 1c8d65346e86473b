#include "store/load_chart_series.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <cmath>
#include <fstream>
#include <gtest/gtest.h>
#include <limits>

using namespace kori::store;
using kori::test::Bytes;
using kori::test::Day;

namespace {
ChartSeries Load(const std::vector<PriceRecord>& records, char period, int first = 1,
                 std::int16_t type = 4, bool volume = true) {
    ChartSeries s;
    SeriesRequest q;
    q.FirstRecord = static_cast<std::int16_t>(first);
    q.LastRecord = static_cast<std::int16_t>(records.size());
    q.Period = period;
    q.RecordType = type;
    q.WantVolume = volume;
    const std::vector<PriceRecord> window(records.begin() + (first - 1), records.end());
    EXPECT_TRUE(LoadChartSeriesFromBytes(Bytes(window), q, "T.WDT", s).ok());
    return s;
}
} // namespace

TEST(LoadChartSeries, DailyNoTradeRecordsFollowTheBarIndexAgainstTheFirstRecord) {
    const std::vector<PriceRecord> recs = {
        Day("20261102", 10, 11, 9, 10, 100, 0.5f), Day("20261103", 0, 0, 0, 0, 0),
        Day("20261104", 0, 0, 0, 0, 0), Day("20261105", 11, 0, 0, 11.5f, 300)};
    const auto s = Load(recs, 'A');
    ASSERT_EQ(s.LastBar, 3);
    EXPECT_EQ(s.ChartBars[0].Note, 1) << "an adjusted record is noted by its number";
    // Index 1 is not above first record 1: the zero record stands as it is, date and all.
    EXPECT_EQ(s.ChartBars[1].DateText(), "20261103");
    EXPECT_EQ(s.ChartBars[1].Close, 0);
    // Index 2 is: it takes the previous bar's close (0 here) and a blank date.
    EXPECT_EQ(s.ChartBars[2].DateText(), "        ");
    EXPECT_EQ(s.ChartBars[2].Close, 0);
    // No high on a type 4 record: open, high and low take the close.
    EXPECT_EQ(s.ChartBars[3].High, 11.5f);
    EXPECT_EQ(s.ChartBars[3].Low, 11.5f);
    EXPECT_EQ(s.Results.HighestPrice, 11.5f);
    EXPECT_EQ(s.Results.LowestPrice, 9.0f);
    EXPECT_EQ(s.Results.AverageVolume, 200);
    EXPECT_TRUE(s.Results.VolumesPresent);
}

TEST(LoadChartSeries, DailyNoTradeCopiesThePreviousClose) {
    const std::vector<PriceRecord> recs = {Day("20261102", 10, 11, 9, 10, 100),
                                           Day("20261103", 11, 12, 10, 11, 100),
                                           Day("20261104", 0, 0, 0, 0, 0)};
    const auto s = Load(recs, 'A');
    EXPECT_EQ(s.ChartBars[2].Open, 11);
    EXPECT_EQ(s.ChartBars[2].Low, 11);
    EXPECT_EQ(s.ChartBars[2].Volume, 0);
}

TEST(LoadChartSeries, WeeksRollByWeekdayAndAZeroCloseEndsOnTheLastGoodClose) {
    const std::vector<PriceRecord> recs = {
        Day("20261102", 10, 12, 9, 11, 100),     // Mon
        Day("20261103", 11, 13, 10, 12, 200),    // Tue
        Day("20261104", 12, 12.5f, 11, 12, 300), // Wed
        Day("20261109", 12, 14, 11.5f, 13, 400), // Mon: weekday fell, new week
        Day("20261116", 13, 15, 12, 0, 0)};      // Mon again: no fall, same bar
    const auto s = Load(recs, 'W');
    ASSERT_EQ(s.LastBar, 1);
    const auto& w1 = s.ChartBars[0];
    EXPECT_EQ(w1.DateText(), "20261104");
    EXPECT_EQ(w1.Open, 10);
    EXPECT_EQ(w1.High, 13);
    EXPECT_EQ(w1.Low, 9);
    EXPECT_EQ(w1.Close, 12);
    EXPECT_EQ(w1.Volume, 600);
    const auto& w2 = s.ChartBars[1];
    EXPECT_EQ(w2.DateText(), "20261116") << "date of the record read at the flush";
    EXPECT_EQ(w2.Open, 12);
    EXPECT_EQ(w2.High, 15);
    EXPECT_EQ(w2.Low, 11.5f);
    EXPECT_EQ(w2.Close, 13) << "the last non-zero close";
    EXPECT_EQ(w2.Volume, 400);
    EXPECT_EQ(s.Results.HighestPrice, 15);
    EXPECT_EQ(s.Results.LowestVolume, 400);
    EXPECT_EQ(s.Results.HighestVolume, 600);
    EXPECT_EQ(s.Results.AverageVolume, 500);
}

TEST(LoadChartSeries, OneRecordGivesOneBarInEveryPeriod) {
    const std::vector<PriceRecord> recs = {Day("20261102", 10, 12, 9, 11, 100)};
    for (char p : {'A', 'W', 'M'})
        EXPECT_EQ(Load(recs, p).LastBar, 0) << p;
}

TEST(LoadChartSeries, MonthsRollByKeyWithVolumesInHundreds) {
    const std::vector<PriceRecord> recs = {
        Day("20261029", 10, 11, 9, 10, 150), Day("20261030", 10, 12, 9, 11, 250),
        Day("20261102", 11, 12, 10, 11, 50), Day("20261103", 11, 13, 10, 12, 99)};
    const auto s = Load(recs, 'M');
    ASSERT_EQ(s.LastBar, 1);
    EXPECT_EQ(s.ChartBars[0].Volume, 3) << "150/100 + 250/100, each truncated";
    EXPECT_EQ(s.ChartBars[1].Volume, 0) << "days below 100 sum to nothing";
    EXPECT_EQ(s.ChartBars[1].High, 13);
    // Only one bar has a volume: the flat rule applies.
    EXPECT_EQ(s.Results.LowestVolume, 1);
    EXPECT_EQ(s.Results.HighestVolume, 9);
    EXPECT_EQ(s.Results.AverageVolume, 9);
}

TEST(LoadChartSeries, FlatVolumesAndUnwantedVolumes) {
    const std::vector<PriceRecord> recs = {Day("20261102", 10, 12, 9, 11, 1000),
                                           Day("20261103", 10, 12, 9, 11, 1000)};
    auto s = Load(recs, 'A');
    EXPECT_EQ(s.Results.LowestVolume, 1);
    EXPECT_EQ(s.Results.HighestVolume, 3000);
    EXPECT_EQ(s.Results.AverageVolume, 3000);
    EXPECT_TRUE(s.Results.VolumesPresent);
    s = Load(recs, 'A', 1, 4, false);
    EXPECT_EQ(s.Results.HighestVolume, 0);
    EXPECT_FALSE(s.Results.VolumesPresent);
}

TEST(LoadChartSeries, AdvanceDeclineSeriesTakesTheCloseOnly) {
    const std::vector<PriceRecord> recs = {Day("20261102", 0, 300, 200, 100, 0),
                                           Day("20261103", 0, 250, 260, 90, 0)};
    const auto s = Load(recs, 'W', 1, 3);
    ASSERT_EQ(s.LastBar, 0);
    EXPECT_EQ(s.ChartBars[0].High, 90);
    EXPECT_EQ(s.ChartBars[0].Close, 90);
    EXPECT_EQ(s.Results.HighestPrice, 90) << "the bar's high is the period close";
}

TEST(LoadChartSeries, AWeeklyLoadOverABadDateIsAClearErrorAndUnknownPeriodsLoadNothing) {
    const std::vector<PriceRecord> recs = {Day("20261102", 10, 12, 9, 11, 100),
                                           Day("2026x103", 10, 12, 9, 11, 100)};
    ChartSeries s;
    SeriesRequest q{1, 2, 'W', true, 4};
    const auto st = LoadChartSeriesFromBytes(Bytes(recs), q, "BAD.WDT", s);
    ASSERT_FALSE(st.ok());
    EXPECT_NE(st.message().find("Record 2 of BAD.WDT"), std::string::npos) << st.message();
    q.Period = 'X';
    EXPECT_TRUE(LoadChartSeriesFromBytes(Bytes(recs), q, "BAD.WDT", s).ok());
    EXPECT_EQ(s.LastBar, -1);
}

TEST(PriceFile, CountIgnoresARemainderAndRefusesMoreThan32767Records) {
    kori::test::TempRoot root;
    const auto bytes = Bytes({Day("20261102", 10, 12, 9, 11, 100)});
    root.Write("ABC.wdt", bytes + "xyz");
    PriceFile f(PriceFile::PathFor(root.folder(), "ABC"));
    ASSERT_TRUE(f.Open().ok());
    EXPECT_EQ(f.Count(), 1);
    EXPECT_EQ(f.path().filename(), "ABC.wdt") << "found whatever its case";

    const auto big = root.path() / "BIG.WDT";
    { std::ofstream out(big); }
    std::filesystem::resize_file(big, 32768ull * 50);
    PriceFile b(big);
    const auto st = b.Open();
    ASSERT_FALSE(st.ok());
    EXPECT_NE(st.message().find("32767"), std::string::npos);
}

TEST(PriceFile, AppendsInOrderWithNoGaps) {
    kori::test::TempRoot root;
    PriceFile f(PriceFile::PathFor(root.folder(), "XYZ"));
    ASSERT_TRUE(f.Open().ok());
    EXPECT_EQ(f.Count(), 0) << "opening creates the file empty";
    ASSERT_TRUE(f.Append(Day("20261104", 1, 1, 1, 3, 0)).ok());
    ASSERT_TRUE(f.Append(Day("20261102", 1, 1, 1, 1, 0)).ok());
    ASSERT_TRUE(f.Append(Day("20261103", 1, 1, 1, 2, 0)).ok());
    std::vector<PriceRecord> all;
    ASSERT_TRUE(f.ReadAll(all).ok());
    ASSERT_EQ(all.size(), 3u);
    EXPECT_EQ(all[0].Close, 3);
    EXPECT_EQ(all[2].Close, 2);
    EXPECT_FALSE(f.Write(5, all[0]).ok()) << "no gaps";
}

TEST(LoadChartSeries, APriceThatIsNoNumberIsReportedAndReadAsNoTrade) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const float inf = std::numeric_limits<float>::infinity();
    const std::vector<PriceRecord> recs = {
        Day("20261102", 10, 11, 9, 10, 100), Day("20261103", 10, inf, 9, 10, 100),
        Day("20261104", 10, 12, 9, nan, 100), Day("20261105", 11, 12, 10, 11, 100)};
    ChartSeries s;
    SeriesRequest q;
    q.FirstRecord = 5;
    q.LastRecord = 8;
    ASSERT_TRUE(LoadChartSeriesFromBytes(Bytes(recs), q, "KRM.WDT", s).ok());
    ASSERT_EQ(s.Issues.size(), 2u);
    EXPECT_EQ(s.Issues[0].file, "KRM.WDT");
    EXPECT_EQ(s.Issues[0].record, 6);
    EXPECT_EQ(s.Issues[1].record, 7);
    // Read as no-trade records (this early in the window their bars keep the zero close), and
    // the scale never sees the bad values.
    EXPECT_EQ(s.ChartBars[1].Close, 0);
    EXPECT_EQ(s.ChartBars[2].High, 0);
    EXPECT_EQ(s.Results.HighestPrice, 12);
    for (const auto& b : s.ChartBars)
        EXPECT_TRUE(std::isfinite(b.High) && std::isfinite(b.Close));
}

TEST(LoadChartSeries, RecordRangesAreCheckedBeforeTheyAreNarrowed) {
    SeriesRequest q;
    auto st = SetRecordRange(q, 1, 65537, 1500, "KRM.WDT");
    EXPECT_FALSE(st.ok());
    EXPECT_EQ(st.message(), "Records 1 to 65537 are not in KRM.WDT (1 to 1500)");
    EXPECT_FALSE(SetRecordRange(q, 65536 + 5, 0, 1500, "KRM.WDT").ok());
    EXPECT_FALSE(SetRecordRange(q, 0, 10, 1500, "KRM.WDT").ok());
    EXPECT_FALSE(SetRecordRange(q, 20, 10, 1500, "KRM.WDT").ok());
    ASSERT_TRUE(SetRecordRange(q, 3, 0, 1500, "KRM.WDT").ok());
    EXPECT_EQ(q.FirstRecord, 3);
    EXPECT_EQ(q.LastRecord, 1500);
}

TEST(PriceFile, OpenWithDataNamesTheTrueReason) {
    kori::test::TempRoot root;
    const auto path = PriceFile::PathFor(root.folder(), "KRM");
    EXPECT_EQ(PriceFile(path).OpenWithData().message(), "No Data for KRM.WDT");
    root.Write("KRM.WDT", "");
    EXPECT_EQ(PriceFile(path).OpenWithData().message(), "No Data for KRM.WDT");
    root.Write("KRM.WDT", std::string(50 * 32768, '\0'));
    EXPECT_EQ(PriceFile(path).OpenWithData().message(),
              "KRM.WDT holds 32768 records; a file can hold at most 32767.");
}
