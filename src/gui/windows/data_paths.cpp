#include "gui/windows/data_paths.h"

#include "platform/files.h"

#include <QButtonGroup>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

DataPaths::DataPaths(app::Session& session, SettingsHub& hub, Mode mode, QWidget* parent)
    : SettingsDialog(session, hub, "DataPaths", QStringLiteral("Data Folders"), parent),
      m_mode(mode) {
    const bool setting = mode == Mode::Setting;
    auto* heading = new QLabel(
        setting ? QStringLiteral(
                      "Sets the folder locations for KORI data and the current path for viewing "
                      "charts.")
                : QStringLiteral("Set the current data path for viewing charts."),
        this);
    heading->setObjectName(QStringLiteral("lblMode"));
    heading->setWordWrap(true);
    // The file is the truth; the session's copy is filled only for DataService 3.
    const auto read = app::ReadChartPathsFile(session.folders.SystemFolder + "ChtPaths.lst");
    const app::ChartDataPaths paths = read.value_or(session.chartDataPaths);

    auto* grid = new QGridLayout;
    grid->addWidget(new QLabel(QStringLiteral("Current"), this), 0, 0);
    grid->addWidget(new QLabel(QStringLiteral("Data type"), this), 0, 1);
    grid->addWidget(new QLabel(QStringLiteral("Folder"), this), 0, 2);
    auto* group = new QButtonGroup(this);
    for (int i = 0; i < app::kDataTypeCount; ++i) {
        const auto u = static_cast<std::size_t>(i);
        auto* option = new QRadioButton(this);
        option->setObjectName(QStringLiteral("optPath%1").arg(i));
        group->addButton(option, i);
        auto* edit = new QLineEdit(Q(paths[u]), this);
        edit->setObjectName(QStringLiteral("txtPath%1").arg(i));
        edit->setReadOnly(!setting);
        edit->setMinimumWidth(320);
        const QString label = QString::fromUtf8(
            app::DataFolderLabels()[u].data(), static_cast<int>(app::DataFolderLabels()[u].size()));
        const QString type = QString::fromUtf8(app::DataTypeNames()[u].data(),
                                               static_cast<int>(app::DataTypeNames()[u].size()));
        auto* name = new QLabel(label, this);
        name->setToolTip(type);
        grid->addWidget(option, i + 1, 0);
        grid->addWidget(name, i + 1, 1);
        grid->addWidget(edit, i + 1, 2);
        m_fields[u] = edit;
        m_options[u] = option;
    }
    MarkCurrent();
    connect(group, &QButtonGroup::idClicked, this, [this](int id) {
        if (!Pick(id)) MarkCurrent();
    });

    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    if (setting) {
        auto* save = Button(QStringLiteral("SAVE"), "cmdSave");
        connect(save, &QPushButton::clicked, this, [this] {
            if (Save()) accept();
        });
        buttons->addWidget(save);
    }
    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    buttons->addWidget(close);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(heading);
    layout->addLayout(grid);
    layout->addLayout(buttons);
}

void DataPaths::MarkCurrent() {
    const std::string current = m_session.folders.DataFolder;
    for (std::size_t i = 0; i < m_fields.size(); ++i) {
        const std::string shown = S(m_fields[i]->text().trimmed());
        const bool match = !shown.empty() && platform::FolderWithSlash(shown) == current;
        m_options[i]->setAutoExclusive(false);
        m_options[i]->setChecked(match);
        m_options[i]->setAutoExclusive(true);
    }
}

bool DataPaths::Save() {
    app::ChartDataPaths edited;
    for (std::size_t i = 0; i < edited.size(); ++i)
        edited[i] = S(m_fields[i]->text());
    if (!app::SaveDataPaths(m_session, edited)) return false;
    for (std::size_t i = 0; i < edited.size(); ++i)
        m_fields[i]->setText(Q(m_session.chartDataPaths[i]));
    return true;
}

bool DataPaths::Pick(int i) {
    const std::string folder = S(field(i)->text());
    if (!app::PickDataFolder(m_session, folder)) {
        dialogs().MsgBox("There is no name file (Names.dat) in " + folder, "Data Folders");
        return false;
    }
    m_folderChanged = true;
    MarkCurrent();
    m_hub.DataFolderChanged();
    return true;
}

} // namespace kori::gui
