#pragma once
// FinDate: asks for the date a chart is to finish on, typed "d/m/yy".
#include <QDialog>

#include <optional>
#include <string>

class QLineEdit;

namespace kori::gui {

class FinDate : public QDialog {
    Q_OBJECT
public:
    explicit FinDate(QWidget* parent = nullptr);
    QLineEdit* field() const { return m_field; }
    // The typed text, or nullopt when cancelled.
    static std::optional<std::string> Ask(QWidget* parent, const std::string& start = {});

private:
    QLineEdit* m_field;
};

} // namespace kori::gui
