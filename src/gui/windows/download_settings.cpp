#include "gui/windows/download_settings.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "gui/widgets/window_place.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QFileDialog>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QItemSelectionModel>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QToolButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {

QString Text(std::string_view s) {
    return QString::fromLatin1(s.data(), static_cast<qsizetype>(s.size()));
}

QPushButton* Button(QWidget* parent, const char* caption, const char* name) {
    auto* b = new QPushButton(QString::fromLatin1(caption), parent);
    b->setObjectName(QString::fromLatin1(name));
    return b;
}

} // namespace

// --- ModDetails ----------------------------------------------------------------------------

ModDetails::ModDetails(app::Session& session, QWidget* parent)
    : QDialog(parent), m_session(session), m_form(session) {
    setObjectName(QStringLiteral("ModDetails"));
    setWindowTitle(QString::fromLatin1(app::ModDetailsForm::kTitle));
    KeepWindowPosition(this, session.services().settings, "ModDetails");

    auto* grid = new QGridLayout;
    m_service = new QComboBox(this);
    m_service->setObjectName(QStringLiteral("Combo1"));
    for (const auto item : app::ModDetailsForm::ServiceItems())
        m_service->addItem(Text(item));
    m_service->setCurrentIndex(m_form.service());
    grid->addWidget(new QLabel(QStringLiteral("Data Service"), this), 0, 0);
    grid->addWidget(m_service, 0, 1);
    m_folder = new QLineEdit(QString::fromStdString(m_form.folder()), this);
    m_folder->setObjectName(QStringLiteral("Text1"));
    grid->addWidget(new QLabel(QStringLiteral("Downloaded Data"), this), 1, 0);
    grid->addWidget(m_folder, 1, 1);

    m_internet = new QWidget(this);
    auto* internet = new QGridLayout(m_internet);
    internet->setContentsMargins(0, 0, 0, 0);
    m_format = new QComboBox(m_internet);
    m_format->setObjectName(QStringLiteral("Combo2"));
    for (const auto item : app::ModDetailsForm::FormatItems())
        m_format->addItem(Text(item));
    m_format->setCurrentIndex(m_form.format());
    internet->addWidget(new QLabel(QStringLiteral("Filename Format"), m_internet), 0, 0);
    internet->addWidget(m_format, 0, 1);
    m_divisor = new QLineEdit(QString::fromStdString(m_form.divisor()), m_internet);
    m_divisor->setObjectName(QStringLiteral("Text2"));
    m_divisor->setToolTip(QStringLiteral(
        "The volumes downloaded are divided by this figure before being updated into the "
        "charts (eg 10 or 100 or 1000)"));
    internet->addWidget(new QLabel(QStringLiteral("Divide volumes by"), m_internet), 1, 0);
    internet->addWidget(m_divisor, 1, 1);
    auto* list = Button(m_internet, "Edit Update List", "Command1");
    internet->addWidget(list, 2, 1);
    grid->addWidget(m_internet, 2, 0, 1, 2);

    m_segments = Button(this, "Download Data Settings", "cmdSegments");
    auto* save = Button(this, "SAVE", "Command3");
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_segments);
    buttons->addStretch();
    buttons->addWidget(save);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(grid);
    layout->addLayout(buttons);

    connect(m_service, &QComboBox::activated, this, &ModDetails::ServiceChosen);
    connect(m_folder, &QLineEdit::textEdited, this,
            [this](const QString& t) { m_form.SetFolder(t.toStdString()); });
    connect(m_format, &QComboBox::activated, this, [this](int i) { m_form.ChooseFormat(i); });
    connect(m_divisor, &QLineEdit::editingFinished, this, [this] {
        if (!m_form.LeaveDivisor(m_divisor->text().toStdString())) m_divisor->setFocus();
    });
    connect(list, &QPushButton::clicked, this, [this] {
        auto* w = new INUpList(m_session, this);
        w->setAttribute(Qt::WA_DeleteOnClose);
        w->open();
    });
    connect(m_segments, &QPushButton::clicked, this, [this] {
        auto* w = new DLWizard(m_session, this);
        w->setAttribute(Qt::WA_DeleteOnClose);
        w->open();
    });
    connect(save, &QPushButton::clicked, this, &ModDetails::Save);
    ShowControls();
    resize(520, 220);
}

void ModDetails::ServiceChosen(int item) {
    m_form.ChooseService(item);
    m_folder->setText(QString::fromStdString(m_form.folder()));
    ShowControls();
}

void ModDetails::ShowControls() {
    m_internet->setVisible(m_form.internetControlsShown());
    m_segments->setVisible(m_form.service() == 0);
}

bool ModDetails::Save() {
    m_form.SetFolder(m_folder->text().toStdString());
    if (!m_form.Save()) return false;
    accept();
    return true;
}

// --- DLWizard -------------------------------------------------------------------------------

DLWizard::DLWizard(app::Session& session, QWidget* parent) : QDialog(parent), m_form(session) {
    setObjectName(QStringLiteral("DLWizard"));
    setWindowTitle(QString::fromLatin1(app::DownloadWizardForm::kTitle));
    KeepWindowPosition(this, session.services().settings, "DLWizard");
    auto* grid = new QGridLayout;
    grid->addWidget(new QLabel(QStringLiteral("Select items you are receiving"), this), 0, 0);
    grid->addWidget(new QLabel(QStringLiteral("Folder/s to maintain data "), this), 0, 1);
    for (int i = 0; i < app::kDataTypeCount; ++i) {
        const auto at = static_cast<std::size_t>(i);
        auto* check = new QCheckBox(Text(app::DownloadWizardForm::Labels()[at]), this);
        check->setObjectName(QStringLiteral("Check%1").arg(i + 1));
        check->setChecked(m_form.received(i));
        auto* folder = new QLineEdit(QString::fromStdString(m_form.folder(i)), this);
        folder->setObjectName(QStringLiteral("Text%1").arg(i + 1));
        auto* browse = new QToolButton(this);
        browse->setArrowType(Qt::DownArrow);
        browse->setObjectName(QStringLiteral("Browse%1").arg(i + 1));
        grid->addWidget(check, i + 1, 0);
        grid->addWidget(folder, i + 1, 1);
        grid->addWidget(browse, i + 1, 2);
        m_received[at] = check;
        m_folders[at] = folder;
        connect(check, &QCheckBox::toggled, this,
                [this, i](bool on) { m_form.SetReceived(i, on); });
        connect(folder, &QLineEdit::textEdited, this,
                [this, i](const QString& t) { m_form.SetFolder(i, t.toStdString()); });
        connect(browse, &QToolButton::clicked, this, [this, i, folder, check] {
            const QString picked =
                QFileDialog::getExistingDirectory(this, QString(), folder->text());
            if (picked.isEmpty()) return;
            folder->setText(picked + QLatin1Char('/'));
            m_form.SetFolder(i, folder->text().toStdString());
            check->setChecked(true);
        });
    }
    auto* save = Button(this, "Save Settings", "Command1");
    connect(save, &QPushButton::clicked, this, &DLWizard::Save);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(grid);
    layout->addWidget(save, 0, Qt::AlignRight);
    resize(560, 340);
}

bool DLWizard::Save() {
    if (!m_form.Save()) return false;
    accept();
    return true;
}

// --- INUpList -------------------------------------------------------------------------------

INUpList::INUpList(app::Session& session, QWidget* parent) : QDialog(parent), m_form(session) {
    setObjectName(QStringLiteral("INUpList"));
    setWindowTitle(QString::fromLatin1(app::UpdateListForm::kTitle));
    KeepWindowPosition(this, session.services().settings, "INUpList");
    m_form.Load();

    m_menus = new QMenuBar(this);
    const auto item = [this](QMenu* menu, const char* caption, const char* name, auto slot) {
        return NamedAction(menu, this, caption, name, slot);
    };
    QMenu* file = m_menus->addMenu(QStringLiteral("&File"));
    item(file, "&Save", "ulSave", [this] { Save(); });
    QMenu* rows = m_menus->addMenu(QStringLiteral("&Rows"));
    item(rows, "&Add Blank Rows", "ulAdd", [this] { AddRows(); });
    item(rows, "&Delete Rows", "ulDel", [this] { DeleteRows(); });

    m_options = new QButtonGroup(this);
    auto* optionsBox = new QVBoxLayout;
    for (int i = 0; i < 3; ++i) {
        auto* r = new QRadioButton(
            Text(app::UpdateListForm::OptionLabels()[static_cast<std::size_t>(i)]), this);
        r->setObjectName(QStringLiteral("Option%1").arg(i + 1));
        r->setChecked(i == m_form.option());
        m_options->addButton(r, i);
        optionsBox->addWidget(r);
    }
    connect(m_options, &QButtonGroup::idClicked, this, [this](int id) { m_form.ChooseOption(id); });

    m_grid = new GridView(m_form.grid(), session.dialogs(), "Update List", this);
    m_grid->setObjectName(QStringLiteral("grdList"));
    m_grid->setSelectionMode(QAbstractItemView::ContiguousSelection);
    m_master = new QListWidget(this);
    m_master->setObjectName(QStringLiteral("List1"));
    FillMaster();
    auto* add = Button(this, "Add checked items to list", "Command1");
    add->setEnabled(m_form.masterPresent());
    connect(add, &QPushButton::clicked, this, &INUpList::AddChecked);

    auto* right = new QVBoxLayout;
    right->addWidget(m_master, 1);
    right->addWidget(add);
    auto* body = new QHBoxLayout;
    body->addWidget(m_grid, 3);
    body->addLayout(right, 2);
    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addLayout(optionsBox);
    layout->addLayout(body, 1);
    resize(720, 480);
}

void INUpList::FillMaster() {
    m_master->clear();
    for (const auto& line : m_form.masterLines()) {
        auto* it = new QListWidgetItem(
            QString::fromLatin1(line.data(), static_cast<qsizetype>(line.size())), m_master);
        if (m_form.masterPresent()) it->setCheckState(Qt::Unchecked);
    }
    QFont mono(QStringLiteral("Monospace"));
    mono.setStyleHint(QFont::TypeWriter);
    m_master->setFont(mono);
}

void INUpList::AddChecked() {
    std::vector<int> chosen;
    for (int i = 0; i < m_master->count(); ++i)
        if (m_master->item(i)->checkState() == Qt::Checked) {
            chosen.push_back(i);
            m_master->item(i)->setCheckState(Qt::Unchecked);
        }
    if (m_form.AddMasterItems(chosen) > 0) {
        m_grid->Refresh();
        m_grid->scrollToBottom();
    }
}

void INUpList::AddRows() {
    if (m_form.AddRows() > 0) {
        m_grid->Refresh();
        m_grid->scrollToBottom();
    }
}

void INUpList::DeleteRows() {
    const auto ranges = m_grid->selectedRanges();
    int first = m_grid->currentRow(), last = first;
    if (!ranges.isEmpty()) {
        first = ranges.front().topRow();
        last = ranges.front().bottomRow();
    }
    if (first < 0) return;
    if (m_form.DeleteRows(first, last)) m_grid->Refresh();
}

bool INUpList::Save() {
    const bool saved = m_form.Save();
    // The option may have been reset to all stocks.
    if (auto* b = m_options->button(m_form.option())) b->setChecked(true);
    return saved;
}

void INUpList::reject() {
    if (!m_form.CanClose()) return;
    QDialog::reject();
}

} // namespace kori::gui
