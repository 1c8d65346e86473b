#pragma once
// The frame every settings window shares: the session, the hub it reports to, its name (which
// is also the key of its position in the settings store) and its caption.
#include "app/session.h"
#include "gui/windows/settings_hub.h"

#include <QDialog>
#include <QString>

#include <functional>
#include <initializer_list>
#include <string>

class QHBoxLayout;
class QPushButton;
class QWidget;

namespace kori::gui {

inline QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
inline std::string S(const QString& s) {
    return s.toStdString();
}

// Buttons in a row at the bottom right of a window, in the order given.
QHBoxLayout* ButtonRow(std::initializer_list<QWidget*> buttons);

class SettingsDialog : public QDialog {
    Q_OBJECT
public:
    SettingsDialog(app::Session& session, SettingsHub& hub, const char* name, const QString& title,
                   QWidget* parent);

protected:
    platform::Dialogs& dialogs() { return m_session.dialogs(); }
    // A push button with a control name, so tests and the keyboard reach it.
    QPushButton* Button(const QString& caption, const char* name);
    // The row of "SAVE" (which closes the window once `save` has stored the values) and the
    // button that leaves without storing, to the right.
    QHBoxLayout* SaveRow(std::function<bool()> save, const QString& leaveCaption,
                         const char* leaveName);

    app::Session& m_session;
    SettingsHub& m_hub;
};

} // namespace kori::gui
