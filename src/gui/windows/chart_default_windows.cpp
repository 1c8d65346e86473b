#include "gui/windows/chart_default_windows.h"

#include "app/chart_service.h"
#include "platform/text.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString Num(double v) {
    return Q(platform::Trim(platform::Str(v)));
}
QString Single(float v) {
    return Q(platform::Trim(platform::StrSingle(v)));
}

QLineEdit* NumberBox(QWidget* parent, const char* name, const QString& text, int width = 70) {
    auto* e = new QLineEdit(text, parent);
    e->setObjectName(QString::fromLatin1(name));
    e->setMaxLength(8);
    e->setFixedWidth(width);
    return e;
}
} // namespace

ChartDefaultWindow::ChartDefaultWindow(app::Session& session, SettingsHub& hub, const char* name,
                                       const QString& title, QWidget* parent)
    : SettingsDialog(session, hub, name, title, parent),
      m_defaults(chart::LoadChartDefaults(session.ini())), m_layout(new QVBoxLayout(this)) {}

void ChartDefaultWindow::AddButtons() {
    auto* ok = Button(QStringLiteral("OK"), "cmdOK");
    auto* cancel = Button(QStringLiteral("Cancel"), "cmdCancel");
    ok->setDefault(true);
    connect(ok, &QPushButton::clicked, this, [this] {
        if (Ok()) accept();
    });
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
    auto* row = new QHBoxLayout;
    row->addStretch();
    row->addWidget(ok);
    row->addWidget(cancel);
    m_layout->addLayout(row);
}

void ChartDefaultWindow::Store() {
    chart::SaveChartDefaults(m_session.ini(), m_defaults);
    m_hub.RebuildChart();
}

// --- PLW

PLW::PLW(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "PLW", QStringLiteral("Printer Line Width"), parent),
      m_width(NumberBox(this, "txtWidth", Num(m_defaults.PrintLineWidth))) {
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Line width of printed charts (1 - 10)"), m_width);
    m_layout->addLayout(form);
    AddButtons();
}

bool PLW::Ok() {
    const std::string t = S(m_width->text());
    if (!app::Accept(app::LineWidthProblem(t), dialogs())) return false;
    m_defaults.PrintLineWidth = static_cast<std::int16_t>(*app::WholeNumber(t));
    Store();
    return true;
}

// --- BlankSpc

BlankSpc::BlankSpc(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "BlankSpc", QStringLiteral("Blank Space"), parent),
      m_blank(NumberBox(this, "txtBlank", Num(m_defaults.BlankRight))) {
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Blank space at the right of the chart"), m_blank);
    m_layout->addLayout(form);
    AddButtons();
}

bool BlankSpc::Ok() {
    const std::string t = S(m_blank->text());
    if (!app::Accept(app::BlankSpaceProblem(t), dialogs())) return false;
    m_defaults.BlankRight = static_cast<std::int16_t>(*app::WholeNumber(t));
    Store();
    return true;
}

// --- GLSpaces

GLSpaces::GLSpaces(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "GLSpaces", QStringLiteral("Grid Line Spaces"), parent),
      m_space(NumberBox(this, "txtVGSpace", Num(m_defaults.VerticalGridSpace))),
      m_midGrid(new QCheckBox(QStringLiteral("Price grid lines at half steps"), this)) {
    m_midGrid->setObjectName(QStringLiteral("chkMidGrid"));
    m_midGrid->setChecked(m_defaults.MidGrid != 0);
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Vertical grid space (0 = no date grid)"), m_space);
    form->addRow(m_midGrid);
    m_layout->addLayout(form);
    AddButtons();
}

bool GLSpaces::Ok() {
    const std::string t = S(m_space->text());
    if (!app::Accept(app::GridSpaceProblem(t), dialogs())) return false;
    m_defaults.VerticalGridSpace = *app::WholeNumber(t);
    m_defaults.MidGrid = m_midGrid->isChecked() ? 1 : 0;
    Store();
    return true;
}

// --- VHeight

VHeight::VHeight(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "VHeight", QStringLiteral("Volume Height"), parent) {
    auto* box = new QGroupBox(QStringLiteral("Height of the volume bars"), this);
    auto* l = new QVBoxLayout(box);
    const char* captions[] = {"Normal", "Double", "Treble"};
    for (int i = 0; i < 3; ++i) {
        auto* r = new QRadioButton(QString::fromLatin1(captions[i]), box);
        r->setObjectName(QStringLiteral("optHeight%1").arg(i + 1));
        l->addWidget(r);
        m_options[static_cast<std::size_t>(i)] = r;
    }
    // A stored value above 3 stands when read; the window shows the nearest choice.
    const int v = std::clamp<int>(m_defaults.VolumeMultiple, 1, 3);
    m_options[static_cast<std::size_t>(v - 1)]->setChecked(true);
    m_layout->addWidget(box);
    AddButtons();
}

bool VHeight::Ok() {
    for (int i = 0; i < 3; ++i)
        if (m_options[static_cast<std::size_t>(i)]->isChecked())
            m_defaults.VolumeMultiple = static_cast<std::int16_t>(i + 1);
    Store();
    return true;
}

// --- StpLs

StpLs::StpLs(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "StpLs", QStringLiteral("Stop Loss"), parent),
      m_on(new QCheckBox(QStringLiteral("Show the stop loss"), this)),
      m_percent(NumberBox(this, "txtPercent", Single(m_defaults.StopPercent))) {
    m_on->setObjectName(QStringLiteral("chkStopLoss"));
    m_on->setChecked(m_defaults.StopLossOn);
    auto* form = new QFormLayout;
    form->addRow(m_on);
    form->addRow(QStringLiteral("Stop loss percentage (0 = none)"), m_percent);
    m_layout->addLayout(form);
    AddButtons();
}

bool StpLs::Ok() {
    const std::string t = S(m_percent->text());
    if (!app::Accept(app::StopLossProblem(t), dialogs())) return false;
    app::SetStopLoss(m_defaults, m_on->isChecked(), static_cast<float>(*app::TypedNumber(t)));
    Store();
    return true;
}

// --- MMASet

MMASet::MMASet(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "MMASet", QStringLiteral("MMA Settings"), parent) {
    auto* groups = new QHBoxLayout;
    for (int g = 0; g < 2; ++g) {
        auto* box = new QGroupBox(
            g == 0 ? QStringLiteral("MMA (Short)") : QStringLiteral("MMA (Long)"), this);
        auto* form = new QFormLayout(box);
        for (int i = 0; i < 6; ++i) {
            const int n = g * 6 + i;
            auto* e = NumberBox(box, "txtAve",
                                Num(m_defaults.MMAPeriods[static_cast<std::size_t>(n)]), 60);
            e->setObjectName(QStringLiteral("txtAve%1").arg(n));
            e->setMaxLength(3);
            form->addRow(QStringLiteral("Ave %1").arg(i + 1), e);
            m_boxes[static_cast<std::size_t>(n)] = e;
        }
        groups->addWidget(box);
    }
    m_layout->addLayout(groups);
    auto* def = Button(QStringLiteral("Default"), "cmdDefault");
    connect(def, &QPushButton::clicked, this, &MMASet::Default);
    auto* row = new QHBoxLayout;
    row->addWidget(def);
    row->addStretch();
    m_layout->addLayout(row);
    AddButtons();
}

void MMASet::Default() {
    for (std::size_t i = 0; i < m_boxes.size(); ++i)
        m_boxes[i]->setText(QString::number(chart::kDefaultMMAPeriods[i]));
}

bool MMASet::Ok() {
    std::array<std::string, 12> texts;
    for (std::size_t i = 0; i < texts.size(); ++i)
        texts[i] = S(m_boxes[i]->text());
    if (!app::Accept(app::MMAProblem(texts), dialogs())) return false;
    for (std::size_t i = 0; i < texts.size(); ++i)
        m_defaults.MMAPeriods[i] = static_cast<std::int16_t>(*app::WholeNumber(texts[i]));
    Store();
    return true;
}

// --- SwingSet

SwingSet::SwingSet(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "SwingSet", QStringLiteral("Swing"), parent),
      m_value(nullptr) {
    const auto s = app::ReadSwingSettings(session.ini());
    auto* box = new QGroupBox(QStringLiteral("Swing method"), this);
    auto* l = new QVBoxLayout(box);
    const char* captions[] = {"Standard (high - low)", "Days in a swing", "Points in a swing",
                              "Points, automatic"};
    for (std::size_t i = 0; i < m_methods.size(); ++i) {
        auto* r = new QRadioButton(QString::fromLatin1(captions[i]), box);
        r->setObjectName(Q("opt" + std::string(app::SwingMethods()[i])));
        r->setChecked(app::SwingMethods()[i] == s.SwingMethod);
        l->addWidget(r);
        m_methods[i] = r;
    }
    m_value = NumberBox(this, "txtSwingValue", Single(s.SwingValue));
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Days or points"), m_value);
    m_layout->addWidget(box);
    m_layout->addLayout(form);
    for (std::size_t i = 0; i < m_methods.size(); ++i) {
        connect(m_methods[i], &QRadioButton::toggled, this, [this, i](bool on) {
            const auto method = app::SwingMethods()[i];
            m_value->setEnabled(method == "XDay" || method == "XPoint");
            if (on && m_value->isEnabled())
                m_value->setText(Single(app::DefaultSwingValue(method)));
        });
    }
    const auto method = s.SwingMethod;
    m_value->setEnabled(method == "XDay" || method == "XPoint");
    AddButtons();
}

bool SwingSet::Ok() {
    app::SwingSettings s;
    for (std::size_t i = 0; i < m_methods.size(); ++i)
        if (m_methods[i]->isChecked()) s.SwingMethod = std::string(app::SwingMethods()[i]);
    const std::string t = S(m_value->text());
    if (!app::Accept(app::SwingValueProblem(s.SwingMethod, t), dialogs())) return false;
    const auto v = app::TypedNumber(t);
    s.SwingValue = v ? static_cast<float>(*v) : app::DefaultSwingValue(s.SwingMethod);
    app::WriteSwingSettings(m_session.ini(), s);
    m_hub.RebuildChart();
    return true;
}

// --- Scales

Scales::Scales(app::Session& session, SettingsHub& hub, const std::string& code, QWidget* parent)
    : ChartDefaultWindow(session, hub, "Scales", QStringLiteral("Change Scales"), parent),
      m_code(NumberBox(this, "txtCode", Q(platform::Trim(code)), 90)),
      m_base(NumberBox(this, "txtBase", QString())), m_top(NumberBox(this, "txtTop", QString())),
      m_pf(NumberBox(this, "txtPFInc", QString())) {
    m_code->setMaxLength(6);
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Code"), m_code);
    form->addRow(QStringLiteral("Chart base"), m_base);
    form->addRow(QStringLiteral("Chart ceiling"), m_top);
    form->addRow(QStringLiteral("PF Inc"), m_pf);
    auto* note = new QLabel(QStringLiteral("0 means automatic scale"), this);
    m_layout->addLayout(form);
    m_layout->addWidget(note);
    connect(m_code, &QLineEdit::returnPressed, this, [this] { (void)Lookup(); });
    AddButtons();
    if (!m_code->text().isEmpty()) (void)Lookup();
}

bool Scales::Lookup() {
    const std::string code = platform::Upper(platform::Trim(S(m_code->text())));
    const auto found = app::FindSecurity(m_session, code);
    if (!found) {
        m_record = 0;
        dialogs().MsgBox("No record on file for that code", "Change Scales");
        return false;
    }
    m_record = found->first;
    m_code->setText(Q(code));
    m_base->setText(Single(found->second.Base));
    m_top->setText(Single(found->second.Top));
    m_pf->setText(Single(found->second.PFIncrement));
    return true;
}

bool Scales::Ok() {
    if (m_record == 0 && !Lookup()) return false;
    const app::ScaleFields fields{S(m_base->text()), S(m_top->text()), S(m_pf->text())};
    if (!app::Accept(app::ScalesProblem(fields), dialogs())) return false;
    if (auto s = app::SaveScales(m_session.folders.DataFolder, m_record, fields); !s) {
        dialogs().MsgBox(s.message(), "Change Scales");
        return false;
    }
    m_hub.RebuildChart();
    return true;
}

// --- Chart2

Chart2::Chart2(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "Chart2", QStringLiteral("Second Chart"), parent),
      m_code(NumberBox(this, "txtCode", QString(), 90)), m_period(new QComboBox(this)) {
    m_code->setMaxLength(6);
    m_period->setObjectName(QStringLiteral("cboPeriod"));
    m_period->addItems(
        {QStringLiteral("Daily"), QStringLiteral("Weekly"), QStringLiteral("Monthly")});
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Code of the lower chart"), m_code);
    form->addRow(QStringLiteral("Period"), m_period);
    m_layout->addLayout(form);
    AddButtons();
}

bool Chart2::Ok() {
    const std::string code = platform::Upper(platform::Trim(S(m_code->text())));
    if (code.empty() || !app::FindSecurity(m_session, code)) {
        dialogs().MsgBox("No record on file for that code", "Second Chart");
        return false;
    }
    static constexpr char kPeriods[] = {'A', 'W', 'M'};
    m_hub.SecondChart(Q(code), QChar::fromLatin1(kPeriods[m_period->currentIndex()]));
    return true;
}

} // namespace kori::gui
