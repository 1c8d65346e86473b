// kori-charting: the desktop program.
#include "app/install_root.h"
#include "app/instance_lock.h"
#include "app/session.h"
#include "app/start_up.h"
#include "gui/services/qt_dialogs.h"
#include "gui/services/qt_progress.h"
#include "gui/windows/chart_windows.h"
#include "gui/windows/help_browser.h"
#include "gui/windows/logo.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "platform/clock.h"
#include "platform/files.h"
#include "platform/heap.h"
#include "platform/settings_store.h"

#include <QApplication>
#include <QCommandLineParser>
#include <QStatusBar>
#include <QTimer>

#include <memory>

int main(int argc, char** argv) {
    kori::platform::KeepFreedMemoryForReuse();
    QApplication qapp(argc, argv);
    QApplication::setApplicationName(QStringLiteral("kori-charting"));
    QCommandLineParser parser;
    parser.addHelpOption();
    QCommandLineOption rootOpt(QStringLiteral("root"),
                               QStringLiteral("Install root (holds Kori.ini)."),
                               QStringLiteral("DIR"));
    parser.addOption(rootOpt);
    QCommandLineOption shotOpt(
        QStringLiteral("screenshot"),
        QStringLiteral("Save a picture of the main window to FILE and quit."),
        QStringLiteral("FILE"));
    parser.addOption(shotOpt);
    QCommandLineOption chartOpt(
        QStringLiteral("chart"),
        QStringLiteral("Open the chart of CODE once the main window stands."),
        QStringLiteral("CODE"));
    parser.addOption(chartOpt);
    parser.addPositionalArgument(QStringLiteral("word"), QStringLiteral("RM, A, N or GD"));
    parser.process(qapp);

    std::optional<std::string> rootArg;
    if (parser.isSet(rootOpt)) rootArg = parser.value(rootOpt).toStdString();
    const auto root = kori::app::FindInstallRoot(rootArg);
    kori::platform::CreateFolderPath(root);

    kori::gui::QtDialogs dialogs;
    // The real progress comes first, so every walk of the session shows its bar and Cancel; its
    // status bar goes to the main window when that stands.
    kori::gui::QtProgress progress(new QStatusBar);
    kori::platform::SettingsStore settings(root / "settings.ini");
    kori::platform::SystemClock clock;
    kori::app::Session session(root, kori::platform::Services{dialogs, progress, settings, clock});

    std::unique_ptr<kori::app::InstanceLock> instance;
    if (!kori::app::CheckSingleInstance(root, dialogs, instance)) return 0;

    kori::gui::Logo logo;
    logo.show();
    QApplication::processEvents();
    QApplication::setOverrideCursor(Qt::WaitCursor);
    const QStringList words = parser.positionalArguments();
    kori::app::InitialiseSession(session,
                                 words.isEmpty() ? std::string() : words.first().toStdString());
    QApplication::restoreOverrideCursor();
    QApplication::processEvents();

    kori::gui::MainWindow main(session, &progress);
    dialogs.SetParent(&main);
    main.SetHideDownloadProgram(session.switches.A);
    kori::gui::RegisterWindows(main);
    // The main window comes up from an event, after the logo window has painted.
    QTimer::singleShot(300, &main, [&] {
        main.show();
        logo.close();
        // Files waiting in the download folder are offered once the main window stands; OK
        // opens the update list.
        if (kori::app::OfferPendingUpdate(session)) (void)main.Trigger("mnuModem");
        // Tips come after every start-up question, and never hold the program up.
        if (!parser.isSet(shotOpt)) kori::gui::ShowTipsIfWanted(main);
        if (parser.isSet(chartOpt))
            if (auto* charts = main.findChild<kori::gui::ChartWindows*>())
                charts->ShowCode(parser.value(chartOpt).toStdString());
        if (parser.isSet(shotOpt)) {
            QTimer::singleShot(700, &main, [&] {
                main.grab().save(parser.value(shotOpt));
                QApplication::quit();
            });
        }
    });
    return QApplication::exec();
}
