#pragma once
// Fundmnt ("Fundamentals"): the security details as a table with the price figures worked out
// beside them; F1Size sets the size the table is shown at. The rules are in
// app::FundamentalsForm.
#include "app/fundamentals_form.h"

#include <QDialog>

#include <vector>

class QMenuBar;
class QPrinter;
class QSpinBox;
class QTableWidget;

namespace kori::gui {

class Fundmnt : public QDialog {
    Q_OBJECT
public:
    explicit Fundmnt(app::Session& session, QWidget* parent = nullptr);

    app::FundamentalsForm& form() { return m_form; }
    QTableWidget* table() const { return m_table; }
    QMenuBar* menus() const { return m_menus; }
    bool loaded() const { return m_loaded; }

    void ShowFigures();
    void HideCurrentColumn();
    void ShowAllColumns();
    void SetDisplaySize(int points);
    void PrintTo(QPrinter& printer) const;
    std::vector<int> SelectedRows() const;

private:
    void Fill();

    app::Session& m_session;
    app::FundamentalsForm m_form;
    QTableWidget* m_table;
    QMenuBar* m_menus;
    bool m_loaded = false;
};

// "Change Display Size": the point size of the details table.
class F1Size : public QDialog {
    Q_OBJECT
public:
    F1Size(Fundmnt& table, int points);
    QSpinBox* size() const { return m_size; }

private:
    QSpinBox* m_size;
};

} // namespace kori::gui
