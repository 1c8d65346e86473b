#include "gui/windows/register_windows.h"

#include "gui/windows/chart_windows.h"
#include "gui/windows/main_window.h"

namespace kori::gui {

void RegisterWindows(MainWindow& main) {
    // Each family of windows adds its actions here; the menus then show what is built.
    RegisterChartWindows(main);
    main.RebuildMenus();
}

} // namespace kori::gui
