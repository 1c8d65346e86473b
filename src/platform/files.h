#pragma once
// File services: presence tests, the case-insensitive resolver, whole-file reads and the
// write-beside-then-rename rule that keeps a file whole when a write fails.
#include "platform/status.h"

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::platform {

namespace fs = std::filesystem;

// Folder text with a closing separator; a back-slash is read as a separator.
std::string FolderWithSlash(std::string_view folder);
// Path text with back-slashes turned into separators.
std::string NormalisePath(std::string_view path);

// The existing file whose name matches `path`'s last component whatever its case, or
// `path` itself (normalised) when none exists.
fs::path ResolvePath(const fs::path& path);
// `folder` joined with `name`, resolved whatever the case of the name on disk.
fs::path ResolveIn(std::string_view folder, std::string_view name);

// A directory search finds the name; a folder name ending in a separator is tested without it.
bool FileExists(const fs::path& path);
// Exists and is longer than zero bytes.
bool FileHasData(const fs::path& path);
std::uintmax_t FileSizeOr0(const fs::path& path);

std::optional<std::string> ReadWholeFile(const fs::path& path);

// Names a rewrite may give its files: the scratch name the new content is written under before
// it takes the target's place (made unique to this writer by a suffix), and an optional back-up
// name beside the target that receives the old content first (`.Old`, `names.bak`, ...).
struct ScratchNames {
    std::string Scratch; // empty: the target's own name
    std::string Backup;  // empty: no back-up
};

// The one gate for replacing a file: writes the complete new content to a scratch file in the
// target's folder, fsyncs it, keeps a back-up of the old file when asked, renames the scratch
// over the target and fsyncs the folder. A symbolic link is written through to its target;
// devices, FIFOs, folders and read-only files are refused. A failure at any step removes the
// scratch file and leaves the old file whole.
Status WriteFileAtomic(const fs::path& path, std::string_view content,
                       const ScratchNames& names = {});

// The same gate for a rewrite that keeps the first `keep` bytes of the existing file and puts
// `tail` after them (a record inserted near the end of a long file). The new file is still made
// whole beside the old one and renamed over it; the whole blocks of its kept part share the old
// file's blocks where the file system can clone a range, and are copied where it cannot. `keep`
// past the end of the file is refused.
Status ReplaceFileFrom(const fs::path& path, std::uint64_t keep, std::string_view tail);

// Appends bytes in one write (a whole record goes in or nothing does).
Status AppendToFile(const fs::path& path, std::string_view bytes);

// For tests: while one is alive, every write through the gate or an append fails after this
// many bytes of content. Scoped, so a failed assertion cannot leave the fault behind.
class ScopedWriteFailure {
public:
    explicit ScopedWriteFailure(long long bytes);
    ~ScopedWriteFailure();
    ScopedWriteFailure(const ScopedWriteFailure&) = delete;
    ScopedWriteFailure& operator=(const ScopedWriteFailure&) = delete;

private:
    long long m_previous;
};

// For tests: while one is alive, all writes through the gate and all appends together may put
// down this many bytes; the write that would pass the budget puts down what is left of it (an
// append: nothing) and fails, and every later write fails at once. Proves that a run stopped by
// a full disk at any point leaves every file it touched whole.
class ScopedWriteBudget {
public:
    explicit ScopedWriteBudget(long long bytes);
    ~ScopedWriteBudget();
    ScopedWriteBudget(const ScopedWriteBudget&) = delete;
    ScopedWriteBudget& operator=(const ScopedWriteBudget&) = delete;
    // Bytes the writes have put down so far.
    static long long Used();

private:
    long long m_previousBudget;
    long long m_previousUsed;
};

// For a bulk writer that replaces thousands of files in one run: while one is alive the gate
// still writes beside and renames (a killed process leaves each file old or new, never half),
// but does not flush each file to disk. At the end of the scope the file system holding
// `anyFileOnTheFileSystem` is synced once, or, with `syncAtEnd` false, the flush is left to the
// system's own write-back (whose rename ordering keeps old-or-new across a power cut on the
// journalled file systems we run on).
class ScopedSyncDeferral {
public:
    explicit ScopedSyncDeferral(const fs::path& anyFileOnTheFileSystem, bool syncAtEnd = true);
    ~ScopedSyncDeferral();
    ScopedSyncDeferral(const ScopedSyncDeferral&) = delete;
    ScopedSyncDeferral& operator=(const ScopedSyncDeferral&) = delete;

private:
    fs::path m_folder;
    bool m_syncAtEnd;
    bool m_previous;
};

// Makes one folder inside a folder that exists; false when its parent is missing, so a path
// read from a file never makes a tree of folders anywhere.
bool CreateFolder(const fs::path& folder);
// Makes a folder and any missing parents: only for the install root and folders the user chose.
bool CreateFolderPath(const fs::path& folder);

} // namespace kori::platform
