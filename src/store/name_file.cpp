#include "store/name_file.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

namespace kori::store {

using platform::Status;

std::filesystem::path NameFile::PathIn(std::string_view dataFolder) {
    return platform::ResolveIn(dataFolder, "Names.dat");
}

std::optional<FoundCode> FindCode(std::string_view dataFolder, std::string_view code,
                                  platform::Status& status) {
    status = Status::Ok();
    if (platform::Trim(code).empty()) return std::nullopt;
    if (!IsValidCode(code)) {
        status = Status::Error("Invalid Code: " + platform::Trim(code));
        return std::nullopt;
    }
    const auto path = NameFile::PathIn(dataFolder);
    if (!platform::FileExists(path)) return std::nullopt;
    std::int16_t count = 0;
    if (status = CountRecords(path, NameRecord::kSize, count); !status) return std::nullopt;
    const auto bytes = platform::ReadWholeFile(path);
    if (!bytes) {
        status = Status::Error("Cannot read " + path.string());
        return std::nullopt;
    }
    const std::string wanted = PadCode(code);
    for (std::size_t i = 0; i < static_cast<std::size_t>(count); ++i) {
        const char* record = bytes->data() + i * NameRecord::kSize;
        if (std::string_view(record + 2, 6) != wanted) continue;
        FoundCode r;
        r.RecordNumber = static_cast<int>(i) + 1;
        r.Record = NameRecord::Decode(record);
        r.CurrentFile = platform::FolderWithSlash(dataFolder) + platform::Trim(wanted) + ".WDT";
        return r;
    }
    return std::nullopt;
}

std::optional<FoundCode> FindCodeInNameFile(std::string_view dataFolder, std::string_view code,
                                            platform::Dialogs& dialogs) {
    dialogs.SetBusy(true);
    Status status;
    auto found = FindCode(dataFolder, code, status);
    dialogs.SetBusy(false);
    if (!status)
        dialogs.MsgBox(status.message(), "Chart Display");
    else if (!found)
        dialogs.MsgBox("No File For That Name", "Chart Display");
    return found;
}

void LookupNameAndClass(std::string_view dataFolder, std::string_view code, std::string& name,
                        std::string& industryClass) {
    if (!platform::FileExists(NameFile::PathIn(dataFolder))) return;
    Status status;
    const auto found = FindCode(dataFolder, code, status);
    name = found ? platform::Trim(found->Record.Name) : std::string();
    industryClass = found ? found->Record.IndustryClass : std::string();
}

std::string LookupGicsSector(std::string_view dataFolder, std::string_view code) {
    if (platform::Trim(code).empty()) return "0000";
    Status status;
    const auto found = FindCode(dataFolder, code, status);
    if (!found) return "0000";
    std::string sector = platform::Trim(found->Record.GicsSector);
    if (!sector.empty() && platform::Val(sector) != 0)
        sector = platform::Format(platform::Val(sector), "0000");
    return sector;
}

} // namespace kori::store
