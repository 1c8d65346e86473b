#include "app/backup_form.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <algorithm>
#include <ctime>
#include <filesystem>

namespace kori::app {

namespace {

constexpr std::string_view kKeepKey = "Backups Kept";

std::string Megabytes(long long bytes) {
    return platform::Format(static_cast<double>(bytes) / (1024.0 * 1024.0), "0.0") + " MB";
}

} // namespace

std::string BackupForm::NowStamp() {
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    char text[32];
    std::strftime(text, sizeof text, "%Y%m%d-%H%M%S", &local);
    return text;
}

std::vector<maint::BackupPlace> BackupForm::Places() const {
    const auto& f = m_session.folders;
    std::vector<std::string> folders{f.DataFolder};
    for (const auto& p : m_session.chartDataPaths)
        folders.push_back(p);
    folders.push_back(f.ChtMiscFolder);
    folders.push_back(f.ChtSaveFolder);
    return maint::LibraryPlaces(f.SystemFolder, folders);
}

int BackupForm::Keep() const {
    const std::string text = platform::Trim(m_session.services().settings.Get(kKeepKey, ""));
    const double v = text.empty() ? 0 : platform::Val(text);
    return v >= 1 && v <= 999 ? static_cast<int>(v) : maint::kDefaultBackupsKept;
}

void BackupForm::SetKeep(int keep) {
    m_session.services().settings.Save(kKeepKey, std::to_string(std::clamp(keep, 1, 999)));
}

std::string BackupForm::Backup(platform::Progress& progress, maint::BackupResult* out) {
    std::error_code ec;
    std::filesystem::create_directories(Folder(), ec);
    const std::string file = Folder() + maint::BackupFileName(NowStamp());
    const auto result = maint::WriteBackup(Places(), file, progress, Folder(), Keep());
    if (out) *out = result;
    if (!result.Status) return result.Status.message();
    if (result.Cancelled) return "Backup cancelled: no back-up was written";
    std::string text = std::to_string(result.Files) + " files (" + Megabytes(result.Bytes) +
                       ") backed up to " + result.File;
    if (!result.Discarded.empty())
        text += ". " + std::to_string(result.Discarded.size()) +
                (result.Discarded.size() == 1 ? " older back-up" : " older back-ups") +
                " removed to keep the last " + std::to_string(Keep());
    return text;
}

std::string BackupForm::Verify(const std::string& file, platform::Progress& progress) const {
    const auto plan = maint::VerifyBackup(Folder() + file, progress);
    if (!plan.Status) return plan.Status.message();
    if (plan.Cancelled) return "Check cancelled";
    return file + " is whole: " + std::to_string(plan.Files) + " files match their checksums";
}

std::string BackupForm::Restore(const std::string& file, platform::Progress& progress) {
    const std::string question = "Restore the library from " + file +
                                 " ?  The present files are kept beside it until you discard "
                                 "them.";
    if (m_session.dialogs().MsgBox(question, kRestoreTitle, platform::Buttons::YesNo,
                                   platform::Icon::Question) != platform::Answer::Yes)
        return {};
    const auto result = maint::RestoreBackup(Folder() + file, progress, NowStamp());
    if (!result.Status) return result.Status.message() + ". The library was not changed.";
    if (result.Cancelled) return "Restore cancelled: the library was not changed";
    return std::to_string(result.Files) + " files restored from " + file +
           ". The replaced files are kept in " + std::to_string(result.Replaced.size()) +
           " folders until you discard them. Restart KORI Charting to use the restored settings.";
}

bool BackupForm::DiscardReplaced() {
    const auto copies = Replaced();
    if (copies.empty()) return false;
    std::string question = "Remove the files that the last restore replaced ?";
    for (const auto& c : copies)
        question += "\n" + c;
    if (m_session.dialogs().MsgBox(question, kRestoreTitle, platform::Buttons::YesNo,
                                   platform::Icon::Question) != platform::Answer::Yes)
        return false;
    if (auto s = maint::DiscardReplaced(copies); !s) {
        m_session.dialogs().MsgBox(s.message(), kRestoreTitle);
        return false;
    }
    return true;
}

} // namespace kori::app
