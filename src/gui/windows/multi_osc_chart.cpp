#include "gui/windows/multi_osc_chart.h"

#include "app/colour_table.h"
#include "chart/saved_chart.h"
#include "chart/screen_player.h"
#include "gui/paint/qt_surface.h"
#include "gui/widgets/chart_view.h"
#include "gui/windows/chart_paper.h"
#include "platform/files.h"
#include "platform/text.h"

#include <QAction>
#include <QActionGroup>
#include <QApplication>
#include <QFileDialog>
#include <QKeyEvent>
#include <QLabel>
#include <QPageLayout>
#include <QPrintPreviewDialog>
#include <QPrinter>
#include <QTimer>
#include <QToolBar>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
} // namespace

MultiOscChart::MultiOscChart(app::Session& session, app::ChartState& state, int set,
                             QWidget* parent)
    : QWidget(parent), m_session(session), m_model(session, state, set),
      m_toolbar(new QToolBar(this)), m_picture(new ChartView(this)), m_status(new QLabel(this)),
      m_resizeTimer(new QTimer(this)) {
    setObjectName(QStringLiteral("MultiOscChart"));
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    m_toolbar->setObjectName(QStringLiteral("Toolbar1"));
    m_toolbar->setToolButtonStyle(Qt::ToolButtonTextOnly);
    auto add = [this](const char* key, const char* text, const char* tip, auto fn) {
        QAction* a = m_toolbar->addAction(QString::fromLatin1(text));
        a->setObjectName(QString::fromLatin1(key));
        a->setToolTip(QString::fromLatin1(tip));
        connect(a, &QAction::triggered, this, fn);
        return a;
    };
    auto* sets = new QActionGroup(this);
    m_set1 = add("set1", "Multi-Osc 1", "The oscillators of set 1", [this] { ChooseSet(1); });
    m_set2 = add("set2", "Multi-Osc 2", "The oscillators of set 2", [this] { ChooseSet(2); });
    for (QAction* a : {m_set1, m_set2}) {
        a->setCheckable(true);
        sets->addAction(a);
    }
    (m_model.set() == 1 ? m_set1 : m_set2)->setChecked(true);
    m_toolbar->addSeparator();
    add("rev", "<", "Previous chart of the list (Page Up)", [this] { NextChart(-1); });
    add("ref", "=", "Redraw this chart", [this] { NextChart(0); });
    add("fwd", ">", "Next chart of the list (Page Down)", [this] { NextChart(1); });
    m_toolbar->addSeparator();
    add("print", "Print", "Print the chart", [this] { Print(); });
    add("save", "Save", "Save Chart As ...", [this] {
        platform::CreateFolder(m_session.folders.ChtSaveFolder);
        const std::string proposed =
            chart::ProposedChartName(m_session.folders.ChtSaveFolder, m_model.Code());
        const QString chosen = QFileDialog::getSaveFileName(
            this, QStringLiteral("Save Chart As ..."), Q(proposed),
            QStringLiteral("Saved charts (*.cht)"), nullptr, QFileDialog::DontConfirmOverwrite);
        SaveChartAs(chosen.isEmpty() ? std::string(chart::kNameCancel) : chosen.toStdString());
    });
    add("saved", "Saved", "Display Saved Chart", [this] {
        const QString chosen = QFileDialog::getOpenFileName(
            this, QStringLiteral("Display Saved Chart"), Q(m_session.folders.ChtSaveFolder),
            QStringLiteral("Saved charts (*.cht)"));
        DisplaySavedChart(chosen.toStdString());
    });
    m_toolbar->addSeparator();
    add("setup", "Setup", "MultiOsc Setup: the oscillators of the two sets",
        [this] { emit SetupRequested(); });
    layout->addWidget(m_toolbar);
    m_picture->setObjectName(QStringLiteral("Picture1"));
    m_picture->setFocusPolicy(Qt::StrongFocus);
    layout->addWidget(m_picture, 1);
    m_status->setObjectName(QStringLiteral("pane1"));
    layout->addWidget(m_status);
    m_resizeTimer->setSingleShot(true);
    m_resizeTimer->setInterval(200);
    connect(m_picture, &ChartView::Resized, m_resizeTimer, qOverload<>(&QTimer::start));
    connect(m_resizeTimer, &QTimer::timeout, this, [this] {
        if (m_model.haveSecurity() && !showingSavedChart() &&
            m_picture->picture().size() != AreaSize())
            Rebuild();
    });
    UpdateCaption();
}

QAction* MultiOscChart::Key(const char* name) const {
    return m_toolbar->findChild<QAction*>(QString::fromLatin1(name));
}

QSize MultiOscChart::AreaSize() const {
    QSize s = m_picture->size();
    if (s.width() < 200 || s.height() < 150) s = m_picture->sizeHint();
    return {std::max(s.width(), 480), std::max(s.height(), 320)};
}

void MultiOscChart::UpdateCaption() {
    std::string title = app::MultiOscCaption(m_model.set());
    if (m_model.haveSecurity())
        title += "   " + m_model.Code() + "  " + platform::Trim(m_model.current().Name);
    setWindowTitle(Q(title));
}

void MultiOscChart::ChooseSet(int set) {
    if (!m_model.SetSet(set)) return;
    (set == 1 ? m_set1 : m_set2)->setChecked(true);
    UpdateCaption();
    Rebuild();
}

void MultiOscChart::ShowSecurity(const store::NameRecord& name) {
    m_model.ShowSecurity(name);
    Rebuild();
}

bool MultiOscChart::NextChart(int delta) {
    if (!m_model.NextChart(delta)) return false;
    return Rebuild();
}

bool MultiOscChart::Rebuild() {
    UpdateCaption();
    if (!m_model.haveSecurity()) return false;
    QApplication::setOverrideCursor(Qt::WaitCursor);
    const QSize size = AreaSize();
    ImageSurface area(size.width(), size.height());
    const app::MultiOscOutcome built = m_model.Build(area);
    m_picture->SetPicture(area.Finish());
    m_savedPath.clear();
    QString panels;
    for (const auto& p : built.Panels)
        panels += (panels.isEmpty() ? QString() : QStringLiteral(", ")) +
                  Q(std::string(osc::ListName(p.Choice)));
    m_status->setText(built.Status ? panels : Q(built.Status.message()));
    QApplication::restoreOverrideCursor();
    return built.Status.ok();
}

bool MultiOscChart::PrintTo(QPrinter& printer) {
    const QString before = m_status->text();
    m_status->setText(QString::fromLatin1(chart::kPrintingStatus));
    const std::filesystem::path source =
        showingSavedChart() ? std::filesystem::path(m_savedPath) : m_model.StreamPath();
    const bool printed =
        PrintChartStream(m_session, m_print, source, printer, m_picture->picture().size());
    m_status->setText(before);
    return printed;
}

void MultiOscChart::Print() {
    QPrinter own(QPrinter::HighResolution);
    QPrinter& printer = m_printer ? *m_printer : own;
    printer.setDocName(Q("KORI multi-oscillator chart " + m_model.Code()));
    if (!m_printer)
        printer.setPageOrientation(m_session.page.Orient == 1 ? QPageLayout::Portrait
                                                              : QPageLayout::Landscape);
    QPrintPreviewDialog preview(&printer, this);
    preview.setObjectName(QStringLiteral("PrintPreview"));
    preview.setWindowTitle(QStringLiteral("Print Chart"));
    connect(&preview, &QPrintPreviewDialog::paintRequested, this,
            [this](QPrinter* p) { PrintTo(*p); });
    preview.exec();
}

bool MultiOscChart::SaveChartAs(const std::string& answer) {
    return chart::SaveChartAs(answer, m_model.StreamPath(), m_session.dialogs()) ==
           chart::SaveChartResult::Saved;
}

bool MultiOscChart::DisplaySavedChart(const std::string& chosen) {
    if (chosen.empty()) return false;
    const QSize size = AreaSize();
    const chart::StreamReach reach =
        chart::MeasureStream(platform::ResolvePath(platform::NormalisePath(chosen)));
    const int height = std::max(size.height(), static_cast<int>(std::ceil(reach.Bottom)) + 1);
    ImageSurface area(size.width(), height);
    const bool shown = chart::DisplaySavedChart(chosen, area, m_session.palette, m_session.fonts,
                                                m_session.dialogs());
    const QImage& picture = area.Finish();
    if (!shown) return false;
    m_picture->SetPicture(picture);
    m_savedPath = chosen;
    setWindowTitle(Q("Saved chart  " + std::filesystem::path(chosen).filename().string()));
    return true;
}

void MultiOscChart::keyPressEvent(QKeyEvent* e) {
    if (e->modifiers() & (Qt::AltModifier | Qt::ControlModifier | Qt::MetaModifier)) {
        QWidget::keyPressEvent(e);
        return;
    }
    switch (e->key()) {
    case Qt::Key_PageDown:
    case Qt::Key_Right:
        NextChart(1);
        break;
    case Qt::Key_PageUp:
    case Qt::Key_Left:
        NextChart(-1);
        break;
    case Qt::Key_1:
    case Qt::Key_2:
        ChooseSet(e->key() - Qt::Key_0);
        break;
    default:
        QWidget::keyPressEvent(e);
        return;
    }
    e->accept();
}

} // namespace kori::gui
