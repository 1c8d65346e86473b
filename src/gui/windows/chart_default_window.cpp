#include "gui/windows/chart_default_window.h"

#include "platform/text.h"

#include <QHBoxLayout>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

QString NumberText(double v) {
    return Q(platform::Trim(platform::Str(v)));
}
QString SingleText(float v) {
    return Q(platform::Trim(platform::StrSingle(v)));
}

QLineEdit* NumberBox(QWidget* parent, const char* name, const QString& text, int width) {
    auto* e = new QLineEdit(text, parent);
    e->setObjectName(QString::fromLatin1(name));
    e->setMaxLength(8);
    e->setFixedWidth(width);
    return e;
}

ChartDefaultWindow::ChartDefaultWindow(app::Session& session, SettingsHub& hub, const char* name,
                                       const QString& title, QWidget* parent)
    : SettingsDialog(session, hub, name, title, parent),
      m_defaults(chart::LoadChartDefaults(session.ini())), m_layout(new QVBoxLayout(this)) {}

void ChartDefaultWindow::AddButtons() {
    auto* ok = Button(QStringLiteral("OK"), "cmdOK");
    auto* cancel = Button(QStringLiteral("Cancel"), "cmdCancel");
    ok->setDefault(true);
    connect(ok, &QPushButton::clicked, this, [this] {
        if (Ok()) accept();
    });
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
    m_layout->addLayout(ButtonRow({ok, cancel}));
}

void ChartDefaultWindow::Store() {
    chart::SaveChartDefaults(m_session.ini(), m_defaults);
    m_hub.RebuildChart();
}

} // namespace kori::gui
