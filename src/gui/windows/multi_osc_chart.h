#pragma once
// The multi-oscillator chart window: the price chart with the oscillators of one of the two
// sets of "MultiOsc Setup" stacked beneath it. Walks the chart list as the chart window does,
// prints, saves and shows saved charts; its setup key opens the sets.
#include "app/chart_selection.h"
#include "app/multi_osc_chart.h"
#include "chart/print_chart.h"

#include <QWidget>

#include <optional>
#include <string>

class QAction;
class QKeyEvent;
class QLabel;
class QPrinter;
class QTimer;
class QToolBar;

namespace kori::gui {

class ChartView;

class MultiOscChart : public QWidget {
    Q_OBJECT
public:
    MultiOscChart(app::Session& session, app::ChartState& state, int set,
                  QWidget* parent = nullptr);

    // Set 1 or 2, drawn again at once when a security is in hand.
    void ChooseSet(int set);
    // The security the chart window has in hand, drawn with the set.
    void ShowSecurity(const store::NameRecord& name);
    // The next-chart command: +1 next, -1 previous, 0 redraw.
    bool NextChart(int delta);
    bool Rebuild();

    void SetPrinter(QPrinter* printer) { m_printer = printer; }
    void Print();
    bool PrintTo(QPrinter& printer);
    // "Save Chart As ...": `answer` is the name dialog's answer (a path, "CANCEL" or "NOGOOD").
    bool SaveChartAs(const std::string& answer);
    bool DisplaySavedChart(const std::string& chosen);

    app::MultiOscChartModel& model() { return m_model; }
    ChartView* picture() const { return m_picture; }
    QAction* Key(const char* name) const;
    bool showingSavedChart() const { return !m_savedPath.empty(); }

signals:
    // The setup of the two sets is wanted.
    void SetupRequested();

protected:
    void keyPressEvent(QKeyEvent* e) override;

private:
    QSize AreaSize() const;
    void UpdateCaption();

    app::Session& m_session;
    app::MultiOscChartModel m_model;
    std::optional<chart::PrintSettings> m_print;
    QPrinter* m_printer = nullptr;
    std::string m_savedPath;
    QToolBar* m_toolbar;
    QAction* m_set1 = nullptr;
    QAction* m_set2 = nullptr;
    ChartView* m_picture;
    QLabel* m_status;
    QTimer* m_resizeTimer;
};

} // namespace kori::gui
