#include "gui/windows/watchlist.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/window_place.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"

#include <QComboBox>
#include <QFileDialog>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QHideEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {

QPushButton* Button(QWidget* parent, const char* caption, const char* name) {
    auto* b = new QPushButton(QString::fromLatin1(caption), parent);
    b->setObjectName(QString::fromLatin1(name));
    return b;
}

QLineEdit* Field(QWidget* parent, const char* name, const char* placeholder, int width) {
    auto* e = new QLineEdit(parent);
    e->setObjectName(QString::fromLatin1(name));
    e->setPlaceholderText(QString::fromLatin1(placeholder));
    if (width > 0) e->setMaximumWidth(width);
    return e;
}

} // namespace

Watchlist::Watchlist(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : QDialog(parent), m_session(session), m_showChart(std::move(showChart)), m_form(session),
      m_model(m_form.Grid()) {
    setObjectName(QStringLiteral("Watchlist"));
    setWindowTitle(QString::fromLatin1(app::kWatchlistTitle));
    auto* layout = new QVBoxLayout(this);

    auto* top = new QHBoxLayout;
    top->addWidget(new QLabel(QStringLiteral("List"), this));
    m_list = new QComboBox(this);
    m_list->setObjectName(QStringLiteral("cboList"));
    top->addWidget(m_list, 1);
    const std::pair<const char*, const char*> listButtons[] = {{"&New List ...", "cmdNewList"},
                                                               {"Re&name ...", "cmdRename"},
                                                               {"&Delete List", "cmdDelete"}};
    for (const auto& [caption, name] : listButtons) {
        auto* b = Button(this, caption, name);
        top->addWidget(b);
        connect(b, &QPushButton::clicked, this, [this, n = std::string(name)] {
            if (n == "cmdNewList")
                NewList();
            else if (n == "cmdRename")
                RenameList();
            else
                DeleteList();
        });
    }
    layout->addLayout(top);

    m_issues = new QLabel(this);
    m_issues->setObjectName(QStringLiteral("lblIssues"));
    m_issues->setWordWrap(true);
    layout->addWidget(m_issues);

    m_grid = new GridView(m_model, session.dialogs(), app::kWatchlistTitle, this);
    m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_grid->horizontalHeader()->setSectionsClickable(true);
    connect(m_grid->horizontalHeader(), &QHeaderView::sectionClicked, this,
            [this](int column) { SortBy(column); });
    connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this] { ShowChart(); });
    layout->addWidget(m_grid, 1);

    // The row to add: only the code is needed.
    auto* add = new QHBoxLayout;
    m_code = Field(this, "txtCode", "Code", 70);
    m_price = Field(this, "txtPrice", "Entry price", 90);
    m_date = Field(this, "txtDate", "Entry date", 90);
    m_quantity = Field(this, "txtQuantity", "Quantity", 80);
    m_note = Field(this, "txtNote", "Note", 0);
    for (auto* e : {m_code, m_price, m_date, m_quantity})
        add->addWidget(e);
    add->addWidget(m_note, 1);
    auto* addButton = Button(this, "&Add", "cmdAdd");
    connect(addButton, &QPushButton::clicked, this, [this] { AddTyped(); });
    connect(m_code, &QLineEdit::returnPressed, this, [this] { AddTyped(); });
    add->addWidget(addButton);
    layout->addLayout(add);

    auto* bottom = new QHBoxLayout;
    const std::pair<const char*, const char*> rowButtons[] = {{"&Remove", "cmdRemove"},
                                                              {"Show &Chart", "cmdChart"},
                                                              {"Re&fresh", "cmdRefresh"},
                                                              {"&Export CSV ...", "cmdExport"}};
    for (const auto& [caption, name] : rowButtons) {
        auto* b = Button(this, caption, name);
        bottom->addWidget(b);
        connect(b, &QPushButton::clicked, this, [this, n = std::string(name)] {
            if (n == "cmdRemove")
                RemoveCurrent();
            else if (n == "cmdChart")
                ShowChart();
            else if (n == "cmdRefresh") {
                m_form.Refresh();
                Show();
            } else {
                const QString file = QFileDialog::getSaveFileName(
                    this, QStringLiteral("Export the watchlist"),
                    QString::fromStdString(m_session.folders.SystemFolder + "Watchlist.csv"),
                    QStringLiteral("CSV files (*.csv)"));
                if (!file.isEmpty()) ExportCsv(file.toStdString());
            }
        });
    }
    bottom->addStretch(1);
    auto* closeButton = Button(this, "Close", "cmdClose");
    connect(closeButton, &QPushButton::clicked, this, [this] { close(); });
    bottom->addWidget(closeButton);
    layout->addLayout(bottom);

    std::string issues;
    for (const auto& i : m_form.issues())
        issues += (issues.empty() ? "" : "\n") + i.file + " line " + std::to_string(i.record) +
                  ": " + i.text;
    m_issues->setText(QString::fromStdString(issues));
    m_issues->setVisible(!issues.empty());
    FillLists();
    connect(m_list, &QComboBox::currentIndexChanged, this, [this](int index) {
        if (index == m_form.current()) return;
        m_form.Choose(index);
        Show();
    });
    Show();
    // The size and column widths the user left it at, as the window store keeps them.
    const auto place = app::LoadWatchWindowPlace(session.services().settings);
    resize(place.Width > 0 ? place.Width / kTwipsPerPixel : 620,
           place.Height > 0 ? place.Height / kTwipsPerPixel : 440);
    if (static_cast<int>(place.Columns.size()) == m_grid->columnCount())
        for (int c = 0; c < m_grid->columnCount(); ++c)
            m_grid->setColumnWidth(c, place.Columns[static_cast<std::size_t>(c)] / kTwipsPerPixel);
}

void Watchlist::hideEvent(QHideEvent* e) {
    app::WatchWindowPlace place{width() * kTwipsPerPixel, height() * kTwipsPerPixel, {}};
    for (int c = 0; c < m_grid->columnCount(); ++c)
        place.Columns.push_back(m_grid->columnWidth(c) * kTwipsPerPixel);
    app::SaveWatchWindowPlace(m_session.services().settings, place);
    QDialog::hideEvent(e);
}

void Watchlist::FillLists() {
    const QSignalBlocker quiet(m_list);
    m_list->clear();
    for (const auto& name : m_form.ListNames())
        m_list->addItem(QString::fromStdString(name));
    m_list->setCurrentIndex(m_form.current());
}

void Watchlist::Show() {
    m_model = m_form.Grid();
    m_grid->Refresh();
    m_grid->resizeColumnsToContents();
}

bool Watchlist::Check(const platform::Status& s) {
    if (!s) m_session.dialogs().MsgBox(s.message(), app::kWatchlistTitle);
    return s.ok();
}

void Watchlist::AddFromChart(const std::string& code) {
    if (!Check(m_form.AddFromChart(code))) return;
    FillLists();
    Show();
    m_grid->setCurrentCell(m_form.RowOf(platform::Upper(platform::Trim(code))), 0);
}

void Watchlist::AddTyped() {
    scan::WatchEntry e;
    e.Code = m_code->text().toStdString();
    e.Note = m_note->text().toStdString();
    // A date as shown ("5/1/2024") or as stored ("20240105").
    e.EntryDate = platform::Trim(m_date->text().toStdString());
    if (e.EntryDate.find('/') != std::string::npos)
        e.EntryDate = platform::DateDisplayToText(e.EntryDate);
    for (auto [edit, out, what] : {std::tuple{m_price, &e.EntryPrice, "entry price"},
                                   std::tuple{m_quantity, &e.Quantity, "quantity"}}) {
        const auto t = platform::Trim(edit->text().toStdString());
        if (t.empty()) continue;
        if (!platform::IsNumber(t)) {
            Check(platform::Status::Error("The " + std::string(what) + " must be a number"));
            return;
        }
        *out = platform::Val(t);
    }
    if (m_form.current() < 0 && !Check(m_form.NewList(std::string(scan::kFirstWatchlist)))) return;
    const std::string code = platform::Upper(platform::Trim(e.Code));
    if (!Check(m_form.AddCode(std::move(e)))) return;
    for (auto* edit : {m_code, m_price, m_date, m_quantity, m_note})
        edit->clear();
    FillLists();
    Show();
    m_grid->setCurrentCell(m_form.RowOf(code), 0);
    m_code->setFocus();
}

void Watchlist::RemoveCurrent() {
    if (Check(m_form.RemoveRow(m_grid->currentRow()))) Show();
}

void Watchlist::NewList() {
    const auto name =
        m_session.dialogs().InputBox("Name of the new watchlist", app::kWatchlistTitle);
    if (!name || !Check(m_form.NewList(*name))) return;
    FillLists();
    Show();
}

void Watchlist::RenameList() {
    if (m_form.current() < 0) return;
    const auto name = m_session.dialogs().InputBox(
        "New name of the watchlist", app::kWatchlistTitle,
        m_form.ListNames()[static_cast<std::size_t>(m_form.current())]);
    if (!name || !Check(m_form.RenameList(*name))) return;
    FillLists();
}

void Watchlist::DeleteList() {
    if (m_form.current() < 0) return;
    const auto& name = m_form.ListNames()[static_cast<std::size_t>(m_form.current())];
    if (m_session.dialogs().MsgBox("Delete the watchlist " + name + " ?", app::kWatchlistTitle,
                                   platform::Buttons::YesNo) != platform::Answer::Yes)
        return;
    if (!Check(m_form.DeleteList())) return;
    FillLists();
    Show();
}

void Watchlist::SortBy(int column) {
    m_form.Sort(column);
    Show();
}

void Watchlist::ShowChart() {
    const auto code = m_form.CodeAt(m_grid->currentRow());
    if (!code.empty() && m_showChart) m_showChart(code);
}

bool Watchlist::ExportCsv(const std::string& path) {
    return Check(platform::WriteFileAtomic(path, m_form.Csv()));
}

} // namespace kori::gui
