#pragma once
// The drawing target every chart is built on and every stream is played onto: the chart area
// on the screen, an image, a page. Coordinates are chart-area units, origin top left, y down.
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kori::platform {

// Packed colour as the stream stores it: low byte red, then green, then blue.
using Colour = std::uint32_t;
constexpr Colour Rgb(int r, int g, int b) {
    return static_cast<Colour>((r & 0xFF) | ((g & 0xFF) << 8) | ((b & 0xFF) << 16));
}
constexpr int Red(Colour c) {
    return static_cast<int>(c & 0xFF);
}
constexpr int Green(Colour c) {
    return static_cast<int>((c >> 8) & 0xFF);
}
constexpr int Blue(Colour c) {
    return static_cast<int>((c >> 16) & 0xFF);
}

enum class LineStyle { Solid, Dash, Dot };

class Surface {
public:
    virtual ~Surface() = default;

    virtual void Clear() = 0; // fills with the back colour
    virtual void SetBackColour(Colour c) = 0;
    virtual void SetLineWidth(int width) = 0;
    virtual void SetLineStyle(LineStyle style) = 0;
    virtual void SetForeColour(Colour c) = 0;

    virtual void Line(double x1, double y1, double x2, double y2, Colour c) = 0;
    virtual void Box(double x1, double y1, double x2, double y2, Colour c) = 0;
    virtual void FilledBox(double x1, double y1, double x2, double y2, Colour c) = 0;
    virtual void Point(double x, double y, Colour c) = 0;

    virtual void SetFontName(std::string_view name) = 0;
    virtual void SetFontSize(double points) = 0;
    virtual void SetFontBold(bool bold) = 0;
    virtual void SetFontItalic(bool italic) = 0;
    virtual void SetTextPosition(double x, double y) = 0;
    // Draws in the fore colour with its top left corner at the text position, then moves the
    // position to the start of the next line (as the classic Print does).
    virtual void PrintText(std::string_view text) = 0;
    virtual double TextWidth(std::string_view text) = 0;
    virtual double TextHeight(std::string_view text) = 0;

    // Size of the area in its own units (the user scale equals the area's size).
    virtual double ScaleWidth() const = 0;
    virtual double ScaleHeight() const = 0;
};

// Records every call as one line of text, with fixed text metrics so that tests are exact and
// need no fonts: a character is 0.6 of the point size wide, a line 1.5 times the point size high.
class RecordingSurface : public Surface {
public:
    RecordingSurface(double width = 1000, double height = 700) : m_width(width), m_height(height) {}

    void Clear() override;
    void SetBackColour(Colour c) override;
    void SetLineWidth(int width) override;
    void SetLineStyle(LineStyle style) override;
    void SetForeColour(Colour c) override;
    void Line(double x1, double y1, double x2, double y2, Colour c) override;
    void Box(double x1, double y1, double x2, double y2, Colour c) override;
    void FilledBox(double x1, double y1, double x2, double y2, Colour c) override;
    void Point(double x, double y, Colour c) override;
    void SetFontName(std::string_view name) override;
    void SetFontSize(double points) override;
    void SetFontBold(bool bold) override;
    void SetFontItalic(bool italic) override;
    void SetTextPosition(double x, double y) override;
    void PrintText(std::string_view text) override;
    double TextWidth(std::string_view text) override;
    double TextHeight(std::string_view text) override;
    double ScaleWidth() const override { return m_width; }
    double ScaleHeight() const override { return m_height; }

    void Resize(double width, double height) {
        m_width = width;
        m_height = height;
    }
    const std::vector<std::string>& calls() const { return m_calls; }
    void ClearCalls() { m_calls.clear(); }

    // Current state, for assertions.
    double fontSize() const { return m_fontSize; }
    bool bold() const { return m_bold; }
    bool italic() const { return m_italic; }
    int lineWidth() const { return m_lineWidth; }
    LineStyle lineStyle() const { return m_style; }
    Colour foreColour() const { return m_fore; }
    const std::string& fontName() const { return m_fontName; }

private:
    void Add(std::string s) { m_calls.push_back(std::move(s)); }
    double m_width, m_height;
    std::vector<std::string> m_calls;
    double m_fontSize = 8.25;
    bool m_bold = false;
    bool m_italic = false;
    int m_lineWidth = 1;
    LineStyle m_style = LineStyle::Solid;
    Colour m_fore = 0;
    Colour m_back = 0xFFFFFF;
    std::string m_fontName = "Arial";
    double m_textX = 0, m_textY = 0;
};

} // namespace kori::platform
