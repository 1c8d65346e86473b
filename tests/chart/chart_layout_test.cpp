// What the chart draws stays inside its frame and text does not print over text: overlays are
// cut at the plot's frame, labels are placed where nothing else prints, and the stamp keeps its
// blank through the stream.
#include "chart/draw_frame.h"
#include "chart/draw_labels.h"
#include "chart/geometry.h"
#include "chart/stream_reader.h"
#include "chart_test_rig.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <regex>

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::Starting;

namespace {

struct Call {
    std::string Kind;
    double X1 = 0, Y1 = 0, X2 = 0, Y2 = 0;
    double Size = 0;
    std::string Text;
    unsigned long Colour = 0;
};

// The recording surface's lines and texts, parsed.
std::vector<Call> Parse(const std::vector<std::string>& calls) {
    static const std::regex shape(
        R"(^(Line|Box|FilledBox) ([-\d.]+),([-\d.]+),([-\d.]+),([-\d.]+) #(\d+))");
    static const std::regex text(R"(^Text ([-\d.]+),([-\d.]+) size ([\d.]+)[^#]*#(\d+) \[(.*)\]$)");
    static const std::regex point(R"(^Point ([-\d.]+),([-\d.]+) #(\d+))");
    std::vector<Call> out;
    for (const auto& c : calls) {
        std::smatch m;
        if (std::regex_search(c, m, shape))
            out.push_back({m[1], std::stod(m[2]), std::stod(m[3]), std::stod(m[4]), std::stod(m[5]),
                           0, "", std::stoul(m[6])});
        else if (std::regex_search(c, m, text))
            out.push_back({"Text", std::stod(m[1]), std::stod(m[2]), 0, 0, std::stod(m[3]), m[5],
                           std::stoul(m[4])});
        else if (std::regex_search(c, m, point))
            out.push_back({"Point", std::stod(m[1]), std::stod(m[2]), std::stod(m[1]),
                           std::stod(m[2]), 0, "", std::stoul(m[3])});
    }
    return out;
}

// The recording surface's text box: 0.6 of the size a character, 1.5 of it a line.
struct Box {
    double Left, Top, Right, Bottom;
};
Box TextBox(const Call& t) {
    return {t.X1, t.Y1, t.X1 + 0.6 * t.Size * static_cast<double>(t.Text.size()),
            t.Y1 + 1.5 * t.Size};
}
bool Overlap(const Box& a, const Box& b) {
    return a.Left < b.Right && b.Left < a.Right && a.Top < b.Bottom && b.Top < a.Bottom;
}

std::string Day(int n) {
    // Consecutive calendar days from 1 January 2024, enough for a few years of bars.
    static const int lengths[] = {31, 29, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31,
                                  31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    int year = 2024, month = 0;
    while (n >= lengths[month % 24]) {
        n -= lengths[month % 24];
        if (++month % 12 == 0) ++year;
    }
    char buf[16];
    std::snprintf(buf, sizeof buf, "%04d%02d%02d", year, month % 12 + 1, n + 1);
    return buf;
}

} // namespace

TEST(Clipping, ALineKeepsOnlyItsPartInsideTheFrame) {
    const PlotRect f{0, 0, 100, 50};
    auto s = ClipToFrame(f, 10, 10, 20, 20);
    ASSERT_TRUE(s);
    EXPECT_EQ(s->X1, 10);
    EXPECT_EQ(s->Y2, 20);
    s = ClipToFrame(f, 10, 40, 30, 60); // out through the bottom at x 20
    ASSERT_TRUE(s);
    EXPECT_DOUBLE_EQ(s->X2, 20);
    EXPECT_DOUBLE_EQ(s->Y2, 50);
    EXPECT_DOUBLE_EQ(s->X1, 10);
    s = ClipToFrame(f, -50, 25, 150, 25);
    ASSERT_TRUE(s);
    EXPECT_DOUBLE_EQ(s->X1, 0);
    EXPECT_DOUBLE_EQ(s->X2, 100);
    EXPECT_FALSE(ClipToFrame(f, 10, 60, 90, 70)); // wholly below
    EXPECT_FALSE(ClipToFrame(f, 110, 10, 110, 20));
    EXPECT_TRUE(ClipToFrame(f, 100, 50, 100, 50)); // a point on the edge
}

TEST(Clipping, BandsBeyondTheScaleStopAtTheFrame) {
    for (int kind : {1, 2}) {
        ChartRig r;
        r.request.ChartBands = static_cast<std::int16_t>(kind);
        r.request.ShowVolume = true;
        r.defaults.BollingerDaily = 5;
        r.name.PercentBandUp = 40;
        // Closes that climb across the whole scale, jumping about: the bands leave it at both
        // ends.
        for (int d = 0; d < 30; ++d) {
            const float c = 15 + 2.5f * static_cast<float>(d) + (d % 2 ? 6.0f : -6.0f);
            r.Add(Day(d), c, c + 1, c - 1, c, 1000 + 10 * d);
        }
        ASSERT_TRUE(r.Build().ok());
        const double top = std::min(r.chart.PlotTop, r.chart.PlotBottom);
        const double bottom = std::max(r.chart.PlotTop, r.chart.PlotBottom);
        int bands = 0, cut = 0;
        for (const Call& c : Parse(r.Calls())) {
            if (c.Kind != "Line" || c.Colour != 41) continue;
            ++bands;
            for (double y : {c.Y1, c.Y2}) {
                cut += y == top || y == bottom;
                EXPECT_GE(y, top) << kind;
                EXPECT_LE(y, bottom) << kind << ": into the volume panel";
            }
        }
        EXPECT_GT(bands, 10) << kind;
        EXPECT_GT(cut, 0) << kind << ": the case leaves the scale";
        for (const auto& l : Starting(r.Lines(), "L,")) {
            StreamFields f;
            ASSERT_TRUE(SplitStreamLine(l, f));
            if (f[5] != "41") continue;
            for (int i : {2, 4}) {
                EXPECT_GE(kori::platform::Val(f[i]), top) << l;
                EXPECT_LE(kori::platform::Val(f[i]), bottom) << l;
            }
        }
    }
}

TEST(Labels, VolumeLabelsStayBetweenThePlotAndTheLetters) {
    EXPECT_EQ(VolumeLabel(9999), "9999");
    EXPECT_EQ(VolumeLabel(517684), "518K");
    EXPECT_EQ(VolumeLabel(3021649), "3.0M");
    EXPECT_EQ(VolumeLabel(45000000), "45M");
    EXPECT_EQ(VolumeLabel(2.5e9), "2.5G");
    EXPECT_EQ(VolumeLabel(-3), "0");

    ChartRig r;
    r.request.ShowVolume = true;
    for (int d = 0; d < 30; ++d)
        r.Add(Day(d), 50, 51, 49, 50, 3000000 + 700000 * (d % 5));
    ASSERT_TRUE(r.Build().ok());
    std::vector<Box> labels, letters;
    for (const Call& c : Parse(r.Calls())) {
        if (c.Kind != "Text" || c.Y1 <= r.chart.PlotBottom) continue;
        if (c.Text == "V" || c.Text == "O" || c.Text == "L")
            letters.push_back(TextBox(c));
        else if (c.X1 > r.chart.PlotRight - 60 && c.X1 < r.chart.PlotRight + 40)
            labels.push_back(TextBox(c));
    }
    ASSERT_EQ(labels.size(), 4u);
    ASSERT_EQ(letters.size(), 3u);
    for (const Box& l : labels) {
        EXPECT_GT(l.Left, r.chart.PlotRight) << "over the volume bars";
        for (const Box& v : letters)
            EXPECT_FALSE(Overlap(l, v)) << "over the V O L letters";
    }
}

TEST(Labels, ParabolicLastStopPrintsWhereNothingElseDoes) {
    ChartRig r;
    r.surface.Resize(1000, 700);
    r.request.AutoOsc = true;
    r.request.AutoOscCode = "PARA";
    for (int d = 0; d < 20; ++d) {
        const float h = 40 + static_cast<float>(d);
        r.Add(Day(d), h - 5, h, h - 10, h - 1);
    }
    ASSERT_TRUE(r.Build().ok());
    const auto calls = Parse(r.Calls());
    const auto stop = std::find_if(calls.begin(), calls.end(), [](const Call& c) {
        return c.Kind == "Text" && c.Text.starts_with("Parabolic last stop : ");
    });
    ASSERT_NE(stop, calls.end());
    const Box box = TextBox(*stop);
    EXPECT_LE(box.Right, r.chart.PlotRight + 0.01);
    EXPECT_LE(box.Bottom, r.chart.PlotTop) << "above the plot";
    for (const Call& c : calls)
        if (c.Kind == "Text" && &c != &*stop) EXPECT_FALSE(Overlap(box, TextBox(c))) << c.Text;
    // The stream holds it where the screen has it.
    const auto t = Starting(r.Lines(), "T, 8.25, ");
    EXPECT_TRUE(std::any_of(t.begin(), t.end(), [&](const std::string& l) {
        StreamFields f;
        return SplitStreamLine(l, f) && f[4].starts_with("Parabolic") &&
               kori::platform::Val(f[2]) == stop->X1 && kori::platform::Val(f[3]) == stop->Y1;
    }));
}

TEST(Labels, ASplitsUpperHeadingStaysOnTheArea) {
    ChartRig r;
    r.request.SplitMode = true;
    r.request.SplitHalf = 1;
    for (int d = 0; d < 20; ++d)
        r.Add(Day(d), 50, 51, 49, 50);
    ASSERT_TRUE(r.Build().ok());
    bool heading = false;
    for (const Call& c : Parse(r.Calls())) {
        if (c.Kind != "Text") continue;
        EXPECT_GE(c.Y1, 0) << c.Text;
        if (c.Text.starts_with("DAILY")) {
            heading = true;
            for (const Call& o : Parse(r.Calls()))
                if (o.Kind == "Text" && o.Text != c.Text)
                    EXPECT_FALSE(Overlap(TextBox(c), TextBox(o))) << o.Text;
        }
    }
    EXPECT_TRUE(heading);
}

TEST(Labels, DateLabelsNeverPrintOverEachOther) {
    for (char style : {'P', 'B'}) {
        ChartRig r;
        r.surface.Resize(1000, 700);
        r.request.ChartStyle = style;
        r.request.BarSpacing = style == 'P' ? 2 : 1;
        r.defaults.AutoScale = true;
        // Quick swings, and one steady rise from late November to February: on a point-and-
        // figure chart December and the new year fall in that one column.
        for (int d = 0; d < 730; ++d) {
            const float c = d >= 329 && d < 400 ? 20 + 0.1f * static_cast<float>(d - 329)
                                                : 25 + 3 * std::sin(0.9f * static_cast<float>(d));
            r.Add(Day(d), c, c + 0.2f, c - 0.2f, c);
        }
        ASSERT_TRUE(r.Build().ok());
        std::vector<Box> dates;
        for (const Call& c : Parse(r.Calls()))
            if (c.Kind == "Text" && c.Y1 == r.chart.VolBottom + 2) dates.push_back(TextBox(c));
        ASSERT_GT(dates.size(), 3u) << style;
        for (std::size_t i = 0; i < dates.size(); ++i)
            for (std::size_t j = i + 1; j < dates.size(); ++j)
                EXPECT_FALSE(Overlap(dates[i], dates[j]))
                    << style << " labels at " << dates[i].Left << " and " << dates[j].Left;
    }
}

TEST(Labels, TheStampKeepsItsBlankOnPlayback) {
    ChartRig r;
    r.Add(Day(0), 50, 51, 49, 50);
    r.Add(Day(1), 50, 51, 49, 50);
    ASSERT_TRUE(r.Build().ok());
    const auto z = Starting(r.Lines(), "Z,");
    ASSERT_EQ(z.size(), 1u);
    auto reader = StreamReader::FromText(z[0] + "\r\n");
    Instruction in;
    ASSERT_EQ(reader.Next(in), StreamReader::Result::Instruction);
    EXPECT_EQ(in.Text, "KORI\xA0"
                       "Charting")
        << "a blank would be squeezed out and print as KORICharting";
}
