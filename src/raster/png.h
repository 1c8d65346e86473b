#pragma once
// PNG bytes of an opaque picture held as 32-bit pixels (0xFFRRGGBB, one row after another).
#include <cstddef>
#include <cstdint>
#include <string>

namespace kori::raster {

struct PixelRows {
    const std::uint32_t* pixels = nullptr;
    int width = 0;
    int height = 0;
    std::size_t stride = 0;  // pixels from one row to the next
    int dotsPerMeter = 3780; // 96 dots an inch
};

// Appends nothing and answers false when the picture is empty or memory runs out.
bool EncodeOpaquePng(const PixelRows& picture, std::string& bytes);

} // namespace kori::raster
