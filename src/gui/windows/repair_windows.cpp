#include "gui/windows/repair_windows.h"

#include "gui/widgets/window_place.h"
#include "gui/windows/repair_progress.h"
#include "maint/asx_chg.h"
#include "maint/move_files.h"
#include "maint/old_files.h"
#include "maint/rem_date.h"
#include "maint/rem_dup_st.h"
#include "platform/files.h"
#include "platform/text.h"

#include <QComboBox>
#include <QFileDialog>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString L(std::string_view text) {
    return QString::fromLatin1(text.data(), static_cast<int>(text.size()));
}
std::string T(const QString& s) {
    return s.toLatin1().toStdString();
}
} // namespace

RepairWindow::RepairWindow(app::Session& session, const char* name, const QString& caption,
                           QWidget* parent)
    : QDialog(parent), m_session(session) {
    setObjectName(QString::fromLatin1(name));
    setWindowTitle(caption);
    KeepWindowPosition(this, session.services().settings, name);
    m_progress = new RepairProgress(this);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_progress);
}

void RepairWindow::AddTexts(std::initializer_list<std::string_view> lines) {
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    for (std::string_view line : lines) {
        auto* label = new QLabel(L(line), this);
        label->setWordWrap(true);
        layout->insertWidget(layout->count() - 1, label);
    }
}

QPushButton* RepairWindow::AddButton(const QString& caption, const char* name) {
    auto* button = new QPushButton(caption, this);
    button->setObjectName(QString::fromLatin1(name));
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    layout->insertWidget(layout->count() - 1, button);
    return button;
}

QLineEdit* RepairWindow::AddFolderField(const char* name, const std::string& folder) {
    auto* row = new QHBoxLayout;
    auto* edit = new QLineEdit(QString::fromStdString(folder), this);
    edit->setObjectName(QString::fromLatin1(name));
    auto* browse = new QPushButton(QStringLiteral("..."), this);
    connect(browse, &QPushButton::clicked, this, [this, edit] {
        const QString chosen = QFileDialog::getExistingDirectory(this, QString(), edit->text());
        if (!chosen.isEmpty()) edit->setText(chosen + "/");
    });
    row->addWidget(edit, 1);
    row->addWidget(browse);
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    layout->insertLayout(layout->count() - 1, row);
    return edit;
}

template <typename Work> void RepairWindow::Run(Work work) {
    m_running = true;
    setEnabled(false);
    m_progress->setEnabled(true); // its Cancel stays live
    m_progress->ResetCancel();
    m_result = work();
    setEnabled(true);
    m_running = false;
}

void RepairWindow::ShowIssues(const platform::Issues& issues, const char* title) {
    if (issues.empty()) return;
    std::string text;
    for (std::size_t i = 0; i < issues.size() && i < 20; ++i)
        text += issues[i].text + "\n";
    if (issues.size() > 20) text += "... and " + std::to_string(issues.size() - 20) + " more\n";
    m_session.dialogs().MsgBox(text, title);
}

void RepairWindow::reject() {
    if (m_running) { // the walk is asked to stop; the window closes when it has
        m_progress->RequestCancel();
        return;
    }
    QDialog::reject();
}

ASXChg::ASXChg(app::Session& session, QWidget* parent)
    : RepairWindow(session, "ASXChg", QStringLiteral("ASX Code Changed"), parent) {
    const auto& intro = maint::asx_text::kIntro;
    AddTexts({intro[0], intro[1], intro[2], intro[3], intro[4]});
    m_old = new QLineEdit(this);
    m_old->setObjectName(QStringLiteral("txtOldCode"));
    m_new = new QLineEdit(this);
    m_new->setObjectName(QStringLiteral("txtNewCode"));
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    auto* row = new QHBoxLayout;
    row->addWidget(new QLabel(QStringLiteral("Old ASX Code"), this));
    row->addWidget(m_old);
    row->addWidget(new QLabel(QStringLiteral("New ASX Code"), this));
    row->addWidget(m_new);
    layout->insertLayout(layout->count() - 1, row);
    connect(AddButton(QStringLiteral("Change"), "cmdChange"), &QPushButton::clicked, this,
            &ASXChg::Convert);
}

void ASXChg::Convert() {
    Run([this] {
        return maint::AsxChg(m_session.folders.DataFolder, T(m_old->text()), T(m_new->text()),
                             m_session.dialogs(), *m_progress);
    });
    ShowIssues(m_result.Issues, "ASX Code Changed");
}

RemDate::RemDate(app::Session& session, QWidget* parent)
    : RepairWindow(session, "RemDate", L(maint::rem_date_text::kCaption), parent) {
    m_folder = AddFolderField("txtFolder", session.folders.DataFolder);
    m_date = new QLineEdit(this);
    m_date->setObjectName(QStringLiteral("txtDate"));
    m_date->setPlaceholderText(QStringLiteral("dd/mm/yyyy"));
    m_all = new QRadioButton(L(maint::rem_date_text::kAll), this);
    m_all->setObjectName(QStringLiteral("optAll"));
    m_latest = new QRadioButton(L(maint::rem_date_text::kLatest), this);
    m_latest->setObjectName(QStringLiteral("optLatest"));
    m_all->setChecked(true);
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    for (QWidget* w : std::initializer_list<QWidget*>{m_date, m_all, m_latest})
        layout->insertWidget(layout->count() - 1, w);
    connect(AddButton(QStringLiteral("Remove"), "cmdRemove"), &QPushButton::clicked, this,
            &RemDate::Remove);
}

void RemDate::Remove() {
    Run([this] {
        return maint::RemDate(T(m_folder->text()), T(m_date->text()),
                              m_all->isChecked() ? maint::RemoveWhich::All
                                                 : maint::RemoveWhich::Latest,
                              m_session.dialogs(), *m_progress);
    });
    ShowIssues(m_result.Issues, "Remove Selected Data");
}

RemDupST::RemDupST(app::Session& session, QWidget* parent)
    : RepairWindow(session, "RemDupST", QStringLiteral("Remove Duplicate Dates"), parent) {
    m_folders = new QComboBox(this);
    m_folders->setObjectName(QStringLiteral("cboFolders"));
    m_folders->setEditable(true);
    m_folders->addItem(QString::fromStdString(session.folders.DataFolder));
    for (const auto& f : session.chartDataPaths)
        if (!platform::Trim(f).empty() && f != session.folders.DataFolder)
            m_folders->addItem(QString::fromStdString(f));
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    layout->insertWidget(layout->count() - 1, m_folders);
    connect(AddButton(QStringLiteral("Start"), "cmdStart"), &QPushButton::clicked, this,
            &RemDupST::Start);
}

void RemDupST::Start() {
    Run([this] { return maint::RemDupST(T(m_folders->currentText()), *m_progress); });
    ShowIssues(m_result.Issues, "Remove Duplicate Dates");
}

DumpOld::DumpOld(app::Session& session, QWidget* parent)
    : RepairWindow(session, "DumpOld", L(maint::old_text::kTitle), parent) {
    m_count = static_cast<int>(maint::OldFiles(session.folders.DataFolder).size());
    AddTexts({});
    auto* count = new QLabel(QStringLiteral("%1 '.Old' files in %2")
                                 .arg(m_count)
                                 .arg(QString::fromStdString(session.folders.DataFolder)),
                             this);
    count->setObjectName(QStringLiteral("lblCount"));
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    layout->insertWidget(layout->count() - 1, count);
    connect(AddButton(QStringLiteral("Delete"), "cmdDelete"), &QPushButton::clicked, this,
            &DumpOld::Delete);
}

void DumpOld::Delete() {
    Run([this] { return maint::DumpOld(m_session.folders.DataFolder, *m_progress); });
    if (m_result.Issues.empty())
        m_session.dialogs().MsgBox(maint::old_text::kCompleted, maint::old_text::kCompletedTitle);
    else
        ShowIssues(m_result.Issues, "Old files");
    m_count = static_cast<int>(maint::OldFiles(m_session.folders.DataFolder).size());
}

ResetFA::ResetFA(app::Session& session, QWidget* parent)
    : RepairWindow(session, "ResetFA", QStringLiteral("Reset read-only data files"), parent) {
    const auto& intro = maint::old_text::kResetIntro;
    AddTexts({intro[0], intro[1], intro[2]});
    m_folder = AddFolderField("txtFolder", session.folders.DataFolder);
    connect(AddButton(QStringLiteral("Reset"), "cmdReset"), &QPushButton::clicked, this,
            &ResetFA::Reset);
}

void ResetFA::Reset() {
    Run([this] { return maint::ResetFA(T(m_folder->text()), *m_progress); });
    ShowIssues(m_result.Issues, "Reset read-only data files");
    if (m_result.Done)
        m_progress->SetStatus(std::to_string(m_result.FilesChanged) + " files made writable");
}

MoveFiles::MoveFiles(app::Session& session, QWidget* parent)
    : RepairWindow(session, "MoveFiles", QStringLiteral("Move data from one folder to another"),
                   parent) {
    const auto& intro = maint::move_text::kIntro;
    AddTexts({intro[0], intro[1], intro[2]});
    m_source = AddFolderField("txtSource", session.folders.DataFolder);
    std::string other;
    for (const auto& f : session.chartDataPaths)
        if (!platform::Trim(f).empty() && f != session.folders.DataFolder) {
            other = f;
            break;
        }
    m_destination = AddFolderField("txtDestination", other);
    m_sourceFiles = new QListWidget(this);
    m_sourceFiles->setObjectName(QStringLiteral("lstSource"));
    m_destinationFiles = new QListWidget(this);
    m_destinationFiles->setObjectName(QStringLiteral("lstDestination"));
    auto* move = new QPushButton(QStringLiteral(">>>"), this);
    move->setObjectName(QStringLiteral("cmdMove"));
    auto* panes = new QHBoxLayout;
    panes->addWidget(m_sourceFiles, 1);
    panes->addWidget(move);
    panes->addWidget(m_destinationFiles, 1);
    auto* layout = static_cast<QVBoxLayout*>(this->layout());
    layout->insertLayout(layout->count() - 1, panes);
    connect(move, &QPushButton::clicked, this, &MoveFiles::Move);
    connect(m_source, &QLineEdit::editingFinished, this, &MoveFiles::Fill);
    connect(m_destination, &QLineEdit::editingFinished, this, &MoveFiles::Fill);
    Fill();
}

void MoveFiles::Fill() {
    const auto fill = [](QListWidget* list, const std::string& folder) {
        list->clear();
        for (const auto& name : maint::WdtFiles(folder))
            list->addItem(QString::fromLatin1(name.c_str()));
    };
    fill(m_sourceFiles, T(m_source->text()));
    fill(m_destinationFiles, T(m_destination->text()));
}

void MoveFiles::Move() {
    const auto* item = m_sourceFiles->currentItem();
    if (!item) return;
    const std::string file = T(item->text());
    Run([this, &file] {
        return maint::MoveFiles(T(m_source->text()), T(m_destination->text()), file,
                                m_session.dialogs(), *m_progress);
    });
    ShowIssues(m_result.Issues, "Error");
    Fill();
}

} // namespace kori::gui
