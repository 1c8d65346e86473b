#pragma once
// A file of fixed-size records, 1-based, no header: the shape of the name file, the price files
// and the chart lists. The count is the file length divided by the record size (a remainder is
// ignored) and may not pass 32,767. Opening creates an absent file empty.
#include "platform/files.h"
#include "platform/status.h"

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace kori::store {

inline constexpr std::int32_t kMaxRecords = 32767;

// Number of whole records of `recordSize` bytes in `length` bytes of the file `name`, refused
// when over 32,767.
platform::Status CountRecordsOfLength(std::uintmax_t length, std::size_t recordSize,
                                      const std::string& name, std::int16_t& count);
// Number of whole records of `size` bytes in a file, refused when over 32,767.
platform::Status CountRecords(const std::filesystem::path& file, std::size_t recordSize,
                              std::int16_t& count);

// Shared record I/O over raw bytes; the typed class below adds encoding.
class RecordFileBase {
public:
    RecordFileBase(std::filesystem::path path, std::size_t recordSize)
        : m_path(std::move(path)), m_size(recordSize) {}

    const std::filesystem::path& path() const { return m_path; }
    std::int16_t Count() const { return m_count; }

    platform::Status Open();
    // Records first..last (inclusive) as raw bytes in one read.
    platform::Status ReadRange(int first, int last, std::string& bytes) const;
    // Writes one record's bytes at a place; one past the end appends.
    platform::Status WriteBytes(int recordNumber, std::string_view bytes);
    // Replaces the whole file through the scratch-file gate.
    platform::Status WriteAllBytes(const std::string& bytes, std::size_t records,
                                   const platform::ScratchNames& names = {});

protected:
    std::filesystem::path m_path;
    std::size_t m_size;
    std::int16_t m_count = 0;
};

template <typename Record> class RecordFile : public RecordFileBase {
public:
    explicit RecordFile(std::filesystem::path path)
        : RecordFileBase(std::move(path), Record::kSize) {}

    platform::Status Read(int recordNumber, Record& out) const {
        std::string bytes;
        if (recordNumber < 1 || recordNumber > m_count)
            return platform::Status::Error("Record " + std::to_string(recordNumber) +
                                           " is not in " + m_path.filename().string());
        if (auto s = ReadRange(recordNumber, recordNumber, bytes); !s) return s;
        out = Record::Decode(bytes.data());
        return platform::Status::Ok();
    }
    platform::Status Write(int recordNumber, const Record& r) {
        const auto b = r.Encode();
        return WriteBytes(recordNumber, {b.data(), b.size()});
    }
    platform::Status Append(const Record& r) { return Write(m_count + 1, r); }

    // Every record in one read (the file's current length, whether or not it was opened).
    platform::Status ReadAll(std::vector<Record>& out) const {
        out.clear();
        std::int16_t count = 0;
        if (auto s = CountRecords(m_path, Record::kSize, count); !s) return s;
        std::string bytes;
        if (count > 0) {
            const auto content = platform::ReadWholeFile(m_path);
            if (!content) return platform::Status::Error("Cannot read " + m_path.string());
            bytes = std::move(*content);
        }
        out.reserve(static_cast<std::size_t>(count));
        for (int i = 0; i < count; ++i)
            out.push_back(
                Record::Decode(bytes.data() + static_cast<std::size_t>(i) * Record::kSize));
        return platform::Status::Ok();
    }
    platform::Status WriteAll(const std::vector<Record>& records,
                              const platform::ScratchNames& names = {}) {
        std::string bytes;
        bytes.reserve(records.size() * Record::kSize);
        for (const auto& r : records) {
            const auto b = r.Encode();
            bytes.append(b.data(), b.size());
        }
        return WriteAllBytes(bytes, records.size(), names);
    }
};

} // namespace kori::store
