#pragma once
// A chart area: shows the picture the builder drew, maps the mouse to chart units, and draws
// the rubber band of a tool while the button is held.
#include <QImage>
#include <QLineF>
#include <QWidget>

#include <optional>

namespace kori::gui {

class ChartView : public QWidget {
    Q_OBJECT
public:
    explicit ChartView(QWidget* parent = nullptr);

    // The picture in chart units (one unit one pixel).
    void SetPicture(const QImage& image);
    const QImage& picture() const { return m_picture; }
    QImage& mutablePicture() { return m_picture; }
    // A line that follows the mouse while a tool drags it; nullopt hides it.
    void SetRubberBand(std::optional<QLineF> line, QColor colour = Qt::yellow);

    // A crosshair through (x, y) while no tool is chosen; nullopt hides it.
    void SetCrosshair(std::optional<QPointF> at);
    std::optional<QPointF> crosshair() const { return m_cross; }

    QSize sizeHint() const override { return {900, 560}; }

signals:
    void ChartMouseMove(double x, double y, Qt::MouseButtons buttons);
    void ChartMousePress(double x, double y, Qt::MouseButton button);
    void ChartMouseRelease(double x, double y, Qt::MouseButton button);
    void ChartDoubleClick(double x, double y);
    // Wheel turns in notches (positive away from the user), with Ctrl held or not.
    void ChartWheel(int notches, bool ctrl);
    void Resized();

protected:
    void paintEvent(QPaintEvent*) override;
    void mouseMoveEvent(QMouseEvent* e) override;
    void mousePressEvent(QMouseEvent* e) override;
    void mouseReleaseEvent(QMouseEvent* e) override;
    void mouseDoubleClickEvent(QMouseEvent* e) override;
    void wheelEvent(QWheelEvent* e) override;
    void leaveEvent(QEvent*) override;
    void resizeEvent(QResizeEvent*) override;

private:
    QImage m_picture;
    std::optional<QLineF> m_rubber;
    QColor m_rubberColour = Qt::yellow;
    std::optional<QPointF> m_cross;
    int m_wheelRest = 0; // eighths of a degree not yet a whole notch
};

} // namespace kori::gui
