#include "store/record_file.h"

namespace kori::store {

using platform::Status;

Status CountRecordsOfLength(std::uintmax_t length, std::size_t recordSize, const std::string& name,
                            std::int16_t& count) {
    const auto records = length / recordSize;
    if (records > static_cast<std::uintmax_t>(kMaxRecords)) {
        count = 0;
        return Status::Error(name + " holds " + std::to_string(records) +
                             " records; a file can hold at most 32767.");
    }
    count = static_cast<std::int16_t>(records);
    return Status::Ok();
}

Status CountRecords(const std::filesystem::path& file, std::size_t recordSize,
                    std::int16_t& count) {
    return CountRecordsOfLength(platform::FileSizeOr0(file), recordSize, file.filename().string(),
                                count);
}

Status RecordFileBase::Open() {
    if (m_path.empty()) return Status::Error("No file for that code");
    m_path = platform::ResolvePath(m_path);
    if (!platform::FileExists(m_path)) {
        std::ofstream create(m_path, std::ios::binary);
        if (!create) return Status::Error("Cannot create " + m_path.string());
    }
    return CountRecords(m_path, m_size, m_count);
}

Status RecordFileBase::ReadRange(int first, int last, std::string& bytes) const {
    bytes.clear();
    if (first < 1 || last < first) return Status::Ok();
    if (last > m_count)
        return Status::Error("Record " + std::to_string(last) + " is not in " +
                             m_path.filename().string());
    std::ifstream in(m_path, std::ios::binary);
    const auto size = static_cast<std::size_t>(last - first + 1) * m_size;
    bytes.resize(size);
    in.seekg(static_cast<std::streamoff>(first - 1) * static_cast<std::streamoff>(m_size));
    if (!in.read(bytes.data(), static_cast<std::streamsize>(size)))
        return Status::Error("Cannot read " + m_path.string());
    return Status::Ok();
}

Status RecordFileBase::WriteBytes(int recordNumber, std::string_view bytes) {
    if (recordNumber < 1 || recordNumber > m_count + 1)
        return Status::Error("Record " + std::to_string(recordNumber) + " is past the end of " +
                             m_path.filename().string());
    if (recordNumber > kMaxRecords)
        return Status::Error(m_path.filename().string() + " is full (32767 records).");
    if (recordNumber == m_count + 1) {
        if (auto s = platform::AppendToFile(m_path, bytes); !s) return s;
        ++m_count;
        return Status::Ok();
    }
    std::fstream f(m_path, std::ios::in | std::ios::out | std::ios::binary);
    f.seekp(static_cast<std::streamoff>(recordNumber - 1) * static_cast<std::streamoff>(m_size));
    if (!f.write(bytes.data(), static_cast<std::streamsize>(bytes.size())))
        return Status::Error("Cannot write " + m_path.string());
    return Status::Ok();
}

Status RecordFileBase::WriteAllBytes(const std::string& bytes, std::size_t records,
                                     const platform::ScratchNames& names) {
    if (records > static_cast<std::size_t>(kMaxRecords))
        return Status::Error(m_path.filename().string() + " can hold at most 32767 records.");
    if (auto s = platform::WriteFileAtomic(m_path, bytes, names); !s) return s;
    m_count = static_cast<std::int16_t>(records);
    return Status::Ok();
}

} // namespace kori::store
