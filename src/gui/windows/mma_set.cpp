#include "gui/windows/mma_set.h"

#include "app/window_rules.h"

#include <QFormLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPushButton>

namespace kori::gui {

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
                                NumberText(m_defaults.MMAPeriods[static_cast<std::size_t>(n)]), 60);
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

} // namespace kori::gui
