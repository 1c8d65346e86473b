#include "gui/windows/cl_names.h"

#include "platform/text.h"
#include "store/chart_list.h"

#include <QFormLayout>
#include <QLineEdit>
#include <QVBoxLayout>

namespace kori::gui {

CLNames::CLNames(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "CLNames", QStringLiteral("Rename Chart Lists"), parent) {
    m_shown = store::GetSubLists(session.services().settings);
    auto* form = new QFormLayout;
    for (std::size_t i = 0; i < m_fields.size(); ++i) {
        auto* edit = new QLineEdit(Q(m_shown[i]), this);
        edit->setObjectName(QStringLiteral("txtName%1").arg(i));
        edit->setMinimumWidth(240);
        form->addRow(QStringLiteral("List %1").arg(QChar::fromLatin1(store::kListLetters[i])),
                     edit);
        m_fields[i] = edit;
    }
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addLayout(SaveRow([this] { return Save(); }, QStringLiteral("Close"), "cmdClose"));
}

std::array<std::string, 10> CLNames::Edited() const {
    std::array<std::string, 10> names;
    for (std::size_t i = 0; i < names.size(); ++i)
        names[i] = platform::Trim(S(m_fields[i]->text()));
    return names;
}

bool CLNames::Save() {
    store::SaveSLNames(m_session.services().settings, Edited());
    // A name left blank reads back as its default.
    m_shown = store::GetSubLists(m_session.services().settings);
    for (std::size_t i = 0; i < m_fields.size(); ++i)
        m_fields[i]->setText(Q(m_shown[i]));
    return true;
}

void CLNames::reject() {
    if (Edited() != m_shown &&
        dialogs().MsgBox("Save changes ?", "Sub-List Names", platform::Buttons::YesNo,
                         platform::Icon::Question) == platform::Answer::Yes)
        Save();
    QDialog::reject();
}

} // namespace kori::gui
