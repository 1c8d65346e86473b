#include "platform/files.h"

#include "platform/text.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <fstream>
#include <linux/fs.h>
#include <optional>
#include <sstream>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

namespace kori::platform {

namespace {
long long g_failAfterBytes = -1;
long long g_writeBudget = -1; // -1: no budget
long long g_writeUsed = 0;
bool g_deferSync = false;

// How many of `size` bytes a write may put down under the injected faults.
std::size_t AllowedBytes(std::size_t size) {
    std::size_t limit = size;
    if (g_failAfterBytes >= 0 && static_cast<std::size_t>(g_failAfterBytes) < limit)
        limit = static_cast<std::size_t>(g_failAfterBytes);
    if (g_writeBudget >= 0) {
        const long long left = std::max(0LL, g_writeBudget - g_writeUsed);
        if (static_cast<std::size_t>(left) < limit) limit = static_cast<std::size_t>(left);
    }
    return limit;
}

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
    // One read of the size the file has; a file that grows meanwhile gives the rest below.
    in.seekg(0, std::ios::end);
    const auto size = in.tellg();
    in.seekg(0, std::ios::beg);
    std::string bytes;
    if (size > 0) {
        bytes.resize(static_cast<std::size_t>(size));
        in.read(bytes.data(), static_cast<std::streamsize>(size));
        bytes.resize(static_cast<std::size_t>(in.gcount()));
        if (in.gcount() < static_cast<std::streamsize>(size)) return bytes;
    }
    in.clear();
    std::ostringstream rest;
    rest << in.rdbuf();
    bytes += rest.str();
    return bytes;
}

ScopedWriteFailure::ScopedWriteFailure(long long bytes) : m_previous(g_failAfterBytes) {
    g_failAfterBytes = bytes;
}

ScopedWriteFailure::~ScopedWriteFailure() {
    g_failAfterBytes = m_previous;
}

ScopedWriteBudget::ScopedWriteBudget(long long bytes)
    : m_previousBudget(g_writeBudget), m_previousUsed(g_writeUsed) {
    g_writeBudget = bytes;
    g_writeUsed = 0;
}

ScopedWriteBudget::~ScopedWriteBudget() {
    g_writeBudget = m_previousBudget;
    g_writeUsed = m_previousUsed;
}

long long ScopedWriteBudget::Used() {
    return g_writeUsed;
}

ScopedSyncDeferral::ScopedSyncDeferral(const fs::path& anyFileOnTheFileSystem, bool syncAtEnd)
    : m_folder(anyFileOnTheFileSystem), m_syncAtEnd(syncAtEnd), m_previous(g_deferSync) {
    g_deferSync = true;
}

ScopedSyncDeferral::~ScopedSyncDeferral() {
    g_deferSync = m_previous;
    if (m_previous || !m_syncAtEnd) return;
    const int fd = ::open(m_folder.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) {
        ::sync();
        return;
    }
    (void)::syncfs(fd);
    ::close(fd);
}

namespace {

// The file a path names once symbolic links are followed; a dangling link names the place
// its target will be made.
fs::path FollowLinks(fs::path p) {
    std::error_code ec;
    for (int hops = 0; hops < 40 && fs::is_symlink(fs::symlink_status(p, ec)); ++hops) {
        const fs::path to = fs::read_symlink(p, ec);
        if (ec) break;
        p = to.is_absolute() ? to : p.parent_path() / to;
    }
    return p;
}

std::string Cannot(const fs::path& target, std::string_view why) {
    return "Cannot write " + target.string() + ": " + std::string(why);
}

// An existing target must be a plain file we may write; nullopt when it may be replaced.
std::optional<std::string> RefusalFor(const fs::path& target, bool& exists, mode_t& mode) {
    struct stat st {};
    exists = ::stat(target.c_str(), &st) == 0;
    if (!exists)
        return errno == ENOENT ? std::nullopt : std::optional(Cannot(target, std::strerror(errno)));
    if (!S_ISREG(st.st_mode)) return Cannot(target, "it is not a plain file");
    if ((st.st_mode & S_IWUSR) == 0 || ::access(target.c_str(), W_OK) != 0)
        return Cannot(target, "the file is read-only");
    mode = st.st_mode & 07777;
    return std::nullopt;
}

// Creates a file no other writer shares: `<folder>/<stem>.<pid>-<n>`, opened exclusively.
int CreateUnique(const fs::path& folder, const std::string& stem, fs::path& made) {
    static unsigned counter = 0;
    for (int tries = 0; tries < 100; ++tries) {
        made = folder / (stem + "." + std::to_string(::getpid()) + "-" + std::to_string(++counter));
        const int fd = ::open(made.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (fd >= 0 || errno != EEXIST) return fd;
    }
    return -1;
}

Status WriteAndSync(int fd, std::string_view content, const fs::path& target) {
    const std::size_t limit = AllowedBytes(content.size());
    const bool inject = limit < content.size();
    if (!WriteAll(fd, content.data(), limit))
        return Status::Error(Cannot(target, std::strerror(errno)));
    g_writeUsed += static_cast<long long>(limit);
    if (inject) return Status::Error(Cannot(target, "write failed"));
    if (!g_deferSync && ::fsync(fd) != 0)
        return Status::Error(Cannot(target, std::strerror(errno)));
    return Status::Ok();
}

bool SyncFolder(const fs::path& folder) {
    const int fd = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (fd < 0) return false;
    const bool ok = ::fsync(fd) == 0;
    ::close(fd);
    return ok;
}

// Writes `content` under a unique scratch name in `folder`, synced to disk, with the mode of the
// file it will replace; the caller renames it.
Status WriteScratch(const fs::path& folder, const std::string& stem, std::string_view content,
                    mode_t mode, const fs::path& target, fs::path& scratch) {
    const int fd = CreateUnique(folder, stem, scratch);
    if (fd < 0) return Status::Error(Cannot(target, std::strerror(errno)));
    if (mode != 0) (void)::fchmod(fd, mode); // 0: a new file, made as the umask says
    Status s = WriteAndSync(fd, content, target);
    if (::close(fd) != 0 && s) s = Status::Error(Cannot(target, std::strerror(errno)));
    if (!s) {
        std::error_code ec;
        fs::remove(scratch, ec);
    }
    return s;
}

Status RenameOver(const fs::path& from, const fs::path& to, const fs::path& target) {
    if (::rename(from.c_str(), to.c_str()) == 0) return Status::Ok();
    const Status s =
        Status::Error("Cannot replace " + target.string() + ": " + std::strerror(errno));
    std::error_code ec;
    fs::remove(from, ec);
    return s;
}

} // namespace

Status WriteFileAtomic(const fs::path& path, std::string_view content, const ScratchNames& names) {
    const fs::path target = FollowLinks(ResolvePath(path));
    bool exists = false;
    mode_t mode = 0;
    if (auto refusal = RefusalFor(target, exists, mode)) return Status::Error(*refusal);
    const fs::path folder = target.has_parent_path() ? target.parent_path() : fs::path(".");
    const std::string stem =
        names.Scratch.empty() ? target.filename().string() + ".kori-new" : names.Scratch;
    fs::path scratch;
    if (auto s = WriteScratch(folder, stem, content, mode, target, scratch); !s) return s;
    if (exists && !names.Backup.empty()) {
        // The old content goes to the back-up first, through its own scratch file.
        const auto old = ReadWholeFile(target);
        fs::path backupScratch;
        Status s = old ? WriteScratch(folder, names.Backup, *old, mode, target, backupScratch)
                       : Status::Error(Cannot(target, "cannot read the old file"));
        if (s) s = RenameOver(backupScratch, ResolvePath(folder / names.Backup), target);
        if (!s) {
            std::error_code ec;
            fs::remove(scratch, ec);
            return s;
        }
    }
    if (auto s = RenameOver(scratch, target, target); !s) return s;
    if (!g_deferSync && !SyncFolder(folder))
        return Status::Error(Cannot(target, "the folder could not be synced"));
    return Status::Ok();
}

namespace {

// The first `keep` bytes of `in` into the empty `out`. Whole blocks are shared with the old
// file where the file system can clone a range (no data written); the rest, or all of it where
// it cannot, is copied with plain reads and writes (an in-kernel copy is no faster there).
bool CopyPrefix(int in, int out, std::uint64_t keep, std::uint64_t blockSize) {
    std::uint64_t done = 0;
    if (const std::uint64_t whole = keep / blockSize * blockSize; whole > 0) {
        file_clone_range range{};
        range.src_fd = in;
        range.src_length = whole;
        if (::ioctl(out, FICLONERANGE, &range) == 0) done = whole;
    }
    std::string buffer(std::size_t{1} << 16, '\0');
    while (done < keep) {
        const auto chunk =
            static_cast<std::size_t>(std::min<std::uint64_t>(keep - done, buffer.size()));
        const auto at = static_cast<off_t>(done);
        const ssize_t n = ::pread(in, buffer.data(), chunk, at);
        if (n <= 0 || ::pwrite(out, buffer.data(), static_cast<std::size_t>(n), at) != n)
            return false;
        done += static_cast<std::uint64_t>(n);
    }
    return true;
}

} // namespace

Status ReplaceFileFrom(const fs::path& path, std::uint64_t keep, std::string_view tail) {
    const fs::path target = FollowLinks(ResolvePath(path));
    bool exists = false;
    mode_t mode = 0;
    if (auto refusal = RefusalFor(target, exists, mode)) return Status::Error(*refusal);
    if (!exists) return WriteFileAtomic(path, tail); // nothing to keep
    const int in = ::open(target.c_str(), O_RDONLY | O_CLOEXEC);
    if (in < 0) return Status::Error(Cannot(target, std::strerror(errno)));
    struct stat st {};
    if (::fstat(in, &st) != 0 || static_cast<std::uint64_t>(st.st_size) < keep) {
        ::close(in);
        return Status::Error(Cannot(target, "the file is shorter than the part to keep"));
    }
    const fs::path folder = target.has_parent_path() ? target.parent_path() : fs::path(".");
    fs::path scratch;
    const int out = CreateUnique(folder, target.filename().string() + ".kori-new", scratch);
    if (out < 0) {
        ::close(in);
        return Status::Error(Cannot(target, std::strerror(errno)));
    }
    (void)::fchmod(out, mode);
    // A failure injected by the tests counts the kept bytes as written content too.
    const std::size_t total = static_cast<std::size_t>(keep) + tail.size();
    const std::size_t limit = AllowedBytes(total);
    Status s;
    const auto blockSize = static_cast<std::uint64_t>(st.st_blksize > 0 ? st.st_blksize : 4096);
    if (!CopyPrefix(in, out, std::min<std::uint64_t>(keep, limit), blockSize))
        s = Status::Error(Cannot(target, std::strerror(errno)));
    const std::size_t tailLimit = limit > keep ? limit - static_cast<std::size_t>(keep) : 0;
    if (s && (::lseek(out, static_cast<off_t>(keep), SEEK_SET) < 0 ||
              !WriteAll(out, tail.data(), std::min(tail.size(), tailLimit))))
        s = Status::Error(Cannot(target, std::strerror(errno)));
    if (s) g_writeUsed += static_cast<long long>(std::min(total, limit));
    if (s && limit < total) s = Status::Error(Cannot(target, "write failed"));
    if (s && !g_deferSync && ::fsync(out) != 0)
        s = Status::Error(Cannot(target, std::strerror(errno)));
    ::close(in);
    if (::close(out) != 0 && s) s = Status::Error(Cannot(target, std::strerror(errno)));
    if (!s) {
        std::error_code ec;
        fs::remove(scratch, ec);
        return s;
    }
    if (auto r = RenameOver(scratch, target, target); !r) return r;
    if (!g_deferSync && !SyncFolder(folder))
        return Status::Error(Cannot(target, "the folder could not be synced"));
    return Status::Ok();
}

Status AppendToFile(const fs::path& path, std::string_view bytes) {
    const fs::path target = ResolvePath(path);
    const int fd = ::open(target.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    if (fd < 0)
        return Status::Error("Cannot write " + target.string() + ": " + std::strerror(errno));
    const bool inject = AllowedBytes(bytes.size()) < bytes.size();
    // An injected failure writes nothing: an append is one record, whole or not at all.
    const bool ok = !inject && WriteAll(fd, bytes.data(), bytes.size());
    if (ok) g_writeUsed += static_cast<long long>(bytes.size());
    const int savedErrno = inject ? EIO : errno;
    if (::close(fd) != 0 && ok)
        return Status::Error("Cannot write " + target.string() + ": " + std::strerror(errno));
    if (!ok)
        return Status::Error("Cannot write " + target.string() + ": " + std::strerror(savedErrno));
    return Status::Ok();
}

bool CreateFolder(const fs::path& folder) {
    std::string s = NormalisePath(folder.string());
    while (s.size() > 1 && s.back() == '/')
        s.pop_back();
    const fs::path p(s);
    std::error_code ec;
    if (fs::is_directory(p, ec)) return true;
    const fs::path parent = p.has_parent_path() ? p.parent_path() : fs::path(".");
    if (!fs::is_directory(parent, ec)) return false;
    return fs::create_directory(p, ec) || fs::is_directory(p, ec);
}

bool CreateFolderPath(const fs::path& folder) {
    std::error_code ec;
    fs::create_directories(fs::path(NormalisePath(folder.string())), ec);
    return !ec;
}

} // namespace kori::platform
