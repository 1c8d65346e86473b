#pragma once
// The four swing methods with everything that depends on the method alone: the name kept in
// the settings, the value it uses and its limits, and how the swing shares the chart area.
#include <optional>
#include <span>
#include <string_view>

namespace kori::chart {

inline constexpr std::string_view kSwingTitle = "Swing";
inline constexpr std::string_view kSwingRefusal = "Incorrect values entered";

// How a swing or point-and-figure panel shares the chart area with the bars.
enum class SidePanel { None, XPointAuto, Other };

enum class SwingMethod {
    Norm,      // "NORM": plain high-low swing with outside bars
    XDay,      // "XDay": N bars against the swing
    XPoint,    // "XPoint": a fall or rise of V cents or points
    XPointAuto // "XPointAuto": V from the mean swing of the chart
};

// In the order the swing window offers them.
std::span<const SwingMethod> SwingMethods();
std::string_view SwingMethodName(SwingMethod m);
// The stored or typed name, in any case and with blanks around it; nothing for another text.
std::optional<SwingMethod> ParseSwingMethod(std::string_view text);

// Only "XDay" and "XPoint" take a value from the user.
bool SwingMethodTakesValue(SwingMethod m);
// 3 days for "XDay", 9 points for the point methods.
float DefaultSwingValue(SwingMethod m);
// "XDay" 1 to 30, "XPoint" 1 or more; any value for the others, which use none.
bool SwingValueValid(SwingMethod m, float value);
// The value in force: one not above 0 (never set) takes the default.
float SwingValueOf(SwingMethod m, float value);
// "NORM" draws over the bars; "XPointAuto" takes 35% of the plot; the others half.
SidePanel SwingSidePanel(SwingMethod m);

} // namespace kori::chart
