#include "gui/windows/gl_spaces.h"

#include "app/window_rules.h"

#include <QCheckBox>
#include <QFormLayout>
#include <QLineEdit>

namespace kori::gui {

GLSpaces::GLSpaces(app::Session& session, SettingsHub& hub, QWidget* parent)
    : ChartDefaultWindow(session, hub, "GLSpaces", QStringLiteral("Grid Line Spaces"), parent),
      m_space(NumberBox(this, "txtVGSpace", NumberText(m_defaults.VerticalGridSpace))),
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

} // namespace kori::gui
