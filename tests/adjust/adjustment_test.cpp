// Adjustments worked out by hand: the factor of each issue, the choice of the day, the rewrite
// of a history and of its notes and trendlines, and the removal of the latest adjustment.
#include "adjust/adjustment.h"

#include "platform/files.h"
#include "store/price_file.h"
#include "store/store_builders.h"
#include "store/trendline_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <cstdio>

namespace kori::adjust {
namespace {

using platform::Money;
using store::PriceRecord;
using test::Day;

Money M(double v) {
    return *Money::FromDouble(v);
}

Factor FactorOf(AdjustmentTerms t, float close) {
    platform::Status why;
    const auto f = WorkOutFactor(t, close, why);
    EXPECT_TRUE(f) << why.message();
    return f.value_or(Factor{-1, ""});
}

TEST(WorkOutFactor, EachKindOfIssue) {
    // Bonus 1 for 4: 4 / 5.
    auto f = FactorOf({AdjType::Bonus, 1, 4, {}, {}}, 2.5f);
    EXPECT_EQ(f.Value, 0.8f);
    EXPECT_EQ(f.Note, "bi1:4");
    // Split 2 new for 1 old: 1 / 2.
    f = FactorOf({AdjType::Split, 2, 1, {}, {}}, 2.5f);
    EXPECT_EQ(f.Value, 0.5f);
    EXPECT_EQ(f.Note, "ss2:1");
    // Cash 1 for 4 at 2.00 on a close of 2.50: T = (2 + 10) / 5 = 2.4, factor 2.4 / 2.5.
    f = FactorOf({AdjType::Cash, 1, 4, M(2), {}}, 2.5f);
    EXPECT_EQ(f.Value, 0.96f);
    EXPECT_EQ(f.Note, "ci1:4 @ 2");
    // Priced at the close: nothing moves.
    f = FactorOf({AdjType::Cash, 1, 4, M(2.5), {}}, 2.5f);
    EXPECT_EQ(f.Value, 1.0f);
    // Call of 25 cents on 2.50: 0.1 + 1.
    f = FactorOf({AdjType::Call, 0, 0, {}, M(0.25)}, 2.5f);
    EXPECT_EQ(f.Value, 1.1f);
    EXPECT_EQ(f.Note, "cl0.25");
    // Dividend of 12.5 cents on 2.50: 1 - 0.05.
    f = FactorOf({AdjType::Dividend, 0, 0, {}, M(0.125)}, 2.5f);
    EXPECT_EQ(f.Value, 0.95f);
    EXPECT_EQ(f.Note, "dv0.125");
    // A dividend equal to the close leaves nothing.
    f = FactorOf({AdjType::Dividend, 0, 0, {}, M(2.5)}, 2.5f);
    EXPECT_EQ(f.Value, 0.0f);
}

TEST(WorkOutFactor, SixDecimalsThroughASingle) {
    // 2 / 3 is held as "0.666667" read back.
    EXPECT_EQ(FactorOf({AdjType::Bonus, 1, 2, {}, {}}, 1).Value, 0.666667f);
    EXPECT_EQ(FactorOf({AdjType::Bonus, 1.5f, 2, {}, {}}, 1).Note, "bi1.5:2");
    // 1 / 7 = 0.142857142... -> 0.142857; 6 / 7 = 0.857142857... -> 0.857143.
    EXPECT_EQ(SixDecimalFactor(1.0 / 7), 0.142857f);
    EXPECT_EQ(SixDecimalFactor(6.0 / 7), 0.857143f);
}

TEST(WorkOutFactor, MissingInputsAndImpossibleFactorsAreRefused) {
    platform::Status why;
    for (const AdjustmentTerms& t : {AdjustmentTerms{AdjType::Bonus, 1, 0, {}, {}},
                                     AdjustmentTerms{AdjType::Bonus, 0, 4, {}, {}},
                                     AdjustmentTerms{AdjType::Split, 0, 1, {}, {}},
                                     AdjustmentTerms{AdjType::Cash, 1, 4, {}, {}},
                                     AdjustmentTerms{AdjType::Call, 0, 0, {}, {}},
                                     AdjustmentTerms{AdjType::Dividend, 0, 0, {}, {}}}) {
        EXPECT_FALSE(WorkOutFactor(t, 2.5f, why));
        EXPECT_EQ(why.message(), "Data incomplete");
    }
    // No close to work from.
    EXPECT_FALSE(WorkOutFactor({AdjType::Dividend, 0, 0, {}, M(0.1)}, 0, why));
    EXPECT_EQ(why.message(), "Data incomplete");
    // A dividend above the close would make prices negative.
    EXPECT_FALSE(WorkOutFactor({AdjType::Dividend, 0, 0, {}, M(3)}, 2.5f, why));
    EXPECT_NE(why.message().find("below 0"), std::string::npos);
}

TEST(AdjustmentTexts, NotesAndReadOuts) {
    EXPECT_EQ(MoneyText(M(12)), "12");
    EXPECT_EQ(MoneyText(M(0.0005)), "0.0005");
    EXPECT_EQ(MoneyText(M(-1.25)), "-1.25");
    EXPECT_EQ(BonusRatioText("1", "4"), "Ratio of Bonus Issue is 1:4");
    EXPECT_EQ(CashRatioText("1", "4", "2.1"), "Ratio = 1:4 @ 2.1");
    EXPECT_EQ(AdjustmentsMadeText("KRM "), "Adjustments made to\nKRM");
    EXPECT_EQ(TypeOf("ss"), AdjType::Split);
    EXPECT_FALSE(TypeOf("R"));
}

// A data folder with one price history and a chart-notes folder.
struct History : ::testing::Test {
    test::TempRoot root;
    std::string data, misc;

    void SetUp() override {
        std::filesystem::create_directories(root.path() / "data");
        std::filesystem::create_directories(root.path() / "misc");
        data = root.folder() + "data/";
        misc = root.folder() + "misc/";
    }
    std::filesystem::path File() const { return root.path() / "data" / "KRM.WDT"; }
    void Write(const std::vector<PriceRecord>& records) const {
        ASSERT_TRUE(platform::WriteFileAtomic(File(), test::Bytes(records)).ok());
    }
    std::vector<PriceRecord> Read() const {
        store::PriceFile f(File());
        std::vector<PriceRecord> out;
        EXPECT_TRUE(f.ReadAll(out).ok());
        return out;
    }
    std::string Raw() const { return *platform::ReadWholeFile(File()); }
    AdjustmentJob Job(int record, float factor, std::string note) const {
        AdjustmentJob j;
        j.DataFolder = data;
        j.ChtMiscFolder = misc;
        j.Code = "KRM";
        j.AdjRecord = record;
        j.AdjFactor = factor;
        j.AdjNote = std::move(note);
        j.NoteColour = "255";
        return j;
    }
    // Records 1..n, a day apart in January 2024 (dates 20240101 + i), close 2.5, volume 1000.
    static std::vector<PriceRecord> Plain(int n) {
        std::vector<PriceRecord> r;
        for (int i = 1; i <= n; ++i) {
            char date[9];
            std::snprintf(date, sizeof date, "2024%02d%02d", 1 + (i - 1) / 28, 1 + (i - 1) % 28);
            r.push_back(Day(date, 2.5f, 2.5f, 2.5f, 2.5f, 1000));
        }
        return r;
    }
};

TEST_F(History, ApplyScalesUpToTheChosenRecordAndNotesOnlyIt) {
    auto days = Plain(5);
    days[2] = Day("20240103", 1.0f, 0, 0, 0, 500); // a no-trade record: left out
    Write(days);
    Applied applied;
    ASSERT_TRUE(ApplyAdjustment(Job(4, 0.8f, "bi1:4"), applied).ok());
    EXPECT_EQ(applied.Date, "20240104");
    EXPECT_EQ(applied.RecordsScaled, 3);
    const auto r = Read();
    for (int i : {0, 1, 3}) {
        EXPECT_EQ(r[i].Open, 2.0f);
        EXPECT_EQ(r[i].High, 2.0f);
        EXPECT_EQ(r[i].Low, 2.0f);
        EXPECT_EQ(r[i].Close, 2.0f);
        EXPECT_EQ(r[i].Volume, 800);
    }
    EXPECT_EQ(r[2].Open, 1.0f);
    EXPECT_EQ(r[2].Volume, 500);
    EXPECT_EQ(r[4].Close, 2.5f);
    EXPECT_EQ(r[4].Volume, 1000);
    EXPECT_EQ(r[3].AdjFactor, 0.8f);
    EXPECT_EQ(r[3].AdjDesc, "bi1:4         ");
    for (int i : {0, 1, 2, 4}) {
        EXPECT_EQ(r[i].AdjFactor, 0.0f);
        EXPECT_EQ(r[i].AdjDesc, std::string(14, ' '));
    }
    EXPECT_EQ(test::FilesIn(root.path() / "data"), std::vector<std::string>{"KRM.WDT"});
}

TEST_F(History, PricesAndVolumesRoundHalvesToEven) {
    Write({Day("20240102", 0.0625f, 0.1875f, 0.0625f, 0.0625f, 5),
           Day("20240103", 0.1875f, 0.1875f, 0.1875f, 0.1875f, 7)});
    Applied applied;
    ASSERT_TRUE(ApplyAdjustment(Job(2, 0.5f, "ss2:1"), applied).ok());
    const auto r = Read();
    // 0.03125 -> 0.0312, 0.09375 -> 0.0938; 2.5 -> 2, 3.5 -> 4.
    EXPECT_EQ(r[0].Open, 0.0312f);
    EXPECT_EQ(r[0].High, 0.0938f);
    EXPECT_EQ(r[1].Close, 0.0938f);
    EXPECT_EQ(r[0].Volume, 2);
    EXPECT_EQ(r[1].Volume, 4);
}

TEST_F(History, ApplyThenRemoveLeavesRoundingAndScaledVolumes) {
    auto days = Plain(4);
    days[0] = Day("20240101", 0.155f, 0.155f, 0.155f, 0.155f, 3000);
    days[1] = Day("20240102", 1.0f, 0, 0, 0, 100); // no trade: skipped by apply, not by remove
    Write(days);
    Applied applied;
    // Bonus 1 for 2.
    ASSERT_TRUE(ApplyAdjustment(Job(3, 0.666667f, "bi1:2"), applied).ok());
    auto r = Read();
    EXPECT_EQ(r[0].Close, 0.1033f);
    EXPECT_EQ(r[0].Volume, 2000);
    EXPECT_EQ(r[2].Close, 1.6667f);

    Removed removed;
    ASSERT_TRUE(RemoveLatestAdjustment(data, "KRM", removed).ok());
    EXPECT_EQ(removed.Entries, 1);
    EXPECT_EQ(removed.Record, 3);
    EXPECT_EQ(removed.Factor, 0.666667f);
    r = Read();
    // 0.1033 x 1.4999993 = 0.15495 -> 0.1549; 1.6667 x 1.4999993 -> 2.5000; 1 x 1.4999993 -> 1.5.
    EXPECT_EQ(r[0].Close, 0.1549f);
    EXPECT_EQ(r[2].Close, 2.5f);
    EXPECT_EQ(r[1].Open, 1.5f);
    EXPECT_EQ(r[1].Close, 0.0f);
    EXPECT_EQ(r[0].Volume, 2000); // volumes stay scaled
    EXPECT_EQ(r[3].Close, 2.5f);  // after the adjustment: untouched both ways
    EXPECT_EQ(r[2].AdjFactor, 0.0f);
    EXPECT_EQ(r[2].AdjDesc, std::string(14, ' '));

    // Nothing left to take off.
    ASSERT_TRUE(RemoveLatestAdjustment(data, "KRM", removed).ok());
    EXPECT_EQ(removed.Entries, 0);
}

TEST_F(History, RemovalPeelsNewestFirstAndHoldsTwentyAdjustments) {
    auto days = Plain(23);
    days[0].AdjFactor = 0.5f; // record 1 is never looked at
    for (int i = 1; i <= 20; ++i)
        days[static_cast<std::size_t>(i)].AdjFactor = 0.8f;
    Write(days);
    Removed removed;
    ASSERT_TRUE(RemoveLatestAdjustment(data, "KRM", removed).ok());
    EXPECT_EQ(removed.Entries, 20);
    EXPECT_EQ(removed.Record, 21);
    auto r = Read();
    EXPECT_EQ(r[0].Close, 3.125f); // 2.5 x 1.25
    EXPECT_EQ(r[20].Close, 3.125f);
    EXPECT_EQ(r[21].Close, 2.5f);
    EXPECT_EQ(r[20].AdjFactor, 0.0f);
    EXPECT_EQ(r[19].AdjFactor, 0.8f);

    // A 21st adjustment overflows the table: refused, file as it was.
    r[20].AdjFactor = 0.8f;
    r[22].AdjFactor = 0.9f;
    Write(r);
    const std::string before = Raw();
    const auto st = RemoveLatestAdjustment(data, "KRM", removed);
    EXPECT_FALSE(st.ok());
    EXPECT_NE(st.message().find("More than 20 adjustments"), std::string::npos);
    EXPECT_EQ(Raw(), before);
}

TEST_F(History, AFailingWriterLeavesTheOldFileWhole) {
    Write(Plain(30));
    const std::string before = Raw();
    Applied applied;
    Removed removed;
    {
        platform::ScopedWriteFailure fail(50 * 12);
        EXPECT_FALSE(ApplyAdjustment(Job(20, 0.8f, "bi1:4"), applied).ok());
        EXPECT_EQ(Raw(), before);
        EXPECT_EQ(test::FilesIn(root.path() / "data"), std::vector<std::string>{"KRM.WDT"});
    }
    ASSERT_TRUE(ApplyAdjustment(Job(20, 0.8f, "bi1:4"), applied).ok());
    const std::string adjusted = Raw();
    {
        platform::ScopedWriteFailure fail(50 * 12);
        EXPECT_FALSE(RemoveLatestAdjustment(data, "KRM", removed).ok());
        EXPECT_EQ(Raw(), adjusted);
        EXPECT_EQ(test::FilesIn(root.path() / "data"), std::vector<std::string>{"KRM.WDT"});
    }
}

TEST_F(History, ValuesThatWouldNotFitChangeNothing) {
    auto days = Plain(3);
    days[0].Volume = 2'000'000'000;
    Write(days);
    const std::string before = Raw();
    Applied applied;
    const auto st = ApplyAdjustment(Job(3, 1.5f, "cl1.25"), applied);
    EXPECT_FALSE(st.ok());
    EXPECT_NE(st.message().find("Record 1 "), std::string::npos) << st.message();
    EXPECT_EQ(Raw(), before);
    // No record chosen, or one past the end.
    EXPECT_FALSE(ApplyAdjustment(Job(0, 0.8f, "x"), applied).ok());
    EXPECT_FALSE(ApplyAdjustment(Job(4, 0.8f, "x"), applied).ok());
    EXPECT_EQ(Raw(), before);
}

TEST_F(History, TheLargestHistoryTheFormatHolds) {
    Write(Plain(32767));
    Applied applied;
    ASSERT_TRUE(ApplyAdjustment(Job(32767, 0.5f, "ss2:1"), applied).ok());
    auto r = Read();
    ASSERT_EQ(r.size(), 32767u);
    EXPECT_EQ(r.front().Close, 1.25f);
    EXPECT_EQ(r.back().Close, 1.25f);
    EXPECT_EQ(r.back().AdjFactor, 0.5f);
    Removed removed;
    ASSERT_TRUE(RemoveLatestAdjustment(data, "KRM", removed).ok());
    EXPECT_EQ(removed.Record, 32767);
    EXPECT_EQ(Read().front().Close, 2.5f);

    // One record more is beyond the format: refused before anything is written.
    auto more = Plain(32768);
    Write(more);
    EXPECT_FALSE(ApplyAdjustment(Job(2, 0.5f, "ss2:1"), applied).ok());
}

TEST_F(History, TheDateChoiceNeverTakesRecordOne) {
    auto days = Plain(3);
    days[0].Date = "20250101"; // out of order: record 1 is not looked at
    Write(days);
    DateChoice c;
    ASSERT_TRUE(ChooseAdjustmentDate(data, "KRM", "20240102", c).ok());
    EXPECT_EQ(c.Record, 2);
    EXPECT_TRUE(c.ExactDate);
    EXPECT_EQ(c.Message, "Close Price on 2/1/24 is 2.50");
    // On or before the second record's date there is nothing to choose.
    for (const char* date : {"20240101", "20231231"}) {
        ASSERT_TRUE(ChooseAdjustmentDate(data, "KRM", date, c).ok());
        EXPECT_EQ(c.Record, 0) << date;
        EXPECT_TRUE(c.Lines.empty());
    }
}

TEST_F(History, TheDateChoiceListsTwentyEachSide) {
    Write(Plain(60)); // records 1..28 in January, 29..56 in February, 57..60 in March
    DateChoice c;
    // 31 January is not on file: the 28th is the nearest before it.
    ASSERT_TRUE(ChooseAdjustmentDate(data, "KRM", "20240131", c).ok());
    EXPECT_EQ(c.Record, 28);
    EXPECT_FALSE(c.ExactDate);
    EXPECT_EQ(
        c.Message,
        "No close price on file for 31/1/24\n Nearest date prior is 28/1/24\n Close price is 2.50");
    EXPECT_EQ(c.FirstShown, 8);
    EXPECT_EQ(c.Lines.size(), 41u);
    EXPECT_EQ(c.Selected, 20);
    EXPECT_EQ(c.Lines[20], "28/1/24    2.50"); // the date padded to 8, then three blanks
    EXPECT_EQ(RecordOfEntry(c, 20), 28);
    // Near the start the list begins at record 1 and the result is not entry 20.
    ASSERT_TRUE(ChooseAdjustmentDate(data, "KRM", "20240105", c).ok());
    EXPECT_EQ(c.Record, 5);
    EXPECT_EQ(c.FirstShown, 1);
    EXPECT_EQ(c.Lines.size(), 25u);
    EXPECT_EQ(c.Selected, 4);
    // Past the end: the last record, with fewer after it.
    ASSERT_TRUE(ChooseAdjustmentDate(data, "KRM", "20991231", c).ok());
    EXPECT_EQ(c.Record, 60);
    EXPECT_EQ(c.Lines.size(), 21u);
    EXPECT_EQ(c.Selected, 20);
}

TEST_F(History, ChartNotesScaleUpToTheDateAndTakeTheColour) {
    Write(Plain(5));
    ASSERT_TRUE(platform::WriteFileAtomic(root.path() / "misc" / "KRM.Txt",
                                          "T,8.25,20240104,2.5,Top ,12\r\n\r\n"
                                          "T,8.25,20240110, 3,Later,12\r\n"
                                          "odd line\r\n")
                    .ok());
    Applied applied;
    ASSERT_TRUE(ApplyAdjustment(Job(4, 0.8f, "bi1:4"), applied).ok());
    EXPECT_EQ(*platform::ReadWholeFile(root.path() / "misc" / "KRM.Txt"),
              "T,8.25,20240104,2.00,Top,255\r\nT,8.25,20240110,3,Later,255\r\nodd line\r\n");
}

TEST_F(History, TrendLinesScaleTheEndsOnOrBeforeTheDate) {
    const auto path = store::TrendlineFile::PathFor(misc, "KRM");
    store::TrendRecord across{0, 'A', "20240102", 2.5f, "20240110", 3.0f};
    store::TrendRecord beyond{0, 'A', "20240103", 2.5f, "X612", 3.0f};
    store::TrendlineFile file(path);
    ASSERT_TRUE(file.WriteAll({across}).ok());
    ASSERT_TRUE(ScaleTrendLines(misc, "KRM", 0.8f, "20240105").ok());
    EXPECT_EQ(store::TrendlineFile::ReadAll(path)[0].PriceA, 2.5f); // one record: left alone

    ASSERT_TRUE(file.WriteAll({across, beyond}).ok());
    ASSERT_TRUE(ScaleTrendLines(misc, "KRM", 0.8f, "20240105").ok());
    const auto lines = store::TrendlineFile::ReadAll(path);
    EXPECT_EQ(lines[0].PriceA, 2.0f);
    EXPECT_EQ(lines[0].PriceB, 3.0f);
    EXPECT_EQ(lines[1].PriceA, 2.5f);
    EXPECT_EQ(lines[1].PriceB, 3.0f);
    // No file at all is not an error.
    EXPECT_TRUE(ScaleTrendLines(misc, "ALX", 0.8f, "20240105").ok());
}

} // namespace
} // namespace kori::adjust
