#include "osc/osc_compute.h"

#include "osc/atr_volatility_obv.h"
#include "osc/compare_osc.h"
#include "osc/directional.h"
#include "osc/macd_coppock_elder.h"
#include "osc/momentum_roc.h"
#include "osc/rsi.h"
#include "osc/stoch_fx.h"
#include "osc/williams_holy_grail.h"
#include "platform/text.h"

namespace kori::osc {

namespace {

double AsDouble(double v) {
    return v;
}
double AsDouble(Money v) {
    return v.ToDouble();
}

class TableBuilder {
public:
    explicit TableBuilder(int bars) : m_bars(static_cast<std::size_t>(bars)) {}

    template <class T> TableBuilder& Add(std::string name, const Series<T>& series) {
        m_table.columns.push_back(std::move(name));
        std::vector<std::optional<double>> column(m_bars);
        for (std::size_t i = 0; i < column.size() && i < series.size(); ++i)
            if (series[i]) column[i] = AsDouble(*series[i]);
        m_columns.push_back(std::move(column));
        return *this;
    }

    OscTable Build() {
        const std::size_t width = m_columns.size();
        m_table.values.resize(m_bars * width);
        for (std::size_t c = 0; c < width; ++c)
            for (std::size_t i = 0; i < m_bars; ++i)
                m_table.values[i * width + c] = m_columns[c][i];
        return std::move(m_table);
    }

private:
    std::size_t m_bars;
    OscTable m_table;
    std::vector<std::vector<std::optional<double>>> m_columns;
};

bool Daily(std::string_view chartPeriod) {
    return platform::Trim(chartPeriod) == "A";
}

// MACD alone looks further: "W" and "M" take the weekly keys, any other code none, and the
// routine stops when a daily key is 0 whatever the column.
std::vector<std::int16_t> MacdPeriods(const OscDef& d, std::string_view chartPeriod) {
    const std::string code = platform::Trim(chartPeriod);
    if (d.Md1 == 0 || d.Md2 == 0 || d.Md3 == 0) return {0, 0, 0};
    if (code == "A") return {d.Md1, d.Md2, d.Md3};
    if (code == "W" || code == "M") return {d.Md1W, d.Md2W, d.Md3W};
    return {0, 0, 0};
}

void AddStochFX(TableBuilder& t, const store::ChartSeries& s, std::int16_t k, std::int16_t d,
                bool slow, std::int16_t recordType, bool withSlow) {
    const StochResult r = ComputeStochFX(s, k, d, slow, recordType);
    t.Add("k", r.k).Add("d", r.d);
    if (withSlow) t.Add("slowd", r.slowd);
}

void AddCompare(TableBuilder& t, std::string_view name, const store::ChartSeries& s,
                std::int16_t period, const OscInputs& in) {
    CompareResult r;
    r.value.assign(static_cast<std::size_t>(BarCount(s)), std::nullopt);
    if (in.CompareFile != nullptr && name == "RMX") r = ComputeRMX(s, *in.CompareFile, period);
    if (in.CompareFile != nullptr && name == "RMO") {
        const bool whole = in.SecurityFile != nullptr;
        r = ComputeRMO(whole ? *in.SecurityFile : s, *in.CompareFile, period,
                       whole ? in.FirstRecord : std::int16_t{1}, BarCount(s));
    }
    t.Add("value", r.value);
}

// Fills the table of one identifier; false when it has no computation here.
bool Fill(TableBuilder& t, std::string_view name, const store::ChartSeries& s,
          const std::vector<std::int16_t>& p, const OscInputs& in) {
    const std::int16_t rt = in.RecordType;
    if (name == "RSI")
        t.Add("rsi", ComputeRSI(s, p[0]).rsi);
    else if (name == "STO")
        AddStochFX(t, s, p[0], p[1], in.SlowStochastic, rt, true);
    else if (name == "FX")
        AddStochFX(t, s, p[0], p[1], false, rt, false);
    else if (name == "ROC")
        t.Add("roc", ComputeROC(s, p[0]).roc);
    else if (name == "R/F") {
        t.Add("roc", ComputeROC(s, p[0]).roc);
        AddStochFX(t, s, p[2], p[3], false, rt, false);
    } else if (name == "MOM")
        t.Add("mom", ComputeMomentum(s, p[0]).mom);
    else if (name == "MACD") {
        const MacdResult r = ComputeMACD(s, p[0], p[1], p[2]);
        t.Add("ema1", r.ema1).Add("ema2", r.ema2).Add("macd", r.macd).Add("signal", r.signal);
    } else if (name == "COP")
        t.Add("coppock", ComputeCoppock(s, p[0]).coppock);
    else if (name == "ERY") {
        const ElderRayResult r = ComputeElderRay(s, p[0], rt);
        t.Add("bull", r.bull).Add("bear", r.bear);
    } else if (name == "ATR") {
        const AtrResult r = ComputeATR(s, p[0]);
        t.Add("tr", r.tr).Add("atr", r.atr);
    } else if (name == "VTY") {
        const VolatilityResult r = ComputeVolatility(s, p[0]);
        t.Add("figure", r.figure).Add("mean", r.mean);
    } else if (name == "OBV")
        t.Add("obv", ComputeOBV(s).obv);
    else if (name == "DM") {
        const DirectionalResult r = ComputeDirectional(s, p[0], p[1]);
        t.Add("pdi", r.pdi).Add("mdi", r.mdi).Add("dx", r.dx).Add("adx", r.adx);
    } else if (name == "WMS")
        t.Add("r", ComputeWilliams(s, p[0], rt).r);
    else if (name == "JHG") {
        const HolyGrailResult r = ComputeHolyGrail(s, p[0]);
        t.Add("col0", r.col0).Add("col1", r.col1).Add("col2", r.col2);
    } else if (name == "RMO" || name == "RMX")
        AddCompare(t, name, s, p[0], in);
    else
        return false;
    return true;
}

} // namespace

std::vector<std::int16_t> OscPeriodsFor(const OscDef& def, std::string_view oscName,
                                        std::string_view chartPeriod) {
    if (oscName == "MACD") return MacdPeriods(def, chartPeriod);
    const bool daily = Daily(chartPeriod);
    std::vector<std::int16_t> periods;
    for (std::string_view key : OscSettingKeys(oscName)) {
        const OscPeriodKey* k = FindOscPeriodKey(key);
        periods.push_back(k == nullptr ? 0 : def.*(daily ? k->DailyField : k->WeeklyField));
    }
    return periods;
}

std::optional<OscTable> ComputeOscillator(std::string_view oscName,
                                          const store::ChartSeries& series, const OscDef& def,
                                          const OscInputs& inputs) {
    const std::string name = platform::Trim(oscName);
    TableBuilder table(BarCount(series));
    if (!Fill(table, name, series, OscPeriodsFor(def, name, inputs.ChartPeriod), inputs))
        return std::nullopt;
    return table.Build();
}

} // namespace kori::osc
