#pragma once
// After the last bar: "Last date processed", "Closing Price" and the program's stamp.
#include "chart/draw_context.h"

#include <string>

namespace kori::chart {

inline constexpr std::string_view kChartStamp = "KORI Charting";

void DrawTrailingLabels(ChartPainter& p);

std::string LastDateText(std::string_view yyyymmdd);
std::string ClosingPriceText(float close, float previous, std::int16_t recordType);

} // namespace kori::chart
