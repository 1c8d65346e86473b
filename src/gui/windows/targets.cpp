#include "gui/windows/targets.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "gui/widgets/window_place.h"

#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QVBoxLayout>

namespace kori::gui {

Targets::Targets(app::Session& session, QWidget* parent)
    : QDialog(parent), m_form(session.folders.SystemFolder, session.dialogs()) {
    setObjectName(QStringLiteral("Targets"));
    setWindowTitle(QString::fromLatin1(app::TargetsForm::kTitle));
    KeepWindowPosition(this, session.services().settings, "Targets");
    m_form.Load();

    m_menus = new QMenuBar(this);
    const auto item = [this](QMenu* menu, const char* caption, const char* name, auto slot) {
        return NamedAction(menu, this, caption, name, slot);
    };
    QMenu* file = m_menus->addMenu(QStringLiteral("&File"));
    file->setObjectName(QStringLiteral("mnuFile"));
    item(file, "&Save", "mnuSave", [this] { Save(); });
    QMenu* edit = m_menus->addMenu(QStringLiteral("&Edit"));
    edit->setObjectName(QStringLiteral("mnuEdit"));
    item(edit, "&Delete Row", "mnuDeleteRow", [this] { DeleteRow(); });
    item(edit, "&Sort List", "mnuSort", [this] { SortList(); });

    m_grid = new GridView(m_form.grid(), session.dialogs(), app::TargetsForm::kTitle, this);
    m_grid->setObjectName(QStringLiteral("grdTargets"));
    m_grid->setColumnWidth(0, 110);
    m_grid->setColumnWidth(1, 110);
    // A target typed into the last row gets a fresh blank row under it.
    connect(m_grid, &GridView::Edited, this, [this] {
        if (m_form.KeepBlankRow()) m_grid->Refresh();
    });
    auto* label = new QLabel(QString::fromLatin1(app::TargetsForm::kMaxLabel), this);
    label->setObjectName(QStringLiteral("lblMax"));

    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addWidget(label);
    layout->addWidget(m_grid);
    resize(380, 420);
}

void Targets::GoToRefusal() {
    if (const auto& r = m_form.refusal()) m_grid->setCurrentCell(r->Row, r->Column);
}

bool Targets::Save() {
    const bool saved = m_form.Save();
    if (!saved) GoToRefusal();
    return saved;
}

void Targets::DeleteRow() {
    if (m_form.DeleteRow(m_grid->currentRow())) m_grid->Refresh();
}

void Targets::SortList() {
    if (m_form.SortList())
        m_grid->Refresh();
    else
        GoToRefusal();
}

void Targets::reject() {
    if (!m_form.CanClose()) {
        GoToRefusal();
        return;
    }
    QDialog::reject();
}

} // namespace kori::gui
