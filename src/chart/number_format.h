#pragma once
// Number patterns of the chart labels ("###.00", "###.00#", "######", ".00#", "0.00#",
// "#####.00#", "#####0.00", "#,###"): '0' a digit always shown, '#' a digit shown when
// significant, '.' and ',' as usual. Rounding is half away from zero on the decimal digits
// the number prints with: 7 significant digits for a 32-bit float, 15 for a double.
#include <string>
#include <string_view>

namespace kori::chart {

std::string FormatNumber(double value, std::string_view pattern);
std::string FormatNumber(float value, std::string_view pattern);

} // namespace kori::chart
