// kori: the command-line tool over the charting core.
#include "cli/run_kori.h"
#include "platform/heap.h"

#include <iostream>

int main(int argc, char** argv) {
    kori::platform::KeepFreedMemoryForReuse();
    return kori::cli::RunKori(argc, argv, std::cout, std::cerr);
}
