#include "maint/security_details.h"

#include "platform/csv_line.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <algorithm>
#include <array>
#include <fcntl.h>
#include <unistd.h>

namespace kori::maint {

using platform::Status;
using platform::Trim;
using platform::TrimRight;
using platform::Upper;

namespace {

struct KeyLabel {
    std::string_view Key, Label;
};

constexpr std::array<KeyLabel, 30> kLabels = {{
    {"SHORTDESCRIPTION", "Description"},
    {"SECURITYTYPE", "Type"},
    {"FIRSTACTIVEDATE", "First Active"},
    {"FIRSTQUOTEDDATE", "First Quoted"},
    {"LASTQUOTEDATE", "Last Quoted"},
    {"SUSPENSIONSTARTDATE", "Suspension Start"},
    {"SUSPENSIONENDDATE", "Suspension End"},
    {"TOTALCLASSISSUE", "Total Issued"},
    {"PARVALUE", "Par Value"},
    {"PAIDUPVALUE", "Paid Value"},
    {"ASSETBACKING", "Asset backing"},
    {"DIVENDRATEPERSHARE", "DPS"},
    {"DIVIDENDSPAIDMONTHS", "Div. Mths"},
    {"CURRENTDIVIDENDAMOUNT", "Current Div"},
    {"ANNUALDIVIDENDRATE", "Annual Dividend"},
    {"DIVIDENTTYPE", "Div. Type"},
    {"DIVIDENDPAYABLEDATE", "Div. Payable  "},
    {"EXDATE", "Ex Div Date"},
    {"FRANKINGPERCENT", "Franking %"},
    {"CLASSAFRANKEDAMOUNT", "Class A Franked $"},
    {"CLASSBFRANKEDAMOUNT", "Class B Franked $"},
    {"CLASSCFRANKEDAMOUNT", "Class C Franked $"},
    {"GROSSDIVIDENDAMOUNT", "Gross Div."},
    {"MINAPPLICATIONMONEY", "Min. Applic.Money"},
    {"MAXAPPLICATIONMONEY", "Max Applic. Money"},
    {"APPLICATIONCLOSEDATE", "Applic.Close"},
    {"QUOTEDSECURITYINDICATOR", "Security Ind."},
    {"STAMPDUTYINDICATOR", "Stamp Duty Ind."},
    {"SHORTSELLINDICATOR", "Short Sell Ind."},
    {"PARIPASSUINDICATOR", "Pari Passu Ind."},
}};

constexpr std::array<KeyLabel, 4> kLondonLabels = {{
    {"LONGNAME", "Name"},
    {"ZEVOTSECURITYTYPE", "Type"},
    {"ZEVOTSECTORNAME", "Sector"},
    {"ZEVOTSUBSECTORNAME", "Sub-Sector"},
}};

constexpr const char* kIndexName = "Sdix1.inx";

// "PRN" cannot be a file name and is stored as "PRNX" everywhere.
std::string StoredCode(std::string_view code) {
    std::string c = Upper(Trim(code));
    if (c == "PRN") c = "PRNX";
    return c;
}

std::vector<std::string_view> Lines(std::string_view text) {
    std::vector<std::string_view> lines;
    std::size_t start = 0;
    while (start < text.size()) {
        std::size_t end = text.find('\n', start);
        if (end == std::string_view::npos) end = text.size();
        std::string_view line = text.substr(start, end - start);
        if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
        lines.push_back(line);
        start = end + 1;
    }
    return lines;
}

std::string Record(std::string_view line) {
    const auto comma = line.find(',');
    const std::string_view code = line.substr(0, comma);
    const std::string_view rest =
        comma == std::string_view::npos ? std::string_view() : line.substr(comma + 1);
    std::string record =
        platform::PadRight(StoredCode(code).substr(0, kDetailsCodeWidth), kDetailsCodeWidth);
    record += platform::PadRight(rest.substr(0, kDetailsRecord - kDetailsCodeWidth),
                                 kDetailsRecord - kDetailsCodeWidth);
    return record;
}

RefreshResult Refresh(const DetailsFiles& files, const std::string& systemFolder,
                      const std::string& inFolder, bool london) {
    RefreshResult result;
    if (systemFolder.empty() || inFolder.empty()) return result;
    const auto sourcePath = platform::ResolveIn(inFolder, files.Source);
    const auto source = platform::ReadWholeFile(sourcePath);
    if (!source) return result; // nothing waiting: the normal case
    result.Loaded = true;
    const auto lines = Lines(*source);
    const std::string headerLine = lines.empty() ? std::string() : std::string(lines[0]);

    // The keys split at every comma, as many as the commas say, each given its label.
    std::string labels;
    std::size_t start = 0;
    for (bool first = true;; first = false) {
        const auto comma = headerLine.find(',', start);
        if (!first) labels += ',';
        labels += DetailsLabel(std::string_view(headerLine).substr(start, comma - start), london);
        if (comma == std::string::npos) break;
        start = comma + 1;
    }
    if (auto s = platform::WriteFileAtomic(platform::ResolveIn(systemFolder, files.Header),
                                           headerLine + "\r\n" + labels + "\r\n");
        !s) {
        result.Status = s;
        return result;
    }

    std::vector<std::string> records;
    for (std::size_t i = 1; i < lines.size(); ++i)
        records.push_back(Record(lines[i]));
    // Sorted by code, blank codes dropped; a file of fewer than 2 records is left as it is.
    if (records.size() >= 2) {
        std::erase_if(records, [](const std::string& r) {
            return Trim(std::string_view(r).substr(0, kDetailsCodeWidth)).empty();
        });
        std::stable_sort(records.begin(), records.end(),
                         [](const std::string& a, const std::string& b) {
                             return a.compare(0, kDetailsCodeWidth, b, 0, kDetailsCodeWidth) < 0;
                         });
    }
    std::string bytes;
    bytes.reserve(records.size() * kDetailsRecord);
    for (const auto& r : records)
        bytes += r;
    if (auto s = platform::WriteFileAtomic(platform::ResolveIn(systemFolder, files.Records), bytes,
                                           {"TEMP.Tmp", ""});
        !s) {
        result.Status = s;
        return result;
    }
    result.Records = static_cast<int>(records.size());

    // The source goes to its back-up name only once its records are safe.
    const auto backup = platform::ResolveIn(inFolder, files.Backup);
    std::error_code ec;
    std::filesystem::remove(backup, ec);
    std::filesystem::rename(sourcePath, backup, ec);
    if (ec) {
        result.Status = Status::Error("Cannot rename " + sourcePath.string() + ": " + ec.message());
        return result;
    }

    if (!files.Index) return result;
    std::string index;
    char letter = 0;
    for (std::size_t i = 0; i < records.size(); ++i) {
        if (records[i][0] == letter) continue;
        letter = records[i][0];
        index += std::string(1, letter) + "," + std::to_string(i + 1) + "\r\n";
    }
    result.Status = platform::WriteFileAtomic(platform::ResolveIn(systemFolder, kIndexName), index);
    return result;
}

} // namespace

const DetailsFiles& AsxDetailsFiles() {
    static const DetailsFiles files{"SecurityDetails.Asx.Stk", "SecurityDetails.Asx.Bak",
                                    "STKHeader.txt", "SecurityDetails.Stx", true};
    return files;
}

const DetailsFiles& UkDetailsFiles() {
    // The index serves the Australian file only.
    static const DetailsFiles files{"SecurityProperties.Lsx.Stk", "SecurityProperties.Lsx.Bak",
                                    "UKSTKHeader.txt", "UKSecurityDetails.Stx", false};
    return files;
}

std::string DetailsLabel(std::string_view key, bool london) {
    const std::string k = Trim(key);
    if (london)
        for (const auto& kl : kLondonLabels)
            if (k == kl.Key) return std::string(kl.Label);
    for (const auto& kl : kLabels)
        if (k == kl.Key) return std::string(kl.Label);
    return std::string(key);
}

RefreshResult RefreshSecurityDetails(const std::string& systemFolder, const std::string& inFolder) {
    return Refresh(AsxDetailsFiles(), systemFolder, inFolder, false);
}

RefreshResult RefreshUKSecurityDetails(const std::string& systemFolder,
                                       const std::string& inFolder) {
    return Refresh(UkDetailsFiles(), systemFolder, inFolder, true);
}

bool SecurityDetailsAvailable(int dataService, const std::string& systemFolder) {
    if (dataService != 1 && dataService != 3) return false;
    if (Trim(systemFolder).empty()) return false;
    return platform::FileExists(platform::ResolveIn(systemFolder, AsxDetailsFiles().Records)) &&
           platform::FileExists(platform::ResolveIn(systemFolder, kIndexName));
}

std::optional<SecurityDetails> LookUpSecurityDetails(const std::string& systemFolder,
                                                     std::string_view code) {
    const std::string wanted = StoredCode(code);
    if (wanted.empty()) return std::nullopt;
    const auto index = platform::ReadWholeFile(platform::ResolveIn(systemFolder, kIndexName));
    if (!index) return std::nullopt;
    long first = 0;
    for (const auto line : Lines(*index))
        if (line.size() > 2 && line[0] == wanted[0] && line[1] == ',')
            first = static_cast<long>(platform::Val(line.substr(2)));
    if (first < 1) return std::nullopt;

    const auto path = platform::ResolveIn(systemFolder, AsxDetailsFiles().Records);
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return std::nullopt;
    // Forward from the letter's first record; the file is sorted, so a code past the one
    // wanted ends the walk as surely as the end of the file.
    std::string block(kDetailsRecord * 64, '\0');
    off_t at = static_cast<off_t>(first - 1) * static_cast<off_t>(kDetailsRecord);
    std::optional<SecurityDetails> found;
    bool done = false;
    while (!done) {
        const ssize_t n = ::pread(fd, block.data(), block.size(), at);
        if (n < static_cast<ssize_t>(kDetailsRecord)) break;
        const std::size_t records = static_cast<std::size_t>(n) / kDetailsRecord;
        for (std::size_t r = 0; r < records && !done; ++r) {
            const std::string_view rec(block.data() + r * kDetailsRecord, kDetailsRecord);
            const std::string c = Trim(rec.substr(0, kDetailsCodeWidth));
            if (c == wanted) {
                SecurityDetails d;
                d.Code = c;
                d.Rest = TrimRight(rec.substr(kDetailsCodeWidth));
                d.Fields = platform::SplitQuoted(d.Rest);
                found = std::move(d);
                done = true;
            } else if (c > wanted) {
                done = true;
            }
        }
        at += static_cast<off_t>(records * kDetailsRecord);
    }
    ::close(fd);
    return found;
}

std::vector<SecurityDetails> ReadAllSecurityDetails(const std::string& systemFolder) {
    std::vector<SecurityDetails> all;
    const auto bytes =
        platform::ReadWholeFile(platform::ResolveIn(systemFolder, AsxDetailsFiles().Records));
    if (!bytes) return all;
    all.reserve(bytes->size() / kDetailsRecord);
    for (std::size_t at = 0; at + kDetailsRecord <= bytes->size(); at += kDetailsRecord) {
        const std::string_view rec(bytes->data() + at, kDetailsRecord);
        SecurityDetails d;
        d.Code = Trim(rec.substr(0, kDetailsCodeWidth));
        d.Rest = TrimRight(rec.substr(kDetailsCodeWidth));
        d.Fields = platform::SplitQuoted(d.Rest);
        all.push_back(std::move(d));
    }
    return all;
}

DetailsHeader ReadDetailsHeader(const std::string& systemFolder, bool london) {
    DetailsHeader h;
    const auto& files = london ? UkDetailsFiles() : AsxDetailsFiles();
    const auto text = platform::ReadWholeFile(platform::ResolveIn(systemFolder, files.Header));
    if (!text) return h;
    const auto lines = Lines(*text);
    if (!lines.empty()) h.Keys = platform::SplitQuoted(lines[0]);
    if (lines.size() > 1) h.Labels = platform::SplitQuoted(lines[1]);
    return h;
}

std::vector<std::string> DetailsTextBox(const DetailsHeader& header, const SecurityDetails& details,
                                        double lastClose) {
    // The keys name the fields of the whole line, the code being the first.
    auto field = [&](std::string_view key) -> std::optional<double> {
        for (std::size_t k = 1; k < header.Keys.size(); ++k)
            if (Upper(Trim(header.Keys[k])) == key && k - 1 < details.Fields.size())
                return platform::Val(details.Fields[k - 1]);
        return std::nullopt;
    };
    std::vector<std::string> lines;
    const auto issued = field("TOTALCLASSISSUE");
    lines.push_back("Issued  " + (issued ? platform::Format(*issued, "#,###") : "n/a"));
    const auto earnings = field("EARNINGSPERSHARE");
    // Without a price there is no ratio either, as in the details window.
    lines.push_back("PE Ratio  " + (earnings && *earnings != 0 && lastClose != 0
                                        ? platform::Format(lastClose / *earnings, "0.0")
                                        : std::string("n/a")));
    const auto dividend = field("ANNUALDIVIDENDRATE");
    lines.push_back("Yield  " + (dividend && lastClose != 0
                                     ? platform::Format(*dividend / lastClose, "#.0%")
                                     : std::string("n/a")));
    return lines;
}

std::optional<std::map<std::string, std::string>>
GicsSectorsFromDetails(const std::string& systemFolder) {
    const DetailsHeader header = ReadDetailsHeader(systemFolder);
    // The keys name the fields of the whole line, the code being the first.
    std::size_t column = 0;
    for (std::size_t k = 1; k < header.Keys.size() && column == 0; ++k)
        if (Upper(header.Keys[k]).find("GICS") != std::string::npos) column = k;
    if (column == 0) return std::nullopt;
    std::map<std::string, std::string> sectors;
    for (auto& d : ReadAllSecurityDetails(systemFolder)) {
        if (column - 1 >= d.Fields.size()) continue;
        // Both files keep "PRN" in its safe form, so the codes meet as stored.
        sectors.emplace(d.Code, Trim(d.Fields[column - 1]));
    }
    return sectors;
}

} // namespace kori::maint
