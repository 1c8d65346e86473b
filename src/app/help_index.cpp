#include "app/help_index.h"

#include "platform/text.h"

#include <algorithm>

namespace kori::app {

const std::vector<HelpPage>& HelpPages() {
    // The contents page lists these in this order; a window named in no entry gets the
    // contents page from F1.
    static const std::vector<HelpPage> pages{
        {"contents", "Contents", {"Main"}, "index menu overview"},
        {"getting-started",
         "Getting started",
         {},
         "first start sample library folders kori command line"},
        {"keys", "Chart window keys", {}, "keyboard shortcuts arrow next previous"},
        {"chart-selection", "Chart Selection Menu", {"ChtSel"}, "charts list period style spacing"},
        {"chart-window",
         "The chart window",
         {"Chts", "ChartWindows"},
         "chart trendline toolbar save print"},
        {"viewing-options", "Viewing Options", {"ChtOptions"}, "chart display grid volume"},
        {"bands", "Bands", {"ChtBands"}, "chart bands envelope"},
        {"zoom", "Zoom", {"ZoomKori"}, "chart enlarge"},
        {"search-by-name", "Search by Name", {"Search"}, "find company code"},
        {"finish-date", "Finish Date", {"FinDate"}, "chart end date"},
        {"print-chart", "Print Chart", {"PrintPreview"}, "printer paper preview"},
        {"oscillator-settings",
         "Oscillator settings",
         {"OscFrm"},
         "rsi stochastic macd point figure"},
        {"multi-osc", "Multi-oscillator chart", {"MultiOscChart"}, "oscillators stacked multi-osc"},
        {"chart-defaults", "Chart Defaults", {"ChtDef"}, "moving average oscillator defaults"},
        {"chart-settings",
         "Chart settings windows",
         {"PLW", "BlankSpc", "GLSpaces", "VHeight", "StpLs", "MMASet", "SwingSet", "Chart2",
          "Scales"},
         "line width blank space grid volume height stop loss mma swing second chart scales"},
        {"colours", "Change Chart Colours", {"ColNew"}, "colours colors palette"},
        {"multi-osc-setup", "MultiOsc Setup", {"MultiOsc"}, "multi oscillators setup slots"},
        {"name-file", "Name File", {"NameForm"}, "securities codes names edit"},
        {"data-file",
         "Data File",
         {"DataForm", "DataCodeEntry", "VolMod"},
         "prices edit records volume"},
        {"classifications",
         "Industry classifications",
         {"IndClass", "GicsClass"},
         "gics industry sector"},
        {"company-details", "ASX Company Details", {"Fundmnt"}, "fundamentals company details"},
        {"folder-locations",
         "Folder Locations",
         {"CPath", "DataPaths", "Locate"},
         "folders paths data system"},
        {"fonts", "Fonts", {"ChtFonts"}, "chart font size"},
        {"page-setup", "Page Setup", {"CHTPage"}, "margins orientation printer"},
        {"backup", "Backup and restore", {"ChartBak", "ChartBak Restore"}, "backup restore copy"},
        {"import-csv", "Import CSV History", {"ImportCsv"}, "csv import history"},
        {"data-entry", "Data Entry via Keyboard", {"DataEntry"}, "type prices keyboard"},
        {"chart-lists", "Edit Chart Lists", {"SubList"}, "chart list edit"},
        {"chart-list-utilities", "Chart List Utilities", {"SubList2"}, "chart list copy merge"},
        {"rename-chart-lists", "Rename Chart Lists", {"CLNames"}, "chart list names"},
        {"import-text-lists", "Import Text to Chart Lists", {"SubList3"}, "chart list text import"},
        {"watchlist", "Watchlist", {"Watchlist"}, "watch list entry price quantity notes targets"},
        {"download-settings",
         "Download Settings",
         {"ModDetails", "DLWizard", "INUpList"},
         "download service folder wizard"},
        {"downloaded-data-update",
         "Downloaded Data Update",
         {"DLList"},
         "update day files download"},
        {"auto-adjustments",
         "Auto adjustments from bulletins",
         {"AdjList", "AdjOpts"},
         "adjust bulletin issues"},
        {"manual-adjustment",
         "Manual Adjustment",
         {"Adjust", "AdjDate", "AdjustR", "AdjustB", "AdjustC", "AdjustSS", "AdjustCC"},
         "adjust bonus split cash call"},
        {"code-changed", "ASX Code Changed", {"ASXChg"}, "code change rename"},
        {"check-data",
         "Check Data for Errors",
         {"ChkDta", "DataStat"},
         "errors stopped trading check"},
        {"reset-read-only", "Reset read-only data files", {"ResetFA"}, "read-only attributes"},
        {"old-files", "'Old' files no longer required", {"DumpOld"}, "old files delete"},
        {"move-data", "Move data from one folder to another", {"MoveFiles"}, "move folder"},
        {"remove-date", "Remove data for a specific date", {"RemDate"}, "delete date"},
        {"remove-duplicates", "Remove Duplicate Dates", {"RemDupST"}, "duplicate dates"},
        {"text-closing", "Text file of closing prices", {"TextData"}, "export text closing"},
        {"text-data", "Text file of data (OHLCV)", {"TextFull"}, "export text ohlcv"},
        {"name-data", "Check Name File - Data Files", {"NameData"}, "name file data files missing"},
        {"ad-totals", "Check Advance/Decline Totals", {"ADTotals"}, "advance decline totals"},
        {"scan1", "Chart Scan 1 - Prices / Oscillators", {"chtScan1"}, "scan prices oscillators"},
        {"scan2", "Chart Scan 2 - Volume", {"ChtScan2"}, "scan volume"},
        {"scan3", "Chart Scan 3 - Parabolic", {"ChtScan3"}, "scan parabolic"},
        {"scan5", "Chart Scan 5 - Averages Crossover", {"ChtScan6"}, "scan averages crossover"},
        {"statistics", "Market Statistics", {"Statistics"}, "advance decline breadth statistics"},
        {"snapshot", "Current Snapshot", {"Snapshot"}, "snapshot market today"},
        {"targets", "Price Targets", {"Targets"}, "targets alerts"},
        {"help", "Using help and tips", {"HelpBrowser", "Tips"}, "help tips f1 search"},
        {"about", "About KORI", {"AbtKori"}, "version folders install"},
    };
    return pages;
}

const HelpPage* FindHelpPage(std::string_view id) {
    for (const auto& p : HelpPages())
        if (p.id == id) return &p;
    return nullptr;
}

namespace {
const HelpPage* PageCovering(std::string_view objectName) {
    if (objectName.empty()) return nullptr;
    for (const auto& p : HelpPages())
        if (std::find(p.windows.begin(), p.windows.end(), objectName) != p.windows.end()) return &p;
    return nullptr;
}

std::vector<std::string> Words(std::string_view text) {
    std::vector<std::string> words;
    std::string word;
    for (char c : platform::Lower(text)) {
        const bool part = (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '-';
        if (part) {
            word += c;
        } else if (!word.empty()) {
            words.push_back(word);
            word.clear();
        }
    }
    if (!word.empty()) words.push_back(word);
    return words;
}
} // namespace

const HelpPage& HelpPageForWindow(std::string_view objectName) {
    if (const auto* p = PageCovering(objectName)) return *p;
    return *FindHelpPage(kHelpContentsId);
}

bool HasOwnHelpPage(std::string_view objectName) {
    const auto* p = PageCovering(objectName);
    return p && p->id != kHelpContentsId;
}

std::vector<const HelpPage*> SearchHelp(std::string_view query) {
    std::vector<const HelpPage*> found;
    const auto wanted = Words(query);
    if (wanted.empty()) return found;
    for (const auto& p : HelpPages()) {
        const auto words = Words(p.title + " " + p.keywords);
        const bool all = std::all_of(wanted.begin(), wanted.end(), [&](const std::string& w) {
            return std::any_of(words.begin(), words.end(),
                               [&](const std::string& have) { return have.rfind(w, 0) == 0; });
        });
        if (all) found.push_back(&p);
    }
    return found;
}

const std::vector<std::string>& Tips::All() {
    static const std::vector<std::string> tips{
        "Press F1 in any window to read the help page of that window.",
        "In the chart window, Page Down shows the next chart of the list and Page Up the "
        "previous one.",
        "The -1D and +1D buttons of the chart window move the end of the chart back or forward "
        "a day at a time.",
        "A scan leaves its finds in a chart list: pick that list in the Chart Selection Menu to "
        "step through the charts of every find.",
        "Keep a back-up: File, Backup / Restore, Backup Chart Data copies your whole library.",
        "Waiting day files in the download folder are offered for the update as the program "
        "starts.",
        "Chart Defaults List sets the moving averages and oscillators that every chart uses.",
        "Edit Chart Lists lets you keep up to ten lists of your own securities.",
        "Check Data for Errors finds price records that cannot be right and securities that "
        "stopped trading.",
        "Auto Adjustments from Downloaded Bulletin Files adjusts price histories for bonus "
        "issues, splits and other capital changes.",
        "The Watchlist shows how far each of your holdings has moved since you bought it.",
        "Market Statistics counts advancing and declining securities day by day.",
        "Saved charts can be opened again from the chart window even when the data has changed "
        "since.",
        "Folder Locations tells the program where your data, back-ups and downloads are kept.",
        "The kori command line tool does updates, scans and exports without opening a window: "
        "run kori --help.",
    };
    return tips;
}

Tips::Tips(std::size_t start) : m_index(start % All().size()) {}

const std::string& Tips::Current() const {
    return All()[m_index];
}

void Tips::Next() {
    m_index = (m_index + 1) % All().size();
}

void Tips::Previous() {
    m_index = (m_index + All().size() - 1) % All().size();
}

bool ShowTipsAtStartup(const platform::SettingsStore& settings) {
    return platform::Upper(platform::Trim(settings.Get(kShowTipsKey, "True"))) != "FALSE";
}

void SetShowTipsAtStartup(platform::SettingsStore& settings, bool on) {
    settings.Save(kShowTipsKey, on ? "True" : "False");
}

bool ToggleShowTipsAtStartup(platform::SettingsStore& settings) {
    const bool on = !ShowTipsAtStartup(settings);
    SetShowTipsAtStartup(settings, on);
    return on;
}

} // namespace kori::app
