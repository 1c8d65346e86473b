// kori chart --osc (the panel under the price chart) and kori indicator (an oscillator's
// values as CSV, one row a bar).
#include "app/colour_table.h"
#include "app/osc_service.h"
#include "cli/cli_context.h"
#include "cli/osc_chart.h"
#include "osc/osc_identifiers.h"
#include "osc/osc_panel.h"
#include "platform/files.h"
#include "platform/sub_surface.h"
#include "platform/text.h"
#include "store/load_chart_series.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <CLI/CLI.hpp>

#include <charconv>
#include <iostream>
#include <memory>

namespace kori::cli {

namespace {

std::string CheckedOscName(const std::string& text) {
    const std::string name = platform::Upper(platform::Trim(text));
    const osc::OscIdentifier* id = osc::FindOscIdentifier(name);
    if (id == nullptr) {
        std::string known;
        for (const auto& i : osc::OscIdentifiers())
            if (!i.OnPriceChart) known += (known.empty() ? "" : ", ") + std::string(i.OscName);
        throw CliError{"Unknown oscillator " + text + " (one of " + known + ")"};
    }
    if (id->OnPriceChart)
        throw CliError{name + " is drawn on the price chart, not in an oscillator panel"};
    return name;
}

} // namespace

void ApplyOscSets(osc::OscDef& def, const std::vector<std::string>& sets) {
    for (const std::string& set : sets) {
        const auto eq = set.find('=');
        if (eq != std::string::npos && osc::FindOscPeriodKeyByName(set.substr(0, eq)) != nullptr &&
            platform::Val(set.substr(eq + 1)) < 0)
            throw CliError{"--set " + set + ": an oscillator period cannot be negative"};
        if (eq == std::string::npos || !app::SetOscKey(def, set.substr(0, eq), set.substr(eq + 1)))
            throw CliError{"--set wants KEY=VALUE with a key of section OscDef, such as RsiP=9: " +
                           set};
    }
}

void PreparePanelPage(app::ChartJob& job, double areaHeight, const OscChartOptions& o) {
    if (o.osc.empty() || job.Page == nullptr) return;
    job.Page->SecondPanelHeight = osc::SplitChartArea(static_cast<int>(areaHeight)).PanelHeight;
}

platform::Status BuildChartWithPanel(app::Session& session, app::ChartJob& job, chart::Chart& c,
                                     platform::Surface& area, const OscChartOptions& o) {
    if (o.osc.empty()) return app::BuildSecurityChart(session, job, c, area);
    const std::string name = CheckedOscName(o.osc);
    const osc::PanelSplit split = osc::SplitChartArea(static_cast<int>(area.ScaleHeight()));
    platform::SubSurface priceArea(area, 0, split.PriceHeight);
    platform::SubSurface panelArea(area, split.PriceHeight, split.PanelHeight);
    job.Request.SecondPanelShowing = true;
    job.Request.AutoOsc = true;
    job.Request.AutoOscCode = name;
    job.Request.AutoOscSlow = o.slow;
    auto built = app::BuildSecurityChart(session, job, c, priceArea);
    if (!built) return built;
    // The panel shows empty, as the chart window's does, when its routine draws nothing.
    panelArea.SetBackColour(session.palette[osc::oscpal::Background]);
    panelArea.Clear();
    app::OscPanelJob panel;
    panel.OscName = name;
    panel.SlowStochastic = o.slow;
    panel.PanelOffset = split.PriceHeight;
    panel.PriceSurface = &priceArea;
    if (!o.sets.empty()) {
        osc::OscDef def = osc::ReadOscSettings(session.ini());
        ApplyOscSets(def, o.sets);
        panel.Settings = def;
    }
    const osc::OscOutcome outcome = app::DrawSecurityOscillator(session, job, c, panel, panelArea);
    if (outcome == osc::OscOutcome::NotValid)
        return platform::Status::Error(name + " Oscillator values not valid");
    if (outcome == osc::OscOutcome::NotSet)
        std::cerr << "kori: the period of " << name
                  << " is 0 in section OscDef of Kori.ini: no panel drawn\n";
    if (outcome == osc::OscOutcome::DailyOnly) {
        // As the chart window does: the price chart goes back to the full area.
        job.Request.SecondPanelShowing = false;
        return app::BuildSecurityChart(session, job, c, area);
    }
    return built;
}

namespace {

struct IndicatorOptions {
    std::string name, code;
    std::string period = "A";
    int first = 1, last = 0;
    std::vector<std::string> sets;
    bool slow = false, csv = false;
};

// Values of float series are written as the float they are; ATR's four-decimal money and
// whole numbers in their shortest exact form.
std::string CsvNumber(double v) {
    const auto f = static_cast<float>(v);
    if (static_cast<double>(f) == v) return platform::FloatText(f);
    char buf[32];
    const auto r = std::to_chars(buf, buf + sizeof buf, v);
    return std::string(buf, r.ptr);
}

void RunIndicator(CliContext& ctx, const IndicatorOptions& o) {
    if (!o.csv) throw CliError{"kori indicator writes CSV only: add --csv"};
    const std::string name = CheckedOscName(o.name);
    auto& session = ctx.OpenSession();
    platform::Status why;
    const auto found = store::FindCode(session.folders.DataFolder, o.code, why);
    if (!why) throw CliError{why.message()};
    if (!found) throw CliError{"No File For That Name: " + platform::Trim(o.code)};
    const store::NameRecord& rec = found->Record;

    osc::OscDef def = osc::ReadOscSettings(session.ini());
    ApplyOscSets(def, o.sets);
    if (const auto problem = osc::NegativePeriodProblem(def, name, o.period))
        throw CliError{problem->text};

    const auto path = store::PriceFile::PathFor(session.folders.DataFolder, rec.Code);
    store::PriceFile pf(path);
    if (auto st = pf.OpenWithData(); !st) throw CliError{st.message()};
    store::SeriesRequest q;
    if (auto st = store::SetRecordRange(q, o.first, o.last > 0 ? o.last : 0, pf.Count(),
                                        path.filename().string());
        !st)
        throw CliError{st.message()};
    q.Period = o.period[0];
    q.WantVolume = true;
    q.RecordType = rec.RecordType;
    store::ChartSeries series;
    if (auto st = store::LoadChartSeries(path.string(), q, series); !st)
        throw CliError{st.message()};

    osc::OscInputs in;
    in.ChartPeriod = o.period;
    in.RecordType = rec.RecordType;
    in.SlowStochastic = o.slow;
    in.FirstRecord = q.FirstRecord;
    app::LoadedCompareFile compare;
    std::optional<store::ChartSeries> own;
    // RMO pairs records, not bars: on weekly and monthly bars it has no meaning.
    if (name == "RMO" && o.period != "A") throw CliError{"RMO only available on Daily Charts"};
    if (name == "RMO" || name == "RMX") {
        compare = app::LoadCompareFile(session, def.CompFile);
        if (compare.CompareCode.empty())
            throw CliError{"No comparison file for " + name + " (CompFile of section OscDef)"};
        in.CompareFile = &compare.Series;
        if (name == "RMO") {
            own = app::LoadWholePriceFile(path);
            if (own) in.SecurityFile = &*own;
        }
    }
    const auto table = osc::ComputeOscillator(name, series, def, in);
    if (!table) throw CliError{name + " has no values to export"};

    std::string out = "index,date";
    for (const auto& col : table->columns)
        out += "," + col;
    out += "\n";
    for (std::size_t i = 0; i < table->RowCount(); ++i) {
        out += std::to_string(i) + "," + platform::Trim(series.ChartBars[i].DateText());
        for (const auto& v : table->Row(i)) {
            out += ',';
            if (v) out += CsvNumber(*v);
        }
        out += '\n';
    }
    ctx.out << out;
}

} // namespace

void AddIndicatorCommand(CLI::App& app, CliContext& ctx) {
    auto o = std::make_shared<IndicatorOptions>();
    auto* cmd = app.add_subcommand("indicator", "An oscillator's values for every bar, as CSV");
    cmd->add_option("NAME", o->name,
                    "Oscillator: RSI STO FX ROC R/F MOM MACD COP ERY ATR VTY "
                    "OBV DM WMS JHG RMO RMX")
        ->required();
    cmd->add_option("CODE", o->code, "Security code")->required();
    cmd->add_option("--period", o->period, "A daily, W weekly, M monthly")
        ->check(CLI::IsMember({"A", "W", "M"}));
    cmd->add_option("--first", o->first, "First record (1-based; default 1)");
    cmd->add_option("--last", o->last, "Last record (default: the record count)");
    cmd->add_option("--set", o->sets, "Override one OscDef key for this run, such as RsiP=9")
        ->option_text("KEY=VALUE");
    cmd->add_flag("--slow", o->slow, "Slow stochastic (STO)");
    cmd->add_flag("--csv", o->csv, "index,date and the oscillator's columns, one row a bar");
    cmd->callback([&ctx, o] { RunIndicator(ctx, *o); });
}

} // namespace kori::cli
