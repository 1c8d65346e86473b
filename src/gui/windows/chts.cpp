#include "gui/windows/chts.h"

#include "app/chart_navigation.h"
#include "app/chart_window_tools.h"
#include "app/colour_table.h"
#include "app/window_rules.h"
#include "chart/saved_chart.h"
#include "chart/screen_player.h"
#include "chart/swing.h"
#include "gui/paint/qt_surface.h"
#include "gui/widgets/chart_view.h"
#include "gui/windows/chart_paper.h"
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
#include <QKeyEvent>
#include <QLabel>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPageLayout>
#include <QPainter>
#include <QPrintPreviewDialog>
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
constexpr int kPanes = 6; // the read-out: date, open, high, low, close, volume
// "d/m/yy" for the scroll read-out.
std::string ShortDate(const std::string& yyyymmdd) {
    const auto d = platform::ParseDateText(yyyymmdd);
    if (!d) return yyyymmdd;
    return std::to_string(d->day) + "/" + std::to_string(d->month) + "/" + yyyymmdd.substr(2, 2);
}
app::ChartButton ButtonOf(Qt::MouseButton b) {
    return b == Qt::LeftButton    ? app::ChartButton::Left
           : b == Qt::RightButton ? app::ChartButton::Right
                                  : app::ChartButton::Other;
}
} // namespace

Chts::Chts(app::Session& session, app::ChartState& state, QWidget* parent)
    : QWidget(parent), m_session(session), m_state(state), m_model(session, state),
      m_toolbar(new QToolBar(this)), m_toolbar2(new QToolBar(this)), m_oscBox(new QComboBox(this)),
      m_picture1(new ChartView(this)), m_picture4(new ChartView(this)),
      m_koriScroll(new QScrollBar(Qt::Horizontal, this)), m_status(new QStatusBar(this)),
      m_autoTimer(new QTimer(this)), m_resizeTimer(new QTimer(this)) {
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
    // The way to the watchlists from a chart, whatever the data service shows in the main menu.
    QAction* watch = file->addAction(QStringLiteral("Add to &Watchlist"), this, [this] {
        const auto code = m_model.Code();
        if (!code.empty()) emit AddToWatchlistRequested(QString::fromStdString(code));
    });
    watch->setObjectName(QStringLiteral("cmAddToWatchlist"));
    watch->setShortcut(QKeySequence(QStringLiteral("Ctrl+Shift+W")));
    file->addAction(QStringLiteral("Chart &Selection"), this, &Chts::NewChart);
    file->addAction(QStringLiteral("&Close"), this, [this] {
        // Inside the frame the window is a sub-window; window() would be the main window.
        if (auto* sub = qobject_cast<QMdiSubWindow*>(parentWidget()))
            sub->close();
        else
            close();
    });
    // Not "Tools": a maximised chart shares the menu bar with the main window's "Tools".
    QMenu* tools = menus->addMenu(QStringLiteral("&Lines"));
    tools
        ->addAction(QStringLiteral("Remove all trendlines for ..."), this,
                    &Chts::RemoveAllTrendlines)
        ->setObjectName(QStringLiteral("cmRemoveTrendlines"));
    m_timeLinesCaption = tools->addAction(QStringLiteral("Fib Time Lines - Trading Days"));
    m_timeLinesCaption->setObjectName(QStringLiteral("cmFibTimeKind"));
    connect(m_timeLinesCaption, &QAction::triggered, this,
            [this] { SetCalendarTimeLines(!m_model.calendarTimeLines()); });
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
    overlays
        ->addAction(QStringLiteral("&Oscillator Settings ..."), this,
                    [this] { emit OscSettingsRequested(); })
        ->setObjectName(QStringLiteral("cmOscSettings"));
    for (int set = 1; set <= 2; ++set)
        overlays
            ->addAction(QStringLiteral("Multi-Osc %1").arg(set), this,
                        [this, set] { emit MultiOscRequested(set); })
            ->setObjectName(QStringLiteral("cmMultiOsc%1").arg(set));
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
    m_picture4->setObjectName(QStringLiteral("Picture4"));
    m_picture4->setMinimumSize(200, 52);
    m_picture4->setMaximumHeight(52);
    m_picture4->hide();
    layout->addWidget(m_picture1, 1);
    layout->addWidget(m_picture4);
    for (int i = 0; i < kPanes; ++i) {
        auto* pane = new QLabel(m_status);
        pane->setObjectName(QStringLiteral("pane%1").arg(i + 1));
        pane->setMinimumWidth(110);
        m_status->addWidget(pane);
        m_panes.push_back(pane);
    }
    m_details = new QLabel(m_status);
    m_details->setObjectName(QStringLiteral("txtDetails"));
    m_details->hide();
    m_status->addPermanentWidget(m_details);
    layout->addWidget(m_status);

    connect(m_picture1, &ChartView::ChartMouseMove, this, &Chts::MouseMove);
    connect(m_picture1, &ChartView::ChartMousePress, this, &Chts::MousePress);
    connect(m_picture1, &ChartView::ChartMouseRelease, this, &Chts::MouseRelease);
    connect(m_picture1, &ChartView::ChartWheel, this, &Chts::Wheel);
    connect(m_picture1, &ChartView::ChartDoubleClick, this,
            [this](double x, double y) { Apply(m_model.DoubleClick(x, y)); });
    m_picture1->setFocusPolicy(Qt::StrongFocus);
    connect(m_koriScroll, &QScrollBar::valueChanged, this, [this](int v) {
        if (!m_model.haveSecurity() || m_koriScroll->signalsBlocked()) return;
        if (!m_model.EndAtRecord(v)) return;
        Rebuild();
        SetPanes({ShortDate(app::PriceRecordDate(m_session, Code(), v))});
    });
    connect(m_autoTimer, &QTimer::timeout, this, [this] { NextChart(1); });
    m_resizeTimer->setSingleShot(true);
    m_resizeTimer->setInterval(200);
    connect(m_picture1, &ChartView::Resized, m_resizeTimer, qOverload<>(&QTimer::start));
    connect(m_resizeTimer, &QTimer::timeout, this, [this] {
        if (m_model.haveSecurity() && !m_model.showingSaved() &&
            m_picture1->picture().size() != AreaSize())
            Rebuild();
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
    add("new", "New", "Chart selection", [this] { NewChart(); });
    add("rev", "<", "Previous chart of the list (Page Up)", [this] { NextChart(-1); });
    add("ref", "=", "Redraw this chart", [this] { NextChart(0); });
    add("fwd", ">", "Next chart of the list (Page Down)", [this] { NextChart(1); });
    m_toolbar->addSeparator();
    add("bar", "Bar", "Bar chart (B)", [this] { SetStyle('B'); });
    add("cstick", "Cdl", "Candlestick chart (C)", [this] { SetStyle('C'); });
    add("lne", "Line", "Line chart (L)", [this] { SetStyle('L'); });
    add("pf", "P&&F", "Point and figure chart (P)", [this] { SetStyle('P'); });
    m_toolbar->addSeparator();
    add("dly", "D", "Daily (D)", [this] { SetPeriod('A'); });
    add("wky", "W", "Weekly (W)", [this] { SetPeriod('W'); });
    add("mly", "M", "Monthly (M)", [this] { SetPeriod('M'); });
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
        if (i != 0 && m_state.Defaults.ShowOscSettings) emit OscSettingsRequested();
        // The keys belong to the chart again: PageDown, Home and letters must not change the
        // oscillator behind the user's back.
        m_picture1->setFocus();
    });
    // Reached by a click only, so the keyboard never lands in it.
    m_oscBox->setFocusPolicy(Qt::ClickFocus);
    m_toolbar->addWidget(m_oscBox);
    bar = m_toolbar2;
    add(
        "tline", "Trend", "Draw trendlines",
        [this] { Apply(m_model.ToggleTool(app::ChartTool::Trendline)); }, true);
    add(
        "terase", "Erase", "Delete a trendline", [this] { SetTool(app::ChartTool::Erase); }, true);
    add(
        "fib", "Fib", "Fibonacci retracement",
        [this] { Apply(m_model.ToggleTool(app::ChartTool::FibRetracement)); }, true);
    add(
        "sFibLines", "FibT", "Fibonacci time lines",
        [this] { Apply(m_model.ToggleTool(app::ChartTool::FibTimeLines)); }, true);
    add(
        "sGannAng", "Gann", "Gann angles",
        [this] { Apply(m_model.ToggleTool(app::ChartTool::Gann)); }, true);
    add(
        "text", "Text", "Text notes", [this] { Apply(m_model.ToggleTool(app::ChartTool::Text)); },
        true);
    add(
        "sDayCount", "Days", "Count the days between two bars",
        [this] { Apply(m_model.ToggleTool(app::ChartTool::DayCount)); }, true);
    add(
        "sZoom", "Zoom", "Zoom", [this] { Apply(m_model.ToggleTool(app::ChartTool::Zoom)); }, true);
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
    return m_model.Code();
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
    m_model.LeaveChart();
}

bool Chts::NextChart(int delta) {
    if (!m_model.NextChart(delta)) return false;
    // The read-out of the chart before says nothing about this one.
    if (delta != 0) SetPanes({});
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
    return RebuildKeeping(false);
}

bool Chts::RebuildKeeping(bool keepToolLines) {
    if (!m_model.haveSecurity()) return false;
    QApplication::setOverrideCursor(Qt::WaitCursor);
    const QSize size = AreaSize();
    ImageSurface area(size.width(), size.height());
    const app::ChartOutcome built = m_model.Build(area, keepToolLines);
    m_picture1->SetPicture(area.Finish());
    m_picture1->SetCrosshair(std::nullopt);
    DrawLegend();
    m_oscBox->setCurrentIndex(app::OscChoiceOf(m_state.Request));
    const std::string code = Code();
    std::string title = code + "  " + platform::Trim(m_model.current().Name);
    if (m_model.splitShown()) title += "   /   " + m_state.Split.Lower()->Name.TrimmedCode();
    setWindowTitle(Q(title));
    m_singleChart->setEnabled(m_state.Split.Chosen());
    QString details;
    for (const auto& line : m_model.SecurityDetailsText())
        details += (details.isEmpty() ? QString() : QStringLiteral("   ")) + Q(line);
    m_details->setText(details);
    m_details->setVisible(!details.isEmpty());
    if (m_koriScroll->isVisible()) {
        m_koriScroll->blockSignals(true);
        m_koriScroll->setRange(1, std::max(1, m_model.PriceRecordCount()));
        m_koriScroll->setValue(chart().LastRecord);
        m_koriScroll->blockSignals(false);
    }
    SyncToolKeys();
    QApplication::restoreOverrideCursor();
    return built.Status.ok();
}

bool Chts::ShowSplit(const app::SecondChart& lower) {
    m_state.Split.Choose(lower, m_model.haveSecurity());
    return m_model.haveSecurity() && Rebuild();
}

void Chts::EndSplit() {
    m_state.Split.End();
    if (m_model.haveSecurity()) Rebuild();
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
    if (m_model.SetStyle(style)) Rebuild();
    SyncToolKeys();
}

void Chts::SetPeriod(char period) {
    if (m_model.SetPeriod(period)) Rebuild();
}

void Chts::StepEnd(char unit, int direction) {
    if (m_model.StepEnd(unit, direction)) Rebuild();
}

void Chts::Wheel(int notches, bool ctrl) {
    if (ctrl) {
        if (m_model.ChangeBarSpacing(notches)) Rebuild();
        return;
    }
    // Away from the user goes back in time, a few bars a notch, as the scroll bar does.
    if (m_model.ScrollBars(-notches * 5)) {
        Rebuild();
        if (const auto& end = m_model.endDate()) SetPanes({ShortDate(*end)});
    }
}

void Chts::NewChart() {
    StopAutoScroll();
    LeaveChart();
    Apply(m_model.SetTool(app::ChartTool::None));
    emit ChartSelectionRequested();
}

void Chts::SetTool(app::ChartTool tool) {
    Apply(m_model.SetTool(tool));
}

void Chts::SyncToolKeys() {
    const struct {
        const char* key;
        app::ChartTool tool;
    } keys[] = {
        {"tline", app::ChartTool::Trendline},    {"terase", app::ChartTool::Erase},
        {"fib", app::ChartTool::FibRetracement}, {"sFibLines", app::ChartTool::FibTimeLines},
        {"sGannAng", app::ChartTool::Gann},      {"text", app::ChartTool::Text},
        {"sZoom", app::ChartTool::Zoom},         {"sDayCount", app::ChartTool::DayCount}};
    for (const auto& k : keys)
        if (QAction* a = ToolKey(k.key)) a->setChecked(m_model.tool() == k.tool);
}

void Chts::SetCalendarTimeLines(bool calendar) {
    m_model.SetCalendarTimeLines(calendar);
    m_timeLinesCaption->setText(calendar ? QStringLiteral("Fib Time Lines - Calander Days")
                                         : QStringLiteral("Fib Time Lines - Trading Days"));
}

void Chts::Apply(const app::ChartEffects& fx) {
    if (fx.ClearRubber) m_picture1->SetRubberBand(std::nullopt);
    if (fx.Rubber)
        m_picture1->SetRubberBand(
            QLineF(fx.Rubber->x1, fx.Rubber->y1, fx.Rubber->x2, fx.Rubber->y2),
            QColor(255, 255, 0));
    if (fx.Rebuild) RebuildKeeping(fx.KeepToolLines);
    if (fx.Panes) SetPanes(*fx.Panes);
    if (fx.PictureChanged) m_picture1->update();
    if (fx.ZoomAt) Zoom(fx.ZoomAt->first, fx.ZoomAt->second);
    if (fx.OscSettings) emit OscSettingsRequested();
    SyncToolKeys();
}

void Chts::WithPicture(const std::function<void(platform::Surface&)>& draw) {
    QImage& image = m_picture1->mutablePicture();
    if (image.isNull()) {
        platform::RecordingSurface none(1, 1);
        draw(none);
        return;
    }
    QPainter painter(&image);
    QtSurface surface(&painter, image.width(), image.height());
    draw(surface);
}

void Chts::MouseMove(double x, double y, Qt::MouseButtons buttons) {
    const app::ChartEffects fx = m_model.MouseMove(x, y, buttons & Qt::LeftButton);
    m_picture1->SetCrosshair(fx.Crosshair ? std::optional<QPointF>(QPointF(*fx.Crosshair, y))
                                          : std::nullopt);
    Apply(fx);
}

void Chts::MousePress(double x, double y, Qt::MouseButton button) {
    app::ChartEffects fx;
    WithPicture([&](platform::Surface& s) { fx = m_model.MousePress(x, y, ButtonOf(button), s); });
    Apply(fx);
}

void Chts::MouseRelease(double x, double y, Qt::MouseButton button) {
    app::ChartEffects fx;
    WithPicture(
        [&](platform::Surface& s) { fx = m_model.MouseRelease(x, y, ButtonOf(button), s); });
    Apply(fx);
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

bool Chts::PrintTo(QPrinter& printer) {
    const QString before = m_panes[0]->text();
    SetPanes({chart::kPrintingStatus});
    QApplication::setOverrideCursor(Qt::WaitCursor);
    const std::filesystem::path source = m_model.showingSaved() ? std::filesystem::path(m_savedPath)
                                                                : app::ChartStreamPath(m_session);
    const bool printed =
        PrintChartStream(m_session, m_print, source, printer, m_picture1->picture().size());
    QApplication::restoreOverrideCursor();
    m_panes[0]->setText(before);
    return printed;
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
    // The page as it will print first; its print key sends it to the printer.
    QPrintPreviewDialog preview(&printer, this);
    preview.setObjectName(QStringLiteral("PrintPreview"));
    preview.setWindowTitle(QStringLiteral("Print Chart"));
    connect(&preview, &QPrintPreviewDialog::paintRequested, this,
            [this](QPrinter* p) { PrintTo(*p); });
    preview.exec();
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
    // The stream is played whole: the oscillator panel lies inside the area as it was built;
    // a stream from a taller area (another program's page) gets the height it reaches.
    const QSize size = AreaSize();
    const chart::StreamReach reach =
        chart::MeasureStream(platform::ResolvePath(platform::NormalisePath(chosen)));
    const int height = std::max(size.height(), static_cast<int>(std::ceil(reach.Bottom)) + 1);
    ImageSurface area(size.width(), height);
    const bool shown = chart::DisplaySavedChart(chosen, area, m_session.palette, m_session.fonts,
                                                m_session.dialogs());
    const QImage& picture = area.Finish();
    if (!shown) return false;
    LeaveChart();
    m_picture1->SetPicture(picture);
    m_model.ShowingSaved(true);
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
    if (!m_model.haveSecurity()) return;
    if (m_model.RemoveAllTrendlines()) Rebuild();
}

void Chts::StartAutoScroll() {
    const auto answer = m_session.dialogs().InputBox("Set interval between charts (0 - 60 seconds)",
                                                     "Display Interval", "2.5");
    if (!answer) return;
    const double seconds = std::clamp(platform::Val(*answer), 0.0, 60.0);
    m_model.SetTool(app::ChartTool::AutoScroll);
    m_autoTimer->start(static_cast<int>(seconds * 1000));
    m_status->showMessage(QStringLiteral("AUTOMATIC SCROLL - TO STOP click AUTO"));
}

void Chts::StopAutoScroll() {
    if (!m_autoTimer->isActive()) return;
    m_autoTimer->stop();
    m_status->clearMessage();
    if (m_model.tool() == app::ChartTool::AutoScroll) SetTool(app::ChartTool::None);
}

void Chts::ShowScrollBar(bool on) {
    if (!on) {
        m_koriScroll->hide();
        m_model.EndAtLatest();
        Rebuild();
        return;
    }
    const int count = m_model.PriceRecordCount();
    if (count < 2 || chart().LastBar() < 0 || count <= chart().LastBar() + 1) {
        m_session.dialogs().MsgBox("Too few records to show scroll bar", "Chart Scroll");
        return;
    }
    m_koriScroll->blockSignals(true);
    m_koriScroll->setRange(1, count);
    m_koriScroll->setValue(chart().LastRecord);
    m_koriScroll->blockSignals(false);
    m_koriScroll->show();
}

void Chts::keyPressEvent(QKeyEvent* e) {
    // Keys a user expects on a chart: the page keys and arrows walk the list, a letter picks
    // the style or the period, Escape leaves a tool. With Alt or Ctrl they stay the menus'.
    if (e->modifiers() & (Qt::AltModifier | Qt::ControlModifier | Qt::MetaModifier)) {
        QWidget::keyPressEvent(e);
        return;
    }
    switch (e->key()) {
    case Qt::Key_PageDown:
    case Qt::Key_Right:
        NextChart(1);
        break;
    case Qt::Key_PageUp:
    case Qt::Key_Left:
        NextChart(-1);
        break;
    case Qt::Key_Escape:
        SetTool(app::ChartTool::None);
        break;
    case Qt::Key_B:
    case Qt::Key_C:
    case Qt::Key_L:
    case Qt::Key_P:
        SetStyle(static_cast<char>(e->key()));
        break;
    case Qt::Key_D:
        SetPeriod('A');
        break;
    case Qt::Key_W:
    case Qt::Key_M:
        SetPeriod(static_cast<char>(e->key()));
        break;
    default:
        QWidget::keyPressEvent(e);
        return;
    }
    e->accept();
}

void Chts::closeEvent(QCloseEvent* e) {
    StopAutoScroll();
    LeaveChart();
    e->accept();
}

} // namespace kori::gui
