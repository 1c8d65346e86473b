#include "osc/osc_identifiers.h"

#include "osc/atr_volatility_obv.h"
#include "osc/compare_osc.h"
#include "osc/directional.h"
#include "osc/macd_coppock_elder.h"
#include "osc/momentum_roc.h"
#include "osc/osc_compute.h"
#include "osc/osc_draw.h"
#include "osc/rsi.h"
#include "osc/stoch_fx.h"
#include "osc/williams_holy_grail.h"
#include "platform/text.h"

namespace kori::osc {

namespace {

using Periods = std::span<const std::int16_t>;
using store::ChartSeries;

void StochColumns(OscColumns& t, const ChartSeries& s, std::int16_t k, std::int16_t d, bool slow,
                  std::int16_t recordType, bool withSlow) {
    const StochResult r = ComputeStochFX(s, k, d, slow, recordType);
    t.Add("k", r.k).Add("d", r.d);
    if (withSlow) t.Add("slowd", r.slowd);
}

// RMO and RMX need the comparison file; without it they compute nothing.
void CompareColumn(OscColumns& t, bool rmo, const ChartSeries& s, std::int16_t period,
                   const OscInputs& in) {
    CompareResult r;
    r.value.assign(static_cast<std::size_t>(BarCount(s)), std::nullopt);
    if (in.CompareFile != nullptr && !rmo) r = ComputeRMX(s, *in.CompareFile, period);
    if (in.CompareFile != nullptr && rmo) {
        const bool whole = in.SecurityFile != nullptr;
        r = ComputeRMO(whole ? *in.SecurityFile : s, *in.CompareFile, period,
                       whole ? in.FirstRecord : std::int16_t{1}, BarCount(s));
    }
    t.Add("value", r.value);
}

using chart::Chart;
using platform::Surface;
using D = const OscDef&;
using In = const OscDrawInputs&;

constexpr OscIdentifier kIdentifiers[] = {
    {"ATR",
     "Average True Range",
     "",
     "Average True Range",
     "",
     {"AtrD"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         const AtrResult r = ComputeATR(s, p[0]);
         t.Add("tr", r.tr).Add("atr", r.atr);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscATR(c, d, period, in, s); }},
    {"STO",
     "Stochastic",
     "Stochastic(slow)",
     "Stochastic (Fast)",
     "Stochastic (Slow)",
     {"StochK", "StochD"},
     2,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         StochColumns(t, s, p[0], p[1], in.SlowStochastic, in.RecordType, true);
     },
     [](Chart& c, D d, char period, In in, Surface& s) {
         OscStochFX(c, "STO", d, period, in, s, false);
     }},
    {"FX",
     "FX",
     "",
     "FX",
     "",
     {"FXF", "FXX"},
     2,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         StochColumns(t, s, p[0], p[1], false, in.RecordType, false);
     },
     [](Chart& c, D d, char period, In in, Surface& s) {
         OscStochFX(c, "FX", d, period, in, s, false);
     }},
    {"ROC",
     "ROC",
     "",
     "ROC",
     "",
     {"RocP", "RocA"},
     2,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         t.Add("roc", ComputeROC(s, p[0]).roc);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscROC(c, "ROC", d, period, in, s); }},
    {"RMX",
     "RMX",
     "",
     "RMX",
     "",
     {"RmxP", "RmxA"},
     2,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         CompareColumn(t, false, s, p[0], in);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscRMX(c, d, period, in, s); }},
    {"RMO",
     "RMO",
     "",
     "",
     "",
     {"RmoP", "RmoA"},
     2,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         CompareColumn(t, true, s, p[0], in);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscRMO(c, d, period, in, s); }},
    {"R/F",
     "ROC & FX",
     "",
     "ROC and FX",
     "",
     {"RocP", "RocA", "FXF", "FXX"},
     4,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         t.Add("roc", ComputeROC(s, p[0]).roc);
         StochColumns(t, s, p[2], p[3], false, in.RecordType, false);
     },
     // ROC draws the panel, then FX goes over it.
     [](Chart& c, D d, char period, In in, Surface& s) {
         OscROC(c, "R/F", d, period, in, s);
         OscStochFX(c, "R/F", d, period, in, s, true);
     }},
    {"RSI",
     "RSI",
     "",
     "RSI",
     "",
     {"RsiP"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         t.Add("rsi", ComputeRSI(s, p[0]).rsi);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscRSI(c, d, period, in, s); }},
    {"MACD",
     "MACD",
     "",
     "MACD",
     "",
     {"Md1", "Md2", "Md3"},
     3,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         const MacdResult r = ComputeMACD(s, p[0], p[1], p[2]);
         t.Add("ema1", r.ema1).Add("ema2", r.ema2).Add("macd", r.macd).Add("signal", r.signal);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscMACD(c, d, period, in, s); }},
    {"WMS",
     "Williams %R",
     "",
     "Williams %R",
     "",
     {"WmsA"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         t.Add("r", ComputeWilliams(s, p[0], in.RecordType).r);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscWilliams(c, d, period, in, s); }},
    {"ERY",
     "ElderRay",
     "",
     "Elder Ray",
     "",
     {"ERA"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs& in) {
         const ElderRayResult r = ComputeElderRay(s, p[0], in.RecordType);
         t.Add("bull", r.bull).Add("bear", r.bear);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscElderRay(c, d, period, in, s); }},
    {"MOM",
     "Momentum",
     "",
     "Momentum",
     "",
     {"MMA"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         t.Add("mom", ComputeMomentum(s, p[0]).mom);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscMomentum(c, d, period, in, s); }},
    {"DM",
     "Directional Movement",
     "",
     "Directional Movement",
     "",
     {"DMA", "DMXA"},
     2,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         const DirectionalResult r = ComputeDirectional(s, p[0], p[1]);
         t.Add("pdi", r.pdi).Add("mdi", r.mdi).Add("dx", r.dx).Add("adx", r.adx);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscDirectional(c, d, period, in, s); }},
    {"JHG",
     "Jones Holy Grail",
     "",
     "Jones Holy Grail",
     "",
     {"HolyD"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         const HolyGrailResult r = ComputeHolyGrail(s, p[0]);
         t.Add("col0", r.col0).Add("col1", r.col1).Add("col2", r.col2);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscHolyGrail(c, d, period, in, s); }},
    {"COP",
     "Coppock",
     "",
     "Coppock",
     "",
     {"CopD"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         t.Add("coppock", ComputeCoppock(s, p[0]).coppock);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscCoppock(c, d, period, in, s); }},
    {"VTY",
     "Volatility",
     "",
     "Volatility",
     "",
     {"VtyD"},
     1,
     [](OscColumns& t, const ChartSeries& s, Periods p, const OscInputs&) {
         const VolatilityResult r = ComputeVolatility(s, p[0]);
         t.Add("figure", r.figure).Add("mean", r.mean);
     },
     [](Chart& c, D d, char period, In in, Surface& s) { OscVolatility(c, d, period, in, s); }},
    {"OBV",
     "On-Balance Volume",
     "",
     "OBV",
     "",
     {},
     0,
     [](OscColumns& t, const ChartSeries& s, Periods, const OscInputs&) {
         t.Add("obv", ComputeOBV(s).obv);
     },
     [](Chart& c, D, char, In in, Surface& s) { OscOBV(c, in, s, false); }},
    {"PARA", "Parabolic", "", "", "", {}, 0, nullptr, nullptr, true},
    {"PARAV", "", "", "", "", {}, 0, nullptr, nullptr, true},
};

constexpr OscChoice kChooserOrder[] = {
    {"ATR"}, {"DM"},        {"COP"}, {"ERY"}, {"FX"},   {"JHG"}, {"MACD"},
    {"MOM"}, {"OBV"},       {"ROC"}, {"R/F"}, {"RMO"},  {"RMX"}, {"RSI"},
    {"STO"}, {"STO", true}, {"VTY"}, {"WMS"}, {"PARA"},
};

constexpr OscChoice kListOrder[] = {
    {"ATR"}, {"DM"},  {"COP"}, {"ERY"}, {"FX"},  {"JHG"},       {"OBV"}, {"MACD"}, {"MOM"},
    {"ROC"}, {"R/F"}, {"RMX"}, {"RSI"}, {"STO"}, {"STO", true}, {"VTY"}, {"WMS"},
};

std::string SlotText(std::string_view text) {
    std::string t = platform::Trim(text);
    return t.empty() ? std::string("None") : t;
}

} // namespace

std::span<const OscIdentifier> OscIdentifiers() {
    return kIdentifiers;
}

const OscIdentifier* FindOscIdentifier(std::string_view oscName) {
    const std::string name = platform::Trim(oscName);
    for (const auto& id : kIdentifiers)
        if (id.OscName == name) return &id;
    return nullptr;
}

std::span<const OscChoice> ChooserOrder() {
    return kChooserOrder;
}

std::string_view ChooserCaption(const OscChoice& choice) {
    const OscIdentifier* id = FindOscIdentifier(choice.OscName);
    if (id == nullptr) return {};
    return choice.SlowStochastic ? id->SlowCaption : id->Caption;
}

std::string_view ListName(const OscChoice& choice) {
    const OscIdentifier* id = FindOscIdentifier(choice.OscName);
    if (id == nullptr) return {};
    return choice.SlowStochastic ? id->SlowListName : id->ListName;
}

std::span<const std::string_view> MultiOscChoices() {
    static const auto names = [] {
        std::array<std::string_view, std::size(kListOrder) + 1> n{"None"};
        for (std::size_t i = 0; i < std::size(kListOrder); ++i)
            n[i + 1] = ListName(kListOrder[i]);
        return n;
    }();
    return names;
}

std::optional<OscChoice> FindMultiOscChoice(std::string_view listName) {
    const std::string name = platform::Trim(listName);
    for (const auto& choice : kListOrder)
        if (ListName(choice) == name) return choice;
    return std::nullopt;
}

std::string MultiOscKey(int set) {
    return "Multi-Osc " + std::to_string(set);
}

MultiOscSet LoadMultiOscSet(const platform::SettingsStore& store, int set) {
    MultiOscSet result;
    const std::string stored = store.Get(MultiOscKey(set), "");
    std::size_t slot = 0;
    std::size_t start = 0;
    while (slot < kMultiOscSlots && start <= stored.size() && !stored.empty()) {
        const auto comma = stored.find(',', start);
        const auto end = comma == std::string::npos ? stored.size() : comma;
        result.Slots[slot++] = SlotText(std::string_view(stored).substr(start, end - start));
        if (comma == std::string::npos) break;
        start = comma + 1;
    }
    return result;
}

void SaveMultiOscSet(platform::SettingsStore& store, int set, const MultiOscSet& slots) {
    std::string joined;
    for (std::size_t i = 0; i < kMultiOscSlots; ++i) {
        if (i > 0) joined += ',';
        joined += platform::Trim(slots.Slots[i]);
    }
    store.Save(MultiOscKey(set), joined);
}

} // namespace kori::osc
