#include "platform/files.h"

#include "platform/text.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <fstream>
#include <sstream>
#include <system_error>
#include <unistd.h>

namespace kori::platform {

namespace {
long long g_failAfterBytes = -1;

bool WriteAll(int fd, const char* data, std::size_t size) {
    while (size > 0) {
        const ssize_t n = ::write(fd, data, size);
        if (n < 0) {
            if (errno == EINTR) continue;
            return false;
        }
        data += n;
        size -= static_cast<std::size_t>(n);
    }
    return true;
}
} // namespace

std::string NormalisePath(std::string_view path) {
    std::string r(path);
    for (auto& c : r)
        if (c == '\\') c = '/';
    return r;
}

std::string FolderWithSlash(std::string_view folder) {
    std::string r = NormalisePath(Trim(folder));
    if (!r.empty() && r.back() != '/') r += '/';
    return r;
}

fs::path ResolvePath(const fs::path& path) {
    fs::path p(NormalisePath(path.string()));
    std::error_code ec;
    if (fs::exists(p, ec)) return p;
    const fs::path dir = p.has_parent_path() ? p.parent_path() : fs::path(".");
    const std::string name = p.filename().string();
    if (name.empty()) return p;
    fs::path resolvedDir = dir;
    if (!fs::exists(dir, ec) && dir != p) resolvedDir = ResolvePath(dir);
    for (fs::directory_iterator it(resolvedDir, ec), end; !ec && it != end; it.increment(ec)) {
        if (EqualsNoCase(it->path().filename().string(), name)) return it->path();
    }
    return resolvedDir / name;
}

fs::path ResolveIn(std::string_view folder, std::string_view name) {
    return ResolvePath(fs::path(FolderWithSlash(folder) + NormalisePath(name)));
}

bool FileExists(const fs::path& path) {
    std::string s = NormalisePath(path.string());
    while (s.size() > 1 && s.back() == '/')
        s.pop_back();
    if (s.empty()) return false;
    std::error_code ec;
    return fs::exists(ResolvePath(s), ec);
}

std::uintmax_t FileSizeOr0(const fs::path& path) {
    std::error_code ec;
    const fs::path p = ResolvePath(path);
    if (!fs::is_regular_file(p, ec)) return 0;
    const auto size = fs::file_size(p, ec);
    return ec ? 0 : size;
}

bool FileHasData(const fs::path& path) {
    return FileSizeOr0(path) > 0;
}

std::optional<std::string> ReadWholeFile(const fs::path& path) {
    std::ifstream in(ResolvePath(path), std::ios::binary);
    if (!in) return std::nullopt;
    std::ostringstream ss;
    ss << in.rdbuf();
    return ss.str();
}

void SetWriteFailureAfterBytesForTesting(long long bytes) {
    g_failAfterBytes = bytes;
}

Status WriteFileAtomic(const fs::path& path, std::string_view content) {
    const fs::path target = ResolvePath(path);
    fs::path tmp = target;
    tmp += ".kori-new";
    const int fd = ::open(tmp.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
    if (fd < 0)
        return Status::Error("Cannot write " + target.string() + ": " + std::strerror(errno));
    std::size_t limit = content.size();
    const bool injectFailure =
        g_failAfterBytes >= 0 && static_cast<std::size_t>(g_failAfterBytes) < content.size();
    if (injectFailure) limit = static_cast<std::size_t>(g_failAfterBytes);
    bool ok = WriteAll(fd, content.data(), limit) && !injectFailure;
    ok = ok && ::fsync(fd) == 0;
    const int savedErrno = errno;
    ::close(fd);
    if (!ok) {
        std::error_code ec;
        fs::remove(tmp, ec);
        return Status::Error("Cannot write " + target.string() + ": " +
                             (injectFailure ? "write failed" : std::strerror(savedErrno)));
    }
    std::error_code ec;
    fs::rename(tmp, target, ec);
    if (ec) {
        fs::remove(tmp, ec);
        return Status::Error("Cannot replace " + target.string() + ": " + ec.message());
    }
    return Status::Ok();
}

Status AppendToFile(const fs::path& path, std::string_view bytes) {
    const fs::path target = ResolvePath(path);
    const int fd = ::open(target.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    if (fd < 0)
        return Status::Error("Cannot write " + target.string() + ": " + std::strerror(errno));
    const bool ok = WriteAll(fd, bytes.data(), bytes.size());
    const int savedErrno = errno;
    ::close(fd);
    if (!ok)
        return Status::Error("Cannot write " + target.string() + ": " + std::strerror(savedErrno));
    return Status::Ok();
}

bool CreateFolder(const fs::path& folder) {
    std::error_code ec;
    fs::create_directories(fs::path(NormalisePath(folder.string())), ec);
    return !ec;
}

} // namespace kori::platform
