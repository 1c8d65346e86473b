// Chart lists and the text a list is imported from.
#include "fuzz_input.h"
#include "store/chart_list.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kori;
    const auto path = fuzz::InputFile("LISTA.DAT", data, size);
    std::vector<store::ChartListEntry> entries;
    (void)store::ReadList(path, entries);
    (void)store::ReadImportCodes(path);
    return 0;
}
