#include "app/session.h"

#include "platform/files.h"
#include "platform/text.h"

namespace kori::app {

using platform::FolderWithSlash;

Session::Session(std::filesystem::path root, platform::Services services)
    : m_root(std::move(root)), m_ini(m_root / "Kori.ini"), m_services(services) {
    folders = DefaultFolders();
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
    folders.DownloadFolder = read("Download", "DLPath", d.DownloadFolder);
    folders.IndicesFolder = folders.DataFolder;
    folders.ChtMiscFolder = folders.SystemFolder + "chtmisc/";
    folders.ChtSaveFolder = folders.SystemFolder + "chtsave/";
}

} // namespace kori::app
