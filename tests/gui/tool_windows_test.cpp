// The data check from its menu item: the choices, the refusals, the report and its ways out.
#include "desktop_fixture.h"

#include "gui/widgets/grid_view.h"
#include "gui/windows/chart_bak.h"
#include "gui/windows/chk_dta.h"
#include "gui/windows/dl_list.h"
#include "gui/windows/name_data.h"
#include "gui/windows/snapshot.h"
#include "gui/windows/text_data.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>

#include <sys/stat.h>

namespace kori::test {
namespace {

struct DataCheckWindows : DesktopTest {
    gui::ChkDta* Open() {
        EXPECT_TRUE(main.Trigger("mnuDataCk"));
        QApplication::processEvents();
        return main.findChild<gui::ChkDta*>();
    }
    void BreakRecord(const char* code, int n) {
        store::PriceFile f(store::PriceFile::PathFor(s.session.folders.DataFolder, code));
        ASSERT_TRUE(f.Open());
        store::PriceRecord r;
        ASSERT_TRUE(f.Read(n, r));
        r.High = r.Low - 1;
        ASSERT_TRUE(f.Write(n, r));
    }
};

TEST_F(DataCheckWindows, ReportsAPlantedFaultAndOpensItsChartAtTheDate) {
    BreakRecord("KRM", 100);
    auto* chk = Open();
    ASSERT_NE(chk, nullptr);
    EXPECT_EQ(chk->listBox()->itemText(0).toStdString(), "Full List (Names.Dat)");
    EXPECT_EQ(chk->gapEdit()->text().toStdString(), "10");
    auto* report = chk->Check();
    ASSERT_NE(report, nullptr);
    const auto& rows = report->grid()->model().rows();
    int krmRow = -1;
    for (int i = 0; i < static_cast<int>(rows.size()); ++i)
        if (rows[static_cast<std::size_t>(i)][0] == "KRM") krmRow = i;
    ASSERT_GE(krmRow, 0);
    EXPECT_EQ(rows[static_cast<std::size_t>(krmRow)][3], "100");
    EXPECT_EQ(rows[static_cast<std::size_t>(krmRow)][4], "High below low");

    report->grid()->setCurrentCell(krmRow, 0);
    report->ShowChart();
    QApplication::processEvents();
    ASSERT_NE(chts(), nullptr);
    const auto& request = charts()->state().Request;
    EXPECT_TRUE(request.ByFinishDate);
    EXPECT_EQ(request.FinishDate, report->findings()[static_cast<std::size_t>(krmRow)].Date);

    const auto csv = s.root.path() / "report.csv";
    ASSERT_TRUE(report->ExportCsv(csv.string()));
    const auto text = platform::ReadWholeFile(csv);
    ASSERT_TRUE(text);
    EXPECT_NE(text->find("KRM,"), std::string::npos);
}

TEST_F(DataCheckWindows, RefusesLimitsThatAreNotNumbersAndKeepsGoodOnes) {
    auto* chk = Open();
    ASSERT_NE(chk, nullptr);
    chk->gapEdit()->setText("ten");
    EXPECT_EQ(chk->Check(), nullptr);
    ASSERT_EQ(s.dialogs.messages().size(), 1u);
    EXPECT_EQ(s.dialogs.messages()[0], "The gap must be a whole number of weekdays from 1 to 9999");
    chk->gapEdit()->setText("4");
    chk->moveEdit()->setText("50");
    ASSERT_NE(chk->Check(), nullptr);
    const auto kept = maint::LoadDataCheckSettings(s.settings);
    EXPECT_EQ(kept.GapWeekdays, 4);
    EXPECT_DOUBLE_EQ(kept.MoveAlertPercent, 50);
}

TEST_F(DesktopTest, ClosingPricesOfADayFromTheMenu) {
    ASSERT_TRUE(main.Trigger("mnuTextFile"));
    QApplication::processEvents();
    auto* w = main.findChild<gui::TextData*>();
    ASSERT_NE(w, nullptr);
    const auto file = s.root.path() / "closes.csv";
    w->fileEdit()->setText(QString::fromStdString(file.string()));
    w->dateEdit()->setText(QStringLiteral("31/2/26"));
    EXPECT_FALSE(w->Create().Ok);
    ASSERT_EQ(s.dialogs.messages().size(), 1u);
    EXPECT_EQ(s.dialogs.messages()[0], "Date must be entered as d/m/yy eg. 9/4/95 or 29/9/95");
    w->dateEdit()->setText(QStringLiteral("20/11/26"));
    const auto r = w->Create();
    ASSERT_TRUE(r.Ok) << r.Message;
    EXPECT_EQ(w->status()->text().toStdString(), r.Message);
    const auto text = platform::ReadWholeFile(file);
    ASSERT_TRUE(text);
    EXPECT_NE(text->find("\nKRM,Karoo Minerals,2026-11-20,1.41,"), std::string::npos) << *text;
}

TEST_F(DesktopTest, DataOfAListAsDayFilesFromTheMenu) {
    ASSERT_TRUE(main.Trigger("mnuTFD"));
    QApplication::processEvents();
    auto* w = main.findChild<gui::TextFull*>();
    ASSERT_NE(w, nullptr);
    w->aList()->setChecked(true);
    w->fromEdit()->setText(QStringLiteral("19/11/26"));
    w->toEdit()->setText(QStringLiteral("18/11/26"));
    w->dayFiles()->setChecked(true);
    const auto folder = s.root.path() / "days";
    w->outputEdit()->setText(QString::fromStdString(folder.string()));
    EXPECT_FALSE(w->Create().Ok); // the range runs backwards
    EXPECT_EQ(s.dialogs.messages().back(), "The first day comes after the last");
    w->toEdit()->clear();
    const auto r = w->Create();
    ASSERT_TRUE(r.Ok) << r.Message;
    EXPECT_EQ(test::FilesIn(folder), (std::vector<std::string>{"19NOV26.D", "20NOV26.D"}));
    const auto day = platform::ReadWholeFile(folder / "20NOV26.D");
    ASSERT_TRUE(day);
    EXPECT_NE(day->find("KRM,20261120,1.43,1.435,1.395,1.41,5755360,0\n"), std::string::npos);
}

TEST_F(DesktopTest, DownloadedDataUpdateFromTheMenuTakesInEveryWaitingDay) {
    s.session.download.DataService = 4;
    s.session.download.InternetDLfmt = "DDMMMYY.D";
    std::vector<std::string> waiting;
    ASSERT_TRUE(platform::CreateFolderPath(s.session.folders.DownloadFolder));
    const auto made = app::MakeSampleDayFiles(s.session.folders.DataFolder,
                                              s.session.folders.DownloadFolder, waiting);
    ASSERT_TRUE(made) << made.message();
    main.RebuildMenus(); // the Download menu follows the data service
    ASSERT_TRUE(main.Trigger("mnuModem"));
    QApplication::processEvents();
    auto* w = main.findChild<gui::DLList*>();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle().toStdString(), "Update with Downloaded Data ");
    std::vector<std::string> shown;
    for (int i = 0; i < w->list()->count(); ++i)
        shown.push_back(w->list()->item(i)->text().toStdString());
    EXPECT_EQ(shown,
              (std::vector<std::string>{"14NOV26.D", "20NOV26.D", "23NOV26.D", "24NOV26.D"}));

    // Every question answered OK: the insert, the replace, the new day; the bad file stays.
    const auto krmBefore = s.Name("KRM");
    w->UpdateAll();
    EXPECT_EQ(w->list()->count(), 1);
    EXPECT_EQ(w->list()->item(0)->text().toStdString(), "24NOV26.D");
    EXPECT_NE(w->status()->text().toStdString().find("4 files: "), std::string::npos)
        << w->status()->text().toStdString();
    store::PriceFile krm(store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM"));
    ASSERT_TRUE(krm.Open());
    store::PriceRecord last;
    ASSERT_TRUE(krm.Read(krm.Count(), last));
    EXPECT_EQ(last.Date, "20261123");
    bool alerts = false;
    for (const auto& m : s.dialogs.shown())
        alerts = alerts || m.title == "Quoren Alerts";
    EXPECT_TRUE(alerts);

    // "Remove Date" asks first; No keeps the file.
    s.dialogs.QueueAnswer(platform::Answer::No);
    w->list()->setCurrentRow(0);
    w->RemoveDate();
    EXPECT_EQ(w->list()->count(), 1);
    EXPECT_EQ(s.dialogs.shown().back().text, "Remove 24NOV26.D");
    EXPECT_EQ(s.dialogs.shown().back().title, "Remove Date");
    w->RemoveDate();
    EXPECT_EQ(w->list()->count(), 0);
    EXPECT_FALSE(platform::FileExists(s.session.folders.DownloadFolder + "24NOV26.D"));
}

TEST_F(DesktopTest, NameFileCheckAsksFirstThenMendsTheNameFile) {
    const std::string folder = s.session.folders.DataFolder;
    // A price file nobody named, and the price file of a named security gone.
    std::filesystem::copy_file(folder + "KRM.WDT", folder + "ORPHAN.WDT");
    std::filesystem::remove(store::PriceFile::PathFor(folder, "QRY"));

    s.dialogs.QueueAnswer(platform::Answer::No);
    ASSERT_TRUE(main.Trigger("mnuChkNameData"));
    QApplication::processEvents();
    EXPECT_EQ(s.dialogs.shown().back().title, "Check Name File - Data Files");
    EXPECT_EQ(main.findChild<gui::NameData*>(), nullptr); // "No" opens nothing

    s.dialogs.QueueAnswer(platform::Answer::Yes);
    ASSERT_TRUE(main.Trigger("mnuChkNameData"));
    QApplication::processEvents();
    auto* window = main.findChild<gui::NameData*>();
    ASSERT_NE(window, nullptr);
    const auto& rows = window->grid()->model().rows();
    ASSERT_EQ(rows.size(), 2u);
    EXPECT_EQ(rows[0][0], "QRY");
    EXPECT_EQ(rows[0][2], "No price file");
    EXPECT_EQ(rows[1][0], "ORPHAN");
    EXPECT_EQ(rows[1][2], "No name record");

    s.dialogs.QueueAnswer(platform::Answer::Yes);
    window->AddMissing();
    EXPECT_EQ(s.dialogs.shown()[s.dialogs.shown().size() - 2].text,
              "Add 1 name record (record type 4, name blank) for the price files without one ?");
    s.dialogs.QueueAnswer(platform::Answer::Yes);
    window->RemoveWithoutData();
    EXPECT_TRUE(window->grid()->model().rows().empty());
    EXPECT_FALSE(window->findChild<QPushButton*>(QStringLiteral("cmdAdd"))->isEnabled());
    platform::Status status;
    EXPECT_TRUE(store::FindCode(folder, "ORPHAN", status).has_value());
    EXPECT_FALSE(store::FindCode(folder, "QRY", status).has_value());
}

TEST_F(DesktopTest, BackupThenRestoreFromTheirMenuItems) {
    ASSERT_TRUE(main.Trigger("mnuBackupData"));
    QApplication::processEvents();
    auto* backup = main.findChild<gui::ChartBak*>(QStringLiteral("ChartBak"));
    ASSERT_NE(backup, nullptr);
    EXPECT_EQ(backup->windowTitle().toStdString(), "Backup Chart Data");
    backup->Backup();
    EXPECT_NE(backup->status()->text().toStdString().find("backed up to"), std::string::npos)
        << backup->status()->text().toStdString();

    const std::string krm = s.session.folders.DataFolder + "KRM.WDT";
    const auto original = platform::ReadWholeFile(krm);
    ASSERT_TRUE(platform::WriteFileAtomic(krm, "damaged").ok());

    ASSERT_TRUE(main.Trigger("mnuRestoreData"));
    QApplication::processEvents();
    auto* restore = main.findChild<gui::ChartBak*>(QStringLiteral("ChartBak Restore"));
    ASSERT_NE(restore, nullptr);
    ASSERT_EQ(restore->list()->count(), 1);
    restore->Verify();
    EXPECT_NE(restore->status()->text().toStdString().find("is whole"), std::string::npos);
    s.dialogs.QueueAnswer(platform::Answer::Yes);
    restore->Restore();
    EXPECT_EQ(platform::ReadWholeFile(krm), original);
    ASSERT_FALSE(restore->form().Replaced().empty());
    s.dialogs.QueueAnswer(platform::Answer::Yes);
    restore->Discard();
    EXPECT_TRUE(restore->form().Replaced().empty());
}

TEST_F(DesktopTest, SnapshotSortsByAColumnAndOpensTheChartOfARow) {
    ASSERT_TRUE(main.Trigger("mnuSnapshot"));
    QApplication::processEvents();
    auto* snap = main.findChild<gui::Snapshot*>();
    ASSERT_NE(snap, nullptr);
    snap->Take();
    const auto& result = snap->form().result();
    ASSERT_GT(result.Rows.size(), 10u);
    const auto& b = result.Market;
    EXPECT_EQ(snap->breadth()->text().toStdString(),
              "Advances " + std::to_string(b.Advances) + "   Declines " +
                  std::to_string(b.Declines) + "   Unchanged " + std::to_string(b.Unchanged) +
                  "   New highs " + std::to_string(b.NewHighs) + "   New lows " +
                  std::to_string(b.NewLows));
    EXPECT_EQ(static_cast<std::size_t>(snap->grid()->rowCount()), result.Rows.size());

    // Change % (column 5) twice: largest first, rows without a figure still last.
    snap->SortBy(5);
    snap->SortBy(5);
    std::vector<double> shown;
    for (const auto& r : snap->form().result().Rows)
        if (r.ChangePercent) shown.push_back(*r.ChangePercent);
    EXPECT_TRUE(std::is_sorted(shown.rbegin(), shown.rend()));
    const std::string top = snap->form().result().Rows[0].Code;
    EXPECT_EQ(snap->grid()->item(0, 0)->text().toStdString(), top);

    snap->grid()->setCurrentCell(0, 0);
    snap->ShowChart();
    QApplication::processEvents();
    ASSERT_NE(chts(), nullptr);
    EXPECT_EQ(chts()->model().Code(), top);

    const auto csv = (s.root.path() / "snap.csv").string();
    ASSERT_TRUE(snap->ExportCsv(csv));
    const auto text = platform::ReadWholeFile(csv);
    ASSERT_TRUE(text);
    EXPECT_EQ(text->substr(text->find('\n') + 1, top.size() + 1), top + ",");
}

// The companion download program: left out until it is installed, then started with "AD"; when
// it ends, the waiting day files are offered.
TEST_F(DesktopTest, KoriDownloadStartsTheCompanionProgramAndOffersWhatItLeft) {
    s.session.download.DataService = 1;
    main.RebuildMenus();
    EXPECT_FALSE(main.Trigger("mnuZEVOT")) << "not installed";

    const std::string marker = s.root.folder() + "ran-with";
    const std::string program = s.session.folders.SystemFolder + "KoriDL8.exe";
    const std::string download = s.session.folders.DownloadFolder;
    std::filesystem::create_directories(download);
    ASSERT_TRUE(platform::WriteFileAtomic(program, "#!/bin/sh\necho \"$1\" > '" + marker +
                                                       "'\n: > '" + download + "25NOV26.D'\n"));
    ::chmod(program.c_str(), 0755);
    gui::RegisterWindows(main);
    main.RebuildMenus();
    s.dialogs.QueueAnswer(platform::Answer::Cancel);
    const auto shownBefore = s.dialogs.shown().size();
    ASSERT_TRUE(main.Trigger("mnuZEVOT"));
    EXPECT_TRUE(QTest::qWaitFor([&] { return s.dialogs.shown().size() > shownBefore; }, 10000));
    EXPECT_EQ(platform::ReadWholeFile(marker).value_or(""), "AD\n");
    ASSERT_GT(s.dialogs.shown().size(), shownBefore);
    EXPECT_EQ(s.dialogs.shown().back().title, "Downloaded Data");
}

} // namespace
} // namespace kori::test
