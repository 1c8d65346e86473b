#include "gui/windows/help_browser.h"

#include "gui/widgets/window_place.h"
#include "gui/windows/main_window.h"
#include "platform/settings_store.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QDialogButtonBox>
#include <QFile>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QSplitter>
#include <QTextBrowser>
#include <QToolButton>
#include <QVBoxLayout>

// The pages live in a static library: their resources must be pulled in by hand.
static void InitHelpResources() {
    Q_INIT_RESOURCE(help);
}

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}

void EnsureResources() {
    static const bool done = (InitHelpResources(), true);
    (void)done;
}

std::string IdOfUrl(const QUrl& url) {
    QString file = url.fileName();
    if (file.endsWith(QStringLiteral(".html"))) file.chop(5);
    return file.toStdString();
}
} // namespace

QString HelpPageUrl(const std::string& id) {
    return QStringLiteral("qrc:/help/") + Q(id) + QStringLiteral(".html");
}

QString HelpPageHtml(const std::string& id) {
    EnsureResources();
    QFile f(QStringLiteral(":/help/") + Q(id) + QStringLiteral(".html"));
    if (!f.open(QIODevice::ReadOnly)) return {};
    return QString::fromUtf8(f.readAll());
}

HelpBrowser::HelpBrowser(QWidget* parent) : QDialog(parent) {
    EnsureResources();
    setObjectName(QStringLiteral("HelpBrowser"));
    setWindowTitle(Q(std::string(app::kHelpCaption)));
    setAttribute(Qt::WA_DeleteOnClose);
    setSizeGripEnabled(true);

    auto* back = new QToolButton;
    back->setObjectName(QStringLiteral("cmdBack"));
    back->setText(QStringLiteral("< Back"));
    auto* forward = new QToolButton;
    forward->setObjectName(QStringLiteral("cmdForward"));
    forward->setText(QStringLiteral("Forward >"));
    auto* home = new QToolButton;
    home->setObjectName(QStringLiteral("cmdHome"));
    home->setText(QStringLiteral("Contents"));
    m_search = new QLineEdit;
    m_search->setObjectName(QStringLiteral("txtSearch"));
    m_search->setPlaceholderText(QStringLiteral("Search the help"));
    m_search->setClearButtonEnabled(true);
    auto* find = new QPushButton(QStringLiteral("&Search"));
    find->setObjectName(QStringLiteral("cmdSearch"));
    find->setAutoDefault(false);

    auto* bar = new QHBoxLayout;
    bar->addWidget(back);
    bar->addWidget(forward);
    bar->addWidget(home);
    bar->addSpacing(12);
    bar->addWidget(m_search, 1);
    bar->addWidget(find);

    m_list = new QListWidget;
    m_list->setObjectName(QStringLiteral("lstPages"));
    m_browser = new QTextBrowser;
    m_browser->setObjectName(QStringLiteral("txtPage"));
    m_browser->setOpenLinks(true);
    m_browser->setOpenExternalLinks(false);
    m_browser->setSearchPaths({QStringLiteral(":/help")});

    auto* split = new QSplitter;
    split->addWidget(m_list);
    split->addWidget(m_browser);
    split->setStretchFactor(0, 0);
    split->setStretchFactor(1, 1);
    split->setSizes({170, 450});

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(bar);
    layout->addWidget(split, 1);
    // Fits a 640x480 screen; maximised, the page takes the room.
    resize(620, 440);

    connect(back, &QToolButton::clicked, m_browser, &QTextBrowser::backward);
    connect(forward, &QToolButton::clicked, m_browser, &QTextBrowser::forward);
    connect(home, &QToolButton::clicked, this, [this] {
        m_search->clear();
        ListPages({});
        ShowPage(std::string(app::kHelpContentsId));
    });
    connect(m_browser, &QTextBrowser::backwardAvailable, back, &QToolButton::setEnabled);
    connect(m_browser, &QTextBrowser::forwardAvailable, forward, &QToolButton::setEnabled);
    back->setEnabled(false);
    forward->setEnabled(false);
    connect(find, &QPushButton::clicked, this, [this] { Search(m_search->text()); });
    connect(m_search, &QLineEdit::returnPressed, this, [this] { Search(m_search->text()); });
    connect(m_list, &QListWidget::itemActivated, this, [this](QListWidgetItem* item) {
        ShowPage(item->data(Qt::UserRole).toString().toStdString());
    });
    connect(m_list, &QListWidget::itemClicked, this, [this](QListWidgetItem* item) {
        ShowPage(item->data(Qt::UserRole).toString().toStdString());
    });
    connect(m_browser, &QTextBrowser::sourceChanged, this, [this](const QUrl& url) {
        const std::string id = IdOfUrl(url);
        for (int i = 0; i < m_list->count(); ++i)
            if (m_list->item(i)->data(Qt::UserRole).toString().toStdString() == id) {
                const QSignalBlocker block(m_list);
                m_list->setCurrentRow(i);
            }
    });
    ListPages({});
    ShowPage(std::string(app::kHelpContentsId));
}

void HelpBrowser::ListPages(const std::vector<const app::HelpPage*>& pages) {
    m_list->clear();
    std::vector<const app::HelpPage*> shown = pages;
    if (shown.empty())
        for (const auto& p : app::HelpPages())
            shown.push_back(&p);
    for (const auto* p : shown) {
        auto* item = new QListWidgetItem(Q(p->title), m_list);
        item->setData(Qt::UserRole, Q(p->id));
    }
}

void HelpBrowser::ShowPage(const std::string& id) {
    const std::string shown = app::FindHelpPage(id) ? id : std::string(app::kHelpContentsId);
    m_browser->setSource(QUrl(HelpPageUrl(shown)));
}

std::string HelpBrowser::CurrentPage() const {
    return IdOfUrl(m_browser->source());
}

void HelpBrowser::Search(const QString& words) {
    const auto found = app::SearchHelp(words.toStdString());
    if (found.empty()) {
        m_browser->setHtml(QStringLiteral("<h1>Search</h1><p>No page holds \"%1\". Try "
                                          "another word, or pick a page from the list.</p>")
                               .arg(words.toHtmlEscaped()));
        ListPages({});
        return;
    }
    ListPages(found);
    ShowPage(found.front()->id);
}

AbtKori::AbtKori(const QString& text, QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("AbtKori"));
    setWindowTitle(QStringLiteral("About KORI"));
    setAttribute(Qt::WA_DeleteOnClose);
    m_text = new QLabel(text);
    m_text->setObjectName(QStringLiteral("lblAbout"));
    m_text->setTextInteractionFlags(Qt::TextSelectableByMouse);
    m_text->setWordWrap(true);
    auto* ok = new QPushButton(QStringLiteral("OK"));
    ok->setObjectName(QStringLiteral("cmdOK"));
    ok->setDefault(true);
    connect(ok, &QPushButton::clicked, this, &QDialog::accept);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(ok);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_text, 1);
    layout->addLayout(buttons);
    setMinimumWidth(380);
}

QString AbtKori::text() const {
    return m_text->text();
}

TipsWindow::TipsWindow(platform::SettingsStore& settings, QWidget* parent)
    : QDialog(parent), m_settings(settings) {
    setObjectName(QStringLiteral("Tips"));
    setWindowTitle(QStringLiteral("Tips"));
    setAttribute(Qt::WA_DeleteOnClose);
    auto* heading = new QLabel(QStringLiteral("<b>Did you know...</b>"));
    m_tip = new QLabel;
    m_tip->setObjectName(QStringLiteral("lblTip"));
    m_tip->setWordWrap(true);
    m_tip->setMinimumHeight(70);
    m_tip->setAlignment(Qt::AlignTop | Qt::AlignLeft);
    m_show = new QCheckBox(QStringLiteral("Show tips at startup"));
    m_show->setObjectName(QStringLiteral("chkShowTips"));
    m_show->setChecked(app::ShowTipsAtStartup(settings));
    auto* previous = new QPushButton(QStringLiteral("Previous Tip"));
    previous->setObjectName(QStringLiteral("cmdPrevious"));
    auto* next = new QPushButton(QStringLiteral("Next Tip"));
    next->setObjectName(QStringLiteral("cmdNext"));
    auto* close = new QPushButton(QStringLiteral("Close"));
    close->setObjectName(QStringLiteral("cmdClose"));
    close->setDefault(true);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_show);
    buttons->addStretch();
    buttons->addWidget(previous);
    buttons->addWidget(next);
    buttons->addWidget(close);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(heading);
    layout->addWidget(m_tip, 1);
    layout->addLayout(buttons);
    setMinimumWidth(440);

    // A different tip each start: the place in the list is kept with the other settings.
    const QString kept = QString::fromStdString(settings.Get("TipNumber", "0"));
    m_tips = app::Tips(static_cast<std::size_t>(std::max(0, kept.toInt())));
    ShowTip();
    settings.Save("TipNumber", std::to_string((m_tips.Index() + 1) % app::Tips::All().size()));

    connect(next, &QPushButton::clicked, this, [this] {
        m_tips.Next();
        ShowTip();
    });
    connect(previous, &QPushButton::clicked, this, [this] {
        m_tips.Previous();
        ShowTip();
    });
    connect(close, &QPushButton::clicked, this, &QDialog::close);
    connect(m_show, &QCheckBox::toggled, this,
            [this](bool on) { app::SetShowTipsAtStartup(m_settings, on); });
}

QString TipsWindow::tip() const {
    return m_tip->text();
}

void TipsWindow::ShowTip() {
    m_tip->setText(Q(m_tips.Current()));
}

namespace {

// F1 anywhere in the program: the help at the page of the window that has the keyboard.
class HelpKey : public QObject {
public:
    explicit HelpKey(MainWindow& main) : QObject(&main), m_main(main) {}

protected:
    bool eventFilter(QObject* watched, QEvent* e) override {
        if (e->type() != QEvent::KeyPress) return false;
        auto* key = static_cast<QKeyEvent*>(e);
        if (key->key() != Qt::Key_F1 || key->modifiers() != Qt::NoModifier) return false;
        const QWidget* w = qobject_cast<QWidget*>(watched);
        if (!w) w = QApplication::focusWidget();
        if (!w) w = QApplication::activeWindow();
        OpenHelpFor(m_main, w);
        return true;
    }

private:
    MainWindow& m_main;
};

HelpBrowser* OpenBrowser(MainWindow& main) {
    if (auto* open = main.findChild<HelpBrowser*>(QStringLiteral("HelpBrowser"))) {
        open->show();
        open->raise();
        open->activateWindow();
        return open;
    }
    // A window of its own beside the others, so that it can be read while one works.
    auto* help = new HelpBrowser(&main);
    help->setWindowFlag(Qt::Window);
    help->show();
    return help;
}

} // namespace

HelpBrowser* OpenHelpFor(MainWindow& main, const QWidget* window) {
    std::string page(app::kHelpContentsId);
    for (const QObject* o = window; o; o = o->parent()) {
        const std::string name = o->objectName().toStdString();
        if (name == "HelpBrowser") return OpenBrowser(main); // F1 in the help itself
        if (app::HasOwnHelpPage(name)) {
            page = app::HelpPageForWindow(name).id;
            break;
        }
    }
    HelpBrowser* help = OpenBrowser(main);
    help->ShowPage(page);
    return help;
}

void RegisterHelpWindows(MainWindow& main) {
    main.SetAction("Help", [&main] { OpenBrowser(main); });
    main.SetAction("ToggleTips", [&main] {
        const bool on = app::ToggleShowTipsAtStartup(main.session().services().settings);
        main.session().dialogs().MsgBox(on ? "Tips will be shown when KORI Charting starts."
                                           : "Tips will not be shown when KORI Charting starts.",
                                        "Tips");
    });
    qApp->installEventFilter(new HelpKey(main));
}

void ShowTipsIfWanted(MainWindow& main) {
    if (!app::ShowTipsAtStartup(main.session().services().settings)) return;
    if (main.findChild<TipsWindow*>(QStringLiteral("Tips"))) return;
    auto* tips = new TipsWindow(main.session().services().settings, &main);
    tips->setWindowFlag(Qt::Window);
    tips->show();
}

} // namespace kori::gui
