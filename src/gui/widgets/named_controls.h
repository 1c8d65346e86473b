#pragma once
// Menu items and buttons made with the object names that tests and the help find them by, their
// signal connected to the owner's slot: the one way the windows build them.
#include <QAction>
#include <QDialogButtonBox>
#include <QPushButton>

namespace kori::gui {

// `where` is a menu or a menu bar.
template <class Where, class Slot>
QAction* NamedAction(Where* where, QObject* owner, const char* caption, const char* name,
                     Slot slot) {
    QAction* a = where->addAction(QString::fromLatin1(caption));
    a->setObjectName(QString::fromLatin1(name));
    QObject::connect(a, &QAction::triggered, owner, slot);
    return a;
}

template <class Slot>
QPushButton* NamedButton(QDialogButtonBox* box, QObject* owner, const char* caption,
                         const char* name, Slot slot) {
    QPushButton* b = box->addButton(QString::fromLatin1(caption), QDialogButtonBox::ActionRole);
    b->setObjectName(QString::fromLatin1(name));
    QObject::connect(b, &QPushButton::clicked, owner, slot);
    return b;
}

} // namespace kori::gui
