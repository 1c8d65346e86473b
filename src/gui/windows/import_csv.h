#pragma once
// ImportCsv ("Import CSV History"): file, code, name and the replace choice; the rules are in
// app::CsvImportForm.
#include "app/csv_import_form.h"
#include "app/session.h"

#include <QDialog>

class QCheckBox;
class QLabel;
class QLineEdit;

namespace kori::gui {

class ImportCsv : public QDialog {
    Q_OBJECT
public:
    explicit ImportCsv(app::Session& session, QWidget* parent = nullptr);

    app::CsvImportForm& form() { return m_form; }
    QLineEdit* fileField() const { return m_file; }
    QLineEdit* codeField() const { return m_code; }
    QLineEdit* nameField() const { return m_name; }
    QCheckBox* replaceBox() const { return m_replace; }
    QLabel* resultLabel() const { return m_result; }

    bool Import();

private:
    void Browse();

    app::Session& m_session;
    app::CsvImportForm m_form;
    QLineEdit* m_file;
    QLineEdit* m_code;
    QLineEdit* m_name;
    QCheckBox* m_replace;
    QLabel* m_result;
};

} // namespace kori::gui
