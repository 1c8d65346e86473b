#pragma once
// A Surface that writes an SVG document: one unit of the chart area is one SVG user unit (a
// pixel at 96 dots an inch), so font points become 96/72 units. Text metrics come from the
// advance widths that Arial and its metric twins share, so builders can measure without a
// font library; other families are measured the same way.
#include "platform/status.h"
#include "platform/surface.h"

#include <filesystem>
#include <string>

namespace kori::platform {

class SvgSurface : public Surface {
public:
    SvgSurface(double width, double height) : m_width(width), m_height(height) {}

    void Clear() override;
    void SetBackColour(Colour c) override { m_back = c; }
    void SetLineWidth(int width) override { m_lineWidth = width < 1 ? 1 : width; }
    void SetLineStyle(LineStyle style) override { m_style = style; }
    void SetForeColour(Colour c) override { m_fore = c; }
    void Line(double x1, double y1, double x2, double y2, Colour c) override;
    void Box(double x1, double y1, double x2, double y2, Colour c) override;
    void FilledBox(double x1, double y1, double x2, double y2, Colour c) override;
    void Point(double x, double y, Colour c) override;
    void SetFontName(std::string_view name) override { m_fontName = name; }
    void SetFontSize(double points) override { m_fontSize = points; }
    void SetFontBold(bool bold) override { m_bold = bold; }
    void SetFontItalic(bool italic) override { m_italic = italic; }
    void SetTextPosition(double x, double y) override {
        m_textX = x;
        m_textY = y;
    }
    void PrintText(std::string_view text) override;
    double TextWidth(std::string_view text) override;
    double TextHeight(std::string_view text) override;
    double ScaleWidth() const override { return m_width; }
    double ScaleHeight() const override { return m_height; }

    // The whole document as it stands.
    std::string Document() const;
    Status Save(const std::filesystem::path& path) const;

private:
    double FontUnits() const; // font size in chart units
    std::string Stroke(Colour c) const;

    double m_width, m_height;
    std::string m_body;
    Colour m_back = 0xFFFFFF;
    Colour m_fore = 0;
    int m_lineWidth = 1;
    LineStyle m_style = LineStyle::Solid;
    std::string m_fontName = "Arial";
    double m_fontSize = 8.25;
    bool m_bold = false;
    bool m_italic = false;
    double m_textX = 0, m_textY = 0;
};

} // namespace kori::platform
