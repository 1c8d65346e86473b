#pragma once
// Chart2: the second chart of a split, by code and period.
#include "gui/windows/chart_default_window.h"

class QComboBox;
class QLineEdit;

namespace kori::gui {

class Chart2 : public ChartDefaultWindow {
    Q_OBJECT
public:
    Chart2(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* code() const { return m_code; }
    QComboBox* period() const { return m_period; }
    bool Ok() override;

private:
    QLineEdit* m_code;
    QComboBox* m_period;
};

} // namespace kori::gui
