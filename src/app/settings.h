#pragma once
// The Kori.ini settings of the application frame: download service, chart fonts, page
// margins, zoom, adjustment options and the chart-list editor. Each reader applies the
// default and the limits of its key; a key not found reads "unknown" first.
#include "platform/ini_file.h"
#include "platform/palette.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kori::app {

// [Download]. DLPath is the DownloadFolder and lives with the other folders.
struct DownloadSettings {
    std::int16_t DataService = 0;
    bool DownloadNew = false;
    std::string InternetDLfmt = "unknown"; // as read; matched against the file-name forms
    bool InternetAccess = false;
    bool UpdateAll = true;
    bool NoWarrants = false;
    // Folders of the download program; read only for DataService 1 or 3, else empty.
    std::string System;
    std::string In;
    std::string Out;
    std::int32_t VolumeDivisor = 1;
    std::int16_t RefreshFreq = 8;
    std::string Broker = "unknown";
};

// [Chart Fonts] as texts, exactly as read.
struct FontSettings {
    std::string CFont = "Arial";
    std::string CFontSize = "8";
    std::string SFont = "Arial";
    std::string SFontSize = "unknown";

    platform::ChartFonts ToChartFonts() const;
};

// [ChtPage]: page margins and orientation.
struct PageSettings {
    std::int32_t PPTop = 0;
    std::int32_t PPLft = 0;
    float PPBot = 0;
    float PPRht = 0;
    std::int16_t Orient = 0;
};

// [Adjustments]
struct AdjustmentSettings {
    std::int16_t Divs = 0;
    bool NoShortNames = false;
};

// [SubLists]: the chart-list editor.
struct SubListSettings {
    std::int16_t Last = 0;    // mode of the list last shown
    std::int16_t Columns = 0; // columns of the name box
};

// "True"/"False" (any case, blanks trimmed) as a boolean; nullopt for any other text.
std::optional<bool> BoolWord(std::string_view text);
const char* BoolText(bool value); // "True" / "False"

// A number key as the classic conversion reads it: Val of the text, half-even to 16 or 32
// bits; "unknown", junk or a value that does not fit read as 0.
std::int16_t ReadInt16(const platform::IniFile& ini, std::string_view section,
                       std::string_view key);
std::int32_t ReadInt32(const platform::IniFile& ini, std::string_view section,
                       std::string_view key);

DownloadSettings ReadDownloadSettings(const platform::IniFile& ini);
FontSettings ReadFontSettings(const platform::IniFile& ini);
PageSettings ReadPageSettings(const platform::IniFile& ini);
// [ChartForms] Zoom: below 50 or above 200 reads as 100.
std::int16_t ReadZoom(const platform::IniFile& ini);
AdjustmentSettings ReadAdjustmentSettings(const platform::IniFile& ini);
SubListSettings ReadSubListSettings(const platform::IniFile& ini);

// The fonts window writes [Chart Fonts]; the settings routine writes the same four keys under
// [ChartFonts] as well.
void WriteFontSettings(platform::IniFile& ini, const FontSettings& fonts,
                       std::string_view section = "Chart Fonts");
void WritePageSettings(platform::IniFile& ini, const PageSettings& page);
void WriteZoom(platform::IniFile& ini, std::int16_t zoom);
void WriteAdjustmentSettings(platform::IniFile& ini, const AdjustmentSettings& adjustments);
void WriteSubListSettings(platform::IniFile& ini, const SubListSettings& subLists);

} // namespace kori::app
