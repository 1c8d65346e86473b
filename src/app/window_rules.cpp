#include "app/window_rules.h"

#include "osc/osc_identifiers.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <cmath>
#include <cstdlib>
#include <limits>

namespace kori::app {

using platform::Trim;

namespace {

std::optional<Refusal> RangeProblem(std::string_view text, int low, int high, Refusal refusal) {
    const auto v = WholeNumber(text);
    if (!v || *v < low || *v > high) return refusal;
    return std::nullopt;
}

} // namespace

ScreenPoint LogoPosition(int screenWidth, int screenHeight, int windowWidth, int windowHeight) {
    const double top = 0.97 * screenHeight / 2.0 - windowHeight / 2.0;
    return {(screenWidth - windowWidth) / 2, static_cast<int>(std::lround(top))};
}

bool Accept(const std::optional<Refusal>& refusal, platform::Dialogs& dialogs) {
    if (!refusal) return true;
    dialogs.MsgBox(refusal->text, refusal->title, platform::Buttons::Ok,
                   platform::Icon::Exclamation);
    return false;
}

std::optional<double> TypedNumber(std::string_view text) {
    const std::string t = Trim(text);
    if (t.empty()) return std::nullopt;
    char* end = nullptr;
    const double v = std::strtod(t.c_str(), &end);
    if (end != t.c_str() + t.size() || !std::isfinite(v)) return std::nullopt;
    return v;
}

std::optional<int> WholeNumber(std::string_view text) {
    const auto v = TypedNumber(text);
    if (!v || *v != std::floor(*v) || std::fabs(*v) > std::numeric_limits<int>::max())
        return std::nullopt;
    return static_cast<int>(*v);
}

std::optional<Refusal> LineWidthProblem(std::string_view text) {
    return RangeProblem(text, 1, 10, {"Line width must be between 1 and 10", "Line Width"});
}

std::optional<Refusal> BlankSpaceProblem(std::string_view text) {
    return RangeProblem(text, 0, 200, {"Blank space must be between 0 and 200", "Blank Space"});
}

std::optional<Refusal> GridSpaceProblem(std::string_view text) {
    return RangeProblem(text, 0, 100,
                        {"Grid line space must be between 0 and 100", "Grid Line Spaces"});
}

std::optional<Refusal> StopLossProblem(std::string_view text) {
    const auto v = TypedNumber(text);
    if (!v || *v < 0 || *v > 100)
        return Refusal{"Invalid value - must be between 0 and 100", "Stop Loss"};
    return std::nullopt;
}

std::optional<Refusal> MMAProblem(const std::array<std::string, 12>& boxes) {
    for (const auto& b : boxes) {
        const auto v = WholeNumber(b);
        if (!v || *v < 1 || *v > 500)
            return Refusal{"Each average must be a number from 1 to 500", "MMA Settings"};
    }
    return std::nullopt;
}

std::optional<Refusal> AveragePeriodsProblem(const std::array<std::string, 4>& boxes) {
    for (const auto& b : boxes) {
        const auto v = WholeNumber(b);
        if (!v || *v < 1 || *v > 200)
            return Refusal{"Average periods must be between 1 - 200", "Chart Defaults"};
    }
    return std::nullopt;
}

void SetStopLoss(chart::ChartDefaults& d, bool on, float percent) {
    d.StopLossOn = on;
    d.StopPercent = percent;
    d.StopPercentOn = percent > 0;
}

SwingSettings ReadSwingSettings(const platform::IniFile& ini) {
    SwingSettings s;
    s.SwingMethod = chart::ParseSwingMethod(ini.Read("Charts", "SwingMethod"))
                        .value_or(chart::SwingMethod::Norm);
    const std::string value = Trim(ini.Read("Charts", "SwingValue"));
    const float v = static_cast<float>(platform::Val(value));
    s.SwingValue = chart::SwingValueOf(s.SwingMethod, value == platform::kUnknown ? 0.0f : v);
    return s;
}

void WriteSwingSettings(platform::IniFile& ini, const SwingSettings& s) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    (void)ini.Write("Charts", "SwingMethod", chart::SwingMethodName(s.SwingMethod));
    (void)ini.Write("Charts", "SwingValue", platform::FloatText(s.SwingValue));
}

std::optional<Refusal> SwingValueProblem(chart::SwingMethod method, std::string_view text) {
    if (!chart::SwingMethodTakesValue(method)) return std::nullopt; // no value is used
    const auto v = TypedNumber(text);
    if (v && chart::SwingValueValid(method, static_cast<float>(*v))) return std::nullopt;
    return Refusal{std::string(chart::kSwingRefusal), std::string(chart::kSwingTitle)};
}

std::optional<Refusal> ScalesProblem(const ScaleFields& fields) {
    const Refusal notNumber{"Scale values must be numbers of 0 or more", "Change Scales"};
    double v[3] = {};
    const std::string* boxes[3] = {&fields.Base, &fields.Top, &fields.PFIncrement};
    for (int i = 0; i < 3; ++i) {
        const std::string t = Trim(*boxes[i]);
        const auto n = t.empty() ? std::optional<double>(0.0) : TypedNumber(t);
        if (!n || *n < 0) return notNumber;
        v[i] = *n;
    }
    if (v[0] > 0 && v[1] > 0 && v[1] <= v[0])
        return Refusal{"The chart top must be above the chart base", "Change Scales"};
    return std::nullopt;
}

platform::Status SaveScales(const std::string& dataFolder, int recordNumber,
                            const ScaleFields& fields) {
    if (auto problem = ScalesProblem(fields)) return platform::Status::Error(problem->text);
    store::NameFile names(store::NameFile::PathIn(dataFolder));
    if (auto s = names.Open(); !s) return s;
    store::NameRecord r;
    if (auto s = names.Read(recordNumber, r); !s) return s;
    auto number = [](const std::string& t) {
        return static_cast<float>(TypedNumber(t).value_or(0.0));
    };
    r.Base = number(fields.Base);
    r.Top = number(fields.Top);
    r.PFIncrement = number(fields.PFIncrement);
    r.ScaleStep = 0.05f;
    return names.Write(recordNumber, r);
}

std::string_view OscFieldLabel(std::string_view dailyKey) {
    struct Label {
        std::string_view key, label;
    };
    static constexpr Label labels[] = {
        {"StochK", "Period K"}, {"StochD", "Period D"},  {"FXF", "Period F"},
        {"FXX", "Period X"},    {"RmxP", "Period RMX"},  {"RmxA", "RMX Ave"},
        {"RmoP", "Period RMO"}, {"RmoA", "RMO Ave"},     {"RocP", "Period ROC"},
        {"RocA", "ROC Ave"},    {"RsiP", "RSI period"},  {"Md1", "EMA 1"},
        {"Md2", "EMA 2"},       {"Md3", "EMA 3 signal"}, {"DMA", "Period "},
        {"DMXA", "AveDX"}};
    for (const auto& l : labels)
        if (l.key == dailyKey) return l.label;
    return "Period";
}

std::string OscDialogTitle(std::string_view oscName) {
    const auto* id = osc::FindOscIdentifier(oscName);
    if (id && !id->ListName.empty()) return std::string(id->ListName);
    return std::string(oscName);
}

std::string CompareFileText(std::string_view stored) {
    const std::string t = Trim(stored);
    return t == platform::kUnknown ? std::string() : t;
}

float ResolveBoxValue(const std::optional<BoxValueAnswer>& answer, float autoValue) {
    float v = (!answer || answer->Auto) ? autoValue : answer->Value;
    if (!(v >= 0.003f)) v = 0.003f;
    return v;
}

std::optional<Refusal> FontsProblem(const FontSettings& fonts) {
    for (const auto* t : {&fonts.CFont, &fonts.CFontSize, &fonts.SFont, &fonts.SFontSize}) {
        const std::string v = Trim(*t);
        if (v.empty() || v == platform::kUnknown)
            return Refusal{"Fonts and sizes must be selected for both", "Font Selection"};
    }
    if (!(platform::Val(fonts.CFontSize) > 0) || !(platform::Val(fonts.SFontSize) > 0))
        return Refusal{"Fonts and sizes must be selected for both", "Font Selection"};
    return std::nullopt;
}

void SaveFonts(Session& session, const FontSettings& fonts) {
    WriteFontSettings(session.ini(), fonts, "Chart Fonts");
    WriteFontSettings(session.ini(), fonts, "ChartFonts");
    session.fontSettings = fonts;
    session.fonts = fonts.ToChartFonts();
}

} // namespace kori::app
