#pragma once
// The settings and folder windows as the rest of the program opens them: the menu items of
// the main window, chart selection's "Change Folder" and "Set Defaults", and the chart
// window's oscillator settings and point-and-figure box question.
#include "app/window_rules.h"
#include "gui/windows/cht_def.h"
#include "gui/windows/settings_hub.h"

#include <optional>
#include <string>

namespace kori::gui {

class MainWindow;

// Adds the actions of "Chart De&faults List", "&Folder Locations", "&Fonts" and
// "&Printer Colour", and makes the hub the settings windows report to.
void RegisterSettingsWindows(MainWindow& main);
// The hub under the main window (made by RegisterSettingsWindows).
SettingsHub& Hub(MainWindow& main);

// Each of these opens its window on top of the main window and returns at once.
void OpenChartDefaults(MainWindow& main, ChtDef::Caller caller, const std::string& code = {});
void OpenOscillatorSettings(MainWindow& main, const std::string& oscName, char chartStyle,
                            const std::string& chartPeriod);
void OpenColours(MainWindow& main);
void OpenMultiOsc(MainWindow& main);
// The folder windows of "&Folder Locations": DataPaths in its setting mode for DataService 3,
// else CPath.
void OpenFolderLocations(MainWindow& main);

// "&Printer Colour": the printer questions of start-up again; koriprn.dat is rewritten.
void AskPrinterColours(MainWindow& main);

// Chart selection's "Change Folder": DataPaths in its picking mode, run to its end; true when
// the data folder changed.
bool PickDataFolderWindow(MainWindow& main);
// The point-and-figure question of a chart on a manual scale, run to its end.
std::optional<app::BoxValueAnswer> AskBoxValue(MainWindow& main, float proposal);

} // namespace kori::gui
