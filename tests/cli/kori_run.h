#pragma once
// Runs the kori tool in-process and keeps what it wrote and its exit status.
#include "cli/run_kori.h"

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

} // namespace kori::test
