#pragma once
// The desktop program over the sample library: a main window with every window registered,
// shown at a size the chart window can use, and the chart windows once they exist.
#include "gui/windows/chart_windows.h"
#include "gui/windows/chts.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "support/sample_session.h"

#include <QApplication>
#include <gtest/gtest.h>

namespace kori::test {

struct DesktopTest : ::testing::Test {
    SampleSession s;
    gui::MainWindow main{s.session};

    void SetUp() override {
        gui::RegisterWindows(main);
        main.resize(1280, 860);
        main.show();
        QApplication::processEvents();
    }
    gui::ChartWindows* charts() { return main.findChild<gui::ChartWindows*>(); }
    gui::Chts* chts() { return charts()->chts(); }
};

} // namespace kori::test
