#pragma once
// NameForm: Names.dat in a grid, one row a record, saved back whole. The rules are in
// app::NameFormModel; this window shows its grid and passes the menu commands in.
#include "app/name_form_model.h"
#include "app/session.h"

#include <QDialog>

class QLabel;
class QMenuBar;

namespace kori::gui {

class GridView;
class RepairProgress;

class NameForm : public QDialog {
    Q_OBJECT
public:
    NameForm(app::Session& session, QWidget* parent = nullptr);
    ~NameForm() override;

    app::NameFormModel& model() { return *m_model; }
    GridView* grid() const { return m_grid; }
    QLabel* caption() const { return m_caption; }
    QMenuBar* menus() const { return m_menus; }

    // ShowNames again from the file.
    void Display();
    bool Save();
    void Sort(store::NameSortOrder order);

public slots:
    void reject() override;

private:
    // First and last selected rows, 1-based; {0, 0} without a selection.
    std::pair<int, int> SelectedRows() const;
    void AfterChange();
    void Print();

    app::Session& m_session;
    RepairProgress* m_progress;
    std::unique_ptr<app::NameFormModel> m_model;
    GridView* m_grid;
    QLabel* m_caption;
    QMenuBar* m_menus;
};

} // namespace kori::gui
