#include "gui/widgets/grid_view.h"

#include <QHeaderView>
#include <QPrinter>
#include <QTextDocument>
#include <QTimer>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
} // namespace

GridView::GridView(app::GridModel& model, platform::Dialogs& dialogs, std::string messageTitle,
                   QWidget* parent)
    : QTableWidget(0, model.columnCount(), parent), m_model(model), m_dialogs(dialogs),
      m_title(std::move(messageTitle)) {
    QStringList headers;
    for (const auto& h : m_model.headers())
        headers << Q(h);
    setHorizontalHeaderLabels(headers);
    horizontalHeader()->setStretchLastSection(true);
    verticalHeader()->setDefaultSectionSize(22);
    setSelectionMode(QAbstractItemView::SingleSelection);
    connect(this, &QTableWidget::itemChanged, this, &GridView::CellLeft);
    Refresh();
}

void GridView::Refresh() {
    m_filling = true;
    setRowCount(m_model.rowCount());
    for (int r = 0; r < m_model.rowCount(); ++r)
        for (int c = 0; c < m_model.columnCount(); ++c) {
            QTableWidgetItem* it = item(r, c);
            if (!it) {
                setItem(r, c, new QTableWidgetItem(Q(m_model.cell(r, c))));
            } else if (it->text() != Q(m_model.cell(r, c))) {
                it->setText(Q(m_model.cell(r, c)));
            }
        }
    m_filling = false;
}

void GridView::CellLeft(QTableWidgetItem* it) {
    if (m_filling) return;
    const app::CellVerdict v = m_model.SetCell(it->row(), it->column(), it->text().toStdString());
    emit Edited();
    if (v.Accepted) {
        if (Q(v.Text) != it->text()) {
            m_filling = true;
            it->setText(Q(v.Text));
            m_filling = false;
        }
        return;
    }
    m_dialogs.MsgBox(v.Message, v.Title.empty() ? m_title : v.Title);
    if (v.Revert) { // a column that is not edited shows its text again
        m_filling = true;
        it->setText(Q(v.Text));
        m_filling = false;
        return;
    }
    // The refused cell stays as typed and takes the focus back.
    QTimer::singleShot(0, this, [this, it] {
        setCurrentItem(it);
        editItem(it);
    });
}

void GridView::AddRow() {
    const int at = m_model.InsertRow(currentRow() >= 0 ? currentRow() + 1 : m_model.rowCount());
    m_filling = true;
    insertRow(at);
    for (int c = 0; c < columnCount(); ++c)
        setItem(at, c, new QTableWidgetItem());
    m_filling = false;
    setCurrentCell(at, 0);
    emit Edited();
}

void GridView::DeleteCurrentRow() {
    const int row = currentRow();
    if (!m_model.DeleteRow(row)) return;
    m_filling = true;
    removeRow(row);
    m_filling = false;
    emit Edited();
}

void GridView::ShowRefusal(const app::CellRefusal& r) {
    m_dialogs.MsgBox(r.Message, r.Title.empty() ? m_title : r.Title);
    setCurrentCell(r.Row, r.Column);
}

void GridView::SortBy(int column) {
    if (const auto refused = m_model.SortBy(column)) {
        ShowRefusal(*refused);
        return;
    }
    Refresh();
    emit Edited();
}

bool GridView::CheckAll() {
    if (const auto refused = m_model.FirstRefusal()) {
        ShowRefusal(*refused);
        return false;
    }
    return true;
}

void PrintTable(QPrinter& printer, const QString& caption, const std::vector<std::string>& headers,
                const std::vector<std::vector<std::string>>& rows,
                const std::function<bool(int)>& shown) {
    const auto show = [&](std::size_t c) { return !shown || shown(static_cast<int>(c)); };
    QString html = QStringLiteral("<h3>%1</h3><table border=\"1\" cellspacing=\"0\" "
                                  "cellpadding=\"3\"><tr>")
                       .arg(caption.toHtmlEscaped());
    for (std::size_t c = 0; c < headers.size(); ++c)
        if (show(c)) html += QStringLiteral("<th>%1</th>").arg(Q(headers[c]).toHtmlEscaped());
    html += QStringLiteral("</tr>");
    for (const auto& row : rows) {
        html += QStringLiteral("<tr>");
        for (std::size_t c = 0; c < row.size() && c < headers.size(); ++c)
            if (show(c)) html += QStringLiteral("<td>%1</td>").arg(Q(row[c]).toHtmlEscaped());
        html += QStringLiteral("</tr>");
    }
    html += QStringLiteral("</table>");
    QTextDocument doc;
    doc.setHtml(html);
    doc.print(&printer);
}

void GridView::PrintTo(QPrinter& printer, const QString& caption) const {
    PrintTable(printer, caption, m_model.headers(), m_model.rows());
}

} // namespace kori::gui
