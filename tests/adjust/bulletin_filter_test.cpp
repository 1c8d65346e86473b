// Bulletin lines through the filter, each expected line worked out from the rules by hand.
#include "adjust/bulletin_filter.h"

#include <gtest/gtest.h>

namespace kori::adjust {
namespace {

using Lines = std::vector<std::string>;

BulletinOptions Stocks() {
    BulletinOptions o;
    o.DateStem = "05JAN24";
    return o;
}

TEST(FilterBulletin, TagsCodesAndIndicators) {
    auto o = Stocks();
    o.OptionsLibrary = true;
    const std::string bulletin = "nc,aux,asx.stk,0,n,05jan24,auxb\r\n"
                                 "\r\n"
                                 "DC,PRN,SUM,0,N,05JAN24\n"
                                 "SP,XYZ,ASX.IDX,0,N,05JAN24,2,1\n"
                                 "BI,OPQ,SFE.FUT,0,N,05JAN24,1,4,ASX.STK\n"
                                 "NI,QQQ,ASX.OPT,0,N,Q OPTION\n"
                                 "EN,LSE1,LSX.STK,0,N\n"
                                 "EN,LSE2,LSX.IDX,0,N\n"
                                 "EN,LIF1,LIF.FUT,0,N\n"
                                 "EN,OVS1,WCM.OVS,0,N\n";
    EXPECT_EQ(FilterBulletin(bulletin, o),
              (Lines{"NC,1AUX,05JAN24,0,N,05JAN24,AUXB", "DC,PRNX,05JAN24,0,Y,05JAN24",
                     "SP,XYZ,IDX,0,N,05JAN24,2,1", "BI,OPQ,SFE,0,N,05JAN24,1,4,ASX.STK",
                     "NI,QQQ,OPT,0,N,Q OPTION", "EN,LSE1,LSE,0,N", "EN,LSE2,LSX,0,N",
                     "EN,LIF1,LIF,0,N", "EN,OVS1,OVS,0,N"}));
    // Without an options library the option line goes.
    o.OptionsLibrary = false;
    EXPECT_TRUE(FilterBulletin("NI,QQQ,ASX.OPT,0,N,Q OPTION", o).empty());
}

TEST(FilterBulletin, ListingNamesAreShortenedWithTheCharacterAfterEachWord) {
    EXPECT_EQ(FilterBulletin("NL,ABC,ASX.STK,0,N,ABC EXPLORATION LIMITED,XYZ", Stocks()),
              Lines{"NL,ABC,05JAN24,0,Y,ABC EXP LTD XYZ"});
    // Only the first of each word; "MACQUARIE BANK" goes before "MACQUARIE" is tried.
    EXPECT_EQ(ShortenListingLine("MACQUARIE BANK MACQUARIE WARRANT LIMITED LIMITED"),
              "LTD LIMITED");
    EXPECT_EQ(ShortenListingLine("CAPITAL PROTECTED OPTION EXPIRING"), "CAP PRO OPT EXP ");
    // "AUSTRALIA" goes first ("SG AUST X"), then "SG AUST" with the blank after it.
    EXPECT_EQ(ShortenListingLine("SG AUSTRALIA X"), "X");
}

TEST(FilterBulletin, WarrantsOfTheStockBulletin) {
    auto o = Stocks();
    o.WarrantFilter = true;
    o.HasPriceFile = [](std::string_view code) { return code == "KRMWOA" || code == "ABCJKL"; };
    const std::string bulletin = "BI,KRMWOA,ASX.STK,0,N,05JAN24,1,4\n"
                                 "BI,KRMWOB,ASX.STK,0,N,05JAN24,1,4\n"
                                 "BI,ABCJKL,ASX.STK,0,N,05JAN24,1,4\n"
                                 "BI,ABCAEF,ASX.STK,0,N,05JAN24,1,4\n"
                                 "BI,ABCWX,ASX.STK,0,N,05JAN24,1,4\n"
                                 "BI,ABC,ASX.WNT,0,N,05JAN24,1,4\n";
    EXPECT_EQ(FilterBulletin(bulletin, o),
              (Lines{"BI,KRMWOA,05JAN24,0,N,05JAN24,1,4", "BI,ABCJKL,05JAN24,0,N,05JAN24,1,4",
                     "BI,ABCAEF,05JAN24,0,N,05JAN24,1,4", "BI,ABCWX,05JAN24,0,N,05JAN24,1,4"}));
    o.NoWarrants = true;
    EXPECT_EQ(FilterBulletin(bulletin, o),
              (Lines{"BI,ABCAEF,05JAN24,0,N,05JAN24,1,4", "BI,ABCWX,05JAN24,0,N,05JAN24,1,4"}));
    // Other bulletins keep their warrants.
    o.WarrantFilter = false;
    EXPECT_EQ(FilterBulletin(bulletin, o).size(), 6u);
}

TEST(FilterBulletin, ShortNamesAndDividends) {
    auto o = Stocks();
    const std::string bulletin = "NI,ABC,ASX.STK,0,N,ABC\n"
                                 "NI,XYZ,ASX.STK,0,N,XYZ\n"
                                 "NI,DEF,ASX.STK,0,N,DELETE THIS\n"
                                 "NL,ABC,ASX.STK,0,N,ABC MINING\n"
                                 "DI,ABC,ASX.STK,0,N,05JAN24,,,12.5\n";
    EXPECT_EQ(FilterBulletin(bulletin, o),
              (Lines{"NI,ABC,05JAN24,0,N,ABC", "NI,XYZ,05JAN24,0,N,XYZ",
                     "NL,ABC,05JAN24,0,Y,ABC MINING"}));
    o.NoShortNames = true;
    o.Divs = DividendRule::MarkY;
    EXPECT_EQ(FilterBulletin(bulletin, o),
              (Lines{"NI,XYZ,05JAN24,0,N,XYZ", "NL,ABC,05JAN24,0,Y,ABC MINING",
                     "DI,ABC,05JAN24,0,Y,05JAN24,,,12.5"}));
    o.Divs = DividendRule::MarkN;
    EXPECT_EQ(FilterBulletin(bulletin, o).back(), "DI,ABC,05JAN24,0,N,05JAN24,,,12.5");
    o.Divs = DividendRule::MarkD;
    EXPECT_EQ(FilterBulletin(bulletin, o).back(), "DI,ABC,05JAN24,0,D,05JAN24,,,12.5");
}

} // namespace
} // namespace kori::adjust
