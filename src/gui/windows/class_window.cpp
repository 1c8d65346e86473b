#include "gui/windows/class_window.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "gui/widgets/settings_dialog.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/gics_class.h"
#include "gui/windows/ind_class.h"
#include "platform/text.h"

#include <QLabel>
#include <QMenuBar>
#include <QPrintDialog>
#include <QPrinter>
#include <QVBoxLayout>

#include <algorithm>

namespace kori::gui {

namespace {

// Column 1 holds the class code, formatted to its digits; the text columns take no commas,
// which separate the fields of the file.
app::GridModel::CellCheck ClassCellCheck(int digits) {
    return [digits](int column, const std::string& text) -> app::CellVerdict {
        if (column == 0) {
            const auto formatted = store::CheckClassId(text, digits);
            if (!formatted) return {false, text, "Id must be numeric"};
            return {true, *formatted, {}};
        }
        if (text.find(',') != std::string::npos) return {false, text, "Commas cannot be used"};
        return {true, text, {}};
    };
}

std::vector<std::string> Headers(const QStringList& headers) {
    std::vector<std::string> out;
    for (const auto& h : headers)
        out.push_back(h.toStdString());
    return out;
}

} // namespace

ClassWindow::ClassWindow(app::Session& session, const Kind& kind, bool pick, QWidget* parent)
    : QDialog(parent), m_session(session), m_kind(kind),
      m_model(Headers(kind.headers), ClassCellCheck(kind.digits)), m_pick(pick) {
    setObjectName(QString::fromLatin1(kind.name));
    setWindowTitle(QString::fromLatin1(kind.title));
    KeepWindowPosition(this, session.services().settings, kind.name);

    m_menus = new QMenuBar(this);
    const auto item = [this](const char* caption, const char* name, auto slot) {
        return NamedAction(m_menus, this, caption, name, slot);
    };
    item("&Add Row", "mnuAddRow", [this] { AddRow(); })->setEnabled(!pick);
    item("&Delete Row", "mnuDeleteRow", [this] { DeleteRow(); })->setEnabled(!pick);
    item("&Sort List", "mnuSort", [this] { SortList(); });
    item("&Close", "mnuClose", [this] { reject(); });
    item("&Display", "mnuDisplay", [this] { Display(); });
    if (kind.canPrint) item("&Print", "mnuPrint", [this] { Print(); });

    m_grid = new GridView(m_model, session.dialogs(), kind.msgTitle, this);
    m_grid->setObjectName(QStringLiteral("grdClass"));
    for (int c = 1; c < m_grid->columnCount(); ++c)
        m_grid->setColumnWidth(c, 200);
    m_grid->setColumnWidth(0, 120);
    if (pick) {
        m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
        m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
        connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this](int row, int) {
            const std::string code = platform::Trim(m_model.cell(row, 0));
            if (code.empty()) return;
            m_picked = code;
            accept();
        });
    }
    m_status = new QLabel(this);
    m_status->setObjectName(QStringLiteral("lblStatus"));

    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addWidget(m_grid);
    layout->addWidget(m_status);
    resize(kind.headers.size() > 2 ? 620 : 440, 420);
    Display();
}

QTableWidget* ClassWindow::grid() const {
    return m_grid;
}

void ClassWindow::Display() {
    m_model.Load(store::ReadClassFile(m_session.folders.SystemFolder, m_kind.fileName,
                                      static_cast<std::size_t>(m_model.columnCount())));
    m_grid->Refresh();
    // Said under the grid, so that a Display over an unchanged grid is seen to have run.
    const int n = m_model.rowCount();
    m_status->setText(QStringLiteral("%1 row%2 read from %3")
                          .arg(n)
                          .arg(n == 1 ? "" : "s")
                          .arg(QString::fromLatin1(m_kind.fileName)));
}

void ClassWindow::AddRow() {
    m_grid->AddRow();
}

void ClassWindow::DeleteRow() {
    m_grid->DeleteCurrentRow();
}

void ClassWindow::SortList() {
    // Codes are formatted to one width, so text order is number order.
    m_grid->SortBy(0);
}

bool ClassWindow::SaveChanges() {
    // A pick only reads the file; a sort made to find a row there is not kept.
    if (!m_model.changed() || m_pick) return true;
    if (!m_grid->CheckAll()) return false;
    if (auto s = store::WriteClassFile(m_session.folders.SystemFolder, m_kind.fileName,
                                       m_model.TrimmedRows());
        !s) {
        m_session.dialogs().MsgBox(s.message(), m_kind.msgTitle);
        return false;
    }
    m_model.MarkSaved();
    return true;
}

void ClassWindow::reject() {
    if (!SaveChanges()) return; // the refused cell or the failed write keeps the window open
    QDialog::reject();
}

void ClassWindow::PrintTo(QPrinter& printer) const {
    m_grid->PrintTo(printer, windowTitle());
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
