#pragma once
// Statistics ("Top Movers by Percentage") and ADTotals ("Check Advance/Decline Totals").
#include "app/statistics_form.h"
#include "gui/windows/scan_windows.h"

#include <QDialog>

#include <array>

class QLabel;
class QLineEdit;
class QListWidget;
class QPrinter;
class QRadioButton;

namespace kori::gui {

class GridView;

class Statistics : public ScanWindow {
    Q_OBJECT
public:
    Statistics(app::Session& session, ShowChartOf showChart, QWidget* parent = nullptr);
    app::StatisticsForm& form() { return m_form; }
    QRadioButton* filter(std::size_t i) const { return m_filters[i]; }
    QLineEdit* top() const { return m_top; }
    GridView* grid() const { return m_grid; }

    // The walk over the name file, then the grid.
    bool Proceed() override;
    // "&Update Statistics": the grid again for the "Top" in hand, with no new walk.
    bool Update();
    bool PrintTo(QPrinter& printer) override;
    // The chart of the code in the grid's current cell.
    void ShowChart();

private:
    void Take();
    void ShowGrid();

    app::StatisticsForm m_form;
    std::array<QRadioButton*, 4> m_filters{};
    QLineEdit* m_top;
    GridView* m_grid;
};

class ADTotals : public QDialog {
    Q_OBJECT
public:
    ADTotals(app::Session& session, QWidget* parent = nullptr);
    app::ADTotalsForm& form() { return m_form; }
    QListWidget* codes() const { return m_codes; }
    QLabel* name() const { return m_name; }
    QLineEdit* base() const { return m_base; }
    // A code of the list picked: its name and base value shown.
    bool Pick(int row);
    // "Check Totals".
    bool CheckTotals();

private:
    app::Session& m_session;
    app::ADTotalsForm m_form;
    QListWidget* m_codes;
    QLabel* m_name;
    QLineEdit* m_base;
};

} // namespace kori::gui
