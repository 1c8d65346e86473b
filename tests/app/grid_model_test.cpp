// The rows behind every editing grid: checks as cells are left, insert, delete, sort, and the
// check of all cells before a save.
#include "app/grid_model.h"

#include <gtest/gtest.h>

using namespace kori;
using app::GridModel;

namespace {

// Codes are three digits; names take no commas.
GridModel Classes() {
    return GridModel({"Code", "Name"}, [](int column, const std::string& text) -> app::CellVerdict {
        if (column == 0) {
            if (text.empty()) return {true, text, {}};
            for (char ch : text)
                if (ch < '0' || ch > '9') return {false, text, "Id must be numeric"};
            return {true, std::string(3 - std::min<std::size_t>(3, text.size()), '0') + text, {}};
        }
        if (text.find(',') != std::string::npos) return {false, text, "Commas cannot be used"};
        return {true, text, {}};
    });
}

} // namespace

TEST(GridModel, LoadFormatsWhatPassesAndCountsNothingAsChanged) {
    GridModel g = Classes();
    g.Load({{"7", "Base Metals"}, {"x1", "Odd"}, {"122"}});
    EXPECT_EQ(g.rowCount(), 3);
    EXPECT_EQ(g.cell(0, 0), "007");
    EXPECT_EQ(g.cell(1, 0), "x1") << "a bad cell read from the file stays for the user to see";
    EXPECT_EQ(g.cell(2, 1), "") << "short rows are padded";
    EXPECT_FALSE(g.changed());
    const auto refused = g.FirstRefusal();
    ASSERT_TRUE(refused);
    EXPECT_EQ(refused->Row, 1);
    EXPECT_EQ(refused->Column, 0);
    EXPECT_EQ(refused->Message, "Id must be numeric");
}

TEST(GridModel, ALeftCellIsFormattedOrKeptAsTypedWithItsMessage) {
    GridModel g = Classes();
    g.Load({{"001", "A"}});
    auto v = g.SetCell(0, 0, "12");
    EXPECT_TRUE(v.Accepted);
    EXPECT_EQ(g.cell(0, 0), "012");
    EXPECT_TRUE(g.changed());
    v = g.SetCell(0, 1, "Gold, Silver");
    EXPECT_FALSE(v.Accepted);
    EXPECT_EQ(v.Message, "Commas cannot be used");
    EXPECT_EQ(g.cell(0, 1), "Gold, Silver");
    EXPECT_FALSE(g.SetCell(5, 0, "1").Accepted);
}

TEST(GridModel, RowsGoInAndOutWhereAsked) {
    GridModel g = Classes();
    g.Load({{"001", "A"}, {"002", "B"}});
    EXPECT_EQ(g.InsertRow(1), 1);
    EXPECT_EQ(g.cell(1, 0), "");
    EXPECT_EQ(g.cell(2, 1), "B");
    EXPECT_EQ(g.InsertRow(-1), 3) << "out of range goes to the end";
    EXPECT_TRUE(g.DeleteRow(0));
    EXPECT_FALSE(g.DeleteRow(9));
    EXPECT_EQ(g.rowCount(), 3);
    EXPECT_EQ(g.cell(1, 1), "B");
    EXPECT_TRUE(g.changed());
    g.MarkSaved();
    EXPECT_FALSE(g.changed());
}

TEST(GridModel, SortPutsBlankKeysLastKeepsTiesAndRefusesOverABadCell) {
    GridModel g = Classes();
    g.Load({{"", "blank"}, {"122", "Gold"}, {"007", "first"}, {"122", "Silver"}});
    ASSERT_FALSE(g.SortBy(0));
    EXPECT_EQ(g.cell(0, 1), "first");
    EXPECT_EQ(g.cell(1, 1), "Gold");
    EXPECT_EQ(g.cell(2, 1), "Silver");
    EXPECT_EQ(g.cell(3, 1), "blank");
    EXPECT_TRUE(g.changed());
    g.MarkSaved();
    ASSERT_FALSE(g.SortBy(0));
    EXPECT_FALSE(g.changed()) << "already in order";
    g.SetCell(1, 1, "a,b");
    const auto refused = g.SortBy(0);
    ASSERT_TRUE(refused);
    EXPECT_EQ(refused->Row, 1);
    EXPECT_EQ(g.cell(0, 1), "first") << "nothing moved";
}

TEST(GridModel, TrimmedRowsAreWhatAFileTakes) {
    GridModel g = Classes();
    g.Load({{"990", " Other "}});
    EXPECT_EQ(g.TrimmedRows(), (std::vector<GridModel::Row>{{"990", "Other"}}));
}
