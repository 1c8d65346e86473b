#include "gui/windows/sub_list.h"

#include "app/settings.h"
#include "platform/text.h"

#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QShortcut>
#include <QVBoxLayout>

#include <algorithm>

namespace kori::gui {

namespace {
constexpr const char* kTitle = "Chart Lists";
constexpr const char* kChanged = "List has changed. SAVE Changes?";
} // namespace

SubList::SubList(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "SubList", QStringLiteral("Edit Chart Lists"), parent) {
    m_panel = new ChartListPanel(session, false, QString(), this);
    m_panel->SetGuard([this](int) { return AskToSave(); });
    // The editor opens on the list it showed last.
    connect(m_panel, &ChartListPanel::ListShown, this, [this](int mode) {
        m_session.subLists.Last = static_cast<std::int16_t>(mode);
        app::WriteSubListSettings(m_session.ini(), m_session.subLists);
    });

    // StockList: every code of the name file, in as many columns as [SubLists] Columns says.
    m_stocks = new QListWidget(this);
    m_stocks->setObjectName(QStringLiteral("lstStocks"));
    m_stocks->setFlow(QListView::TopToBottom);
    m_stocks->setWrapping(true);
    m_stocks->setResizeMode(QListView::Adjust);
    m_stocks->setGridSize(QSize(64, 20));
    const int columns = session.subLists.Columns > 0 ? session.subLists.Columns : 5;
    m_stocks->setMinimumWidth(columns * 64 + 24);
    m_stockCodes = store::StockList(session.folders.DataFolder);
    for (const auto& code : m_stockCodes)
        m_stocks->addItem(Q(code));
    connect(m_stocks, &QListWidget::itemDoubleClicked, this,
            [this](QListWidgetItem* item) { AddCode(item->text()); });

    m_code = new QLineEdit(this);
    m_code->setObjectName(QStringLiteral("txtCode"));
    m_code->setMaxLength(6);
    m_code->setMinimumWidth(80);
    connect(m_code, &QLineEdit::returnPressed, this, [this] {
        if (AddCode(m_code->text())) m_code->clear();
    });
    auto* add = Button(QStringLiteral("&Add"), "cmdAdd");
    connect(add, &QPushButton::clicked, this, [this] {
        if (AddCode(m_code->text())) m_code->clear();
    });
    auto* del = Button(QStringLiteral("&Delete"), "cmdDelete");
    connect(del, &QPushButton::clicked, this, &SubList::DeleteSelected);
    auto* delKey = new QShortcut(QKeySequence::Delete, m_panel->list());
    delKey->setContext(Qt::WidgetShortcut);
    connect(delKey, &QShortcut::activated, this, &SubList::DeleteSelected);
    auto* delAll = Button(QStringLiteral("Delete A&ll"), "cmdDeleteAll");
    connect(delAll, &QPushButton::clicked, this, &SubList::DeleteAll);
    auto* up = Button(QStringLiteral("Move &Up"), "cmdUp");
    connect(up, &QPushButton::clicked, this, [this] { MoveSelected(-1); });
    auto* down = Button(QStringLiteral("Move Do&wn"), "cmdDown");
    connect(down, &QPushButton::clicked, this, [this] { MoveSelected(1); });
    auto* save = Button(QStringLiteral("SAVE"), "cmdSave");
    connect(save, &QPushButton::clicked, this, &SubList::SaveList);
    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    connect(close, &QPushButton::clicked, this, &SubList::reject);

    auto* entry = new QHBoxLayout;
    entry->addWidget(new QLabel(QStringLiteral("Code"), this));
    entry->addWidget(m_code);
    entry->addWidget(add);
    auto* left = new QVBoxLayout;
    left->addLayout(entry);
    left->addWidget(m_panel, 1);
    auto* tools = new QVBoxLayout;
    for (auto* b : {del, delAll, up, down})
        tools->addWidget(b);
    tools->addStretch();
    auto* right = new QVBoxLayout;
    right->addWidget(new QLabel(QStringLiteral("All codes (double-click to add)"), this));
    right->addWidget(m_stocks, 1);
    auto* body = new QHBoxLayout;
    body->addLayout(left, 2);
    body->addLayout(tools);
    body->addLayout(right, 3);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(body, 1);
    layout->addLayout(ButtonRow({save, close}));
    resize(560, 420);

    const int last = session.subLists.Last;
    m_panel->Display(last >= 2 && last <= 11 ? last : 2);
}

bool SubList::AddCode(const QString& typed) {
    const std::string code = platform::Upper(platform::Trim(S(typed)));
    if (code.empty()) return false;
    if (std::find(m_stockCodes.begin(), m_stockCodes.end(), code) == m_stockCodes.end()) {
        dialogs().MsgBox("Code not found", kTitle);
        return false;
    }
    const auto rows = m_panel->SelectedRows();
    auto& box = m_panel->box();
    const std::size_t at = rows.empty() ? box.codes().size() : rows.back() + 1;
    box.Insert(at, code);
    m_panel->Refresh();
    m_panel->list()->setCurrentRow(static_cast<int>(std::min(at, box.codes().size() - 1)));
    return true;
}

void SubList::DeleteSelected() {
    const auto rows = m_panel->SelectedRows();
    if (rows.empty()) return;
    auto& box = m_panel->box();
    // From the bottom up, so the rows above keep their places.
    for (auto it = rows.rbegin(); it != rows.rend(); ++it) {
        if (dialogs().MsgBox("Delete " + box.codes()[*it], kTitle, platform::Buttons::YesNo,
                             platform::Icon::Question) == platform::Answer::Yes)
            box.Remove(*it);
    }
    m_panel->Refresh();
}

void SubList::DeleteAll() {
    if (m_panel->box().codes().empty()) return;
    if (dialogs().MsgBox("Delete all items ?", kTitle, platform::Buttons::YesNo,
                         platform::Icon::Question) != platform::Answer::Yes)
        return;
    m_panel->box().Clear();
    m_panel->Refresh();
}

void SubList::MoveSelected(int step) {
    const auto rows = m_panel->SelectedRows();
    if (rows.size() != 1) return;
    const auto to = static_cast<long long>(rows[0]) + step;
    if (to < 0 || !m_panel->box().Move(rows[0], static_cast<std::size_t>(to))) return;
    m_panel->Refresh();
    m_panel->list()->setCurrentRow(static_cast<int>(to));
}

bool SubList::SaveList() {
    return m_panel->displayed() && m_panel->Save();
}

bool SubList::AskToSave() {
    return m_panel->AskToSave(kChanged, kTitle);
}

void SubList::reject() {
    if (!AskToSave()) return; // a failed save keeps the window open
    QDialog::reject();
}

} // namespace kori::gui
