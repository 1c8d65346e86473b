#include "app/session.h"

#include "app/folder_config.h"
#include "platform/files.h"
#include "platform/text.h"

namespace kori::app {

using platform::FolderWithSlash;

Session::Session(std::filesystem::path root, platform::Services services)
    : m_root(std::move(root)), m_ini(m_root / "Kori.ini"), m_services(services) {
    folders = DefaultFolders();
    fonts = fontSettings.ToChartFonts();
}

Folders Session::DefaultFolders() const {
    Folders f;
    f.SystemFolder = FolderWithSlash(m_root.string());
    f.DataFolder = f.SystemFolder + "data/";
    f.PFMData = f.SystemFolder + "pfdata/";
    f.ChartBackupFolder = f.SystemFolder + "chtbak/";
    f.PFMBackUp = f.SystemFolder + "pfbak/";
    f.DownloadFolder = f.SystemFolder + "download/Out/";
    f.IndicesFolder = f.DataFolder;
    f.ChtMiscFolder = f.SystemFolder + "chtmisc/";
    f.ChtSaveFolder = f.SystemFolder + "chtsave/";
    return f;
}

void Session::ReadFolders() {
    const Folders d = DefaultFolders();
    auto read = [&](const char* section, const char* key, const std::string& fallback) {
        const std::string v = platform::Trim(m_ini.Read(section, key));
        return v == platform::kUnknown ? fallback : FolderWithSlash(v);
    };
    folders.SystemFolder = read("KoriPaths", "System", d.SystemFolder);
    folders.DataFolder = read("KoriPaths", "ChtData", d.DataFolder);
    folders.ChartBackupFolder = read("KoriPaths", "ChtBackUp", d.ChartBackupFolder);
    folders.PFMData = read("KoriPaths", "PFMData", d.PFMData);
    folders.PFMBackUp = read("KoriPaths", "PFMBackUp", d.PFMBackUp);
    download = ReadDownloadSettings(m_ini);
    folders.DownloadFolder = read("Download", "DLPath", d.DownloadFolder);
    folders.ChtMiscFolder = folders.SystemFolder + "chtmisc/";
    folders.ChtSaveFolder = folders.SystemFolder + "chtsave/";

    chartDataPaths = {};
    folders.IndicesFolder = folders.DataFolder;
    if (download.DataService != 3) return;
    // A missing list leaves the paths empty; the indices then stay in the DataFolder.
    if (const auto paths = ReadChartPathsFile(folders.SystemFolder + "ChtPaths.lst"))
        chartDataPaths = *paths;
    if (!chartDataPaths[kIndicesPath].empty()) folders.IndicesFolder = chartDataPaths[kIndicesPath];
}

void Session::ReadSettings() {
    fontSettings = ReadFontSettings(m_ini);
    fonts = fontSettings.ToChartFonts();
    page = ReadPageSettings(m_ini);
    zoom = ReadZoom(m_ini);
    adjustments = ReadAdjustmentSettings(m_ini);
    subLists = ReadSubListSettings(m_ini);
}

} // namespace kori::app
