// The targets, keyboard entry and import windows on the sample library, opened from the menus
// and driven as the user would, with what they leave on disk.
#include "gui/widgets/grid_view.h"
#include "gui/windows/data_entry.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "gui/windows/targets.h"
#include "platform/files.h"
#include "support/sample_session.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QPushButton>
#include <QTest>
#include <gtest/gtest.h>

using namespace kori;
using platform::Answer;

namespace {

struct EntryWindows : ::testing::Test {
    test::SampleSession s;
    gui::MainWindow main{s.session};

    void SetUp() override { gui::RegisterWindows(main); }
    std::string ReadSys(const char* name) {
        return platform::ReadWholeFile(platform::ResolveIn(s.session.folders.SystemFolder, name))
            .value_or("");
    }
    void Trigger(gui::Targets& w, const char* action) {
        auto* a = w.findChild<QAction*>(QString::fromLatin1(action));
        ASSERT_NE(a, nullptr) << action;
        a->trigger();
    }
};

} // namespace

TEST_F(EntryWindows, TargetsOpensFromTheMenuEditsAndSaves) {
    ASSERT_TRUE(main.Trigger("mnuTargets"));
    auto* w = main.findChild<gui::Targets*>();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle(), "Quoren Alerts");
    EXPECT_EQ(w->findChild<QLabel*>("lblMax")->text(), "Max. 2 alerts per stock");
    QStringList menus;
    for (QAction* a : w->menus()->actions())
        menus << a->text();
    EXPECT_EQ(menus, (QStringList{"&File", "&Edit"}));
    EXPECT_EQ(w->findChild<QAction*>("mnuSave")->text(), "&Save");
    EXPECT_EQ(w->findChild<QAction*>("mnuDeleteRow")->text(), "&Delete Row");
    EXPECT_EQ(w->findChild<QAction*>("mnuSort")->text(), "&Sort List");

    auto* grid = w->grid();
    ASSERT_EQ(grid->rowCount(), 7) << "the six sample targets and a blank row";
    EXPECT_EQ(grid->horizontalHeaderItem(1)->text(), "Target $");
    // Typing into the blank row: the direction is refused under its own title, a new blank
    // row comes under the row typed into.
    grid->item(6, 0)->setText("abc");
    EXPECT_EQ(grid->rowCount(), 8);
    EXPECT_EQ(grid->item(6, 0)->text(), "ABC");
    grid->item(6, 1)->setText("2");
    grid->item(6, 2)->setText("x");
    EXPECT_EQ(s.dialogs.shown().back().text, "Must be either U or D");
    EXPECT_EQ(s.dialogs.shown().back().title, "Up or Down");
    grid->item(6, 2)->setText("u");
    // The first row (FRG) goes, the list is sorted and saved.
    grid->setCurrentCell(0, 0);
    Trigger(*w, "mnuDeleteRow");
    Trigger(*w, "mnuSort");
    EXPECT_EQ(grid->item(0, 0)->text(), "ABC");
    Trigger(*w, "mnuSave");
    const std::string file = ReadSys("Targets.txt");
    EXPECT_EQ(file.rfind("ABC,2.00,U\r\nGLN,", 0), 0u) << file;
    EXPECT_EQ(file.find("FRG"), std::string::npos);
    EXPECT_FALSE(w->form().changed());
    w->reject();
}

TEST_F(EntryWindows, DataEntryShowsTheRecordTypesFieldsAndSaves) {
    ASSERT_TRUE(main.Trigger("mnuKBUpdate"));
    auto* w = main.findChild<gui::DataEntry*>();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle(), "Data Entry - Keyboard");
    EXPECT_EQ(w->findChild<QCheckBox*>("Check1")->text(), "Auto Date Advance");
    EXPECT_EQ(w->findChild<QCheckBox*>("Check2")->text(), "Advance after Save");
    EXPECT_EQ(w->codeField()->text(), "XAO");
    EXPECT_EQ(w->findChild<QLabel*>("lblRecType")->text(), "Rec.Tp  1");
    EXPECT_EQ(w->dateField()->text(), "23/11/26");

    w->codeField()->setText("advdec");
    QTest::keyClick(w->codeField(), Qt::Key_Return);
    EXPECT_EQ(w->findChild<QLabel*>("lblName")->text(), "Advance Decline Line (sample)");
    EXPECT_EQ(w->figureLabel(1)->text(), "Rises");
    EXPECT_EQ(w->figureLabel(3)->text(), "Cum.Total");
    EXPECT_TRUE(w->figureField(0)->isHidden());
    EXPECT_TRUE(w->figureField(4)->isHidden());

    w->codeField()->setText("KRM");
    QTest::keyClick(w->codeField(), Qt::Key_Return);
    EXPECT_EQ(w->figureLabel(4)->text(), "Volume");
    EXPECT_FALSE(w->figureField(4)->isHidden());
    const std::string prevClose = w->previousLabel(3)->text().toStdString();
    EXPECT_FALSE(prevClose.empty());
    const char* figures[] = {"3.10", "3.30", "0", "3.20", "5000"};
    for (int i = 0; i < 5; ++i)
        w->figureField(i)->setText(figures[i]);
    QTest::mouseClick(w->findChild<QPushButton*>("Command1"), Qt::LeftButton);
    EXPECT_EQ(s.dialogs.shown().back().text, "Data should not be 0\nUse previous close ");
    w->figureField(2)->setText("3.00");
    QTest::mouseClick(w->findChild<QPushButton*>("Command1"), Qt::LeftButton);
    EXPECT_EQ(w->previousLabel(3)->text(), "3.20") << "the day saved is now the previous one";
    EXPECT_EQ(w->dateField()->text(), "24/11/26");
    EXPECT_TRUE(w->figureField(3)->text().isEmpty());
    QTest::mouseClick(w->findChild<QPushButton*>("Command3"), Qt::LeftButton);
}
