#include "gui/windows/import_csv.h"

#include "gui/widgets/window_place.h"

#include <QCheckBox>
#include <QFileDialog>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
std::string S(const QString& s) {
    return s.toStdString();
}
} // namespace

ImportCsv::ImportCsv(app::Session& session, QWidget* parent)
    : QDialog(parent), m_session(session), m_form(session.folders.DataFolder, session.dialogs()) {
    setObjectName(QStringLiteral("ImportCsv"));
    setWindowTitle(QString::fromLatin1(app::CsvImportForm::kTitle));
    KeepWindowPosition(this, session.services().settings, "ImportCsv");

    m_file = new QLineEdit(this);
    m_file->setObjectName(QStringLiteral("txtFile"));
    m_file->setMinimumWidth(320);
    auto* browse = new QPushButton(QStringLiteral("..."), this);
    browse->setObjectName(QStringLiteral("cmdBrowse"));
    connect(browse, &QPushButton::clicked, this, [this] { Browse(); });
    auto* fileRow = new QHBoxLayout;
    fileRow->addWidget(m_file, 1);
    fileRow->addWidget(browse);

    m_code = new QLineEdit(this);
    m_code->setObjectName(QStringLiteral("txtCode"));
    m_code->setMaxLength(6);
    m_name = new QLineEdit(this);
    m_name->setObjectName(QStringLiteral("txtName"));
    m_name->setMaxLength(35);
    // A code already in the name file shows its name: the import then adds to its history.
    connect(m_code, &QLineEdit::editingFinished, this, [this] {
        m_form.code = S(m_code->text());
        const std::string existing = m_form.ExistingName();
        if (!existing.empty()) m_name->setText(Q(existing));
        m_name->setEnabled(existing.empty());
    });
    m_replace = new QCheckBox(QStringLiteral("Replace days already on file"), this);
    m_replace->setObjectName(QStringLiteral("chkReplace"));

    auto* form = new QFormLayout;
    form->addRow(QStringLiteral("CSV file"), fileRow);
    form->addRow(QStringLiteral("Code"), m_code);
    form->addRow(QStringLiteral("Name"), m_name);
    form->addRow(QString(), m_replace);

    m_result = new QLabel(this);
    m_result->setObjectName(QStringLiteral("lblResult"));
    m_result->setWordWrap(true);
    auto* import = new QPushButton(QStringLiteral("&Import"), this);
    import->setObjectName(QStringLiteral("cmdImport"));
    auto* close = new QPushButton(QStringLiteral("&Close"), this);
    close->setObjectName(QStringLiteral("cmdClose"));
    connect(import, &QPushButton::clicked, this, [this] { Import(); });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(import);
    buttons->addWidget(close);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addWidget(m_result);
    layout->addLayout(buttons);
}

void ImportCsv::Browse() {
    const QString chosen =
        QFileDialog::getOpenFileName(this, QStringLiteral("CSV file"), m_file->text(),
                                     QStringLiteral("CSV files (*.csv *.txt);;All files (*)"));
    if (!chosen.isEmpty()) m_file->setText(chosen);
}

bool ImportCsv::Import() {
    m_form.file = S(m_file->text());
    m_form.code = S(m_code->text());
    m_form.name = m_name->isEnabled() ? S(m_name->text()) : std::string();
    m_form.replace = m_replace->isChecked();
    const bool ok = m_form.Import();
    m_result->setText(Q(m_form.resultText()));
    return ok;
}

} // namespace kori::gui
