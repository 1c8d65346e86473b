#pragma once
// The scan windows (chtScan1, ChtScan2, ChtScan3, ChtScan6) as the user fills them: the choices
// as typed and ticked, kept in the window store between uses, the run, and what the window
// shows and prints of the finds.
#include "app/grid_model.h"
#include "app/printed_pages.h"
#include "app/session.h"
#include "platform/text.h"
#include "scan/chart_scans.h"
#include "scan/cht_scan1.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

// The list selector: "Full List (Names.dat)", then the chart lists by their names.
std::vector<std::string> ScanListCaptions(const Session& session);
// The letter of a row of the selector; 0 for the full list.
char ScanListLetter(int index);

// The questions of a deletion from the results grid (rows counted from 1).
std::string DeleteRowQuestion(int row);
std::string DeleteItemsQuestion(int first, int last);
inline constexpr const char* kScanGridTitle = "Chart Scan";

// What every scan window keeps between uses: a choice is a text or a tick under a key of the
// window's section; what the store does not hold reads as the window's default.
class ScanChoices {
public:
    ScanChoices(platform::SettingsStore& store, std::string section)
        : m_store(store), m_section(std::move(section)) {}
    std::string Text(std::string_view key, std::string_view fallback) const;
    bool Tick(std::string_view key, bool fallback) const;
    int Index(std::string_view key, int count) const; // 0 when not one of 0 .. count-1
    void Put(std::string_view key, std::string_view text);
    void Put(std::string_view key, bool tick);
    void Put(std::string_view key, int index);

private:
    platform::SettingsStore& m_store;
    std::string m_section;
};

class Scan1Form {
public:
    explicit Scan1Form(Session& session);

    const std::vector<std::string>& listCaptions() const { return m_captions; }
    int ListIndex = 0;
    scan::Scan1Options Options; // List follows ListIndex at the run

    // "Proceed": the first check that fails, with the oscillator periods of the daily settings.
    std::optional<scan::ScanMessage> Refusal() const;
    // Keeps the choices, walks the list; the grid is filled with what was found.
    const scan::Scan1Result& Run(platform::Progress& progress);
    const scan::Scan1Result& result() const { return m_result; }

    // "SCAN RESULTS        Date:" with the date of the last data met.
    std::string GridHeading() const;
    GridModel& grid() { return m_grid; }
    // The code of a grid row (empty when out of range).
    std::string CodeAt(int row) const;
    // Deletes rows first..last (0-based) after the question; true when they went.
    bool DeleteRows(int first, int last, platform::Dialogs& dialogs);

    // The printed results, headed "ANALYSIS RESULTS  " and "Page " n; nothing with no rows.
    std::vector<PrintedPage> Pages(int linesPerPage) const;

    void SaveChoices();

private:
    void Fill();

    Session& m_session;
    ScanChoices m_choices;
    std::vector<std::string> m_captions;
    scan::Scan1Result m_result;
    GridModel m_grid;
};

// A listing of Scans 2, 3 and 6: the heading line and one line a find, with their codes.
struct ScanListingLines {
    std::string Heading;
    std::vector<std::string> Lines;
    std::vector<std::string> Codes;
};

// The printed listing: the title, then the heading line, "  (continued)" after the title on the
// later pages.
std::vector<PrintedPage> ListingPages(std::string_view title, const ScanListingLines& listing,
                                      int linesPerPage);

// What the listing scans share: their session, their remembered choices, the list choice
// (where the scan offers one) and the listing of their finds.
class ListingScanForm {
public:
    const std::vector<std::string>& listCaptions() const { return m_captions; }
    int ListIndex = 0;
    const ScanListingLines& listing() const { return m_listing; }

protected:
    // `withLists`: the scan walks a chosen list, remembered with its choices.
    ListingScanForm(Session& session, std::string section, std::string heading, bool withLists);
    // The list, frame and warrant choices kept with the others.
    void LoadShared(scan::ScanFrame& frame, bool* noWarrants);
    void SaveShared(const scan::ScanFrame& frame, const bool* noWarrants);
    // The finds as lines, with their codes for the charts.
    template <class Row, class LineOf> void List(const std::vector<Row>& rows, LineOf lineOf) {
        m_listing.Lines.clear();
        m_listing.Codes.clear();
        for (const auto& r : rows) {
            m_listing.Lines.push_back(lineOf(r));
            m_listing.Codes.push_back(platform::Trim(r.Code));
        }
    }

    Session& m_session;
    ScanChoices m_choices;
    std::vector<std::string> m_captions;
    ScanListingLines m_listing;
};

class Scan2Form : public ListingScanForm {
public:
    explicit Scan2Form(Session& session);
    scan::Scan2Options Options;

    std::optional<scan::ScanMessage> Refusal() const;
    const scan::Scan2Result& Run(platform::Progress& progress);
    std::vector<PrintedPage> Pages(int linesPerPage) const;
    void SaveChoices();

private:
    scan::Scan2Result m_result;
};

class Scan3Form : public ListingScanForm {
public:
    explicit Scan3Form(Session& session);
    scan::Scan3Options Options;

    std::optional<scan::ScanMessage> Refusal() const;
    const scan::Scan3Result& Run(platform::Progress& progress);
    std::vector<PrintedPage> Pages(int linesPerPage) const;
    void SaveChoices();

private:
    scan::Scan3Result m_result;
};

class Scan6Form : public ListingScanForm {
public:
    explicit Scan6Form(Session& session);
    // "Code length": "All, 3, 4, 5, 6".
    static const std::array<std::string, 5>& CodeLengths();
    scan::Scan6Options Options; // the averages are read from the chart defaults at each check

    std::optional<scan::ScanMessage> Refusal();
    const scan::Scan6Result& Run(platform::Progress& progress);
    // The rows the box shows: the last 23 when there are more.
    int FirstShownLine() const;
    std::vector<PrintedPage> Pages(int linesPerPage) const;
    void SaveChoices();

private:
    void ReadAverages();

    scan::Scan6Result m_result;
};

} // namespace kori::app
