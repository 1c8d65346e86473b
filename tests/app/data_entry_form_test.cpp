// The keyboard entry window's model on the sample library: labels by record type, the date
// proposed, the save and what follows it, and the messages.
#include "app/data_entry_form.h"
#include "intake/keyboard_entry.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

struct DataEntryTest : testing::Test {
    test::SampleSession s;
    DataEntryForm form{s.session.folders.DataFolder, s.dialogs};
    std::filesystem::path Wdt(const char* code) {
        return store::PriceFile::PathFor(s.session.folders.DataFolder, code);
    }
};

TEST_F(DataEntryTest, OpensOnTheFirstSecurityAndProposesTheMondayAfterTheLastFriday) {
    ASSERT_TRUE(form.Open());
    EXPECT_EQ(form.name().TrimmedCode(), "XAO");
    EXPECT_EQ(form.RecordTypeText(), "Rec.Tp  1");
    EXPECT_EQ(form.PreviousTexts()[0], "20/11/26"); // the sample ends on Friday 20/11/26
    EXPECT_EQ(form.entered.Date, "23/11/26");
    EXPECT_TRUE(s.dialogs.shown().empty());

    form.autoDateAdvance = false;
    form.entered.Date = "1/1/27";
    form.Step(1);
    EXPECT_EQ(form.name().TrimmedCode(), "XJO");
    EXPECT_EQ(form.entered.Date, "1/1/27") << "without Auto Date Advance the date stays";
    form.Step(-2);
    EXPECT_EQ(form.current(), form.securityCount() - 1) << "round at the start";
}

TEST_F(DataEntryTest, LabelsFollowTheRecordType) {
    ASSERT_TRUE(form.Open());
    const auto labels = [this] {
        std::vector<std::string> out;
        for (const auto& f : form.Figures())
            out.push_back(f.Shown ? f.Label : "-");
        return out;
    };
    EXPECT_EQ(labels(), (std::vector<std::string>{"Open", "High", "Low", "Close", "Volume"}));
    ASSERT_TRUE(form.GoToCode("xjo"));
    EXPECT_EQ(labels(), (std::vector<std::string>{"Open", "High", "Low", "Close", "-"}));
    ASSERT_TRUE(form.GoToCode("ADVDEC"));
    EXPECT_EQ(labels(), (std::vector<std::string>{"-", "Rises", "Falls", "Cum.Total", "-"}));
    EXPECT_EQ(form.PreviousTexts()[1], "");
    EXPECT_FALSE(form.GoToCode("NOPE"));
    EXPECT_EQ(s.dialogs.messages().back(), "No File For That Name");
    EXPECT_EQ(form.name().TrimmedCode(), "ADVDEC") << "an unknown code leaves the window as it was";
}

TEST_F(DataEntryTest, TypeThreeChecksTheTotalOnLeavingItAndOnSave) {
    ASSERT_TRUE(form.GoToCode("ADVDEC"));
    const float previous = form.previous()->Close;
    form.entered.High = "30";
    form.entered.Low = "10";
    form.entered.Close = platform::FormatSingle(previous + 21, "0");
    EXPECT_FALSE(form.LeaveTotal());
    EXPECT_EQ(s.dialogs.shown().front().kind, "beep");
    EXPECT_EQ(s.dialogs.shown().back().title, "Advance/Decline Edit");
    EXPECT_FALSE(form.Save());
    form.entered.Close = platform::FormatSingle(previous + 20, "0");
    EXPECT_TRUE(form.LeaveTotal());
    ASSERT_TRUE(form.Save());
    EXPECT_EQ(form.previous()->Close, previous + 20) << "the saved record is now the previous";
    EXPECT_EQ(form.previous()->Date, "20261123");
    EXPECT_EQ(form.entered.Date, "24/11/26");
    EXPECT_TRUE(form.entered.Close.empty()) << "figures cleared for the next day";
}

TEST_F(DataEntryTest, SaveAppendsAndTheChecksBoxesDecideTheNextDate) {
    ASSERT_TRUE(form.GoToCode("KRM"));
    const auto before = platform::FileSizeOr0(Wdt("KRM"));
    form.entered = {"20/11/26", "3.10", "3.20", "0", "3.15", "1000"};
    EXPECT_FALSE(form.Save()) << "a zero low on a type 4 security";
    EXPECT_EQ(s.dialogs.messages().back(), "Data should not be 0\nUse previous close ");
    EXPECT_EQ(platform::FileSizeOr0(Wdt("KRM")), before);

    // Check1 off, Check2 on: the date moves on from the Friday saved to the Monday.
    form.autoDateAdvance = false;
    form.advanceAfterSave = true;
    form.entered.Low = "3.00";
    form.entered.Date = "27/11/26";
    ASSERT_TRUE(form.Save());
    EXPECT_EQ(platform::FileSizeOr0(Wdt("KRM")), before + 50);
    EXPECT_EQ(form.entered.Date, "30/11/26");
    EXPECT_EQ(form.entered.Close, "3.15") << "the figures stay to be typed over";
    EXPECT_TRUE(form.selectDate());
    // Both off: the date saved stays.
    form.advanceAfterSave = false;
    ASSERT_TRUE(form.Save());
    EXPECT_EQ(form.entered.Date, "30/11/26");
    EXPECT_EQ(intake::LastPriceRecord(Wdt("KRM"))->Date, "20261130");
}

TEST_F(DataEntryTest, EmptyNameFileAndEmptyPriceFile) {
    ASSERT_TRUE(platform::WriteFileAtomic(Wdt("KRM"), "").ok());
    ASSERT_TRUE(form.GoToCode("KRM"));
    EXPECT_EQ(s.dialogs.messages().back(), "No previous data for KRM");
    EXPECT_EQ(s.dialogs.shown().back().title, "Data Entry");
    EXPECT_FALSE(form.previous());

    test::TempRoot empty;
    EXPECT_FALSE(form.ChangeFolder(empty.folder()));
    EXPECT_EQ(s.dialogs.messages().back(), "No Records in Name File");
}

} // namespace
} // namespace kori::app
