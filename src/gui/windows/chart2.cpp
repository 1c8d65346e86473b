#include "gui/windows/chart2.h"

#include "app/chart_service.h"
#include "app/window_rules.h"
#include "platform/text.h"

#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>

namespace kori::gui {

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
