#pragma once
// StpLs: the stop-loss line and its percentage, 0 to 100.
#include "gui/windows/chart_default_window.h"

class QCheckBox;
class QLineEdit;

namespace kori::gui {

class StpLs : public ChartDefaultWindow {
    Q_OBJECT
public:
    StpLs(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QCheckBox* on() const { return m_on; }
    QLineEdit* percent() const { return m_percent; }
    bool Ok() override;

private:
    QCheckBox* m_on;
    QLineEdit* m_percent;
};

} // namespace kori::gui
