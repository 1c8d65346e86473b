#pragma once
// The stage label, bar and Cancel button every maintenance window shows while it works: the
// platform progress its walk reports to.
#include "platform/progress.h"

#include <QWidget>

class QLabel;
class QProgressBar;
class QPushButton;

namespace kori::gui {

class RepairProgress : public QWidget, public platform::Progress {
    Q_OBJECT
public:
    explicit RepairProgress(QWidget* parent = nullptr);
    void SetStatus(std::string_view text) override;
    void SetRange(long long maximum) override;
    void SetValue(long long value) override;
    void Yield() override;
    QLabel* label() const { return m_label; }
    QProgressBar* bar() const { return m_bar; }
    QPushButton* cancelButton() const { return m_cancel; }

private:
    QLabel* m_label;
    QProgressBar* m_bar;
    QPushButton* m_cancel;
};

} // namespace kori::gui
