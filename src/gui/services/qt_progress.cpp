#include "gui/services/qt_progress.h"

#include <QCoreApplication>
#include <QLabel>
#include <QProgressBar>
#include <QPushButton>
#include <QStatusBar>

namespace kori::gui {

QtProgress::QtProgress(QStatusBar* bar)
    : m_bar(bar), m_label(new QLabel(bar)), m_progress(new QProgressBar(bar)),
      m_cancel(new QPushButton(QStringLiteral("Cancel"), bar)) {
    m_bar->addPermanentWidget(m_label);
    m_bar->addPermanentWidget(m_progress);
    m_bar->addPermanentWidget(m_cancel);
    m_progress->setMaximumWidth(240);
    QObject::connect(m_cancel, &QPushButton::clicked, [this] { RequestCancel(); });
    Finish();
}

void QtProgress::SetStatus(std::string_view text) {
    m_label->setText(QString::fromLatin1(text.data(), static_cast<qsizetype>(text.size())));
    m_label->show();
}

void QtProgress::SetRange(long long maximum) {
    ResetCancel();
    m_progress->setRange(0, static_cast<int>(maximum));
    m_progress->setValue(0);
    m_progress->show();
    m_cancel->show();
}

void QtProgress::SetValue(long long value) {
    m_progress->setValue(static_cast<int>(value));
    Yield();
}

void QtProgress::Yield() {
    QCoreApplication::processEvents();
}

bool QtProgress::barShown() const {
    return !m_progress->isHidden() && !m_cancel->isHidden();
}

void QtProgress::Finish() {
    m_label->hide();
    m_progress->hide();
    m_cancel->hide();
}

} // namespace kori::gui
