#include "app/session.h"
#include "gui/services/qt_progress.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/chart_windows.h"
#include "gui/windows/cht_sel.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/settings_store.h"
#include "support/sample_session.h"
#include "support/temp_root.h"

#include <QAction>
#include <QApplication>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QScreen>
#include <QScrollBar>
#include <QStatusBar>
#include <gtest/gtest.h>

using namespace kori;

namespace {
struct Fixture {
    test::TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::SettingsStore settings{root.path() / "settings.ini"};
    platform::FixedClock clock{"20261120"};
    app::Session session{root.path(), platform::Services{dialogs, progress, settings, clock}};
};

QStringList MenuTitles(QMainWindow& w) {
    QStringList r;
    for (QAction* a : w.menuBar()->actions())
        r << a->text();
    return r;
}
} // namespace

TEST(MainWindow, CaptionNamesTheDataFolderAndMenusHoldOnlyWhatIsBuilt) {
    Fixture f;
    gui::MainWindow w(f.session);
    EXPECT_EQ(w.windowTitle().toStdString(),
              "Kori Charting 8   -   Current Data Folder " + f.session.folders.DataFolder);
    // Every item shown must lead somewhere: triggering it is accepted.
    for (QAction* top : w.menuBar()->actions()) {
        ASSERT_NE(top->menu(), nullptr);
        for (QAction* a : top->menu()->actions()) {
            if (a->isSeparator() || a->menu()) continue;
            EXPECT_FALSE(a->objectName().isEmpty()) << a->text().toStdString();
        }
    }
    EXPECT_TRUE(MenuTitles(w).contains("&File"));
    w.SetAction("ChtSel", [] {});
    w.RebuildMenus();
    EXPECT_NE(w.findChild<QAction*>("mnuChartDisplay"), nullptr);
}

TEST(MainWindow, ModalToolsHideTheTopsAndBringThemBack) {
    Fixture f;
    gui::MainWindow w(f.session);
    w.SetModalToolRunning(true);
    EXPECT_FALSE(MenuTitles(w).contains("&File"));
    EXPECT_TRUE(MenuTitles(w).contains("&Help"));
    w.SetModalToolRunning(false);
    EXPECT_TRUE(MenuTitles(w).contains("&File"));
}

TEST(MainWindow, TheSessionsWalksReportToTheBarOfTheMainWindowWithAWorkingCancel) {
    test::TempRoot root;
    platform::ScriptedDialogs dialogs;
    gui::QtProgress progress(new QStatusBar);
    platform::SettingsStore settings{root.path() / "settings.ini"};
    platform::FixedClock clock{"20261120"};
    app::Session session{root.path(), platform::Services{dialogs, progress, settings, clock}};
    gui::MainWindow w(session, &progress);
    w.show();
    EXPECT_EQ(w.statusBar(), progress.statusBar());
    EXPECT_EQ(&w.progress(), &progress);
    // A walk of the session: its bar shows in the main window and Cancel reaches the walk.
    platform::Progress& walk = session.services().progress;
    walk.SetRange(10);
    walk.SetValue(3);
    EXPECT_TRUE(progress.barShown());
    auto* cancel = w.statusBar()->findChild<QPushButton*>();
    ASSERT_NE(cancel, nullptr);
    EXPECT_TRUE(cancel->isVisible());
    cancel->click();
    EXPECT_TRUE(walk.Cancelled());
    progress.Finish();
    EXPECT_FALSE(progress.barShown());
}

TEST(MainWindow, AboutNamesTheVersionOfThisBuild) {
    Fixture f;
    gui::MainWindow w(f.session);
    EXPECT_TRUE(w.AboutText().startsWith(QStringLiteral("KORI Charting\nVersion 8.0\n")))
        << w.AboutText().toStdString();
}

TEST(MainWindow, FirstStartShowsChartSelectionWholeOrScrollsToIt) {
    test::SampleSession s;
    gui::MainWindow main{s.session};
    gui::RegisterWindows(main);
    main.show();
    QApplication::processEvents();
    ASSERT_TRUE(main.firstStart());
    EXPECT_GT(main.width(), 640) << "not the clipping design size";
    EXPECT_GT(main.height(), 480);
    const QRect free = main.screen()->availableGeometry();
    EXPECT_LE(main.width(), free.width());
    EXPECT_LE(main.height(), free.height());

    ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
    QApplication::processEvents();
    QMdiSubWindow* sel = nullptr;
    for (auto* w : main.mdiArea()->subWindowList())
        if (qobject_cast<gui::ChtSel*>(w->widget())) sel = w;
    ASSERT_NE(sel, nullptr);
    const QRect area = main.mdiArea()->viewport()->rect();
    const bool whole = area.contains(sel->geometry());
    const bool scrolls = main.mdiArea()->horizontalScrollBar()->isVisible() ||
                         main.mdiArea()->verticalScrollBar()->isVisible();
    EXPECT_TRUE(whole || scrolls) << "clipped with no way to reach the rest";
    // Where the screen has the room, nothing needs scrolling.
    if (free.width() >= 1200 && free.height() >= 900) EXPECT_TRUE(whole);

    // A size kept from an earlier run is the size the next run opens at.
    app::SaveMainWindowPlace(s.settings, {0, 0, 700 * 15, 500 * 15}, gui::ScreenTwips(&main));
    gui::MainWindow again{s.session};
    EXPECT_FALSE(again.firstStart());
    EXPECT_EQ(again.size(), QSize(700, 500));
}
