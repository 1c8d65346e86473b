#include "gui/windows/list_windows.h"

#include "gui/windows/cl_names.h"
#include "gui/windows/gics_class.h"
#include "gui/windows/ind_class.h"
#include "gui/windows/main_window.h"
#include "gui/windows/settings_windows.h"
#include "gui/windows/show_once.h"
#include "gui/windows/sub_list.h"
#include "gui/windows/sub_list2.h"
#include "gui/windows/sub_list3.h"

namespace kori::gui {

void RegisterListWindows(MainWindow& main) {
    main.SetAction("SubList", [&main] {
        ShowOnce(main, "SubList",
                 [&main] { return new SubList(main.session(), Hub(main), &main); });
    });
    main.SetAction("SubList2", [&main] {
        ShowOnce(main, "SubList2",
                 [&main] { return new SubList2(main.session(), Hub(main), &main); });
    });
    main.SetAction("SubList3", [&main] {
        ShowOnce(main, "SubList3",
                 [&main] { return new SubList3(main.session(), Hub(main), &main); });
    });
    main.SetAction("CLNames", [&main] {
        ShowOnce(main, "CLNames",
                 [&main] { return new CLNames(main.session(), Hub(main), &main); });
    });
    main.SetAction("IndClass", [&main] {
        ShowOnce(main, "IndClass", [&main] { return new IndClass(main.session(), false, &main); });
    });
    main.SetAction("GicsClass", [&main] {
        ShowOnce(main, "GicsClass",
                 [&main] { return new GicsClass(main.session(), false, &main); });
    });
}

} // namespace kori::gui
