// The rules of the manual adjustment windows without widgets: the record left from an earlier
// date step, the removal's repeat question, and the notes' colour.
#include "app/adjustment_forms.h"

#include "platform/files.h"
#include "store/price_file.h"
#include "store/store_builders.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

using platform::Answer;

struct AdjustmentForms : ::testing::Test {
    test::SampleSession s;

    std::filesystem::path Krm() {
        return store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM");
    }
    void Write(std::vector<store::PriceRecord> r) {
        ASSERT_TRUE(platform::WriteFileAtomic(Krm(), test::Bytes(r)).ok());
    }
    std::vector<store::PriceRecord> Records() {
        store::PriceFile f(Krm());
        std::vector<store::PriceRecord> r;
        EXPECT_TRUE(f.ReadAll(r).ok());
        return r;
    }
    static store::PriceRecord At(const char* date, float factor = 0) {
        return test::Day(date, 2.5f, 2.5f, 2.5f, 2.5f, 1000, factor);
    }
};

TEST_F(AdjustmentForms, ADateBeforeTheSecondRecordKeepsTheRecordChosenBefore) {
    Write({At("20240102"), At("20240103"), At("20240104")});
    AdjustSelection sel(s.session);
    ASSERT_TRUE(sel.Load());
    ASSERT_EQ(sel.Code(), "KRM");
    AdjustmentEntry e(s.session, sel.inputs(), adjust::AdjType::Dividend);
    e.SetMoney("0.5");
    ASSERT_TRUE(e.DateStep("3/1/24"));
    EXPECT_EQ(sel.inputs().AdjRecord, 2);
    // On the first record's day nothing is chosen, yet the step ran: Adjust Data is enabled and
    // takes record 2, left from before.
    ASSERT_TRUE(e.DateStep("2/1/24"));
    EXPECT_TRUE(e.choice().Lines.empty());
    EXPECT_TRUE(e.AdjustEnabled());
    ASSERT_TRUE(e.AdjustData());
    const auto r = Records();
    EXPECT_EQ(r[1].AdjFactor, 0.8f); // 1 - 0.5 / 2.5
    EXPECT_EQ(r[1].AdjDesc.substr(0, 5), "dv0.5");
    EXPECT_EQ(r[0].Close, 2.0f);
    EXPECT_EQ(r[2].Close, 2.5f);
    EXPECT_EQ(e.DescText(), "Adjustment Desc :dv0.5");

    // A fresh security forgets the record: nothing chosen, nothing written.
    sel.Step(1);
    EXPECT_EQ(sel.inputs().AdjRecord, 0);
}

TEST_F(AdjustmentForms, RemovalAsksBeforeEachFurtherAdjustment) {
    Write({At("20240102"), At("20240103", 0.5f), At("20240104", 0.5f), At("20240105", 0.5f)});
    s.dialogs.QueueAnswer(Answer::Yes);
    s.dialogs.QueueAnswer(Answer::No);
    EXPECT_EQ(ProceedRemoval(s.session, "KRM"), 2);
    const std::string again = "Latest adjustment removed for KRM\nRemove next adjustment ?";
    EXPECT_EQ(s.dialogs.messages(), (std::vector<std::string>{again, again}));
    EXPECT_EQ(s.dialogs.shown().back().buttons, platform::Buttons::YesNo);
    auto r = Records();
    EXPECT_EQ(r[1].AdjFactor, 0.5f);
    EXPECT_EQ(r[2].AdjFactor, 0.0f);
    EXPECT_EQ(r[0].Close, 10.0f); // 2.5 x 2 x 2

    s.dialogs.clear();
    EXPECT_EQ(ProceedRemoval(s.session, "KRM"), 1);
    EXPECT_EQ(s.dialogs.messages().back(), "Latest adjustment removed for KRM");
    EXPECT_EQ(s.dialogs.shown().back().title, "Remove Adjustment");
    EXPECT_EQ(ProceedRemoval(s.session, "KRM"), 0);
    EXPECT_EQ(s.dialogs.messages().back(), "File has not previously been adjusted");
    EXPECT_EQ(s.dialogs.shown().back().title, "Remove Adjustments");
}

TEST_F(AdjustmentForms, NotesTakeTheTwentySixthColour) {
    s.session.palette[25] = platform::Rgb(1, 2, 3);
    s.session.palette[26] = platform::Rgb(9, 9, 9);
    EXPECT_EQ(AdjustmentNoteColour(s.session), "197121"); // 1 + 2 x 256 + 3 x 65536
}

} // namespace
} // namespace kori::app
