#include "osc/compare_osc.h"

#include "platform/files.h"
#include "platform/text.h"

#include <algorithm>

namespace kori::osc {

namespace {

constexpr int kMaxCompareBars = 30000;

// Feeds the ratios, oldest first, through a ring of P: once full, value = the ring's mean -
// the ratio. The result keeps the places of the ratios.
Series<float> RingValues(const Series<float>& ratios, int period) {
    Series<float> out(ratios.size());
    std::vector<float> taken;
    std::vector<std::size_t> places;
    taken.reserve(ratios.size());
    places.reserve(ratios.size());
    for (std::size_t i = 0; i < ratios.size(); ++i) {
        if (!ratios[i]) continue;
        taken.push_back(*ratios[i]);
        places.push_back(i);
    }
    const std::vector<float> sums = WindowSums(taken, period);
    for (std::size_t k = static_cast<std::size_t>(period) - 1; k < taken.size(); ++k)
        out[places[k]] = sums[k] / static_cast<float>(period) - taken[k];
    return out;
}

float Ratio(float reference, float close) {
    return reference / (close * 100.0f);
}

} // namespace

CompareFile ResolveCompareFile(std::string_view compFile) {
    CompareFile result;
    const std::string path = platform::NormalisePath(platform::Trim(compFile));
    if (path.empty()) return result;
    result.Path = platform::ResolvePath(path);
    if (!platform::FileExists(result.Path)) return result;
    if (path.size() < 4 || platform::Upper(path.substr(path.size() - 4)) != ".WDT") return result;
    const auto slash = path.find_last_of('/');
    if (slash == std::string::npos) return result;
    result.CompareCode = platform::Upper(path.substr(slash + 1, path.size() - 4 - (slash + 1)));
    return result;
}

CompareFile ResolveCompareFile(std::string_view compFile, platform::Dialogs& dialogs) {
    CompareFile result = ResolveCompareFile(compFile);
    if (result.CompareCode.empty())
        dialogs.MsgBox("RMX/RMO Compare file path/file details are invalid. Reset details in "
                       "Chart Defaults available from the Chart Select window",
                       "RMX/RMO Compare file");
    return result;
}

CompareResult ComputeRMO(const store::ChartSeries& securityFile,
                         const store::ChartSeries& compareFile, std::int16_t period,
                         std::int16_t firstRecord, int chartBars) {
    CompareResult r;
    r.value.assign(static_cast<std::size_t>(std::max(chartBars, 0)), std::nullopt);
    if (period <= 0) return r;
    const int ns = BarCount(securityFile);
    const int nc = BarCount(compareFile);
    const int entries = std::min(ns, kMaxCompareBars);

    // From the last record of each file back, placed from the end of the entries back. A
    // ratio of 0 (either close 0) is passed over.
    Series<float> ratios(static_cast<std::size_t>(entries));
    for (int c = 0; c < entries && nc - c >= 1; ++c) {
        const float cs = securityFile.ChartBars[static_cast<std::size_t>(ns - 1 - c)].Close;
        const float cc = compareFile.ChartBars[static_cast<std::size_t>(nc - 1 - c)].Close;
        const float ratio = cs != 0 ? Ratio(cc, cs) : 0.0f;
        if (ratio != 0) ratios[static_cast<std::size_t>(entries - 1 - c)] = ratio;
    }
    // Entry e is counted e + 1; the chart shows counts from the first record on.
    const Series<float> values = RingValues(ratios, period);
    for (std::size_t j = 0; j < r.value.size(); ++j) {
        const long e = static_cast<long>(firstRecord) - 1 + static_cast<long>(j);
        if (e >= 0 && e < entries) r.value[j] = values[static_cast<std::size_t>(e)];
    }
    return r;
}

CompareResult ComputeRMX(const store::ChartSeries& chart, const store::ChartSeries& compareFile,
                         std::int16_t period) {
    const int bars = BarCount(chart);
    CompareResult r;
    r.value.assign(static_cast<std::size_t>(bars), std::nullopt);
    if (period <= 0 || bars == 0) return r;
    const int nc = BarCount(compareFile);
    const int start = std::max(nc - (bars - 1), 1);

    // Only a zero close of the chart's bar drops the step; a zero reference goes in as 0.
    Series<float> ratios(static_cast<std::size_t>(bars));
    for (int rec = start; rec <= nc; ++rec) {
        const auto j = static_cast<std::size_t>(rec - start);
        const float close = chart.ChartBars[j].Close;
        if (close == 0) continue;
        ratios[j] = Ratio(compareFile.ChartBars[static_cast<std::size_t>(rec - 1)].Close, close);
    }
    r.value = RingValues(ratios, period);
    return r;
}

} // namespace kori::osc
