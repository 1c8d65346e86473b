#include "platform/clock.h"

#include <ctime>

namespace kori::platform {

namespace {
std::string FormatNow(const char* fmt) {
    const std::time_t t = std::time(nullptr);
    std::tm tm{};
    localtime_r(&t, &tm);
    char buf[32];
    std::strftime(buf, sizeof buf, fmt, &tm);
    return buf;
}
} // namespace

std::string SystemClock::Today() const {
    return FormatNow("%Y%m%d");
}
std::string SystemClock::Now() const {
    return FormatNow("%H:%M:%S");
}

} // namespace kori::platform
