#include "gui/windows/sub_list2.h"

#include <QHBoxLayout>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
constexpr const char* kListsTitle = "Chart Lists";
const std::string kTitle(store::kUtilitiesTitle);
} // namespace

SubList2::SubList2(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "SubList2", QStringLiteral("Chart List Utilities"), parent) {
    m_left = new ChartListPanel(session, true, QStringLiteral("1"), this);
    m_right = new ChartListPanel(session, true, QStringLiteral("2"), this);
    for (ChartListPanel* p : {m_left, m_right}) {
        ChartListPanel* other = p == m_left ? m_right : m_left;
        p->SetGuard([this, p, other](int mode) {
            if (other->mode() == mode) {
                dialogs().MsgBox(std::string(store::kListsSame), kTitle);
                return false;
            }
            return AskToSave(*p);
        });
    }
    auto* toRight = Button(QStringLiteral("Copy >>"), "cmdCopyRight");
    connect(toRight, &QPushButton::clicked, this, [this] { CopyAcross(0); });
    auto* toLeft = Button(QStringLiteral("<< Copy"), "cmdCopyLeft");
    connect(toLeft, &QPushButton::clicked, this, [this] { CopyAcross(1); });
    auto* middle = new QVBoxLayout;
    middle->addStretch();
    middle->addWidget(toRight);
    middle->addWidget(toLeft);
    middle->addStretch();

    auto* left = new QVBoxLayout;
    left->addWidget(m_left, 1);
    left->addLayout(SideButtons(0));
    auto* right = new QVBoxLayout;
    right->addWidget(m_right, 1);
    right->addLayout(SideButtons(1));
    auto* body = new QHBoxLayout;
    body->addLayout(left, 1);
    body->addLayout(middle);
    body->addLayout(right, 1);

    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    connect(close, &QPushButton::clicked, this, &SubList2::reject);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(body, 1);
    layout->addLayout(ButtonRow({close}));
    resize(520, 420);
}

QVBoxLayout* SubList2::SideButtons(int side) {
    const QString n = QString::number(side + 1);
    auto* del = Button(QStringLiteral("&Delete"), ("cmdDelete" + n).toLatin1().constData());
    connect(del, &QPushButton::clicked, this, [this, side] { DeleteSelected(side); });
    auto* all = Button(QStringLiteral("Delete All"), ("cmdDeleteAll" + n).toLatin1().constData());
    connect(all, &QPushButton::clicked, this, [this, side] { DeleteAll(side); });
    auto* save = Button(QStringLiteral("SAVE"), ("cmdSave" + n).toLatin1().constData());
    connect(save, &QPushButton::clicked, this, [this, side] { SaveSide(side); });
    auto* row = new QHBoxLayout;
    row->addWidget(del);
    row->addWidget(all);
    row->addWidget(save);
    auto* column = new QVBoxLayout;
    column->addLayout(row);
    return column;
}

bool SubList2::CopyAcross(int fromSide) {
    ChartListPanel& from = panel(fromSide);
    ChartListPanel& to = panel(1 - fromSide);
    if (!from.displayed() || !to.displayed()) {
        dialogs().MsgBox(std::string(store::kBothListsShown), kTitle);
        return false;
    }
    const auto rows = from.SelectedRows();
    // A code the other list already holds is not added again.
    for (std::size_t row : rows)
        to.box().AddIfAbsent(from.box().codes()[row]);
    to.Refresh();
    return !rows.empty();
}

void SubList2::DeleteSelected(int side) {
    ChartListPanel& p = panel(side);
    const auto rows = p.SelectedRows();
    for (auto it = rows.rbegin(); it != rows.rend(); ++it) {
        if (dialogs().MsgBox("Delete " + p.box().codes()[*it], kTitle, platform::Buttons::YesNo,
                             platform::Icon::Question) == platform::Answer::Yes)
            p.box().Remove(*it);
    }
    p.Refresh();
}

void SubList2::DeleteAll(int side) {
    ChartListPanel& p = panel(side);
    if (!p.displayed() || p.box().codes().empty()) return;
    if (dialogs().MsgBox("Delete all items from " + p.displayName() + "  ?", kTitle,
                         platform::Buttons::YesNo,
                         platform::Icon::Question) != platform::Answer::Yes)
        return;
    p.box().Clear();
    p.Refresh();
}

bool SubList2::SaveSide(int side) {
    return panel(side).displayed() && panel(side).Save();
}

bool SubList2::AskToSave(ChartListPanel& p) {
    return p.AskToSave(store::ListChangedQuestion(p.displayName()), kListsTitle);
}

void SubList2::reject() {
    if (!AskToSave(*m_left) || !AskToSave(*m_right)) return;
    QDialog::reject();
}

} // namespace kori::gui
