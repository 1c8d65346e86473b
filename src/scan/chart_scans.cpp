#include "scan/chart_scans.h"

#include "chart/parabolic.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/rounding.h"
#include "platform/text.h"
#include "store/price_file.h"
#include "store/security_walk.h"

#include <cmath>

namespace kori::scan {

namespace {

using platform::Trim;

std::optional<ScanMessage> FrameProblem(const ScanFrame& f) {
    if (!f.Range.Valid()) return ScanMessage{"Price values invalid", "Closing Price Range"};
    if (f.ClassOn && CheckClass(f.Class) != ClassProblem::None)
        return ScanMessage{"Industry Class invalid", "Industry Class"};
    return std::nullopt;
}

bool CategoryValid(const std::string& text) {
    const double c = platform::Val(text);
    return IsNumericText(text) && c >= 0 && c <= 99 && c == std::floor(c);
}

// The rows' report file, written whole.
platform::Status WriteReport(const std::string& folder, std::string_view name,
                             const std::string& text) {
    if (folder.empty()) return platform::Status::Ok();
    return platform::WriteFileAtomic(platform::ResolveIn(folder, name), text);
}

// What the three walks do with the walk's outcome: issues, cancel, the list and the message.
template <class Result>
void Finish(Result& r, const store::WalkResult& walked, std::string_view dataFolder,
            const std::vector<ListedCode>& listed, const ScanMessage& stored,
            const std::string& noneTitle) {
    r.Cancelled = walked.Cancelled;
    r.Issues.insert(r.Issues.begin(), walked.Issues.begin(), walked.Issues.end());
    if (!walked.Status) {
        r.Status = walked.Status;
        return;
    }
    if (r.Cancelled) return;
    if (listed.empty()) {
        r.Message = ScanMessage{std::string(kNoRecordsFound), noneTitle};
        return;
    }
    if (auto s = StoreScanList(dataFolder, listed); !s) {
        r.Status = s;
        return;
    }
    r.Message = stored;
}

std::string Padded(std::string text, std::size_t width) {
    if (text.size() < width) text.insert(0, width - text.size(), ' ');
    return text;
}

} // namespace

ScanMessage Scan2StoredMessage() {
    return {"The codes have been stored in Chart Scan Results list\n"
            " This list can be selected for viewing\n"
            " from the\n"
            " Chart Selection Window.",
            " Chart Scan 2"};
}

ScanMessage Scan3StoredMessage() {
    return {"The codes have been stored in Chart Scan list Z\n"
            " The list can be selected for viewing\n"
            " from the\n"
            " Chart Selection Window.",
            " Chart Scan 3"};
}

// ---- Scan 2 ----

std::optional<ScanMessage> ValidateScan2(const Scan2Options& o) {
    if (!o.Frame.Range.On && !o.Volume && !o.Price)
        return ScanMessage{"No selection made", "Selection criteria"};
    if (!o.Frame.Range.Valid()) return ScanMessage{"Price values invalid", "Closing Price Range"};
    if (o.Volume && (!IsNumericText(o.VolumePercent) || platform::Val(o.VolumePercent) <= 0 ||
                     !IsNumericText(o.VolumeDays) || platform::Val(o.VolumeDays) < 0 ||
                     platform::Val(o.VolumeDays) > 32767))
        return ScanMessage{"Volume percentage increases invalid", "Volume Percentage Increases"};
    if (o.Price && (!IsNumericText(o.PricePercent) || platform::Val(o.PricePercent) <= 0))
        return ScanMessage{"Price percentage invalid", "Price Percentage Increases/decreases"};
    if (o.Frame.ClassOn && CheckClass(o.Frame.Class) != ClassProblem::None)
        return ScanMessage{"Industry Class invalid", "Industry Class"};
    return std::nullopt;
}

std::string Scan2Line(const Scan2Row& row) {
    std::string line = platform::PadRight(row.Code, 6);
    line += Padded(platform::FormatSingle(row.Close, "####.00"), 9);
    line += Padded(row.VolUp ? std::to_string(*row.VolUp) : std::string(), 9);
    line += Padded(row.Change ? platform::Format(*row.Change, "0.00") : std::string(), 8);
    return line;
}

Scan2Result RunScan2(std::string_view dataFolder, const Scan2Options& o,
                     platform::Progress& progress) {
    Scan2Result r;
    if (o.Frame.Range.On) r.Selection += 'A';
    if (o.Volume) r.Selection += 'B';
    if (o.Price) r.Selection += 'C';
    const double volPct = platform::Val(o.VolumePercent);
    const int days = static_cast<int>(platform::Val(o.VolumeDays));
    const double pricePct = platform::Val(o.PricePercent);
    std::string bytes;
    std::vector<ListedCode> listed;
    std::string report;
    progress.SetStatus(kCheckingData);
    const auto walked = store::ForEachSecurity(
        {std::string(dataFolder), o.List}, progress, [&](const store::WalkItem& item) {
            const store::NameRecord& n = item.Name;
            if (o.Frame.ClassOn && !ClassMatches(o.Frame.Class, n.IndustryClass))
                return store::WalkStep::Continue;
            if (n.RecordType == 3 || (o.NoWarrants && IsWarrant(n)) || item.PriceRecords < 2)
                return store::WalkStep::Continue;
            const int records = item.PriceRecords;
            const int want = o.Volume ? std::max(2, std::min(days, records)) : 2;
            if (auto s =
                    store::ReadPriceRecords(item.PriceFile, records - want + 1, records, bytes);
                !s) {
                r.Issues.push_back({platform::Severity::Warning, s.message(),
                                    item.PriceFile.filename().string(), 0});
                return store::WalkStep::Continue;
            }
            const char* lastRec = bytes.data() + bytes.size() - store::PriceRecord::kSize;
            const float last = store::PriceField(lastRec, store::kCloseAt);
            const float prev =
                store::PriceField(lastRec - store::PriceRecord::kSize, store::kCloseAt);
            Scan2Row row;
            if (o.Frame.Range.On && !o.Frame.Range.Holds(last)) return store::WalkStep::Continue;
            if (o.Volume) {
                if (days <= 0) return store::WalkStep::Continue;
                const int n2 = std::min(days, records);
                double sum = 0;
                for (int k = 0; k < n2; ++k)
                    sum += store::PriceVolume(lastRec - static_cast<std::size_t>(k) *
                                                            store::PriceRecord::kSize);
                const double aveVol = sum / n2;
                const std::int32_t vol = store::PriceVolume(lastRec);
                const double need = aveVol * (1 + volPct / 100);
                if (vol == 0 || aveVol == 0 || vol < need) return store::WalkStep::Continue;
                row.VolUp = static_cast<long long>(platform::RoundHalfEven(vol - need));
            }
            if (o.Price) {
                if (last == 0 || prev == 0) return store::WalkStep::Continue;
                const bool passed = (last > prev && RoseBy(prev, last, pricePct)) ||
                                    (last < prev && FellBy(prev, last, pricePct));
                if (!passed) return store::WalkStep::Continue;
                row.Change = ChangePercent(prev, last);
            }
            row.NameRecord = item.NameRecordNumber;
            row.Code = n.TrimmedCode();
            row.Close = last;
            listed.push_back({row.NameRecord, row.Code});
            report += Scan2Line(row) + "\r\n";
            r.Rows.push_back(std::move(row));
            return store::WalkStep::Continue;
        });
    Finish(r, walked, dataFolder, listed, Scan2StoredMessage(), " Chart Scan 2");
    if (r.Status && !r.Cancelled && !r.Rows.empty())
        r.Status = WriteReport(o.ReportFolder, "ChtScan2.txt", report);
    return r;
}

// ---- Scan 3 ----

std::optional<ScanMessage> ValidateScan3(const Scan3Options& o) {
    if (!o.Up && !o.Down)
        return ScanMessage{"Either Look for break UP  or Look for break DOWN need to be selected",
                           "Break Parabolic"};
    if (o.CategoryOn && !CategoryValid(o.Category))
        return ScanMessage{"Invalid Category", "Category Selected"};
    return FrameProblem(o.Frame);
}

std::string LastParabolicDirections(std::string_view bytes) {
    const auto n = bytes.size() / store::PriceRecord::kSize;
    std::vector<chart::ParabolicBar> bars(n);
    for (std::size_t k = 0; k < n; ++k) {
        const char* rec = bytes.data() + k * store::PriceRecord::kSize;
        bars[k] = {store::PriceField(rec, store::kHighAt), store::PriceField(rec, store::kLowAt)};
    }
    std::string dirs = "   ";
    for (const auto& p : chart::ComputeParabolic(bars)) {
        const auto fromEnd = static_cast<long long>(n) - 1 - p.Bar; // 0 for the last record
        if (fromEnd <= 2 && p.Stop > 0) dirs[static_cast<std::size_t>(2 - fromEnd)] = p.Direction;
    }
    return dirs;
}

std::string BreakOf(std::string_view d, bool up, bool down) {
    if (d.size() != 3 || (d[0] == d[1] && d[1] == d[2])) return {};
    if (d[2] == 'U' && up) return "UP";
    if (d[2] == 'D' && down) return "DOWN";
    return {};
}

std::string Scan3Line(const Scan3Row& row) {
    return platform::PadRight(row.Code, 6) +
           Padded(platform::FormatSingle(row.Close, "####.00"), 9) + "    " + row.Direction;
}

Scan3Result RunScan3(std::string_view dataFolder, const Scan3Options& o,
                     platform::Progress& progress) {
    Scan3Result r;
    const auto category = static_cast<std::int16_t>(platform::Val(o.Category));
    std::string bytes;
    std::vector<ListedCode> listed;
    progress.SetStatus(kCheckingData);
    const auto walked = store::ForEachSecurity(
        {std::string(dataFolder), o.List}, progress, [&](const store::WalkItem& item) {
            const store::NameRecord& n = item.Name;
            if (n.RecordType != 4) return store::WalkStep::Continue;
            if (o.Frame.ClassOn && !ClassMatches(o.Frame.Class, n.IndustryClass))
                return store::WalkStep::Continue;
            if (o.CategoryOn && n.Category != category) return store::WalkStep::Continue;
            if ((o.NoWarrants && IsWarrant(n)) || item.PriceRecords < 2)
                return store::WalkStep::Continue;
            const int records = item.PriceRecords;
            const int first = records <= 100 ? 1 : records - 100;
            if (auto s = store::ReadPriceRecords(item.PriceFile, first, records, bytes); !s) {
                r.Issues.push_back({platform::Severity::Warning, s.message(),
                                    item.PriceFile.filename().string(), 0});
                return store::WalkStep::Continue;
            }
            const float last = store::PriceField(
                bytes.data() + bytes.size() - store::PriceRecord::kSize, store::kCloseAt);
            if (!o.Frame.Range.Holds(last)) return store::WalkStep::Continue;
            const std::string direction = BreakOf(LastParabolicDirections(bytes), o.Up, o.Down);
            if (direction.empty()) return store::WalkStep::Continue;
            Scan3Row row{item.NameRecordNumber, n.TrimmedCode(), last, direction};
            listed.push_back({row.NameRecord, row.Code});
            r.Rows.push_back(std::move(row));
            return store::WalkStep::Continue;
        });
    Finish(r, walked, dataFolder, listed, Scan3StoredMessage(), " Chart Scan 3");
    return r;
}

// ---- Scan 6 ----

std::optional<ScanMessage> ValidateScan6(const Scan6Options& o) {
    if (o.Av1D <= 0 || o.Av2D <= 0 || o.Av1D == o.Av2D)
        return ScanMessage{"Averages not set - Set averages in Chart Defaults  and re-try",
                           "Average Crossover Scan"};
    const std::string len = Trim(o.CodeLength);
    if (len != "All" && len != "3" && len != "4" && len != "5" && len != "6")
        return ScanMessage{"Code length invalid", "Code length"};
    return FrameProblem(o.Frame);
}

double AverageGap(double longAve, double shortAve) {
    const double gap = longAve > shortAve ? (longAve - shortAve) / shortAve * 100
                                          : (shortAve - longAve) / longAve * 100;
    return platform::RoundHalfEven(gap, 4);
}

std::string Scan6Line(const Scan6Row& row) {
    return row.Code + "\t" + platform::FormatSingle(row.Close, "####.00") + "\t" +
           platform::Format(row.Gap, "####0.0") + "\t" + row.Name + "\t" + row.Class;
}

Scan6Result RunScan6(std::string_view dataFolder, const Scan6Options& o,
                     platform::Progress& progress) {
    Scan6Result r;
    const int longP = std::max(o.Av1D, o.Av2D);
    const int shortP = std::min(o.Av1D, o.Av2D);
    const std::string len = Trim(o.CodeLength);
    std::string bytes;
    std::vector<ListedCode> listed;
    std::string report;
    progress.SetStatus(kCheckingData);
    store::SecurityList list{std::string(dataFolder), 0, kScan6RecordLimit};
    const auto walked = store::ForEachSecurity(list, progress, [&](const store::WalkItem& item) {
        const store::NameRecord& n = item.Name;
        const std::string code = n.TrimmedCode();
        if (n.RecordType != 4) return store::WalkStep::Continue;
        if (len != "All" && code.size() != static_cast<std::size_t>(platform::Val(len)))
            return store::WalkStep::Continue;
        if (o.Frame.ClassOn && !ClassMatches(o.Frame.Class, n.IndustryClass))
            return store::WalkStep::Continue;
        const int records = item.PriceRecords;
        if (records < longP) return store::WalkStep::Continue;
        if (auto s = store::ReadPriceRecords(item.PriceFile, records - longP + 1, records, bytes);
            !s) {
            r.Issues.push_back(
                {platform::Severity::Warning, s.message(), item.PriceFile.filename().string(), 0});
            return store::WalkStep::Continue;
        }
        const auto closeAt = [&](int k) { // k = 0 the oldest of the Long records
            return store::PriceField(bytes.data() +
                                         static_cast<std::size_t>(k) * store::PriceRecord::kSize,
                                     store::kCloseAt);
        };
        const float last = closeAt(longP - 1);
        if (!o.Frame.Range.Holds(last)) return store::WalkStep::Continue;
        double longSum = 0, shortSum = 0;
        for (int k = 0; k < longP; ++k) {
            longSum += closeAt(k);
            if (k >= longP - shortP) shortSum += closeAt(k);
        }
        const double longAve = longSum / longP, shortAve = shortSum / shortP;
        if (longAve == 0 || shortAve == 0) return store::WalkStep::Continue;
        const double gap = AverageGap(longAve, shortAve);
        if (gap < 0 || gap > 0.5) return store::WalkStep::Continue;
        Scan6Row row{item.NameRecordNumber, code, Trim(n.Name), Trim(n.IndustryClass), last, gap};
        listed.push_back({row.NameRecord, row.Code});
        report += Scan6Line(row) + "\r\n";
        r.Rows.push_back(std::move(row));
        return store::WalkStep::Continue;
    });
    Finish(r, walked, dataFolder, listed, Scan2StoredMessage(), " Chart Scan 2");
    if (r.Status && !r.Cancelled && !r.Rows.empty())
        r.Status = WriteReport(o.ReportFolder, "ChtScan6.txt", report);
    return r;
}

} // namespace kori::scan
