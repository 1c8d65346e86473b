#include "maint/vol_mod.h"

#include "platform/number_format.h"
#include "platform/rounding.h"
#include "platform/text.h"
#include "store/editor_cells.h"

#include <cmath>

namespace kori::maint {

namespace vt = vol_mod_text;

std::optional<VolItem> VolItemNamed(std::string_view name) {
    const std::string up = platform::Upper(platform::Trim(name));
    for (std::size_t i = 0; i < vt::kItems.size(); ++i)
        if (up == vt::kItems[i]) return static_cast<VolItem>(i);
    return std::nullopt;
}

std::string VolModRangeText(int first, int last) {
    if (first == last) return "Modify record " + std::to_string(first);
    return "Modify records " + std::to_string(first) + " to " + std::to_string(last);
}

std::optional<std::string> VolModRefusal(std::optional<VolItem> item, VolOp op) {
    if (!item) return std::string(vt::kNoItem);
    if (op == VolOp::None) return std::string(vt::kNoOperation);
    return std::nullopt;
}

std::optional<std::string> VolModCell(std::string_view text, VolItem item, VolOp op, int factor) {
    if (op == VolOp::None || factor == 0) return std::nullopt;
    const auto value = store::CellNumber(text);
    if (!value) return std::nullopt;
    if (item == VolItem::Volume) {
        const auto whole = platform::CLng(*value);
        if (!whole || *whole == 0) return std::nullopt;
        const long long v = op == VolOp::Multiply ? static_cast<long long>(*whole) * factor
                                                  : static_cast<long long>(*whole) / factor;
        if (v > INT32_MAX || v < INT32_MIN) return std::nullopt;
        return platform::Format(static_cast<double>(v), "######0");
    }
    const auto price = static_cast<float>(*value);
    if (price == 0) return std::nullopt;
    const float f = static_cast<float>(factor);
    const float v = op == VolOp::Multiply ? price * f : price / f;
    if (!std::isfinite(v)) return std::nullopt;
    return platform::FormatSingle(v, "####.0###");
}

} // namespace kori::maint
