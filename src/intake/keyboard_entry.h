#pragma once
// One day's figures typed for a security and appended to its price file: the proposed date,
// the checks by record type with their messages, and the append.
#include "platform/status.h"
#include "store/name_record.h"
#include "store/price_file.h"

#include <optional>
#include <string>
#include <string_view>

namespace kori::intake {

inline constexpr std::string_view kDataEntryTitle = "Data Entry";

// The day after `yyyymmdd`, moved past a weekend: a Saturday and a Sunday both become the
// Monday. Nullopt for a text that is not a date.
std::optional<std::string> NextTradingDate(std::string_view yyyymmdd);

// The fields as typed. For record type 3, High holds the rises, Low the falls and Close the
// cumulative total; Open and Volume are not used.
struct KeyedDay {
    std::string Date; // as typed, "d/m/yy"
    std::string Open, High, Low, Close, Volume;
};

struct EntryRefusal {
    std::string Message; // lines joined by "\n"
    std::string Title;
};

// The check of the typed figures for a record type. `previousTotal` is the close of the last
// record (type 3 only; 0 for an empty file).
//  1, 2: a close blank or 0: " Close should not be 0" / "Use previous close ".
//  3: previous total + rises - falls must equal the total: "Cumulative total must equal" /
//     "Previous total + Rises - Falls" (under "Advance/Decline Edit").
//  4, 5: an open, high, low or close of 0: "Data should not be 0" / "Use previous close ".
// A filled field that is not a number, or a volume that is not a whole number of shares, is
// refused as well.
std::optional<EntryRefusal> CheckKeyedFigures(int recordType, const KeyedDay& day,
                                              float previousTotal);

// The record the figures make for a checked date ("yyyymmdd"): factor 0, note blank.
store::PriceRecord KeyedRecord(int recordType, const std::string& dateText, const KeyedDay& day);

struct EntryResult {
    bool Saved = false;
    EntryRefusal Refusal; // when not saved
    store::PriceRecord Record;
    int RecordNumber = 0; // where it went
};

// The whole save: the date checked, the figures checked against the last record, then the
// record appended at count + 1 in one write of 50 bytes. Dates are not compared with those on
// file, so an earlier date goes in after later ones. A file whose length is not a whole
// number of records is refused rather than appended to out of step.
EntryResult SaveKeyedDay(std::string_view dataFolder, const store::NameRecord& name,
                         const KeyedDay& day);

// The last record of a price file, if it has one.
std::optional<store::PriceRecord> LastPriceRecord(const std::filesystem::path& priceFile);

} // namespace kori::intake
