#include "platform/files.h"
#include "platform/text.h"
#include "scan/cht_scan1.h"
#include "scan_rig.h"
#include "store/chart_list.h"

#include <filesystem>
#include <gtest/gtest.h>

using namespace kori::scan;
using kori::test::RecordingProgress;
using kori::test::RigSecurity;
using kori::test::TempRoot;
using kori::test::WriteRig;

namespace {

Scan1Options Rises(const char* pct = "10") {
    Scan1Options o;
    o.Rise = true;
    o.RisePercent = pct;
    return o;
}

Scan1Result Scan(const TempRoot& root, const Scan1Options& o, kori::osc::OscDef def = {}) {
    RecordingProgress progress;
    return RunScan1(root.folder(), o, def, progress);
}

std::vector<std::string> Codes(const Scan1Result& r) {
    std::vector<std::string> out;
    for (const auto& row : r.Rows)
        out.push_back(row.Code + ":" + row.Move);
    return out;
}

std::vector<std::string> ListZ(const TempRoot& root) {
    std::vector<kori::store::ChartListEntry> entries;
    std::vector<std::string> out;
    if (!kori::platform::FileExists(kori::store::ListPath(root.folder(), 'Z'))) return out;
    EXPECT_TRUE(kori::store::ReadList(kori::store::ListPath(root.folder(), 'Z'), entries).ok());
    for (const auto& e : entries)
        out.push_back(std::to_string(e.NameRecord) + " " + kori::platform::Trim(e.Code));
    return out;
}

} // namespace

TEST(ChtScan1, RisesAndFallsOnTheLastTwoClosesExactPercentagesPass) {
    TempRoot root;
    WriteRig(root, {{"ONE", {1.00f}},                 // one record: skipped
                    {"FLAT", {2.00f, 2.00f}},         // equal closes pass neither test
                    {"EXACT", {5.00f, 1.00f, 1.10f}}, // exactly 10% up
                    {"THIRTY", {0.30f, 0.33f}},       // exactly 10% up in cents
                    {"SHORT", {1.00f, 1.09f}},        // 9% up
                    {"DOWN", {2.00f, 1.80f}},         // exactly 10% down
                    {"ZERO", {0.00f, 1.50f}}});       // a previous close of 0: no test
    Scan1Options o = Rises();
    o.Fall = true;
    const Scan1Result r = Scan(root, o);
    ASSERT_TRUE(r.Status.ok()) << r.Status.message();
    EXPECT_EQ(Codes(r), (std::vector<std::string>{"EXACT:U", "THIRTY:U", "DOWN:D"}));
    ASSERT_TRUE(r.Rows[0].Change);
    EXPECT_NEAR(*r.Rows[0].Change, 10.0, 1e-4);
    EXPECT_NEAR(*r.Rows[2].Change, -10.0, 1e-4);
    EXPECT_FLOAT_EQ(r.Rows[0].Close, 1.10f);
    EXPECT_TRUE(r.Rows[0].All);
    // Record numbers in Names.dat go to the scan list with the codes.
    EXPECT_EQ(ListZ(root), (std::vector<std::string>{"3 EXACT", "4 THIRTY", "6 DOWN"}));
    ASSERT_TRUE(r.Message);
    EXPECT_EQ(r.Message->Text, "The codes have been stored in list Chart Scan Results List\n"
                               " This list can be selected to view charts\n from the\n"
                               " Chart Selection form.");
    EXPECT_EQ(r.Message->Title, " Chart Scan");
}

TEST(ChtScan1, ClosingMessagesWhenNothingIsFound) {
    TempRoot root;
    WriteRig(root, {{"FLAT", {2.00f, 2.00f}}});
    Scan1Options o = Rises("12");
    EXPECT_EQ(Scan(root, o).Message->Text, "There were no rises of 12% or Buy/Sell Indications ");
    o.Rise = false;
    o.Fall = true;
    o.FallPercent = "7";
    EXPECT_EQ(Scan(root, o).Message->Text, "There were no falls of 7% or Buy/Sell Indications ");
    o.Rise = true;
    EXPECT_EQ(Scan(root, o).Message->Text,
              "There were no rises of 12% or falls of 7% or Buy/Sell Indications ");
    o.Rise = o.Fall = false;
    o.Osc[0] = true;
    o.Indications.OB = true;
    EXPECT_EQ(Scan(root, o).Message->Text, "There were no Buy/Sell Indications ");
    EXPECT_TRUE(ListZ(root).empty()); // nothing found: no list written
}

TEST(ChtScan1, FiltersOfTheNameRecordAndThePriceRange) {
    TempRoot root;
    const std::vector<float> up = {1.00f, 1.50f};
    WriteRig(root, {{"AAA", up, 4, 5, "121"},
                    {"BBB", up, 4, 6, "131"},
                    {"CCC", up, 5, 5, "12"},
                    {"ADV", up, 3, 5, "121"},
                    {"AAAWOA", up, 4, 5, "121"},
                    {"DEAR", {10.0f, 15.0f}, 4, 5, "121"}});
    EXPECT_EQ(Codes(Scan(root, Rises())),
              (std::vector<std::string>{"AAA:U", "BBB:U", "CCC:U", "AAAWOA:U", "DEAR:U"}));
    Scan1Options o = Rises();
    o.CategoryOn = true; // type 4 and category 5 only
    o.Category = "5";
    EXPECT_EQ(Codes(Scan(root, o)), (std::vector<std::string>{"AAA:U", "AAAWOA:U", "DEAR:U"}));
    o = Rises();
    o.ClassOn = true; // a group: first two digits, classes of three characters
    o.Class = "120";
    EXPECT_EQ(Codes(Scan(root, o)), (std::vector<std::string>{"AAA:U", "AAAWOA:U", "DEAR:U"}));
    o.Class = "131";
    EXPECT_EQ(Codes(Scan(root, o)), (std::vector<std::string>{"BBB:U"}));
    o = Rises();
    o.NoWarrants = true;
    o.Range = {true, "0.50", "5.00"};
    EXPECT_EQ(Codes(Scan(root, o)), (std::vector<std::string>{"AAA:U", "BBB:U", "CCC:U"}));
    // Min above Max holds no close: nothing is found and the list stays as it was.
    o.Range = {true, "5.00", "0.50"};
    const auto before = ListZ(root);
    const auto r = Scan(root, o);
    EXPECT_TRUE(r.Rows.empty());
    EXPECT_EQ(r.Message->Text, "There were no rises of 10% or Buy/Sell Indications ");
    EXPECT_EQ(ListZ(root), before);
}

TEST(ChtScan1, OscillatorColumnsAndTheAllMark) {
    TempRoot root;
    // Stochastic K = 2 cuts up through the OB line; the rise is 33%.
    WriteRig(root, {{"STO", {10, 10, 10, 20, 15, 20}},
                    {"HALF", {10, 10, 10, 20, 15, 17.5f}},
                    {"OSD", {20, 20, 20, 20, 10, 10}}});
    kori::osc::OscDef def;
    def.StochK = 2;
    def.StochD = 3;
    Scan1Options o = Rises();
    o.Osc[0] = true;
    o.Indications.CutOB = true;
    auto r = Scan(root, o, def);
    ASSERT_EQ(r.Rows.size(), 2u);
    EXPECT_EQ(r.Rows[0].Code, "STO");
    EXPECT_EQ(r.Rows[0].Indications[0], "Cut OB UP");
    EXPECT_TRUE(r.Rows[0].All);
    EXPECT_EQ(r.Rows[1].Code, "HALF"); // a rise without an indication: not all
    EXPECT_EQ(r.Rows[1].Indications[0], "");
    EXPECT_FALSE(r.Rows[1].All);
    // "OS" is found only when its box is ticked.
    o.Rise = false;
    o.Indications.OS = true;
    r = Scan(root, o, def);
    EXPECT_EQ(Codes(r), (std::vector<std::string>{"STO:", "OSD:"}));
    EXPECT_EQ(r.Rows[1].Indications[0], "OS");
    // Ticked oscillators without an indication box are not worked at all.
    o.Indications = {};
    r = Scan(root, o, def);
    EXPECT_TRUE(r.Rows.empty());
}

TEST(ChtScan1, MomentumTakesTheRateOfChangePeriod) {
    TempRoot root;
    WriteRig(root, {{"MOM", {10, 20, 30, 30, 30}}});
    kori::osc::OscDef def;
    def.RocP = 3;
    def.MMA = 1;
    Scan1Options o;
    o.Osc[3] = true;
    o.Indications.OB = true;
    auto r = Scan(root, o, def);
    ASSERT_EQ(r.Rows.size(), 1u);
    EXPECT_EQ(r.Rows[0].Indications[3], "Cut OB UP");
    def.RocP = 1;
    def.MMA = 3;
    EXPECT_TRUE(Scan(root, o, def).Rows.empty());
}

TEST(ChtScan1, ValidationMessages) {
    kori::osc::OscDef def;
    def.StochK = 10;
    Scan1Options o;
    o.Range = {true, "abc", "5"};
    auto m = ValidateScan1(o, def);
    ASSERT_TRUE(m);
    EXPECT_EQ(m->Text, "Invalid price range");
    EXPECT_EQ(m->Title, "Analysis");
    o.Range.Min = "0.5";
    EXPECT_FALSE(ValidateScan1(o, def));
    o.Rise = true;
    o.RisePercent = "201";
    EXPECT_EQ(ValidateScan1(o, def)->Text, "Percentage Not valid - Valid Range 1 to 200 ");
    o.RisePercent = "200";
    o.CategoryOn = true;
    o.Category = "x";
    EXPECT_EQ(ValidateScan1(o, def)->Text, "Category invalid");
    o.Category = "86";
    o.ClassOn = true;
    o.Class = "01A";
    m = ValidateScan1(o, def);
    EXPECT_EQ(m->Text, "Industry Classification ID must be numeric   eg 010");
    EXPECT_EQ(m->Title, "Chart Scan");
    o.Class = "01";
    EXPECT_EQ(ValidateScan1(o, def)->Text, "Industry Classification invalid");
    o.Class = "010";
    EXPECT_FALSE(ValidateScan1(o, def));
    o.Osc[4] = true;
    def.RsiP = -1;
    EXPECT_EQ(ValidateScan1(o, def)->Text, "Invalid R.S.I Oscillator Values. Correct the values "
                                           "in the CHART DEFAULTS List");
    def.RsiP = 0; // means 21
    EXPECT_FALSE(ValidateScan1(o, def));
    o.Osc[0] = true;
    def.StochK = 0;
    EXPECT_EQ(ValidateScan1(o, def)->Text, "Invalid STOCHASTIC Oscillator Values. Correct the "
                                           "values in the CHART DEFAULTS List");
}

TEST(ChtScan1, PriceFilesThatCannotBeReadAreSkippedAndTheWalkGoesOn) {
    TempRoot root;
    WriteRig(root, {{"MISS", {}},
                    {"EMPTY", {}},
                    {"TORN", {1.0f, 1.5f}},
                    {"HUGE", {}},
                    {"GOOD", {1.0f, 1.5f}}});
    root.Write("EMPTY.WDT", "");
    {
        std::string torn = root.Read("TORN.WDT");
        root.Write("TORN.WDT", torn + "part");
    }
    // 32,768 records: one more than the format can count.
    std::filesystem::resize_file(root.Write("HUGE.WDT", ""), 32768u * 50u);
    const auto r = Scan(root, Rises());
    // A torn end is reported but its whole records are read.
    EXPECT_EQ(Codes(r), (std::vector<std::string>{"TORN:U", "GOOD:U"}));
    EXPECT_GE(r.Issues.size(), 4u);
}

TEST(ChtScan1, ChartListEntriesPastTheNameFileAreSkipped) {
    TempRoot root;
    WriteRig(root, {{"AAA", {1.0f, 1.5f}}, {"BBB", {1.0f, 1.5f}}});
    ASSERT_TRUE(kori::store::WriteList(kori::store::ListPath(root.folder(), 'B'),
                                       {{9, "XXX"}, {2, "BBB"}, {0, "AAA"}})
                    .ok());
    Scan1Options o = Rises();
    o.List = 'B';
    const auto r = Scan(root, o);
    EXPECT_EQ(Codes(r), (std::vector<std::string>{"BBB:U"}));
    EXPECT_EQ(ListZ(root), (std::vector<std::string>{"2 BBB"}));
}

TEST(ChtScan1, CancelKeepsTheRowsSoFarAndWritesNoList) {
    TempRoot root;
    std::vector<RigSecurity> list;
    for (int i = 0; i < 300; ++i)
        list.push_back({"C" + std::to_string(i), {1.0f, 1.5f}});
    WriteRig(root, list);
    ASSERT_TRUE(
        kori::store::WriteList(kori::store::ListPath(root.folder(), 'Z'), {{1, "OLD"}}).ok());
    RecordingProgress progress(5);
    const auto r = RunScan1(root.folder(), Rises(), {}, progress);
    // Both threads stop at the cancel: what was done is kept, in the order of the walk. The
    // other thread may, on a starved machine, have finished the walk before the cancel was
    // seen; then the run is whole and says so.
    EXPECT_GE(r.Rows.size(), 1u);
    for (std::size_t i = 1; i < r.Rows.size(); ++i)
        EXPECT_LT(r.Rows[i - 1].NameRecord, r.Rows[i].NameRecord);
    if (r.Cancelled) {
        EXPECT_LT(r.Rows.size(), 300u);
        EXPECT_FALSE(r.Message);
        EXPECT_EQ(ListZ(root), (std::vector<std::string>{"1 OLD"}));
    } else {
        EXPECT_EQ(r.Rows.size(), 300u);
    }
    EXPECT_EQ(progress.statuses.front(), "Checking Data - WAIT");
    EXPECT_EQ(progress.range, 300);
}

TEST(ChtScan1, RowsComeInTheOrderOfTheWalk) {
    TempRoot root;
    std::vector<RigSecurity> list;
    std::vector<std::string> expected;
    for (int i = 0; i < 200; ++i) {
        const bool up = i % 3 == 0;
        list.push_back({"C" + std::to_string(i), {1.0f, up ? 1.5f : 1.0f}});
        if (up) expected.push_back("C" + std::to_string(i) + ":U");
    }
    WriteRig(root, list);
    EXPECT_EQ(Codes(Scan(root, Rises())), expected);
}

TEST(ChtScan1, ReadsBackToTheCloseANoTradeRecordRepeats) {
    // A long flat run of no-trade records before the last bars: the stochastic's window sees
    // the close they repeat, found far back in the file.
    std::vector<float> closes(60, 0.0f);
    closes[0] = 10;
    closes[1] = 10;
    closes[2] = 20;
    closes.push_back(15);
    TempRoot root;
    WriteRig(root, {{"GAP", closes}});
    kori::osc::OscDef def;
    def.StochK = 2;
    Scan1Options o;
    o.Osc[0] = true;
    o.Indications.CutOB = true;
    o.Indications.OB = true;
    // Bars 3..59 repeat 20: bar 59 stands at v 100 of a window without range... 100 x (20 - 20) =
    // 0. The last bar, 15, under a window of 20, 20, 15: v 0. Neither is overbought.
    EXPECT_TRUE(Scan(root, o, def).Rows.empty());
    o.Indications.OS = true;
    const auto r = Scan(root, o, def);
    ASSERT_EQ(r.Rows.size(), 1u);
    EXPECT_EQ(r.Rows[0].Indications[0], "OS");
}
