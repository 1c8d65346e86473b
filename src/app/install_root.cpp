#include "app/install_root.h"

#include <cstdlib>

namespace kori::app {

std::filesystem::path FindInstallRoot(const std::optional<std::string>& commandLineRoot) {
    if (commandLineRoot && !commandLineRoot->empty())
        return std::filesystem::absolute(*commandLineRoot);
    if (const char* env = std::getenv("KORI_ROOT"); env && *env)
        return std::filesystem::absolute(env);
    if (const char* xdg = std::getenv("XDG_DATA_HOME"); xdg && *xdg)
        return std::filesystem::path(xdg) / "kori";
    if (const char* home = std::getenv("HOME"); home && *home)
        return std::filesystem::path(home) / ".local/share/kori";
    return std::filesystem::absolute("kori");
}

} // namespace kori::app
