#include "app/session.h"
#include "gui/services/qt_progress.h"
#include "gui/windows/main_window.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/settings_store.h"
#include "support/temp_root.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
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
