// Keyboard entry: the proposed date, the checks by record type, and the append.
#include "intake/keyboard_entry.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include "../store/store_builders.h"

#include <gtest/gtest.h>

namespace kori::intake {
namespace {

using test::Bytes;
using test::Day;
using test::TempRoot;

TEST(KeyboardEntry, NextTradingDateSkipsTheWeekend) {
    EXPECT_EQ(NextTradingDate("20261120"), "20261123"); // Friday -> Monday
    EXPECT_EQ(NextTradingDate("20261121"), "20261123"); // Saturday -> Monday
    EXPECT_EQ(NextTradingDate("20261122"), "20261123"); // Sunday -> Monday
    EXPECT_EQ(NextTradingDate("20261119"), "20261120"); // Thursday -> Friday
    EXPECT_EQ(NextTradingDate("20261231"), "20270101"); // a Thursday over the year's end
    EXPECT_EQ(NextTradingDate("2026113"), std::nullopt);
}

TEST(KeyboardEntry, AdvanceDeclineTotalMustFollowFromThePrevious) {
    KeyedDay d{"", "", "30", "10", "120", ""};
    EXPECT_FALSE(CheckKeyedFigures(3, d, 100)); // 100 + 30 - 10 = 120
    d.Close = "121";
    const auto r = CheckKeyedFigures(3, d, 100);
    ASSERT_TRUE(r);
    EXPECT_EQ(r->Message, "Cumulative total must equal\nPrevious total + Rises - Falls");
    EXPECT_EQ(r->Title, "Advance/Decline Edit");
    d.Close = "";
    EXPECT_TRUE(CheckKeyedFigures(3, d, 100)) << "a blank total is not 120";
    d.Close = "-80"; // an empty file starts from 0: 0 + 10 - 90
    d.High = "10";
    d.Low = "90";
    EXPECT_FALSE(CheckKeyedFigures(3, d, 0));
}

TEST(KeyboardEntry, ZeroFiguresByRecordType) {
    const KeyedDay full{"", "1.10", "1.20", "1.00", "1.15", "5000"};
    EXPECT_FALSE(CheckKeyedFigures(4, full, 0));
    KeyedDay zeroLow = full;
    zeroLow.Low = "0";
    for (int type : {4, 5}) {
        const auto r = CheckKeyedFigures(type, zeroLow, 0);
        ASSERT_TRUE(r) << type;
        EXPECT_EQ(r->Message, "Data should not be 0\nUse previous close ");
        EXPECT_EQ(r->Title, "Data Entry");
    }
    // Types 1 and 2 ask only for a close.
    EXPECT_FALSE(CheckKeyedFigures(1, zeroLow, 0));
    KeyedDay noClose{"", "", "", "", " ", ""};
    const auto r = CheckKeyedFigures(2, noClose, 0);
    ASSERT_TRUE(r);
    EXPECT_EQ(r->Message, " Close should not be 0\nUse previous close ");
    noClose.Close = "0";
    EXPECT_TRUE(CheckKeyedFigures(1, noClose, 0));
    // Text where a number belongs, and volumes that are no share counts.
    KeyedDay bad = full;
    bad.High = "1.2x";
    EXPECT_EQ(CheckKeyedFigures(4, bad, 0)->Message, "High must be a number");
    bad = full;
    bad.Volume = "12.5";
    EXPECT_TRUE(CheckKeyedFigures(4, bad, 0));
    bad.Volume = "3000000000";
    EXPECT_TRUE(CheckKeyedFigures(4, bad, 0));
    EXPECT_FALSE(CheckKeyedFigures(2, bad, 0)) << "type 2 has no volume";
}

class SaveKeyed : public testing::Test {
protected:
    void SetUp() override {
        root.Write("AAA.WDT", Bytes({Day("20261119", 1, 1.2f, 0.9f, 1.1f, 100),
                                     Day("20261120", 1.1f, 1.3f, 1.0f, 1.2f, 200)}));
        root.Write("ADV.WDT", Bytes({Day("20261120", 0, 30, 10, 100, 0)}));
    }
    std::string Data() const { return root.folder(); }
    TempRoot root;
};

TEST_F(SaveKeyed, AppendsOneRecordAfterTheLastWhateverItsDate) {
    const auto name = test::Name("AAA", "Triple A", 4);
    const KeyedDay d{"23/11/26", "1.2", "1.35", "1.15", "1.3", "1500"};
    auto r = SaveKeyedDay(Data(), name, d);
    ASSERT_TRUE(r.Saved) << r.Refusal.Message;
    EXPECT_EQ(r.RecordNumber, 3);
    const std::string bytes = root.Read("AAA.WDT");
    ASSERT_EQ(bytes.size(), 150u);
    const auto rec = store::PriceRecord::Decode(bytes.data() + 100);
    EXPECT_EQ(rec.Date, "20261123");
    EXPECT_EQ(rec.Open, 1.2f);
    EXPECT_EQ(rec.High, 1.35f);
    EXPECT_EQ(rec.Low, 1.15f);
    EXPECT_EQ(rec.Close, 1.3f);
    EXPECT_EQ(rec.Volume, 1500);
    EXPECT_EQ(rec.AdjFactor, 0.0f);

    // An earlier date is not compared with the file: it goes in as record 4.
    r = SaveKeyedDay(Data(), name, {"1/1/20", "1", "1", "1", "1", "0"});
    ASSERT_TRUE(r.Saved);
    EXPECT_EQ(r.RecordNumber, 4);
    EXPECT_EQ(LastPriceRecord(root.path() / "AAA.WDT")->Date, "20200101");
}

TEST_F(SaveKeyed, RefusalsWriteNothing) {
    const auto name = test::Name("AAA", "Triple A", 4);
    auto r = SaveKeyedDay(Data(), name, {"23.11.26", "1", "1", "1", "1", "1"});
    EXPECT_FALSE(r.Saved);
    EXPECT_EQ(r.Refusal.Title, "Incorrect Date Format ");
    r = SaveKeyedDay(Data(), name, {"", "1", "1", "1", "1", "1"});
    EXPECT_EQ(r.Refusal.Message, " Date must be entered");
    r = SaveKeyedDay(Data(), name, {"23/11/26", "1", "1", "0", "1", "1"});
    EXPECT_EQ(r.Refusal.Message, "Data should not be 0\nUse previous close ");
    {
        platform::ScopedWriteFailure fail(10);
        r = SaveKeyedDay(Data(), name, {"23/11/26", "1", "1", "1", "1", "1"});
        EXPECT_FALSE(r.Saved);
    }
    EXPECT_EQ(root.Read("AAA.WDT").size(), 100u);

    // The previous total comes from the file: 100 + 40 - 15.
    const auto adv = test::Name("ADV", "Advance decline", 3);
    r = SaveKeyedDay(Data(), adv, {"23/11/26", "", "40", "15", "126", ""});
    EXPECT_EQ(r.Refusal.Title, "Advance/Decline Edit");
    r = SaveKeyedDay(Data(), adv, {"23/11/26", "", "40", "15", "125", ""});
    ASSERT_TRUE(r.Saved);
    EXPECT_EQ(r.Record.Close, 125.0f);
    EXPECT_EQ(r.Record.High, 40.0f);
    EXPECT_EQ(r.Record.Open, 0.0f);

    // A file cut short in its last record is not appended to out of step.
    root.Write("CUT.WDT", std::string(75, ' '));
    r = SaveKeyedDay(Data(), test::Name("CUT", "Cut", 4), {"23/11/26", "1", "1", "1", "1", "1"});
    EXPECT_FALSE(r.Saved);
    EXPECT_EQ(root.Read("CUT.WDT").size(), 75u);
}

} // namespace
} // namespace kori::intake
