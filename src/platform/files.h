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

// Writes the complete new content beside the target, flushes it to disk, then renames it over
// the target: a failure at any point leaves the old file whole.
Status WriteFileAtomic(const fs::path& path, std::string_view content);

// Appends bytes in one write (a whole record goes in or nothing does).
Status AppendToFile(const fs::path& path, std::string_view bytes);

// Seam for tests: the next atomic writes fail after this many bytes (negative: never).
void SetWriteFailureAfterBytesForTesting(long long bytes);

bool CreateFolder(const fs::path& folder);

} // namespace kori::platform
