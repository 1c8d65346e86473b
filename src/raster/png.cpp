#include "raster/png.h"

#include "raster/large_buffer.h"

#include <libdeflate.h>

#include <memory>

namespace kori::raster {

namespace {

void PutBigEndian(unsigned char* out, std::uint32_t value) {
    out[0] = static_cast<unsigned char>(value >> 24);
    out[1] = static_cast<unsigned char>(value >> 16);
    out[2] = static_cast<unsigned char>(value >> 8);
    out[3] = static_cast<unsigned char>(value);
}

// One chunk: length, type, data, then the CRC of type and data.
void AppendChunk(std::string& bytes, const char (&type)[5], const unsigned char* data,
                 std::size_t length) {
    unsigned char word[4];
    PutBigEndian(word, static_cast<std::uint32_t>(length));
    bytes.append(reinterpret_cast<const char*>(word), 4);
    bytes.append(type, 4);
    if (length > 0) bytes.append(reinterpret_cast<const char*>(data), length);
    std::uint32_t crc = libdeflate_crc32(0, type, 4);
    if (length > 0) crc = libdeflate_crc32(crc, data, length);
    PutBigEndian(word, crc);
    bytes.append(reinterpret_cast<const char*>(word), 4);
}

unsigned char Channel(std::uint32_t pixel, int shift) {
    return static_cast<unsigned char>(pixel >> shift);
}

} // namespace

// Charts are written here rather than through a general writer: each row less the row above
// (flat areas and grids become runs of zeros), all rows compressed in one call with run-length
// matching at the fastest level. A general writer feeding the compressor row by row, or trying
// every filter, costs two to three times as much for the same pixels.
bool EncodeOpaquePng(const PixelRows& picture, std::string& bytes) {
    const int width = picture.width;
    const int height = picture.height;
    if (width <= 0 || height <= 0 || picture.pixels == nullptr) return false;
    const std::size_t stride = static_cast<std::size_t>(width) * 3 + 1;
    const std::size_t rowBytes = stride * static_cast<std::size_t>(height);
    thread_local LargeBuffer rows;
    thread_local LargeBuffer packed;
    if (!rows.Reserve(rowBytes)) return false;
    unsigned char* out = rows.data();
    const std::uint32_t* above = nullptr;
    for (int y = 0; y < height; ++y) {
        const std::uint32_t* pixels = picture.pixels + picture.stride * static_cast<std::size_t>(y);
        *out++ = 2; // filter "up"
        if (above == nullptr) {
            for (int x = 0; x < width; ++x) {
                *out++ = Channel(pixels[x], 16);
                *out++ = Channel(pixels[x], 8);
                *out++ = Channel(pixels[x], 0);
            }
        } else {
            for (int x = 0; x < width; ++x) {
                *out++ = static_cast<unsigned char>(Channel(pixels[x], 16) - Channel(above[x], 16));
                *out++ = static_cast<unsigned char>(Channel(pixels[x], 8) - Channel(above[x], 8));
                *out++ = static_cast<unsigned char>(Channel(pixels[x], 0) - Channel(above[x], 0));
            }
        }
        above = pixels;
    }

    // Level 2 of this compressor: faster than the usual library's fastest, and smaller.
    thread_local std::unique_ptr<libdeflate_compressor, void (*)(libdeflate_compressor*)>
        compressor(libdeflate_alloc_compressor(2), libdeflate_free_compressor);
    if (!compressor) return false;
    if (!packed.Reserve(libdeflate_zlib_compress_bound(compressor.get(), rowBytes))) return false;
    const std::size_t packedSize = libdeflate_zlib_compress(compressor.get(), rows.data(), rowBytes,
                                                            packed.data(), packed.size());
    if (packedSize == 0) return false;

    static constexpr unsigned char kSignature[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    bytes.reserve(bytes.size() + packedSize + 128);
    bytes.append(reinterpret_cast<const char*>(kSignature), 8);
    unsigned char header[13];
    PutBigEndian(header, static_cast<std::uint32_t>(width));
    PutBigEndian(header + 4, static_cast<std::uint32_t>(height));
    header[8] = 8;  // bits a sample
    header[9] = 2;  // RGB
    header[10] = 0; // deflate
    header[11] = 0; // adaptive filtering
    header[12] = 0; // not interlaced
    AppendChunk(bytes, "IHDR", header, sizeof header);
    unsigned char physical[9];
    PutBigEndian(physical, static_cast<std::uint32_t>(picture.dotsPerMeter));
    PutBigEndian(physical + 4, static_cast<std::uint32_t>(picture.dotsPerMeter));
    physical[8] = 1; // metres
    AppendChunk(bytes, "pHYs", physical, sizeof physical);
    AppendChunk(bytes, "IDAT", packed.data(), packedSize);
    AppendChunk(bytes, "IEND", nullptr, 0);
    return true;
}

} // namespace kori::raster
