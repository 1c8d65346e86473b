#pragma once
// Locate ("Modify File Locations"): a drive list and a folder tree to pick a folder with.
#include "gui/widgets/settings_dialog.h"

#include <optional>

class QComboBox;
class QFileSystemModel;
class QLineEdit;
class QTreeView;

namespace kori::gui {

class Locate : public SettingsDialog {
    Q_OBJECT
public:
    Locate(app::Session& session, SettingsHub& hub, const std::string& start,
           QWidget* parent = nullptr);

    // The folder chosen, with its closing separator; set when OK accepted it.
    const std::optional<std::string>& chosen() const { return m_chosen; }
    void SetPath(const QString& path);

    // Runs the window and returns the folder picked, if any.
    static std::optional<std::string> Choose(app::Session& session, SettingsHub& hub,
                                             const std::string& start, QWidget* parent);

private:
    void Ok();

    QComboBox* m_drives;
    QFileSystemModel* m_model;
    QTreeView* m_tree;
    QLineEdit* m_path;
    std::optional<std::string> m_chosen;
};

} // namespace kori::gui
