#include "chart/draw_context.h"

#include <algorithm>

namespace kori::chart {

PlotRect PlotFrame(const Chart& c) {
    return {c.PlotLeft - 1.0, static_cast<double>(std::min(c.PlotTop, c.PlotBottom)),
            static_cast<double>(c.PlotRight),
            static_cast<double>(std::max(c.PlotTop, c.PlotBottom))};
}

platform::Colour ChartPainter::Col(int entry) const {
    return in.Palette[static_cast<std::size_t>(entry)];
}

void ChartPainter::Line(char letter, double x1, double y1, double x2, double y2, int entry) {
    screen.Line(x1, y1, x2, y2, Col(entry));
    stream.Shape(letter, x1, y1, x2, y2, Col(entry));
}

void ChartPainter::DottedScreen(double x1, double y1, double x2, double y2, int entry) {
    screen.SetLineStyle(platform::LineStyle::Dot);
    screen.Line(x1, y1, x2, y2, Col(entry));
    screen.SetLineStyle(platform::LineStyle::Solid);
}

void ChartPainter::Dotted(double x1, double y1, double x2, double y2, int entry) {
    DottedScreen(x1, y1, x2, y2, entry);
    stream.Shape('V', x1, y1, x2, y2, Col(entry));
}

void ChartPainter::Box(double x1, double y1, double x2, double y2, int entry) {
    screen.Box(x1, y1, x2, y2, Col(entry));
    stream.Shape('B', x1, y1, x2, y2, Col(entry));
}

void ChartPainter::PlotLine(char letter, double x1, double y1, double x2, double y2, int entry) {
    PlotLine(letter, x1, y1, x2, y2, Col(entry));
}

void ChartPainter::PlotLine(char letter, double x1, double y1, double x2, double y2,
                            platform::Colour colour) {
    const auto part = ClipToFrame(PlotFrame(chart), x1, y1, x2, y2);
    if (!part) return;
    screen.Line(part->X1, part->Y1, part->X2, part->Y2, colour);
    stream.Shape(letter, part->X1, part->Y1, part->X2, part->Y2, colour);
}

bool ChartPainter::InPlot(double x, double y) const {
    const PlotRect f = PlotFrame(chart);
    return x >= f.Left && x <= f.Right && y >= f.Top && y <= f.Bottom;
}

TextFont ChartPainter::Font1(bool bold) const {
    return {1, in.Fonts.Size1, bold, false};
}

TextFont ChartPainter::Font2() const {
    return {2, in.Fonts.Size2, false, false};
}

double ChartPainter::Width(std::string_view text, const TextFont& f) {
    screen.SetFontName(f.Number == 2 ? in.Fonts.Font2 : in.Fonts.Font1);
    screen.SetFontSize(f.Size);
    screen.SetFontBold(f.Bold);
    screen.SetFontItalic(f.Italic);
    return screen.TextWidth(text);
}

void ChartPainter::ScreenText(double x, double y, std::string_view text, int entry,
                              const TextFont& f) {
    screen.SetFontName(f.Number == 2 ? in.Fonts.Font2 : in.Fonts.Font1);
    screen.SetFontSize(f.Size);
    screen.SetFontBold(f.Bold);
    screen.SetFontItalic(f.Italic);
    screen.SetForeColour(Col(entry));
    screen.SetTextPosition(x, y);
    screen.PrintText(text);
    if (f.Italic) screen.SetFontItalic(false);
    screen.SetForeColour(Col(pal::Labels));
}

void ChartPainter::StreamT(double x, double y, std::string_view text, int entry, double dxBold,
                           double dyBold) {
    if (in.PrintBold)
        stream.Text('T', in.Fonts.Size1, x + dxBold, y + dyBold, text, Col(entry));
    else
        stream.Text('T', 8.25, x, y, text, Col(entry));
}

} // namespace kori::chart
