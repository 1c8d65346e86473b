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

    QSize sizeHint() const override { return {900, 560}; }

signals:
    void ChartMouseMove(double x, double y, Qt::MouseButtons buttons);
    void ChartMousePress(double x, double y, Qt::MouseButton button);
    void ChartMouseRelease(double x, double y, Qt::MouseButton button);
    void Resized();

protected:
    void paintEvent(QPaintEvent*) override;
    void mouseMoveEvent(QMouseEvent* e) override;
    void mousePressEvent(QMouseEvent* e) override;
    void mouseReleaseEvent(QMouseEvent* e) override;
    void resizeEvent(QResizeEvent*) override;

private:
    QImage m_picture;
    std::optional<QLineF> m_rubber;
    QColor m_rubberColour = Qt::yellow;
};

} // namespace kori::gui
