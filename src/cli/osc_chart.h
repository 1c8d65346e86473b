#pragma once
// kori chart --osc: the price chart on the top part of the area and the oscillator panel
// under it, split as the chart window splits them, one stream for both.
#include "app/chart_service.h"
#include "app/session.h"
#include "chart/chart.h"
#include "osc/osc_settings.h"
#include "platform/surface.h"

#include <string>
#include <vector>

namespace kori::cli {

struct OscChartOptions {
    std::string osc; // empty: the price chart alone
    bool slow = false;
    std::vector<std::string> sets; // KEY=VALUE overrides of section OscDef for this run
};

// Builds the chart of `job` on `area` through the shared chart-with-panel build, with the panel
// when `o.osc` is set. Throws CliError for an identifier the panel cannot draw.
platform::Status BuildChartWithPanel(app::Session& session, app::ChartJob& job, chart::Chart& c,
                                     platform::Surface& area, const OscChartOptions& o);

// "KEY=VALUE" overrides of section OscDef; throws CliError for a key it does not have.
void ApplyOscSets(osc::OscDef& def, const std::vector<std::string>& sets);

} // namespace kori::cli
