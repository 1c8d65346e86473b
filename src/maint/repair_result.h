#pragma once
// What a repair tool hands back to its window or to the command line: whether it ran to its
// end, how many files it rewrote, and the problems it met on the way that did not stop it.
#include "platform/issues.h"

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>

namespace kori::maint {

struct RepairResult {
    bool Done = false;      // ran to its end (false: refused, failed or cancelled)
    bool Cancelled = false; // stopped by the cancel flag
    int FilesChanged = 0;
    platform::Issues Issues;
};

// A price file's bytes read in one go; nullopt when it cannot be read.
std::optional<std::string> ReadFileBytes(const std::filesystem::path& path);

// Whether a new file can be made in the folder (a repair asks before it starts, so an
// unwritable folder gives one message instead of one a file).
bool FolderWritable(const std::filesystem::path& folder);
std::string NotWritableMessage(std::string_view folder);

} // namespace kori::maint
