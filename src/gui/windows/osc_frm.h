#pragma once
// OscFrm: the settings of the oscillator in hand (its period fields, and for RMO and RMX the
// comparison file), or on a point-and-figure chart the "Box Value " form titled
// "Point and Figure".
#include "app/window_rules.h"
#include "gui/widgets/settings_dialog.h"
#include "osc/osc_settings.h"

#include <optional>
#include <vector>

class QLineEdit;

namespace kori::gui {

class OscFrm : public SettingsDialog {
    Q_OBJECT
public:
    // `chartStyle` 'P' makes the box-value form; `chartPeriod` "A" edits the daily column.
    OscFrm(app::Session& session, SettingsHub& hub, const std::string& oscName, char chartStyle,
           const std::string& chartPeriod, QWidget* parent = nullptr);

    bool pointAndFigure() const { return m_pointAndFigure; }
    // The period fields in order, the compare box (RMO and RMX), the box-value field.
    QLineEdit* field(int i) const { return m_fields[static_cast<std::size_t>(i)]; }
    int fieldCount() const { return static_cast<int>(m_fields.size()); }
    QLineEdit* compareBox() const { return m_compare; }
    QLineEdit* boxValue() const { return m_box; }
    // The answer of the box-value form once OK or "Auto " closed it.
    const std::optional<app::BoxValueAnswer>& boxAnswer() const { return m_boxAnswer; }

    bool Ok();
    void Auto();

    // The question of a point-and-figure chart on a manual scale: the form shown modally with
    // the automatic value proposed; nullopt when the user closed it.
    static std::optional<app::BoxValueAnswer> AskBoxValue(app::Session& session, SettingsHub& hub,
                                                          float proposal, QWidget* parent);

private:
    void BuildOscillatorForm();
    void BuildBoxForm();

    std::string m_oscName;
    bool m_weekly;
    bool m_pointAndFigure;
    osc::OscDef m_def;
    std::vector<QLineEdit*> m_fields;
    QLineEdit* m_compare = nullptr;
    QLineEdit* m_box = nullptr;
    std::optional<app::BoxValueAnswer> m_boxAnswer;
};

} // namespace kori::gui
