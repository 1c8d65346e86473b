#include "maint/move_files.h"

#include "maint/rem_dup_st.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list_relink.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <algorithm>

namespace kori::maint {

namespace fs = std::filesystem;
namespace mt = move_text;
using platform::Trim;

std::vector<std::string> WdtFiles(std::string_view folder) {
    std::vector<std::string> out;
    std::error_code ec;
    for (fs::directory_iterator it(fs::path(platform::FolderWithSlash(folder)), ec), end;
         !ec && it != end; it.increment(ec))
        if (it->is_regular_file(ec) &&
            platform::EqualsNoCase(it->path().extension().string(), ".wdt"))
            out.push_back(it->path().filename().string());
    std::sort(out.begin(), out.end());
    return out;
}

namespace {

constexpr std::size_t kSize = store::PriceRecord::kSize;

double DateKey(std::string_view bytes, std::size_t i) {
    return platform::Val(bytes.substr(i * kSize, 8));
}

bool SameFolder(const std::string& a, const std::string& b) {
    std::error_code ec1, ec2;
    const auto ca = fs::weakly_canonical(fs::path(a), ec1);
    const auto cb = fs::weakly_canonical(fs::path(b), ec2);
    if (ec1 || ec2) return a == b;
    return ca == cb;
}

} // namespace

std::string MergeByDate(std::string_view destinationBytes, std::string_view movedBytes) {
    const std::string a = SortRecordsByDate(destinationBytes);
    const std::string b = SortRecordsByDate(movedBytes);
    const std::size_t na = a.size() / kSize, nb = b.size() / kSize;
    std::string out;
    out.reserve(a.size() + b.size());
    std::size_t i = 0, j = 0;
    while (i < na || j < nb) {
        if (j == nb || (i < na && DateKey(a, i) < DateKey(b, j))) {
            out.append(a.substr(i++ * kSize, kSize));
        } else if (i == na || DateKey(b, j) < DateKey(a, i)) {
            out.append(b.substr(j++ * kSize, kSize));
        } else { // the same date in both: the moved record stands for it
            out.append(b.substr(j++ * kSize, kSize));
            ++i;
        }
    }
    return out;
}

RepairResult MoveFiles(std::string_view sourceIn, std::string_view destinationIn,
                       std::string_view file, platform::Dialogs& dialogs,
                       platform::Progress& progress) {
    RepairResult result;
    const std::string source = platform::FolderWithSlash(sourceIn);
    const std::string destination = platform::FolderWithSlash(destinationIn);
    if (SameFolder(source, destination)) {
        dialogs.MsgBox(mt::kSameFolder, mt::kErrorTitle);
        return result;
    }
    std::string code = Trim(file);
    if (code.size() > 4 && platform::EqualsNoCase(code.substr(code.size() - 4), ".wdt"))
        code.resize(code.size() - 4);
    code = platform::Upper(code);
    const auto from = store::PriceFile::PathFor(source, code);
    if (!store::IsValidCode(code) || !platform::FileExists(from)) {
        dialogs.MsgBox("Cannot find " + source + code + ".WDT", mt::kErrorTitle);
        return result;
    }
    for (const std::string& folder : {source, destination})
        if (!FolderWritable(folder)) {
            dialogs.MsgBox(NotWritableMessage(folder), mt::kErrorTitle);
            return result;
        }
    const auto moved = ReadFileBytes(from);
    if (!moved) {
        dialogs.MsgBox("Cannot read " + from.string(), mt::kErrorTitle);
        return result;
    }
    const std::string whole = moved->substr(0, moved->size() / kSize * kSize);

    // 1. The destination's file: the moved one, or both merged with the old copy kept.
    const auto existing = store::PriceFile::PathFor(destination, code);
    platform::Status s;
    if (platform::FileExists(existing)) {
        progress.SetStatus(mt::kMerging);
        const auto old = ReadFileBytes(existing);
        if (!old) {
            dialogs.MsgBox("Cannot read " + existing.string(), mt::kErrorTitle);
            return result;
        }
        const std::string merged = MergeByDate(old->substr(0, old->size() / kSize * kSize), whole);
        if (merged.size() / kSize > static_cast<std::size_t>(store::kMaxRecords))
            s = platform::Status::Error("The merged file would hold more than 32767 records.");
        else
            s = platform::WriteFileAtomic(existing, merged,
                                          {"Temp.TMP", Trim(store::PadCode(code)) + ".Old"});
    } else {
        s = platform::WriteFileAtomic(fs::path(destination) / (Trim(store::PadCode(code)) + ".WDT"),
                                      whole);
    }
    if (!s) {
        dialogs.MsgBox(s.message(), mt::kErrorTitle);
        return result;
    }
    result.FilesChanged = 1;

    // 2. The name record joins the destination's name file unless the code is there already.
    platform::Status why;
    const auto entry = store::FindCode(source, code, why);
    if (entry) {
        const auto there = store::FindCode(destination, code, why);
        if (!there && why) {
            store::NameFile names(store::NameFile::PathIn(destination));
            std::vector<store::NameRecord> records;
            if (platform::FileExists(names.path())) s = names.ReadAll(records);
            if (s) {
                records.push_back(entry->Record);
                s = names.WriteAll(records, {"Names.dat.new", ""});
            }
            if (!s) {
                dialogs.MsgBox(s.message(), mt::kErrorTitle);
                return result; // the source still holds file and record: nothing is lost
            }
        }
    }

    // 3. The source lets go of the file, then of the record; its lists follow the new order.
    std::error_code ec;
    fs::remove(from, ec);
    if (ec)
        result.Issues.push_back({platform::Severity::Error,
                                 "Cannot delete " + from.string() + ": " + ec.message(),
                                 from.filename().string(), 0});
    if (entry) {
        store::NameFile names(store::NameFile::PathIn(source));
        std::vector<store::NameRecord> records;
        s = names.ReadAll(records);
        if (s) {
            records.erase(records.begin() + (entry->RecordNumber - 1));
            s = names.WriteAll(records, {"Names.dat.new", ""});
        }
        if (!s)
            result.Issues.push_back(
                {platform::Severity::Error, s.message(), "Names.dat", entry->RecordNumber});
        else if (auto relink = store::RelinkChartLists(source, progress); !relink.Status)
            result.Issues.push_back({platform::Severity::Error, relink.Status.message(), "", 0});
    }
    progress.SetStatus(mt::kCompleted);
    result.Done = true;
    return result;
}

} // namespace kori::maint
