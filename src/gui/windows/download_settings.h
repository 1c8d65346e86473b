#pragma once
// The download settings windows: ModDetails ("Data Download Service Details"), DLWizard
// ("Download Data Settings") and INUpList ("Download Update List"). Their rules are in
// app/download_settings_form.h; these show them and pass the user's choices in.
#include "app/download_settings_form.h"

#include <QDialog>

#include <array>

class QButtonGroup;
class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QListWidget;
class QMenuBar;
class QPushButton;

namespace kori::gui {

class GridView;

class ModDetails : public QDialog {
    Q_OBJECT
public:
    explicit ModDetails(app::Session& session, QWidget* parent = nullptr);

    app::ModDetailsForm& form() { return m_form; }
    QComboBox* service() const { return m_service; }
    QLineEdit* folder() const { return m_folder; }
    QComboBox* format() const { return m_format; }
    QLineEdit* divisor() const { return m_divisor; }
    // "SAVE": closes the window when saved.
    bool Save();

private:
    void ServiceChosen(int item);
    void ShowControls();

    app::Session& m_session;
    app::ModDetailsForm m_form;
    QComboBox* m_service;
    QLineEdit* m_folder;
    QComboBox* m_format;
    QLineEdit* m_divisor;
    QWidget* m_internet;     // form, divisor and update-list controls
    QPushButton* m_segments; // DLWizard, for the service of a folder a segment
};

class DLWizard : public QDialog {
    Q_OBJECT
public:
    explicit DLWizard(app::Session& session, QWidget* parent = nullptr);

    app::DownloadWizardForm& form() { return m_form; }
    QCheckBox* received(int i) const { return m_received.at(static_cast<std::size_t>(i)); }
    QLineEdit* folder(int i) const { return m_folders.at(static_cast<std::size_t>(i)); }
    // "Save Settings": closes the window when saved.
    bool Save();

private:
    app::DownloadWizardForm m_form;
    std::array<QCheckBox*, app::kDataTypeCount> m_received{};
    std::array<QLineEdit*, app::kDataTypeCount> m_folders{};
};

class INUpList : public QDialog {
    Q_OBJECT
public:
    explicit INUpList(app::Session& session, QWidget* parent = nullptr);

    app::UpdateListForm& form() { return m_form; }
    GridView* grid() const { return m_grid; }
    QListWidget* master() const { return m_master; }
    QMenuBar* menus() const { return m_menus; }
    QButtonGroup* options() const { return m_options; }

    void AddChecked();
    void AddRows();
    void DeleteRows();
    bool Save();

public slots:
    void reject() override;

private:
    void FillMaster();

    app::UpdateListForm m_form;
    GridView* m_grid;
    QListWidget* m_master;
    QMenuBar* m_menus;
    QButtonGroup* m_options;
};

} // namespace kori::gui
