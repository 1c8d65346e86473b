#include "app/scan_forms.h"

#include "app/chart_service.h"
#include "chart/chart_defaults.h"
#include "osc/osc_settings.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/chart_list.h"

#include <algorithm>

namespace kori::app {

namespace {

using platform::Trim;

// The keys the choices are kept under, by window.
void LoadFrame(const ScanChoices& c, scan::ScanFrame& f) {
    f.Range.On = c.Tick("Range", f.Range.On);
    f.Range.Min = c.Text("Min", f.Range.Min);
    f.Range.Max = c.Text("Max", f.Range.Max);
    f.ClassOn = c.Tick("ClassOn", f.ClassOn);
    f.Class = c.Text("Class", f.Class);
}

void SaveFrame(ScanChoices& c, const scan::ScanFrame& f) {
    c.Put("Range", f.Range.On);
    c.Put("Min", f.Range.Min);
    c.Put("Max", f.Range.Max);
    c.Put("ClassOn", f.ClassOn);
    c.Put("Class", f.Class);
}

constexpr std::array<const char*, 5> kOscKeys = {"STO", "WMS", "ROC", "MM", "RSI"};

} // namespace

std::vector<std::string> ScanListCaptions(const Session& session) {
    std::vector<std::string> captions{"Full List (Names.dat)"};
    for (auto& c : store::ListChoices(const_cast<Session&>(session).services().settings, false))
        captions.push_back(Trim(c));
    return captions;
}

char ScanListLetter(int index) {
    return index <= 0 ? '\0' : store::ListLetterOfMode(store::ModeOfChoice(index - 1));
}

std::string DeleteRowQuestion(int row) {
    return "Delete row " + std::to_string(row) + " ?";
}

std::string DeleteItemsQuestion(int first, int last) {
    return "Delete items " + std::to_string(first) + " to " + std::to_string(last);
}

// ---- ScanChoices ----

std::string ScanChoices::Text(std::string_view key, std::string_view fallback) const {
    const std::string v = m_store.Get(platform::kAppName, m_section, key, "unknown");
    return v == "unknown" ? std::string(fallback) : v;
}

bool ScanChoices::Tick(std::string_view key, bool fallback) const {
    const std::string v = Text(key, "");
    if (v == "1") return true;
    if (v == "0") return false;
    return fallback;
}

int ScanChoices::Index(std::string_view key, int count) const {
    const std::string v = Trim(Text(key, "0"));
    if (v.empty() || v.find_first_not_of("0123456789") != std::string::npos) return 0;
    const int i = static_cast<int>(platform::Val(v));
    return i < count ? i : 0;
}

void ScanChoices::Put(std::string_view key, std::string_view text) {
    m_store.Save(platform::kAppName, m_section, key, text);
}

void ScanChoices::Put(std::string_view key, bool tick) {
    Put(key, std::string_view(tick ? "1" : "0"));
}

void ScanChoices::Put(std::string_view key, int index) {
    Put(key, std::string_view(std::to_string(index)));
}

// ---- Scan 1 ----

Scan1Form::Scan1Form(Session& session)
    : m_session(session), m_choices(session.services().settings, "Scan1_Other"),
      m_captions(ScanListCaptions(session)),
      m_grid({"All", "Code", "Name", "Close", "Move", "Change", "STO", "WMS", "ROC", "MM", "RSI"}) {
    auto& o = Options;
    ListIndex = m_choices.Index("List", static_cast<int>(m_captions.size()));
    o.Rise = m_choices.Tick("Rise", o.Rise);
    o.RisePercent = m_choices.Text("RisePercent", o.RisePercent);
    o.Fall = m_choices.Tick("Fall", o.Fall);
    o.FallPercent = m_choices.Text("FallPercent", o.FallPercent);
    o.Range.On = m_choices.Tick("Range", o.Range.On);
    o.Range.Min = m_choices.Text("Min", o.Range.Min);
    o.Range.Max = m_choices.Text("Max", o.Range.Max);
    o.CategoryOn = m_choices.Tick("CategoryOn", o.CategoryOn);
    o.Category = m_choices.Text("Category", o.Category);
    o.ClassOn = m_choices.Tick("ClassOn", o.ClassOn);
    o.Class = m_choices.Text("Class", o.Class);
    o.NoWarrants = m_choices.Tick("NoWarrants", o.NoWarrants);
    for (std::size_t k = 0; k < kOscKeys.size(); ++k)
        o.Osc[k] = m_choices.Tick(kOscKeys[k], false);
    o.Indications.OB = m_choices.Tick("OB", false);
    o.Indications.OS = m_choices.Tick("OS", false);
    o.Indications.CutOB = m_choices.Tick("CutOB", false);
    o.Indications.CutOS = m_choices.Tick("CutOS", false);
}

void Scan1Form::SaveChoices() {
    const auto& o = Options;
    m_choices.Put("List", ListIndex);
    m_choices.Put("Rise", o.Rise);
    m_choices.Put("RisePercent", o.RisePercent);
    m_choices.Put("Fall", o.Fall);
    m_choices.Put("FallPercent", o.FallPercent);
    m_choices.Put("Range", o.Range.On);
    m_choices.Put("Min", o.Range.Min);
    m_choices.Put("Max", o.Range.Max);
    m_choices.Put("CategoryOn", o.CategoryOn);
    m_choices.Put("Category", o.Category);
    m_choices.Put("ClassOn", o.ClassOn);
    m_choices.Put("Class", o.Class);
    m_choices.Put("NoWarrants", o.NoWarrants);
    for (std::size_t k = 0; k < kOscKeys.size(); ++k)
        m_choices.Put(kOscKeys[k], o.Osc[k]);
    m_choices.Put("OB", o.Indications.OB);
    m_choices.Put("OS", o.Indications.OS);
    m_choices.Put("CutOB", o.Indications.CutOB);
    m_choices.Put("CutOS", o.Indications.CutOS);
}

std::optional<scan::ScanMessage> Scan1Form::Refusal() const {
    return scan::ValidateScan1(Options, osc::ReadOscSettings(m_session.ini()));
}

const scan::Scan1Result& Scan1Form::Run(platform::Progress& progress) {
    SaveChoices();
    Options.List = ScanListLetter(ListIndex);
    m_result = scan::RunScan1(m_session.folders.DataFolder, Options,
                              osc::ReadOscSettings(m_session.ini()), progress);
    Fill();
    return m_result;
}

void Scan1Form::Fill() {
    std::vector<GridModel::Row> rows;
    rows.reserve(m_result.Rows.size());
    for (const auto& r : m_result.Rows) {
        GridModel::Row row{r.All ? "*" : "", Trim(r.Code),
                           Trim(r.Name),     platform::FormatSingle(r.Close, "####.00"),
                           r.Move,           r.Change ? platform::Format(*r.Change, "0.00") : ""};
        for (const auto& ind : r.Indications)
            row.push_back(ind);
        rows.push_back(std::move(row));
    }
    m_grid.LoadInForm(std::move(rows));
}

std::string Scan1Form::GridHeading() const {
    std::string heading = "SCAN RESULTS        Date:";
    if (!m_result.LastDate.empty())
        heading += " " + platform::FormatDate(m_result.LastDate, "d/m/yy");
    return heading;
}

std::string Scan1Form::CodeAt(int row) const {
    if (row < 0 || row >= m_grid.rowCount()) return {};
    return m_grid.cell(row, 1);
}

bool Scan1Form::DeleteRows(int first, int last, platform::Dialogs& dialogs) {
    if (first > last) std::swap(first, last);
    first = std::max(first, 0);
    last = std::min(last, m_grid.rowCount() - 1);
    if (first > last) return false;
    const std::string question =
        first == last ? DeleteRowQuestion(first + 1) : DeleteItemsQuestion(first + 1, last + 1);
    if (dialogs.MsgBox(question, kScanGridTitle, platform::Buttons::YesNo,
                       platform::Icon::Question) != platform::Answer::Yes)
        return false;
    for (int r = last; r >= first; --r)
        m_grid.DeleteRow(r);
    return true;
}

std::vector<PrintedPage> Scan1Form::Pages(int linesPerPage) const {
    // The printed columns: the grid's, with only the oscillators the scan tested.
    static constexpr std::array<int, 11> kWidths = {4, 10, 32, 10, 6, 9, 11, 11, 11, 11, 11};
    std::vector<std::size_t> shown;
    for (std::size_t c = 0; c < kWidths.size(); ++c)
        if (c < 6 || Options.Osc[c - 6]) shown.push_back(c);
    PrintedColumns columns;
    for (auto c : shown)
        columns.Widths.push_back(kWidths[c]);
    auto line = [&](const std::vector<std::string>& cells) {
        std::vector<std::string> picked;
        for (auto c : shown)
            picked.push_back(c < cells.size() ? cells[c] : std::string());
        return columns.Line(picked);
    };
    std::vector<std::string> body;
    body.reserve(static_cast<std::size_t>(m_grid.rowCount()));
    for (const auto& row : m_grid.rows())
        body.push_back(line(row));
    const std::string heads = line(m_grid.headers());
    const std::string date = GridHeading();
    auto pages = PaginateLines(body, linesPerPage, [&](int page) {
        return std::vector<PrintedLine>{
            {"ANALYSIS RESULTS  " + std::string("Page ") + std::to_string(page), false, true},
            {date},
            {heads},
            {""}};
    });
    for (auto& p : pages)
        p.TabStops = columns.Stops();
    return pages;
}

// ---- the listings of Scans 2, 3 and 6 ----

std::vector<PrintedPage> ListingPages(std::string_view title, const ScanListingLines& listing,
                                      int linesPerPage) {
    const std::string t(title);
    return PaginateLines(listing.Lines, linesPerPage, [&](int page) {
        return std::vector<PrintedLine>{
            {page == 1 ? t : t + "  (continued)", false, true}, {listing.Heading}, {""}};
    });
}

ListingScanForm::ListingScanForm(Session& session, std::string section, std::string heading,
                                 bool withLists)
    : m_session(session), m_choices(session.services().settings, std::move(section)) {
    if (withLists) {
        m_captions = ScanListCaptions(session);
        ListIndex = m_choices.Index("List", static_cast<int>(m_captions.size()));
    }
    m_listing.Heading = std::move(heading);
}

void ListingScanForm::LoadShared(scan::ScanFrame& frame, bool* noWarrants) {
    LoadFrame(m_choices, frame);
    if (noWarrants) *noWarrants = m_choices.Tick("NoWarrants", *noWarrants);
}

void ListingScanForm::SaveShared(const scan::ScanFrame& frame, const bool* noWarrants) {
    if (!m_captions.empty()) m_choices.Put("List", ListIndex);
    SaveFrame(m_choices, frame);
    if (noWarrants) m_choices.Put("NoWarrants", *noWarrants);
}

Scan2Form::Scan2Form(Session& session)
    : ListingScanForm(session, "Scan2_Other", std::string(scan::kScan2Heading), true) {
    auto& o = Options;
    LoadShared(o.Frame, &o.NoWarrants);
    o.Volume = m_choices.Tick("Volume", o.Volume);
    o.VolumePercent = m_choices.Text("VolumePercent", o.VolumePercent);
    o.VolumeDays = m_choices.Text("VolumeDays", o.VolumeDays);
    o.Price = m_choices.Tick("Price", o.Price);
    o.PricePercent = m_choices.Text("PricePercent", o.PricePercent);
}

void Scan2Form::SaveChoices() {
    const auto& o = Options;
    SaveShared(o.Frame, &o.NoWarrants);
    m_choices.Put("Volume", o.Volume);
    m_choices.Put("VolumePercent", o.VolumePercent);
    m_choices.Put("VolumeDays", o.VolumeDays);
    m_choices.Put("Price", o.Price);
    m_choices.Put("PricePercent", o.PricePercent);
}

std::optional<scan::ScanMessage> Scan2Form::Refusal() const {
    return scan::ValidateScan2(Options);
}

const scan::Scan2Result& Scan2Form::Run(platform::Progress& progress) {
    SaveChoices();
    Options.List = ScanListLetter(ListIndex);
    Options.ReportFolder = TempFolder(m_session).string();
    m_result = scan::RunScan2(m_session.folders.DataFolder, Options, progress);
    List(m_result.Rows, scan::Scan2Line);
    return m_result;
}

std::vector<PrintedPage> Scan2Form::Pages(int linesPerPage) const {
    return ListingPages(scan::kScan2Title, m_listing, linesPerPage);
}

Scan3Form::Scan3Form(Session& session)
    : ListingScanForm(session, "Scan3_Other", std::string(scan::kScan3Heading), true) {
    auto& o = Options;
    LoadShared(o.Frame, &o.NoWarrants);
    o.Up = m_choices.Tick("Up", o.Up);
    o.Down = m_choices.Tick("Down", o.Down);
    o.CategoryOn = m_choices.Tick("CategoryOn", o.CategoryOn);
    o.Category = m_choices.Text("Category", o.Category);
}

void Scan3Form::SaveChoices() {
    const auto& o = Options;
    SaveShared(o.Frame, &o.NoWarrants);
    m_choices.Put("Up", o.Up);
    m_choices.Put("Down", o.Down);
    m_choices.Put("CategoryOn", o.CategoryOn);
    m_choices.Put("Category", o.Category);
}

std::optional<scan::ScanMessage> Scan3Form::Refusal() const {
    return scan::ValidateScan3(Options);
}

const scan::Scan3Result& Scan3Form::Run(platform::Progress& progress) {
    SaveChoices();
    Options.List = ScanListLetter(ListIndex);
    m_result = scan::RunScan3(m_session.folders.DataFolder, Options, progress);
    List(m_result.Rows, scan::Scan3Line);
    return m_result;
}

std::vector<PrintedPage> Scan3Form::Pages(int linesPerPage) const {
    return ListingPages(scan::kScan3Title, m_listing, linesPerPage);
}

Scan6Form::Scan6Form(Session& session)
    : ListingScanForm(session, "Scan6_Other", "Code\tL/Price\tGap %\tName\tClass", false) {
    auto& o = Options;
    LoadShared(o.Frame, nullptr);
    o.CodeLength = CodeLengths()[static_cast<std::size_t>(m_choices.Index("CodeLength", 5))];
    ReadAverages();
}

const std::array<std::string, 5>& Scan6Form::CodeLengths() {
    static const std::array<std::string, 5> lengths = {"All", "3", "4", "5", "6"};
    return lengths;
}

void Scan6Form::ReadAverages() {
    const auto defaults = chart::LoadChartDefaults(m_session.ini());
    Options.Av1D = defaults.MAPeriod1Daily;
    Options.Av2D = defaults.MAPeriod2Daily;
}

void Scan6Form::SaveChoices() {
    SaveShared(Options.Frame, nullptr);
    const auto& lengths = CodeLengths();
    const auto at = std::find(lengths.begin(), lengths.end(), Options.CodeLength);
    m_choices.Put("CodeLength", static_cast<int>(at == lengths.end() ? 0 : at - lengths.begin()));
}

std::optional<scan::ScanMessage> Scan6Form::Refusal() {
    // The averages may have been changed in the chart defaults since the window opened.
    ReadAverages();
    return scan::ValidateScan6(Options);
}

const scan::Scan6Result& Scan6Form::Run(platform::Progress& progress) {
    SaveChoices();
    ReadAverages();
    Options.ReportFolder = TempFolder(m_session).string();
    m_result = scan::RunScan6(m_session.folders.DataFolder, Options, progress);
    List(m_result.Rows, scan::Scan6Line);
    return m_result;
}

int Scan6Form::FirstShownLine() const {
    return std::max(0, static_cast<int>(m_listing.Lines.size()) - 23);
}

std::vector<PrintedPage> Scan6Form::Pages(int linesPerPage) const {
    // The window is Scan 2's sibling, and its paper says so.
    ScanListingLines printed = m_listing;
    printed.Heading = std::string(scan::kScan2Heading);
    auto pages = ListingPages(scan::kScan2Title, printed, linesPerPage);
    // Its lines are tab-separated: code, close and gap under the sibling's first three headings,
    // then name and class.
    for (auto& p : pages)
        p.TabStops = {0, 7, 17, 25, 58};
    return pages;
}

} // namespace kori::app
