// The chart stream on a device that takes no more bytes: every failure is seen and kept.
#include "chart/stream_writer.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::chart {
namespace {

void WriteLines(StreamWriter& w, int count) {
    for (int i = 0; i < count; ++i)
        w.Text('T', 8.25, i, i, "A heading long enough to fill the buffer soon", 65535);
}

TEST(StreamWriterFailure, AFullDeviceFailsTheStreamAndTheFailureStays) {
    StreamWriter w;
    ASSERT_TRUE(w.Open("/dev/full", false).ok());
    WriteLines(w, 2000); // about 100 KB: more than any stream buffer holds
    EXPECT_FALSE(w.status().ok());
    EXPECT_FALSE(w.Close().ok());
    // The panel's instructions are appended to the same stream: it stays failed.
    (void)w.Open("/dev/full", true);
    EXPECT_FALSE(w.Close().ok());
}

TEST(StreamWriterFailure, AFailureSeenOnlyAtTheLastFlushIsReported) {
    StreamWriter w;
    ASSERT_TRUE(w.Open("/dev/full", false).ok());
    w.Shape('B', 1, 2, 3, 4, 5); // stays in the buffer until the close
    EXPECT_FALSE(w.Close().ok());
}

TEST(StreamWriterFailure, ANewStreamStartsClean) {
    test::TempRoot dir;
    StreamWriter w;
    ASSERT_TRUE(w.Open("/dev/full", false).ok());
    WriteLines(w, 2000);
    EXPECT_FALSE(w.Close().ok());
    ASSERT_TRUE(w.Open(dir.path() / "s.tmp", false).ok());
    WriteLines(w, 3);
    EXPECT_TRUE(w.Close().ok());
    EXPECT_FALSE(w.Open(dir.path() / "no" / "such" / "s.tmp", false).ok());
    EXPECT_FALSE(w.status().ok());
}

} // namespace
} // namespace kori::chart
