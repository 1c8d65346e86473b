#pragma once
// "&About KORI" and `kori about`: the version and the folders the program works in.
#include "app/session.h"

#include <string>
#include <string_view>

namespace kori::app {

std::string_view Version();
// The text of the About window: name, version, a line on what the program is, then the install
// root, the system folder and the data folder, one a line.
std::string AboutText(const Session& session);

} // namespace kori::app
