#include "gui/windows/snapshot.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "platform/files.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFileDialog>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

Snapshot::Snapshot(app::Session& session, QtProgress& progress, ShowChartAt showChart,
                   QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress), m_showChart(std::move(showChart)),
      m_form(session), m_model(m_form.Grid()) {
    setObjectName(QStringLiteral("Snapshot"));
    setWindowTitle(QString::fromLatin1(app::kSnapshotTitle));
    auto* layout = new QVBoxLayout(this);
    auto* top = new QHBoxLayout;
    top->addWidget(new QLabel(QStringLiteral("Securities"), this));
    m_list = new QComboBox(this);
    m_list->setObjectName(QStringLiteral("cboList"));
    for (const auto& c : m_form.listCaptions())
        m_list->addItem(QString::fromStdString(c));
    top->addWidget(m_list, 1);
    auto* take = new QPushButton(QStringLiteral("&Take Snapshot"), this);
    take->setObjectName(QStringLiteral("cmdTake"));
    take->setDefault(true);
    connect(take, &QPushButton::clicked, this, [this] { Take(); });
    top->addWidget(take);
    layout->addLayout(top);
    m_breadth = new QLabel(this);
    m_breadth->setObjectName(QStringLiteral("lblBreadth"));
    layout->addWidget(m_breadth);
    m_grid = new GridView(m_model, session.dialogs(), app::kSnapshotTitle, this);
    m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_grid->horizontalHeader()->setSectionsClickable(true);
    connect(m_grid->horizontalHeader(), &QHeaderView::sectionClicked, this,
            [this](int column) { SortBy(column); });
    connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this] { ShowChart(); });
    layout->addWidget(m_grid, 1);
    auto* buttons = new QDialogButtonBox(this);
    auto add = [&](const char* caption, const char* name, auto slot) {
        return NamedButton(buttons, this, caption, name, slot);
    };
    add("Show &Chart", "cmdChart", [this] { ShowChart(); });
    add("&Export CSV ...", "cmdExport", [this] { ChooseExportFile(); });
    add("Close", "cmdClose", [this] { close(); });
    layout->addWidget(buttons);
    resize(980, 560);
}

void Snapshot::Take() {
    m_form.ListIndex = m_list->currentIndex();
    setEnabled(false);
    m_progress.ResetCancel();
    const auto& result = m_form.Run(m_progress);
    m_progress.Finish();
    setEnabled(true);
    if (!result.Status) {
        m_session.dialogs().MsgBox(result.Status.message(), app::kSnapshotTitle);
        return;
    }
    Show();
}

void Snapshot::Show() {
    m_model = m_form.Grid();
    m_grid->Refresh();
    m_grid->resizeColumnsToContents();
    std::string line = m_form.BreadthLine();
    if (m_form.result().Cancelled) line += "   (cancelled before the end of the list)";
    m_breadth->setText(QString::fromStdString(line));
}

void Snapshot::SortBy(int column) {
    m_form.Sort(column);
    Show();
}

void Snapshot::ShowChart() {
    const int row = m_grid->currentRow();
    const auto& rows = m_form.result().Rows;
    if (row < 0 || row >= static_cast<int>(rows.size()) || !m_showChart) return;
    const auto& r = rows[static_cast<std::size_t>(row)];
    m_showChart(r.Code, r.Date);
}

bool Snapshot::ExportCsv(const std::string& path) {
    if (auto s = platform::WriteFileAtomic(path, m_form.Csv()); !s) {
        m_session.dialogs().MsgBox(s.message(), app::kSnapshotTitle);
        return false;
    }
    return true;
}

void Snapshot::ChooseExportFile() {
    const QString file = QFileDialog::getSaveFileName(
        this, QStringLiteral("Export the snapshot"),
        QString::fromStdString(m_session.folders.SystemFolder + "Snapshot.csv"),
        QStringLiteral("CSV files (*.csv)"));
    if (!file.isEmpty()) ExportCsv(file.toStdString());
}

} // namespace kori::gui
