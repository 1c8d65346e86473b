// The in-process commands print PDF pages as kori-paper does.
#include "cli/paper/pdf_player.h"

namespace {
const bool kPdfPlayerSet = [] {
    kori::cli::SetPdfPlayer(&kori::cli::PlayStreamToPdf);
    return true;
}();
} // namespace
