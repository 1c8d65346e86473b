#include "cli/cli_context.h"

#include "app/folder_config.h"
#include "app/osc_service.h"
#include "app/sample_library.h"
#include "app/session.h"
#include "app/start_up.h"
#include "chart/chart_defaults.h"
#include "platform/files.h"

#include <CLI/CLI.hpp>

#include <iostream>
#include <memory>

namespace kori::cli {

void AddInitCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("init", "Create the install root, Kori.ini and folders");
    auto sample = std::make_shared<bool>(false);
    cmd->add_flag("--sample", *sample, "Also make the invented sample library");
    cmd->callback([&ctx, sample] {
        auto& session = ctx.OpenSession(false);
        const auto& f = session.folders;
        for (const auto& folder : {f.SystemFolder, f.DataFolder, f.PFMData, f.ChartBackupFolder,
                                   f.PFMBackUp, f.DownloadFolder, f.ChtMiscFolder, f.ChtSaveFolder})
            if (!platform::CreateFolder(folder)) throw CliError{"Cannot create " + folder};
        app::WritePaths(session);
        if (auto st = app::InstallOscDefaults(session); !st) throw CliError{st.message()};
        // Colours as start-up has them: an existing koriclr.dat stays, else the "Black" scheme.
        app::LoadColours(session);
        if (!platform::FileExists(platform::ResolveIn(f.SystemFolder, "koriclr.dat")))
            throw CliError{"Cannot write " + f.SystemFolder + "koriclr.dat"};
        ctx.out << "Install root ready at " << session.root().string() << "\n";
        if (*sample) {
            app::SampleSummary summary;
            auto st = app::MakeSampleLibrary(f.SystemFolder, f.DataFolder,
                                             session.services().settings, summary);
            if (!st) throw CliError{st.message()};
            // The sample's charts keep their volume bars inside the volume panel.
            auto defaults = chart::LoadChartDefaults(session.ini());
            defaults.LimitVolumeHeight = true;
            chart::SaveChartDefaults(session.ini(), defaults);
            ctx.out << "Sample library: " << summary.Securities << " securities, "
                    << summary.Records << " daily records to " << summary.LastDate << " in "
                    << f.DataFolder << "\n";
        }
    });
}

} // namespace kori::cli
