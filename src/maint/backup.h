#pragma once
// Back-up and restore of the whole library as one archive (tar, compressed), with a manifest
// that gives the SHA-256 of every file. A back-up holds "places": the install root's own files
// (settings, colours, targets, update and adjustment lists) and each data, chart-notes and
// saved-chart folder, flat. Restore checks every file against the manifest before it touches
// anything, writes each place into a new folder beside it, and only when all are whole swaps
// them in, keeping what they replace beside them until the user discards it.
#include "platform/progress.h"
#include "platform/status.h"

#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

inline constexpr std::string_view kBackupManifest = "MANIFEST.txt";
inline constexpr int kDefaultBackupsKept = 5;

struct BackupPlace {
    std::string Name;   // "root", "place1", ... inside the archive
    std::string Folder; // absolute, ending in '/'
};

// The places of a library: the install root's files, then each folder once, in the order
// given (the data folder first); folders that do not exist are left out.
std::vector<BackupPlace> LibraryPlaces(std::string_view installRoot,
                                       const std::vector<std::string>& folders);

struct BackupResult {
    platform::Status Status;
    std::string File; // the archive written
    int Files = 0;    // files stored, the manifest not counted
    long long Bytes = 0;
    std::vector<std::string> Discarded; // older back-ups removed to keep the last N
    bool Cancelled = false;
};

// "KoriBackup-<stamp>.tar.zst"; the stamp "yyyymmdd-hhmmss" makes names sort by time.
std::string BackupFileName(std::string_view stamp);

// Writes the archive (beside, then renamed) to `archivePath`; when `backupFolder` is given,
// keeps only the newest `keep` back-ups there afterwards. A cancel or a failure leaves no
// archive.
BackupResult WriteBackup(const std::vector<BackupPlace>& places, const std::string& archivePath,
                         platform::Progress& progress, const std::string& backupFolder = {},
                         int keep = kDefaultBackupsKept);

// The back-ups of a folder, newest first (by name, which holds the time).
std::vector<std::string> ListBackups(std::string_view backupFolder);

struct RestorePlan {
    platform::Status Status;         // the first bad file named
    std::vector<BackupPlace> Places; // as the manifest recorded them
    int Files = 0;
    bool Cancelled = false;
};

// Reads the whole archive and checks every file against the manifest; nothing is written.
RestorePlan VerifyBackup(const std::string& archivePath, platform::Progress& progress);

struct RestoreResult {
    platform::Status Status;
    int Files = 0;
    std::vector<std::string> Replaced; // where each replaced place was kept
    bool Cancelled = false;
};

// Verifies, then restores every place to where the manifest says it was (or, with `remap`,
// place i to remap[i] when given and not empty). The old content of each place is kept in a
// folder beside it named "<folder>.replaced-<stamp>". A failure or cancel before the swap
// leaves the library as it was.
RestoreResult RestoreBackup(const std::string& archivePath, platform::Progress& progress,
                            const std::string& stamp, const std::vector<std::string>& remap = {});

// The copies a restore kept beside the places it replaced, and their removal.
std::vector<std::string> ReplacedCopies(const std::vector<BackupPlace>& places);
platform::Status DiscardReplaced(const std::vector<std::string>& copies);

} // namespace kori::maint
