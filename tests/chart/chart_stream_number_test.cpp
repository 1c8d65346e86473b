#include "chart/stream_writer.h"
#include "platform/text.h"

#include <gtest/gtest.h>

#include <cmath>

using kori::chart::StreamWriter;

// The stream's quick number text must be the classic one, whatever the number.
TEST(StreamNumber, SameTextAsTheClassicConversion) {
    const double values[] = {
        0,      -0.0,     1,    -1,      3.5,   -3.5,           0.5,      -0.5,
        0.25,   8.25,     9.75, 0.05,    -0.05, 101.5,          16777215, 32767,
        -32768, 269.4,    0.1,  1.0 / 3, 1e11,  99999999999.99, 1e12,     123456789012345.0,
        2.675,  -1234.56, 0.07, 1e-7};
    for (double v : values)
        EXPECT_EQ(StreamWriter::Number(v), kori::platform::Str(v)) << v;
    for (int i = -2000; i <= 2000; ++i) {
        const double v = i / 4.0;
        ASSERT_EQ(StreamWriter::Number(v), kori::platform::Str(v)) << v;
    }
}
