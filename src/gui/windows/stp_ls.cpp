#include "gui/windows/stp_ls.h"

#include "app/window_rules.h"

#include <QCheckBox>
#include <QFormLayout>
#include <QLineEdit>

namespace kori::gui {

StpLs::StpLs(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "StpLs", QStringLiteral("Stop Loss"), parent),
      m_on(new QCheckBox(QStringLiteral("Show the stop loss"), this)),
      m_percent(NumberBox(this, "txtPercent", SingleText(m_defaults.StopPercent))) {
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

} // namespace kori::gui
