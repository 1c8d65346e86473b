#pragma once
// The kori tool as a function: the command line in, the exit status out, the results on `out`
// and the messages on `err`. main() is a thin shell around it; tests call it in-process.
#include <iosfwd>

namespace kori::cli {

int RunKori(int argc, const char* const* argv, std::ostream& out, std::ostream& err);

} // namespace kori::cli
