#include "app/data_entry_form.h"

#include "platform/date_entry.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_file.h"

namespace kori::app {

namespace {
constexpr const char* kMessageTitle = "Data Entry";
}

DataEntryForm::DataEntryForm(std::string dataFolder, platform::Dialogs& dialogs)
    : m_dataFolder(std::move(dataFolder)), m_dialogs(dialogs) {}

bool DataEntryForm::Open() {
    m_names.clear();
    m_current = -1;
    m_previous.reset();
    store::NameFile file(store::NameFile::PathIn(m_dataFolder));
    if (platform::FileExists(file.path())) {
        if (auto s = file.ReadAll(m_names); !s) {
            m_dialogs.MsgBox(s.message(), kMessageTitle);
            m_names.clear();
            return false;
        }
    }
    if (m_names.empty()) {
        m_dialogs.MsgBox("No Records in Name File", kMessageTitle);
        return false;
    }
    return Show(0);
}

bool DataEntryForm::ChangeFolder(std::string dataFolder) {
    m_dataFolder = platform::FolderWithSlash(dataFolder);
    return Open();
}

std::string DataEntryForm::RecordTypeText() const {
    if (m_current < 0) return "Rec.Tp  ";
    return "Rec.Tp  " + std::to_string(name().RecordType);
}

std::array<DataEntryForm::FigureRow, DataEntryForm::kFigures> DataEntryForm::Figures() const {
    const int type = m_current < 0 ? 4 : name().RecordType;
    if (type == 3)
        return {{{"", false}, {"Rises", true}, {"Falls", true}, {"Cum.Total", true}, {"", false}}};
    return {{{"Open", true},
             {"High", true},
             {"Low", true},
             {"Close", true},
             {type == 2 ? "" : "Volume", type != 2}}};
}

std::array<std::string, DataEntryForm::kFigures + 1> DataEntryForm::PreviousTexts() const {
    std::array<std::string, kFigures + 1> texts;
    if (!m_previous) return texts;
    const auto& p = *m_previous;
    const bool counts = m_current >= 0 && name().RecordType == 3;
    const auto figure = [counts](float v) {
        return platform::FormatSingle(v, counts ? "0" : "0.00#");
    };
    texts[0] = platform::DateTextToEntry(p.Date);
    const auto rows = Figures();
    const std::array<float, 4> prices = {p.Open, p.High, p.Low, p.Close};
    for (std::size_t i = 0; i < prices.size(); ++i)
        if (rows[i].Shown) texts[i + 1] = figure(prices[i]);
    if (rows[4].Shown) texts[5] = std::to_string(p.Volume);
    return texts;
}

bool DataEntryForm::Show(int index) {
    if (index < 0 || index >= securityCount()) return false;
    m_current = index;
    m_selectDate = false;
    const auto path = store::PriceFile::PathFor(m_dataFolder, name().TrimmedCode());
    m_previous = intake::LastPriceRecord(path);
    if (!m_previous) {
        m_dialogs.MsgBox("No previous data for " + name().TrimmedCode(), kMessageTitle);
        return true;
    }
    if (autoDateAdvance)
        if (const auto next = intake::NextTradingDate(m_previous->Date))
            entered.Date = platform::DateTextToEntry(*next);
    return true;
}

bool DataEntryForm::GoToCode(std::string_view code) {
    const auto found = store::FindCodeInNameFile(m_dataFolder, code, m_dialogs);
    if (!found) return false;
    // The name file may have changed since it was read: read it again when it has.
    if (found->RecordNumber > securityCount() ||
        m_names[static_cast<std::size_t>(found->RecordNumber - 1)].Code != found->Record.Code) {
        store::NameFile file(store::NameFile::PathIn(m_dataFolder));
        if (!file.ReadAll(m_names)) return false;
    }
    return Show(found->RecordNumber - 1);
}

void DataEntryForm::Step(int delta) {
    const int n = securityCount();
    if (n == 0) return;
    Show(((m_current + delta) % n + n) % n);
}

void DataEntryForm::Refuse(const intake::EntryRefusal& r) {
    m_dialogs.Beep();
    m_dialogs.MsgBox(r.Message, r.Title);
}

bool DataEntryForm::LeaveTotal() {
    if (m_current < 0 || name().RecordType != 3) return true;
    if (const auto r = intake::CheckKeyedFigures(3, entered, m_previous ? m_previous->Close : 0)) {
        Refuse(*r);
        return false;
    }
    return true;
}

bool DataEntryForm::Save() {
    if (m_current < 0) return false;
    const auto result = intake::SaveKeyedDay(m_dataFolder, name(), entered);
    if (!result.Saved) {
        Refuse(result.Refusal);
        return false;
    }
    const std::string saved = result.Record.Date;
    if (autoDateAdvance) {
        Show(m_current);
        Reset();
    } else {
        m_previous = result.Record;
        entered.Date = platform::DateTextToEntry(saved);
    }
    if (advanceAfterSave)
        if (const auto next = intake::NextTradingDate(saved))
            entered.Date = platform::DateTextToEntry(*next);
    m_selectDate = !autoDateAdvance;
    return true;
}

void DataEntryForm::Reset() {
    entered.Open.clear();
    entered.High.clear();
    entered.Low.clear();
    entered.Close.clear();
    entered.Volume.clear();
}

} // namespace kori::app
