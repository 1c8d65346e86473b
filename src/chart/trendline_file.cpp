#include "chart/trendline_file.h"

#include "platform/files.h"
#include "platform/text.h"

#include <cstring>
#include <fstream>

namespace kori::chart {

namespace {
void PutText(char* dst, std::string_view s, std::size_t width) {
    const std::string padded = platform::PadRight(s, width);
    std::memcpy(dst, padded.data(), width);
}
template <typename T> void PutNumber(char* dst, T v) {
    std::memcpy(dst, &v, sizeof v);
}
template <typename T> T GetNumber(const char* src) {
    T v;
    std::memcpy(&v, src, sizeof v);
    return v;
}
} // namespace

std::array<char, TrendRecord::kSize> TrendRecord::Encode() const {
    std::array<char, kSize> b{};
    PutNumber(b.data(), LineKind);
    b[2] = Period;
    PutText(b.data() + 3, DateA, 8);
    PutNumber(b.data() + 11, PriceA);
    PutText(b.data() + 15, DateB, 8);
    PutNumber(b.data() + 23, PriceB);
    return b;
}

TrendRecord TrendRecord::Decode(const char* bytes) {
    TrendRecord r;
    r.LineKind = GetNumber<std::int16_t>(bytes);
    r.Period = bytes[2];
    r.DateA.assign(bytes + 3, 8);
    r.PriceA = GetNumber<float>(bytes + 11);
    r.DateB.assign(bytes + 15, 8);
    r.PriceB = GetNumber<float>(bytes + 23);
    return r;
}

TrendRecord TrendRecord::Blank() {
    TrendRecord r;
    r.DateA = std::string(8, ' ');
    r.DateB = std::string(8, ' ');
    return r;
}

std::filesystem::path TrendlineFile::PathFor(std::string_view chartFolder, std::string_view code) {
    return platform::ResolveIn(chartFolder, platform::Trim(code) + ".TND");
}

std::vector<TrendRecord> TrendlineFile::ReadAll(const std::filesystem::path& path) {
    std::vector<TrendRecord> r;
    const auto bytes = platform::ReadWholeFile(path);
    if (!bytes) return r;
    const std::size_t n = bytes->size() / TrendRecord::kSize;
    r.reserve(n);
    for (std::size_t i = 0; i < n; ++i)
        r.push_back(TrendRecord::Decode(bytes->data() + i * TrendRecord::kSize));
    return r;
}

platform::Status TrendlineFile::WriteRecord(const std::filesystem::path& path, int recordNumber,
                                            const TrendRecord& r) {
    if (recordNumber < 1) return platform::Status::Error("Bad trendline record number");
    const auto target = platform::ResolvePath(path);
    std::fstream f(target, std::ios::in | std::ios::out | std::ios::binary);
    if (!f) {
        std::ofstream create(target, std::ios::binary);
        create.close();
        f.open(target, std::ios::in | std::ios::out | std::ios::binary);
    }
    if (!f) return platform::Status::Error("Cannot write " + target.string());
    const auto bytes = r.Encode();
    f.seekp(static_cast<std::streamoff>(recordNumber - 1) *
            static_cast<std::streamoff>(TrendRecord::kSize));
    f.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    return f ? platform::Status::Ok() : platform::Status::Error("Cannot write " + target.string());
}

int TrendlineFile::AddRecord(const std::filesystem::path& path, const TrendRecord& r,
                             platform::Status& status) {
    const auto records = ReadAll(path);
    int place = static_cast<int>(records.size()) + 1;
    for (std::size_t i = 0; i < records.size(); ++i) {
        if (records[i].deleted()) {
            place = static_cast<int>(i) + 1;
            break;
        }
    }
    status = WriteRecord(path, place, r);
    return status.ok() ? place : 0;
}

platform::Status TrendlineFile::Pack(const std::filesystem::path& path) {
    const auto target = platform::ResolvePath(path);
    const auto records = ReadAll(target);
    std::string live;
    for (const auto& r : records) {
        if (r.deleted()) continue;
        const auto b = r.Encode();
        live.append(b.data(), b.size());
    }
    // Temp.Wk3 is written whole beside the file, then takes its place.
    const auto work = target.parent_path() / "Temp.Wk3";
    if (auto s = platform::WriteFileAtomic(work, live); !s) return s;
    std::error_code ec;
    std::filesystem::rename(work, target, ec);
    if (ec)
        return platform::Status::Error("Cannot replace " + target.string() + ": " + ec.message());
    return platform::Status::Ok();
}

} // namespace kori::chart
