#pragma once
// The editors and repair tools as the main window's menu items open them.
namespace kori::gui {

class MainWindow;

// Adds the actions of "&Name File", "&Data File" (the code entry window, then DataForm),
// "&ASX Code Changed", "Reset read-only data files", "'Old' &files no longer required",
// "&Move data from one folder to another", "&Remove data for a specific date" and
// "Remove &Duplicate Dates".
void RegisterMaintWindows(MainWindow& main);

} // namespace kori::gui
