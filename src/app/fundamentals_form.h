#pragma once
// Fundmnt ("Fundamentals"): the security details file as a table, one row a security, with the
// price, PE ratio, yield and GICS sector worked out beside it on demand and columns the user
// hid kept hidden. The window shows this model; the conversions and figures are here.
#include "app/session.h"

#include <string>
#include <vector>

namespace kori::app {

class FundamentalsForm {
public:
    static constexpr const char* kTitle = "Fundamentals";
    static constexpr const char* kTransferTitle = "Transfer to Name File";
    static constexpr const char* kTransferMessage =
        "Click the description of the data that you want transferred to the Other Details "
        "section of the Name file";
    // The four columns at the end of the table.
    static constexpr int kExtraColumns = 4;

    explicit FundamentalsForm(Session& session);

    // The menu item is enabled only when this holds.
    bool Available() const;
    // Reads the header labels and every record, converted for display. Without the header or
    // records: "There is no fundamental data" under "ASX Security Data", and false.
    bool Load();

    const std::vector<std::string>& headers() const { return m_headers; }
    const std::vector<std::vector<std::string>>& rows() const { return m_rows; }
    // The first column of the four worked-out ones.
    int priceColumn() const { return m_priceColumn; }

    // "Show Current Price,PE Ratio,Yield and GICS": the four columns for every row.
    void ShowFigures();

    // "Show Industry Groups/Classifications": a column "Ind Class" (added once) with each
    // security's class from Names.dat, formatted "000".
    void ShowIndustryClasses();
    // "Add Highlighted Stocks to Scan Results List": the rows' codes found in Names.dat are
    // appended to SubListZ.Dat; the number added, told to the user.
    int AddToScanList(const std::vector<int>& rows);
    // "Update Name File (Other Details)": the message, then the next heading clicked is copied.
    void BeginTransfer();
    bool transferPending() const { return m_transferPending; }
    // A click on a column heading: while a transfer waits, that column of every row goes to
    // the other details of the security's name record (cut to the field, commas dropped);
    // the number of records changed, or -1 when nothing waited or the save failed.
    int HeadingClicked(int column);

    // Columns hidden by the user, kept in the settings store ("ASX Columns").
    bool hidden(int column) const;
    void HideColumn(int column);
    void ShowAllColumns();

    // One field of a record shown as the table shows it (`field` numbered from 1, the code
    // being the first).
    static std::string DisplayField(int field, const std::string& text);

private:
    Session& m_session;
    std::vector<std::string> m_headers;
    std::vector<std::vector<std::string>> m_rows;
    std::vector<bool> m_hidden;
    int m_priceColumn = 0;
    int m_classColumn = -1;
    bool m_transferPending = false;
};

} // namespace kori::app
