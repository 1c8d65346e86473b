#include "cli/multi_chart.h"

#include "app/multi_osc_chart.h"
#include "cli/cli_context.h"
#include "osc/osc_identifiers.h"

namespace kori::cli {

void CheckMultiOptions(int set, const OscChartOptions& osc, bool split) {
    if (!app::MultiOscSetValid(set))
        throw CliError{"--multi wants the set 1 or 2 (Multi-Osc 1, Multi-Osc 2)"};
    if (!osc.osc.empty()) throw CliError{"--multi draws the panels of its set: leave out --osc"};
    if (split) throw CliError{"--multi draws no split chart: leave out --split"};
}

platform::Status BuildMultiChart(app::Session& session, const app::ChartJob& job, int set,
                                 chart::Chart& c, platform::Surface& area,
                                 const OscChartOptions& osc) {
    app::PanelOptions options;
    if (!osc.sets.empty()) {
        osc::OscDef def = osc::ReadOscSettings(session.ini());
        ApplyOscSets(def, osc.sets);
        options.Settings = def;
    }
    const osc::MultiOscSet slots = osc::LoadMultiOscSet(session.services().settings, set);
    return app::BuildMultiOscChart(session, job, set, slots, c, area, options).Status;
}

} // namespace kori::cli
