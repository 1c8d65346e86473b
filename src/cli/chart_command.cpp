// kori chart: one security's chart to a picture, an SVG drawing, a printed page, the stream,
// and its chart numbers as JSON. kori scale: the automatic scale of a price range.
#include "app/chart_service.h"
#include "chart/print_chart.h"
#include "chart/scale.h"
#include "chart/swing.h"
#include "cli/cli_context.h"
#include "cli/json_out.h"
#include "cli/multi_chart.h"
#include "cli/osc_chart.h"
#include "cli/pdf_output.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/svg_surface.h"
#include "platform/text.h"
#include "raster/raster_surface.h"
#include "store/name_file.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <cstdlib>
#include <iostream>
#include <memory>

#include <unistd.h>

namespace kori::cli {

namespace {

struct ChartOptions {
    std::string code;
    std::string style, period;
    int spacing = 0;
    bool log = false, upsideDown = false, noVolume = false, json = false;
    std::string finish;
    std::string size = "1000x700";
    std::string stream, png, svg, pdf;
    // Overlays, swing and point-and-figure; 0 or empty keeps the chart defaults.
    int ma1 = 0, ma2 = 0;
    bool exponential = false, mma = false, para = false, parav = false;
    std::string bands, swing;
    int reversal = 0;
    float boxValue = 0;
    std::string split; // CODE or CODE:PERIOD of the lower half
    OscChartOptions osc;
    int multi = 0; // 1 or 2: the oscillators of that multi-oscillator set under the chart
};

void ApplySwing(const std::string& text, app::ChartJob& job) {
    auto& r = job.Request;
    const auto colon = text.find(':');
    const auto method = chart::ParseSwingMethod(text.substr(0, colon));
    if (!method) throw CliError{"--swing wants NORM, XDay:N, XPoint:N or XPointAuto"};
    float value = 0;
    if (colon != std::string::npos)
        value = static_cast<float>(platform::Val(text.substr(colon + 1)));
    if (chart::SwingMethodTakesValue(*method) && colon != std::string::npos &&
        !chart::SwingValueValid(*method, value))
        throw CliError{std::string(chart::kSwingRefusal)};
    chart::SwingSwitch swing;
    swing.Set(r, true);
    r.SwingMethod = *method;
    r.SwingValue = value;
    r.SwingPanel = chart::SwingSidePanel(*method);
}

void ApplyOverlays(const ChartOptions& o, app::ChartJob& job) {
    auto& r = job.Request;
    auto& d = job.Defaults;
    if (o.ma1 > 0) {
        r.AvOne = true;
        d.MAPeriod1Daily = d.MAPeriod1Long = static_cast<std::int16_t>(o.ma1);
    }
    if (o.ma2 > 0) {
        r.AvTwo = true;
        d.MAPeriod2Daily = d.MAPeriod2Long = static_cast<std::int16_t>(o.ma2);
    }
    if (o.exponential) d.MAExponential = true;
    if (o.mma) r.MMAOn = true;
    if (o.bands == "percent") r.ChartBands = 1;
    if (o.bands == "bollinger") r.ChartBands = 2;
    if (o.bands == "none") r.ChartBands = 0;
    if (o.para || o.parav) {
        r.AutoOsc = true;
        r.AutoOscCode = o.parav ? "PARAV" : "PARA";
    }
    if (!o.swing.empty()) ApplySwing(o.swing, job);
    if (o.reversal > 0) r.BarSpacing = static_cast<std::int16_t>(o.reversal);
    if (o.boxValue > 0) job.Name.PFIncrement = o.boxValue;
}

// "--split CODE[:PERIOD]": the lower half of a split, at the chart's own period unless named.
void ApplySplit(const app::Session& session, const std::string& text, const ChartOptions& o,
                app::ChartJob& job, app::SplitChart& split) {
    const auto colon = text.find(':');
    const std::string code = platform::Upper(platform::Trim(text.substr(0, colon)));
    const std::string period = colon == std::string::npos ? std::string(1, job.Request.ChartPeriod)
                                                          : platform::Upper(text.substr(colon + 1));
    if (period != "A" && period != "W" && period != "M")
        throw CliError{"--split wants CODE or CODE:PERIOD with the period A, W or M"};
    platform::Status why;
    const auto found =
        code.empty() ? std::nullopt : store::FindCode(session.folders.DataFolder, code, why);
    if (!why) throw CliError{why.message()};
    if (!found) throw CliError{"No record on file for that code: " + code};
    if (!o.osc.osc.empty()) throw CliError{"--split draws no oscillator panel: leave out --osc"};
    split.Choose({found->Record, period[0]}, true);
    if (!split.Applies(job.Request)) throw CliError{"A point-and-figure chart is never split"};
    job.Lower = split.Lower();
}

std::pair<int, int> ParseArea(const std::string& text) {
    const auto x = text.find_first_of("xX");
    int w = 0, h = 0;
    if (x != std::string::npos) {
        w = static_cast<int>(platform::Val(text.substr(0, x)));
        h = static_cast<int>(platform::Val(text.substr(x + 1)));
    }
    if (w < 100 || h < 100 || w > 16000 || h > 16000)
        throw CliError{
            "--size wants WIDTHxHEIGHT in chart units from 100 to 16000, such as 1000x700"};
    return {w, h};
}

void ApplyOptions(const ChartOptions& o, app::ChartJob& job) {
    auto& r = job.Request;
    if (!o.style.empty()) r.ChartStyle = o.style[0];
    if (!o.period.empty()) r.ChartPeriod = o.period[0];
    if (o.spacing > 0) r.BarSpacing = static_cast<std::int16_t>(o.spacing);
    if (o.noVolume) r.ShowVolume = false;
    r.UpsideDown = o.upsideDown;
    if (o.log) job.Defaults.LogBars = job.Defaults.LogLine = true;
    if (!o.finish.empty()) {
        if (!platform::IsValidDateText(o.finish))
            throw CliError{"--finish wants a date as yyyymmdd"};
        r.ByFinishDate = true;
        r.FinishDate = o.finish;
    }
    r.AvOnePeriod = r.ChartPeriod == 'A' ? job.Defaults.MAPeriod1Daily : job.Defaults.MAPeriod1Long;
    r.AvTwoPeriod = r.ChartPeriod == 'A' ? job.Defaults.MAPeriod2Daily : job.Defaults.MAPeriod2Long;
}

void PrintNumbers(std::ostream& to, const chart::Chart& c) {
    json out = {{"first_record", c.FirstRecord},
                {"last_record", c.LastRecord},
                {"last_bar", c.LastBar()},
                {"plot_left", c.PlotLeft},
                {"plot_right", c.PlotRight},
                {"plot_top", c.PlotTop},
                {"plot_bottom", c.PlotBottom},
                {"chart_base", FloatJson(c.ChartBase)},
                {"chart_ceiling", FloatJson(c.ChartCeiling)},
                {"grid_step", FloatJson(c.GridStep)},
                {"grid_count", c.GridCount},
                {"max_high", FloatJson(c.MaxHigh)},
                {"min_low", FloatJson(c.MinLow)}};
    to << out.dump() << "\n";
}

// The stream of this run: a file of its own in the temporary folder, removed when the run
// ends, so that two runs on one library (or a run beside the desktop program) never read or
// overwrite each other's chart.
class PrivateStream {
public:
    explicit PrivateStream(app::Session& session) : m_session(session) {
        std::string name = (app::TempFolder(session) / "TCht-XXXXXX.Tmp").string();
        const int fd = ::mkstemps(name.data(), 4);
        if (fd < 0)
            throw CliError{"Cannot make a chart stream in " + app::TempFolder(session).string()};
        ::close(fd);
        m_path = name;
        m_session.chartStream = m_path;
    }
    ~PrivateStream() {
        m_session.chartStream.clear();
        std::error_code ec;
        std::filesystem::remove(m_path, ec);
    }
    PrivateStream(const PrivateStream&) = delete;
    PrivateStream& operator=(const PrivateStream&) = delete;

private:
    app::Session& m_session;
    std::filesystem::path m_path;
};

void CopyStream(const app::Session& session, const std::string& to) {
    const auto content = platform::ReadWholeFile(app::ChartStreamPath(session));
    if (!content) throw CliError{"No chart stream was written"};
    if (auto s = platform::WriteFileAtomic(to, *content); !s) throw CliError{s.message()};
}

void Run(CliContext& ctx, const ChartOptions& o) {
    auto& session = ctx.OpenSession();
    platform::Status why;
    const auto found = store::FindCode(session.folders.DataFolder, o.code, why);
    if (!why) throw CliError{why.message()};
    if (!found) throw CliError{"No File For That Name: " + platform::Trim(o.code)};
    const auto [w, h] = ParseArea(o.size);
    const PrivateStream stream(session);

    app::ChartJob job;
    job.Name = found->Record;
    job.Defaults = chart::LoadChartDefaults(session.ini());
    chart::LoadChartRequestSettings(session.ini(), job.Request);
    ApplyOptions(o, job);
    ApplyOverlays(o, job);
    chart::PrinterPage page;
    job.Page = &page;
    app::SplitChart split;
    if (!o.split.empty()) ApplySplit(session, o.split, o, job, split);
    if (o.multi != 0) CheckMultiOptions(o.multi, o.osc, !o.split.empty());
    const auto build = [&](chart::Chart& into, platform::Surface& area) {
        if (o.multi != 0) return BuildMultiChart(session, job, o.multi, into, area, o.osc);
        split.Apply(job.Request);
        return BuildChartWithPanel(session, job, into, area, o.osc);
    };

    chart::Chart c;
    platform::Status built;
    if (!o.svg.empty()) {
        platform::SvgSurface area(w, h);
        built = build(c, area);
        if (built) {
            if (auto s = area.Save(o.svg); !s) throw CliError{s.message()};
        }
    }
    if (o.png.empty() && o.svg.empty()) {
        // Numbers, stream or page only: the chart is built on a surface that draws nothing.
        platform::RecordingSurface area(w, h);
        built = build(c, area);
    }
    if (built && !o.png.empty()) {
        raster::RasterSurface area(w, h);
        built = build(c, area);
        if (built) {
            if (auto s = area.SavePng(o.png); !s) throw CliError{s.message()};
        }
    }
    if (!built) throw CliError{built.message()};
    if (!o.pdf.empty()) {
        chart::PrintSettings settings = chart::LoadPrintSettings(session.ini());
        settings.PrintColour = session.printer.PrintColour;
        settings.PrintColourLines = session.printer.PrintColourLines;
        PdfPage page{session.palette, session.fonts, static_cast<double>(w), static_cast<double>(h),
                     settings};
        std::string document;
        if (PlayPdf(app::ChartStreamPath(session), page, document) != chart::PlayOutcome::Played)
            throw CliError{"Cannot print the chart to " + o.pdf};
        if (auto s = platform::WriteFileAtomic(o.pdf, document); !s) throw CliError{s.message()};
    }
    if (!o.stream.empty()) CopyStream(session, o.stream);
    if (o.json) PrintNumbers(ctx.out, c);
}

} // namespace

void AddChartCommand(CLI::App& app, CliContext& ctx) {
    auto o = std::make_shared<ChartOptions>();
    auto* cmd = app.add_subcommand("chart", "Draw the chart of a security");
    cmd->add_option("CODE", o->code, "Security code")->required();
    cmd->add_option("--style", o->style, "B bar, C candlestick, L line, P point and figure")
        ->check(CLI::IsMember({"B", "C", "L", "P"}));
    cmd->add_option("--period", o->period, "A daily, W weekly, M monthly")
        ->check(CLI::IsMember({"A", "W", "M"}));
    cmd->add_option("--spacing", o->spacing, "Chart units between bars (reversal on P)")
        ->check(CLI::Range(1, 20));
    cmd->add_flag("--log", o->log, "Logarithmic price scale");
    cmd->add_flag("--upside-down", o->upsideDown, "High prices at the bottom");
    cmd->add_flag("--no-volume", o->noVolume, "No volume panel");
    cmd->add_option("--finish", o->finish, "Last date shown (yyyymmdd)");
    cmd->add_option("--size", o->size, "Chart area in chart units (default 1000x700)")
        ->option_text("WxH");
    cmd->add_option("--stream", o->stream, "Copy of the chart instruction stream")
        ->option_text("FILE");
    cmd->add_option("--png", o->png, "Picture as the screen shows it")->option_text("FILE");
    cmd->add_option("--svg", o->svg, "SVG drawing as the screen shows it")->option_text("FILE");
    cmd->add_option("--pdf", o->pdf, "A4 page as the printer prints it")->option_text("FILE");
    cmd->add_flag("--json", o->json, "Print the chart numbers as JSON");
    cmd->add_option("--ma1", o->ma1, "Moving average 1 on, with this period")
        ->check(CLI::Range(1, 500));
    cmd->add_option("--ma2", o->ma2, "Moving average 2 on, with this period")
        ->check(CLI::Range(1, 500));
    cmd->add_flag("--exponential", o->exponential, "Exponential moving averages");
    cmd->add_flag("--mma", o->mma, "Multiple moving averages in place of the two averages");
    cmd->add_option("--bands", o->bands, "percent, bollinger or none")
        ->check(CLI::IsMember({"percent", "bollinger", "none"}));
    cmd->add_flag("--para", o->para, "Parabolic stop over the bars");
    cmd->add_flag("--parav", o->parav, "Parabolic stop over the close line");
    cmd->add_option("--swing", o->swing, "Swing lines: NORM, XDay:N, XPoint:N or XPointAuto")
        ->option_text("METHOD");
    cmd->add_option("--reversal", o->reversal, "Boxes in a point-and-figure reversal (2 to 6)")
        ->check(CLI::Range(1, 20));
    cmd->add_option("--box-value", o->boxValue, "Point-and-figure box value (automatic scale)")
        ->check(CLI::PositiveNumber);
    cmd->add_option("--split", o->split,
                    "Split chart: this security (at period A, W or M) in the lower half")
        ->option_text("CODE[:PERIOD]");
    cmd->add_option("--osc", o->osc.osc, "Oscillator panel under the price chart (RSI, MACD, ...)")
        ->option_text("NAME");
    cmd->add_flag("--slow", o->osc.slow, "Slow stochastic with --osc STO");
    cmd->add_option("--multi", o->multi,
                    "The oscillators of multi-oscillator set 1 or 2 stacked under the chart")
        ->option_text("SET");
    cmd->add_option("--set", o->osc.sets, "Override one OscDef key for this run, such as RsiP=9")
        ->option_text("KEY=VALUE");
    cmd->callback([&ctx, o] { Run(ctx, *o); });
}

void AddScaleCommand(CLI::App& app, CliContext& ctx) {
    struct ScaleOptions {
        float high = 0, low = 0;
        bool json = false;
    };
    auto o = std::make_shared<ScaleOptions>();
    auto* cmd =
        app.add_subcommand("scale", "The automatic price scale for a highest and lowest price");
    cmd->add_option("--high", o->high, "Highest price")->required();
    cmd->add_option("--low", o->low, "Lowest price")->required();
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        const chart::ChartScale s = chart::AutoScale(o->high, o->low);
        if (o->json) {
            json out = {{"chart_base", FloatJson(s.ChartBase)},
                        {"chart_ceiling", FloatJson(s.ChartCeiling)},
                        {"grid_step", FloatJson(s.GridStep)},
                        {"grid_count", s.GridCount}};
            ctx.out << out.dump() << "\n";
            return;
        }
        ctx.out << "Base " << platform::FloatText(s.ChartBase) << "  ceiling "
                << platform::FloatText(s.ChartCeiling) << "  grid step "
                << platform::FloatText(s.GridStep) << " (" << s.GridCount << " lines)\n";
    });
}

} // namespace kori::cli
