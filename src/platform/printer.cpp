#include "platform/printer.h"

#include <cstdio>

namespace kori::platform {

namespace {
std::string Num(double v) {
    char buf[32];
    std::snprintf(buf, sizeof buf, "%g", v);
    return buf;
}
} // namespace

void RecordingPrinter::Take() {
    for (const auto& c : m_page.calls())
        m_calls.push_back(c);
    m_page.ClearCalls();
}

void RecordingPrinter::SetOrientation(int orientation) {
    m_orientation = orientation;
    m_calls.push_back("Orientation " + std::to_string(orientation));
}
void RecordingPrinter::SetScaleOrigin(double left, double top) {
    m_calls.push_back("Origin " + Num(left) + "," + Num(top));
}
void RecordingPrinter::NewPage() {
    m_calls.push_back("NewPage");
}
Status RecordingPrinter::EndDoc() {
    m_calls.push_back("EndDoc");
    return Status::Ok();
}

void RecordingPrinter::Clear() {
    m_page.Clear();
    Take();
}
void RecordingPrinter::SetBackColour(Colour c) {
    m_page.SetBackColour(c);
}
void RecordingPrinter::SetLineWidth(int width) {
    m_page.SetLineWidth(width);
    Take();
}
void RecordingPrinter::SetLineStyle(LineStyle style) {
    m_page.SetLineStyle(style);
    Take();
}
void RecordingPrinter::SetForeColour(Colour c) {
    m_page.SetForeColour(c);
}
void RecordingPrinter::Line(double x1, double y1, double x2, double y2, Colour c) {
    m_page.Line(x1, y1, x2, y2, c);
    Take();
}
void RecordingPrinter::Box(double x1, double y1, double x2, double y2, Colour c) {
    m_page.Box(x1, y1, x2, y2, c);
    Take();
}
void RecordingPrinter::FilledBox(double x1, double y1, double x2, double y2, Colour c) {
    m_page.FilledBox(x1, y1, x2, y2, c);
    Take();
}
void RecordingPrinter::Point(double x, double y, Colour c) {
    m_page.Point(x, y, c);
    Take();
}
void RecordingPrinter::SetFontName(std::string_view name) {
    m_page.SetFontName(name);
}
void RecordingPrinter::SetFontSize(double points) {
    m_page.SetFontSize(points);
}
void RecordingPrinter::SetFontBold(bool bold) {
    m_page.SetFontBold(bold);
}
void RecordingPrinter::SetFontItalic(bool italic) {
    m_page.SetFontItalic(italic);
}
void RecordingPrinter::SetTextPosition(double x, double y) {
    m_page.SetTextPosition(x, y);
}
void RecordingPrinter::PrintText(std::string_view text) {
    m_page.PrintText(text);
    Take();
}

} // namespace kori::platform
