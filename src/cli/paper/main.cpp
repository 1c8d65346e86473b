// kori-paper: the kori tool with the page printer, which kori runs for a PDF.
#include "cli/paper/pdf_player.h"
#include "cli/run_kori.h"
#include "platform/heap.h"

#include <iostream>

int main(int argc, char** argv) {
    kori::platform::KeepFreedMemoryForReuse();
    kori::cli::SetPdfPlayer(&kori::cli::PlayStreamToPdf);
    return kori::cli::RunKori(argc, argv, std::cout, std::cerr);
}
