#include "app/fundamentals_form.h"

#include "maint/security_details.h"
#include "platform/csv_line.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/classifications.h"
#include "store/name_editor.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <cmath>
#include <map>

namespace kori::app {

using platform::Format;
using platform::Trim;
using platform::Val;

namespace {

constexpr const char* kColumnsSection = "ASX Columns";

std::vector<store::NameRecord> ReadNames(const std::string& dataFolder) {
    std::vector<store::NameRecord> names;
    store::NameFile nf(store::NameFile::PathIn(dataFolder));
    if (!nf.ReadAll(names)) names.clear();
    return names;
}

std::string ColumnKey(int column) {
    return "Col" + std::to_string(column);
}

} // namespace

FundamentalsForm::FundamentalsForm(Session& session) : m_session(session) {}

bool FundamentalsForm::Available() const {
    return maint::SecurityDetailsAvailable(m_session.download.DataService,
                                           m_session.folders.SystemFolder);
}

std::string FundamentalsForm::DisplayField(int field, const std::string& text) {
    const std::string t = Trim(text);
    switch (field) {
    case 10:
        return Format(Val(t), "#");
    case 18:
        return t == "I" ? "Interim" : t == "F" ? "Final" : t;
    case 26:
    case 27:
        return Format(Val(t) / 100000, "0.00#");
    case 28:
        return platform::FormatDate(t, "ddMMMyy");
    case 31:
    case 32:
        return t == "Y" ? "YES" : t == "N" ? "NO" : t;
    case 33:
        return Trim(platform::Str(Val(t) / 10000));
    default:
        return t;
    }
}

bool FundamentalsForm::Load() {
    const std::string& system = m_session.folders.SystemFolder;
    const auto header = maint::ReadDetailsHeader(system);
    const auto bytes =
        platform::ReadWholeFile(platform::ResolveIn(system, maint::AsxDetailsFiles().Records));
    if (header.Labels.empty() || !bytes || bytes->size() < maint::kDetailsRecord) {
        m_session.dialogs().MsgBox("There is no fundamental data", "ASX Security Data");
        return false;
    }
    m_headers = header.Labels;
    m_priceColumn = static_cast<int>(m_headers.size());
    m_classColumn = -1;
    m_transferPending = false;
    for (const char* extra : {"Price $", "PE Ratio", "Yield %", "GICS"})
        m_headers.emplace_back(extra);
    const std::size_t width = m_headers.size();
    m_rows.clear();
    for (std::size_t at = 0; at + maint::kDetailsRecord <= bytes->size();
         at += maint::kDetailsRecord) {
        const std::string_view rec(bytes->data() + at, maint::kDetailsRecord);
        std::vector<std::string> row;
        row.push_back(Trim(rec.substr(0, maint::kDetailsCodeWidth)));
        for (auto& f :
             platform::SplitQuoted(platform::TrimRight(rec.substr(maint::kDetailsCodeWidth))))
            row.push_back(DisplayField(static_cast<int>(row.size()) + 1, f));
        row.resize(width);
        m_rows.push_back(std::move(row));
    }
    m_hidden.assign(width, false);
    for (std::size_t c = 0; c < width; ++c)
        m_hidden[c] =
            m_session.services().settings.Get(platform::kAppName, kColumnsSection,
                                              ColumnKey(static_cast<int>(c)), "") == "Hidden";
    return true;
}

void FundamentalsForm::ShowFigures() {
    const int price = priceColumn();
    const std::string& data = m_session.folders.DataFolder;
    const std::string& system = m_session.folders.SystemFolder;
    std::map<std::string, std::string> gics;
    for (const auto& n : ReadNames(data))
        gics.emplace(n.TrimmedCode(), Trim(n.GicsSector));
    for (auto& row : m_rows) {
        const std::string& code = row[0];
        if (code == "AUX" || code == "1AUX" || code == "PRN" || code == "PRNX") continue;
        // Table columns 14 and 15, counted from the code.
        const double earnings = row.size() > 13 ? Val(row[13]) : 0;
        const double dividend = row.size() > 14 ? Val(row[14]) : 0;
        const auto path = store::PriceFile::PathFor(data, code);
        if (platform::FileExists(path)) {
            double last = 0;
            store::PriceFile f(path);
            store::PriceRecord r;
            if (f.Open() && f.Count() > 0 && f.Read(f.Count(), r)) last = r.Close;
            auto& p = row[static_cast<std::size_t>(price)];
            auto& pe = row[static_cast<std::size_t>(price + 1)];
            auto& yield = row[static_cast<std::size_t>(price + 2)];
            p = last > 0 ? Format(last, "#0.00#") : std::string();
            yield.clear();
            if (dividend > 0 && last > 0) {
                const double y = std::round(dividend / last * 100 * 10000) / 10000;
                if (y > 0) yield = Format(y, "000.0");
            }
            pe.clear();
            if (earnings > 0) {
                if (last != 0) {
                    const double ratio = last / earnings;
                    if (ratio > 0) pe = Format(ratio, "000.0");
                } else {
                    pe = "n/a";
                }
            }
        }
        if (const auto it = gics.find(code); it != gics.end() && !it->second.empty())
            row[static_cast<std::size_t>(price + 3)] = store::SectorNameOf(system, it->second);
    }
}

void FundamentalsForm::ShowIndustryClasses() {
    if (m_classColumn < 0) {
        m_classColumn = static_cast<int>(m_headers.size());
        m_headers.emplace_back("Ind Class");
        m_hidden.push_back(false);
        for (auto& row : m_rows)
            row.resize(m_headers.size());
    }
    std::map<std::string, std::string> classes;
    for (const auto& n : ReadNames(m_session.folders.DataFolder))
        classes.emplace(n.TrimmedCode(), Trim(n.IndustryClass));
    for (auto& row : m_rows) {
        const auto it = classes.find(row[0]);
        row[static_cast<std::size_t>(m_classColumn)] = it == classes.end() || it->second.empty()
                                                           ? std::string()
                                                           : Format(Val(it->second), "000");
    }
}

int FundamentalsForm::AddToScanList(const std::vector<int>& rows) {
    const std::string& data = m_session.folders.DataFolder;
    const auto names = ReadNames(data);
    const auto listPath = store::ListPath(data, 'Z');
    std::vector<store::ChartListEntry> list;
    if (platform::FileExists(listPath) && !store::ReadList(listPath, list)) list.clear();
    int added = 0;
    for (const int r : rows) {
        if (r < 0 || r >= static_cast<int>(m_rows.size())) continue;
        const std::string& code = m_rows[static_cast<std::size_t>(r)][0];
        for (std::size_t i = 0; i < names.size(); ++i)
            if (names[i].TrimmedCode() == code) {
                list.push_back({static_cast<std::int16_t>(i + 1), code});
                ++added;
                break;
            }
    }
    if (added > 0) {
        if (auto st = store::WriteList(listPath, list); !st) {
            m_session.dialogs().MsgBox(st.message(), kTitle);
            return 0;
        }
    }
    m_session.dialogs().MsgBox(std::to_string(added) + " added to the scan results list", kTitle);
    return added;
}

void FundamentalsForm::BeginTransfer() {
    m_session.dialogs().MsgBox(kTransferMessage, kTransferTitle);
    m_transferPending = true;
}

int FundamentalsForm::HeadingClicked(int column) {
    if (!m_transferPending) return -1;
    m_transferPending = false;
    if (column < 0 || column >= static_cast<int>(m_headers.size())) return -1;
    std::map<std::string, std::string> values;
    for (const auto& row : m_rows) {
        std::string text = row[static_cast<std::size_t>(column)];
        std::erase(text, ',');
        values.emplace(row[0], Trim(text.substr(0, store::NameRecord::kOtherDetailsWidth)));
    }
    const std::string& data = m_session.folders.DataFolder;
    auto names = ReadNames(data);
    int changed = 0;
    for (auto& n : names)
        if (const auto it = values.find(n.TrimmedCode());
            it != values.end() && Trim(n.OtherDetails) != it->second) {
            n.OtherDetails = it->second;
            ++changed;
        }
    if (changed > 0) {
        if (auto st = store::SaveNameFile(data, names); !st) {
            m_session.dialogs().MsgBox(st.message(), kTransferTitle);
            return -1;
        }
    }
    return changed;
}

bool FundamentalsForm::hidden(int column) const {
    return column >= 0 && column < static_cast<int>(m_hidden.size()) &&
           m_hidden[static_cast<std::size_t>(column)];
}

void FundamentalsForm::HideColumn(int column) {
    if (column < 0 || column >= static_cast<int>(m_hidden.size())) return;
    m_hidden[static_cast<std::size_t>(column)] = true;
    m_session.services().settings.Save(platform::kAppName, kColumnsSection, ColumnKey(column),
                                       "Hidden");
}

void FundamentalsForm::ShowAllColumns() {
    for (std::size_t c = 0; c < m_hidden.size(); ++c) {
        if (!m_hidden[c]) continue;
        m_hidden[c] = false;
        m_session.services().settings.Save(platform::kAppName, kColumnsSection,
                                           ColumnKey(static_cast<int>(c)), "Shown");
    }
}

} // namespace kori::app
