#pragma once
// The windows of prices typed in or imported, and of the price targets, as the main window's
// menu items open them.
namespace kori::gui {

class MainWindow;

// Adds the actions of "Data Entry via &Keyboard" and of the targets window ("Quoren Alerts").
void RegisterEntryWindows(MainWindow& main);

} // namespace kori::gui
