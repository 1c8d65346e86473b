#include "gui/windows/chart_windows.h"

#include "app/chart_service.h"

#include "gui/windows/cht_page.h"
#include "gui/windows/cht_sel.h"
#include "gui/windows/chts.h"
#include "gui/windows/main_window.h"
#include "gui/windows/multi_osc_chart.h"
#include "gui/windows/settings_windows.h"
#include "gui/windows/watchlist.h"
#include "platform/date_text.h"
#include "store/name_file.h"

#include <QApplication>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QPageLayout>
#include <QPageSetupDialog>
#include <QPrinter>

namespace kori::gui {

ChartWindows::ChartWindows(MainWindow& main) : QObject(&main), m_main(main) {
    setObjectName(QStringLiteral("ChartWindows"));
    // The settings windows change what the chart on show is built from.
    SettingsHub& hub = Hub(m_main);
    const auto reload = [this] {
        m_state.Defaults = chart::LoadChartDefaults(m_main.session().ini());
    };
    const auto rebuild = [this, reload] {
        reload();
        if (Chts* c = chts(); c && m_chartWindow->isVisible()) c->Rebuild();
    };
    // SAVE in the chart defaults redraws the chart on show with them.
    connect(&hub, &SettingsHub::ChartDefaultsSaved, this, rebuild);
    connect(&hub, &SettingsHub::RebuildChart, this, rebuild);
    connect(&hub, &SettingsHub::ColoursChanged, this, rebuild);
    connect(&hub, &SettingsHub::FontsChanged, this, rebuild);
    connect(&hub, &SettingsHub::ShowOscillator, this, [this, rebuild](const QString& name) {
        m_state.Request.AutoOsc = !name.isEmpty();
        m_state.Request.AutoOscCode = name.toStdString();
        rebuild();
    });
    connect(&hub, &SettingsHub::MultiOscSaved, this, [this] {
        if (MultiOscChart* m = multiOscChart(); m && m_multiWindow->isVisible()) m->Rebuild();
    });
    // Chart2: the chart on show is split at once; with none on show the next chart comes split.
    connect(&hub, &SettingsHub::SecondChart, this, [this](const QString& code, QChar period) {
        platform::Status why;
        const auto found =
            store::FindCode(m_main.session().folders.DataFolder, code.toStdString(), why);
        if (!found) return;
        const app::SecondChart lower{found->Record, period.toLatin1()};
        if (Chts* c = chts(); c && m_chartWindow->isVisible())
            c->ShowSplit(lower);
        else
            m_state.Split.Choose(lower, false);
    });
}

ChartWindows::~ChartWindows() = default;

QPrinter& ChartWindows::printer() {
    if (!m_printer) {
        m_printer = std::make_unique<QPrinter>(QPrinter::HighResolution);
        const int orient = m_main.session().page.Orient;
        m_printer->setPageOrientation(orient == 1 ? QPageLayout::Portrait : QPageLayout::Landscape);
    }
    return *m_printer;
}

ChtSel* ChartWindows::chtSel() const {
    return m_selWindow ? qobject_cast<ChtSel*>(m_selWindow->widget()) : nullptr;
}

Chts* ChartWindows::chts() const {
    return m_chartWindow ? qobject_cast<Chts*>(m_chartWindow->widget()) : nullptr;
}

void ChartWindows::OpenCharts() {
    if (Chts* c = chts(); c && m_chartWindow->isVisible()) {
        m_main.mdiArea()->setActiveSubWindow(m_chartWindow);
        m_chartWindow->raise();
        return;
    }
    if (!m_selWindow) {
        auto* sel = new ChtSel(m_main.session(), m_state);
        m_selWindow = m_main.mdiArea()->addSubWindow(sel);
        m_selWindow->setAttribute(Qt::WA_DeleteOnClose);
        sel->SetFolderButton(m_main.session().download.DataService == 3);
        sel->SetDefaultsButton(true);
        connect(sel, &ChtSel::ShowChartRequested, this, &ChartWindows::ShowChart);
        connect(sel, &ChtSel::CloseRequested, this, &ChartWindows::CloseAll);
        connect(sel, &ChtSel::ChangeFolderRequested, this, [this] {
            const std::string before = m_main.session().folders.DataFolder;
            (void)PickDataFolderWindow(m_main);
            if (m_main.session().folders.DataFolder != before)
                if (ChtSel* s = chtSel()) {
                    s->selection().FolderChanged();
                    s->Load();
                }
        });
        connect(sel, &ChtSel::SetDefaultsRequested, this,
                [this] { OpenChartDefaults(m_main, ChtDef::Caller::ChartSelection); });
        // Placed from the main window's size, as the selection has always sat.
        const QRect area = m_main.mdiArea()->rect();
        m_selWindow->move(static_cast<int>(0.006 * area.width()),
                          static_cast<int>(0.077 * area.height()));
        sel->Load();
        m_main.FitChild(m_selWindow);
    } else if (ChtSel* s = chtSel()) {
        s->Activate();
    }
    m_selWindow->show();
    m_main.mdiArea()->setActiveSubWindow(m_selWindow);
}

Chts* ChartWindows::EnsureChts() {
    if (Chts* c = chts()) return c;
    auto* c = new Chts(m_main.session(), m_state);
    m_chartWindow = m_main.mdiArea()->addSubWindow(c);
    m_chartWindow->setAttribute(Qt::WA_DeleteOnClose);
    connect(c, &Chts::ChartSelectionRequested, this, &ChartWindows::BackToSelection);
    c->SetPrinter(&printer());
    connect(c, &Chts::MultiOscRequested, this, [this](int set) { OpenMultiOscChart(set); });
    // The oscillator settings box: from the panel, the chart's menu, or before an oscillator
    // picked in the toolbar shows when "Always show oscillator settings box" is ticked.
    connect(c, &Chts::OscSettingsRequested, this, [this] {
        const auto& r = m_state.Request;
        OpenOscillatorSettings(m_main, r.AutoOsc ? r.AutoOscCode : std::string(), r.ChartStyle,
                               std::string(1, r.ChartPeriod));
    });
    connect(c, &Chts::AddToWatchlistRequested, this, [this](const QString& code) {
        if (!m_main.Open("Watchlist")) return;
        if (auto* w = m_main.findChild<Watchlist*>()) w->AddFromChart(code.toStdString());
    });
    // Closing the chart window on its own goes back to the selection it came from.
    connect(m_chartWindow, &QObject::destroyed, this, [this] {
        if (!m_closingAll && m_selWindow && !m_main.ending()) {
            m_selWindow->show();
            if (ChtSel* s = chtSel()) s->Activate();
        }
    });
    return c;
}

void ChartWindows::ShowChart() {
    if (m_selWindow) m_selWindow->hide();
    Chts* c = EnsureChts();
    // The chart takes the whole frame; its area is laid out before the chart is sized to it.
    m_chartWindow->showMaximized();
    m_main.mdiArea()->setActiveSubWindow(m_chartWindow);
    QApplication::sendPostedEvents();
    QApplication::processEvents();
    // ChtSel left the position one short; the next-chart command steps onto it.
    c->NextChart(1);
}

bool ChartWindows::ShowCode(const std::string& code) {
    OpenCharts();
    ChtSel* s = chtSel();
    if (!s || !s->selection().TypeCode(code)) return false;
    s->ShowChart();
    return chts() != nullptr;
}

bool ChartWindows::ShowCodeAt(const std::string& code, const std::string& date) {
    OpenCharts();
    ChtSel* s = chtSel();
    if (!s || !s->selection().TypeCode(code)) return false;
    s->selection().SetFinishDate(platform::IsValidDateText(date)
                                     ? std::optional(platform::DateTextToDisplay(date))
                                     : std::nullopt);
    s->ShowChart();
    return chts() != nullptr;
}

void ChartWindows::BackToSelection() {
    if (m_chartWindow) m_chartWindow->hide();
    OpenCharts();
}

MultiOscChart* ChartWindows::multiOscChart() const {
    return m_multiWindow ? qobject_cast<MultiOscChart*>(m_multiWindow->widget()) : nullptr;
}

MultiOscChart* ChartWindows::OpenMultiOscChart(int set) {
    MultiOscChart* m = multiOscChart();
    if (!m) {
        m = new MultiOscChart(m_main.session(), m_state, set);
        m_multiWindow = m_main.mdiArea()->addSubWindow(m);
        m_multiWindow->setAttribute(Qt::WA_DeleteOnClose);
        m->SetPrinter(&printer());
        connect(m, &MultiOscChart::SetupRequested, this, [this] { OpenMultiOsc(m_main); });
    }
    m_multiWindow->showMaximized();
    m_main.mdiArea()->setActiveSubWindow(m_multiWindow);
    QApplication::sendPostedEvents();
    QApplication::processEvents();
    // The chart window's security, drawn once with the set chosen.
    if (Chts* c = chts(); c && c->model().haveSecurity()) m->model().ShowSecurity(c->current());
    m->ChooseSet(set);
    return m;
}

void ChartWindows::CloseAll() {
    m_closingAll = true;
    if (m_multiWindow) m_multiWindow->close();
    if (m_chartWindow) m_chartWindow->close();
    if (m_selWindow) m_selWindow->close();
    m_closingAll = false;
}

void RegisterChartWindows(MainWindow& main) {
    auto* charts = new ChartWindows(main);
    main.SetAction("ChtSel", [charts] { charts->OpenCharts(); });
    main.SetAction("CHTPage", [&main] {
        CHTPage page(main.session(), &main);
        page.exec();
    });
    main.SetAction("PrinterDialog", [&main, charts] {
        QPageSetupDialog dialog(&charts->printer(), &main);
        dialog.exec();
    });
}

} // namespace kori::gui
