#include "chart/targets.h"

#include "platform/files.h"
#include "platform/text.h"

#include <algorithm>
#include <sstream>

namespace kori::chart {

std::vector<float> ReadTargetPrices(const std::filesystem::path& targetsFile,
                                    std::string_view code) {
    std::vector<float> prices;
    const auto content = platform::ReadWholeFile(targetsFile);
    if (!content) return prices;
    std::istringstream in(*content);
    std::string line;
    const std::string wanted = platform::Trim(code);
    while (prices.size() < 2 && std::getline(in, line)) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        const auto comma = line.find(',');
        if (comma == std::string::npos) continue;
        if (platform::Trim(line.substr(0, comma)) != wanted) continue;
        const auto next = line.find(',', comma + 1);
        prices.push_back(static_cast<float>(platform::Val(
            line.substr(comma + 1, next == std::string::npos ? next : next - comma - 1))));
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
