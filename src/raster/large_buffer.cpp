#include "raster/large_buffer.h"

#include <cstdint>
#include <new>
#include <utility>

#if defined(__linux__)
#include <sys/mman.h>
#endif

namespace kori::raster {

namespace {
constexpr std::size_t kLargePage = std::size_t{2} << 20;
} // namespace

LargeBuffer::LargeBuffer(std::size_t bytes) {
    Reserve(bytes);
}

LargeBuffer::~LargeBuffer() {
    Release();
}

LargeBuffer::LargeBuffer(LargeBuffer&& other) noexcept {
    *this = std::move(other);
}

LargeBuffer& LargeBuffer::operator=(LargeBuffer&& other) noexcept {
    if (this != &other) {
        Release();
        m_mapping = std::exchange(other.m_mapping, nullptr);
        m_mappingBytes = std::exchange(other.m_mappingBytes, 0);
        m_data = std::exchange(other.m_data, nullptr);
        m_size = std::exchange(other.m_size, 0);
    }
    return *this;
}

bool LargeBuffer::Reserve(std::size_t bytes) {
    if (bytes <= m_size && m_data != nullptr) return true;
    Release();
    if (bytes == 0) return true;
#if defined(__linux__)
    // Large pages must start on a large-page boundary: map one page more and align inside.
    const std::size_t rounded = (bytes + kLargePage - 1) / kLargePage * kLargePage;
    const std::size_t mappingBytes = rounded + kLargePage;
    void* mapping =
        mmap(nullptr, mappingBytes, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (mapping != MAP_FAILED) {
        const auto start = (reinterpret_cast<std::uintptr_t>(mapping) + kLargePage - 1) &
                           ~(std::uintptr_t{kLargePage} - 1);
        m_data = reinterpret_cast<unsigned char*>(start);
        madvise(m_data, rounded, MADV_HUGEPAGE); // a hint: without it the pages are small
        m_mapping = mapping;
        m_mappingBytes = mappingBytes;
        m_size = rounded;
        return true;
    }
#endif
    m_data = new (std::nothrow) unsigned char[bytes];
    if (m_data == nullptr) return false;
    m_size = bytes;
    return true;
}

void LargeBuffer::Release() {
#if defined(__linux__)
    if (m_mapping != nullptr) {
        munmap(m_mapping, m_mappingBytes);
        m_mapping = nullptr;
        m_mappingBytes = 0;
        m_data = nullptr;
        m_size = 0;
        return;
    }
#endif
    delete[] m_data;
    m_data = nullptr;
    m_size = 0;
}

} // namespace kori::raster
