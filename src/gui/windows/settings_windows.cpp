#include "gui/windows/settings_windows.h"

#include "app/colour_table.h"
#include "gui/windows/c_path.h"
#include "gui/windows/cht_fonts.h"
#include "gui/windows/col_new.h"
#include "gui/windows/data_paths.h"
#include "gui/windows/main_window.h"
#include "gui/windows/multi_osc.h"
#include "gui/windows/osc_frm.h"

namespace kori::gui {

namespace {
// Settings windows are dialogs over the main window; they delete themselves when closed.
void ShowWindow(QDialog* w) {
    w->setAttribute(Qt::WA_DeleteOnClose);
    w->open();
}
} // namespace

SettingsHub& Hub(MainWindow& main) {
    if (auto* hub = main.findChild<SettingsHub*>(QStringLiteral("SettingsHub"))) return *hub;
    return *new SettingsHub(&main);
}

void RegisterSettingsWindows(MainWindow& main) {
    SettingsHub& hub = Hub(main);
    QObject::connect(&hub, &SettingsHub::DataFolderChanged, &main,
                     [&main] { main.UpdateCaption(); });
    QObject::connect(&hub, &SettingsHub::ExitRequested, &main,
                     [&main] { main.Trigger("mnuExit"); });
    main.SetAction("ChtDef", [&main] { OpenChartDefaults(main, ChtDef::Caller::Menu); });
    main.SetAction("CPath", [&main] { OpenFolderLocations(main); });
    main.SetAction("PrinterColour", [&main] { AskPrinterColours(main); });
    main.SetAction("ChtFonts",
                   [&main] { ShowWindow(new ChtFonts(main.session(), Hub(main), &main)); });
}

void OpenChartDefaults(MainWindow& main, ChtDef::Caller caller, const std::string& code) {
    ShowWindow(new ChtDef(main.session(), Hub(main), caller, code, &main));
}

void OpenOscillatorSettings(MainWindow& main, const std::string& oscName, char chartStyle,
                            const std::string& chartPeriod) {
    ShowWindow(new OscFrm(main.session(), Hub(main), oscName, chartStyle, chartPeriod, &main));
}

void OpenColours(MainWindow& main) {
    ShowWindow(new ColNew(main.session(), Hub(main), &main));
}

void OpenMultiOsc(MainWindow& main) {
    ShowWindow(new MultiOsc(main.session(), Hub(main), &main));
}

void OpenFolderLocations(MainWindow& main) {
    if (main.session().download.DataService == 3) {
        ShowWindow(new DataPaths(main.session(), Hub(main), DataPaths::Mode::Setting, &main));
        return;
    }
    auto* w = new CPath(main.session(), Hub(main), &main);
    if (!w->proceed()) {
        delete w;
        return;
    }
    ShowWindow(w);
}

void AskPrinterColours(MainWindow& main) {
    auto& session = main.session();
    session.printer = app::AskPrinterColours(session.dialogs());
    const std::string file = session.folders.SystemFolder + "koriprn.dat";
    if (auto s = app::WritePrinterFile(file, session.printer); !s)
        session.dialogs().MsgBox(s.message(), "Printer");
}

bool PickDataFolderWindow(MainWindow& main) {
    DataPaths w(main.session(), Hub(main), DataPaths::Mode::Picking, &main);
    w.exec();
    return w.folderChanged();
}

std::optional<app::BoxValueAnswer> AskBoxValue(MainWindow& main, float proposal) {
    return OscFrm::AskBoxValue(main.session(), Hub(main), proposal, &main);
}

} // namespace kori::gui
