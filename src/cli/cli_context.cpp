#include "cli/cli_context.h"

#include "app/install_root.h"
#include "app/start_up.h"
#include "platform/files.h"

#include <cstdarg>
#include <cstdio>

#include <unistd.h>

namespace kori::cli {

CliContext::CliContext(std::ostream& out_, std::ostream& err_) : out(out_), err(err_) {}
CliContext::~CliContext() = default;

app::Session& CliContext::OpenSession(bool mustExist) {
    if (m_session) return *m_session;
    const auto rootPath = app::FindInstallRoot(root);
    if (mustExist && !platform::FileExists(rootPath / "Kori.ini")) {
        throw CliError{"No library at " + rootPath.string() +
                       " (no Kori.ini). Make one with: kori init --sample --root " +
                       rootPath.string()};
    }
    m_dialogs = std::make_unique<platform::ConsoleDialogs>(::isatty(0) != 0);
    m_progress = std::make_unique<platform::TerminalProgress>();
    m_settings = std::make_unique<platform::SettingsStore>(rootPath / "settings.ini");
    m_session = std::make_unique<app::Session>(
        rootPath, platform::Services{*m_dialogs, *m_progress, *m_settings, m_clock});
    m_session->ReadFolders();
    m_session->ReadSettings();
    if (mustExist) {
        app::LoadColours(*m_session);
        if (auto printer = app::ReadPrinterFile(m_session->folders.SystemFolder + "koriprn.dat"))
            m_session->printer = *printer;
    }
    if (data) {
        m_session->folders.DataFolder = platform::FolderWithSlash(*data);
        m_session->folders.IndicesFolder = m_session->folders.DataFolder;
    }
    return *m_session;
}

std::string Printf(const char* format, ...) {
    va_list args;
    va_start(args, format);
    va_list again;
    va_copy(again, args);
    const int n = std::vsnprintf(nullptr, 0, format, args);
    va_end(args);
    std::string text(n > 0 ? static_cast<std::size_t>(n) : 0, '\0');
    if (n > 0) std::vsnprintf(text.data(), text.size() + 1, format, again);
    va_end(again);
    return text;
}

} // namespace kori::cli
