#pragma once
// ChkDta: the data check's choices (which list, the three limits) and "Check"; DataStat: its
// report, one row a finding, from which a chart or a CSV file is one click away.
#include "app/data_check_form.h"

#include <QDialog>

#include <functional>
#include <memory>

class QComboBox;
class QLabel;
class QLineEdit;

namespace kori::gui {

class GridView;
class QtProgress;

// Opens the chart of a code ending at a date ("yyyymmdd").
using ShowChartAt = std::function<void(const std::string& code, const std::string& date)>;

class DataStat : public QDialog {
    Q_OBJECT
public:
    DataStat(app::Session& session, const maint::DataCheckResult& result, ShowChartAt showChart,
             QWidget* parent = nullptr);

    GridView* grid() const { return m_grid; }
    const std::vector<maint::Finding>& findings() const { return m_findings; }
    // The chart of the current row, ending at its date.
    void ShowChart();
    // Writes the report as CSV; false (after a message) when the file cannot be written.
    bool ExportCsv(const std::string& path);

private:
    void ChooseExportFile();
    void Print();

    app::Session& m_session;
    std::vector<maint::Finding> m_findings;
    app::GridModel m_model;
    GridView* m_grid;
    ShowChartAt m_showChart;
};

class ChkDta : public QDialog {
    Q_OBJECT
public:
    ChkDta(app::Session& session, QtProgress& progress, ShowChartAt showChart,
           QWidget* parent = nullptr);

    app::DataCheckForm& form() { return m_form; }
    QComboBox* listBox() const { return m_list; }
    QLineEdit* gapEdit() const { return m_gap; }
    QLineEdit* stoppedEdit() const { return m_stopped; }
    QLineEdit* moveEdit() const { return m_move; }
    // "Check": the limits checked, the walk run with progress, the report opened. The report,
    // or null when a limit was refused or the list could not be read.
    DataStat* Check();

private:
    app::Session& m_session;
    QtProgress& m_progress;
    ShowChartAt m_showChart;
    app::DataCheckForm m_form;
    QComboBox* m_list;
    QLineEdit* m_gap;
    QLineEdit* m_stopped;
    QLineEdit* m_move;
    QLabel* m_status;
};

} // namespace kori::gui
