// Name file records: the whole file through the record file and every record decoded.
#include "fuzz_input.h"
#include "store/name_file.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kori;
    const auto bytes = fuzz::Bytes(data, size);
    for (std::size_t at = 0; at + store::NameRecord::kSize <= bytes.size();
         at += store::NameRecord::kSize) {
        const auto rec = store::NameRecord::Decode(bytes.data() + at);
        (void)rec.TrimmedCode();
    }
    store::NameFile file(fuzz::InputFile("NAMES.DAT", data, size));
    std::vector<store::NameRecord> all;
    if (file.Open()) (void)file.ReadAll(all);
    return 0;
}
