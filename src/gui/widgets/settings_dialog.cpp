#include "gui/widgets/settings_dialog.h"

#include "gui/widgets/window_place.h"

#include <QHBoxLayout>
#include <QPushButton>

namespace kori::gui {

QHBoxLayout* ButtonRow(std::initializer_list<QWidget*> buttons) {
    auto* row = new QHBoxLayout;
    row->addStretch();
    for (QWidget* b : buttons)
        row->addWidget(b);
    return row;
}

SettingsDialog::SettingsDialog(app::Session& session, SettingsHub& hub, const char* name,
                               const QString& title, QWidget* parent)
    : QDialog(parent), m_session(session), m_hub(hub) {
    setObjectName(QString::fromLatin1(name));
    setWindowTitle(title);
    KeepWindowPosition(this, session.services().settings, name);
}

QPushButton* SettingsDialog::Button(const QString& caption, const char* name) {
    auto* b = new QPushButton(caption, this);
    b->setObjectName(QString::fromLatin1(name));
    b->setAutoDefault(false);
    return b;
}

QHBoxLayout* SettingsDialog::SaveRow(std::function<bool()> save, const QString& leaveCaption,
                                     const char* leaveName) {
    auto* saveButton = Button(QStringLiteral("SAVE"), "cmdSave");
    auto* leave = Button(leaveCaption, leaveName);
    connect(saveButton, &QPushButton::clicked, this, [this, save = std::move(save)] {
        if (save()) accept();
    });
    connect(leave, &QPushButton::clicked, this, &QDialog::reject);
    return ButtonRow({saveButton, leave});
}

} // namespace kori::gui
