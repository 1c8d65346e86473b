#include "gui/windows/name_data.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"

#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QPrintDialog>
#include <QPrinter>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

NameData::NameData(app::Session& session, QtProgress& progress, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress), m_form(session),
      m_model(m_form.Report()) {
    setObjectName(QStringLiteral("NameData"));
    setWindowTitle(QString::fromLatin1(app::kNameDataTitle));
    auto* layout = new QVBoxLayout(this);
    m_summary = new QLabel(this);
    m_summary->setObjectName(QStringLiteral("lblSummary"));
    m_summary->setWordWrap(true);
    layout->addWidget(m_summary);
    m_grid = new GridView(m_model, session.dialogs(), app::kNameDataTitle, this);
    m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_grid->horizontalHeader()->setStretchLastSection(true);
    layout->addWidget(m_grid, 1);

    auto* buttons = new QDialogButtonBox(this);
    auto add = [&](const char* caption, const char* name, auto slot) {
        return NamedButton(buttons, this, caption, name, slot);
    };
    m_add = add("&Add Missing Name Records", "cmdAdd", [this] { AddMissing(); });
    m_remove = add("&Remove Entries Without Data", "cmdRemove", [this] { RemoveWithoutData(); });
    add("&Print", "cmdPrint", [this] { Print(); });
    add("Close", "cmdClose", [this] { close(); });
    layout->addWidget(buttons);
    resize(760, 440);
    m_form.Check();
    Show();
}

void NameData::Show() {
    m_model = m_form.Report();
    m_grid->Refresh();
    m_grid->resizeColumnsToContents();
    m_summary->setText(QString::fromStdString(m_form.Summary()));
    m_add->setEnabled(m_form.Missing() > 0);
    m_remove->setEnabled(m_form.WithoutData() > 0);
}

void NameData::AddMissing() {
    m_progress.ResetCancel();
    m_form.AddMissing(m_progress);
    m_progress.Finish();
    Show();
}

void NameData::RemoveWithoutData() {
    m_progress.ResetCancel();
    m_form.RemoveWithoutData(m_progress);
    m_progress.Finish();
    Show();
}

void NameData::Print() {
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, this);
    if (dialog.exec() == QDialog::Accepted) m_grid->PrintTo(printer, windowTitle());
}

} // namespace kori::gui
