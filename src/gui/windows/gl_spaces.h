#pragma once
// GLSpaces: the vertical grid space (0 turns the date grid off) and the price grid at half
// steps.
#include "gui/windows/chart_default_window.h"

class QCheckBox;
class QLineEdit;

namespace kori::gui {

class GLSpaces : public ChartDefaultWindow {
    Q_OBJECT
public:
    GLSpaces(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* space() const { return m_space; }
    QCheckBox* midGrid() const { return m_midGrid; }
    bool Ok() override;

private:
    QLineEdit* m_space;
    QCheckBox* m_midGrid;
};

} // namespace kori::gui
