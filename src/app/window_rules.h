#pragma once
// The rules behind the settings windows and the logo window: where the logo stands, the
// checks of the small chart-default windows, the swing settings, the scale fields of a name
// record, the oscillator dialog's labels, the point-and-figure box question and the two
// multi-oscillator sets. The windows only show fields and pass them here.
#include "app/session.h"
#include "chart/chart_defaults.h"
#include "chart/swing_method.h"
#include "platform/dialogs.h"
#include "platform/settings_store.h"

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::app {

// The logo window is centred across, and a little above the middle: top is
// (0.97 x screen height) / 2 - window height / 2.
struct ScreenPoint {
    int left = 0;
    int top = 0;
};
ScreenPoint LogoPosition(int screenWidth, int screenHeight, int windowWidth, int windowHeight);

// A message a window shows when a value is refused.
struct Refusal {
    std::string text;
    std::string title;
};
// Shows a refusal through the dialogs; true when there was none.
bool Accept(const std::optional<Refusal>& refusal, platform::Dialogs& dialogs);

// A whole number typed in a box: nullopt for an empty box or one that is no whole number.
std::optional<int> WholeNumber(std::string_view text);
// A number typed in a box ("0.25", "-1", "12"): nullopt unless the whole text is a number.
std::optional<double> TypedNumber(std::string_view text);

// PLW: the printed line width, 1 to 10.
std::optional<Refusal> LineWidthProblem(std::string_view text);
// BlankSpc: chart units left blank at the right of the chart, 0 to 200.
std::optional<Refusal> BlankSpaceProblem(std::string_view text);
// GLSpaces: the vertical grid space (0 turns the date grid off), 0 to 100.
std::optional<Refusal> GridSpaceProblem(std::string_view text);
// StpLs: the stop-loss percentage, 0 to 100.
std::optional<Refusal> StopLossProblem(std::string_view text);
// MMASet: each of the twelve boxes must hold a whole number from 1 to 500.
std::optional<Refusal> MMAProblem(const std::array<std::string, 12>& boxes);

// The chart-default fields of the ChtDef window: the four average periods, 1 to 200.
std::optional<Refusal> AveragePeriodsProblem(const std::array<std::string, 4>& boxes);

// Small windows store one value and the chart is rebuilt; these apply the value the way the
// readers will read it back.
void SetStopLoss(chart::ChartDefaults& d, bool on, float percent);

// The swing settings the swing window edits, kept in [Charts] "SwingMethod" and "SwingValue".
struct SwingSettings {
    chart::SwingMethod SwingMethod = chart::SwingMethod::Norm;
    float SwingValue = 3; // days for "XDay", points for "XPoint"
};
SwingSettings ReadSwingSettings(const platform::IniFile& ini);
void WriteSwingSettings(platform::IniFile& ini, const SwingSettings& s);
// "Incorrect values entered" under "Swing" for a typed value the method refuses.
std::optional<Refusal> SwingValueProblem(chart::SwingMethod method, std::string_view text);

// Scales: the base, top and box value of a name record. Numbers of 0 or more; a base and top
// both set must have the top above the base. Saving writes the record back with ScaleStep
// 0.05, as every change of these fields does.
struct ScaleFields {
    std::string Base, Top, PFIncrement;
};
std::optional<Refusal> ScalesProblem(const ScaleFields& fields);
platform::Status SaveScales(const std::string& dataFolder, int recordNumber,
                            const ScaleFields& fields);

// OscFrm: the label of each period field, by its daily key ("StochK" -> "Period K").
std::string_view OscFieldLabel(std::string_view dailyKey);
// The title of the dialog for an oscillator: its name in lists, else the identifier.
std::string OscDialogTitle(std::string_view oscName);

// The comparison file as a box shows it: a key never set ("unknown") shows empty.
std::string CompareFileText(std::string_view stored);

// The point-and-figure box question of a chart on manual scale. The chart proposes the
// automatic value; the answer is a typed value or "automatic".
struct BoxValueAnswer {
    bool Auto = false;
    float Value = 0;
};
// The box value the chart uses after the question: the automatic value when automatic was
// ticked or the question was dismissed, else the typed value; never below 0.003.
float ResolveBoxValue(const std::optional<BoxValueAnswer>& answer, float autoValue);

// ChtFonts: both fonts and both sizes must be chosen.
std::optional<Refusal> FontsProblem(const FontSettings& fonts);
// Saving the fonts: [Chart Fonts] and the same four keys under [ChartFonts]; the session's
// fonts follow.
void SaveFonts(Session& session, const FontSettings& fonts);

} // namespace kori::app
