#include "app/statistics_form.h"

#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <algorithm>

namespace kori::app {

namespace {

using platform::Trim;

constexpr int kLeft = 0, kRight = 6; // first columns of the two blocks

std::string PercentText(double percent) {
    return platform::Format(percent, "0.00 %");
}

} // namespace

StatisticsForm::StatisticsForm(Session& session)
    : m_session(session), m_choices(session.services().settings, "Statistics_Other"),
      m_grid({"Code", "Name", "Previous", "Latest", "+%", "Class", "Code", "Name", "Previous",
              "Latest", "-%"}) {
    FilterIndex = m_choices.Index("Filter", 4);
    TopText = m_choices.Text("Top", "20");
}

const std::array<std::string, 4>& StatisticsForm::FilterCaptions() {
    static const std::array<std::string, 4> captions = {
        "Check ALL stocks", "Check only FP shares", "Do NOT check Warrants", "Check Warrants only"};
    return captions;
}

const std::array<std::string, 4>& StatisticsForm::FilterWords() {
    static const std::array<std::string, 4> words = {"ALL", "3", "NW", "WO"};
    return words;
}

void StatisticsForm::SaveChoices() {
    m_choices.Put("Filter", FilterIndex);
    m_choices.Put("Top", TopText);
}

bool StatisticsForm::Check(platform::Progress& progress) {
    SaveChoices();
    const auto& word = FilterWords()[static_cast<std::size_t>(std::clamp(FilterIndex, 0, 3))];
    if (auto s = m_stats.Check(m_session.folders.DataFolder, word, progress); !s) {
        m_session.dialogs().MsgBox(s.message(), scan::kStatisticsTitle);
        m_grid.LoadInForm({});
        return false;
    }
    Show();
    return true;
}

bool StatisticsForm::Update(platform::Progress& progress) {
    if (!m_stats.HasRows()) return Check(progress);
    SaveChoices();
    Show();
    return true;
}

void StatisticsForm::Show() {
    const auto d = m_stats.Display(TopText);
    m_topCount = d.TopCount;
    const auto width = static_cast<std::size_t>(m_grid.columnCount());
    std::vector<GridModel::Row> rows;
    rows.reserve(static_cast<std::size_t>(d.TopCount) + 6);
    GridModel::Row head(width);
    head[kLeft + 1] = "RISES";
    head[kRight + 1] = "FALLS";
    rows.push_back(std::move(head));
    for (int i = 0; i < d.TopCount; ++i) {
        GridModel::Row row(width);
        auto put = [&row](std::size_t at, const scan::MoverRow& m) {
            row[at] = Trim(m.Code);
            row[at + 1] = Trim(m.Name);
            row[at + 2] = m.Previous;
            row[at + 3] = m.Latest;
            row[at + 4] = PercentText(m.Percent);
        };
        put(kLeft, d.Rises[static_cast<std::size_t>(i)]);
        put(kRight, d.Falls[static_cast<std::size_t>(i)]);
        rows.push_back(std::move(row));
    }
    const auto& c = m_stats.Counters();
    const std::pair<const char*, std::int32_t> counters[] = {{"Rises", c.Rises},
                                                             {"Falls", c.Falls},
                                                             {"Steady", c.Steady},
                                                             {"Traded", c.Traded},
                                                             {"Untraded", c.Untraded}};
    for (const auto& [label, count] : counters) {
        GridModel::Row row(width);
        row[kLeft + 1] = label;
        row[kLeft + 2] = std::to_string(count);
        rows.push_back(std::move(row));
    }
    m_grid.LoadInForm(std::move(rows));
}

std::string StatisticsForm::CodeAt(int row, int column) const {
    if (row < 1 || row > m_topCount || column < 0 || column >= m_grid.columnCount()) return {};
    return m_grid.cell(row, column < kRight ? kLeft : kRight);
}

std::vector<PrintedPage> StatisticsForm::Pages(int linesPerPage, std::string_view todayText) const {
    const PrintedColumns columns{{7, 26, 9, 9, 10, 6, 7, 26, 9, 9, 10}};
    std::vector<std::string> body;
    for (const auto& row : m_grid.rows())
        body.push_back(columns.Line(row));
    const std::string heads = columns.Line(m_grid.headers());
    const std::string date = platform::FormatDate(todayText, "Medium Date");
    auto pages = PaginateLines(
        body, linesPerPage,
        [&](int) {
            return std::vector<PrintedLine>{
                {"STATISTICS"}, {date}, {kStatisticsCaption, true, true, true}, {""}, {heads}};
        },
        [](int page) { return "Page  " + std::to_string(page); });
    for (auto& p : pages)
        p.TabStops = columns.Stops();
    return pages;
}

// ---- ADTotals ----

ADTotalsForm::ADTotalsForm(Session& session)
    : m_session(session), m_codes(scan::AdvanceDeclineCodes(session.folders.DataFolder)) {
    for (auto& c : m_codes)
        c = Trim(c);
}

std::filesystem::path ADTotalsForm::PathOf(const std::string& code) const {
    return store::PriceFile::PathFor(m_session.folders.DataFolder, code);
}

bool ADTotalsForm::Pick(const std::string& code) {
    m_code.clear();
    m_name.clear();
    BaseText.clear();
    platform::Status why;
    const auto found = store::FindCode(m_session.folders.DataFolder, code, why);
    if (!found) {
        m_session.dialogs().MsgBox(why ? "No File For That Name: " + Trim(code) : why.message(),
                                   scan::kADTitle);
        return false;
    }
    m_name = Trim(found->Record.Name);
    double base = 0;
    if (auto s = scan::ADBaseValue(PathOf(found->Record.Code), base); !s) {
        m_session.dialogs().MsgBox(s.message(), scan::kADTitle);
        return false;
    }
    m_code = Trim(found->Record.Code);
    BaseText = Trim(platform::Str(base));
    return true;
}

bool ADTotalsForm::CheckTotals() {
    if (m_code.empty()) {
        m_session.dialogs().MsgBox("Pick an advance-decline code from the list first",
                                   scan::kADTitle);
        return false;
    }
    if (!scan::IsNumericText(BaseText)) {
        m_session.dialogs().MsgBox("Base Value must be numeric", "Base Value");
        return false;
    }
    const auto path = PathOf(m_code);
    if (auto s = scan::CheckADTotals(path, platform::Val(BaseText), m_total); !s) {
        m_session.dialogs().MsgBox(s.message(), scan::kADTitle);
        return false;
    }
    m_session.dialogs().MsgBox(scan::ADCheckedMessage(path, m_total), scan::kADTitle);
    return true;
}

} // namespace kori::app
