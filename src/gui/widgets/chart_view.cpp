#include "gui/widgets/chart_view.h"

#include <QMouseEvent>
#include <QPainter>
#include <QWheelEvent>

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
    if (m_cross && !m_picture.isNull()) {
        p.setPen(QPen(QColor(128, 128, 128), 1, Qt::DotLine));
        p.drawLine(QLineF(m_cross->x(), 0, m_cross->x(), m_picture.height()));
        p.drawLine(QLineF(0, m_cross->y(), m_picture.width(), m_cross->y()));
    }
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

void ChartView::SetCrosshair(std::optional<QPointF> at) {
    if (m_cross == at) return;
    m_cross = at;
    update();
}

void ChartView::mouseDoubleClickEvent(QMouseEvent* e) {
    emit ChartDoubleClick(e->position().x(), e->position().y());
}

void ChartView::wheelEvent(QWheelEvent* e) {
    m_wheelRest += e->angleDelta().y();
    const int notches = m_wheelRest / 120;
    m_wheelRest -= notches * 120;
    if (notches != 0) emit ChartWheel(notches, e->modifiers() & Qt::ControlModifier);
    e->accept();
}

void ChartView::leaveEvent(QEvent*) {
    SetCrosshair(std::nullopt);
}

void ChartView::resizeEvent(QResizeEvent*) {
    emit Resized();
}

} // namespace kori::gui
