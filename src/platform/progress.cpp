#include "platform/progress.h"

#include <cstdio>
#include <unistd.h>

namespace kori::platform {

void TerminalProgress::SetStatus(std::string_view text) {
    m_status = text;
    m_shownPercent = -1;
}

void TerminalProgress::SetRange(long long maximum) {
    m_max = maximum;
    m_shownPercent = -1;
}

void TerminalProgress::SetValue(long long value) {
    if (m_max <= 0 || !::isatty(2)) return;
    const int pct = static_cast<int>(100 * value / m_max);
    if (pct == m_shownPercent) return;
    m_shownPercent = pct;
    const int filled = pct * 30 / 100;
    std::fprintf(stderr, "\r%-30.30s [%.*s%*s] %3d%%", m_status.c_str(), filled,
                 "##############################", 30 - filled, "", pct);
    m_drawn = true;
}

TerminalProgress::~TerminalProgress() {
    if (m_drawn) std::fprintf(stderr, "\n");
}

} // namespace kori::platform
