#pragma once
// One chart of a security of the library, built with the session's colours, fonts, defaults
// and stream: what the chart window, the CLI and the tests all do to get a chart.
#include "app/session.h"
#include "app/split_chart.h"
#include "chart/build_chart.h"
#include "chart/chart.h"
#include "chart/chart_defaults.h"
#include "chart/chart_request.h"
#include "store/name_record.h"

#include <filesystem>
#include <functional>
#include <optional>

namespace kori::app {

// The folder of the scratch files (TCht.Tmp, ChtLns.Tmp), made when missing.
std::filesystem::path TempFolder(const Session& session);
std::filesystem::path ChartStreamPath(const Session& session);

chart::ChartName ChartNameOf(const store::NameRecord& r);

struct ChartJob {
    store::NameRecord Name;
    chart::ChartRequest Request;
    chart::ChartDefaults Defaults;
    bool WriteStream = true;
    chart::PrinterPage* Page = nullptr;
    std::function<void(chart::Chart&, platform::Surface&)> DrawOverlays;
    // The lower half when the request asks for a split; without it both halves show `Name`.
    std::optional<SecondChart> Lower;
};

// Builds the chart of `job.Name` from its price file onto `surface`; a split puts the chart of
// `job.Lower` under it, into the same stream.
platform::Status BuildSecurityChart(Session& session, ChartJob& job, chart::Chart& chart,
                                    platform::Surface& surface);

} // namespace kori::app
