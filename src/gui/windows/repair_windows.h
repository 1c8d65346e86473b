#pragma once
// The small one-shot windows of the data repair tools. Each shows its texts, takes what the
// user gives, runs its tool from src/maint with the stage in a label and the walk in a bar,
// and shows the tool's messages and the problems it met.
#include "app/session.h"
#include "maint/repair_result.h"

#include <QDialog>

class QLineEdit;
class QListWidget;
class QPushButton;
class QRadioButton;
class QComboBox;

namespace kori::gui {

class RepairProgress;

class RepairWindow : public QDialog {
    Q_OBJECT
public:
    RepairProgress* progress() const { return m_progress; }
    // What the last run gave back.
    const maint::RepairResult& result() const { return m_result; }

protected:
    RepairWindow(app::Session& session, const char* name, const QString& caption, QWidget* parent);
    // Runs `work` with the window's buttons held, then lists the problems met.
    template <typename Work> void Run(Work work);
    void ShowIssues(const platform::Issues& issues, const char* title);
    void AddTexts(std::initializer_list<std::string_view> lines);
    QPushButton* AddButton(const QString& caption, const char* name);
    QLineEdit* AddFolderField(const char* name, const std::string& folder);

    app::Session& m_session;
    RepairProgress* m_progress;
    maint::RepairResult m_result;
    bool m_running = false;

public slots:
    void reject() override;
};

// ASXChg: the old and the new code.
class ASXChg : public RepairWindow {
    Q_OBJECT
public:
    ASXChg(app::Session& session, QWidget* parent = nullptr);
    QLineEdit* oldCode() const { return m_old; }
    QLineEdit* newCode() const { return m_new; }
    void Convert();

private:
    QLineEdit* m_old;
    QLineEdit* m_new;
};

// RemDate ("Remove Specific Date"): folder, date and which instances.
class RemDate : public RepairWindow {
    Q_OBJECT
public:
    RemDate(app::Session& session, QWidget* parent = nullptr);
    QLineEdit* folder() const { return m_folder; }
    QLineEdit* date() const { return m_date; }
    QRadioButton* all() const { return m_all; }
    QRadioButton* latest() const { return m_latest; }
    void Remove();

private:
    QLineEdit* m_folder;
    QLineEdit* m_date;
    QRadioButton* m_all;
    QRadioButton* m_latest;
};

// RemDupST: the folder, from the data folders of ChtPaths.lst or the current one.
class RemDupST : public RepairWindow {
    Q_OBJECT
public:
    RemDupST(app::Session& session, QWidget* parent = nullptr);
    QComboBox* folders() const { return m_folders; }
    void Start();

private:
    QComboBox* m_folders;
};

// DumpOld ("Old Files "): says when there are none; deletes them on the button.
class DumpOld : public RepairWindow {
    Q_OBJECT
public:
    DumpOld(app::Session& session, QWidget* parent = nullptr);
    bool hasFiles() const { return m_count > 0; }
    void Delete();

private:
    int m_count = 0;
};

// ResetFA: the folder whose files become writable.
class ResetFA : public RepairWindow {
    Q_OBJECT
public:
    ResetFA(app::Session& session, QWidget* parent = nullptr);
    QLineEdit* folder() const { return m_folder; }
    void Reset();

private:
    QLineEdit* m_folder;
};

// MoveFiles: source and destination panes of *.wdt and the >>> button.
class MoveFiles : public RepairWindow {
    Q_OBJECT
public:
    MoveFiles(app::Session& session, QWidget* parent = nullptr);
    QLineEdit* source() const { return m_source; }
    QLineEdit* destination() const { return m_destination; }
    QListWidget* sourceFiles() const { return m_sourceFiles; }
    QListWidget* destinationFiles() const { return m_destinationFiles; }
    void Fill();
    void Move();

private:
    QLineEdit* m_source;
    QLineEdit* m_destination;
    QListWidget* m_sourceFiles;
    QListWidget* m_destinationFiles;
};

} // namespace kori::gui
