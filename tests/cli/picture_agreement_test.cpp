// The chart picture kori draws without the desktop's painting libraries against the same chart
// drawn by the desktop's chart area: lines on the same pixels, text in the same places.
#include "chart/chart_defaults.h"
#include "chart/swing.h"
#include "cli/cli_context.h"
#include "cli/osc_chart.h"
#include "cli/paper/gui_app.h"
#include "gui/paint/qt_surface.h"
#include "kori_run.h"
#include "raster/raster_surface.h"
#include "store/name_file.h"

#include <QImage>

#include <functional>
#include <iostream>
#include <random>
#include <sstream>

namespace kori::test {
namespace {

using platform::LineStyle;
using platform::Rgb;

std::uint32_t QtAt(const QImage& image, int x, int y) {
    return image.pixel(x, y) & 0xFFFFFF;
}
std::uint32_t RasterAt(const raster::RasterSurface& s, int x, int y) {
    return s.PixelAt(x, y) & 0xFFFFFF;
}

int Distance(std::uint32_t a, std::uint32_t b) {
    int most = 0;
    for (int shift = 0; shift <= 16; shift += 8)
        most = std::max(most, std::abs(static_cast<int>((a >> shift) & 0xFF) -
                                       static_cast<int>((b >> shift) & 0xFF)));
    return most;
}

struct Agreement {
    int differing = 0;     // pixels not equal
    int unmatched = 0;     // pixels with no equal neighbour within one pixel either way
    long textDistance = 0; // summed channel distance over smoothed (grey-edged) pixels
    int smoothed = 0;
    int total = 0;
};

Agreement Compare(const QImage& qt, const raster::RasterSurface& ours, int w, int h) {
    Agreement a;
    a.total = w * h;
    for (int y = 0; y < h; ++y)
        for (int x = 0; x < w; ++x) {
            const std::uint32_t want = QtAt(qt, x, y);
            const std::uint32_t got = RasterAt(ours, x, y);
            if (want != got) {
                ++a.differing;
                bool near = false;
                for (int dy = -1; dy <= 1 && !near; ++dy)
                    for (int dx = -1; dx <= 1 && !near; ++dx) {
                        const int nx = x + dx, ny = y + dy;
                        if (nx < 0 || ny < 0 || nx >= w || ny >= h) continue;
                        near = RasterAt(ours, nx, ny) == want || QtAt(qt, nx, ny) == got;
                    }
                if (!near) ++a.unmatched;
            }
            a.textDistance += Distance(want, got);
        }
    return a;
}

class PictureAgreement : public SampleRootSuite {
protected:
    static void SetUpTestSuite() {
        SampleRootSuite::SetUpTestSuite();
        cli::EnsureGuiApplication();
    }

    // Builds one chart of the sample on both surfaces and compares them.
    static Agreement Chart(const std::string& code, const std::function<void(app::ChartJob&)>& set,
                           const std::string& osc = {}, const std::string& name = {}) {
        std::ostringstream out, err;
        cli::CliContext ctx(out, err);
        ctx.root = Root();
        auto& session = ctx.OpenSession();
        platform::Status why;
        const auto found = store::FindCode(session.folders.DataFolder, code, why);
        EXPECT_TRUE(found.has_value()) << code;
        if (!found) return {};
        constexpr int w = 1000, h = 700;
        const auto draw = [&](platform::Surface& area) {
            app::ChartJob job;
            job.Name = found->Record;
            job.Defaults = chart::LoadChartDefaults(session.ini());
            chart::LoadChartRequestSettings(session.ini(), job.Request);
            set(job);
            chart::Chart c;
            cli::OscChartOptions o;
            o.osc = osc;
            EXPECT_TRUE(cli::BuildChartWithPanel(session, job, c, area, o).ok()) << code;
        };
        gui::ImageSurface qt(w, h);
        draw(qt);
        const QImage picture = qt.Finish().copy();
        raster::RasterSurface ours(w, h);
        draw(ours);
        if (!name.empty() && std::getenv("KORI_KEEP_PICTURES") != nullptr) {
            picture.save(QString::fromStdString("/tmp/" + name + "-qt.png"));
            (void)ours.SavePng("/tmp/" + name + "-raster.png");
            QImage diff(w, h, QImage::Format_RGB32);
            for (int y = 0; y < h; ++y)
                for (int x = 0; x < w; ++x)
                    diff.setPixel(x, y,
                                  QtAt(picture, x, y) == RasterAt(ours, x, y)
                                      ? 0xFF000000u | ((QtAt(picture, x, y) >> 2) & 0x3F3F3F)
                                      : 0xFFFF0000u);
            diff.save(QString::fromStdString("/tmp/" + name + "-diff.png"));
        }
        return Compare(picture, ours, w, h);
    }
};

// A user would notice a line moved or missing, text in another place or weight. One pixel in a
// thousand with no equal pixel beside it is a few smoothed text edges; a line one pixel off
// over its length, or a label in the wrong place, is far more. Dotted averages whose dots
// start a pixel apart differ on many pixels by a whole colour, hence the mean distance.
void ExpectAlike(const Agreement& a, const std::string& what) {
    ASSERT_GT(a.total, 0);
    const double unmatched = static_cast<double>(a.unmatched) / a.total;
    const double differing = static_cast<double>(a.differing) / a.total;
    std::cout << what << ": differing " << a.differing << ", unmatched " << a.unmatched
              << ", mean distance " << static_cast<double>(a.textDistance) / a.total << "\n";
    EXPECT_LT(unmatched, 0.001) << what;
    EXPECT_LT(differing, 0.006) << what;
    EXPECT_LT(static_cast<double>(a.textDistance) / a.total, 1.5) << what;
}

// Short thin lines at any fraction, in every style and direction, as the overlays draw them.
TEST(ThinLineAgreement, RandomLinesTakeTheSamePixels) {
    cli::EnsureGuiApplication();
    std::mt19937 random(7);
    std::uniform_real_distribution<double> at(2, 38);
    int mismatched = 0;
    for (int i = 0; i < 600; ++i) {
        const auto style = static_cast<LineStyle>(i % 3);
        double c[4];
        for (double& v : c)
            v = i % 2 == 0 ? std::round(at(random) * 2) / 2 : at(random);
        gui::ImageSurface qt(40, 40);
        qt.SetLineStyle(style);
        qt.Line(c[0], c[1], c[2], c[3], 0);
        const QImage picture = qt.Finish().copy();
        raster::RasterSurface ours(40, 40);
        ours.SetLineStyle(style);
        ours.Line(c[0], c[1], c[2], c[3], 0);
        const Agreement a = Compare(picture, ours, 40, 40);
        // Lines along an axis agree pixel for pixel; a slanting line may take a step a pixel
        // apart here and there, and a broken one start its dashes a pixel apart.
        const bool slanting = c[0] != c[2] && c[1] != c[3];
        if (!slanting)
            EXPECT_EQ(a.differing, 0) << c[0] << "," << c[1] << " " << c[2] << "," << c[3];
        else
            mismatched += a.differing;
    }
    std::cout << "slanting lines: " << mismatched << " pixels differ\n";
    EXPECT_LT(mismatched, 4000);
}

TEST_F(PictureAgreement, EveryStyleWithOverlaysAndPanelsLooksTheSame) {
    ExpectAlike(Chart(
                    "KRM", [](app::ChartJob&) {}, {}, "bars"),
                "daily bars");
    ExpectAlike(Chart(
                    "HBK",
                    [](app::ChartJob& j) {
                        j.Request.ChartStyle = 'C';
                        j.Request.ChartPeriod = 'W';
                        j.Request.BarSpacing = 4;
                    },
                    {}, "candles"),
                "weekly candles");
    ExpectAlike(Chart(
                    "XAO",
                    [](app::ChartJob& j) {
                        j.Request.ChartStyle = 'L';
                        j.Request.AvOne = j.Request.AvTwo = true;
                        j.Request.ChartBands = 2;
                    },
                    {}, "line"),
                "line with averages and bands");
    ExpectAlike(Chart(
                    "KRM", [](app::ChartJob&) {}, "RSI", "rsi"),
                "bars with an RSI panel");
    ExpectAlike(Chart(
                    "BWG", [](app::ChartJob&) {}, "MACD", "macd"),
                "bars with a MACD panel");
    ExpectAlike(Chart(
                    "KRM",
                    [](app::ChartJob& j) {
                        j.Request.ChartStyle = 'P';
                        j.Request.BarSpacing = 3;
                    },
                    {}, "pf"),
                "point and figure");
    ExpectAlike(Chart(
                    "HBK",
                    [](app::ChartJob& j) {
                        chart::SwingSwitch swing;
                        swing.Set(j.Request, true);
                        j.Request.SwingMethod = *chart::ParseSwingMethod("XPointAuto");
                        j.Request.SwingPanel = chart::SwingSidePanel(j.Request.SwingMethod);
                    },
                    {}, "swing"),
                "swing");
}

} // namespace
} // namespace kori::test
