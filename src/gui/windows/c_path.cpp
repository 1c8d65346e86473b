#include "gui/windows/c_path.h"

#include "gui/windows/locate.h"
#include "platform/files.h"

#include <QCloseEvent>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
constexpr const char* kLabels[] = {"System Folder", "Chart Data Folder", "Chart Backup Folder",
                                   "Portfolio Manager Data", "Portfolio Manager Backup"};
constexpr const char* kNames[] = {"txtSystem", "txtChtData", "txtChtBackUp", "txtPFMData",
                                  "txtPFMBackUp"};

bool Same(const app::PathDetails& a, const app::PathDetails& b) {
    return a.SystemFolder == b.SystemFolder && a.DataFolder == b.DataFolder &&
           a.ChartBackupFolder == b.ChartBackupFolder && a.PFMData == b.PFMData &&
           a.PFMBackUp == b.PFMBackUp;
}
} // namespace

CPath::CPath(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "CPath", QStringLiteral("Path Details"), parent) {
    auto* grid = new QGridLayout;
    for (int i = 0; i < 5; ++i) {
        auto* edit = new QLineEdit(this);
        edit->setObjectName(QString::fromLatin1(kNames[i]));
        edit->setMinimumWidth(340);
        // A path typed by hand gets its closing separator.
        connect(edit, &QLineEdit::editingFinished, this, [edit] {
            const QString t = edit->text().trimmed();
            if (!t.isEmpty()) edit->setText(Q(platform::FolderWithSlash(S(t))));
        });
        auto* browse = Button(QStringLiteral("Browse..."), "cmdBrowse");
        connect(browse, &QPushButton::clicked, this, [this, i] { Browse(i); });
        grid->addWidget(new QLabel(QString::fromLatin1(kLabels[i]), this), i, 0);
        grid->addWidget(edit, i, 1);
        grid->addWidget(browse, i, 2);
        m_fields[static_cast<std::size_t>(i)] = edit;
    }
    auto* buttons = SaveRow([this] { return Save(); }, QStringLiteral("Exit"), "cmdExit");
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(grid);
    layout->addLayout(buttons);

    if (session.pathsMissing) {
        switch (app::AskForMissingPaths(session)) {
        case app::MissingPathsChoice::EnterPaths:
            Show(app::PathDetails{});
            return;
        case app::MissingPathsChoice::UseDefaults:
            hub.DataFolderChanged();
            break;
        case app::MissingPathsChoice::Exit:
            m_proceed = false;
            hub.ExitRequested();
            return;
        }
    } else {
        session.ReadFolders();
    }
    Show(app::CurrentPathDetails(session));
}

void CPath::Show(const app::PathDetails& p) {
    m_shown = p;
    const std::string* v[] = {&p.SystemFolder, &p.DataFolder, &p.ChartBackupFolder, &p.PFMData,
                              &p.PFMBackUp};
    for (std::size_t i = 0; i < m_fields.size(); ++i)
        m_fields[i]->setText(Q(*v[i]));
}

app::PathDetails CPath::Edited() const {
    auto t = [this](int i) { return S(field(i)->text().trimmed()); };
    return {t(0), t(1), t(2), t(3), t(4)};
}

void CPath::Browse(int i) {
    if (auto folder = Locate::Choose(m_session, m_hub, S(field(i)->text()), this))
        field(i)->setText(Q(*folder));
}

bool CPath::Save() {
    if (!app::SavePathDetails(m_session, Edited())) return false;
    Show(app::CurrentPathDetails(m_session));
    m_hub.DataFolderChanged();
    return true;
}

void CPath::reject() {
    if (m_proceed && !Same(Edited(), m_shown) &&
        dialogs().MsgBox("Paths have changed. SAVE Changes ?", "Save Changes",
                         platform::Buttons::YesNo,
                         platform::Icon::Question) == platform::Answer::Yes &&
        !Save())
        return; // a refused save keeps the window open
    QDialog::reject();
}

} // namespace kori::gui
