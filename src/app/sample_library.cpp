#include "app/sample_library.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "store/targets_file.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <map>
#include <vector>

namespace kori::app {

namespace {

constexpr const char* kLastDate = "20261120"; // a Friday
constexpr int kYears = 6;

// A small generator of our own, so the library is the same on every machine.
class Random {
public:
    explicit Random(std::uint64_t seed) : m_state(seed) {}
    std::uint64_t Next() {
        std::uint64_t z = (m_state += 0x9E3779B97F4A7C15ull);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        return z ^ (z >> 31);
    }
    double Uniform() { return static_cast<double>(Next() >> 11) * (1.0 / 9007199254740992.0); }
    double Normal() {
        const double u1 = std::max(Uniform(), 1e-12), u2 = Uniform();
        return std::sqrt(-2.0 * std::log(u1)) * std::cos(6.283185307179586 * u2);
    }

private:
    std::uint64_t m_state;
};

struct Security {
    const char* code;
    const char* name;
    std::int16_t type;
    const char* industry; // three digits or ""
    const char* gics;     // four digits or ""
    double start;         // price six years ago
    double drift;         // yearly
    double volatility;    // yearly
    double volume;        // typical daily volume
    std::int16_t category = 0;
};

const std::vector<Security>& Securities() {
    static const std::vector<Security> list = {
        {"XAO", "All Ordinaries Index (sample)", 1, "", "", 5200, 0.05, 0.14, 900000},
        {"XJO", "Top 200 Index (sample)", 2, "", "", 5100, 0.05, 0.15, 0},
        {"ADVDEC", "Advance Decline Line (sample)", 3, "", "", 0, 0, 0, 0},
        {"KRM", "Karoo Minerals", 4, "121", "1510", 3.20, 0.12, 0.38, 2400000},
        {"ALX", "Alexandra Resources", 4, "121", "1510", 12.40, 0.06, 0.30, 1100000},
        {"BWG", "Bowen Gold Fields", 4, "122", "1510", 0.84, 0.18, 0.55, 5200000},
        {"CPR", "Copperline Holdings", 4, "121", "1510", 1.95, -0.04, 0.45, 3100000},
        {"DLT", "Delta Lithium Works", 4, "123", "1510", 0.36, 0.25, 0.70, 9800000},
        {"EMB", "Emberton Energy", 4, "131", "1010", 7.80, 0.03, 0.33, 1500000},
        {"FRG", "Forge Gas Pipelines", 4, "132", "1010", 4.15, 0.04, 0.24, 800000},
        {"GLN", "Glenmore Oil Search", 4, "131", "1010", 22.10, 0.02, 0.29, 650000},
        {"HBK", "Harbour Bank Group", 5, "211", "4010", 31.00, 0.07, 0.20, 1900000},
        {"IRB", "Ironbark Savings Bank", 4, "211", "4010", 9.45, 0.05, 0.22, 1200000},
        {"JNS", "Jarrah National Securities", 4, "212", "4020", 5.60, 0.08, 0.28, 700000},
        {"KST", "Kestrel Insurance", 4, "213", "4030", 6.75, 0.06, 0.21, 950000},
        {"LMT", "Lamington Trust", 4, "221", "6010", 2.85, 0.03, 0.18, 1400000},
        {"MRW", "Marrow Property Fund", 4, "221", "6010", 1.42, 0.02, 0.17, 2600000},
        {"NTL", "Nullarbor Telecom", 4, "311", "5010", 4.90, -0.02, 0.23, 4200000},
        {"OCR", "Ochre Media", 4, "312", "5020", 0.72, 0.01, 0.40, 1800000},
        {"PNS", "Pinnacle Software", 4, "321", "4510", 18.30, 0.20, 0.42, 500000},
        {"QRY", "Quarry Digital", 4, "321", "4510", 0.155, 0.30, 0.80, 12000000},
        {"RVH", "Riverhead Health", 5, "411", "3510", 88.00, 0.09, 0.24, 300000},
        {"SLM", "Salmon Gum Pharmaceuticals", 4, "412", "3520", 2.35, 0.11, 0.48, 2100000},
        {"TWR", "Tower Hill Retail", 4, "511", "2550", 3.95, 0.03, 0.27, 1700000},
        {"UBT", "Ubirr Tourism", 4, "512", "2530", 1.10, 0.05, 0.36, 900000},
        {"VNT", "Vantage Transport", 4, "611", "2030", 5.25, 0.04, 0.26, 1300000},
        {"WLB", "Wallaby Airlines", 4, "611", "2030", 2.65, -0.03, 0.41, 6100000},
        {"XTN", "Xanthe Construction", 4, "621", "2010", 1.88, 0.06, 0.31, 1000000},
        {"YRA", "Yarra Water Utilities", 4, "711", "5510", 4.40, 0.04, 0.15, 600000},
        {"ZNC", "Zinc Coast Smelters", 4, "121", "1510", 0.48, 0.07, 0.52, 4800000},
        {"ARG", "Argyle Agriculture", 4, "811", "3020", 3.05, 0.05, 0.29, 750000},
        {"BLV", "Bellevue Beverages", 4, "812", "3020", 8.60, 0.04, 0.22, 450000},
        {"CSW", "Coastwide Steel", 4, "124", "1510", 2.05, 0.02, 0.34, 2300000},
        {"DRN", "Darling Renewables", 4, "133", "5510", 0.92, 0.15, 0.50, 3900000},
        {"ESK", "Eskdale Chemicals", 4, "125", "1510", 6.30, 0.03, 0.25, 520000},
        {"FLN", "Flinders Logistics", 4, "611", "2030", 3.70, 0.06, 0.28, 880000},
        {"GRN", "Greenhide Foods", 4, "811", "3020", 1.58, 0.04, 0.33, 1250000},
        {"HLT", "Highland Timber", 4, "126", "1510", 0.265, 0.00, 0.58, 7300000},
        {"KRMWOA", "Karoo Minerals Warrant A", 4, "121", "1510", 0.42, 0.10, 0.90, 350000, 84},
        {"ALXWOB", "Alexandra Resources Warrant B", 4, "121", "1510", 1.05, 0.04, 0.85, 210000, 84},
        {"HBKWOC", "Harbour Bank Warrant C", 4, "211", "4010", 2.10, 0.06, 0.75, 160000, 84},
        {"PNSWOD", "Pinnacle Software Warrant D", 4, "321", "4510", 0.66, 0.18, 0.95, 420000, 84},
    };
    return list;
}

std::vector<std::string> Weekdays() {
    std::vector<std::string> dates;
    const std::int32_t last = *platform::DaySerial(kLastDate);
    const std::int32_t first = last - 365 * kYears - kYears / 4;
    for (std::int32_t d = first; d <= last; ++d) {
        const auto text = platform::DateTextFromSerial(d);
        const int wd = *platform::Weekday(*text);
        if (wd != 1 && wd != 7) dates.push_back(*text);
    }
    return dates;
}

float RoundPrice(double p, std::int16_t type) {
    if (type == 5 || p >= 1000) return static_cast<float>(std::round(p));
    if (p < 0.1) return static_cast<float>(std::round(p * 1000) / 1000);
    if (p < 2) return static_cast<float>(std::round(p * 200) / 200); // half cents
    return static_cast<float>(std::round(p * 100) / 100);
}

std::vector<store::PriceRecord> PriceHistory(const Security& s,
                                             const std::vector<std::string>& dates, Random& rng) {
    std::vector<store::PriceRecord> out;
    out.reserve(dates.size());
    const double dt = 1.0 / 252;
    double price = s.start;
    double regime = 0;
    for (std::size_t i = 0; i < dates.size(); ++i) {
        // A slowly changing trend over the fixed drift gives charts visible swings.
        if (i % 60 == 0) regime = rng.Normal() * 0.35;
        const double ret = (s.drift + regime) * dt + s.volatility * std::sqrt(dt) * rng.Normal();
        const double open = price * (1 + 0.25 * s.volatility * std::sqrt(dt) * rng.Normal());
        const double close = std::max(price * std::exp(ret), 0.005);
        const double span = s.volatility * std::sqrt(dt) * std::fabs(price);
        const double high = std::max(open, close) + std::fabs(rng.Normal()) * span * 0.6;
        const double low =
            std::max(std::min(open, close) - std::fabs(rng.Normal()) * span * 0.6, 0.001);
        store::PriceRecord r;
        r.Date = dates[i];
        r.Open = RoundPrice(open, s.type);
        r.High = std::max({RoundPrice(high, s.type), r.Open, RoundPrice(close, s.type)});
        r.Low = std::min({RoundPrice(low, s.type), r.Open, RoundPrice(close, s.type)});
        r.Close = RoundPrice(close, s.type);
        if (s.volume > 0) {
            const double v =
                s.volume * std::exp(0.5 * rng.Normal()) *
                (1 + 3 * std::fabs(ret) / std::max(s.volatility * std::sqrt(dt), 1e-9) / 10);
            r.Volume = static_cast<std::int32_t>(std::min(v, 2.0e9));
        }
        if (s.type == 2) r.Volume = 0;
        out.push_back(r);
        price = close;
    }
    return out;
}

std::vector<store::PriceRecord> AdvanceDecline(const std::vector<std::string>& dates, Random& rng) {
    std::vector<store::PriceRecord> out;
    double total = 10000;
    for (const auto& d : dates) {
        const int advances = 300 + static_cast<int>(rng.Uniform() * 500);
        const int declines = 300 + static_cast<int>(rng.Uniform() * 500);
        total += advances - declines;
        store::PriceRecord r;
        r.Date = d;
        r.High = static_cast<float>(advances);
        r.Low = static_cast<float>(declines);
        r.Close = static_cast<float>(total);
        out.push_back(r);
    }
    return out;
}

// Illiquid securities miss some days: those records stand with a close of 0.
void AddNoTradeDays(std::vector<store::PriceRecord>& recs, Random& rng) {
    for (std::size_t i = 5; i < recs.size(); ++i) {
        if (rng.Uniform() < 0.01) {
            recs[i].Open = recs[i].High = recs[i].Low = recs[i].Close = 0;
            recs[i].Volume = 0;
        }
    }
}

// A two-for-one split a year before the end. The history stands adjusted (continuous); the
// record of the split carries its factor and note.
void AddSplit(std::vector<store::PriceRecord>& recs) {
    const std::size_t at = recs.size() - 252;
    recs[at].AdjFactor = 0.5f;
    recs[at].AdjDesc = "Split 2 for 1";
}

platform::Status WriteClassFiles(const std::string& systemFolder) {
    const std::string indClass =
        "121,Base Metals\r\n122,Gold\r\n123,Battery Metals\r\n124,Steel\r\n125,Chemicals\r\n"
        "126,Forestry\r\n131,Oil and Gas\r\n132,Gas Transport\r\n133,Renewable Energy\r\n"
        "211,Banks\r\n212,Stockbroking\r\n213,Insurance\r\n221,Property Trusts\r\n"
        "311,Telecommunications\r\n312,Media\r\n321,Software\r\n411,Hospitals\r\n"
        "412,Pharmaceuticals\r\n511,Retail\r\n512,Tourism\r\n611,Transport\r\n"
        "621,Construction\r\n711,Water\r\n811,Food\r\n812,Beverages\r\n";
    const std::string gics =
        "1010,Energy,Energy\r\n1510,Materials,Materials\r\n2010,Industrials,Capital Goods\r\n"
        "2030,Industrials,Transportation\r\n2530,Consumer Discretionary,Consumer Services\r\n"
        "2550,Consumer Discretionary,Retailing\r\n3020,Consumer Staples,Food Beverage and "
        "Tobacco\r\n"
        "3510,Health Care,Equipment and Services\r\n3520,Health Care,Pharmaceuticals\r\n"
        "4010,Financials,Banks\r\n4020,Financials,Diversified Financials\r\n"
        "4030,Financials,Insurance\r\n4510,Information Technology,Software and Services\r\n"
        "5010,Communication Services,Telecommunication\r\n5020,Communication Services,Media\r\n"
        "5510,Utilities,Utilities\r\n6010,Real Estate,Real Estate\r\n";
    if (auto s =
            platform::WriteFileAtomic(platform::ResolveIn(systemFolder, "IndClass.dat"), indClass);
        !s)
        return s;
    return platform::WriteFileAtomic(platform::ResolveIn(systemFolder, "Gics.dat"), gics);
}

// Targets that the last day of the sample meets in each of the four ways, and a security on two
// lines whose targets stay out of reach, worked out from that day's prices.
platform::Status WriteSampleTargets(const std::string& systemFolder,
                                    const std::map<std::string, store::PriceRecord>& lastDay) {
    const auto price = [](float p) { return platform::FormatSingle(p, "0.00#"); };
    const auto& frg = lastDay.at("FRG");
    const auto& gln = lastDay.at("GLN");
    const auto& twr = lastDay.at("TWR");
    const auto& vnt = lastDay.at("VNT");
    const auto& yra = lastDay.at("YRA");
    const std::vector<store::TargetLine> lines = {
        {"FRG", price(frg.Low), "U"},          // the day's low: reached
        {"GLN", price(gln.Low * 0.95f), "U"},  // below the whole day: exceeded
        {"TWR", price(twr.High), "D"},         // the day's high: reached
        {"VNT", price(vnt.High * 1.05f), "D"}, // above the whole day: exceeded
        {"YRA", price(yra.High * 1.1f), "U"},  // out of reach either way
        {"YRA", price(yra.Low * 0.9f), "D"},
    };
    return store::WriteTargetsFile(store::TargetsFilePath(systemFolder), lines);
}

// Securities whose last days are placed so that every scan finds something: a rise of exactly
// 10%, overbought and oversold oscillators, breaks of the parabolic stop up and down, a volume
// spike, two averages together, and an advance-decline series whose totals need recomputing.
platform::Status AddScanExamples(const std::string& dataFolder,
                                 const std::vector<std::string>& dates,
                                 std::vector<store::NameRecord>& names, SampleSummary& summary) {
    struct Example {
        const char* code;
        const char* name;
        std::int16_t type;
        std::vector<float> lastCloses; // the closes of the last days; earlier days stand at the
                                       // first of them
        std::int32_t lastVolume = 0;   // 0: as the other days
    };
    auto ramp = [](float from, float step, int days) {
        std::vector<float> v;
        for (int i = 0; i < days; ++i)
            v.push_back(std::round((from + step * static_cast<float>(i)) * 100) / 100);
        return v;
    };
    auto then = [](std::vector<float> v, float last) {
        v.push_back(last);
        return v;
    };
    const std::vector<Example> examples = {
        {"TENUP", "Tenfold Mining (ten per cent rise)", 4, {2.00f, 2.00f, 2.00f, 2.20f}},
        {"OBHI", "Overbought Holdings", 4, ramp(1.00f, 0.05f, 40)},
        {"OSLO", "Oversold Logistics", 4, ramp(4.00f, -0.05f, 40)},
        {"PARUP", "Parabola Up Resources", 4, then(ramp(4.00f, -0.05f, 40), 4.50f)},
        {"PARDN", "Parabola Down Resources", 4, then(ramp(1.00f, 0.05f, 40), 0.50f)},
        {"VOLSP", "Volume Spike Ventures", 4, {0.80f, 0.80f, 0.81f}, 50000000},
        {"AVGX", "Average Crossing Estates", 4, std::vector<float>(40, 0.95f)},
        {"ADNEW", "New Advance Decline Series (sample)", 3, {}},
    };
    Random rng(77);
    for (const auto& e : examples) {
        store::NameRecord n;
        n.Code = e.code;
        n.Name = e.name;
        n.RecordType = e.type;
        n.Category = 1;
        n.IndustryClass = "121";
        names.push_back(n);
        std::vector<store::PriceRecord> recs;
        for (std::size_t i = 0; i < dates.size(); ++i) {
            store::PriceRecord r;
            r.Date = dates[i];
            if (e.type == 3) { // advances and declines without their running total
                r.High = static_cast<float>(300 + static_cast<int>(rng.Uniform() * 400));
                r.Low = static_cast<float>(300 + static_cast<int>(rng.Uniform() * 400));
                recs.push_back(r);
                continue;
            }
            const std::size_t fromEnd = dates.size() - 1 - i;
            const auto& c = e.lastCloses;
            r.Close = fromEnd < c.size() ? c[c.size() - 1 - fromEnd] : c.front();
            r.Open = r.High = r.Low = r.Close;
            r.Volume = 100000 + static_cast<std::int32_t>(rng.Uniform() * 20000);
            if (fromEnd == 0 && e.lastVolume > 0) r.Volume = e.lastVolume;
            recs.push_back(r);
        }
        store::PriceFile pf(store::PriceFile::PathFor(dataFolder, e.code));
        if (auto st = pf.WriteAll(recs); !st) return st;
        summary.Records += static_cast<int>(recs.size());
    }
    return platform::Status::Ok();
}

// Histories a library gathers damage in, for the data check and the repair tools to find:
// a file with bad records of every kind, a security whose code changed (its old file stopped,
// the new one runs on), a history with a hole in it, and the .Old copies an adjustment leaves.
platform::Status AddDamagedExamples(const std::string& dataFolder,
                                    const std::vector<std::string>& dates,
                                    std::vector<store::NameRecord>& names, SampleSummary& summary) {
    Random rng(4242);
    const auto add = [&](const Security& s, std::vector<store::PriceRecord> recs) {
        store::NameRecord n;
        n.Code = s.code;
        n.Name = s.name;
        n.RecordType = s.type;
        n.IndustryClass = s.industry;
        n.Category = 1;
        names.push_back(n);
        summary.Records += static_cast<int>(recs.size());
        return store::PriceFile(store::PriceFile::PathFor(dataFolder, s.code)).WriteAll(recs);
    };

    auto bad = PriceHistory(
        {"FLT", "Faulty Data Holdings (sample)", 4, "121", "", 1.20, 0.02, 0.30, 300000}, dates,
        rng);
    const std::size_t n = bad.size();
    const store::PriceRecord twice = bad[n - 31];
    bad.insert(bad.begin() + static_cast<std::ptrdiff_t>(n - 30), twice); // a day twice
    bad[n - 25].Date = "20261017";                                        // a Saturday
    std::swap(bad[n - 22].Date, bad[n - 21].Date);                        // two days swapped
    std::swap(bad[n - 18].High, bad[n - 18].Low);                         // high below low
    bad[n - 15].Close = bad[n - 15].High * 1.1f;                          // close above the high
    bad[n - 12].Low = 0;       // a zero price on a traded day
    bad[n - 8].Volume = -5000; // negative volume
    if (auto st =
            add({"FLT", "Faulty Data Holdings (sample)", 4, "121", "", 1.20, 0.02, 0.30, 0}, bad);
        !st)
        return st;

    // The old code stopped 40 days before the end; the user joins it to the new one with the
    // code-change tool.
    auto before = PriceHistory(
        {"BRX", "Brook Energy (old code)", 4, "101", "", 0.85, 0.05, 0.35, 900000}, dates, rng);
    std::vector<store::PriceRecord> after(before.end() - 40, before.end());
    before.resize(before.size() - 40);
    if (auto st = add({"BRX", "Brook Energy (old code)", 4, "101", "", 0, 0, 0, 0}, before); !st)
        return st;
    names.back().OtherDetails = "Now BRK";
    if (auto st = add({"BRK", "Brook Energy (sample)", 4, "101", "", 0, 0, 0, 0}, after); !st)
        return st;

    // Five weeks without a record in the middle of the history.
    auto holed = PriceHistory(
        {"GAP", "Gapped History Mining (sample)", 4, "101", "", 2.40, 0.04, 0.40, 150000}, dates,
        rng);
    holed.erase(holed.end() - 150, holed.end() - 125);
    if (auto st = add({"GAP", "Gapped History Mining (sample)", 4, "101", "", 0, 0, 0, 0}, holed);
        !st)
        return st;

    // Copies kept by adjustments long done.
    for (const char* code : {"ALX", "KRM", "HBK"}) {
        const auto from = store::PriceFile::PathFor(dataFolder, code);
        auto to = from;
        to.replace_extension(".Old");
        const auto bytes = platform::ReadWholeFile(from);
        if (!bytes) return platform::Status::Error("Cannot read " + from.string());
        if (auto st = platform::WriteFileAtomic(to, *bytes); !st) return st;
    }
    return platform::Status::Ok();
}

} // namespace

platform::Status MakeSampleLibrary(const std::string& systemFolder, const std::string& dataFolder,
                                   platform::SettingsStore& settings, SampleSummary& summary) {
    platform::CreateFolder(dataFolder);
    const auto dates = Weekdays();
    Random rng(20261120);
    std::vector<store::NameRecord> names;
    std::map<std::string, store::PriceRecord> lastDay;
    summary = SampleSummary{};
    for (const auto& s : Securities()) {
        store::NameRecord n;
        n.Code = s.code;
        n.Name = s.name;
        n.RecordType = s.type;
        n.IndustryClass = s.industry;
        n.GicsSector = s.gics;
        n.Category = s.category != 0 ? s.category : std::int16_t{1};
        names.push_back(n);

        std::vector<store::PriceRecord> recs =
            s.type == 3 ? AdvanceDecline(dates, rng) : PriceHistory(s, dates, rng);
        if (std::string(s.code).size() == 6 || std::string(s.code) == "HLT")
            AddNoTradeDays(recs, rng);
        if (std::string(s.code) == "ALX") AddSplit(recs);
        store::PriceFile pf(store::PriceFile::PathFor(dataFolder, s.code));
        if (auto st = pf.WriteAll(recs); !st) return st;
        summary.Records += static_cast<int>(recs.size());
        lastDay[s.code] = recs.back();
    }
    names[names.size() - 4].OtherDetails = "Exp 30/06/27"; // a warrant's details
    if (auto st = AddScanExamples(dataFolder, dates, names, summary); !st) return st;
    if (auto st = AddDamagedExamples(dataFolder, dates, names, summary); !st) return st;
    names[3].PercentBandUp = 8;
    names[3].PercentBandDown = 8;
    store::NameFile nf(store::NameFile::PathIn(dataFolder));
    if (auto st = nf.WriteAll(names); !st) return st;
    summary.Securities = static_cast<int>(names.size());
    summary.LastDate = kLastDate;

    if (auto st = WriteClassFiles(systemFolder); !st) return st;
    if (auto st = WriteSampleTargets(systemFolder, lastDay); !st) return st;
    if (auto st = store::SaveListFromCodes(dataFolder, 'A', {"HBK", "IRB", "JNS", "KST", "LMT"});
        !st)
        return st;
    if (auto st = store::SaveListFromCodes(
            dataFolder, 'B', {"KRM", "ALX", "BWG", "CPR", "DLT", "ZNC", "CSW", "ESK"});
        !st)
        return st;
    if (auto st = store::SaveListFromCodes(dataFolder, 'C', {"XAO", "PNS", "QRY", "DRN", "KRMWOA"});
        !st)
        return st;
    auto listNames = store::GetSubLists(settings);
    listNames[0] = "Banks and Finance";
    listNames[1] = "Resources";
    listNames[2] = "Watching";
    store::SaveSLNames(settings, listNames);
    return platform::Status::Ok();
}

} // namespace kori::app

namespace kori::app {

namespace {

constexpr const char* kNextDate = "20261123"; // the Monday after the sample's last day

// A price as a day file writes it: at most four decimals, no trailing zeros.
std::string PriceText(double v) {
    std::string s = std::to_string(std::round(v * 10000) / 10000);
    while (!s.empty() && s.back() == '0')
        s.pop_back();
    if (!s.empty() && s.back() == '.') s.pop_back();
    return s.empty() ? "0" : s;
}

// A line of a day file for a security whose last record is `last`, moved by `move` (a ratio).
std::string DayLine(const std::string& code, const std::string& date,
                    const store::PriceRecord& last, double move, std::int32_t volume,
                    double spare = 0) {
    const double base = last.Close != 0 ? last.Close : 1.0;
    const double close = base * move;
    const double open = base * (1 + (move - 1) / 3);
    const double high = std::max(open, close) * 1.004;
    const double low = std::min(open, close) * 0.996;
    return code + "," + date + "," + PriceText(open) + "," + PriceText(high) + "," +
           PriceText(low) + "," + PriceText(close) + "," + std::to_string(volume) + "," +
           PriceText(spare) + "\r\n";
}

platform::Status LastRecord(const std::string& folder, const std::string& code,
                            store::PriceRecord& last) {
    store::PriceFile pf(store::PriceFile::PathFor(folder, code));
    if (auto s = pf.OpenWithData(); !s) return s;
    return pf.Read(pf.Count(), last);
}

// The waiting day's bulletin has capital issues in it: the day's prices already trade on the
// new basis (a bonus of 1 for 4, a consolidation of 1 for 2, an 85-cent dividend), so that the
// adjusted histories run on without a step.
store::PriceRecord OnNewBasis(const std::string& code, store::PriceRecord last) {
    if (code == "KRM") last.Close *= 0.8f;
    if (code == "PNS") last.Close *= 2.0f;
    if (code == "HBK" && last.Close > 0.85f) last.Close -= 0.85f;
    return last;
}

platform::Status WriteDayFile(const std::string& folder, const std::string& name,
                              const std::string& text, std::vector<std::string>& made) {
    made.push_back(name);
    return platform::WriteFileAtomic(platform::ResolveIn(folder, name), text);
}

// The advance/decline line: advances and declines in high and low, the running total in close.
std::string AdvanceDeclineLine(const std::string& date, const store::PriceRecord& last, int adv,
                               int dec) {
    return "ADVDEC," + date + ",0," + std::to_string(adv) + "," + std::to_string(dec) + "," +
           PriceText(last.Close + static_cast<double>(adv - dec)) + ",0,0\r\n";
}

} // namespace

platform::Status MakeSampleDayFiles(const std::string& dataFolder,
                                    const std::string& downloadFolder,
                                    std::vector<std::string>& made) {
    platform::CreateFolder(downloadFolder);
    made.clear();
    Random rng(20261123);
    std::string next, replace, insert;
    for (const auto& s : Securities()) {
        const std::string code = s.code;
        store::PriceRecord last;
        if (auto st = LastRecord(dataFolder, code, last); !st) return st;
        const double move = 1 + 0.02 * rng.Normal() * s.volatility;
        const auto volume = static_cast<std::int32_t>(s.volume * (0.6 + rng.Uniform()));
        if (code == "ADVDEC") {
            next += AdvanceDeclineLine(kNextDate, last, 412, 377);
            continue;
        }
        if (code == "OCR") continue; // did not trade: the update gives it a filler
        // The service corrects Friday's volume of KRM on Monday's line.
        const double spare = code == "KRM" ? static_cast<double>(last.Volume) + 125000 : 0;
        if (code == "CSW") {
            // CPR's holders now trade as CSW: the new code's first day follows CPR's last.
            store::PriceRecord cpr;
            if (auto st = LastRecord(dataFolder, "CPR", cpr); !st) return st;
            next += DayLine(code, kNextDate, cpr, 1.0, volume, spare);
        } else {
            next += DayLine(code, kNextDate, OnNewBasis(code, last), move, volume, spare);
        }
        if (code == "KRM" || code == "ALX" || code == "BWG")
            replace += DayLine(code, kLastDate, last, 1.0, last.Volume + 1000);
        if (code == "KRM" || code == "ALX" || code == "CPR")
            insert += DayLine(code, "20261114", last, 0.99, volume / 4);
    }
    store::PriceRecord krm;
    if (auto st = LastRecord(dataFolder, "KRM", krm); !st) return st;
    next += "NEWCO," + std::string(kNextDate) + ",0.5,0.52,0.48,0.51,250000,0\r\n";
    // A Saturday session, delivered late: it goes in among the records already on file.
    if (auto st = WriteDayFile(downloadFolder, "14NOV26.D", insert, made); !st) return st;
    if (auto st = WriteDayFile(downloadFolder, "20NOV26.D", replace, made); !st) return st;
    if (auto st = WriteDayFile(downloadFolder, "23NOV26.D", next, made); !st) return st;
    // One line short of a field: the whole file is refused before anything is written.
    const std::string bad = DayLine("KRM", "20261124", krm, 1.01, 1000000) +
                            "ALX,20261124,12.1,12.3,12.0,12.2,900000\r\n";
    return WriteDayFile(downloadFolder, "24NOV26.D", bad, made);
}

platform::Status MakeSampleBundle(const std::string& rootFolder, const std::string& dataFolder,
                                  const std::string& downloadFolder,
                                  std::array<std::string, 8>& segmentFolders,
                                  std::vector<std::string>& made) {
    platform::CreateFolder(downloadFolder);
    made.clear();
    segmentFolders = {};
    segmentFolders[0] = dataFolder; // Australian stocks and warrants
    const std::string idx = rootFolder + "indices/", fut = rootFolder + "futures/",
                      ovs = rootFolder + "overseas/", opt = rootFolder + "options/";
    segmentFolders[1] = idx;
    segmentFolders[2] = fut;
    segmentFolders[3] = ovs;
    segmentFolders[4] = opt;
    const auto dates = Weekdays();
    Random rng(20261124);

    // Each segment folder is a small library of its own.
    struct Extra {
        const char* folder;
        Security security;
        const char* details;
    };
    const std::vector<Extra> extras = {
        {"indices/", {"XAO", "All Ordinaries Index (sample)", 5, "", "", 5200, 0.05, 0.14, 0}, ""},
        {"indices/", {"XJO", "Top 200 Index (sample)", 5, "", "", 5100, 0.05, 0.15, 0}, ""},
        {"futures/",
         {"APZ6", "Share Price Index Dec (sample)", 4, "", "", 5150, 0.05, 0.16, 40000},
         ""},
        {"futures/", {"IRZ6", "90 Day Bills Dec (sample)", 4, "", "", 95.6, 0.0, 0.02, 25000}, ""},
        {"overseas/",
         {"DJIEZ", "Overseas Industrials (sample)", 4, "", "", 31000, 0.06, 0.15, 0},
         ""},
        {"options/",
         {"KRMLZ6", "Karoo Minerals Dec Put (sample)", 4, "", "", 0.35, 0, 0.9, 20000},
         "0P17/12/26"},
        {"options/",
         {"ALXOZ6", "Alexandra Dec Call (sample)", 4, "", "", 0.80, 0, 0.8, 15000},
         "0C17/12/26"},
        // Details never filled in: the no-trade check marks it for the user.
        {"options/", {"BWGLX6", "Bowen Gold Nov Put (sample)", 4, "", "", 0.05, 0, 0.9, 5000}, ""},
    };
    std::map<std::string, std::vector<store::NameRecord>> names;
    std::string dix, dsf, dov, dop;
    for (const auto& e : extras) {
        const std::string folder = rootFolder + e.folder;
        if (!platform::CreateFolder(folder))
            return platform::Status::Error("Cannot create " + folder);
        store::NameRecord n;
        n.Code = e.security.code;
        n.Name = e.security.name;
        n.RecordType = e.security.type;
        n.OtherDetails = e.details;
        n.Category = 1;
        names[folder].push_back(n);
        // Options trade for the last three months only.
        const std::vector<std::string> span =
            std::string(e.folder) == "options/"
                ? std::vector<std::string>(dates.end() - 63, dates.end())
                : dates;
        const auto recs = PriceHistory(e.security, span, rng);
        store::PriceFile pf(store::PriceFile::PathFor(folder, e.security.code));
        if (auto st = pf.WriteAll(recs); !st) return st;
        const std::string code = e.security.code;
        const auto volume = static_cast<std::int32_t>(e.security.volume);
        const std::string line = DayLine(code, kNextDate, recs.back(), 1.003, volume);
        if (std::string(e.folder) == "indices/") dix += line;
        if (std::string(e.folder) == "futures/") dsf += line;
        if (std::string(e.folder) == "overseas/") dov += line;
        if (std::string(e.folder) == "options/" && code != "BWGLX6") {
            std::string l = line.substr(0, line.size() - 2); // the spare field holds days
            l = l.substr(0, l.rfind(',')) + ",24," + (code == "KRMLZ6" ? "P" : "C") + "\r\n";
            dop += l;
        }
    }
    for (const auto& [folder, list] : names) {
        store::NameFile nf(store::NameFile::PathIn(folder));
        if (auto st = nf.WriteAll(list); !st) return st;
    }
    // A new series in two segments: an index and an option.
    dix += "XNR," + std::string(kNextDate) + ",0,812.5,798.1,805.2,0,0\r\n";
    dop += "KRMWZ6," + std::string(kNextDate) + ",0.21,0.23,0.2,0.22,3000,24,C\r\n";

    std::string dsu;
    Random move(20261125);
    for (const auto& s : Securities()) {
        const std::string code = s.code;
        if (code == "ADVDEC" || code == "XAO" || code == "XJO" || code == "OCR") continue;
        store::PriceRecord last;
        if (auto st = LastRecord(dataFolder, code, last); !st) return st;
        store::PriceRecord base = OnNewBasis(code, last);
        if (code == "CSW")
            if (auto st = LastRecord(dataFolder, "CPR", base); !st) return st;
        const double drawn = 1 + 0.02 * move.Normal() * s.volatility;
        const double step = code == "CSW" ? 1.0 : drawn;
        dsu += DayLine(code, kNextDate, base, step,
                       static_cast<std::int32_t>(s.volume * (0.6 + move.Uniform())));
    }
    dsu += "KRMWOE," + std::string(kNextDate) + ",0.1,0.11,0.09,0.1,50000,0\r\n";
    dsu += "NEWCO," + std::string(kNextDate) + ",0.5,0.52,0.48,0.51,250000,0\r\n";
    const std::string stem = "23NOV26";
    for (const auto& [ext, text] :
         std::vector<std::pair<std::string, std::string>>{{".d", "23NOV26 bundle\r\n"},
                                                          {".dix", dix},
                                                          {".dov", dov},
                                                          {".dsu", dsu},
                                                          {".dsf", dsf},
                                                          {".dop", dop}}) {
        if (auto st = WriteDayFile(downloadFolder, stem + ext, text, made); !st) return st;
    }
    return platform::Status::Ok();
}

platform::Status MakeSampleBulletins(const std::string& dataFolder, const std::string& inFolder) {
    if (!platform::CreateFolderPath(inFolder))
        return platform::Status::Error("Cannot create " + inFolder);
    store::PriceRecord bwg;
    if (auto st = LastRecord(dataFolder, "BWG", bwg); !st) return st;
    // The service corrects the high and the volume of BWG's last day, in cents.
    const std::string high = std::to_string(static_cast<int>(std::ceil(bwg.High * 100)) + 1);
    const std::string asx = "NI,NEWCO,ASX.STK,0,Y,NEWCO MINING,ORD\r\n"
                            "NL,NEWCO,ASX.STK,0,N,NEWCASTLE EXPLORATION LIMITED ORD,ORD\r\n"
                            "NC,CPR,ASX.STK,0,Y,23NOV26,CSW\r\n"
                            "DC,HLT,ASX.STK,0,N,23NOV26\r\n"
                            "BI,KRM,ASX.STK,0,Y,23NOV26,1,4\r\n"
                            "SP,PNS,ASX.STK,0,Y,23NOV26,-1,2\r\n"
                            "DI,HBK,ASX.STK,0,N,23NOV26,,,85\r\n"
                            "PC,BWG,ASX.STK,0,Y,20261120,H:" +
                            high + " V:" + std::to_string(bwg.Volume + 50000) +
                            "\r\n"
                            // Lines the filter drops: a warrant without a price file and an option
                            // series with no options library.
                            "BI,DLTWOZ,ASX.STK,0,Y,23NOV26,1,1\r\n"
                            "NI,KRMLZ6,ASX.OPT,0,Y,KAROO DEC PUT\r\n";
    return platform::WriteFileAtomic(platform::ResolveIn(inFolder, "23NOV26.Asx.Btn"), asx);
}

platform::Status MakeSampleSecurityDetails(const std::string& dataFolder,
                                           const std::string& inFolder) {
    std::vector<store::NameRecord> names;
    store::NameFile nf(store::NameFile::PathIn(dataFolder));
    if (auto st = nf.ReadAll(names); !st) return st;
    std::string text =
        "CODE,SHORTDESCRIPTION,SECURITYTYPE,FIRSTACTIVEDATE,FIRSTQUOTEDDATE,LASTQUOTEDATE,"
        "SUSPENSIONSTARTDATE,SUSPENSIONENDDATE,TOTALCLASSISSUE,PARVALUE,PAIDUPVALUE,ASSETBACKING,"
        "DIVENDRATEPERSHARE,EARNINGSPERSHARE,ANNUALDIVIDENDRATE,FRANKINGPERCENT,EXDATE,"
        "DIVIDENTTYPE,GICSSECTORCODE\r\n";
    // Earnings and dividend stand in the 14th and 15th columns, where the details window
    // reads them.
    const auto line = [](const std::string& code, const std::string& name, long issue,
                         const std::string& dividend, const std::string& earnings,
                         const std::string& franking, const std::string& exDate, bool interim,
                         const std::string& gics = "") {
        return code + "," + name + ",ORD,20100104,20100105,20261120,,," + std::to_string(issue) +
               ",0,0,0," + dividend + "," + earnings + "," + dividend + "," + franking + "," +
               exDate + "," + (interim ? "I" : "F") + "," + gics + "\r\n";
    };
    int i = 0;
    for (const auto& n : names) {
        if (n.RecordType != 4) continue;
        ++i;
        // Every fifth pays nothing and every seventh earns nothing: their figures show "n/a".
        const std::string dividend =
            i % 5 == 0 ? "0" : platform::Format((i % 9 + 1) * 0.025, "0.00#");
        const std::string earnings =
            i % 7 == 0 ? "0" : platform::Format((i % 11 + 1) * 0.04, "0.00#");
        text += line(n.TrimmedCode(), platform::Upper(platform::Trim(n.Name)),
                     1000000L * (i * 37 % 900 + 10), dividend, earnings, i % 2 ? "100" : "0",
                     "2026101" + std::to_string(i % 10), i % 3 == 0,
                     // The download knows a sector for the names the sample left without one.
                     platform::Trim(n.GicsSector).empty() ? "4010" : platform::Trim(n.GicsSector));
    }
    text += line("PRN", "PERENNIAL RESOURCES", 52000000, "0.01", "0.05", "100", "20260901", false);
    // A row whose description runs past what a record keeps.
    text += line("ZLONG", "A SECURITY WHOSE DESCRIPTION RUNS ON " + std::string(320, 'X'), 1000,
                 "0", "0", "0", "20260101", false);
    platform::CreateFolder(inFolder);
    return platform::WriteFileAtomic(platform::ResolveIn(inFolder, "SecurityDetails.Asx.Stk"),
                                     text);
}

} // namespace kori::app
