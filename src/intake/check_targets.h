#pragma once
// The price targets tested after an update: each line of Targets.txt against the last record
// of its security.
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::intake {

// Title of the box that shows the alerts.
inline constexpr std::string_view kAlertsTitle = "Quoren Alerts";

// One alert line per target met, in file order: "<code> - target reached UP" when the last
// day's range holds the target, else "<code> - target exceeded UP" when the close is above it
// (DOWN: the same range test, else a close below). A line whose price file is missing or
// empty is skipped; an absent targets file gives nothing.
std::vector<std::string> CheckTargets(const std::filesystem::path& targetsFile,
                                      std::string_view dataFolder);

// The alert lines joined by CR LF, as the box shows them.
std::string JoinAlerts(const std::vector<std::string>& alerts);

} // namespace kori::intake
