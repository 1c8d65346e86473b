#include "store/price_file.h"

#include "platform/files.h"
#include "platform/text.h"
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

Status PriceFile::SortByDate() {
    std::vector<PriceRecord> records;
    if (auto s = ReadAll(records); !s) return s;
    std::stable_sort(records.begin(), records.end(),
                     [](const PriceRecord& a, const PriceRecord& b) {
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
