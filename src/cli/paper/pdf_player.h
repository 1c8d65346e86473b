#pragma once
// The page printer of kori-paper: a stream played onto a PDF page through the desktop's
// painting libraries.
#include "cli/pdf_output.h"

namespace kori::cli {

chart::PlayOutcome PlayStreamToPdf(const std::filesystem::path& stream, PdfPage& page,
                                   std::string& document);

} // namespace kori::cli
