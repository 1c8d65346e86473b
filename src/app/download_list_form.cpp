#include "app/download_list_form.h"

#include "app/adjustment_list_form.h"

#include "app/target_alerts.h"
#include "intake/download_list.h"
#include "maint/security_details.h"
#include "platform/files.h"
#include "platform/text.h"

#include <algorithm>

namespace kori::app {

intake::UpdateSettings UpdateSettingsOf(const Session& s) {
    intake::UpdateSettings u;
    u.DataService = s.download.DataService;
    u.DownloadFolder = s.folders.DownloadFolder;
    u.DataFolder = s.folders.DataFolder;
    u.SystemFolder = s.folders.SystemFolder;
    u.UpdateAll = s.download.UpdateAll;
    u.NoWarrants = s.download.NoWarrants;
    u.VolumeDivisor = s.download.VolumeDivisor;
    u.RefreshFreq = s.download.RefreshFreq;
    for (std::size_t i = 0; i < u.SegmentFolders.size(); ++i)
        u.SegmentFolders[i] = s.chartDataPaths[i];
    return u;
}

std::string DownloadInFolder(const Session& session) {
    const std::string in = platform::Trim(session.ini().Read("Download", "In"));
    return in.empty() || in == platform::kUnknown ? std::string() : platform::FolderWithSlash(in);
}

intake::UpdateHooks UpdateHooksOf(Session& session) {
    intake::UpdateHooks hooks;
    const auto refresh = [&session](auto load) {
        const auto r = load(session.folders.SystemFolder, DownloadInFolder(session));
        if (!r.Status) session.dialogs().MsgBox(r.Status.message(), "Downloaded Data");
    };
    hooks.RefreshSecurityDetails = [refresh] { refresh(maint::RefreshSecurityDetails); };
    hooks.RefreshSecurityProperties = [refresh] { refresh(maint::RefreshUKSecurityDetails); };
    return hooks;
}

DownloadListForm::DownloadListForm(Session& session) : m_session(session) {}

void DownloadListForm::Build() {
    m_items = intake::BuildDownloadFileList(m_session.folders.DownloadFolder,
                                            m_session.download.DataService,
                                            m_session.download.InternetDLfmt, m_session.dialogs());
}

intake::RunResult DownloadListForm::Run(const std::string& item, bool more) {
    auto settings = UpdateSettingsOf(m_session);
    const intake::UpdateHost host{m_session.dialogs(), m_session.services().progress,
                                  &m_session.services().settings, &m_session.ini()};
    intake::UpdateHooks hooks = UpdateHooksOf(m_session);
    hooks.UpdateAdjustmentsList =
        AdjustmentHooks(m_session, m_listHasNewItems).UpdateAdjustmentsList;
    const std::string today = m_session.services().clock.Today();
    return intake::RunDownloadUpdate(settings, host, hooks, item,
                                     intake::UpdateDateFromItem(item, today), more);
}

void DownloadListForm::AfterRuns(const std::vector<intake::RunResult>& runs) {
    const bool failed =
        std::any_of(runs.begin(), runs.end(), [](const auto& r) { return r.Failed || r.Stopped; });
    const bool wrote = std::any_of(runs.begin(), runs.end(), [](const auto& r) {
        return std::any_of(r.Files.begin(), r.Files.end(),
                           [](const auto& f) { return f.Records > 0; });
    });
    // The targets are tested once the day's prices are in.
    if (wrote && !failed && !runs.empty())
        CheckAndShowTargets(m_session.dialogs(), m_session.folders.SystemFolder,
                            runs.back().CurrentDataFolder.empty() ? m_session.folders.DataFolder
                                                                  : runs.back().CurrentDataFolder);
    Build();
}

intake::RunResult DownloadListForm::UpdateOne(int index) {
    if (index < 0 || index >= static_cast<int>(m_items.size()) || m_running) return {};
    m_running = true;
    m_session.services().progress.ResetCancel();
    auto r = Run(m_items[static_cast<std::size_t>(index)], false);
    m_running = false;
    AfterRuns({r});
    return r;
}

std::vector<intake::RunResult> DownloadListForm::UpdateAll() {
    std::vector<intake::RunResult> runs;
    if (m_running) return runs;
    m_running = true;
    m_session.services().progress.ResetCancel();
    const auto items = m_items;
    for (std::size_t i = 0; i < items.size(); ++i) {
        runs.push_back(Run(items[i], i + 1 < items.size()));
        m_session.services().progress.Yield();
        if (runs.back().Failed || runs.back().Stopped) break;
    }
    m_running = false;
    AfterRuns(runs);
    return runs;
}

bool DownloadListForm::RemoveDate(int index) {
    if (index < 0 || index >= static_cast<int>(m_items.size()) || m_running) return false;
    const std::string item = m_items[static_cast<std::size_t>(index)];
    if (m_session.dialogs().MsgBox("Remove " + item, "Remove Date", platform::Buttons::YesNo,
                                   platform::Icon::Question) != platform::Answer::Yes)
        return false;
    const auto path = platform::ResolveIn(m_session.folders.DownloadFolder, platform::Trim(item));
    std::error_code ec;
    std::filesystem::remove(path, ec);
    m_items.erase(m_items.begin() + index);
    return true;
}

std::string DownloadListForm::Summary(const std::vector<intake::RunResult>& runs) {
    int records = 0, fresh = 0, fillers = 0, files = 0, cancelled = 0;
    for (const auto& r : runs)
        for (const auto& f : r.Files) {
            ++files;
            records += f.Records;
            fresh += f.NewSecurities;
            fillers += f.Fillers;
            if (f.State == intake::FileState::Cancelled) ++cancelled;
        }
    std::string text = std::to_string(files) + (files == 1 ? " file: " : " files: ") +
                       std::to_string(records) + " records, " + std::to_string(fresh) +
                       (fresh == 1 ? " new security, " : " new securities, ") +
                       std::to_string(fillers) + " fillers";
    if (cancelled > 0) text += "; " + std::to_string(cancelled) + " not updated";
    if (std::any_of(runs.begin(), runs.end(), [](const auto& r) { return r.Failed; }))
        text += "; stopped by a file error";
    return text;
}

} // namespace kori::app
