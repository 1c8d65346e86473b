// The maintenance list window on the sample library: reached from the menu, the ADJ cell rule,
// the Edit menu, a run of the list, the closing question, and the options window.
#include "gui/windows/adj_list.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "platform/files.h"
#include "store/price_file.h"
#include "support/sample_session.h"

#include <QAction>
#include <QApplication>
#include <QButtonGroup>
#include <QCheckBox>
#include <QLabel>
#include <QMenuBar>
#include <QPrinter>
#include <QTableWidget>
#include <gtest/gtest.h>

using namespace kori;

namespace {

struct AdjListWindow : ::testing::Test {
    test::SampleSession s;
    gui::MainWindow main{s.session};

    void SetUp() override { gui::RegisterWindows(main); }
    void WriteList(const std::string& text) {
        ASSERT_TRUE(platform::WriteFileAtomic(
            platform::ResolveIn(s.session.folders.DataFolder, "Adjust.Lst"), text));
    }
    gui::AdjList* Open() {
        EXPECT_TRUE(main.Trigger("mnuAdjExBtn"));
        QApplication::processEvents();
        return main.findChild<gui::AdjList*>();
    }
    void Pick(gui::AdjList* w, const char* name) {
        auto* a = w->findChild<QAction*>(QString::fromLatin1(name));
        ASSERT_NE(a, nullptr) << name;
        a->trigger();
        QApplication::processEvents();
    }
    std::string Text(gui::AdjList* w, int row, int col) {
        return w->grid()->item(row, col)->text().toStdString();
    }
    float LastAdjFactor(const char* code) {
        std::vector<store::PriceRecord> recs;
        store::PriceFile f(store::PriceFile::PathFor(s.session.folders.DataFolder, code));
        EXPECT_TRUE(f.ReadAll(recs));
        return recs.empty() ? -1 : recs[recs.size() - 2].AdjFactor;
    }
};

TEST_F(AdjListWindow, TheMenuOpensItWithItsCaptionHeadingsAndLabel) {
    auto* w = Open();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle(), "KORI Data Mainenance");
    EXPECT_EQ(w->label()->text(), "There is no bulletin data");
    EXPECT_EQ(w->grid()->horizontalHeaderItem(0)->text(), "Act");
    EXPECT_EQ(w->grid()->horizontalHeaderItem(4)->text(), "ADJ");
    EXPECT_EQ(w->grid()->horizontalHeaderItem(5)->text(), "Name");
    for (const char* item :
         {"alSave", "alPage", "alPrint", "alExit", "alSort", "alSetY", "alSetN", "alSetD", "rmOPTS",
          "rmWNT", "alDelRow", "alopt", "alDisplay", "muAdj", "muRemAdj"})
        EXPECT_NE(w->findChild<QAction*>(QString::fromLatin1(item)), nullptr) << item;
    // A second pick brings the same window forward.
    EXPECT_EQ(Open(), w);
}

TEST_F(AdjListWindow, IndicatorsAreYNOrDAndTheEditMenuSortsAndRemoves) {
    WriteList("DI,HBK,20NOV26,0,N,20NOV26,,,85\r\nEN,XX1,OPT,0,N\r\n"
              "BI,KRM,20NOV26,0,N,20NOV26,1,4\r\nNI,NEW,WNT,0,N,NEW ONE\r\n");
    auto* w = Open();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->label()->text(), "Click MAKE ADJUSTMENTS (above) to process maintenance data");
    ASSERT_EQ(w->grid()->rowCount(), 4);
    w->grid()->item(0, 4)->setText("X");
    EXPECT_EQ(Text(w, 0, 4), "N"); // refused: the cell keeps its value
    ASSERT_FALSE(s.dialogs.messages().empty());
    EXPECT_EQ(s.dialogs.shown().back().title, "Adjustment ");
    w->grid()->item(0, 4)->setText("y");
    EXPECT_EQ(Text(w, 0, 4), "Y");

    Pick(w, "alSort"); // NI 1, BI 5, DI 7, EN 8
    EXPECT_EQ(Text(w, 0, 1), "NEW");
    EXPECT_EQ(Text(w, 1, 1), "KRM");
    EXPECT_EQ(Text(w, 2, 1), "HBK");
    Pick(w, "rmOPTS");
    Pick(w, "rmWNT");
    ASSERT_EQ(w->grid()->rowCount(), 2);
    Pick(w, "alSetD");
    EXPECT_EQ(Text(w, 1, 4), "D");
    Pick(w, "muRemAdj");
    EXPECT_EQ(w->grid()->rowCount(), 0);
    EXPECT_EQ(w->label()->text(), "There is no bulletin data");
    EXPECT_EQ(
        platform::ReadWholeFile(platform::ResolveIn(s.session.folders.DataFolder, "Adjust.Lst")),
        std::string());
}

TEST_F(AdjListWindow, MakeAdjustmentsCarriesOutTheMarkedItems) {
    WriteList("BI,KRM,20NOV26,0,Y,20NOV26,1,4\r\nEN,XX1,20NOV26,0,N\r\n");
    auto* w = Open();
    ASSERT_NE(w, nullptr);
    Pick(w, "muAdj");
    // The record before the 20th carries the factor of a 1 for 4 bonus.
    EXPECT_FLOAT_EQ(LastAdjFactor("KRM"), 0.8f);
    ASSERT_EQ(w->grid()->rowCount(), 1);
    EXPECT_EQ(Text(w, 0, 1), "XX1");
    EXPECT_NE(w->status()->text().toStdString().find("Adjustment :KRM  bi"), std::string::npos);
    EXPECT_TRUE(w->form().processed());
}

TEST_F(AdjListWindow, ClosingAsksToSaveAndToProcess) {
    WriteList("EN,XX1,20NOV26,0,N\r\n");
    auto* w = Open();
    ASSERT_NE(w, nullptr);
    w->grid()->item(0, 4)->setText("D");
    s.dialogs.QueueAnswer(platform::Answer::Yes); // save
    s.dialogs.QueueAnswer(platform::Answer::No);  // do not process now
    w->close();
    QApplication::processEvents();
    const auto& shown = s.dialogs.shown();
    ASSERT_GE(shown.size(), 2u);
    EXPECT_EQ(shown[shown.size() - 2].text, "File has changed. SAVE Changes?");
    EXPECT_EQ(shown[shown.size() - 2].title, "Adjustments List");
    EXPECT_EQ(shown.back().title, "Process Adjustments");
    EXPECT_EQ(
        platform::ReadWholeFile(platform::ResolveIn(s.session.folders.DataFolder, "Adjust.Lst")),
        std::string("EN,XX1,20NOV26,0,D\r\n"));
}

TEST_F(AdjListWindow, OptionsAreSavedInTheirSection) {
    auto* w = Open();
    ASSERT_NE(w, nullptr);
    gui::AdjOpts opts(s.session, w);
    EXPECT_EQ(opts.windowTitle(), "Adjustments");
    EXPECT_EQ(opts.divs()->button(3)->text(), "Include dividends - Set ADJ indicator to N");
    opts.divs()->button(3)->setChecked(true);
    opts.noShortNames()->setChecked(true);
    opts.Save();
    EXPECT_EQ(s.session.ini().Read("Adjustments", "Divs"), "3");
    EXPECT_EQ(s.session.adjustments.Divs, 3);
    EXPECT_TRUE(s.session.adjustments.NoShortNames);
}

TEST_F(AdjListWindow, TheListPrintsAPageForEachScreenfulOfLines) {
    std::string list;
    for (int i = 0; i < 200; ++i)
        list += "EN,C" + std::to_string(i) + ",20NOV26,0,N\r\n";
    WriteList(list);
    auto* w = Open();
    ASSERT_NE(w, nullptr);
    const auto pdf = s.root.path() / "list.pdf";
    QPrinter printer(QPrinter::HighResolution);
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(QString::fromStdString(pdf.string()));
    ASSERT_TRUE(w->PrintTo(printer));
    const auto bytes = platform::ReadWholeFile(pdf).value_or("");
    EXPECT_TRUE(bytes.starts_with("%PDF"));
    // 202 lines do not fit one page.
    std::size_t pages = 0;
    for (auto at = bytes.find("/Type /Page\n"); at != std::string::npos;
         at = bytes.find("/Type /Page\n", at + 1))
        ++pages;
    EXPECT_GE(pages, 2u);
}

} // namespace
