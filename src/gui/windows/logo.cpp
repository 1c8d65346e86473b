#include "gui/windows/logo.h"

#include "app/window_rules.h"

#include <QGuiApplication>
#include <QLinearGradient>
#include <QPainter>
#include <QScreen>

namespace kori::gui {

Logo::Logo(QWidget* parent)
    : QWidget(parent, Qt::SplashScreen | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint) {
    setObjectName(QStringLiteral("Logo"));
    setFixedSize(440, 240);
    setCursor(Qt::WaitCursor);
    Centre();
}

void Logo::Centre() {
    const QScreen* screen = QGuiApplication::primaryScreen();
    if (!screen) return;
    const QRect s = screen->geometry();
    const auto p = app::LogoPosition(s.width(), s.height(), width(), height());
    move(s.x() + p.left, s.y() + p.top);
}

void Logo::paintEvent(QPaintEvent*) {
    QPainter p(this);
    p.setRenderHint(QPainter::Antialiasing);
    QLinearGradient g(0, 0, 0, height());
    g.setColorAt(0, QColor(20, 40, 80));
    g.setColorAt(1, QColor(8, 16, 36));
    p.fillRect(rect(), g);
    // A small rising price line as the emblem.
    p.setPen(QPen(QColor(80, 200, 120), 3));
    const QPoint pts[] = {{40, 186},  {90, 168},  {130, 176}, {180, 146},
                          {230, 154}, {290, 124}, {340, 132}, {400, 108}};
    p.drawPolyline(pts, 8);
    p.setPen(QColor(255, 214, 0));
    p.setFont(QFont(QStringLiteral("Liberation Sans"), 28, QFont::Bold));
    p.drawText(QRect(0, 20, width(), 80), Qt::AlignCenter, QStringLiteral("KORI Charting 8"));
    p.setPen(Qt::white);
    p.setFont(QFont(QStringLiteral("Liberation Sans"), 10));
    p.drawText(QRect(0, 196, width(), 30), Qt::AlignCenter,
               QStringLiteral("End-of-day share-market charting  -  loading ..."));
    p.setPen(QColor(120, 140, 180));
    p.drawRect(rect().adjusted(0, 0, -1, -1));
}

} // namespace kori::gui
