#include "app/colour_table.h"
#include "platform/dialogs.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::app;
using kori::platform::Answer;
using kori::platform::kStandardColours;
using kori::platform::Palette;
using kori::test::TempRoot;

namespace {
Palette Filled(kori::platform::Colour c) {
    Palette p;
    p.fill(c);
    return p;
}
} // namespace

TEST(ColourTable, TooFewNumbersOrJunkKeepWhatWasRead) {
    TempRoot root;
    Palette p = Filled(0xABCDEF);
    root.Write("koriclr.dat", "1\r\n2\r\n3\r\n");
    EXPECT_EQ(ReadColourFile(root.folder() + "koriclr.dat", p), 3);
    EXPECT_EQ(p[0], 1u);
    EXPECT_EQ(p[2], 3u);
    EXPECT_EQ(p[3], 0xABCDEFu);
    EXPECT_EQ(p[48], 0xABCDEFu);

    p = Filled(7);
    root.Write("koriclr.dat", "16777215\nred\n255\n");
    EXPECT_EQ(ReadColourFile(root.folder() + "koriclr.dat", p), 1);
    EXPECT_EQ(p[0], 16777215u);
    EXPECT_EQ(p[1], 7u);
    EXPECT_FALSE(ReadColourFile(root.folder() + "none.dat", p).has_value());
}

TEST(ColourTable, BuiltInSchemeFillsTheRolesAndWritesTheFile) {
    TempRoot root;
    Palette p = Filled(0x123456);
    ASSERT_TRUE(ApplyColourScheme("Black", root.folder(), p).ok());
    for (std::size_t i = 0; i < 16; ++i)
        EXPECT_EQ(p[i], kStandardColours[i]);
    EXPECT_EQ(p[16], kStandardColours[3]); // first built-in number
    EXPECT_EQ(p[17], kStandardColours[0]);
    EXPECT_EQ(p[18], kStandardColours[15]);
    EXPECT_EQ(p[44], kStandardColours[10]); // last of the given numbers
    EXPECT_EQ(p[45], kStandardColours[10]); // the oscillator lines, as a new install has them
    EXPECT_EQ(p[48], kStandardColours[13]);

    Palette back = Filled(0);
    EXPECT_EQ(ReadColourFile(root.folder() + "koriclr.dat", back), 49);
    EXPECT_EQ(back, p);
    EXPECT_FALSE(ApplyColourScheme("Green", root.folder(), p).ok());
}

TEST(ColourTable, SchemeFileWinsOverTheBuiltInColours) {
    TempRoot root;
    Palette saved = Filled(0);
    saved[16] = 0x00FF00;
    saved[48] = 0x0000FF;
    saved[0] = 0x010203;
    ASSERT_TRUE(SaveColourScheme("White", root.folder(), saved).ok());
    EXPECT_FALSE(root.Read("koriclr.WHT").empty());
    std::filesystem::rename(root.path() / "koriclr.WHT", root.path() / "KORICLR.wht");

    Palette p = Filled(1);
    ASSERT_TRUE(ApplyColourScheme("White", root.folder(), p).ok());
    EXPECT_EQ(p[16], 0x00FF00u);
    EXPECT_EQ(p[48], 0x0000FFu);
    EXPECT_EQ(p[0], 0x010203u); // the file's own entry 0 replaces the standard colour
    EXPECT_EQ(root.Read("koriclr.dat"), root.Read("KORICLR.wht"));
}

TEST(PrinterFile, OneRecordOfTwoSixteenBitValues) {
    TempRoot root;
    const std::string file = root.folder() + "koriprn.dat";
    EXPECT_FALSE(ReadPrinterFile(file).has_value());
    root.Write("koriprn.dat", "");
    EXPECT_FALSE(ReadPrinterFile(file).has_value());
    ASSERT_TRUE(WritePrinterFile(file, {1, 0}).ok());
    EXPECT_EQ(root.Read("koriprn.dat"), std::string("\x01\x00\x00\x00", 4));
    ASSERT_TRUE(WritePrinterFile(file, {0, -1}).ok());
    const auto back = ReadPrinterFile(file);
    ASSERT_TRUE(back.has_value());
    EXPECT_EQ(back->PrintColour, 0);
    EXPECT_EQ(back->PrintColourLines, -1);
}

TEST(PrinterFile, QuestionsGiveTheTwoValues) {
    {
        kori::platform::ScriptedDialogs d;
        d.QueueAnswer(Answer::Yes);
        d.QueueAnswer(Answer::No);
        const auto c = AskPrinterColours(d);
        EXPECT_EQ(c.PrintColour, 1);
        EXPECT_EQ(c.PrintColourLines, 0);
        ASSERT_EQ(d.shown().size(), 2u);
        EXPECT_EQ(d.shown()[0].text, " Do you have a Colour Printer ?");
        EXPECT_EQ(d.shown()[0].title, "Printer");
        EXPECT_EQ(d.shown()[1].text, "Print the colour WHITE as BLACK ?");
        EXPECT_EQ(d.shown()[1].title, "Chart Printing");
    }
    kori::platform::ScriptedDialogs d;
    d.QueueAnswer(Answer::No);
    const auto c = AskPrinterColours(d);
    EXPECT_EQ(c.PrintColour, 0);
    EXPECT_EQ(c.PrintColourLines, 1);
    EXPECT_EQ(d.shown().size(), 1u); // no second question without a colour printer
}
