#include "gui/windows/data_entry.h"

#include "gui/widgets/window_place.h"
#include "platform/text.h"

#include <QCheckBox>
#include <QFileDialog>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QVBoxLayout>

#include <algorithm>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromLatin1(s.data(), static_cast<int>(s.size()));
}
std::string S(const QString& s) {
    return s.toLatin1().toStdString();
}
} // namespace

DataEntry::DataEntry(app::Session& session, QWidget* parent)
    : QDialog(parent), m_form(session.folders.DataFolder, session.dialogs()) {
    setObjectName(QStringLiteral("DataEntry"));
    setWindowTitle(QString::fromLatin1(app::DataEntryForm::kTitle));
    KeepWindowPosition(this, session.services().settings, "DataEntry");

    m_code = new QLineEdit(this);
    m_code->setObjectName(QStringLiteral("txtCode"));
    m_code->setMaxLength(6);
    m_updown = new QSpinBox(this);
    m_updown->setObjectName(QStringLiteral("updSecurity"));
    m_updown->setWrapping(true);
    m_name = new QLabel(this);
    m_name->setObjectName(QStringLiteral("lblName"));
    m_type = new QLabel(this);
    m_type->setObjectName(QStringLiteral("lblRecType"));
    auto* top = new QHBoxLayout;
    top->addWidget(m_code);
    top->addWidget(m_updown);
    top->addWidget(m_name, 1);
    top->addWidget(m_type);

    auto* grid = new QGridLayout;
    grid->addWidget(new QLabel(QStringLiteral("Previous"), this), 0, 1);
    grid->addWidget(new QLabel(QStringLiteral("Current"), this), 0, 2);
    grid->addWidget(new QLabel(QStringLiteral("Date  d/m/yy"), this), 1, 0);
    m_previousDate = new QLabel(this);
    m_previousDate->setObjectName(QStringLiteral("lblPrevDate"));
    grid->addWidget(m_previousDate, 1, 1);
    m_date = new QLineEdit(this);
    m_date->setObjectName(QStringLiteral("txtDate"));
    grid->addWidget(m_date, 1, 2);
    m_date->installEventFilter(this);
    for (int i = 0; i < app::DataEntryForm::kFigures; ++i) {
        const auto at = static_cast<std::size_t>(i);
        m_labels[at] = new QLabel(this);
        m_labels[at]->setObjectName(QStringLiteral("lblField%1").arg(i));
        m_previous[at] = new QLabel(this);
        m_previous[at]->setObjectName(QStringLiteral("lblPrev%1").arg(i));
        m_fields[at] = new QLineEdit(this);
        m_fields[at]->setObjectName(QStringLiteral("txtField%1").arg(i));
        m_fields[at]->installEventFilter(this);
        grid->addWidget(m_labels[at], i + 2, 0);
        grid->addWidget(m_previous[at], i + 2, 1);
        grid->addWidget(m_fields[at], i + 2, 2);
    }

    m_check1 = new QCheckBox(QStringLiteral("Auto Date Advance"), this);
    m_check1->setObjectName(QStringLiteral("Check1"));
    m_check1->setChecked(m_form.autoDateAdvance);
    m_check2 = new QCheckBox(QStringLiteral("Advance after Save"), this);
    m_check2->setObjectName(QStringLiteral("Check2"));
    m_check2->setChecked(m_form.advanceAfterSave);
    connect(m_check1, &QCheckBox::toggled, this, [this](bool on) { m_form.autoDateAdvance = on; });
    connect(m_check2, &QCheckBox::toggled, this, [this](bool on) { m_form.advanceAfterSave = on; });

    m_save = new QPushButton(QStringLiteral("&Save"), this);
    m_save->setObjectName(QStringLiteral("Command1"));
    auto* reset = new QPushButton(QStringLiteral("Reset"), this);
    reset->setObjectName(QStringLiteral("Command2"));
    auto* close = new QPushButton(QStringLiteral("Close"), this);
    close->setObjectName(QStringLiteral("Command3"));
    auto* folder = new QPushButton(QStringLiteral("Change Folder"), this);
    folder->setObjectName(QStringLiteral("Command4"));
    for (auto* b : {m_save, reset, close, folder})
        b->setAutoDefault(false);
    connect(m_save, &QPushButton::clicked, this, [this] { Save(); });
    connect(reset, &QPushButton::clicked, this, [this] {
        m_form.Reset();
        Refresh();
    });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    connect(folder, &QPushButton::clicked, this, [this] { ChangeFolder(); });

    connect(m_code, &QLineEdit::returnPressed, this, [this] {
        TakeFields();
        m_form.GoToCode(S(m_code->text()));
        Refresh();
    });
    connect(m_updown, &QSpinBox::valueChanged, this, [this](int value) {
        if (m_filling) return;
        TakeFields();
        m_form.Show(value - 1);
        Refresh();
    });

    auto* checks = new QHBoxLayout;
    checks->addWidget(m_check1);
    checks->addWidget(m_check2);
    auto* buttons = new QHBoxLayout;
    for (auto* b : {m_save, reset, close, folder})
        buttons->addWidget(b);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top);
    layout->addLayout(grid);
    layout->addLayout(checks);
    layout->addLayout(buttons);

    m_form.Open();
    Refresh();
}

void DataEntry::Refresh() {
    m_filling = true;
    const bool open = m_form.current() >= 0;
    m_updown->setRange(1, std::max(1, m_form.securityCount()));
    if (open) {
        m_updown->setValue(m_form.current() + 1);
        m_code->setText(Q(m_form.name().TrimmedCode()));
        m_name->setText(Q(platform::Trim(m_form.name().Name)));
    } else {
        m_code->clear();
        m_name->clear();
    }
    m_type->setText(Q(m_form.RecordTypeText()));
    const auto rows = m_form.Figures();
    const auto previous = m_form.PreviousTexts();
    m_previousDate->setText(Q(previous[0]));
    const std::array<const std::string*, app::DataEntryForm::kFigures> typed = {
        &m_form.entered.Open, &m_form.entered.High, &m_form.entered.Low, &m_form.entered.Close,
        &m_form.entered.Volume};
    for (std::size_t i = 0; i < rows.size(); ++i) {
        m_labels[i]->setText(Q(rows[i].Label));
        m_labels[i]->setVisible(rows[i].Shown);
        m_previous[i]->setText(Q(previous[i + 1]));
        m_previous[i]->setVisible(rows[i].Shown);
        m_fields[i]->setText(Q(*typed[i]));
        m_fields[i]->setVisible(rows[i].Shown);
    }
    m_date->setText(Q(m_form.entered.Date));
    m_filling = false;
}

void DataEntry::TakeFields() {
    auto& e = m_form.entered;
    e.Date = S(m_date->text());
    std::array<std::string*, app::DataEntryForm::kFigures> typed = {&e.Open, &e.High, &e.Low,
                                                                    &e.Close, &e.Volume};
    const auto rows = m_form.Figures();
    for (std::size_t i = 0; i < typed.size(); ++i)
        *typed[i] = rows[i].Shown ? S(m_fields[i]->text()) : std::string();
}

void DataEntry::Save() {
    TakeFields();
    if (!m_form.Save()) return;
    Refresh();
    if (m_form.selectDate()) {
        m_date->setFocus();
        m_date->selectAll();
    } else {
        for (auto* f : m_fields)
            if (f->isVisible()) {
                f->setFocus();
                break;
            }
    }
}

void DataEntry::ChangeFolder() {
    const QString dir = QFileDialog::getExistingDirectory(this, QStringLiteral("Change Folder"),
                                                          Q(m_form.dataFolder()));
    if (dir.isEmpty()) return;
    m_form.ChangeFolder(S(dir));
    Refresh();
}

void DataEntry::EnterIn(QLineEdit* field) {
    std::vector<QLineEdit*> order = {m_date};
    for (auto* f : m_fields)
        if (!f->isHidden()) order.push_back(f);
    const auto at = std::find(order.begin(), order.end(), field);
    if (at == order.end()) return;
    // The total of an advance-decline day is checked as it is left.
    if (field == m_fields[3] && m_form.current() >= 0 && m_form.name().RecordType == 3) {
        TakeFields();
        if (!m_form.LeaveTotal()) return;
    }
    if (at + 1 == order.end())
        m_save->setFocus();
    else
        (*(at + 1))->setFocus();
}

bool DataEntry::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::KeyPress) {
        const auto key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Return || key == Qt::Key_Enter) {
            EnterIn(qobject_cast<QLineEdit*>(watched));
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

} // namespace kori::gui
