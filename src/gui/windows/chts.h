#pragma once
// Chts: the chart window. Picture1 shows the price chart, Picture2 the oscillator panel (drawn
// by whatever the oscillator code plugs in), Picture4 the reversal legend. The toolbar changes
// the request and rebuilds; the mouse tools draw onto the picture and into the streams; the
// menu prints, sets up the page, saves and shows saved charts.
#include "app/chart_selection.h"
#include "app/chart_service.h"
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
class QLabel;
class QPrinter;
class QScrollBar;
class QStatusBar;
class QTimer;
class QToolBar;

namespace kori::gui {

class ChartView;

// What the mouse is doing.
enum ToolMode : int {
    kToolNone = 0,
    kToolNewChart = 4,
    kToolTrendline = 7,
    kToolZoom = 10,
    kToolAutoScroll = 14,
    kToolFibRetracement = 22,
    kToolFibTimeLines = 23,
    kToolGann = 30,  // the Gann fan tool (a flip, not a mode of its own elsewhere)
    kToolText = 31,  // text notes
    kToolErase = 32, // delete a trendline with the right button
    kToolDayCount = 33,
};

class Chts : public QWidget {
    Q_OBJECT
public:
    Chts(app::Session& session, app::ChartState& state, QWidget* parent = nullptr);
    ~Chts() override;

    // Seams for extra drawing: the overlay hook runs on every build; the oscillator painter
    // draws the panel into Picture2 (`panel` is the panel's own area) and may add to the price
    // chart (`price`, still open), as the classic MACD lines do. It answers whether the panel
    // is wanted; when not (RMO on a weekly chart), the price chart is built again on its own.
    using OverlayHook =
        std::function<void(chart::Chart&, const chart::ChartRequest&, platform::Surface&)>;
    using OscillatorPainter = std::function<bool(
        chart::Chart&, const app::ChartJob&, platform::Surface& price, platform::Surface& panel)>;
    void SetOverlayHook(OverlayHook hook) { m_overlayHook = std::move(hook); }
    void SetOscillatorPainter(OscillatorPainter painter) { m_oscPainter = std::move(painter); }

    // The next-chart command: "fwd" +1, "rev" -1, "ref" 0 on the list in use.
    bool NextChart(int delta);
    // Builds the chart of the security in hand with the request as it stands.
    bool Rebuild();
    void SetStyle(char style);
    void SetPeriod(char period);
    // Steps the chart's end by a day, week or month ('A', 'W', 'M'), forward or back.
    void StepEnd(char unit, int direction);
    void SetTool(int mode);
    int toolMode() const { return m_tool; }
    void SetCalendarTimeLines(bool calendar);
    // Swing lines on or off, by the method and value of the swing settings.
    void SetSwing(bool on);
    // Chart2's choice: the security in hand above, `lower` at its own period below, until the
    // next-chart command steps on or "Single Chart" is chosen.
    bool ShowSplit(const app::SecondChart& lower);
    void EndSplit();
    bool splitShown() const { return m_splitShown; }

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

    chart::Chart& chart() { return *m_chart; }
    const store::NameRecord& current() const { return m_name; }
    ChartView* picture1() const { return m_picture1; }
    ChartView* picture2() const { return m_picture2; }
    ChartView* picture4() const { return m_picture4; }
    const std::vector<chart::TrendEnds>& trendEnds() const { return m_trendEnds; }
    // The texts of the status panes.
    std::vector<std::string> StatusPanes() const;
    QToolBar* toolBar() const { return m_toolbar; }
    // The action of a toolbar key ("fwd", "tline", ...), or nullptr.
    QAction* ToolKey(const char* key) const;
    bool showingSavedChart() const { return m_showingSaved; }

signals:
    // "new": back to the chart selection.
    void ChartSelectionRequested();

protected:
    void closeEvent(QCloseEvent* e) override;

private:
    void BuildToolBar();
    void SetPanes(const std::vector<std::string>& texts);
    void PaintOnPicture(const std::function<void(platform::Surface&)>& draw);
    void DrawLegend();
    void EnsurePrinterColours();
    void LeaveChart();
    std::string Code() const;
    QSize AreaSize() const;
    void Zoom(double x, double y);

    app::Session& m_session;
    app::ChartState& m_state;
    app::ChartWalk m_walk;
    store::NameRecord m_name;
    bool m_haveName = false;
    std::unique_ptr<chart::Chart> m_chart;
    chart::PrinterPage m_page;
    std::optional<chart::PrintSettings> m_print;
    QPrinter* m_printer = nullptr;
    std::vector<chart::TrendEnds> m_trendEnds;
    bool m_trendChanged = false;
    OverlayHook m_overlayHook;
    OscillatorPainter m_oscPainter;

    int m_tool = kToolNone;
    int m_clickStage = 0;
    double m_downX = 0, m_downY = 0;
    bool m_leftDown = false;
    double m_fibStart = 0;
    double m_countFromX = 0;
    int m_moving = -1; // index in m_trendEnds of a line being moved
    double m_fixedX = 0, m_fixedY = 0;
    bool m_calendarLines = false;
    bool m_showingSaved = false;
    bool m_splitShown = false; // the picture holds two charts: the mouse tools stay quiet
    std::string m_savedPath;

    QToolBar* m_toolbar;
    QToolBar* m_toolbar2; // the mouse tools, scroll, print and save
    QComboBox* m_oscBox;
    QAction* m_timeLinesCaption = nullptr;
    QAction* m_singleChart = nullptr;
    chart::SwingSwitch m_swingSwitch;
    ChartView* m_picture1;
    ChartView* m_picture2;
    ChartView* m_picture4;
    QScrollBar* m_koriScroll;
    QStatusBar* m_status;
    std::vector<QLabel*> m_panes;
    QTimer* m_autoTimer;
    QTimer* m_resizeTimer; // a resized area gets a chart of its new size
};

} // namespace kori::gui
