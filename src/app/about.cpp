#include "app/about.h"

namespace kori::app {

std::string_view Version() {
    return KORI_VERSION; // from the project's version, set by the build
}

std::string AboutText(const Session& session) {
    return "KORI Charting\nVersion " + std::string(Version()) +
           "\n\nEnd-of-day share-market charting.\n\nInstall root: " + session.root().string() +
           "\nSystem folder: " + session.folders.SystemFolder +
           "\nData folder: " + session.folders.DataFolder;
}

} // namespace kori::app
