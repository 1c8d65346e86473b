#include "gui/windows/repair_progress.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QProgressBar>
#include <QPushButton>

namespace kori::gui {

RepairProgress::RepairProgress(QWidget* parent) : QWidget(parent) {
    m_label = new QLabel(this);
    m_label->setObjectName(QStringLiteral("lblStage"));
    m_bar = new QProgressBar(this);
    m_bar->setObjectName(QStringLiteral("prgWalk"));
    m_bar->setRange(0, 1);
    m_bar->setValue(0);
    m_cancel = new QPushButton(QStringLiteral("Cancel"), this);
    m_cancel->setObjectName(QStringLiteral("cmdCancelWalk"));
    connect(m_cancel, &QPushButton::clicked, this, [this] { RequestCancel(); });
    auto* row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->addWidget(m_label, 1);
    row->addWidget(m_bar, 1);
    row->addWidget(m_cancel);
}

void RepairProgress::SetStatus(std::string_view text) {
    m_label->setText(QString::fromLatin1(text.data(), static_cast<int>(text.size())));
}

void RepairProgress::SetRange(long long maximum) {
    // The bar counts in ints; a long walk is scaled down to fit.
    m_bar->setRange(0, static_cast<int>(std::min<long long>(maximum, 1 << 30)));
}

void RepairProgress::SetValue(long long value) {
    m_bar->setValue(static_cast<int>(std::min<long long>(value, m_bar->maximum())));
}

void RepairProgress::Yield() {
    QApplication::processEvents();
}

} // namespace kori::gui
