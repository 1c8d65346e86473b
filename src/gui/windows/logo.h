#pragma once
// Logo: the window that stands while the program initialises.
#include <QWidget>

namespace kori::gui {

class Logo : public QWidget {
    Q_OBJECT
public:
    explicit Logo(QWidget* parent = nullptr);
    // Centred across the screen and a little above its middle.
    void Centre();

protected:
    void paintEvent(QPaintEvent* e) override;
};

} // namespace kori::gui
