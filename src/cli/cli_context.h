#pragma once
// What every subcommand of the kori tool shares: the global options and the session they open.
#include "app/session.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "platform/settings_store.h"

#include <iosfwd>
#include <memory>
#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace kori::cli {

// Thrown by a subcommand to end with a message on standard error and a non-zero exit.
struct CliError {
    std::string message;
    int exitCode = 1;
};

class CliContext {
public:
    // Commands write their results to `out` and their warnings to `err`.
    CliContext(std::ostream& out, std::ostream& err);
    ~CliContext();

    std::ostream& out;
    std::ostream& err;

    std::optional<std::string> root; // --root
    std::optional<std::string> data; // --data

    // Opens the session over the install root. With `mustExist`, a root without Kori.ini is an
    // error that tells the user how to make one.
    app::Session& OpenSession(bool mustExist = true);

private:
    std::unique_ptr<platform::ConsoleDialogs> m_dialogs;
    std::unique_ptr<platform::TerminalProgress> m_progress;
    std::unique_ptr<platform::SettingsStore> m_settings;
    platform::SystemClock m_clock;
    std::unique_ptr<app::Session> m_session;
};

// printf-style text, for the commands' fixed-width tables.
std::string Printf(const char* format, ...) __attribute__((format(printf, 1, 2)));

// One function per subcommand; each adds itself to the app.
void AddInitCommand(CLI::App& app, CliContext& ctx);
void AddAboutCommand(CLI::App& app, CliContext& ctx);
void AddNamesCommand(CLI::App& app, CliContext& ctx);
void AddBarsCommand(CLI::App& app, CliContext& ctx);
void AddListsCommand(CLI::App& app, CliContext& ctx);
void AddPlayCommand(CLI::App& app, CliContext& ctx);
void AddChartCommand(CLI::App& app, CliContext& ctx);
void AddScaleCommand(CLI::App& app, CliContext& ctx);
void AddIndicatorCommand(CLI::App& app, CliContext& ctx);
void AddUpdateCommand(CLI::App& app, CliContext& ctx);
void AddTargetsCommand(CLI::App& app, CliContext& ctx);
void AddDetailsCommand(CLI::App& app, CliContext& ctx);
void AddEntryCommand(CLI::App& app, CliContext& ctx);
void AddImportCommand(CLI::App& app, CliContext& ctx);
// scan1, scan2, scan3, scan6, stats, adtotals.
void AddScanCommands(CLI::App& app, CliContext& ctx);
void AddAdjustCommand(CLI::App& app, CliContext& ctx);
void AddAdjListCommand(CLI::App& app, CliContext& ctx);
void AddDataCommand(CLI::App& app, CliContext& ctx);
void AddRepairCommand(CLI::App& app, CliContext& ctx);
void AddCheckCommand(CLI::App& app, CliContext& ctx);
void AddCheckNamesCommand(CLI::App& app, CliContext& ctx);
void AddBackupCommands(CLI::App& app, CliContext& ctx);
void AddExportCommand(CLI::App& app, CliContext& ctx);
void AddWatchlistCommand(CLI::App& app, CliContext& ctx);

} // namespace kori::cli
