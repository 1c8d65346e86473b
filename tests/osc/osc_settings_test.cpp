#include "osc/osc_identifiers.h"
#include "osc/osc_settings.h"

#include "platform/dialogs.h"
#include "platform/ini_file.h"
#include "platform/settings_store.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori;
using namespace kori::osc;

TEST(OscSettings, MissingKeysReadAsZeroAndFalse) {
    test::TempRoot root;
    root.Write("Kori.ini", "[OscDef]\r\nStochK=12abc\r\nRsiPW=70000\r\nFXRev=True\r\n"
                           "FillIn=-1\r\nCompFile=  C:\\data\\XAO.WDT  \r\n");
    const OscDef def = ReadOscSettings(platform::IniFile(root.path() / "Kori.ini"));
    EXPECT_EQ(def.StochK, 12); // the leading number of the text
    EXPECT_EQ(def.RsiPW, 0);   // beyond 16 bits: not set
    EXPECT_EQ(def.StochD, 0);  // absent
    EXPECT_EQ(def.Md3W, 0);
    EXPECT_TRUE(def.FXRev);
    EXPECT_TRUE(def.FillIn);
    EXPECT_FALSE(def.RFAve);
    EXPECT_FALSE(def.NoClassicMACD);
    EXPECT_EQ(def.CompFile, "C:\\data\\XAO.WDT");
    EXPECT_EQ(def.MMASet, "unknown");
}

TEST(OscSettings, WrittenSettingsReadBackUnderTheirKeys) {
    test::TempRoot root;
    platform::IniFile ini(root.path() / "Kori.ini");
    OscDef def;
    def.Md1W = 8;
    def.RmxP = 120;
    def.DMXW = 7;
    def.FXRev = true;
    def.CompFile = "/data/XAO.WDT";
    ASSERT_TRUE(WriteOscSettings(ini, def));
    EXPECT_EQ(ini.Read("OscDef", "Md1W"), "8");
    EXPECT_EQ(ini.Read("OscDef", "FXRev"), "True");
    const OscDef back = ReadOscSettings(ini);
    EXPECT_EQ(back.Md1W, 8);
    EXPECT_EQ(back.RmxP, 120);
    EXPECT_EQ(back.DMXW, 7);
    EXPECT_EQ(back.Md1, 0);
    EXPECT_TRUE(back.FXRev);
    EXPECT_EQ(back.CompFile, "/data/XAO.WDT");
}

TEST(OscSettings, DialogFillsDefaultsOfItsOwnColumnOnly) {
    OscDef def;
    def.RmxA = 4;
    FillOscDefaults(def, "RMX", true);
    EXPECT_EQ(def.RmxPW, 50); // weekly RMX default differs from the daily 100
    EXPECT_EQ(def.RmxAW, 20);
    EXPECT_EQ(def.RmxP, 0);
    FillOscDefaults(def, "RMX", false);
    EXPECT_EQ(def.RmxP, 100);
    EXPECT_EQ(def.RmxA, 4); // a set value stays

    FillOscDefaults(def, "ATR", false);
    EXPECT_EQ(def.AtrD, 0); // no default in the dialog
    FillOscDefaults(def, "R/F", false);
    EXPECT_EQ(def.RocP, 21);
    EXPECT_EQ(def.FXX, 25);

    def.BBA = 101;
    def.BBW = 100;
    EXPECT_EQ(BollingerPeriod(def, false), 21);
    EXPECT_EQ(BollingerPeriod(def, true), 100);
}

// Averages have no range test, but a negative one is refused by the dialog as any period is.
TEST(OscSettings, NegativePeriodsFailEvenWithoutARangeTest) {
    OscDef def;
    FillOscDefaults(def, "ROC", true);
    EXPECT_FALSE(OscFormProblem(def, "ROC", true));
    def.RocAW = -3;
    EXPECT_EQ(OscFormProblem(def, "ROC", true)->text, " Periods must be between 1 - 200 ");
    EXPECT_FALSE(NegativePeriodProblem(def, "ROC", "A")); // the daily column is fine
    EXPECT_EQ(NegativePeriodProblem(def, "ROC", "W")->text, "ROC Oscillator values not valid");
    EXPECT_EQ(FindOscPeriodKeyByName("RocAW")->Daily, "RocA");
    EXPECT_EQ(FindOscPeriodKeyByName("Nope"), nullptr);
}

TEST(OscSettings, ChartCheckNamesTheOscillatorAndUsesDailyRmxInBothColumns) {
    test::TempRoot root;
    OscDef def;
    FillOscDefaults(def, "STO", false);
    def.StochD = 0; // 0 is allowed for D
    EXPECT_FALSE(OscSettingsProblem(def, "STO", "A", "Chts"));
    def.StochK = 201;
    EXPECT_FALSE(OscSettingsProblem(def, "STO", "A", "ANAL")); // only in the chart window

    platform::ScriptedDialogs dialogs;
    EXPECT_FALSE(CheckOscSettings(def, "STO", "A", "CHTS", dialogs));
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text, "STO Oscillator values not valid");
    EXPECT_EQ(dialogs.shown()[0].title, "Oscillator Values");

    def.CompFile = root.Write("XAO.WDT", "").string();
    def.RmxP = 100;
    def.RmxPW = 0;
    EXPECT_FALSE(OscSettingsProblem(def, "RMX", "W ", "CHTS"));
    def.RmxP = 0;
    def.RmxPW = 50;
    EXPECT_TRUE(OscSettingsProblem(def, "RMX", "W", "CHTS"));
    // The settings dialog tests the weekly field itself.
    EXPECT_FALSE(OscFormProblem(def, "RMX", true));
    EXPECT_TRUE(OscFormProblem(def, "RMX", false));
}

TEST(OscSettings, ComparisonFileMessages) {
    test::TempRoot root;
    OscDef def;
    def.RmoP = 30;
    def.CompFile = (root.path() / "xao.wdt").string();
    auto problem = OscSettingsProblem(def, "RMO", "A", "CHTS");
    ASSERT_TRUE(problem);
    EXPECT_EQ(problem->text, "XAO is not available. Use your code for the All Ordinaries Index");
    EXPECT_EQ(problem->title, "RMX Compare ");

    root.Write("XAO.WDT", "x"); // found whatever the case of its name
    EXPECT_FALSE(OscSettingsProblem(def, "RMO", "A", "CHTS"));

    def.CompFile = "  ";
    problem = OscFormProblem(def, "RMO", false);
    ASSERT_TRUE(problem);
    EXPECT_EQ(problem->text, "Compare file code must be entered");
    EXPECT_EQ(problem->title, "RMO");

    def.RmoP = 0;
    problem = OscFormProblem(def, "RMO", false);
    ASSERT_TRUE(problem);
    EXPECT_EQ(problem->text, " Periods must be between 1 - 200 ");
}

TEST(OscSettings, BoxValueChecks) {
    EXPECT_EQ(BoxValueProblem("")->text, "Box value must have a value. eg 0.20");
    EXPECT_EQ(BoxValueProblem("0.00")->text, "Box value must have a value. eg 0.20");
    EXPECT_EQ(BoxValueProblem(".2x")->text, "Box value must be numeric eg 0.20");
    EXPECT_EQ(BoxValueProblem(".2x")->title, "Box Value");
    EXPECT_FALSE(BoxValueProblem(" 0.25 "));
}

TEST(OscIdentifiers, DispatcherOrderAndChoices) {
    std::string order;
    for (const auto& id : OscIdentifiers())
        order += std::string(id.OscName) + " ";
    EXPECT_EQ(order, "ATR STO FX ROC RMX RMO R/F RSI MACD WMS ERY MOM DM JHG COP VTY OBV PARA "
                     "PARAV ");
    EXPECT_EQ(FindOscIdentifier("RMO")->ListName, "");
    EXPECT_EQ(FindOscIdentifier(" R/F ")->PeriodKeys().size(), 4u);
    EXPECT_TRUE(FindOscIdentifier("OBV")->PeriodKeys().empty());
    EXPECT_EQ(FindOscIdentifier("XYZ"), nullptr);
    // Every panel oscillator has a computation and a panel; the parabolic has neither.
    for (const auto& id : OscIdentifiers()) {
        EXPECT_EQ(id.Compute == nullptr, id.OnPriceChart) << id.OscName;
        EXPECT_EQ(id.Draw == nullptr, id.OnPriceChart) << id.OscName;
    }

    const auto choices = MultiOscChoices();
    ASSERT_EQ(choices.size(), 18u);
    EXPECT_EQ(choices[0], "None");
    EXPECT_EQ(choices[2], "Directional Movement");
    EXPECT_EQ(choices[7], "OBV");
    EXPECT_EQ(choices[11], "ROC and FX");
    EXPECT_EQ(choices[14], "Stochastic (Fast)");
    EXPECT_EQ(choices[15], "Stochastic (Slow)");
    EXPECT_EQ(choices[17], "Williams %R");

    // The chooser: the window's order with its own captions, the slow stochastic its own row.
    std::string chooser;
    for (const auto& c : ChooserOrder())
        chooser += std::string(ChooserCaption(c)) + "|";
    EXPECT_EQ(chooser, "Average True Range|Directional Movement|Coppock|ElderRay|FX|"
                       "Jones Holy Grail|MACD|Momentum|On-Balance Volume|ROC|ROC & FX|RMO|RMX|"
                       "RSI|Stochastic|Stochastic(slow)|Volatility|Williams %R|Parabolic|");
    EXPECT_TRUE(ChooserOrder()[15].SlowStochastic);
}

TEST(OscIdentifiers, MultiOscSetsAreStoredAsTrimmedCommaLists) {
    test::TempRoot root;
    platform::SettingsStore store(root.path() / "store.ini");
    EXPECT_EQ(LoadMultiOscSet(store, 1).Slots[4], "None");

    MultiOscSet set;
    set.Slots = {" RSI ", "MACD", "None", "Stochastic (Slow)", "OBV"};
    SaveMultiOscSet(store, 2, set);
    EXPECT_EQ(store.Get("Multi-Osc 2", ""), "RSI,MACD,None,Stochastic (Slow),OBV");
    EXPECT_EQ(store.Get("Multi-Osc 1", "absent"), "absent");

    store.Save("Multi-Osc 1", "RSI,,FX");
    const MultiOscSet back = LoadMultiOscSet(store, 1);
    EXPECT_EQ(back.Slots[0], "RSI");
    EXPECT_EQ(back.Slots[1], "None"); // an empty slot reads "None"
    EXPECT_EQ(back.Slots[2], "FX");
    EXPECT_EQ(back.Slots[3], "None");
}
