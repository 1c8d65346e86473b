#pragma once
// The box of alerts shown after an update: the targets met, one a line, under "Quoren Alerts".
#include "platform/dialogs.h"

#include <string>
#include <string_view>
#include <vector>

namespace kori::app {

// Shows the lines joined by CR LF when there is at least one; says nothing otherwise. True
// when a box was shown.
bool ShowTargetAlerts(platform::Dialogs& dialogs, const std::vector<std::string>& alerts);

// CheckTargets over the Targets.txt of `systemFolder` and the price files of `dataFolder`,
// then the box. The lines found are returned.
std::vector<std::string> CheckAndShowTargets(platform::Dialogs& dialogs,
                                             std::string_view systemFolder,
                                             std::string_view dataFolder);

} // namespace kori::app
