#pragma once
// The data check window (ChkDta) and its report (DataStat): which securities to check, the
// three limits as typed, the run, and the report's rows.
#include "app/grid_model.h"
#include "app/session.h"
#include "maint/data_check.h"

#include <optional>
#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kDataCheckTitle = "Data Check";

class DataCheckForm {
public:
    explicit DataCheckForm(Session& session);

    // "Full List (Names.Dat)", then the chart lists by their names and the scan list Z.
    const std::vector<std::string>& listCaptions() const { return m_captions; }
    int ListIndex = 0;
    std::string GapText, StoppedText, MoveText; // as typed, first from the window store

    // The limits as typed, or the message of the first that is refused.
    std::optional<std::string> Refusal() const;
    // Keeps the limits for the next check and walks the list. Call after Refusal() is empty.
    maint::DataCheckResult Run(platform::Progress& progress);
    store::SecurityList List() const;

    // "42 securities checked: 3 findings" (and the cancel, when there was one).
    static std::string Summary(const maint::DataCheckResult& result);
    // The report's grid: Code, Name, Date (d/m/yyyy), Record, Finding, Detail.
    static GridModel Report(const std::vector<maint::Finding>& findings);

private:
    std::optional<maint::DataCheckSettings> Typed() const;

    Session& m_session;
    std::vector<std::string> m_captions;
};

} // namespace kori::app
