#pragma once
// MoveFiles: one security moved from a source data folder to a destination folder. Without a
// namesake at the destination the file moves; with one the two are merged by date (the
// destination's old copy kept as <code>.Old). The name record goes from the source's Names.dat
// to the destination's (where that one has no entry of the code yet), and the source's chart
// lists are re-linked.
#include "maint/repair_result.h"
#include "platform/dialogs.h"
#include "platform/progress.h"

#include <array>
#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

namespace move_text {
inline constexpr std::array<std::string_view, 3> kIntro = {
    "Set SOURCE side to the folder that contains the file to move.",
    "Set DESTINATION side to the folder you want to accept files.",
    "Find the required file on the source side. Click file to highlight. Click >>> button to "
    "move it."};
inline constexpr std::string_view kSameFolder =
    "You have the same folder selected for both Source and Destination";
inline constexpr std::string_view kErrorTitle = "Error";
inline constexpr std::string_view kMerging = "Merging Files";
inline constexpr std::string_view kCompleted = "COMPLETED";
} // namespace move_text

// The `*.wdt` file names of a folder (any case), sorted: one pane of the window.
std::vector<std::string> WdtFiles(std::string_view folder);

// Two price files' records in one date order. Each is put in date order first; of records of
// one date in both, the moved file's record is kept.
std::string MergeByDate(std::string_view destinationBytes, std::string_view movedBytes);

// `file`: the price file's name as the pane shows it ("ABC.WDT") or the bare code.
RepairResult MoveFiles(std::string_view source, std::string_view destination, std::string_view file,
                       platform::Dialogs& dialogs, platform::Progress& progress);

} // namespace kori::maint
