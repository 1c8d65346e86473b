// kori chart --multi: the sample's two sets drawn under the price chart, their stream played
// back, and the refusals.
#include "cli/kori_run.h"
#include "osc/osc_identifiers.h"
#include "platform/settings_store.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace kori::test {
namespace {

// Frames of oscillator panels in a stream: "B" lines that start at x 5 (the price chart's
// frames start at 4).
int PanelFrames(const std::filesystem::path& stream) {
    std::ifstream in(stream);
    int n = 0;
    for (std::string line; std::getline(in, line);) {
        // Numbers stand with the blank of a plain number-to-text in the stream.
        std::erase(line, ' ');
        if (line.rfind("B,5,", 0) == 0) ++n;
    }
    return n;
}

class MultiChartCommand : public SampleRootSuite {
protected:
    static std::string Out(const std::string& name) { return (s_dir->path() / name).string(); }
};

TEST_F(MultiChartCommand, EachSetDrawsOnePanelPerOscillatorIntoOnePlayableStream) {
    // The sample's set 1 holds three oscillators, set 2 five.
    const struct {
        const char* set;
        int panels;
    } cases[] = {{"1", 3}, {"2", 5}};
    for (const auto& c : cases) {
        const std::string stream = Out(std::string("multi") + c.set + ".cht");
        const std::string png = Out(std::string("multi") + c.set + ".png");
        const auto r = Kori({"chart", "KRM", "--multi", c.set, "--size", "640x480", "--stream",
                             stream, "--png", png});
        ASSERT_EQ(r.status, 0) << r.err;
        EXPECT_EQ(PanelFrames(stream), c.panels) << "set " << c.set;
        EXPECT_GT(std::filesystem::file_size(png), 1000u);
        // The saved stream plays back whole with no market data.
        const auto played = Kori({"play", stream, "--png", Out("played.png"), "--size", "640x480"});
        EXPECT_EQ(played.status, 0) << played.err;
    }
    // The plain chart of the same security has no panel at all.
    const auto plain = Kori({"chart", "KRM", "--stream", Out("plain.cht")});
    ASSERT_EQ(plain.status, 0) << plain.err;
    EXPECT_EQ(PanelFrames(Out("plain.cht")), 0);
}

TEST_F(MultiChartCommand, UnknownSetsClashingOptionsAndEmptySetsAreRefused) {
    const auto three = Kori({"chart", "KRM", "--multi", "3", "--stream", Out("x.cht")});
    EXPECT_NE(three.status, 0);
    EXPECT_NE(three.err.find("--multi wants the set 1 or 2"), std::string::npos) << three.err;
    const auto withOsc = Kori({"chart", "KRM", "--multi", "1", "--osc", "RSI"});
    EXPECT_NE(withOsc.status, 0);
    EXPECT_NE(withOsc.err.find("leave out --osc"), std::string::npos) << withOsc.err;

    platform::SettingsStore settings(std::filesystem::path(Root()) / "settings.ini");
    const osc::MultiOscSet kept = osc::LoadMultiOscSet(settings, 2);
    osc::SaveMultiOscSet(settings, 2, osc::MultiOscSet{});
    const auto empty = Kori({"chart", "KRM", "--multi", "2", "--png", Out("empty.png")});
    osc::SaveMultiOscSet(settings, 2, kept);
    EXPECT_NE(empty.status, 0);
    EXPECT_NE(empty.err.find("There are no oscillators in Multi-Osc 2"), std::string::npos)
        << empty.err;
    EXPECT_FALSE(std::filesystem::exists(Out("empty.png")));
}

} // namespace
} // namespace kori::test
