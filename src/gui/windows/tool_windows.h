#pragma once
// The further tools of the main window's menus: the data check and its report, and the rest of
// the tools as they are built.
namespace kori::gui {

class MainWindow;

void RegisterToolWindows(MainWindow& main);

} // namespace kori::gui
