#include "gui/windows/dl_list.h"

#include "app/adjustment_list_form.h"
#include "gui/services/qt_progress.h"
#include "gui/windows/main_window.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

DLList::DLList(app::Session& session, QtProgress& progress, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress), m_form(session) {
    setObjectName(QStringLiteral("DLList"));
    setWindowTitle(QStringLiteral("Update with Downloaded Data "));
    auto* layout = new QVBoxLayout(this);
    m_list = new QListWidget(this);
    m_list->setObjectName(QStringLiteral("List1"));
    layout->addWidget(m_list, 1);
    m_status = new QLabel(this);
    m_status->setObjectName(QStringLiteral("lblStatus"));
    m_status->setWordWrap(true);
    layout->addWidget(m_status);
    auto* row = new QHBoxLayout;
    auto button = [&](const char* caption, const char* name, void (DLList::*slot)()) {
        auto* b = new QPushButton(QString::fromLatin1(caption), this);
        b->setObjectName(QString::fromLatin1(name));
        connect(b, &QPushButton::clicked, this, slot);
        row->addWidget(b);
        return b;
    };
    m_one = button("Update 1 Day", "cmdUpdate1", &DLList::UpdateOneDay);
    m_all = button("Update All", "cmdUpdateAll", &DLList::UpdateAll);
    m_remove = button("Remove Date", "cmdRemove", &DLList::RemoveDate);
    m_close = new QPushButton(QStringLiteral("Close"), this);
    m_close->setObjectName(QStringLiteral("cmdClose"));
    connect(m_close, &QPushButton::clicked, this, &QDialog::reject);
    row->addWidget(m_close);
    layout->addLayout(row);
    m_form.Build();
    Refill();
    resize(420, 320);
}

void DLList::Refill() {
    m_list->clear();
    for (const auto& item : m_form.items())
        m_list->addItem(QString::fromStdString(item));
    if (m_list->count() > 0) m_list->setCurrentRow(0);
}

// While a run lasts the buttons are off and the status label turns red.
void DLList::Running(bool on) {
    for (auto* b : {m_one, m_all, m_remove, m_close})
        b->setEnabled(!on);
    m_status->setStyleSheet(on ? QStringLiteral("color: red") : QString());
    if (on) m_status->setText(QStringLiteral("Updating ..."));
}

void DLList::UpdateOneDay() {
    if (m_list->currentRow() < 0) return;
    Running(true);
    const auto r = m_form.UpdateOne(m_list->currentRow());
    m_progress.Finish();
    Running(false);
    m_status->setText(QString::fromStdString(app::DownloadListForm::Summary({r})));
    Refill();
}

void DLList::UpdateAll() {
    if (m_list->count() == 0) return;
    Running(true);
    const auto runs = m_form.UpdateAll();
    m_progress.Finish();
    Running(false);
    m_status->setText(QString::fromStdString(app::DownloadListForm::Summary(runs)));
    Refill();
    m_close->setDefault(true);
}

void DLList::RemoveDate() {
    if (m_form.RemoveDate(m_list->currentRow())) Refill();
}

void DLList::done(int result) {
    const bool openList = app::TellItemsAdded(m_session, m_form.listHasNewItems());
    auto* main = qobject_cast<MainWindow*>(parentWidget());
    QDialog::done(result);
    if (openList && main) main->Open("AdjList");
}

} // namespace kori::gui
