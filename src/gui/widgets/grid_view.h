#pragma once
// The view of a GridModel: a table the user edits cell by cell. Leaving a refused cell shows
// its message and puts the cursor back in it; insert, delete and sort go through the model and
// the table follows. It prints the rows as a table under a caption.
#include "app/grid_model.h"
#include "platform/dialogs.h"

#include <QTableWidget>

#include <functional>
#include <string>
#include <vector>

class QPrinter;

namespace kori::gui {

// Rows of texts printed as one table under a caption; `shown(column)` leaves out the columns
// the user hid (all shown without it).
void PrintTable(QPrinter& printer, const QString& caption, const std::vector<std::string>& headers,
                const std::vector<std::vector<std::string>>& rows,
                const std::function<bool(int)>& shown = {});

class GridView : public QTableWidget {
    Q_OBJECT
public:
    // `messageTitle`: the title of the cell messages ("Industry Class", ...).
    GridView(app::GridModel& model, platform::Dialogs& dialogs, std::string messageTitle,
             QWidget* parent = nullptr);

    app::GridModel& model() { return m_model; }
    // The table again from the model.
    void Refresh();
    // A blank row under the current one (at the end without one), made current.
    void AddRow();
    void DeleteCurrentRow();
    // Sorts by `column`; a refused cell is shown and made current instead.
    void SortBy(int column);
    // Every cell checked; the first refused one is shown and made current. True when all pass.
    bool CheckAll();
    void PrintTo(QPrinter& printer, const QString& caption) const;

signals:
    void Edited();

private:
    void CellLeft(QTableWidgetItem* item);
    void ShowRefusal(const app::CellRefusal& r);

    app::GridModel& m_model;
    platform::Dialogs& m_dialogs;
    std::string m_title;
    bool m_filling = false;
};

} // namespace kori::gui
