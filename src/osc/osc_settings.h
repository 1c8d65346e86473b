#pragma once
// The oscillator settings of Kori.ini section OscDef: one 16-bit period a key (daily and
// weekly columns), the comparison file of RMO and RMX and a few switches. A key that is absent
// reads "unknown", whose value is 0, so a period of 0 means "not set".
#include "platform/dialogs.h"
#include "platform/ini_file.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace kori::osc {

inline constexpr std::string_view kOscDefSection = "OscDef";

struct OscDef {
    std::int16_t StochK = 0, StochKW = 0, StochD = 0, StochDW = 0;
    std::int16_t FXF = 0, FXFW = 0, FXX = 0, FXXW = 0;
    std::int16_t RocP = 0, RocPW = 0, RocA = 0, RocAW = 0;
    std::int16_t RsiP = 0, RsiPW = 0;
    std::int16_t RmoP = 0, RmoPW = 0, RmoA = 0, RmoAW = 0;
    std::int16_t RmxP = 0, RmxPW = 0, RmxA = 0, RmxAW = 0;
    std::int16_t Md1 = 0, Md2 = 0, Md3 = 0, Md1W = 0, Md2W = 0, Md3W = 0;
    std::int16_t WmsA = 0, WmsW = 0;
    std::int16_t ERA = 0, ERW = 0;
    std::int16_t DMA = 0, DMW = 0, DMXA = 0, DMXW = 0;
    std::int16_t MMA = 0, MMW = 0;
    std::int16_t CopD = 0, CopW = 0;
    std::int16_t HolyD = 0, HolyW = 0;
    std::int16_t VtyD = 0, VtyW = 0;
    std::int16_t AtrD = 0, AtrW = 0;
    std::int16_t BBA = 0, BBW = 0;

    std::string CompFile; // trimmed full path of the comparison price file
    std::string ShowOsc;
    bool FXRev = false;
    bool FillIn = false;
    bool RFAve = false;
    bool NoClassicMACD = false;
    std::string MMASet, BCCalTp, LCalTp, VCalTp, CutVols;
};

// One period setting: its daily and weekly key, defaults (0: the settings dialog has none)
// and the range the validation applies.
struct OscPeriodKey {
    std::string_view Daily, Weekly;
    std::int16_t OscDef::*DailyField;
    std::int16_t OscDef::*WeeklyField;
    std::int16_t DefaultDaily, DefaultWeekly;
    std::int16_t Min, Max;
    bool Tested; // false: "no test"
};

std::span<const OscPeriodKey> OscPeriodKeys();
const OscPeriodKey* FindOscPeriodKey(std::string_view dailyKey);
// By its daily or its weekly key.
const OscPeriodKey* FindOscPeriodKeyByName(std::string_view key);

OscDef ReadOscSettings(const platform::IniFile& ini);
// Writes every key of the section; failures are ignored as the settings rules say, but the
// result says whether all went to disk.
bool WriteOscSettings(platform::IniFile& ini, const OscDef& def);

// The dialog's opening step: each period of the oscillator's column that is 0 takes its
// default (ATR has none there; it is set in the chart defaults).
void FillOscDefaults(OscDef& def, std::string_view oscName, bool weekly);

// The Bollinger period as the bands use it: 21 outside 1 to 100.
std::int16_t BollingerPeriod(const OscDef& def, bool weekly);

// The daily keys of the periods an oscillator uses, in the order they are validated.
std::span<const std::string_view> OscSettingKeys(std::string_view oscName);

struct OscMessage {
    std::string text;
    std::string title;
};

// Code of a comparison file as its messages name it: the name without folder or extension.
std::string CompareFileCode(std::string_view compFile);

// Validation of the chart window: runs only when `targetName` is "CHTS" (any case); the
// column is daily when `chartPeriod` (trimmed) is "A". RMX is tested on its daily period in
// both columns. RMO and RMX also need their comparison file to exist, unless `compareFile` is
// false because the caller resolves the file itself (with its own message).
std::optional<OscMessage> OscSettingsProblem(const OscDef& def, std::string_view oscName,
                                             std::string_view chartPeriod,
                                             std::string_view targetName, bool compareFile = true);
// Whatever the window: a negative period in the column in use (it would count back before
// the first bar), with the same message.
std::optional<OscMessage> NegativePeriodProblem(const OscDef& def, std::string_view oscName,
                                                std::string_view chartPeriod);
// Shows the problem, if any, through `dialogs`; true when the settings pass.
bool CheckOscSettings(const OscDef& def, std::string_view oscName, std::string_view chartPeriod,
                      std::string_view targetName, platform::Dialogs& dialogs,
                      bool compareFile = true);

// Validation of the settings dialog's OK for the oscillator's own column.
std::optional<OscMessage> OscFormProblem(const OscDef& def, std::string_view oscName, bool weekly);
// The point-and-figure form of the same dialog: its single "Box Value " field.
std::optional<OscMessage> BoxValueProblem(std::string_view text);

} // namespace kori::osc
