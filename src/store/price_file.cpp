#include "store/price_file.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/record_codec.h"

#include <algorithm>
#include <fstream>

namespace kori::store {

using namespace codec;
using platform::Status;

std::array<char, PriceRecord::kSize> PriceRecord::Encode() const {
    std::array<char, kSize> b{};
    PutText(b.data() + 0, Date, 8);
    Put(b.data() + 8, Open);
    Put(b.data() + 12, High);
    Put(b.data() + 16, Low);
    Put(b.data() + 20, Close);
    Put(b.data() + 24, Volume);
    Put(b.data() + 28, AdjFactor);
    PutText(b.data() + 32, AdjDesc, 14);
    PutText(b.data() + 46, Flag, 1);
    PutText(b.data() + 47, Reserved, 3);
    return b;
}

PriceRecord PriceRecord::Decode(const char* p) {
    PriceRecord r;
    r.Date = GetText(p, 8);
    r.Open = Get<float>(p + 8);
    r.High = Get<float>(p + 12);
    r.Low = Get<float>(p + 16);
    r.Close = Get<float>(p + 20);
    r.Volume = Get<std::int32_t>(p + 24);
    r.AdjFactor = Get<float>(p + 28);
    r.AdjDesc = GetText(p + 32, 14);
    r.Flag = GetText(p + 46, 1);
    r.Reserved = GetText(p + 47, 3);
    return r;
}

std::filesystem::path PriceFile::PathFor(std::string_view dataFolder, std::string_view code) {
    return platform::ResolveIn(dataFolder, platform::Trim(code) + ".WDT");
}

Status PriceFile::Open() {
    m_path = platform::ResolvePath(m_path);
    if (!platform::FileExists(m_path)) {
        std::ofstream create(m_path, std::ios::binary);
        if (!create) return Status::Error("Cannot create " + m_path.string());
    }
    return CountRecords(m_path, PriceRecord::kSize, m_count);
}

Status PriceFile::ReadRange(int first, int last, std::string& bytes) const {
    bytes.clear();
    if (first < 1 || last < first) return Status::Ok();
    if (last > m_count)
        return Status::Error("Record " + std::to_string(last) + " is not in " + m_path.filename().string());
    std::ifstream in(m_path, std::ios::binary);
    const auto size = static_cast<std::size_t>(last - first + 1) * PriceRecord::kSize;
    bytes.resize(size);
    in.seekg(static_cast<std::streamoff>(first - 1) * static_cast<std::streamoff>(PriceRecord::kSize));
    if (!in.read(bytes.data(), static_cast<std::streamsize>(size)))
        return Status::Error("Cannot read " + m_path.string());
    return Status::Ok();
}

Status PriceFile::Read(int recordNumber, PriceRecord& out) const {
    std::string bytes;
    if (recordNumber < 1 || recordNumber > m_count)
        return Status::Error("Record " + std::to_string(recordNumber) + " is not in " +
                             m_path.filename().string());
    if (auto s = ReadRange(recordNumber, recordNumber, bytes); !s) return s;
    out = PriceRecord::Decode(bytes.data());
    return Status::Ok();
}

Status PriceFile::Write(int recordNumber, const PriceRecord& r) {
    if (recordNumber < 1 || recordNumber > m_count + 1)
        return Status::Error("Record " + std::to_string(recordNumber) + " is past the end of " +
                             m_path.filename().string());
    if (recordNumber > kMaxRecords)
        return Status::Error(m_path.filename().string() + " is full (32767 records).");
    const auto bytes = r.Encode();
    if (recordNumber == m_count + 1) {
        if (auto s = platform::AppendToFile(m_path, {bytes.data(), bytes.size()}); !s) return s;
        ++m_count;
        return Status::Ok();
    }
    std::fstream f(m_path, std::ios::in | std::ios::out | std::ios::binary);
    f.seekp(static_cast<std::streamoff>(recordNumber - 1) * static_cast<std::streamoff>(PriceRecord::kSize));
    if (!f.write(bytes.data(), static_cast<std::streamsize>(bytes.size())))
        return Status::Error("Cannot write " + m_path.string());
    return Status::Ok();
}

Status PriceFile::ReadAll(std::vector<PriceRecord>& out) const {
    out.clear();
    std::string bytes;
    if (auto s = ReadRange(1, m_count, bytes); !s) return s;
    out.reserve(static_cast<std::size_t>(m_count));
    for (std::size_t off = 0; off + PriceRecord::kSize <= bytes.size(); off += PriceRecord::kSize)
        out.push_back(PriceRecord::Decode(bytes.data() + off));
    return Status::Ok();
}

Status PriceFile::WriteAll(const std::vector<PriceRecord>& records) {
    if (records.size() > static_cast<std::size_t>(kMaxRecords))
        return Status::Error("A price file can hold at most 32767 records.");
    std::string bytes;
    bytes.reserve(records.size() * PriceRecord::kSize);
    for (const auto& r : records) {
        const auto b = r.Encode();
        bytes.append(b.data(), b.size());
    }
    if (auto s = platform::WriteFileAtomic(m_path, bytes); !s) return s;
    m_count = static_cast<std::int16_t>(records.size());
    return Status::Ok();
}

Status PriceFile::SortByDate() {
    std::vector<PriceRecord> records;
    if (auto s = ReadAll(records); !s) return s;
    std::stable_sort(records.begin(), records.end(), [](const PriceRecord& a, const PriceRecord& b) {
        return platform::Val(a.Date) < platform::Val(b.Date);
    });
    // The sorted copy goes to Temp.Wk2 first, then takes the file's place.
    PriceFile work(m_path.parent_path() / "Temp.Wk2");
    if (auto s = work.WriteAll(records); !s) return s;
    std::error_code ec;
    std::filesystem::rename(work.path(), m_path, ec);
    if (ec) return Status::Error("Cannot replace " + m_path.string() + ": " + ec.message());
    return Status::Ok();
}

} // namespace kori::store
