#pragma once
// ChartBak: the back-up of the whole library to the back-up folder, and the restore from one
// of the back-ups there, with the copies a restore keeps until the user discards them.
#include "app/session.h"
#include "maint/backup.h"

#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kBackupTitle = "Backup Chart Data";
inline constexpr const char* kRestoreTitle = "Restore Data from Backup";

class BackupForm {
public:
    explicit BackupForm(Session& session) : m_session(session) {}

    // The install root's files, the data folder(s), the chart notes and the saved charts.
    std::vector<maint::BackupPlace> Places() const;
    std::string Folder() const { return m_session.folders.ChartBackupFolder; }
    // How many back-ups are kept in the folder (the settings store; 5 when not set).
    int Keep() const;
    void SetKeep(int keep);

    // Backs up to a new file named by the local time; the message to show afterwards.
    std::string Backup(platform::Progress& progress, maint::BackupResult* result = nullptr);
    // The back-ups of the folder, newest first.
    std::vector<std::string> Backups() const { return maint::ListBackups(Folder()); }
    // Checks one back-up whole; the message to show.
    std::string Verify(const std::string& file, platform::Progress& progress) const;
    // Asks, then restores; the message to show, empty when the user said no.
    std::string Restore(const std::string& file, platform::Progress& progress);
    std::vector<std::string> Replaced() const { return maint::ReplacedCopies(Places()); }
    // "yyyymmdd-hhmmss" of the local time: the name of the copies a restore keeps.
    static std::string NowStamp();
    // Asks, then removes the kept copies; false when there were none or the user said no.
    bool DiscardReplaced();

private:
    Session& m_session;
};

} // namespace kori::app
