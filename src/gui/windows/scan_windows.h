#pragma once
// The scan windows of the "&Chart Scans" menu: chtScan1 (prices and oscillators) with its
// results grid, and ChtScan2, ChtScan3 and ChtScan6 with their listings. Each walks with its
// own progress bar and Cancel, and opens the chart of a find on a double click.
#include "app/scan_forms.h"

#include <QDialog>

#include <array>
#include <functional>
#include <memory>

class QBoxLayout;
class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QListWidget;
class QPrinter;
class QPushButton;
class QStatusBar;

namespace kori::gui {

class GridView;
class QtProgress;

// Opens the chart of a code.
using ShowChartOf = std::function<void(const std::string& code)>;

// What the scan windows share: the Proceed, Print and Close buttons, the status line with the
// progress bar and Cancel, and a walk that the window's close cannot cut short.
class ScanWindow : public QDialog {
    Q_OBJECT
public:
    ScanWindow(app::Session& session, ShowChartOf showChart, QWidget* parent);
    ~ScanWindow() override;

    QtProgress& progress() { return *m_progress; }
    QLabel* status() const { return m_status; }
    bool running() const { return m_running; }
    // "Proceed": the choices checked, the walk run, the finds shown. False when refused.
    virtual bool Proceed() = 0;
    // The listing or results on a printer; false with nothing to print.
    virtual bool PrintTo(QPrinter& printer) = 0;

protected:
    // The buttons row and the status line, added at the end of the window's layout.
    void AddFoot(QBoxLayout* layout);
    // Runs `walk` with the controls disabled and the Cancel live.
    void RunWalk(const std::function<void()>& walk);
    void ShowMessage(const std::optional<scan::ScanMessage>& m, bool cancelled);
    bool Refused(const std::optional<scan::ScanMessage>& m);
    void Print();
    void closeEvent(QCloseEvent* e) override;
    void reject() override; // Escape: during a walk it cancels the walk instead

    app::Session& m_session;
    ShowChartOf m_showChart;
    QWidget* m_controls = nullptr; // what is disabled while the walk runs
    QPushButton* m_proceed = nullptr;
    QLabel* m_status = nullptr;

private:
    QStatusBar* m_bar = nullptr;
    std::unique_ptr<QtProgress> m_progress;
    bool m_running = false;
};

// The widgets of the shared frame: list selector, warrants, class and price range.
struct ScanFrameBoxes {
    QComboBox* List = nullptr;
    QCheckBox* NoWarrants = nullptr;
    QCheckBox* ClassOn = nullptr;
    QLineEdit* Class = nullptr;
    QCheckBox* Range = nullptr;
    QLineEdit* Min = nullptr;
    QLineEdit* Max = nullptr;
};

class ChtScan1 : public ScanWindow {
    Q_OBJECT
public:
    ChtScan1(app::Session& session, ShowChartOf showChart, QWidget* parent = nullptr);

    app::Scan1Form& form() { return m_form; }
    const ScanFrameBoxes& frame() const { return m_frame; }
    QCheckBox* rise() const { return m_rise; }
    QLineEdit* risePercent() const { return m_risePercent; }
    QCheckBox* fall() const { return m_fall; }
    QLineEdit* fallPercent() const { return m_fallPercent; }
    QCheckBox* categoryOn() const { return m_categoryOn; }
    QLineEdit* category() const { return m_category; }
    QCheckBox* osc(std::size_t k) const { return m_osc[k]; }
    QCheckBox* indication(std::size_t k) const { return m_ind[k]; }
    GridView* grid() const { return m_grid; }
    QLabel* heading() const { return m_heading; }

    bool Proceed() override;
    bool PrintTo(QPrinter& printer) override;
    // The chart of the grid's current row.
    void ShowChart();
    // Deletes the selected rows after the question.
    void DeleteSelected();

private:
    void Take();

    app::Scan1Form m_form;
    ScanFrameBoxes m_frame;
    QCheckBox *m_rise, *m_fall, *m_categoryOn;
    QLineEdit *m_risePercent, *m_fallPercent, *m_category;
    std::array<QCheckBox*, 5> m_osc{};
    std::array<QCheckBox*, 4> m_ind{};
    QLabel* m_heading;
    GridView* m_grid;
};

// Scans 2, 3 and 6 show their finds as lines of a list box under a heading line.
class ListingScanWindow : public ScanWindow {
    Q_OBJECT
public:
    ListingScanWindow(app::Session& session, ShowChartOf showChart, QWidget* parent);
    QListWidget* list() const { return m_list; }
    QLabel* heading() const { return m_heading; }
    // The chart of the list's current line.
    void ShowChart();

protected:
    // The list box and its heading, added to `layout`.
    void AddListing(QBoxLayout* layout);
    void ShowListing(const app::ScanListingLines& listing, int firstShown = 0);
    // The closing message of a walk, or its failure.
    void Finish(const scan::ScanListing& r);
    // What each listing scan does once its choices are in the form: refuse them, or walk and
    // show the finds (the last lines, where the form keeps to them).
    template <class Form> bool RunListing(Form& form) {
        if (Refused(form.Refusal())) return false;
        const scan::ScanListing* r = nullptr;
        RunWalk([&] { r = &form.Run(progress()); });
        if constexpr (requires { form.FirstShownLine(); })
            ShowListing(form.listing(), form.FirstShownLine());
        else
            ShowListing(form.listing());
        Finish(*r);
        return true;
    }
    // The listing on paper, or the message that there is none.
    bool PrintPages(QPrinter& printer,
                    const std::function<std::vector<app::PrintedPage>(int)>& pages, bool empty);
    template <class Form> bool PrintListing(QPrinter& printer, const Form& form) {
        return PrintPages(
            printer, [&form](int n) { return form.Pages(n); }, form.listing().Lines.empty());
    }

private:
    QLabel* m_heading = nullptr;
    QListWidget* m_list = nullptr;
    std::vector<std::string> m_codes;
};

class ChtScan2 : public ListingScanWindow {
    Q_OBJECT
public:
    ChtScan2(app::Session& session, ShowChartOf showChart, QWidget* parent = nullptr);
    app::Scan2Form& form() { return m_form; }
    const ScanFrameBoxes& frame() const { return m_frame; }
    QCheckBox* volume() const { return m_volume; }
    QLineEdit* volumePercent() const { return m_volumePercent; }
    QLineEdit* volumeDays() const { return m_volumeDays; }
    QCheckBox* price() const { return m_price; }
    QLineEdit* pricePercent() const { return m_pricePercent; }
    bool Proceed() override;
    bool PrintTo(QPrinter& printer) override;

private:
    app::Scan2Form m_form;
    ScanFrameBoxes m_frame;
    QCheckBox *m_volume, *m_price;
    QLineEdit *m_volumePercent, *m_volumeDays, *m_pricePercent;
};

class ChtScan3 : public ListingScanWindow {
    Q_OBJECT
public:
    ChtScan3(app::Session& session, ShowChartOf showChart, QWidget* parent = nullptr);
    app::Scan3Form& form() { return m_form; }
    const ScanFrameBoxes& frame() const { return m_frame; }
    QCheckBox* up() const { return m_up; }
    QCheckBox* down() const { return m_down; }
    QCheckBox* categoryOn() const { return m_categoryOn; }
    QLineEdit* category() const { return m_category; }
    bool Proceed() override;
    bool PrintTo(QPrinter& printer) override;

private:
    app::Scan3Form m_form;
    ScanFrameBoxes m_frame;
    QCheckBox *m_up, *m_down, *m_categoryOn;
    QLineEdit* m_category;
};

class ChtScan6 : public ListingScanWindow {
    Q_OBJECT
public:
    ChtScan6(app::Session& session, ShowChartOf showChart, QWidget* parent = nullptr);
    app::Scan6Form& form() { return m_form; }
    const ScanFrameBoxes& frame() const { return m_frame; }
    QComboBox* codeLength() const { return m_codeLength; }
    bool Proceed() override;
    bool PrintTo(QPrinter& printer) override;

private:
    app::Scan6Form m_form;
    ScanFrameBoxes m_frame; // no list selector: the walk always reads the name file
    QComboBox* m_codeLength;
};

} // namespace kori::gui
