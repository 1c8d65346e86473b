#include "adjust/adjustment.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/price_file.h"
#include "store/record_codec.h"
#include "store/record_file.h"
#include "store/trendline_file.h"

#include <cmath>
#include <cstdint>
#include <cstring>

namespace kori::adjust {

using platform::Money;
using platform::Status;
namespace codec = store::codec;

namespace {

constexpr std::size_t kRec = store::PriceRecord::kSize;
constexpr std::size_t kOpen = 8, kHigh = 12, kLow = 16, kClose = 20, kVolume = 24, kFactor = 28,
                      kNote = 32, kNoteWidth = 14;
constexpr std::size_t kPrices[] = {kOpen, kHigh, kLow, kClose};

// The rewrite of a price history goes to this name beside it, then takes the file's place.
const platform::ScratchNames kPriceScratch{"Temp.Wk1", ""};

// A price history as bytes, with its record count checked against the format's limit.
struct History {
    std::filesystem::path Path;
    std::string Bytes;
    int Count = 0;

    char* At(int record) { return Bytes.data() + static_cast<std::size_t>(record - 1) * kRec; }
    const char* At(int record) const {
        return Bytes.data() + static_cast<std::size_t>(record - 1) * kRec;
    }
    float Close(int record) const { return codec::Get<float>(At(record) + kClose); }
    std::string_view Date(int record) const { return {At(record), 8}; }
};

Status ReadHistory(std::string_view dataFolder, std::string_view code, History& h) {
    store::PriceFile file(store::PriceFile::PathFor(dataFolder, code));
    if (file.path().empty()) return Status::Error("No File For That Name");
    if (auto s = file.OpenWithData(); !s) return s;
    auto bytes = platform::ReadWholeFile(file.path());
    if (!bytes) return Status::Error("Cannot read " + file.path().string());
    h.Path = file.path();
    h.Bytes = std::move(*bytes);
    h.Count = static_cast<int>(h.Bytes.size() / kRec);
    if (h.Count > store::kMaxRecords || h.Count < 1)
        return Status::Error(h.Path.filename().string() + " changed while it was read");
    return Status::Ok();
}

Status WouldNotFit(const History& h, int record) {
    return Status::Error("Record " + std::to_string(record) + " of " + h.Path.filename().string() +
                         " would not fit its fields after the adjustment: nothing was changed");
}

// Multiplies the four prices of a record, each in the width of the file's floats to four
// decimals, halves to even; false when one does not fit.
bool ScalePrices(char* rec, float factor) {
    // The optional-free conversion: this runs for every price of a history of 30,000 records.
    float scaled[4];
    for (std::size_t i = 0; i < 4; ++i) {
        const float product = codec::Get<float>(rec + kPrices[i]) * factor;
        Money money;
        if (!Money::TryFromDouble(product, money)) return false;
        scaled[i] = money.ToFloat();
        if (!std::isfinite(scaled[i])) return false;
    }
    for (std::size_t i = 0; i < 4; ++i)
        codec::Put(rec + kPrices[i], scaled[i]);
    return true;
}

std::string FieldsLine(const std::vector<std::string>& f, std::string_view colour) {
    std::string line;
    for (std::size_t i = 0; i < 5; ++i) {
        line += platform::Trim(f[i]);
        line += ',';
    }
    line += platform::Trim(colour);
    return line;
}

std::vector<std::string> SplitCommas(std::string_view line) {
    std::vector<std::string> fields;
    std::size_t start = 0;
    while (true) {
        const std::size_t comma = line.find(',', start);
        if (comma == std::string_view::npos) {
            fields.emplace_back(line.substr(start));
            return fields;
        }
        fields.emplace_back(line.substr(start, comma - start));
        start = comma + 1;
    }
}

std::string ShortDate(std::string_view yyyymmdd) {
    const auto d = platform::FormatDate(yyyymmdd, "d/m/yy");
    return d.empty() ? platform::Trim(yyyymmdd) : d;
}

std::string CloseText(float close) {
    return platform::Trim(platform::FormatSingle(close, "#####0.00##"));
}

} // namespace

std::string_view TypeLetters(AdjType type) {
    switch (type) {
    case AdjType::Bonus:
        return "B";
    case AdjType::Cash:
        return "C";
    case AdjType::Split:
        return "SS";
    case AdjType::Call:
        return "CC";
    case AdjType::Dividend:
        return "D";
    }
    return "";
}

std::optional<AdjType> TypeOf(std::string_view letters) {
    const std::string u = platform::Upper(platform::Trim(letters));
    for (AdjType t :
         {AdjType::Bonus, AdjType::Cash, AdjType::Split, AdjType::Call, AdjType::Dividend})
        if (u == TypeLetters(t)) return t;
    return std::nullopt;
}

float SixDecimalFactor(double factor) {
    return static_cast<float>(platform::Val(platform::Format(factor, "#####.######")));
}

std::string TermText(float term) {
    return platform::Trim(platform::StrSingle(term));
}

std::string MoneyText(Money m) {
    const std::int64_t raw = m.raw();
    const std::uint64_t mag =
        raw < 0 ? static_cast<std::uint64_t>(-(raw + 1)) + 1 : static_cast<std::uint64_t>(raw);
    std::string text = std::to_string(mag / Money::kScale);
    std::string frac = std::to_string(mag % Money::kScale);
    frac.insert(0, 4 - frac.size(), '0');
    while (!frac.empty() && frac.back() == '0')
        frac.pop_back();
    if (!frac.empty()) text += "." + frac;
    return raw < 0 ? "-" + text : text;
}

std::string BonusRatioText(std::string_view a, std::string_view b) {
    return "Ratio of Bonus Issue is " + std::string(a) + ":" + std::string(b);
}

std::string CashRatioText(std::string_view a, std::string_view b, std::string_view cost) {
    return "Ratio = " + std::string(a) + ":" + std::string(b) + " @ " + std::string(cost);
}

std::optional<Factor> WorkOutFactor(const AdjustmentTerms& t, float close, Status& why) {
    const double a = t.RatioA, b = t.RatioB, c = close;
    double value = 0;
    std::string note;
    auto incomplete = [&why] {
        why = Status::Error(std::string(kDataIncomplete));
        return std::nullopt;
    };
    switch (t.Type) {
    case AdjType::Bonus:
        if (a == 0 || b == 0 || a + b == 0) return incomplete();
        value = b / (a + b);
        note = "bi" + TermText(t.RatioA) + ":" + TermText(t.RatioB);
        break;
    case AdjType::Cash: {
        if (a == 0 || b == 0 || a + b == 0 || !t.Cost || c == 0) return incomplete();
        const double cost = t.Cost->ToDouble();
        const double theoretical = (a * cost + b * c) / (a + b);
        value = 1 - (c - theoretical) / c;
        note = "ci" + TermText(t.RatioA) + ":" + TermText(t.RatioB) + " @ " + MoneyText(*t.Cost);
        break;
    }
    case AdjType::Split:
        if (a == 0 || b == 0) return incomplete();
        value = b / a;
        note = "ss" + TermText(t.RatioA) + ":" + TermText(t.RatioB);
        break;
    case AdjType::Call:
        if (!t.Amount || c == 0) return incomplete();
        value = t.Amount->ToDouble() / c + 1;
        note = "cl" + MoneyText(*t.Amount);
        break;
    case AdjType::Dividend:
        if (!t.Amount || c == 0) return incomplete();
        value = 1 - t.Amount->ToDouble() / c;
        note = "dv" + MoneyText(*t.Amount);
        break;
    }
    const float rounded = SixDecimalFactor(value);
    if (!std::isfinite(rounded) || rounded < 0) {
        why = Status::Error("The factor of this adjustment would be " +
                            platform::Format(value, "0.######") +
                            ": prices cannot fall below 0. Check the amounts entered.");
        return std::nullopt;
    }
    why = Status::Ok();
    return Factor{rounded, note};
}

std::string EntryLine(std::string_view yyyymmdd, float close) {
    return platform::PadRight(ShortDate(yyyymmdd), 8) + "   " +
           platform::FormatSingle(close, "######.00");
}

Status ChooseAdjustmentDate(std::string_view dataFolder, std::string_view code,
                            std::string_view adjDate, DateChoice& out) {
    out = DateChoice{};
    History h;
    if (auto s = ReadHistory(dataFolder, code, h); !s) return s;
    // Record 1 is never looked at: the walk starts at 2 and the result never goes below 1.
    int i = 2;
    while (i <= h.Count && h.Date(i) <= adjDate)
        ++i;
    const int result = i - 1;
    if (result <= 1) return Status::Ok();

    out.Record = result;
    out.FirstShown = std::max(1, result - 20);
    const int last = std::min(h.Count, result + 20);
    for (int r = out.FirstShown; r <= last; ++r) {
        out.Lines.push_back(EntryLine(h.Date(r), h.Close(r)));
        out.Dates.emplace_back(h.Date(r));
    }
    out.Selected = result - out.FirstShown;
    out.RecordDate = std::string(h.Date(result));
    out.Close = h.Close(result);
    out.ExactDate = out.RecordDate == adjDate;
    if (out.ExactDate)
        out.Message = "Close Price on " + ShortDate(adjDate) + " is " + CloseText(out.Close);
    else
        out.Message = "No close price on file for " + ShortDate(adjDate) +
                      "\n Nearest date prior is " + ShortDate(out.RecordDate) +
                      "\n Close price is " + CloseText(out.Close);
    return Status::Ok();
}

Status ApplyAdjustment(const AdjustmentJob& job, Applied& out) {
    out = Applied{};
    History h;
    if (auto s = ReadHistory(job.DataFolder, job.Code, h); !s) return s;
    if (job.AdjRecord < 1 || job.AdjRecord > h.Count)
        return Status::Error("No record of " + h.Path.filename().string() +
                             " has been chosen for the adjustment");

    for (int r = job.AdjRecord; r >= 1; --r) {
        char* rec = h.At(r);
        if (codec::Get<float>(rec + kClose) == 0) continue;
        if (!ScalePrices(rec, job.AdjFactor)) return WouldNotFit(h, r);
        if (job.Volumes == VolumeRule::Scaled) {
            const double v = static_cast<double>(codec::Get<std::int32_t>(rec + kVolume)) *
                             static_cast<double>(job.AdjFactor);
            const auto scaled = platform::CLng(v);
            if (!scaled) return WouldNotFit(h, r);
            codec::Put(rec + kVolume, *scaled);
        }
        ++out.RecordsScaled;
    }
    char* chosen = h.At(job.AdjRecord);
    codec::PutText(chosen + kNote, job.AdjNote, kNoteWidth);
    codec::Put(chosen + kFactor, job.AdjFactor);
    out.Date = std::string(h.Date(job.AdjRecord));

    if (auto s = platform::WriteFileAtomic(h.Path, h.Bytes, kPriceScratch); !s) return s;
    AdjustChartNotes(job.ChtMiscFolder, job.Code, out.Date, job.AdjFactor, job.NoteColour);
    return Status::Ok();
}

std::string AdjustmentsMadeText(std::string_view code) {
    return "Adjustments made to\n" + platform::Trim(code);
}

void AdjustChartNotes(std::string_view chtMiscFolder, std::string_view code,
                      std::string_view lastDate, float factor, std::string_view colour) {
    if (chtMiscFolder.empty()) return;
    const auto path = platform::ResolveIn(chtMiscFolder, platform::Trim(code) + ".txt");
    if (!platform::FileExists(path)) return;
    const auto content = platform::ReadWholeFile(path);
    if (!content) return;
    const double last = platform::Val(lastDate);
    std::string rewritten;
    std::size_t pos = 0;
    while (pos < content->size()) {
        std::size_t end = content->find('\n', pos);
        if (end == std::string::npos) end = content->size();
        std::string line = content->substr(pos, end - pos);
        pos = end + 1;
        if (!line.empty() && line.back() == '\r') line.pop_back();
        if (platform::Trim(line).empty()) continue;
        auto fields = SplitCommas(line);
        if (fields.size() < 5) {
            // Not a note this rewrite understands: carried through as it stands.
            rewritten += line + "\r\n";
            continue;
        }
        if (last >= platform::Val(fields[2])) {
            const auto price = Money::FromDouble(platform::Val(fields[3]) * factor);
            if (price) fields[3] = platform::Format(price->ToDouble(), "#.00");
        }
        rewritten += FieldsLine(fields, colour) + "\r\n";
    }
    (void)platform::WriteFileAtomic(path, rewritten, {"Temp.Wk2", ""});
}

Status ScaleTrendLines(std::string_view chtMiscFolder, std::string_view code, float factor,
                       std::string_view date) {
    const auto path = store::TrendlineFile::PathFor(chtMiscFolder, platform::Trim(code));
    if (path.empty() || !platform::FileExists(path)) return Status::Ok();
    store::TrendlineFile file(path);
    auto lines = store::TrendlineFile::ReadAll(path);
    if (lines.size() <= 1) return Status::Ok();
    for (auto& l : lines) {
        const std::string a = platform::Trim(l.DateA), b = platform::Trim(l.DateB);
        if (a.size() != 8 || b.size() != 8) continue;
        if (a <= date) l.PriceA *= factor;
        if (b <= date) l.PriceB *= factor;
    }
    return file.WriteAll(lines, {"Temp.Wk3", ""});
}

Status RemoveLatestAdjustment(std::string_view dataFolder, std::string_view code, Removed& out) {
    out = Removed{};
    History h;
    if (auto s = ReadHistory(dataFolder, code, h); !s) return s;
    int entries = 0, n = 0;
    float f = 0;
    for (int r = 2; r <= h.Count; ++r) {
        const float factor = codec::Get<float>(h.At(r) + kFactor);
        if (factor == 0) continue;
        if (++entries > kRemovalTableSize)
            return Status::Error("More than " + std::to_string(kRemovalTableSize) +
                                 " adjustments are on file for " + platform::Trim(code) +
                                 ": the latest cannot be told apart, nothing was removed");
        n = r;
        f = factor;
    }
    out.Entries = entries;
    if (entries == 0) return Status::Ok();

    // The reciprocal as the original arithmetic gives it, in single precision.
    const float m = 1.0f + (1.0f - f) / f;
    const std::string note = platform::Trim(std::string_view(h.At(n) + kNote, kNoteWidth));
    for (int r = n; r >= 1; --r)
        if (!ScalePrices(h.At(r), m)) return WouldNotFit(h, r);
    codec::PutText(h.At(n) + kNote, "", kNoteWidth);
    codec::Put(h.At(n) + kFactor, 0.0f);
    if (auto s = platform::WriteFileAtomic(h.Path, h.Bytes, kPriceScratch); !s) return s;
    out.Record = n;
    out.Factor = f;
    out.Date = std::string(h.Date(n));
    out.Note = note;
    return Status::Ok();
}

std::string LatestRemovedText(std::string_view code) {
    return "Latest adjustment removed for " + platform::Trim(code);
}

} // namespace kori::adjust
