#include "gui/windows/chart2.h"

#include "app/split_chart.h"

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
    const auto lower =
        app::ChooseSecondChart(m_session, S(m_code->text()), m_period->currentIndex(), dialogs());
    if (!lower) return false;
    m_hub.SecondChart(Q(lower->Name.TrimmedCode()), QChar::fromLatin1(lower->ChartPeriod));
    return true;
}

} // namespace kori::gui
