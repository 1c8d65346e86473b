#pragma once
// The grid both classification windows share: the rows of IndClass.dat or Gics.dat, checked
// cell by cell as the user leaves them and written back when the window closes with changes.
// In pick mode (chart selection) a double click on a row returns its code.
#include "app/grid_model.h"
#include "app/session.h"
#include "store/classifications.h"

#include <QDialog>
#include <QStringList>

#include <optional>
#include <string>

class QLabel;
class QMenuBar;
class QPrinter;
class QTableWidget;

namespace kori::gui {

class GridView;

class ClassWindow : public QDialog {
    Q_OBJECT
public:
    struct Kind {
        const char* name;     // window name, also its position key
        const char* title;    // caption
        const char* fileName; // in the system folder
        const char* msgTitle; // title of its messages
        int digits;           // of the code
        QStringList headers;
        bool canPrint;
    };

    QTableWidget* grid() const;
    // What "&Display" last did, under the grid.
    QLabel* statusLine() const { return m_status; }
    QMenuBar* menus() const { return m_menus; }
    bool changed() const { return m_model.changed(); }
    const std::optional<std::string>& picked() const { return m_picked; }

    // ShowIndClass / ShowGicsClass: the file into the grid, codes formatted.
    void Display();
    void AddRow();
    void DeleteRow();
    // SortIC / SortGICS: by code, rows without a code last.
    void SortList();
    // Writes the grid back to the file when it has changes; false (with the message) when a
    // cell is refused or the file could not be written. "&Close" does this before closing.
    bool SaveChanges();
    // The grid on paper (or PDF), one line a row under the window's caption.
    void PrintTo(QPrinter& printer) const;

public slots:
    void reject() override;

protected:
    ClassWindow(app::Session& session, const Kind& kind, bool pick, QWidget* parent);

private:
    void Print();

    app::Session& m_session;
    Kind m_kind;
    app::GridModel m_model;
    GridView* m_grid;
    QLabel* m_status;
    QMenuBar* m_menus;
    bool m_pick;
    std::optional<std::string> m_picked;
};

// Chart selection's pick: runs the class window (`gics` for the sectors) and returns the code
// of the row double-clicked, if any.
std::optional<std::string> PickClass(app::Session& session, bool gics, QWidget* parent);

} // namespace kori::gui
