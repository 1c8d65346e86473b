#include "osc/osc_series.h"

#include <gtest/gtest.h>

#include <random>

using namespace kori::osc;

// The window helpers must give bit for bit what a window re-added oldest first gives.
TEST(OscSeries, WindowHelpersMatchAPlainReAddedWindow) {
    std::mt19937 rng(3);
    std::uniform_real_distribution<float> dist(-50.0f, 50.0f);
    std::vector<float> x(5000);
    for (float& v : x)
        v = dist(rng);
    for (int width : {1, 2, 7, 200, 2049}) {
        const auto sums = WindowSums(x, width);
        const auto hi = WindowMax(x, width);
        const auto lo = WindowMin(x, width);
        for (std::size_t i = 0; i < x.size(); i += 37) {
            float sum = 0.0f, max = x[i], min = x[i];
            const std::size_t first = i + 1 >= static_cast<std::size_t>(width) ? i + 1 - width : 0;
            for (std::size_t j = first; j <= i; ++j) {
                sum += x[j];
                max = std::max(max, x[j]);
                min = std::min(min, x[j]);
            }
            ASSERT_EQ(sums[i], sum) << width << " " << i;
            ASSERT_EQ(hi[i], max) << width << " " << i;
            ASSERT_EQ(lo[i], min) << width << " " << i;
        }
    }
    EXPECT_EQ(WindowSums(x, 0)[10], 0.0f);
}

TEST(OscSeries, RoundingIsHalfToEvenAndStopsAtTheLimits) {
    EXPECT_EQ(RoundToInt16(2.5), 2);
    EXPECT_EQ(RoundToInt16(3.5), 4);
    EXPECT_EQ(RoundToInt16(-2.5), -2);
    EXPECT_EQ(RoundToInt16(40000.0), 32767);
    EXPECT_EQ(RoundToInt32(-1e12), std::numeric_limits<std::int32_t>::min());
    EXPECT_EQ(TruncToInt16(-7.9), -7);
}
