#include "gui/windows/ind_class.h"

namespace kori::gui {

IndClass::IndClass(app::Session& session, bool pick, QWidget* parent)
    : ClassWindow(session,
                  {"IndClass",
                   "Industry Classifications",
                   "IndClass.dat",
                   "Industry Class",
                   3,
                   {QStringLiteral("Class Id"), QStringLiteral("Industry Classification")},
                   true},
                  pick, parent) {}

} // namespace kori::gui
