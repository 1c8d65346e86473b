#include "gui/windows/search.h"

#include "app/chart_selection.h"
#include "platform/dialogs.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

Search::Search(const std::vector<store::NameRecord>& names, int fromPosition,
               platform::Dialogs& dialogs, std::function<void(int)> found, QWidget* parent)
    : QDialog(parent), m_names(names), m_position(fromPosition), m_dialogs(dialogs),
      m_found(std::move(found)), m_field(new QLineEdit(this)) {
    setObjectName(QStringLiteral("Search"));
    setWindowTitle(QStringLiteral("Search by Name"));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(new QLabel(QStringLiteral("Code or part of the name"), this));
    m_field->setObjectName(QStringLiteral("Text1"));
    layout->addWidget(m_field);
    auto* row = new QHBoxLayout;
    auto* next = new QPushButton(QStringLiteral("Find Next"), this);
    next->setObjectName(QStringLiteral("cmdNext"));
    next->setDefault(true);
    auto* close = new QPushButton(QStringLiteral("Close"), this);
    row->addStretch();
    row->addWidget(next);
    row->addWidget(close);
    layout->addLayout(row);
    connect(next, &QPushButton::clicked, this, &Search::FindNext);
    connect(close, &QPushButton::clicked, this, &QDialog::accept);
}

void Search::FindNext() {
    const int pos = app::FindNextMatch(m_names, m_position, m_field->text().toStdString());
    if (pos == 0) {
        m_dialogs.MsgBox("No more matches", "Search by Name");
        m_position = 0; // the next search starts again from the top
        return;
    }
    m_position = pos;
    if (m_found) m_found(pos);
}

} // namespace kori::gui
