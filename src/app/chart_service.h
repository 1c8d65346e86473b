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

// What every build of the session reads and none changes: made once from the `Session`.
struct ChartContext {
    const platform::Palette& Palette;
    const platform::ChartFonts& Fonts;
    platform::Dialogs& Dialogs;
    std::string DataFolder;
    std::filesystem::path SystemFolder;
    std::filesystem::path StreamPath; // empty: no stream written
    std::int32_t VolumeDivisor = 1;

    // `dialogs`: where the build's messages go, the session's when none.
    static ChartContext Of(Session& session, bool writeStream = true,
                           platform::Dialogs* dialogs = nullptr);
};

struct ChartJob {
    store::NameRecord Name;
    chart::ChartRequest Request;
    chart::ChartDefaults Defaults;
    bool WriteStream = true;
    chart::PrinterPage* Page = nullptr;
    // Runs at the end of each half with the request of that half (a split's lower half has
    // `SplitHalf` 2 and the lower period).
    std::function<void(chart::Chart&, const chart::ChartRequest&, platform::Surface&)> DrawOverlays;
    // The lower half when the request asks for a split; without it both halves show `Name`.
    std::optional<SecondChart> Lower;
};

// Builds the chart of `job.Name` from its price file onto `surface`; a split puts the chart of
// `job.Lower` under it, into the same stream. The job is read, never changed.
platform::Status BuildSecurityChart(const ChartContext& context, const ChartJob& job,
                                    chart::Chart& chart, platform::Surface& surface);
platform::Status BuildSecurityChart(Session& session, const ChartJob& job, chart::Chart& chart,
                                    platform::Surface& surface);

} // namespace kori::app
