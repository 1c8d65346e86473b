// The editors and repair windows on the sample library, opened from their menu items: what they
// show, what their commands change on disk, and the messages the user sees.
#include "gui/widgets/grid_view.h"
#include "gui/windows/data_form.h"
#include "gui/windows/main_window.h"
#include "gui/windows/name_form.h"
#include "gui/windows/register_windows.h"
#include "gui/windows/repair_progress.h"
#include "gui/windows/repair_windows.h"
#include "platform/files.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/sample_session.h"

#include <QAction>
#include <QApplication>
#include <QButtonGroup>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <gtest/gtest.h>

using namespace kori;

namespace {

struct Maint : ::testing::Test {
    test::SampleSession s;
    gui::MainWindow main{s.session};

    void SetUp() override { gui::RegisterWindows(main); }
    std::string data() { return s.session.folders.DataFolder; }
    template <typename W> W* Opened(const char* item) {
        EXPECT_TRUE(main.Trigger(item)) << item;
        QApplication::processEvents();
        return main.findChild<W*>();
    }
    std::vector<store::PriceRecord> Prices(const char* code) {
        std::vector<store::PriceRecord> r;
        EXPECT_TRUE(store::PriceFile(store::PriceFile::PathFor(data(), code)).ReadAll(r).ok());
        return r;
    }
};

TEST_F(Maint, NameFileOpensFromItsMenuSortsAndSaves) {
    auto* form = Opened<gui::NameForm>("mnuViewNames");
    ASSERT_NE(form, nullptr);
    std::vector<store::NameRecord> names;
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(data())).ReadAll(names).ok());
    EXPECT_EQ(form->grid()->rowCount(), static_cast<int>(names.size()));
    EXPECT_EQ(form->grid()->columnCount(), store::kNameShownColumns);
    EXPECT_TRUE(form->caption()->text().startsWith("NAMES.DAT"));
    form->findChild<QAction*>("mnuSortCode")->trigger();
    const int n = form->grid()->rowCount();
    for (int r = 1; r < n; ++r)
        EXPECT_LE(form->grid()->item(r - 1, store::kNameCode)->text(),
                  form->grid()->item(r, store::kNameCode)->text());
    // A type of 6 typed into the grid is refused with its message.
    form->grid()->item(0, store::kNameType)->setText("6");
    EXPECT_EQ(s.dialogs.messages().back(), "Record Type must be either 1,2,3,4 or 5");
    form->grid()->item(0, store::kNameType)->setText("4");
    ASSERT_TRUE(form->Save());
    EXPECT_TRUE(platform::FileExists(data() + "names.bak"));
    form->close();
}

TEST_F(Maint, DataFormShowsRecordsAndVolModChangesTheHighlightedRows) {
    const auto before = Prices("KRM");
    gui::DataForm form(s.session, store::PriceFile::PathFor(data(), "KRM"), "KRM");
    ASSERT_TRUE(form.loaded());
    EXPECT_EQ(form.grid()->rowCount(), static_cast<int>(before.size()));
    EXPECT_EQ(form.grid()->item(0, store::kDataRec)->text(), "1");
    ASSERT_GT(before[0].Volume, 0);
    form.grid()->setCurrentCell(0, store::kDataVolume);
    gui::VolMod vol(form.model(), 1, 1, &form);
    vol.accept(); // nothing chosen
    EXPECT_EQ(s.dialogs.messages().back(), "No data item to Adjust");
    vol.items()->button(4)->setChecked(true);
    vol.operations()->button(static_cast<int>(maint::VolOp::Multiply))->setChecked(true);
    vol.factor()->setCurrentIndex(0); // 10
    vol.accept();
    form.grid()->Refresh();
    EXPECT_EQ(form.grid()->item(0, store::kDataVolume)->text().toLongLong(),
              static_cast<long long>(before[0].Volume) * 10);
    ASSERT_TRUE(form.model().SaveData());
    EXPECT_EQ(Prices("KRM")[0].Volume, before[0].Volume * 10);
}

TEST_F(Maint, RepairWindowsFromTheirMenus) {
    // Remove Duplicate Dates: a record twice is taken out again.
    auto prices = Prices("KRM");
    const auto clean = prices;
    prices.insert(prices.begin() + 5, prices[5]);
    ASSERT_TRUE(store::PriceFile(store::PriceFile::PathFor(data(), "KRM")).WriteAll(prices).ok());
    auto* dup = Opened<gui::RemDupST>("mnuDupDates");
    ASSERT_NE(dup, nullptr);
    dup->findChild<QPushButton*>("cmdStart")->click();
    EXPECT_TRUE(dup->result().Done);
    EXPECT_EQ(dup->progress()->label()->text(), "COMPLETED ");
    EXPECT_EQ(Prices("KRM").size(), clean.size());
    dup->close();

    // No '.Old' files: the message alone.
    for (const char* old : {"ALX.Old", "KRM.Old", "HBK.Old"}) // the sample's own
        std::filesystem::remove(data() + old);
    s.dialogs.clear();
    EXPECT_TRUE(main.Trigger("mnuRemOld"));
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].text, " There are no '.Old' files in " + data());
    EXPECT_EQ(s.dialogs.shown()[0].title, "Old Files ");

    // ASX code change: KRM becomes KRQ.
    auto* chg = Opened<gui::ASXChg>("mnuCodeChanged");
    ASSERT_NE(chg, nullptr);
    chg->oldCode()->setText("KRM");
    chg->newCode()->setText("KRQ");
    s.dialogs.QueueAnswer(platform::Answer::Yes);
    chg->Convert();
    EXPECT_TRUE(chg->result().Done);
    EXPECT_TRUE(platform::FileExists(data() + "KRQ.WDT"));
    EXPECT_FALSE(platform::FileExists(data() + "KRM.WDT"));
    chg->close();

    auto* rem = Opened<gui::RemDate>("mnuCDupDts");
    ASSERT_NE(rem, nullptr);
    EXPECT_EQ(rem->windowTitle(), "Remove Specific Date");
    rem->findChild<QPushButton*>("cmdRemove")->click();
    EXPECT_EQ(s.dialogs.messages().back(), "Date to remove must be entered.");
    rem->close();

    EXPECT_NE(Opened<gui::ResetFA>("mnuResetRO"), nullptr);
}

} // namespace
