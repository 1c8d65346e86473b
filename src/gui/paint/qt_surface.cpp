#include "gui/paint/qt_surface.h"

#include "platform/files.h"
#include "raster/large_buffer.h"
#include "raster/png.h"

#include <QBuffer>
#include <QFontMetricsF>

#include <algorithm>
#include <vector>

#include <cmath>
#include <cstdint>
#include <memory>

namespace kori::gui {

namespace {

constexpr int kDotsPerMeter96 = 3780; // 96 dots an inch

QColor ToQColor(platform::Colour c) {
    return QColor(platform::Red(c), platform::Green(c), platform::Blue(c));
}

QRectF Span(double x1, double y1, double x2, double y2, double extra) {
    return QRectF(std::min(x1, x2), std::min(y1, y2), std::fabs(x2 - x1) + extra,
                  std::fabs(y2 - y1) + extra);
}

} // namespace

QString FromStreamText(std::string_view text) {
    return QString::fromLatin1(text.data(), static_cast<qsizetype>(text.size()));
}

QtSurface::QtSurface(QPainter* painter, double width, double height)
    : m_painter(painter), m_width(width), m_height(height), m_font(QStringLiteral("Arial")) {
    m_font.setPointSizeF(8.25);
    m_font.setStyleHint(QFont::SansSerif);
    m_painter->setRenderHint(QPainter::Antialiasing, false);
    m_painter->setRenderHint(QPainter::TextAntialiasing, true);
}

void QtSurface::Resize(double width, double height) {
    m_width = width;
    m_height = height;
}

// Dashes and dots are counted in pen widths, so a wide broken line keeps its look.
QPen QtSurface::Pen(platform::Colour c) const {
    QPen pen(ToQColor(c));
    pen.setWidth(m_lineWidth);
    pen.setCapStyle(m_lineWidth > 1 ? Qt::RoundCap : Qt::SquareCap);
    pen.setJoinStyle(Qt::MiterJoin);
    if (m_style == platform::LineStyle::Dash) pen.setDashPattern({5, 3});
    if (m_style == platform::LineStyle::Dot) pen.setDashPattern({1, 2});
    return pen;
}

void QtSurface::Clear() {
    m_painter->fillRect(QRectF(0, 0, m_width, m_height), ToQColor(m_back));
}

// A zero-length line is a dot as wide as the pen: the large dots of the paper.
void QtSurface::Dot(double x, double y, platform::Colour c) {
    if (m_lineWidth <= 1) {
        m_painter->fillRect(QRectF(x, y, 1, 1), ToQColor(c));
        return;
    }
    const double r = m_lineWidth / 2.0;
    m_painter->save();
    m_painter->setRenderHint(QPainter::Antialiasing, true);
    m_painter->setPen(Qt::NoPen);
    m_painter->setBrush(ToQColor(c));
    m_painter->drawEllipse(QPointF(x, y), r, r);
    m_painter->restore();
}

void QtSurface::Line(double x1, double y1, double x2, double y2, platform::Colour c) {
    if (x1 == x2 && y1 == y2) return Dot(x1, y1, c);
    m_painter->setPen(Pen(c));
    m_painter->drawLine(QPointF(x1, y1), QPointF(x2, y2));
}

void QtSurface::Box(double x1, double y1, double x2, double y2, platform::Colour c) {
    m_painter->setPen(Pen(c));
    m_painter->setBrush(Qt::NoBrush);
    m_painter->drawRect(Span(x1, y1, x2, y2, 0));
}

// Both corners lie inside the filled area.
void QtSurface::FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) {
    m_painter->fillRect(Span(x1, y1, x2, y2, 1), ToQColor(c));
}

void QtSurface::Point(double x, double y, platform::Colour c) {
    m_painter->fillRect(QRectF(x, y, 1, 1), ToQColor(c));
}

void QtSurface::SetFontName(std::string_view name) {
    m_font.setFamily(FromStreamText(name));
}

void QtSurface::SetFontSize(double points) {
    m_font.setPointSizeF(std::max(points, 1.0));
}

void QtSurface::PrintText(std::string_view text) {
    const QFontMetricsF fm(m_font, m_painter->device());
    m_painter->setFont(m_font);
    m_painter->setPen(ToQColor(m_fore));
    m_painter->drawText(QPointF(m_textX, m_textY + fm.ascent()), FromStreamText(text));
    m_textY += fm.height();
}

double QtSurface::TextWidth(std::string_view text) {
    return QFontMetricsF(m_font, m_painter->device()).horizontalAdvance(FromStreamText(text));
}

double QtSurface::TextHeight(std::string_view) {
    return QFontMetricsF(m_font, m_painter->device()).height();
}

namespace {

void DeleteLargeBuffer(void* buffer) {
    delete static_cast<raster::LargeBuffer*>(buffer);
}

// The picture's pixels in large pages; the picture frees them when its last copy goes.
QImage MakePicture(int width, int height) {
    const qsizetype bytesPerLine = static_cast<qsizetype>(width) * 4;
    auto* buffer = new raster::LargeBuffer(static_cast<std::size_t>(bytesPerLine) * height);
    if (!*buffer) {
        delete buffer;
        return QImage(width, height, QImage::Format_RGB32);
    }
    return QImage(buffer->data(), width, height, bytesPerLine, QImage::Format_RGB32,
                  DeleteLargeBuffer, buffer);
}

} // namespace

ImageSurface::Canvas::Canvas(int width, int height)
    : image(MakePicture(std::max(width, 1), std::max(height, 1))) {
    image.setDotsPerMeterX(kDotsPerMeter96);
    image.setDotsPerMeterY(kDotsPerMeter96);
    image.fill(Qt::white);
    painter.begin(&image);
}

ImageSurface::ImageSurface(int width, int height)
    : ImageSurface(new Canvas(width, height), width, height) {}

ImageSurface::ImageSurface(Canvas* canvas, int width, int height)
    : QtSurface(&canvas->painter, width, height), m_canvas(canvas) {}

ImageSurface::~ImageSurface() {
    if (m_canvas->painter.isActive()) m_canvas->painter.end();
}

const QImage& ImageSurface::Finish() {
    if (m_canvas->painter.isActive()) m_canvas->painter.end();
    return m_canvas->image;
}

bool EncodePng(const QImage& image, QByteArray& bytes) {
    bytes.clear();
    if (image.format() == QImage::Format_RGB32) {
        // The one encoder of chart pictures, shared with the raster surface.
        std::string encoded;
        const raster::PixelRows rows{reinterpret_cast<const std::uint32_t*>(image.constBits()),
                                     image.width(), image.height(),
                                     static_cast<std::size_t>(image.bytesPerLine()) / 4,
                                     image.dotsPerMeterX()};
        if (!raster::EncodeOpaquePng(rows, encoded)) return false;
        bytes = QByteArray(encoded.data(), static_cast<qsizetype>(encoded.size()));
        return true;
    }
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    return image.save(&buffer, "PNG");
}

platform::Status SavePng(const QImage& image, const std::filesystem::path& path) {
    QByteArray bytes;
    if (!EncodePng(image, bytes))
        return platform::Status::Error("Cannot make a picture for " + path.string());
    return platform::WriteFileAtomic(
        path, std::string_view(bytes.constData(), static_cast<std::size_t>(bytes.size())));
}

} // namespace kori::gui
