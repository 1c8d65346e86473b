#include "store/price_file.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_record.h"
#include "store/record_codec.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <fstream>
#include <unistd.h>

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
    // A code that could reach outside the folder names no file at all.
    if (!IsValidCode(code)) return {};
    return platform::ResolveIn(dataFolder, platform::Trim(code) + ".WDT");
}

Status PriceFile::OpenWithData() {
    const std::string name = m_path.empty() ? std::string("that code") : m_path.filename().string();
    if (m_path.empty() || !platform::FileHasData(m_path))
        return Status::Error("No Data for " + name);
    if (auto s = Open(); !s) return s;
    if (Count() < 1) return Status::Error("No Data for " + name);
    return Status::Ok();
}

Status ReadPriceRecords(const std::filesystem::path& file, int first, int last,
                        std::string& bytes) {
    bytes.clear();
    if (first < 1 || last < first) return Status::Ok();
    const int fd = ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return Status::Error("Cannot open " + file.filename().string());
    const std::size_t size = static_cast<std::size_t>(last - first + 1) * PriceRecord::kSize;
    bytes.resize(size);
    auto offset = static_cast<off_t>(first - 1) * static_cast<off_t>(PriceRecord::kSize);
    std::size_t done = 0;
    while (done < size) {
        const ssize_t n = ::pread(fd, bytes.data() + done, size - done, offset);
        if (n < 0 && errno == EINTR) continue;
        if (n <= 0) break;
        done += static_cast<std::size_t>(n);
        offset += n;
    }
    ::close(fd);
    if (done != size) {
        bytes.clear();
        return Status::Error("Cannot read " + file.filename().string());
    }
    return Status::Ok();
}

} // namespace kori::store
