#pragma once
// The road of one chart on the desktop: "&CHARTS" opens ChtSel (or brings Chts forward), "SHOW
// CHART" hands over to Chts, "new" comes back. Holds the chart request shared by the two.
#include "app/chart_selection.h"

#include <QObject>
#include <QPointer>

#include <memory>

class QMdiSubWindow;
class QPrinter;

namespace kori::gui {

class MainWindow;
class ChtSel;
class Chts;
class MultiOscChart;

class ChartWindows : public QObject {
    Q_OBJECT
public:
    explicit ChartWindows(MainWindow& main);
    ~ChartWindows() override;

    // "&CHARTS".
    void OpenCharts();
    // "SHOW CHART" of ChtSel: the chart window comes up on the next chart of the list.
    void ShowChart();
    // "new" of Chts: back to the selection.
    void BackToSelection();
    // "&CHARTS", then the code typed into the selection: its chart when found.
    bool ShowCode(const std::string& code);
    // The same chart ending at a date ("yyyymmdd"; a date that is not one shows the latest).
    bool ShowCodeAt(const std::string& code, const std::string& date);
    // "Close" of ChtSel: both windows go.
    void CloseAll();
    // The multi-oscillator chart of set 1 or 2 for the security of the chart window.
    MultiOscChart* OpenMultiOscChart(int set);
    MultiOscChart* multiOscChart() const;

    ChtSel* chtSel() const;
    Chts* chts() const;
    app::ChartState& state() { return m_state; }
    // The printer of the run: "Printer Setup" shapes it and every print starts from it.
    QPrinter& printer();

private:
    Chts* EnsureChts();

    MainWindow& m_main;
    app::ChartState m_state;
    QPointer<QMdiSubWindow> m_selWindow;
    QPointer<QMdiSubWindow> m_chartWindow;
    QPointer<QMdiSubWindow> m_multiWindow;
    bool m_closingAll = false;
    std::unique_ptr<QPrinter> m_printer;
};

// Registers "&CHARTS", "&Page Setup (Text)" and "Printer &Setup" with the main window.
void RegisterChartWindows(MainWindow& main);

} // namespace kori::gui
