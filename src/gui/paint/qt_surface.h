#pragma once
// Surfaces over QPainter: the chart area on an image (one chart unit one pixel), and the same
// drawing for any other paint device (the printed page). Fonts are set in points and converted
// at the device's resolution; "Arial" resolves through fontconfig to its metric twin.
#include "platform/status.h"
#include "platform/surface.h"

#include <QFont>
#include <QImage>
#include <QPainter>

#include <filesystem>
#include <memory>

namespace kori::gui {

class QtSurface : public platform::Surface {
public:
    // Paints through `painter`, which stays the caller's, on an area of width x height units.
    QtSurface(QPainter* painter, double width, double height);

    void Clear() override;
    void SetBackColour(platform::Colour c) override { m_back = c; }
    void SetLineWidth(int width) override { m_lineWidth = width < 1 ? 1 : width; }
    void SetLineStyle(platform::LineStyle style) override { m_style = style; }
    void SetForeColour(platform::Colour c) override { m_fore = c; }
    void Line(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void Box(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void Point(double x, double y, platform::Colour c) override;
    void SetFontName(std::string_view name) override;
    void SetFontSize(double points) override;
    void SetFontBold(bool bold) override { m_font.setBold(bold); }
    void SetFontItalic(bool italic) override { m_font.setItalic(italic); }
    void SetTextPosition(double x, double y) override {
        m_textX = x;
        m_textY = y;
    }
    void PrintText(std::string_view text) override;
    double TextWidth(std::string_view text) override;
    double TextHeight(std::string_view text) override;
    double ScaleWidth() const override { return m_width; }
    double ScaleHeight() const override { return m_height; }

    void Resize(double width, double height);
    const QFont& font() const { return m_font; }

private:
    QPen Pen(platform::Colour c) const;
    void Dot(double x, double y, platform::Colour c);

    QPainter* m_painter;
    double m_width, m_height;
    platform::Colour m_back = 0xFFFFFF;
    platform::Colour m_fore = 0;
    int m_lineWidth = 1;
    platform::LineStyle m_style = platform::LineStyle::Solid;
    QFont m_font;
    double m_textX = 0, m_textY = 0;
};

// A chart area of its own: an image of width x height pixels at 96 dots an inch.
class ImageSurface : public QtSurface {
public:
    ImageSurface(int width, int height);
    ~ImageSurface() override;
    ImageSurface(const ImageSurface&) = delete;
    ImageSurface& operator=(const ImageSurface&) = delete;

    // Ends the painting and hands over the picture; the surface draws no more after it.
    const QImage& Finish();

private:
    struct Canvas {
        Canvas(int width, int height);
        QImage image;
        QPainter painter;
    };
    ImageSurface(Canvas* canvas, int width, int height);
    std::unique_ptr<Canvas> m_canvas;
};

// The picture as PNG bytes, as SavePng writes it.
bool EncodePng(const QImage& image, QByteArray& bytes);
platform::Status SavePng(const QImage& image, const std::filesystem::path& path);

// Stream text is single-byte.
QString FromStreamText(std::string_view text);

} // namespace kori::gui
