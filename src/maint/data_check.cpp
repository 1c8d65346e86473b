#include "maint/data_check.h"

#include "platform/date_text.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/two_thread_walk.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <filesystem>
#include <mutex>
#include <unordered_map>

namespace kori::maint {

namespace {

std::string Price(float v) {
    return platform::FormatSingle(v, "0.00##");
}

// Weekdays strictly between two day numbers (serial 1, 31 December 1899, was a Sunday).
int WeekdaysBetweenSerials(std::int32_t a, std::int32_t b) {
    if (b <= a + 1) return 0;
    auto weekdaysUpTo = [](std::int32_t s) { // weekdays in serials 1..s, weeks from a Sunday
        return s / 7 * 5 + std::clamp(s % 7 - 1, 0, 5);
    };
    return static_cast<int>(weekdaysUpTo(b - 1) - weekdaysUpTo(a));
}

class HistoryChecker {
public:
    HistoryChecker(const store::NameRecord& name, const DataCheckSettings& settings)
        : m_code(name.TrimmedCode()), m_name(platform::Trim(name.Name)),
          m_closeOnly(store::IsCloseOnly(name.RecordType)),
          m_signed(name.RecordType == 3), // advance-decline totals may go below zero
          m_settings(settings) {}

    std::vector<Finding> Run(const std::vector<store::PriceRecord>& records) {
        for (std::size_t i = 0; i < records.size(); ++i)
            Check(records, static_cast<int>(i));
        return std::move(m_findings);
    }
    // After a run: the latest date in order and its record (1-based; 0 when none).
    const std::string& lastDate() const { return m_lastDate; }
    int lastRecord() const { return m_lastIndex + 1; }

private:
    void Add(const store::PriceRecord& r, int index, std::string_view what, std::string detail) {
        m_findings.push_back(
            {m_code, m_name, r.Date, index + 1, std::string(what), std::move(detail)});
    }

    void Check(const std::vector<store::PriceRecord>& records, int i) {
        const auto& r = records[static_cast<std::size_t>(i)];
        CheckDate(r, i);
        CheckPrices(r, i);
        if (r.Volume < 0) Add(r, i, finding::NegativeVolume, std::to_string(r.Volume));
        CheckMove(records, i);
    }

    // One day number a record serves every date rule: valid, weekday, order and gap.
    void CheckDate(const store::PriceRecord& r, int i) {
        const auto serial = platform::DaySerial(r.Date);
        if (!serial) {
            Add(r, i, finding::NotADate, "\"" + r.Date + "\"");
            return;
        }
        const int weekday = *serial % 7; // 0 Saturday, 1 Sunday (serial 1 was a Sunday)
        if (weekday == 0 || weekday == 1)
            Add(r, i, finding::Weekend, platform::FormatDate(r.Date, "dddd"));
        if (m_lastIndex >= 0) {
            if (*serial < m_lastSerial) {
                Add(r, i, finding::OutOfOrder, "after " + platform::DateTextToDisplay(m_lastDate));
                return; // the order is broken: the last good date stays the reference
            }
            if (*serial == m_lastSerial) {
                Add(r, i, finding::Duplicated, "also record " + std::to_string(m_lastIndex + 1));
                return;
            }
            const int missing = WeekdaysBetweenSerials(m_lastSerial, *serial);
            if (missing > m_settings.GapWeekdays)
                Add(r, i, finding::Gap,
                    std::to_string(missing) + " weekdays without a record since " +
                        platform::DateTextToDisplay(m_lastDate));
        }
        m_lastDate = r.Date;
        m_lastSerial = *serial;
        m_lastIndex = i;
    }

    void CheckPrices(const store::PriceRecord& r, int i) {
        const float fields[] = {r.Open, r.High, r.Low, r.Close};
        if (std::any_of(std::begin(fields), std::end(fields),
                        [](float v) { return !std::isfinite(v); })) {
            Add(r, i, finding::NotANumber, "");
            return;
        }
        if (r.Close == 0 || m_signed) return; // no trade that day, or a signed series
        if (m_closeOnly) {
            if (r.Close < 0) Add(r, i, finding::ZeroPrice, "close " + Price(r.Close));
            return;
        }
        if (r.Open <= 0 || r.High <= 0 || r.Low <= 0 || r.Close < 0) {
            Add(r, i, finding::ZeroPrice,
                "open " + Price(r.Open) + " high " + Price(r.High) + " low " + Price(r.Low) +
                    " close " + Price(r.Close));
            return;
        }
        if (r.High < r.Low) {
            Add(r, i, finding::HighBelowLow, Price(r.High) + " < " + Price(r.Low));
            return;
        }
        if (r.Open < r.Low || r.Open > r.High)
            Add(r, i, finding::OpenOutside,
                Price(r.Open) + " not in " + Price(r.Low) + " - " + Price(r.High));
        if (r.Close < r.Low || r.Close > r.High)
            Add(r, i, finding::CloseOutside,
                Price(r.Close) + " not in " + Price(r.Low) + " - " + Price(r.High));
    }

    // An overnight move beyond the setting between two traded closes, with no adjustment
    // factor on any record within two records of the move's day.
    void CheckMove(const std::vector<store::PriceRecord>& records, int i) {
        const auto& r = records[static_cast<std::size_t>(i)];
        if (r.Close == 0 || !std::isfinite(r.Close) || m_signed) return;
        if (m_lastTraded >= 0) {
            const float before = records[static_cast<std::size_t>(m_lastTraded)].Close;
            if (before > 0 && r.Close > 0) {
                const double percent = (static_cast<double>(r.Close) / before - 1.0) * 100.0;
                if (std::fabs(percent) > m_settings.MoveAlertPercent && !AdjustedNear(records, i)) {
                    Add(r, i, finding::MissedAdjustment,
                        platform::Format(percent, "+0.0;-0.0") + "% from " + Price(before) +
                            " to " + Price(r.Close));
                }
            }
        }
        m_lastTraded = i;
    }

    static bool AdjustedNear(const std::vector<store::PriceRecord>& records, int i) {
        const int first = std::max(0, i - 2);
        const int last = std::min(static_cast<int>(records.size()) - 1, i + 2);
        for (int k = first; k <= last; ++k)
            if (records[static_cast<std::size_t>(k)].AdjFactor != 0) return true;
        return false;
    }

    std::string m_code, m_name;
    bool m_closeOnly, m_signed;
    const DataCheckSettings& m_settings;
    std::vector<Finding> m_findings;
    std::string m_lastDate;
    std::int32_t m_lastSerial = 0;
    int m_lastIndex = -1;
    int m_lastTraded = -1;
};

constexpr std::string_view kGapKey = "Data Check Gap Weekdays";
constexpr std::string_view kStoppedKey = "Data Check Stopped Weekdays";
constexpr std::string_view kMoveKey = "Data Check Move Percent";

} // namespace

DataCheckSettings LoadDataCheckSettings(const platform::SettingsStore& store) {
    DataCheckSettings s;
    auto read = [&](std::string_view key, double fallback, double low, double high) {
        const std::string text = platform::Trim(store.Get(key, ""));
        if (text.empty()) return fallback;
        const double v = platform::Val(text);
        return v >= low && v <= high ? v : fallback;
    };
    s.GapWeekdays = static_cast<int>(read(kGapKey, s.GapWeekdays, 1, 9999));
    s.StoppedWeekdays = static_cast<int>(read(kStoppedKey, s.StoppedWeekdays, 1, 9999));
    s.MoveAlertPercent = read(kMoveKey, s.MoveAlertPercent, 1, 10000);
    return s;
}

void SaveDataCheckSettings(platform::SettingsStore& store, const DataCheckSettings& settings) {
    store.Save(kGapKey, std::to_string(settings.GapWeekdays));
    store.Save(kStoppedKey, std::to_string(settings.StoppedWeekdays));
    store.Save(kMoveKey, platform::Format(settings.MoveAlertPercent, "0.##"));
}

int WeekdaysBetween(std::string_view fromDate, std::string_view toDate) {
    const auto a = platform::DaySerial(fromDate);
    const auto b = platform::DaySerial(toDate);
    return a && b ? WeekdaysBetweenSerials(*a, *b) : 0;
}

std::vector<Finding> CheckHistory(const store::NameRecord& name,
                                  const std::vector<store::PriceRecord>& records,
                                  const DataCheckSettings& settings) {
    return HistoryChecker(name, settings).Run(records);
}

std::string LastValidDate(const std::vector<store::PriceRecord>& records) {
    std::string last;
    for (const auto& r : records)
        if (platform::IsValidDateText(r.Date) && r.Date > last) last = r.Date;
    return last;
}

std::vector<Finding> StoppedTrading(const store::NameRecord& name, std::string_view lastDate,
                                    int lastRecord, std::string_view libraryLatest,
                                    const DataCheckSettings& settings) {
    if (lastDate.empty() || libraryLatest.empty()) return {};
    const int behind = WeekdaysBetween(lastDate, libraryLatest) + 1;
    if (behind <= settings.StoppedWeekdays) return {};
    return {{name.TrimmedCode(), platform::Trim(name.Name), std::string(lastDate), lastRecord,
             std::string(finding::Stopped),
             "last record " + std::to_string(behind) + " weekdays before " +
                 platform::DateTextToDisplay(libraryLatest)}};
}

DataCheckResult CheckLibrary(const store::SecurityList& list, const DataCheckSettings& settings,
                             platform::Progress& progress) {
    DataCheckResult result;
    // One slot a place in the walk, filled by whichever thread checked it, so the report keeps
    // the walk's order.
    struct Checked {
        bool Done = false;
        store::NameRecord Name;
        std::vector<Finding> Findings;
        std::string LastDate;
        int LastRecord = 0;
    };
    std::vector<Checked> slots;
    std::mutex grow;
    struct Buffers {
        std::string Bytes;
        std::vector<store::PriceRecord> Records;
    };
    std::array<Buffers, 2> buffers;
    progress.SetStatus("Checking data");
    const auto walk =
        store::WalkOnTwoThreads(list, progress, [&](int thread, const store::WalkItem& item) {
            auto& [bytes, records] = buffers[static_cast<std::size_t>(thread)];
            Checked c;
            c.Done = true;
            c.Name = item.Name;
            records.clear();
            if (auto s = store::ReadPriceRecords(item.PriceFile, 1, item.PriceRecords, bytes); !s) {
                c.Findings.push_back({item.Name.TrimmedCode(), platform::Trim(item.Name.Name), "",
                                      0, std::string(finding::Damaged), s.message()});
                c.LastRecord = -1; // no history to have stopped
            } else {
                for (std::size_t at = 0; at < bytes.size(); at += store::PriceRecord::kSize)
                    records.push_back(store::PriceRecord::Decode(bytes.data() + at));
                HistoryChecker checker(item.Name, settings);
                c.Findings = checker.Run(records);
                c.LastDate = checker.lastDate();
                c.LastRecord = checker.lastRecord();
            }
            std::lock_guard lock(grow);
            if (slots.size() < static_cast<std::size_t>(item.Position))
                slots.resize(static_cast<std::size_t>(item.Position));
            slots[static_cast<std::size_t>(item.Position - 1)] = std::move(c);
        });
    result.Status = walk.Status;
    result.Cancelled = walk.Cancelled;
    for (const auto& c : slots)
        if (c.Done && c.LastRecord >= 0) {
            ++result.Checked;
            if (c.LastDate > result.LatestDate) result.LatestDate = c.LastDate;
        }

    // Stopped trading needs the latest date of all: each row goes after its security's others.
    for (auto& c : slots) {
        if (!c.Done) continue;
        for (auto& f : c.Findings)
            result.Findings.push_back(std::move(f));
        if (c.LastRecord < 0) continue;
        for (auto& f :
             StoppedTrading(c.Name, c.LastDate, c.LastRecord, result.LatestDate, settings))
            result.Findings.push_back(std::move(f));
    }
    for (const auto& issue : walk.Issues) {
        const std::string code = std::filesystem::path(issue.file).stem().string();
        result.Findings.push_back(
            {code, "", "", issue.record, std::string(finding::Damaged), issue.text});
    }
    return result;
}

std::string FindingsCsv(const std::vector<Finding>& findings) {
    auto field = [](std::string_view s) {
        if (s.find_first_of(",\"\n") == std::string_view::npos) return std::string(s);
        std::string q = "\"";
        for (const char c : s) {
            if (c == '"') q += '"';
            q += c;
        }
        return q + "\"";
    };
    std::string csv = "Code,Name,Date,Record,Finding,Detail\n";
    for (const auto& f : findings)
        csv += field(f.Code) + "," + field(f.Name) + "," + field(f.Date) + "," +
               std::to_string(f.Record) + "," + field(f.What) + "," + field(f.Detail) + "\n";
    return csv;
}

} // namespace kori::maint
