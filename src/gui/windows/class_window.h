#pragma once
// The grid both classification windows share: the rows of IndClass.dat or Gics.dat, checked
// cell by cell as the user leaves them and written back when the window closes with changes.
// In pick mode (chart selection) a double click on a row returns its code.
#include "app/session.h"
#include "store/classifications.h"

#include <QDialog>
#include <QStringList>

#include <optional>
#include <string>

class QMenuBar;
class QPrinter;
class QTableWidget;
class QTableWidgetItem;

namespace kori::gui {

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

    QTableWidget* grid() const { return m_grid; }
    QMenuBar* menus() const { return m_menus; }
    bool changed() const { return m_changed; }
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
    void CellLeft(QTableWidgetItem* item);
    // Rows as the file takes them, or nullopt (with the message) when a cell is refused.
    std::optional<std::vector<store::ClassRow>> Rows();
    bool CheckCell(int row, int column, bool report);
    void Print();
    void SetRow(int row, const store::ClassRow& values);

    app::Session& m_session;
    Kind m_kind;
    QTableWidget* m_grid;
    QMenuBar* m_menus;
    bool m_pick;
    bool m_changed = false;
    bool m_filling = false;
    std::optional<std::string> m_picked;
};

// Chart selection's pick: runs the class window (`gics` for the sectors) and returns the code
// of the row double-clicked, if any.
std::optional<std::string> PickClass(app::Session& session, bool gics, QWidget* parent);

} // namespace kori::gui
