#include "store/editor_cells.h"

#include "platform/text.h"

#include <charconv>
#include <cmath>

namespace kori::store {

std::optional<double> CellNumber(std::string_view text) {
    std::string t = platform::Trim(text);
    if (!t.empty() && t.front() == '+') t.erase(0, 1);
    if (t.empty()) return std::nullopt;
    double value = 0;
    const auto [end, ec] = std::from_chars(t.data(), t.data() + t.size(), value);
    if (ec != std::errc() || end != t.data() + t.size() || !std::isfinite(value))
        return std::nullopt;
    return value;
}

std::string CellFloat(float value) {
    if (std::isnan(value)) return "NaN";
    if (std::isinf(value)) return value > 0 ? "Infinity" : "-Infinity";
    return platform::FloatText(value);
}

} // namespace kori::store
