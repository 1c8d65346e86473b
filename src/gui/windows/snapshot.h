#pragma once
// Snapshot: the last day of every security of a list beside its oscillators, sortable by any
// column, with the market's breadth above it; a double click opens the chart.
#include "app/snapshot_form.h"
#include "gui/windows/chk_dta.h"

#include <QDialog>

class QComboBox;
class QLabel;

namespace kori::gui {

class GridView;
class QtProgress;

class Snapshot : public QDialog {
    Q_OBJECT
public:
    Snapshot(app::Session& session, QtProgress& progress, ShowChartAt showChart,
             QWidget* parent = nullptr);

    app::SnapshotForm& form() { return m_form; }
    GridView* grid() const { return m_grid; }
    QLabel* breadth() const { return m_breadth; }
    QComboBox* listBox() const { return m_list; }
    void Take();
    void SortBy(int column);
    void ShowChart();
    bool ExportCsv(const std::string& path);

private:
    void Show();
    void ChooseExportFile();

    app::Session& m_session;
    QtProgress& m_progress;
    ShowChartAt m_showChart;
    app::SnapshotForm m_form;
    app::GridModel m_model;
    QComboBox* m_list;
    QLabel* m_breadth;
    GridView* m_grid;
};

} // namespace kori::gui
