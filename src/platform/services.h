#pragma once
// What the core needs from its host, built once in main() and handed to the Session.
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "platform/settings_store.h"

namespace kori::platform {

struct Services {
    Dialogs& dialogs;
    Progress& progress;
    SettingsStore& settings;
    Clock& clock;
};

} // namespace kori::platform
