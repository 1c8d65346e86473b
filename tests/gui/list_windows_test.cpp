// The chart list and classification windows on the sample library: lists edited, copied and
// imported, classes edited and checked, each saved and read back from disk, with the questions
// and refusals the user sees.
#include "gui/windows/cht_sel.h"
#include "gui/windows/cl_names.h"
#include "gui/windows/gics_class.h"
#include "gui/windows/ind_class.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "gui/windows/settings_windows.h"
#include "gui/windows/sub_list.h"
#include "gui/windows/sub_list2.h"
#include "gui/windows/sub_list3.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "support/sample_session.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenuBar>
#include <QPrinter>
#include <QPushButton>
#include <QTableWidget>
#include <QTest>
#include <QTimer>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

using namespace kori;
using platform::Answer;

namespace {

struct Lists : ::testing::Test {
    test::SampleSession s;
    gui::MainWindow main{s.session};

    void SetUp() override { gui::RegisterWindows(main); }

    gui::SettingsHub& hub() { return gui::Hub(main); }
    std::string data() { return s.session.folders.DataFolder; }
    std::string sys() { return s.session.folders.SystemFolder; }
    // The list on disk as "code:record" words.
    std::vector<std::string> OnDisk(char letter) {
        std::vector<store::ChartListEntry> entries;
        EXPECT_TRUE(store::ReadList(store::ListPath(data(), letter), entries).ok());
        std::vector<std::string> words;
        for (const auto& e : entries)
            words.push_back(platform::Trim(e.Code) + ":" + std::to_string(e.NameRecord));
        return words;
    }
    std::vector<std::string> Shown(QListWidget* box) {
        std::vector<std::string> codes;
        for (int r = 0; r < box->count(); ++r)
            codes.push_back(box->item(r)->text().toStdString());
        return codes;
    }
    const platform::ScriptedDialogs::Shown& LastMsg() {
        static const platform::ScriptedDialogs::Shown none;
        const auto& shown = s.dialogs.shown();
        for (auto it = shown.rbegin(); it != shown.rend(); ++it)
            if (it->kind == "msg") return *it;
        return none;
    }
    void Select(QListWidget* box, std::initializer_list<int> rows) {
        box->clearSelection();
        for (int r : rows)
            box->item(r)->setSelected(true);
    }
    void Click(QWidget& w, const char* name) {
        auto* b = w.findChild<QPushButton*>(QString::fromLatin1(name));
        ASSERT_NE(b, nullptr) << name;
        QTest::mouseClick(b, Qt::LeftButton);
    }
    void Shot(QWidget& w, const char* name) {
        if (const char* dir = std::getenv("KORI_SHOTS")) {
            w.show();
            QApplication::processEvents();
            w.grab().save(QString::fromLatin1(dir) + "/" + name + ".png");
        }
    }
    std::string ReadSys(const char* name) {
        return platform::ReadWholeFile(platform::ResolveIn(sys(), name)).value_or("");
    }
};

} // namespace

TEST_F(Lists, MenuItemsAppearAndOpenTheirWindows) {
    for (const char* item : {"mnuLists", "mnuListsUte", "mnImpTxtCds", "nmIndCl", "nmGics"})
        EXPECT_NE(main.findChild<QAction*>(item), nullptr) << item;
    ASSERT_TRUE(main.Trigger("mnuLists"));
    auto* w = main.findChild<gui::SubList*>();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle(), "Edit Chart Lists");
    ASSERT_TRUE(main.Trigger("mnuLists"));
    EXPECT_EQ(main.findChildren<gui::SubList*>().size(), 1) << "a second pick brings it forward";
    ASSERT_TRUE(main.Trigger("nmGics"));
    auto* g = main.findChild<gui::GicsClass*>();
    ASSERT_NE(g, nullptr);
    EXPECT_EQ(g->findChild<QAction*>("mnuPrint"), nullptr) << "GICS has no print";
    ASSERT_TRUE(main.Trigger("nmIndCl"));
    ASSERT_TRUE(main.Trigger("mnuListsUte"));
    ASSERT_TRUE(main.Trigger("mnImpTxtCds"));
    EXPECT_NE(main.findChild<gui::SubList3*>(), nullptr);
}

TEST_F(Lists, EditorAddsOrdersDeletesAndAsksBeforeLeavingAChangedList) {
    gui::SubList w(s.session, hub());
    auto& panel = w.panel();
    // First time: list A, under the display name the settings give it.
    EXPECT_EQ(panel.chooser()->currentText(), "Banks and Finance");
    EXPECT_EQ(Shown(panel.list()), (std::vector<std::string>{"HBK", "IRB", "JNS", "KST", "LMT"}));
    EXPECT_EQ(w.stocks()->count(), 54);

    w.codeField()->setText("qqq");
    Click(w, "cmdAdd");
    EXPECT_EQ(LastMsg().text, "Code not found");
    EXPECT_EQ(LastMsg().title, "Chart Lists");
    EXPECT_EQ(w.codeField()->text(), "qqq") << "the refused code stays to be corrected";

    // Typed in any case; goes in after the selected entry.
    Select(panel.list(), {0});
    w.codeField()->setText("mrw");
    Click(w, "cmdAdd");
    EXPECT_TRUE(w.codeField()->text().isEmpty());
    // Double click in the box of all codes adds at the end when nothing is selected.
    panel.list()->clearSelection();
    w.stocks()->itemDoubleClicked(w.stocks()->item(0));
    EXPECT_EQ(Shown(panel.list()),
              (std::vector<std::string>{"HBK", "MRW", "IRB", "JNS", "KST", "LMT", "XAO"}));
    Select(panel.list(), {6});
    Click(w, "cmdUp");
    Select(panel.list(), {0, 2});
    s.dialogs.QueueAnswer(Answer::No);  // "Delete IRB"
    s.dialogs.QueueAnswer(Answer::Yes); // "Delete HBK"
    Click(w, "cmdDelete");
    EXPECT_EQ(s.dialogs.messages().back(), "Delete HBK");
    EXPECT_EQ(Shown(panel.list()),
              (std::vector<std::string>{"MRW", "IRB", "JNS", "KST", "XAO", "LMT"}));

    // Leaving the changed list: No keeps the file as it was and shows the other list.
    s.dialogs.QueueAnswer(Answer::No);
    panel.chooser()->setCurrentIndex(1);
    EXPECT_EQ(LastMsg().text, "List has changed. SAVE Changes?");
    EXPECT_EQ(panel.box().letter(), 'B');
    EXPECT_EQ(OnDisk('A'),
              (std::vector<std::string>{"HBK:12", "IRB:13", "JNS:14", "KST:15", "LMT:16"}));
    EXPECT_EQ(s.session.ini().Read("SubLists", "Last"), "3");

    // Back to A, change and save, then empty it and close saying Yes.
    panel.chooser()->setCurrentIndex(0);
    Select(panel.list(), {4});
    w.codeField()->setText("ADVDEC");
    Click(w, "cmdAdd");
    Click(w, "cmdSave");
    EXPECT_EQ(OnDisk('A'), (std::vector<std::string>{"HBK:12", "IRB:13", "JNS:14", "KST:15",
                                                     "LMT:16", "ADVDEC:3"}));
    s.dialogs.QueueAnswer(Answer::Yes);
    Click(w, "cmdDeleteAll");
    EXPECT_EQ(LastMsg().text, "Delete all items ?");
    EXPECT_EQ(panel.list()->count(), 0);
    s.dialogs.QueueAnswer(Answer::Yes);
    w.reject();
    EXPECT_EQ(LastMsg().text, "List has changed. SAVE Changes?");
    EXPECT_TRUE(OnDisk('A').empty());

    gui::SubList again(s.session, hub());
    EXPECT_EQ(again.panel().box().letter(), 'A') << "opens on the list shown last";
    Shot(again, "SubList");
}

TEST_F(Lists, UtilitiesRefuseTheSameListAndCopyOnlyBetweenTwoShownLists) {
    gui::SubList2 w(s.session, hub());
    EXPECT_EQ(w.windowTitle(), "Chart List Utilities");
    auto& left = w.panel(0);
    auto& right = w.panel(1);
    EXPECT_EQ(right.chooser()->count(), 11);
    EXPECT_EQ(right.chooser()->itemText(10), "Chart List Z");

    Click(w, "cmdCopyRight");
    EXPECT_EQ(LastMsg().text, "Both lists must be displayed");
    EXPECT_EQ(LastMsg().title, "Chart List Utilities");

    left.chooser()->setCurrentIndex(1); // Resources
    right.chooser()->setCurrentIndex(1);
    EXPECT_EQ(LastMsg().text, "Lists cannot be same");
    EXPECT_FALSE(right.displayed());
    EXPECT_EQ(right.chooser()->currentIndex(), -1);

    ASSERT_FALSE(std::filesystem::exists(store::ListPath(data(), 'Z')));
    right.chooser()->setCurrentIndex(10);
    EXPECT_TRUE(right.displayed());
    EXPECT_TRUE(std::filesystem::exists(store::ListPath(data(), 'Z'))) << "created by opening";
    right.box().Add("KRM");
    right.Refresh();
    QString count;
    for (auto* label : right.findChildren<QLabel*>())
        if (label->objectName().startsWith(QStringLiteral("lblCount"))) count = label->text();
    EXPECT_EQ(count, "1 chart");
    right.box().Clear();
    right.Refresh();

    Select(left.list(), {0, 5});
    Click(w, "cmdCopyRight");
    EXPECT_EQ(Shown(right.list()), (std::vector<std::string>{"KRM", "ZNC"}));
    Select(left.list(), {0, 1, 5});
    Click(w, "cmdCopyRight");
    EXPECT_EQ(Shown(right.list()), (std::vector<std::string>{"KRM", "ZNC", "ALX"}))
        << "a second copy adds no duplicates";
    EXPECT_EQ(left.list()->count(), 8) << "copying leaves the source whole";

    s.dialogs.QueueAnswer(Answer::No);
    Click(w, "cmdDeleteAll1");
    EXPECT_EQ(LastMsg().text, "Delete all items from Resources  ?");
    EXPECT_EQ(left.list()->count(), 8);

    s.dialogs.QueueAnswer(Answer::Yes);
    w.reject();
    EXPECT_EQ(LastMsg().text, "Chart List Z has changed. SAVE Changes?");
    EXPECT_EQ(LastMsg().title, "Chart Lists");
    EXPECT_EQ(OnDisk('Z'), (std::vector<std::string>{"KRM:4", "ZNC:30", "ALX:5"}));
    Shot(w, "SubList2");
}

TEST_F(Lists, TextImportTakesCodeLinesAndListsWhatItRefuses) {
    std::filesystem::create_directories(s.root.path() / "imports");
    const auto file =
        s.root.Write("imports/codes.txt", "BHP\r\nhbk\r\nKST\r\nWES.AX\r\n mrw \r\nTOOLONG\r\nDLT");
    gui::SubList3 w(s.session, hub());
    EXPECT_EQ(w.windowTitle(), "Import Text to Chart Lists");
    EXPECT_EQ(w.folder(), sys()) << "no folder kept yet";
    ASSERT_TRUE(w.LoadFile(file));
    EXPECT_EQ(Shown(w.fileBox()), (std::vector<std::string>{"BHP", "HBK", "KST", "MRW", "DLT"}))
        << "lower case and blanks around a code do not lose it";
    EXPECT_EQ(LastMsg().text, std::string(store::kImportRefusedHeading) + "\nWES.AX\nTOOLONG");
    EXPECT_EQ(LastMsg().title, "Chart Lists");
    EXPECT_EQ(s.settings.Get("SL3TXT", ""), (s.root.path() / "imports").string() + "/");

    s.dialogs.clear();
    w.panel().chooser()->setCurrentIndex(3); // list D, absent until now
    Select(w.fileBox(), {2});
    Click(w, "cmdMove");
    Click(w, "cmdMoveAll");
    EXPECT_EQ(w.fileBox()->count(), 0);
    EXPECT_EQ(Shown(w.panel().list()),
              (std::vector<std::string>{"KST", "BHP", "HBK", "MRW", "DLT"}));
    Click(w, "cmdSave");
    EXPECT_EQ(OnDisk('D'), (std::vector<std::string>{"KST:15", "HBK:12", "MRW:17", "DLT:8"}));
    ASSERT_EQ(s.dialogs.messages().size(), 1u);
    EXPECT_EQ(s.dialogs.messages().back(), std::string(store::kSaveDroppedHeading) + "\nBHP")
        << "a code the name file does not hold is told, not dropped in silence";

    EXPECT_FALSE(w.LoadFile(s.root.path() / "imports" / "missing.txt"));
    gui::SubList3 again(s.session, hub());
    EXPECT_EQ(again.folder(), (s.root.path() / "imports").string() + "/");
    Shot(w, "SubList3");
}

namespace {
void Edit(QTableWidget* grid, int row, int column, const char* text) {
    grid->item(row, column)->setText(QString::fromLatin1(text));
}
QString Cell(QTableWidget* grid, int row, int column) {
    return grid->item(row, column)->text();
}
} // namespace

TEST_F(Lists, IndustryClassesAreCheckedCellByCellAndWrittenBackOnClose) {
    auto* w = new gui::IndClass(s.session);
    QStringList captions;
    for (QAction* a : w->menus()->actions())
        captions << a->text();
    EXPECT_EQ(captions, (QStringList{"&Add Row", "&Delete Row", "&Sort List", "&Close", "&Display",
                                     "&Print"}));
    QTableWidget* grid = w->grid();
    ASSERT_EQ(grid->rowCount(), 25);
    EXPECT_EQ(grid->horizontalHeaderItem(1)->text(), "Industry Classification");

    Edit(grid, 0, 0, "1a");
    EXPECT_EQ(LastMsg().text, "Id must be numeric");
    EXPECT_EQ(LastMsg().title, "Industry Class");
    EXPECT_EQ(Cell(grid, 0, 0), "1a") << "the cell stays as typed";
    Edit(grid, 0, 0, "7");
    EXPECT_EQ(Cell(grid, 0, 0), "007");
    Edit(grid, 1, 1, "Gold, Silver");
    EXPECT_EQ(LastMsg().text, "Commas cannot be used");

    // Closing with a refused cell keeps the window and the file.
    const std::string before = ReadSys("IndClass.dat");
    s.dialogs.clear();
    w->findChild<QAction*>("mnuClose")->trigger();
    EXPECT_EQ(s.dialogs.messages(), std::vector<std::string>{"Commas cannot be used"});
    EXPECT_EQ(ReadSys("IndClass.dat"), before);
    Edit(grid, 1, 1, "Gold and Silver");

    grid->setCurrentCell(24, 0);
    w->AddRow(); // row 25: a code without a name is lost on close
    Edit(grid, 25, 0, "9");
    w->AddRow();
    Edit(grid, 26, 0, "990");
    Edit(grid, 26, 1, " Other ");
    grid->setCurrentCell(2, 0);
    w->DeleteRow(); // 123 Battery Metals
    w->findChild<QAction*>("mnuSort")->trigger();
    EXPECT_EQ(Cell(grid, 0, 0), "007");
    EXPECT_EQ(Cell(grid, 1, 0), "009");
    EXPECT_EQ(Cell(grid, 2, 0), "122");
    s.dialogs.clear();
    w->findChild<QAction*>("mnuClose")->trigger();
    EXPECT_TRUE(s.dialogs.messages().empty());
    const std::string after = ReadSys("IndClass.dat");
    EXPECT_EQ(after.substr(0, 41), "007,Base Metals\r\n122,Gold and Silver\r\n124");
    EXPECT_NE(after.find("811,Food\r\n812,Beverages\r\n990,Other\r\n"), std::string::npos);
    EXPECT_EQ(after.find("009"), std::string::npos);
    EXPECT_EQ(after.find("123"), std::string::npos);
    EXPECT_EQ(store::ClassNameOf(sys(), "990"), "Other");
    delete w;

    // Display reads the file again, forgets edits, and says what it read.
    gui::IndClass again(s.session);
    Edit(again.grid(), 0, 1, "Changed");
    again.statusLine()->clear();
    again.findChild<QAction*>("mnuDisplay")->trigger();
    EXPECT_EQ(Cell(again.grid(), 0, 1), "Base Metals");
    EXPECT_FALSE(again.changed());
    EXPECT_EQ(again.statusLine()->text(),
              QStringLiteral("%1 rows read from IndClass.dat").arg(again.grid()->rowCount()));

    const auto pdf = s.root.path() / "classes.pdf";
    QPrinter printer(QPrinter::HighResolution);
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(QString::fromStdString(pdf.string()));
    again.PrintTo(printer);
    const auto bytes = platform::ReadWholeFile(pdf).value_or("");
    EXPECT_EQ(bytes.substr(0, 4), "%PDF");
    Shot(again, "IndClass");
}

TEST_F(Lists, GicsSectorsKeepThreeFieldsAndFourDigitCodes) {
    gui::GicsClass w(s.session);
    QTableWidget* grid = w.grid();
    ASSERT_EQ(grid->columnCount(), 3);
    EXPECT_EQ(grid->horizontalHeaderItem(0)->text(), "GICS Sector Code");
    EXPECT_EQ(grid->horizontalHeaderItem(2)->text(), "Sub-Sector");
    Edit(grid, 0, 0, "x");
    EXPECT_EQ(LastMsg().title, "GICS Class");
    Edit(grid, 0, 0, "15");
    EXPECT_EQ(Cell(grid, 0, 0), "0015");
    Edit(grid, 0, 2, "Oil, Gas");
    EXPECT_EQ(LastMsg().text, "Commas cannot be used");
    Edit(grid, 0, 2, "Oil and Gas");
    w.reject();
    EXPECT_EQ(ReadSys("Gics.dat").substr(0, 43), "0015,Energy,Oil and Gas\r\n1510,Materials,Mat");
    EXPECT_EQ(store::SectorNameOf(sys(), "0015"), "Energy_Oil and Gas");
    Shot(w, "GicsClass");
}

TEST_F(Lists, ChartSelectionPicksAClassFromTheClassWindow) {
    app::ChartState state;
    gui::ChtSel sel(s.session, state);
    ASSERT_TRUE(sel.Load());
    auto* box = sel.findChild<QCheckBox*>("chkClass");
    ASSERT_NE(box, nullptr);
    box->click();
    // The pick window is modal: double-click the row of 211 (Banks) once it is up.
    QTimer::singleShot(0, [] {
        auto* w = qobject_cast<gui::ClassWindow*>(QApplication::activeModalWidget());
        ASSERT_NE(w, nullptr);
        EXPECT_EQ(w->findChild<QAction*>("mnuAddRow")->isEnabled(), false);
        w->grid()->cellDoubleClicked(9, 1);
    });
    auto* field = sel.findChild<QLineEdit*>("txtClass");
    ASSERT_TRUE(field->isEnabled());
    QTest::mouseDClick(field, Qt::LeftButton);
    EXPECT_EQ(sel.findChild<QLineEdit*>("txtClass")->text(), "211");
    EXPECT_EQ(state.ClassCode, "211");
    ASSERT_TRUE(sel.selection().Current().has_value());
    EXPECT_EQ(sel.selection().Current()->TrimmedCode(), "HBK");

    // Closed without a pick: the walk ends with the message.
    QTimer::singleShot(0, [] {
        auto* w = qobject_cast<gui::ClassWindow*>(QApplication::activeModalWidget());
        ASSERT_NE(w, nullptr);
        EXPECT_EQ(w->objectName(), "GicsClass");
        w->reject();
    });
    sel.PickClassCode(true);
    EXPECT_EQ(LastMsg().text, "GICS Classification invalid");
    EXPECT_EQ(LastMsg().title, "Chart Select");
    EXPECT_FALSE(state.GicsWalk);
}

TEST_F(Lists, RenamingListsAsksBeforeLeavingAndTheChoosersFollow) {
    ASSERT_NE(main.findChild<QAction*>("mnuRenameCL"), nullptr);
    gui::CLNames w(s.session, hub());
    EXPECT_EQ(w.windowTitle(), "Rename Chart Lists");
    EXPECT_EQ(w.field(1)->text(), "Resources");
    EXPECT_EQ(w.field(9)->text(), "Chart List K");
    w.reject();
    EXPECT_TRUE(s.dialogs.messages().empty()) << "nothing changed, nothing asked";

    gui::CLNames again(s.session, hub());
    again.field(1)->setText(" Miners ");
    again.field(2)->setText("");
    s.dialogs.QueueAnswer(Answer::No);
    again.reject();
    EXPECT_EQ(LastMsg().text, "Save changes ?");
    EXPECT_EQ(LastMsg().title, "Sub-List Names");
    EXPECT_EQ(store::GetSubLists(s.settings)[1], "Resources");
    s.dialogs.QueueAnswer(Answer::Yes);
    again.reject();
    EXPECT_EQ(store::GetSubLists(s.settings)[1], "Miners");
    EXPECT_EQ(again.field(2)->text(), "Chart List C") << "a blank name reads as its default";

    gui::SubList2 utilities(s.session, hub());
    EXPECT_EQ(utilities.panel(0).chooser()->itemText(1), "Miners");
    Shot(again, "CLNames");
}

TEST_F(Lists, AMissingClassFileStartsAnEmptyGridAndIsWrittenOnClose) {
    std::filesystem::remove(platform::ResolveIn(sys(), "Gics.dat"));
    gui::GicsClass w(s.session);
    EXPECT_EQ(w.grid()->rowCount(), 0);
    w.findChild<QAction*>("mnuAddRow")->trigger();
    ASSERT_EQ(w.grid()->rowCount(), 1);
    Edit(w.grid(), 0, 0, "4510");
    Edit(w.grid(), 0, 1, "Information Technology");
    w.findChild<QAction*>("mnuClose")->trigger();
    EXPECT_EQ(ReadSys("Gics.dat"), "4510,Information Technology,\r\n");
    EXPECT_EQ(store::SectorNameOf(sys(), "4510"), "Information Technology_");
}

TEST_F(Lists, TheCountUnderAListSaysOneChartNotOneCharts) {
    gui::SubList2 w(s.session, hub());
    auto& left = w.panel(0);
    auto& right = w.panel(1);
    left.chooser()->setCurrentIndex(1);   // Resources
    right.chooser()->setCurrentIndex(10); // Z, empty
    QLabel* count = nullptr;
    for (auto* l : right.findChildren<QLabel*>())
        if (l->objectName().startsWith(QStringLiteral("lblCount"))) count = l;
    ASSERT_NE(count, nullptr);
    Select(left.list(), {0});
    Click(w, "cmdCopyRight");
    EXPECT_EQ(count->text(), QStringLiteral("1 chart"));
    Select(left.list(), {5});
    Click(w, "cmdCopyRight");
    EXPECT_EQ(count->text(), QStringLiteral("2 charts"));
    s.dialogs.QueueAnswer(Answer::No);
    w.reject();
}
