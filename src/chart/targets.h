#pragma once
// Target prices of Targets.txt drawn across the chart of their security.
#include "chart/chart.h"
#include "platform/palette.h"
#include "platform/surface.h"

#include <filesystem>
#include <string_view>
#include <vector>

namespace kori::chart {

namespace pal {
inline constexpr int TargetLine = 12;
}

// The target prices of the first two lines for `code` (a security may stand on two lines);
// a missing file gives none. Lines are "code,price,U|D".
std::vector<float> ReadTargetPrices(const std::filesystem::path& targetsFile,
                                    std::string_view code);

// A line across the plot for each price above 0 whose y falls within the plot.
void DrawTargetLines(Chart& c, platform::Surface& surface, const platform::Palette& palette,
                     const std::vector<float>& prices);

} // namespace kori::chart
