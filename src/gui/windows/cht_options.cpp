#include "gui/windows/cht_options.h"

#include <QDialogButtonBox>
#include <QListWidget>
#include <QVBoxLayout>

#include <array>

namespace kori::gui {

ChtOptions::ChtOptions(const std::array<std::string, 10>& names, QWidget* parent)
    : QDialog(parent), m_list(new QListWidget(this)) {
    setObjectName(QStringLiteral("ChtOptions"));
    setWindowTitle(QStringLiteral("Viewing Options"));
    auto* layout = new QVBoxLayout(this);
    m_list->setObjectName(QStringLiteral("List1"));
    auto* full = new QListWidgetItem(QStringLiteral(" FULL LIST"), m_list);
    full->setData(Qt::UserRole, 1);
    for (std::size_t i = 0; i < names.size(); ++i) {
        auto* item = new QListWidgetItem(QString::fromStdString(names[i]), m_list);
        item->setData(Qt::UserRole, static_cast<int>(i) + 2);
    }
    // The scans leave their finds in list Z, to be walked like any other list.
    auto* scans = new QListWidgetItem(QStringLiteral("Chart List Z"), m_list);
    scans->setData(Qt::UserRole, 12);
    m_list->setCurrentRow(0);
    layout->addWidget(m_list);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(m_list, &QListWidget::itemDoubleClicked, this, &QDialog::accept);
    layout->addWidget(buttons);
    resize(280, 320);
}

std::optional<std::pair<int, std::string>> ChtOptions::Picked() const {
    const auto* item = m_list->currentItem();
    if (!item) return std::nullopt;
    return std::pair{item->data(Qt::UserRole).toInt(), item->text().trimmed().toStdString()};
}

} // namespace kori::gui
