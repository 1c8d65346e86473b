#include "store/name_file.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

namespace kori::store {

using platform::Status;

std::filesystem::path NameFile::PathIn(std::string_view dataFolder) {
    return platform::ResolveIn(dataFolder, "Names.dat");
}

namespace {
// Walks the name file in one read, stopping when `visit` returns true. The code field sits at
// offset 2 for six characters.
template <typename Visit> int WalkCodes(const std::string& bytes, Visit visit) {
    const std::size_t n = std::min<std::size_t>(bytes.size() / NameRecord::kSize, kMaxRecords);
    for (std::size_t i = 0; i < n; ++i)
        if (visit(std::string_view(bytes.data() + i * NameRecord::kSize + 2, 6)))
            return static_cast<int>(i) + 1;
    return 0;
}
} // namespace

std::optional<FoundCode> FindCodeInNameFile(std::string_view dataFolder, std::string_view code,
                                            platform::Dialogs& dialogs) {
    dialogs.SetBusy(true);
    const std::string wanted = PadCode(code);
    const auto path = NameFile::PathIn(dataFolder);
    const auto bytes = platform::ReadWholeFile(path);
    int found = 0;
    if (bytes) found = WalkCodes(*bytes, [&](std::string_view c) { return c == wanted; });
    dialogs.SetBusy(false);
    if (found == 0) {
        dialogs.MsgBox("No File For That Name", "Chart Display");
        return std::nullopt;
    }
    FoundCode r;
    r.RecordNumber = found;
    r.Record =
        NameRecord::Decode(bytes->data() + static_cast<std::size_t>(found - 1) * NameRecord::kSize);
    r.CurrentFile = platform::FolderWithSlash(dataFolder) + platform::Trim(wanted) + ".WDT";
    return r;
}

void LookupNameAndClass(std::string_view dataFolder, std::string_view code, std::string& name,
                        std::string& industryClass) {
    const auto path = NameFile::PathIn(dataFolder);
    if (!platform::FileExists(path)) return;
    const auto bytes = platform::ReadWholeFile(path);
    const std::string wanted = platform::Upper(platform::Trim(code));
    const int found =
        bytes ? WalkCodes(*bytes, [&](std::string_view c) { return platform::Trim(c) == wanted; })
              : 0;
    if (found == 0) {
        name.clear();
        industryClass.clear();
        return;
    }
    const auto r =
        NameRecord::Decode(bytes->data() + static_cast<std::size_t>(found - 1) * NameRecord::kSize);
    name = platform::Trim(r.Name);
    industryClass = r.IndustryClass;
}

std::string LookupGicsSector(std::string_view dataFolder, std::string_view code) {
    const std::string wanted = platform::Upper(platform::Trim(code));
    if (wanted.empty()) return "0000";
    const auto bytes = platform::ReadWholeFile(NameFile::PathIn(dataFolder));
    if (!bytes) return "0000";
    const int found =
        WalkCodes(*bytes, [&](std::string_view c) { return platform::Trim(c) == wanted; });
    if (found == 0) return "0000";
    const auto r =
        NameRecord::Decode(bytes->data() + static_cast<std::size_t>(found - 1) * NameRecord::kSize);
    std::string sector = platform::Trim(r.GicsSector);
    if (!sector.empty() && platform::Val(sector) != 0)
        sector = platform::Format(platform::Val(sector), "0000");
    return sector;
}

} // namespace kori::store
