#pragma once
// A band of another surface seen as a surface of its own: the price chart and the oscillator
// panel under it share one picture, each with its own origin and height.
#include "platform/surface.h"

namespace kori::platform {

class SubSurface : public Surface {
public:
    // The band from `top` down, `height` units high, over the whole width of `whole`.
    SubSurface(Surface& whole, double top, double height)
        : m_whole(whole), m_top(top), m_height(height) {}

    // Only the band is cleared, in the back colour given to it.
    void Clear() override {
        m_whole.FilledBox(0, m_top, m_whole.ScaleWidth(), m_top + m_height, m_back);
    }
    void SetBackColour(Colour c) override {
        m_back = c;
        m_whole.SetBackColour(c);
    }
    void SetLineWidth(int width) override { m_whole.SetLineWidth(width); }
    void SetLineStyle(LineStyle style) override { m_whole.SetLineStyle(style); }
    void SetForeColour(Colour c) override { m_whole.SetForeColour(c); }
    void Line(double x1, double y1, double x2, double y2, Colour c) override {
        m_whole.Line(x1, y1 + m_top, x2, y2 + m_top, c);
    }
    void Box(double x1, double y1, double x2, double y2, Colour c) override {
        m_whole.Box(x1, y1 + m_top, x2, y2 + m_top, c);
    }
    void FilledBox(double x1, double y1, double x2, double y2, Colour c) override {
        m_whole.FilledBox(x1, y1 + m_top, x2, y2 + m_top, c);
    }
    void Point(double x, double y, Colour c) override { m_whole.Point(x, y + m_top, c); }
    void SetFontName(std::string_view name) override { m_whole.SetFontName(name); }
    void SetFontSize(double points) override { m_whole.SetFontSize(points); }
    void SetFontBold(bool bold) override { m_whole.SetFontBold(bold); }
    void SetFontItalic(bool italic) override { m_whole.SetFontItalic(italic); }
    void SetTextPosition(double x, double y) override { m_whole.SetTextPosition(x, y + m_top); }
    void PrintText(std::string_view text) override { m_whole.PrintText(text); }
    double TextWidth(std::string_view text) override { return m_whole.TextWidth(text); }
    double TextHeight(std::string_view text) override { return m_whole.TextHeight(text); }
    double ScaleWidth() const override { return m_whole.ScaleWidth(); }
    double ScaleHeight() const override { return m_height; }

private:
    Surface& m_whole;
    double m_top, m_height;
    Colour m_back = Rgb(255, 255, 255);
};

} // namespace kori::platform
