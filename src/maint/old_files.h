#pragma once
// DumpOld and ResetFA: the leftover `.Old` copies of a data folder deleted, and the files of a
// folder made writable again (on this system: by their owner) after a copy from read-only media.
#include "maint/repair_result.h"
#include "platform/progress.h"

#include <array>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

namespace old_text {
inline constexpr std::string_view kTitle = "Old Files ";
inline constexpr std::string_view kCompleted = "Completed";
inline constexpr std::string_view kCompletedTitle = "Old files";
inline constexpr std::array<std::string_view, 3> kResetIntro = {
    "Use this procedure to reset the read-only attribute of KORI files to to read-write",
    "This is necessary if the data files have been copied directly from a CD backup",
    "The procedure may take approximately 10 to 20 minutes to complete."};
} // namespace old_text

// " There are no '.Old' files in " + folder
std::string NoOldFilesMessage(std::string_view folder);
// The `*.Old` files of a folder (any case of the extension), by name.
std::vector<std::filesystem::path> OldFiles(std::string_view folder);
// Deletes them; one issue for each that could not go.
RepairResult DumpOld(std::string_view folder, platform::Progress& progress);

// Every file of the folder (not its sub-folders) writable by its owner.
RepairResult ResetFA(std::string_view folder, platform::Progress& progress);

} // namespace kori::maint
