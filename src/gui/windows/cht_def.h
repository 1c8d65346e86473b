#pragma once
// ChtDef ("Chart Defaults"): the stored defaults every new chart starts from, and the door to
// the small windows that set the rest (line width, blank space, grid, volume height, stop
// loss, averages, swing, second chart, scales, colours, fonts, multi-oscillators).
#include "chart/chart_defaults.h"
#include "gui/widgets/settings_dialog.h"

#include <functional>
#include <map>

class QCheckBox;
class QComboBox;
class QLineEdit;

namespace kori::gui {

class ChtDef : public SettingsDialog {
    Q_OBJECT
public:
    // From the menu, or from chart selection's "Set Defaults" with the security in hand (whose
    // scales "Change Scales" then edits).
    enum class Caller { Menu, ChartSelection };
    ChtDef(app::Session& session, SettingsHub& hub, Caller caller, const std::string& code = {},
           QWidget* parent = nullptr);

    Caller caller() const { return m_caller; }
    // The edit or choice box of a key ("Av1D", "AvCalc", "ScMethod", "AtrD", "CompFile", ...).
    QWidget* control(const std::string& key) const;
    bool Save();
    // Opens one of the small windows by its name ("PLW", "ColNew", ...), modally.
    void OpenWindow(const std::string& name);

private:
    QComboBox* Choice(const char* key, const QString& a, const QString& b, bool first);
    QLineEdit* Box(const char* key, int value);

    Caller m_caller;
    std::string m_code;
    std::map<std::string, QWidget*> m_controls;
};

} // namespace kori::gui
