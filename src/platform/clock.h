#pragma once
// Today and now, behind an interface so tests can fix the date.
#include <string>

namespace kori::platform {

class Clock {
public:
    virtual ~Clock() = default;
    virtual std::string Today() const = 0; // "yyyymmdd"
    virtual std::string Now() const = 0;   // "hh:mm:ss"
};

class SystemClock : public Clock {
public:
    std::string Today() const override;
    std::string Now() const override;
};

class FixedClock : public Clock {
public:
    FixedClock(std::string today, std::string now = "12:00:00")
        : m_today(std::move(today)), m_now(std::move(now)) {}
    std::string Today() const override { return m_today; }
    std::string Now() const override { return m_now; }

private:
    std::string m_today;
    std::string m_now;
};

} // namespace kori::platform
