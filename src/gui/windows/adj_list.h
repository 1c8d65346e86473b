#pragma once
// AdjList ("KORI Data Mainenance"): the maintenance list in a grid, its menus, and the run of
// the marked items; AdjOpts ("Adjustments"): how bulletins enter the list. The rules are in
// app::AdjustmentListForm; these windows show it and pass the user's acts in.
#include "app/adjustment_list_form.h"

#include <QDialog>
#include <QPrinter>

class QButtonGroup;
class QCheckBox;
class QLabel;
class QMenuBar;
class QTableWidget;

namespace kori::gui {

class MainWindow;
class QtProgress;

class AdjList : public QDialog {
    Q_OBJECT
public:
    AdjList(app::Session& session, QtProgress& progress, QWidget* parent = nullptr);

    app::AdjustmentListForm& form() { return m_form; }
    QTableWidget* grid() const { return m_grid; }
    QLabel* label() const { return m_label; }
    QLabel* status() const { return m_status; }
    QMenuBar* menus() const { return m_menus; }
    bool loaded() const { return m_loaded; }

    void MakeAdjustments();
    void RemoveMarkedD();
    void DeleteRows();
    // The list as text lines, a page at a time, headed by the caption. False when the printer
    // could not start.
    bool PrintTo(QPrinter& printer);
    // The list again from the form.
    void Refill();

protected:
    void closeEvent(QCloseEvent* e) override;
    void reject() override;

private:
    void CellEdited(int row, int column);

    app::Session& m_session;
    QtProgress& m_progress;
    QPrinter m_printer{QPrinter::HighResolution};
    app::AdjustmentListForm m_form;
    QMenuBar* m_menus;
    QLabel* m_label;
    QLabel* m_status;
    QTableWidget* m_grid;
    bool m_filling = false;
    bool m_loaded = false;
};

class AdjOpts : public QDialog {
    Q_OBJECT
public:
    explicit AdjOpts(app::Session& session, QWidget* parent = nullptr);
    QButtonGroup* divs() const { return m_divs; }
    QCheckBox* noShortNames() const { return m_noShort; }
    void Save();

private:
    app::Session& m_session;
    QButtonGroup* m_divs;
    QCheckBox* m_noShort;
};

void RegisterAdjListWindows(MainWindow& main);

} // namespace kori::gui
