#pragma once
// DataEntry ("Data Entry - Keyboard"): the code, name and record type, the "Previous" column
// of the last record beside the "Current" one typed; the rules are in app::DataEntryForm.
#include "app/data_entry_form.h"
#include "app/session.h"

#include <QDialog>

#include <array>

class QCheckBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QSpinBox;

namespace kori::gui {

class DataEntry : public QDialog {
    Q_OBJECT
public:
    explicit DataEntry(app::Session& session, QWidget* parent = nullptr);

    app::DataEntryForm& form() { return m_form; }
    QLineEdit* codeField() const { return m_code; }
    QLineEdit* dateField() const { return m_date; }
    // Open, high, low, close, volume (the rows the record type shows).
    QLineEdit* figureField(int i) const { return m_fields.at(static_cast<std::size_t>(i)); }
    QLabel* figureLabel(int i) const { return m_labels.at(static_cast<std::size_t>(i)); }
    QLabel* previousLabel(int i) const { return m_previous.at(static_cast<std::size_t>(i)); }

    // The model shown again: labels, previous column, current fields.
    void Refresh();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void TakeFields();
    void Save();
    void ChangeFolder();
    // Enter: on to the next field the record type shows, the save button after the last.
    void EnterIn(QLineEdit* field);

    app::DataEntryForm m_form;
    QLineEdit* m_code;
    QLabel* m_name;
    QLabel* m_type;
    QSpinBox* m_updown;
    QLineEdit* m_date;
    QLabel* m_previousDate;
    std::array<QLabel*, app::DataEntryForm::kFigures> m_labels{};
    std::array<QLabel*, app::DataEntryForm::kFigures> m_previous{};
    std::array<QLineEdit*, app::DataEntryForm::kFigures> m_fields{};
    QCheckBox* m_check1;
    QCheckBox* m_check2;
    QPushButton* m_save;
    bool m_filling = false;
};

} // namespace kori::gui
