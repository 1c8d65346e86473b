#include "store/trendline_file.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_record.h"
#include "store/record_codec.h"

namespace kori::store {

using namespace codec;
using platform::Status;

std::array<char, TrendRecord::kSize> TrendRecord::Encode() const {
    std::array<char, kSize> b{};
    Put(b.data(), LineKind);
    b[2] = Period;
    PutText(b.data() + 3, DateA, 8);
    Put(b.data() + 11, PriceA);
    PutText(b.data() + 15, DateB, 8);
    Put(b.data() + 23, PriceB);
    return b;
}

TrendRecord TrendRecord::Decode(const char* bytes) {
    TrendRecord r;
    r.LineKind = Get<std::int16_t>(bytes);
    r.Period = bytes[2];
    r.DateA = GetText(bytes + 3, 8);
    r.PriceA = Get<float>(bytes + 11);
    r.DateB = GetText(bytes + 15, 8);
    r.PriceB = Get<float>(bytes + 23);
    return r;
}

TrendRecord TrendRecord::Blank() {
    TrendRecord r;
    r.DateA = std::string(8, ' ');
    r.DateB = std::string(8, ' ');
    return r;
}

std::filesystem::path TrendlineFile::PathFor(std::string_view chartFolder, std::string_view code) {
    if (!IsValidCode(code)) return {};
    return platform::ResolveIn(chartFolder, platform::Trim(code) + ".TND");
}

std::vector<TrendRecord> TrendlineFile::ReadAll(const std::filesystem::path& path) {
    std::vector<TrendRecord> r;
    if (!TrendlineFile(platform::ResolvePath(path)).RecordFile::ReadAll(r)) r.clear();
    return r;
}

Status TrendlineFile::WriteRecord(const std::filesystem::path& path, int recordNumber,
                                  const TrendRecord& r) {
    TrendlineFile f(path);
    if (auto s = f.Open(); !s) return s;
    return f.Write(recordNumber, r);
}

int TrendlineFile::AddRecord(const std::filesystem::path& path, const TrendRecord& r,
                             Status& status) {
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

Status TrendlineFile::Pack(const std::filesystem::path& path) {
    TrendlineFile f(platform::ResolvePath(path));
    std::vector<TrendRecord> records;
    if (auto s = f.RecordFile::ReadAll(records); !s) return s;
    std::erase_if(records, [](const TrendRecord& r) { return r.deleted(); });
    return f.WriteAll(records, {"Temp.Wk3", {}});
}

} // namespace kori::store
