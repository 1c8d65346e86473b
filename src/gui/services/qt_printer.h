#pragma once
// A real printer as the paper player's Printer: any QPrinter the print dialog set up (a CUPS
// queue or "Print to PDF"). Printer units are the device's dots.
#include "gui/paint/qt_surface.h"
#include "platform/printer.h"

#include <QPainter>

#include <optional>

class QPrinter;

namespace kori::gui {

class QtPrinter : public platform::Printer {
public:
    explicit QtPrinter(QPrinter& printer);
    ~QtPrinter() override;
    QtPrinter(const QtPrinter&) = delete;
    QtPrinter& operator=(const QtPrinter&) = delete;

    void SetOrientation(int orientation) override;
    int Orientation() const override { return m_orientation; }
    void SetScaleOrigin(double left, double top) override;
    double Width() const override;
    double Height() const override;
    double TwipsPerPixelX() const override;
    double TwipsPerPixelY() const override;
    void NewPage() override;
    platform::Status EndDoc() override;

    void Clear() override { Page().Clear(); }
    void SetBackColour(platform::Colour c) override { Page().SetBackColour(c); }
    void SetLineWidth(int width) override { Page().SetLineWidth(width); }
    void SetLineStyle(platform::LineStyle style) override { Page().SetLineStyle(style); }
    void SetForeColour(platform::Colour c) override { Page().SetForeColour(c); }
    void Line(double x1, double y1, double x2, double y2, platform::Colour c) override {
        Page().Line(x1, y1, x2, y2, c);
    }
    void Box(double x1, double y1, double x2, double y2, platform::Colour c) override {
        Page().Box(x1, y1, x2, y2, c);
    }
    void FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) override {
        Page().FilledBox(x1, y1, x2, y2, c);
    }
    void Point(double x, double y, platform::Colour c) override { Page().Point(x, y, c); }
    void SetFontName(std::string_view name) override { Page().SetFontName(name); }
    void SetFontSize(double points) override { Page().SetFontSize(points); }
    void SetFontBold(bool bold) override { Page().SetFontBold(bold); }
    void SetFontItalic(bool italic) override { Page().SetFontItalic(italic); }
    void SetTextPosition(double x, double y) override { Page().SetTextPosition(x, y); }
    void PrintText(std::string_view text) override { Page().PrintText(text); }
    double TextWidth(std::string_view text) override { return Page().TextWidth(text); }
    double TextHeight(std::string_view text) override { return Page().TextHeight(text); }

private:
    QtSurface& Page(); // begins the document on first use
    void ApplyOrigin();

    QPrinter& m_printer;
    int m_orientation = platform::kPortrait;
    double m_originLeft = 0, m_originTop = 0;
    QPainter m_painter;
    std::optional<QtSurface> m_page;
    bool m_failed = false;
    bool m_ended = false;
};

} // namespace kori::gui
