#include "chart/saved_chart.h"

#include "chart/screen_player.h"
#include "platform/files.h"
#include "platform/text.h"

namespace kori::chart {

namespace {
constexpr const char* kSaveTitle = "Save Chart";
constexpr const char* kSavedChartsTitle = "Saved Charts";
constexpr const char* kBadExtension = "File extension must be .cht";

void Tell(platform::Dialogs& dialogs, const char* text, const char* title) {
    dialogs.MsgBox(text, title, platform::Buttons::Ok, platform::Icon::Exclamation);
}

bool CopyStream(const std::filesystem::path& streamPath, const std::filesystem::path& target) {
    const auto bytes = platform::ReadWholeFile(streamPath);
    return bytes && platform::WriteFileAtomic(target, *bytes).ok();
}
} // namespace

std::string ProposedChartName(std::string_view chartFolder, std::string_view code) {
    return platform::FolderWithSlash(chartFolder) + platform::Trim(code) + ".cht";
}

bool HasChartExtension(std::string_view name) {
    return name.size() >= 4 && platform::Upper(name.substr(name.size() - 4)) == ".CHT";
}

SaveChartResult SaveChartAs(std::string_view answer, const std::filesystem::path& streamPath,
                            platform::Dialogs& dialogs) {
    if (answer == kNameCancel) return SaveChartResult::Cancelled;
    if (answer == kNameNoGood) {
        Tell(dialogs, "File name invalid", kSaveTitle);
        return SaveChartResult::Refused;
    }
    if (!HasChartExtension(answer)) {
        Tell(dialogs, kBadExtension, kSaveTitle);
        return SaveChartResult::Refused;
    }
    const std::filesystem::path target(platform::NormalisePath(answer));
    if (platform::FileExists(target)) {
        const std::string question = std::string(answer) + " already exists - Overwrite";
        if (dialogs.MsgBox(question, kSaveTitle, platform::Buttons::OkCancel,
                           platform::Icon::Question) != platform::Answer::Ok)
            return SaveChartResult::Cancelled;
    }
    if (!CopyStream(streamPath, target)) {
        Tell(dialogs, " CHART NOT SAVED ", kSaveTitle);
        return SaveChartResult::NotSaved;
    }
    dialogs.MsgBox(" CHART SAVED ", kSaveTitle, platform::Buttons::Ok, platform::Icon::Information);
    return SaveChartResult::Saved;
}

bool DisplaySavedChart(std::string_view chosen, platform::Surface& area,
                       const platform::Palette& palette, const platform::ChartFonts& fonts,
                       platform::Dialogs& dialogs) {
    if (chosen.empty()) return false;
    if (!HasChartExtension(chosen)) {
        Tell(dialogs, kBadExtension, kSavedChartsTitle);
        return false;
    }
    return ShowSavedChart(platform::ResolvePath(platform::NormalisePath(chosen)), area, palette,
                          fonts, dialogs);
}

} // namespace kori::chart
