#pragma once
// The program's shared state, held in one place and passed by reference: folders, Kori.ini,
// the settings store and the services of the host.
#include "platform/ini_file.h"
#include "platform/services.h"

#include <filesystem>
#include <string>

namespace kori::app {

struct Folders {
    std::string SystemFolder;      // all folder texts end with '/'
    std::string DataFolder;
    std::string PFMData;
    std::string ChartBackupFolder;
    std::string PFMBackUp;
    std::string DownloadFolder;
    std::string IndicesFolder;
    std::string ChtMiscFolder;
    std::string ChtSaveFolder;
};

class Session {
public:
    Session(std::filesystem::path root, platform::Services services);

    const std::filesystem::path& root() const { return m_root; }
    platform::IniFile& ini() { return m_ini; }
    platform::Services& services() { return m_services; }
    platform::Dialogs& dialogs() { return m_services.dialogs; }

    Folders folders;

    // Reads the folder keys of Kori.ini; keys that read "unknown" take the defaults below
    // the install root.
    void ReadFolders();
    // Default folders below the install root (data/, pfdata/, chtbak/, ...).
    Folders DefaultFolders() const;

private:
    std::filesystem::path m_root;
    platform::IniFile m_ini;
    platform::Services m_services;
};

} // namespace kori::app
