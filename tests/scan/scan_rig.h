#pragma once
// A small library on disk for the scan tests: name records and price files made from closes.
#include "platform/progress.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace kori::test {

struct RigSecurity {
    std::string Code;
    std::vector<float> Closes; // one record a close; high = low = close unless given
    std::int16_t Type = 4;
    std::int16_t Category = 1;
    std::string Class = "121";
    std::vector<std::int32_t> Volumes; // empty: 1000 each
    std::vector<float> Highs, Lows;    // empty: the closes
};

inline std::vector<store::PriceRecord> RigRecords(const RigSecurity& s) {
    std::vector<store::PriceRecord> out;
    for (std::size_t i = 0; i < s.Closes.size(); ++i) {
        store::PriceRecord r;
        r.Date = "2026" + std::to_string(1000 + i / 28 * 100 + i % 28 + 1).substr(0, 4);
        r.Close = s.Closes[i];
        r.High = s.Highs.empty() ? r.Close : s.Highs[i];
        r.Low = s.Lows.empty() ? r.Close : s.Lows[i];
        r.Open = r.Close;
        r.Volume = s.Volumes.empty() ? 1000 : s.Volumes[i];
        out.push_back(r);
    }
    return out;
}

// Writes Names.dat with the securities in order and a price file for each that has closes.
inline void WriteRig(const TempRoot& root, const std::vector<RigSecurity>& list) {
    std::vector<store::NameRecord> names;
    for (const auto& s : list) {
        store::NameRecord n;
        n.Code = s.Code;
        n.Name = "Name of " + s.Code;
        n.RecordType = s.Type;
        n.Category = s.Category;
        n.IndustryClass = s.Class;
        names.push_back(n);
        if (s.Closes.empty()) continue;
        ASSERT_TRUE(store::PriceFile(store::PriceFile::PathFor(root.folder(), s.Code))
                        .WriteAll(RigRecords(s))
                        .ok());
    }
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).WriteAll(names).ok());
}

// A progress that asks to cancel once the walk has reached a place, and keeps what it was shown.
class RecordingProgress : public platform::Progress {
public:
    explicit RecordingProgress(long long cancelAt = 0) : m_cancelAt(cancelAt) {}
    void SetStatus(std::string_view text) override { statuses.emplace_back(text); }
    void SetRange(long long maximum) override { range = maximum; }
    void SetValue(long long value) override {
        last = value;
        if (m_cancelAt > 0 && value >= m_cancelAt) RequestCancel();
    }
    std::vector<std::string> statuses;
    long long range = 0, last = 0;

private:
    long long m_cancelAt;
};

} // namespace kori::test
