#include "app/settings.h"

#include "platform/rounding.h"
#include "platform/text.h"

namespace kori::app {

using platform::IniFile;
using platform::kUnknown;
using platform::Trim;

namespace {

bool IsUnknownOrEmpty(const std::string& text) {
    return text.empty() || text == kUnknown;
}

// An unset text key reads as its default.
std::string TextOr(const IniFile& ini, std::string_view section, std::string_view key,
                   std::string_view fallback) {
    const std::string v = Trim(ini.Read(section, key));
    return IsUnknownOrEmpty(v) ? std::string(fallback) : v;
}

std::string FolderText(const IniFile& ini, std::string_view key) {
    const std::string v = Trim(ini.Read("Download", key));
    return v == kUnknown ? std::string() : v;
}

std::int32_t VolumeDivisorOf(std::int32_t v) {
    return (v == 1 || v == 10 || v == 100 || v == 1000 || v == 10000) ? v : 1;
}

void WriteNumber(IniFile& ini, std::string_view section, std::string_view key, double value) {
    (void)ini.Write(section, key, platform::Str(value));
}

} // namespace

std::optional<bool> BoolWord(std::string_view text) {
    const std::string t = Trim(text);
    if (platform::EqualsNoCase(t, "True")) return true;
    if (platform::EqualsNoCase(t, "False")) return false;
    return std::nullopt;
}

const char* BoolText(bool value) {
    return value ? "True" : "False";
}

std::int16_t ReadInt16(const IniFile& ini, std::string_view section, std::string_view key) {
    return platform::CInt(platform::Val(ini.Read(section, key))).value_or(0);
}

std::int32_t ReadInt32(const IniFile& ini, std::string_view section, std::string_view key) {
    return platform::CLng(platform::Val(ini.Read(section, key))).value_or(0);
}

DownloadSettings ReadDownloadSettings(const IniFile& ini) {
    DownloadSettings d;
    d.DataService = ReadInt16(ini, "Download", "DataService");
    d.DownloadNew = BoolWord(ini.Read("Download", "DownloadNew")).value_or(false);
    d.InternetDLfmt = Trim(ini.Read("Download", "InternetDLfmt"));
    // Only true (the word, or -1) counts as true here.
    const std::string access = Trim(ini.Read("Download", "Internet Access"));
    d.InternetAccess = BoolWord(access).value_or(false) || access == "-1";
    d.UpdateAll = BoolWord(ini.Read("Download", "UpdateAll")).value_or(true);
    d.NoWarrants = BoolWord(ini.Read("Download", "NoWarrants")).value_or(false);
    if (d.DataService == 1 || d.DataService == 3) {
        d.System = FolderText(ini, "System");
        d.In = FolderText(ini, "In");
        d.Out = FolderText(ini, "Out");
    }
    d.VolumeDivisor = VolumeDivisorOf(ReadInt32(ini, "Download", "Volume divisor"));
    const std::int16_t refresh = ReadInt16(ini, "Download", "RefreshFreq");
    d.RefreshFreq = (refresh >= 10 && refresh <= 200) ? refresh : 8;
    d.Broker = Trim(ini.Read("Download", "Broker"));
    return d;
}

FontSettings ReadFontSettings(const IniFile& ini) {
    FontSettings f;
    f.CFont = TextOr(ini, "Chart Fonts", "CFont", "Arial");
    f.CFontSize = TextOr(ini, "Chart Fonts", "CFontSize", "8");
    f.SFont = TextOr(ini, "Chart Fonts", "SFont", "Arial");
    f.SFontSize = Trim(ini.Read("Chart Fonts", "SFontSize"));
    // The default for the scale font size tests and sets the chart font size instead, which
    // by now is never unset: an unset SFontSize stays "unknown". Kept as the program has it.
    if (IsUnknownOrEmpty(f.CFontSize)) f.CFontSize = std::string(1, '6');
    return f;
}

platform::ChartFonts FontSettings::ToChartFonts() const {
    platform::ChartFonts fonts;
    fonts.Font1 = CFont;
    fonts.Font2 = SFont;
    // A size that is no positive number (an unset SFontSize reads "unknown") keeps the
    // default size rather than asking for a font of size 0.
    if (const double s = platform::Val(CFontSize); s > 0) fonts.Size1 = s;
    if (const double s = platform::Val(SFontSize); s > 0) fonts.Size2 = s;
    return fonts;
}

PageSettings ReadPageSettings(const IniFile& ini) {
    PageSettings p;
    p.PPTop = ReadInt32(ini, "ChtPage", "PPTop");
    p.PPLft = ReadInt32(ini, "ChtPage", "PPLft");
    p.PPBot = static_cast<float>(platform::Val(ini.Read("ChtPage", "PPBot")));
    p.PPRht = static_cast<float>(platform::Val(ini.Read("ChtPage", "PPRht")));
    p.Orient = ReadInt16(ini, "ChtPage", "Orient");
    return p;
}

std::int16_t ReadZoom(const IniFile& ini) {
    const std::int16_t zoom = ReadInt16(ini, "ChartForms", "Zoom");
    return (zoom < 50 || zoom > 200) ? std::int16_t{100} : zoom;
}

AdjustmentSettings ReadAdjustmentSettings(const IniFile& ini) {
    AdjustmentSettings a;
    a.Divs = ReadInt16(ini, "Adjustments", "Divs");
    a.NoShortNames = BoolWord(ini.Read("Adjustments", "NoShortNames")).value_or(false);
    return a;
}

SubListSettings ReadSubListSettings(const IniFile& ini) {
    return {ReadInt16(ini, "SubLists", "Last"), ReadInt16(ini, "SubLists", "Columns")};
}

void WriteFontSettings(IniFile& ini, const FontSettings& fonts, std::string_view section) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    (void)ini.Write(section, "CFont", fonts.CFont);
    (void)ini.Write(section, "CFontSize", fonts.CFontSize);
    (void)ini.Write(section, "SFont", fonts.SFont);
    (void)ini.Write(section, "SFontSize", fonts.SFontSize);
}

void WritePageSettings(IniFile& ini, const PageSettings& page) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    WriteNumber(ini, "ChtPage", "PPTop", page.PPTop);
    WriteNumber(ini, "ChtPage", "PPLft", page.PPLft);
    (void)ini.Write("ChtPage", "PPBot", platform::StrSingle(page.PPBot));
    (void)ini.Write("ChtPage", "PPRht", platform::StrSingle(page.PPRht));
    WriteNumber(ini, "ChtPage", "Orient", page.Orient);
}

void WriteZoom(IniFile& ini, std::int16_t zoom) {
    WriteNumber(ini, "ChartForms", "Zoom", zoom);
}

void WriteAdjustmentSettings(IniFile& ini, const AdjustmentSettings& adjustments) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    WriteNumber(ini, "Adjustments", "Divs", adjustments.Divs);
    (void)ini.Write("Adjustments", "NoShortNames", BoolText(adjustments.NoShortNames));
}

void WriteSubListSettings(IniFile& ini, const SubListSettings& subLists) {
    platform::IniFile::Batch once(ini); // one write of the file for the whole save
    WriteNumber(ini, "SubLists", "Last", subLists.Last);
    WriteNumber(ini, "SubLists", "Columns", subLists.Columns);
}

} // namespace kori::app
