#include "adjust/bulletin_filter.h"

#include "platform/text.h"

#include <array>
#include <set>
#include <utility>

namespace kori::adjust {

namespace {

struct Tag {
    std::string_view From;
    std::string_view To; // empty: the bulletin's date stem
};

// In the order they are tried; only the first that matches is replaced.
constexpr std::array<Tag, 10> kTags = {{{",ASX.STK,", ""},
                                        {",SUM,", ""},
                                        {",ASX.OPT,", "OPT"},
                                        {",ASX.IDX,", "IDX"},
                                        {",ASX.WNT,", "WNT"},
                                        {",SFE.FUT,", "SFE"},
                                        {",WCM.OVS,", "OVS"},
                                        {",LSX.STK,", "LSE"},
                                        {",LSX.IDX,", "LSX"},
                                        {",LIF.FUT,", "LIF"}}};

// Each word, with the one character after it, becomes the short form: first occurrence only.
constexpr std::array<std::pair<std::string_view, std::string_view>, 14> kShortWords = {{
    {"LIMITED", "LTD "},
    {"BARRIER", "BAR "},
    {"ROLLING", "RLG "},
    {"ENDOWMENT", "ENDOW "},
    {"AUSTRALIA", "AUST "},
    {"PORTFOLIO", "PORT "},
    {"INSTALMENT", "INSTAL "},
    {"EXPLORATION", "EXP "},
    {"CORPORATION", "CORP "},
    {"SELF FUNDING", "SFDG "},
    {"CITIWARRANTS", "CITY "},
    {"INTERNATIONAL", "INTER "},
    {"OPTION EXPIRING", "OPT EXP "},
    {"CAPITAL PROTECTED", "CAP PRO "},
}};

// Each word is removed with the one character after it: first occurrence only.
constexpr std::array<std::string_view, 18> kDroppedWords = {
    "WARRANT",     "WARR ",          "SG AUST",       "WARBURG",       "WESTPAC",
    "ABN AMRO",    "CITIBANK",       "ANZ BANK",      "CHALLENGER",    "UBS WARBURG",
    "BNP PARIBAS", "SG AUSTRALIA",   "MERRILL LYNCH", "DEUTSCHE BANK", "MACQUARIE BANK",
    "MACQUARIE",   "ROBERT FLEMING", "CREDIT SUISSE"};

bool Contains(std::string_view line, std::string_view part) {
    return line.find(part) != std::string_view::npos;
}

// Every occurrence, as the classic Replace.
void ReplaceAll(std::string& line, std::string_view from, std::string_view to) {
    std::size_t pos = 0;
    while ((pos = line.find(from, pos)) != std::string::npos) {
        line.replace(pos, from.size(), to);
        pos += to.size();
    }
}

// The word and the character after it (when there is one) replaced, first occurrence only.
void ReplaceWordAndNext(std::string& line, std::string_view word, std::string_view to) {
    const std::size_t pos = line.find(word);
    if (pos == std::string::npos) return;
    const std::size_t length = std::min(word.size() + 1, line.size() - pos);
    line.replace(pos, length, to);
}

std::string_view Action(std::string_view line) {
    return line.substr(0, 2);
}

// The code: from the fourth character up to the next comma.
std::string_view CodeOf(std::string_view line) {
    if (line.size() < 4) return {};
    const std::string_view rest = line.substr(3);
    return rest.substr(0, rest.find(','));
}

// The first occurrence only.
void ReplaceFirst(std::string& line, std::string_view from, std::string_view to) {
    const std::size_t pos = line.find(from);
    if (pos != std::string::npos) line.replace(pos, from.size(), to);
}

void FixCodes(std::string& line) {
    ReplaceFirst(line, ",AUX", ",1AUX");
    ReplaceFirst(line, ",PRN,", ",PRNX,");
}

void ReplaceFirstTag(std::string& line, std::string_view dateStem) {
    for (const auto& tag : kTags) {
        const std::size_t pos = line.find(tag.From);
        if (pos == std::string::npos) continue;
        const std::string to = "," + std::string(tag.To.empty() ? dateStem : tag.To) + ",";
        line.replace(pos, tag.From.size(), to);
        return;
    }
}

bool IsWarrant(std::string_view line) {
    if (Contains(line, ",WNT,") || Contains(line, ",ASX.WNT,")) return true;
    const std::string_view code = CodeOf(line);
    return code.size() == 6 && std::string_view("WIEXDSJ").find(code[3]) != std::string_view::npos;
}

} // namespace

std::string ShortenListingLine(std::string line) {
    for (const auto& [word, to] : kShortWords)
        ReplaceWordAndNext(line, word, to);
    for (const auto word : kDroppedWords)
        ReplaceWordAndNext(line, word, "");
    return line;
}

std::vector<std::string> FilterBulletin(std::string_view bulletin, const BulletinOptions& o) {
    std::vector<std::string> lines;
    std::size_t pos = 0;
    while (pos < bulletin.size()) {
        std::size_t end = bulletin.find('\n', pos);
        if (end == std::string_view::npos) end = bulletin.size();
        std::string line = platform::Upper(bulletin.substr(pos, end - pos));
        pos = end + 1;
        if (!line.empty() && line.back() == '\r') line.pop_back();
        if (!platform::Trim(line).empty()) lines.push_back(std::move(line));
    }

    // Short names give way to the long names of the same bulletin.
    std::set<std::string, std::less<>> longNamed;
    if (o.NoShortNames)
        for (auto line : lines) {
            FixCodes(line);
            if (Action(line) == "NL") longNamed.emplace(CodeOf(line));
        }

    std::vector<std::string> kept;
    for (auto& line : lines) {
        FixCodes(line);
        ReplaceFirstTag(line, o.DateStem);
        if (Contains(line, ",OPT,") && !o.OptionsLibrary) continue;
        if (o.WarrantFilter && IsWarrant(line)) {
            if (o.NoWarrants) continue;
            if (!o.HasPriceFile || !o.HasPriceFile(CodeOf(line))) continue;
        }
        const std::string action(Action(line));
        if (action == "NI") {
            if (Contains(line, "DELETE THIS")) continue;
            if (o.NoShortNames && longNamed.count(CodeOf(line)) > 0) continue;
        }
        if (action == "DC") ReplaceAll(line, ",N,", ",Y,");
        if (action == "NL") {
            ReplaceAll(line, ",N,", ",Y,");
            line = ShortenListingLine(std::move(line));
        }
        if (action == "DI") {
            switch (o.Divs) {
            case DividendRule::Leave:
                continue;
            case DividendRule::MarkY:
                ReplaceAll(line, ",N,", ",Y,");
                break;
            case DividendRule::MarkN:
                break;
            case DividendRule::MarkD:
                ReplaceAll(line, ",N,", ",D,");
                break;
            }
        }
        kept.push_back(std::move(line));
    }
    return kept;
}

} // namespace kori::adjust
