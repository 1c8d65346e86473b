#pragma once
// MultiOsc ("MultiOsc Setup"): two sets of five oscillator slots. Click a slot, then double
// click a name in the list to fill it.
#include "gui/widgets/settings_dialog.h"

#include <array>

class QListWidget;

namespace kori::gui {

class MultiOsc : public SettingsDialog {
    Q_OBJECT
public:
    MultiOsc(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    QListWidget* choices() const { return m_choices; }
    QListWidget* set(int i) const { return m_sets[static_cast<std::size_t>(i)]; }
    // Fills the chosen slot with the name of a row of the list (a double click).
    void Fill(int choiceRow);
    void Save();

private:
    QListWidget* m_choices;
    std::array<QListWidget*, 2> m_sets{};
    QListWidget* m_activeSet = nullptr;
};

} // namespace kori::gui
