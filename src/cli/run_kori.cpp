#include "cli/run_kori.h"

#include "app/about.h"
#include "cli/cli_context.h"

#include <CLI/CLI.hpp>

#include <ostream>
#include <string>

namespace kori::cli {

int RunKori(int argc, const char* const* argv, std::ostream& out, std::ostream& err) {
    CLI::App app{"kori - KORI Charting from the command line"};
    app.require_subcommand(1);
    app.fallthrough(); // global options may follow the subcommand: kori names --root DIR
    app.set_version_flag("--version", "kori " + std::string(app::Version()));
    CliContext ctx(out, err);
    app.add_option("--root", ctx.root,
                   "Install root (holds Kori.ini); default $KORI_ROOT or ~/.local/share/kori")
        ->option_text("DIR");
    app.add_option("--data", ctx.data, "Data folder to use instead of the one in Kori.ini")
        ->option_text("DIR");

    AddInitCommand(app, ctx);
    AddAboutCommand(app, ctx);
    AddNamesCommand(app, ctx);
    AddBarsCommand(app, ctx);
    AddListsCommand(app, ctx);
    AddPlayCommand(app, ctx);
    AddChartCommand(app, ctx);
    AddScaleCommand(app, ctx);
    AddIndicatorCommand(app, ctx);
    AddUpdateCommand(app, ctx);
    AddTargetsCommand(app, ctx);
    AddDetailsCommand(app, ctx);
    AddEntryCommand(app, ctx);
    AddImportCommand(app, ctx);
    AddScanCommands(app, ctx);
    AddAdjustCommand(app, ctx);
    AddAdjListCommand(app, ctx);
    AddDataCommand(app, ctx);
    AddRepairCommand(app, ctx);
    AddCheckCommand(app, ctx);
    AddCheckNamesCommand(app, ctx);
    AddBackupCommands(app, ctx);
    AddExportCommand(app, ctx);
    AddWatchlistCommand(app, ctx);

    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& e) {
        return app.exit(e, out, err);
    } catch (const CliError& e) {
        err << "kori: " << e.message << "\n";
        return e.exitCode;
    } catch (const std::exception& e) {
        err << "kori: " << e.what() << "\n";
        return 1;
    }
    // Results that did not reach their reader (a full disk, a closed pipe) are a failure too.
    out.flush();
    if (!out) {
        err << "kori: cannot write the output\n";
        return 1;
    }
    return 0;
}

} // namespace kori::cli
