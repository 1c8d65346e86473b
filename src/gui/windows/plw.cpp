#include "gui/windows/plw.h"

#include "app/window_rules.h"

#include <QFormLayout>
#include <QLineEdit>

namespace kori::gui {

PLW::PLW(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "PLW", QStringLiteral("Printer Line Width"), parent),
      m_width(NumberBox(this, "txtWidth", NumberText(m_defaults.PrintLineWidth))) {
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

} // namespace kori::gui
