#pragma once
// A whole synthetic market on disk for the benchmarks that walk the library: a data folder with
// Names.dat and one daily price file a security, deterministic for a given seed. Securities
// follow random walks over weekdays ending on one common last date; a few records carry no
// trade. Made once per folder and kept: a stamp file names the shape it was made with, so a
// second benchmark run reuses it from the page cache.
#include "platform/date_text.h"
#include "platform/files.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <random>
#include <string>
#include <vector>

namespace kori::bench {

struct MarketShape {
    int Securities = 2000;
    int Records = 5000;
    std::uint32_t Seed = 20261123;
    std::string LastDate = "20261120"; // a Friday
};

// Code of security i (0-based): three to five characters, never "PRN" or "AUX".
inline std::string SyntheticCode(int i) {
    static const char* letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZ";
    std::string code;
    code += letters[i % 26];
    code += letters[(i / 26) % 26];
    code += letters[(i / 676) % 26];
    if (i >= 17576) code += std::to_string(i / 17576);
    code = "S" + code; // keeps clear of the device names
    return code;
}

// The `count` weekdays ending on `lastDate`, oldest first, as "yyyymmdd".
inline std::vector<std::string> SyntheticWeekdays(const std::string& lastDate, int count) {
    std::vector<std::string> dates(static_cast<std::size_t>(count));
    std::int32_t serial = *platform::DaySerial(lastDate);
    for (int i = count - 1; i >= 0;) {
        const std::string d = *platform::DateTextFromSerial(serial--);
        const int wd = *platform::Weekday(d);
        if (wd == 1 || wd == 7) continue;
        dates[static_cast<std::size_t>(i--)] = d;
    }
    return dates;
}

inline std::string MarketStamp(const MarketShape& s) {
    return std::to_string(s.Securities) + "x" + std::to_string(s.Records) + " seed " +
           std::to_string(s.Seed) + " to " + s.LastDate + "\n";
}

// Makes (or reuses) the market in `folder`; returns the data folder with its trailing '/'.
inline std::string MakeSyntheticMarket(const std::filesystem::path& folder,
                                       const MarketShape& shape = {}) {
    namespace fs = std::filesystem;
    const std::string dataFolder = folder.string() + "/";
    const fs::path stamp = folder / "market.stamp";
    if (const auto text = platform::ReadWholeFile(stamp); text && *text == MarketStamp(shape))
        return dataFolder;
    fs::remove_all(folder);
    fs::create_directories(folder);

    const auto dates = SyntheticWeekdays(shape.LastDate, shape.Records);
    std::mt19937 rng(shape.Seed);
    std::normal_distribution<double> step(0.0, 0.018);
    std::uniform_real_distribution<double> unit(0.0, 1.0);
    std::string names;
    std::string bytes;
    for (int s = 0; s < shape.Securities; ++s) {
        store::NameRecord n;
        n.Code = store::PadCode(SyntheticCode(s));
        n.RecordType = 4;
        n.Name = "SYNTHETIC " + std::to_string(s + 1);
        n.Category = static_cast<std::int16_t>(s % 10);
        n.IndustryClass = std::to_string(100 + s % 50);
        n.GicsSector = "1010";
        const auto nb = n.Encode();
        names.append(nb.data(), nb.size());

        bytes.clear();
        bytes.reserve(static_cast<std::size_t>(shape.Records) * store::PriceRecord::kSize);
        double price = 0.5 + 20 * unit(rng);
        for (int r = 0; r < shape.Records; ++r) {
            store::PriceRecord p;
            p.Date = dates[static_cast<std::size_t>(r)];
            price = std::max(0.01, price * std::exp(step(rng)));
            if (unit(rng) < 0.01) { // a day without trade keeps the last close, no volume
                p.Close = 0;
            } else {
                const double range = price * (0.005 + 0.03 * unit(rng));
                p.High = static_cast<float>(price + range * unit(rng));
                p.Low = static_cast<float>(std::max(0.005, price - range * unit(rng)));
                p.Open = static_cast<float>(p.Low + (p.High - p.Low) * unit(rng));
                p.Close = static_cast<float>(price);
                p.Volume = static_cast<std::int32_t>(1000 + 200000 * unit(rng));
            }
            const auto pb = p.Encode();
            bytes.append(pb.data(), pb.size());
        }
        std::ofstream(dataFolder + n.TrimmedCode() + ".WDT", std::ios::binary)
            .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    }
    std::ofstream(dataFolder + "Names.dat", std::ios::binary)
        .write(names.data(), static_cast<std::streamsize>(names.size()));
    std::ofstream(stamp, std::ios::binary) << MarketStamp(shape);
    return dataFolder;
}

// The 2000 x 5000 market the walks over the library are measured on, made once per machine
// in the temporary folder (or in $KORI_BENCH_MARKET).
inline const std::string& DefaultMarket() {
    static const std::string folder = [] {
        if (const char* dir = std::getenv("KORI_BENCH_MARKET")) return MakeSyntheticMarket(dir);
        return MakeSyntheticMarket(std::filesystem::temp_directory_path() /
                                   "kori-bench-market-2000x5000");
    }();
    return folder;
}

} // namespace kori::bench
