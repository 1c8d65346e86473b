#pragma once
// The small windows of the chart defaults. Each edits one or two values; OK checks them,
// stores them and has the chart on show rebuilt.
#include "app/window_rules.h"
#include "chart/chart_defaults.h"
#include "gui/widgets/settings_dialog.h"

#include <array>

class QCheckBox;
class QComboBox;
class QLineEdit;
class QRadioButton;
class QVBoxLayout;

namespace kori::gui {

class ChartDefaultWindow : public SettingsDialog {
    Q_OBJECT
public:
    ChartDefaultWindow(app::Session& session, SettingsHub& hub, const char* name,
                       const QString& title, QWidget* parent);
    // Checks and stores the value; false leaves the window open.
    virtual bool Ok() = 0;

protected:
    // OK and Cancel under the window's own rows.
    void AddButtons();
    // Writes the defaults and asks for the chart again.
    void Store();

    chart::ChartDefaults m_defaults;
    QVBoxLayout* m_layout;
};

// PLW: the line width of printed charts, 1 to 10.
class PLW : public ChartDefaultWindow {
    Q_OBJECT
public:
    PLW(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* width() const { return m_width; }
    bool Ok() override;

private:
    QLineEdit* m_width;
};

// BlankSpc: blank chart units at the right of the chart.
class BlankSpc : public ChartDefaultWindow {
    Q_OBJECT
public:
    BlankSpc(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* blank() const { return m_blank; }
    bool Ok() override;

private:
    QLineEdit* m_blank;
};

// GLSpaces: the vertical grid space (0 turns the date grid off) and the price grid at half
// steps.
class GLSpaces : public ChartDefaultWindow {
    Q_OBJECT
public:
    GLSpaces(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* space() const { return m_space; }
    QCheckBox* midGrid() const { return m_midGrid; }
    bool Ok() override;

private:
    QLineEdit* m_space;
    QCheckBox* m_midGrid;
};

// VHeight: the volume panel at one, two or three times its height.
class VHeight : public ChartDefaultWindow {
    Q_OBJECT
public:
    VHeight(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QRadioButton* option(int multiple) const {
        return m_options[static_cast<std::size_t>(multiple - 1)];
    }
    bool Ok() override;

private:
    std::array<QRadioButton*, 3> m_options{};
};

// StpLs: the stop-loss line and its percentage, 0 to 100.
class StpLs : public ChartDefaultWindow {
    Q_OBJECT
public:
    StpLs(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QCheckBox* on() const { return m_on; }
    QLineEdit* percent() const { return m_percent; }
    bool Ok() override;

private:
    QCheckBox* m_on;
    QLineEdit* m_percent;
};

// MMASet: the twelve periods of the multiple moving averages, "Ave 1" to "Ave 6" twice.
class MMASet : public ChartDefaultWindow {
    Q_OBJECT
public:
    MMASet(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* box(int i) const { return m_boxes[static_cast<std::size_t>(i)]; }
    void Default();
    bool Ok() override;

private:
    std::array<QLineEdit*, 12> m_boxes{};
};

// SwingSet: the swing method and its days or points.
class SwingSet : public ChartDefaultWindow {
    Q_OBJECT
public:
    SwingSet(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QRadioButton* method(int i) const { return m_methods[static_cast<std::size_t>(i)]; }
    QLineEdit* value() const { return m_value; }
    bool Ok() override;

private:
    std::array<QRadioButton*, 4> m_methods{};
    QLineEdit* m_value;
};

// Scales: the fixed base and top of the price scale and the point-and-figure box value of a
// security, kept in its name record.
class Scales : public ChartDefaultWindow {
    Q_OBJECT
public:
    Scales(app::Session& session, SettingsHub& hub, const std::string& code,
           QWidget* parent = nullptr);
    QLineEdit* code() const { return m_code; }
    QLineEdit* base() const { return m_base; }
    QLineEdit* top() const { return m_top; }
    QLineEdit* pfIncrement() const { return m_pf; }
    // Finds the code in the name file and shows its scales; false when it is not there.
    bool Lookup();
    bool Ok() override;

private:
    QLineEdit* m_code;
    QLineEdit* m_base;
    QLineEdit* m_top;
    QLineEdit* m_pf;
    int m_record = 0;
};

// Chart2: the second chart of a split, by code and period.
class Chart2 : public ChartDefaultWindow {
    Q_OBJECT
public:
    Chart2(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);
    QLineEdit* code() const { return m_code; }
    QComboBox* period() const { return m_period; }
    bool Ok() override;

private:
    QLineEdit* m_code;
    QComboBox* m_period;
};

} // namespace kori::gui
