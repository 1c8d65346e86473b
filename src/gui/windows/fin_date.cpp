#include "gui/windows/fin_date.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QVBoxLayout>

namespace kori::gui {

FinDate::FinDate(QWidget* parent) : QDialog(parent), m_field(new QLineEdit(this)) {
    setObjectName(QStringLiteral("FinDate"));
    setWindowTitle(QStringLiteral("Finish Date"));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(new QLabel(QStringLiteral("Chart to finish on (d/m/yy)"), this));
    m_field->setObjectName(QStringLiteral("Text1"));
    m_field->setPlaceholderText(QStringLiteral("d/m/yy"));
    layout->addWidget(m_field);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    layout->addWidget(buttons);
}

std::optional<std::string> FinDate::Ask(QWidget* parent, const std::string& start) {
    FinDate d(parent);
    d.m_field->setText(QString::fromStdString(start));
    if (d.exec() != QDialog::Accepted) return std::nullopt;
    return d.m_field->text().toStdString();
}

} // namespace kori::gui
