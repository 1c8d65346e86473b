#pragma once
// NameData: the name file held against the price files, one row a finding, with the two
// remedies.
#include "app/name_data_form.h"

#include <QDialog>

class QLabel;
class QPushButton;

namespace kori::gui {

class GridView;
class QtProgress;

class NameData : public QDialog {
    Q_OBJECT
public:
    NameData(app::Session& session, QtProgress& progress, QWidget* parent = nullptr);

    app::NameDataForm& form() { return m_form; }
    GridView* grid() const { return m_grid; }
    QLabel* summary() const { return m_summary; }
    void AddMissing();
    void RemoveWithoutData();

private:
    void Show();
    void Print();

    app::Session& m_session;
    QtProgress& m_progress;
    app::NameDataForm m_form;
    app::GridModel m_model;
    GridView* m_grid;
    QLabel* m_summary;
    QPushButton* m_add;
    QPushButton* m_remove;
};

} // namespace kori::gui
