#include "app/start_up.h"

#include "app/folder_config.h"
#include "app/osc_service.h"
#include "platform/files.h"
#include "platform/text.h"

#include <filesystem>

namespace kori::app {

using platform::Trim;

namespace {

const char* PendingFilesText(int dataService) {
    switch (dataService) {
    case 1:
    case 3:
        return " There are some KORI/Zevot files to update into KORI";
    case 2:
        return " There are some BOURSE files to update into KORI";
    case 4:
        return " There are some Ex Internet data files to update into KORI";
    case 5:
        return " There are some EIS downloaded files to update into KORI";
    default:
        return nullptr;
    }
}

} // namespace

CommandLineSwitches ParseCommandLine(std::string_view commandLine) {
    const std::string word = Trim(commandLine);
    CommandLineSwitches s;
    if (word == "RM") s.RM = true;
    if (word == "A") s.A = true;
    if (word == "N") s.N = true;
    if (word == "GD") s.GD = s.RM = true;
    return s;
}

bool InstallRootKnown(const platform::IniFile& ini) {
    const std::string drive = platform::Upper(Trim(ini.Read("KoriDisk", "KoriDrv")));
    return !(drive.empty() || drive == "UNKNOWN" || drive == "OK");
}

void ReadPaths(Session& session) {
    session.ReadFolders();
    if (Trim(session.ini().Read("KoriPaths", "System")) == platform::kUnknown)
        UseInstallRoot(session);
}

void MakeChartFolders(const Session& session) {
    for (const auto& folder : {session.folders.ChtMiscFolder, session.folders.ChtSaveFolder})
        if (!platform::FileExists(folder)) (void)platform::CreateFolder(folder);
}

void LoadColours(Session& session) {
    const auto file = platform::ResolveIn(session.folders.SystemFolder, "koriclr.dat");
    if (platform::FileExists(file)) {
        // Too few numbers or junk: the table keeps what was read.
        (void)ReadColourFile(file.string(), session.palette);
        return;
    }
    (void)ApplyColourScheme("Black", session.folders.SystemFolder, session.palette);
}

void LoadPrinterColours(Session& session) {
    const std::string file = session.folders.SystemFolder + "koriprn.dat";
    if (const auto stored = ReadPrinterFile(file)) {
        session.printer = *stored;
        return;
    }
    session.printer = AskPrinterColours(session.dialogs());
    (void)WritePrinterFile(file, session.printer);
}

void InitialiseSession(Session& session, std::string_view commandLine) {
    session.switches = ParseCommandLine(commandLine);
    if (!InstallRootKnown(session.ini())) UseInstallRoot(session);
    ReadPaths(session);
    MakeChartFolders(session);
    LoadColours(session);
    LoadPrinterColours(session);
    (void)InstallOscDefaults(session); // a failed write leaves the oscillators unset, no worse
    session.ReadSettings();
    session.pathsMissing = Trim(session.folders.SystemFolder).empty();
}

bool HasPendingUpdateFiles(const std::string& downloadFolder) {
    namespace fs = std::filesystem;
    std::error_code ec;
    fs::directory_iterator it(platform::NormalisePath(downloadFolder), ec);
    if (ec) return false;
    for (; !ec && it != fs::directory_iterator(); it.increment(ec)) {
        const auto ext = it->path().extension().string();
        if (platform::EqualsNoCase(ext, ".d") && it->is_regular_file(ec)) return true;
    }
    return false;
}

bool OfferPendingUpdate(Session& session) {
    const char* text = PendingFilesText(session.download.DataService);
    if (!text || !HasPendingUpdateFiles(session.folders.DownloadFolder)) return false;
    return session.dialogs().MsgBox(text, "Downloaded Data", platform::Buttons::OkCancel,
                                    platform::Icon::Information) == platform::Answer::Ok;
}

} // namespace kori::app
