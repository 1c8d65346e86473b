// The targets window's rules: cells checked as they are left, the blank row to type into, and
// the save with its refusals.
#include "app/target_alerts.h"
#include "app/targets_form.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

using platform::ScriptedDialogs;
using test::TempRoot;

class TargetsFormTest : public testing::Test {
protected:
    TargetsForm Opened(const std::string& file) {
        root.Write("Targets.txt", file);
        TargetsForm f(root.folder(), dialogs);
        f.Load();
        return f;
    }
    TempRoot root;
    ScriptedDialogs dialogs;
};

TEST_F(TargetsFormTest, LoadShowsTheLinesFormattedWithABlankRowToTypeInto) {
    auto f = Opened("bhp,55.5,u\r\nNAB,30,D\r\n");
    const auto& g = f.grid();
    EXPECT_EQ(g.headers(), (std::vector<std::string>{"Code", "Target $", "Up/Down"}));
    ASSERT_EQ(g.rowCount(), 3);
    EXPECT_EQ(g.rows()[0], (GridModel::Row{"BHP", "55.50", "U"}));
    EXPECT_EQ(g.rows()[1], (GridModel::Row{"NAB", "30.00", "D"}));
    EXPECT_EQ(g.rows()[2], (GridModel::Row{"", "", ""}));
    EXPECT_FALSE(f.changed());
}

TEST_F(TargetsFormTest, CellChecks) {
    auto f = Opened("");
    auto& g = f.grid();
    EXPECT_EQ(g.SetCell(0, 1, "1.2345").Text, "1.235"); // "0.00#"
    const auto ud = g.SetCell(0, 2, "X");
    EXPECT_FALSE(ud.Accepted);
    EXPECT_EQ(ud.Message, "Must be either U or D");
    EXPECT_EQ(ud.Title, "Up or Down");
    EXPECT_EQ(g.SetCell(0, 2, "d").Text, "D");
    EXPECT_FALSE(g.SetCell(0, 1, "12x").Accepted);
    EXPECT_FALSE(g.SetCell(0, 1, "0").Accepted);
    EXPECT_EQ(g.SetCell(0, 1, "1,5").Message, "Commas cannot be used");
    EXPECT_FALSE(g.SetCell(0, 0, "AB/C").Accepted);
    EXPECT_EQ(g.SetCell(0, 0, "krm").Text, "KRM");
    EXPECT_TRUE(f.KeepBlankRow()) << "the row typed into is no longer blank";
    EXPECT_FALSE(f.KeepBlankRow());
    EXPECT_EQ(g.rowCount(), 2);
}

TEST_F(TargetsFormTest, SaveWritesTheFilledRowsInOrder) {
    auto f = Opened("NAB,30,D\r\n");
    auto& g = f.grid();
    g.SetCell(1, 0, "BHP");
    g.SetCell(1, 1, "41");
    g.SetCell(1, 2, "U");
    f.KeepBlankRow();
    ASSERT_TRUE(f.SortList());
    EXPECT_EQ(g.cell(0, 0), "BHP");
    EXPECT_EQ(g.cell(2, 0), "") << "the blank row sorts last";
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,41.00,U\r\nNAB,30.00,D\r\n");
    EXPECT_FALSE(f.changed());
    EXPECT_TRUE(dialogs.messages().empty());
}

TEST_F(TargetsFormTest, SaveRefusesIncompleteRowsAThirdTargetAndBadCells) {
    auto f = Opened("BHP,1,U\r\nBHP,2,D\r\nNAB,3,D\r\n");
    auto& g = f.grid();
    g.SetCell(2, 0, "BHP"); // a third line for BHP
    EXPECT_FALSE(f.Save());
    ASSERT_TRUE(f.refusal());
    EXPECT_EQ(f.refusal()->Row, 2);
    EXPECT_EQ(dialogs.messages().back(), "Max. 2 alerts per stock");

    g.SetCell(2, 0, "NAB");
    g.SetCell(2, 2, "");
    EXPECT_FALSE(f.Save());
    EXPECT_EQ(dialogs.shown().back().text, "Must be either U or D");
    EXPECT_EQ(dialogs.shown().back().title, "Up or Down");
    EXPECT_EQ(f.refusal()->Column, 2);

    g.SetCell(2, 2, "Q");
    EXPECT_FALSE(f.Save());
    EXPECT_EQ(f.refusal()->Row, 2);
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,1,U\r\nBHP,2,D\r\nNAB,3,D\r\n") << "nothing written";

    ASSERT_TRUE(f.DeleteRow(2));
    EXPECT_EQ(g.rowCount(), 3) << "two targets and the blank row";
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,1.00,U\r\nBHP,2.00,D\r\n");
}

TEST_F(TargetsFormTest, AFailedWriteKeepsTheOldFileAndTheChanges) {
    auto f = Opened("BHP,1,U\r\n");
    f.grid().SetCell(0, 1, "2");
    {
        platform::ScopedWriteFailure fail(3);
        EXPECT_FALSE(f.Save());
    }
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,1,U\r\n");
    EXPECT_TRUE(f.changed());
    EXPECT_EQ(dialogs.shown().back().title, "Quoren Alerts");
}

TEST_F(TargetsFormTest, ClosingWithChangesAsks) {
    auto f = Opened("BHP,1,U\r\n");
    EXPECT_TRUE(f.CanClose()) << "nothing changed: no question";
    EXPECT_TRUE(dialogs.shown().empty());
    f.grid().SetCell(0, 1, "2");
    dialogs.QueueAnswer(platform::Answer::Cancel);
    EXPECT_FALSE(f.CanClose());
    dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(f.CanClose());
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,2.00,U\r\n");
}

} // namespace
} // namespace kori::app

namespace kori::app {
namespace {

TEST(TargetAlerts, OneBoxWithTheLinesJoinedOrNoneAtAll) {
    platform::ScriptedDialogs dialogs;
    EXPECT_FALSE(ShowTargetAlerts(dialogs, {}));
    EXPECT_TRUE(dialogs.shown().empty());
    EXPECT_TRUE(
        ShowTargetAlerts(dialogs, {"AAA - target reached UP", "BBB - target exceeded DOWN"}));
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text, "AAA - target reached UP\r\nBBB - target exceeded DOWN");
    EXPECT_EQ(dialogs.shown()[0].title, "Quoren Alerts");

    test::TempRoot root;
    dialogs.clear();
    EXPECT_TRUE(CheckAndShowTargets(dialogs, root.folder(), root.folder()).empty());
    EXPECT_TRUE(dialogs.shown().empty()) << "no Targets.txt: nothing is said";
}

} // namespace
} // namespace kori::app
