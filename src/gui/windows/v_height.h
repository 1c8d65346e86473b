#pragma once
// VHeight: the volume panel at one, two or three times its height.
#include "gui/windows/chart_default_window.h"

#include <array>

class QRadioButton;

namespace kori::gui {

class VHeight : public ChartDefaultWindow {
    Q_OBJECT
public:
    VHeight(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QRadioButton* option(int multiple) const {
        return m_options[static_cast<std::size_t>(multiple - 1)];
    }
    bool Ok() override;

private:
    std::array<QRadioButton*, 3> m_options{};
};

} // namespace kori::gui
