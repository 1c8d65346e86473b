#include "gui/windows/sub_list3.h"

#include "platform/files.h"

#include <QFileDialog>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
constexpr const char* kTitle = "Chart Lists";
constexpr const char* kFolderKey = "SL3TXT";
} // namespace

SubList3::SubList3(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "SubList3", QStringLiteral("Import Text to Chart Lists"),
                     parent) {
    m_panel = new ChartListPanel(session, false, QString(), this);
    m_panel->SetGuard([this](int) { return AskToSave(); });
    m_file = new QListWidget(this);
    m_file->setObjectName(QStringLiteral("lstFile"));
    m_file->setSelectionMode(QAbstractItemView::ExtendedSelection);
    m_folder = new QLabel(Q(folder()), this);
    m_folder->setObjectName(QStringLiteral("lblFolder"));
    m_folder->setWordWrap(true);

    auto* open = Button(QStringLiteral("&Open Text File..."), "cmdOpen");
    connect(open, &QPushButton::clicked, this, &SubList3::ChooseFile);
    auto* move = Button(QStringLiteral("Move >>"), "cmdMove");
    connect(move, &QPushButton::clicked, this, [this] { MoveToList(false); });
    auto* moveAll = Button(QStringLiteral("Move All >>"), "cmdMoveAll");
    connect(moveAll, &QPushButton::clicked, this, [this] { MoveToList(true); });
    auto* save = Button(QStringLiteral("SAVE"), "cmdSave");
    connect(save, &QPushButton::clicked, this, &SubList3::SaveList);
    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    connect(close, &QPushButton::clicked, this, &SubList3::reject);

    auto* left = new QVBoxLayout;
    left->addWidget(m_folder);
    left->addWidget(open);
    left->addWidget(m_file, 1);
    auto* middle = new QVBoxLayout;
    middle->addStretch();
    middle->addWidget(move);
    middle->addWidget(moveAll);
    middle->addStretch();
    auto* body = new QHBoxLayout;
    body->addLayout(left, 1);
    body->addLayout(middle);
    body->addWidget(m_panel, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(body, 1);
    layout->addLayout(ButtonRow({save, close}));
    resize(520, 420);
    m_panel->Display(2);
}

std::string SubList3::folder() const {
    const std::string kept = m_session.services().settings.Get(kFolderKey, "");
    return kept.empty() || kept == platform::kUnknown ? m_session.folders.SystemFolder : kept;
}

void SubList3::ChooseFile() {
    const QString file = QFileDialog::getOpenFileName(
        this, QStringLiteral("Locate text data to import"), Q(folder()),
        QStringLiteral("Text files (*.txt *.TXT);;All files (*)"));
    if (!file.isEmpty()) LoadFile(file.toStdString());
}

bool SubList3::LoadFile(const std::filesystem::path& file) {
    const auto read = store::ReadImportFile(file);
    if (!read) {
        dialogs().MsgBox("Cannot read " + file.string(), kTitle);
        return false;
    }
    m_file->clear();
    for (const auto& code : read->Codes)
        m_file->addItem(Q(code));
    const std::string dir = platform::FolderWithSlash(file.parent_path().string());
    m_session.services().settings.Save(kFolderKey, dir);
    m_folder->setText(Q(dir));
    if (!read->Refused.empty())
        dialogs().MsgBox(store::RefusedCodesMessage(store::kImportRefusedHeading, read->Refused),
                         kTitle);
    return true;
}

int SubList3::MoveToList(bool all) {
    if (!m_panel->displayed()) return 0;
    std::vector<int> rows;
    for (int r = 0; r < m_file->count(); ++r)
        if (all || m_file->item(r)->isSelected()) rows.push_back(r);
    for (int r : rows)
        m_panel->box().Add(S(m_file->item(r)->text()));
    for (auto it = rows.rbegin(); it != rows.rend(); ++it)
        delete m_file->takeItem(*it);
    m_panel->Refresh();
    return static_cast<int>(rows.size());
}

bool SubList3::SaveList() {
    return m_panel->displayed() && m_panel->Save();
}

bool SubList3::AskToSave() {
    return m_panel->AskToSave(store::ListChangedQuestion(m_panel->displayName()), kTitle);
}

void SubList3::reject() {
    if (!AskToSave()) return;
    QDialog::reject();
}

} // namespace kori::gui
