#pragma once
// ChtSel without its widgets: the chart request the selection fills, the choosers' rules, the
// typed code, the scroll bar and spacing wraps, the finish date, and the settings written by
// "SHOW CHART" and "Close". The window shows `form()` and hands every user action here.
#include "app/chart_navigation.h"
#include "app/session.h"
#include "app/split_chart.h"
#include "chart/chart_defaults.h"
#include "chart/chart_request.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

// The chart request and the flags that live as long as the program, shared by ChtSel and Chts.
struct ChartState {
    chart::ChartRequest Request;
    chart::ChartDefaults Defaults;
    bool SettingsLoaded = false; // ChtSel has read the [Charts] keys once
    bool ListChanged = false;    // the list chooser ran: reopen the list on activation
    // Walking one industry class (or group) or one GICS class of the full list.
    bool ClassWalk = false;
    std::string ClassCode;
    bool GicsWalk = false;
    std::string GicsCode;
    // The second chart of a split, chosen in Chart2, and whether the chart window shows it.
    SplitChart Split;
};

// A row of the oscillator chooser; the rows come from the oscillator registry.
struct OscChoice {
    std::string Caption;
    std::string Code; // empty for "(None)"
    bool Slow;
};
// The rows of the oscillator chooser, "(None)" first.
const std::vector<OscChoice>& OscChoices();
int OscChoiceOf(const chart::ChartRequest& r);

inline constexpr std::array<const char*, 4> kStyleCaptions = {"Bar", "Candlestick", "Line",
                                                              "Point & Figure"};
inline constexpr std::array<char, 4> kStyleLetters = {'B', 'C', 'L', 'P'};
inline constexpr std::array<const char*, 4> kPeriodCaptions = {"Daily", "Weekly", "Monthly"};
inline constexpr std::array<char, 3> kPeriodLetters = {'A', 'W', 'M'};
inline constexpr std::array<const char*, 3> kBandCaptions = {"(None)", "Percentage Bands",
                                                             "Bollinger Bands"};
inline constexpr const char* kLatest = "LATEST";
inline constexpr const char* kDateFormatMessage =
    "Date must be entered as d/m/yy eg. 9/4/95 or 29/9/95";

int StyleIndexOf(char style);
int PeriodIndexOf(char period);

// "d/m/yy" (or "d/m/yyyy") to "yyyymmdd"; two-digit years run 1930 to 2029.
std::optional<std::string> ParseFinishDate(std::string_view typed);
// Spacing typed into the field: below 1 becomes 2, above 20 becomes 20; candlesticks at least 3.
int TypedSpacing(int value, char style);

// What the window shows.
struct SelectionForm {
    std::string Code, Name;
    int Position = 0, Count = 0;
    int StyleIndex = 0, PeriodIndex = 0, BandIndex = 0, OscIndex = 0;
    int Spacing = 2;
    std::string SpacingCaption = "Chart Spacing";
    std::string FinishText = kLatest;
    bool VolumeOn = true;
    bool AvOne = false, AvTwo = false;
    int AvOnePeriod = 0, AvTwoPeriod = 0;
    bool ChoosersEnabled = true; // oscillators, bands and averages (off for point and figure)
    std::string ListCaption = kFullListCaption;
};

class ChartSelection {
public:
    ChartSelection(Session& session, ChartState& state);

    // First load of the window. False (after the invalid-path message) when the data folder
    // cannot be read.
    bool Load();
    // Activation: after the list chooser ran, reopen the list and go to position 1.
    void Activate();

    // Enter in the code field. True when the code was found and "SHOW CHART" is to be pressed.
    bool TypeCode(std::string_view typed);
    // The scroll bar moved to `value`; beyond the count wraps to 1 with a beep.
    void ScrollTo(int value);
    // The up-down control: one step with the wraps 0 -> 10 and 11 -> 1.
    void StepSpacing(int delta);
    void TypeSpacingValue(int value);

    void ChooseStyle(int index);
    void ChoosePeriod(int index);
    void ChooseOscillator(int index);
    // The band chooser. Bands 1 and 2 want the two values of ChtBands; `values` is nullopt
    // when the window was cancelled (the choice then stands with the record's values).
    // False, with "Values must be between 0 - 100", when a value is out of range.
    bool ChooseBands(int index, std::optional<std::pair<int, int>> values);
    void SetAverage(int which, bool on);
    void SetVolume(bool on);

    // A click on the finish date field: true when FinDate is to open; otherwise it resets to
    // "LATEST". Nothing happens on point and figure.
    bool FinishDateClicked();
    // FinDate's answer: nullopt cancels (back to "LATEST"); a bad date shows the date message
    // and returns false.
    bool SetFinishDate(std::optional<std::string> typed);

    // The "Industry Class" (gics false) or "GICS" box: ticking clears the code and rules out
    // the other walk; unticking ends the walk.
    void SetClassWalk(bool gics, bool on);
    // A class code for the walk, as picked: an unknown or empty one shows "Industry
    // Classification invalid" ("GICS Classification invalid") and ends the walk. A good one
    // starts the walk from position 1. True when a record of the class is shown.
    bool SetClassCode(bool gics, std::string_view code);
    // `FindNextICRec` / `FindNextGICSRec`: the next record of the class after `ListPosition`.
    bool FindNextClass();

    // "SHOW CHART": stores the choices in the request, writes the settings, and lowers the
    // position by one for the chart window's next-chart command.
    void ShowChart();
    // "Close": writes the settings that hold a valid value.
    void Close();
    // "Change List": the chooser's pick.
    void ChangeList(int listMode, std::string listName);
    // "Change Folder" changed the folder: back to the full list and a fresh load.
    void FolderChanged();

    const SelectionForm& form() const { return m_form; }
    ChartWalk& walk() { return m_walk; }
    ChartState& state() { return m_state; }
    // The record on show, if any.
    std::optional<store::NameRecord> Current() const { return m_walk.RecordAt(m_form.Position); }

private:
    void ShowRecord(int position);
    void ApplyStyleRule(const store::NameRecord& r);
    void ShowAverages();
    void ForceSpacing();
    void WriteSettings();

    Session& m_session;
    ChartState& m_state;
    ChartWalk m_walk;
    SelectionForm m_form;
};

} // namespace kori::app

namespace kori::app {
// The Search window's walk: the first position after `afterPosition` whose code or name holds
// `text` (any case); 0 when the walk ends with no match.
int FindNextMatch(const std::vector<store::NameRecord>& names, int afterPosition,
                  std::string_view text);
} // namespace kori::app
