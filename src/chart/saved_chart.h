#pragma once
// Saved charts: a .cht file is a byte-for-byte copy of the stream TCht.Tmp, never changed once
// saved, and showing one plays it back with no market data at all.
#include "platform/dialogs.h"
#include "platform/palette.h"
#include "platform/surface.h"

#include <filesystem>
#include <string>
#include <string_view>

namespace kori::chart {

// What the name dialog of "Save Chart As ..." answers besides a path.
inline constexpr std::string_view kNameNoGood = "NOGOOD";
inline constexpr std::string_view kNameCancel = "CANCEL";
inline constexpr const char* kSavedChartFilter = "Saved charts (*.cht)|*.cht";

// The name first offered: the security code with ".cht" in the chart folder.
std::string ProposedChartName(std::string_view chartFolder, std::string_view code);

// The last four characters read ".CHT" in upper case.
bool HasChartExtension(std::string_view name);

enum class SaveChartResult { Cancelled, Refused, Saved, NotSaved };

// "Save Chart As": `answer` is the name dialog's answer. Checks the name, asks before
// overwriting, then copies `streamPath` over the chosen file whole or not at all.
SaveChartResult SaveChartAs(std::string_view answer, const std::filesystem::path& streamPath,
                            platform::Dialogs& dialogs);

// "Display Saved Chart": `chosen` is the file dialog's answer (empty when cancelled). True when
// the chart showed.
bool DisplaySavedChart(std::string_view chosen, platform::Surface& area,
                       const platform::Palette& palette, const platform::ChartFonts& fonts,
                       platform::Dialogs& dialogs);

} // namespace kori::chart
