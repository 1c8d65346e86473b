#pragma once
// The chart list and classification windows as the main window's menu items open them.
namespace kori::gui {

class MainWindow;

// Adds the actions of "Edit Chart &Lists", "Chart List &Utilities", "Rename Chart Lists",
// "&Import Text to Chart Lists", "&Industry Classifications" and "&Global Industry
// Classifications".
void RegisterListWindows(MainWindow& main);

} // namespace kori::gui
