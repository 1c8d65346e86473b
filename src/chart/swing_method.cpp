#include "chart/swing_method.h"

#include "platform/text.h"

#include <array>

namespace kori::chart {

namespace {
constexpr std::array kMethods{SwingMethod::Norm, SwingMethod::XDay, SwingMethod::XPoint,
                              SwingMethod::XPointAuto};
} // namespace

std::span<const SwingMethod> SwingMethods() {
    return kMethods;
}

std::string_view SwingMethodName(SwingMethod m) {
    switch (m) {
    case SwingMethod::XDay:
        return "XDay";
    case SwingMethod::XPoint:
        return "XPoint";
    case SwingMethod::XPointAuto:
        return "XPointAuto";
    case SwingMethod::Norm:
        break;
    }
    return "NORM";
}

std::optional<SwingMethod> ParseSwingMethod(std::string_view text) {
    const std::string t = platform::Trim(text);
    for (SwingMethod m : kMethods)
        if (platform::EqualsNoCase(t, SwingMethodName(m))) return m;
    return std::nullopt;
}

bool SwingMethodTakesValue(SwingMethod m) {
    return m == SwingMethod::XDay || m == SwingMethod::XPoint;
}

float DefaultSwingValue(SwingMethod m) {
    return m == SwingMethod::XDay ? 3.0f : 9.0f;
}

bool SwingValueValid(SwingMethod m, float value) {
    if (m == SwingMethod::XDay) return value >= 1 && value <= 30;
    if (m == SwingMethod::XPoint) return value >= 1;
    return true;
}

float SwingValueOf(SwingMethod m, float value) {
    return value > 0 ? value : DefaultSwingValue(m);
}

SidePanel SwingSidePanel(SwingMethod m) {
    if (m == SwingMethod::Norm) return SidePanel::None;
    return m == SwingMethod::XPointAuto ? SidePanel::XPointAuto : SidePanel::Other;
}

} // namespace kori::chart
