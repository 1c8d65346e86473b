#pragma once
// After the last bar: "Last date processed", "Closing Price" and the program's stamp.
#include "chart/draw_context.h"

#include <string>

namespace kori::chart {

inline constexpr std::string_view kChartStamp = "KORI Charting";
// The stamp as the stream holds it: a "Z" line loses its blanks when it is played, so the
// stamp's blank is written as a no-break space (Latin-1 0xA0), which prints as a blank.
inline constexpr std::string_view kChartStampInStream = "KORI\xA0"
                                                        "Charting";

void DrawTrailingLabels(ChartPainter& p);

std::string LastDateText(std::string_view yyyymmdd);
std::string ClosingPriceText(float close, float previous, std::int16_t recordType);

} // namespace kori::chart
