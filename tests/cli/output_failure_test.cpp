// Every output of kori on a disk that takes no more bytes: a failed write is a failed command,
// and a file that was there before stays as it was.
#include "cli/kori_run.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <fstream>

#include <sys/resource.h>

namespace kori::test {
namespace {

std::string ReadFile(const std::filesystem::path& p) {
    std::ifstream in(p, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), {}};
}

// While it lives, no file of this process may grow past `bytes`: every write beyond fails as
// a write to a full disk does.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes) {
        m_oldHandler = std::signal(SIGXFSZ, SIG_IGN);
        getrlimit(RLIMIT_FSIZE, &m_old);
        const rlimit limit{bytes, m_old.rlim_max};
        m_set = setrlimit(RLIMIT_FSIZE, &limit) == 0;
    }
    ~FileSizeLimit() {
        setrlimit(RLIMIT_FSIZE, &m_old);
        std::signal(SIGXFSZ, m_oldHandler);
    }
    bool set() const { return m_set; }

private:
    rlimit m_old{};
    void (*m_oldHandler)(int) = nullptr;
    bool m_set = false;
};

class KoriOnAFullDisk : public testing::Test {
protected:
    static void SetUpTestSuite() {
        s_dir = new TempRoot;
        ASSERT_EQ(RunKoriWith({"init", "--sample", "--root", Root()}).status, 0);
        // A whole chart to play: its stream, with a panel, is well over the limit below.
        const auto r = RunKoriWith(
            {"chart", "KRM", "--osc", "RSI", "--root", Root(), "--stream", Out("whole.cht")});
        ASSERT_EQ(r.status, 0) << r.err;
    }
    static void TearDownTestSuite() {
        delete s_dir;
        s_dir = nullptr;
    }
    static std::string Root() { return (s_dir->path() / "k").string(); }
    static std::string Out(const std::string& name) { return (s_dir->path() / name).string(); }

    // Runs kori with files limited to `limit` bytes; `output` held an older file before.
    static KoriResult RunLimited(std::vector<std::string> args, const std::string& output,
                                 rlim_t limit = 12000) {
        {
            std::ofstream old(output, std::ios::binary | std::ios::trunc);
            old << "the older file";
        }
        FileSizeLimit guard(limit);
        EXPECT_TRUE(guard.set());
        return RunKoriWith(std::move(args));
    }

    static void ExpectFailedAndKept(const KoriResult& r, const std::string& output) {
        EXPECT_NE(r.status, 0) << "a failed write ended with status 0";
        EXPECT_FALSE(r.err.empty());
        EXPECT_TRUE(ReadFile(output) == "the older file") << output << " was replaced";
        // No scratch file is left beside the output.
        for (const auto& e : std::filesystem::directory_iterator(s_dir->path())) {
            const auto name = e.path().filename().string();
            EXPECT_EQ(name.find(std::filesystem::path(output).filename().string() + "."),
                      std::string::npos)
                << name;
        }
    }

    static TempRoot* s_dir;
};
TempRoot* KoriOnAFullDisk::s_dir = nullptr;

TEST_F(KoriOnAFullDisk, PlayedPagesPicturesAndDrawingsFail) {
    ASSERT_GT(ReadFile(Out("whole.cht")).size(), 40000u);
    for (const std::string kind : {"pdf", "png", "svg"}) {
        const auto out = Out("played." + kind);
        const auto r = RunLimited({"play", Out("whole.cht"), "--" + kind, out}, out);
        ExpectFailedAndKept(r, out);
    }
}

TEST_F(KoriOnAFullDisk, ChartOutputsFail) {
    for (const std::string kind : {"stream", "pdf", "png", "svg"}) {
        const auto out = Out("chart." + kind);
        const auto r =
            RunLimited({"chart", "KRM", "--osc", "RSI", "--root", Root(), "--" + kind, out}, out);
        ExpectFailedAndKept(r, out);
    }
}

TEST_F(KoriOnAFullDisk, ATornRunStreamFailsTheChartWhateverItsOutput) {
    // The run's own stream in the temporary folder is the first file to outgrow the disk;
    // the numbers of a chart whose stream is torn are not given.
    const auto out = Out("numbers.json");
    const auto r = RunLimited({"chart", "KRM", "--osc", "RSI", "--root", Root(), "--json"}, out);
    EXPECT_NE(r.status, 0);
    EXPECT_TRUE(r.out.empty()) << r.out;
    EXPECT_NE(r.err.find("chart stream"), std::string::npos) << r.err;
}

TEST_F(KoriOnAFullDisk, EveryOutputWorksAgainWithRoom) {
    const auto out = Out("again.pdf");
    const auto r = RunKoriWith({"play", Out("whole.cht"), "--pdf", out});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(ReadFile(out).substr(0, 4), "%PDF");
}

// Standard output on a full disk: the buffer takes nothing.
class FullBuffer : public std::streambuf {
protected:
    int_type overflow(int_type) override { return traits_type::eof(); }
    std::streamsize xsputn(const char*, std::streamsize) override { return 0; }
};

TEST_F(KoriOnAFullDisk, ResultsThatCannotBeWrittenFailTheCommand) {
    FullBuffer full;
    std::ostream out(&full);
    std::ostringstream err;
    const std::vector<std::string> args{"kori", "names", "--json", "--root", Root()};
    std::vector<const char*> argv;
    for (const auto& a : args)
        argv.push_back(a.c_str());
    EXPECT_EQ(cli::RunKori(static_cast<int>(argv.size()), argv.data(), out, err), 1);
    EXPECT_EQ(err.str(), "kori: cannot write the output\n");
}

} // namespace
} // namespace kori::test
