#pragma once
// Long walks over the library report here and poll the cancel flag.
#include <string>
#include <string_view>

namespace kori::platform {

class Progress {
public:
    virtual ~Progress() = default;
    virtual void SetStatus(std::string_view text) = 0;
    virtual void SetRange(long long maximum) = 0;
    virtual void SetValue(long long value) = 0;
    // Lets pending events run (the window's repaint, the cancel button).
    virtual void Yield() {}
    virtual bool Cancelled() const { return m_cancel; }
    void RequestCancel() { m_cancel = true; }
    void ResetCancel() { m_cancel = false; }

private:
    bool m_cancel = false;
};

class NullProgress : public Progress {
public:
    void SetStatus(std::string_view) override {}
    void SetRange(long long) override {}
    void SetValue(long long) override {}
};

// A bar on standard error, redrawn only when the shown percentage changes.
class TerminalProgress : public Progress {
public:
    void SetStatus(std::string_view text) override;
    void SetRange(long long maximum) override;
    void SetValue(long long value) override;
    ~TerminalProgress() override;

private:
    std::string m_status;
    long long m_max = 0;
    int m_shownPercent = -1;
    bool m_drawn = false;
};

} // namespace kori::platform
