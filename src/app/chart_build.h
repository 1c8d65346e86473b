#pragma once
// The one chart-with-panel build: the price chart on the top of the area and, when an
// oscillator is chosen, its panel under it, into one stream. The chart window, `kori chart`,
// the printout (which plays that stream) and the saved chart all come from here, so the
// screen, a PNG, a PDF and paper show the same chart.
#include "app/chart_service.h"
#include "app/session.h"
#include "chart/chart.h"
#include "osc/osc_draw.h"
#include "osc/osc_panel.h"
#include "osc/osc_settings.h"
#include "platform/status.h"
#include "platform/surface.h"

#include <optional>
#include <string>

namespace kori::app {

// The moving-average periods of a request: the daily pair on a daily chart, the long pair on
// a weekly or monthly one.
void ApplyAveragePeriods(chart::ChartRequest& request, const chart::ChartDefaults& defaults);

// Whether the request wants the oscillator panel: an oscillator is chosen that draws in a panel
// (the parabolic goes over the bars), the chart is not point and figure, and it is not split.
bool PanelWanted(const chart::ChartRequest& request);

// Where the area is cut when the panel shows: the panel takes the bottom 3/10.
osc::PanelSplit PanelSplitOf(int areaHeight);

struct PanelOptions {
    std::optional<osc::OscDef> Settings;  // none: as Kori.ini has them
    platform::Dialogs* Dialogs = nullptr; // none: the session's
};

struct ChartOutcome {
    platform::Status Status;
    bool PanelShown = false;
    // What the oscillator routine answered (only when the panel was wanted).
    std::optional<osc::OscOutcome> Panel;
    int PriceHeight = 0; // rows of the area the price chart takes
    // The request the chart was built from (periods, panel flag as they ended up).
    chart::ChartRequest Request;
};

// Builds `job` on `area`. The job is read, never changed. When the routine will not draw on this
// chart (RMO on a weekly chart), the price chart is built again over the whole area.
ChartOutcome BuildChartWithPanel(Session& session, const ChartJob& job, chart::Chart& chart,
                                 platform::Surface& area, const PanelOptions& panel = {});

} // namespace kori::app
