#pragma once
// The oscillator registry: one row an identifier held in OscName, in the order the dispatcher
// compares them, with its captions, its period keys, its computation and its panel. The
// chooser, the chart, `kori indicator` and the scans all read these rows; nothing else
// dispatches on the identifier. Also the two multi-oscillator sets of the settings store.
#include "platform/settings_store.h"

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace kori::chart {
struct Chart;
}
namespace kori::platform {
class Surface;
}
namespace kori::store {
struct ChartSeries;
}

namespace kori::osc {

struct OscDef;
struct OscDrawInputs;
struct OscInputs;
class OscColumns;

// Fills the named columns of an identifier from its periods (in the order of its keys).
using OscComputeFn = void (*)(OscColumns& out, const store::ChartSeries& series,
                              std::span<const std::int16_t> periods, const OscInputs& in);
// Draws the identifier's panel (the routine or routines it selects).
using OscDrawFn = void (*)(chart::Chart& chart, const OscDef& def, char chartPeriod,
                           const OscDrawInputs& in, platform::Surface& panel);

struct OscIdentifier {
    std::string_view OscName;
    std::string_view Caption;               // in the chart selection chooser; empty for none
    std::string_view SlowCaption;           // "Stochastic(slow)"; empty for all others
    std::string_view ListName;              // in the multi-oscillator lists; empty for none
    std::string_view SlowListName;          // "Stochastic (Slow)"
    std::array<std::string_view, 4> Keys{}; // daily keys of its periods, validation order
    std::size_t KeyCount = 0;
    OscComputeFn Compute = nullptr; // none for the parabolic
    OscDrawFn Draw = nullptr;       // none for the parabolic
    bool OnPriceChart = false;      // "PARA", "PARAV": drawn on the price chart

    std::span<const std::string_view> PeriodKeys() const { return {Keys.data(), KeyCount}; }
};

// Dispatcher order: the 17 oscillators, then the two parabolic identifiers.
std::span<const OscIdentifier> OscIdentifiers();
const OscIdentifier* FindOscIdentifier(std::string_view oscName);

// One row of a list of oscillators: the identifier and the slow-stochastic flag.
struct OscChoice {
    std::string_view OscName;
    bool SlowStochastic = false;
};
// The chart selection chooser after its "(None)" row, in the window's order.
std::span<const OscChoice> ChooserOrder();
// The caption of a chooser or list row, from the identifier's row.
std::string_view ChooserCaption(const OscChoice& choice);
std::string_view ListName(const OscChoice& choice);

// The multi-oscillator list: "None" and the 17 names in the order the window offers them.
std::span<const std::string_view> MultiOscChoices();
// The oscillator behind a name of that list (trimmed, exact case); nullopt for "None" and for a
// name the list does not offer.
std::optional<OscChoice> FindMultiOscChoice(std::string_view listName);

inline constexpr std::size_t kMultiOscSlots = 5;
struct MultiOscSet {
    std::array<std::string, kMultiOscSlots> Slots{"None", "None", "None", "None", "None"};
};

// Set 1 or 2, under the keys "Multi-Osc 1" and "Multi-Osc 2" of the settings store.
std::string MultiOscKey(int set);
MultiOscSet LoadMultiOscSet(const platform::SettingsStore& store, int set);
void SaveMultiOscSet(platform::SettingsStore& store, int set, const MultiOscSet& slots);

} // namespace kori::osc
