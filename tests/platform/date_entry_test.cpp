// Typed dates: what is taken, in which century, and the messages of what is not.
// Typed dates of the entry windows: the accepted forms and every refusal with its words.
#include "platform/date_entry.h"

#include <gtest/gtest.h>

namespace kori::platform {
namespace {

TEST(DateEntry, GoodDatesGiveFileTextAndTheShortForm) {
    const auto a = CheckEnteredDate(" 2/10/93 ");
    ASSERT_TRUE(a.Ok) << a.Message;
    EXPECT_EQ(a.Text, "19931002");
    EXPECT_EQ(a.Display, "2/10/93");
    EXPECT_EQ(CheckEnteredDate("02-10-2024").Text, "20241002");
    EXPECT_EQ(CheckEnteredDate("02-10-2024").Display, "2/10/24");
    EXPECT_EQ(CheckEnteredDate("31/12/29").Text, "20291231"); // two digits: 2029 ...
    EXPECT_EQ(CheckEnteredDate("1/1/30").Text, "19300101");   // ... and 1930
    EXPECT_EQ(CheckEnteredDate("29/2/24").Text, "20240229");  // a leap day
    EXPECT_EQ(DateTextToEntry("20260105"), "5/1/26");
    EXPECT_EQ(DateTextToEntry("2026010"), "");
}

TEST(DateEntry, RefusalsAndTheirMessages) {
    const auto blank = CheckEnteredDate("   ");
    EXPECT_FALSE(blank.Ok);
    EXPECT_EQ(blank.Message, " Date must be entered");
    for (const char* bad :
         {"2.10.93", "2/10", "2/10/93/1", "123/1/93", "0/1/93", "32/1/93", "a/1/93", "/1/93",
          "15/13/24", "15/0/24", "29/2/23", "1/1/993", "1/x/24"}) {
        const auto d = CheckEnteredDate(bad);
        EXPECT_FALSE(d.Ok) << bad;
        EXPECT_EQ(d.Message, " Use  /   or  -  to separate day/month/year\n eg.  2/10/93") << bad;
        EXPECT_EQ(d.Title, "Incorrect Date Format ") << bad;
const char* kFormatHelp = " Use  /   or  -  to separate day/month/year\n eg.  2/10/93";

TEST(ParseEntryDate, GoodDatesGiveTheShortFormAndTheFileForm) {
    struct Case {
        const char* typed;
        const char* shown;
        const char* text;
    } cases[] = {
        {"2/10/93", "2/10/93", "19931002"},   {"02-10-2024", "2/10/24", "20241002"},
        {" 29/2/24 ", "29/2/24", "20240229"}, {"5-1/29", "5/1/29", "20290105"},
        {"31/12/30", "31/12/30", "19301231"}, {"1/1/0", "1/1/00", "20000101"},
    };
    for (const auto& c : cases) {
        const auto r = ParseEntryDate(c.typed);
        ASSERT_TRUE(r.Date) << c.typed << ": " << r.Message;
        EXPECT_EQ(r.Date->Shown, c.shown) << c.typed;
        EXPECT_EQ(r.Date->Text, c.text) << c.typed;
        EXPECT_TRUE(r.Message.empty());
    }
}

TEST(ParseEntryDate, BlankTextMustBeEntered) {
    for (const char* typed : {"", "   "}) {
        const auto r = ParseEntryDate(typed);
        EXPECT_FALSE(r.Date);
        EXPECT_EQ(r.Message, " Date must be entered");
    }
}

TEST(ParseEntryDate, BadSeparatorsDaysAndNonDatesGetTheFormatHelp) {
    for (const char* typed :
         {"2.10.93", "2/1093", "1/2/3/4", "0/1/24", "a/1/24", "123/1/24", "/1/24", "32/1/24",
          "-1/1/24", "ab/1/24", "31/2/24", "29/2/23", "1/13/24", "1/0/24", "1/1/", "1/x/24",
          "1/1/123", "1/1/24x", "00/1/24"}) {
        const auto r = ParseEntryDate(typed);
        EXPECT_FALSE(r.Date) << typed;
        EXPECT_EQ(r.Message, kFormatHelp) << typed;
        EXPECT_EQ(r.Title, "Incorrect Date Format ") << typed;
    }
}

} // namespace
} // namespace kori::platform
