#include "cli/pdf_output.h"

#include "cli/cli_context.h"

#include <string_view>

namespace kori::cli {

namespace {
PdfPlayer g_player = nullptr;
} // namespace

void SetPdfPlayer(PdfPlayer player) {
    g_player = player;
}

chart::PlayOutcome PlayPdf(const std::filesystem::path& stream, PdfPage& page,
                           std::string& document) {
    if (g_player == nullptr)
        throw CliError{"This kori cannot print a PDF page: run it through kori-paper"};
    return g_player(stream, page, document);
}

bool AsksForPdf(int argc, const char* const* argv) {
    for (int i = 1; i < argc; ++i) {
        const std::string_view arg = argv[i];
        if (arg == "--pdf" || arg.starts_with("--pdf=")) return true;
    }
    return false;
}

std::filesystem::path PaperProgramPath() {
    std::error_code ec;
    const auto self = std::filesystem::read_symlink("/proc/self/exe", ec);
    if (ec) return "kori-paper";
    return self.parent_path() / "kori-paper";
}

} // namespace kori::cli
