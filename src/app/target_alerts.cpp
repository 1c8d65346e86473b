#include "app/target_alerts.h"

#include "intake/check_targets.h"
#include "store/targets_file.h"

namespace kori::app {

bool ShowTargetAlerts(platform::Dialogs& dialogs, const std::vector<std::string>& alerts) {
    if (alerts.empty()) return false;
    dialogs.MsgBox(intake::JoinAlerts(alerts), intake::kAlertsTitle);
    return true;
}

std::vector<std::string> CheckAndShowTargets(platform::Dialogs& dialogs,
                                             std::string_view systemFolder,
                                             std::string_view dataFolder) {
    auto alerts = intake::CheckTargets(store::TargetsFilePath(systemFolder), dataFolder);
    ShowTargetAlerts(dialogs, alerts);
    return alerts;
}

} // namespace kori::app
