// A split chart in the chart window: Chart2's OK splits the chart on show, the stream carries
// both halves to paper and to a saved chart, and the next chart or "Single Chart" ends it.
// Window places kept in the settings store follow the screen they were written on.
#include "desktop_fixture.h"

#include "app/chart_service.h"
#include "app/window_position.h"
#include "gui/widgets/chart_view.h"
#include "gui/widgets/window_place.h"
#include "gui/windows/chart2.h"
#include "gui/windows/chart_windows.h"
#include "gui/windows/cht_fonts.h"
#include "gui/windows/cht_sel.h"
#include "gui/windows/chts.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "gui/windows/settings_windows.h"
#include "platform/files.h"

#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QLineEdit>
#include <QPrinter>
#include <QPushButton>
#include <QScreen>
#include <QTest>
#include <gtest/gtest.h>

#include <cstdlib>
#include <sstream>

using namespace kori;

namespace {

struct SplitRoad : test::DesktopTest {
    void ShowCode(const char* code) {
        ASSERT_TRUE(charts()->ShowCode(code));
        QApplication::processEvents();
    }
    // Chart2 as the chart defaults open it: a code and a period, then OK.
    void SecondChart(const char* code, int period) {
        gui::Chart2 w(s.session, gui::Hub(main));
        w.code()->setText(QString::fromLatin1(code));
        w.period()->setCurrentIndex(period);
        auto* ok = w.findChild<QPushButton*>(QStringLiteral("cmdOK"));
        ASSERT_NE(ok, nullptr);
        QTest::mouseClick(ok, Qt::LeftButton);
        QApplication::processEvents();
    }
    void Trigger(const char* name) {
        auto* a = chts()->findChild<QAction*>(QString::fromLatin1(name));
        ASSERT_NE(a, nullptr) << name;
        a->trigger();
        QApplication::processEvents();
    }
    std::vector<std::string> Titles(const std::filesystem::path& stream) {
        std::vector<std::string> out;
        std::istringstream in(platform::ReadWholeFile(stream).value_or(""));
        for (std::string line; std::getline(in, line);)
            if (line.rfind("T, 9.75,", 0) == 0) out.push_back(line.substr(0, line.rfind(',')));
        return out;
    }
    std::vector<std::string> StreamTitles() { return Titles(app::ChartStreamPath(s.session)); }
    void Shot(const char* name) {
        if (const char* dir = std::getenv("KORI_SHOTS")) {
            QApplication::processEvents();
            main.grab().save(QString::fromLatin1(dir) + "/" + QString::fromLatin1(name));
        }
    }
};

// The code of a split title line "T, 9.75, x, y,CODE" (its colour cut off).
std::string CodeOf(const std::string& title) {
    return title.substr(title.rfind(',') + 1);
}

} // namespace

TEST_F(SplitRoad, SecondChartSplitsTheChartOnShowAndPrintAndSaveCarryIt) {
    ShowCode("alx");
    ASSERT_NE(chts(), nullptr);
    EXPECT_TRUE(StreamTitles().empty()) << "a single chart has its full heading";
    const QImage single = chts()->picture1()->picture().copy();

    SecondChart("krm", 1);
    EXPECT_TRUE(chts()->splitShown());
    const auto titles = StreamTitles();
    ASSERT_EQ(titles.size(), 2u);
    EXPECT_EQ(CodeOf(titles[0]), "ALX");
    EXPECT_EQ(CodeOf(titles[1]), "KRM");
    EXPECT_TRUE(chts()->windowTitle().endsWith(QStringLiteral("/   KRM")));
    const std::string stream =
        platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or("");
    EXPECT_NE(stream.find("WEEKLY - "), std::string::npos);
    EXPECT_NE(stream.find("DAILY - "), std::string::npos);
    EXPECT_FALSE(chts()->panelShown());
    EXPECT_NE(chts()->picture1()->picture(), single);
    // The mouse tools stay quiet over two charts.
    chts()->MouseMove(200, 200, Qt::NoButton);
    for (const auto& pane : chts()->StatusPanes())
        EXPECT_TRUE(pane.empty()) << pane;
    if (const char* dir = std::getenv("KORI_SHOTS"))
        chts()->grab().save(QString::fromLatin1(dir) + "/split.png");

    // A new size rebuilds the split, not a single chart.
    chts()->Rebuild();
    EXPECT_EQ(StreamTitles().size(), 2u);

    const auto bytes = PrintToPdf("split.pdf");
    ASSERT_TRUE(bytes);
    EXPECT_EQ(bytes->rfind("%PDF", 0), 0u);

    const std::string saved = s.session.folders.ChtSaveFolder + "ALX.cht";
    ASSERT_TRUE(chts()->SaveChartAs(saved));
    EXPECT_EQ(Titles(saved), titles);
    ASSERT_TRUE(chts()->DisplaySavedChart(saved));
    EXPECT_EQ(chts()->picture1()->picture().size(), single.size());
}

TEST_F(SplitRoad, NextChartOrSingleChartEndsTheSplit) {
    ShowCode("alx");
    auto* single = chts()->findChild<QAction*>(QStringLiteral("cmSingleChart"));
    ASSERT_NE(single, nullptr);
    EXPECT_FALSE(single->isEnabled());
    SecondChart("krm", 0);
    EXPECT_TRUE(single->isEnabled());

    chts()->ToolKey("ref")->trigger(); // "=": the same security, still split
    EXPECT_TRUE(chts()->splitShown());
    chts()->ToolKey("wky")->trigger(); // the upper half's period changes, the lower's stays
    ASSERT_TRUE(chts()->splitShown());
    const std::string weekly =
        platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or("");
    EXPECT_LT(weekly.find("WEEKLY - "), weekly.find("DAILY - "));

    chts()->ToolKey("fwd")->trigger();
    EXPECT_FALSE(chts()->splitShown());
    EXPECT_TRUE(StreamTitles().empty());
    EXPECT_FALSE(single->isEnabled());
    EXPECT_FALSE(chts()->windowTitle().contains(QLatin1Char('/')));

    SecondChart("krm", 2);
    EXPECT_TRUE(chts()->splitShown());
    Trigger("cmSingleChart");
    EXPECT_FALSE(chts()->splitShown());
    EXPECT_TRUE(StreamTitles().empty());
}

TEST_F(SplitRoad, ChosenWithNoChartOnShowTheNextChartComesSplit) {
    SecondChart("KRM", 1);
    EXPECT_TRUE(charts()->state().Split.Chosen());
    ShowCode("alx");
    ASSERT_NE(chts(), nullptr);
    EXPECT_TRUE(chts()->splitShown());
    const auto titles = StreamTitles();
    ASSERT_EQ(titles.size(), 2u);
    EXPECT_EQ(CodeOf(titles[0]), "ALX");
    EXPECT_EQ(CodeOf(titles[1]), "KRM");
}

TEST_F(SplitRoad, PointAndFigureIsNeverSplit) {
    ShowCode("alx");
    SecondChart("krm", 0);
    s.dialogs.QueueAnswer(platform::Answer::Yes); // any box-value question
    chts()->ToolKey("pf")->trigger();
    EXPECT_FALSE(chts()->splitShown());
    EXPECT_TRUE(StreamTitles().empty());
    chts()->ToolKey("bar")->trigger();
    EXPECT_TRUE(chts()->splitShown()) << "the choice holds for the same security";
}

TEST_F(SplitRoad, WindowPlacesFollowTheScreenTheyWereWrittenOn) {
    const app::ScreenSize screen = gui::ScreenTwips(&main);
    ASSERT_GT(screen.width, 0);
    auto& store = s.settings;
    // Written on a screen twice as wide and twice as high: everything halves.
    store.Save("ChtFonts", "3000,1500,21000,12000");
    store.Save("ChtFontsSW", std::to_string(screen.width * 2));
    store.Save("ChtFontsSH", std::to_string(screen.height * 2));
    {
        gui::ChtFonts w(s.session, gui::Hub(main));
        w.show();
        EXPECT_EQ(w.geometry().topLeft(), QPoint(100, 50));
        EXPECT_EQ(w.size(), QSize(700, 400));
        w.close();
    }
    // Closing writes the place on this screen and the screen itself.
    EXPECT_EQ(store.Get("ChtFonts", ""), "1500,750,10500,6000");
    EXPECT_EQ(store.Get("ChtFontsSW", ""), std::to_string(screen.width));
    EXPECT_EQ(store.Get("ChtFontsSH", ""), std::to_string(screen.height));

    // The main window: Height and Width written on a screen half as big double here.
    store.Save("Width", "6000");
    store.Save("Height", "4500");
    store.Save("Main", "150,75,6000,4500");
    store.Save("MainSW", std::to_string(screen.width / 2));
    store.Save("MainSH", std::to_string(screen.height / 2));
    gui::MainWindow other(s.session);
    EXPECT_EQ(other.size(), QSize(800, 600));
    EXPECT_EQ(other.geometry().topLeft(), QPoint(20, 10));
    other.close();
    EXPECT_EQ(store.Get("Width", ""), "12000");
    EXPECT_EQ(store.Get("Main", ""), "300,150,12000,9000");
    EXPECT_EQ(store.Get("MainSW", ""), std::to_string(screen.width));
}
