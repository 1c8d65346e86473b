#include "gui/windows/tool_windows.h"

#include "app/start_up.h"
#include "gui/windows/chart_bak.h"
#include "gui/windows/chart_windows.h"
#include "gui/windows/chk_dta.h"
#include "gui/windows/dl_list.h"
#include "gui/windows/download_settings.h"
#include "gui/windows/fundmnt.h"
#include "gui/windows/main_window.h"
#include "gui/windows/name_data.h"
#include "gui/windows/scan_windows.h"
#include "gui/windows/show_once.h"
#include "gui/windows/snapshot.h"
#include "gui/windows/stats_windows.h"
#include "gui/windows/text_data.h"
#include "gui/windows/watchlist.h"
#include "platform/files.h"

#include <QProcess>

namespace kori::gui {

namespace {

// The chart of a code ending at a date, through the chart road of the main window.
ShowChartAt ChartsOf(MainWindow& main) {
    return [&main](const std::string& code, const std::string& date) {
        if (auto* charts = main.findChild<ChartWindows*>()) charts->ShowCodeAt(code, date);
    };
}

// A tool window over the session and the main window's progress, one at a time.
template <typename Window, typename... Extra>
void Register(MainWindow& main, const char* opens, Extra... extra) {
    main.SetAction(opens, [&main, opens, extra...] {
        // Each window's object name is the name of what opens it.
        ShowOnce(main, opens,
                 [&] { return new Window(main.session(), main.progress(), extra..., &main); });
    });
}

// The chart of a code, through the chart road of the main window.
ShowChartOf ChartOf(MainWindow& main) {
    return [&main](const std::string& code) {
        if (auto* charts = main.findChild<ChartWindows*>()) charts->ShowCode(code);
    };
}

// A scan window: one at a time, and not modal, so that its finds and their charts can be
// looked at side by side.
template <typename Window> void RegisterScan(MainWindow& main, const char* opens) {
    main.SetAction(opens, [&main, opens] {
        if (auto* open = main.findChild<QDialog*>(QString::fromLatin1(opens))) {
            open->raise();
            open->activateWindow();
            return;
        }
        QDialog* w;
        if constexpr (std::is_constructible_v<Window, app::Session&, QWidget*>)
            w = new Window(main.session(), &main);
        else
            w = new Window(main.session(), ChartOf(main), &main);
        w->setAttribute(Qt::WA_DeleteOnClose);
        w->show();
    });
}

// A companion scan program of the system folder, started on its own; the menu offers it only
// when the program is there.
void RegisterCompanion(MainWindow& main, const char* opens, const char* program) {
    main.SetAction(opens, [&main, program] {
        const auto path = platform::ResolveIn(main.session().folders.SystemFolder, program);
        if (!QProcess::startDetached(QString::fromStdString(path.string()), {},
                                     QString::fromStdString(main.session().folders.SystemFolder)))
            main.session().dialogs().MsgBox("Cannot start " + path.string(), "Chart Scans");
    });
}

// The companion download program, offered only when it is installed. When it ends, the days
// it left waiting are offered as at start-up, and taken in through the update list.
void RegisterDownloadProgram(MainWindow& main) {
    const auto path = platform::ResolveIn(main.session().folders.SystemFolder, "KoriDL8.exe");
    if (!platform::FileExists(path)) return;
    main.SetAction("KoriDownload", [&main, path] {
        auto* process = new QProcess(&main);
        process->setObjectName(QStringLiteral("KoriDownload"));
        process->setWorkingDirectory(QString::fromStdString(main.session().folders.SystemFolder));
        QObject::connect(process, &QProcess::finished, &main, [&main, process] {
            process->deleteLater();
            if (app::OfferPendingUpdate(main.session())) main.Trigger("mnuModem");
        });
        QObject::connect(process, &QProcess::errorOccurred, &main,
                         [&main, process, path](QProcess::ProcessError error) {
                             if (error != QProcess::FailedToStart) return;
                             process->deleteLater();
                             main.session().dialogs().MsgBox("Cannot start " + path.string(),
                                                             "Download");
                         });
        process->start(QString::fromStdString(path.string()), {QStringLiteral("AD")});
    });
}

} // namespace

void RegisterToolWindows(MainWindow& main) {
    RegisterDownloadProgram(main);
    Register<ChkDta>(main, "ChkDta", ChartsOf(main));
    Register<TextData>(main, "TextData");
    Register<TextFull>(main, "TextFull");
    RegisterScan<ChtScan1>(main, "chtScan1");
    RegisterScan<ChtScan2>(main, "ChtScan2");
    RegisterScan<ChtScan3>(main, "ChtScan3");
    RegisterScan<ChtScan6>(main, "ChtScan6");
    RegisterScan<Statistics>(main, "Statistics");
    RegisterScan<ADTotals>(main, "ADTotals");
    RegisterCompanion(main, "KoriMaxScan", "KoriMaxScan.exe");
    RegisterCompanion(main, "KoriMMA", "KoriMMA.EXE");
    main.SetAction("ModDetails", [&main] {
        ShowOnce(main, "ModDetails", [&main] { return new ModDetails(main.session(), &main); });
    });
    main.SetAction("DLList", [&main] {
        switch (app::WhatDownloadUpdateOpens(main.session())) {
        case app::DownloadUpdateOpens::List:
            ShowOnce(main, "DLList",
                     [&main] { return new DLList(main.session(), main.progress(), &main); });
            break;
        case app::DownloadUpdateOpens::Settings:
            main.Trigger("mnuDDetails");
            break;
        case app::DownloadUpdateOpens::Nothing:
            break;
        }
    });
    // Without the details the window says so and does not open.
    main.SetAction("Fundmnt", [&main] {
        if (auto* open = main.findChild<Fundmnt*>()) {
            open->raise();
            return;
        }
        auto* w = new Fundmnt(main.session(), &main);
        w->setAttribute(Qt::WA_DeleteOnClose);
        if (!w->loaded()) {
            delete w;
            return;
        }
        w->open();
    });
    Register<Snapshot>(main, "Snapshot", ChartsOf(main));
    // Not modal: a row's chart and the list are looked at side by side.
    RegisterScan<Watchlist>(main, "Watchlist");
    Register<ChartBak>(main, "ChartBak", false);
    Register<ChartBak>(main, "ChartBak Restore", true);
    // The name-file check asks first, as its menu item says.
    main.SetAction("NameData", [&main] {
        app::NameDataForm question(main.session());
        if (!question.Ask()) return;
        ShowOnce(main, "NameData",
                 [&] { return new NameData(main.session(), main.progress(), &main); });
    });
}

} // namespace kori::gui
