#include "osc/osc_panel.h"

#include "platform/text.h"

#include <cmath>

namespace kori::osc {

std::string TitleNumber(double v) {
    return platform::Str(v);
}

OscPainter::OscPainter(chart::Chart& c, const OscDrawInputs& in, platform::Surface& surface)
    : chart(c), screen(surface), m_in(in) {
    // The panel's instructions follow the price chart's in the same stream.
    (void)chart.Stream.Close();
    if (!chart.RedrawOnly && !in.StreamPath.empty()) {
        (void)chart.Stream.Open(in.StreamPath, true);
    }
    if (!in.Fonts.Font1.empty()) screen.SetFontName(in.Fonts.Font1);
    screen.SetFontSize(8.25);
    screen.SetFontBold(false);
    screen.SetFontItalic(false);
}

OscPainter::~OscPainter() {
    (void)chart.Stream.Close();
}

platform::Colour OscPainter::Col(int entry) const {
    return m_in.Palette[static_cast<std::size_t>(entry)];
}

void OscPainter::Line(char letter, double x1, double y1, double x2, double y2, int entry) {
    screen.Line(x1, y1, x2, y2, Col(entry));
    chart.Stream.Shape(letter, StreamUnits(x1), StreamY(y1), StreamUnits(x2), StreamY(y2),
                       Col(entry));
}

void OscPainter::Dotted(double x1, double y1, double x2, double y2, int entry) {
    screen.SetLineStyle(platform::LineStyle::Dot);
    screen.Line(x1, y1, x2, y2, Col(entry));
    screen.SetLineStyle(platform::LineStyle::Solid);
    chart.Stream.Shape('V', StreamUnits(x1), StreamY(y1), StreamUnits(x2), StreamY(y2), Col(entry));
}

void OscPainter::Dashed(double x1, double y1, double x2, double y2, int entry) {
    screen.SetLineStyle(platform::LineStyle::Dash);
    screen.Line(x1, y1, x2, y2, Col(entry));
    screen.SetLineStyle(platform::LineStyle::Solid);
    chart.Stream.Shape('E', StreamUnits(x1), StreamY(y1), StreamUnits(x2), StreamY(y2), Col(entry));
}

void OscPainter::Box(double x1, double y1, double x2, double y2, int entry) {
    screen.SetLineWidth(1);
    screen.Box(x1, y1, x2, y2, Col(entry));
    chart.Stream.Shape('B', StreamUnits(x1), StreamY(y1), StreamUnits(x2), StreamY(y2), Col(entry));
}

void OscPainter::Text(double x, double y, std::string_view text, int entry) {
    Text(x, x, y, text, entry);
}

void OscPainter::Text(double x, double streamX, double y, std::string_view text, int entry) {
    screen.SetForeColour(Col(entry));
    screen.SetTextPosition(x, y);
    screen.PrintText(text);
    chart.Stream.Text('T', 8.25, StreamUnits(streamX), StreamY(y), text, Col(entry));
}

double OscPainter::Width(std::string_view text) {
    return screen.TextWidth(text);
}

void OscPainter::PriceLine(char letter, double x1, double y1, double x2, double y2,
                           platform::Colour c) {
    if (m_in.PriceSurface == nullptr) return;
    m_in.PriceSurface->Line(x1, y1, x2, y2, c);
    chart.Stream.Shape(letter, StreamUnits(x1), StreamUnits(y1), StreamUnits(x2), StreamUnits(y2),
                       c);
}

OscPanel SetOscPanel(OscPainter& p, bool secondOsc, bool wholeNumberHalves) {
    OscPanel panel;
    panel.SecondOsc = secondOsc;
    if (!secondOsc) {
        p.screen.SetBackColour(p.Col(oscpal::Background));
        p.screen.Clear();
    }
    const double h = p.screen.ScaleHeight();
    if (wholeNumberHalves) {
        const auto whole = static_cast<long>(h);
        panel.OscTop = static_cast<std::int16_t>(whole * 2 / 100);
        panel.OscBottom = static_cast<std::int16_t>(whole * 98 / 100);
    } else {
        panel.OscTop = static_cast<std::int16_t>(std::nearbyint(0.02 * h));
        panel.OscBottom = static_cast<std::int16_t>(std::nearbyint(0.98 * h));
    }
    panel.OscRight = p.chart.PlotRight;
    panel.OscLeft = 5;
    return panel;
}

void DrawTitle(OscPainter& p, const OscPanel& panel, std::string_view title) {
    // The title of the second routine of a pair stands clear of the first one's; the screen
    // and the stream measure that differently.
    const double screenX = panel.OscLeft + (panel.SecondOsc ? 290 : 2);
    const double streamX = panel.OscLeft + (panel.SecondOsc ? 250 : 2);
    p.Text(screenX, streamX, panel.OscTop + 2, title, oscpal::Text);
}

void DrawFrameAndTitle(OscPainter& p, const OscPanel& panel, std::string_view title, bool frame) {
    if (frame && !panel.SecondOsc)
        p.Box(panel.OscLeft, panel.OscTop, panel.OscRight, panel.OscBottom, oscpal::Frame);
    DrawTitle(p, panel, title);
}

void ReferenceLine(OscPainter& p, const OscPanel& panel, double y, std::string_view label,
                   double room, char letter) {
    p.Line(letter, panel.OscLeft, y, panel.OscRight, y, oscpal::Frame);
    if (!label.empty())
        p.Text(panel.OscRight + (room - p.Width(label)), y - 6, label, oscpal::Text);
}

FixedScale MakeFixedScale(const OscPanel& panel) {
    FixedScale s;
    s.Span = panel.OscBottom - panel.OscTop - 20;
    s.Unit = s.Span / 100;
    return s;
}

void MakeSymmetric(double& hi, double& lo) {
    if (lo < -hi)
        hi = -lo;
    else
        lo = -hi;
}

SymmetricScale MakeSymmetricScale(const OscPanel& panel, double hi, double lo) {
    SymmetricScale s;
    MakeSymmetric(hi, lo);
    s.Hi = hi;
    s.Lo = lo;
    const double height = panel.OscBottom - panel.OscTop - 20;
    s.Per = height == 0 ? 0 : (hi - lo) / height;
    return s;
}

void ShowOscFailure(platform::Dialogs& dialogs, int number, std::string_view text) {
    if (number == 480) {
        dialogs.MsgBox("There is not enough memory to complete all pages display. Please ring "
                       "KORI if this message appears often.",
                       "Chart Display");
        return;
    }
    dialogs.MsgBox("There is an unexpected error No. " + std::to_string(number) + "\n" +
                       std::string(text),
                   "Chart Display");
}

PanelSplit SplitChartArea(int areaHeight) {
    PanelSplit s;
    s.PanelHeight = areaHeight * 3 / 10;
    s.PriceHeight = areaHeight - s.PanelHeight;
    return s;
}

} // namespace kori::osc
