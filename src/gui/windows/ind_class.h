#pragma once
// IndClass: the industry classes of IndClass.dat, "Class Id" and "Industry Classification".
#include "gui/windows/class_window.h"

namespace kori::gui {

class IndClass : public ClassWindow {
    Q_OBJECT
public:
    explicit IndClass(app::Session& session, bool pick = false, QWidget* parent = nullptr);
};

} // namespace kori::gui
