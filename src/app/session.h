#pragma once
// The program's shared state, held in one place and passed by reference: folders, Kori.ini,
// the settings store, the services of the host, and the settings, colours and switches that
// start-up reads.
#include "app/colour_table.h"
#include "app/settings.h"
#include "platform/ini_file.h"
#include "platform/palette.h"
#include "platform/services.h"

#include <array>
#include <filesystem>
#include <string>

namespace kori::app {

struct Folders {
    std::string SystemFolder; // all folder texts end with '/'
    std::string DataFolder;
    std::string PFMData;
    std::string ChartBackupFolder;
    std::string PFMBackUp;
    std::string DownloadFolder;
    std::string IndicesFolder;
    std::string ChtMiscFolder;
    std::string ChtSaveFolder;
};

// The words of the command line.
struct CommandLineSwitches {
    bool RM = false; // RMO/RMX ask for details; stochastic signals shown
    bool A = false;  // the download program's menu is hidden
    bool N = false;  // read by chart printing
    bool GD = false; // sets RM as well
};

// ChtPaths.lst: the data folder of each data type, in file order after the header line.
inline constexpr int kDataTypeCount = 8;
using ChartDataPaths = std::array<std::string, kDataTypeCount>;

class Session {
public:
    Session(std::filesystem::path root, platform::Services services);

    const std::filesystem::path& root() const { return m_root; }
    platform::IniFile& ini() { return m_ini; }
    const platform::IniFile& ini() const { return m_ini; }
    platform::Services& services() { return m_services; }
    platform::Dialogs& dialogs() { return m_services.dialogs; }

    Folders folders;
    DownloadSettings download;
    ChartDataPaths chartDataPaths; // empty unless DataService is 3 and the file reads
    FontSettings fontSettings;     // the [Chart Fonts] texts as read
    platform::ChartFonts fonts;
    PageSettings page;
    std::int16_t zoom = 100;
    AdjustmentSettings adjustments;
    SubListSettings subLists;
    platform::Palette palette = StartingPalette();
    PrinterColours printer;
    CommandLineSwitches switches;
    bool pathsMissing = false; // set when the SystemFolder is blank, until paths are saved
    // The stream the charts of this session write; empty: TCht.Tmp of the temporary folder, the
    // desktop program's own. A command-line run sets a private one so runs never share it.
    std::filesystem::path chartStream;

    // Reads the paths: the folder keys of Kori.ini (keys that read "unknown" take the defaults
    // below the install root), the [Download] keys, and for DataService 3 the data folders of
    // ChtPaths.lst with the IndicesFolder taken from them.
    void ReadFolders();
    // Default folders below the install root (data/, pfdata/, chtbak/, ...).
    Folders DefaultFolders() const;
    // Fonts, page, zoom, adjustment and chart-list settings with their limits.
    void ReadSettings();

private:
    std::filesystem::path m_root;
    platform::IniFile m_ini;
    platform::Services m_services;
};

} // namespace kori::app
