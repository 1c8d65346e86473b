#include "gui/windows/maint_windows.h"

#include "gui/windows/data_form.h"
#include "gui/windows/main_window.h"
#include "gui/windows/name_form.h"
#include "gui/windows/repair_windows.h"
#include "gui/windows/show_once.h"
#include "maint/old_files.h"

namespace kori::gui {

namespace {

template <typename Window> void Register(MainWindow& main, const char* name) {
    main.SetAction(name, [&main, name] {
        ShowOnce(main, name, [&main] { return new Window(main.session(), &main); });
    });
}
} // namespace

void RegisterMaintWindows(MainWindow& main) {
    Register<NameForm>(main, "NameForm");
    Register<ASXChg>(main, "ASXChg");
    Register<RemDate>(main, "RemDate");
    Register<RemDupST>(main, "RemDupST");
    Register<ResetFA>(main, "ResetFA");
    Register<MoveFiles>(main, "MoveFiles");
    main.SetAction("DumpOld", [&main] {
        auto& s = main.session();
        // Nothing to delete: the message alone, no window.
        if (maint::OldFiles(s.folders.DataFolder).empty()) {
            s.dialogs().MsgBox(maint::NoOldFilesMessage(s.folders.DataFolder),
                               maint::old_text::kTitle);
            return;
        }
        ShowOnce(main, "DumpOld", [&main] { return new DumpOld(main.session(), &main); });
    });
    main.SetAction("DataForm", [&main] {
        DataCodeEntry entry(main.session(), &main);
        if (entry.exec() != QDialog::Accepted || !entry.file()) return;
        auto* form = new DataForm(main.session(), *entry.file(), entry.code(), &main);
        form->setAttribute(Qt::WA_DeleteOnClose);
        if (!form->loaded()) { // the message was shown; there is nothing to edit
            form->deleteLater();
            return;
        }
        form->open();
    });
}

} // namespace kori::gui
