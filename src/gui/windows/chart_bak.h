#pragma once
// ChartBak: "Backup Chart Data" writes the whole library to one archive in the back-up folder;
// "Restore Data from Backup" lists the back-ups there, checks one, restores it, and discards
// the copies a restore kept.
#include "app/backup_form.h"

#include <QDialog>

class QLabel;
class QListWidget;
class QPushButton;
class QSpinBox;

namespace kori::gui {

class QtProgress;

class ChartBak : public QDialog {
    Q_OBJECT
public:
    ChartBak(app::Session& session, QtProgress& progress, bool restore, QWidget* parent = nullptr);

    app::BackupForm& form() { return m_form; }
    QListWidget* list() const { return m_list; }
    QLabel* status() const { return m_status; }
    void Backup();
    void Verify();
    void Restore();
    void Discard();

private:
    void Busy(bool busy);
    void Refresh();
    std::string Chosen() const;

    app::Session& m_session;
    QtProgress& m_progress;
    app::BackupForm m_form;
    bool m_restore;
    QListWidget* m_list = nullptr;
    QSpinBox* m_keep = nullptr;
    QLabel* m_status;
    QPushButton* m_discard = nullptr;
};

} // namespace kori::gui
