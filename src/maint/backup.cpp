#include "maint/backup.h"

#include "platform/files.h"
#include "platform/text.h"

#include <archive.h>
#include <archive_entry.h>
#include <openssl/evp.h>

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <sstream>
#include <system_error>
#include <unistd.h>

namespace kori::maint {

namespace fs = std::filesystem;
using platform::Status;

namespace {

constexpr std::string_view kPrefix = "KoriBackup-";
constexpr std::string_view kSuffix = ".tar.zst";
constexpr std::string_view kManifestHeader = "KORI backup 1";

std::string Sha256(std::string_view data) {
    unsigned char digest[EVP_MAX_MD_SIZE];
    unsigned int length = 0;
    EVP_Digest(data.data(), data.size(), digest, &length, EVP_sha256(), nullptr);
    static constexpr char kHex[] = "0123456789abcdef";
    std::string hex;
    hex.reserve(length * 2);
    for (unsigned int i = 0; i < length; ++i) {
        hex += kHex[digest[i] >> 4];
        hex += kHex[digest[i] & 15];
    }
    return hex;
}

std::string Slash(std::string folder) {
    if (!folder.empty() && folder.back() != '/') folder += '/';
    return folder;
}

std::string WithoutSlash(std::string folder) {
    while (folder.size() > 1 && folder.back() == '/')
        folder.pop_back();
    return folder;
}

// Regular files directly in a folder, by name.
std::vector<std::string> FilesIn(const std::string& folder) {
    std::vector<std::string> names;
    std::error_code ec;
    for (fs::directory_iterator it(folder, ec), end; !ec && it != end; it.increment(ec))
        if (it->is_regular_file(ec)) names.push_back(it->path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
}

struct ArchiveWriter {
    archive* a = archive_write_new();
    ~ArchiveWriter() { archive_write_free(a); }
};
struct ArchiveReader {
    archive* a = archive_read_new();
    ~ArchiveReader() { archive_read_free(a); }
};

std::string Why(archive* a) {
    const char* text = archive_error_string(a);
    return text ? text : "unknown error";
}

bool AddEntry(archive* a, const std::string& path, std::string_view data) {
    std::unique_ptr<archive_entry, void (*)(archive_entry*)> entry(archive_entry_new(),
                                                                   archive_entry_free);
    archive_entry_set_pathname(entry.get(), path.c_str());
    archive_entry_set_size(entry.get(), static_cast<la_int64_t>(data.size()));
    archive_entry_set_filetype(entry.get(), AE_IFREG);
    archive_entry_set_perm(entry.get(), 0644);
    if (archive_write_header(a, entry.get()) != ARCHIVE_OK) return false;
    return data.empty() ||
           archive_write_data(a, data.data(), data.size()) == static_cast<la_ssize_t>(data.size());
}

// One entry of a back-up as the manifest lists it.
struct Listed {
    std::string Sha;
    long long Size = 0;
    std::string Path; // "place/file"
};

struct Manifest {
    std::vector<BackupPlace> Places;
    std::vector<Listed> Files;
};

std::string ManifestText(const std::vector<BackupPlace>& places, const std::vector<Listed>& files) {
    std::string text = std::string(kManifestHeader) + "\n";
    for (const auto& p : places)
        text += "place " + p.Name + " " + p.Folder + "\n";
    for (const auto& f : files)
        text += "file " + f.Sha + " " + std::to_string(f.Size) + " " + f.Path + "\n";
    return text;
}

std::optional<Manifest> ParseManifest(std::string_view text) {
    Manifest m;
    std::istringstream in{std::string(text)};
    std::string line;
    if (!std::getline(in, line) || line != kManifestHeader) return std::nullopt;
    while (std::getline(in, line)) {
        if (line.rfind("place ", 0) == 0) {
            const auto space = line.find(' ', 6);
            if (space == std::string::npos) return std::nullopt;
            m.Places.push_back({line.substr(6, space - 6), line.substr(space + 1)});
        } else if (line.rfind("file ", 0) == 0) {
            const auto a = line.find(' ', 5);
            const auto b = a == std::string::npos ? a : line.find(' ', a + 1);
            if (b == std::string::npos) return std::nullopt;
            Listed f;
            f.Sha = line.substr(5, a - 5);
            f.Size = std::atoll(line.substr(a + 1, b - a - 1).c_str());
            f.Path = line.substr(b + 1);
            m.Files.push_back(std::move(f));
        } else if (!line.empty()) {
            return std::nullopt;
        }
    }
    return m;
}

// "place/file" split, refusing anything that could land outside its place.
bool SplitMember(const std::string& path, std::string& place, std::string& file) {
    const auto slash = path.find('/');
    if (slash == std::string::npos || slash == 0) return false;
    place = path.substr(0, slash);
    file = path.substr(slash + 1);
    return !file.empty() && file.find('/') == std::string::npos && file != "." && file != "..";
}

// Every entry of an archive in order, given to `visit(path, data)`; stops at the first
// refusal. A damaged archive names the entry it was reading.
Status ReadEntries(const std::string& archivePath, platform::Progress& progress,
                   const std::function<Status(const std::string&, const std::string&)>& visit,
                   bool& cancelled) {
    ArchiveReader r;
    archive_read_support_filter_all(r.a);
    archive_read_support_format_tar(r.a);
    if (archive_read_open_filename(r.a, archivePath.c_str(), 1 << 20) != ARCHIVE_OK)
        return Status::Error("Cannot open the back-up " + archivePath + ": " + Why(r.a));
    archive_entry* entry = nullptr;
    std::string data;
    std::string previous = "its start";
    long long done = 0;
    for (;;) {
        const int header = archive_read_next_header(r.a, &entry);
        if (header == ARCHIVE_EOF) break;
        if (header != ARCHIVE_OK)
            return Status::Error("The back-up is damaged after " + previous + ": " + Why(r.a));
        const std::string path = archive_entry_pathname(entry) ? archive_entry_pathname(entry) : "";
        const la_int64_t size = archive_entry_size(entry);
        if (size < 0 || size > (la_int64_t{1} << 31))
            return Status::Error("The back-up is damaged at " + path + ": impossible size");
        data.resize(static_cast<std::size_t>(size));
        la_ssize_t got = 0;
        while (got < size) {
            const la_ssize_t n =
                archive_read_data(r.a, data.data() + got, static_cast<std::size_t>(size - got));
            if (n <= 0)
                return Status::Error("The back-up is damaged at " + path + ": " +
                                     (n < 0 ? Why(r.a) : std::string("the file is cut short")));
            got += n;
        }
        if (auto s = visit(path, data); !s) return s;
        previous = path;
        progress.SetValue(++done);
        progress.Yield();
        if (progress.Cancelled()) {
            cancelled = true;
            return Status::Ok();
        }
    }
    return Status::Ok();
}

void SyncPath(const fs::path& path) {
    if (FILE* f = std::fopen(path.c_str(), "rb")) {
        fsync(fileno(f));
        std::fclose(f);
    }
}

} // namespace

std::vector<BackupPlace> LibraryPlaces(std::string_view installRoot,
                                       const std::vector<std::string>& folders) {
    std::vector<BackupPlace> places;
    std::set<std::string> seen;
    const std::string root = Slash(platform::NormalisePath(installRoot));
    places.push_back({"root", root});
    seen.insert(root);
    int n = 0;
    for (const auto& f : folders) {
        if (f.empty()) continue;
        const std::string folder = Slash(platform::NormalisePath(f));
        std::error_code ec;
        if (!seen.insert(folder).second || !fs::is_directory(folder, ec)) continue;
        places.push_back({"place" + std::to_string(++n), folder});
    }
    return places;
}

std::string BackupFileName(std::string_view stamp) {
    return std::string(kPrefix) + std::string(stamp) + std::string(kSuffix);
}

std::vector<std::string> ListBackups(std::string_view backupFolder) {
    std::vector<std::string> found;
    for (const auto& name : FilesIn(std::string(backupFolder)))
        if (name.rfind(kPrefix, 0) == 0 && name.size() > kSuffix.size() &&
            name.compare(name.size() - kSuffix.size(), kSuffix.size(), kSuffix) == 0)
            found.push_back(name);
    std::sort(found.rbegin(), found.rend());
    return found;
}

BackupResult WriteBackup(const std::vector<BackupPlace>& places, const std::string& archivePath,
                         platform::Progress& progress, const std::string& backupFolder, int keep) {
    BackupResult result;
    result.File = archivePath;
    std::vector<std::pair<const BackupPlace*, std::string>> files;
    for (const auto& place : places)
        for (const auto& name : FilesIn(place.Folder))
            files.emplace_back(&place, name);
    const std::string part = archivePath + ".part";
    {
        ArchiveWriter w;
        archive_write_set_format_pax_restricted(w.a);
        if (archive_write_add_filter_zstd(w.a) != ARCHIVE_OK) {
            result.Status = Status::Error("This system cannot write compressed archives");
            return result;
        }
        archive_write_set_filter_option(w.a, "zstd", "compression-level", "1");
        if (archive_write_open_filename(w.a, part.c_str()) != ARCHIVE_OK) {
            result.Status = Status::Error("Cannot write " + part + ": " + Why(w.a));
            return result;
        }
        progress.SetStatus("Backing up");
        progress.SetRange(static_cast<long long>(files.size()));
        std::vector<Listed> listed;
        listed.reserve(files.size());
        for (const auto& [place, name] : files) {
            const std::string from = place->Folder + name;
            if (from == part || from == archivePath) continue;
            const auto data = platform::ReadWholeFile(from);
            if (!data) {
                result.Status = Status::Error("Cannot read " + from);
                break;
            }
            Listed entry{Sha256(*data), static_cast<long long>(data->size()),
                         place->Name + "/" + name};
            if (!AddEntry(w.a, entry.Path, *data)) {
                result.Status = Status::Error("Cannot write " + part + ": " + Why(w.a));
                break;
            }
            result.Bytes += entry.Size;
            listed.push_back(std::move(entry));
            progress.SetValue(static_cast<long long>(listed.size()));
            progress.Yield();
            if (progress.Cancelled()) {
                result.Cancelled = true;
                break;
            }
        }
        if (result.Status && !result.Cancelled &&
            !AddEntry(w.a, std::string(kBackupManifest), ManifestText(places, listed)))
            result.Status = Status::Error("Cannot write " + part + ": " + Why(w.a));
        if (result.Status && !result.Cancelled && archive_write_close(w.a) != ARCHIVE_OK)
            result.Status = Status::Error("Cannot write " + part + ": " + Why(w.a));
        result.Files = static_cast<int>(listed.size());
    }
    std::error_code ec;
    if (!result.Status || result.Cancelled) {
        fs::remove(part, ec);
        result.Files = 0;
        return result;
    }
    SyncPath(part);
    fs::rename(part, archivePath, ec);
    if (ec) {
        fs::remove(part, ec);
        result.Status = Status::Error("Cannot write " + archivePath);
        return result;
    }
    if (!backupFolder.empty() && keep > 0) {
        const auto all = ListBackups(backupFolder);
        for (std::size_t i = static_cast<std::size_t>(keep); i < all.size(); ++i) {
            if (fs::remove(Slash(backupFolder) + all[i], ec)) result.Discarded.push_back(all[i]);
        }
    }
    return result;
}

RestorePlan VerifyBackup(const std::string& archivePath, platform::Progress& progress) {
    RestorePlan plan;
    std::vector<Listed> seen;
    std::optional<Manifest> manifest;
    progress.SetStatus("Checking the back-up");
    const auto status = ReadEntries(
        archivePath, progress,
        [&](const std::string& path, const std::string& data) {
            if (path == kBackupManifest) {
                manifest = ParseManifest(data);
                if (!manifest) return Status::Error("The back-up's manifest cannot be read");
                return Status::Ok();
            }
            std::string place, file;
            if (!SplitMember(path, place, file))
                return Status::Error("The back-up holds a file it should not: " + path);
            seen.push_back({Sha256(data), static_cast<long long>(data.size()), path});
            return Status::Ok();
        },
        plan.Cancelled);
    if (!status || plan.Cancelled) {
        plan.Status = status;
        return plan;
    }
    if (!manifest) {
        plan.Status =
            Status::Error("The back-up has no manifest: it is cut short or not a back-up");
        return plan;
    }
    std::map<std::string, const Listed*> byPath;
    for (const auto& f : manifest->Files)
        byPath[f.Path] = &f;
    std::set<std::string> places;
    for (const auto& p : manifest->Places)
        places.insert(p.Name);
    for (const auto& f : seen) {
        const auto it = byPath.find(f.Path);
        std::string place, file;
        SplitMember(f.Path, place, file);
        if (it == byPath.end() || places.count(place) == 0) {
            plan.Status =
                Status::Error("The back-up holds a file its manifest does not: " + f.Path);
            return plan;
        }
        if (it->second->Sha != f.Sha || it->second->Size != f.Size) {
            plan.Status =
                Status::Error("The back-up is damaged: " + f.Path + " does not match its checksum");
            return plan;
        }
        byPath.erase(it);
    }
    if (!byPath.empty()) {
        plan.Status = Status::Error("The back-up is missing " + byPath.begin()->first);
        return plan;
    }
    plan.Places = manifest->Places;
    plan.Files = static_cast<int>(seen.size());
    return plan;
}

namespace {

// Where a place's restored files are written first, and where the replaced ones are kept.
std::string Staging(const BackupPlace& p) {
    return p.Name == "root" ? p.Folder + "restoring-root/" : WithoutSlash(p.Folder) + ".restoring/";
}
std::string Kept(const BackupPlace& p, const std::string& stamp) {
    return p.Name == "root" ? p.Folder + "replaced-" + stamp + "/"
                            : WithoutSlash(p.Folder) + ".replaced-" + stamp + "/";
}

void RemoveStaging(const std::vector<BackupPlace>& places) {
    std::error_code ec;
    for (const auto& p : places)
        fs::remove_all(Staging(p), ec);
}

// Puts a staged place in: the root's files one by one (its folder holds the others), every
// other place as a whole folder.
Status SwapIn(const BackupPlace& p, const std::string& stamp) {
    std::error_code ec;
    const std::string kept = Kept(p, stamp);
    if (p.Name != "root") {
        if (fs::exists(WithoutSlash(p.Folder), ec)) {
            fs::rename(WithoutSlash(p.Folder), WithoutSlash(kept), ec);
            if (ec) return Status::Error("Cannot move " + p.Folder + " aside: " + ec.message());
        }
        fs::rename(WithoutSlash(Staging(p)), WithoutSlash(p.Folder), ec);
        if (ec) {
            std::error_code back;
            fs::rename(WithoutSlash(kept), WithoutSlash(p.Folder), back);
            return Status::Error("Cannot put " + p.Folder + " in place: " + ec.message());
        }
        return Status::Ok();
    }
    fs::create_directories(kept, ec);
    for (const auto& name : FilesIn(p.Folder)) {
        fs::rename(p.Folder + name, kept + name, ec);
        if (ec) return Status::Error("Cannot move " + p.Folder + name + " aside");
    }
    for (const auto& name : FilesIn(Staging(p))) {
        fs::rename(Staging(p) + name, p.Folder + name, ec);
        if (ec) return Status::Error("Cannot put " + p.Folder + name + " in place");
    }
    fs::remove_all(Staging(p), ec);
    return Status::Ok();
}

} // namespace

RestoreResult RestoreBackup(const std::string& archivePath, platform::Progress& progress,
                            const std::string& stamp, const std::vector<std::string>& remap) {
    RestoreResult result;
    auto plan = VerifyBackup(archivePath, progress);
    if (!plan.Status || plan.Cancelled) {
        result.Status = plan.Status;
        result.Cancelled = plan.Cancelled;
        return result;
    }
    for (std::size_t i = 0; i < plan.Places.size() && i < remap.size(); ++i)
        if (!remap[i].empty()) plan.Places[i].Folder = Slash(platform::NormalisePath(remap[i]));
    std::map<std::string, const BackupPlace*> byName;
    for (const auto& p : plan.Places)
        byName[p.Name] = &p;

    RemoveStaging(plan.Places);
    std::error_code ec;
    for (const auto& p : plan.Places) {
        fs::create_directories(Staging(p), ec);
        if (ec) {
            result.Status = Status::Error("Cannot make " + Staging(p) + ": " + ec.message());
            RemoveStaging(plan.Places);
            return result;
        }
    }
    progress.SetStatus("Restoring");
    progress.SetRange(plan.Files + 1);
    {
        platform::ScopedSyncDeferral deferral(plan.Places.front().Folder);
        const auto status = ReadEntries(
            archivePath, progress,
            [&](const std::string& path, const std::string& data) {
                if (path == kBackupManifest) return Status::Ok();
                std::string place, file;
                SplitMember(path, place, file);
                const auto* p = byName.at(place);
                if (auto s = platform::WriteFileAtomic(Staging(*p) + file, data); !s) return s;
                ++result.Files;
                return Status::Ok();
            },
            result.Cancelled);
        if (!status || result.Cancelled || result.Files != plan.Files) {
            result.Status = status ? (result.Cancelled ? Status::Ok()
                                                       : Status::Error("The back-up changed while "
                                                                       "it was being restored"))
                                   : status;
            result.Files = 0;
            RemoveStaging(plan.Places);
            return result;
        }
    }
    for (const auto& p : plan.Places) {
        if (auto s = SwapIn(p, stamp); !s) {
            result.Status = s;
            return result;
        }
        result.Replaced.push_back(Kept(p, stamp));
    }
    return result;
}

std::vector<std::string> ReplacedCopies(const std::vector<BackupPlace>& places) {
    std::set<std::string> copies;
    std::error_code ec;
    for (const auto& p : places) {
        const bool root = p.Name == "root";
        const fs::path parent =
            root ? fs::path(p.Folder) : fs::path(WithoutSlash(p.Folder)).parent_path();
        const std::string prefix =
            root ? std::string("replaced-")
                 : fs::path(WithoutSlash(p.Folder)).filename().string() + ".replaced-";
        for (fs::directory_iterator it(parent, ec), end; !ec && it != end; it.increment(ec))
            if (it->is_directory(ec) && it->path().filename().string().rfind(prefix, 0) == 0)
                copies.insert(Slash(it->path().string()));
    }
    return {copies.begin(), copies.end()};
}

Status DiscardReplaced(const std::vector<std::string>& copies) {
    for (const auto& c : copies) {
        std::error_code ec;
        fs::remove_all(c, ec);
        if (ec) return Status::Error("Cannot remove " + c + ": " + ec.message());
    }
    return Status::Ok();
}

} // namespace kori::maint
