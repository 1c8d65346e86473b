#include "gui/paint/pdf_printer.h"

#include "platform/files.h"

#include <QPageLayout>
#include <QPageSize>

namespace kori::gui {

namespace {
QPageLayout::Orientation ToQt(int orientation) {
    return orientation == platform::kLandscape ? QPageLayout::Landscape : QPageLayout::Portrait;
}
} // namespace

PdfPrinter::PdfPrinter(const std::filesystem::path& path, int dotsPerInch)
    : m_path(path), m_dpi(dotsPerInch), m_writer(&m_buffer) {
    if (!m_buffer.open(QIODevice::WriteOnly)) m_failed = true;
    m_writer.setResolution(m_dpi);
    m_writer.setPageSize(QPageSize(QPageSize::A4));
    m_writer.setPageMargins(QMarginsF(0, 0, 0, 0));
    m_writer.setPageOrientation(QPageLayout::Portrait);
    m_writer.setCreator(QStringLiteral("KORI Charting"));
}

PdfPrinter::~PdfPrinter() {
    if (m_painter.isActive()) m_painter.end();
}

// Before the first drawing this shapes the first page; afterwards, the next one.
void PdfPrinter::SetOrientation(int orientation) {
    m_orientation = orientation;
    m_writer.setPageOrientation(ToQt(orientation));
}

double PdfPrinter::Width() const {
    return m_writer.pageLayout().paintRectPixels(m_dpi).width();
}

double PdfPrinter::Height() const {
    return m_writer.pageLayout().paintRectPixels(m_dpi).height();
}

void PdfPrinter::ApplyOrigin() {
    m_painter.resetTransform();
    m_painter.translate(-m_originLeft, -m_originTop);
}

void PdfPrinter::SetScaleOrigin(double left, double top) {
    m_originLeft = left;
    m_originTop = top;
    if (m_painter.isActive()) ApplyOrigin();
}

QtSurface& PdfPrinter::Page() {
    if (!m_page) {
        if (!m_painter.begin(&m_writer)) m_failed = true;
        m_page.emplace(&m_painter, Width(), Height());
        if (m_painter.isActive()) ApplyOrigin();
    }
    return *m_page;
}

void PdfPrinter::NewPage() {
    Page();
    if (!m_failed && !m_writer.newPage()) m_failed = true;
    m_page->Resize(Width(), Height());
}

platform::Status PdfPrinter::EndDoc() {
    Page(); // an empty document is still one blank page
    if (m_ended) return m_result;
    m_ended = true;
    bool ok = !m_failed;
    // The painter writes the last objects and the cross-reference table at its end.
    if (m_painter.isActive() && !m_painter.end()) ok = false;
    m_buffer.close();
    if (!ok || m_bytes.isEmpty()) {
        m_result = platform::Status::Error("Cannot write " + m_path.string());
        return m_result;
    }
    if (m_path.empty()) return m_result;
    m_result = platform::WriteFileAtomic(
        m_path, std::string_view(m_bytes.constData(), static_cast<std::size_t>(m_bytes.size())));
    if (!m_result) m_result = platform::Status::Error("Cannot write " + m_path.string());
    return m_result;
}

void PdfPrinter::Clear() {
    Page().Clear();
}
void PdfPrinter::SetBackColour(platform::Colour c) {
    Page().SetBackColour(c);
}
void PdfPrinter::SetLineWidth(int width) {
    Page().SetLineWidth(width);
}
void PdfPrinter::SetLineStyle(platform::LineStyle style) {
    Page().SetLineStyle(style);
}
void PdfPrinter::SetForeColour(platform::Colour c) {
    Page().SetForeColour(c);
}
void PdfPrinter::Line(double x1, double y1, double x2, double y2, platform::Colour c) {
    Page().Line(x1, y1, x2, y2, c);
}
void PdfPrinter::Box(double x1, double y1, double x2, double y2, platform::Colour c) {
    Page().Box(x1, y1, x2, y2, c);
}
void PdfPrinter::FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) {
    Page().FilledBox(x1, y1, x2, y2, c);
}
void PdfPrinter::Point(double x, double y, platform::Colour c) {
    Page().Point(x, y, c);
}
void PdfPrinter::SetFontName(std::string_view name) {
    Page().SetFontName(name);
}
void PdfPrinter::SetFontSize(double points) {
    Page().SetFontSize(points);
}
void PdfPrinter::SetFontBold(bool bold) {
    Page().SetFontBold(bold);
}
void PdfPrinter::SetFontItalic(bool italic) {
    Page().SetFontItalic(italic);
}
void PdfPrinter::SetTextPosition(double x, double y) {
    Page().SetTextPosition(x, y);
}
void PdfPrinter::PrintText(std::string_view text) {
    Page().PrintText(text);
}
double PdfPrinter::TextWidth(std::string_view text) {
    return Page().TextWidth(text);
}
double PdfPrinter::TextHeight(std::string_view text) {
    return Page().TextHeight(text);
}

} // namespace kori::gui
