#pragma once
// PLW: the line width of printed charts, 1 to 10.
#include "gui/windows/chart_default_window.h"

class QLineEdit;

namespace kori::gui {

class PLW : public ChartDefaultWindow {
    Q_OBJECT
public:
    PLW(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* width() const { return m_width; }
    bool Ok() override;

private:
    QLineEdit* m_width;
};

} // namespace kori::gui
