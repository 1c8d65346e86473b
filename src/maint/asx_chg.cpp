#include "maint/asx_chg.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"

namespace kori::maint {

namespace at = asx_text;
using platform::Buttons;
using platform::Trim;

std::string AsxChgQuestion(std::string_view oldCode, std::string_view newCode) {
    return "Do you want data for " + Trim(oldCode) + " renamed to " + Trim(newCode) + "?";
}

std::string ConvertedNoEntryMessage(std::string_view oldCode) {
    return "Files converted but was unable to find entry for " + Trim(oldCode) + " the Name File";
}

namespace {

// The name entry of the old code takes the new code, upper-cased; false when there is none.
bool RenameNameEntry(std::string_view folder, std::string_view oldCode, std::string_view newCode,
                     platform::Progress& progress, RepairResult& result) {
    progress.SetStatus(at::kChecking);
    platform::Status why;
    const auto found = store::FindCode(folder, oldCode, why);
    if (!why) {
        result.Issues.push_back({platform::Severity::Error, why.message(), "Names.dat", 0});
        return false;
    }
    if (!found) return false;
    progress.SetStatus(at::kRenamingEntry);
    store::NameFile names(store::NameFile::PathIn(folder));
    std::vector<store::NameRecord> records;
    platform::Status s = names.ReadAll(records);
    if (s) {
        records[static_cast<std::size_t>(found->RecordNumber - 1)].Code =
            platform::Upper(Trim(newCode));
        s = names.WriteAll(records, {"Names.dat.new", ""});
    }
    if (!s) {
        result.Issues.push_back(
            {platform::Severity::Error, s.message(), "Names.dat", found->RecordNumber});
        return false;
    }
    return true;
}

} // namespace

RepairResult AsxChg(std::string_view dataFolder, std::string_view oldCodeIn,
                    std::string_view newCodeIn, platform::Dialogs& dialogs,
                    platform::Progress& progress) {
    RepairResult result;
    const std::string folder = platform::FolderWithSlash(dataFolder);
    const std::string oldCode = platform::Upper(Trim(oldCodeIn));
    const std::string newCode = platform::Upper(Trim(newCodeIn));
    if (!store::IsValidCode(oldCode)) {
        dialogs.MsgBox(at::kInvalid, at::kOldTitle);
        return result;
    }
    if (!store::IsValidCode(newCode) || store::PadCode(newCode) == store::PadCode(oldCode)) {
        dialogs.MsgBox(at::kInvalid, at::kNewTitle);
        return result;
    }
    const auto oldPath = store::PriceFile::PathFor(folder, oldCode);
    if (!platform::FileExists(oldPath)) {
        dialogs.MsgBox(std::string(at::kCannotFind) + oldPath.string(), at::kFileTitle);
        return result;
    }
    if (dialogs.MsgBox(AsxChgQuestion(oldCode, newCode), at::kQuestionTitle, Buttons::YesNo) !=
        platform::Answer::Yes)
        return result;
    if (!FolderWritable(folder)) {
        dialogs.MsgBox(NotWritableMessage(folder), at::kFileTitle);
        return result;
    }
    const auto existingNew = store::PriceFile::PathFor(folder, newCode);
    const bool bothExist = platform::FileExists(existingNew);
    // The new file takes the canonical name, whatever the case of the one it replaces.
    const auto newPath = std::filesystem::path(folder) / (Trim(store::PadCode(newCode)) + ".WDT");
    std::error_code ec;
    if (!bothExist) {
        progress.SetStatus(at::kRenaming);
        std::filesystem::rename(oldPath, newPath, ec);
        if (ec) {
            dialogs.MsgBox("Cannot rename " + oldPath.string() + ": " + ec.message(),
                           at::kFileTitle);
            return result;
        }
        result.FilesChanged = 1;
        if (!RenameNameEntry(folder, oldCode, newCode, progress, result))
            dialogs.MsgBox(std::string(at::kRenamedNoEntry) + oldCode, at::kFileTitle);
        result.Done = true;
        return result;
    }

    progress.SetStatus(at::kCombining);
    const auto oldBytes = ReadFileBytes(oldPath);
    const auto newBytes = ReadFileBytes(existingNew);
    if (!oldBytes || !newBytes) {
        dialogs.MsgBox("Cannot read " + (oldBytes ? existingNew : oldPath).string(),
                       at::kFileTitle);
        return result;
    }
    const std::size_t size = store::PriceRecord::kSize;
    // Whole records only: a torn tail of either file is not carried into the other.
    std::string combined = oldBytes->substr(0, oldBytes->size() / size * size);
    combined += newBytes->substr(0, newBytes->size() / size * size);
    if (combined.size() / size > static_cast<std::size_t>(store::kMaxRecords)) {
        dialogs.MsgBox("The two files hold more than 32767 records together; nothing was "
                       "combined.",
                       at::kConversionTitle);
        return result;
    }
    // Two steps, each a whole file or nothing: the old file becomes the combined one, then it
    // takes the new name over the new file. At no moment is a record only in a deleted file.
    if (auto s = platform::WriteFileAtomic(oldPath, combined, {"Temp.Tmp", ""}); !s) {
        dialogs.MsgBox(s.message(), at::kConversionTitle);
        return result;
    }
    std::filesystem::rename(oldPath, existingNew, ec);
    if (!ec && existingNew != newPath) std::filesystem::rename(existingNew, newPath, ec);
    if (ec) {
        dialogs.MsgBox("Cannot rename " + oldPath.string() + ": " + ec.message(),
                       at::kConversionTitle);
        return result;
    }
    result.FilesChanged = 1;
    if (!RenameNameEntry(folder, oldCode, newCode, progress, result))
        dialogs.MsgBox(ConvertedNoEntryMessage(oldCode), at::kConversionTitle);
    result.Done = true;
    return result;
}

} // namespace kori::maint
