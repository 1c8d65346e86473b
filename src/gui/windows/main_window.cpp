#include "gui/windows/main_window.h"

#include "maint/security_details.h"

#include "app/about.h"
#include "app/window_position.h"
#include "gui/services/qt_progress.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/help_browser.h"
#include "platform/files.h"
#include "platform/text.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QGuiApplication>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QScreen>
#include <QStatusBar>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
} // namespace

MainWindow::MainWindow(app::Session& session, QtProgress* progress, QWidget* parent)
    : QMainWindow(parent), m_session(session), m_mdi(new QMdiArea(this)), m_progress(progress) {
    if (m_progress) {
        setStatusBar(m_progress->statusBar());
    } else {
        m_ownProgress = std::make_unique<QtProgress>(statusBar());
        m_progress = m_ownProgress.get();
    }
    setObjectName(QStringLiteral("Main"));
    setCentralWidget(m_mdi);
    m_mdi->setViewMode(QMdiArea::SubWindowView);
    // A child window larger than the work area is reached by scrolling, never clipped.
    m_mdi->setHorizontalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    m_mdi->setVerticalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    // Sizes in the settings store are twips, scaled when the screen is not the one they were
    // written on.
    const auto place = app::LoadMainWindowPlace(m_session.services().settings, ScreenTwips(this));
    QSize size(std::max(place.width / kTwipsPerPixel, 640),
               std::max(place.height / kTwipsPerPixel, 480));
    m_firstStart = !place.sizeStored;
    if (m_firstStart) {
        const auto first = app::FirstStartSize({size.width(), size.height()}, FreeScreen());
        size = QSize(first.width, first.height);
    }
    resize(size);
    if (place.left && place.top) {
        // The same client geometry that closing wrote, unless no screen shows it any more.
        const QRect stored(QPoint(*place.left / kTwipsPerPixel, *place.top / kTwipsPerPixel), size);
        if (!screen() || screen()->availableVirtualGeometry().intersects(stored))
            setGeometry(stored);
    }
    SetAction("Exit", [this] {
        m_ending = true;
        ULForms();
        close();
    });
    SetAction("AbtKori", [this] { ShowAbout(); });
    UpdateCaption();
    RebuildMenus();
}

MainWindow::~MainWindow() = default;

app::PixelSize MainWindow::FreeScreen() const {
    const QScreen* s = screen() ? screen() : QGuiApplication::primaryScreen();
    if (!s) return {};
    // The frame and title bar take a little of the free area.
    const QSize free = s->availableGeometry().size() - QSize(16, 40);
    return {free.width(), free.height()};
}

void MainWindow::FitChild(QMdiSubWindow* child) {
    if (!child || !m_firstStart || isMaximized() || isFullScreen()) return;
    const QRect frame = child->geometry();
    const QSize area = m_mdi->viewport()->size();
    const auto grown = app::GrowToFit({width(), height()}, {area.width(), area.height()},
                                      {frame.right() + 1, frame.bottom() + 1}, FreeScreen());
    if (grown.width != width() || grown.height != height()) resize(grown.width, grown.height);
}

void MainWindow::UpdateCaption() {
    setWindowTitle(Q("Kori Charting 8 " + std::string("  -   Current Data Folder ") +
                     platform::Trim(m_session.folders.DataFolder)));
}

void MainWindow::SetAction(const std::string& opens, std::function<void()> action) {
    m_actions[opens] = std::move(action);
}

app::MenuConditions MainWindow::Conditions() const {
    app::MenuConditions c;
    c.DataService = m_session.download.DataService;
    c.HideDownloadProgram = m_hideDownloadProgram;
    const std::string sys = m_session.folders.SystemFolder;
    c.MaxScanPresent = platform::FileExists(platform::ResolveIn(sys, "KoriMaxScan.exe"));
    c.MMAScanPresent = platform::FileExists(platform::ResolveIn(sys, "KoriMMA.EXE"));
    c.SecurityDetailsPresent = maint::SecurityDetailsAvailable(c.DataService, sys);
    return c;
}

void MainWindow::RebuildMenus() {
    m_tops = app::BuildMenuTree();
    app::ApplyMenuConditions(m_tops, Conditions());
    if (m_modal) app::SetModalToolRunning(m_tops, true, Conditions(), m_ending);
    std::map<std::string, std::string> opensByName;
    auto available = [this](const std::string& name) {
        auto tops = app::BuildMenuTree();
        const auto* item = app::FindItem(tops, name);
        return item && m_actions.count(item->opens) > 0;
    };
    app::KeepAvailable(m_tops, available);
    // Old menus go later (a rebuild may run from one of their own actions); their names go now
    // so that nothing finds them by name in the meantime.
    for (QAction* a : menuBar()->actions()) {
        if (QMenu* m = a->menu()) {
            for (QObject* o : m->findChildren<QObject*>())
                o->setObjectName(QString());
            m->setObjectName(QString());
            m->deleteLater();
        }
    }
    menuBar()->clear();
    for (const auto& top : m_tops) {
        if (!top.visible) continue;
        QMenu* menu = menuBar()->addMenu(Q(top.caption));
        menu->setObjectName(Q(top.name));
        AddItems(menu, top.items);
    }
}

void MainWindow::AddItems(QMenu* menu, const std::vector<app::MenuItem>& items) {
    for (const auto& item : items) {
        if (!item.visible) continue;
        if (item.separatorBefore) menu->addSeparator();
        if (!item.items.empty()) {
            QMenu* sub = menu->addMenu(Q(item.caption));
            sub->setObjectName(Q(item.name));
            AddItems(sub, item.items);
            continue;
        }
        QAction* a = menu->addAction(Q(item.caption));
        a->setObjectName(Q(item.name));
        a->setEnabled(item.enabled);
        const std::string name = item.name;
        connect(a, &QAction::triggered, this, [this, name] { Trigger(name); });
    }
}

bool MainWindow::Trigger(const std::string& itemName) {
    const auto* item = app::FindItem(m_tops, itemName);
    if (!item || !item->enabled) return false;
    auto it = m_actions.find(item->opens);
    if (it == m_actions.end()) return false;
    it->second();
    return true;
}

bool MainWindow::Open(const std::string& opens) {
    auto it = m_actions.find(opens);
    if (it == m_actions.end()) return false;
    it->second();
    return true;
}

void MainWindow::SetModalToolRunning(bool running) {
    m_modal = running;
    if (!running && m_ending) return;
    RebuildMenus();
}

void MainWindow::ULForms() {
    m_mdi->closeAllSubWindows();
}

void MainWindow::closeEvent(QCloseEvent* e) {
    // Unloading saves the main window's size (in twips, as the settings hold it).
    if (!isMaximized() && !isMinimized()) {
        const QRect g = geometry();
        app::SaveMainWindowPlace(m_session.services().settings,
                                 {g.x() * kTwipsPerPixel, g.y() * kTwipsPerPixel,
                                  g.width() * kTwipsPerPixel, g.height() * kTwipsPerPixel},
                                 ScreenTwips(this));
    }
    m_ending = true;
    ULForms();
    e->accept();
}

QString MainWindow::AboutText() const {
    return QString::fromStdString(app::AboutText(m_session));
}

void MainWindow::ShowAbout() {
    if (auto* open = findChild<AbtKori*>(QStringLiteral("AbtKori"))) {
        open->raise();
        open->activateWindow();
        return;
    }
    (new AbtKori(AboutText(), this))->open();
}

} // namespace kori::gui
