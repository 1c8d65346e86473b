#pragma once
// The two text export windows: TextData (closing prices of a day for a list) and TextFull (the
// records of one security or a list over a date range, as CSV or day files). What the user
// typed, its checks, and the export with the line the window shows afterwards.
#include "app/session.h"
#include "platform/progress.h"

#include <optional>
#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kTextExportTitle = "Text Export";

// "Full List (Names.Dat)", then the chart lists by their names and the scan list Z; and the
// walk of a choice.
std::vector<std::string> ExportListCaptions(Session& session);
char ExportListLetter(int index);

// A typed date, d/m/yy or d/m/yyyy; blank gives "". Nullopt when it is not a date.
std::optional<std::string> TypedExportDate(const std::string& typed);

struct ExportOutcome {
    bool Ok = false;
    std::string Message; // the refusal, or what was written where
};

struct ClosesForm {
    int ListIndex = 0;
    std::string DateText; // blank: the latest day
    std::string File;
    ExportOutcome Run(Session& session, platform::Progress& progress) const;
};

struct DataForm {
    bool OneSecurity = true;
    std::string Code;
    int ListIndex = 0;
    std::string FromText, ToText;
    bool DayFiles = false; // else CSV
    std::string Output;    // the CSV file, or the folder of the day files
    ExportOutcome Run(Session& session, platform::Progress& progress) const;
};

} // namespace kori::app
