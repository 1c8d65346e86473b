#pragma once
// Every window the menus can open, registered with the main window by what they open.
namespace kori::gui {

class MainWindow;

void RegisterWindows(MainWindow& main);

} // namespace kori::gui
