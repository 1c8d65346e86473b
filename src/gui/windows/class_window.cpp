#include "gui/windows/class_window.h"

#include "gui/widgets/settings_dialog.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/gics_class.h"
#include "gui/windows/ind_class.h"
#include "platform/text.h"

#include <QHeaderView>
#include <QMenuBar>
#include <QPrintDialog>
#include <QPrinter>
#include <QTableWidget>
#include <QTextDocument>
#include <QTimer>
#include <QVBoxLayout>

#include <algorithm>

namespace kori::gui {

ClassWindow::ClassWindow(app::Session& session, const Kind& kind, bool pick, QWidget* parent)
    : QDialog(parent), m_session(session), m_kind(kind), m_pick(pick) {
    setObjectName(QString::fromLatin1(kind.name));
    setWindowTitle(QString::fromLatin1(kind.title));
    KeepWindowPosition(this, session.services().settings, kind.name);

    m_menus = new QMenuBar(this);
    const auto item = [this](const char* caption, const char* name, auto slot) {
        QAction* a = m_menus->addAction(QString::fromLatin1(caption));
        a->setObjectName(QString::fromLatin1(name));
        connect(a, &QAction::triggered, this, slot);
        return a;
    };
    item("&Add Row", "mnuAddRow", [this] { AddRow(); })->setEnabled(!pick);
    item("&Delete Row", "mnuDeleteRow", [this] { DeleteRow(); })->setEnabled(!pick);
    item("&Sort List", "mnuSort", [this] { SortList(); });
    item("&Close", "mnuClose", [this] { reject(); });
    item("&Display", "mnuDisplay", [this] { Display(); });
    if (kind.canPrint) item("&Print", "mnuPrint", [this] { Print(); });

    m_grid = new QTableWidget(0, static_cast<int>(kind.headers.size()), this);
    m_grid->setObjectName(QStringLiteral("grdClass"));
    m_grid->setHorizontalHeaderLabels(kind.headers);
    m_grid->horizontalHeader()->setStretchLastSection(true);
    m_grid->verticalHeader()->setDefaultSectionSize(22);
    m_grid->setSelectionMode(QAbstractItemView::SingleSelection);
    for (int c = 1; c < m_grid->columnCount(); ++c)
        m_grid->setColumnWidth(c, 200);
    m_grid->setColumnWidth(0, 120);
    if (pick) {
        m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
        m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
        connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this](int row, int) {
            const QTableWidgetItem* it = m_grid->item(row, 0);
            const std::string code = it ? platform::Trim(S(it->text())) : std::string();
            if (code.empty()) return;
            m_picked = code;
            accept();
        });
    }
    connect(m_grid, &QTableWidget::itemChanged, this, &ClassWindow::CellLeft);

    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addWidget(m_grid);
    resize(kind.headers.size() > 2 ? 620 : 440, 420);
    Display();
}

void ClassWindow::SetRow(int row, const store::ClassRow& values) {
    for (int c = 0; c < m_grid->columnCount(); ++c) {
        const auto i = static_cast<std::size_t>(c);
        std::string text = i < values.size() ? values[i] : std::string();
        if (c == 0)
            if (auto formatted = store::CheckClassId(text, m_kind.digits)) text = *formatted;
        m_grid->setItem(row, c, new QTableWidgetItem(Q(text)));
    }
}

void ClassWindow::Display() {
    m_filling = true;
    const auto rows = store::ReadClassFile(m_session.folders.SystemFolder, m_kind.fileName,
                                           static_cast<std::size_t>(m_grid->columnCount()));
    m_grid->setRowCount(static_cast<int>(rows.size()));
    for (std::size_t r = 0; r < rows.size(); ++r)
        SetRow(static_cast<int>(r), rows[r]);
    m_filling = false;
    m_changed = false;
}

bool ClassWindow::CheckCell(int row, int column, bool report) {
    QTableWidgetItem* it = m_grid->item(row, column);
    if (!it) return true;
    const std::string text = S(it->text());
    if (column == 0) {
        const auto formatted = store::CheckClassId(text, m_kind.digits);
        if (!formatted) {
            if (report) m_session.dialogs().MsgBox("Id must be numeric", m_kind.msgTitle);
            return false;
        }
        if (Q(*formatted) != it->text()) {
            m_filling = true;
            it->setText(Q(*formatted));
            m_filling = false;
        }
        return true;
    }
    if (text.find(',') != std::string::npos) {
        if (report) m_session.dialogs().MsgBox("Commas cannot be used", m_kind.msgTitle);
        return false;
    }
    return true;
}

void ClassWindow::CellLeft(QTableWidgetItem* item) {
    if (m_filling) return;
    m_changed = true;
    if (CheckCell(item->row(), item->column(), true)) return;
    // The refused cell stays as typed and takes the focus back.
    QTimer::singleShot(0, m_grid, [grid = m_grid, item] {
        grid->setCurrentItem(item);
        grid->editItem(item);
    });
}

void ClassWindow::AddRow() {
    const int at = m_grid->currentRow() >= 0 ? m_grid->currentRow() + 1 : m_grid->rowCount();
    m_filling = true;
    m_grid->insertRow(at);
    SetRow(at, {});
    m_filling = false;
    m_grid->setCurrentCell(at, 0);
}

void ClassWindow::DeleteRow() {
    const int row = m_grid->currentRow();
    if (row < 0) return;
    m_grid->removeRow(row);
    m_changed = true;
}

std::optional<std::vector<store::ClassRow>> ClassWindow::Rows() {
    std::vector<store::ClassRow> rows;
    for (int r = 0; r < m_grid->rowCount(); ++r) {
        store::ClassRow row;
        for (int c = 0; c < m_grid->columnCount(); ++c) {
            if (!CheckCell(r, c, true)) {
                m_grid->setCurrentCell(r, c);
                return std::nullopt;
            }
            const QTableWidgetItem* it = m_grid->item(r, c);
            row.push_back(it ? platform::Trim(S(it->text())) : std::string());
        }
        rows.push_back(std::move(row));
    }
    return rows;
}

void ClassWindow::SortList() {
    const auto rows = Rows();
    if (!rows) return;
    auto sorted = *rows;
    // Codes are formatted to one width, so text order is number order.
    std::stable_sort(sorted.begin(), sorted.end(), [](const auto& a, const auto& b) {
        if (a[0].empty() != b[0].empty()) return b[0].empty();
        return a[0] < b[0];
    });
    m_filling = true;
    for (std::size_t r = 0; r < sorted.size(); ++r)
        SetRow(static_cast<int>(r), sorted[r]);
    m_filling = false;
    if (sorted != *rows) m_changed = true;
}

bool ClassWindow::SaveChanges() {
    // A pick only reads the file; a sort made to find a row there is not kept.
    if (!m_changed || m_pick) return true;
    const auto rows = Rows();
    if (!rows) return false;
    if (auto s = store::WriteClassFile(m_session.folders.SystemFolder, m_kind.fileName, *rows);
        !s) {
        m_session.dialogs().MsgBox(s.message(), m_kind.msgTitle);
        return false;
    }
    m_changed = false;
    return true;
}

void ClassWindow::reject() {
    if (!SaveChanges()) return; // the refused cell or the failed write keeps the window open
    QDialog::reject();
}

void ClassWindow::PrintTo(QPrinter& printer) const {
    QString html = QStringLiteral("<h3>%1</h3><table border=\"1\" cellspacing=\"0\" "
                                  "cellpadding=\"3\"><tr>")
                       .arg(windowTitle().toHtmlEscaped());
    for (const auto& h : m_kind.headers)
        html += QStringLiteral("<th>%1</th>").arg(h.toHtmlEscaped());
    html += QStringLiteral("</tr>");
    for (int r = 0; r < m_grid->rowCount(); ++r) {
        html += QStringLiteral("<tr>");
        for (int c = 0; c < m_grid->columnCount(); ++c) {
            const QTableWidgetItem* it = m_grid->item(r, c);
            html += QStringLiteral("<td>%1</td>").arg(it ? it->text().toHtmlEscaped() : QString());
        }
        html += QStringLiteral("</tr>");
    }
    html += QStringLiteral("</table>");
    QTextDocument doc;
    doc.setHtml(html);
    doc.print(&printer);
}

void ClassWindow::Print() {
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, this);
    if (dialog.exec() == QDialog::Accepted) PrintTo(printer);
}

std::optional<std::string> PickClass(app::Session& session, bool gics, QWidget* parent) {
    std::unique_ptr<ClassWindow> w;
    if (gics)
        w = std::make_unique<GicsClass>(session, true, parent);
    else
        w = std::make_unique<IndClass>(session, true, parent);
    w->exec();
    return w->picked();
}

} // namespace kori::gui
