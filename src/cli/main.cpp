// kori: the command-line tool over the charting core. It loads no windowing library; a
// command that prints a PDF page runs as kori-paper, the same tool with the page printer.
#include "cli/pdf_output.h"
#include "cli/run_kori.h"
#include "platform/heap.h"

#include <cerrno>
#include <cstring>
#include <iostream>

#include <unistd.h>

int main(int argc, char** argv) {
    if (kori::cli::AsksForPdf(argc, argv)) {
        const std::string paper = kori::cli::PaperProgramPath().string();
        ::execv(paper.c_str(), argv);
        std::cerr << "Cannot start " << paper << " for the PDF page: " << std::strerror(errno)
                  << "\n";
        return 1;
    }
    kori::platform::KeepFreedMemoryForReuse();
    return kori::cli::RunKori(argc, argv, std::cout, std::cerr);
}
