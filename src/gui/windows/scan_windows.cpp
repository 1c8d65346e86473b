#include "gui/windows/scan_windows.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/grid_view.h"
#include "gui/widgets/text_print.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/main_window.h"
#include "platform/text.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QComboBox>
#include <QFontDatabase>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPrintDialog>
#include <QPrinter>
#include <QPushButton>
#include <QScreen>
#include <QShortcut>
#include <QStatusBar>
#include <QVBoxLayout>

namespace kori::gui {

namespace {

QString Q(std::string_view s) {
    return QString::fromLatin1(s.data(), static_cast<qsizetype>(s.size()));
}

std::string S(const QLineEdit* e) {
    return e->text().toLatin1().toStdString();
}

QCheckBox* Check(QWidget* parent, const char* name, const char* caption, bool on) {
    auto* c = new QCheckBox(QString::fromLatin1(caption), parent);
    c->setObjectName(QString::fromLatin1(name));
    c->setChecked(on);
    return c;
}

QLineEdit* Edit(QWidget* parent, const char* name, const std::string& text, int width = 70) {
    auto* e = new QLineEdit(Q(text), parent);
    e->setObjectName(QString::fromLatin1(name));
    e->setMaximumWidth(width);
    return e;
}

QPushButton* Button(QWidget* parent, const char* name, const char* caption) {
    auto* b = new QPushButton(QString::fromLatin1(caption), parent);
    b->setObjectName(QString::fromLatin1(name));
    return b;
}

// The frame of the scans as boxes, into `grid` from `row` on; `withList` adds the selector.
ScanFrameBoxes AddFrame(QWidget* parent, QGridLayout* grid, int row, const scan::ScanFrame& f,
                        bool noWarrants, const std::vector<std::string>* lists, int listIndex) {
    ScanFrameBoxes b;
    b.Range = Check(parent, "chkRange", "By closing price range", f.Range.On);
    grid->addWidget(b.Range, row, 0);
    auto* minMax = new QHBoxLayout;
    minMax->addSpacing(24);
    minMax->addWidget(new QLabel(QStringLiteral("Min"), parent));
    b.Min = Edit(parent, "txtMin", f.Range.Min, 70);
    minMax->addWidget(b.Min);
    minMax->addWidget(new QLabel(QStringLiteral("Max"), parent));
    b.Max = Edit(parent, "txtMax", f.Range.Max, 70);
    minMax->addWidget(b.Max);
    minMax->addStretch();
    grid->addLayout(minMax, row + 1, 0, 1, 2);
    b.ClassOn = Check(parent, "chkClass", "Check only Industry Class ", f.ClassOn);
    grid->addWidget(b.ClassOn, row + 2, 0);
    b.Class = Edit(parent, "txtClass", f.Class, 50);
    grid->addWidget(b.Class, row + 2, 1);
    if (lists) {
        b.NoWarrants = Check(parent, "chkWarrants", "Do not check warrants", noWarrants);
        grid->addWidget(b.NoWarrants, row + 3, 0);
        b.List = new QComboBox(parent);
        b.List->setObjectName(QStringLiteral("cboList"));
        for (const auto& c : *lists)
            b.List->addItem(Q(c));
        b.List->setCurrentIndex(listIndex);
        grid->addWidget(b.List, row + 4, 0, 1, 2);
    }
    return b;
}

void TakeFrame(const ScanFrameBoxes& b, scan::ScanFrame& f) {
    f.Range.On = b.Range->isChecked();
    f.Range.Min = S(b.Min);
    f.Range.Max = S(b.Max);
    f.ClassOn = b.ClassOn->isChecked();
    f.Class = S(b.Class);
}

// A first size that the screen can hold, however small it is.
void SizeWithin(QWidget* w, int width, int height) {
    if (const QScreen* screen = w->screen()) {
        const QSize free = screen->availableGeometry().size() - QSize(16, 40);
        width = std::min(width, free.width());
        height = std::min(height, free.height());
    }
    w->resize(width, height);
}

QFont ListingFont() {
    return QFontDatabase::systemFont(QFontDatabase::FixedFont);
}

} // namespace

// ---- ScanWindow ----

ScanWindow::ScanWindow(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : QDialog(parent), m_session(session), m_showChart(std::move(showChart)) {}

ScanWindow::~ScanWindow() = default;

void ScanWindow::AddFoot(QBoxLayout* layout) {
    auto* buttons = new QHBoxLayout;
    m_proceed = Button(this, "cmdProceed", "Proceed");
    m_proceed->setDefault(true);
    auto* print = Button(this, "cmdPrint", "&Print");
    auto* close = Button(this, "cmdClose", "Close");
    buttons->addWidget(m_proceed);
    buttons->addWidget(print);
    buttons->addStretch();
    buttons->addWidget(close);
    connect(m_proceed, &QPushButton::clicked, this, [this] { Proceed(); });
    connect(print, &QPushButton::clicked, this, [this] { Print(); });
    connect(close, &QPushButton::clicked, this, &QDialog::close);
    layout->addLayout(buttons);
    // The window's own status line: the walk's text, its bar and Cancel stay live while the
    // choices are locked.
    m_bar = new QStatusBar(this);
    m_bar->setSizeGripEnabled(false);
    m_status = new QLabel(m_bar);
    m_status->setObjectName(QStringLiteral("lblStatus"));
    m_bar->addWidget(m_status, 1);
    m_progress = std::make_unique<QtProgress>(m_bar);
    layout->addWidget(m_bar);
}

void ScanWindow::RunWalk(const std::function<void()>& walk) {
    // The menus go while the walk lets events run: no second walk starts inside this one.
    auto* main = qobject_cast<MainWindow*>(parentWidget());
    if (main) main->SetModalToolRunning(true);
    m_running = true;
    if (m_controls) m_controls->setEnabled(false);
    m_proceed->setEnabled(false);
    m_status->clear();
    m_progress->ResetCancel();
    walk();
    m_progress->Finish();
    m_proceed->setEnabled(true);
    if (m_controls) m_controls->setEnabled(true);
    m_running = false;
    if (main) main->SetModalToolRunning(false);
}

bool ScanWindow::Refused(const std::optional<scan::ScanMessage>& m) {
    if (!m) return false;
    m_session.dialogs().MsgBox(m->Text, m->Title);
    return true;
}

void ScanWindow::ShowMessage(const std::optional<scan::ScanMessage>& m, bool cancelled) {
    if (cancelled) {
        m_status->setText(
            QStringLiteral("Cancelled: the finds so far are shown; the scan list is unchanged"));
        return;
    }
    if (m) m_session.dialogs().MsgBox(m->Text, m->Title);
}

void ScanWindow::Print() {
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, this);
    if (dialog.exec() == QDialog::Accepted) PrintTo(printer);
}

void ScanWindow::closeEvent(QCloseEvent* e) {
    // The walk runs inside this window's own call: closing now would pull it from under it.
    if (m_running) {
        m_progress->RequestCancel();
        e->ignore();
        return;
    }
    QDialog::closeEvent(e);
}

void ScanWindow::reject() {
    if (m_running) {
        m_progress->RequestCancel();
        return;
    }
    QDialog::reject();
}

// ---- chtScan1 ----

ChtScan1::ChtScan1(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : ScanWindow(session, std::move(showChart), parent), m_form(session) {
    setObjectName(QStringLiteral("chtScan1"));
    setWindowTitle(QStringLiteral("Chart Scan 1 - Prices / Oscillators"));
    KeepWindowPosition(this, session.services().settings, "Scan1_Form");
    const auto& o = m_form.Options;
    auto* layout = new QVBoxLayout(this);
    m_controls = new QWidget(this);
    auto* top = new QHBoxLayout(m_controls);
    top->setContentsMargins(0, 0, 0, 0);

    auto* choices = new QGroupBox(QStringLiteral("Selection"), m_controls);
    auto* g = new QGridLayout(choices);
    m_rise = Check(choices, "chkRise", "Percentage Rise", o.Rise);
    m_risePercent = Edit(choices, "txtRise", o.RisePercent, 50);
    g->addWidget(m_rise, 0, 0);
    g->addWidget(m_risePercent, 0, 1);
    m_fall = Check(choices, "chkFall", "Percentage Fall", o.Fall);
    m_fallPercent = Edit(choices, "txtFall", o.FallPercent, 50);
    g->addWidget(m_fall, 1, 0);
    g->addWidget(m_fallPercent, 1, 1);
    m_categoryOn = Check(choices, "chkCategory", "Check only Category ", o.CategoryOn);
    m_category = Edit(choices, "txtCategory", o.Category, 50);
    g->addWidget(m_categoryOn, 2, 0);
    g->addWidget(m_category, 2, 1);
    scan::ScanFrame frame{o.Range, o.ClassOn, o.Class};
    const auto& lists = m_form.listCaptions();
    m_frame = AddFrame(choices, g, 3, frame, o.NoWarrants, &lists, m_form.ListIndex);
    top->addWidget(choices);

    auto* oscs = new QGroupBox(QStringLiteral("Oscillators"), m_controls);
    // Two columns each, stacked: the window still fits a small screen.
    auto* ol = new QGridLayout(oscs);
    static constexpr std::array<const char*, 5> kOscCaptions = {
        "Stochastic ", "Williams %R", "Rate of Change", "Momentum", "RSI"};
    static constexpr std::array<const char*, 5> kOscNames = {"chkSTO", "chkWMS", "chkROC", "chkMM",
                                                             "chkRSI"};
    for (std::size_t k = 0; k < m_osc.size(); ++k) {
        m_osc[k] = Check(oscs, kOscNames[k], kOscCaptions[k], o.Osc[k]);
        ol->addWidget(m_osc[k], static_cast<int>(k / 2), static_cast<int>(k % 2));
    }
    auto* right = new QVBoxLayout;
    right->addWidget(oscs);

    auto* inds = new QGroupBox(QStringLiteral("Indications"), m_controls);
    auto* il = new QGridLayout(inds);
    const std::array<std::pair<const char*, bool>, 4> indications = {
        std::pair{"OB (over bought)", o.Indications.OB},
        {"OS (over sold)", o.Indications.OS},
        {"Cut OB (up or down)", o.Indications.CutOB},
        {"Cut OS (up or down) ", o.Indications.CutOS}};
    static constexpr std::array<const char*, 4> kIndNames = {"chkOB", "chkOS", "chkCutOB",
                                                             "chkCutOS"};
    for (std::size_t k = 0; k < m_ind.size(); ++k) {
        m_ind[k] = Check(inds, kIndNames[k], indications[k].first, indications[k].second);
        il->addWidget(m_ind[k], static_cast<int>(k / 2), static_cast<int>(k % 2));
    }
    right->addWidget(inds);
    right->addStretch();
    top->addLayout(right);
    top->addStretch();
    layout->addWidget(m_controls);

    m_heading = new QLabel(Q(m_form.GridHeading()), this);
    m_heading->setObjectName(QStringLiteral("lblHeading"));
    layout->addWidget(m_heading);
    m_grid = new GridView(m_form.grid(), session.dialogs(), app::kScanGridTitle, this);
    m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_grid->setSelectionMode(QAbstractItemView::ContiguousSelection);
    m_grid->Refresh();
    for (std::size_t k = 0; k < m_osc.size(); ++k)
        m_grid->setColumnHidden(6 + static_cast<int>(k), !o.Osc[k]);
    m_grid->horizontalHeader()->setStretchLastSection(true);
    layout->addWidget(m_grid, 1);
    connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this] { ShowChart(); });
    auto* all = new QLabel(QStringLiteral("* ") + Q(scan::kScan1AllLabel), this);
    all->setObjectName(QStringLiteral("lblAll"));
    layout->addWidget(all);
    auto* rowButtons = new QHBoxLayout;
    auto* chart = Button(this, "cmdChart", "Show &Chart");
    auto* del = Button(this, "cmdDelete", "&Delete Rows");
    rowButtons->addWidget(chart);
    rowButtons->addWidget(del);
    rowButtons->addStretch();
    connect(chart, &QPushButton::clicked, this, [this] { ShowChart(); });
    connect(del, &QPushButton::clicked, this, [this] { DeleteSelected(); });
    auto* delKey = new QShortcut(QKeySequence::Delete, m_grid);
    delKey->setContext(Qt::WidgetShortcut);
    connect(delKey, &QShortcut::activated, this, [this] { DeleteSelected(); });
    layout->addLayout(rowButtons);
    AddFoot(layout);
    SizeWithin(this, 920, 700);
}

void ChtScan1::Take() {
    auto& o = m_form.Options;
    m_form.ListIndex = std::max(0, m_frame.List->currentIndex());
    o.Rise = m_rise->isChecked();
    o.RisePercent = S(m_risePercent);
    o.Fall = m_fall->isChecked();
    o.FallPercent = S(m_fallPercent);
    o.CategoryOn = m_categoryOn->isChecked();
    o.Category = S(m_category);
    scan::ScanFrame f;
    TakeFrame(m_frame, f);
    o.Range = f.Range;
    o.ClassOn = f.ClassOn;
    o.Class = f.Class;
    o.NoWarrants = m_frame.NoWarrants->isChecked();
    for (std::size_t k = 0; k < m_osc.size(); ++k)
        o.Osc[k] = m_osc[k]->isChecked();
    o.Indications = {m_ind[0]->isChecked(), m_ind[1]->isChecked(), m_ind[2]->isChecked(),
                     m_ind[3]->isChecked()};
}

bool ChtScan1::Proceed() {
    Take();
    if (Refused(m_form.Refusal())) return false;
    RunWalk([this] { m_form.Run(progress()); });
    const auto& r = m_form.result();
    m_grid->Refresh();
    // Only the oscillators the scan tested have a column worth showing.
    for (std::size_t k = 0; k < m_osc.size(); ++k)
        m_grid->setColumnHidden(6 + static_cast<int>(k), !m_form.Options.Osc[k]);
    m_grid->resizeColumnsToContents();
    m_heading->setText(Q(m_form.GridHeading()));
    if (!r.Status) {
        m_session.dialogs().MsgBox(r.Status.message(), " Chart Scan");
        return true;
    }
    ShowMessage(r.Message, r.Cancelled);
    return true;
}

void ChtScan1::ShowChart() {
    const std::string code = m_form.CodeAt(m_grid->currentRow());
    if (!code.empty() && m_showChart) m_showChart(code);
}

void ChtScan1::DeleteSelected() {
    const auto ranges = m_grid->selectedRanges();
    int first = m_grid->currentRow(), last = first;
    if (!ranges.isEmpty()) {
        first = ranges.front().topRow();
        last = ranges.front().bottomRow();
    }
    if (first < 0) return;
    if (m_form.DeleteRows(first, last, m_session.dialogs())) m_grid->Refresh();
}

bool ChtScan1::PrintTo(QPrinter& printer) {
    if (m_form.grid().rowCount() == 0) {
        m_session.dialogs().MsgBox("No records to print", " Chart Scan");
        return false;
    }
    m_status->setText(QStringLiteral("PRINTING ANALYSIS RESULTS -  WAIT"));
    const auto& fs = m_session.fontSettings;
    QFont font(Q(fs.CFont));
    const int size = static_cast<int>(platform::Val(fs.CFontSize));
    font.setPointSize(size > 0 ? size : 8);
    const bool ok =
        PrintTextPages(printer, font, [this](int lines) { return m_form.Pages(lines); });
    m_status->clear();
    return ok;
}

// ---- the listings ----

ListingScanWindow::ListingScanWindow(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : ScanWindow(session, std::move(showChart), parent) {}

void ListingScanWindow::AddListing(QBoxLayout* layout) {
    m_heading = new QLabel(this);
    m_heading->setObjectName(QStringLiteral("lblHeading"));
    m_heading->setFont(ListingFont());
    layout->addWidget(m_heading);
    m_list = new QListWidget(this);
    m_list->setObjectName(QStringLiteral("List1"));
    m_list->setFont(ListingFont());
    layout->addWidget(m_list, 1);
    connect(m_list, &QListWidget::itemDoubleClicked, this, [this] { ShowChart(); });
    auto* chart = Button(this, "cmdChart", "Show &Chart");
    connect(chart, &QPushButton::clicked, this, [this] { ShowChart(); });
    auto* row = new QHBoxLayout;
    row->addWidget(chart);
    row->addStretch();
    layout->addLayout(row);
}

void ListingScanWindow::ShowListing(const app::ScanListingLines& listing, int firstShown) {
    QString heading = Q(listing.Heading);
    heading.replace(QLatin1Char('\t'), QStringLiteral("    "));
    m_heading->setText(heading);
    m_list->clear();
    for (const auto& line : listing.Lines) {
        QString text = Q(line);
        text.replace(QLatin1Char('\t'), QStringLiteral("    "));
        m_list->addItem(text);
    }
    m_codes = listing.Codes;
    if (firstShown > 0 && firstShown < m_list->count())
        m_list->scrollToItem(m_list->item(firstShown), QAbstractItemView::PositionAtTop);
}

void ListingScanWindow::Finish(const scan::ScanListing& r) {
    if (!r.Status)
        m_session.dialogs().MsgBox(r.Status.message(), " Chart Scan");
    else
        ShowMessage(r.Message, r.Cancelled);
}

void ListingScanWindow::ShowChart() {
    const int row = m_list->currentRow();
    if (row < 0 || row >= static_cast<int>(m_codes.size()) || !m_showChart) return;
    m_showChart(m_codes[static_cast<std::size_t>(row)]);
}

bool ListingScanWindow::PrintPages(QPrinter& printer,
                                   const std::function<std::vector<app::PrintedPage>(int)>& pages,
                                   bool empty) {
    if (empty) {
        m_session.dialogs().MsgBox("No records to print", " Chart Scan");
        return false;
    }
    m_status->setText(QStringLiteral("PRINTING  -  WAIT"));
    const bool ok = PrintTextPages(printer, ListingFont(), pages);
    m_status->clear();
    return ok;
}

// ---- ChtScan2 ----

ChtScan2::ChtScan2(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : ListingScanWindow(session, std::move(showChart), parent), m_form(session) {
    setObjectName(QStringLiteral("ChtScan2"));
    setWindowTitle(QStringLiteral("Chart Scan 2 (Increases in Volume)"));
    KeepWindowPosition(this, session.services().settings, "Scan2_Form");
    const auto& o = m_form.Options;
    auto* layout = new QVBoxLayout(this);
    m_controls = new QGroupBox(QStringLiteral("Selection criteria"), this);
    auto* g = new QGridLayout(m_controls);
    m_frame =
        AddFrame(m_controls, g, 0, o.Frame, o.NoWarrants, &m_form.listCaptions(), m_form.ListIndex);
    m_volume = Check(m_controls, "chkVolume", "By increases in volume", o.Volume);
    g->addWidget(m_volume, 5, 0);
    auto* vol = new QHBoxLayout;
    m_volumePercent = Edit(m_controls, "txtVolPercent", o.VolumePercent, 60);
    vol->addWidget(m_volumePercent);
    vol->addWidget(new QLabel(QStringLiteral("% over average volume last"), m_controls));
    m_volumeDays = Edit(m_controls, "txtVolDays", o.VolumeDays, 40);
    vol->addWidget(m_volumeDays);
    vol->addWidget(new QLabel(QStringLiteral("days"), m_controls));
    vol->addStretch();
    g->addLayout(vol, 5, 1);
    m_price = Check(m_controls, "chkPrice", "By +/- in price %", o.Price);
    g->addWidget(m_price, 6, 0);
    m_pricePercent = Edit(m_controls, "txtPricePercent", o.PricePercent, 60);
    g->addWidget(m_pricePercent, 6, 1);
    layout->addWidget(m_controls);
    AddListing(layout);
    AddFoot(layout);
    ShowListing(m_form.listing());
    SizeWithin(this, 640, 600);
}

bool ChtScan2::Proceed() {
    auto& o = m_form.Options;
    m_form.ListIndex = std::max(0, m_frame.List->currentIndex());
    TakeFrame(m_frame, o.Frame);
    o.NoWarrants = m_frame.NoWarrants->isChecked();
    o.Volume = m_volume->isChecked();
    o.VolumePercent = S(m_volumePercent);
    o.VolumeDays = S(m_volumeDays);
    o.Price = m_price->isChecked();
    o.PricePercent = S(m_pricePercent);
    return RunListing(m_form);
}

bool ChtScan2::PrintTo(QPrinter& printer) {
    return PrintListing(printer, m_form);
}

// ---- ChtScan3 ----

ChtScan3::ChtScan3(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : ListingScanWindow(session, std::move(showChart), parent), m_form(session) {
    setObjectName(QStringLiteral("ChtScan3"));
    setWindowTitle(QStringLiteral("Chart Scan 3 (Stocks breaking Parabolic Indicator)"));
    KeepWindowPosition(this, session.services().settings, "Scan3_Form");
    const auto& o = m_form.Options;
    auto* layout = new QVBoxLayout(this);
    m_controls = new QGroupBox(QStringLiteral("Break Parabolic"), this);
    auto* g = new QGridLayout(m_controls);
    m_up = Check(m_controls, "chkUp", "Look for break UP", o.Up);
    m_down = Check(m_controls, "chkDown", "Look for break DOWN", o.Down);
    g->addWidget(m_up, 0, 0);
    g->addWidget(m_down, 0, 1);
    m_categoryOn = Check(m_controls, "chkCategory", "Check only Category ", o.CategoryOn);
    m_category = Edit(m_controls, "txtCategory", o.Category, 50);
    g->addWidget(m_categoryOn, 1, 0);
    g->addWidget(m_category, 1, 1);
    m_frame =
        AddFrame(m_controls, g, 2, o.Frame, o.NoWarrants, &m_form.listCaptions(), m_form.ListIndex);
    layout->addWidget(m_controls);
    AddListing(layout);
    AddFoot(layout);
    ShowListing(m_form.listing());
    SizeWithin(this, 600, 580);
}

bool ChtScan3::Proceed() {
    auto& o = m_form.Options;
    m_form.ListIndex = std::max(0, m_frame.List->currentIndex());
    TakeFrame(m_frame, o.Frame);
    o.NoWarrants = m_frame.NoWarrants->isChecked();
    o.Up = m_up->isChecked();
    o.Down = m_down->isChecked();
    o.CategoryOn = m_categoryOn->isChecked();
    o.Category = S(m_category);
    return RunListing(m_form);
}

bool ChtScan3::PrintTo(QPrinter& printer) {
    return PrintListing(printer, m_form);
}

// ---- ChtScan6 ----

ChtScan6::ChtScan6(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : ListingScanWindow(session, std::move(showChart), parent), m_form(session) {
    setObjectName(QStringLiteral("ChtScan6"));
    setWindowTitle(QStringLiteral("Chart Scan 6 - Average Crossover"));
    KeepWindowPosition(this, session.services().settings, "Scan6_Form");
    const auto& o = m_form.Options;
    auto* layout = new QVBoxLayout(this);
    m_controls = new QGroupBox(QStringLiteral("Average Crossover Scan"), this);
    auto* g = new QGridLayout(m_controls);
    g->addWidget(new QLabel(QStringLiteral("Code length"), m_controls), 0, 0);
    m_codeLength = new QComboBox(m_controls);
    m_codeLength->setObjectName(QStringLiteral("cboCodeLength"));
    for (const auto& c : app::Scan6Form::CodeLengths())
        m_codeLength->addItem(Q(c));
    m_codeLength->setCurrentText(Q(o.CodeLength));
    g->addWidget(m_codeLength, 0, 1);
    m_frame = AddFrame(m_controls, g, 1, o.Frame, false, nullptr, 0);
    auto* note = new QLabel(
        QStringLiteral("Lists the securities whose two daily averages of the Chart Defaults "
                       "lie within half of one per cent of each other."),
        m_controls);
    note->setWordWrap(true);
    g->addWidget(note, 4, 0, 1, 2);
    layout->addWidget(m_controls);
    AddListing(layout);
    AddFoot(layout);
    ShowListing(m_form.listing());
    SizeWithin(this, 640, 600);
}

bool ChtScan6::Proceed() {
    auto& o = m_form.Options;
    TakeFrame(m_frame, o.Frame);
    o.CodeLength = m_codeLength->currentText().toStdString();
    return RunListing(m_form);
}

bool ChtScan6::PrintTo(QPrinter& printer) {
    return PrintListing(printer, m_form);
}

} // namespace kori::gui
