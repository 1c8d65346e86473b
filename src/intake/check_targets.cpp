#include "intake/check_targets.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_record.h"
#include "store/price_file.h"
#include "store/targets_file.h"

namespace kori::intake {

namespace {

// The last record of the code's price file, or nothing when the file is missing or empty.
bool ReadLastRecord(std::string_view dataFolder, const std::string& code,
                    store::PriceRecord& last) {
    if (code.empty() || !store::IsValidCode(code)) return false;
    // "PRN" and "AUX" live under their safe names.
    const auto path = store::PriceFile::PathFor(dataFolder, platform::Trim(store::PadCode(code)));
    if (path.empty() || !platform::FileHasData(path)) return false;
    store::PriceFile file(path);
    if (!file.Open() || file.Count() < 1) return false;
    return static_cast<bool>(file.Read(file.Count(), last));
}

} // namespace

std::vector<std::string> CheckTargets(const std::filesystem::path& targetsFile,
                                      std::string_view dataFolder) {
    std::vector<std::string> alerts;
    for (const auto& line : store::ReadTargetsFile(targetsFile)) {
        store::PriceRecord last;
        if (!ReadLastRecord(dataFolder, line.Code, last)) continue;
        if (const auto outcome = store::TargetOutcome(line, last); !outcome.empty())
            alerts.push_back(line.Code + " - " + outcome);
    }
    return alerts;
}

std::string JoinAlerts(const std::vector<std::string>& alerts) {
    std::string text;
    for (std::size_t i = 0; i < alerts.size(); ++i) {
        if (i > 0) text += "\r\n";
        text += alerts[i];
    }
    return text;
}

} // namespace kori::intake
