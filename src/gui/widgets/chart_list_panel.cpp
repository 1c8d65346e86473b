#include "gui/widgets/chart_list_panel.h"

#include "gui/widgets/settings_dialog.h"

#include <QComboBox>
#include <QLabel>
#include <QListWidget>
#include <QSignalBlocker>
#include <QVBoxLayout>

#include <algorithm>

namespace kori::gui {

ChartListPanel::ChartListPanel(app::Session& session, bool withZ, const QString& suffix,
                               QWidget* parent)
    : QWidget(parent), m_session(session) {
    m_chooser = new QComboBox(this);
    m_chooser->setObjectName(QStringLiteral("cboList") + suffix);
    for (const auto& name : store::ListChoices(session.services().settings, withZ))
        m_chooser->addItem(Q(name));
    m_chooser->setCurrentIndex(-1);
    m_list = new QListWidget(this);
    m_list->setObjectName(QStringLiteral("lstList") + suffix);
    m_list->setSelectionMode(QAbstractItemView::ExtendedSelection);
    m_count = new QLabel(this);
    m_count->setObjectName(QStringLiteral("lblCount") + suffix);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_chooser);
    layout->addWidget(m_list, 1);
    layout->addWidget(m_count);
    connect(m_chooser, &QComboBox::currentIndexChanged, this, &ChartListPanel::ChooserMoved);
    Refresh();
}

std::string ChartListPanel::displayName() const {
    const int row = store::ChoiceOfMode(m_mode);
    return row >= 0 && row < m_chooser->count() ? S(m_chooser->itemText(row)) : std::string();
}

void ChartListPanel::ChooserMoved(int row) {
    const int mode = store::ModeOfChoice(row);
    if (mode == 0 || mode == m_mode) return;
    if (m_guard && !m_guard(mode)) {
        const QSignalBlocker block(m_chooser);
        m_chooser->setCurrentIndex(store::ChoiceOfMode(m_mode));
        return;
    }
    Display(mode);
}

bool ChartListPanel::Display(int mode) {
    const char letter = store::ListLetterOfMode(mode);
    if (letter == 0) return false;
    if (auto s = m_box.Load(m_session.folders.DataFolder, letter); !s) {
        m_session.dialogs().MsgBox(s.message(), "Chart Lists");
        return false;
    }
    m_mode = mode;
    {
        const QSignalBlocker block(m_chooser);
        m_chooser->setCurrentIndex(store::ChoiceOfMode(mode));
    }
    Refresh();
    emit ListShown(mode);
    return true;
}

bool ChartListPanel::Save() {
    std::vector<std::string> dropped;
    if (auto s = m_box.Save(m_session.folders.DataFolder, &dropped); !s) {
        m_session.dialogs().MsgBox(s.message(), "Chart Lists");
        return false;
    }
    Refresh();
    if (!dropped.empty())
        m_session.dialogs().MsgBox(store::RefusedCodesMessage(store::kSaveDroppedHeading, dropped),
                                   "Chart Lists");
    return true;
}

bool ChartListPanel::AskToSave(const std::string& question, const std::string& title) {
    if (!displayed() || !m_box.changed()) return true;
    if (m_session.dialogs().MsgBox(question, title, platform::Buttons::YesNo,
                                   platform::Icon::Question) != platform::Answer::Yes)
        return true;
    return Save();
}

std::vector<std::size_t> ChartListPanel::SelectedRows() const {
    std::vector<std::size_t> rows;
    for (const auto& index : m_list->selectionModel()->selectedIndexes())
        rows.push_back(static_cast<std::size_t>(index.row()));
    std::sort(rows.begin(), rows.end());
    return rows;
}

void ChartListPanel::Refresh() {
    const int current = m_list->currentRow();
    m_list->clear();
    for (const auto& code : m_box.codes())
        m_list->addItem(Q(code));
    if (current >= 0 && current < m_list->count()) m_list->setCurrentRow(current);
    const auto n = m_box.codes().size();
    m_count->setText(displayed() ? QStringLiteral("%1 chart%2").arg(n).arg(n == 1 ? "" : "s")
                                 : QString());
}

} // namespace kori::gui
