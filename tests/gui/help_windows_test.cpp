#include "app/help_index.h"
#include "desktop_fixture.h"
#include "gui/windows/help_browser.h"

#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRegularExpression>
#include <QTest>
#include <QTextBrowser>
#include <QToolButton>

#include <set>

using namespace kori;

namespace {

// Where KORI_SHOTS names a folder, a picture of the window goes there for a look by eye.
void Shot(QWidget* w, const char* name) {
    if (const char* dir = std::getenv("KORI_SHOTS"))
        w->grab().save(QString::fromLatin1(dir) + QLatin1Char('/') + QLatin1String(name));
}

struct HelpTest : test::DesktopTest {
    gui::HelpBrowser* help() { return main.findChild<gui::HelpBrowser*>("HelpBrowser"); }
};

} // namespace

TEST(HelpPages, EveryPageIsCarriedWithTitleAndLinksThatResolve) {
    std::set<std::string> ids;
    for (const auto& p : app::HelpPages())
        ids.insert(p.id);
    const QRegularExpression link(QStringLiteral("href=\"([^\"]+)\""));
    for (const auto& p : app::HelpPages()) {
        const QString html = gui::HelpPageHtml(p.id);
        ASSERT_FALSE(html.isEmpty()) << "not in the resources: " << p.id;
        EXPECT_TRUE(html.contains(QStringLiteral("<h1>") +
                                  QString::fromStdString(p.title).toHtmlEscaped() +
                                  QStringLiteral("</h1>")))
            << p.id;
        // Some words beyond the heading: a page is never just a title.
        EXPECT_GT(html.size(), 300) << p.id;
        for (auto it = link.globalMatch(html); it.hasNext();) {
            const QString target = it.next().captured(1);
            ASSERT_TRUE(target.endsWith(QStringLiteral(".html"))) << p.id;
            EXPECT_TRUE(ids.count(target.chopped(5).toStdString()))
                << p.id << " links to " << target.toStdString();
        }
    }
    EXPECT_TRUE(gui::HelpPageHtml("no-such-page").isEmpty());
}

TEST_F(HelpTest, MenuOpensTheContentsAndLinksSearchAndHistoryWork) {
    ASSERT_TRUE(main.Trigger("mnSHlp"));
    QApplication::processEvents();
    ASSERT_NE(help(), nullptr);
    EXPECT_EQ(help()->windowTitle(), QStringLiteral("KORI Charting Help"));
    EXPECT_EQ(help()->CurrentPage(), "contents");
    EXPECT_TRUE(help()->browser()->toPlainText().contains(QStringLiteral("Getting started")));
    auto* list = help()->findChild<QListWidget*>("lstPages");
    EXPECT_EQ(list->count(), static_cast<int>(app::HelpPages().size()));
    Shot(help(), "help_contents.png");

    // A link of the page, as a click on it would follow.
    help()->browser()->setSource(QUrl(QStringLiteral("getting-started.html")));
    EXPECT_EQ(help()->CurrentPage(), "getting-started");
    EXPECT_TRUE(help()->browser()->toPlainText().contains(QStringLiteral("kori init --sample")));
    help()->findChild<QToolButton*>("cmdBack")->click();
    EXPECT_EQ(help()->CurrentPage(), "contents");
    help()->findChild<QToolButton*>("cmdForward")->click();
    EXPECT_EQ(help()->CurrentPage(), "getting-started");

    auto* search = help()->findChild<QLineEdit*>("txtSearch");
    search->setText(QStringLiteral("parabolic"));
    help()->findChild<QPushButton*>("cmdSearch")->click();
    EXPECT_EQ(help()->CurrentPage(), "scan3");
    EXPECT_EQ(list->count(), 1);
    search->setText(QStringLiteral("qqqq"));
    help()->findChild<QPushButton*>("cmdSearch")->click();
    EXPECT_TRUE(help()->browser()->toPlainText().contains(QStringLiteral("No page holds")));
    help()->findChild<QToolButton*>("cmdHome")->click();
    EXPECT_EQ(help()->CurrentPage(), "contents");

    // A second pick of the menu brings the same window forward.
    ASSERT_TRUE(main.Trigger("mnSHlp"));
    EXPECT_EQ(main.findChildren<gui::HelpBrowser*>().size(), 1);
}

TEST_F(HelpTest, F1OpensThePageOfTheWindowThatHasTheKeyboard) {
    ASSERT_TRUE(main.Trigger("mnuChartDefaults"));
    QApplication::processEvents();
    auto* defaults = main.findChild<QDialog*>("ChtDef");
    ASSERT_NE(defaults, nullptr);
    // F1 on a control inside the window finds the window by its parents.
    auto* control = defaults->findChild<QWidget*>("ShowOsc");
    ASSERT_NE(control, nullptr);
    QTest::keyClick(control, Qt::Key_F1);
    QApplication::processEvents();
    ASSERT_NE(help(), nullptr);
    EXPECT_EQ(help()->CurrentPage(), "chart-defaults");
    Shot(help(), "help_chart_defaults.png");

    // The main window itself has the contents.
    QTest::keyClick(&main, Qt::Key_F1);
    EXPECT_EQ(help()->CurrentPage(), "contents");
    // F1 with a modifier is left to the window.
    QTest::keyClick(control, Qt::Key_F1, Qt::ShiftModifier);
    EXPECT_EQ(help()->CurrentPage(), "contents");
}

TEST_F(HelpTest, AboutShowsVersionAndTheThreeFolders) {
    ASSERT_TRUE(main.Trigger("mnuAboutKORI"));
    QApplication::processEvents();
    auto* about = main.findChild<gui::AbtKori*>("AbtKori");
    ASSERT_NE(about, nullptr);
    EXPECT_EQ(about->windowTitle(), QStringLiteral("About KORI"));
    const QString text = about->text();
    EXPECT_TRUE(text.contains(QStringLiteral("Version ")));
    EXPECT_TRUE(text.contains(QString::fromStdString(s.root.path().string())));
    EXPECT_TRUE(text.contains(QString::fromStdString(s.session.folders.SystemFolder)));
    EXPECT_TRUE(text.contains(QString::fromStdString(s.session.folders.DataFolder)));
    Shot(about, "about.png");
    about->findChild<QPushButton*>("cmdOK")->click();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_EQ(main.findChild<gui::AbtKori*>("AbtKori"), nullptr);
}

TEST_F(HelpTest, TipsMenuItemFlipsTheStoredSettingAndSaysSo) {
    EXPECT_TRUE(app::ShowTipsAtStartup(s.settings));
    ASSERT_TRUE(main.Trigger("mnutips"));
    EXPECT_EQ(s.settings.Get("Show Tips at Startup", ""), "False");
    ASSERT_FALSE(s.dialogs.messages().empty());
    EXPECT_EQ(s.dialogs.messages().back(), "Tips will not be shown when KORI Charting starts.");
    gui::ShowTipsIfWanted(main);
    EXPECT_EQ(main.findChild<gui::TipsWindow*>("Tips"), nullptr);
    ASSERT_TRUE(main.Trigger("mnutips"));
    EXPECT_EQ(s.settings.Get("Show Tips at Startup", ""), "True");
}

TEST_F(HelpTest, TipsWindowStepsThroughTipsAndItsBoxWritesTheSetting) {
    gui::ShowTipsIfWanted(main);
    auto* tips = main.findChild<gui::TipsWindow*>("Tips");
    ASSERT_NE(tips, nullptr);
    EXPECT_EQ(tips->windowTitle(), QStringLiteral("Tips"));
    EXPECT_FALSE(tips->isModal());
    const auto& all = app::Tips::All();
    EXPECT_EQ(tips->tip().toStdString(), all[0]);
    Shot(tips, "tips.png");
    tips->findChild<QPushButton*>("cmdNext")->click();
    EXPECT_EQ(tips->tip().toStdString(), all[1]);
    tips->findChild<QPushButton*>("cmdPrevious")->click();
    tips->findChild<QPushButton*>("cmdPrevious")->click();
    EXPECT_EQ(tips->tip().toStdString(), all.back());
    auto* box = tips->findChild<QCheckBox*>("chkShowTips");
    ASSERT_TRUE(box->isChecked());
    box->click();
    EXPECT_FALSE(app::ShowTipsAtStartup(s.settings));
    tips->findChild<QPushButton*>("cmdClose")->click();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);

    // The next start shows the next tip.
    app::SetShowTipsAtStartup(s.settings, true);
    gui::ShowTipsIfWanted(main);
    tips = main.findChild<gui::TipsWindow*>("Tips");
    ASSERT_NE(tips, nullptr);
    EXPECT_EQ(tips->tip().toStdString(), all[1]);
}
