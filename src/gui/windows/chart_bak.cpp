#include "gui/windows/chart_bak.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/named_controls.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QSpinBox>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString Text(const std::string& s) {
    return QString::fromStdString(s);
}
} // namespace

ChartBak::ChartBak(app::Session& session, QtProgress& progress, bool restore, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress), m_form(session),
      m_restore(restore) {
    setObjectName(restore ? QStringLiteral("ChartBak Restore") : QStringLiteral("ChartBak"));
    setWindowTitle(QString::fromLatin1(restore ? app::kRestoreTitle : app::kBackupTitle));
    auto* layout = new QVBoxLayout(this);
    auto* buttons = new QDialogButtonBox(this);
    auto add = [&](const char* caption, const char* name, auto slot) {
        return NamedButton(buttons, this, caption, name, slot);
    };
    if (!restore) {
        auto* intro = new QLabel(
            Text("The name files, price files, chart lists, chart notes, saved charts and "
                 "settings of the library are written to one archive in the back-up folder "
                 "with a checksum of every file."),
            this);
        intro->setWordWrap(true);
        layout->addWidget(intro);
        auto* form = new QFormLayout;
        form->addRow(QStringLiteral("Back-up folder"), new QLabel(Text(m_form.Folder()), this));
        m_keep = new QSpinBox(this);
        m_keep->setObjectName(QStringLiteral("spnKeep"));
        m_keep->setRange(1, 999);
        m_keep->setValue(m_form.Keep());
        form->addRow(QStringLiteral("Back-ups kept"), m_keep);
        layout->addLayout(form);
        add("&Backup", "cmdBackup", [this] { Backup(); });
    } else {
        layout->addWidget(new QLabel(Text("Back-ups in " + m_form.Folder()), this));
        m_list = new QListWidget(this);
        m_list->setObjectName(QStringLiteral("lstBackups"));
        layout->addWidget(m_list, 1);
        add("&Check", "cmdVerify", [this] { Verify(); });
        add("&Restore", "cmdRestore", [this] { Restore(); });
        m_discard = add("&Discard Replaced Files", "cmdDiscard", [this] { Discard(); });
    }
    m_status = new QLabel(this);
    m_status->setObjectName(QStringLiteral("lblStatus"));
    m_status->setWordWrap(true);
    layout->addWidget(m_status);
    add("Close", "cmdClose", [this] { close(); });
    layout->addWidget(buttons);
    resize(560, restore ? 380 : 220);
    Refresh();
}

void ChartBak::Refresh() {
    if (!m_list) return;
    m_list->clear();
    for (const auto& b : m_form.Backups())
        m_list->addItem(Text(b));
    if (m_list->count() > 0)
        m_list->setCurrentRow(0);
    else
        m_status->setText(QStringLiteral("There are no back-ups in the back-up folder."));
    m_discard->setEnabled(!m_form.Replaced().empty());
}

std::string ChartBak::Chosen() const {
    const auto* item = m_list ? m_list->currentItem() : nullptr;
    return item ? item->text().toStdString() : std::string();
}

void ChartBak::Busy(bool busy) {
    setEnabled(!busy);
    m_session.dialogs().SetBusy(busy);
    if (busy)
        m_progress.ResetCancel();
    else
        m_progress.Finish();
}

void ChartBak::Backup() {
    m_form.SetKeep(m_keep->value());
    Busy(true);
    const std::string message = m_form.Backup(m_progress);
    Busy(false);
    m_status->setText(Text(message));
}

void ChartBak::Verify() {
    const std::string file = Chosen();
    if (file.empty()) return;
    Busy(true);
    const std::string message = m_form.Verify(file, m_progress);
    Busy(false);
    m_status->setText(Text(message));
}

void ChartBak::Restore() {
    const std::string file = Chosen();
    if (file.empty()) return;
    Busy(true);
    const std::string message = m_form.Restore(file, m_progress);
    Busy(false);
    if (message.empty()) return;
    m_status->setText(Text(message));
    Refresh();
    m_status->setText(Text(message));
}

void ChartBak::Discard() {
    if (m_form.DiscardReplaced())
        m_status->setText(QStringLiteral("The replaced files were removed."));
    Refresh();
}

} // namespace kori::gui
