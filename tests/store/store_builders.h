#pragma once
// Small price and name files for the store tests.
#include "store/name_file.h"
#include "store/price_file.h"

#include <string>
#include <vector>

namespace kori::test {

inline store::PriceRecord Day(const char* date, float o, float h, float l, float c, int v,
                              float adj = 0) {
    store::PriceRecord r;
    r.Date = date;
    r.Open = o;
    r.High = h;
    r.Low = l;
    r.Close = c;
    r.Volume = v;
    r.AdjFactor = adj;
    return r;
}

inline std::string Bytes(const std::vector<store::PriceRecord>& records) {
    std::string s;
    for (const auto& r : records) {
        const auto b = r.Encode();
        s.append(b.data(), b.size());
    }
    return s;
}

inline store::NameRecord Name(const char* code, const char* name, std::int16_t type = 4) {
    store::NameRecord r;
    r.Code = code;
    r.Name = name;
    r.RecordType = type;
    return r;
}

} // namespace kori::test
