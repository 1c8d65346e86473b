#pragma once
// DLList ("Update with Downloaded Data "): the waiting day files oldest first, and what its
// buttons do with them. The window shows the list and the running state; the rules are here.
#include "app/session.h"
#include "intake/download_update.h"

#include <string>
#include <vector>

namespace kori::app {

// The update's settings as the session holds them.
intake::UpdateSettings UpdateSettingsOf(const Session& session);
// The download program's In folder, where its tables wait ([Download] In), whatever the
// service; empty when not set.
std::string DownloadInFolder(const Session& session);
// What a run hands on when it ends: the security details tables of the download program's In
// folder are loaded (a failure is told under "Downloaded Data").
intake::UpdateHooks UpdateHooksOf(Session& session);

class DownloadListForm {
public:
    explicit DownloadListForm(Session& session);

    // `BuildDownloadFileList`: the list again from the download folder.
    void Build();
    const std::vector<std::string>& items() const { return m_items; }
    bool running() const { return m_running; }
    // An update of this window added items to the maintenance list.
    bool listHasNewItems() const { return m_listHasNewItems; }

    // "Update 1 Day": the item at `index`, no more files following.
    intake::RunResult UpdateOne(int index);
    // "Update All": every item from the first, each run told whether more follow; stops at a
    // file error or a cancel. The results of the files run.
    std::vector<intake::RunResult> UpdateAll();
    // "Remove Date": asks "Remove " + item under "Remove Date"; on Yes the file (when it is
    // there) and the item go. True when removed.
    bool RemoveDate(int index);

    // The line of the status label after a run.
    static std::string Summary(const std::vector<intake::RunResult>& runs);

private:
    intake::RunResult Run(const std::string& item, bool more);
    void AfterRuns(const std::vector<intake::RunResult>& runs);

    Session& m_session;
    std::vector<std::string> m_items;
    bool m_running = false;
    bool m_listHasNewItems = false;
};

} // namespace kori::app
