#pragma once
// Progress of long work in the main window's status bar, with a Cancel button that sets the
// cancel flag the work polls.
#include "platform/progress.h"

class QProgressBar;
class QLabel;
class QPushButton;
class QStatusBar;

namespace kori::gui {

class QtProgress : public platform::Progress {
public:
    explicit QtProgress(QStatusBar* bar);
    void SetStatus(std::string_view text) override;
    void SetRange(long long maximum) override;
    void SetValue(long long value) override;
    void Yield() override;
    void Finish(); // hides the bar again
    QStatusBar* statusBar() const { return m_bar; }
    bool barShown() const; // the bar and its Cancel button are on show

private:
    QStatusBar* m_bar;
    QLabel* m_label;
    QProgressBar* m_progress;
    QPushButton* m_cancel;
};

} // namespace kori::gui
