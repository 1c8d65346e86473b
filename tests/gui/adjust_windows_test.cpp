// The manual adjustment windows on the sample library: reached from the menu, the security
// chooser's rules, the two steps before "Adjust Data", and one adjustment and its removal.
#include "gui/windows/adjust_windows.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "platform/files.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "store/store_builders.h"
#include "support/sample_session.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QTest>
#include <QToolButton>
#include <gtest/gtest.h>

using namespace kori;

namespace {

struct AdjustWindows : ::testing::Test {
    test::SampleSession s;
    gui::MainWindow main{s.session};

    void SetUp() override { gui::RegisterWindows(main); }

    std::filesystem::path Krm() {
        return store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM");
    }
    // KRM at 2.50, 1000 shares a day, on 2, 3, 4 and 8 January 2024.
    void KnownHistory() {
        ASSERT_TRUE(platform::WriteFileAtomic(
                        Krm(), test::Bytes({test::Day("20240102", 2.5f, 2.5f, 2.5f, 2.5f, 1000),
                                            test::Day("20240103", 2.5f, 2.5f, 2.5f, 2.5f, 1000),
                                            test::Day("20240104", 2.5f, 2.5f, 2.5f, 2.5f, 1000),
                                            test::Day("20240108", 2.5f, 2.5f, 2.5f, 2.5f, 1000)}))
                        .ok());
    }
    std::vector<store::PriceRecord> Records() {
        store::PriceFile f(Krm());
        std::vector<store::PriceRecord> r;
        EXPECT_TRUE(f.ReadAll(r).ok());
        return r;
    }
    gui::Adjust* OpenAdjust() {
        EXPECT_TRUE(main.Trigger("mnuManAdjust"));
        QApplication::processEvents();
        return main.findChild<gui::Adjust*>();
    }
    std::vector<std::string> Messages() { return s.dialogs.messages(); }
    std::string LastTitle() {
        for (auto it = s.dialogs.shown().rbegin(); it != s.dialogs.shown().rend(); ++it)
            if (it->kind == "msg") return it->title;
        return {};
    }
    static void Type(QLineEdit* f, const char* text) {
        f->setFocus();
        f->clear();
        QTest::keyClicks(f, QString::fromLatin1(text));
        emit f->editingFinished();
    }
};

TEST_F(AdjustWindows, TheChooserTakesOnlyTypesFourAndFiveAndWraps) {
    auto* w = OpenAdjust();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle(), "Adjustments for Issues");
    // The sample starts with three indices and statistics (types 1 to 3): KRM is first.
    EXPECT_EQ(w->codeField()->text(), "KRM");
    EXPECT_EQ(w->nameLabel()->text(), "Karoo Minerals");

    // Down from the first adjustable security wraps to the last one of the file.
    std::vector<store::NameRecord> names;
    ASSERT_TRUE(
        store::NameFile(store::NameFile::PathIn(s.session.folders.DataFolder)).ReadAll(names).ok());
    std::string lastAdjustable;
    for (const auto& n : names)
        if (n.RecordType > 3) lastAdjustable = n.TrimmedCode();
    w->downButton()->click();
    EXPECT_EQ(w->codeField()->text().toStdString(), lastAdjustable);
    w->upButton()->click();
    EXPECT_EQ(w->codeField()->text(), "KRM");
    w->upButton()->click();
    EXPECT_EQ(w->codeField()->text(), "ALX");

    w->codeField()->setText("advdec");
    QTest::keyClick(w->codeField(), Qt::Key_Return);
    EXPECT_EQ(Messages().back(), " Only Record Types 4 and 5 can be adjusted");
    EXPECT_EQ(LastTitle(), "Adjust Data");
    EXPECT_EQ(w->codeField()->text(), "KRM");

    w->codeField()->setText("glN");
    QTest::keyClick(w->codeField(), Qt::Key_Return);
    EXPECT_EQ(w->codeField()->text(), "GLN");
    // An unknown code leaves the choice as it was.
    w->codeField()->setText("NOPE");
    QTest::keyClick(w->codeField(), Qt::Key_Return);
    EXPECT_EQ(Messages().back(), "No File For That Name");
    EXPECT_EQ(w->codeField()->text(), "GLN");
    EXPECT_EQ(w->nameLabel()->text(), "Glenmore Oil Search");
}

TEST_F(AdjustWindows, AdjustDataWaitsForTheTermsAndTheDate) {
    KnownHistory();
    auto* w = OpenAdjust();
    ASSERT_NE(w, nullptr);
    auto* e = w->OpenEntry(adjust::AdjType::Bonus);
    ASSERT_NE(e, nullptr);
    EXPECT_EQ(e->objectName(), "AdjustB");
    EXPECT_EQ(e->windowTitle(), "Bonus Issue");
    EXPECT_EQ(e->findChild<QLabel*>("lblHelp1")->text(),
              " ie 1 Bonus Share/s for every 4 Shares held");
    EXPECT_FALSE(e->adjustButton()->isEnabled());

    e->dateButton()->click();
    EXPECT_EQ(Messages().back(), "Ratio Data incomplete");
    EXPECT_FALSE(e->adjustButton()->isEnabled());

    Type(e->fieldA(), "1");
    Type(e->fieldB(), "4");
    EXPECT_EQ(e->ratioLabel()->text(), "Ratio of Bonus Issue is 1:4");
    Type(e->fieldA(), "x"); // not a number: the 1 stays
    EXPECT_EQ(e->fieldA()->text(), "1");

    e->fieldDate()->setText("4.1.24");
    e->dateButton()->click();
    EXPECT_EQ(Messages().back(), " Use  /   or  -  to separate day/month/year\n eg.  2/10/93");
    EXPECT_EQ(LastTitle(), "Incorrect Date Format ");
    EXPECT_FALSE(e->adjustButton()->isEnabled());

    e->fieldDate()->setText("04-01-2024");
    e->dateButton()->click();
    EXPECT_TRUE(e->adjustButton()->isEnabled());
    EXPECT_EQ(e->fieldDate()->text(), "4/1/24");
    EXPECT_EQ(e->closeLabel()->text(), "Close Price on 4/1/24 is 2.50");
    ASSERT_NE(e->dateWindow(), nullptr);
    EXPECT_EQ(e->dateWindow()->windowTitle(), "Exercise Date");
    EXPECT_EQ(e->dateWindow()->list()->count(), 4);
    EXPECT_EQ(e->dateWindow()->list()->currentRow(), 2); // record 3 of a list from record 1
    EXPECT_EQ(Records()[0].Close, 2.5f);                 // nothing written yet

    // Opening another kind closes this one.
    QPointer<gui::AdjustEntry> first = e;
    auto* d = w->OpenEntry(adjust::AdjType::Dividend);
    QApplication::processEvents();
    EXPECT_TRUE(first.isNull() || !first->isVisible());
    EXPECT_EQ(d->objectName(), "AdjustD");
    EXPECT_FALSE(d->adjustButton()->isEnabled());
}

TEST_F(AdjustWindows, OneAdjustmentThroughTheWindowsAndItsRemoval) {
    KnownHistory();
    auto* w = OpenAdjust();
    ASSERT_NE(w, nullptr);
    auto* e = w->OpenEntry(adjust::AdjType::Cash);
    ASSERT_NE(e, nullptr);
    EXPECT_EQ(e->windowTitle(), "Cash Issues");
    Type(e->fieldA(), "1");
    Type(e->fieldB(), "4");
    Type(e->fieldMoney(), "2");
    EXPECT_EQ(e->ratioLabel()->text(), "Ratio = 1:4 @ 2");
    // 6 January is a Saturday: the 4th is the nearest before it.
    e->fieldDate()->setText("6/1/24");
    e->dateButton()->click();
    EXPECT_EQ(Messages().back(),
              "No close price on file for 6/1/24\n Nearest date prior is 4/1/24\n Close price "
              "is 2.50");
    ASSERT_NE(e->dateWindow(), nullptr);
    // The user picks the 3rd instead; a cash issue writes it back into the date field.
    e->dateWindow()->list()->setCurrentRow(1);
    EXPECT_EQ(e->fieldDate()->text(), "3/1/24");
    e->adjustButton()->click();
    EXPECT_EQ(Messages().back(), "Adjustments made to\nKRM");
    EXPECT_EQ(LastTitle(), "Data Adjustments");
    EXPECT_EQ(e->descLabel()->text(), "Adjustment Desc :ci1:4 @ 2");
    auto r = Records();
    // T = (2 + 4 x 2.5) / 5 = 2.4: factor 0.96 on records 1 and 2.
    EXPECT_EQ(r[0].Close, 2.4f);
    EXPECT_EQ(r[1].Close, 2.4f);
    EXPECT_EQ(r[1].Volume, 960);
    EXPECT_EQ(r[1].AdjFactor, 0.96f);
    EXPECT_EQ(r[2].Close, 2.5f);

    auto* rm = w->OpenRemove();
    ASSERT_NE(rm, nullptr);
    EXPECT_EQ(rm->windowTitle(), "Remove Adjustment");
    rm->proceedButton()->click();
    EXPECT_EQ(Messages().back(), "Latest adjustment removed for KRM");
    EXPECT_EQ(LastTitle(), "Remove Adjustment");
    r = Records();
    EXPECT_EQ(r[0].Close, 2.5f);
    EXPECT_EQ(r[1].Volume, 960);
    EXPECT_EQ(r[1].AdjFactor, 0.0f);
}

} // namespace
