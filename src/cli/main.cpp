// kori: the command-line tool over the charting core.
#include "cli/cli_context.h"
#include "platform/heap.h"

#include <CLI/CLI.hpp>

#include <iostream>

int main(int argc, char** argv) {
    kori::platform::KeepFreedMemoryForReuse();
    CLI::App app{"kori - KORI Charting from the command line"};
    app.require_subcommand(1);
    app.fallthrough(); // global options may follow the subcommand: kori names --root DIR
    app.set_version_flag("--version", "kori 8.0");
    kori::cli::CliContext ctx;
    app.add_option("--root", ctx.root,
                   "Install root (holds Kori.ini); default $KORI_ROOT or ~/.local/share/kori")
        ->option_text("DIR");
    app.add_option("--data", ctx.data, "Data folder to use instead of the one in Kori.ini")
        ->option_text("DIR");

    kori::cli::AddInitCommand(app, ctx);
    kori::cli::AddNamesCommand(app, ctx);
    kori::cli::AddBarsCommand(app, ctx);
    kori::cli::AddListsCommand(app, ctx);
    kori::cli::AddPlayCommand(app, ctx);
    kori::cli::AddChartCommand(app, ctx);
    kori::cli::AddScaleCommand(app, ctx);
    kori::cli::AddIndicatorCommand(app, ctx);

    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& e) {
        return app.exit(e);
    } catch (const kori::cli::CliError& e) {
        std::cerr << "kori: " << e.message << "\n";
        return e.exitCode;
    } catch (const std::exception& e) {
        std::cerr << "kori: " << e.what() << "\n";
        return 1;
    }
    return 0;
}
