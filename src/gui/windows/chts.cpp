#include "gui/windows/chts.h"

#include "app/chart_navigation.h"
#include "app/chart_window_tools.h"
#include "app/colour_table.h"
#include "app/window_rules.h"
#include "chart/saved_chart.h"
#include "chart/screen_player.h"
#include "chart/swing.h"
#include "gui/paint/qt_surface.h"
#include "gui/services/qt_printer.h"
#include "gui/widgets/chart_view.h"
#include "gui/windows/cht_page.h"
#include "osc/osc_identifiers.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/price_file.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QComboBox>
#include <QDialog>
#include <QFileDialog>
#include <QLabel>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPageLayout>
#include <QPainter>
#include <QPrintDialog>
#include <QPrinter>
#include <QScrollBar>
#include <QStatusBar>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
constexpr int kPanes = 5;
constexpr int kOscPanelHeight = 170;

// The parabolic is chosen as an oscillator but drawn over the bars: no panel for it.
bool OnPriceChart(const std::string& oscName) {
    const auto* id = osc::FindOscIdentifier(oscName);
    return id != nullptr && id->OnPriceChart;
}
constexpr int kFibTimeLineEntry = 21;
// "d/m/yy" for the scroll read-out.
std::string ShortDate(const std::string& yyyymmdd) {
    const auto d = platform::ParseDateText(yyyymmdd);
    if (!d) return yyyymmdd;
    return std::to_string(d->day) + "/" + std::to_string(d->month) + "/" + yyyymmdd.substr(2, 2);
}
} // namespace

Chts::Chts(app::Session& session, app::ChartState& state, QWidget* parent)
    : QWidget(parent), m_session(session), m_state(state), m_walk(session),
      m_chart(std::make_unique<chart::Chart>()), m_toolbar(new QToolBar(this)),
      m_toolbar2(new QToolBar(this)), m_oscBox(new QComboBox(this)),
      m_picture1(new ChartView(this)), m_picture2(new ChartView(this)),
      m_picture4(new ChartView(this)), m_koriScroll(new QScrollBar(Qt::Horizontal, this)),
      m_status(new QStatusBar(this)), m_autoTimer(new QTimer(this)),
      m_resizeTimer(new QTimer(this)) {
    setObjectName(QStringLiteral("Chts"));
    setWindowTitle(QStringLiteral("Chart"));
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);

    auto* menus = new QMenuBar(this);
    QMenu* file = menus->addMenu(QStringLiteral("&Chart"));
    file->addAction(QStringLiteral("&Print"), this, &Chts::Print)
        ->setObjectName(QStringLiteral("cmPrintChart"));
    file->addAction(QStringLiteral("Page Set&up"), this, &Chts::PageSetup)
        ->setObjectName(QStringLiteral("cmPageSetup"));
    file->addSeparator();
    file->addAction(QStringLiteral("Save Chart As ..."), this, &Chts::SaveChartDialog)
        ->setObjectName(QStringLiteral("cmSaveChart"));
    file->addAction(QStringLiteral("Display Saved Chart"), this, &Chts::DisplaySavedChartDialog)
        ->setObjectName(QStringLiteral("cmShowSaved"));
    file->addSeparator();
    file->addAction(QStringLiteral("Chart &Selection"), this, [this] { SetTool(kToolNewChart); });
    file->addAction(QStringLiteral("&Close"), this, [this] {
        // Inside the frame the window is a sub-window; window() would be the main window.
        if (auto* sub = qobject_cast<QMdiSubWindow*>(parentWidget()))
            sub->close();
        else
            close();
    });
    QMenu* tools = menus->addMenu(QStringLiteral("&Tools"));
    tools
        ->addAction(QStringLiteral("Remove all trendlines for ..."), this,
                    &Chts::RemoveAllTrendlines)
        ->setObjectName(QStringLiteral("cmRemoveTrendlines"));
    m_timeLinesCaption = tools->addAction(QStringLiteral("Fib Time Lines - Trading Days"));
    m_timeLinesCaption->setObjectName(QStringLiteral("cmFibTimeKind"));
    connect(m_timeLinesCaption, &QAction::triggered, this,
            [this] { SetCalendarTimeLines(!m_calendarLines); });
    QMenu* overlays = menus->addMenu(QStringLiteral("&Overlays"));
    QAction* mma = overlays->addAction(QStringLiteral("&Multiple Moving Averages"));
    mma->setObjectName(QStringLiteral("cmMMA"));
    mma->setCheckable(true);
    connect(mma, &QAction::toggled, this, [this](bool on) {
        m_state.Request.MMAOn = on;
        Rebuild();
    });
    QAction* swing = overlays->addAction(QStringLiteral("S&wing Chart"));
    swing->setObjectName(QStringLiteral("cmSwing"));
    swing->setCheckable(true);
    connect(swing, &QAction::toggled, this, [this](bool on) { SetSwing(on); });
    overlays->addSeparator();
    m_singleChart = overlays->addAction(QStringLiteral("Single C&hart"), this, &Chts::EndSplit);
    m_singleChart->setObjectName(QStringLiteral("cmSingleChart"));
    m_singleChart->setEnabled(false);
    layout->setMenuBar(menus);

    BuildToolBar();
    layout->addWidget(m_toolbar);
    layout->addWidget(m_toolbar2);
    m_koriScroll->setObjectName(QStringLiteral("KoriScroll"));
    m_koriScroll->hide();
    layout->addWidget(m_koriScroll);
    m_picture1->setObjectName(QStringLiteral("Picture1"));
    m_picture2->setObjectName(QStringLiteral("Picture2"));
    m_picture4->setObjectName(QStringLiteral("Picture4"));
    m_picture2->setMinimumHeight(kOscPanelHeight);
    m_picture2->setMaximumHeight(kOscPanelHeight);
    m_picture2->hide();
    m_picture4->setMinimumSize(200, 52);
    m_picture4->setMaximumHeight(52);
    m_picture4->hide();
    layout->addWidget(m_picture1, 1);
    layout->addWidget(m_picture2);
    layout->addWidget(m_picture4);
    for (int i = 0; i < kPanes; ++i) {
        auto* pane = new QLabel(m_status);
        pane->setObjectName(QStringLiteral("pane%1").arg(i + 1));
        pane->setMinimumWidth(110);
        m_status->addWidget(pane);
        m_panes.push_back(pane);
    }
    layout->addWidget(m_status);

    connect(m_picture1, &ChartView::ChartMouseMove, this, &Chts::MouseMove);
    connect(m_picture1, &ChartView::ChartMousePress, this, &Chts::MousePress);
    connect(m_picture1, &ChartView::ChartMouseRelease, this, &Chts::MouseRelease);
    connect(m_koriScroll, &QScrollBar::valueChanged, this, [this](int v) {
        if (!m_haveName || m_koriScroll->signalsBlocked()) return;
        const std::string date = app::PriceRecordDate(m_session, Code(), v);
        if (date.empty()) return;
        m_state.Request.ByFinishDate = true;
        m_state.Request.FinishDate = date;
        Rebuild();
        SetPanes({ShortDate(date)});
    });
    connect(m_autoTimer, &QTimer::timeout, this, [this] { NextChart(1); });
    m_resizeTimer->setSingleShot(true);
    m_resizeTimer->setInterval(200);
    connect(m_picture1, &ChartView::Resized, m_resizeTimer, qOverload<>(&QTimer::start));
    connect(m_resizeTimer, &QTimer::timeout, this, [this] {
        if (m_haveName && !m_showingSaved && m_picture1->picture().size() != AreaSize()) Rebuild();
    });
}

Chts::~Chts() {
    LeaveChart();
}

void Chts::BuildToolBar() {
    m_toolbar->setObjectName(QStringLiteral("Toolbar1"));
    m_toolbar->setToolButtonStyle(Qt::ToolButtonTextOnly);
    m_toolbar2->setObjectName(QStringLiteral("Toolbar2"));
    m_toolbar2->setToolButtonStyle(Qt::ToolButtonTextOnly);
    QToolBar* bar = m_toolbar;
    auto add = [this, &bar](const char* key, const char* text, const char* tip, auto fn,
                            bool checkable = false) {
        QAction* a = bar->addAction(QString::fromLatin1(text));
        a->setObjectName(QString::fromLatin1(key));
        a->setToolTip(QString::fromLatin1(tip));
        a->setCheckable(checkable);
        connect(a, &QAction::triggered, this, fn);
        return a;
    };
    add("new", "New", "Chart selection", [this] { SetTool(kToolNewChart); });
    add("rev", "<", "Previous chart of the list", [this] { NextChart(-1); });
    add("ref", "=", "Redraw this chart", [this] { NextChart(0); });
    add("fwd", ">", "Next chart of the list", [this] { NextChart(1); });
    m_toolbar->addSeparator();
    add("bar", "Bar", "Bar chart", [this] { SetStyle('B'); });
    add("cstick", "Cdl", "Candlestick chart", [this] { SetStyle('C'); });
    add("lne", "Line", "Line chart", [this] { SetStyle('L'); });
    add("pf", "P&&F", "Point and figure chart", [this] { SetStyle('P'); });
    m_toolbar->addSeparator();
    add("dly", "D", "Daily", [this] { SetPeriod('A'); });
    add("wky", "W", "Weekly", [this] { SetPeriod('W'); });
    add("mly", "M", "Monthly", [this] { SetPeriod('M'); });
    add("m1D", "-1D", "Back a day", [this] { StepEnd('A', -1); });
    add("p1D", "+1D", "Forward a day", [this] { StepEnd('A', 1); });
    add("m1W", "-1W", "Back a week", [this] { StepEnd('W', -1); });
    add("p1W", "+1W", "Forward a week", [this] { StepEnd('W', 1); });
    add("m1M", "-1M", "Back a month", [this] { StepEnd('M', -1); });
    add("p1M", "+1M", "Forward a month", [this] { StepEnd('M', 1); });
    m_toolbar->addSeparator();
    add("grid", "Grid", "Price grid on or off", [this] {
        m_state.Defaults.ShowPriceGrid = !m_state.Defaults.ShowPriceGrid;
        Rebuild();
    });
    add("mo1", "Av1", "Moving average 1 on or off", [this] {
        m_state.Request.AvOne = !m_state.Request.AvOne;
        Rebuild();
    });
    add("mo2", "Av2", "Moving average 2 on or off", [this] {
        m_state.Request.AvTwo = !m_state.Request.AvTwo;
        Rebuild();
    });
    m_oscBox->setObjectName(QStringLiteral("cboOsc"));
    for (const auto& row : app::OscChoices())
        m_oscBox->addItem(QString::fromLatin1(row.Caption.c_str()));
    m_oscBox->setToolTip(QStringLiteral("Oscillator"));
    connect(m_oscBox, &QComboBox::activated, this, [this](int i) {
        const auto& row = app::OscChoices()[static_cast<std::size_t>(i)];
        m_state.Request.AutoOsc = i != 0;
        m_state.Request.AutoOscCode = row.Code;
        m_state.Request.AutoOscSlow = row.Slow;
        Rebuild();
    });
    m_toolbar->addWidget(m_oscBox);
    bar = m_toolbar2;
    add(
        "tline", "Trend", "Draw trendlines",
        [this] { SetTool(m_tool == kToolTrendline ? kToolNone : kToolTrendline); }, true);
    add(
        "terase", "Erase", "Delete a trendline", [this] { SetTool(kToolErase); }, true);
    add(
        "fib", "Fib", "Fibonacci retracement",
        [this] { SetTool(m_tool == kToolFibRetracement ? kToolNone : kToolFibRetracement); }, true);
    add(
        "sFibLines", "FibT", "Fibonacci time lines",
        [this] { SetTool(m_tool == kToolFibTimeLines ? kToolNone : kToolFibTimeLines); }, true);
    add(
        "sGannAng", "Gann", "Gann angles",
        [this] { SetTool(m_tool == kToolGann ? kToolNone : kToolGann); }, true);
    add(
        "text", "Text", "Text notes",
        [this] { SetTool(m_tool == kToolText ? kToolNone : kToolText); }, true);
    add(
        "sDayCount", "Days", "Count the days between two bars",
        [this] { SetTool(m_tool == kToolDayCount ? kToolNone : kToolDayCount); }, true);
    add(
        "sZoom", "Zoom", "Zoom", [this] { SetTool(m_tool == kToolZoom ? kToolNone : kToolZoom); },
        true);
    m_toolbar2->addSeparator();
    add("scroll", "Scroll", "Scroll through the history",
        [this] { ShowScrollBar(m_koriScroll->isHidden()); });
    add("auto", "Auto", "Automatic scroll through the list", [this] {
        if (m_autoTimer->isActive())
            StopAutoScroll();
        else
            StartAutoScroll();
    });
    add("print", "Print", "Print the chart", [this] { Print(); });
    add("save", "Save", "Save the chart", [this] { SaveChartDialog(); });
}

QAction* Chts::ToolKey(const char* key) const {
    for (QToolBar* b : {m_toolbar, m_toolbar2})
        if (auto* a = b->findChild<QAction*>(QString::fromLatin1(key))) return a;
    return nullptr;
}

std::string Chts::Code() const {
    return platform::Trim(m_name.Code);
}

QSize Chts::AreaSize() const {
    QSize s = m_picture1->size();
    if (s.width() < 200 || s.height() < 150) s = m_picture1->sizeHint();
    return {std::max(s.width(), 480), std::max(s.height(), 320)};
}

void Chts::SetPanes(const std::vector<std::string>& texts) {
    for (std::size_t i = 0; i < m_panes.size(); ++i)
        m_panes[i]->setText(i < texts.size() ? Q(texts[i]) : QString());
}

std::vector<std::string> Chts::StatusPanes() const {
    std::vector<std::string> out;
    for (QLabel* p : m_panes)
        out.push_back(p->text().toStdString());
    return out;
}

void Chts::LeaveChart() {
    // Trendlines that changed are packed when the chart goes.
    if (m_trendChanged && m_haveName) (void)app::PackTrendlines(m_session, Code());
    m_trendChanged = false;
}

bool Chts::NextChart(int delta) {
    LeaveChart();
    if (!m_walk.Open(m_state.Request)) {
        m_session.dialogs().MsgBox(m_walk.status().message(), "Chart Display");
        return false;
    }
    const bool classWalk = (m_state.ClassWalk || m_state.GicsWalk) && m_state.Request.ListMode == 1;
    const auto r =
        classWalk ? app::StepClassChart(m_walk, m_state.Request, delta,
                                        m_state.GicsWalk ? m_state.GicsCode : m_state.ClassCode,
                                        m_state.GicsWalk, m_session.dialogs())
                  : app::StepChart(m_walk, m_state.Request, delta);
    if (!r) return false;
    m_name = *r;
    m_haveName = true;
    m_state.Split.AfterNextChart(delta);
    if (delta != 0)
        m_state.Request.ByFinishDate = m_state.Request.ByFinishDate && !m_koriScroll->isVisible();
    return Rebuild();
}

void Chts::SetSwing(bool on) {
    auto& r = m_state.Request;
    if (on) {
        const app::SwingSettings settings = app::ReadSwingSettings(m_session.ini());
        r.SwingMethod = settings.SwingMethod;
        r.SwingValue = settings.SwingValue;
        r.SwingPanel = chart::SwingSidePanel(r.SwingMethod);
    } else {
        r.SwingPanel = chart::SidePanel::None;
    }
    m_swingSwitch.Set(r, on);
    Rebuild();
}

bool Chts::Rebuild() {
    if (!m_haveName) return false;
    QApplication::setOverrideCursor(Qt::WaitCursor);
    app::ClearChartLines(m_session);
    m_clickStage = 0;
    m_showingSaved = false;
    m_moving = -1;
    auto& req = m_state.Request;
    const bool longer = req.ChartPeriod != 'A';
    req.AvOnePeriod = longer ? m_state.Defaults.MAPeriod1Long : m_state.Defaults.MAPeriod1Daily;
    req.AvTwoPeriod = longer ? m_state.Defaults.MAPeriod2Long : m_state.Defaults.MAPeriod2Daily;
    // A split fills the whole area with its two charts: no oscillator panel under them.
    m_splitShown = m_state.Split.Applies(req);
    req.SecondPanelShowing = req.AutoOsc && static_cast<bool>(m_oscPainter) && !m_splitShown &&
                             req.ChartStyle != 'P' && !OnPriceChart(req.AutoOscCode);
    const QSize size = AreaSize();
    ImageSurface area(size.width(), size.height());
    app::ChartJob job;
    job.Name = m_name;
    job.Request = req;
    if (app::IsCloseOnly(m_name.RecordType)) job.Request.ChartStyle = 'L';
    job.Defaults = m_state.Defaults;
    job.Page = &m_page;
    if (m_splitShown) {
        m_state.Split.Apply(job.Request);
        job.Lower = m_state.Split.Lower();
    }
    const std::string code = Code();
    job.DrawOverlays = [this, &job, code](chart::Chart& c, platform::Surface& s) {
        if (m_overlayHook) m_overlayHook(c, job.Request, s);
        // Trendlines and notes belong to one security's single chart.
        if (job.Request.SplitMode) return;
        m_trendEnds = app::DrawChartLines(m_session, c, job.Request, code, s);
        app::DrawTextNotes(m_session, c, job.Request, code, s);
    };
    m_trendEnds.clear();
    m_chart = std::make_unique<chart::Chart>();
    auto built = app::BuildSecurityChart(m_session, job, *m_chart, area);
    bool panelShown = false;
    if (req.SecondPanelShowing && built) {
        ImageSurface panel(size.width(), kOscPanelHeight);
        panelShown = m_oscPainter(*m_chart, job, area, panel);
        if (panelShown) m_picture2->SetPicture(panel.Finish());
    }
    m_picture2->setVisible(panelShown);
    if (req.SecondPanelShowing && built && !panelShown) {
        // The price chart takes the whole area again.
        req.SecondPanelShowing = job.Request.SecondPanelShowing = false;
        area.Clear();
        m_trendEnds.clear();
        m_chart = std::make_unique<chart::Chart>();
        built = app::BuildSecurityChart(m_session, job, *m_chart, area);
    }
    m_picture1->SetPicture(area.Finish());
    DrawLegend();
    m_oscBox->setCurrentIndex(app::OscChoiceOf(req));
    std::string title = code + "  " + platform::Trim(m_name.Name);
    if (m_splitShown) title += "   /   " + m_state.Split.Lower()->Name.TrimmedCode();
    setWindowTitle(Q(title));
    m_singleChart->setEnabled(m_state.Split.Chosen());
    if (m_koriScroll->isVisible()) {
        m_koriScroll->blockSignals(true);
        m_koriScroll->setRange(1, std::max(1, app::PriceRecordCount(m_session, code)));
        m_koriScroll->setValue(m_chart->LastRecord);
        m_koriScroll->blockSignals(false);
    }
    QApplication::restoreOverrideCursor();
    return built.ok();
}

bool Chts::ShowSplit(const app::SecondChart& lower) {
    m_state.Split.Choose(lower, m_haveName);
    return m_haveName && Rebuild();
}

void Chts::EndSplit() {
    m_state.Split.End();
    if (m_haveName) Rebuild();
}

void Chts::DrawLegend() {
    if (!m_state.Request.ShowReversals || m_state.Request.ChartStyle != 'B') {
        m_picture4->hide();
        return;
    }
    ImageSurface legend(200, 52);
    legend.SetBackColour(m_session.palette[15]);
    legend.Clear();
    const struct {
        const char* text;
        int entry;
        int y;
    } rows[] = {{" Reversal", 29, 1},
                {" Key Reversal", 30, 10},
                {" Hook Reversal", 31, 20},
                {" Open-Close Rev.", 32, 30},
                {" Pivot Point", 33, 40}};
    legend.SetFontSize(7);
    for (const auto& r : rows) {
        const auto colour = m_session.palette[static_cast<std::size_t>(r.entry)];
        legend.SetForeColour(m_session.palette[0]);
        legend.SetTextPosition(2, r.y);
        legend.PrintText(r.text);
        legend.FilledBox(105, r.y, 190, r.y + 8, colour);
    }
    m_picture4->SetPicture(legend.Finish());
    m_picture4->show();
}

void Chts::SetStyle(char style) {
    m_state.Request.ChartStyle = style;
    if (style == 'P') {
        m_state.Request.ChartPeriod = 'A';
        m_state.Request.AutoOsc = false;
        m_state.Request.ChartBands = 0;
    }
    if (style == 'C' && m_state.Request.BarSpacing < 3) m_state.Request.BarSpacing = 3;
    Rebuild();
}

void Chts::SetPeriod(char period) {
    if (m_state.Request.ChartStyle == 'P') return;
    m_state.Request.ChartPeriod = period;
    Rebuild();
}

void Chts::StepEnd(char unit, int direction) {
    if (!m_haveName || m_chart->LastBar() < 0) return;
    auto& req = m_state.Request;
    const std::string shown(
        m_chart->ChartBars()[static_cast<std::size_t>(m_chart->LastBar())].DateText());
    const std::string next = chart::AddCalendarPeriods(shown, unit, direction);
    const int count = app::PriceRecordCount(m_session, Code());
    const std::string latest = app::PriceRecordDate(m_session, Code(), count);
    if (direction > 0 && !latest.empty() && next >= latest) {
        req.ByFinishDate = false;
    } else {
        req.ByFinishDate = true;
        req.FinishDate = next;
    }
    Rebuild();
}

void Chts::SetTool(int mode) {
    if (mode == kToolNewChart) {
        StopAutoScroll();
        LeaveChart();
        m_tool = kToolNone;
        emit ChartSelectionRequested();
        return;
    }
    if (mode == kToolZoom && m_state.Request.ChartStyle != 'B' &&
        m_state.Request.ChartStyle != 'C') {
        m_session.dialogs().MsgBox("Zoom only available on Bar & Candlestick charts", "Zoom");
        mode = kToolNone;
    }
    if (mode == kToolErase)
        m_session.dialogs().MsgBox(
            "To delete a trendline, click that trendline with your RIGHT mouse button",
            "Trendlines");
    m_tool = mode;
    m_clickStage = 0;
    const struct {
        const char* key;
        int mode;
    } keys[] = {{"tline", kToolTrendline},    {"terase", kToolErase},
                {"fib", kToolFibRetracement}, {"sFibLines", kToolFibTimeLines},
                {"sGannAng", kToolGann},      {"text", kToolText},
                {"sZoom", kToolZoom},         {"sDayCount", kToolDayCount}};
    for (const auto& k : keys)
        if (QAction* a = ToolKey(k.key)) a->setChecked(m_tool == k.mode);
    if (m_tool == kToolFibRetracement) SetPanes({});
}

void Chts::SetCalendarTimeLines(bool calendar) {
    m_calendarLines = calendar;
    m_timeLinesCaption->setText(calendar ? QStringLiteral("Fib Time Lines - Calander Days")
                                         : QStringLiteral("Fib Time Lines - Trading Days"));
}

void Chts::PaintOnPicture(const std::function<void(platform::Surface&)>& draw) {
    QImage& image = m_picture1->mutablePicture();
    if (image.isNull()) return;
    {
        QPainter painter(&image);
        QtSurface surface(&painter, image.width(), image.height());
        draw(surface);
    }
    m_picture1->update();
}

void Chts::MouseMove(double x, double y, Qt::MouseButtons buttons) {
    if (!m_haveName || m_showingSaved || m_splitShown || m_chart->LastBar() < 0) return;
    if ((m_tool == kToolTrendline && (buttons & Qt::LeftButton)) || m_moving >= 0) {
        const double ax = m_moving >= 0 ? m_fixedX : m_downX;
        const double ay = m_moving >= 0 ? m_fixedY : m_downY;
        m_picture1->SetRubberBand(QLineF(ax, ay, x, y), QColor(255, 255, 0));
        return;
    }
    const bool closeOnly = app::IsCloseOnly(m_name.RecordType);
    if ((buttons & Qt::LeftButton) && m_tool == kToolNone)
        SetPanes(app::RiseFallReadout(*m_chart, m_downX, x));
    else if (m_tool != kToolFibRetracement && m_tool != kToolDayCount)
        SetPanes(app::CursorReadout(*m_chart, x, closeOnly));
    (void)y;
}

void Chts::MousePress(double x, double y, Qt::MouseButton button) {
    if (!m_haveName || m_showingSaved || m_splitShown || m_chart->LastBar() < 0) return;
    m_downX = x;
    m_downY = y;
    m_leftDown = button == Qt::LeftButton;
    const auto& req = m_state.Request;
    const std::string code = Code();
    if (button == Qt::RightButton && m_tool != kToolGann) {
        const int i = chart::NearestTrendline(m_trendEnds, x, y);
        if (i < 0) return;
        const auto e = m_trendEnds[static_cast<std::size_t>(i)];
        if (m_tool == kToolErase) {
            if (app::EraseTrendline(m_session, code, e.RecordNumber)) {
                m_trendChanged = true;
                Rebuild();
            }
            return;
        }
        if (m_tool == kToolTrendline) {
            // The end nearer the click moves; the other stays.
            const bool moveA = std::hypot(x - e.xA, y - e.yA) < std::hypot(x - e.xB, y - e.yB);
            m_moving = i;
            m_fixedX = moveA ? e.xB : e.xA;
            m_fixedY = moveA ? e.yB : e.yA;
        }
        return;
    }
    const auto frame = app::ToolFrameOf(*m_chart, req);
    switch (m_tool) {
    case kToolFibRetracement: {
        const double price = m_chart->YToPrice(y);
        if (price <= 0) return;
        if (m_clickStage == 0) {
            m_fibStart = price;
            m_clickStage = 1;
            SetPanes({"Start  " + app::ReadoutPrice(price)});
            return;
        }
        m_clickStage = 0;
        const auto levels = chart::FibonacciLevels(m_fibStart, price);
        const double rise = price - m_fibStart;
        if (levels.empty()) {
            SetPanes({"Start  " + app::ReadoutPrice(m_fibStart),
                      "End   " + app::ReadoutPrice(price),
                      "Rise   " + platform::Trim(platform::Format(rise, "#####.00#",
                                                                  platform::ZeroSign::Dropped))});
            SetTool(kToolNone);
            return;
        }
        std::vector<std::string> panes = {
            "End   " + app::ReadoutPrice(price),
            "Rise   " +
                platform::Trim(platform::Format(rise, "#####.00#", platform::ZeroSign::Dropped))};
        for (const auto& l : levels)
            panes.push_back(l.StatusText + app::ReadoutPrice(l.Price));
        SetPanes(panes);
        const auto lines = chart::FibonacciLines(frame, x, levels);
        PaintOnPicture([&](platform::Surface& s) {
            for (const auto& seg : lines)
                app::RecordChartLine(m_session, s, seg);
        });
        return;
    }
    case kToolFibTimeLines: {
        const int bar = app::BarUnder(*m_chart, x);
        if (bar < 0) return;
        const auto xs = chart::FibTimeLines(frame, bar, m_calendarLines);
        PaintOnPicture([&](platform::Surface& s) {
            for (double lx : xs)
                app::RecordChartLine(m_session, s,
                                     {lx, static_cast<double>(m_chart->PlotTop), lx,
                                      static_cast<double>(m_chart->PlotBottom), kFibTimeLineEntry,
                                      'D'});
        });
        return;
    }
    case kToolGann: {
        const auto fan = chart::GannFan(frame, x, y, button == Qt::LeftButton);
        PaintOnPicture([&](platform::Surface& s) {
            for (const auto& seg : fan)
                app::RecordChartLine(m_session, s, seg);
        });
        return;
    }
    case kToolText: {
        if (m_chart->YToPrice(y) <= 0) return;
        const auto text = m_session.dialogs().InputBox(
            "Text - Enter text required - Press ENTER to Save", "Text");
        if (!text || platform::Trim(*text).empty()) return;
        if (app::AddTextNote(m_session, *m_chart, req, code, x, y, *text)) Rebuild();
        return;
    }
    case kToolZoom:
        Zoom(x, y);
        return;
    case kToolDayCount:
        if (app::BarUnder(*m_chart, x) < 0) return;
        if (m_clickStage == 0) {
            m_countFromX = x;
            m_clickStage = 1;
            SetPanes({"From  " +
                      ShortDate(std::string(
                          m_chart->ChartBars()[static_cast<std::size_t>(app::BarUnder(*m_chart, x))]
                              .DateText()))});
            return;
        }
        m_clickStage = 0;
        SetPanes(app::DayCountReadout(*m_chart, m_countFromX, x));
        return;
    default:
        return;
    }
}

void Chts::MouseRelease(double x, double y, Qt::MouseButton button) {
    if (!m_haveName || m_showingSaved || m_splitShown) return;
    m_picture1->SetRubberBand(std::nullopt);
    const auto& req = m_state.Request;
    if (m_moving >= 0 && button == Qt::RightButton) {
        const int record = m_trendEnds[static_cast<std::size_t>(m_moving)].RecordNumber;
        m_moving = -1;
        if (app::MoveTrendline(m_session, *m_chart, req, Code(), record, m_fixedX, m_fixedY, x,
                               y)) {
            m_trendChanged = true;
            Rebuild();
        }
        return;
    }
    if (m_tool == kToolTrendline && button == Qt::LeftButton && m_leftDown) {
        m_leftDown = false;
        bool added = false;
        PaintOnPicture([&](platform::Surface& s) {
            added = app::AddTrendline(m_session, *m_chart, req, Code(), s, m_downX, m_downY, x, y);
        });
        if (added) {
            // The new line is found by a right click like the replayed ones.
            m_trendEnds = app::TrendEndsOf(m_session, *m_chart, req, Code());
        }
    }
    m_leftDown = false;
}

void Chts::Zoom(double x, double y) {
    const QImage& image = m_picture1->picture();
    if (image.isNull()) return;
    const QRect part = QRect(static_cast<int>(x) - 100, static_cast<int>(y) - 75, 200, 150)
                           .intersected(image.rect());
    if (part.isEmpty()) return;
    auto* zoom = new QDialog(this);
    zoom->setObjectName(QStringLiteral("ZoomKori"));
    zoom->setWindowTitle(QStringLiteral("Zoom"));
    zoom->setAttribute(Qt::WA_DeleteOnClose);
    auto* label = new QLabel(zoom);
    label->setPixmap(QPixmap::fromImage(
        image.copy(part).scaled(part.size() * 3, Qt::KeepAspectRatio, Qt::FastTransformation)));
    auto* l = new QVBoxLayout(zoom);
    l->addWidget(label);
    zoom->show();
}

void Chts::EnsurePrinterColours() {
    const std::string path = m_session.folders.SystemFolder + "koriprn.dat";
    if (auto colours = app::ReadPrinterFile(path)) {
        m_session.printer = *colours;
        return;
    }
    m_session.printer = app::AskPrinterColours(m_session.dialogs());
    (void)app::WritePrinterFile(path, m_session.printer);
}

bool Chts::PrintTo(QPrinter& printer) {
    EnsurePrinterColours();
    if (!m_print) m_print = chart::LoadPrintSettings(m_session.ini());
    m_print->PrintColour = m_session.printer.PrintColour;
    m_print->PrintColourLines = m_session.printer.PrintColourLines;
    const QString before = m_panes[0]->text();
    SetPanes({chart::kPrintingStatus});
    QApplication::setOverrideCursor(Qt::WaitCursor);
    QtPrinter paper(printer);
    const QImage& shown = m_picture1->picture();
    chart::PaperJob job{paper, m_session.palette, m_session.fonts,
                        static_cast<double>(shown.width()), static_cast<double>(shown.height())};
    const std::filesystem::path source =
        m_showingSaved ? std::filesystem::path(m_savedPath) : app::ChartStreamPath(m_session);
    const auto outcome = chart::PrintChart(source, job, *m_print);
    QApplication::restoreOverrideCursor();
    m_panes[0]->setText(before);
    if (outcome == chart::PlayOutcome::PrinterFailed) {
        m_session.dialogs().MsgBox("The chart could not be printed", "Print Chart");
        return false;
    }
    return true;
}

void Chts::Print() {
    QPrinter own(QPrinter::HighResolution);
    QPrinter& printer = m_printer ? *m_printer : own;
    printer.setDocName(Q("KORI chart " + Code()));
    if (!m_printer) {
        // A chart is wider than tall: landscape is offered first unless the page set-up says.
        const int orient = m_session.page.Orient;
        printer.setPageOrientation(orient == 1 ? QPageLayout::Portrait : QPageLayout::Landscape);
    }
    QPrintDialog dialog(&printer, this);
    dialog.setWindowTitle(QStringLiteral("Print Chart"));
    if (dialog.exec() != QDialog::Accepted) return;
    PrintTo(printer);
}

void Chts::PageSetup() {
    CHTPage page(m_session, this);
    if (page.exec() == QDialog::Accepted) m_print.reset(); // the next print reads the new origin
}

bool Chts::SaveChartAs(const std::string& answer) {
    return chart::SaveChartAs(answer, app::ChartStreamPath(m_session), m_session.dialogs()) ==
           chart::SaveChartResult::Saved;
}

void Chts::SaveChartDialog() {
    platform::CreateFolder(m_session.folders.ChtSaveFolder);
    const std::string proposed = chart::ProposedChartName(m_session.folders.ChtSaveFolder, Code());
    const QString chosen = QFileDialog::getSaveFileName(
        this, QStringLiteral("Save Chart As ..."), Q(proposed),
        QStringLiteral("Saved charts (*.cht)"), nullptr, QFileDialog::DontConfirmOverwrite);
    SaveChartAs(chosen.isEmpty() ? std::string(chart::kNameCancel) : chosen.toStdString());
}

bool Chts::DisplaySavedChart(const std::string& chosen) {
    if (chosen.empty()) return false;
    // The stream is played whole: what lies below the price area (an oscillator panel) goes to
    // Picture2, as it did when the chart was built.
    const QSize size = AreaSize();
    const chart::StreamReach reach =
        chart::MeasureStream(platform::ResolvePath(platform::NormalisePath(chosen)));
    const int panel = reach.Bottom > size.height() ? kOscPanelHeight : 0;
    ImageSurface area(size.width(), size.height() + panel);
    const bool shown = chart::DisplaySavedChart(chosen, area, m_session.palette, m_session.fonts,
                                                m_session.dialogs());
    const QImage& picture = area.Finish();
    if (!shown) return false;
    LeaveChart();
    m_picture1->SetPicture(picture.copy(0, 0, size.width(), size.height()));
    if (panel > 0) m_picture2->SetPicture(picture.copy(0, size.height(), size.width(), panel));
    m_picture2->setVisible(panel > 0);
    m_showingSaved = true;
    m_splitShown = false;
    m_savedPath = chosen;
    setWindowTitle(Q("Saved chart  " + std::filesystem::path(chosen).filename().string()));
    return true;
}

void Chts::DisplaySavedChartDialog() {
    const QString chosen = QFileDialog::getOpenFileName(this, QStringLiteral("Display Saved Chart"),
                                                        Q(m_session.folders.ChtSaveFolder),
                                                        QStringLiteral("Saved charts (*.cht)"));
    DisplaySavedChart(chosen.toStdString());
}

void Chts::RemoveAllTrendlines() {
    if (!m_haveName) return;
    if (app::RemoveAllTrendlines(m_session, Code())) {
        m_trendChanged = false;
        Rebuild();
    }
}

void Chts::StartAutoScroll() {
    const auto answer = m_session.dialogs().InputBox("Set interval between charts (0 - 60 seconds)",
                                                     "Display Interval", "2.5");
    if (!answer) return;
    const double seconds = std::clamp(platform::Val(*answer), 0.0, 60.0);
    m_tool = kToolAutoScroll;
    m_autoTimer->start(static_cast<int>(seconds * 1000));
    m_status->showMessage(QStringLiteral("AUTOMATIC SCROLL - TO STOP click AUTO"));
}

void Chts::StopAutoScroll() {
    if (!m_autoTimer->isActive()) return;
    m_autoTimer->stop();
    m_status->clearMessage();
    if (m_tool == kToolAutoScroll) m_tool = kToolNone;
}

void Chts::ShowScrollBar(bool on) {
    if (!on) {
        m_koriScroll->hide();
        m_state.Request.ByFinishDate = false;
        Rebuild();
        return;
    }
    const int count = m_haveName ? app::PriceRecordCount(m_session, Code()) : 0;
    if (count < 2 || m_chart->LastBar() < 0 || count <= m_chart->LastBar() + 1) {
        m_session.dialogs().MsgBox("Too few records to show scroll bar", "Chart Scroll");
        return;
    }
    m_koriScroll->blockSignals(true);
    m_koriScroll->setRange(1, count);
    m_koriScroll->setValue(m_chart->LastRecord);
    m_koriScroll->blockSignals(false);
    m_koriScroll->show();
}

void Chts::closeEvent(QCloseEvent* e) {
    StopAutoScroll();
    LeaveChart();
    e->accept();
}

} // namespace kori::gui
