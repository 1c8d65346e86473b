#include "app/window_position.h"

#include "platform/rounding.h"
#include "platform/text.h"

#include <vector>

namespace kori::app {

std::optional<WindowPosition> ParseWindowPosition(std::string_view text) {
    std::vector<std::int32_t> parts;
    std::size_t start = 0;
    for (;;) {
        const auto comma = text.find(',', start);
        const auto part = text.substr(start, comma == std::string_view::npos ? text.npos : comma - start);
        parts.push_back(platform::CLng(platform::Val(part)).value_or(0));
        if (comma == std::string_view::npos) break;
        start = comma + 1;
    }
    if (parts.size() != 4 || platform::Trim(text).empty()) return std::nullopt;
    return WindowPosition{parts[0], parts[1], parts[2], parts[3]};
}

std::string FormatWindowPosition(const WindowPosition& p) {
    return std::to_string(p.left) + "," + std::to_string(p.top) + "," + std::to_string(p.width) +
           "," + std::to_string(p.height);
}

std::optional<WindowPosition> LoadWindowPosition(const platform::SettingsStore& store,
                                                 std::string_view key) {
    const std::string text = store.Get(key, "");
    if (text.empty()) return std::nullopt;
    return ParseWindowPosition(text);
}

void SaveWindowPosition(platform::SettingsStore& store, std::string_view key,
                        const WindowPosition& position) {
    store.Save(key, FormatWindowPosition(position));
}

} // namespace kori::app
