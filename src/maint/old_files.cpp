#include "maint/old_files.h"

#include "platform/files.h"
#include "platform/text.h"

#include <algorithm>
#include <sys/stat.h>

namespace kori::maint {

namespace fs = std::filesystem;

std::string NoOldFilesMessage(std::string_view folder) {
    return " There are no '.Old' files in " + std::string(folder);
}

std::vector<fs::path> OldFiles(std::string_view folder) {
    std::vector<fs::path> out;
    std::error_code ec;
    const fs::path dir(platform::FolderWithSlash(folder));
    for (fs::directory_iterator it(dir, ec), end; !ec && it != end; it.increment(ec)) {
        if (!it->is_regular_file(ec)) continue;
        if (platform::EqualsNoCase(it->path().extension().string(), ".old"))
            out.push_back(it->path());
    }
    std::sort(out.begin(), out.end());
    return out;
}

RepairResult DumpOld(std::string_view folder, platform::Progress& progress) {
    RepairResult result;
    const auto files = OldFiles(folder);
    progress.SetRange(static_cast<long long>(files.size()));
    long long n = 0;
    for (const auto& f : files) {
        progress.SetValue(++n);
        std::error_code ec;
        if (!fs::remove(f, ec) || ec)
            result.Issues.push_back({platform::Severity::Error,
                                     "Cannot delete " + f.filename().string() +
                                         (ec ? ": " + ec.message() : std::string()),
                                     f.filename().string(), 0});
        else
            ++result.FilesChanged;
    }
    result.Done = true;
    return result;
}

RepairResult ResetFA(std::string_view folder, platform::Progress& progress) {
    RepairResult result;
    const fs::path dir(platform::FolderWithSlash(folder));
    std::error_code ec;
    if (!fs::is_directory(dir, ec)) {
        result.Issues.push_back(
            {platform::Severity::Error, "No folder " + dir.string(), dir.string(), 0});
        return result;
    }
    std::vector<fs::path> files;
    for (fs::directory_iterator it(dir, ec), end; !ec && it != end; it.increment(ec))
        if (it->is_regular_file(ec)) files.push_back(it->path());
    std::sort(files.begin(), files.end());
    progress.SetRange(static_cast<long long>(files.size()));
    long long n = 0;
    for (const auto& f : files) {
        progress.SetValue(++n);
        progress.Yield();
        if (progress.Cancelled()) {
            result.Cancelled = true;
            return result;
        }
        struct stat st {};
        if (::stat(f.c_str(), &st) != 0) continue;
        if (st.st_mode & S_IWUSR) continue;
        if (::chmod(f.c_str(), (st.st_mode & 07777) | S_IWUSR) != 0)
            result.Issues.push_back({platform::Severity::Error,
                                     "Cannot make " + f.filename().string() + " writable",
                                     f.filename().string(), 0});
        else
            ++result.FilesChanged;
    }
    result.Done = true;
    return result;
}

} // namespace kori::maint
