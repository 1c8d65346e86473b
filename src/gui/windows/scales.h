#pragma once
// Scales: the fixed base and top of the price scale and the point-and-figure box value of a
// security, kept in its name record.
#include "gui/windows/chart_default_window.h"

class QLineEdit;

namespace kori::gui {

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

} // namespace kori::gui
