// kori play: a saved chart or stream played to a picture (the screen's rules) or to a PDF page
// (the paper's rules), with no market data at all.
#include "app/install_root.h"
#include "chart/print_chart.h"
#include "chart/screen_player.h"
#include "cli/cli_context.h"
#include "cli/pdf_output.h"
#include "platform/files.h"
#include "platform/svg_surface.h"
#include "platform/text.h"
#include "raster/raster_surface.h"

#include <CLI/CLI.hpp>

#include <iostream>
#include <memory>

namespace kori::cli {

namespace {

struct PlayOptions {
    std::string source;
    std::string png, svg, pdf;
    std::string size = "1000x700";
    bool landscape = false;
};

// Chart roles 16 to 44 of the built-in colour scheme, as standard palette numbers.
constexpr int kBuiltInRoles[] = {3,  0,  15, 14, 10, 12, 14, 2,  6,  13, 14, 7, 4,  12, 10,
                                 11, 14, 2,  11, 8,  10, 11, 10, 11, 14, 14, 6, 12, 10};

platform::Palette BuiltInPalette() {
    platform::Palette p{};
    for (std::size_t i = 0; i < platform::kStandardColours.size(); ++i)
        p[i] = platform::kStandardColours[i];
    std::size_t entry = 16;
    for (int n : kBuiltInRoles)
        p[entry++] = platform::kStandardColours[static_cast<std::size_t>(n)];
    return p;
}

std::pair<int, int> ParseSize(const std::string& text) {
    const auto x = text.find_first_of("xX");
    int w = 0, h = 0;
    if (x != std::string::npos) {
        w = static_cast<int>(platform::Val(text.substr(0, x)));
        h = static_cast<int>(platform::Val(text.substr(x + 1)));
    }
    if (w < 1 || h < 1 || w > 32767 || h > 32767)
        throw CliError{"--size wants WIDTHxHEIGHT in chart units, such as 1000x700"};
    return {w, h};
}

// The print settings of the library when there is one, else the defaults.
chart::PrintSettings PrintSettingsFor(const CliContext& ctx, bool landscape) {
    const auto ini = app::FindInstallRoot(ctx.root) / "Kori.ini";
    chart::PrintSettings s;
    if (platform::FileExists(ini)) s = chart::LoadPrintSettings(platform::IniFile(ini));
    if (landscape) s.PrintOrientation = platform::kLandscape;
    return s;
}

// Outputs are written whole or not at all, so a failure leaves whatever file was there.
[[noreturn]] void Fail(const std::string& message) {
    throw CliError{message};
}

void PlayToScreenPicture(const PlayOptions& o, int w, int h) {
    const auto palette = BuiltInPalette();
    const platform::ChartFonts fonts;
    platform::ScriptedDialogs messages; // collected, then told as the tool's error
    const auto show = [&](platform::Surface& area) {
        if (!chart::ShowSavedChart(o.source, area, palette, fonts, messages))
            throw CliError{messages.messages().front()};
    };
    if (!o.svg.empty()) {
        platform::SvgSurface area(w, h);
        show(area);
        if (auto s = area.Save(o.svg); !s) throw CliError{s.message()};
        return;
    }
    raster::RasterSurface area(w, h);
    show(area);
    if (auto s = area.SavePng(o.png); !s) throw CliError{s.message()};
}

void PlayToPaper(const CliContext& ctx, const PlayOptions& o, int w, int h) {
    const auto palette = BuiltInPalette();
    const platform::ChartFonts fonts;
    PdfPage page{palette, fonts, static_cast<double>(w), static_cast<double>(h),
                 PrintSettingsFor(ctx, o.landscape)};
    std::string document;
    const chart::PlayOutcome outcome = PlayPdf(o.source, page, document);
    if (outcome == chart::PlayOutcome::PrinterFailed) Fail("Cannot write " + o.pdf);
    if (outcome != chart::PlayOutcome::Played) Fail(chart::kFormatInvalidText);
    // Only a page played whole replaces the file.
    if (auto s = platform::WriteFileAtomic(o.pdf, document); !s) Fail(s.message());
}

} // namespace

void AddPlayCommand(CLI::App& app, CliContext& ctx) {
    auto o = std::make_shared<PlayOptions>();
    auto* cmd = app.add_subcommand(
        "play", "Play a saved chart (.cht) or chart stream to a picture or a printed page");
    cmd->add_option("file", o->source, "Saved chart or stream (TCht.Tmp)")->required();
    auto* out = cmd->add_option_group("output", "Where the chart goes");
    out->add_option("--png", o->png, "Picture as the screen shows it")->option_text("FILE");
    out->add_option("--svg", o->svg, "SVG drawing as the screen shows it")->option_text("FILE");
    out->add_option("--pdf", o->pdf, "A4 page as the printer prints it")->option_text("FILE");
    out->require_option(1);
    cmd->add_option("--size", o->size, "Chart area in chart units (default 1000x700)")
        ->option_text("WxH");
    cmd->add_flag("--landscape", o->landscape, "Print the page in landscape");
    cmd->callback([&ctx, o] {
        const auto [w, h] = ParseSize(o->size);
        if (!o->pdf.empty())
            PlayToPaper(ctx, *o, w, h);
        else
            PlayToScreenPicture(*o, w, h);
    });
}

} // namespace kori::cli
