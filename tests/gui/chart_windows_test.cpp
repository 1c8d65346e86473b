// The road of one chart on the desktop: "&CHARTS", the selection, the chart window and its
// toolbar, a trendline drawn with the mouse, printing to a PDF file, saving and showing again.
#include "desktop_fixture.h"

#include "app/chart_build.h"
#include "app/chart_navigation.h"
#include "app/chart_service.h"
#include "app/chart_window_tools.h"
#include "gui/paint/qt_surface.h"
#include "gui/widgets/chart_view.h"
#include "gui/windows/chart_windows.h"
#include "gui/windows/cht_sel.h"
#include "gui/windows/chts.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "gui/windows/search.h"
#include "gui/windows/settings_hub.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "store/price_file.h"
#include "store/trendline_file.h"

#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QPointer>
#include <QPrinter>
#include <QScrollBar>
#include <QTest>
#include <QTimer>
#include <QToolBar>
#include <QWheelEvent>
#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>

using namespace kori;

namespace {

struct Road : test::DesktopTest {
    gui::ChtSel* sel() { return charts()->chtSel(); }
    void Key(const char* key) {
        QAction* a = chts()->ToolKey(key);
        ASSERT_NE(a, nullptr) << key;
        a->trigger();
        QApplication::processEvents();
    }
    std::string Code() { return chts()->current().TrimmedCode(); }
    // Opens the selection, types a code as the user would, and presses Enter.
    void TypeCode(const char* code) {
        ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
        auto* field = sel()->findChild<QLineEdit*>(QStringLiteral("txtCode"));
        ASSERT_NE(field, nullptr);
        field->setText(QString::fromLatin1(code));
        QTest::keyClick(field, Qt::Key_Return);
        QApplication::processEvents();
    }
    // Saves a picture of the main window when KORI_SHOTS names a folder.
    void Shot(const char* name) {
        if (const char* dir = std::getenv("KORI_SHOTS")) {
            QApplication::processEvents();
            main.grab().save(QString::fromLatin1(dir) + "/" + QString::fromLatin1(name));
        }
    }
};

} // namespace

TEST_F(Road, ChartsMenuOpensTheSelectionAndALowerCaseCodeShowsItsChart) {
    ASSERT_NE(main.findChild<QAction*>(QStringLiteral("mnuChartDisplay")), nullptr);
    ASSERT_NE(main.findChild<QAction*>(QStringLiteral("mnTPSU")), nullptr);
    ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
    ASSERT_NE(sel(), nullptr);
    EXPECT_EQ(sel()->windowTitle().toStdString(), "Chart Selection Menu");
    Shot("chtsel.png");
    TypeCode("krm");
    ASSERT_NE(chts(), nullptr);
    EXPECT_EQ(Code(), "KRM");
    EXPECT_FALSE(sel()->isVisible());
    EXPECT_FALSE(chts()->picture1()->picture().isNull());
    EXPECT_GT(chts()->chart().LastBar(), 100);
    EXPECT_FALSE(chts()->chart().Failed);
    // "&CHARTS" again brings the chart window forward rather than the selection.
    ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
    EXPECT_EQ(main.mdiArea()->activeSubWindow()->widget(), chts());
    Shot("chts.png");
}

TEST_F(Road, NextAndPreviousWalkTheChosenList) {
    ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
    sel()->selection().ChangeList(2, "Banks and Finance");
    sel()->Activate();
    sel()->ShowChart();
    ASSERT_NE(chts(), nullptr);
    EXPECT_EQ(Code(), "HBK");
    Key("fwd");
    EXPECT_EQ(Code(), "IRB");
    Key("rev");
    Key("rev");
    EXPECT_EQ(Code(), "LMT"); // before the first comes the last
    Key("fwd");
    EXPECT_EQ(Code(), "HBK");
    // "new" goes back to the selection, which shows the same list.
    Key("wky");
    Key("new");
    EXPECT_TRUE(sel()->isVisible());
    EXPECT_EQ(sel()->selection().form().Code, "HBK"); // where the chart window got to
    EXPECT_EQ(sel()->selection().form().PeriodIndex, 1);
    EXPECT_EQ(sel()->selection().form().ListCaption, " Banks and Finance");
}

TEST_F(Road, ToolbarStyleAndPeriodRebuildTheChart) {
    TypeCode("alx");
    const QImage bars = chts()->picture1()->picture().copy();
    const std::string firstDaily(chts()->chart().ChartBars()[0].DateText());
    Key("cstick");
    EXPECT_EQ(chts()->chart().Style, 'C');
    EXPECT_NE(chts()->picture1()->picture(), bars);
    Key("wky");
    EXPECT_EQ(charts()->state().Request.ChartPeriod, 'W');
    const std::string firstWeekly(chts()->chart().ChartBars()[0].DateText());
    EXPECT_LT(firstWeekly, firstDaily); // a week a bar reaches further back
    Key("lne");
    EXPECT_EQ(chts()->chart().Style, 'L');
    Key("dly");
    Key("bar");
    EXPECT_EQ(chts()->chart().Style, 'B');
    // Candlesticks widened the spacing to 3, which stays: fewer days fit than at first.
    EXPECT_EQ(charts()->state().Request.BarSpacing, 3);
    EXPECT_GT(std::string(chts()->chart().ChartBars()[0].DateText()), firstDaily);
}

TEST_F(Road, ATrendlineDrawnWithTheMouseComesBackOnItsPeriodOnly) {
    TypeCode("krm");
    Key("tline");
    EXPECT_EQ(chts()->tool(), app::ChartTool::Trendline);
    const auto& c = chts()->chart();
    const int last = c.LastBar();
    const int x1 = c.PlotLeft + (last - 60) * c.BarSpacing,
              x2 = c.PlotLeft + (last - 10) * c.BarSpacing;
    const int y1 = c.PriceToY(c.ChartBars()[static_cast<std::size_t>(last - 60)].Low);
    const int y2 = c.PriceToY(c.ChartBars()[static_cast<std::size_t>(last - 10)].Low);
    gui::ChartView* view = chts()->picture1();
    QTest::mousePress(view, Qt::LeftButton, {}, QPoint(x1, y1));
    QTest::mouseMove(view, QPoint((x1 + x2) / 2, (y1 + y2) / 2));
    QTest::mouseRelease(view, Qt::LeftButton, {}, QPoint(x2, y2));
    const auto path = app::TrendlinePath(s.session, "KRM");
    const auto records = store::TrendlineFile::ReadAll(path);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].Period, 'A');
    EXPECT_EQ(chts()->trendEnds().size(), 1u);
    Shot("trendline.png");

    Key("fwd"); // the next security has no lines
    EXPECT_TRUE(chts()->trendEnds().empty());
    Key("rev");
    EXPECT_EQ(Code(), "KRM");
    EXPECT_EQ(chts()->trendEnds().size(), 1u);
    Key("wky");
    EXPECT_TRUE(chts()->trendEnds().empty());
    Key("dly");
    ASSERT_EQ(chts()->trendEnds().size(), 1u);
    EXPECT_EQ(chts()->trendEnds()[0].xA, x1);

    // The erase key and a right click on the line blank its record.
    s.dialogs.clear();
    Key("terase");
    EXPECT_EQ(s.dialogs.messages().back(),
              "To delete a trendline, click that trendline with your RIGHT mouse button");
    QTest::mouseClick(view, Qt::RightButton, {}, QPoint((x1 + x2) / 2, (y1 + y2) / 2));
    EXPECT_TRUE(chts()->trendEnds().empty());
    EXPECT_TRUE(store::TrendlineFile::ReadAll(path)[0].deleted());
}

TEST_F(Road, CursorReadoutAndFibonacciInTheStatusBar) {
    TypeCode("krm");
    const auto& c = chts()->chart();
    const int last = c.LastBar();
    const auto& bar = c.ChartBars()[static_cast<std::size_t>(last)];
    chts()->MouseMove(c.PlotLeft + last * c.BarSpacing, 100, Qt::NoButton);
    const auto panes = chts()->StatusPanes();
    EXPECT_EQ(panes[0], "Date  " + platform::DateTextToDisplay(bar.DateText()));
    EXPECT_EQ(panes[1], "Open  " + app::ReadoutPrice(bar.Open));
    EXPECT_EQ(panes[4], "Close  " + app::ReadoutPrice(bar.Close));
    EXPECT_EQ(panes[5].rfind("Vol  ", 0), 0u);
    // With no tool a crosshair follows the cursor over the bars.
    ASSERT_TRUE(chts()->picture1()->crosshair());
    EXPECT_EQ(chts()->picture1()->crosshair()->x(), c.PlotLeft + last * c.BarSpacing);
    // The next chart does not keep the prices of this one in the status bar.
    Key("fwd");
    for (const auto& pane : chts()->StatusPanes())
        EXPECT_EQ(pane, "");
    Key("rev");

    Key("fib");
    const double low = c.PriceToY(c.MinLow), high = c.PriceToY(c.MaxHigh);
    chts()->MousePress(c.PlotLeft + 40, low, Qt::LeftButton);
    EXPECT_EQ(chts()->StatusPanes()[0].rfind("Start  ", 0), 0u);
    chts()->MousePress(c.PlotLeft + 300, high, Qt::LeftButton);
    const auto fib = chts()->StatusPanes();
    EXPECT_EQ(fib[0].rfind("End   ", 0), 0u);
    EXPECT_EQ(fib[1].rfind("Rise   ", 0), 0u);
    EXPECT_EQ(fib[2].rfind("38%    ", 0), 0u);
    EXPECT_EQ(fib[3].rfind("50%    ", 0), 0u);
    EXPECT_EQ(fib[4].rfind("62%    ", 0), 0u);
    // Three dotted lines went to ChtLns.Tmp and the stream.
    const std::string lines = platform::ReadWholeFile(app::ChartLinesPath(s.session)).value_or("");
    EXPECT_EQ(std::count(lines.begin(), lines.end(), 'D'), 3);
    Key("sGannAng");
    chts()->MousePress(c.PlotLeft + 100, (low + high) / 2, Qt::LeftButton);
    Shot("tools.png");
}

TEST_F(Road, PrintToAPdfFileThenSaveAndShowTheChartAgain) {
    TypeCode("bwg");
    const auto bytes = PrintToPdf("printed.pdf");
    ASSERT_TRUE(bytes);
    EXPECT_EQ(bytes->rfind("%PDF", 0), 0u);
    EXPECT_GT(bytes->size(), 2000u);

    const std::string saved = s.session.folders.ChtSaveFolder + "BWG.cht";
    s.dialogs.clear();
    EXPECT_FALSE(chts()->SaveChartAs(s.session.folders.ChtSaveFolder + "BWG.txt"));
    EXPECT_EQ(s.dialogs.messages().back(), "File extension must be .cht");
    ASSERT_TRUE(chts()->SaveChartAs(saved));
    EXPECT_EQ(platform::ReadWholeFile(saved),
              platform::ReadWholeFile(app::ChartStreamPath(s.session)));

    const QImage live = chts()->picture1()->picture().copy();
    Key("fwd"); // another chart on show, then the saved one comes back without market data
    ASSERT_TRUE(chts()->DisplaySavedChart(saved));
    EXPECT_TRUE(chts()->showingSavedChart());
    EXPECT_EQ(chts()->picture1()->picture().size(), live.size());
    Shot("saved.png");
}

TEST_F(Road, ZoomOnlyOnBarsAndCandlesticks) {
    TypeCode("krm");
    Key("lne");
    s.dialogs.clear();
    Key("sZoom");
    EXPECT_EQ(s.dialogs.messages().back(), "Zoom only available on Bar & Candlestick charts");
    EXPECT_EQ(chts()->tool(), app::ChartTool::None);
    Key("bar");
    Key("sZoom");
    EXPECT_EQ(chts()->tool(), app::ChartTool::Zoom);
    const auto& c = chts()->chart();
    chts()->MousePress(c.PlotLeft + 200, (c.PlotTop + c.PlotBottom) / 2.0, Qt::LeftButton);
    auto* zoom = chts()->findChild<QDialog*>(QStringLiteral("ZoomKori"));
    ASSERT_NE(zoom, nullptr);
    auto* label = zoom->findChild<QLabel*>();
    ASSERT_NE(label, nullptr);
    EXPECT_EQ(label->pixmap().size(), QSize(600, 450)); // 200 x 150 of the chart, three times
}

TEST_F(Road, FibonacciTimeLinesByTradingOrCalendarDays) {
    TypeCode("krm");
    Key("sFibLines");
    const auto& c = chts()->chart();
    auto lines = [this] {
        const std::string t = platform::ReadWholeFile(app::ChartLinesPath(s.session)).value_or("");
        return std::count(t.begin(), t.end(), '\n');
    };
    chts()->MousePress(c.PlotLeft + 20 * c.BarSpacing, 200, Qt::LeftButton);
    const auto trading = lines();
    EXPECT_GE(trading, 8); // 1, 2, 3, 5, 8, 13, 21, 34, 55, 89, ... bars on a long chart
    auto* kind = chts()->findChild<QAction*>(QStringLiteral("cmFibTimeKind"));
    ASSERT_NE(kind, nullptr);
    EXPECT_EQ(kind->text().toStdString(), "Fib Time Lines - Trading Days");
    kind->trigger();
    EXPECT_EQ(kind->text().toStdString(), "Fib Time Lines - Calander Days");
    chts()->MousePress(c.PlotLeft + 20 * c.BarSpacing, 200, Qt::LeftButton);
    EXPECT_GT(lines(), trading);
}

TEST_F(Road, TheOscillatorPanelShowsOnlyWithAnOscillatorChosen) {
    TypeCode("krm");
    Key("ref");
    EXPECT_FALSE(chts()->panelShown());
    EXPECT_EQ(chts()->model().lastBuild().PriceHeight, chts()->picture1()->picture().height());
    charts()->state().Request.AutoOsc = true;
    charts()->state().Request.AutoOscCode = "RSI";
    Key("ref");
    EXPECT_TRUE(chts()->panelShown());
    // The panel takes the bottom of the one picture, as it does in a PNG of the same size.
    const int height = chts()->picture1()->picture().height();
    EXPECT_EQ(chts()->model().lastBuild().PriceHeight, height - height * 3 / 10);
}

TEST_F(Road, AChosenOscillatorDrawsItsPanelUnderTheChartAndTheParabolicNone) {
    TypeCode("krm");
    auto& req = charts()->state().Request;
    req.AutoOsc = true;
    req.AutoOscCode = "RSI";
    Key("ref");
    ASSERT_TRUE(chts()->panelShown());
    // The panel lies below the price chart in the one stream: some line starts below its area.
    std::ifstream stream(app::ChartStreamPath(s.session));
    const double priceHeight = chts()->model().lastBuild().PriceHeight;
    bool below = false;
    for (std::string l; std::getline(stream, l);) {
        const auto comma = l.find(',', 2); // y1 follows the second comma
        if (l.size() > 2 && l[0] == 'H' && comma != std::string::npos &&
            std::atof(l.c_str() + comma + 1) > priceHeight)
            below = true;
    }
    EXPECT_TRUE(below);

    req.AutoOscCode = "PARA";
    Key("ref");
    EXPECT_FALSE(chts()->panelShown());
}

TEST_F(Road, ASavedChartShowsItsOscillatorPanelAgain) {
    TypeCode("krm");
    auto& req = charts()->state().Request;
    req.AutoOsc = true;
    req.AutoOscCode = "RSI";
    Key("ref");
    ASSERT_TRUE(chts()->panelShown());
    const int top = chts()->model().lastBuild().PriceHeight;
    const QImage& live = chts()->picture1()->picture();
    const QImage livePanel = live.copy(0, top, live.width(), live.height() - top);
    const std::string saved = s.session.folders.ChtSaveFolder + "KRMRSI.cht";
    ASSERT_TRUE(chts()->SaveChartAs(saved));

    req.AutoOsc = false;
    Key("fwd");
    ASSERT_FALSE(chts()->panelShown());
    ASSERT_TRUE(chts()->DisplaySavedChart(saved));
    // The played panel is the live one but for what only the builder draws (blanks of titles).
    const QImage& shown = chts()->picture1()->picture();
    const QImage played = shown.copy(0, top, livePanel.width(), livePanel.height())
                              .convertToFormat(livePanel.format());
    ASSERT_EQ(played.size(), livePanel.size());
    long same = 0, drawn = 0;
    const QRgb back = livePanel.pixel(livePanel.width() - 1, livePanel.height() - 1);
    for (int y = 0; y < played.height(); ++y)
        for (int x = 0; x < played.width(); ++x) {
            same += played.pixel(x, y) == livePanel.pixel(x, y);
            drawn += played.pixel(x, y) != back;
        }
    const long all = static_cast<long>(played.width()) * played.height();
    EXPECT_GT(same, all * 95 / 100) << "the panel of the saved stream is dropped";
    EXPECT_GT(drawn, all / 50);
}

TEST_F(Road, SwingAndSettingsWindowsReachTheChartOnShow) {
    TypeCode("krm");
    auto& req = charts()->state().Request;
    req.BarSpacing = 2;
    auto* swing = chts()->findChild<QAction*>(QStringLiteral("cmSwing"));
    ASSERT_NE(swing, nullptr);
    swing->setChecked(true);
    EXPECT_TRUE(req.SwingOn);
    EXPECT_EQ(req.ChartStyle, 'B');
    EXPECT_EQ(req.BarSpacing, 3);
    EXPECT_EQ(chts()->chart().BarSpacing, 3);
    swing->setChecked(false);
    EXPECT_FALSE(req.SwingOn);
    EXPECT_EQ(req.BarSpacing, 2) << "the spacing in force before comes back";

    // OK in the oscillator settings shows that oscillator under the chart.
    auto* hub = main.findChild<gui::SettingsHub*>(QStringLiteral("SettingsHub"));
    ASSERT_NE(hub, nullptr);
    emit hub->ShowOscillator(QStringLiteral("MACD"));
    QApplication::processEvents();
    EXPECT_EQ(req.AutoOscCode, "MACD");
    EXPECT_TRUE(chts()->panelShown());
}

TEST_F(Road, ScrollAndStepsMoveTheEndOfTheChart) {
    TypeCode("krm");
    // Every rebuild makes a new chart: read it afresh each time.
    auto lastBarDate = [this] {
        const auto& c = chts()->chart();
        return std::string(c.ChartBars()[static_cast<std::size_t>(c.LastBar())].DateText());
    };
    const int lastRecord = chts()->chart().LastRecord;
    const std::string lastDate = lastBarDate();
    Key("m1M");
    const std::string stepped = lastBarDate();
    EXPECT_LT(stepped, chart::AddCalendarPeriods(lastDate, 'M', -1) + "1");
    EXPECT_GT(stepped, chart::AddCalendarPeriods(lastDate, 'M', -2));
    Key("p1M"); // forward past the last record is the latest chart again
    EXPECT_EQ(chts()->chart().LastRecord, lastRecord);
    EXPECT_FALSE(chts()->model().endDate());

    Key("scroll");
    auto* scroll = chts()->findChild<QScrollBar*>(QStringLiteral("KoriScroll"));
    ASSERT_NE(scroll, nullptr);
    EXPECT_TRUE(scroll->isVisible());
    EXPECT_EQ(scroll->maximum(), lastRecord);
    scroll->setValue(lastRecord - 250);
    EXPECT_EQ(chts()->chart().LastRecord, lastRecord - 250);
    EXPECT_EQ(chts()->StatusPanes()[0].find('/') != std::string::npos, true);
}

TEST_F(Road, TextNotesAndAutomaticScroll) {
    TypeCode("krm");
    Key("text");
    const auto& c = chts()->chart();
    const std::string date(c.ChartBars()[40].DateText());
    s.dialogs.QueueInput(std::string("breakout"));
    chts()->MousePress(c.PlotLeft + 40 * c.BarSpacing, c.PriceToY(c.ChartBars()[40].Close),
                       Qt::LeftButton);
    const auto notes = platform::ReadWholeFile(app::NotesPath(s.session, "KRM")).value_or("");
    EXPECT_EQ(notes.rfind("T,8.25," + date + ",", 0), 0u) << notes;
    EXPECT_NE(notes.find(",breakout,"), std::string::npos);

    s.dialogs.QueueInput(std::string("0.05"));
    Key("auto");
    EXPECT_EQ(s.dialogs.shown().back().text, "Set interval between charts (0 - 60 seconds)");
    EXPECT_EQ(s.dialogs.shown().back().title, "Display Interval");
    QTest::qWait(400);
    EXPECT_NE(Code(), "KRM"); // the list moved on by itself
    Key("auto");
    const std::string stopped = Code();
    QTest::qWait(200);
    EXPECT_EQ(Code(), stopped);
}

TEST_F(Road, ClosingTheChartGoesBackToTheSelectionAndCloseEndsBoth) {
    TypeCode("krm");
    QPointer<QMdiSubWindow> chartSub = qobject_cast<QMdiSubWindow*>(chts()->parentWidget());
    ASSERT_TRUE(chartSub);
    chartSub->close();
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QApplication::processEvents();
    EXPECT_TRUE(main.isVisible());
    EXPECT_FALSE(chartSub);
    ASSERT_NE(sel(), nullptr);
    EXPECT_TRUE(sel()->isVisible());
    EXPECT_EQ(sel()->selection().form().Code, "KRM");

    sel()->ShowChart();
    ASSERT_NE(chts(), nullptr);
    sel()->CloseWindow();
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QApplication::processEvents();
    EXPECT_EQ(charts()->chts(), nullptr);
    EXPECT_EQ(charts()->chtSel(), nullptr);
    EXPECT_TRUE(main.mdiArea()->subWindowList().isEmpty());
}

TEST_F(Road, ARightDragInTheTrendlineToolMovesTheNearerEnd) {
    TypeCode("krm");
    Key("tline");
    const auto& c = chts()->chart();
    const int last = c.LastBar();
    const double xA = c.PlotLeft + (last - 80) * c.BarSpacing,
                 xB = c.PlotLeft + (last - 20) * c.BarSpacing;
    const double y = c.PriceToY(c.ChartBars()[static_cast<std::size_t>(last - 80)].Close);
    chts()->MousePress(xA, y, Qt::LeftButton);
    chts()->MouseRelease(xB, y, Qt::LeftButton);
    ASSERT_EQ(chts()->trendEnds().size(), 1u);
    const std::string dateB =
        store::TrendlineFile::ReadAll(app::TrendlinePath(s.session, "KRM"))[0].DateB;
    // Grab near the right end and drop it ten bars further right.
    chts()->MousePress(xB - 1, y, Qt::RightButton);
    chts()->MouseRelease(xB + 10 * chts()->chart().BarSpacing, y, Qt::RightButton);
    const auto records = store::TrendlineFile::ReadAll(app::TrendlinePath(s.session, "KRM"));
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(
        records[0].DateA,
        std::string(chts()->chart().ChartBars()[static_cast<std::size_t>(last - 80)].DateText()));
    EXPECT_GT(records[0].DateB, dateB);
    ASSERT_EQ(chts()->trendEnds().size(), 1u);
    EXPECT_DOUBLE_EQ(chts()->trendEnds()[0].xB, xB + 10 * chts()->chart().BarSpacing);
}

TEST_F(Road, SearchByNameStepsThroughTheMatchesUntilNoMoreMatches) {
    ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
    std::vector<int> found;
    gui::Search search(sel()->selection().walk().names(), 0, s.dialogs,
                       [&](int pos) { found.push_back(pos); });
    search.field()->setText(QStringLiteral("bank"));
    search.FindNext();
    search.FindNext();
    ASSERT_EQ(found.size(), 2u);
    EXPECT_EQ(sel()->selection().walk().RecordAt(found[0])->TrimmedCode(), "HBK");
    EXPECT_EQ(sel()->selection().walk().RecordAt(found[1])->TrimmedCode(), "IRB");
    s.dialogs.clear();
    for (int i = 0; i < 10 && s.dialogs.messages().empty(); ++i)
        search.FindNext();
    ASSERT_FALSE(s.dialogs.messages().empty());
    EXPECT_EQ(s.dialogs.messages().back(), "No more matches");
}

TEST_F(Road, AMissingPriceFileIsReportedAndTheToolsStayQuiet) {
    std::filesystem::remove(store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM"));
    s.dialogs.clear();
    TypeCode("krm");
    ASSERT_NE(chts(), nullptr);
    ASSERT_FALSE(s.dialogs.messages().empty());
    EXPECT_EQ(s.dialogs.shown().back().title, "Chart Display");
    Key("tline");
    chts()->MousePress(100, 100, Qt::LeftButton);
    chts()->MouseMove(150, 120, Qt::LeftButton);
    chts()->MouseRelease(200, 150, Qt::LeftButton);
    EXPECT_FALSE(platform::FileExists(app::TrendlinePath(s.session, "KRM")));
    Key("fwd"); // the walk goes on to the next security
    EXPECT_EQ(Code(), "ALX");
    EXPECT_GT(chts()->chart().LastBar(), 0);
}

TEST_F(Road, AnEndDateMovedInTheWindowStaysWithThatChartOnly) {
    TypeCode("krm");
    const int latest = chts()->chart().LastRecord;
    Key("m1M");
    ASSERT_LT(chts()->chart().LastRecord, latest);
    Key("fwd");
    const std::string next = Code();
    EXPECT_EQ(chts()->chart().LastRecord, app::PriceRecordCount(s.session, next))
        << "the next chart shows its latest data";
    Key("rev");
    EXPECT_EQ(chts()->chart().LastRecord, latest);
    // Back in the selection the finish date still says LATEST, and SHOW CHART means it.
    Key("m1M");
    Key("new");
    auto* finish = sel()->findChild<QLineEdit*>(QStringLiteral("txtFinish"));
    ASSERT_NE(finish, nullptr);
    EXPECT_EQ(finish->text(), QStringLiteral("LATEST"));
    sel()->ShowChart();
    EXPECT_EQ(chts()->chart().LastRecord, latest);
}

TEST_F(Road, TheKeyboardWalksTheListPicksStyleAndPeriodAndLeavesATool) {
    TypeCode("krm");
    main.activateWindow();
    (void)QTest::qWaitForWindowActive(&main);
    QWidget* view = chts()->picture1();
    view->setFocus();
    QTest::keyClick(view, Qt::Key_PageDown);
    EXPECT_NE(Code(), "KRM");
    QTest::keyClick(view, Qt::Key_PageUp);
    EXPECT_EQ(Code(), "KRM");
    QTest::keyClick(view, Qt::Key_Right);
    QTest::keyClick(view, Qt::Key_Left);
    EXPECT_EQ(Code(), "KRM");
    QTest::keyClick(view, Qt::Key_W);
    EXPECT_EQ(charts()->state().Request.ChartPeriod, 'W');
    QTest::keyClick(view, Qt::Key_C);
    EXPECT_EQ(charts()->state().Request.ChartStyle, 'C');
    QTest::keyClick(view, Qt::Key_D);
    QTest::keyClick(view, Qt::Key_B);
    Key("tline");
    ASSERT_EQ(chts()->tool(), app::ChartTool::Trendline);
    QTest::keyClick(view, Qt::Key_Escape);
    EXPECT_EQ(chts()->tool(), app::ChartTool::None);
    EXPECT_FALSE(chts()->ToolKey("tline")->isChecked());

    // After a pick in the oscillator box the keys go to the chart, not to the box.
    auto* box = chts()->findChild<QComboBox*>(QStringLiteral("cboOsc"));
    ASSERT_NE(box, nullptr);
    EXPECT_EQ(box->focusPolicy(), Qt::ClickFocus);
    box->setFocus();
    emit box->activated(1);
    QApplication::processEvents();
    if (main.isActiveWindow()) EXPECT_TRUE(view->hasFocus());
    const int picked = box->currentIndex();
    QTest::keyClick(view, Qt::Key_PageDown);
    EXPECT_EQ(box->currentIndex(), picked) << "PageDown walked the list, not the oscillators";
    EXPECT_NE(Code(), "KRM");
}

TEST_F(Road, TheWheelScrollsTheHistoryAndCtrlWheelChangesTheSpacing) {
    TypeCode("krm");
    const int latest = chts()->chart().LastRecord;
    const int spacing = chts()->chart().BarSpacing;
    auto wheel = [this](int delta, Qt::KeyboardModifiers mods) {
        QWidget* view = chts()->picture1();
        const QPointF at(200, 200);
        QWheelEvent e(at, view->mapToGlobal(at), QPoint(), QPoint(0, delta), Qt::NoButton, mods,
                      Qt::NoScrollPhase, false);
        QApplication::sendEvent(view, &e);
        QApplication::processEvents();
    };
    wheel(120, Qt::NoModifier);
    EXPECT_EQ(chts()->chart().LastRecord, latest - 5);
    wheel(-120, Qt::NoModifier);
    EXPECT_EQ(chts()->chart().LastRecord, latest);
    wheel(120, Qt::ControlModifier);
    EXPECT_EQ(chts()->chart().BarSpacing, spacing + 1);
    wheel(-240, Qt::ControlModifier);
    EXPECT_EQ(chts()->chart().BarSpacing, spacing - 1);
}

TEST_F(Road, ANoteLeavesTheFibonacciLinesOnTheChart) {
    TypeCode("krm");
    const auto& c = chts()->chart();
    Key("fib");
    chts()->MousePress(c.PlotLeft + 40, c.PriceToY(c.MinLow), Qt::LeftButton);
    chts()->MousePress(c.PlotLeft + 300, c.PriceToY(c.MaxHigh), Qt::LeftButton);
    auto dashed = [this] {
        const std::string l = platform::ReadWholeFile(app::ChartLinesPath(s.session)).value_or("");
        return std::count(l.begin(), l.end(), 'D');
    };
    ASSERT_EQ(dashed(), 3);
    Key("text");
    s.dialogs.QueueInput(std::string("note"));
    chts()->MousePress(c.PlotLeft + 100, c.PriceToY(c.ChartBars()[25].Close), Qt::LeftButton);
    ASSERT_NE(platform::ReadWholeFile(app::NotesPath(s.session, "KRM")).value_or("").find("note"),
              std::string::npos);
    EXPECT_EQ(dashed(), 3);
}

TEST_F(Road, AGarbagePriceFileSaysWhyTheChartAreaIsBlank) {
    TypeCode("krm");
    const auto path = store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM");
    const auto size = platform::FileSizeOr0(path);
    {
        // Garbage whose every float reads as the largest float there is: no scale spans it.
        std::string bytes;
        while (bytes.size() < size)
            bytes += std::string("\xff\xff\x7f\x7f", 4);
        std::ofstream out(path, std::ios::binary | std::ios::trunc);
        out << bytes.substr(0, static_cast<std::size_t>(size));
    }
    s.dialogs.clear();
    Key("ref");
    ASSERT_FALSE(s.dialogs.shown().empty());
    EXPECT_EQ(s.dialogs.shown().back().text, "The chart has no usable price scale.");
    EXPECT_EQ(s.dialogs.shown().back().title, "Chart Display");
}

TEST_F(Road, TheOscillatorSettingsAreReachedFromTheChartAndSavesRedraw) {
    TypeCode("krm");
    auto* settings = chts()->findChild<QAction*>(QStringLiteral("cmOscSettings"));
    ASSERT_NE(settings, nullptr);
    settings->trigger();
    QApplication::processEvents();
    auto* frm = main.findChild<QDialog*>(QStringLiteral("OscFrm"));
    ASSERT_NE(frm, nullptr);
    EXPECT_TRUE(frm->isVisible());
    frm->close();
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);

    // "Always show oscillator settings box": a pick in the toolbar opens it.
    charts()->state().Defaults.ShowOscSettings = true;
    auto* box = chts()->findChild<QComboBox*>(QStringLiteral("cboOsc"));
    int rsi = -1;
    for (int i = 0; i < box->count(); ++i)
        if (app::OscChoices()[static_cast<std::size_t>(i)].Code == std::string("RSI")) rsi = i;
    ASSERT_GE(rsi, 0);
    emit box->activated(rsi);
    QApplication::processEvents();
    frm = main.findChild<QDialog*>(QStringLiteral("OscFrm"));
    ASSERT_NE(frm, nullptr);
    EXPECT_TRUE(frm->isVisible());
    frm->close();
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    ASSERT_TRUE(chts()->panelShown());

    // A double click on the panel opens it too.
    const int y = chts()->model().lastBuild().PriceHeight + 30;
    QTest::mouseDClick(chts()->picture1(), Qt::LeftButton, {}, QPoint(200, y));
    QApplication::processEvents();
    frm = main.findChild<QDialog*>(QStringLiteral("OscFrm"));
    ASSERT_NE(frm, nullptr);
    frm->close();
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);

    // SAVE in the chart defaults draws the chart again at once.
    std::filesystem::remove(app::ChartStreamPath(s.session));
    auto* hub = main.findChild<gui::SettingsHub*>(QStringLiteral("SettingsHub"));
    ASSERT_NE(hub, nullptr);
    emit hub->ChartDefaultsSaved();
    QApplication::processEvents();
    EXPECT_TRUE(platform::FileHasData(app::ChartStreamPath(s.session)));
}

TEST_F(Road, ChartSelectionFollowsAStyleChangedInTheChartWindow) {
    TypeCode("krm");
    Key("pf");
    Key("bar");
    Key("new");
    for (const char* name : {"Combo2", "Combo3", "Combo4"}) {
        auto* w = sel()->findChild<QComboBox*>(QString::fromLatin1(name));
        ASSERT_NE(w, nullptr) << name;
        EXPECT_TRUE(w->isEnabled()) << name;
    }
    EXPECT_EQ(sel()->findChild<QComboBox*>(QStringLiteral("Combo1"))->currentIndex(), 0);
}

TEST_F(Road, PrintShowsAPreviewOfThePageFirst) {
    TypeCode("krm");
    QPrinter printer(QPrinter::HighResolution);
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(QString::fromStdString((s.root.path() / "preview.pdf").string()));
    chts()->SetPrinter(&printer);
    bool previewed = false;
    QTimer poll;
    poll.setInterval(50);
    int tries = 0;
    QObject::connect(&poll, &QTimer::timeout, [&] {
        if (++tries > 200) QApplication::exit(); // never reached while the preview works
        if (auto* d = qobject_cast<QDialog*>(QApplication::activeModalWidget());
            d && d->objectName() == QStringLiteral("PrintPreview")) {
            previewed = true;
            d->reject();
        }
    });
    poll.start();
    chts()->Print();
    poll.stop();
    EXPECT_TRUE(previewed);
}

TEST_F(Road, TheScreenShowsThePictureTheSharedBuildMakesForAFile) {
    TypeCode("krm");
    auto& req = charts()->state().Request;
    req.AutoOsc = true;
    req.AutoOscCode = "RSI";
    Key("ref");
    const QImage& shown = chts()->picture1()->picture();
    app::ChartJob job;
    job.Name = chts()->current();
    job.Request = req;
    job.Defaults = charts()->state().Defaults;
    job.WriteStream = false;
    job.DrawOverlays = [this](chart::Chart& c, const chart::ChartRequest& half,
                              platform::Surface& surface) {
        app::DrawChartLines(s.session, c, half, "KRM", surface);
        app::DrawTextNotes(s.session, c, half, "KRM", surface);
    };
    gui::ImageSurface file(shown.width(), shown.height());
    chart::Chart c;
    ASSERT_TRUE(app::BuildChartWithPanel(s.session, job, c, file).Status.ok());
    EXPECT_TRUE(file.Finish() == shown) << "a PNG of the same size is the picture on screen";
}

TEST_F(Road, AMaximisedChartAddsNoSecondToolsMenu) {
    TypeCode("krm");
    auto* bar = chts()->findChild<QMenuBar*>();
    ASSERT_NE(bar, nullptr);
    QStringList titles;
    for (QAction* a : bar->actions())
        titles << a->text();
    EXPECT_FALSE(titles.contains(QStringLiteral("&Tools"))) << titles.join(' ').toStdString();
    EXPECT_TRUE(titles.contains(QStringLiteral("&Lines")));
    // The tool lines menu still holds what it held.
    EXPECT_NE(chts()->findChild<QAction*>(QStringLiteral("cmRemoveTrendlines")), nullptr);
}
