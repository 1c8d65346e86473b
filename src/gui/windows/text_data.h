#pragma once
// TextData ("Create text file of closing prices") and TextFull ("Create text file of data
// (OHLCV)"): the export windows over app::ClosesForm and app::DataForm.
#include "app/text_export_form.h"

#include <QDialog>

class QComboBox;
class QLabel;
class QLineEdit;
class QRadioButton;

namespace kori::gui {

class QtProgress;

class TextData : public QDialog {
    Q_OBJECT
public:
    TextData(app::Session& session, QtProgress& progress, QWidget* parent = nullptr);
    QComboBox* listBox() const { return m_list; }
    QLineEdit* dateEdit() const { return m_date; }
    QLineEdit* fileEdit() const { return m_file; }
    QLabel* status() const { return m_status; }
    // "Create": the export with the window's choices; its outcome is shown and returned.
    app::ExportOutcome Create();

private:
    app::Session& m_session;
    QtProgress& m_progress;
    QComboBox* m_list;
    QLineEdit* m_date;
    QLineEdit* m_file;
    QLabel* m_status;
};

class TextFull : public QDialog {
    Q_OBJECT
public:
    TextFull(app::Session& session, QtProgress& progress, QWidget* parent = nullptr);
    QRadioButton* oneSecurity() const { return m_one; }
    QRadioButton* aList() const { return m_many; }
    QLineEdit* codeEdit() const { return m_code; }
    QComboBox* listBox() const { return m_list; }
    QLineEdit* fromEdit() const { return m_from; }
    QLineEdit* toEdit() const { return m_to; }
    QRadioButton* dayFiles() const { return m_day; }
    QLineEdit* outputEdit() const { return m_output; }
    QLabel* status() const { return m_status; }
    app::ExportOutcome Create();

private:
    void ChooseOutput();

    app::Session& m_session;
    QtProgress& m_progress;
    QRadioButton *m_one, *m_many, *m_csv, *m_day;
    QLineEdit *m_code, *m_from, *m_to, *m_output;
    QComboBox* m_list;
    QLabel* m_status;
};

} // namespace kori::gui
