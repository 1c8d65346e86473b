#include "gui/windows/gics_class.h"

namespace kori::gui {

GicsClass::GicsClass(app::Session& session, bool pick, QWidget* parent)
    : ClassWindow(session,
                  {"GicsClass",
                   "Global Industry Classifications",
                   "Gics.dat",
                   "GICS Class",
                   4,
                   {QStringLiteral("GICS Sector Code"), QStringLiteral("Sector"),
                    QStringLiteral("Sub-Sector")},
                   false},
                  pick, parent) {}

} // namespace kori::gui
