#include "chart/targets.h"

#include "platform/text.h"
#include "store/targets_file.h"

#include <algorithm>

namespace kori::chart {

std::vector<float> ReadTargetPrices(const std::filesystem::path& targetsFile,
                                    std::string_view code) {
    std::vector<float> prices;
    const std::string wanted = platform::Upper(platform::Trim(code));
    for (const auto& line : store::ReadTargetsFile(targetsFile)) {
        if (prices.size() == 2) break;
        if (platform::Upper(line.Code) != wanted) continue;
        prices.push_back(static_cast<float>(platform::Val(line.Target)));
    }
    return prices;
}

void DrawTargetLines(Chart& c, platform::Surface& surface, const platform::Palette& palette,
                     const std::vector<float>& prices) {
    if (c.Style == 'P' || c.Failed) return;
    const platform::Colour col = palette[pal::TargetLine];
    const auto top = std::min(c.PlotTop, c.PlotBottom), bottom = std::max(c.PlotTop, c.PlotBottom);
    for (float price : prices) {
        if (!(price > 0)) continue;
        const std::int16_t y = c.PriceToY(price);
        if (y < top || y > bottom) continue;
        surface.Line(c.PlotLeft, y, c.PlotRight, y, col);
        c.Stream.Shape('L', c.PlotLeft, y, c.PlotRight, y, col);
    }
}

} // namespace kori::chart
