// kori details: the download program's table of security details loaded, and one security's
// details shown with the chart window's figures.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "app/download_list_form.h"
#include "app/session.h"
#include "maint/security_details.h"
#include "platform/text.h"
#include "store/price_file.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

namespace {

struct DetailsOptions {
    bool refresh = false;
    std::string code;
    bool json = false;
};

// The close of the security's last record; 0 without a price file or records.
double LastClose(const std::string& dataFolder, const std::string& code) {
    store::PriceFile f(store::PriceFile::PathFor(dataFolder, code));
    store::PriceRecord last;
    if (!f.Open() || f.Count() == 0 || !f.Read(f.Count(), last)) return 0;
    return last.Close;
}

} // namespace

void AddDetailsCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("details", "Load or show the security details table");
    auto o = std::make_shared<DetailsOptions>();
    cmd->add_flag("--refresh", o->refresh, "Load the table waiting in the download In folder");
    cmd->add_option("CODE", o->code, "The security whose details are shown");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const std::string& system = session.folders.SystemFolder;
        if (o->refresh) {
            const std::string in = app::DownloadInFolder(session);
            if (in.empty()) throw CliError{"The download In folder is not set ([Download] In)"};
            const auto r = maint::RefreshSecurityDetails(system, in);
            if (!r.Status) throw CliError{r.Status.message()};
            const auto uk = maint::RefreshUKSecurityDetails(system, in);
            if (!uk.Status) throw CliError{uk.Status.message()};
            if (o->json) {
                ctx.out << json{{"loaded", r.Loaded}, {"records", r.Records}}.dump() << "\n";
            } else if (r.Loaded) {
                ctx.out << "Security details loaded: " << r.Records << " records\n";
            } else {
                ctx.out << "No security details table waiting in " << in << "\n";
            }
        }
        if (o->code.empty()) {
            if (!o->refresh) throw CliError{"Give a CODE or --refresh"};
            return;
        }
        const auto details = maint::LookUpSecurityDetails(system, o->code);
        if (!details) throw CliError{"No security details for " + platform::Upper(o->code)};
        const auto header = maint::ReadDetailsHeader(system);
        const auto box = maint::DetailsTextBox(
            header, *details, LastClose(session.folders.DataFolder, details->Code));
        // Fields are labelled by the header after its code column.
        auto labelOf = [&](std::size_t i) {
            return i + 1 < header.Labels.size() ? header.Labels[i + 1] : std::to_string(i + 2);
        };
        if (o->json) {
            json fields = json::array();
            for (std::size_t i = 0; i < details->Fields.size(); ++i)
                fields.push_back({{"label", platform::Latin1ToUtf8(labelOf(i))},
                                  {"value", platform::Latin1ToUtf8(details->Fields[i])}});
            json lines = json::array();
            for (const auto& l : box)
                lines.push_back(l);
            ctx.out << json{{"code", details->Code}, {"fields", fields}, {"text_box", lines}}.dump()
                    << "\n";
            return;
        }
        ctx.out << details->Code << "\n";
        for (std::size_t i = 0; i < details->Fields.size(); ++i)
            ctx.out << "  " << labelOf(i) << ": " << details->Fields[i] << "\n";
        for (const auto& l : box)
            ctx.out << l << "\n";
    });
}

} // namespace kori::cli
