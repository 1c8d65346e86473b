#pragma once
// DataForm: one price file in a grid, newest record at the bottom, saved back whole; the code
// entry window that leads to it; and VolMod, which multiplies or divides one item of the
// highlighted rows. The rules are in app::DataFormModel.
#include "app/data_form_model.h"
#include "app/session.h"

#include <QDialog>

#include <memory>
#include <optional>
#include <string>

class QButtonGroup;
class QComboBox;
class QLabel;
class QLineEdit;
class QMenuBar;

namespace kori::gui {

class GridView;
class RepairProgress;

// The code entry window: a code, then its price file; nullopt when cancelled or refused.
class DataCodeEntry : public QDialog {
    Q_OBJECT
public:
    DataCodeEntry(app::Session& session, QWidget* parent = nullptr);
    QLineEdit* codeField() const { return m_code; }
    const std::optional<std::filesystem::path>& file() const { return m_file; }
    std::string code() const;

public slots:
    void accept() override;

private:
    app::Session& m_session;
    QLineEdit* m_code;
    std::optional<std::filesystem::path> m_file;
};

class DataForm : public QDialog {
    Q_OBJECT
public:
    DataForm(app::Session& session, std::filesystem::path file, std::string code,
             QWidget* parent = nullptr);
    ~DataForm() override;

    app::DataFormModel& model() { return *m_model; }
    GridView* grid() const { return m_grid; }
    QMenuBar* menus() const { return m_menus; }
    bool loaded() const { return m_loaded; }
    std::pair<int, int> SelectedRows() const;
    // nmAdjVol: VolMod over the highlighted rows.
    void AdjustVolume();

public slots:
    void reject() override;

private:
    app::Session& m_session;
    RepairProgress* m_progress;
    std::unique_ptr<app::DataFormModel> m_model;
    GridView* m_grid;
    QMenuBar* m_menus;
    bool m_loaded = false;
};

// VolMod ("Data Modification"): item, operation and factor for rows first..last.
class VolMod : public QDialog {
    Q_OBJECT
public:
    VolMod(app::DataFormModel& model, int first, int last, QWidget* parent = nullptr);
    QButtonGroup* items() const { return m_items; }
    QButtonGroup* operations() const { return m_ops; }
    QComboBox* factor() const { return m_factor; }

public slots:
    void accept() override;

private:
    app::DataFormModel& m_model;
    int m_first, m_last;
    QButtonGroup* m_items;
    QButtonGroup* m_ops;
    QComboBox* m_factor;
};

} // namespace kori::gui
