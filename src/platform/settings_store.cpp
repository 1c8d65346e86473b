#include "platform/settings_store.h"

namespace kori::platform {

std::string SettingsStore::SectionName(std::string_view app, std::string_view section) {
    return std::string(app) + "\\" + std::string(section);
}

std::string SettingsStore::Get(std::string_view app, std::string_view section, std::string_view key,
                               std::string_view fallback) const {
    std::string v = m_ini.ReadRaw(SectionName(app, section), key);
    if (v.empty()) return std::string(fallback);
    return v;
}

void SettingsStore::Save(std::string_view app, std::string_view section, std::string_view key,
                         std::string_view value) {
    (void)m_ini.Write(SectionName(app, section), key, value);
}

} // namespace kori::platform
