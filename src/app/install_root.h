#pragma once
// Where the program's own files live: --root, else KORI_ROOT, else $XDG_DATA_HOME/kori,
// else ~/.local/share/kori. The root is the SystemFolder and holds Kori.ini.
#include <filesystem>
#include <optional>
#include <string>

namespace kori::app {

std::filesystem::path FindInstallRoot(const std::optional<std::string>& commandLineRoot);

} // namespace kori::app
