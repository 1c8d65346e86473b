// The import window's model: what it asks for, the result text and the refusal box.
#include "app/csv_import_form.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

TEST(CsvImportFormTest, AsksForFileAndCodeThenImportsIntoTheDataFolder) {
    test::SampleSession s;
    CsvImportForm f(s.session.folders.DataFolder, s.dialogs);
    EXPECT_FALSE(f.Import());
    EXPECT_EQ(f.resultText(), "Choose the CSV file to import");
    EXPECT_EQ(s.dialogs.shown().back().title, "Import CSV History");
    f.file = s.root
                 .Write("h.csv", "Date,Open,High,Low,Close\n2026-11-20,1,1,1,1\n"
                                 "2026-11-23,2,2,2,2\n")
                 .string();
    EXPECT_FALSE(f.Import());
    EXPECT_EQ(f.resultText(), "Enter the code of the security");

    f.code = "krm";
    EXPECT_EQ(f.ExistingName(), "Karoo Minerals");
    ASSERT_TRUE(f.Import()) << f.resultText();
    EXPECT_EQ(
        f.resultText().rfind("KRM: 2 records read; 1 added, 0 replaced, 1 already on file", 0), 0u)
        << f.resultText();
    f.code = "ZZZ";
    EXPECT_EQ(f.ExistingName(), "");
    f.name = "Zed";
    ASSERT_TRUE(f.Import());
    EXPECT_EQ(s.Name("ZZZ").Name.substr(0, 3), "Zed");
}

} // namespace
} // namespace kori::app
