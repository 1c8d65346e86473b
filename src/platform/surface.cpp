#include "platform/surface.h"

#include <charconv>
#include <cmath>
#include <cstdio>

namespace kori::platform {

namespace {
void AppendNum(std::string& out, double v) {
    // Whole numbers, the bulk of every chart, skip printf; "%g" would print them the same.
    char buf[32];
    if (v != 0 && std::fabs(v) < 1e6 && v == std::trunc(v)) {
        const auto r = std::to_chars(buf, buf + sizeof buf, static_cast<long>(v));
        out.append(buf, r.ptr);
        return;
    }
    const int n = std::snprintf(buf, sizeof buf, "%g", v);
    out.append(buf, static_cast<std::size_t>(n));
}
std::string Num(double v) {
    std::string s;
    AppendNum(s, v);
    return s;
}
// "Name x1,y1,x2,y2 #colour", built in one string: tests record thousands of these.
std::string Four(const char* name, double a, double b, double c, double d, Colour col) {
    std::string s;
    s.reserve(48);
    s += name;
    s += ' ';
    AppendNum(s, a);
    s += ',';
    AppendNum(s, b);
    s += ',';
    AppendNum(s, c);
    s += ',';
    AppendNum(s, d);
    s += " #";
    char buf[16];
    const auto r = std::to_chars(buf, buf + sizeof buf, col);
    s.append(buf, r.ptr);
    return s;
}
const char* StyleName(LineStyle s) {
    switch (s) {
    case LineStyle::Solid:
        return "solid";
    case LineStyle::Dash:
        return "dash";
    case LineStyle::Dot:
        return "dot";
    }
    return "?";
}
} // namespace

void RecordingSurface::Clear() {
    Add("Clear #" + std::to_string(m_back));
}
void RecordingSurface::SetBackColour(Colour c) {
    m_back = c;
}
void RecordingSurface::SetLineWidth(int width) {
    m_lineWidth = width;
    Add("Width " + std::to_string(width));
}
void RecordingSurface::SetLineStyle(LineStyle style) {
    m_style = style;
    Add(std::string("Style ") + StyleName(style));
}
void RecordingSurface::SetForeColour(Colour c) {
    m_fore = c;
}
void RecordingSurface::Line(double x1, double y1, double x2, double y2, Colour c) {
    Add(Four("Line", x1, y1, x2, y2, c));
}
void RecordingSurface::Box(double x1, double y1, double x2, double y2, Colour c) {
    Add(Four("Box", x1, y1, x2, y2, c));
}
void RecordingSurface::FilledBox(double x1, double y1, double x2, double y2, Colour c) {
    Add(Four("FilledBox", x1, y1, x2, y2, c));
}
void RecordingSurface::Point(double x, double y, Colour c) {
    Add("Point " + Num(x) + "," + Num(y) + " #" + std::to_string(c));
}
void RecordingSurface::SetFontName(std::string_view name) {
    m_fontName = name;
}
void RecordingSurface::SetFontSize(double points) {
    m_fontSize = points;
}
void RecordingSurface::SetFontBold(bool bold) {
    m_bold = bold;
}
void RecordingSurface::SetFontItalic(bool italic) {
    m_italic = italic;
}
void RecordingSurface::SetTextPosition(double x, double y) {
    m_textX = x;
    m_textY = y;
}
void RecordingSurface::PrintText(std::string_view text) {
    Add("Text " + Num(m_textX) + "," + Num(m_textY) + " size " + Num(m_fontSize) +
        (m_bold ? " bold" : "") + (m_italic ? " italic" : "") + " #" + std::to_string(m_fore) +
        " [" + std::string(text) + "]");
    m_textY += TextHeight(text);
}
double RecordingSurface::TextWidth(std::string_view text) {
    return 0.6 * m_fontSize * static_cast<double>(text.size());
}
double RecordingSurface::TextHeight(std::string_view) {
    return 1.5 * m_fontSize;
}

} // namespace kori::platform
