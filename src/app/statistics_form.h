#pragma once
// The market statistics window (Statistics, "Top Movers by Percentage") and the advance-decline
// check (ADTotals): the choices, the runs, the grid of the movers and what the user is told.
#include "app/grid_model.h"
#include "app/printed_pages.h"
#include "app/scan_forms.h"
#include "app/session.h"
#include "scan/statistics.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kStatisticsCaption = "Top Movers by Percentage";

class StatisticsForm {
public:
    explicit StatisticsForm(Session& session);

    // The option texts and their filter words, in the window's order.
    static const std::array<std::string, 4>& FilterCaptions();
    static const std::array<std::string, 4>& FilterWords();
    int FilterIndex = 0;
    std::string TopText; // "Top": empty means 20

    // The walk over the name file; false (after the message) when there is none.
    bool Check(platform::Progress& progress);
    // "&Update Statistics": the display again with the "Top" in hand, the walk only when no
    // rows are held yet. False when a needed walk failed.
    bool Update(platform::Progress& progress);
    bool Checked() const { return m_stats.HasRows(); }
    const scan::MarketStatistics& statistics() const { return m_stats; }

    // The grid: a heading row, the rises and falls side by side, a blank row and the five
    // counters; TopCount + 6 rows when the movers fill the blocks.
    GridModel& grid() { return m_grid; }
    // The code of the grid cell (row, column); empty when it holds none.
    std::string CodeAt(int row, int column) const;
    // The printed page: "STATISTICS" and the date above the centred heading, "Page  " below.
    std::vector<PrintedPage> Pages(int linesPerPage, std::string_view todayText) const;

    void SaveChoices();

private:
    void Show();

    Session& m_session;
    ScanChoices m_choices;
    scan::MarketStatistics m_stats;
    GridModel m_grid;
    int m_topCount = 0;
};

class ADTotalsForm {
public:
    explicit ADTotalsForm(Session& session);

    const std::vector<std::string>& codes() const { return m_codes; }
    // Picking a code: its name and the base value from its first record; false (after the
    // message) when its file holds no records.
    bool Pick(const std::string& code);
    const std::string& code() const { return m_code; }
    const std::string& name() const { return m_name; }
    std::string BaseText; // "Base Value" as typed

    // "Check Totals": the file rewritten from the base value; the closing message shown. False
    // when refused or failed.
    bool CheckTotals();
    std::int32_t total() const { return m_total; }

private:
    std::filesystem::path PathOf(const std::string& code) const;

    Session& m_session;
    std::vector<std::string> m_codes;
    std::string m_code, m_name;
    std::int32_t m_total = 0;
};

} // namespace kori::app
