#include "osc/osc_identifiers.h"

#include "platform/text.h"

namespace kori::osc {

namespace {

constexpr OscIdentifier kIdentifiers[] = {
    {"ATR", "tbATR", "", "Average True Range", "", "OscATR"},
    {"STO", "tbSTF", "tbSTS", "Stochastic (Fast)", "Stochastic (Slow)", "OscStochFX"},
    {"FX", "tbFX", "", "FX", "", "OscStochFX"},
    {"ROC", "tbROC", "", "ROC", "", "OscROC"},
    {"RMX", "tbRMX", "", "RMX", "", "OscRMX"},
    {"RMO", "tbRMO", "", "", "", "OscRMO"},
    {"R/F", "tbROCFX", "", "ROC and FX", "", "OscROC, OscStochFX"},
    {"RSI", "tbRSI", "", "RSI", "", "OscRSI"},
    {"MACD", "tbMcD", "", "MACD", "", "OscMACD"},
    {"WMS", "tbWR", "", "Williams %R", "", "OscWilliams"},
    {"ERY", "tbER", "", "Elder Ray", "", "OscElderRay"},
    {"MOM", "tbMOM", "", "Momentum", "", "OscMomentum"},
    {"DM", "tbDM", "", "Directional Movement", "", "OscDirectional"},
    {"JHG", "tbJHG", "", "Jones Holy Grail", "", "OscHolyGrail"},
    {"COP", "tbCOP", "", "Coppock", "", "OscCoppock"},
    {"VTY", "tbVTY", "", "Volatility", "", "OscVolatility"},
    {"OBV", "tbOBV", "", "OBV", "", "OscOBV"},
    {"PARA", "", "", "", "", "", true},
    {"PARAV", "", "", "", "", "", true},
};

constexpr std::string_view kMultiOscChoices[] = {
    "None",
    "Average True Range",
    "Directional Movement",
    "Coppock",
    "Elder Ray",
    "FX",
    "Jones Holy Grail",
    "OBV",
    "MACD",
    "Momentum",
    "ROC",
    "ROC and FX",
    "RMX",
    "RSI",
    "Stochastic (Fast)",
    "Stochastic (Slow)",
    "Volatility",
    "Williams %R",
};

std::string SlotText(std::string_view text) {
    std::string t = platform::Trim(text);
    return t.empty() ? std::string("None") : t;
}

} // namespace

std::span<const OscIdentifier> OscIdentifiers() {
    return kIdentifiers;
}

const OscIdentifier* FindOscIdentifier(std::string_view oscName) {
    const std::string name = platform::Trim(oscName);
    for (const auto& id : kIdentifiers)
        if (id.OscName == name) return &id;
    return nullptr;
}

std::optional<OscChoice> OscChoiceForToolbarKey(std::string_view key) {
    for (const auto& id : kIdentifiers) {
        if (!id.ToolbarKey.empty() && id.ToolbarKey == key) return OscChoice{id.OscName, false};
        if (!id.SlowToolbarKey.empty() && id.SlowToolbarKey == key)
            return OscChoice{id.OscName, true};
    }
    return std::nullopt;
}

std::optional<OscChoice> OscChoiceForListName(std::string_view listName) {
    const std::string name = platform::Trim(listName);
    for (const auto& id : kIdentifiers) {
        if (!id.ListName.empty() && id.ListName == name) return OscChoice{id.OscName, false};
        if (!id.SlowListName.empty() && id.SlowListName == name) return OscChoice{id.OscName, true};
    }
    return std::nullopt;
}

std::span<const std::string_view> MultiOscChoices() {
    return kMultiOscChoices;
}

std::string MultiOscKey(int set) {
    return "Multi-Osc " + std::to_string(set);
}

MultiOscSet LoadMultiOscSet(const platform::SettingsStore& store, int set) {
    MultiOscSet result;
    const std::string stored = store.Get(MultiOscKey(set), "");
    std::size_t slot = 0;
    std::size_t start = 0;
    while (slot < kMultiOscSlots && start <= stored.size() && !stored.empty()) {
        const auto comma = stored.find(',', start);
        const auto end = comma == std::string::npos ? stored.size() : comma;
        result.Slots[slot++] = SlotText(std::string_view(stored).substr(start, end - start));
        if (comma == std::string::npos) break;
        start = comma + 1;
    }
    return result;
}

void SaveMultiOscSet(platform::SettingsStore& store, int set, const MultiOscSet& slots) {
    std::string joined;
    for (std::size_t i = 0; i < kMultiOscSlots; ++i) {
        if (i > 0) joined += ',';
        joined += platform::Trim(slots.Slots[i]);
    }
    store.Save(MultiOscKey(set), joined);
}

} // namespace kori::osc
