#pragma once
// Main: the frame that holds the menus and every other window as a child.
#include "app/menu_model.h"
#include "app/session.h"
#include "app/window_position.h"

#include <QMainWindow>

#include <functional>
#include <map>
#include <string>

class QMdiArea;
class QMdiSubWindow;
class QMenu;

namespace kori::gui {

class QtProgress;

class MainWindow : public QMainWindow {
    Q_OBJECT
public:
    explicit MainWindow(app::Session& session, QWidget* parent = nullptr);
    ~MainWindow() override;

    QMdiArea* mdiArea() const { return m_mdi; }
    // On the first start (no size kept yet) the main window grows, within the screen, until a
    // child window shows whole; what still does not fit is reached by the work area's scroll
    // bars. A size the user chose is left alone.
    void FitChild(QMdiSubWindow* child);
    bool firstStart() const { return m_firstStart; }
    QtProgress& progress() { return *m_progress; }

    // Sets the caption from the current data folder.
    void UpdateCaption();
    // Rebuilds the menus from the tree and the conditions of the moment.
    void RebuildMenus();
    // Hides the tops while a tool that must not be interrupted runs.
    void SetModalToolRunning(bool running);
    // Closes every child window.
    void ULForms();
    // Runs the action behind a menu item by its control name (used by tests and start-up).
    bool Trigger(const std::string& itemName);

    // Registers what a menu item opens; items without an action are left out of the menus.
    void SetAction(const std::string& opens, std::function<void()> action);
    // Whether something opens `opens`, and opening it (false when nothing is registered).
    bool HasAction(const std::string& opens) const { return m_actions.count(opens) > 0; }
    bool Open(const std::string& opens);

    app::Session& session() { return m_session; }
    bool ending() const { return m_ending; }
    void SetHideDownloadProgram(bool hide) { m_hideDownloadProgram = hide; }

protected:
    void closeEvent(QCloseEvent* e) override;

private:
    void AddItems(QMenu* menu, const std::vector<app::MenuItem>& items);
    app::MenuConditions Conditions() const;
    void ShowAbout();
    app::PixelSize FreeScreen() const;

    app::Session& m_session;
    QMdiArea* m_mdi;
    QtProgress* m_progress;
    std::vector<app::MenuItem> m_tops;
    std::map<std::string, std::function<void()>> m_actions; // by `opens`
    bool m_modal = false;
    bool m_ending = false;
    bool m_hideDownloadProgram = false;
    bool m_firstStart = false;
};

} // namespace kori::gui
