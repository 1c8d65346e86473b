// The maintenance list's rules as the windows use them: the hook the download update calls,
// the message after an update that added items, the folder questions, and the row deletion.
#include "app/adjustment_list_form.h"

#include "platform/files.h"
#include "support/sample_session.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

struct ListSession {
    test::SampleSession s;
    test::TempRoot in, out;
    ListSession() {
        s.session.download.In = in.folder();
        s.session.download.Out = out.folder();
    }
    std::string List() {
        return platform::ReadWholeFile(
                   platform::ResolveIn(s.session.folders.DataFolder, "Adjust.Lst"))
            .value_or("");
    }
};

TEST(AdjustmentHooks, TheUpdateFillsTheListAndTheUserIsToldOnce) {
    ListSession l;
    l.in.Write("23NOV26.Asx.Btn", "BI,KRM,ASX.STK,0,N,23NOV26,1,4\r\n");
    bool added = false;
    const auto hooks = AdjustmentHooks(l.s.session, added);
    ASSERT_TRUE(hooks.UpdateAdjustmentsList);
    hooks.UpdateAdjustmentsList(l.s.session.folders.DataFolder, "23NOV26");
    EXPECT_TRUE(added);
    EXPECT_EQ(l.List(), "BI,KRM,23NOV26,0,N,23NOV26,1,4\r\n");
    EXPECT_TRUE(TellItemsAdded(l.s.session, added));
    ASSERT_EQ(l.s.dialogs.shown().size(), 1u);
    EXPECT_EQ(l.s.dialogs.shown()[0].text,
              "There have been maintenance items added to the Adjustment List");
    EXPECT_EQ(l.s.dialogs.shown()[0].title, "Adjustment List");
    // The same day again adds nothing and nobody is told.
    bool again = false;
    AdjustmentHooks(l.s.session, again)
        .UpdateAdjustmentsList(l.s.session.folders.DataFolder, "23NOV26");
    EXPECT_FALSE(again);
    EXPECT_FALSE(TellItemsAdded(l.s.session, again));
    EXPECT_EQ(l.s.dialogs.shown().size(), 1u);
}

TEST(AdjustmentListForm, DeletingRowsAsksAndTheBundleServiceNeedsItsFolders) {
    ListSession l;
    ASSERT_TRUE(
        platform::WriteFileAtomic(platform::ResolveIn(l.s.session.folders.DataFolder, "Adjust.Lst"),
                                  "EN,A,X,0,N\r\nEN,B,X,0,N\r\nEN,C,X,0,N\r\n"));
    AdjustmentListForm form(l.s.session);
    ASSERT_TRUE(form.Load());
    l.s.dialogs.QueueAnswer(platform::Answer::No);
    EXPECT_FALSE(form.DeleteRows(0, 0));
    EXPECT_EQ(l.s.dialogs.shown().back().text, "Delete row 1 ?");
    EXPECT_EQ(l.s.dialogs.shown().back().title, "Delete Rows");
    l.s.dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(form.DeleteRows(2, 1));
    EXPECT_EQ(l.s.dialogs.shown().back().text, "Delete items 2 to 3 ?");
    ASSERT_EQ(form.items().size(), 1u);
    EXPECT_EQ(form.Cell(0, 1), "A");
    EXPECT_TRUE(form.edited());
    EXPECT_FALSE(form.DeleteRows(0, 5)); // past the end: nothing asked, nothing done

    l.s.session.download.DataService = 3;
    l.s.session.chartDataPaths = {};
    AdjustmentListForm bundle(l.s.session);
    EXPECT_FALSE(bundle.Load());
    EXPECT_EQ(l.s.dialogs.shown().back().title, "Data Paths");
}

} // namespace
} // namespace kori::app
