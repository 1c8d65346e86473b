#pragma once
// Chts: the chart window. Picture1 shows the price chart, Picture2 the oscillator panel (drawn
// by whatever the oscillator code plugs in), Picture4 the reversal legend. The toolbar changes
// the request and rebuilds; the mouse tools draw onto the picture and into the streams; the
// menu prints, sets up the page, saves and shows saved charts.
#include "app/chart_selection.h"
#include "app/chart_service.h"
#include "app/chart_window_model.h"
#include "chart/chart_tools.h"
#include "chart/print_chart.h"
#include "chart/swing.h"

#include <QWidget>

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

class QAction;
class QComboBox;
class QKeyEvent;
class QLabel;
class QPrinter;
class QScrollBar;
class QStatusBar;
class QTimer;
class QToolBar;

namespace kori::gui {

class ChartView;

class Chts : public QWidget {
    Q_OBJECT
public:
    Chts(app::Session& session, app::ChartState& state, QWidget* parent = nullptr);
    ~Chts() override;

    // Seam for extra drawing on every build.
    void SetOverlayHook(app::ChartWindowModel::OverlayHook hook) {
        m_model.SetOverlayHook(std::move(hook));
    }

    // The next-chart command: "fwd" +1, "rev" -1, "ref" 0 on the list in use.
    bool NextChart(int delta);
    // Builds the chart of the security in hand with the request as it stands.
    bool Rebuild();
    void SetStyle(char style);
    void SetPeriod(char period);
    // Steps the chart's end by a day, week or month ('A', 'W', 'M'), forward or back.
    void StepEnd(char unit, int direction);
    void SetTool(app::ChartTool tool);
    // "new": leaves the chart for the chart selection.
    void NewChart();
    app::ChartTool tool() const { return m_model.tool(); }
    void SetCalendarTimeLines(bool calendar);
    // Swing lines on or off, by the method and value of the swing settings.
    void SetSwing(bool on);
    // Chart2's choice: the security in hand above, `lower` at its own period below, until the
    // next-chart command steps on or "Single Chart" is chosen.
    bool ShowSplit(const app::SecondChart& lower);
    void EndSplit();
    bool splitShown() const { return m_model.splitShown(); }
    // Whether the oscillator panel shows under the price chart (in the same picture).
    bool panelShown() const { return m_model.panelShown(); }

    // The printer "Printer Setup" shapes, kept for the run; without one each print starts afresh.
    void SetPrinter(QPrinter* printer) { m_printer = printer; }
    // Printing: the dialog, and the road behind it for a printer already set up.
    void Print();
    bool PrintTo(QPrinter& printer);
    void PageSetup();
    // "Save Chart As ...": `answer` is the name dialog's answer (a path, "CANCEL" or "NOGOOD").
    bool SaveChartAs(const std::string& answer);
    void SaveChartDialog();
    // "Display Saved Chart" of a chosen file (empty: cancelled).
    bool DisplaySavedChart(const std::string& chosen);
    void DisplaySavedChartDialog();
    void RemoveAllTrendlines();
    void StartAutoScroll();
    void StopAutoScroll();
    void ShowScrollBar(bool on);

    // The mouse on Picture1, in chart units (the tests drive these as the widget does).
    void MouseMove(double x, double y, Qt::MouseButtons buttons);
    void MousePress(double x, double y, Qt::MouseButton button);
    void MouseRelease(double x, double y, Qt::MouseButton button);

    chart::Chart& chart() { return m_model.chart(); }
    const store::NameRecord& current() const { return m_model.current(); }
    app::ChartWindowModel& model() { return m_model; }
    ChartView* picture1() const { return m_picture1; }
    ChartView* picture4() const { return m_picture4; }
    const std::vector<chart::TrendEnds>& trendEnds() const { return m_model.trendEnds(); }
    // The texts of the status panes.
    std::vector<std::string> StatusPanes() const;
    QToolBar* toolBar() const { return m_toolbar; }
    // The action of a toolbar key ("fwd", "tline", ...), or nullptr.
    QAction* ToolKey(const char* key) const;
    bool showingSavedChart() const { return m_model.showingSaved(); }
    void Wheel(int notches, bool ctrl);

signals:
    // "new": back to the chart selection.
    void ChartSelectionRequested();
    // The oscillator settings box is wanted (the panel was double-clicked).
    void OscSettingsRequested();
    // "Multi-Osc 1" or "Multi-Osc 2": the chart in hand with the oscillators of that set.
    void MultiOscRequested(int set);
    // "Add to Watchlist": the shown security into the Watchlist window.
    void AddToWatchlistRequested(const QString& code);

protected:
    void closeEvent(QCloseEvent* e) override;
    void keyPressEvent(QKeyEvent* e) override;

private:
    void BuildToolBar();
    void SetPanes(const std::vector<std::string>& texts);
    void WithPicture(const std::function<void(platform::Surface&)>& draw);
    bool RebuildKeeping(bool keepToolLines);
    void DrawLegend();
    void LeaveChart();
    std::string Code() const;
    QSize AreaSize() const;
    void Zoom(double x, double y);
    void Apply(const app::ChartEffects& fx);
    void SyncToolKeys();

    app::Session& m_session;
    app::ChartState& m_state;
    app::ChartWindowModel m_model;
    std::optional<chart::PrintSettings> m_print;
    QPrinter* m_printer = nullptr;
    std::string m_savedPath;

    QToolBar* m_toolbar;
    QToolBar* m_toolbar2; // the mouse tools, scroll, print and save
    QComboBox* m_oscBox;
    QAction* m_timeLinesCaption = nullptr;
    QAction* m_singleChart = nullptr;
    chart::SwingSwitch m_swingSwitch;
    ChartView* m_picture1;
    ChartView* m_picture4;
    QScrollBar* m_koriScroll;
    QStatusBar* m_status;
    std::vector<QLabel*> m_panes;
    QLabel* m_details; // the security's issue size, PE ratio and yield, when known
    QTimer* m_autoTimer;
    QTimer* m_resizeTimer; // a resized area gets a chart of its new size
};

} // namespace kori::gui
