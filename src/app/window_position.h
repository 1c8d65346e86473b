#pragma once
// Window positions in the window store: one text "left,top,width,height" a window, in twips.
// Beside each position the store keeps the size of the screen it was written on, under the
// position's key with "SW" and "SH" after it (the names the chart page size uses for its
// screen), so that a window opened on another screen keeps its place in proportion.
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
    bool operator==(const WindowPosition&) const = default;
};

// The whole screen, in the units of the positions.
struct ScreenSize {
    std::int32_t width = 0;
    std::int32_t height = 0;
    bool operator==(const ScreenSize&) const = default;
};

// Split at commas, each part read as a number; nullopt when there are not four parts, so the
// window keeps its design position.
std::optional<WindowPosition> ParseWindowPosition(std::string_view text);
std::string FormatWindowPosition(const WindowPosition& position);

// Left and width follow the screen's width, top and height its height, rounded to the
// nearest unit. A screen of unknown size (0 or less on either side) leaves the position as is.
WindowPosition ScaleWindowPosition(const WindowPosition& position, ScreenSize writtenOn,
                                   ScreenSize now);

// Read and write under the application's own section; an absent key gives nullopt. The
// reader without a screen gives the position as stored.
std::optional<WindowPosition> LoadWindowPosition(const platform::SettingsStore& store,
                                                 std::string_view key);
std::optional<WindowPosition> LoadWindowPosition(const platform::SettingsStore& store,
                                                 std::string_view key, ScreenSize screen);
void SaveWindowPosition(platform::SettingsStore& store, std::string_view key,
                        const WindowPosition& position);
void SaveWindowPosition(platform::SettingsStore& store, std::string_view key,
                        const WindowPosition& position, ScreenSize screen);

// The screen a key's position was written on; nullopt when it was not kept.
std::optional<ScreenSize> StoredScreen(const platform::SettingsStore& store, std::string_view key);

// The main window: its size from `Height` and `Width` (6645 and 9045 when absent or not a
// positive number), its place from `Main` when that is kept; both scaled by the screen they
// were written on.
inline constexpr std::int32_t kMainDesignHeight = 6645;
inline constexpr std::int32_t kMainDesignWidth = 9045;
struct MainWindowPlace {
    std::int32_t width = kMainDesignWidth;
    std::int32_t height = kMainDesignHeight;
    std::optional<std::int32_t> left, top; // design place when absent
    bool sizeStored = false;               // false on a first start: the design size stands
};

// Sizes in pixels for the first start, when no size is kept.
struct PixelSize {
    int width = 0, height = 0;
};
// The first start opens the main window large enough for its child windows (the chart
// selection whole, the chart window's toolbar) and never larger than the screen's free area:
// the design size is a size, not a limit that clips them.
inline constexpr PixelSize kFirstStartSize{1100, 780};
PixelSize FirstStartSize(PixelSize design, PixelSize available);
// How much a main window of size `window` must grow for a child of `child` (its frame,
// including its place in the work area) to fit in a work area of size `area`, held within
// `available`: the new size. The same size when the child fits.
PixelSize GrowToFit(PixelSize window, PixelSize area, PixelSize child, PixelSize available);
MainWindowPlace LoadMainWindowPlace(const platform::SettingsStore& store, ScreenSize screen);
// On close: `Height`, `Width` and `Main`, with the screen.
void SaveMainWindowPlace(platform::SettingsStore& store, const WindowPosition& position,
                         ScreenSize screen);

} // namespace kori::app
