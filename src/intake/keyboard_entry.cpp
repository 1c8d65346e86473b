#include "intake/keyboard_entry.h"

#include "platform/date_entry.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"

#include <cmath>
#include <cstdint>
#include <limits>

namespace kori::intake {

namespace {

constexpr std::string_view kAdvanceDeclineTitle = "Advance/Decline Edit";

// Blank counts as 0, as the figure fields read it.
bool IsZero(const std::string& text) {
    const std::string t = platform::Trim(text);
    return t.empty() || platform::Val(t) == 0;
}

std::optional<EntryRefusal> NotANumber(const char* label, const std::string& text) {
    const std::string t = platform::Trim(text);
    if (t.empty() || platform::IsNumber(t)) return std::nullopt;
    return EntryRefusal{std::string(label) + " must be a number", std::string(kDataEntryTitle)};
}

std::optional<EntryRefusal> CheckVolume(const std::string& text) {
    if (auto r = NotANumber("Volume", text)) return r;
    const double v = platform::Val(text);
    if (v < 0 || v != std::floor(v) || v > std::numeric_limits<std::int32_t>::max())
        return EntryRefusal{"Volume must be a whole number of shares, at most 2147483647",
                            std::string(kDataEntryTitle)};
    return std::nullopt;
}

} // namespace

std::optional<std::string> NextTradingDate(std::string_view yyyymmdd) {
    const auto serial = platform::DaySerial(yyyymmdd);
    if (!serial) return std::nullopt;
    auto next = platform::DateTextFromSerial(*serial + 1);
    if (!next) return std::nullopt;
    const int weekday = *platform::Weekday(*next);
    if (weekday == 7) next = platform::DateTextFromSerial(*serial + 3); // Saturday
    if (weekday == 1) next = platform::DateTextFromSerial(*serial + 2); // Sunday
    return next;
}

std::optional<EntryRefusal> CheckKeyedFigures(int recordType, const KeyedDay& day,
                                              float previousTotal) {
    if (recordType == 3) {
        for (const auto& [label, text] :
             {std::pair{"Rises", &day.High}, std::pair{"Falls", &day.Low},
              std::pair{"Cum.Total", &day.Close}})
            if (auto r = NotANumber(label, *text)) return r;
        const double expected =
            static_cast<double>(previousTotal) + platform::Val(day.High) - platform::Val(day.Low);
        if (platform::Trim(day.Close).empty() || platform::Val(day.Close) != expected)
            return EntryRefusal{"Cumulative total must equal\nPrevious total + Rises - Falls",
                                std::string(kAdvanceDeclineTitle)};
        return std::nullopt;
    }
    for (const auto& [label, text] : {std::pair{"Open", &day.Open}, std::pair{"High", &day.High},
                                      std::pair{"Low", &day.Low}, std::pair{"Close", &day.Close}})
        if (auto r = NotANumber(label, *text)) return r;
    if (recordType != 2)
        if (auto r = CheckVolume(day.Volume)) return r;
    if (recordType == 4 || recordType == 5) {
        if (IsZero(day.Open) || IsZero(day.High) || IsZero(day.Low) || IsZero(day.Close))
            return EntryRefusal{"Data should not be 0\nUse previous close ",
                                std::string(kDataEntryTitle)};
        return std::nullopt;
    }
    // Types 1 and 2, and any other type as they are: only the close must be there.
    if (IsZero(day.Close))
        return EntryRefusal{" Close should not be 0\nUse previous close ",
                            std::string(kDataEntryTitle)};
    return std::nullopt;
}

store::PriceRecord KeyedRecord(int recordType, const std::string& dateText, const KeyedDay& day) {
    store::PriceRecord r;
    r.Date = dateText;
    const auto price = [](const std::string& t) { return static_cast<float>(platform::Val(t)); };
    if (recordType != 3) r.Open = price(day.Open);
    r.High = price(day.High);
    r.Low = price(day.Low);
    r.Close = price(day.Close);
    if (recordType != 2 && recordType != 3)
        r.Volume = static_cast<std::int32_t>(platform::Val(day.Volume));
    return r;
}

std::optional<store::PriceRecord> LastPriceRecord(const std::filesystem::path& priceFile) {
    if (priceFile.empty() || !platform::FileHasData(priceFile)) return std::nullopt;
    store::PriceFile f(priceFile);
    store::PriceRecord last;
    if (!f.Open() || f.Count() < 1 || !f.Read(f.Count(), last)) return std::nullopt;
    return last;
}

EntryResult SaveKeyedDay(std::string_view dataFolder, const store::NameRecord& name,
                         const KeyedDay& day) {
    EntryResult result;
    const auto date = platform::CheckEnteredDate(day.Date);
    if (!date.Ok) {
        result.Refusal = {date.Message, date.Title};
        return result;
    }
    const auto path = store::PriceFile::PathFor(dataFolder, name.TrimmedCode());
    if (path.empty()) {
        result.Refusal = {"No File For That Name", std::string(kDataEntryTitle)};
        return result;
    }
    const auto last = LastPriceRecord(path);
    if (auto refused = CheckKeyedFigures(name.RecordType, day, last ? last->Close : 0.0f)) {
        result.Refusal = *refused;
        return result;
    }
    if (platform::FileSizeOr0(path) % store::PriceRecord::kSize != 0) {
        result.Refusal = {path.filename().string() +
                              " is damaged: its length is not a whole number of records",
                          std::string(kDataEntryTitle)};
        return result;
    }
    store::PriceFile file(path);
    result.Record = KeyedRecord(name.RecordType, date.Text, day);
    if (auto s = file.Open(); !s) {
        result.Refusal = {s.message(), std::string(kDataEntryTitle)};
        return result;
    }
    if (auto s = file.Append(result.Record); !s) {
        result.Refusal = {s.message(), std::string(kDataEntryTitle)};
        return result;
    }
    result.Saved = true;
    result.RecordNumber = file.Count();
    return result;
}

} // namespace kori::intake
