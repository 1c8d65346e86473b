#include "gui/windows/chk_dta.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "platform/files.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFileDialog>
#include <QFormLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPrintDialog>
#include <QPrinter>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {

QString Text(const std::string& s) {
    return QString::fromStdString(s);
}

} // namespace

DataStat::DataStat(app::Session& session, const maint::DataCheckResult& result,
                   ShowChartAt showChart, QWidget* parent)
    : QDialog(parent), m_session(session), m_findings(result.Findings),
      m_model(app::DataCheckForm::Report(result.Findings)), m_showChart(std::move(showChart)) {
    setObjectName(QStringLiteral("DataStat"));
    setWindowTitle(QStringLiteral("Check Data for Errors and Stocks Stopped Trading"));
    auto* layout = new QVBoxLayout(this);
    auto* summary = new QLabel(Text(app::DataCheckForm::Summary(result)), this);
    summary->setObjectName(QStringLiteral("lblSummary"));
    layout->addWidget(summary);
    m_grid = new GridView(m_model, session.dialogs(), app::kDataCheckTitle, this);
    m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_grid->Refresh();
    m_grid->horizontalHeader()->setStretchLastSection(true);
    m_grid->resizeColumnsToContents();
    layout->addWidget(m_grid, 1);
    connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this] { ShowChart(); });

    auto* buttons = new QDialogButtonBox(this);
    auto add = [&](const char* caption, const char* name, auto slot) {
        return NamedButton(buttons, this, caption, name, slot);
    };
    add("Show &Chart", "cmdChart", [this] { ShowChart(); });
    add("&Export CSV ...", "cmdExport", [this] { ChooseExportFile(); });
    add("&Print", "cmdPrint", [this] { Print(); });
    add("Close", "cmdClose", [this] { close(); });
    layout->addWidget(buttons);
    resize(900, 520);
}

void DataStat::ShowChart() {
    const int row = m_grid->currentRow();
    if (row < 0 || row >= static_cast<int>(m_findings.size()) || !m_showChart) return;
    const auto& f = m_findings[static_cast<std::size_t>(row)];
    m_showChart(f.Code, f.Date);
}

bool DataStat::ExportCsv(const std::string& path) {
    if (auto s = platform::WriteFileAtomic(path, maint::FindingsCsv(m_findings)); !s) {
        m_session.dialogs().MsgBox(s.message(), app::kDataCheckTitle);
        return false;
    }
    return true;
}

void DataStat::ChooseExportFile() {
    const QString file =
        QFileDialog::getSaveFileName(this, QStringLiteral("Export the report"),
                                     Text(m_session.folders.SystemFolder + "DataCheck.csv"),
                                     QStringLiteral("CSV files (*.csv)"));
    if (!file.isEmpty()) ExportCsv(file.toStdString());
}

void DataStat::Print() {
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, this);
    if (dialog.exec() == QDialog::Accepted) m_grid->PrintTo(printer, windowTitle());
}

ChkDta::ChkDta(app::Session& session, QtProgress& progress, ShowChartAt showChart, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress), m_showChart(std::move(showChart)),
      m_form(session) {
    setObjectName(QStringLiteral("ChkDta"));
    setWindowTitle(QStringLiteral("Check Data for Errors and Stocks Stopped Trading"));
    auto* layout = new QVBoxLayout(this);
    auto* form = new QFormLayout;
    m_list = new QComboBox(this);
    m_list->setObjectName(QStringLiteral("cboList"));
    for (const auto& c : m_form.listCaptions())
        m_list->addItem(Text(c));
    form->addRow(QStringLiteral("Securities"), m_list);
    auto edit = [&](const char* name, const std::string& text, const char* label) {
        auto* e = new QLineEdit(Text(text), this);
        e->setObjectName(QString::fromLatin1(name));
        e->setMaximumWidth(90);
        form->addRow(QString::fromLatin1(label), e);
        return e;
    };
    m_gap = edit("txtGap", m_form.GapText, "Gap: more weekdays than");
    m_stopped = edit("txtStopped", m_form.StoppedText, "Stopped: last record more weekdays than");
    m_move = edit("txtMove", m_form.MoveText, "Missed adjustment: overnight move above %");
    layout->addLayout(form);
    auto* note = new QLabel(
        QStringLiteral("Every price file of the list is read and checked for dates out of "
                       "order, duplicated or on weekends, impossible prices and volumes, gaps, "
                       "securities that stopped trading and moves without an adjustment."),
        this);
    note->setWordWrap(true);
    layout->addWidget(note);
    m_status = new QLabel(this);
    m_status->setObjectName(QStringLiteral("lblStatus"));
    layout->addWidget(m_status);
    auto* buttons = new QDialogButtonBox(this);
    auto* check = buttons->addButton(QStringLiteral("&Check"), QDialogButtonBox::AcceptRole);
    check->setObjectName(QStringLiteral("cmdCheck"));
    auto* close = buttons->addButton(QStringLiteral("Close"), QDialogButtonBox::RejectRole);
    close->setObjectName(QStringLiteral("cmdClose"));
    connect(check, &QPushButton::clicked, this, [this] { Check(); });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    layout->addWidget(buttons);
}

DataStat* ChkDta::Check() {
    m_form.ListIndex = m_list->currentIndex();
    m_form.GapText = m_gap->text().toStdString();
    m_form.StoppedText = m_stopped->text().toStdString();
    m_form.MoveText = m_move->text().toStdString();
    if (auto why = m_form.Refusal()) {
        m_session.dialogs().MsgBox(*why, app::kDataCheckTitle);
        return nullptr;
    }
    setEnabled(false);
    m_progress.ResetCancel();
    const auto result = m_form.Run(m_progress);
    m_progress.Finish();
    setEnabled(true);
    if (!result.Status) {
        m_session.dialogs().MsgBox(result.Status.message(), app::kDataCheckTitle);
        return nullptr;
    }
    m_status->setText(Text(app::DataCheckForm::Summary(result)));
    auto* report = new DataStat(m_session, result, m_showChart, parentWidget());
    report->setAttribute(Qt::WA_DeleteOnClose);
    report->show();
    accept();
    return report;
}

} // namespace kori::gui
