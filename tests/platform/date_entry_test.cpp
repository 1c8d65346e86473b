// Typed dates of the entry windows: the accepted forms and every refusal with its words.
#include "platform/date_entry.h"

#include <gtest/gtest.h>

namespace kori::platform {
namespace {

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

TEST(DateTextToEntryForm, FileDatesAsTheFieldsShowThem) {
    EXPECT_EQ(DateTextToEntry("20260105"), "5/1/26");
    EXPECT_EQ(DateTextToEntry("19931002"), "2/10/93");
    EXPECT_EQ(DateTextToEntry("2026010"), "");
    EXPECT_EQ(DateTextToEntry("20260230"), "");
}

} // namespace
} // namespace kori::platform
