#include "gui/windows/name_form.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "gui/widgets/settings_dialog.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/repair_progress.h"

#include <QLabel>
#include <QMenuBar>
#include <QPageSetupDialog>
#include <QPrintDialog>
#include <QPrinter>
#include <QVBoxLayout>

namespace kori::gui {

NameForm::NameForm(app::Session& session, QWidget* parent) : QDialog(parent), m_session(session) {
    setObjectName(QStringLiteral("NameForm"));
    setWindowTitle(QStringLiteral("Name File"));
    KeepWindowPosition(this, session.services().settings, "NameForm");
    m_progress = new RepairProgress(this);
    m_model = std::make_unique<app::NameFormModel>(
        session.folders.DataFolder, session.folders.SystemFolder, session.download.DataService,
        session.dialogs(), *m_progress, session.ini());
    m_caption = new QLabel(QString::fromLatin1(m_model->Caption().c_str()), this);
    m_caption->setObjectName(QStringLiteral("lblCaption"));
    m_grid = new GridView(m_model->grid(), session.dialogs(), "Name File", this);
    m_grid->setObjectName(QStringLiteral("grdNames"));
    m_grid->setSelectionMode(QAbstractItemView::ContiguousSelection);
    connect(m_grid, &GridView::Edited, this, [] {});

    m_menus = new QMenuBar(this);
    const auto item = [this](QMenu* menu, const char* caption, const char* name, auto slot) {
        return menu ? NamedAction(menu, this, caption, name, slot)
                    : NamedAction(m_menus, this, caption, name, slot);
    };
    QMenu* file = m_menus->addMenu(QStringLiteral("&File"));
    item(file, "&Save ", "mnuSave", [this] { Save(); });
    item(file, "Pa&ge Setup", "mnuPageSetup", [this] {
        QPrinter printer;
        QPageSetupDialog(&printer, this).exec();
    });
    item(file, "&Print", "mnuPrint", [this] { Print(); });
    item(file, "&Close", "mnuClose", [this] { reject(); });
    QMenu* edit = m_menus->addMenu(QStringLiteral("&Edit"));
    item(edit, "&Add Row", "mnuAddRow", [this] {
        const int row = m_model->AddRow();
        m_grid->Refresh();
        m_grid->setCurrentCell(row, store::kNameCode);
    });
    item(edit, "&Delete Rows", "mnuDeleteRows", [this] {
        const auto [first, last] = SelectedRows();
        if (m_model->DeleteRows(first, last)) AfterChange();
    });
    QMenu* sort = edit->addMenu(QStringLiteral("S&ort List"));
    sort->setObjectName(QStringLiteral("mnuSortList"));
    item(sort, "Sort by Code", "mnuSortCode", [this] { Sort(store::NameSortOrder::Code); });
    item(sort, "Sort By Category", "mnuSortCat", [this] { Sort(store::NameSortOrder::Category); });
    item(sort, "Sort by Industry Classification", "mnuSortIC",
         [this] { Sort(store::NameSortOrder::Industry); });
    item(sort, "Sort By GICS Classification", "mnuSortGics",
         [this] { Sort(store::NameSortOrder::Gics); });
    QMenu* tools = m_menus->addMenu(QStringLiteral("&Tools"));
    item(tools, "&Update Names from KORI Master list", "mnuUpdateNames", [this] {
        if (m_model->UpdateNames() > 0) AfterChange();
    });
    item(tools, "Check for Du&plicate Entries", "mnuDupNames", [this] {
        if (m_model->Dupnames() >= 0) AfterChange();
    });
    item(tools, "Update Indust.Classifications from underlying stock", "mnuUpdateIC", [this] {
        if (m_model->UpdateIC_from_Stock() > 0) AfterChange();
    });
    item(tools, "Update GICS Sectors from download", "mnuUpdateGics", [this] {
        if (m_model->UpdateGICS() > 0) AfterChange();
    });
    item(tools, "&Change Case to Title Case", "mnuTitleCase", [this] {
        m_model->TitleCase();
        AfterChange();
    });
    item(tools, "&Clean Optional Details", "mnuCleanOpt", [this] {
        if (m_model->CleanOptionalDetails()) AfterChange();
    });
    item(tools, "&Remove Expired Options", "mnuRemExpired", [this] {
        m_model->RemoveExpiredOptions();
        AfterChange();
    });
    item(tools, "Remove &Warrants from list", "mnuRemWarrants", [this] {
        if (m_model->DeleteWarrants() >= 0) AfterChange();
    });
    item(tools, "gd Special - refresh option (other details)", "mnuGdSpecial", [this] {
        m_model->GdSpecial();
        AfterChange();
    });
    item(tools, "Change category of selected stocks", "mnuChangeCat", [this] {
        const auto [first, last] = SelectedRows();
        if (m_model->ChangeCategory(first, last)) AfterChange();
    });
    item(tools, "Change Record Type of selected stocks", "mnuChangeType", [this] {
        const auto [first, last] = SelectedRows();
        if (m_model->ChangeRecordType(first, last)) AfterChange();
    });
    item(nullptr, "&Display", "mnuDisplay", [this] { Display(); });

    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addWidget(m_caption);
    layout->addWidget(m_grid, 1);
    layout->addWidget(m_progress);
    m_progress->hide();
    resize(980, 560);
    // Numbers are short; the name is what the user reads the rows by.
    for (int c = 0; c < store::kNameShownColumns; ++c)
        m_grid->setColumnWidth(c, 64);
    m_grid->setColumnWidth(store::kNameRec, 48);
    m_grid->setColumnWidth(store::kNameName, 250);
    m_grid->setColumnWidth(store::kNameOther, 120);
    Display();
}

NameForm::~NameForm() = default;

void NameForm::Display() {
    m_model->ShowNames();
    m_grid->Refresh();
}

void NameForm::AfterChange() {
    m_grid->Refresh();
}

bool NameForm::Save() {
    const bool saved = m_model->SaveNames();
    if (const auto& refusal = m_model->refusal(); !saved && refusal)
        m_grid->setCurrentCell(refusal->Row, refusal->Column);
    m_grid->Refresh();
    return saved;
}

void NameForm::Sort(store::NameSortOrder order) {
    // The bar is there while the sort runs through its scratch files, not while the user edits.
    m_progress->show();
    const bool sorted = m_model->Sort(order);
    m_progress->hide();
    if (sorted) AfterChange();
}

std::pair<int, int> NameForm::SelectedRows() const {
    const auto ranges = m_grid->selectedRanges();
    if (ranges.isEmpty()) {
        const int row = m_grid->currentRow();
        return row < 0 ? std::pair{0, 0} : std::pair{row + 1, row + 1};
    }
    return {ranges.first().topRow() + 1, ranges.first().bottomRow() + 1};
}

void NameForm::Print() {
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, this);
    if (dialog.exec() == QDialog::Accepted) m_grid->PrintTo(printer, m_caption->text());
}

void NameForm::reject() {
    if (!m_model->Close()) return; // a refused save keeps the window open
    QDialog::reject();
}

} // namespace kori::gui
