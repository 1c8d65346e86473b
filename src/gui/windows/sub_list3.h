#pragma once
// SubList3 ("Import Text to Chart Lists"): codes read from a text file, one a line, moved
// into a chart list and saved. The folder of the last file is kept under the key SL3TXT.
#include "gui/widgets/chart_list_panel.h"
#include "gui/widgets/settings_dialog.h"

#include <filesystem>

class QLabel;
class QListWidget;

namespace kori::gui {

class SubList3 : public SettingsDialog {
    Q_OBJECT
public:
    SubList3(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    ChartListPanel& panel() { return *m_panel; }
    QListWidget* fileBox() const { return m_file; }
    // The folder the file dialog opens in: SL3TXT, else the system folder.
    std::string folder() const;

    // Reads the codes of a text file into the file box and remembers its folder.
    bool LoadFile(const std::filesystem::path& file);
    // Moves the selected codes of the file box (all of them when `all`) to the end of the list.
    int MoveToList(bool all);
    bool SaveList();

public slots:
    void reject() override;

private:
    void ChooseFile();
    bool AskToSave();

    ChartListPanel* m_panel;
    QListWidget* m_file;
    QLabel* m_folder;
};

} // namespace kori::gui
