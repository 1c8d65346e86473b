// The download settings windows from the Download menu: the service details, the segment
// folders and the update list, each opened and driven as a user would.
#include "desktop_fixture.h"

#include "app/sample_library.h"
#include "gui/widgets/grid_view.h"
#include "gui/windows/cht_sel.h"
#include "gui/windows/dl_list.h"
#include "gui/windows/download_settings.h"
#include "gui/windows/fundmnt.h"
#include "maint/security_details.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPrinter>
#include <QPushButton>
#include <QSpinBox>
#include <QTableWidget>
#include <QTest>

namespace kori::test {
namespace {

struct DownloadSettingsWindows : DesktopTest {
    gui::ModDetails* OpenDetails() {
        EXPECT_TRUE(main.Trigger("mnuDDetails"));
        QApplication::processEvents();
        return main.findChild<gui::ModDetails*>();
    }
    QPushButton* ButtonOf(QWidget* w, const char* name) {
        return w->findChild<QPushButton*>(QString::fromLatin1(name));
    }
};

TEST_F(DownloadSettingsWindows, SettingsMenuOpensTheServiceDetailsWhichSave) {
    auto* w = OpenDetails();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle().toStdString(), "Data Download Service Details");
    EXPECT_EQ(w->format()->count(), 7);
    EXPECT_EQ(w->format()->itemText(0).toStdString(), "ddMMMyy.d        (eg 15SEP98.d)");

    w->service()->setCurrentIndex(1);
    emit w->service()->activated(1);
    EXPECT_TRUE(w->format()->isVisibleTo(w));
    w->folder()->setText(QString::fromStdString(s.root.folder() + "net"));
    ButtonOf(w, "Command3")->click();
    EXPECT_EQ(s.dialogs.messages().back(), "Path must end with a backslash \\ ");
    EXPECT_TRUE(w->isVisible()) << "a refusal leaves the window open";

    w->folder()->setText(QString::fromStdString(s.root.folder() + "net/"));
    w->format()->setCurrentIndex(6);
    emit w->format()->activated(6);
    ButtonOf(w, "Command3")->click();
    QApplication::processEvents();
    EXPECT_EQ(s.session.ini().Read("Download", "InternetDLfmt"), "YYYYMMDD.D");
    EXPECT_EQ(s.session.folders.DownloadFolder, s.root.folder() + "net/");
}

TEST_F(DownloadSettingsWindows, DetailsOpenTheSegmentFoldersAndTheUpdateList) {
    auto* w = OpenDetails();
    ASSERT_NE(w, nullptr);
    w->service()->setCurrentIndex(0);
    emit w->service()->activated(0);
    EXPECT_FALSE(w->format()->isVisibleTo(w)) << "the form belongs to the internet files";
    ButtonOf(w, "cmdSegments")->click();
    QApplication::processEvents();
    auto* wizard = w->findChild<gui::DLWizard*>();
    ASSERT_NE(wizard, nullptr);
    EXPECT_EQ(wizard->windowTitle().toStdString(), "Download Data Settings");
    EXPECT_EQ(wizard->received(4)->text().toStdString(), "Put / Call Options");
    wizard->received(1)->setChecked(true);
    wizard->folder(1)->setText(QString::fromStdString(s.session.folders.DataFolder));
    emit wizard->folder(1)->textEdited(wizard->folder(1)->text());
    ButtonOf(wizard, "Command1")->click();
    QApplication::processEvents();
    const auto paths = platform::ReadWholeFile(s.root.path() / "ChtPaths.lst");
    ASSERT_TRUE(paths);
    EXPECT_NE(paths->find(s.session.folders.DataFolder), std::string::npos);

    w->service()->setCurrentIndex(1);
    emit w->service()->activated(1);
    ButtonOf(w, "Command1")->click();
    QApplication::processEvents();
    auto* list = w->findChild<gui::INUpList*>();
    ASSERT_NE(list, nullptr);
    EXPECT_EQ(list->windowTitle().toStdString(), "Download Update List");
    EXPECT_EQ(list->master()->item(0)->text().toStdString(), "KORI Master list is missing");

    // Only the listed stocks, with one typed in, then saved from the menu.
    s.dialogs.clear();
    list->options()->button(2)->click();
    EXPECT_EQ(s.dialogs.shown().at(0).title, "Update List");
    s.dialogs.QueueInput("1");
    list->findChild<QAction*>(QStringLiteral("ulAdd"))->trigger();
    ASSERT_EQ(list->grid()->rowCount(), 1);
    list->grid()->model().SetCell(0, 0, "krm");
    list->findChild<QAction*>(QStringLiteral("ulSave"))->trigger();
    EXPECT_EQ(platform::ReadWholeFile(s.root.path() / "Update.Lst").value_or(""), "KRM,0,\r\n");
    EXPECT_FALSE(s.session.download.UpdateAll);
}

TEST_F(DownloadSettingsWindows, UpdateMenuWithNoDownloadFolderOffersTheSettings) {
    s.session.folders.DownloadFolder = s.root.folder() + "nowhere/";
    s.dialogs.QueueAnswer(platform::Answer::Yes);
    ASSERT_TRUE(main.Trigger("mnuModem"));
    QApplication::processEvents();
    EXPECT_EQ(s.dialogs.shown().back().title, "Downloaded Data");
    EXPECT_EQ(main.findChild<gui::DLList*>(), nullptr);
    EXPECT_NE(main.findChild<gui::ModDetails*>(), nullptr);
}

// The chart window shows the security's figures from the details files of the download
// program's services, and nothing without them.
TEST_F(DesktopTest, ChartShowsTheSecurityDetailsTextBox) {
    const std::string in = s.root.folder() + "In/";
    ASSERT_TRUE(app::MakeSampleSecurityDetails(s.session.folders.DataFolder, in));
    ASSERT_TRUE(maint::RefreshSecurityDetails(s.session.folders.SystemFolder, in).Status);
    const auto open = [this](const char* code) {
        ASSERT_TRUE(main.Trigger("mnuChartDisplay"));
        auto* field = charts()->chtSel()->findChild<QLineEdit*>(QStringLiteral("txtCode"));
        ASSERT_NE(field, nullptr);
        field->setText(QString::fromLatin1(code));
        QTest::keyClick(field, Qt::Key_Return);
        QApplication::processEvents();
    };
    s.session.download.DataService = 3;
    open("krm");
    ASSERT_NE(chts(), nullptr);
    auto* box = chts()->findChild<QLabel*>(QStringLiteral("txtDetails"));
    ASSERT_NE(box, nullptr);
    // Last close 1.41: 1.41 / 0.08 = 17.6 and 0.05 / 1.41 = 3.5%.
    EXPECT_EQ(box->text().toStdString(), "Issued  47,000,000   PE Ratio  17.6   Yield  3.5%");
    EXPECT_TRUE(box->isVisibleTo(chts()));

    s.session.download.DataService = 4; // not a service that delivers the details
    open("krm");
    EXPECT_FALSE(box->isVisibleTo(chts()));
}

// The company details menu item is on only with the details files; its window shows them with
// the figures, and its display size window sets the table's size.
TEST_F(DesktopTest, CompanyDetailsOpenFromTheMenuWhenTheDetailsExist) {
    s.session.download.DataService = 3;
    main.RebuildMenus();
    EXPECT_FALSE(main.Trigger("mnuFundamtl")) << "no details files yet";
    const std::string in = s.root.folder() + "In/";
    ASSERT_TRUE(app::MakeSampleSecurityDetails(s.session.folders.DataFolder, in));
    ASSERT_TRUE(maint::RefreshSecurityDetails(s.session.folders.SystemFolder, in).Status);
    main.RebuildMenus();
    ASSERT_TRUE(main.Trigger("mnuFundamtl"));
    QApplication::processEvents();
    auto* w = main.findChild<gui::Fundmnt*>();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle().toStdString(), "Fundamentals");
    auto* t = w->table();
    EXPECT_EQ(t->horizontalHeaderItem(1)->text().toStdString(), "Description");
    const int price = w->form().priceColumn();
    int krm = -1;
    for (int r = 0; r < t->rowCount(); ++r)
        if (t->item(r, 0)->text() == QStringLiteral("KRM")) krm = r;
    ASSERT_GE(krm, 0);
    EXPECT_TRUE(t->item(krm, price)->text().isEmpty());
    w->findChild<QAction*>(QStringLiteral("mnYCP"))->trigger();
    EXPECT_EQ(w->table()->item(krm, price)->text().toStdString(), "1.41");
    // Earnings 0.08 and dividend 0.05 in the 14th and 15th columns: 1.41 / 0.08 = 17.6 and
    // 0.05 / 1.41 x 100 = 3.5.
    EXPECT_EQ(w->table()->item(krm, price + 1)->text().toStdString(), "017.6");
    EXPECT_EQ(w->table()->item(krm, price + 2)->text().toStdString(), "003.5");

    w->findChild<QAction*>(QStringLiteral("mnSize"))->trigger();
    QApplication::processEvents();
    auto* size = w->findChild<gui::F1Size*>();
    ASSERT_NE(size, nullptr);
    size->size()->setValue(12);
    size->findChild<QDialogButtonBox*>()->button(QDialogButtonBox::Ok)->click();
    EXPECT_EQ(w->table()->font().pointSize(), 12);

    // The class column, the scan list from the highlighted row, and a heading click that
    // sends a column to the name file's other details.
    w->findChild<QAction*>(QStringLiteral("mnInGrp"))->trigger();
    const int classes = w->table()->columnCount() - 1;
    EXPECT_EQ(w->table()->horizontalHeaderItem(classes)->text().toStdString(), "Ind Class");
    t = w->table();
    t->selectRow(krm);
    w->findChild<QAction*>(QStringLiteral("mnScanList"))->trigger();
    std::vector<std::string> listed;
    ASSERT_TRUE(store::ShowList(s.session.folders.DataFolder, 'Z', listed).ok());
    ASSERT_FALSE(listed.empty());
    EXPECT_EQ(listed.back(), "KRM");
    w->findChild<QAction*>(QStringLiteral("mnUpName"))->trigger();
    EXPECT_EQ(s.dialogs.shown().back().title, "Transfer to Name File");
    auto* header = t->horizontalHeader();
    QTest::mouseClick(header->viewport(), Qt::LeftButton, {},
                      QPoint(header->sectionViewportPosition(2) + 5, header->height() / 2));
    EXPECT_NE(s.dialogs.shown().back().text.find(" name records updated"), std::string::npos);
    platform::Status status;
    const auto found = store::FindCode(s.session.folders.DataFolder, "KRM", status);
    ASSERT_TRUE(found.has_value());
    EXPECT_EQ(platform::Trim(found->Record.OtherDetails), "ORD") << "the Type column";

    QPrinter printer;
    printer.setOutputFormat(QPrinter::PdfFormat);
    const std::string pdf = s.root.folder() + "details.pdf";
    printer.setOutputFileName(QString::fromStdString(pdf));
    w->PrintTo(printer);
    EXPECT_GT(std::filesystem::file_size(pdf), 1000u);
}

} // namespace
} // namespace kori::test
