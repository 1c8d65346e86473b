#pragma once
// Memory for a whole picture or its encoded rows. On this platform every first touch of a
// fresh 4 KB page costs a trap; a picture of a few megabytes touches hundreds of them, which
// costs more than drawing the chart. Large pages, where the system offers them, turn those
// hundreds of traps into one or two.
#include <cstddef>

namespace kori::raster {

class LargeBuffer {
public:
    LargeBuffer() = default;
    explicit LargeBuffer(std::size_t bytes);
    ~LargeBuffer();
    LargeBuffer(LargeBuffer&& other) noexcept;
    LargeBuffer& operator=(LargeBuffer&& other) noexcept;
    LargeBuffer(const LargeBuffer&) = delete;
    LargeBuffer& operator=(const LargeBuffer&) = delete;

    // At least `bytes` usable; what was there is not kept when it grows. Contents start
    // undefined.
    bool Reserve(std::size_t bytes);
    unsigned char* data() const { return m_data; }
    std::size_t size() const { return m_size; }
    explicit operator bool() const { return m_data != nullptr; }

private:
    void Release();
    void* m_mapping = nullptr;
    std::size_t m_mappingBytes = 0;
    unsigned char* m_data = nullptr;
    std::size_t m_size = 0;
};

} // namespace kori::raster
