#include "scan/cht_scan1.h"

#include "platform/text.h"
#include "store/price_file.h"
#include "store/security_walk.h"
#include "store/two_thread_walk.h"

#include <algorithm>
#include <cmath>

namespace kori::scan {

namespace {

constexpr std::string_view kAnalysis = "Analysis";

bool PercentValid(const std::string& text) {
    if (!IsNumericText(text)) return false;
    const double v = platform::Val(text);
    return v >= 1 && v <= 200;
}

std::string_view OscWord(ScanOsc osc) {
    switch (osc) {
    case ScanOsc::Stochastic:
        return "STOCHASTIC";
    case ScanOsc::Williams:
        return "WILLIAMS %R";
    case ScanOsc::ROC:
        return "RATE OF CHANGE";
    case ScanOsc::MM:
        return "MOMENTUM";
    case ScanOsc::RSI:
        return "R.S.I";
    }
    return "";
}

// A period the scan can count back by: from 0 (which skips the oscillator, or for RSI means
// 21) to 200, the stochastic's K from 1 and its D from 0.
bool PeriodsPass(ScanOsc osc, const osc::OscDef& def) {
    auto within = [](int v, int lo) { return v >= lo && v <= 200; };
    switch (osc) {
    case ScanOsc::Stochastic:
        return within(def.StochK, 1) && within(def.StochD, 0);
    case ScanOsc::Williams:
        return within(def.WmsA, 0);
    case ScanOsc::ROC:
    case ScanOsc::MM:
        return within(def.RocP, 0);
    case ScanOsc::RSI:
        return within(def.RsiP, 0);
    }
    return false;
}

// The message of an empty result, by the moves that were asked for.
std::string NothingFound(const Scan1Options& o) {
    const std::string rise = platform::Trim(o.RisePercent);
    const std::string fall = platform::Trim(o.FallPercent);
    if (o.Rise && o.Fall)
        return "There were no rises of " + rise + "%" + " or falls of " + fall + "%" +
               " or Buy/Sell Indications ";
    if (o.Rise) return "There were no rises of " + rise + "%" + " or Buy/Sell Indications ";
    if (o.Fall) return "There were no falls of " + fall + "%" + " or Buy/Sell Indications ";
    return "There were no Buy/Sell Indications ";
}

std::string_view DateOf(const char* record) {
    return {record, 8};
}

// What one thread keeps: its buffers, reused for every security so that the work allocates
// nothing per file, and its finds with their places in the walk.
struct ThreadState {
    std::string bytes;
    DailyTail tail;
    std::vector<std::pair<int, Scan1Row>> rows;
    std::string lastDate;
    platform::Issues issues;
};

struct Scan1Walk {
    const Scan1Options& o;
    const osc::OscDef& def;
    bool runOscs = false;
    bool wholeFile = false;
    int wanted = 2;
    double risePct = 0, fallPct = 0;
    std::int16_t category = 0;
    ThreadState state[2]{};

    bool Filtered(const store::NameRecord& n) const {
        if (o.CategoryOn && (n.RecordType != 4 || n.Category != category)) return true;
        if (o.ClassOn && !ClassMatches(o.Class, n.IndustryClass)) return true;
        if (n.RecordType == 3) return true;
        return o.NoWarrants && IsWarrant(n);
    }

    void Visit(ThreadState& st, const store::WalkItem& item) {
        const store::NameRecord& n = item.Name;
        if (Filtered(n) || item.PriceRecords < 2) return;
        const int records = item.PriceRecords;
        if (auto s = ReadDailyTail(item.PriceFile, records, wholeFile ? 0 : wanted, n.RecordType,
                                   st.bytes, st.tail);
            !s) {
            st.issues.push_back(
                {platform::Severity::Warning, s.message(), item.PriceFile.filename().string(), 0});
            return;
        }
        const char* lastRec = st.bytes.data() + st.bytes.size() - store::PriceRecord::kSize;
        const char* prevRec = lastRec - store::PriceRecord::kSize;
        if (st.lastDate.empty() || DateOf(lastRec) > st.lastDate)
            st.lastDate = std::string(DateOf(lastRec));
        const float last = store::PriceField(lastRec, store::kCloseAt);
        const float prev = store::PriceField(prevRec, store::kCloseAt);
        if (!o.Range.Holds(last)) return;

        Scan1Row row;
        if ((o.Rise || o.Fall) && last != 0 && prev != 0) {
            if (last > prev && o.Rise && RoseBy(prev, last, risePct)) row.Move = "U";
            if (last < prev && o.Fall && FellBy(prev, last, fallPct)) row.Move = "D";
            if (!row.Move.empty()) row.Change = ChangePercent(prev, last);
        }
        int kept = 0, ticked = 0;
        for (std::size_t k = 0; k < kScanOscs.size(); ++k) {
            if (!o.Osc[k]) continue;
            ++ticked;
            if (!runOscs) continue;
            const std::string_view ind = IndicationOf(st, kScanOscs[k], item);
            if (!ind.empty() && Kept(ind, o.Indications)) {
                row.Indications[k] = std::string(ind);
                ++kept;
            }
        }
        if (row.Move.empty() && kept == 0) return;
        row.All = (!(o.Rise || o.Fall) || !row.Move.empty()) && kept == ticked;
        row.NameRecord = item.NameRecordNumber;
        row.Code = n.TrimmedCode();
        row.Name = platform::Trim(n.Name);
        row.Close = last;
        st.rows.emplace_back(item.Position, std::move(row));
    }

    std::string_view IndicationOf(ThreadState& st, ScanOsc osc, const store::WalkItem& item) {
        const store::NameRecord& n = item.Name;
        const int period = ScanPeriod(osc, def);
        const bool closeOnly = store::IsCloseOnly(n.RecordType);
        OscReading r = ReadOscillator(osc, st.tail, period, closeOnly);
        if (r.Outcome == OscOutcome::NeedMore) {
            // Flat stretches reach further back than the part read: take the whole file.
            if (!ReadDailyTail(item.PriceFile, item.PriceRecords, 0, n.RecordType, st.bytes,
                               st.tail))
                return {};
            r = ReadOscillator(osc, st.tail, period, closeOnly);
        }
        if (r.Outcome != OscOutcome::Positions) return {};
        return Indication(r.Positions);
    }

    // The finds of both threads in the order of the walk.
    void Gather(Scan1Result& result) {
        std::vector<std::pair<int, Scan1Row>> all;
        for (auto& st : state) {
            for (auto& r : st.rows)
                all.push_back(std::move(r));
            if (!st.lastDate.empty() && st.lastDate > result.LastDate)
                result.LastDate = st.lastDate;
            result.Issues.insert(result.Issues.end(), st.issues.begin(), st.issues.end());
        }
        std::sort(all.begin(), all.end(),
                  [](const auto& a, const auto& b) { return a.first < b.first; });
        for (auto& r : all)
            result.Rows.push_back(std::move(r.second));
    }
};

} // namespace

int ScanPeriod(ScanOsc osc, const osc::OscDef& def) {
    switch (osc) {
    case ScanOsc::Stochastic:
        return def.StochK;
    case ScanOsc::Williams:
        return def.WmsA;
    case ScanOsc::ROC:
    case ScanOsc::MM:
        return def.RocP;
    case ScanOsc::RSI:
        return def.RsiP;
    }
    return 0;
}

std::optional<ScanMessage> ValidateScan1(const Scan1Options& o, const osc::OscDef& def) {
    if (!o.Range.Valid()) return ScanMessage{"Invalid price range", std::string(kAnalysis)};
    if ((o.Rise && !PercentValid(o.RisePercent)) || (o.Fall && !PercentValid(o.FallPercent)))
        return ScanMessage{"Percentage Not valid - Valid Range 1 to 200 ", std::string(kAnalysis)};
    if (o.CategoryOn) {
        const double c = platform::Val(o.Category);
        if (!IsNumericText(o.Category) || c < 0 || c > 99 || c != std::floor(c))
            return ScanMessage{"Category invalid", std::string(kAnalysis)};
    }
    if (o.ClassOn) {
        switch (CheckClass(o.Class)) {
        case ClassProblem::NotNumeric:
            return ScanMessage{"Industry Classification ID must be numeric   eg 010", "Chart Scan"};
        case ClassProblem::NotThreeDigits:
            return ScanMessage{"Industry Classification invalid", std::string(kAnalysis)};
        case ClassProblem::None:
            break;
        }
    }
    for (std::size_t k = 0; k < kScanOscs.size(); ++k)
        if (o.Osc[k] && !PeriodsPass(kScanOscs[k], def))
            return ScanMessage{"Invalid " + std::string(OscWord(kScanOscs[k])) +
                                   " Oscillator Values. Correct the values in the CHART "
                                   "DEFAULTS List",
                               std::string(kAnalysis)};
    return std::nullopt;
}

Scan1Result RunScan1(std::string_view dataFolder, const Scan1Options& o, const osc::OscDef& def,
                     platform::Progress& progress) {
    Scan1Result result;
    const bool anyOsc = std::any_of(o.Osc.begin(), o.Osc.end(), [](bool b) { return b; });
    const bool runOscs = anyOsc && o.Indications.Any();
    int wanted = 2;
    bool wholeFile = false;
    if (runOscs)
        for (std::size_t k = 0; k < kScanOscs.size(); ++k) {
            if (!o.Osc[k]) continue;
            const int w = OscBarsWanted(kScanOscs[k], ScanPeriod(kScanOscs[k], def));
            if (w == 0) wholeFile = true;
            wanted = std::max(wanted, w);
        }
    Scan1Walk walk{o, def};
    walk.runOscs = runOscs;
    walk.wholeFile = wholeFile;
    walk.wanted = wanted;
    walk.risePct = platform::Val(o.RisePercent);
    walk.fallPct = platform::Val(o.FallPercent);
    walk.category = static_cast<std::int16_t>(platform::Val(o.Category));
    progress.SetStatus(kCheckingData);
    store::SecurityList list{std::string(dataFolder), o.List};
    const auto walked =
        store::WalkOnTwoThreads(list, progress, [&](int thread, const store::WalkItem& i) {
            walk.Visit(walk.state[thread], i);
        });
    result.Cancelled = walked.Cancelled;
    result.Issues = walked.Issues;
    walk.Gather(result);
    if (!walked.Status) {
        result.Status = walked.Status;
        return result;
    }
    if (result.Cancelled) return result;
    if (result.Rows.empty()) {
        result.Message = ScanMessage{NothingFound(o), " Chart Scan"};
        return result;
    }
    std::vector<ListedCode> listed;
    for (const auto& row : result.Rows)
        listed.push_back({row.NameRecord, row.Code});
    if (auto s = StoreScanList(dataFolder, listed); !s) {
        result.Status = s;
        return result;
    }
    result.Message = ScanMessage{"The codes have been stored in list Chart Scan Results List\n"
                                 " This list can be selected to view charts\n"
                                 " from the\n"
                                 " Chart Selection form.",
                                 " Chart Scan"};
    return result;
}

} // namespace kori::scan
