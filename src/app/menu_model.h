#pragma once
// The main window's menu tree: names, captions and what each item opens, with the rules that
// show, hide, enable and disable items by the data service and by the files present. Windows
// turn this into real menus; the rules live here so they can be tested without a display.
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

struct MenuItem {
    std::string name;    // control name, e.g. "mnuChartDisplay"
    std::string caption; // with its '&' accelerator
    std::string opens;   // window or action it starts
    bool visible = true;
    bool enabled = true;
    bool separatorBefore = false;
    std::vector<MenuItem> items;

    MenuItem* Find(const std::string& itemName);
    const MenuItem* Find(const std::string& itemName) const;
};

struct MenuConditions {
    int DataService = 0;
    bool HideDownloadProgram = false; // command-line word "A"
    bool SecurityDetailsPresent = false;
    bool MaxScanPresent = false;
    bool MMAScanPresent = false; // the companion averages scan program is installed
};

// The whole tree as the program defines it, before any rule is applied.
std::vector<MenuItem> BuildMenuTree();

// Menus by data service, the security-details item and the companion scan programs.
void ApplyMenuConditions(std::vector<MenuItem>& tops, const MenuConditions& c);

// While a tool that must not be interrupted runs, the tops are hidden.
void SetModalToolRunning(std::vector<MenuItem>& tops, bool running, const MenuConditions& c,
                         bool ending);

// Removes every item whose window or action this build does not have, so that no menu item
// leads nowhere. `available` says, for an item name, whether it is built.
template <typename Pred> void KeepAvailable(std::vector<MenuItem>& items, Pred available);

MenuItem* FindItem(std::vector<MenuItem>& tops, const std::string& name);

template <typename Pred> void KeepAvailable(std::vector<MenuItem>& items, Pred available) {
    std::vector<MenuItem> kept;
    for (auto& item : items) {
        if (!item.items.empty()) {
            KeepAvailable(item.items, available);
            if (item.items.empty()) continue;
            kept.push_back(std::move(item));
        } else if (available(item.name)) {
            kept.push_back(std::move(item));
        }
    }
    items = std::move(kept);
}

} // namespace kori::app
