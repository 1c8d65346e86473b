// The chart stream reader over any text, to its end.
#include "chart/stream_reader.h"
#include "fuzz_input.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kori;
    auto reader = chart::StreamReader::FromText(std::string(fuzz::Bytes(data, size)));
    chart::Instruction in;
    // Every call reads at least one line, so the loop ends within the input's line count.
    for (std::size_t calls = 0; calls <= size + 1; ++calls)
        if (reader.Next(in) != chart::StreamReader::Result::Instruction) break;
    platform::Colour colour = 0;
    (void)chart::ReadStreamColour(fuzz::Bytes(data, size), colour);
    return 0;
}
