#pragma once
// ColNew ("Change Chart Colours"): click a colour, then the items that are to take it.
#include "app/colour_form.h"
#include "gui/widgets/settings_dialog.h"
#include "platform/palette.h"

#include <string>
#include <vector>

class QLabel;
class QPushButton;

namespace kori::gui {

class ColNew : public SettingsDialog {
    Q_OBJECT
public:
    ColNew(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    const platform::Palette& table() const { return m_form.table(); }
    // The sixteen palette swatches and the item swatches, in the window's order, for clicks.
    QPushButton* colourSwatch(int i) const { return m_colours[static_cast<std::size_t>(i)]; }
    QPushButton* roleSwatch(int i) const { return m_roles[static_cast<std::size_t>(i)]; }

private:
    void PickColour(int i);
    void PaintItem(int role);
    void ApplyScheme(const char* scheme);
    void SaveColours();
    void SaveDefaultColours();
    void Refresh();

    app::ColourForm m_form;
    std::vector<QPushButton*> m_colours;
    std::vector<QPushButton*> m_roles;
    QLabel* m_hint;
};

} // namespace kori::gui
