#include "store/name_file.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <fstream>

namespace kori::store {

using platform::Status;

Status CountRecords(const std::filesystem::path& file, std::size_t recordSize, std::int16_t& count) {
    const auto records = platform::FileSizeOr0(file) / recordSize;
    if (records > static_cast<std::uintmax_t>(kMaxRecords)) {
        count = 0;
        return Status::Error(file.filename().string() + " holds " + std::to_string(records) +
                             " records; a file can hold at most 32767.");
    }
    count = static_cast<std::int16_t>(records);
    return Status::Ok();
}

std::filesystem::path NameFile::PathIn(std::string_view dataFolder) {
    return platform::ResolveIn(dataFolder, "Names.dat");
}

Status NameFile::Open() {
    m_path = platform::ResolvePath(m_path);
    if (!platform::FileExists(m_path)) {
        std::ofstream create(m_path, std::ios::binary);
        if (!create) return Status::Error("Cannot create " + m_path.string());
    }
    return CountRecords(m_path, NameRecord::kSize, m_count);
}

Status NameFile::Read(int recordNumber, NameRecord& out) const {
    if (recordNumber < 1 || recordNumber > m_count)
        return Status::Error("Record " + std::to_string(recordNumber) + " is not in " +
                             m_path.filename().string());
    std::ifstream in(m_path, std::ios::binary);
    char buf[NameRecord::kSize];
    in.seekg(static_cast<std::streamoff>(recordNumber - 1) * static_cast<std::streamoff>(NameRecord::kSize));
    if (!in.read(buf, sizeof buf)) return Status::Error("Cannot read " + m_path.string());
    out = NameRecord::Decode(buf);
    return Status::Ok();
}

Status NameFile::Write(int recordNumber, const NameRecord& r) {
    if (recordNumber < 1 || recordNumber > m_count + 1)
        return Status::Error("Record " + std::to_string(recordNumber) + " is past the end of " +
                             m_path.filename().string());
    if (recordNumber > kMaxRecords) return Status::Error("The name file is full (32767 records).");
    const auto bytes = r.Encode();
    if (recordNumber == m_count + 1) {
        if (auto s = platform::AppendToFile(m_path, {bytes.data(), bytes.size()}); !s) return s;
        ++m_count;
        return Status::Ok();
    }
    std::fstream f(m_path, std::ios::in | std::ios::out | std::ios::binary);
    f.seekp(static_cast<std::streamoff>(recordNumber - 1) * static_cast<std::streamoff>(NameRecord::kSize));
    if (!f.write(bytes.data(), static_cast<std::streamsize>(bytes.size())))
        return Status::Error("Cannot write " + m_path.string());
    return Status::Ok();
}

Status NameFile::ReadAll(std::vector<NameRecord>& out) const {
    out.clear();
    std::int16_t count = 0;
    if (auto s = CountRecords(m_path, NameRecord::kSize, count); !s) return s;
    if (count == 0) return Status::Ok();
    const auto bytes = platform::ReadWholeFile(m_path);
    if (!bytes) return Status::Error("Cannot read " + m_path.string());
    out.reserve(static_cast<std::size_t>(count));
    for (int i = 0; i < count; ++i)
        out.push_back(NameRecord::Decode(bytes->data() + static_cast<std::size_t>(i) * NameRecord::kSize));
    return Status::Ok();
}

Status NameFile::WriteAll(const std::vector<NameRecord>& records) {
    if (records.size() > static_cast<std::size_t>(kMaxRecords))
        return Status::Error("A name file can hold at most 32767 records.");
    std::string bytes;
    bytes.reserve(records.size() * NameRecord::kSize);
    for (const auto& r : records) {
        const auto b = r.Encode();
        bytes.append(b.data(), b.size());
    }
    if (auto s = platform::WriteFileAtomic(m_path, bytes); !s) return s;
    m_count = static_cast<std::int16_t>(records.size());
    return Status::Ok();
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
    r.Record = NameRecord::Decode(bytes->data() + static_cast<std::size_t>(found - 1) * NameRecord::kSize);
    r.CurrentFile = platform::FolderWithSlash(dataFolder) + platform::Trim(wanted) + ".WDT";
    return r;
}

void LookupNameAndClass(std::string_view dataFolder, std::string_view code, std::string& name,
                        std::string& industryClass) {
    const auto path = NameFile::PathIn(dataFolder);
    if (!platform::FileExists(path)) return;
    const auto bytes = platform::ReadWholeFile(path);
    const std::string wanted = platform::Upper(platform::Trim(code));
    const int found = bytes ? WalkCodes(*bytes, [&](std::string_view c) {
        return platform::Trim(c) == wanted;
    })
                            : 0;
    if (found == 0) {
        name.clear();
        industryClass.clear();
        return;
    }
    const auto r = NameRecord::Decode(bytes->data() + static_cast<std::size_t>(found - 1) * NameRecord::kSize);
    name = platform::Trim(r.Name);
    industryClass = r.IndustryClass;
}

std::string LookupGicsSector(std::string_view dataFolder, std::string_view code) {
    const std::string wanted = platform::Upper(platform::Trim(code));
    if (wanted.empty()) return "0000";
    const auto bytes = platform::ReadWholeFile(NameFile::PathIn(dataFolder));
    if (!bytes) return "0000";
    const int found = WalkCodes(*bytes, [&](std::string_view c) { return platform::Trim(c) == wanted; });
    if (found == 0) return "0000";
    const auto r = NameRecord::Decode(bytes->data() + static_cast<std::size_t>(found - 1) * NameRecord::kSize);
    std::string sector = platform::Trim(r.GicsSector);
    if (!sector.empty() && platform::Val(sector) != 0) sector = platform::Format(platform::Val(sector), "0000");
    return sector;
}

} // namespace kori::store
