#include "gui/windows/scales.h"

#include "app/chart_service.h"
#include "app/window_rules.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>

namespace kori::gui {

Scales::Scales(app::Session& session, SettingsHub& hub, const std::string& code, QWidget* parent)
    : ChartDefaultWindow(session, hub, "Scales", QStringLiteral("Change Scales"), parent),
      m_code(NumberBox(this, "txtCode", Q(platform::Trim(code)), 90)),
      m_base(NumberBox(this, "txtBase", QString())), m_top(NumberBox(this, "txtTop", QString())),
      m_pf(NumberBox(this, "txtPFInc", QString())) {
    m_code->setMaxLength(6);
    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("Code"), m_code);
    form->addRow(QStringLiteral("Chart base"), m_base);
    form->addRow(QStringLiteral("Chart ceiling"), m_top);
    form->addRow(QStringLiteral("PF Inc"), m_pf);
    auto* note = new QLabel(QStringLiteral("0 means automatic scale"), this);
    m_layout->addLayout(form);
    m_layout->addWidget(note);
    connect(m_code, &QLineEdit::returnPressed, this, [this] { (void)Lookup(); });
    AddButtons();
    if (!m_code->text().isEmpty()) (void)Lookup();
}

bool Scales::Lookup() {
    const std::string code = platform::Upper(platform::Trim(S(m_code->text())));
    platform::Status why;
    const auto found = store::FindCode(m_session.folders.DataFolder, code, why);
    if (!why || !found) {
        m_record = 0;
        dialogs().MsgBox(why ? "No record on file for that code" : why.message(), "Change Scales");
        return false;
    }
    m_record = found->RecordNumber;
    m_code->setText(Q(code));
    m_base->setText(SingleText(found->Record.Base));
    m_top->setText(SingleText(found->Record.Top));
    m_pf->setText(SingleText(found->Record.PFIncrement));
    return true;
}

bool Scales::Ok() {
    if (m_record == 0 && !Lookup()) return false;
    const app::ScaleFields fields{S(m_base->text()), S(m_top->text()), S(m_pf->text())};
    if (!app::Accept(app::ScalesProblem(fields), dialogs())) return false;
    if (auto s = app::SaveScales(m_session.folders.DataFolder, m_record, fields); !s) {
        dialogs().MsgBox(s.message(), "Change Scales");
        return false;
    }
    m_hub.RebuildChart();
    return true;
}

} // namespace kori::gui
