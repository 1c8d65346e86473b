#include "cli/cli_context.h"

#include "app/about.h"
#include "app/folder_config.h"
#include "app/install_root.h"
#include "app/osc_service.h"
#include "app/sample_library.h"
#include "app/session.h"
#include "app/start_up.h"
#include "chart/chart_defaults.h"
#include "platform/files.h"
#include "store/name_file.h"

#include <CLI/CLI.hpp>

#include <filesystem>
#include <iostream>
#include <memory>
#include <unistd.h>

namespace kori::cli {

namespace {

namespace fs = std::filesystem;

bool AbsentOrEmpty(const fs::path& folder) {
    std::error_code ec;
    if (!fs::exists(folder, ec)) return true;
    return fs::is_directory(folder, ec) && fs::is_empty(folder, ec);
}

// The folders of a root built under another name, as they will read once it is in place.
void MoveFolders(app::Folders& f, const std::string& from, const std::string& to) {
    for (std::string* folder :
         {&f.SystemFolder, &f.DataFolder, &f.PFMData, &f.ChartBackupFolder, &f.PFMBackUp,
          &f.DownloadFolder, &f.IndicesFolder, &f.ChtMiscFolder, &f.ChtSaveFolder})
        if (folder->starts_with(from)) *folder = to + folder->substr(from.size());
}

// Every mention of one folder in a text file becomes the other.
void RenameIn(const fs::path& file, const std::string& from, const std::string& to) {
    auto text = platform::ReadWholeFile(file);
    if (!text) return;
    for (auto at = text->find(from); at != std::string::npos; at = text->find(from, at + to.size()))
        text->replace(at, from.size(), to);
    if (auto st = platform::WriteFileAtomic(file, *text); !st) throw CliError{st.message()};
}

// Kori.ini, the folders, the oscillator defaults, the colours and, when asked, the sample (its
// summary is returned for the report).
std::string BuildRoot(app::Session& session, bool sample, int service) {
    const auto& f = session.folders;
    // The root and the folders below it are made whole; a folder Kori.ini puts elsewhere must
    // have a parent that exists.
    for (const auto& folder : {f.SystemFolder, f.DataFolder, f.PFMData, f.ChartBackupFolder,
                               f.PFMBackUp, f.DownloadFolder, f.ChtMiscFolder, f.ChtSaveFolder}) {
        const bool below = folder.starts_with(f.SystemFolder);
        if (!(below ? platform::CreateFolderPath(folder) : platform::CreateFolder(folder)))
            throw CliError{"Cannot create " + folder};
    }
    app::WritePaths(session);
    if (auto st = app::InstallOscDefaults(session); !st) throw CliError{st.message()};
    // Colours as start-up has them: an existing koriclr.dat stays, else the "Black" scheme.
    app::LoadColours(session);
    if (!platform::FileExists(platform::ResolveIn(f.SystemFolder, "koriclr.dat")))
        throw CliError{"Cannot write " + f.SystemFolder + "koriclr.dat"};
    if (!sample) return {};
    if (platform::FileExists(store::NameFile::PathIn(f.DataFolder)))
        throw CliError{"A library already exists in " + f.DataFolder +
                       "; kori init --sample makes one only where there is none."};
    app::SampleSummary summary;
    auto st =
        app::MakeSampleLibrary(f.SystemFolder, f.DataFolder, session.services().settings, summary);
    if (!st) throw CliError{st.message()};
    std::vector<std::string> waiting;
    if (service == 3) {
        app::ChartDataPaths paths;
        st = app::MakeSampleBundle(f.SystemFolder, f.DataFolder, f.DownloadFolder, paths, waiting);
        if (st) st = app::WriteChartPathsFile(f.SystemFolder + "ChtPaths.lst", paths);
        if (!st) throw CliError{st.message()};
        session.chartDataPaths = paths;
    } else {
        st = app::MakeSampleDayFiles(f.DataFolder, f.DownloadFolder, waiting);
        if (!st) throw CliError{st.message()};
        (void)session.ini().Write("Download", "InternetDLfmt", "DDMMMYY.D");
    }
    // The download program's folders with the day's maintenance bulletin, and dividends taken
    // into the list marked to run.
    const std::string in = f.SystemFolder + "dlin/", out = f.SystemFolder + "dlout/";
    if (!platform::CreateFolderPath(out)) throw CliError{"Cannot create " + out};
    if (st = app::MakeSampleBulletins(f.DataFolder, in); !st) throw CliError{st.message()};
    {
        platform::IniFile::Batch once(session.ini());
        (void)session.ini().Write("Download", "In", in);
        (void)session.ini().Write("Download", "Out", out);
        (void)session.ini().Write("Adjustments", "Divs", "2");
    }
    session.download.In = in;
    session.download.Out = out;
    session.adjustments.Divs = 2;
    // The details table waits in the same In folder.
    if (st = app::MakeSampleSecurityDetails(f.DataFolder, in); !st) throw CliError{st.message()};
    // The sample's charts keep their volume bars inside the volume panel.
    auto defaults = chart::LoadChartDefaults(session.ini());
    defaults.LimitVolumeHeight = true;
    chart::SaveChartDefaults(session.ini(), defaults);
    std::string files;
    for (const auto& w : waiting)
        files += " " + w;
    return "Waiting day files in the download folder:" + files +
           "\nSample library: " + std::to_string(summary.Securities) + " securities, " +
           std::to_string(summary.Records) + " daily records to " + summary.LastDate + " in ";
}

} // namespace

void AddInitCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("init", "Create the install root, Kori.ini and folders");
    auto sample = std::make_shared<bool>(false);
    auto service = std::make_shared<int>(4);
    cmd->add_flag("--sample", *sample, "Also make the invented sample library");
    cmd->add_option("--service", *service,
                    "Download service of the sample: 4 day files (default) or 3 bundles by market")
        ->check(CLI::IsMember({3, 4}));
    cmd->callback([&ctx, sample, service] {
        const fs::path root = app::FindInstallRoot(ctx.root);
        const bool fresh = AbsentOrEmpty(root);
        // The sample never goes over a library that is there: the user's files stay theirs.
        if (*sample && !fresh)
            throw CliError{"A library already exists at " + root.string() +
                           "; kori init --sample makes one only where there is none. Start a new "
                           "one with: kori init --sample --root NEW_FOLDER"};
        if (!fresh) {
            // Folders that are missing are made; the files there stay as they are.
            (void)BuildRoot(ctx.OpenSession(false), false, 0);
            ctx.out << "Install root ready at " << root.string() << "\n";
            return;
        }
        // A new root is built whole beside its place and moved in by one rename, so a failure
        // or a kill leaves no half-made library where the user looks for one.
        const fs::path parent = root.has_parent_path() ? root.parent_path() : fs::path(".");
        if (!platform::CreateFolderPath(parent)) throw CliError{"Cannot create " + parent.string()};
        const fs::path staging =
            parent / ("." + root.filename().string() + ".kori-init-" + std::to_string(::getpid()));
        const std::string finalFolder = platform::FolderWithSlash(root.string());
        std::string report;
        try {
            ctx.root = staging.string();
            auto& session = ctx.OpenSession(false);
            if (*sample) session.download.DataService = static_cast<std::int16_t>(*service);
            report = BuildRoot(session, *sample, *service);
            MoveFolders(session.folders, platform::FolderWithSlash(staging.string()), finalFolder);
            if (!report.empty()) report += session.folders.DataFolder + "\n";
            app::WritePaths(session);
            // Settings that name a file of the new library (the compare file) name it in place.
            for (const char* name : {"Kori.ini", "settings.ini", "ChtPaths.lst"})
                RenameIn(staging / name, platform::FolderWithSlash(staging.string()), finalFolder);
            std::error_code ec;
            fs::rename(staging, root, ec);
            if (ec)
                throw CliError{"Cannot move the new library to " + root.string() + ": " +
                               ec.message()};
        } catch (...) {
            std::error_code ec;
            fs::remove_all(staging, ec);
            throw;
        }
        ctx.out << "Install root ready at " << root.string() << "\n" << report;
    });
}

void AddAboutCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("about", "The version, the install root and the folders in use");
    cmd->callback([&ctx] { ctx.out << app::AboutText(ctx.OpenSession()) << "\n"; });
}

} // namespace kori::cli
