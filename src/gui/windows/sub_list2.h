#pragma once
// SubList2 ("Chart List Utilities"): two chart lists side by side (the scan list Z among
// them); entries are copied across, deleted, and each list saved.
#include "gui/widgets/chart_list_panel.h"
#include "gui/widgets/settings_dialog.h"

class QVBoxLayout;

namespace kori::gui {

class SubList2 : public SettingsDialog {
    Q_OBJECT
public:
    SubList2(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    ChartListPanel& panel(int side) { return side == 0 ? *m_left : *m_right; }

    // Copies the selected entries of one side to the end of the other; both lists must be
    // displayed.
    bool CopyAcross(int fromSide);
    void DeleteSelected(int side);
    void DeleteAll(int side);
    bool SaveSide(int side);

public slots:
    void reject() override;

private:
    bool AskToSave(ChartListPanel& panel);
    QVBoxLayout* SideButtons(int side);

    ChartListPanel* m_left;
    ChartListPanel* m_right;
};

} // namespace kori::gui
