#include "app/window_position.h"

#include "platform/rounding.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace kori::app {

namespace {
constexpr std::string_view kMainKey = "Main";

std::string WidthKey(std::string_view key) {
    return std::string(key) + "SW";
}
std::string HeightKey(std::string_view key) {
    return std::string(key) + "SH";
}

std::int32_t Scale(std::int32_t v, std::int32_t from, std::int32_t to) {
    const double scaled = std::nearbyint(static_cast<double>(v) * to / from);
    constexpr double lo = std::numeric_limits<std::int32_t>::min();
    constexpr double hi = std::numeric_limits<std::int32_t>::max();
    return static_cast<std::int32_t>(std::fmin(std::fmax(scaled, lo), hi));
}

bool Known(ScreenSize s) {
    return s.width > 0 && s.height > 0;
}

// A stored size in twips when it is a positive number.
std::optional<std::int32_t> StoredSize(const platform::SettingsStore& store, std::string_view key) {
    const auto v = platform::CLng(platform::Val(store.Get(key, "")));
    if (!v || *v <= 0) return std::nullopt;
    return v;
}
} // namespace

std::optional<WindowPosition> ParseWindowPosition(std::string_view text) {
    std::vector<std::int32_t> parts;
    std::size_t start = 0;
    for (;;) {
        const auto comma = text.find(',', start);
        const auto part =
            text.substr(start, comma == std::string_view::npos ? text.npos : comma - start);
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

WindowPosition ScaleWindowPosition(const WindowPosition& p, ScreenSize writtenOn, ScreenSize now) {
    if (!Known(writtenOn) || !Known(now) || writtenOn == now) return p;
    return {Scale(p.left, writtenOn.width, now.width), Scale(p.top, writtenOn.height, now.height),
            Scale(p.width, writtenOn.width, now.width),
            Scale(p.height, writtenOn.height, now.height)};
}

std::optional<ScreenSize> StoredScreen(const platform::SettingsStore& store, std::string_view key) {
    const auto w = platform::CLng(platform::Val(store.Get(WidthKey(key), "")));
    const auto h = platform::CLng(platform::Val(store.Get(HeightKey(key), "")));
    const ScreenSize s{w.value_or(0), h.value_or(0)};
    if (!Known(s)) return std::nullopt;
    return s;
}

std::optional<WindowPosition> LoadWindowPosition(const platform::SettingsStore& store,
                                                 std::string_view key) {
    const std::string text = store.Get(key, "");
    if (text.empty()) return std::nullopt;
    return ParseWindowPosition(text);
}

std::optional<WindowPosition> LoadWindowPosition(const platform::SettingsStore& store,
                                                 std::string_view key, ScreenSize screen) {
    const auto p = LoadWindowPosition(store, key);
    if (!p) return std::nullopt;
    const auto writtenOn = StoredScreen(store, key);
    return writtenOn ? ScaleWindowPosition(*p, *writtenOn, screen) : *p;
}

void SaveWindowPosition(platform::SettingsStore& store, std::string_view key,
                        const WindowPosition& position) {
    store.Save(key, FormatWindowPosition(position));
}

void SaveWindowPosition(platform::SettingsStore& store, std::string_view key,
                        const WindowPosition& position, ScreenSize screen) {
    SaveWindowPosition(store, key, position);
    if (!Known(screen)) return;
    store.Save(WidthKey(key), std::to_string(screen.width));
    store.Save(HeightKey(key), std::to_string(screen.height));
}

MainWindowPlace LoadMainWindowPlace(const platform::SettingsStore& store, ScreenSize screen) {
    MainWindowPlace place;
    // The design size stands for any screen; a stored one follows the screen.
    const ScreenSize writtenOn = StoredScreen(store, kMainKey).value_or(ScreenSize{});
    if (const auto w = StoredSize(store, "Width")) {
        place.width = ScaleWindowPosition({0, 0, *w, 0}, writtenOn, screen).width;
        place.sizeStored = true;
    }
    if (const auto h = StoredSize(store, "Height")) {
        place.height = ScaleWindowPosition({0, 0, 0, *h}, writtenOn, screen).height;
        place.sizeStored = true;
    }
    if (const auto p = LoadWindowPosition(store, kMainKey, screen)) {
        place.left = p->left;
        place.top = p->top;
    }
    return place;
}

PixelSize FirstStartSize(PixelSize design, PixelSize available) {
    const auto fit = [](int want, int least, int room) {
        const int size = std::max(want, least);
        return room > 0 ? std::min(size, room) : size;
    };
    return {fit(kFirstStartSize.width, design.width, available.width),
            fit(kFirstStartSize.height, design.height, available.height)};
}

PixelSize GrowToFit(PixelSize window, PixelSize area, PixelSize child, PixelSize available) {
    const auto grow = [](int size, int room, int need, int limit) {
        if (need <= room) return size;
        const int wanted = size + (need - room);
        return limit > 0 ? std::max(size, std::min(wanted, limit)) : wanted;
    };
    return {grow(window.width, area.width, child.width, available.width),
            grow(window.height, area.height, child.height, available.height)};
}

void SaveMainWindowPlace(platform::SettingsStore& store, const WindowPosition& position,
                         ScreenSize screen) {
    store.Save("Height", std::to_string(position.height));
    store.Save("Width", std::to_string(position.width));
    SaveWindowPosition(store, kMainKey, position, screen);
}

} // namespace kori::app
