#include "platform/files.h"
#include "platform/ini_file.h"
#include "platform/settings_store.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::platform;
using kori::test::TempRoot;

TEST(Files, ResolverFindsAFileWhateverItsCase) {
    TempRoot root;
    root.Write("names.DAT", "x");
    EXPECT_EQ(ResolveIn(root.folder(), "Names.dat").filename(), "names.DAT");
    EXPECT_TRUE(FileExists(root.path() / "NAMES.dat"));
    EXPECT_TRUE(FileHasData(root.path() / "Names.Dat"));
    // An absent file keeps the canonical name it was asked for.
    EXPECT_EQ(ResolveIn(root.folder(), "BHP.WDT").filename(), "BHP.WDT");
    EXPECT_FALSE(FileExists(root.path() / "BHP.WDT"));
}

TEST(Files, FolderTestsIgnoreTheClosingSeparatorAndBackSlashes) {
    TempRoot root;
    CreateFolder(root.path() / "data");
    EXPECT_TRUE(FileExists(root.folder() + "data/"));
    EXPECT_EQ(FolderWithSlash("a\\b"), "a/b/");
    EXPECT_EQ(FolderWithSlash("a/b/"), "a/b/");
    root.Write("empty", "");
    EXPECT_TRUE(FileExists(root.path() / "empty"));
    EXPECT_FALSE(FileHasData(root.path() / "empty"));
}

TEST(Files, AFailedAtomicWriteLeavesTheOldFileWhole) {
    TempRoot root;
    const auto p = root.Write("Names.dat", "old content");
    SetWriteFailureAfterBytesForTesting(3);
    EXPECT_FALSE(WriteFileAtomic(p, "new content that fails").ok());
    SetWriteFailureAfterBytesForTesting(-1);
    EXPECT_EQ(root.Read("Names.dat"), "old content");
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(root.path()), {}), 1);
    ASSERT_TRUE(WriteFileAtomic(p, "new").ok());
    EXPECT_EQ(root.Read("Names.dat"), "new");
}

TEST(IniFile, UnknownForMissingOrEmptyCutAt60CaseFreeNames) {
    TempRoot root;
    IniFile ini(root.path() / "Kori.ini");
    EXPECT_EQ(ini.Read("Charts", "Zoom"), "unknown");
    ASSERT_TRUE(ini.Write("Charts", "Zoom", "  120  "));
    EXPECT_EQ(ini.Read("charts", "ZOOM"), "120");
    ini.Write("Charts", "Empty", "");
    EXPECT_EQ(ini.Read("Charts", "Empty"), "unknown");
    ini.Write("Other", "Long", std::string(70, 'x'));
    EXPECT_EQ(ini.Read("Other", "Long"), std::string(60, 'x'));
    ini.Write("Charts", "Zoom", "90");
    EXPECT_EQ(ini.Read("Charts", "Zoom"), "90");
    // A second reader sees what the first wrote.
    IniFile again(root.path() / "kori.INI");
    EXPECT_EQ(again.Read("Charts", "Zoom"), "90");
    EXPECT_EQ(again.Section("Charts").size(), 2u);
}

TEST(SettingsStore, FallsBackAndKeepsApplicationsApart) {
    TempRoot root;
    SettingsStore store(root.path() / "settings.ini");
    EXPECT_EQ(store.Get("SubListA", "Chart List A"), "Chart List A");
    store.Save("SubListA", "Banks");
    EXPECT_EQ(store.Get("SubListA", "x"), "Banks");
    EXPECT_EQ(store.Get("Other App", kAppSection, "SubListA", "none"), "none");
}
