#include "gui/windows/stats_windows.h"

#include "gui/services/qt_progress.h"
#include "gui/widgets/grid_view.h"
#include "gui/widgets/text_print.h"
#include "gui/widgets/window_place.h"

#include <QFontDatabase>
#include <QFormLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPrinter>
#include <QPushButton>
#include <QRadioButton>
#include <QScreen>
#include <QVBoxLayout>

namespace kori::gui {

namespace {

QString Q(std::string_view s) {
    return QString::fromLatin1(s.data(), static_cast<qsizetype>(s.size()));
}

} // namespace

Statistics::Statistics(app::Session& session, ShowChartOf showChart, QWidget* parent)
    : ScanWindow(session, std::move(showChart), parent), m_form(session) {
    setObjectName(QStringLiteral("Statistics"));
    setWindowTitle(QString::fromLatin1(app::kStatisticsCaption));
    KeepWindowPosition(this, session.services().settings, "Statistics");
    auto* layout = new QVBoxLayout(this);
    m_controls = new QWidget(this);
    auto* top = new QHBoxLayout(m_controls);
    top->setContentsMargins(0, 0, 0, 0);
    auto* filters = new QGroupBox(m_controls);
    auto* fl = new QVBoxLayout(filters);
    static constexpr std::array<const char*, 4> kNames = {"optAll", "optFP", "optNoWarrants",
                                                          "optWarrants"};
    for (std::size_t i = 0; i < m_filters.size(); ++i) {
        m_filters[i] = new QRadioButton(Q(app::StatisticsForm::FilterCaptions()[i]), filters);
        m_filters[i]->setObjectName(QString::fromLatin1(kNames[i]));
        fl->addWidget(m_filters[i]);
    }
    m_filters[static_cast<std::size_t>(std::clamp(m_form.FilterIndex, 0, 3))]->setChecked(true);
    top->addWidget(filters);
    auto* topBox = new QFormLayout;
    m_top = new QLineEdit(Q(m_form.TopText), m_controls);
    m_top->setObjectName(QStringLiteral("txtTop"));
    m_top->setMaximumWidth(50);
    topBox->addRow(QStringLiteral("Top"), m_top);
    top->addLayout(topBox);
    auto* update = new QPushButton(QStringLiteral("&Update Statistics"), m_controls);
    update->setObjectName(QStringLiteral("cmdUpdate"));
    auto* display = new QPushButton(QStringLiteral("&Display"), m_controls);
    display->setObjectName(QStringLiteral("cmdDisplay"));
    auto* chart = new QPushButton(QStringLiteral("Show &Chart"), m_controls);
    chart->setObjectName(QStringLiteral("cmdChart"));
    auto* side = new QVBoxLayout;
    side->addWidget(update);
    side->addWidget(display);
    side->addWidget(chart);
    side->addStretch();
    top->addLayout(side);
    top->addStretch();
    layout->addWidget(m_controls);
    connect(update, &QPushButton::clicked, this, [this] { Update(); });
    connect(display, &QPushButton::clicked, this, [this] { ShowGrid(); });
    connect(chart, &QPushButton::clicked, this, [this] { ShowChart(); });

    m_grid =
        new GridView(m_form.grid(), session.dialogs(), std::string(scan::kStatisticsTitle), this);
    m_grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_grid->Refresh();
    layout->addWidget(m_grid, 1);
    connect(m_grid, &QTableWidget::cellDoubleClicked, this, [this] { ShowChart(); });
    AddFoot(layout);
    m_proceed->setText(QStringLiteral("Check &Statistics"));
    resize(std::min(1000, screen() ? screen()->availableGeometry().width() - 16 : 1000),
           std::min(640, screen() ? screen()->availableGeometry().height() - 40 : 640));
}

void Statistics::Take() {
    for (std::size_t i = 0; i < m_filters.size(); ++i)
        if (m_filters[i]->isChecked()) m_form.FilterIndex = static_cast<int>(i);
    m_form.TopText = m_top->text().toStdString();
}

void Statistics::ShowGrid() {
    m_grid->Refresh();
    m_grid->resizeColumnsToContents();
}

bool Statistics::Proceed() {
    Take();
    bool ok = false;
    RunWalk([&] { ok = m_form.Check(progress()); });
    ShowGrid();
    if (ok)
        m_status->setText(m_form.statistics().Cancelled()
                              ? QStringLiteral("Cancelled: the counts stand as far as they went")
                              : QStringLiteral("COMPLETED"));
    return ok;
}

bool Statistics::Update() {
    Take();
    bool ok = false;
    RunWalk([&] { ok = m_form.Update(progress()); });
    ShowGrid();
    if (ok) m_status->setText(QStringLiteral("COMPLETED"));
    return ok;
}

void Statistics::ShowChart() {
    const std::string code = m_form.CodeAt(m_grid->currentRow(), m_grid->currentColumn());
    if (!code.empty() && m_showChart) m_showChart(code);
}

bool Statistics::PrintTo(QPrinter& printer) {
    if (!m_form.Checked()) {
        m_session.dialogs().MsgBox("No records to print", scan::kStatisticsTitle);
        return false;
    }
    m_status->setText(QStringLiteral("PRINTING"));
    const std::string today = m_session.services().clock.Today();
    const bool ok = PrintTextPages(printer, QFontDatabase::systemFont(QFontDatabase::FixedFont),
                                   [&](int lines) { return m_form.Pages(lines, today); });
    m_status->setText(QStringLiteral("COMPLETED"));
    return ok;
}

// ---- ADTotals ----

ADTotals::ADTotals(app::Session& session, QWidget* parent)
    : QDialog(parent), m_session(session), m_form(session) {
    setObjectName(QStringLiteral("ADTotals"));
    setWindowTitle(QStringLiteral("Check Advance/Decline Totals"));
    KeepWindowPosition(this, session.services().settings, "ADTotals");
    auto* layout = new QVBoxLayout(this);
    auto* intro = new QLabel(Q(scan::kADIntro), this);
    intro->setWordWrap(true);
    layout->addWidget(intro);
    m_codes = new QListWidget(this);
    m_codes->setObjectName(QStringLiteral("List1"));
    for (const auto& c : m_form.codes())
        m_codes->addItem(Q(c));
    layout->addWidget(m_codes, 1);
    connect(m_codes, &QListWidget::currentRowChanged, this, [this](int row) { Pick(row); });
    m_name = new QLabel(this);
    m_name->setObjectName(QStringLiteral("lblName"));
    layout->addWidget(m_name);
    auto* form = new QFormLayout;
    m_base = new QLineEdit(this);
    m_base->setObjectName(QStringLiteral("txtBase"));
    m_base->setMaximumWidth(120);
    form->addRow(QStringLiteral("Base Value"), m_base);
    layout->addLayout(form);
    auto* buttons = new QHBoxLayout;
    auto* check = new QPushButton(QStringLiteral("Check Totals"), this);
    check->setObjectName(QStringLiteral("cmdCheck"));
    auto* close = new QPushButton(QStringLiteral("Close"), this);
    close->setObjectName(QStringLiteral("cmdClose"));
    buttons->addWidget(check);
    buttons->addStretch();
    buttons->addWidget(close);
    layout->addLayout(buttons);
    connect(check, &QPushButton::clicked, this, [this] { CheckTotals(); });
    connect(close, &QPushButton::clicked, this, &QDialog::close);
    resize(420, 360);
}

bool ADTotals::Pick(int row) {
    if (row < 0 || row >= static_cast<int>(m_form.codes().size())) return false;
    const bool ok = m_form.Pick(m_form.codes()[static_cast<std::size_t>(row)]);
    m_name->setText(Q(m_form.name()));
    m_base->setText(Q(m_form.BaseText));
    return ok;
}

bool ADTotals::CheckTotals() {
    m_form.BaseText = m_base->text().toStdString();
    return m_form.CheckTotals();
}

} // namespace kori::gui
