#include "gui/windows/v_height.h"

#include "app/window_rules.h"

#include <QGroupBox>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

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

} // namespace kori::gui
