#include "gui/windows/fundmnt.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "gui/widgets/window_place.h"
#include "platform/text.h"

#include <QApplication>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QPrintDialog>
#include <QPrinter>
#include <QSpinBox>
#include <QTableWidget>
#include <QVBoxLayout>

#include <algorithm>

namespace kori::gui {

namespace {

QString Q(const std::string& s) {
    return QString::fromLatin1(s.data(), static_cast<qsizetype>(s.size()));
}

constexpr const char* kDetailsSection = "ASX Details";

} // namespace

Fundmnt::Fundmnt(app::Session& session, QWidget* parent)
    : QDialog(parent), m_session(session), m_form(session) {
    setObjectName(QStringLiteral("Fundmnt"));
    setWindowTitle(QString::fromLatin1(app::FundamentalsForm::kTitle));
    KeepWindowPosition(this, session.services().settings, kDetailsSection);
    m_menus = new QMenuBar(this);
    const auto item = [this](QMenu* menu, const char* caption, const char* name, auto slot) {
        return NamedAction(menu, this, caption, name, slot);
    };
    QMenu* file = m_menus->addMenu(QStringLiteral("&File"));
    item(file, "&Print", "mnPrint", [this] {
        QPrinter printer(QPrinter::HighResolution);
        printer.setPageOrientation(QPageLayout::Landscape);
        QPrintDialog dialog(&printer, this);
        if (dialog.exec() == QDialog::Accepted) PrintTo(printer);
    });
    item(file, "&Close", "mnClose", [this] { reject(); });
    QMenu* show = m_menus->addMenu(QStringLiteral("&Options"));
    item(show, "Show Current Price,PE Ratio,Yield and GICS", "mnYCP", [this] { ShowFigures(); });
    item(show, "Show Industry Groups/Classifications", "mnInGrp", [this] {
        QApplication::setOverrideCursor(Qt::WaitCursor);
        m_form.ShowIndustryClasses();
        QApplication::restoreOverrideCursor();
        Fill();
    });
    item(show, "Add Highlighted Stocks to Scan Results List", "mnScanList",
         [this] { m_form.AddToScanList(SelectedRows()); });
    item(show, "Update Name File (Other Details)", "mnUpName", [this] { m_form.BeginTransfer(); });
    item(show, "Change Display Size", "mnSize", [this] {
        auto* w = new F1Size(*this, m_table->font().pointSize());
        w->setAttribute(Qt::WA_DeleteOnClose);
        w->open();
    });
    item(show, "Show All Columns", "mnShowAll", [this] { ShowAllColumns(); });
    item(show, "Hide Current Column", "mnHide", [this] { HideCurrentColumn(); });

    m_table = new QTableWidget(this);
    m_table->setObjectName(QStringLiteral("grdDetails"));
    m_table->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_table->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_table->setSelectionMode(QAbstractItemView::ExtendedSelection);
    connect(m_table->horizontalHeader(), &QHeaderView::sectionClicked, this, [this](int column) {
        if (!m_form.transferPending()) return;
        QApplication::setOverrideCursor(Qt::WaitCursor);
        const int changed = m_form.HeadingClicked(column);
        QApplication::restoreOverrideCursor();
        if (changed >= 0)
            m_session.dialogs().MsgBox(std::to_string(changed) + " name records updated",
                                       app::FundamentalsForm::kTransferTitle);
    });
    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addWidget(m_table);
    resize(900, 520);

    QApplication::setOverrideCursor(Qt::WaitCursor);
    m_loaded = m_form.Load();
    QApplication::restoreOverrideCursor();
    const int points = static_cast<int>(platform::Val(
        session.services().settings.Get(platform::kAppName, kDetailsSection, "FontSize", "0")));
    if (points > 0) SetDisplaySize(points);
    Fill();
}

void Fundmnt::Fill() {
    const auto& headers = m_form.headers();
    const auto& rows = m_form.rows();
    m_table->clear();
    m_table->setColumnCount(static_cast<int>(headers.size()));
    m_table->setRowCount(static_cast<int>(rows.size()));
    QStringList labels;
    for (const auto& h : headers)
        labels << Q(h);
    m_table->setHorizontalHeaderLabels(labels);
    for (int r = 0; r < static_cast<int>(rows.size()); ++r) {
        const auto& row = rows[static_cast<std::size_t>(r)];
        for (int c = 0; c < static_cast<int>(row.size()); ++c)
            m_table->setItem(r, c, new QTableWidgetItem(Q(row[static_cast<std::size_t>(c)])));
    }
    for (int c = 0; c < m_table->columnCount(); ++c)
        m_table->setColumnHidden(c, m_form.hidden(c));
}

std::vector<int> Fundmnt::SelectedRows() const {
    std::vector<int> rows;
    for (const QModelIndex& i : m_table->selectionModel()->selectedRows())
        rows.push_back(i.row());
    std::sort(rows.begin(), rows.end());
    return rows;
}

void Fundmnt::PrintTo(QPrinter& printer) const {
    PrintTable(printer, windowTitle(), m_form.headers(), m_form.rows(),
               [this](int c) { return !m_form.hidden(c); });
}

void Fundmnt::ShowFigures() {
    QApplication::setOverrideCursor(Qt::WaitCursor);
    m_form.ShowFigures();
    QApplication::restoreOverrideCursor();
    Fill();
}

void Fundmnt::HideCurrentColumn() {
    m_form.HideColumn(m_table->currentColumn());
    Fill();
}

void Fundmnt::ShowAllColumns() {
    m_form.ShowAllColumns();
    Fill();
}

void Fundmnt::SetDisplaySize(int points) {
    QFont f = m_table->font();
    f.setPointSize(points);
    m_table->setFont(f);
    m_table->resizeRowsToContents();
    m_session.services().settings.Save(platform::kAppName, kDetailsSection, "FontSize",
                                       std::to_string(points));
}

F1Size::F1Size(Fundmnt& table, int points) : QDialog(&table) {
    setObjectName(QStringLiteral("F1Size"));
    setWindowTitle(QStringLiteral("Change Display Size"));
    m_size = new QSpinBox(this);
    m_size->setObjectName(QStringLiteral("txtSize"));
    m_size->setRange(6, 20);
    m_size->setValue(points);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, [this, &table] {
        table.SetDisplaySize(m_size->value());
        accept();
    });
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(new QLabel(QStringLiteral("Point size of the table"), this));
    layout->addWidget(m_size);
    layout->addWidget(buttons);
}

} // namespace kori::gui
