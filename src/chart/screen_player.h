#pragma once
// The screen player: plays a stream (TCht.Tmp or a saved .cht file) onto a chart area with no
// market data at all. The screen skips "X" and "K": a saved point-and-figure chart loses its
// falling columns there and parabolic dots are gone; only paper shows them.
#include "chart/stream_reader.h"
#include "platform/dialogs.h"
#include "platform/palette.h"
#include "platform/surface.h"

#include <filesystem>

namespace kori::chart {

inline constexpr const char* kFormatInvalidText =
    "There is problem displaying this chart - format invalid.";
inline constexpr const char* kShowSavedChartTitle = "Show Saved Chart";

// Plays every instruction of `reader` onto `area` by the screen's rules. What was drawn before
// a failure stays drawn.
PlayOutcome PlayOnScreen(StreamReader& reader, platform::Surface& area,
                         const platform::Palette& palette, const platform::ChartFonts& fonts);

// How far a stream reaches: the largest x and y of its instructions, text taken one line
// high. A chart with an oscillator panel reaches below its price area; a player that shows
// the stream whole needs an area this large. Zero for a file that cannot be read.
struct StreamReach {
    double Right = 0, Bottom = 0;
};
StreamReach MeasureStream(const std::filesystem::path& path);

// `ShowSavedChart`: clears the area, plays the file, and shows the format message under
// "Show Saved Chart" unless something was drawn. True when the chart showed.
bool ShowSavedChart(const std::filesystem::path& path, platform::Surface& area,
                    const platform::Palette& palette, const platform::ChartFonts& fonts,
                    platform::Dialogs& dialogs);

} // namespace kori::chart
