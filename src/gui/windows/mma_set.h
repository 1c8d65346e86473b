#pragma once
// MMASet: the twelve periods of the multiple moving averages, "Ave 1" to "Ave 6" twice.
#include "gui/windows/chart_default_window.h"

#include <array>

class QLineEdit;

namespace kori::gui {

class MMASet : public ChartDefaultWindow {
    Q_OBJECT
public:
    MMASet(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* box(int i) const { return m_boxes[static_cast<std::size_t>(i)]; }
    void Default();
    bool Ok() override;

private:
    std::array<QLineEdit*, 12> m_boxes{};
};

} // namespace kori::gui
