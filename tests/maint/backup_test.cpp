#include "maint/backup.h"

#include "platform/files.h"
#include "support/temp_root.h"

#include <archive.h>
#include <archive_entry.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <map>

using namespace kori;
using namespace kori::maint;
using kori::test::TempRoot;
namespace fs = std::filesystem;

namespace {

platform::NullProgress g_progress;

// Every file below a folder with its bytes, by path relative to it.
std::map<std::string, std::string> Snapshot(const fs::path& dir) {
    std::map<std::string, std::string> files;
    for (const auto& e : fs::recursive_directory_iterator(dir))
        if (e.is_regular_file())
            files[fs::relative(e.path(), dir).string()] = *platform::ReadWholeFile(e.path());
    return files;
}

// An install root with settings at the top and a data folder and a notes folder below.
struct Library {
    TempRoot dir;
    std::string root = dir.folder();
    std::string data = root + "data/";
    std::string misc = root + "chtmisc/";
    Library() {
        fs::create_directories(data);
        fs::create_directories(misc);
        dir.Write("Kori.ini", "[KoriPaths]\nData=data\n");
        dir.Write("Targets.txt", "KRM,1.5,U\n");
        std::string prices(5000 * 50, '\0');
        for (std::size_t i = 0; i < prices.size(); ++i)
            prices[i] = static_cast<char>((i * 7919) % 251);
        dir.Write("data/KRM.WDT", prices);
        dir.Write("data/Names.dat", std::string(96, 'N'));
        dir.Write("data/SubListA.Dat", "");
        dir.Write("chtmisc/KRM.txt", "note");
    }
    std::vector<BackupPlace> Places() const {
        return LibraryPlaces(root, {data, misc, root + "absent/"});
    }
};

class CancelAfter : public platform::Progress {
public:
    explicit CancelAfter(long long n) : m_n(n) {}
    void SetStatus(std::string_view) override {}
    void SetRange(long long) override {}
    void SetValue(long long v) override {
        if (v >= m_n) RequestCancel();
    }

private:
    long long m_n;
};

} // namespace

TEST(Backup, PlacesAreTheRootThenEachExistingFolderOnce) {
    Library lib;
    const auto places =
        LibraryPlaces(lib.root, {lib.data, lib.data, lib.misc, lib.root + "absent/"});
    ASSERT_EQ(places.size(), 3u);
    EXPECT_EQ(places[0].Name, "root");
    EXPECT_EQ(places[1].Folder, lib.data);
    EXPECT_EQ(places[2].Name, "place2");
    EXPECT_EQ(BackupFileName("20261123-090507"), "KoriBackup-20261123-090507.tar.zst");
}

TEST(Backup, RestoresAnIdenticalLibraryAndKeepsWhatItReplaced) {
    Library lib;
    const auto original = Snapshot(lib.dir.path());
    TempRoot out;
    const std::string archive = out.folder() + "b.tar.zst";
    const auto written = WriteBackup(lib.Places(), archive, g_progress);
    ASSERT_TRUE(written.Status.ok()) << written.Status.message();
    EXPECT_EQ(written.Files, 6);
    EXPECT_FALSE(fs::exists(archive + ".part"));

    // The library changes after the back-up: a file edited, one removed, one added.
    lib.dir.Write("data/KRM.WDT", "short");
    fs::remove(lib.data + "SubListA.Dat");
    lib.dir.Write("data/NEW.WDT", "new");
    lib.dir.Write("Kori.ini", "changed");

    const auto restored = RestoreBackup(archive, g_progress, "T1");
    ASSERT_TRUE(restored.Status.ok()) << restored.Status.message();
    EXPECT_EQ(restored.Files, 6);
    ASSERT_EQ(restored.Replaced.size(), 3u);
    auto now = Snapshot(lib.dir.path());
    // What was replaced is kept beside, and is all that differs.
    EXPECT_EQ(now.at("data.replaced-T1/KRM.WDT"), "short");
    EXPECT_EQ(now.at("data.replaced-T1/NEW.WDT"), "new");
    EXPECT_EQ(now.at("replaced-T1/Kori.ini"), "changed");
    std::erase_if(now,
                  [](const auto& kv) { return kv.first.find("replaced-T1") != std::string::npos; });
    EXPECT_EQ(now, original);

    const auto copies = ReplacedCopies(lib.Places());
    EXPECT_EQ(copies, (std::vector<std::string>{lib.root + "chtmisc.replaced-T1/",
                                                lib.root + "data.replaced-T1/",
                                                lib.root + "replaced-T1/"}));
    ASSERT_TRUE(DiscardReplaced(copies).ok());
    EXPECT_EQ(Snapshot(lib.dir.path()), original);
}

TEST(Backup, AFlippedByteOrACutArchiveIsRefusedAndTheLibraryStaysAsItWas) {
    Library lib;
    TempRoot out;
    const std::string archive = out.folder() + "b.tar.zst";
    ASSERT_TRUE(WriteBackup(lib.Places(), archive, g_progress).Status.ok());
    const std::string bytes = *platform::ReadWholeFile(archive);
    lib.dir.Write("data/KRM.WDT", "changed since");
    const auto before = Snapshot(lib.dir.path());

    std::string cut = bytes.substr(0, bytes.size() / 2);
    std::string flipped = bytes;
    flipped[bytes.size() / 2] = static_cast<char>(flipped[bytes.size() / 2] ^ 0x5A);
    for (const auto& damaged : {cut, flipped}) {
        out.Write("damaged.tar.zst", damaged);
        const auto plan = VerifyBackup(out.folder() + "damaged.tar.zst", g_progress);
        EXPECT_FALSE(plan.Status.ok());
        const auto restored = RestoreBackup(out.folder() + "damaged.tar.zst", g_progress, "T2");
        EXPECT_FALSE(restored.Status.ok());
        EXPECT_EQ(Snapshot(lib.dir.path()), before);
    }
}

TEST(Backup, AFileThatDoesNotMatchItsChecksumIsNamed) {
    Library lib;
    TempRoot out;
    ASSERT_TRUE(WriteBackup(lib.Places(), out.folder() + "good.tar.zst", g_progress).Status.ok());
    // The same archive again, member by member, with one file's bytes changed: a sound archive
    // whose manifest no longer agrees.
    archive* in = archive_read_new();
    archive_read_support_filter_all(in);
    archive_read_support_format_tar(in);
    ASSERT_EQ(archive_read_open_filename(in, (out.folder() + "good.tar.zst").c_str(), 65536),
              ARCHIVE_OK);
    archive* w = archive_write_new();
    archive_write_set_format_pax_restricted(w);
    ASSERT_EQ(archive_write_open_filename(w, (out.folder() + "bad.tar").c_str()), ARCHIVE_OK);
    archive_entry* entry = nullptr;
    while (archive_read_next_header(in, &entry) == ARCHIVE_OK) {
        std::string data(static_cast<std::size_t>(archive_entry_size(entry)), '\0');
        if (!data.empty()) archive_read_data(in, data.data(), data.size());
        if (std::string(archive_entry_pathname(entry)) == "place1/Names.dat") data[3] = 'X';
        archive_write_header(w, entry);
        if (!data.empty()) archive_write_data(w, data.data(), data.size());
    }
    archive_write_free(w);
    archive_read_free(in);

    const auto plan = VerifyBackup(out.folder() + "bad.tar", g_progress);
    ASSERT_FALSE(plan.Status.ok());
    EXPECT_EQ(plan.Status.message(),
              "The back-up is damaged: place1/Names.dat does not match its checksum");
}

TEST(Backup, KeepsTheNewestBackupsAndACancelLeavesNoArchive) {
    Library lib;
    TempRoot out;
    for (int second : {1, 2, 3}) {
        const auto r = WriteBackup(
            lib.Places(), out.folder() + BackupFileName("20261123-09000" + std::to_string(second)),
            g_progress, out.folder(), 2);
        ASSERT_TRUE(r.Status.ok());
        if (second == 3) {
            ASSERT_EQ(r.Discarded.size(), 1u);
            EXPECT_EQ(r.Discarded[0], "KoriBackup-20261123-090001.tar.zst");
        }
    }
    EXPECT_EQ(ListBackups(out.folder()),
              (std::vector<std::string>{"KoriBackup-20261123-090003.tar.zst",
                                        "KoriBackup-20261123-090002.tar.zst"}));

    CancelAfter cancel(2);
    const auto r = WriteBackup(lib.Places(), out.folder() + "cancelled.tar.zst", cancel);
    EXPECT_TRUE(r.Cancelled);
    EXPECT_FALSE(fs::exists(out.folder() + "cancelled.tar.zst"));
    EXPECT_FALSE(fs::exists(out.folder() + "cancelled.tar.zst.part"));
}
