#pragma once
// The desktop program over the sample library: a main window with every window registered,
// shown at a size the chart window can use, and the chart windows once they exist.
#include "gui/windows/chart_windows.h"
#include "gui/windows/chts.h"
#include "gui/windows/main_window.h"
#include "gui/windows/register_windows.h"
#include "platform/files.h"
#include "support/sample_session.h"

#include <QApplication>
#include <QPrinter>
#include <gtest/gtest.h>

#include <cstdlib>
#include <optional>
#include <string>

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

    // Prints the chart on show to a landscape PDF file in the root and gives its bytes (none
    // when printing failed); a copy goes to KORI_SHOTS when that names a folder.
    std::optional<std::string> PrintToPdf(const char* fileName) {
        const auto pdf = s.root.path() / fileName;
        {
            QPrinter printer(QPrinter::HighResolution);
            printer.setOutputFormat(QPrinter::PdfFormat);
            printer.setOutputFileName(QString::fromStdString(pdf.string()));
            printer.setPageOrientation(QPageLayout::Landscape);
            if (!chts()->PrintTo(printer)) return std::nullopt;
        }
        auto bytes = platform::ReadWholeFile(pdf);
        if (const char* dir = std::getenv("KORI_SHOTS"); dir && bytes)
            (void)platform::WriteFileAtomic(std::filesystem::path(dir) / fileName, *bytes);
        return bytes;
    }
};

} // namespace kori::test
