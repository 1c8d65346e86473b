#include "maint/data_check.h"

#include "store/name_file.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <cstdio>

#include <cmath>
#include <limits>

namespace kori::maint {
namespace {

using store::NameRecord;
using store::PriceRecord;
using test::Day;

NameRecord Security(const char* code, int type = 4) {
    NameRecord n;
    n.Code = store::PadCode(code);
    n.Name = std::string("Name of ") + code;
    n.RecordType = static_cast<std::int16_t>(type);
    return n;
}

std::vector<std::string> Whats(const std::vector<Finding>& found) {
    std::vector<std::string> w;
    for (const auto& f : found)
        w.push_back(std::to_string(f.Record) + " " + f.What);
    return w;
}

TEST(WeekdaysBetween, CountsMondayToFridayStrictlyBetween) {
    EXPECT_EQ(WeekdaysBetween("20261120", "20261123"), 0); // Friday to Monday
    EXPECT_EQ(WeekdaysBetween("20261116", "20261120"), 3); // Monday to Friday: Tue, Wed, Thu
    EXPECT_EQ(WeekdaysBetween("20261113", "20261123"), 5); // a whole week between
    EXPECT_EQ(WeekdaysBetween("20261121", "20261122"), 0); // Saturday to Sunday
    EXPECT_EQ(WeekdaysBetween("20261123", "20261120"), 0); // wrong order
    EXPECT_EQ(WeekdaysBetween("2026112X", "20261120"), 0);
}

TEST(CheckHistory, ASoundHistoryHasNoFindings) {
    const std::vector<PriceRecord> recs = {Day("20261119", 10, 11, 9, 10.5f, 1000),
                                           Day("20261120", 10.5f, 10.5f, 10.5f, 10.5f, 1000),
                                           Day("20261123", 0, 0, 0, 0, 0)}; // no trade
    EXPECT_TRUE(CheckHistory(Security("ABC"), recs, {}).empty());
}

TEST(CheckHistory, DatesOutOfOrderDuplicatedWeekendAndNotADate) {
    const std::vector<PriceRecord> recs = {
        Day("20261118", 10, 11, 9, 10, 1000), Day("20261120", 10, 11, 9, 10, 1000),
        Day("20261119", 10, 11, 9, 10, 1000), // out of order: Thursday after Friday
        Day("20261120", 10, 11, 9, 10, 1000), // the Friday again
        Day("20261121", 10, 11, 9, 10, 1000), // Saturday
        Day("2026-11-", 10, 11, 9, 10, 1000)};
    const auto found = CheckHistory(Security("ABC"), recs, {});
    EXPECT_EQ(Whats(found), (std::vector<std::string>{"3 " + std::string(finding::OutOfOrder),
                                                      "4 " + std::string(finding::Duplicated),
                                                      "5 " + std::string(finding::Weekend),
                                                      "6 " + std::string(finding::NotADate)}));
    EXPECT_EQ(found[0].Detail, "after 20/11/2026");
    EXPECT_EQ(found[1].Detail, "also record 2");
    EXPECT_EQ(found[2].Detail, "Saturday");
    EXPECT_EQ(found[0].Code, "ABC");
    EXPECT_EQ(found[0].Name, "Name of ABC");
}

TEST(CheckHistory, PricesOfATradedDay) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const std::vector<PriceRecord> recs = {
        Day("20261116", 10, 9, 11, 10, 1000),   // high below low
        Day("20261117", 12, 12, 9, 9.5f, 1000), // fine
        Day("20261118", 13, 12, 9, 9.5f, 1000), // open above the high
        Day("20261119", 10, 12, 9, 8.5f, 1000), // close below the low
        Day("20261120", 0, 12, 9, 10, 1000),    // open 0 on a traded day
        Day("20261123", 10, nan, 9, 10, 1000),  // not a number
        Day("20261124", 10, 11, 9, 10, -5)};    // negative volume
    const auto found = CheckHistory(Security("ABC"), recs, {});
    EXPECT_EQ(
        Whats(found),
        (std::vector<std::string>{
            "1 " + std::string(finding::HighBelowLow), "3 " + std::string(finding::OpenOutside),
            "4 " + std::string(finding::CloseOutside), "5 " + std::string(finding::ZeroPrice),
            "6 " + std::string(finding::NotANumber), "7 " + std::string(finding::NegativeVolume)}));
    EXPECT_EQ(found[0].Detail, "9.00 < 11.00");
    EXPECT_EQ(found[1].Detail, "13.00 not in 9.00 - 12.00");
}

TEST(CheckHistory, CloseOnlyAndSignedSeriesAreNotHeldToBars) {
    // An index of closes only carries no open, high or low; an advance-decline line goes negative.
    const std::vector<PriceRecord> index = {Day("20261119", 0, 0, 0, 5000, 1000),
                                            Day("20261120", 0, 0, 0, 5010, 1000)};
    EXPECT_TRUE(CheckHistory(Security("XAO", 1), index, {}).empty());
    const std::vector<PriceRecord> ad = {Day("20261119", 0, 0, 0, -40, 1000),
                                         Day("20261120", 0, 0, 0, -900, 1000)};
    EXPECT_TRUE(CheckHistory(Security("ADV", 3), ad, {}).empty());
}

TEST(CheckHistory, GapBeyondTheSetting) {
    DataCheckSettings s;
    s.GapWeekdays = 3;
    const std::vector<PriceRecord> recs = {Day("20261102", 10, 11, 9, 10, 1000),  // Monday
                                           Day("20261106", 10, 11, 9, 10, 1000),  // 3 between: fine
                                           Day("20261113", 10, 11, 9, 10, 1000)}; // 4 between
    const auto found = CheckHistory(Security("ABC"), recs, s);
    ASSERT_EQ(Whats(found), (std::vector<std::string>{"3 " + std::string(finding::Gap)}));
    EXPECT_EQ(found[0].Detail, "4 weekdays without a record since 06/11/2026");
}

TEST(CheckHistory, AMoveBeyondTheSettingWithoutAnAdjustmentNearIt) {
    // 10 to 5 is -50 %; a factor two records away explains it, three away does not.
    auto history = [](int adjustedAt) {
        std::vector<PriceRecord> recs;
        const char* dates[] = {"20261102", "20261103", "20261104", "20261105",
                               "20261106", "20261109", "20261110", "20261111"};
        for (int i = 0; i < 8; ++i) {
            const float c = i < 4 ? 10.0f : 5.0f;
            recs.push_back(Day(dates[i], c, c, c, c, 1000, i == adjustedAt ? 0.5f : 0.0f));
        }
        return recs;
    };
    const auto unexplained = CheckHistory(Security("ABC"), history(-1), {});
    ASSERT_EQ(Whats(unexplained),
              (std::vector<std::string>{"5 " + std::string(finding::MissedAdjustment)}));
    EXPECT_EQ(unexplained[0].Detail, "-50.0% from 10.00 to 5.00");
    EXPECT_TRUE(CheckHistory(Security("ABC"), history(6), {}).empty());
    EXPECT_TRUE(CheckHistory(Security("ABC"), history(2), {}).empty());
    EXPECT_EQ(CheckHistory(Security("ABC"), history(1), {}).size(), 1u);
    // A day without trade between does not hide the move, and the setting moves the line.
    auto recs = history(-1);
    recs[4].Close = 0;
    EXPECT_EQ(Whats(CheckHistory(Security("ABC"), recs, {})),
              (std::vector<std::string>{"6 " + std::string(finding::MissedAdjustment)}));
    DataCheckSettings loose;
    loose.MoveAlertPercent = 50;
    EXPECT_TRUE(CheckHistory(Security("ABC"), history(-1), loose).empty());
}

TEST(StoppedTrading, CountsWeekdaysBehindTheLatest) {
    DataCheckSettings s;
    s.StoppedWeekdays = 5;
    // Friday 13th to Friday 20th: five weekdays behind, not more than five.
    EXPECT_TRUE(StoppedTrading(Security("ABC"), "20261113", 9, "20261120", s).empty());
    const auto found = StoppedTrading(Security("ABC"), "20261112", 9, "20261120", s);
    ASSERT_EQ(found.size(), 1u);
    EXPECT_EQ(found[0].What, finding::Stopped);
    EXPECT_EQ(found[0].Record, 9);
    EXPECT_EQ(found[0].Detail, "last record 6 weekdays before 20/11/2026");
}

class CheckLibraryTest : public testing::Test {
protected:
    void Add(const char* code, const std::vector<PriceRecord>& recs, int type = 4) {
        store::NameFile names(store::NameFile::PathIn(root.folder()));
        ASSERT_TRUE(names.Open());
        ASSERT_TRUE(names.Append(Security(code, type)));
        store::PriceFile file(root.path() / (std::string(code) + ".WDT"));
        ASSERT_TRUE(file.WriteAll(recs));
    }
    test::TempRoot root;
    platform::NullProgress progress;
};

TEST_F(CheckLibraryTest, ReportsEverySecurityWithTheLatestDateOfAll) {
    Add("AAA", {Day("20261119", 10, 11, 9, 10, 1000), Day("20261120", 10, 9, 11, 10, 1000)});
    Add("BBB", {Day("20261030", 10, 11, 9, 10, 1000)}); // stopped three weeks before
    Add("CCC", {Day("20261120", 10, 11, 9, 10, 1000)});
    root.Write("DDD.WDT", std::string(75, 'x')); // one record of letters and half another
    {
        store::NameFile names(store::NameFile::PathIn(root.folder()));
        ASSERT_TRUE(names.Open());
        ASSERT_TRUE(names.Append(Security("DDD")));
        ASSERT_TRUE(names.Append(Security("EEE"))); // no price file at all
    }
    const auto result = CheckLibrary({root.folder(), 0}, {}, progress);
    ASSERT_TRUE(result.Status);
    EXPECT_EQ(result.LatestDate, "20261120");
    EXPECT_EQ(result.Checked, 4);
    std::vector<std::string> rows;
    for (const auto& f : result.Findings)
        rows.push_back(f.Code + " " + f.What);
    EXPECT_EQ(rows, (std::vector<std::string>{"AAA " + std::string(finding::HighBelowLow),
                                              "BBB " + std::string(finding::Stopped),
                                              "DDD " + std::string(finding::NotADate),
                                              "DDD " + std::string(finding::Damaged),
                                              "EEE " + std::string(finding::Damaged)}))
        << FindingsCsv(result.Findings);
}

TEST_F(CheckLibraryTest, CancelKeepsWhatWasFound) {
    // Both cores check; a cancel early in the walk keeps the histories already checked, in
    // the walk's order. The other thread may, on a starved machine, finish the walk before the
    // cancel is seen; then the report is whole and not marked cancelled.
    constexpr int kCount = 300;
    for (int i = 0; i < kCount; ++i) {
        char code[8];
        std::snprintf(code, sizeof code, "C%03d", i);
        Add(code, {Day("20261120", 10, 9, 11, 10, 1000)}); // high below low
    }
    struct CancelEarly : platform::NullProgress {
        void SetValue(long long v) override {
            if (v >= 2) RequestCancel();
        }
    } cancelling;
    const auto result = CheckLibrary({root.folder(), 0}, {}, cancelling);
    ASSERT_GE(result.Findings.size(), 1u);
    for (std::size_t i = 1; i < result.Findings.size(); ++i)
        EXPECT_LT(result.Findings[i - 1].Code, result.Findings[i].Code);
    if (result.Cancelled)
        EXPECT_LT(result.Findings.size(), static_cast<std::size_t>(kCount));
    else
        EXPECT_EQ(result.Findings.size(), static_cast<std::size_t>(kCount));
}

TEST(FindingsCsv, QuotesFieldsThatNeedIt) {
    const std::vector<Finding> f = {{"ABC", "Smith, Jones \"Ltd\"", "20261120", 3, "What", "d"}};
    EXPECT_EQ(FindingsCsv(f), "Code,Name,Date,Record,Finding,Detail\n"
                              "ABC,\"Smith, Jones \"\"Ltd\"\"\",20261120,3,What,d\n");
}

TEST(DataCheckSettings, KeptInTheWindowStoreWithDefaultsForNonsense) {
    test::TempRoot root;
    platform::SettingsStore store(root.path() / "settings.ini");
    EXPECT_EQ(LoadDataCheckSettings(store).GapWeekdays, 10);
    SaveDataCheckSettings(store, {4, 7, 22.5});
    const auto s = LoadDataCheckSettings(store);
    EXPECT_EQ(s.GapWeekdays, 4);
    EXPECT_EQ(s.StoppedWeekdays, 7);
    EXPECT_DOUBLE_EQ(s.MoveAlertPercent, 22.5);
    store.Save("Data Check Gap Weekdays", "lots");
    EXPECT_EQ(LoadDataCheckSettings(store).GapWeekdays, 10);
}

} // namespace
} // namespace kori::maint
