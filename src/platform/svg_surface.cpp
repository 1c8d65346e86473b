#include "platform/svg_surface.h"

#include "platform/files.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace kori::platform {

namespace {

constexpr double kUnitsPerPoint = 96.0 / 72.0;
constexpr double kAscent = 0.905;     // of the em, Arial and its metric twins
constexpr double kLineHeight = 1.149; // ascent + descent + line gap

// Advance widths in thousandths of an em of the printable ASCII characters, from the blank
// to the tilde; other characters count as an "n".
constexpr short kAdvance[95] = {
    278, 278, 355, 556, 556, 889, 667, 191, 333, 333, 389, 584, 278, 333,  278, 278, 556, 556, 556,
    556, 556, 556, 556, 556, 556, 556, 278, 278, 584, 584, 584, 556, 1015, 667, 667, 722, 722, 667,
    611, 778, 722, 278, 500, 667, 556, 833, 722, 778, 667, 778, 722, 667,  611, 722, 667, 944, 667,
    667, 611, 278, 278, 278, 469, 556, 333, 556, 556, 500, 556, 556, 278,  556, 556, 222, 222, 500,
    222, 833, 556, 556, 556, 556, 333, 500, 278, 556, 500, 722, 500, 500,  500, 334, 260, 334, 584};
constexpr double kBoldWidening = 1.07;

std::string Num(double v) {
    if (v == std::trunc(v) && std::fabs(v) < 1e9) return std::to_string(static_cast<long long>(v));
    char buf[32];
    std::snprintf(buf, sizeof buf, "%.10g", v);
    return buf;
}

std::string Hex(Colour c) {
    char buf[8];
    std::snprintf(buf, sizeof buf, "#%02x%02x%02x", Red(c), Green(c), Blue(c));
    return buf;
}

// Stream text is single-byte (Latin-1); SVG wants escaped UTF-8.
std::string XmlText(std::string_view text) {
    std::string r;
    for (char ch : text) {
        const auto u = static_cast<unsigned char>(ch);
        switch (ch) {
        case '&':
            r += "&amp;";
            continue;
        case '<':
            r += "&lt;";
            continue;
        case '>':
            r += "&gt;";
            continue;
        case '"':
            r += "&quot;";
            continue;
        default:
            break;
        }
        if (u < 0x20) continue;
        AppendLatin1AsUtf8(r, ch);
    }
    return r;
}

std::string Rect(double x, double y, double w, double h) {
    return "<rect x=\"" + Num(x) + "\" y=\"" + Num(y) + "\" width=\"" + Num(w) + "\" height=\"" +
           Num(h) + "\"";
}

} // namespace

double SvgSurface::FontUnits() const {
    return std::max(m_fontSize, 1.0) * kUnitsPerPoint;
}

std::string SvgSurface::Stroke(Colour c) const {
    std::string s = " stroke=\"" + Hex(c) + "\" stroke-width=\"" + Num(m_lineWidth) + "\"";
    if (m_style == LineStyle::Dash)
        s += " stroke-dasharray=\"" + Num(5 * m_lineWidth) + "," + Num(3 * m_lineWidth) + "\"";
    else if (m_style == LineStyle::Dot)
        s += " stroke-dasharray=\"" + Num(m_lineWidth) + "," + Num(2 * m_lineWidth) + "\"";
    return s;
}

void SvgSurface::Clear() {
    m_body = Rect(0, 0, m_width, m_height) + " fill=\"" + Hex(m_back) + "\"/>\n";
}

void SvgSurface::Line(double x1, double y1, double x2, double y2, Colour c) {
    if (x1 == x2 && y1 == y2) { // a dot as wide as the pen
        const double w = m_lineWidth;
        m_body += Rect(x1 - w / 2, y1 - w / 2, w, w) + " fill=\"" + Hex(c) + "\"/>\n";
        return;
    }
    m_body += "<line x1=\"" + Num(x1) + "\" y1=\"" + Num(y1) + "\" x2=\"" + Num(x2) + "\" y2=\"" +
              Num(y2) + "\"" + Stroke(c) + "/>\n";
}

void SvgSurface::Box(double x1, double y1, double x2, double y2, Colour c) {
    m_body += Rect(std::min(x1, x2), std::min(y1, y2), std::fabs(x2 - x1), std::fabs(y2 - y1)) +
              " fill=\"none\"" + Stroke(c) + "/>\n";
}

// Both corners are inside the filled area.
void SvgSurface::FilledBox(double x1, double y1, double x2, double y2, Colour c) {
    m_body +=
        Rect(std::min(x1, x2), std::min(y1, y2), std::fabs(x2 - x1) + 1, std::fabs(y2 - y1) + 1) +
        " fill=\"" + Hex(c) + "\"/>\n";
}

void SvgSurface::Point(double x, double y, Colour c) {
    m_body += Rect(x, y, 1, 1) + " fill=\"" + Hex(c) + "\"/>\n";
}

void SvgSurface::PrintText(std::string_view text) {
    const double size = FontUnits();
    m_body += "<text x=\"" + Num(m_textX) + "\" y=\"" + Num(m_textY + kAscent * size) +
              "\" font-family=\"" + XmlText(m_fontName) + "\" font-size=\"" + Num(size) + "\"" +
              (m_bold ? " font-weight=\"bold\"" : "") + (m_italic ? " font-style=\"italic\"" : "") +
              " fill=\"" + Hex(m_fore) + "\" xml:space=\"preserve\">" + XmlText(text) + "</text>\n";
    m_textY += TextHeight(text);
}

double SvgSurface::TextWidth(std::string_view text) {
    double thousandths = 0;
    for (char ch : text) {
        const auto u = static_cast<unsigned char>(ch);
        thousandths += (u >= 32 && u < 127) ? kAdvance[u - 32] : kAdvance['n' - 32];
    }
    return thousandths / 1000 * FontUnits() * (m_bold ? kBoldWidening : 1.0);
}

double SvgSurface::TextHeight(std::string_view) {
    return kLineHeight * FontUnits();
}

std::string SvgSurface::Document() const {
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
           "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" +
           Num(m_width) + "\" height=\"" + Num(m_height) + "\" viewBox=\"0 0 " + Num(m_width) +
           " " + Num(m_height) + "\" shape-rendering=\"crispEdges\">\n" + m_body + "</svg>\n";
}

Status SvgSurface::Save(const std::filesystem::path& path) const {
    return WriteFileAtomic(path, Document());
}

} // namespace kori::platform
