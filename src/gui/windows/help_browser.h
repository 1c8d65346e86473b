#pragma once
// The help browser over the pages shipped inside the program, the About window and the tips
// window shown at start-up.
#include "app/help_index.h"

#include <QDialog>

#include <string>

class QLabel;
class QLineEdit;
class QListWidget;
class QTextBrowser;
class QCheckBox;

namespace kori::platform {
class SettingsStore;
}

namespace kori::gui {

class MainWindow;

// The resource path of a help page, "qrc:/help/<id>.html".
QString HelpPageUrl(const std::string& id);
// The page text from the resources; empty when the program does not carry it.
QString HelpPageHtml(const std::string& id);

class HelpBrowser : public QDialog {
    Q_OBJECT
public:
    explicit HelpBrowser(QWidget* parent = nullptr);
    void ShowPage(const std::string& id);
    // The id of the page on show.
    std::string CurrentPage() const;
    QTextBrowser* browser() const { return m_browser; }
    // Runs the search field's words and lists what it found in place of the contents.
    void Search(const QString& words);

private:
    void ListPages(const std::vector<const app::HelpPage*>& pages);

    QListWidget* m_list;
    QTextBrowser* m_browser;
    QLineEdit* m_search;
};

// "About KORI": the version and the folders this copy runs from.
class AbtKori : public QDialog {
    Q_OBJECT
public:
    AbtKori(const QString& text, QWidget* parent = nullptr);
    QString text() const;

private:
    QLabel* m_text;
};

// "Tips": one tip at a time; its check box is the start-up setting.
class TipsWindow : public QDialog {
    Q_OBJECT
public:
    TipsWindow(platform::SettingsStore& settings, QWidget* parent = nullptr);
    QString tip() const;

private:
    void ShowTip();

    platform::SettingsStore& m_settings;
    app::Tips m_tips;
    QLabel* m_tip;
    QCheckBox* m_show;
};

// Binds "Help", "ToggleTips" and F1 in the main window; "AbtKori" stays the main window's.
void RegisterHelpWindows(MainWindow& main);
// Opens the help at the page of `window` (by its object name or a parent's).
HelpBrowser* OpenHelpFor(MainWindow& main, const QWidget* window);
// The tips window, when the setting asks for it; never modal.
void ShowTipsIfWanted(MainWindow& main);

} // namespace kori::gui
