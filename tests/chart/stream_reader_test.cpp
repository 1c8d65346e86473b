#include "chart/stream_reader.h"
#include "chart/stream_writer.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::chart {
namespace {

StreamFields Split(std::string_view line) {
    StreamFields f;
    EXPECT_TRUE(SplitStreamLine(line, f)) << line;
    return f;
}

TEST(StreamSplit, BlanksKeptOnlyInTheTextOfARawUpperCaseT) {
    EXPECT_EQ(Split("T, 8.25, 10 , 20,A  B ,255"),
              (StreamFields{"T", "8.25", "10", "20", "A  B ", "255"}));
    // "S" and "Z" text lose their blanks; so does a "T" spelled in lower case or led by a blank.
    EXPECT_EQ(Split("S,8.25,10,20,A  B,255")[4], "AB");
    EXPECT_EQ(Split("Z,8.25,10,20, x y ,255")[4], "xy");
    EXPECT_EQ(Split("t,8.25,10,20,A  B,255")[4], "AB");
    EXPECT_EQ(Split(" T,8.25,10,20,A  B,255")[4], "AB");
    // Only field 5 of a "T" keeps its blanks.
    EXPECT_EQ(Split("T,8.25,1 0,20,x,2 55")[2], "10");
    EXPECT_EQ(Split("T,8.25,1 0,20,x,2 55")[5], "255");
}

TEST(StreamSplit, SixFieldsAtMostAndFewerAreEmpty) {
    EXPECT_EQ(Split("P,1,2"), (StreamFields{"P", "1", "2", "", "", ""}));
    EXPECT_EQ(Split("L,1,2,3,4,"), (StreamFields{"L", "1", "2", "3", "4", ""}));
    StreamFields f;
    EXPECT_FALSE(SplitStreamLine("L,1,2,3,4,5,", f));
    EXPECT_FALSE(SplitStreamLine("T,8.25,1,2,Hello, world,255", f));
}

std::vector<Instruction> ReadAll(std::string text, StreamReader::Result& last) {
    auto reader = StreamReader::FromText(std::move(text));
    std::vector<Instruction> r;
    Instruction in;
    while ((last = reader.Next(in)) == StreamReader::Result::Instruction)
        r.push_back(in);
    return r;
}

TEST(StreamReader, SkipsEmptyLinesAndUnknownLettersAndFoldsCase) {
    StreamReader::Result last{};
    const auto all = ReadAll("\r\nQ,1,2,3,4,5\r\nTT,1,2,3,x,5\nh,1,2,3,4,5\r  \rk,7,8,9", last);
    EXPECT_EQ(last, StreamReader::Result::End);
    ASSERT_EQ(all.size(), 2u);
    EXPECT_EQ(all[0].Letter, 'H');
    EXPECT_EQ(all[0].Y2, 4);
    EXPECT_EQ(all[0].Colour, 5u);
    EXPECT_EQ(all[1].Letter, 'K');
    EXPECT_EQ(all[1].X1, 7);
    EXPECT_EQ(all[1].Y1, 8);
    EXPECT_EQ(all[1].Colour, 9u);
}

TEST(StreamReader, NumbersThatDoNotParseReadZero) {
    StreamReader::Result last{};
    const auto all = ReadAll("L,abc,-2.5,,1e2,red\r\nT,big,.5,7x,text,", last);
    ASSERT_EQ(all.size(), 2u);
    EXPECT_EQ(all[0].X1, 0);
    EXPECT_EQ(all[0].Y1, -2.5);
    EXPECT_EQ(all[0].X2, 0);
    EXPECT_EQ(all[0].Y2, 100);
    EXPECT_EQ(all[0].Colour, 0u);
    EXPECT_EQ(all[1].Size, 0);
    EXPECT_EQ(all[1].X1, 0.5);
    EXPECT_EQ(all[1].Y1, 7);
    EXPECT_EQ(all[1].Text, "text");
}

TEST(StreamReader, ColoursAreThirtyTwoBitsAndMalformedLinesStopTheRead) {
    StreamReader::Result last{};
    auto all = ReadAll("P,1,1,-1\r\nP,1,1,4294967295\r\nP,1,1,4294967296\r\nP,2,2,3", last);
    EXPECT_EQ(last, StreamReader::Result::Malformed);
    ASSERT_EQ(all.size(), 2u);
    EXPECT_EQ(all[0].Colour, 0xFFFFFFFFu);
    EXPECT_EQ(all[1].Colour, 0xFFFFFFFFu);

    all = ReadAll("L,1,2,3,4,5\r\nT,8.25,1,2,a,b,255\r\nL,1,2,3,4,5", last);
    EXPECT_EQ(last, StreamReader::Result::Malformed);
    EXPECT_EQ(all.size(), 1u);
}

TEST(StreamReader, MissingFileIsUnreadable) {
    test::TempRoot root;
    StreamReader reader(root.path() / "none.cht");
    Instruction in;
    EXPECT_EQ(reader.Next(in), StreamReader::Result::Unreadable);
}

TEST(StreamReader, ReadsBackWhatTheWriterWrote) {
    test::TempRoot root;
    const auto path = root.path() / "TCht.Tmp";
    StreamWriter w;
    ASSERT_TRUE(w.Open(path, false));
    w.Shape('H', 10.5, -20, 30, 40.25, platform::Rgb(1, 2, 3));
    w.Dot('K', 0, 7, 0xFFFFFF);
    w.Text('T', 8.25, 1.5, 2, "Close  12, up", 255);
    w.Text('S', 9.75, 3, 4, "Two  words", 65535);
    ASSERT_TRUE(w.Close().ok());

    StreamReader::Result last{};
    const auto all = ReadAll(*platform::ReadWholeFile(path), last);
    EXPECT_EQ(last, StreamReader::Result::End);
    ASSERT_EQ(all.size(), 4u);
    EXPECT_EQ(all[0].Letter, 'H');
    EXPECT_EQ(all[0].X1, 10.5);
    EXPECT_EQ(all[0].Y1, -20);
    EXPECT_EQ(all[0].Y2, 40.25);
    EXPECT_EQ(all[0].Colour, platform::Rgb(1, 2, 3));
    EXPECT_EQ(all[1].Colour, 0xFFFFFFu);
    EXPECT_EQ(all[2].Size, 8.25);
    EXPECT_EQ(all[2].X1, 1.5);
    EXPECT_EQ(all[2].Text, "Close  12 up"); // the comma is gone, the blanks stay
    EXPECT_EQ(all[2].Colour, 255u);
    EXPECT_EQ(all[3].Text, "Twowords");
}

} // namespace
} // namespace kori::chart
