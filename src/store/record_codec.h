#pragma once
// Little-endian numbers and blank-padded text at fixed offsets of a record buffer.
#include "platform/text.h"

#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

namespace kori::store::codec {

template <typename T> inline T Get(const char* p) {
    T v;
    std::memcpy(&v, p, sizeof v);
    return v;
}
template <typename T> inline void Put(char* p, T v) {
    std::memcpy(p, &v, sizeof v);
}

inline std::string GetText(const char* p, std::size_t n) {
    return std::string(p, n);
}
inline void PutText(char* p, std::string_view s, std::size_t n) {
    const std::string padded = platform::PadRight(s, n);
    std::memcpy(p, padded.data(), n);
}

} // namespace kori::store::codec
