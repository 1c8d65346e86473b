#include "app/folder_config.h"

#include "platform/files.h"
#include "platform/text.h"

#include <sstream>

namespace kori::app {

using platform::Answer;
using platform::Buttons;
using platform::FolderWithSlash;
using platform::Icon;
using platform::Trim;

namespace {

// A blank entry stays blank; any other gets its closing separator.
std::string PathEntry(std::string_view text) {
    const std::string t = Trim(text);
    return t.empty() ? t : FolderWithSlash(t);
}

void SetDerivedFolders(Session& session) {
    auto& f = session.folders;
    f.ChtMiscFolder = f.SystemFolder + "chtmisc/";
    f.ChtSaveFolder = f.SystemFolder + "chtsave/";
    const bool separateIndices =
        session.download.DataService == 3 && !session.chartDataPaths[kIndicesPath].empty();
    f.IndicesFolder = separateIndices ? session.chartDataPaths[kIndicesPath] : f.DataFolder;
}

} // namespace

const std::array<std::string_view, kDataTypeCount>& DataTypeNames() {
    static constexpr std::array<std::string_view, kDataTypeCount> names = {
        "Asx.Stk", "Asx.Idx", "Sfe.Fut", "Wcm.Ovs", "Asx.Opt", "Lsx.Stk", "Lsx.Idx", "Lif.Fut"};
    return names;
}

const std::array<std::string_view, kDataTypeCount>& DataFolderLabels() {
    static constexpr std::array<std::string_view, kDataTypeCount> labels = {
        "Stocks ",          "Indices", "Sydney Futures", "World Commodities",
        "Put/Call Options", "Stocks ", "Indices",        "Liffe Futures"};
    return labels;
}

std::optional<ChartDataPaths> ReadChartPathsFile(const std::string& path) {
    const auto content = platform::ReadWholeFile(platform::ResolvePath(path));
    if (!content) return std::nullopt;
    std::istringstream in(*content);
    std::string line;
    std::getline(in, line); // header
    ChartDataPaths paths;
    for (auto& p : paths) {
        if (!std::getline(in, line)) break;
        p = PathEntry(line);
    }
    return paths;
}

platform::Status WriteChartPathsFile(const std::string& path, const ChartDataPaths& paths) {
    std::string out = "KORI chart data folders\r\n";
    for (const auto& p : paths)
        out += p + "\r\n";
    return platform::WriteFileAtomic(platform::ResolvePath(path), out);
}

void WritePaths(Session& session) {
    auto& ini = session.ini();
    const auto& f = session.folders;
    (void)ini.Write("KoriPaths", "System", f.SystemFolder);
    (void)ini.Write("KoriPaths", "ChtData", f.DataFolder);
    (void)ini.Write("KoriPaths", "ChtBackUp", f.ChartBackupFolder);
    (void)ini.Write("KoriPaths", "PFMData", f.PFMData);
    (void)ini.Write("KoriPaths", "PFMBackUp", f.PFMBackUp);
    (void)ini.Write("Download", "DataService", std::to_string(session.download.DataService));
    (void)ini.Write("Download", "DLPath", f.DownloadFolder);
    // The drive of the original install; here the start of the root, which marks the paths
    // as known so that the next start reads them rather than setting them again.
    (void)ini.Write("KoriDisk", "KoriDrv", f.SystemFolder.substr(0, 2));
}

void UseInstallRoot(Session& session) {
    session.folders = session.DefaultFolders();
    SetDerivedFolders(session);
    WritePaths(session);
}

MissingPathsChoice AskForMissingPaths(Session& session) {
    const std::string text = "Directory Paths are missing and must be re-entered. \n"
                             "Select YES to enter paths \n"
                             "Select NO  to use default paths \n"
                             "Select CANCEL to exit KORI ";
    switch (session.dialogs().MsgBox(text, "No Paths selected", Buttons::YesNoCancel,
                                     Icon::Exclamation)) {
    case Answer::Yes:
        return MissingPathsChoice::EnterPaths;
    case Answer::No:
        UseInstallRoot(session);
        return MissingPathsChoice::UseDefaults;
    default:
        return MissingPathsChoice::Exit;
    }
}

PathDetails CurrentPathDetails(const Session& session) {
    const auto& f = session.folders;
    return {f.SystemFolder, f.DataFolder, f.ChartBackupFolder, f.PFMData, f.PFMBackUp};
}

bool SavePathDetails(Session& session, const PathDetails& edited) {
    for (const auto* p : {&edited.SystemFolder, &edited.DataFolder, &edited.ChartBackupFolder,
                          &edited.PFMData, &edited.PFMBackUp}) {
        if (Trim(*p).empty()) {
            session.dialogs().MsgBox("Directory paths must be entered", "Path Details", Buttons::Ok,
                                     Icon::Exclamation);
            return false;
        }
    }
    auto& f = session.folders;
    f.SystemFolder = PathEntry(edited.SystemFolder);
    f.DataFolder = PathEntry(edited.DataFolder);
    f.ChartBackupFolder = PathEntry(edited.ChartBackupFolder);
    f.PFMData = PathEntry(edited.PFMData);
    f.PFMBackUp = PathEntry(edited.PFMBackUp);
    SetDerivedFolders(session);
    WritePaths(session);
    session.pathsMissing = false;
    return true;
}

bool SaveDataPaths(Session& session, const ChartDataPaths& edited) {
    ChartDataPaths paths;
    bool any = false;
    for (std::size_t i = 0; i < paths.size(); ++i) {
        paths[i] = PathEntry(edited[i]);
        any = any || !paths[i].empty();
    }
    if (!any) {
        session.dialogs().MsgBox("At least one data folder must be entered", "Chart Data Folders",
                                 Buttons::Ok, Icon::Exclamation);
        return false;
    }
    for (const auto& p : paths) {
        if (p.empty() || platform::FileExists(p)) continue;
        const std::string question = "Directory " + p + " does not exist. Create this directory ?";
        if (session.dialogs().MsgBox(question, "Create Directory", Buttons::YesNo,
                                     Icon::Question) == Answer::Yes)
            (void)platform::CreateFolderPath(p); // the user asked for this one
    }
    const std::string& system = session.folders.SystemFolder;
    (void)WriteChartPathsFile(system + "ChtPaths.lst", paths);
    (void)WriteChartPathsFile(system + "WMPaths.lst", paths);
    session.chartDataPaths = paths;
    SetDerivedFolders(session);
    return true;
}

bool PickDataFolder(Session& session, std::string_view folder) {
    const std::string path = PathEntry(folder);
    if (path.empty() || !platform::FileExists(platform::ResolveIn(path, "Names.dat"))) return false;
    session.folders.DataFolder = path;
    SetDerivedFolders(session);
    (void)session.ini().Write("KoriPaths", "ChtData", path);
    return true;
}

std::string MainWindowCaption(const Session& session) {
    return std::string("Kori Charting 8 ") + "  -   Current Data Folder " +
           Trim(session.folders.DataFolder);
}

} // namespace kori::app
