#pragma once
// ChtBands: the two percentage band values of the security in hand.
#include <QDialog>

#include <optional>
#include <utility>

class QSpinBox;
class QLineEdit;

namespace kori::gui {

class ChtBands : public QDialog {
    Q_OBJECT
public:
    ChtBands(int up, int down, QWidget* parent = nullptr);
    // The two values as typed (unchecked: the selection checks them), or nullopt on cancel.
    static std::optional<std::pair<int, int>> Ask(QWidget* parent, int up, int down);

private:
    QLineEdit* m_up;
    QLineEdit* m_down;
};

} // namespace kori::gui
