#include "gui/services/qt_dialogs.h"

#include <QApplication>
#include <QGuiApplication>
#include <QInputDialog>
#include <QMessageBox>

namespace kori::gui {

namespace {
QString Q(std::string_view s) {
    return QString::fromLatin1(s.data(), static_cast<qsizetype>(s.size()));
}

QMessageBox::StandardButtons ToQt(platform::Buttons b) {
    switch (b) {
    case platform::Buttons::Ok:
        return QMessageBox::Ok;
    case platform::Buttons::OkCancel:
        return QMessageBox::Ok | QMessageBox::Cancel;
    case platform::Buttons::YesNo:
        return QMessageBox::Yes | QMessageBox::No;
    case platform::Buttons::YesNoCancel:
        return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    case platform::Buttons::RetryCancel:
        return QMessageBox::Retry | QMessageBox::Cancel;
    }
    return QMessageBox::Ok;
}

QMessageBox::Icon ToQt(platform::Icon i) {
    switch (i) {
    case platform::Icon::None:
        return QMessageBox::NoIcon;
    case platform::Icon::Information:
        return QMessageBox::Information;
    case platform::Icon::Exclamation:
        return QMessageBox::Warning;
    case platform::Icon::Question:
        return QMessageBox::Question;
    case platform::Icon::Critical:
        return QMessageBox::Critical;
    }
    return QMessageBox::NoIcon;
}
} // namespace

platform::Answer QtDialogs::MsgBox(std::string_view text, std::string_view title,
                                   platform::Buttons buttons, platform::Icon icon) {
    // A message must be readable even while the busy pointer is up.
    const bool busy = m_busyDepth > 0;
    if (busy) QGuiApplication::restoreOverrideCursor();
    QMessageBox box(ToQt(icon), Q(title), Q(text), ToQt(buttons), m_parent);
    const int r = box.exec();
    if (busy) QGuiApplication::setOverrideCursor(Qt::WaitCursor);
    switch (r) {
    case QMessageBox::Yes:
        return platform::Answer::Yes;
    case QMessageBox::No:
        return platform::Answer::No;
    case QMessageBox::Cancel:
        return platform::Answer::Cancel;
    case QMessageBox::Retry:
        return platform::Answer::Retry;
    default:
        return platform::Answer::Ok;
    }
}

std::optional<std::string> QtDialogs::InputBox(std::string_view prompt, std::string_view title,
                                               std::string_view defaultText) {
    bool ok = false;
    const QString r = QInputDialog::getText(m_parent, Q(title), Q(prompt), QLineEdit::Normal,
                                            Q(defaultText), &ok);
    if (!ok) return std::nullopt;
    return r.toStdString();
}

void QtDialogs::Beep() {
    QApplication::beep();
}

void QtDialogs::SetBusy(bool busy) {
    if (busy) {
        if (m_busyDepth++ == 0) QGuiApplication::setOverrideCursor(Qt::WaitCursor);
    } else if (m_busyDepth > 0) {
        if (--m_busyDepth == 0) QGuiApplication::restoreOverrideCursor();
    }
}

} // namespace kori::gui
