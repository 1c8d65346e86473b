// kori targets: the price targets tested against the last day of each security.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "intake/check_targets.h"
#include "platform/text.h"
#include "store/targets_file.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

void AddTargetsCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("targets", "Test the price targets of Targets.txt");
    auto asJson = std::make_shared<bool>(false);
    cmd->add_flag("--json", *asJson, "JSON output: {\"alerts\":[...]}");
    cmd->callback([&ctx, asJson] {
        auto& session = ctx.OpenSession();
        const auto alerts = intake::CheckTargets(
            store::TargetsFilePath(session.folders.SystemFolder), session.folders.DataFolder);
        if (*asJson) {
            json list = json::array();
            for (const auto& a : alerts)
                list.push_back(platform::Latin1ToUtf8(a));
            ctx.out << json{{"alerts", list}}.dump() << "\n";
            return;
        }
        for (const auto& a : alerts)
            ctx.out << a << "\n";
    });
}

} // namespace kori::cli
