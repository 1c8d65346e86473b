#pragma once
// The printed page: the drawing operations of a Surface plus what paper needs on top of them.
// Coordinates are printer units (the device's own pixels); the scale origin names the page
// coordinate of the paper's top left corner, so a negative origin moves the drawing right and
// down. Line widths are in printer units too.
#include "platform/status.h"
#include "platform/surface.h"

#include <string>
#include <vector>

namespace kori::platform {

inline constexpr int kPortrait = 1;
inline constexpr int kLandscape = 2;

class Printer : public Surface {
public:
    // 1 portrait, 2 landscape. Takes effect on the page not yet begun.
    virtual void SetOrientation(int orientation) = 0;
    virtual int Orientation() const = 0;
    virtual void SetScaleOrigin(double left, double top) = 0;
    // Size of the page in printer units, in the orientation set.
    virtual double Width() const = 0;
    virtual double Height() const = 0;
    virtual double TwipsPerPixelX() const = 0;
    virtual double TwipsPerPixelY() const = 0;
    virtual void NewPage() = 0;
    // Ends the document and hands it over; an error when it could not be written.
    virtual Status EndDoc() = 0;

    double ScaleWidth() const override { return Width(); }
    double ScaleHeight() const override { return Height(); }
};

// Records every call, the page's own ones included, as text lines in one list; drawing calls
// read as those of RecordingSurface. The default page is A4 at 600 dots an inch.
class RecordingPrinter : public Printer {
public:
    RecordingPrinter(double width = 4961, double height = 7016, double twipsPerPixel = 2.4)
        : m_width(width), m_height(height), m_twips(twipsPerPixel) {}

    void SetOrientation(int orientation) override;
    int Orientation() const override { return m_orientation; }
    void SetScaleOrigin(double left, double top) override;
    double Width() const override { return m_orientation == kLandscape ? m_height : m_width; }
    double Height() const override { return m_orientation == kLandscape ? m_width : m_height; }
    double TwipsPerPixelX() const override { return m_twips; }
    double TwipsPerPixelY() const override { return m_twips; }
    void NewPage() override;
    Status EndDoc() override;

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
    double TextWidth(std::string_view text) override { return m_page.TextWidth(text); }
    double TextHeight(std::string_view text) override { return m_page.TextHeight(text); }

    const std::vector<std::string>& calls() const { return m_calls; }
    // State of the drawing, for assertions.
    const RecordingSurface& page() const { return m_page; }

private:
    void Take(); // moves what the page recorded into the one list
    double m_width, m_height, m_twips;
    int m_orientation = kPortrait;
    RecordingSurface m_page;
    std::vector<std::string> m_calls;
};

} // namespace kori::platform
