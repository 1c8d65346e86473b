#include "gui/services/qt_printer.h"

#include <QPageLayout>
#include <QPrinter>

namespace kori::gui {

QtPrinter::QtPrinter(QPrinter& printer) : m_printer(printer) {
    // The print scale is worked out from twips per printer dot; at 600 dots an inch a chart
    // fills the page as it does on the PDF printer, whatever resolution the dialog chose.
    m_printer.setResolution(600);
    m_orientation = printer.pageLayout().orientation() == QPageLayout::Landscape
                        ? platform::kLandscape
                        : platform::kPortrait;
}

QtPrinter::~QtPrinter() {
    if (m_painter.isActive()) m_painter.end();
}

void QtPrinter::SetOrientation(int orientation) {
    m_orientation = orientation;
    m_printer.setPageOrientation(orientation == platform::kLandscape ? QPageLayout::Landscape
                                                                     : QPageLayout::Portrait);
}

double QtPrinter::Width() const {
    return m_printer.pageLayout().paintRectPixels(m_printer.resolution()).width();
}
double QtPrinter::Height() const {
    return m_printer.pageLayout().paintRectPixels(m_printer.resolution()).height();
}
double QtPrinter::TwipsPerPixelX() const {
    return 1440.0 / m_printer.resolution();
}
double QtPrinter::TwipsPerPixelY() const {
    return 1440.0 / m_printer.resolution();
}

void QtPrinter::ApplyOrigin() {
    m_painter.resetTransform();
    m_painter.translate(-m_originLeft, -m_originTop);
}

void QtPrinter::SetScaleOrigin(double left, double top) {
    m_originLeft = left;
    m_originTop = top;
    if (m_painter.isActive()) ApplyOrigin();
}

QtSurface& QtPrinter::Page() {
    if (!m_page) {
        if (!m_painter.begin(&m_printer)) m_failed = true;
        m_page.emplace(&m_painter, Width(), Height());
        if (m_painter.isActive()) ApplyOrigin();
    }
    return *m_page;
}

void QtPrinter::NewPage() {
    Page();
    if (!m_failed && !m_printer.newPage()) m_failed = true;
    m_page->Resize(Width(), Height());
}

platform::Status QtPrinter::EndDoc() {
    Page(); // an empty document is still one blank page
    if (m_ended) return platform::Status::Ok();
    m_ended = true;
    if (m_painter.isActive()) m_painter.end();
    if (m_failed) return platform::Status::Error("The printer could not print the chart");
    return platform::Status::Ok();
}

} // namespace kori::gui
