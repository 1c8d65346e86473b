#pragma once
// DataPaths ("Data Folders"): the folder of each data type. In the setting mode the folders
// can be edited and saved; in the picking mode only the current data folder can be picked.
#include "app/folder_config.h"
#include "gui/widgets/settings_dialog.h"

#include <array>

class QLineEdit;
class QRadioButton;

namespace kori::gui {

class DataPaths : public SettingsDialog {
    Q_OBJECT
public:
    enum class Mode { Setting, Picking };
    DataPaths(app::Session& session, SettingsHub& hub, Mode mode, QWidget* parent = nullptr);

    bool folderChanged() const { return m_folderChanged; }
    QLineEdit* field(int i) const { return m_fields[static_cast<std::size_t>(i)]; }
    QRadioButton* option(int i) const { return m_options[static_cast<std::size_t>(i)]; }
    bool Save();
    // The option button of a row: makes its folder the data folder at once.
    bool Pick(int i);

private:
    void MarkCurrent();

    Mode m_mode;
    std::array<QLineEdit*, app::kDataTypeCount> m_fields{};
    std::array<QRadioButton*, app::kDataTypeCount> m_options{};
    bool m_folderChanged = false;
};

} // namespace kori::gui
