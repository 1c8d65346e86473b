#include "gui/windows/entry_windows.h"

#include "gui/windows/data_entry.h"
#include "gui/windows/import_csv.h"
#include "gui/windows/main_window.h"
#include "gui/windows/show_once.h"
#include "gui/windows/targets.h"

namespace kori::gui {

void RegisterEntryWindows(MainWindow& main) {
    main.SetAction("DataEntry", [&main] {
        ShowOnce(main, "DataEntry", [&main] { return new DataEntry(main.session(), &main); });
    });
    main.SetAction("ImportCsv", [&main] {
        ShowOnce(main, "ImportCsv", [&main] { return new ImportCsv(main.session(), &main); });
    });
    main.SetAction("Targets", [&main] {
        ShowOnce(main, "Targets", [&main] { return new Targets(main.session(), &main); });
    });
}

} // namespace kori::gui
