#pragma once
// The oscillator identifiers held in OscName, in the order the dispatcher compares them, with
// their toolbar keys, their names in lists and the routine each selects; and the two
// multi-oscillator sets kept in the settings store.
#include "platform/settings_store.h"

#include <array>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace kori::osc {

struct OscIdentifier {
    std::string_view OscName;
    std::string_view ToolbarKey;     // "tbSTF" for the fast stochastic
    std::string_view SlowToolbarKey; // "tbSTS"; empty for all others
    std::string_view ListName;       // empty where the oscillator has no name in lists
    std::string_view SlowListName;   // "Stochastic (Slow)"
    std::string_view Routine;        // "OscROC, OscStochFX" for the pair
    bool OnPriceChart = false;       // "PARA", "PARAV": drawn on the price chart
};

// Dispatcher order: the 17 oscillators, then the two parabolic identifiers.
std::span<const OscIdentifier> OscIdentifiers();
const OscIdentifier* FindOscIdentifier(std::string_view oscName);

// What a toolbar key or a list name selects: the identifier and the slow-stochastic flag.
struct OscChoice {
    std::string_view OscName;
    bool SlowStochastic = false;
};
std::optional<OscChoice> OscChoiceForToolbarKey(std::string_view key);
std::optional<OscChoice> OscChoiceForListName(std::string_view listName);

// The multi-oscillator list: "None" and the 17 names in the order the window offers them.
std::span<const std::string_view> MultiOscChoices();

inline constexpr std::size_t kMultiOscSlots = 5;
struct MultiOscSet {
    std::array<std::string, kMultiOscSlots> Slots{"None", "None", "None", "None", "None"};
};

// Set 1 or 2, under the keys "Multi-Osc 1" and "Multi-Osc 2" of the settings store.
std::string MultiOscKey(int set);
MultiOscSet LoadMultiOscSet(const platform::SettingsStore& store, int set);
void SaveMultiOscSet(platform::SettingsStore& store, int set, const MultiOscSet& slots);

} // namespace kori::osc
