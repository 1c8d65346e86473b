#include "osc/osc_settings.h"

#include "osc/osc_identifiers.h"
#include "platform/files.h"
#include "platform/text.h"

#include <array>
#include <cmath>
#include <cstdlib>

namespace kori::osc {

namespace {

using D = OscDef;

constexpr OscPeriodKey kPeriodKeys[] = {
    {"StochK", "StochKW", &D::StochK, &D::StochKW, 10, 10, 1, 200, true},
    {"StochD", "StochDW", &D::StochD, &D::StochDW, 5, 5, 0, 200, true},
    {"FXF", "FXFW", &D::FXF, &D::FXFW, 50, 50, 1, 200, true},
    {"FXX", "FXXW", &D::FXX, &D::FXXW, 25, 25, 0, 200, true},
    {"RocP", "RocPW", &D::RocP, &D::RocPW, 21, 21, 1, 200, true},
    {"RocA", "RocAW", &D::RocA, &D::RocAW, 10, 10, 0, 0, false},
    {"RsiP", "RsiPW", &D::RsiP, &D::RsiPW, 14, 14, 1, 200, true},
    {"RmoP", "RmoPW", &D::RmoP, &D::RmoPW, 30, 30, 1, 200, true},
    {"RmoA", "RmoAW", &D::RmoA, &D::RmoAW, 10, 10, 0, 0, false},
    {"RmxP", "RmxPW", &D::RmxP, &D::RmxPW, 100, 50, 1, 200, true},
    {"RmxA", "RmxAW", &D::RmxA, &D::RmxAW, 20, 20, 0, 0, false},
    {"Md1", "Md1W", &D::Md1, &D::Md1W, 12, 12, 1, 200, true},
    {"Md2", "Md2W", &D::Md2, &D::Md2W, 26, 26, 1, 200, true},
    {"Md3", "Md3W", &D::Md3, &D::Md3W, 9, 9, 1, 200, true},
    {"WmsA", "WmsW", &D::WmsA, &D::WmsW, 7, 7, 1, 200, true},
    {"ERA", "ERW", &D::ERA, &D::ERW, 14, 14, 1, 200, true},
    {"DMA", "DMW", &D::DMA, &D::DMW, 14, 14, 1, 200, true},
    {"DMXA", "DMXW", &D::DMXA, &D::DMXW, 14, 14, 0, 0, false},
    {"MMA", "MMW", &D::MMA, &D::MMW, 14, 14, 1, 200, true},
    {"CopD", "CopW", &D::CopD, &D::CopW, 14, 14, 1, 200, true},
    {"HolyD", "HolyW", &D::HolyD, &D::HolyW, 50, 50, 1, 200, true},
    {"VtyD", "VtyW", &D::VtyD, &D::VtyW, 3, 3, 1, 200, true},
    {"AtrD", "AtrW", &D::AtrD, &D::AtrW, 0, 0, 1, 200, true},
    {"BBA", "BBW", &D::BBA, &D::BBW, 21, 21, 1, 100, false},
};

std::int16_t ReadPeriod(const platform::IniFile& ini, std::string_view key) {
    const double v = std::nearbyint(platform::Val(ini.Read(kOscDefSection, key)));
    // A number a 16-bit setting cannot hold counts as not set.
    if (v < -32768.0 || v > 32767.0) return 0;
    return static_cast<std::int16_t>(v);
}

bool ReadBool(const platform::IniFile& ini, std::string_view key) {
    const std::string t = platform::Trim(ini.Read(kOscDefSection, key));
    if (platform::EqualsNoCase(t, "true")) return true;
    if (platform::EqualsNoCase(t, "false") || t == platform::kUnknown) return false;
    return platform::Val(t) != 0;
}

std::string ReadText(const platform::IniFile& ini, std::string_view key) {
    return ini.Read(kOscDefSection, key);
}

bool WeeklyColumn(std::string_view chartPeriod) {
    return platform::Trim(chartPeriod) != "A";
}

// A negative period fails even on a key without a range test: no routine can count back a
// negative number of bars.
bool InRange(const OscPeriodKey& k, std::int16_t v) {
    if (v < 0) return false;
    return !k.Tested || (v >= k.Min && v <= k.Max);
}

// The first key of the oscillator whose value is out of range, if any.
const OscPeriodKey* FirstFailingKey(const OscDef& def, std::string_view oscName, bool weekly,
                                    bool rmxDailyOnly) {
    for (std::string_view name : OscSettingKeys(oscName)) {
        const OscPeriodKey* k = FindOscPeriodKey(name);
        if (k == nullptr) continue;
        const bool useWeekly = weekly && !(rmxDailyOnly && name == "RmxP");
        const std::int16_t v = def.*(useWeekly ? k->WeeklyField : k->DailyField);
        if (!InRange(*k, v)) return k;
    }
    return nullptr;
}

std::optional<OscMessage> NotValid(std::string_view oscName) {
    return OscMessage{std::string(oscName) + " Oscillator values not valid", "Oscillator Values"};
}

bool UsesCompareFile(std::string_view oscName) {
    return oscName == "RMO" || oscName == "RMX";
}

std::optional<OscMessage> CompareFileProblem(const OscDef& def) {
    if (platform::FileExists(platform::ResolvePath(platform::NormalisePath(def.CompFile))))
        return std::nullopt;
    return OscMessage{CompareFileCode(def.CompFile) +
                          " is not available. Use your code for the All Ordinaries Index",
                      "RMX Compare "};
}

} // namespace

std::span<const OscPeriodKey> OscPeriodKeys() {
    return kPeriodKeys;
}

const OscPeriodKey* FindOscPeriodKey(std::string_view dailyKey) {
    for (const auto& k : OscPeriodKeys())
        if (platform::EqualsNoCase(k.Daily, dailyKey)) return &k;
    return nullptr;
}

const OscPeriodKey* FindOscPeriodKeyByName(std::string_view key) {
    const std::string k = platform::Trim(key);
    for (const auto& p : OscPeriodKeys())
        if (p.Daily == k || p.Weekly == k) return &p;
    return nullptr;
}

std::span<const std::string_view> OscSettingKeys(std::string_view oscName) {
    const OscIdentifier* id = FindOscIdentifier(oscName);
    return id == nullptr ? std::span<const std::string_view>{} : id->PeriodKeys();
}

OscDef ReadOscSettings(const platform::IniFile& ini) {
    OscDef def;
    for (const auto& k : OscPeriodKeys()) {
        def.*k.DailyField = ReadPeriod(ini, k.Daily);
        def.*k.WeeklyField = ReadPeriod(ini, k.Weekly);
    }
    def.CompFile = platform::Trim(ReadText(ini, "CompFile"));
    def.ShowOsc = ReadText(ini, "ShowOsc");
    def.FXRev = ReadBool(ini, "FXRev");
    def.FillIn = ReadBool(ini, "FillIn");
    def.RFAve = ReadBool(ini, "RFAve");
    def.NoClassicMACD = ReadBool(ini, "NoClassicMACD");
    def.MMASet = ReadText(ini, "MMASet");
    def.BCCalTp = ReadText(ini, "BCCalTp");
    def.LCalTp = ReadText(ini, "LCalTp");
    def.VCalTp = ReadText(ini, "VCalTp");
    def.CutVols = ReadText(ini, "CutVols");
    return def;
}

bool WriteOscSettings(platform::IniFile& ini, const OscDef& def) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    bool ok = true;
    auto put = [&](std::string_view key, std::string_view value) {
        ok = ini.Write(kOscDefSection, key, value) && ok;
    };
    auto flag = [](bool b) { return b ? "True" : "False"; };
    for (const auto& k : OscPeriodKeys()) {
        put(k.Daily, std::to_string(def.*k.DailyField));
        put(k.Weekly, std::to_string(def.*k.WeeklyField));
    }
    put("CompFile", def.CompFile);
    put("ShowOsc", def.ShowOsc);
    put("FXRev", flag(def.FXRev));
    put("FillIn", flag(def.FillIn));
    put("RFAve", flag(def.RFAve));
    put("NoClassicMACD", flag(def.NoClassicMACD));
    put("MMASet", def.MMASet);
    put("BCCalTp", def.BCCalTp);
    put("LCalTp", def.LCalTp);
    put("VCalTp", def.VCalTp);
    put("CutVols", def.CutVols);
    return once.Commit() && ok;
}

void FillOscDefaults(OscDef& def, std::string_view oscName, bool weekly) {
    for (std::string_view name : OscSettingKeys(oscName)) {
        const OscPeriodKey* k = FindOscPeriodKey(name);
        if (k == nullptr) continue;
        std::int16_t& v = def.*(weekly ? k->WeeklyField : k->DailyField);
        if (v == 0) v = weekly ? k->DefaultWeekly : k->DefaultDaily;
    }
}

std::int16_t BollingerPeriod(const OscDef& def, bool weekly) {
    const std::int16_t v = weekly ? def.BBW : def.BBA;
    return (v < 1 || v > 100) ? std::int16_t{21} : v;
}

std::string CompareFileCode(std::string_view compFile) {
    std::string name = platform::Trim(compFile);
    const auto slash = name.find_last_of("/\\");
    if (slash != std::string::npos) name.erase(0, slash + 1);
    const auto dot = name.find_last_of('.');
    if (dot != std::string::npos) name.erase(dot);
    return platform::Upper(name);
}

std::optional<OscMessage> OscSettingsProblem(const OscDef& def, std::string_view oscName,
                                             std::string_view chartPeriod,
                                             std::string_view targetName, bool compareFile) {
    if (platform::Upper(targetName) != "CHTS") return std::nullopt;
    if (FirstFailingKey(def, oscName, WeeklyColumn(chartPeriod), true) != nullptr)
        return NotValid(oscName);
    if (compareFile && UsesCompareFile(oscName)) return CompareFileProblem(def);
    return std::nullopt;
}

std::optional<OscMessage> NegativePeriodProblem(const OscDef& def, std::string_view oscName,
                                                std::string_view chartPeriod) {
    const bool weekly = WeeklyColumn(chartPeriod);
    for (std::string_view name : OscSettingKeys(oscName)) {
        const OscPeriodKey* k = FindOscPeriodKey(name);
        if (k != nullptr && def.*(weekly ? k->WeeklyField : k->DailyField) < 0)
            return NotValid(oscName);
    }
    return std::nullopt;
}

bool CheckOscSettings(const OscDef& def, std::string_view oscName, std::string_view chartPeriod,
                      std::string_view targetName, platform::Dialogs& dialogs, bool compareFile) {
    const auto problem = OscSettingsProblem(def, oscName, chartPeriod, targetName, compareFile);
    if (!problem) return true;
    dialogs.MsgBox(problem->text, problem->title);
    return false;
}

std::optional<OscMessage> OscFormProblem(const OscDef& def, std::string_view oscName, bool weekly) {
    if (FirstFailingKey(def, oscName, weekly, false) != nullptr)
        return OscMessage{" Periods must be between 1 - 200 ", "Oscillator Values"};
    if (!UsesCompareFile(oscName)) return std::nullopt;
    if (platform::Trim(def.CompFile).empty())
        return OscMessage{"Compare file code must be entered", std::string(oscName)};
    return CompareFileProblem(def);
}

std::optional<OscMessage> BoxValueProblem(std::string_view text) {
    const std::string t = platform::Trim(text);
    if (t.empty() || platform::Val(t) == 0)
        return OscMessage{"Box value must have a value. eg 0.20", "Box Value"};
    char* end = nullptr;
    (void)std::strtod(t.c_str(), &end);
    if (end != t.c_str() + t.size())
        return OscMessage{"Box value must be numeric eg 0.20", "Box Value"};
    return std::nullopt;
}

} // namespace kori::osc
