// The multi-oscillator chart window: opened from the chart window's menu on the chart in hand,
// set chooser, page keys, save and print of the whole picture, redraw after the setup is saved.
#include "app/chart_service.h"
#include "desktop_fixture.h"
#include "gui/widgets/chart_view.h"
#include "gui/windows/multi_osc.h"
#include "gui/windows/multi_osc_chart.h"
#include "gui/windows/settings_windows.h"
#include "osc/osc_identifiers.h"
#include "platform/text.h"

#include <QAction>
#include <QKeyEvent>
#include <QLabel>
#include <QListWidget>
#include <QPrinter>

using namespace kori;

namespace {

struct MultiWindow : test::DesktopTest {
    gui::MultiOscChart* OpenFromChartWindow(int set) {
        EXPECT_TRUE(charts()->ShowCode("KRM"));
        auto* menu = chts()->findChild<QAction*>(QStringLiteral("cmMultiOsc%1").arg(set));
        EXPECT_NE(menu, nullptr);
        if (!menu) return nullptr;
        menu->trigger();
        QApplication::processEvents();
        return charts()->multiOscChart();
    }
    int PanelCount(gui::MultiOscChart* w) {
        return static_cast<int>(w->model().lastBuild().Panels.size());
    }
};

} // namespace

TEST_F(MultiWindow, OpensOnTheChartInHandAndSwitchesSetsAndSteps) {
    gui::MultiOscChart* w = OpenFromChartWindow(2);
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->model().Code(), "KRM");
    EXPECT_TRUE(w->windowTitle().startsWith("Multi Oscillator Chart - Set 2"));
    EXPECT_EQ(PanelCount(w), 5);
    EXPECT_FALSE(w->picture()->picture().isNull());

    w->Key("set1")->trigger();
    EXPECT_EQ(w->model().set(), 1);
    EXPECT_TRUE(w->windowTitle().startsWith("Multi Oscillator Chart - Set 1"));
    EXPECT_EQ(PanelCount(w), 3);

    QKeyEvent down(QEvent::KeyPress, Qt::Key_PageDown, Qt::NoModifier);
    QApplication::sendEvent(w, &down);
    EXPECT_NE(w->model().Code(), "KRM");
    QKeyEvent up(QEvent::KeyPress, Qt::Key_PageUp, Qt::NoModifier);
    QApplication::sendEvent(w, &up);
    EXPECT_EQ(w->model().Code(), "KRM");
    EXPECT_EQ(chts()->current().TrimmedCode(), "KRM") << "the chart window keeps its chart";
}

TEST_F(MultiWindow, SavesAndPrintsThePictureWithItsPanelsAndRedrawsAfterTheSetup) {
    gui::MultiOscChart* w = OpenFromChartWindow(1);
    ASSERT_NE(w, nullptr);
    const auto saved = s.root.path() / "multi.cht";
    ASSERT_TRUE(w->SaveChartAs(saved.string()));
    const auto text = platform::ReadWholeFile(saved).value_or("");
    EXPECT_NE(text.find("Relative Strength Index"), std::string::npos);
    EXPECT_NE(text.find("Stochastic"), std::string::npos);
    ASSERT_TRUE(w->DisplaySavedChart(saved.string()));
    EXPECT_TRUE(w->showingSavedChart());

    const auto pdf = s.root.path() / "multi.pdf";
    {
        QPrinter printer(QPrinter::HighResolution);
        printer.setOutputFormat(QPrinter::PdfFormat);
        printer.setOutputFileName(QString::fromStdString(pdf.string()));
        ASSERT_TRUE(w->PrintTo(printer));
    }
    EXPECT_GT(std::filesystem::file_size(pdf), 1000u);

    // The setup key opens "MultiOsc Setup"; saving a set with one slot redraws the chart.
    w->Key("setup")->trigger();
    QApplication::processEvents();
    auto* setup = main.findChild<gui::MultiOsc*>();
    ASSERT_NE(setup, nullptr);
    EXPECT_EQ(setup->windowTitle(), "MultiOsc Setup");
    QListWidget* set1 = setup->set(0);
    for (int i = 1; i < 5; ++i)
        set1->item(i)->setText("None");
    set1->item(0)->setText("Momentum");
    setup->Save();
    QApplication::processEvents();
    ASSERT_EQ(PanelCount(w), 1);
    EXPECT_EQ(w->model().lastBuild().Panels[0].Choice.OscName, "MOM");
    EXPECT_FALSE(w->showingSavedChart());
}
