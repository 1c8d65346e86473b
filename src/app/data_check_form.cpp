#include "app/data_check_form.h"

#include "platform/date_text.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/chart_list.h"

namespace kori::app {

namespace {

// A whole number from `low` to `high` as typed, or nullopt.
std::optional<double> TypedNumber(const std::string& text, double low, double high, bool whole) {
    const std::string t = platform::Trim(text);
    if (t.empty() || t.find_first_not_of("0123456789.") != std::string::npos) return std::nullopt;
    const double v = platform::Val(t);
    if (v < low || v > high || (whole && v != static_cast<double>(static_cast<long long>(v))))
        return std::nullopt;
    return v;
}

} // namespace

DataCheckForm::DataCheckForm(Session& session) : m_session(session) {
    m_captions.push_back("Full List (Names.Dat)");
    for (auto& c : store::ListChoices(session.services().settings, true))
        m_captions.push_back(std::move(c));
    const auto s = maint::LoadDataCheckSettings(session.services().settings);
    GapText = std::to_string(s.GapWeekdays);
    StoppedText = std::to_string(s.StoppedWeekdays);
    MoveText = platform::Format(s.MoveAlertPercent, "0.##");
}

std::optional<maint::DataCheckSettings> DataCheckForm::Typed() const {
    const auto gap = TypedNumber(GapText, 1, 9999, true);
    const auto stopped = TypedNumber(StoppedText, 1, 9999, true);
    const auto move = TypedNumber(MoveText, 1, 10000, false);
    if (!gap || !stopped || !move) return std::nullopt;
    return maint::DataCheckSettings{static_cast<int>(*gap), static_cast<int>(*stopped), *move};
}

std::optional<std::string> DataCheckForm::Refusal() const {
    if (!TypedNumber(GapText, 1, 9999, true))
        return "The gap must be a whole number of weekdays from 1 to 9999";
    if (!TypedNumber(StoppedText, 1, 9999, true))
        return "Stopped trading must be a whole number of weekdays from 1 to 9999";
    if (!TypedNumber(MoveText, 1, 10000, false))
        return "The overnight move must be a per cent from 1 to 10000";
    return std::nullopt;
}

store::SecurityList DataCheckForm::List() const {
    return {m_session.folders.DataFolder,
            ListIndex <= 0 ? '\0' : store::ListLetterOfMode(store::ModeOfChoice(ListIndex - 1))};
}

maint::DataCheckResult DataCheckForm::Run(platform::Progress& progress) {
    const auto settings = Typed().value_or(maint::DataCheckSettings{});
    maint::SaveDataCheckSettings(m_session.services().settings, settings);
    return maint::CheckLibrary(List(), settings, progress);
}

std::string DataCheckForm::Summary(const maint::DataCheckResult& result) {
    std::string text = std::to_string(result.Checked) +
                       (result.Checked == 1 ? " security checked: " : " securities checked: ") +
                       std::to_string(result.Findings.size()) +
                       (result.Findings.size() == 1 ? " finding" : " findings");
    if (result.Cancelled) text += " (cancelled before the end of the list)";
    return text;
}

GridModel DataCheckForm::Report(const std::vector<maint::Finding>& findings) {
    GridModel grid({"Code", "Name", "Date", "Record", "Finding", "Detail"});
    std::vector<GridModel::Row> rows;
    rows.reserve(findings.size());
    for (const auto& f : findings)
        rows.push_back(
            {f.Code, f.Name,
             platform::IsValidDateText(f.Date) ? platform::DateTextToDisplay(f.Date) : f.Date,
             f.Record > 0 ? std::to_string(f.Record) : "", f.What, f.Detail});
    grid.Load(std::move(rows));
    return grid;
}

} // namespace kori::app
