#include "gui/windows/adj_list.h"

#include "gui/services/qt_progress.h"
#include "gui/windows/main_window.h"
#include "gui/windows/show_once.h"

#include <QApplication>
#include <QButtonGroup>
#include <QCheckBox>
#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QPageSetupDialog>
#include <QPainter>
#include <QPrintDialog>
#include <QRadioButton>
#include <QTableWidget>
#include <QVBoxLayout>

namespace kori::gui {

namespace {

QString Q(std::string_view s) {
    return QString::fromStdString(std::string(s));
}

} // namespace

AdjList::AdjList(app::Session& session, QtProgress& progress, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress), m_form(session) {
    setObjectName(QStringLiteral("AdjList"));
    setWindowTitle(Q(app::kAdjListCaption));
    auto* layout = new QVBoxLayout(this);
    m_menus = new QMenuBar(this);
    layout->setMenuBar(m_menus);

    auto add = [this](QMenu* menu, const char* name, const char* caption, auto slot) {
        auto* a = menu->addAction(QString::fromLatin1(caption));
        a->setObjectName(QString::fromLatin1(name));
        connect(a, &QAction::triggered, this, slot);
        return a;
    };
    auto* file = m_menus->addMenu(QStringLiteral("&File"));
    add(file, "alSave", "&Save", [this] {
        if (auto st = m_form.Save(); !st) m_session.dialogs().MsgBox(st.message(), "Save");
    });
    add(file, "alPage", "Pa&ge Setup", [this] { QPageSetupDialog(&m_printer, this).exec(); });
    add(file, "alPrint", "&Print", [this] {
        QPrintDialog dialog(&m_printer, this);
        if (dialog.exec() == QDialog::Accepted && !PrintTo(m_printer))
            m_session.dialogs().MsgBox("The printer could not be started", "Print");
    });
    add(file, "alExit", "E&xit", [this] { close(); });
    auto* edit = m_menus->addMenu(QStringLiteral("&Edit"));
    add(edit, "alSort", "&Sort", [this] {
        QApplication::setOverrideCursor(Qt::WaitCursor);
        m_status->setText(Q(app::kSorting));
        m_form.Sort();
        m_progress.Finish();
        Refill();
        QApplication::restoreOverrideCursor();
    });
    add(edit, "alSetY", "Set all ADJ items to Y", [this] {
        m_form.SetAll("Y");
        Refill();
    });
    add(edit, "alSetN", "Set all ADJ items to N", [this] {
        m_form.SetAll("N");
        Refill();
    });
    add(edit, "alSetD", "Set all ADJ items to D", [this] {
        m_form.SetAll("D");
        Refill();
    });
    add(edit, "rmOPTS", "Remove ASX.OPT and OPT from list", [this] {
        m_form.RemoveTag("OPT");
        Refill();
    });
    add(edit, "rmWNT", "Remove ASX.WNT and WNT from list", [this] {
        m_form.RemoveTag("WNT");
        Refill();
    });
    add(edit, "alDelRow", "&Delete Rows", [this] { DeleteRows(); });
    auto* options = m_menus->addAction(QStringLiteral("&Options"));
    options->setObjectName(QStringLiteral("alopt"));
    connect(options, &QAction::triggered, this, [this] {
        AdjOpts opts(m_session, this);
        opts.exec();
    });
    auto* display = m_menus->addAction(QStringLiteral("&Display"));
    display->setObjectName(QStringLiteral("alDisplay"));
    connect(display, &QAction::triggered, this, [this] {
        m_form.Load();
        Refill();
    });
    auto* make = m_menus->addAction(QStringLiteral("MAKE ADJUSTMENTS"));
    make->setObjectName(QStringLiteral("muAdj"));
    connect(make, &QAction::triggered, this, &AdjList::MakeAdjustments);
    auto* remove = m_menus->addAction(QStringLiteral("Remove Items Marked D"));
    remove->setObjectName(QStringLiteral("muRemAdj"));
    connect(remove, &QAction::triggered, this, &AdjList::RemoveMarkedD);

    m_label = new QLabel(this);
    m_label->setObjectName(QStringLiteral("Label1"));
    layout->addWidget(m_label);
    m_grid = new QTableWidget(0, app::kListColumns, this);
    m_grid->setObjectName(QStringLiteral("Grid1"));
    QStringList headings;
    for (int c = 0; c < app::kListColumns; ++c)
        headings << Q(app::ListHeading(c));
    m_grid->setHorizontalHeaderLabels(headings);
    m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    connect(m_grid, &QTableWidget::cellChanged, this, &AdjList::CellEdited);
    layout->addWidget(m_grid, 1);
    m_status = new QLabel(this);
    m_status->setObjectName(QStringLiteral("lblStatus"));
    layout->addWidget(m_status);
    m_loaded = m_form.Load();
    Refill();
    resize(760, 480);
}

void AdjList::Refill() {
    m_filling = true;
    const auto& items = m_form.items();
    m_grid->setRowCount(static_cast<int>(items.size()));
    for (int r = 0; r < static_cast<int>(items.size()); ++r)
        for (int c = 0; c < app::kListColumns; ++c)
            m_grid->setItem(r, c, new QTableWidgetItem(Q(m_form.Cell(r, c))));
    m_grid->resizeColumnsToContents();
    m_label->setText(Q(m_form.Label()));
    m_filling = false;
}

void AdjList::CellEdited(int row, int column) {
    if (m_filling) return;
    const auto* item = m_grid->item(row, column);
    const std::string typed = item ? item->text().toStdString() : std::string();
    m_form.SetCell(row, column, typed);
    // The cell shows what the list holds: the typed value, or the old one when refused.
    m_filling = true;
    if (auto* cell = m_grid->item(row, column)) cell->setText(Q(m_form.Cell(row, column)));
    m_filling = false;
}

void AdjList::MakeAdjustments() {
    if (m_form.items().empty()) return;
    QApplication::setOverrideCursor(Qt::WaitCursor);
    setEnabled(false);
    adjust::MakeReport report;
    const auto st = m_form.Make(report, [this](std::size_t row) {
        if (static_cast<int>(row) < m_grid->rowCount())
            m_grid->scrollToItem(m_grid->item(static_cast<int>(row), 0));
        m_status->setText(QStringLiteral("Row %1").arg(row + 1));
        QApplication::processEvents();
    });
    m_progress.Finish();
    setEnabled(true);
    QApplication::restoreOverrideCursor();
    Refill();
    std::string shown;
    for (const auto& m : report.Messages)
        shown += m + "\n";
    m_status->setText(Q(shown.empty() ? std::string("No adjustments were made") : shown));
    if (!st) m_session.dialogs().MsgBox(st.message(), app::kAdjListCaption);
}

bool AdjList::PrintTo(QPrinter& printer) {
    QPainter painter;
    if (!painter.begin(&printer)) return false;
    painter.setFont(QFont(QStringLiteral("Courier New"), 9));
    const int line = painter.fontMetrics().lineSpacing();
    const QRect page = painter.viewport();
    int y = line;
    auto put = [&](const QString& text) {
        if (y + line > page.height()) {
            printer.newPage();
            y = line;
        }
        painter.drawText(0, y, text);
        y += line;
    };
    put(Q(app::kAdjListCaption));
    put(QString());
    for (const auto& item : m_form.items())
        put(Q(item.Line()));
    return painter.end();
}

void AdjList::RemoveMarkedD() {
    if (auto st = m_form.RemoveMarkedD(); !st)
        m_session.dialogs().MsgBox(st.message(), app::kAdjListCaption);
    Refill();
}

void AdjList::DeleteRows() {
    const auto ranges = m_grid->selectedRanges();
    int first = m_grid->currentRow(), last = first;
    if (!ranges.isEmpty()) {
        first = ranges.front().topRow();
        last = ranges.front().bottomRow();
    }
    if (first < 0) return;
    if (m_form.DeleteRows(first, last)) Refill();
}

void AdjList::closeEvent(QCloseEvent* e) {
    bool process = false;
    if (!m_form.QueryClose(process)) {
        e->ignore();
        return;
    }
    if (process) MakeAdjustments();
    e->accept();
}

void AdjList::reject() {
    close();
}

AdjOpts::AdjOpts(app::Session& session, QWidget* parent) : QDialog(parent), m_session(session) {
    setObjectName(QStringLiteral("AdjOpts"));
    setWindowTitle(Q(app::AdjustmentOptionsForm::kCaption));
    auto* layout = new QVBoxLayout(this);
    m_divs = new QButtonGroup(this);
    const auto form = app::AdjustmentOptionsForm::Read(session);
    const auto choices = app::AdjustmentOptionsForm::DivsChoices();
    for (int i = 0; i < static_cast<int>(choices.size()); ++i) {
        auto* b = new QRadioButton(Q(choices[static_cast<std::size_t>(i)]), this);
        b->setObjectName(QStringLiteral("optDivs%1").arg(i + 1));
        m_divs->addButton(b, i + 1);
        b->setChecked(form.Divs == i + 1);
        layout->addWidget(b);
    }
    m_noShort = new QCheckBox(Q(app::AdjustmentOptionsForm::kNoShortNamesText), this);
    m_noShort->setObjectName(QStringLiteral("chkNoShortNames"));
    m_noShort->setChecked(form.NoShortNames);
    layout->addWidget(m_noShort);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, [this] {
        Save();
        accept();
    });
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    layout->addWidget(buttons);
}

void AdjOpts::Save() {
    app::AdjustmentOptionsForm form;
    form.Divs = m_divs->checkedId() >= 1 ? m_divs->checkedId() : 1;
    form.NoShortNames = m_noShort->isChecked();
    form.Save(m_session);
}

void RegisterAdjListWindows(MainWindow& main) {
    main.SetAction("AdjList", [&main] {
        ShowOnce(main, "AdjList",
                 [&] { return new AdjList(main.session(), main.progress(), &main); });
    });
    main.SetAction("AdjOpts", [&main] {
        ShowOnce(main, "AdjOpts", [&] { return new AdjOpts(main.session(), &main); });
    });
}

} // namespace kori::gui
