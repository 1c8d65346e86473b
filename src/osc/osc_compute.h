#pragma once
// One entry point for every oscillator's computation, for exports and scans: the series of an
// identifier as named columns, one row a bar, with no value where the routine computed none.
#include "osc/osc_series.h"
#include "osc/osc_settings.h"
#include "platform/rounding.h"

#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace kori::osc {

struct OscInputs {
    std::string ChartPeriod = "A"; // "A" daily; "W", "M" take the weekly keys
    std::int16_t RecordType = 4;   // of the security (1 to 3: closes only)
    bool SlowStochastic = false;   // "STO" only
    // RMO and RMX: every record of the comparison file (zero closes as they stand). Without
    // it they compute nothing, as when the comparison file is missing.
    const store::ChartSeries* CompareFile = nullptr;
    // RMO: every record of the security's own file, and the record of chart bar 0. Without
    // it the chart's bars stand for the whole file.
    const store::ChartSeries* SecurityFile = nullptr;
    std::int16_t FirstRecord = 1;
};

struct OscTable {
    std::vector<std::string> columns;
    // Row by row, one row a bar (0 to LastBar), one value a column.
    std::vector<std::optional<double>> values;

    std::size_t RowCount() const { return columns.empty() ? 0 : values.size() / columns.size(); }
    std::span<const std::optional<double>> Row(std::size_t bar) const {
        return std::span(values).subspan(bar * columns.size(), columns.size());
    }
};

// The columns an identifier's computation fills, one value a bar; built into an OscTable.
class OscColumns {
public:
    explicit OscColumns(int bars) : m_bars(static_cast<std::size_t>(bars)) {}

    template <class T> OscColumns& Add(std::string name, const Series<T>& series) {
        m_table.columns.push_back(std::move(name));
        std::vector<std::optional<double>> column(m_bars);
        for (std::size_t i = 0; i < column.size() && i < series.size(); ++i)
            if (series[i]) column[i] = AsDouble(*series[i]);
        m_columns.push_back(std::move(column));
        return *this;
    }

    OscTable Build();

private:
    static double AsDouble(double v) { return v; }
    static double AsDouble(platform::Money v) { return v.ToDouble(); }

    std::size_t m_bars;
    OscTable m_table;
    std::vector<std::vector<std::optional<double>>> m_columns;
};

// The periods of an identifier for the chart period, in the order of its settings keys.
std::vector<std::int16_t> OscPeriodsFor(const OscDef& def, std::string_view oscName,
                                        std::string_view chartPeriod);

// nullopt for an identifier that has no computation here ("PARA", "PARAV" or unknown).
std::optional<OscTable> ComputeOscillator(std::string_view oscName,
                                          const store::ChartSeries& series, const OscDef& def,
                                          const OscInputs& inputs);

} // namespace kori::osc
