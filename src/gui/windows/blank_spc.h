#pragma once
// BlankSpc: blank chart units at the right of the chart.
#include "gui/windows/chart_default_window.h"

class QLineEdit;

namespace kori::gui {

class BlankSpc : public ChartDefaultWindow {
    Q_OBJECT
public:
    BlankSpc(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* blank() const { return m_blank; }
    bool Ok() override;

private:
    QLineEdit* m_blank;
};

} // namespace kori::gui
