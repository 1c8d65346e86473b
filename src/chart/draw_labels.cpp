#include "chart/draw_labels.h"

#include "platform/number_format.h"

namespace kori::chart {

std::string LastDateText(std::string_view d) {
    std::string s = "Last date processed ";
    if (d.size() < 8) return s;
    return s + std::string(d.substr(6, 2)) + "-" + std::string(d.substr(4, 2)) + "-" +
           std::string(d.substr(2, 2));
}

std::string ClosingPriceText(float close, float previous, std::int16_t recordType) {
    const bool decimals = recordType == 1 || recordType == 2 || recordType == 4;
    const char* pattern = decimals ? "#####.00#" : "#####";
    return "Closing Price : " +
           platform::FormatSingle(close, pattern, platform::ZeroSign::Dropped) + "  (" +
           platform::FormatSingle(previous, pattern, platform::ZeroSign::Dropped) + ")";
}

void DrawTrailingLabels(ChartPainter& p) {
    Chart& c = p.chart;
    const ChartRequest& r = p.in.Request;
    if (c.LastBar() < 0) return;
    const auto& bars = c.ChartBars();
    const store::ChartBar& last = bars[static_cast<std::size_t>(c.LastBar())];
    const bool lowerHalf = r.SplitMode && r.SplitHalf == 2;
    const TextFont f1 = p.Font1();

    if (r.ChartSlot == 0) {
        const std::string text = LastDateText(last.DateText());
        const double y = lowerHalf ? c.TitleTop + 2 : 2;
        p.ScreenText(380, y, text, pal::Labels, f1);
        if (!p.in.PrintBold) p.stream.Text('T', 8.25, 380, y, text, p.Col(pal::Labels));
    }
    const float previous =
        c.LastBar() >= 1 ? bars[static_cast<std::size_t>(c.LastBar() - 1)].Close : 0.0f;
    const std::string closing = ClosingPriceText(last.Close, previous, p.in.Name.RecordType);
    const double y = lowerHalf ? c.TitleTop + 20 : 20;
    p.ScreenText(380, y, closing, pal::Labels, f1);
    if (!p.in.PrintBold) p.stream.Text('T', 8.25, 380, y, closing, p.Col(pal::Labels));
    c.ChartLastClose = last.Close;

    const TextFont stamp{1, 7, true, true};
    const double w = p.Width(kChartStamp, stamp);
    p.ScreenText(c.PlotRight - 30 - w, c.TitleTop - 10, kChartStamp, pal::Labels, stamp);
    if (p.in.PrintBold)
        p.stream.Text('Z', p.in.Fonts.Size1, c.PlotRight - 50 - w, c.TitleTop - 20,
                      kChartStampInStream, p.Col(pal::Labels));
    else
        p.stream.Text('Z', 7, c.PlotRight - 30 - w, c.TitleTop - 10, kChartStampInStream,
                      p.Col(pal::Labels));
}

} // namespace kori::chart
