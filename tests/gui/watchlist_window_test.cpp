// The Watchlist window on the sample library: from the menu and from the chart window, its
// rows, the changes saved at once, sorting, and a double click that charts a row.
#include "desktop_fixture.h"
#include "gui/widgets/grid_view.h"
#include "gui/windows/watchlist.h"

#include <QAction>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QTest>

namespace kori::test {
namespace {

std::vector<std::string> Column(gui::GridView* grid, int column) {
    std::vector<std::string> out;
    for (int r = 0; r < grid->rowCount(); ++r)
        out.push_back(grid->item(r, column)->text().toStdString());
    return out;
}

TEST_F(DesktopTest, WatchlistFromTheMenuShowsSortsAndChartsARow) {
    s.session.download.DataService = 1; // the item shows for the companion's services
    main.RebuildMenus();
    ASSERT_TRUE(main.Trigger("mnuWatch"));
    QApplication::processEvents();
    auto* w = main.findChild<gui::Watchlist*>();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->windowTitle(), QStringLiteral("Watchlist"));
    ASSERT_EQ(w->listBox()->count(), 2);
    EXPECT_EQ(w->listBox()->currentText(), QStringLiteral("Portfolio"));
    EXPECT_EQ(Column(w->grid(), 0), (std::vector<std::string>{"HBK", "FRG", "GLN", "TWR"}));
    EXPECT_TRUE(w->issuesLabel()->isHidden());
    EXPECT_LE(w->minimumSizeHint().width(), 640);
    EXPECT_LE(w->minimumSizeHint().height(), 480);

    // Close (column 3), then the same column again: highest first.
    w->SortBy(scan::kWatchClose);
    w->SortBy(scan::kWatchClose);
    std::vector<double> closes;
    for (const auto& r : w->form().rows())
        closes.push_back(*r.Close);
    EXPECT_TRUE(std::is_sorted(closes.rbegin(), closes.rend()));

    const std::string code = w->grid()->item(1, 0)->text().toStdString();
    w->grid()->setCurrentCell(1, 0);
    emit w->grid()->cellDoubleClicked(1, 0);
    QApplication::processEvents();
    ASSERT_NE(chts(), nullptr);
    EXPECT_EQ(chts()->model().Code(), code);

    // The other list keeps the order chosen; then a row typed in, saved at once, and the same
    // code again refused with a message.
    w->listBox()->setCurrentIndex(1);
    auto codes = Column(w->grid(), 0);
    std::sort(codes.begin(), codes.end());
    EXPECT_EQ(codes, (std::vector<std::string>{"BWG", "DLT", "KRM"}));
    closes.clear();
    for (const auto& r : w->form().rows())
        closes.push_back(*r.Close);
    EXPECT_TRUE(std::is_sorted(closes.rbegin(), closes.rend()));
    w->findChild<QLineEdit*>("txtCode")->setText("alx");
    w->findChild<QLineEdit*>("txtPrice")->setText("10.5");
    w->findChild<QLineEdit*>("txtQuantity")->setText("100");
    w->AddTyped();
    EXPECT_EQ(w->grid()->rowCount(), 4);
    EXPECT_NE(s.root.Read("Watchlists.txt").find("ALX,,10.5,100,"), std::string::npos);
    w->findChild<QLineEdit*>("txtCode")->setText("ALX");
    w->AddTyped();
    EXPECT_EQ(s.dialogs.shown().back().text, "ALX is already in Speculative");
    const int alx = w->form().RowOf("ALX");
    ASSERT_GE(alx, 0);
    EXPECT_EQ(w->grid()->currentRow(), alx);
    w->RemoveCurrent();
    EXPECT_EQ(w->grid()->rowCount(), 3);
    EXPECT_EQ(w->form().RowOf("ALX"), -1);
    EXPECT_EQ(s.root.Read("Watchlists.txt").find("ALX"), std::string::npos);
}

TEST_F(DesktopTest, ChartWindowAddsItsSecurityAndOpensTheWatchlist) {
    s.session.download.DataService = 2; // the menu item is hidden: the chart is the way in
    main.RebuildMenus();
    ASSERT_FALSE(main.Trigger("mnuWatch"));
    ASSERT_TRUE(charts()->ShowCode("KRM"));
    QApplication::processEvents();
    auto* add = chts()->findChild<QAction*>("cmAddToWatchlist");
    ASSERT_NE(add, nullptr);
    add->trigger();
    QApplication::processEvents();
    auto* w = main.findChild<gui::Watchlist*>();
    ASSERT_NE(w, nullptr);
    EXPECT_TRUE(w->isVisible());
    EXPECT_EQ(w->listBox()->currentText(), QStringLiteral("Portfolio"));
    EXPECT_EQ(w->grid()->rowCount(), 5);
    EXPECT_EQ(w->grid()->item(w->grid()->currentRow(), 0)->text(), QStringLiteral("KRM"));
    // A second time leaves the list as it is, and the one window stays the one.
    add->trigger();
    QApplication::processEvents();
    EXPECT_EQ(w->grid()->rowCount(), 5);
    EXPECT_EQ(main.findChildren<gui::Watchlist*>().size(), 1);
    EXPECT_NE(s.root.Read("Watchlists.txt").find("KRM,,,,"), std::string::npos);
}

// The window store keeps the size and column widths the user left it at, in twips; a stored
// value that does not read as a size is passed over.
TEST_F(DesktopTest, WatchlistReopensAtTheSizeAndColumnWidthsItWasLeftAt) {
    auto& store = s.session.services().settings;
    {
        gui::Watchlist w(s.session, {});
        w.resize(700, 500);
        w.grid()->setColumnWidth(1, 180);
        w.show();
        w.hide();
    }
    EXPECT_EQ(store.Get("WatchWth", ""), "10500");
    EXPECT_EQ(store.Get("WatchHgt", ""), "7500");
    const auto place = app::LoadWatchWindowPlace(store);
    ASSERT_GT(place.Columns.size(), 2u);
    EXPECT_EQ(place.Columns[1], 180 * 15);
    gui::Watchlist again(s.session, {});
    EXPECT_EQ(again.size(), QSize(700, 500));
    EXPECT_EQ(again.grid()->columnWidth(1), 180);

    store.Save("WatchWth", "wide");
    store.Save("WatchCols", "900,x,300");
    const auto bad = app::LoadWatchWindowPlace(store);
    EXPECT_EQ(bad.Width, 0);
    EXPECT_EQ(bad.Height, 7500);
    EXPECT_TRUE(bad.Columns.empty());
}

} // namespace
} // namespace kori::test
