#pragma once
// Window positions kept in the settings store: a window opens where it was last closed, or at
// its design position when its key is absent, and writes left, top, width and height on close.
#include "platform/settings_store.h"

#include <string>

class QWidget;

namespace kori::gui {

// Positions are held in twips, as the original's window store held them (15 to a pixel).
void KeepWindowPosition(QWidget* window, platform::SettingsStore& store, const std::string& key);

} // namespace kori::gui
