// The settings and folder windows on a sample library: each window opened, a value changed,
// and what lands in Kori.ini or the settings store checked, with the refusals the user sees.
#include "app/chart_service.h"
#include "app/colour_table.h"
#include "app/folder_config.h"
#include "app/sample_library.h"
#include "app/session.h"
#include "app/start_up.h"
#include "gui/windows/blank_spc.h"
#include "gui/windows/c_path.h"
#include "gui/windows/chart2.h"
#include "gui/windows/cht_def.h"
#include "gui/windows/cht_fonts.h"
#include "gui/windows/col_new.h"
#include "gui/windows/data_paths.h"
#include "gui/windows/gl_spaces.h"
#include "gui/windows/locate.h"
#include "gui/windows/logo.h"
#include "gui/windows/main_window.h"
#include "gui/windows/mma_set.h"
#include "gui/windows/multi_osc.h"
#include "gui/windows/osc_frm.h"
#include "gui/windows/plw.h"
#include "gui/windows/register_windows.h"
#include "gui/windows/scales.h"
#include "gui/windows/settings_windows.h"
#include "gui/windows/stp_ls.h"
#include "gui/windows/swing_set.h"
#include "gui/windows/v_height.h"
#include "osc/osc_identifiers.h"
#include "osc/osc_settings.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/files.h"
#include "platform/settings_store.h"
#include "store/name_file.h"
#include "support/temp_root.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QGuiApplication>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QScreen>
#include <QSignalSpy>
#include <QTest>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

using namespace kori;
using platform::Answer;

namespace {

struct SampleRoot : ::testing::Test {
    test::TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::SettingsStore settings{root.path() / "settings.ini"};
    platform::FixedClock clock{"20261120"};
    app::Session session{root.path(), platform::Services{dialogs, progress, settings, clock}};
    gui::SettingsHub hub;

    void SetUp() override {
        dialogs.QueueAnswer(Answer::No); // " Do you have a Colour Printer ?"
        app::InitialiseSession(session, "");
        platform::CreateFolder(session.folders.DataFolder);
        app::SampleSummary summary;
        ASSERT_TRUE(app::MakeSampleLibrary(session.folders.SystemFolder, session.folders.DataFolder,
                                           settings, summary));
        dialogs.clear();
    }

    std::string Ini(const char* section, const char* key) {
        return session.ini().Read(section, key);
    }
    std::vector<std::string> Messages() const { return dialogs.messages(); }
    std::string LastTitle() const {
        for (auto it = dialogs.shown().rbegin(); it != dialogs.shown().rend(); ++it)
            if (it->kind == "msg") return it->title;
        return {};
    }
};

template <typename T> T* Child(QWidget& w, const char* name) {
    T* c = w.findChild<T*>(QString::fromLatin1(name));
    EXPECT_NE(c, nullptr) << name;
    return c;
}

void Click(QWidget& w, const char* button) {
    auto* b = Child<QPushButton>(w, button);
    if (b) QTest::mouseClick(b, Qt::LeftButton);
}

} // namespace

TEST_F(SampleRoot, PathDetailsSaveRefuseAndAskBeforeLeavingWithChanges) {
    gui::CPath w(session, hub);
    QSignalSpy changed(&hub, &gui::SettingsHub::DataFolderChanged);
    ASSERT_TRUE(w.proceed());
    EXPECT_EQ(w.windowTitle(), "Path Details");
    EXPECT_EQ(w.field(1)->text().toStdString(), session.folders.DataFolder);

    w.field(3)->setText("");
    Click(w, "cmdSave");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Directory paths must be entered"});
    EXPECT_TRUE(w.isVisible() || w.result() != QDialog::Accepted);

    const std::string other = root.folder() + "elsewhere";
    w.field(3)->setText(QString::fromStdString(root.folder() + "pfm"));
    w.field(1)->setText(QString::fromStdString(other)); // typed without the separator
    Click(w, "cmdSave");
    EXPECT_EQ(Ini("KoriPaths", "ChtData"), other + "/");
    EXPECT_EQ(Ini("KoriPaths", "PFMData"), root.folder() + "pfm/");
    EXPECT_EQ(session.folders.DataFolder, other + "/");
    EXPECT_EQ(changed.count(), 1);

    // Leaving with an unsaved change asks; "No" leaves without writing.
    gui::CPath again(session, hub);
    again.field(2)->setText("/tmp/never");
    dialogs.clear();
    dialogs.QueueAnswer(Answer::No);
    again.reject();
    EXPECT_EQ(Messages(), std::vector<std::string>{"Paths have changed. SAVE Changes ?"});
    EXPECT_EQ(LastTitle(), "Save Changes");
    EXPECT_NE(Ini("KoriPaths", "ChtBackUp"), "/tmp/never/");
}

TEST_F(SampleRoot, PathDetailsWithPathsMissing) {
    session.pathsMissing = true;
    QSignalSpy exit(&hub, &gui::SettingsHub::ExitRequested);
    dialogs.QueueAnswer(Answer::Cancel);
    gui::CPath ending(session, hub);
    EXPECT_FALSE(ending.proceed());
    EXPECT_EQ(exit.count(), 1);
    EXPECT_EQ(LastTitle(), "No Paths selected");

    // "Yes" stays in the window with the fields to fill.
    dialogs.QueueAnswer(Answer::Yes);
    gui::CPath entering(session, hub);
    EXPECT_TRUE(entering.proceed());
    EXPECT_TRUE(entering.field(0)->text().isEmpty());
}

TEST_F(SampleRoot, LocateRefusesWhatIsNotAFolder) {
    gui::Locate w(session, hub, session.folders.SystemFolder);
    w.SetPath(QString::fromStdString(session.folders.SystemFolder + "Kori.ini"));
    Click(w, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Path not set correctly"});
    EXPECT_FALSE(w.chosen());
    w.SetPath(QString::fromStdString(session.folders.DataFolder));
    Click(w, "cmdOK");
    ASSERT_TRUE(w.chosen());
    EXPECT_EQ(*w.chosen(), session.folders.DataFolder);
}

TEST_F(SampleRoot, DataFoldersSaveTheListAndOfferToCreateMissingFolders) {
    gui::DataPaths w(session, hub, gui::DataPaths::Mode::Setting);
    EXPECT_EQ(w.windowTitle(), "Data Folders");
    for (int i = 0; i < app::kDataTypeCount; ++i)
        w.field(i)->setText("");
    Click(w, "cmdSave");
    EXPECT_EQ(Messages(), std::vector<std::string>{"At least one data folder must be entered"});
    EXPECT_EQ(LastTitle(), "Chart Data Folders");

    dialogs.clear();
    const std::string fresh = root.folder() + "indices";
    w.field(0)->setText(QString::fromStdString(session.folders.DataFolder));
    w.field(1)->setText(QString::fromStdString(fresh));
    dialogs.QueueAnswer(Answer::Yes);
    Click(w, "cmdSave");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Directory " + fresh +
                                                   "/ does not exist. Create this directory ?"});
    EXPECT_TRUE(std::filesystem::is_directory(fresh));
    const auto lst = app::ReadChartPathsFile(session.folders.SystemFolder + "ChtPaths.lst");
    ASSERT_TRUE(lst);
    EXPECT_EQ((*lst)[1], fresh + "/");
    EXPECT_TRUE(platform::FileExists(session.folders.SystemFolder + "WMPaths.lst"));
}

TEST_F(SampleRoot, PickingADataFolderNeedsANameFile) {
    const std::string empty = root.folder() + "empty/";
    platform::CreateFolder(empty);
    app::ChartDataPaths paths;
    paths[0] = session.folders.DataFolder;
    paths[2] = empty;
    ASSERT_TRUE(app::WriteChartPathsFile(session.folders.SystemFolder + "ChtPaths.lst", paths));
    const std::string before = session.folders.DataFolder;

    gui::DataPaths w(session, hub, gui::DataPaths::Mode::Picking);
    QSignalSpy changed(&hub, &gui::SettingsHub::DataFolderChanged);
    EXPECT_TRUE(w.field(0)->isReadOnly());
    EXPECT_EQ(w.findChild<QPushButton*>("cmdSave"), nullptr);
    EXPECT_TRUE(w.option(0)->isChecked());

    w.option(2)->click();
    EXPECT_EQ(session.folders.DataFolder, before);
    EXPECT_FALSE(w.folderChanged());
    EXPECT_TRUE(w.option(0)->isChecked()); // the refused pick does not stay ticked
    EXPECT_EQ(Messages().size(), 1u);

    (void)session.ini().Write("KoriPaths", "ChtData", "somewhere");
    ASSERT_TRUE(w.Pick(0));
    EXPECT_TRUE(w.folderChanged());
    EXPECT_EQ(Ini("KoriPaths", "ChtData"), before);
    EXPECT_EQ(changed.count(), 1);
}

TEST_F(SampleRoot, ColoursClickAColourThenItemsAndSave) {
    gui::ColNew w(session, hub);
    EXPECT_EQ(w.windowTitle(), "Change Chart Colours");
    QTest::mouseClick(w.roleSwatch(0), Qt::LeftButton); // no colour chosen yet: a beep
    ASSERT_FALSE(dialogs.shown().empty());
    EXPECT_EQ(dialogs.shown().back().kind, "beep");

    QTest::mouseClick(w.colourSwatch(12), Qt::LeftButton); // light red
    const platform::Colour frame = w.table()[16];
    QTest::mouseClick(w.roleSwatch(0), Qt::LeftButton);  // Background: the cleared plot, 17
    QTest::mouseClick(w.roleSwatch(31), Qt::LeftButton); // End of year marker: year lines, 34
    EXPECT_EQ(w.table()[17], platform::kStandardColours[12]);
    EXPECT_EQ(w.table()[34], platform::kStandardColours[12]);
    EXPECT_EQ(w.table()[16], frame) << "the frame is not the background";
    EXPECT_NE(session.palette[17], platform::kStandardColours[12]); // nothing kept until saved
    // The swatch shows the colour the chart takes.
    EXPECT_TRUE(w.roleSwatch(0)->styleSheet().contains(QStringLiteral("#ff0000")));

    Click(w, "cmdSave");
    platform::Palette read{};
    ASSERT_EQ(app::ReadColourFile(session.folders.SystemFolder + "koriclr.dat", read), 49);
    EXPECT_EQ(read[17], platform::kStandardColours[12]);
    EXPECT_EQ(session.palette[34], platform::kStandardColours[12]);
}

TEST_F(SampleRoot, ColourSchemesApplyAndSaveAsDefault) {
    gui::ColNew w(session, hub);
    auto buttons = w.findChildren<QPushButton*>("cmdDefault");
    ASSERT_EQ(buttons.size(), 3);
    EXPECT_EQ(buttons[1]->text(), "Default WHITE");
    QTest::mouseClick(buttons[1], Qt::LeftButton);
    // The built-in white scheme: a white plot with black bars, and the chart on show takes it.
    EXPECT_EQ(w.table()[17], platform::kStandardColours[15]);
    EXPECT_EQ(w.table()[18], platform::kStandardColours[0]);
    EXPECT_EQ(session.palette[17], platform::kStandardColours[15]);
    EXPECT_TRUE(w.roleSwatch(0)->styleSheet().contains(QStringLiteral("#ffffff")));
    QTest::mouseClick(buttons[2], Qt::LeftButton);
    EXPECT_EQ(session.palette[17], platform::kStandardColours[1]) << "Default BLUE";

    QTest::mouseClick(buttons[1], Qt::LeftButton);
    QTest::mouseClick(w.colourSwatch(14), Qt::LeftButton);
    QTest::mouseClick(w.roleSwatch(0), Qt::LeftButton);
    dialogs.QueueAnswer(Answer::Yes);
    Click(w, "cmdSaveDefault");
    EXPECT_EQ(LastTitle(), "Colours");
    platform::Palette scheme{};
    ASSERT_TRUE(app::ReadColourFile(session.folders.SystemFolder + "koriclr.WHT", scheme));
    EXPECT_EQ(scheme[17], platform::kStandardColours[14]);
}

TEST_F(SampleRoot, FontsNeedBothAndAreWrittenUnderBothSections) {
    gui::ChtFonts w(session, hub);
    EXPECT_EQ(w.windowTitle(), "Fonts Selection");
    w.SetFont1("DejaVu Sans", 9);
    Click(w, "cmdSave"); // the scale font's size was never chosen
    EXPECT_EQ(Messages(), std::vector<std::string>{"Fonts and sizes must be selected for both"});
    EXPECT_EQ(LastTitle(), "Font Selection");

    QSignalSpy rebuild(&hub, &gui::SettingsHub::RebuildChart);
    w.SetFont2("DejaVu Sans Mono", 7.5);
    Click(w, "cmdSave");
    EXPECT_EQ(Ini("Chart Fonts", "CFont"), "DejaVu Sans");
    EXPECT_EQ(Ini("Chart Fonts", "CFontSize"), "9");
    EXPECT_EQ(Ini("Chart Fonts", "SFontSize"), "7.5");
    EXPECT_EQ(Ini("ChartFonts", "SFont"), "DejaVu Sans Mono");
    EXPECT_EQ(rebuild.count(), 1);
}

TEST_F(SampleRoot, ChartDefaultsSaveEveryFieldAndRefuseBadPeriods) {
    gui::ChtDef w(session, hub, gui::ChtDef::Caller::Menu);
    EXPECT_EQ(w.windowTitle(), "Chart Defaults");
    auto* av1 = static_cast<QLineEdit*>(w.control("Av1D"));
    ASSERT_NE(av1, nullptr);
    EXPECT_EQ(av1->text(), "10");
    av1->setText("0");
    static_cast<QLineEdit*>(w.control("AtrD"))->setText("14");
    static_cast<QLineEdit*>(w.control("AtrW"))->setText("10");
    EXPECT_FALSE(w.Save());
    EXPECT_EQ(Messages(), std::vector<std::string>{"Average periods must be between 1 - 200"});

    QSignalSpy saved(&hub, &gui::SettingsHub::ChartDefaultsSaved);
    (void)session.ini().Write("Charts", "Line Width", "7"); // as a small window would
    av1->setText("15");
    static_cast<QComboBox*>(w.control("AvCalc"))->setCurrentIndex(0);
    static_cast<QComboBox*>(w.control("ScMethod"))->setCurrentText("Name File");
    static_cast<QCheckBox*>(w.control("NoClassicMACD"))->setChecked(false);
    static_cast<QLineEdit*>(w.control("CompFile"))->setText(" /data/XAO.WDT ");
    Click(w, "cmdSave");
    EXPECT_EQ(saved.count(), 1);
    EXPECT_EQ(Ini("Charts", "Av1D"), "15");
    EXPECT_EQ(Ini("Charts", "AvCalc"), "True");
    EXPECT_EQ(Ini("Charts", "ScMethod"), "False");
    EXPECT_EQ(Ini("Charts", "NoClassicMACD"), "True");
    EXPECT_EQ(Ini("Charts", "Line Width"), "7"); // the small window's value stands
    EXPECT_EQ(Ini("OscDef", "AtrD"), "14");
    EXPECT_EQ(Ini("OscDef", "CompFile"), "/data/XAO.WDT");
    EXPECT_EQ(Ini("OscDef", "NoClassicMACD"), "True");

    // The ATR period may stay unset, but a value must be 1 to 200.
    gui::ChtDef again(session, hub, gui::ChtDef::Caller::Menu);
    EXPECT_EQ(static_cast<QLineEdit*>(again.control("CompFile"))->text(), "/data/XAO.WDT");
    static_cast<QLineEdit*>(again.control("AtrW"))->setText("201");
    dialogs.clear();
    EXPECT_FALSE(again.Save());
    EXPECT_EQ(Messages(), std::vector<std::string>{" Periods must be between 1 - 200 "});
    static_cast<QLineEdit*>(again.control("AtrW"))->setText("");
    EXPECT_TRUE(again.Save());
    EXPECT_EQ(Ini("OscDef", "AtrW"), "0");
}

TEST_F(SampleRoot, SmallWindowsStoreTheirValueAndRebuildTheChart) {
    QSignalSpy rebuild(&hub, &gui::SettingsHub::RebuildChart);
    gui::PLW plw(session, hub);
    plw.width()->setText("11");
    Click(plw, "cmdOK");
    EXPECT_EQ(LastTitle(), "Line Width");
    EXPECT_EQ(rebuild.count(), 0);
    plw.width()->setText("4");
    Click(plw, "cmdOK");
    EXPECT_EQ(Ini("Charts", "Line Width"), "4");
    EXPECT_EQ(rebuild.count(), 1);

    gui::StpLs stop(session, hub);
    stop.on()->setChecked(true);
    stop.percent()->setText("150");
    dialogs.clear();
    Click(stop, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Invalid value - must be between 0 and 100"});
    EXPECT_EQ(LastTitle(), "Stop Loss");
    stop.percent()->setText("8.5");
    Click(stop, "cmdOK");
    EXPECT_EQ(Ini("Charts", "StopLoss"), "True");
    EXPECT_EQ(Ini("Charts", "SL Percent"), "8.5");

    gui::VHeight height(session, hub);
    EXPECT_TRUE(height.option(1)->isChecked());
    height.option(3)->setChecked(true);
    Click(height, "cmdOK");
    EXPECT_EQ(Ini("Charts", "VHeight"), "3");

    gui::GLSpaces grid(session, hub);
    grid.space()->setText("12");
    grid.midGrid()->setChecked(true);
    Click(grid, "cmdOK");
    EXPECT_EQ(Ini("Charts", "VGSpace"), "12");
    EXPECT_EQ(Ini("Charts", "MidGrid"), "1");

    gui::BlankSpc blank(session, hub);
    blank.blank()->setText("30");
    Click(blank, "cmdOK");
    EXPECT_EQ(Ini("Charts", "DBlank"), "30");
    EXPECT_EQ(rebuild.count(), 5);
}

TEST_F(SampleRoot, MMASettingsMustBeNumericAndTheDefaultButtonPutsThemBack) {
    gui::MMASet w(session, hub);
    w.box(0)->setText("7");
    w.box(11)->setText("6o");
    Click(w, "cmdOK");
    EXPECT_EQ(LastTitle(), "MMA Settings");
    w.box(11)->setText("65");
    Click(w, "cmdOK");
    EXPECT_EQ(Ini("Charts", "MMASet"), "7,5,8,10,12,15,30,35,40,45,50,65");
    gui::MMASet again(session, hub);
    EXPECT_EQ(again.box(11)->text(), "65");
    Click(again, "cmdDefault");
    EXPECT_EQ(again.box(0)->text(), "3");
    EXPECT_EQ(again.box(11)->text(), "60");
}

TEST_F(SampleRoot, SwingSettingsCheckTheirValue) {
    gui::SwingSet w(session, hub);
    EXPECT_EQ(w.windowTitle(), "Swing");
    w.method(1)->setChecked(true); // XDay: the value box starts at 3 days
    EXPECT_EQ(w.value()->text(), "3");
    w.value()->setText("31");
    Click(w, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Incorrect values entered"});
    EXPECT_EQ(LastTitle(), "Swing");
    w.value()->setText("5");
    Click(w, "cmdOK");
    EXPECT_EQ(Ini("Charts", "SwingMethod"), "XDay");
    EXPECT_EQ(Ini("Charts", "SwingValue"), "5");
}

TEST_F(SampleRoot, ScalesWriteTheNameRecordAndChart2NamesTheLowerChart) {
    gui::Scales w(session, hub, "krm");
    EXPECT_EQ(w.code()->text(), "KRM");
    w.base()->setText("2.5");
    w.top()->setText("1");
    Click(w, "cmdOK");
    EXPECT_EQ(LastTitle(), "Change Scales");
    w.top()->setText("4.75");
    w.pfIncrement()->setText("0.05");
    Click(w, "cmdOK");
    kori::platform::Status why;
    const auto found = kori::store::FindCode(session.folders.DataFolder, "KRM", why);
    ASSERT_TRUE(found);
    EXPECT_FLOAT_EQ(found->Record.Base, 2.5f);
    EXPECT_FLOAT_EQ(found->Record.Top, 4.75f);
    EXPECT_FLOAT_EQ(found->Record.PFIncrement, 0.05f);

    gui::Chart2 second(session, hub);
    QSignalSpy chosen(&hub, &gui::SettingsHub::SecondChart);
    second.code()->setText("zzz");
    Click(second, "cmdOK");
    EXPECT_EQ(LastTitle(), "Second Chart");
    second.code()->setText("alx");
    second.period()->setCurrentIndex(1);
    Click(second, "cmdOK");
    ASSERT_EQ(chosen.count(), 1);
    EXPECT_EQ(chosen[0][0].toString(), "ALX");
    EXPECT_EQ(chosen[0][1].value<QChar>(), QChar('W'));
}

TEST_F(SampleRoot, OscillatorSettingsFillDefaultsValidateAndStore) {
    // Periods never set read 0; the window offers the defaults for them.
    for (const char* key : {"Md1W", "Md2W", "Md3W", "Md3"})
        (void)session.ini().Write("OscDef", key, "0");
    gui::OscFrm w(session, hub, "MACD", 'B', "W");
    EXPECT_EQ(w.windowTitle(), "MACD");
    ASSERT_EQ(w.fieldCount(), 3);
    EXPECT_EQ(w.field(0)->objectName(), "Md1W");
    EXPECT_EQ(w.field(1)->text(), "26");
    EXPECT_EQ(Ini("OscDef", "Md1W"), "0"); // defaults are held only on OK
    w.field(2)->setText("201");
    Click(w, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{" Periods must be between 1 - 200 "});
    EXPECT_EQ(LastTitle(), "Oscillator Values");

    QSignalSpy show(&hub, &gui::SettingsHub::ShowOscillator);
    w.field(2)->setText("7");
    Click(w, "cmdOK");
    EXPECT_EQ(Ini("OscDef", "Md1W"), "12");
    EXPECT_EQ(Ini("OscDef", "Md3W"), "7");
    EXPECT_EQ(Ini("OscDef", "Md3"), "0"); // the daily column is not this dialog's
    ASSERT_EQ(show.count(), 1);
    EXPECT_EQ(show[0][0].toString(), "MACD");
}

TEST_F(SampleRoot, CompareOscillatorsNeedTheirFile) {
    gui::OscFrm w(session, hub, "RMX", 'B', "A");
    ASSERT_NE(w.compareBox(), nullptr);
    EXPECT_EQ(w.field(0)->text(), "100");
    w.compareBox()->setText("");
    Click(w, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Compare file code must be entered"});
    EXPECT_EQ(LastTitle(), "RMX");
    dialogs.clear();
    w.compareBox()->setText(QString::fromStdString(session.folders.DataFolder + "NOPE.WDT"));
    Click(w, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{
                              "NOPE is not available. Use your code for the All Ordinaries Index"});
    const auto xao = platform::ResolveIn(session.folders.DataFolder, "XAO.WDT").string();
    w.compareBox()->setText(QString::fromStdString(xao));
    Click(w, "cmdOK");
    EXPECT_EQ(Ini("OscDef", "CompFile"), xao);
}

TEST_F(SampleRoot, PointAndFigureBoxValueForm) {
    (void)session.ini().Write("OscDef", "RsiP", "9");
    gui::OscFrm w(session, hub, "RSI", 'P', "A");
    EXPECT_EQ(w.windowTitle(), "Point and Figure");
    EXPECT_EQ(w.fieldCount(), 0);
    ASSERT_NE(w.boxValue(), nullptr);
    EXPECT_EQ(w.boxValue()->maxLength(), 5);
    Click(w, "cmdOK");
    EXPECT_EQ(Messages(), std::vector<std::string>{"Box value must have a value. eg 0.20"});
    EXPECT_EQ(LastTitle(), "Box Value");
    w.boxValue()->setText("0.2x");
    Click(w, "cmdOK");
    EXPECT_EQ(Messages().back(), "Box value must be numeric eg 0.20");
    w.boxValue()->setText("0.25");
    Click(w, "cmdOK");
    ASSERT_TRUE(w.boxAnswer());
    EXPECT_FALSE(w.boxAnswer()->Auto);
    EXPECT_FLOAT_EQ(w.boxAnswer()->Value, 0.25f);
    EXPECT_EQ(Ini("OscDef", "RsiP"), "9"); // the box form writes no oscillator settings

    gui::OscFrm autoForm(session, hub, "", 'P', "A");
    Click(autoForm, "cmdAuto");
    ASSERT_TRUE(autoForm.boxAnswer());
    EXPECT_TRUE(autoForm.boxAnswer()->Auto);
}

TEST_F(SampleRoot, MultiOscillatorSetsAreJoinedIntoTheSettingsStore) {
    // The sample comes with two sets; this starts from empty ones.
    osc::SaveMultiOscSet(settings, 1, osc::MultiOscSet{});
    osc::SaveMultiOscSet(settings, 2, osc::MultiOscSet{});
    gui::MultiOsc w(session, hub);
    EXPECT_EQ(w.choices()->count(), 18);
    EXPECT_EQ(w.set(0)->item(0)->text(), "None");
    w.Fill(3); // no slot chosen yet: nothing happens
    EXPECT_EQ(w.set(0)->item(0)->text(), "None");
    auto* slot = w.set(1)->item(2);
    const QRect r = w.set(1)->visualItemRect(slot);
    QTest::mouseClick(w.set(1)->viewport(), Qt::LeftButton, {}, r.center());
    const auto rows = w.choices()->findItems("Williams %R", Qt::MatchExactly);
    ASSERT_EQ(rows.size(), 1);
    w.Fill(w.choices()->row(rows[0]));
    Click(w, "cmdSave");
    EXPECT_EQ(settings.Get("Multi-Osc 2", ""), "None,None,Williams %R,None,None");
    EXPECT_EQ(settings.Get("Multi-Osc 1", ""), "None,None,None,None,None");
}

TEST_F(SampleRoot, WindowPositionsAreKeptInTheSettingsStore) {
    {
        gui::ChtFonts w(session, hub);
        w.show();
        w.setGeometry(120, 90, 700, 400);
        w.close();
    }
    EXPECT_EQ(settings.Get("ChtFonts", ""), "1800,1350,10500,6000");
    gui::ChtFonts again(session, hub);
    again.show();
    EXPECT_EQ(again.geometry(), QRect(120, 90, 700, 400));
    again.close();

    // A place far off every screen is not used.
    settings.Save("MultiOsc", "900000,900000,7500,6000");
    gui::MultiOsc lost(session, hub);
    lost.show();
    EXPECT_LT(lost.x(), 5000);
    lost.close();
}

TEST_F(SampleRoot, AverageTrueRangeSettingsBelongToTheChartDefaults) {
    gui::OscFrm w(session, hub, "ATR", 'B', "A");
    EXPECT_EQ(w.fieldCount(), 0);
    (void)session.ini().Write("OscDef", "AtrD", "20");
    gui::OscFrm set(session, hub, "ATR", 'B', "A");
    EXPECT_TRUE(set.Ok());
    EXPECT_EQ(Ini("OscDef", "AtrD"), "20");
}

TEST_F(SampleRoot, MenuItemsOpenTheSettingsWindows) {
    gui::MainWindow main(session);
    gui::RegisterWindows(main);
    for (const char* item : {"mnuChartDefaults", "mnuPaths", "mnFnts", "mnuPntCol"})
        EXPECT_NE(main.findChild<QAction*>(item), nullptr) << item;
    ASSERT_TRUE(main.Trigger("mnuChartDefaults"));
    auto* def = main.findChild<gui::ChtDef*>("ChtDef");
    ASSERT_NE(def, nullptr);
    EXPECT_TRUE(def->isVisible());
    def->close();

    // Folder locations: the path details, or the data folders for DataService 3.
    ASSERT_TRUE(main.Trigger("mnuPaths"));
    EXPECT_NE(main.findChild<gui::CPath*>("CPath"), nullptr);
    session.download.DataService = 3;
    ASSERT_TRUE(main.Trigger("mnuPaths"));
    EXPECT_NE(main.findChild<gui::DataPaths*>("DataPaths"), nullptr);

    // The printer questions again: a colour printer that prints white as it is.
    dialogs.clear();
    dialogs.QueueAnswer(Answer::Yes);
    dialogs.QueueAnswer(Answer::No);
    ASSERT_TRUE(main.Trigger("mnuPntCol"));
    EXPECT_EQ(Messages(), (std::vector<std::string>{" Do you have a Colour Printer ?",
                                                    "Print the colour WHITE as BLACK ?"}));
    const auto printer = app::ReadPrinterFile(session.folders.SystemFolder + "koriprn.dat");
    ASSERT_TRUE(printer);
    EXPECT_EQ(printer->PrintColour, 1);
    EXPECT_EQ(printer->PrintColourLines, 0);

    // A saved folder renames the main window.
    const std::string other = root.folder() + "other/";
    app::PathDetails p = app::CurrentPathDetails(session);
    p.DataFolder = other;
    ASSERT_TRUE(app::SavePathDetails(session, p));
    gui::Hub(main).DataFolderChanged();
    EXPECT_EQ(main.windowTitle().toStdString(),
              "Kori Charting 8   -   Current Data Folder " + other);
}

TEST(Logo, StandsCentredAcrossAndAboveTheMiddleOfTheScreen) {
    gui::Logo logo;
    const QRect screen = QGuiApplication::primaryScreen()->geometry();
    EXPECT_EQ(logo.x() - screen.x(), (screen.width() - logo.width()) / 2);
    // (0.97 x screen height) / 2 - height / 2, to the nearest unit.
    EXPECT_NEAR(logo.y() - screen.y(), 0.97 * screen.height() / 2 - logo.height() / 2.0, 0.5);
    EXPECT_LT(logo.y() + logo.height() / 2, screen.y() + screen.height() / 2);
}

// Pictures of the windows for a person to look at: written when KORI_SCREENSHOTS names a folder.
TEST_F(SampleRoot, Screenshots) {
    const char* dir = std::getenv("KORI_SCREENSHOTS");
    if (dir == nullptr) GTEST_SKIP() << "set KORI_SCREENSHOTS to a folder to get the pictures";
    QDir().mkpath(dir);
    auto shoot = [&](QWidget& w, const char* name) {
        w.show();
        QApplication::processEvents();
        EXPECT_TRUE(w.grab().save(QString::fromLatin1(dir) + "/" + name + ".png")) << name;
        w.hide();
    };
    gui::Logo logo;
    shoot(logo, "Logo");
    gui::CPath cpath(session, hub);
    shoot(cpath, "CPath");
    gui::DataPaths data(session, hub, gui::DataPaths::Mode::Setting);
    shoot(data, "DataPaths");
    gui::Locate locate(session, hub, session.folders.DataFolder);
    shoot(locate, "Locate");
    gui::ColNew colours(session, hub);
    shoot(colours, "ColNew");
    gui::ChtFonts fonts(session, hub);
    shoot(fonts, "ChtFonts");
    gui::ChtDef def(session, hub, gui::ChtDef::Caller::Menu);
    shoot(def, "ChtDef");
    gui::OscFrm macd(session, hub, "MACD", 'B', "A");
    shoot(macd, "OscFrm");
    gui::OscFrm rmx(session, hub, "RMX", 'B', "A");
    shoot(rmx, "OscFrm_RMX");
    gui::OscFrm box(session, hub, "", 'P', "A");
    shoot(box, "OscFrm_PointAndFigure");
    gui::MultiOsc multi(session, hub);
    shoot(multi, "MultiOsc");
    gui::MMASet mma(session, hub);
    shoot(mma, "MMASet");
    gui::SwingSet swing(session, hub);
    shoot(swing, "SwingSet");
    gui::StpLs stop(session, hub);
    shoot(stop, "StpLs");
    gui::VHeight vh(session, hub);
    shoot(vh, "VHeight");
    gui::Scales scales(session, hub, "KRM");
    shoot(scales, "Scales");
    gui::PLW plw(session, hub);
    shoot(plw, "PLW");

    // Under a real display (Xvfb), the whole screen: the main window with the chart defaults
    // over it, as a person sees them.
    if (QGuiApplication::platformName() == "xcb") {
        gui::MainWindow main(session);
        gui::RegisterWindows(main);
        main.setGeometry(20, 40, 1000, 640);
        main.show();
        ASSERT_TRUE(main.Trigger("mnuChartDefaults"));
        for (int i = 0; i < 20; ++i) {
            QApplication::processEvents();
            QTest::qWait(20);
        }
        const QPixmap screen = QGuiApplication::primaryScreen()->grabWindow(0);
        EXPECT_TRUE(screen.save(QString::fromLatin1(dir) + "/Main_ChtDef.png"));
    }
}
