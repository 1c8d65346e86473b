#pragma once
// The window store: (application, section, key) -> text, kept as an ini file in the install
// root. It holds window positions and the display names of the chart lists.
#include "platform/ini_file.h"

#include <filesystem>
#include <string>
#include <string_view>

namespace kori::platform {

inline constexpr std::string_view kAppName = "Kori Investor Software";
inline constexpr std::string_view kAppSection = "Kori Charting System";

class SettingsStore {
public:
    explicit SettingsStore(std::filesystem::path path) : m_ini(std::move(path)) {}
    virtual ~SettingsStore() = default;

    virtual std::string Get(std::string_view app, std::string_view section, std::string_view key,
                            std::string_view fallback) const;
    virtual void Save(std::string_view app, std::string_view section, std::string_view key,
                      std::string_view value);

    // The application's own section, the one every window uses.
    std::string Get(std::string_view key, std::string_view fallback) const {
        return Get(kAppName, kAppSection, key, fallback);
    }
    void Save(std::string_view key, std::string_view value) {
        Save(kAppName, kAppSection, key, value);
    }

private:
    static std::string SectionName(std::string_view app, std::string_view section);
    IniFile m_ini;
};

} // namespace kori::platform
