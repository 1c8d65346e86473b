#include "gui/windows/locate.h"

#include "platform/files.h"

#include <QComboBox>
#include <QDir>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStorageInfo>
#include <QTreeView>
#include <QVBoxLayout>

namespace kori::gui {

Locate::Locate(app::Session& session, SettingsHub& hub, const std::string& start, QWidget* parent)
    : SettingsDialog(session, hub, "Locate", QStringLiteral("Modify File Locations"), parent),
      m_drives(new QComboBox(this)), m_model(new QFileSystemModel(this)),
      m_tree(new QTreeView(this)), m_path(new QLineEdit(this)) {
    m_drives->setObjectName(QStringLiteral("Drive1"));
    m_tree->setObjectName(QStringLiteral("Dir1"));
    m_path->setObjectName(QStringLiteral("txtPath"));
    // Mounted volumes stand in for the drive letters of the original.
    for (const QStorageInfo& v : QStorageInfo::mountedVolumes())
        if (v.isValid() && v.isReady() && !v.isReadOnly()) m_drives->addItem(v.rootPath());
    if (m_drives->findText(QDir::homePath()) < 0) m_drives->insertItem(0, QDir::homePath());

    m_model->setFilter(QDir::AllDirs | QDir::NoDotAndDotDot);
    m_model->setRootPath(QStringLiteral("/"));
    m_tree->setModel(m_model);
    for (int c = 1; c < m_model->columnCount(); ++c)
        m_tree->hideColumn(c);
    m_tree->header()->hide();

    auto* ok = Button(QStringLiteral("OK"), "cmdOK");
    auto* cancel = Button(QStringLiteral("Cancel"), "cmdCancel");
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(new QLabel(QStringLiteral("Drive"), this));
    layout->addWidget(m_drives);
    layout->addWidget(new QLabel(QStringLiteral("Folders"), this));
    layout->addWidget(m_tree, 1);
    layout->addWidget(m_path);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(ok);
    buttons->addWidget(cancel);
    layout->addLayout(buttons);
    resize(460, 420);

    connect(m_drives, &QComboBox::currentTextChanged, this, [this](const QString& root) {
        m_tree->setRootIndex(m_model->index(root));
        m_path->setText(root);
    });
    connect(m_tree, &QTreeView::clicked, this,
            [this](const QModelIndex& i) { m_path->setText(m_model->filePath(i)); });
    connect(ok, &QPushButton::clicked, this, &Locate::Ok);
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
    SetPath(Q(start));
}

void Locate::SetPath(const QString& path) {
    m_path->setText(path);
    const QModelIndex i = m_model->index(path);
    if (i.isValid()) {
        m_tree->setCurrentIndex(i);
        m_tree->scrollTo(i);
    }
}

void Locate::Ok() {
    const QString path = m_path->text().trimmed();
    if (path.isEmpty() || !QFileInfo(path).isDir()) {
        dialogs().MsgBox("Path not set correctly", "Modify File Locations");
        return;
    }
    m_chosen = platform::FolderWithSlash(S(QDir::cleanPath(path)));
    accept();
}

std::optional<std::string> Locate::Choose(app::Session& session, SettingsHub& hub,
                                          const std::string& start, QWidget* parent) {
    Locate w(session, hub, start, parent);
    if (w.exec() != QDialog::Accepted) return std::nullopt;
    return w.chosen();
}

} // namespace kori::gui
