#pragma once
// VolMod: the highlighted rows of the data window, one item of each multiplied or divided by a
// factor. Volumes in whole numbers, prices as floats; a 0 stays 0.
#include "platform/issues.h"

#include <array>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

namespace vol_mod_text {
inline constexpr std::string_view kCaption = "Data Modification";
inline constexpr std::string_view kExplain =
    "This procedure multiplies or divides the VOLUMES of the highlighted record/s, by the "
    "factor selected. ";
inline constexpr std::string_view kNoItem = "No data item to Adjust";
inline constexpr std::string_view kNoOperation = "Multiply or Divide option must be selected";
inline constexpr std::array<std::string_view, 5> kItems = {"OPEN", "HIGH", "LOW", "CLOSE",
                                                           "VOLUME"};
} // namespace vol_mod_text

enum class VolItem { Open, High, Low, Close, Volume };
enum class VolOp { None, Multiply, Divide };

// The factors offered: "x 10", "x 100", ... and "/ 10", "/ 100", ...
inline constexpr std::array<int, 4> kVolModFactors = {10, 100, 1000, 10000};

std::optional<VolItem> VolItemNamed(std::string_view name); // "OPEN" .. "VOLUME", any case
// "Modify records a to b" or "Modify record a".
std::string VolModRangeText(int first, int last);
// Why the request cannot run: no item, or no operation; nullopt when it can.
std::optional<std::string> VolModRefusal(std::optional<VolItem> item, VolOp op);

// One cell changed: a volume read as a whole number, skipped when 0, multiplied or divided in
// whole numbers and written "######0"; a price read as a float, skipped when 0, written
// "####.0###". Nullopt when the cell stays (0, not a number, or a volume that would not fit).
std::optional<std::string> VolModCell(std::string_view text, VolItem item, VolOp op, int factor);

} // namespace kori::maint
