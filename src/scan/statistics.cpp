#include "scan/statistics.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/rounding.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "store/security_walk.h"

#include <cmath>
#include <cstring>
#include <unordered_map>

namespace kori::scan {

using platform::Status;

bool StatisticsTakes(std::string_view filterWord, std::string_view code) {
    const std::size_t len = platform::Trim(code).size();
    if (filterWord == "3") return len == 3;
    if (filterWord == "NW") return len < 6;
    if (filterWord == "WO") return len == 6;
    return true;
}

std::string PercentKey(double percent) {
    return platform::PadRight(platform::Str(percent), 12);
}

void SortMovers(std::vector<MoverRow>& rows) {
    const std::size_t n = rows.size();
    // The keys are kept as text and compared by the value they read as.
    std::vector<double> key(n);
    for (std::size_t i = 0; i < n; ++i)
        key[i] = platform::Val(PercentKey(rows[i].Percent));
    std::size_t power = 1;
    while (power < n)
        power *= 2;
    for (std::size_t gap = power - 1; gap > 0; gap /= 2) {
        for (std::size_t i = gap; i < n; ++i) {
            MoverRow row = std::move(rows[i]);
            const double k = key[i];
            std::size_t j = i;
            for (; j >= gap && key[j - gap] < k; j -= gap) {
                rows[j] = std::move(rows[j - gap]);
                key[j] = key[j - gap];
            }
            rows[j] = std::move(row);
            key[j] = k;
        }
    }
}

Status MarketStatistics::Check(std::string_view dataFolder, std::string_view filterWord,
                               platform::Progress& progress) {
    const auto namePath = store::NameFile::PathIn(dataFolder);
    if (platform::FileSizeOr0(namePath) < store::NameRecord::kSize)
        return Status::Error(std::string(kNoNameFile));
    *this = MarketStatistics{};
    progress.SetStatus("Checking Statistics");
    std::string bytes;
    const auto walked = store::ForEachSecurity(
        {std::string(dataFolder), 0}, progress, [&](const store::WalkItem& item) {
            const std::string code = item.Name.TrimmedCode();
            if (!StatisticsTakes(filterWord, code) || item.PriceRecords < 2)
                return store::WalkStep::Continue;
            const int records = item.PriceRecords;
            if (auto s = store::ReadPriceRecords(item.PriceFile, records - 1, records, bytes); !s) {
                m_issues.push_back({platform::Severity::Warning, s.message(),
                                    item.PriceFile.filename().string(), 0});
                return store::WalkStep::Continue;
            }
            const char* lastRec = bytes.data() + store::PriceRecord::kSize;
            if (store::PriceVolume(lastRec) <= 1) {
                ++m_counters.Untraded;
                return store::WalkStep::Continue;
            }
            ++m_counters.Traded;
            const float latest = store::PriceField(lastRec, store::kCloseAt);
            const float previous = store::PriceField(bytes.data(), store::kCloseAt);
            double percent = 0;
            if (latest > previous) {
                ++m_counters.Rises;
                const float change = latest - previous;
                if (change != 0 && previous != 0)
                    percent = platform::RoundHalfEven(change / previous, 4);
                if (percent <= 0) return store::WalkStep::Continue;
            } else if (latest < previous) {
                ++m_counters.Falls;
                if (previous == 0) return store::WalkStep::Continue;
                percent = platform::RoundHalfEven(-(previous - latest) / previous, 4);
                if (percent >= 0) return store::WalkStep::Continue;
            } else {
                ++m_counters.Steady;
                return store::WalkStep::Continue;
            }
            m_rows.push_back({code,
                              platform::FormatSingle(latest, "0.00#"),
                              percent,
                              platform::FormatSingle(previous, "0.00#"),
                              {}});
            return store::WalkStep::Continue;
        });
    m_issues.insert(m_issues.begin(), walked.Issues.begin(), walked.Issues.end());
    m_cancelled = walked.Cancelled;
    if (!walked.Status) return walked.Status;
    progress.SetStatus("SORTING STATISTICS");
    SortMovers(m_rows);
    // The name column: a last pass over the name file.
    std::vector<store::NameRecord> names;
    if (auto s = store::NameFile(namePath).ReadAll(names); !s) return s;
    std::unordered_map<std::string, std::string> nameOf;
    for (const auto& n : names)
        nameOf[n.TrimmedCode()] = platform::Trim(n.Name);
    for (auto& row : m_rows)
        if (auto it = nameOf.find(row.Code); it != nameOf.end()) row.Name = it->second;
    m_checked = true;
    progress.SetStatus("COMPLETED");
    return Status::Ok();
}

MoversDisplay MarketStatistics::Display(std::string_view topText) const {
    MoversDisplay d;
    const std::string t = platform::Trim(topText);
    int top = t.empty() ? 20 : static_cast<int>(platform::Val(t));
    const int movers = static_cast<int>(m_rows.size());
    if (movers < top) top = movers;
    if (top < 0) top = 0;
    d.TopCount = top;
    for (int i = 0; i < top; ++i) {
        d.Rises.push_back(m_rows[static_cast<std::size_t>(i)]);
        d.Falls.push_back(m_rows[static_cast<std::size_t>(movers - 1 - i)]);
    }
    return d;
}

// ---- Advance-decline totals ----

std::vector<std::string> AdvanceDeclineCodes(std::string_view dataFolder) {
    std::vector<store::NameRecord> names;
    std::vector<std::string> codes;
    const auto path = store::NameFile::PathIn(dataFolder);
    if (!platform::FileExists(path) || !store::NameFile(path).ReadAll(names)) return codes;
    for (const auto& n : names)
        if (n.RecordType == 3) codes.push_back(n.TrimmedCode());
    return codes;
}

namespace {
Status NoRecords(const std::filesystem::path& file) {
    return Status::Error("There are no records for " + file.filename().string());
}

void PutFloat(char* p, float v) {
    std::memcpy(p, &v, sizeof v);
}
} // namespace

Status ADBaseValue(const std::filesystem::path& priceFile, double& base) {
    std::int16_t count = 0;
    if (auto s = store::CountRecords(priceFile, store::PriceRecord::kSize, count); !s) return s;
    if (count < 1) return NoRecords(priceFile);
    std::string bytes;
    if (auto s = store::ReadPriceRecords(priceFile, 1, 1, bytes); !s) return s;
    const float close = store::PriceField(bytes.data(), store::kCloseAt);
    const float low = store::PriceField(bytes.data(), store::kLowAt);
    const float high = store::PriceField(bytes.data(), store::kHighAt);
    base = static_cast<double>(close) + low - high;
    return Status::Ok();
}

Status CheckADTotals(const std::filesystem::path& priceFile, double base, std::int32_t& total) {
    std::int16_t count = 0;
    if (auto s = store::CountRecords(priceFile, store::PriceRecord::kSize, count); !s) return s;
    if (count < 1) return NoRecords(priceFile);
    auto bytes = platform::ReadWholeFile(priceFile);
    if (!bytes) return Status::Error("Cannot read " + priceFile.filename().string());
    // A torn last record is not a record: the rewrite keeps only whole ones.
    bytes->resize(static_cast<std::size_t>(count) * store::PriceRecord::kSize);
    const auto start = platform::CLng(base);
    if (!start) return Status::Error("Base Value must be numeric");
    double running = *start;
    for (std::size_t k = 0; k < static_cast<std::size_t>(count); ++k) {
        char* rec = bytes->data() + k * store::PriceRecord::kSize;
        running = platform::RoundHalfEven(running + store::PriceField(rec, store::kHighAt) -
                                          store::PriceField(rec, store::kLowAt));
        PutFloat(rec + store::kCloseAt, static_cast<float>(running));
        PutFloat(rec + store::kOpenAt, 0.0f);
    }
    if (std::fabs(running) > 2147483647.0)
        return Status::Error("The cumulative total is beyond the range of a whole number");
    if (auto s = platform::WriteFileAtomic(priceFile, *bytes); !s) return s;
    total = static_cast<std::int32_t>(running);
    return Status::Ok();
}

std::string ADCheckedMessage(const std::filesystem::path& priceFile, std::int32_t total) {
    return " Checked " + priceFile.filename().string() + "\n" + "Cumulative Total at end is " +
           std::to_string(total);
}

} // namespace kori::scan
