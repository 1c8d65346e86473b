#include "osc/osc_compute.h"

#include "osc/osc_identifiers.h"

#include "platform/text.h"

namespace kori::osc {

namespace {

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

} // namespace

OscTable OscColumns::Build() {
    const std::size_t width = m_columns.size();
    m_table.values.resize(m_bars * width);
    for (std::size_t c = 0; c < width; ++c)
        for (std::size_t i = 0; i < m_bars; ++i)
            m_table.values[i * width + c] = m_columns[c][i];
    return std::move(m_table);
}

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
    const OscIdentifier* id = FindOscIdentifier(name);
    if (id == nullptr || id->Compute == nullptr) return std::nullopt;
    const std::vector<std::int16_t> periods = OscPeriodsFor(def, name, inputs.ChartPeriod);
    OscColumns table(BarCount(series));
    id->Compute(table, series, periods, inputs);
    return table.Build();
}

} // namespace kori::osc
