#pragma once
// CLNames ("Rename Chart Lists"): the display names of the ten chart lists.
#include "gui/widgets/settings_dialog.h"

#include <array>
#include <string>

class QLineEdit;

namespace kori::gui {

class CLNames : public SettingsDialog {
    Q_OBJECT
public:
    CLNames(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    QLineEdit* field(int i) const { return m_fields[static_cast<std::size_t>(i)]; }
    // SaveSLNames with the names as typed.
    bool Save();

public slots:
    // Closing with changes asks "Save changes ?".
    void reject() override;

private:
    std::array<std::string, 10> Edited() const;

    std::array<QLineEdit*, 10> m_fields{};
    std::array<std::string, 10> m_shown;
};

} // namespace kori::gui
