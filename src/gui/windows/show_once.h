#pragma once
// One window of a kind at a time: a second pick of the menu brings the open one forward.
#include "gui/windows/main_window.h"

#include <QDialog>

namespace kori::gui {

// `make` builds the window (named `name`) when none is open; it is deleted when closed.
template <typename Make> void ShowOnce(MainWindow& main, const char* name, Make make) {
    if (auto* open = main.findChild<QDialog*>(QString::fromLatin1(name))) {
        open->raise();
        open->activateWindow();
        return;
    }
    QDialog* w = make();
    w->setAttribute(Qt::WA_DeleteOnClose);
    w->open();
}

} // namespace kori::gui
