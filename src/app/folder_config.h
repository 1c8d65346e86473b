#pragma once
// The folders of the program and how they are changed: writing the paths to Kori.ini, the
// defaults below the install root, the path-details and data-folders dialogs' rules, and the
// data-folder list ChtPaths.lst shared with the download program.
#include "app/session.h"
#include "platform/status.h"

#include <array>
#include <optional>
#include <string>
#include <string_view>

namespace kori::app {

// The IndicesFolder is the second path of ChtPaths.lst, the one for Asx.Idx.
inline constexpr std::size_t kIndicesPath = 1;

// Data types of the eight paths, and their labels in the data-folders dialog.
const std::array<std::string_view, kDataTypeCount>& DataTypeNames();
const std::array<std::string_view, kDataTypeCount>& DataFolderLabels();

// Nine lines: a header that is ignored, then the eight paths (blank ones stay empty, others
// get a closing separator). nullopt when the file cannot be opened.
std::optional<ChartDataPaths> ReadChartPathsFile(const std::string& path);
platform::Status WriteChartPathsFile(const std::string& path, const ChartDataPaths& paths);

// "Write the paths": the five folders, DataService, DLPath and KoriDrv (the first two
// characters of the SystemFolder) into Kori.ini.
void WritePaths(Session& session);
// Stands in for the search for the install drive: the folders become the defaults below the
// install root and are written.
void UseInstallRoot(Session& session);

// The question of the path-details dialog when the paths are missing. "No" uses the default
// paths at once; "Cancel" means the program ends.
enum class MissingPathsChoice { EnterPaths, UseDefaults, Exit };
MissingPathsChoice AskForMissingPaths(Session& session);

// The five folders the path-details dialog edits.
struct PathDetails {
    std::string SystemFolder;
    std::string DataFolder;
    std::string ChartBackupFolder;
    std::string PFMData;
    std::string PFMBackUp;
};
PathDetails CurrentPathDetails(const Session& session);
// Saving the path details: an empty entry is refused with "Directory paths must be entered";
// each path gets a closing separator; the paths are written and the paths-missing flag clears.
bool SavePathDetails(Session& session, const PathDetails& edited);

// Saving the data-folders dialog (DataService 3): each path gets a closing separator; none at
// all is refused; a folder that does not exist is offered for creation; then ChtPaths.lst and
// WMPaths.lst are rewritten.
bool SaveDataPaths(Session& session, const ChartDataPaths& edited);
// Picking a data folder makes it the DataFolder and writes [KoriPaths] ChtData; a folder with
// no name file is refused. The caller returns the chart selection to the full list.
bool PickDataFolder(Session& session, std::string_view folder);

// "Kori Charting 8   -   Current Data Folder <DataFolder>"
std::string MainWindowCaption(const Session& session);

} // namespace kori::app
