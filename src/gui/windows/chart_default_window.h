#pragma once
// The frame of the small windows of the chart defaults. Each edits one or two values; OK checks
// them, stores them and has the chart on show rebuilt.
#include "chart/chart_defaults.h"
#include "gui/widgets/settings_dialog.h"

class QLineEdit;
class QVBoxLayout;

namespace kori::gui {

// Numbers as the small windows show them, and the small number box they use.
QString NumberText(double v);
QString SingleText(float v);
QLineEdit* NumberBox(QWidget* parent, const char* name, const QString& text, int width = 70);

class ChartDefaultWindow : public SettingsDialog {
    Q_OBJECT
public:
    ChartDefaultWindow(app::Session& session, SettingsHub& hub, const char* name,
                       const QString& title, QWidget* parent);
    // Checks and stores the value; false leaves the window open.
    virtual bool Ok() = 0;

protected:
    // OK and Cancel under the window's own rows.
    void AddButtons();
    // Writes the defaults and asks for the chart again.
    void Store();

    chart::ChartDefaults m_defaults;
    QVBoxLayout* m_layout;
};

} // namespace kori::gui
