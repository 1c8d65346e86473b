#pragma once
// CPath ("Path Details"): the system, data, back-up and portfolio-manager folders.
#include "app/folder_config.h"
#include "gui/widgets/settings_dialog.h"

#include <array>

class QLineEdit;

namespace kori::gui {

class CPath : public SettingsDialog {
    Q_OBJECT
public:
    CPath(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    // False when the user chose to end the program at the missing-paths question; the window
    // is then not to be shown.
    bool proceed() const { return m_proceed; }
    QLineEdit* field(int i) const { return m_fields[static_cast<std::size_t>(i)]; }
    bool Save();

public slots:
    void reject() override;

private:
    void Show(const app::PathDetails& p);
    app::PathDetails Edited() const;
    void Browse(int i);

    std::array<QLineEdit*, 5> m_fields{};
    app::PathDetails m_shown;
    bool m_proceed = true;
};

} // namespace kori::gui
