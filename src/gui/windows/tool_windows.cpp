#include "gui/windows/tool_windows.h"

#include "gui/windows/chart_windows.h"
#include "gui/windows/chk_dta.h"
#include "gui/windows/main_window.h"

namespace kori::gui {

namespace {

// The chart of a code ending at a date, through the chart road of the main window.
ShowChartAt ChartsOf(MainWindow& main) {
    return [&main](const std::string& code, const std::string& date) {
        if (auto* charts = main.findChild<ChartWindows*>()) charts->ShowCodeAt(code, date);
    };
}

} // namespace

void RegisterToolWindows(MainWindow& main) {
    main.SetAction("ChkDta", [&main] {
        auto* w = new ChkDta(main.session(), main.progress(), ChartsOf(main), &main);
        w->setAttribute(Qt::WA_DeleteOnClose);
        w->open();
    });
}

} // namespace kori::gui
