#pragma once
// The help pages shipped inside the program: which page covers which window, a word search
// over the pages, and the tips shown at start-up with their on/off setting.
#include "platform/settings_store.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace kori::app {

struct HelpPage {
    std::string id;                   // file name without ".html"
    std::string title;                // shown in the contents list
    std::vector<std::string> windows; // object names of the windows the page covers
    std::string keywords;             // blank-separated words the search also matches
};

inline constexpr std::string_view kHelpContentsId = "contents";
inline constexpr std::string_view kHelpCaption = "KORI Charting Help";

// Every page, the contents first, in the order of the contents list.
const std::vector<HelpPage>& HelpPages();
const HelpPage* FindHelpPage(std::string_view id);
// The page of a window by its object name; the contents when no page covers it.
const HelpPage& HelpPageForWindow(std::string_view objectName);
// Whether some page other than the contents covers the window.
bool HasOwnHelpPage(std::string_view objectName);

// Pages whose title or keywords hold every word of the query (case ignored, a word matches
// the start of a title or keyword word); a blank query finds nothing.
std::vector<const HelpPage*> SearchHelp(std::string_view query);

// The tips window's text and its place in the list.
class Tips {
public:
    static const std::vector<std::string>& All();
    explicit Tips(std::size_t start = 0);
    const std::string& Current() const;
    std::size_t Index() const { return m_index; }
    void Next();     // wraps after the last
    void Previous(); // wraps before the first

private:
    std::size_t m_index;
};

inline constexpr std::string_view kShowTipsKey = "Show Tips at Startup";
// On unless the store holds "False" (any case).
bool ShowTipsAtStartup(const platform::SettingsStore& settings);
void SetShowTipsAtStartup(platform::SettingsStore& settings, bool on);
// The menu item: flips the setting and returns the new state.
bool ToggleShowTipsAtStartup(platform::SettingsStore& settings);

} // namespace kori::app
