#pragma once
// SwingSet: the swing method and its days or points.
#include "gui/windows/chart_default_window.h"

#include <array>

class QLineEdit;
class QRadioButton;

namespace kori::gui {

class SwingSet : public ChartDefaultWindow {
    Q_OBJECT
public:
    SwingSet(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QRadioButton* method(int i) const { return m_methods[static_cast<std::size_t>(i)]; }
    QLineEdit* value() const { return m_value; }
    bool Ok() override;

private:
    std::array<QRadioButton*, 4> m_methods{};
    QLineEdit* m_value;
};

} // namespace kori::gui
