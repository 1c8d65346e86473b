#include "app/split_chart.h"

#include "app/chart_service.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <array>

namespace kori::app {

std::optional<SecondChart> ChooseSecondChart(const Session& session, std::string_view codeText,
                                             int periodIndex, platform::Dialogs& dialogs) {
    static constexpr std::array<char, 3> kPeriods = {'A', 'W', 'M'};
    const std::string code = platform::Upper(platform::Trim(codeText));
    platform::Status why;
    const auto found =
        code.empty() ? std::nullopt : store::FindCode(session.folders.DataFolder, code, why);
    if (!why) {
        dialogs.MsgBox(why.message(), "Second Chart");
        return std::nullopt;
    }
    if (!found) {
        dialogs.MsgBox("No record on file for that code", "Second Chart");
        return std::nullopt;
    }
    const std::size_t i = periodIndex >= 0 && periodIndex < 3
                              ? static_cast<std::size_t>(periodIndex)
                              : std::size_t{0};
    return SecondChart{found->Record, kPeriods[i]};
}

void SplitChart::Choose(SecondChart lower, bool chartOnShow) {
    m_lower = std::move(lower);
    m_waiting = !chartOnShow;
}

void SplitChart::End() {
    m_lower.reset();
    m_waiting = false;
}

void SplitChart::AfterNextChart(int delta) {
    if (m_waiting) {
        m_waiting = false;
        return;
    }
    if (delta != 0) End();
}

bool SplitChart::Applies(const chart::ChartRequest& request) const {
    return m_lower.has_value() && !m_waiting && request.ChartStyle != 'P' && request.ChartSlot == 0;
}

void SplitChart::Apply(chart::ChartRequest& request) const {
    const bool on = Applies(request);
    request.SplitMode = on;
    request.SplitHalf = 1;
}

} // namespace kori::app
