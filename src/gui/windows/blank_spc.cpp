#include "gui/windows/blank_spc.h"

#include "app/window_rules.h"

#include <QFormLayout>
#include <QLineEdit>

namespace kori::gui {

BlankSpc::BlankSpc(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "BlankSpc", QStringLiteral("Blank Space"), parent),
      m_blank(NumberBox(this, "txtBlank", NumberText(m_defaults.BlankRight))) {
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

} // namespace kori::gui
