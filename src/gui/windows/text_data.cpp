#include "gui/windows/text_data.h"

#include "gui/services/qt_progress.h"

#include <QButtonGroup>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QFileDialog>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

#include <functional>

namespace kori::gui {

namespace {

QString Text(const std::string& s) {
    return QString::fromStdString(s);
}

QComboBox* ListBox(app::Session& session, QWidget* parent) {
    auto* box = new QComboBox(parent);
    box->setObjectName(QStringLiteral("cboList"));
    for (const auto& c : app::ExportListCaptions(session))
        box->addItem(Text(c));
    return box;
}

QLineEdit* Edit(const char* name, QWidget* parent, int width = 0) {
    auto* e = new QLineEdit(parent);
    e->setObjectName(QString::fromLatin1(name));
    if (width > 0) e->setMaximumWidth(width);
    return e;
}

// A line edit with a "..." button beside it that fills it from a file dialog.
QWidget* WithChooser(QLineEdit* edit, QWidget* parent, std::function<void()> choose) {
    auto* row = new QWidget(parent);
    auto* l = new QHBoxLayout(row);
    l->setContentsMargins(0, 0, 0, 0);
    l->addWidget(edit, 1);
    auto* b = new QPushButton(QStringLiteral("..."), row);
    b->setObjectName(QStringLiteral("cmdChoose"));
    b->setMaximumWidth(40);
    QObject::connect(b, &QPushButton::clicked, row, std::move(choose));
    l->addWidget(b);
    return row;
}

// "Create" and "Close", and a label for the outcome.
QLabel* Finish(QDialog* dialog, QVBoxLayout* layout, std::function<void()> create) {
    auto* status = new QLabel(dialog);
    status->setObjectName(QStringLiteral("lblStatus"));
    status->setWordWrap(true);
    layout->addWidget(status);
    auto* buttons = new QDialogButtonBox(dialog);
    auto* make = buttons->addButton(QStringLiteral("&Create"), QDialogButtonBox::AcceptRole);
    make->setObjectName(QStringLiteral("cmdCreate"));
    auto* close = buttons->addButton(QStringLiteral("Close"), QDialogButtonBox::RejectRole);
    close->setObjectName(QStringLiteral("cmdClose"));
    QObject::connect(make, &QPushButton::clicked, dialog, std::move(create));
    QObject::connect(close, &QPushButton::clicked, dialog, &QDialog::reject);
    layout->addWidget(buttons);
    return status;
}

app::ExportOutcome Shown(app::ExportOutcome outcome, app::Session& session, QLabel* status,
                         QtProgress& progress) {
    progress.Finish();
    if (!outcome.Ok) session.dialogs().MsgBox(outcome.Message, app::kTextExportTitle);
    status->setText(outcome.Ok ? Text(outcome.Message) : QString());
    return outcome;
}

} // namespace

TextData::TextData(app::Session& session, QtProgress& progress, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress) {
    setObjectName(QStringLiteral("TextData"));
    setWindowTitle(QStringLiteral("Create text file of closing prices"));
    auto* layout = new QVBoxLayout(this);
    auto* form = new QFormLayout;
    m_list = ListBox(session, this);
    form->addRow(QStringLiteral("Securities"), m_list);
    m_date = Edit("txtDate", this, 110);
    m_date->setPlaceholderText(QStringLiteral("latest"));
    form->addRow(QStringLiteral("Date  d/m/yy (blank: the latest)"), m_date);
    m_file = Edit("txtFile", this);
    m_file->setText(Text(session.folders.SystemFolder + "Closes.csv"));
    form->addRow(QStringLiteral("File"), WithChooser(m_file, this, [this] {
                     const QString f = QFileDialog::getSaveFileName(
                         this, windowTitle(), m_file->text(), QStringLiteral("CSV (*.csv)"));
                     if (!f.isEmpty()) m_file->setText(f);
                 }));
    layout->addLayout(form);
    m_status = Finish(this, layout, [this] { Create(); });
    resize(560, sizeHint().height());
}

app::ExportOutcome TextData::Create() {
    app::ClosesForm f;
    f.ListIndex = m_list->currentIndex();
    f.DateText = m_date->text().toStdString();
    f.File = m_file->text().toStdString();
    m_progress.ResetCancel();
    return Shown(f.Run(m_session, m_progress), m_session, m_status, m_progress);
}

TextFull::TextFull(app::Session& session, QtProgress& progress, QWidget* parent)
    : QDialog(parent), m_session(session), m_progress(progress) {
    setObjectName(QStringLiteral("TextFull"));
    setWindowTitle(QStringLiteral("Create text file of data (OHLCV)"));
    auto* layout = new QVBoxLayout(this);
    auto* form = new QFormLayout;
    m_one = new QRadioButton(QStringLiteral("One security"), this);
    m_one->setObjectName(QStringLiteral("optOne"));
    m_one->setChecked(true);
    m_code = Edit("txtCode", this, 90);
    form->addRow(m_one, m_code);
    m_many = new QRadioButton(QStringLiteral("A list"), this);
    m_many->setObjectName(QStringLiteral("optList"));
    m_list = ListBox(session, this);
    form->addRow(m_many, m_list);
    m_from = Edit("txtFrom", this, 110);
    m_from->setPlaceholderText(QStringLiteral("first"));
    form->addRow(QStringLiteral("From  d/m/yy"), m_from);
    m_to = Edit("txtTo", this, 110);
    m_to->setPlaceholderText(QStringLiteral("last"));
    form->addRow(QStringLiteral("To  d/m/yy"), m_to);
    auto* formats = new QWidget(this);
    auto* fl = new QHBoxLayout(formats);
    fl->setContentsMargins(0, 0, 0, 0);
    m_csv = new QRadioButton(QStringLiteral("CSV with a header"), formats);
    m_csv->setObjectName(QStringLiteral("optCsv"));
    m_csv->setChecked(true);
    m_day = new QRadioButton(QStringLiteral("Day files (DDMMMYY.D)"), formats);
    m_day->setObjectName(QStringLiteral("optDay"));
    fl->addWidget(m_csv);
    fl->addWidget(m_day);
    form->addRow(QStringLiteral("Format"), formats);
    m_output = Edit("txtOutput", this);
    m_output->setText(Text(session.folders.SystemFolder + "Data.csv"));
    form->addRow(QStringLiteral("File or folder"),
                 WithChooser(m_output, this, [this] { ChooseOutput(); }));
    layout->addLayout(form);
    // The two choices of what to export exclude each other within their own group.
    auto* which = new QButtonGroup(this);
    which->addButton(m_one);
    which->addButton(m_many);
    m_status = Finish(this, layout, [this] { Create(); });
    resize(560, sizeHint().height());
}

void TextFull::ChooseOutput() {
    const QString f = m_day->isChecked()
                          ? QFileDialog::getExistingDirectory(this, windowTitle(), m_output->text())
                          : QFileDialog::getSaveFileName(this, windowTitle(), m_output->text(),
                                                         QStringLiteral("CSV (*.csv)"));
    if (!f.isEmpty()) m_output->setText(f);
}

app::ExportOutcome TextFull::Create() {
    app::DataForm f;
    f.OneSecurity = m_one->isChecked();
    f.Code = m_code->text().toStdString();
    f.ListIndex = m_list->currentIndex();
    f.FromText = m_from->text().toStdString();
    f.ToText = m_to->text().toStdString();
    f.DayFiles = m_day->isChecked();
    f.Output = m_output->text().toStdString();
    m_progress.ResetCancel();
    return Shown(f.Run(m_session, m_progress), m_session, m_status, m_progress);
}

} // namespace kori::gui
