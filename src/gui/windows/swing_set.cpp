#include "gui/windows/swing_set.h"

#include "app/window_rules.h"

#include <QFormLayout>
#include <QGroupBox>
#include <QLineEdit>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

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
        r->setObjectName(Q("opt" + std::string(chart::SwingMethodName(chart::SwingMethods()[i]))));
        r->setChecked(chart::SwingMethods()[i] == s.SwingMethod);
        l->addWidget(r);
        m_methods[i] = r;
    }
    m_value = NumberBox(this, "txtSwingValue", SingleText(s.SwingValue));
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Days or points"), m_value);
    m_layout->addWidget(box);
    m_layout->addLayout(form);
    for (std::size_t i = 0; i < m_methods.size(); ++i) {
        connect(m_methods[i], &QRadioButton::toggled, this, [this, i](bool on) {
            const auto method = chart::SwingMethods()[i];
            m_value->setEnabled(chart::SwingMethodTakesValue(method));
            if (on && m_value->isEnabled())
                m_value->setText(SingleText(chart::DefaultSwingValue(method)));
        });
    }
    m_value->setEnabled(chart::SwingMethodTakesValue(s.SwingMethod));
    AddButtons();
}

bool SwingSet::Ok() {
    app::SwingSettings s;
    for (std::size_t i = 0; i < m_methods.size(); ++i)
        if (m_methods[i]->isChecked()) s.SwingMethod = chart::SwingMethods()[i];
    const std::string t = S(m_value->text());
    if (!app::Accept(app::SwingValueProblem(s.SwingMethod, t), dialogs())) return false;
    const auto v = app::TypedNumber(t);
    s.SwingValue = v ? static_cast<float>(*v) : chart::DefaultSwingValue(s.SwingMethod);
    app::WriteSwingSettings(m_session.ini(), s);
    m_hub.RebuildChart();
    return true;
}

} // namespace kori::gui
