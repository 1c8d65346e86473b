#pragma once
// Watchlist: the user's lists of securities, each row worked against its last days; sortable by
// any column, rows added and removed, lists made, renamed and deleted; a double click charts.
#include "app/watchlist_form.h"
#include "gui/windows/scan_windows.h"

#include <QDialog>

class QComboBox;
class QLabel;
class QLineEdit;

namespace kori::gui {

class GridView;

class Watchlist : public QDialog {
    Q_OBJECT
public:
    Watchlist(app::Session& session, ShowChartOf showChart, QWidget* parent = nullptr);

    app::WatchlistForm& form() { return m_form; }
    GridView* grid() const { return m_grid; }
    QComboBox* listBox() const { return m_list; }
    QLabel* issuesLabel() const { return m_issues; }

    // The shown security of the chart window into the shown list, its row made current.
    void AddFromChart(const std::string& code);
    // The code, entry price, date, quantity and note typed below the grid.
    void AddTyped();
    void RemoveCurrent();
    void NewList();
    void RenameList();
    void DeleteList();
    void SortBy(int column);
    void ShowChart();
    bool ExportCsv(const std::string& path);

protected:
    void hideEvent(QHideEvent* e) override;

private:
    void FillLists();
    void Show();
    bool Check(const platform::Status& s);

    app::Session& m_session;
    ShowChartOf m_showChart;
    app::WatchlistForm m_form;
    app::GridModel m_model;
    QComboBox* m_list;
    QLabel* m_issues;
    GridView* m_grid;
    QLineEdit *m_code, *m_price, *m_date, *m_quantity, *m_note;
};

} // namespace kori::gui
