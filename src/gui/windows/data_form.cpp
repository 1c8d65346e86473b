#include "gui/windows/data_form.h"

#include "gui/widgets/grid_view.h"
#include "gui/widgets/named_controls.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/repair_progress.h"
#include "platform/text.h"

#include <QButtonGroup>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString L(std::string_view text) {
    return QString::fromLatin1(text.data(), static_cast<int>(text.size()));
}
} // namespace

DataCodeEntry::DataCodeEntry(app::Session& session, QWidget* parent)
    : QDialog(parent), m_session(session) {
    setObjectName(QStringLiteral("DataCodeEntry"));
    setWindowTitle(QStringLiteral("Data File"));
    m_code = new QLineEdit(this);
    m_code->setObjectName(QStringLiteral("txtCode"));
    m_code->setMaxLength(6);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &DataCodeEntry::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &DataCodeEntry::reject);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(new QLabel(QStringLiteral("Code"), this));
    layout->addWidget(m_code);
    layout->addWidget(buttons);
}

std::string DataCodeEntry::code() const {
    return platform::Upper(platform::Trim(m_code->text().toLatin1().toStdString()));
}

void DataCodeEntry::accept() {
    m_file = app::DataFileForCode(m_session.folders.DataFolder, code(), m_session.dialogs());
    if (m_file) QDialog::accept();
}

DataForm::DataForm(app::Session& session, std::filesystem::path file, std::string code,
                   QWidget* parent)
    : QDialog(parent), m_session(session) {
    setObjectName(QStringLiteral("DataForm"));
    setWindowTitle(QStringLiteral("Data File  ") + QString::fromStdString(file.string()));
    KeepWindowPosition(this, session.services().settings, "DataForm");
    m_progress = new RepairProgress(this);
    m_model = std::make_unique<app::DataFormModel>(std::move(file), std::move(code),
                                                   session.dialogs(), *m_progress);
    m_grid = new GridView(m_model->grid(), session.dialogs(), "Data", this);
    m_grid->setObjectName(QStringLiteral("grdData"));
    m_grid->setSelectionMode(QAbstractItemView::ContiguousSelection);

    m_menus = new QMenuBar(this);
    const auto item = [this](const char* caption, const char* name, auto slot) {
        return NamedAction(m_menus, this, caption, name, slot);
    };
    item("&Save", "mnuSave", [this] {
        if (!m_model->SaveData() && m_model->refusal())
            m_grid->setCurrentCell(m_model->refusal()->Row, m_model->refusal()->Column);
    });
    item("S&ort", "mnuSort", [this] {
        if (m_model->SortData()) m_grid->Refresh();
    });
    item("&Delete Rows", "mnuDeleteRows", [this] {
        const auto [first, last] = SelectedRows();
        if (m_model->DeleteRows(first, last)) m_grid->Refresh();
    });
    item("Adjust &Volume", "nmAdjVol", [this] { AdjustVolume(); });
    item("&Close", "mnuClose", [this] { reject(); });

    auto* layout = new QVBoxLayout(this);
    layout->setMenuBar(m_menus);
    layout->addWidget(m_grid, 1);
    layout->addWidget(m_progress);
    resize(860, 560);
    m_loaded = m_model->ShowData();
    m_grid->Refresh();
    if (m_grid->rowCount() > 0) m_grid->scrollToBottom(); // the newest record
}

DataForm::~DataForm() = default;

std::pair<int, int> DataForm::SelectedRows() const {
    const auto ranges = m_grid->selectedRanges();
    if (ranges.isEmpty()) {
        const int row = m_grid->currentRow();
        return row < 0 ? std::pair{0, 0} : std::pair{row + 1, row + 1};
    }
    return {ranges.first().topRow() + 1, ranges.first().bottomRow() + 1};
}

void DataForm::AdjustVolume() {
    const auto [first, last] = SelectedRows();
    if (first < 1) return;
    VolMod window(*m_model, first, last, this);
    if (window.exec() == QDialog::Accepted) m_grid->Refresh();
}

void DataForm::reject() {
    if (!m_model->Close()) return;
    QDialog::reject();
}

VolMod::VolMod(app::DataFormModel& model, int first, int last, QWidget* parent)
    : QDialog(parent), m_model(model), m_first(first), m_last(last) {
    setObjectName(QStringLiteral("VolMod"));
    setWindowTitle(L(maint::vol_mod_text::kCaption));
    auto* layout = new QVBoxLayout(this);
    auto* range = new QLabel(QString::fromStdString(maint::VolModRangeText(first, last)), this);
    range->setObjectName(QStringLiteral("lblRange"));
    layout->addWidget(range);
    auto* explain = new QLabel(L(maint::vol_mod_text::kExplain), this);
    explain->setWordWrap(true);
    layout->addWidget(explain);

    auto* itemBox = new QGroupBox(this);
    auto* itemRow = new QHBoxLayout(itemBox);
    m_items = new QButtonGroup(this);
    for (std::size_t i = 0; i < maint::vol_mod_text::kItems.size(); ++i) {
        auto* b = new QRadioButton(L(maint::vol_mod_text::kItems[i]), itemBox);
        m_items->addButton(b, static_cast<int>(i));
        itemRow->addWidget(b);
    }
    layout->addWidget(itemBox);
    auto* opBox = new QGroupBox(this);
    auto* opRow = new QHBoxLayout(opBox);
    m_ops = new QButtonGroup(this);
    auto* times = new QRadioButton(QStringLiteral("x"), opBox);
    auto* divide = new QRadioButton(QStringLiteral("/"), opBox);
    m_ops->addButton(times, static_cast<int>(maint::VolOp::Multiply));
    m_ops->addButton(divide, static_cast<int>(maint::VolOp::Divide));
    m_factor = new QComboBox(opBox);
    for (int f : maint::kVolModFactors)
        m_factor->addItem(QString::number(f), f);
    m_factor->setCurrentIndex(1); // 100
    opRow->addWidget(times);
    opRow->addWidget(divide);
    opRow->addWidget(m_factor);
    layout->addWidget(opBox);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &VolMod::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &VolMod::reject);
    layout->addWidget(buttons);
}

void VolMod::accept() {
    std::optional<maint::VolItem> item;
    if (m_items->checkedId() >= 0) item = static_cast<maint::VolItem>(m_items->checkedId());
    const auto op = m_ops->checkedId() >= 0 ? static_cast<maint::VolOp>(m_ops->checkedId())
                                            : maint::VolOp::None;
    if (m_model.AdjustVolumes(m_first, m_last, item, op, m_factor->currentData().toInt()))
        QDialog::accept();
}

} // namespace kori::gui
