#pragma once
// DLList ("Update with Downloaded Data "): the waiting day files oldest first, updated one day
// or all at once with progress, or removed.
#include "app/download_list_form.h"

#include <QDialog>

class QLabel;
class QListWidget;
class QPushButton;

namespace kori::gui {

class QtProgress;

class DLList : public QDialog {
    Q_OBJECT
public:
    DLList(app::Session& session, QtProgress& progress, QWidget* parent = nullptr);

    app::DownloadListForm& form() { return m_form; }
    QListWidget* list() const { return m_list; }
    QLabel* status() const { return m_status; }
    void UpdateOneDay();
    void UpdateAll();
    void RemoveDate();
    // Closing after an update that added maintenance items tells so and opens the list.
    void done(int result) override;

private:
    void Running(bool on);
    void Refill();

    app::Session& m_session;
    QtProgress& m_progress;
    app::DownloadListForm m_form;
    QListWidget* m_list;
    QLabel* m_status;
    QPushButton *m_one, *m_all, *m_remove, *m_close;
};

} // namespace kori::gui
