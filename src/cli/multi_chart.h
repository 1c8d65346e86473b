#pragma once
// kori chart --multi: the price chart with the oscillators of "Multi-Osc 1" or "Multi-Osc 2"
// stacked beneath it, one stream for all.
#include "app/chart_service.h"
#include "app/session.h"
#include "chart/chart.h"
#include "cli/osc_chart.h"
#include "platform/status.h"
#include "platform/surface.h"

namespace kori::cli {

// Throws CliError for a set that is neither 1 nor 2, or for options the multi chart cannot
// take with it (a single oscillator panel, a split).
void CheckMultiOptions(int set, const OscChartOptions& osc, bool split);

// Builds the multi-oscillator chart of `job` on `area` with the set as the settings store
// holds it; an empty set answers its refusal as the status.
platform::Status BuildMultiChart(app::Session& session, const app::ChartJob& job, int set,
                                 chart::Chart& c, platform::Surface& area,
                                 const OscChartOptions& osc);

} // namespace kori::cli
