#pragma once
// Targets ("Quoren Alerts"): the price targets of Targets.txt in a grid; the rules are in
// app::TargetsForm.
#include "app/session.h"
#include "app/targets_form.h"

#include <QDialog>

class QLabel;
class QMenuBar;

namespace kori::gui {

class GridView;

class Targets : public QDialog {
    Q_OBJECT
public:
    explicit Targets(app::Session& session, QWidget* parent = nullptr);

    app::TargetsForm& form() { return m_form; }
    GridView* grid() const { return m_grid; }
    QMenuBar* menus() const { return m_menus; }

    // "&Save", "&Delete Row" (the current row), "&Sort List".
    bool Save();
    void DeleteRow();
    void SortList();

public slots:
    void reject() override;

private:
    void GoToRefusal();

    app::TargetsForm m_form;
    GridView* m_grid;
    QMenuBar* m_menus;
};

} // namespace kori::gui
