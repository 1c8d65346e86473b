#pragma once
// Window positions kept in the settings store: a window opens where it was last closed, or at
// its design position when its key is absent, and writes left, top, width and height on close.
#include "app/window_position.h"
#include "platform/settings_store.h"

#include <string>

class QWidget;

namespace kori::gui {

// Positions are held in twips, as the window store has always held them (15 to a pixel).
inline constexpr int kTwipsPerPixel = 15;

// The size of the screen `window` is on, in twips; 0 by 0 when it has none.
app::ScreenSize ScreenTwips(const QWidget* window);

// Opens `window` at its stored place, scaled when the screen differs from the one it was
// written on; on close writes the place and the screen.
void KeepWindowPosition(QWidget* window, platform::SettingsStore& store, const std::string& key);

} // namespace kori::gui
