#pragma once
// A routine's outcome: success, or a message that says what went wrong in the user's words.
#include <string>
#include <utility>

namespace kori::platform {

class [[nodiscard]] Status {
public:
    Status() = default;
    static Status Ok() { return {}; }
    static Status Error(std::string message) {
        Status s;
        s.m_ok = false;
        s.m_message = std::move(message);
        return s;
    }
    bool ok() const { return m_ok; }
    explicit operator bool() const { return m_ok; }
    const std::string& message() const { return m_message; }

private:
    bool m_ok = true;
    std::string m_message;
};

} // namespace kori::platform
