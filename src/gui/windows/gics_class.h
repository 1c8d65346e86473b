#pragma once
// GicsClass: the sectors of Gics.dat, "GICS Sector Code", "Sector" and "Sub-Sector"; the
// same grid as IndClass without printing.
#include "gui/windows/class_window.h"

namespace kori::gui {

class GicsClass : public ClassWindow {
    Q_OBJECT
public:
    explicit GicsClass(app::Session& session, bool pick = false, QWidget* parent = nullptr);
};

} // namespace kori::gui
