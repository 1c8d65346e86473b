#include "scan/scan_common.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/price_file.h"

#include <cctype>
#include <cmath>
#include <cstdlib>

namespace kori::scan {

using platform::Status;

bool IsNumericText(std::string_view text) {
    const std::string t = platform::Trim(text);
    if (t.empty()) return false;
    char* end = nullptr;
    const double v = std::strtod(t.c_str(), &end);
    return end == t.c_str() + t.size() && std::isfinite(v);
}

bool PriceRange::Valid() const {
    return !On || (IsNumericText(Min) && IsNumericText(Max));
}

bool PriceRange::Holds(float close) const {
    if (!On) return true;
    return close >= platform::Val(Min) && close <= platform::Val(Max);
}

bool ClassMatches(std::string_view chosen, std::string_view recordClass) {
    const std::string c = platform::Trim(chosen);
    const std::string r = platform::Trim(recordClass);
    if (!c.empty() && c.back() == '0') {
        if (r.size() != 3 || c.size() < 2) return false;
        return r.compare(0, 2, c, 0, 2) == 0;
    }
    return c == r;
}

ClassProblem CheckClass(std::string_view chosen) {
    const std::string c = platform::Trim(chosen);
    for (char ch : c)
        if (!std::isdigit(static_cast<unsigned char>(ch))) return ClassProblem::NotNumeric;
    if (c.empty()) return ClassProblem::NotNumeric;
    return c.size() == 3 ? ClassProblem::None : ClassProblem::NotThreeDigits;
}

bool IsWarrant(const store::NameRecord& r) {
    return r.TrimmedCode().size() == 6;
}

namespace {
// Relative width of a 32-bit float's last place, with room for the two closes' rounding.
constexpr double kFloatSlack = 1e-6;
} // namespace

bool RoseBy(float previous, float last, double percent) {
    const double need = static_cast<double>(previous) * (1 + percent / 100);
    return last >= need - std::fabs(need) * kFloatSlack;
}

bool FellBy(float previous, float last, double percent) {
    const double need = static_cast<double>(previous) * (1 - percent / 100);
    return last <= need + std::fabs(need) * kFloatSlack;
}

double ChangePercent(float previous, float last) {
    return (static_cast<double>(last) - previous) / previous * 100;
}

bool FoldDailyTail(std::string_view bytes, int firstBar, int barCount, std::int16_t recordType,
                   DailyTail& tail) {
    const auto n = bytes.size() / store::PriceRecord::kSize;
    tail.First = firstBar;
    tail.BarCount = barCount;
    tail.Close.resize(n);
    tail.High.resize(n);
    tail.Low.resize(n);
    tail.Volume.resize(n);
    const bool bars = !store::IsCloseOnly(recordType);
    float previous = 0;
    for (std::size_t k = 0; k < n; ++k) {
        const char* rec = bytes.data() + k * store::PriceRecord::kSize;
        const int bar = firstBar + static_cast<int>(k);
        float high = store::PriceField(rec, store::kHighAt);
        float low = store::PriceField(rec, store::kLowAt);
        float close = store::PriceField(rec, store::kCloseAt);
        std::int32_t volume = store::PriceVolume(rec);
        // The daily load's rule: from the third bar a no-trade record repeats the close before.
        if (close == 0 && bar > 1) {
            if (k == 0) return false; // the close before lies outside the bytes
            high = low = close = previous;
            volume = 0;
        }
        previous = close;
        if (store::PriceField(rec, store::kHighAt) == 0 && bars) high = low = close;
        tail.Close[k] = close;
        tail.High[k] = high;
        tail.Low[k] = low;
        tail.Volume[k] = volume;
    }
    return true;
}

Status ReadDailyTail(const std::filesystem::path& file, int records, int wanted,
                     std::int16_t recordType, std::string& buffer, DailyTail& tail) {
    int first = wanted <= 0 || wanted >= records ? 1 : records - wanted + 1;
    // Start a few records early: the close a no-trade record repeats is usually near.
    first = std::max(1, first - 8);
    for (;;) {
        if (auto s = store::ReadPriceRecords(file, first, records, buffer); !s) return s;
        if (FoldDailyTail(buffer, first - 1, records, recordType, tail)) return Status::Ok();
        first = 1;
    }
}

Status StoreScanList(std::string_view dataFolder, const std::vector<ListedCode>& codes) {
    std::vector<store::ChartListEntry> entries;
    entries.reserve(codes.size());
    for (const auto& c : codes)
        entries.push_back({static_cast<std::int16_t>(c.NameRecord), platform::Trim(c.Code)});
    return store::WriteList(store::ListPath(dataFolder, 'Z'), entries);
}

std::filesystem::path ScanTempFolder(std::string_view systemFolder) {
    const std::filesystem::path dir = platform::FolderWithSlash(systemFolder) + "temp";
    platform::CreateFolder(dir);
    return dir;
}

} // namespace kori::scan
