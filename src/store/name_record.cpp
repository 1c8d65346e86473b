#include "store/name_record.h"

#include "store/record_codec.h"

namespace kori::store {

using namespace codec;

std::array<char, NameRecord::kSize> NameRecord::Encode() const {
    std::array<char, kSize> b{};
    Put(b.data() + 0, Status);
    PutText(b.data() + 2, Code, 6);
    Put(b.data() + 8, RecordType);
    PutText(b.data() + 10, Name, kNameWidth);
    PutText(b.data() + 45, OtherDetails, kOtherDetailsWidth);
    Put(b.data() + 60, Base);
    Put(b.data() + 64, Top);
    Put(b.data() + 68, PFIncrement);
    Put(b.data() + 72, ScaleStep);
    Put(b.data() + 76, PercentBandUp);
    Put(b.data() + 78, PercentBandDown);
    Put(b.data() + 80, BollingerPeriod);
    Put(b.data() + 82, BollingerWidth);
    Put(b.data() + 84, Category);
    PutText(b.data() + 86, Id, 1);
    PutText(b.data() + 87, IndustryClass, 3);
    PutText(b.data() + 90, GicsSector, 4);
    PutText(b.data() + 94, Reserved, 2);
    return b;
}

NameRecord NameRecord::Decode(const char* p) {
    NameRecord r;
    r.Status = Get<std::int16_t>(p + 0);
    r.Code = GetText(p + 2, 6);
    r.RecordType = Get<std::int16_t>(p + 8);
    r.Name = GetText(p + 10, kNameWidth);
    r.OtherDetails = GetText(p + 45, kOtherDetailsWidth);
    r.Base = Get<float>(p + 60);
    r.Top = Get<float>(p + 64);
    r.PFIncrement = Get<float>(p + 68);
    r.ScaleStep = Get<float>(p + 72);
    r.PercentBandUp = Get<std::int16_t>(p + 76);
    r.PercentBandDown = Get<std::int16_t>(p + 78);
    r.BollingerPeriod = Get<std::int16_t>(p + 80);
    r.BollingerWidth = Get<std::int16_t>(p + 82);
    r.Category = Get<std::int16_t>(p + 84);
    r.Id = GetText(p + 86, 1);
    r.IndustryClass = GetText(p + 87, 3);
    r.GicsSector = GetText(p + 90, 4);
    r.Reserved = GetText(p + 94, 2);
    return r;
}

std::string NameRecord::TrimmedCode() const {
    return platform::Trim(Code);
}

bool IsValidCode(std::string_view code) {
    const std::string c = platform::Trim(code);
    if (c.empty() || c.size() > 6) return false;
    for (const char ch : c) {
        const auto u = static_cast<unsigned char>(ch);
        if (u <= ' ' || u == 127 || ch == '/' || ch == '\\' || ch == '.' || ch == ':') return false;
    }
    return true;
}

std::string PadCode(std::string_view code) {
    std::string c = platform::Upper(platform::Trim(code));
    if (c == "PRN") c = "PRNX";
    if (c == "AUX") c = "1AUX";
    return platform::PadRight(c, 6);
}

} // namespace kori::store
