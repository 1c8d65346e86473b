#pragma once
// Runs the kori tool in-process and keeps what it wrote and its exit status.
#include "cli/run_kori.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

namespace kori::test {

struct KoriResult {
    int status = -1;
    std::string out, err;
};

inline KoriResult RunKoriWith(std::vector<std::string> args) {
    args.insert(args.begin(), "kori");
    std::vector<const char*> argv;
    for (const auto& a : args)
        argv.push_back(a.c_str());
    std::ostringstream out, err;
    KoriResult r;
    r.status = cli::RunKori(static_cast<int>(argv.size()), argv.data(), out, err);
    r.out = out.str();
    r.err = err.str();
    return r;
}

// One sample library made by kori init --sample for a whole test suite, and the commands run
// over it with its --root.
class SampleRootSuite : public testing::Test {
protected:
    static void SetUpTestSuite() {
        s_dir = new TempRoot;
        const auto r = RunKoriWith({"init", "--sample", "--root", Root()});
        ASSERT_EQ(r.status, 0) << r.err;
    }
    static void TearDownTestSuite() {
        delete s_dir;
        s_dir = nullptr;
    }
    static std::string Root() { return (s_dir->path() / "k").string(); }
    static KoriResult Kori(std::vector<std::string> args) {
        args.push_back("--root");
        args.push_back(Root());
        return RunKoriWith(std::move(args));
    }
    static inline TempRoot* s_dir = nullptr;
};

} // namespace kori::test
