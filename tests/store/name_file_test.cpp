#include "platform/dialogs.h"
#include "store/name_file.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::store;
using kori::test::Name;

TEST(NameRecord, FieldsSitAtTheirOffsets) {
    NameRecord r = Name("BHP", "Bright Hills Prospecting");
    r.GicsSector = "1510";
    r.IndustryClass = "042";
    r.Base = 1.5f;
    r.PercentBandUp = 7;
    const auto b = r.Encode();
    EXPECT_EQ(std::string(b.data() + 2, 6), "BHP   ");
    EXPECT_EQ(b[8], 4);
    EXPECT_EQ(std::string(b.data() + 87, 3), "042");
    EXPECT_EQ(std::string(b.data() + 90, 4), "1510");
    const auto back = NameRecord::Decode(b.data());
    EXPECT_EQ(back.Base, 1.5f);
    EXPECT_EQ(back.PercentBandUp, 7);
    EXPECT_EQ(back.TrimmedCode(), "BHP");
    EXPECT_EQ(back.BandUp(), 7);
    r.PercentBandDown = 101;
    EXPECT_EQ(r.BandDown(), 5) << "outside 1 to 100 reads 5";
    EXPECT_EQ(PadCode("prn"), "PRNX  ");
}

// The one test of "closes only" that charts, oscillators and the series loader share: types
// 1 to 3, and any type a bar chart cannot take (below 4).
TEST(NameRecord, CloseOnlyTypes) {
    for (int type : {-1, 0, 1, 2, 3})
        EXPECT_TRUE(kori::store::IsCloseOnly(type)) << type;
    for (int type : {4, 5})
        EXPECT_FALSE(kori::store::IsCloseOnly(type)) << type;
}

TEST(NameFile, FindsCodesExactlyWhateverTheCaseOfTheRequest) {
    kori::test::TempRoot root;
    NameFile f(NameFile::PathIn(root.folder()));
    ASSERT_TRUE(f.Open().ok());
    ASSERT_TRUE(f.Append(Name("AB", "Two")).ok());
    ASSERT_TRUE(f.Append(Name("A", "One")).ok());
    ASSERT_TRUE(f.Append(Name("ABCDEF", "Six")).ok());
    kori::platform::ScriptedDialogs d;
    auto found = FindCodeInNameFile(root.folder(), "a", d);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->RecordNumber, 2);
    EXPECT_EQ(found->CurrentFile, root.folder() + "A.WDT");
    found = FindCodeInNameFile(root.folder(), "abcdef", d);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->RecordNumber, 3);
    EXPECT_TRUE(d.messages().empty());
    EXPECT_FALSE(FindCodeInNameFile(root.folder(), "ABC", d));
    EXPECT_EQ(d.messages(), std::vector<std::string>{"No File For That Name"});
}

TEST(NameFile, SilentLookups) {
    kori::test::TempRoot root;
    std::string name = "kept", cls = "kept";
    LookupNameAndClass(root.folder(), "ABC", name, cls);
    EXPECT_EQ(name, "kept") << "no file: the outputs stay";
    NameFile f(NameFile::PathIn(root.folder()));
    ASSERT_TRUE(f.Open().ok());
    auto r = Name("ABC", "Alpha Beta");
    r.IndustryClass = "123";
    r.GicsSector = "15";
    ASSERT_TRUE(f.Append(r).ok());
    ASSERT_TRUE(f.Append(Name("XYZ", "No sector")).ok());
    LookupNameAndClass(root.folder(), "abc ", name, cls);
    EXPECT_EQ(name, "Alpha Beta");
    EXPECT_EQ(cls, "123");
    LookupNameAndClass(root.folder(), "QQQ", name, cls);
    EXPECT_EQ(name, "");
    EXPECT_EQ(LookupGicsSector(root.folder(), "ABC"), "0015");
    EXPECT_EQ(LookupGicsSector(root.folder(), "XYZ"), "");
    EXPECT_EQ(LookupGicsSector(root.folder(), "QQQ"), "0000");
    EXPECT_EQ(LookupGicsSector(root.folder(), ""), "0000");
}

TEST(NameFile, CountIgnoresARemainderAndRefusesAnOversizedFile) {
    kori::test::TempRoot root;
    root.Write("names.DAT", std::string(96 * 2 + 50, ' '));
    NameFile f(NameFile::PathIn(root.folder()));
    ASSERT_TRUE(f.Open().ok());
    EXPECT_EQ(f.Count(), 2);
    std::filesystem::resize_file(f.path(), 32768ull * 96);
    EXPECT_FALSE(f.Open().ok());
}

TEST(NameFile, OneLookupServesEveryCaller) {
    kori::test::TempRoot root;
    NameFile f(NameFile::PathIn(root.folder()));
    ASSERT_TRUE(f.Open().ok());
    auto prn = Name("PRNX", "Stored in its safe form");
    prn.IndustryClass = "321";
    ASSERT_TRUE(f.Append(prn).ok());
    ASSERT_TRUE(f.Append(Name("../X", "A code that is no file name")).ok());
    kori::platform::Status why;
    // "PRN" reaches "PRNX" whichever lookup asks.
    const auto found = FindCode(root.folder(), "prn", why);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->RecordNumber, 1);
    std::string name, cls;
    LookupNameAndClass(root.folder(), "PRN", name, cls);
    EXPECT_EQ(name, "Stored in its safe form");
    EXPECT_EQ(cls, "321");
    // A request that could reach outside the folder is refused, not looked up.
    EXPECT_FALSE(FindCode(root.folder(), "../X", why));
    EXPECT_EQ(why.message(), "Invalid Code: ../X");
    EXPECT_TRUE(PriceFile::PathFor(root.folder(), "../X").empty());
    EXPECT_FALSE(PriceFile(PriceFile::PathFor(root.folder(), "../X")).Open().ok());
    EXPECT_TRUE(IsValidCode("1AUX"));
    EXPECT_FALSE(IsValidCode("A B"));
    EXPECT_FALSE(IsValidCode("SEVENXX"));
}

TEST(NameFile, AFileOverTheLimitIsNamedNotTakenForAMissingCode) {
    kori::test::TempRoot root;
    std::string bytes;
    auto last = Name("KRM", "Past the limit").Encode();
    bytes.assign(96 * 32767, ' ');
    bytes.append(last.data(), last.size());
    root.Write("Names.dat", bytes);
    kori::platform::ScriptedDialogs d;
    EXPECT_FALSE(FindCodeInNameFile(root.folder(), "KRM", d));
    EXPECT_EQ(d.messages(), std::vector<std::string>{
                                "Names.dat holds 32768 records; a file can hold at most 32767."});
    kori::platform::Status why;
    EXPECT_FALSE(FindCode(root.folder(), "KRM", why));
    EXPECT_FALSE(why.ok());
}
