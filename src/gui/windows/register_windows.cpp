#include "gui/windows/register_windows.h"

#include "gui/windows/adj_list.h"
#include "gui/windows/adjust_windows.h"
#include "gui/windows/chart_windows.h"
#include "gui/windows/entry_windows.h"
#include "gui/windows/help_browser.h"
#include "gui/windows/list_windows.h"
#include "gui/windows/main_window.h"
#include "gui/windows/maint_windows.h"
#include "gui/windows/settings_windows.h"
#include "gui/windows/tool_windows.h"

namespace kori::gui {

void RegisterWindows(MainWindow& main) {
    // Each family of windows adds its actions here; the menus then show what is built.
    RegisterSettingsWindows(main);
    RegisterChartWindows(main);
    RegisterListWindows(main);
    RegisterMaintWindows(main);
    RegisterAdjustWindows(main);
    RegisterAdjListWindows(main);
    RegisterToolWindows(main);
    RegisterEntryWindows(main);
    RegisterHelpWindows(main);
    main.RebuildMenus();
}

} // namespace kori::gui
