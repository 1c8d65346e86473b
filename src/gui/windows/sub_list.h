#pragma once
// SubList ("Edit Chart Lists"): one chart list beside the box of every code of the name file.
// Codes are typed or double-clicked into the list, ordered, deleted, and saved.
#include "gui/widgets/chart_list_panel.h"
#include "gui/widgets/settings_dialog.h"

class QLineEdit;
class QListWidget;

namespace kori::gui {

class SubList : public SettingsDialog {
    Q_OBJECT
public:
    SubList(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    ChartListPanel& panel() { return *m_panel; }
    QListWidget* stocks() const { return m_stocks; }
    QLineEdit* codeField() const { return m_code; }

    // Looks the code up in the name file: "Code not found", else it goes in after the
    // selected entry (at the end when none is).
    bool AddCode(const QString& code);
    void DeleteSelected();
    void DeleteAll();
    void MoveSelected(int step);
    bool SaveList();

public slots:
    void reject() override;

private:
    bool AskToSave();

    ChartListPanel* m_panel;
    QListWidget* m_stocks;
    QLineEdit* m_code;
    std::vector<std::string> m_stockCodes;
};

} // namespace kori::gui
