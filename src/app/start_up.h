#pragma once
// What the program does between its start and the main window: the command line, the paths,
// the folders it needs, colours, printer colours and settings, and at the end the offer to
// update from files waiting in the download folder. The windows themselves (logo, timer,
// main window) are the desktop program's; the single-instance test is in instance_lock.h.
#include "app/session.h"

#include <string>
#include <string_view>

namespace kori::app {

// The command line compared exactly after trimming: "RM", "A", "N", or "GD" (which sets RM
// too). Anything else is ignored.
CommandLineSwitches ParseCommandLine(std::string_view commandLine);

// [KoriDisk] KoriDrv names a known install unless it reads "unknown", "OK" or empty.
bool InstallRootKnown(const platform::IniFile& ini);

// The general initialisation: command line; the install root when Kori.ini does not know it
// yet (the default folders are set and written); the paths; chtmisc and chtsave; colours;
// printer colours; the remaining settings; the paths-missing flag.
void InitialiseSession(Session& session, std::string_view commandLine);

// The paths as Kori.ini gives them; a SystemFolder that reads "unknown" sets and writes the
// defaults below the install root.
void ReadPaths(Session& session);
// chtmisc and chtsave below the SystemFolder, made when a directory search does not find them.
void MakeChartFolders(const Session& session);
// koriclr.dat when there is one, else the scheme "Black" (which writes koriclr.dat).
void LoadColours(Session& session);
// koriprn.dat's record 1; an empty or missing file asks the printer questions and writes it.
void LoadPrinterColours(Session& session);

// Any "*.d" file (any case) in the folder; false when the folder cannot be read.
bool HasPendingUpdateFiles(const std::string& downloadFolder);
// The pending-files test for DataService 1 to 5 (0 and others make no test): when files wait,
// asks by the service's words and returns whether the user chose OK, in which case the
// downloaded data update opens.
bool OfferPendingUpdate(Session& session);

} // namespace kori::app
