#pragma once
// Window positions in the window store: one text "left,top,width,height" a window.
#include "platform/settings_store.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kori::app {

struct WindowPosition {
    std::int32_t left = 0;
    std::int32_t top = 0;
    std::int32_t width = 0;
    std::int32_t height = 0;
};

// Split at commas, each part read as a number; nullopt when there are not four parts, so the
// window keeps its design position.
std::optional<WindowPosition> ParseWindowPosition(std::string_view text);
std::string FormatWindowPosition(const WindowPosition& position);

// Read and write under the application's own section; an absent key gives nullopt.
std::optional<WindowPosition> LoadWindowPosition(const platform::SettingsStore& store,
                                                 std::string_view key);
void SaveWindowPosition(platform::SettingsStore& store, std::string_view key,
                        const WindowPosition& position);

} // namespace kori::app
