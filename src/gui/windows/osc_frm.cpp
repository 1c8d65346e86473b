#include "gui/windows/osc_frm.h"

#include "platform/text.h"

#include <QDoubleValidator>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

OscFrm::OscFrm(app::Session& session, SettingsHub& hub, const std::string& oscName, char chartStyle,
               const std::string& chartPeriod, QWidget* parent)
    : SettingsDialog(session, hub, "OscFrm", QString(), parent), m_oscName(oscName),
      m_weekly(platform::Trim(chartPeriod) != "A"), m_pointAndFigure(chartStyle == 'P'),
      m_def(osc::ReadOscSettings(session.ini())) {
    if (m_pointAndFigure)
        BuildBoxForm();
    else
        BuildOscillatorForm();
}

void OscFrm::BuildOscillatorForm() {
    setWindowTitle(Q(app::OscDialogTitle(m_oscName)));
    // Periods not set yet show their defaults; they are written only on OK.
    osc::FillOscDefaults(m_def, m_oscName, m_weekly);
    auto* form = new QFormLayout;
    // The ATR period belongs to the chart defaults, not to this dialog.
    const bool ownFields = m_oscName != "ATR";
    for (std::string_view key :
         ownFields ? osc::OscSettingKeys(m_oscName) : std::span<const std::string_view>{}) {
        const auto* k = osc::FindOscPeriodKey(key);
        if (k == nullptr) continue;
        auto* edit = new QLineEdit(this);
        edit->setObjectName(Q(std::string(m_weekly ? k->Weekly : k->Daily)));
        edit->setMaxLength(5);
        edit->setText(QString::number(m_def.*(m_weekly ? k->WeeklyField : k->DailyField)));
        form->addRow(Q(std::string(app::OscFieldLabel(key))), edit);
        m_fields.push_back(edit);
    }
    if (m_oscName == "RMO" || m_oscName == "RMX") {
        m_compare = new QLineEdit(Q(app::CompareFileText(m_def.CompFile)), this);
        m_compare->setObjectName(QStringLiteral("txtCompare"));
        m_compare->setMaxLength(100);
        m_compare->setMinimumWidth(300);
        form->addRow(QStringLiteral("Compare to:"), m_compare);
        connect(m_compare, &QLineEdit::editingFinished, this, [this] {
            if (m_compare->text().trimmed().isEmpty())
                dialogs().MsgBox("Compare file code must be entered", m_oscName);
        });
    }
    if (m_fields.empty() && !m_compare)
        form->addRow(new QLabel(ownFields ? QStringLiteral("This oscillator has no settings.")
                                          : QStringLiteral("The Average True Range period is set "
                                                           "in the Chart Defaults."),
                                this));
    auto* heading = new QLabel(m_weekly ? QStringLiteral("Weekly and monthly charts")
                                        : QStringLiteral("Daily charts"),
                               this);
    auto* ok = Button(QStringLiteral("OK"), "cmdOK");
    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    ok->setDefault(true);
    connect(ok, &QPushButton::clicked, this, [this] {
        if (Ok()) accept();
    });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(ok);
    buttons->addWidget(close);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(heading);
    layout->addLayout(form);
    layout->addLayout(buttons);
    layout->setSizeConstraint(QLayout::SetFixedSize);
}

void OscFrm::BuildBoxForm() {
    setWindowTitle(QStringLiteral("Point and Figure"));
    m_box = new QLineEdit(this);
    m_box->setObjectName(QStringLiteral("txtBoxValue"));
    m_box->setMaxLength(5);
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Box Value "), m_box);
    auto* ok = Button(QStringLiteral("OK"), "cmdOK");
    auto* autoButton = Button(QStringLiteral("Auto "), "cmdAuto");
    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    ok->setDefault(true);
    connect(ok, &QPushButton::clicked, this, [this] {
        if (Ok()) accept();
    });
    connect(autoButton, &QPushButton::clicked, this, [this] {
        Auto();
        accept();
    });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(ok);
    buttons->addWidget(autoButton);
    buttons->addWidget(close);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addLayout(buttons);
    layout->setSizeConstraint(QLayout::SetFixedSize);
}

bool OscFrm::Ok() {
    if (m_pointAndFigure) {
        const std::string text = S(m_box->text());
        if (auto problem = osc::BoxValueProblem(text)) {
            dialogs().MsgBox(problem->text, problem->title);
            return false;
        }
        m_boxAnswer = app::BoxValueAnswer{false, static_cast<float>(platform::Val(text))};
        return true;
    }
    osc::OscDef edited = m_def;
    std::size_t i = 0;
    for (std::string_view key : osc::OscSettingKeys(m_oscName)) {
        const auto* k = osc::FindOscPeriodKey(key);
        if (k == nullptr) continue;
        if (i >= m_fields.size()) break;
        // Text that is no whole number fails the range test as 0 does, or, for a field with
        // no test, is held as 0 ("none").
        const auto v = app::WholeNumber(S(m_fields[i++]->text()));
        const int n = v.value_or(0);
        edited.*(m_weekly ? k->WeeklyField : k->DailyField) =
            static_cast<std::int16_t>(n < -32768 || n > 32767 ? 0 : n);
    }
    if (m_compare) edited.CompFile = platform::Trim(S(m_compare->text()));
    if (auto problem = osc::OscFormProblem(edited, m_oscName, m_weekly)) {
        dialogs().MsgBox(problem->text, problem->title);
        return false;
    }
    m_def = edited;
    (void)osc::WriteOscSettings(m_session.ini(), m_def);
    m_hub.ShowOscillator(Q(m_oscName));
    return true;
}

void OscFrm::Auto() {
    m_boxAnswer = app::BoxValueAnswer{true, 0};
}

std::optional<app::BoxValueAnswer> OscFrm::AskBoxValue(app::Session& session, SettingsHub& hub,
                                                       float proposal, QWidget* parent) {
    OscFrm w(session, hub, "", 'P', "A", parent);
    w.boxValue()->setText(Q(platform::Trim(platform::StrSingle(proposal))));
    if (w.exec() != QDialog::Accepted) return std::nullopt;
    return w.boxAnswer();
}

} // namespace kori::gui
