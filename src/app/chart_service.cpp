#include "app/chart_service.h"

#include "chart/file_price_source.h"
#include "chart/targets.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"

namespace kori::app {

std::filesystem::path TempFolder(const Session& session) {
    const std::filesystem::path dir = session.folders.SystemFolder + "temp";
    platform::CreateFolder(dir);
    return dir;
}

std::filesystem::path ChartStreamPath(const Session& session) {
    if (!session.chartStream.empty()) return session.chartStream;
    return TempFolder(session) / "TCht.Tmp";
}

chart::ChartName ChartNameOf(const store::NameRecord& r) {
    chart::ChartName n;
    n.Code = platform::Trim(r.Code);
    n.Name = r.Name;
    n.OtherDetails = r.OtherDetails;
    n.RecordType = r.RecordType;
    n.Base = r.Base;
    n.Top = r.Top;
    n.PercentBandUp = r.BandUp();
    n.PercentBandDown = r.BandDown();
    n.PFIncrement = r.PFIncrement;
    return n;
}

ChartContext ChartContext::Of(Session& session, bool writeStream, platform::Dialogs* dialogs) {
    return ChartContext{session.palette,
                        session.fonts,
                        dialogs ? *dialogs : session.dialogs(),
                        session.folders.DataFolder,
                        std::filesystem::path(session.folders.SystemFolder),
                        writeStream ? ChartStreamPath(session) : std::filesystem::path(),
                        session.download.VolumeDivisor};
}

platform::Status BuildSecurityChart(Session& session, const ChartJob& job, chart::Chart& chart,
                                    platform::Surface& surface) {
    return BuildSecurityChart(ChartContext::Of(session, job.WriteStream), job, chart, surface);
}

platform::Status BuildSecurityChart(const ChartContext& context, const ChartJob& job,
                                    chart::Chart& chart, platform::Surface& surface) {
    chart::FilePriceSource source(store::PriceFile::PathFor(context.DataFolder, job.Name.Code));
    if (auto s = source.Open(); !s) {
        context.Dialogs.MsgBox(s.message(), "Chart Display");
        return s;
    }
    const chart::ChartName name = ChartNameOf(job.Name);
    const bool split = job.Request.SplitMode && job.Lower.has_value();
    const std::string lowerCode = split ? platform::Trim(job.Lower->Name.Code) : std::string();
    chart::FilePriceSource lowerSource(
        store::PriceFile::PathFor(context.DataFolder, split ? lowerCode : job.Name.Code));
    chart::ChartName lowerName;
    chart::SplitLowerHalf lower;
    if (split) {
        if (auto s = lowerSource.Open(); !s) {
            context.Dialogs.MsgBox(s.message(), "Chart Display");
            return s;
        }
        lowerName = ChartNameOf(job.Lower->Name);
        lower = {&lowerName, &lowerSource, job.Lower->ChartPeriod};
    }
    chart::ChartBuild build{job.Request,
                            job.Defaults,
                            name,
                            context.Palette,
                            context.Fonts,
                            context.Dialogs,
                            job.WriteStream ? context.StreamPath : std::filesystem::path(),
                            false, // no setting holds the bold-print option yet
                            context.VolumeDivisor,
                            job.Page,
                            {}};
    if (split) build.Lower = &lower;
    // Target lines go on last, while the stream is still open; each half has its security's.
    const auto targetsFile = context.SystemFolder / "Targets.txt";
    const std::vector<float> targets = chart::ReadTargetPrices(targetsFile, name.Code);
    const std::vector<float> lowerTargets =
        split ? chart::ReadTargetPrices(targetsFile, lowerCode) : std::vector<float>();
    build.DrawOverlays = [&job, &context, &targets, &lowerTargets](chart::Chart& c,
                                                                   const chart::ChartRequest& half,
                                                                   platform::Surface& s) {
        const bool lowerHalf = half.SplitMode && half.SplitHalf == 2;
        chart::DrawTargetLines(c, s, context.Palette, lowerHalf ? lowerTargets : targets);
        if (job.DrawOverlays) job.DrawOverlays(c, half, s);
    };
    return chart::BuildChart(chart, build, source, surface);
}

} // namespace kori::app
