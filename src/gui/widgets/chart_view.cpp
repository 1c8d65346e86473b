#include "gui/widgets/chart_view.h"

#include <QMouseEvent>
#include <QPainter>

namespace kori::gui {

ChartView::ChartView(QWidget* parent) : QWidget(parent) {
    setMouseTracking(true);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setMinimumSize(320, 200);
}

void ChartView::SetPicture(const QImage& image) {
    m_picture = image;
    update();
}

void ChartView::SetRubberBand(std::optional<QLineF> line, QColor colour) {
    m_rubber = line;
    m_rubberColour = colour;
    update();
}

void ChartView::paintEvent(QPaintEvent*) {
    QPainter p(this);
    p.fillRect(rect(), palette().color(QPalette::Window));
    if (!m_picture.isNull()) p.drawImage(0, 0, m_picture);
    if (m_rubber) {
        p.setPen(QPen(m_rubberColour, 1, Qt::DashLine));
        p.drawLine(*m_rubber);
    }
}

void ChartView::mouseMoveEvent(QMouseEvent* e) {
    emit ChartMouseMove(e->position().x(), e->position().y(), e->buttons());
}

void ChartView::mousePressEvent(QMouseEvent* e) {
    emit ChartMousePress(e->position().x(), e->position().y(), e->button());
}

void ChartView::mouseReleaseEvent(QMouseEvent* e) {
    emit ChartMouseRelease(e->position().x(), e->position().y(), e->button());
}

void ChartView::resizeEvent(QResizeEvent*) {
    emit Resized();
}

} // namespace kori::gui
