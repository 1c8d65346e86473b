#pragma once
// One chart list as the list windows show it: the chooser of lists, the box of its codes and
// its count. The codes live in a store::ChartListBox; the box on screen mirrors it.
#include "app/session.h"
#include "store/chart_list.h"

#include <QString>
#include <QWidget>

#include <functional>
#include <string>
#include <vector>

class QComboBox;
class QLabel;
class QListWidget;

namespace kori::gui {

class ChartListPanel : public QWidget {
    Q_OBJECT
public:
    // `withZ` adds the scan list after the ten user lists; `suffix` ends the control names
    // (cboList<suffix>, lstList<suffix>, lblCount<suffix>) so two panels can share a window.
    ChartListPanel(app::Session& session, bool withZ, const QString& suffix, QWidget* parent);

    QComboBox* chooser() const { return m_chooser; }
    QListWidget* list() const { return m_list; }
    store::ChartListBox& box() { return m_box; }
    const store::ChartListBox& box() const { return m_box; }

    // List mode on show (2..12), 0 while no list is displayed.
    int mode() const { return m_mode; }
    bool displayed() const { return m_mode != 0; }
    std::string displayName() const;

    // Called before the chooser moves to another list; false keeps the list on show (and the
    // chooser goes back to it).
    void SetGuard(std::function<bool(int newMode)> guard) { m_guard = std::move(guard); }

    // Loads and shows the list of a mode, without asking.
    bool Display(int mode);
    // SaveSubList for the list on show; a failure is reported and returns false.
    bool Save();
    // Asks `question` (Yes/No) when the list has changes; Yes saves. False only when the save
    // failed.
    bool AskToSave(const std::string& question, const std::string& title);

    // Rows selected in the box, in order.
    std::vector<std::size_t> SelectedRows() const;
    // Mirrors the codes after a change of the box.
    void Refresh();

signals:
    void ListShown(int mode);

private:
    void ChooserMoved(int row);

    app::Session& m_session;
    QComboBox* m_chooser;
    QListWidget* m_list;
    QLabel* m_count;
    store::ChartListBox m_box;
    int m_mode = 0;
    std::function<bool(int)> m_guard;
};

} // namespace kori::gui
