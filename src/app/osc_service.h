#pragma once
// The oscillator panel of a security's chart and the export of its values: the settings of
// Kori.ini, the comparison file of RMO and RMX, and the panel drawn under the price chart.
#include "app/chart_service.h"
#include "app/session.h"
#include "chart/chart.h"
#include "osc/osc_compute.h"
#include "osc/osc_draw.h"
#include "osc/osc_settings.h"

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>

namespace kori::app {

// Every record of a price file as daily bars; nullopt when it cannot be read.
std::optional<store::ChartSeries> LoadWholePriceFile(const std::filesystem::path& path);

// The comparison file named by CompFile, checked (its message shown on failure) and loaded.
struct LoadedCompareFile {
    std::string CompareCode; // empty: no comparison
    store::ChartSeries Series;
};
LoadedCompareFile LoadCompareFile(Session& session, std::string_view compFile);

// A new install has no section OscDef, and every oscillator would read period 0 and draw
// nothing: the section is written with the settings window's defaults, ATR 14, and the index
// file XAO.WDT of the data folder to compare with. An existing section is left as it is.
platform::Status InstallOscDefaults(Session& session);

// Sets one key of section OscDef for this run, by its daily or weekly name ("RsiP", "RsiPW",
// "CompFile", "FXRev", ...). False for a key the section does not have.
bool SetOscKey(osc::OscDef& def, std::string_view key, std::string_view value);

struct OscPanelJob {
    std::string OscName;
    bool SlowStochastic = false;
    double PanelOffset = 0; // top of the panel within the chart page
    std::string TargetName = "CHTS";
    platform::Surface* PriceSurface = nullptr; // for the classic MACD lines
    std::optional<osc::OscDef> Settings;       // none: as Kori.ini has them
};

// Draws the panel of `job.OscName` for the chart just built from `chartJob` onto `panel`,
// appending to the chart's stream.
osc::OscOutcome DrawSecurityOscillator(Session& session, const ChartJob& chartJob,
                                       chart::Chart& chart, const OscPanelJob& job,
                                       platform::Surface& panel);

} // namespace kori::app
