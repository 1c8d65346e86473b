#pragma once
// ASXChg: a security's code changed. Its price file takes the new name and its name entry the
// new code; when a file of the new code exists too, the new file's records go behind the old
// file's (unsorted: the new file is taken to be the later one) under the new name.
#include "maint/repair_result.h"
#include "platform/dialogs.h"
#include "platform/progress.h"

#include <array>
#include <string_view>

namespace kori::maint {

namespace asx_text {
inline constexpr std::array<std::string_view, 5> kIntro = {
    "Occasionally an ASX code of a company may change.", "This procedure will:-",
    "1) rename your data files and Name file entry",
    "2) combine data if you have ended up with a data file for both codes.",
    "IMPORTANT: This routine does not rename the code in the download Mainfile - you will have "
    "to do that manually."};
inline constexpr std::string_view kInvalid = "Invalid Code";
inline constexpr std::string_view kOldTitle = "Old ASX Code";
inline constexpr std::string_view kNewTitle = "New ASX Code";
inline constexpr std::string_view kCannotFind = "Cannot find ";
inline constexpr std::string_view kFileTitle = "File details";
inline constexpr std::string_view kQuestionTitle = "ASX Code Changed";
inline constexpr std::string_view kRenaming = "RENAMING FILES";
inline constexpr std::string_view kChecking = "CHECKING NAME FILE";
inline constexpr std::string_view kRenamingEntry = "RENAMING NAME FILE ENTRY";
inline constexpr std::string_view kCombining = "COMBINING FILES";
inline constexpr std::string_view kRenamedNoEntry =
    "Data file renamed but was unable to find entry for ";
inline constexpr std::string_view kConversionTitle = "Conversion";
} // namespace asx_text

// "Do you want data for OLD renamed to NEW?"
std::string AsxChgQuestion(std::string_view oldCode, std::string_view newCode);
// "Files converted but was unable to find entry for OLD the Name File"
std::string ConvertedNoEntryMessage(std::string_view oldCode);

// Runs the change in the data folder: the refusals and the question through `dialogs`, the
// stages in the progress status.
RepairResult AsxChg(std::string_view dataFolder, std::string_view oldCode, std::string_view newCode,
                    platform::Dialogs& dialogs, platform::Progress& progress);

} // namespace kori::maint
