// The scan and statistics windows from their menu items over the sample library: the walks,
// their Cancel, the way from a find to its chart, the choices kept, printing, and list Z in the
// list chooser.
#include "desktop_fixture.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/grid_view.h"
#include "gui/windows/cht_options.h"
#include "gui/windows/scan_windows.h"
#include "gui/windows/stats_windows.h"
#include "store/chart_list.h"

#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenu>
#include <QPushButton>
#include <QRadioButton>
#include <QStatusBar>
#include <QTimer>

namespace kori::test {
namespace {

struct ScanWindows : DesktopTest {
    template <typename W> W* Open(const char* item) {
        EXPECT_TRUE(main.Trigger(item)) << item;
        QApplication::processEvents();
        return main.findChild<W*>();
    }
    std::string Code() { return chts() ? chts()->current().TrimmedCode() : std::string(); }
    // Prints a window's finds to a PDF file in the root; its bytes, with a copy to KORI_SHOTS
    // when that names a folder. Nothing when the window printed nothing.
    std::optional<std::string> PrintPdf(gui::ScanWindow* w, const char* fileName) {
        const auto pdf = s.root.path() / fileName;
        {
            QPrinter printer(QPrinter::HighResolution);
            printer.setOutputFormat(QPrinter::PdfFormat);
            printer.setOutputFileName(QString::fromStdString(pdf.string()));
            if (!w->PrintTo(printer)) return std::nullopt;
        }
        auto bytes = platform::ReadWholeFile(pdf);
        if (const char* dir = std::getenv("KORI_SHOTS"); dir && bytes)
            (void)platform::WriteFileAtomic(std::filesystem::path(dir) / fileName, *bytes);
        return bytes;
    }
    static int RowOf(gui::GridView* grid, int column, const char* code) {
        for (int r = 0; r < grid->rowCount(); ++r)
            if (grid->item(r, column) && grid->item(r, column)->text() == QLatin1String(code))
                return r;
        return -1;
    }
    static int LineOf(QListWidget* list, const char* code) {
        for (int r = 0; r < list->count(); ++r)
            if (list->item(r)->text().startsWith(QLatin1String(code) + QLatin1Char(' '))) return r;
        return -1;
    }
};

TEST_F(ScanWindows, EachMenuItemOpensItsWindowOnce) {
    struct Case {
        const char* item;
        const char* name;
        const char* title;
    };
    const Case cases[] = {
        {"mnuChartScan", "chtScan1", "Chart Scan 1 - Prices / Oscillators"},
        {"mnuChartScan2", "ChtScan2", "Chart Scan 2 (Increases in Volume)"},
        {"mnuChtScan3", "ChtScan3", "Chart Scan 3 (Stocks breaking Parabolic Indicator)"},
        {"mnuAvCO", "ChtScan6", "Chart Scan 6 - Average Crossover"},
        {"mnStats", "Statistics", "Top Movers by Percentage"},
        {"mnuADCheck", "ADTotals", "Check Advance/Decline Totals"},
    };
    for (const auto& c : cases) {
        ASSERT_TRUE(main.Trigger(c.item)) << c.item;
        QApplication::processEvents();
        auto* w = main.findChild<QDialog*>(QString::fromLatin1(c.name));
        ASSERT_NE(w, nullptr) << c.item;
        EXPECT_TRUE(w->isVisible()) << c.item;
        EXPECT_EQ(w->windowTitle().toStdString(), c.title);
        ASSERT_TRUE(main.Trigger(c.item));
        EXPECT_EQ(main.findChildren<QDialog*>(QString::fromLatin1(c.name)).size(), 1) << c.item;
    }
    // The companion programs are offered only when they are installed.
    EXPECT_EQ(main.findChild<QAction*>(QStringLiteral("mnuMaxScan")), nullptr);
    EXPECT_EQ(main.findChild<QAction*>(QStringLiteral("mnuMMAScan")), nullptr);
    ASSERT_TRUE(platform::WriteFileAtomic(s.root.path() / "KoriMMA.EXE", "x").ok());
    main.RebuildMenus();
    EXPECT_NE(main.findChild<QAction*>(QStringLiteral("mnuMMAScan")), nullptr);
}

TEST_F(ScanWindows, Scan1FillsItsGridAndADoubleClickShowsTheChart) {
    auto* w = Open<gui::ChtScan1>("mnuChartScan");
    ASSERT_NE(w, nullptr);
    w->rise()->setChecked(true);
    w->risePercent()->setText(QStringLiteral("10"));
    w->osc(0)->setChecked(true); // Stochastic
    w->indication(0)->setChecked(true);
    w->indication(1)->setChecked(true);
    ASSERT_TRUE(w->Proceed());
    EXPECT_EQ(w->heading()->text().toStdString(), "SCAN RESULTS        Date: 20/11/26");
    ASSERT_FALSE(s.dialogs.messages().empty());
    EXPECT_EQ(s.dialogs.messages().back(),
              "The codes have been stored in list Chart Scan Results List\n"
              " This list can be selected to view charts\n from the\n Chart Selection form.");
    const int ten = RowOf(w->grid(), 1, "TENUP");
    ASSERT_GE(ten, 0);
    EXPECT_EQ(w->grid()->item(ten, 4)->text().toStdString(), "U");
    const int high = RowOf(w->grid(), 1, "OBHI");
    ASSERT_GE(high, 0);
    EXPECT_FALSE(w->grid()->item(high, 6)->text().isEmpty()); // its stochastic indication

    w->grid()->setCurrentCell(high, 2);
    emit w->grid()->cellDoubleClicked(high, 2);
    QApplication::processEvents();
    ASSERT_NE(chts(), nullptr);
    EXPECT_EQ(Code(), "OBHI");

    const auto pdf = PrintPdf(w, "scan1.pdf");
    ASSERT_TRUE(pdf);
    EXPECT_EQ(pdf->rfind("%PDF", 0), 0u);
}

TEST_F(ScanWindows, Scan1RefusesBadChoicesAndKeepsGoodOnesForItsNextOpening) {
    auto* w = Open<gui::ChtScan1>("mnuChartScan");
    ASSERT_NE(w, nullptr);
    w->fall()->setChecked(true);
    w->fallPercent()->setText(QStringLiteral("0"));
    EXPECT_FALSE(w->Proceed());
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].text, "Percentage Not valid - Valid Range 1 to 200 ");
    EXPECT_EQ(s.dialogs.shown()[0].title, "Analysis");
    EXPECT_EQ(w->grid()->rowCount(), 0);
    EXPECT_FALSE(PrintPdf(w, "none.pdf")); // nothing found yet: nothing to print
    EXPECT_EQ(s.dialogs.messages().back(), "No records to print");

    w->fallPercent()->setText(QStringLiteral("12"));
    w->frame().Range->setChecked(true);
    w->frame().Max->setText(QStringLiteral("8"));
    w->osc(4)->setChecked(true);
    w->indication(3)->setChecked(true);
    ASSERT_TRUE(w->Proceed());
    w->close();
    QApplication::processEvents(); // deleted on close
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    ASSERT_EQ(main.findChild<gui::ChtScan1*>(), nullptr);

    auto* again = Open<gui::ChtScan1>("mnuChartScan");
    ASSERT_NE(again, nullptr);
    EXPECT_TRUE(again->fall()->isChecked());
    EXPECT_EQ(again->fallPercent()->text().toStdString(), "12");
    EXPECT_TRUE(again->frame().Range->isChecked());
    EXPECT_EQ(again->frame().Max->text().toStdString(), "8");
    EXPECT_TRUE(again->osc(4)->isChecked());
    EXPECT_FALSE(again->osc(0)->isChecked());
    EXPECT_TRUE(again->indication(3)->isChecked());
    EXPECT_FALSE(again->rise()->isChecked());
}

TEST_F(ScanWindows, CancelStopsTheWalkAndLeavesTheScanListAlone) {
    const auto listZ = store::ListPath(s.session.folders.DataFolder, 'Z');
    ASSERT_FALSE(platform::FileExists(listZ));
    auto* w = Open<gui::ChtScan1>("mnuChartScan");
    ASSERT_NE(w, nullptr);
    w->rise()->setChecked(true);
    w->fall()->setChecked(true);
    w->risePercent()->setText(QStringLiteral("1"));
    w->fallPercent()->setText(QStringLiteral("1"));
    // The window's own Cancel, pressed as soon as the walk lets events run.
    QPushButton* cancel = nullptr;
    for (auto* b : w->findChildren<QPushButton*>())
        if (b->text() == QLatin1String("Cancel")) cancel = b;
    ASSERT_NE(cancel, nullptr);
    bool menusWhileWalking = true;
    QTimer::singleShot(0, cancel, [&] {
        menusWhileWalking = main.findChild<QMenu*>(QStringLiteral("mnuAnalysis")) != nullptr;
        cancel->click();
    });
    ASSERT_TRUE(w->Proceed());
    EXPECT_FALSE(menusWhileWalking); // no second walk can start inside this one
    EXPECT_NE(main.findChild<QMenu*>(QStringLiteral("mnuAnalysis")), nullptr);
    EXPECT_TRUE(w->form().result().Cancelled);
    EXPECT_TRUE(s.dialogs.messages().empty()); // no closing message after a cancel
    EXPECT_TRUE(w->status()->text().startsWith(QStringLiteral("Cancelled")));
    EXPECT_FALSE(platform::FileExists(listZ));
    EXPECT_FALSE(w->running());
}

TEST_F(ScanWindows, ListingScansShowTheirFindsAndOpenTheirCharts) {
    auto* scan2 = Open<gui::ChtScan2>("mnuChartScan2");
    ASSERT_NE(scan2, nullptr);
    EXPECT_FALSE(scan2->Proceed());
    EXPECT_EQ(s.dialogs.messages().back(), "No selection made");
    scan2->volume()->setChecked(true);
    ASSERT_TRUE(scan2->Proceed());
    EXPECT_EQ(scan2->heading()->text().toStdString(), "Code   L/Price    Vol+   % +/-");
    const int spike = LineOf(scan2->list(), "VOLSP");
    ASSERT_GE(spike, 0);
    scan2->list()->setCurrentRow(spike);
    emit scan2->list()->itemDoubleClicked(scan2->list()->item(spike));
    QApplication::processEvents();
    EXPECT_EQ(Code(), "VOLSP");

    auto* scan3 = Open<gui::ChtScan3>("mnuChtScan3");
    ASSERT_NE(scan3, nullptr);
    scan3->down()->setChecked(true);
    ASSERT_TRUE(scan3->Proceed());
    EXPECT_EQ(s.dialogs.messages().back(),
              "The codes have been stored in Chart Scan list Z\n The list can be selected for "
              "viewing\n from the\n Chart Selection Window.");
    EXPECT_GE(LineOf(scan3->list(), "PARDN"), 0);
    EXPECT_LT(LineOf(scan3->list(), "PARUP"), 0);
    EXPECT_TRUE(PrintPdf(scan3, "scan3.pdf"));

    auto* scan6 = Open<gui::ChtScan6>("mnuAvCO");
    ASSERT_NE(scan6, nullptr);
    scan6->codeLength()->setCurrentText(QStringLiteral("4"));
    ASSERT_TRUE(scan6->Proceed());
    const int avg = LineOf(scan6->list(), "AVGX");
    ASSERT_GE(avg, 0);
    scan6->list()->setCurrentRow(avg);
    scan6->ShowChart();
    QApplication::processEvents();
    EXPECT_EQ(Code(), "AVGX");
}

TEST_F(ScanWindows, StatisticsAndAdvanceDeclineFromTheirMenus) {
    auto* stats = Open<gui::Statistics>("mnStats");
    ASSERT_NE(stats, nullptr);
    stats->top()->setText(QStringLiteral("3"));
    ASSERT_TRUE(stats->Proceed());
    EXPECT_EQ(stats->status()->text().toStdString(), "COMPLETED");
    auto* grid = stats->grid();
    ASSERT_EQ(grid->rowCount(), 3 + 6);
    EXPECT_EQ(grid->item(1, 0)->text().toStdString(), "PARUP");
    EXPECT_EQ(grid->item(1, 6)->text().toStdString(), "PARDN");
    grid->setCurrentCell(1, 8);
    emit grid->cellDoubleClicked(1, 8);
    QApplication::processEvents();
    EXPECT_EQ(Code(), "PARDN");
    stats->top()->setText(QStringLiteral("1"));
    ASSERT_TRUE(stats->Update());
    EXPECT_EQ(grid->rowCount(), 1 + 6);
    EXPECT_TRUE(PrintPdf(stats, "statistics.pdf"));

    auto* ad = Open<gui::ADTotals>("mnuADCheck");
    ASSERT_NE(ad, nullptr);
    int row = -1;
    for (int i = 0; i < ad->codes()->count(); ++i)
        if (ad->codes()->item(i)->text() == QLatin1String("ADNEW")) row = i;
    ASSERT_GE(row, 0);
    ad->codes()->setCurrentRow(row);
    EXPECT_EQ(ad->name()->text().toStdString(), "New Advance Decline Series (sample)");
    EXPECT_FALSE(ad->base()->text().isEmpty());
    s.dialogs.clear();
    ASSERT_TRUE(ad->CheckTotals());
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].title, "Advance/Decline");
    EXPECT_EQ(s.dialogs.shown()[0].text.rfind(" Checked ", 0), 0u);
}

TEST(ListChooser, OffersTheScanListAfterTheTenLists) {
    std::array<std::string, 10> names;
    for (std::size_t i = 0; i < names.size(); ++i)
        names[i] = "List " + std::to_string(i);
    gui::ChtOptions options(names);
    auto* list = options.list();
    ASSERT_EQ(list->count(), 12);
    list->setCurrentRow(11);
    const auto picked = options.Picked();
    ASSERT_TRUE(picked);
    EXPECT_EQ(picked->first, 12);
    EXPECT_EQ(picked->second, "Chart List Z");
}

} // namespace
} // namespace kori::test
