#include "app/menu_model.h"

namespace kori::app {

namespace {
MenuItem Item(std::string name, std::string caption, std::string opens, bool sep = false) {
    MenuItem m;
    m.name = std::move(name);
    m.caption = std::move(caption);
    m.opens = std::move(opens);
    m.separatorBefore = sep;
    return m;
}
MenuItem Top(std::string name, std::string caption, std::vector<MenuItem> items) {
    MenuItem m = Item(std::move(name), std::move(caption), "");
    m.items = std::move(items);
    return m;
}
void Show(std::vector<MenuItem>& tops, const char* name, bool visible, bool enabled) {
    if (auto* m = FindItem(tops, name)) {
        m->visible = visible;
        m->enabled = enabled;
    }
}
} // namespace

MenuItem* MenuItem::Find(const std::string& itemName) {
    if (name == itemName) return this;
    for (auto& i : items)
        if (auto* f = i.Find(itemName)) return f;
    return nullptr;
}

const MenuItem* MenuItem::Find(const std::string& itemName) const {
    return const_cast<MenuItem*>(this)->Find(itemName);
}

MenuItem* FindItem(std::vector<MenuItem>& tops, const std::string& name) {
    for (auto& t : tops)
        if (auto* f = t.Find(name)) return f;
    return nullptr;
}

std::vector<MenuItem> BuildMenuTree() {
    MenuItem open = Top("mnOpen", "&Open",
                        {Item("mnuChartDisplay", "&CHARTS", "ChtSel"),
                         Item("mnuViewNames", "&Name File", "NameForm"),
                         Item("mnuViewData", "&Data File", "DataForm"),
                         Item("nmGics", "&Global Industry Classifications", "GicsClass"),
                         Item("nmIndCl", "&Industry Classifications", "IndClass"),
                         Item("mnuChartDefaults", "Chart De&faults List", "ChtDef"),
                         Item("mnuFundamtl", "&ASX Company Details", "Fundmnt")});
    MenuItem backup =
        Top("mnuBackup", "Bac&kup / Restore",
            {Item("mnuBackupData", "&Backup Chart Data", "ChartBak"),
             Item("mnuRestoreData", "&Restore Data from Backup", "ChartBak Restore")});
    std::vector<MenuItem> tops;
    tops.push_back(
        Top("mnuFile", "&File",
            {open, Item("mnuPaths", "&Folder Locations", "CPath", true),
             Item("mnFnts", "&Fonts", "ChtFonts"), Item("mnTPSU", "&Page Setup (Text)", "CHTPage"),
             Item("mnPrSU", "Printer &Setup", "PrinterDialog"), backup,
             Item("mnuImportCsv", "Import CSV History ...", "ImportCsv", true),
             Item("mnuExit", "E&XIT", "Exit", true)}));
    tops.push_back(Top("mnuData", "&Edit",
                       {Item("mnuKBUpdate", "Data Entry via &Keyboard", "DataEntry"),
                        Item("mnuLists", "Edit Chart &Lists", "SubList"),
                        Item("mnuListsUte", "Chart List &Utilities", "SubList2"),
                        Item("mnuRenameCL", "Rename Chart Lists", "CLNames"),
                        Item("mnImpTxtCds", "&Import Text to Chart Lists", "SubList3")}));
    tops.push_back(Top("mnuAComms", "&Download",
                       {Item("mnuZEVOT", "&KORI Download", "KoriDownload"),
                        Item("mnuCollectData", "&Collect Data (shortcut)", "KoriDownload"),
                        Item("mnuWatch", "&Watchlist", "Watchlist"),
                        Item("mnuKoriDLAdvantage", "&Advantages of KORI Download", "AboutDownload"),
                        Item("mnuBourse", "&Bourse Data ", "Bourse"),
                        Item("mnuDDetails", "Download Se&ttings", "ModDetails", true),
                        Item("mnuModem", "&Downloaded Data Update", "DLList")}));
    tops.push_back(Top(
        "mnTools", "&Tools",
        {Top("mnuAdjustData", "Adjust Data for &Issues",
             {Item("mnuAdjExBtn", "&Auto Adjustments from Downloaded Bulletin Files", "AdjList"),
              Item("mnuManAdjust", "&Manual Adjustment", "Adjust"),
              Item("mnuCodeChanged", "&ASX Code Changed", "ASXChg")}),
         Item("mnuDataCk", "Check &Data for Errors and Stocks Stopped Trading", "ChkDta"),
         Item("mnuResetRO", "Reset read-only data files", "ResetFA"),
         Item("mnuRemOld", "'Old' &files no longer required", "DumpOld"),
         Item("mnuMveData", "&Move data from one folder to another", "MoveFiles"),
         Item("mnutips", "Show tips at startup", "ToggleTips"),
         Item("mnuTextFile", "Create &text file of closing prices", "TextData"),
         Item("mnuTFD", "Create te&xt file of data (OHLCV)", "TextFull"),
         Item("mnuCDupDts", "&Remove data for a specific date", "RemDate"),
         Item("mnuDupDates", "Remove &Duplicate Dates", "RemDupST"),
         Item("mnuChkNameData", "Check &Name File - Data Files", "NameData"),
         Item("mnuADCheck", "&Check Advance-Decline Totals", "ADTotals"),
         Item("mnuPntCol", "&Printer Colour", "PrinterColour")}));
    tops.push_back(Top("mnuAnalysis", "&Chart Scans",
                       {Item("mnuMaxScan", "Kori Max-Scan", "KoriMaxScan"),
                        Item("mnuChartScan", "Chart Scan &1 - Prices / Oscillators", "chtScan1"),
                        Item("mnuChartScan2", "Chart Scan &2 - Volume", "ChtScan2"),
                        Item("mnuChtScan3", "Chart Scan &3 - Parabolic", "ChtScan3"),
                        Item("mnuMMAScan", "Chart Scan &4 - Multiple Moving Averages", "KoriMMA"),
                        Item("mnuAvCO", "Chart Scan &5 - Averages Crossover", "ChtScan6"),
                        Item("mnStats", "Market S&tatistics", "Statistics"),
                        Item("mnuSnapshot", "Current &Snapshot", "Snapshot"),
                        Item("mnuTargets", "Price &Targets (Quoren Alerts)", "Targets", true)}));
    tops.push_back(Top("mnuHelp", "&Help",
                       {Item("mnSHlp", "KORI Charting Help", "Help"),
                        Item("mnuAboutKORI", "&About KORI", "AbtKori")}));
    return tops;
}

void ApplyMenuConditions(std::vector<MenuItem>& tops, const MenuConditions& c) {
    const bool companion = c.DataService == 1 || c.DataService == 3;
    Show(tops, "mnuZEVOT", companion && !c.HideDownloadProgram, companion);
    Show(tops, "mnuWatch", companion && !c.HideDownloadProgram, companion);
    Show(tops, "mnuCollectData", companion, companion);
    Show(tops, "mnuKoriDLAdvantage", companion, companion);
    Show(tops, "mnuBourse", c.DataService == 2, c.DataService == 2);
    if (auto* m = FindItem(tops, "mnuMveData")) m->enabled = c.DataService == 3;
    if (auto* m = FindItem(tops, "mnuFundamtl")) m->enabled = c.SecurityDetailsPresent;
    Show(tops, "mnuMaxScan", c.MaxScanPresent, c.MaxScanPresent);
    // A companion program that is not installed has no item to fail from.
    Show(tops, "mnuMMAScan", c.MMAScanPresent, c.MMAScanPresent);
}

void SetModalToolRunning(std::vector<MenuItem>& tops, bool running, const MenuConditions& c,
                         bool ending) {
    for (const char* name : {"mnuFile", "mnuData", "mnuAComms", "mnTools", "mnuAnalysis"})
        if (auto* m = FindItem(tops, name)) m->visible = !running;
    if (!running && !ending) ApplyMenuConditions(tops, c);
}

} // namespace kori::app
