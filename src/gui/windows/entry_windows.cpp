#include "gui/windows/entry_windows.h"

#include "gui/windows/data_entry.h"
#include "gui/windows/main_window.h"
#include "gui/windows/targets.h"

namespace kori::gui {

namespace {
// One window of a kind at a time: a second pick of the menu brings the open one forward.
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
} // namespace

void RegisterEntryWindows(MainWindow& main) {
    main.SetAction("DataEntry", [&main] {
        ShowOnce(main, "DataEntry", [&main] { return new DataEntry(main.session(), &main); });
    });
    main.SetAction("Targets", [&main] {
        ShowOnce(main, "Targets", [&main] { return new Targets(main.session(), &main); });
    });
}

} // namespace kori::gui
