// The security details table loaded into fixed records with a first-letter index, looked up,
// and shown in the chart window's text box.
#include "maint/security_details.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::maint {
namespace {

using test::TempRoot;

struct DetailsTest : testing::Test {
    DetailsTest() {
        std::filesystem::create_directory(root.path() / "In");
        std::filesystem::create_directory(root.path() / "sys");
    }
    std::string In() const { return root.folder() + "In/"; }
    std::string Sys() const { return root.folder() + "sys/"; }
    void Source(const std::string& text) const { root.Write("In/SecurityDetails.Asx.Stk", text); }
    TempRoot root;
};

const std::string kLong(400, 'q');

std::string Table() {
    return "CODE,SHORTDESCRIPTION,TOTALCLASSISSUE,ANNUALDIVIDENDRATE,EARNINGSPERSHARE,NEWKEY\r\n"
           "WES,WESFARMERS,1000000,0.5,2.0,x\r\n"
           "BHP,BHP GROUP,2500000,1.2,0,y\r\n"
           "PRN,PERENTI,300,0,0.1,z\r\n"
           "ANZ,ANZ BANK,5,0.2,0.4,w\r\n"
           "\r\n"
           "LNG," +
           kLong + "\r\n";
}

TEST_F(DetailsTest, RefreshWritesHeaderSortedRecordsIndexAndKeepsTheSource) {
    Source(Table());
    const auto r = RefreshSecurityDetails(Sys(), In());
    ASSERT_TRUE(r.Status.ok()) << r.Status.message();
    EXPECT_TRUE(r.Loaded);
    EXPECT_EQ(r.Records, 5) << "the blank line's record is dropped";
    EXPECT_EQ(root.Read("sys/STKHeader.txt"),
              "CODE,SHORTDESCRIPTION,TOTALCLASSISSUE,ANNUALDIVIDENDRATE,EARNINGSPERSHARE,NEWKEY\r\n"
              "CODE,Description,Total Issued,Annual Dividend,EARNINGSPERSHARE,NEWKEY\r\n");
    const std::string stx = root.Read("sys/SecurityDetails.Stx");
    ASSERT_EQ(stx.size(), 5 * kDetailsRecord);
    EXPECT_EQ(stx.substr(0, 20), "ANZ   ANZ BANK,5,0.2");
    EXPECT_EQ(stx.substr(kDetailsRecord, 6), "BHP   ");
    EXPECT_EQ(stx.substr(2 * kDetailsRecord, kDetailsRecord), "LNG   " + kLong.substr(0, 306))
        << "a long line cut at 306 after the code";
    EXPECT_EQ(stx.substr(3 * kDetailsRecord, 6), "PRNX  ");
    EXPECT_EQ(stx.substr(4 * kDetailsRecord, 6), "WES   ");
    EXPECT_EQ(root.Read("sys/Sdix1.inx"), "A,1\r\nB,2\r\nL,3\r\nP,4\r\nW,5\r\n");
    EXPECT_FALSE(std::filesystem::exists(root.path() / "In/SecurityDetails.Asx.Stk"));
    EXPECT_EQ(root.Read("In/SecurityDetails.Asx.Bak"), Table());

    // Nothing waiting: nothing done, nothing said.
    const auto again = RefreshSecurityDetails(Sys(), In());
    EXPECT_FALSE(again.Loaded);
    EXPECT_TRUE(again.Status.ok());
    EXPECT_EQ(root.Read("sys/SecurityDetails.Stx"), stx);
}

TEST_F(DetailsTest, LookUpByFirstLetterWithPrnAsPrnx) {
    EXPECT_FALSE(LookUpSecurityDetails(Sys(), "WES")) << "no files yet";
    EXPECT_FALSE(SecurityDetailsAvailable(3, Sys()));
    Source(Table());
    ASSERT_TRUE(RefreshSecurityDetails(Sys(), In()).Status.ok());
    EXPECT_TRUE(SecurityDetailsAvailable(3, Sys()));
    EXPECT_TRUE(SecurityDetailsAvailable(1, Sys()));
    EXPECT_FALSE(SecurityDetailsAvailable(4, Sys())) << "only the download program's services";
    EXPECT_FALSE(SecurityDetailsAvailable(3, ""));

    const auto prn = LookUpSecurityDetails(Sys(), "prn");
    ASSERT_TRUE(prn);
    EXPECT_EQ(prn->Code, "PRNX");
    EXPECT_EQ(prn->Rest, "PERENTI,300,0,0.1,z");
    EXPECT_EQ(prn->Fields, (std::vector<std::string>{"PERENTI", "300", "0", "0.1", "z"}));
    ASSERT_TRUE(LookUpSecurityDetails(Sys(), "WES"));
    EXPECT_EQ(LookUpSecurityDetails(Sys(), "WES")->Fields.at(0), "WESFARMERS");
    EXPECT_FALSE(LookUpSecurityDetails(Sys(), "ZZZ")) << "a letter not in the index";
    EXPECT_FALSE(LookUpSecurityDetails(Sys(), "BHQ")) << "a letter there, the code not";
    EXPECT_FALSE(LookUpSecurityDetails(Sys(), ""));
}

TEST_F(DetailsTest, TextBoxShowsIssuePeAndYieldOrNa) {
    Source(Table());
    ASSERT_TRUE(RefreshSecurityDetails(Sys(), In()).Status.ok());
    const auto header = ReadDetailsHeader(Sys());
    ASSERT_EQ(header.Labels.size(), 6u);
    // 10 / 2.0 = 5.0; 0.5 / 10 = 5.0%.
    EXPECT_EQ(DetailsTextBox(header, *LookUpSecurityDetails(Sys(), "WES"), 10),
              (std::vector<std::string>{"Issued  1,000,000", "PE Ratio  5.0", "Yield  5.0%"}));
    // No price: no ratio, and a yield over 0 that cannot be had.
    EXPECT_EQ(DetailsTextBox(header, *LookUpSecurityDetails(Sys(), "WES"), 0),
              (std::vector<std::string>{"Issued  1,000,000", "PE Ratio  n/a", "Yield  n/a"}));
    // Earnings of 0 and a close of 0 are divisors of 0.
    EXPECT_EQ(DetailsTextBox(header, *LookUpSecurityDetails(Sys(), "BHP"), 0),
              (std::vector<std::string>{"Issued  2,500,000", "PE Ratio  n/a", "Yield  n/a"}));
}

TEST_F(DetailsTest, AFailedWriteLeavesTheOldRecordsAndTheSourceWaiting) {
    Source("CODE,SHORTDESCRIPTION\r\nAAA,ONE\r\nBBB,TWO\r\n");
    ASSERT_TRUE(RefreshSecurityDetails(Sys(), In()).Status.ok());
    const std::string before = root.Read("sys/SecurityDetails.Stx");
    Source(Table());
    {
        platform::ScopedWriteFailure fail(200);
        EXPECT_FALSE(RefreshSecurityDetails(Sys(), In()).Status.ok());
    }
    EXPECT_EQ(root.Read("sys/SecurityDetails.Stx"), before);
    EXPECT_EQ(root.Read("In/SecurityDetails.Asx.Stk"), Table()) << "still waiting for a retry";
}

TEST_F(DetailsTest, LondonTableHasItsOwnFilesLabelsAndNoIndex) {
    root.Write("In/SecurityProperties.Lsx.Stk", "CODE,LONGNAME,SECURITYTYPE\r\nVOD,VODAFONE,O\r\n");
    const auto r = RefreshUKSecurityDetails(Sys(), In());
    ASSERT_TRUE(r.Status.ok());
    EXPECT_EQ(root.Read("sys/UKSTKHeader.txt"), "CODE,LONGNAME,SECURITYTYPE\r\nCODE,Name,Type\r\n");
    EXPECT_EQ(root.Read("sys/UKSecurityDetails.Stx").substr(0, 18), "VOD   VODAFONE,O  ");
    EXPECT_FALSE(std::filesystem::exists(root.path() / "sys/Sdix1.inx"));
    EXPECT_TRUE(std::filesystem::exists(root.path() / "In/SecurityProperties.Lsx.Bak"));
}

} // namespace
} // namespace kori::maint
