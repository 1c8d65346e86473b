#include "platform/files.h"
#include "platform/ini_file.h"
#include "platform/settings_store.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <sys/stat.h>

using namespace kori::platform;
using kori::test::FilesIn;
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

TEST(Files, AFailedAtomicWriteLeavesTheOldFileWholeAndNoScratch) {
    TempRoot root;
    const auto p = root.Write("Names.dat", "old content");
    {
        ScopedWriteFailure fail(3);
        EXPECT_FALSE(WriteFileAtomic(p, "new content that fails").ok());
        EXPECT_FALSE(WriteFileAtomic(p, "new content", {"Temp.Wk2", "names.bak"}).ok());
        EXPECT_FALSE(AppendToFile(p, "appended").ok());
    }
    EXPECT_EQ(root.Read("Names.dat"), "old content");
    EXPECT_EQ(FilesIn(root.path()), std::vector<std::string>{"Names.dat"});
    ASSERT_TRUE(WriteFileAtomic(p, "new").ok()) << "the fault ends with its scope";
    EXPECT_EQ(root.Read("Names.dat"), "new");
}

TEST(Files, TheGateKeepsABackUpAndTheFileMode) {
    TempRoot root;
    const auto p = root.Write("Names.dat", "first");
    std::filesystem::permissions(p, std::filesystem::perms(0640));
    ASSERT_TRUE(WriteFileAtomic(p, "second", {"Temp.Wk1", "names.bak"}).ok());
    EXPECT_EQ(root.Read("Names.dat"), "second");
    EXPECT_EQ(root.Read("names.bak"), "first");
    EXPECT_EQ(std::filesystem::status(p).permissions(), std::filesystem::perms(0640));
    EXPECT_EQ(FilesIn(root.path()), (std::vector<std::string>{"Names.dat", "names.bak"}));
    // No old file: nothing to back up.
    ASSERT_TRUE(WriteFileAtomic(root.path() / "New.dat", "x", {"Temp.Wk1", "New.bak"}).ok());
    EXPECT_FALSE(std::filesystem::exists(root.path() / "New.bak"));
}

TEST(Files, TheGateWritesThroughALinkAndRefusesWhatIsNoPlainWritableFile) {
    TempRoot root;
    std::filesystem::create_directory(root.path() / "real");
    const auto target = root.Write("real/chart.png", "old");
    const auto link = root.path() / "link.png";
    std::filesystem::create_symlink("real/chart.png", link);
    ASSERT_TRUE(WriteFileAtomic(link, "new").ok());
    EXPECT_TRUE(std::filesystem::is_symlink(link)) << "the link stays a link";
    EXPECT_EQ(root.Read("real/chart.png"), "new");

    const auto fifo = root.path() / "pipe";
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0644), 0);
    const auto refused = WriteFileAtomic(fifo, "x");
    EXPECT_FALSE(refused.ok());
    EXPECT_NE(refused.message().find("not a plain file"), std::string::npos) << refused.message();
    EXPECT_EQ(std::filesystem::status(fifo).type(), std::filesystem::file_type::fifo);

    EXPECT_FALSE(WriteFileAtomic(root.path() / "real", "x").ok()) << "a folder is refused";

    const auto readOnly = root.Write("locked.dat", "keep");
    std::filesystem::permissions(readOnly, std::filesystem::perms(0444));
    const auto locked = WriteFileAtomic(readOnly, "lost");
    EXPECT_FALSE(locked.ok());
    EXPECT_NE(locked.message().find("read-only"), std::string::npos) << locked.message();
    EXPECT_EQ(root.Read("locked.dat"), "keep");
    EXPECT_EQ(std::filesystem::status(readOnly).permissions(), std::filesystem::perms(0444));
}

TEST(Files, TwoWritersNeverShareAScratchFile) {
    TempRoot root;
    const auto p = root.Write("TCht.Tmp", "");
    // A scratch file of the old fixed name, left by a killed writer, is not in the way.
    root.Write("TCht.Tmp.kori-new", "stale");
    ASSERT_TRUE(WriteFileAtomic(p, "mine").ok());
    EXPECT_EQ(root.Read("TCht.Tmp"), "mine");
    EXPECT_EQ(root.Read("TCht.Tmp.kori-new"), "stale");
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

TEST(IniFile, ReadFromDiskOnceAndAgainOnlyWhenItChanges) {
    TempRoot root;
    root.Write("Kori.ini", "[Charts]\r\nZoom=120\r\nType=B\r\n");
    IniFile ini(root.path() / "Kori.ini");
    for (int i = 0; i < 50; ++i) {
        EXPECT_EQ(ini.Read("Charts", "Zoom"), "120");
        EXPECT_EQ(ini.Read("Charts", "Type"), "B");
    }
    EXPECT_EQ(ini.DiskReads(), 1u);
    // Our own write needs no read back; another writer's change is seen.
    ASSERT_TRUE(ini.Write("Charts", "Zoom", "90"));
    EXPECT_EQ(ini.Read("Charts", "Zoom"), "90");
    EXPECT_EQ(ini.DiskReads(), 1u);
    IniFile other(root.path() / "Kori.ini");
    ASSERT_TRUE(other.Write("Charts", "Type", "C"));
    EXPECT_EQ(ini.Read("Charts", "Type"), "C");
    EXPECT_EQ(ini.Read("Charts", "Zoom"), "90");
    EXPECT_EQ(ini.DiskReads(), 2u);
}

TEST(IniFile, ABatchWritesTheFileOnce) {
    TempRoot root;
    IniFile ini(root.path() / "Kori.ini");
    {
        IniFile::Batch once(ini);
        ASSERT_TRUE(ini.Write("Fonts", "Name", "Arial"));
        ASSERT_TRUE(ini.Write("Fonts", "Size", "10"));
        EXPECT_FALSE(FileExists(root.path() / "Kori.ini")) << "nothing written yet";
        EXPECT_EQ(ini.Read("Fonts", "Size"), "10");
    }
    IniFile again(root.path() / "Kori.ini");
    EXPECT_EQ(again.Read("Fonts", "Name"), "Arial");
    EXPECT_EQ(again.Read("Fonts", "Size"), "10");
}

TEST(Files, AFolderIsMadeOnlyInsideOneThatExists) {
    TempRoot root;
    // A path read from a file makes no tree of folders.
    EXPECT_FALSE(CreateFolder(root.path() / "no" / "such" / "temp"));
    EXPECT_FALSE(std::filesystem::exists(root.path() / "no"));
    EXPECT_TRUE(CreateFolder(root.folder() + "temp/"));
    EXPECT_TRUE(std::filesystem::is_directory(root.path() / "temp"));
    EXPECT_TRUE(CreateFolder(root.path() / "temp")) << "an existing folder is fine";
    // The install root and folders the user chose are made whole.
    EXPECT_TRUE(CreateFolderPath(root.path() / "a" / "b"));
    EXPECT_TRUE(std::filesystem::is_directory(root.path() / "a" / "b"));
}

namespace {

// A rewrite that keeps the head of a file, in `folder`: the content, the mode, a link written
// through, a kept part past the end refused, and an injected failure in the kept part and in the
// tail each leaving the old file whole with no scratch file behind.
void CheckReplaceFrom(const std::filesystem::path& folder) {
    const auto p = folder / "BHP.WDT";
    std::string old(200000, '\0');
    for (std::size_t i = 0; i < old.size(); ++i)
        old[i] = static_cast<char>('a' + i % 26);
    { std::ofstream(p, std::ios::binary) << old; }
    std::filesystem::permissions(p, std::filesystem::perms(0640));
    ASSERT_TRUE(ReplaceFileFrom(p, 150000, "NEW-TAIL").ok());
    EXPECT_EQ(ReadWholeFile(p).value_or(""), old.substr(0, 150000) + "NEW-TAIL");
    EXPECT_EQ(std::filesystem::status(p).permissions(), std::filesystem::perms(0640));
    EXPECT_EQ(FilesIn(folder), std::vector<std::string>{"BHP.WDT"});

    const std::string now = old.substr(0, 150000) + "NEW-TAIL";
    EXPECT_FALSE(ReplaceFileFrom(p, now.size() + 1, "x").ok()) << "more kept than there is";
    for (const long long at : {1000LL, 150003LL}) {
        ScopedWriteFailure fail(at);
        EXPECT_FALSE(ReplaceFileFrom(p, 150000, "OTHER-TAIL").ok()) << at;
    }
    EXPECT_EQ(ReadWholeFile(p).value_or(""), now);
    EXPECT_EQ(FilesIn(folder), std::vector<std::string>{"BHP.WDT"});

    const auto link = folder / "link.WDT";
    std::filesystem::create_symlink("BHP.WDT", link);
    ASSERT_TRUE(ReplaceFileFrom(link, 3, "Z").ok());
    EXPECT_TRUE(std::filesystem::is_symlink(link));
    EXPECT_EQ(ReadWholeFile(p).value_or(""), "abcZ");
    ASSERT_TRUE(ReplaceFileFrom(p, 0, "").ok());
    EXPECT_EQ(std::filesystem::file_size(p), 0u);
}

} // namespace

TEST(Files, ReplaceFromKeepsTheHeadAndStaysWholeOnFailure) {
    TempRoot root;
    CheckReplaceFrom(root.path());
}

// The same where the file system shares the kept part's blocks (a folder on XFS or Btrfs, named
// by KORI_CLONE_FOLDER).
TEST(Files, ReplaceFromByCloneKeepsTheHeadAndStaysWholeOnFailure) {
    const char* dir = std::getenv("KORI_CLONE_FOLDER");
    if (!dir) GTEST_SKIP() << "KORI_CLONE_FOLDER names no folder on a cloning file system";
    const auto folder = std::filesystem::path(dir) / "replace-from-test";
    std::filesystem::remove_all(folder);
    std::filesystem::create_directories(folder);
    CheckReplaceFrom(folder);
    std::filesystem::remove_all(folder);
}
