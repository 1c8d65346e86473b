#include "scan/cht_scan1.h"

#include "platform/text.h"
#include "store/price_file.h"
#include "store/security_walk.h"

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

// Per-walk state reused for every security, so that the walk allocates nothing per file.
struct Scan1Walk {
    const Scan1Options& o;
    const osc::OscDef& def;
    bool runOscs;
    bool wholeFile;
    int wanted;
    double risePct, fallPct;
    std::int16_t category;
    std::string bytes;
    DailyTail tail;
    Scan1Result& result;
    std::vector<ListedCode> listed;

    bool Filtered(const store::NameRecord& n) const {
        if (o.CategoryOn && (n.RecordType != 4 || n.Category != category)) return true;
        if (o.ClassOn && !ClassMatches(o.Class, n.IndustryClass)) return true;
        if (n.RecordType == 3) return true;
        return o.NoWarrants && IsWarrant(n);
    }

    void Visit(const store::WalkItem& item) {
        const store::NameRecord& n = item.Name;
        if (Filtered(n) || item.PriceRecords < 2) return;
        const int records = item.PriceRecords;
        if (auto s = ReadDailyTail(item.PriceFile, records, wholeFile ? 0 : wanted, n.RecordType,
                                   bytes, tail);
            !s) {
            result.Issues.push_back(
                {platform::Severity::Warning, s.message(), item.PriceFile.filename().string(), 0});
            return;
        }
        const char* lastRec = bytes.data() + bytes.size() - store::PriceRecord::kSize;
        const char* prevRec = lastRec - store::PriceRecord::kSize;
        if (result.LastDate.empty() || DateOf(lastRec) > result.LastDate)
            result.LastDate = std::string(DateOf(lastRec));
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
        if (runOscs) {
            for (std::size_t k = 0; k < kScanOscs.size(); ++k) {
                if (!o.Osc[k]) continue;
                ++ticked;
                const std::string_view ind = IndicationOf(kScanOscs[k], item, n);
                if (!ind.empty() && Kept(ind, o.Indications)) {
                    row.Indications[k] = std::string(ind);
                    ++kept;
                }
            }
        } else {
            for (bool t : o.Osc)
                ticked += t ? 1 : 0;
        }
        if (row.Move.empty() && kept == 0) return;
        row.All = (!(o.Rise || o.Fall) || !row.Move.empty()) && kept == ticked;
        row.NameRecord = item.NameRecordNumber;
        row.Code = n.TrimmedCode();
        row.Name = platform::Trim(n.Name);
        row.Close = last;
        listed.push_back({item.NameRecordNumber, row.Code});
        result.Rows.push_back(std::move(row));
    }

    std::string_view IndicationOf(ScanOsc osc, const store::WalkItem& item,
                                  const store::NameRecord& n) {
        const int period = ScanPeriod(osc, def);
        const bool closeOnly = store::IsCloseOnly(n.RecordType);
        OscReading r = ReadOscillator(osc, tail, period, closeOnly);
        if (r.Outcome == OscOutcome::NeedMore) {
            // Flat stretches reach further back than the part read: take the whole file.
            if (!ReadDailyTail(item.PriceFile, item.PriceRecords, 0, n.RecordType, bytes, tail))
                return {};
            r = ReadOscillator(osc, tail, period, closeOnly);
        }
        if (r.Outcome != OscOutcome::Positions) return {};
        return Indication(r.Positions);
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
    Scan1Walk walk{o,
                   def,
                   runOscs,
                   wholeFile,
                   wanted,
                   platform::Val(o.RisePercent),
                   platform::Val(o.FallPercent),
                   static_cast<std::int16_t>(platform::Val(o.Category)),
                   {},
                   {},
                   result,
                   {}};
    progress.SetStatus(kCheckingData);
    store::SecurityList list{std::string(dataFolder), o.List};
    const auto walked = store::ForEachSecurity(list, progress, [&](const store::WalkItem& item) {
        walk.Visit(item);
        return store::WalkStep::Continue;
    });
    result.Cancelled = walked.Cancelled;
    result.Issues.insert(result.Issues.begin(), walked.Issues.begin(), walked.Issues.end());
    if (!walked.Status) {
        result.Status = walked.Status;
        return result;
    }
    if (result.Cancelled) return result;
    if (result.Rows.empty()) {
        result.Message = ScanMessage{NothingFound(o), " Chart Scan"};
        return result;
    }
    if (auto s = StoreScanList(dataFolder, walk.listed); !s) {
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
