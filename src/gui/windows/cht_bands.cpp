#include "gui/windows/cht_bands.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLineEdit>

namespace kori::gui {

ChtBands::ChtBands(int up, int down, QWidget* parent)
    : QDialog(parent), m_up(new QLineEdit(QString::number(up), this)),
      m_down(new QLineEdit(QString::number(down), this)) {
    setObjectName(QStringLiteral("ChtBands"));
    setWindowTitle(QStringLiteral("Bands"));
    auto* form = new QFormLayout(this);
    m_up->setObjectName(QStringLiteral("Text1"));
    m_down->setObjectName(QStringLiteral("Text2"));
    form->addRow(QStringLiteral("Upper band %"), m_up);
    form->addRow(QStringLiteral("Lower band %"), m_down);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    form->addRow(buttons);
}

std::optional<std::pair<int, int>> ChtBands::Ask(QWidget* parent, int up, int down) {
    ChtBands d(up, down, parent);
    if (d.exec() != QDialog::Accepted) return std::nullopt;
    bool ok1 = false, ok2 = false;
    const int a = d.m_up->text().trimmed().toInt(&ok1);
    const int b = d.m_down->text().trimmed().toInt(&ok2);
    // Text that is not a number fails the range check like any value outside it.
    return std::pair{ok1 ? a : -1, ok2 ? b : -1};
}

} // namespace kori::gui
