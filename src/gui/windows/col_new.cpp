#include "gui/windows/col_new.h"

#include "app/colour_table.h"
#include "platform/text.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QColor ToQColor(platform::Colour c) {
    return QColor(platform::Red(c), platform::Green(c), platform::Blue(c));
}

void Paint(QPushButton* swatch, platform::Colour c, bool selected = false) {
    swatch->setStyleSheet(
        QStringLiteral("background-color: %1; border: %2px solid %3;")
            .arg(ToQColor(c).name())
            .arg(selected ? 3 : 1)
            .arg(selected ? QStringLiteral("#ff8c00") : QStringLiteral("#606060")));
}
} // namespace

ColNew::ColNew(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "ColNew", QStringLiteral("Change Chart Colours"), parent),
      m_form(session.palette),
      m_hint(new QLabel(QStringLiteral("Click colour then click items that you want to change to "
                                       "that colour"),
                        this)) {
    m_hint->setObjectName(QStringLiteral("lblHint"));
    auto* paletteBox = new QGroupBox(QStringLiteral("Colours"), this);
    auto* paletteGrid = new QGridLayout(paletteBox);
    for (int i = 0; i < 16; ++i) {
        auto* swatch = Button(QString(), "cmdColour");
        swatch->setFixedSize(34, 24);
        connect(swatch, &QPushButton::clicked, this, [this, i] { PickColour(i); });
        paletteGrid->addWidget(swatch, i / 8, i % 8);
        m_colours.push_back(swatch);
    }
    auto* rolesBox = new QGroupBox(QStringLiteral("Chart items"), this);
    auto* rolesGrid = new QGridLayout(rolesBox);
    rolesGrid->setHorizontalSpacing(10);
    rolesGrid->setVerticalSpacing(3);
    const auto& items = app::ColourItems();
    const int count = static_cast<int>(items.size());
    const int kRows = (count + 1) / 2;
    for (int i = 0; i < count; ++i) {
        const auto& item = items[static_cast<std::size_t>(i)];
        auto* swatch = Button(QString(), "cmdItem");
        swatch->setFixedSize(40, 18);
        swatch->setToolTip(
            item.Drawn
                ? QStringLiteral("Entry %1").arg(item.Entries.front())
                : QStringLiteral("Entry %1: no chart draws in it yet").arg(item.Entries.front()));
        connect(swatch, &QPushButton::clicked, this, [this, i] { PaintItem(i); });
        const auto& n = item.Name;
        const int col = (i / kRows) * 2;
        rolesGrid->addWidget(swatch, i % kRows, col);
        rolesGrid->addWidget(
            new QLabel(QString::fromUtf8(n.data(), static_cast<int>(n.size())), this), i % kRows,
            col + 1);
        m_roles.push_back(swatch);
    }
    rolesGrid->setColumnStretch(1, 1);
    rolesGrid->setColumnStretch(3, 1);

    auto* schemes = new QHBoxLayout;
    for (const char* s : {"Black", "White", "Blue"}) {
        auto* b = Button(QStringLiteral("Default %1").arg(QString::fromLatin1(s).toUpper()),
                         "cmdDefault");
        connect(b, &QPushButton::clicked, this, [this, s] { ApplyScheme(s); });
        schemes->addWidget(b);
    }
    auto* saveDefault = Button(QStringLiteral("SAVE DEFAULT COLOURS"), "cmdSaveDefault");
    connect(saveDefault, &QPushButton::clicked, this, &ColNew::SaveDefaultColours);
    schemes->addWidget(saveDefault);
    auto* buttons = new QHBoxLayout;
    auto* save = Button(QStringLiteral("Save Colours"), "cmdSave");
    auto* exit = Button(QStringLiteral("Exit without Saving"), "cmdExit");
    connect(save, &QPushButton::clicked, this, &ColNew::SaveColours);
    connect(exit, &QPushButton::clicked, this, &QDialog::reject);
    buttons->addStretch();
    buttons->addWidget(save);
    buttons->addWidget(exit);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_hint);
    layout->addWidget(paletteBox);
    layout->addWidget(rolesBox);
    layout->addLayout(schemes);
    layout->addLayout(buttons);
    Refresh();
}

void ColNew::Refresh() {
    for (std::size_t i = 0; i < m_colours.size(); ++i)
        Paint(m_colours[i], m_form.table()[i], static_cast<int>(i) == m_form.selected());
    for (std::size_t i = 0; i < m_roles.size(); ++i)
        Paint(m_roles[i], m_form.ItemColour(i));
}

void ColNew::PickColour(int i) {
    m_form.PickColour(i);
    Refresh();
}

void ColNew::PaintItem(int item) {
    if (!m_form.PaintItem(static_cast<std::size_t>(item))) {
        dialogs().Beep(); // no colour clicked yet
        return;
    }
    Refresh();
}

void ColNew::ApplyScheme(const char* scheme) {
    // Applying a scheme writes koriclr.dat, as it does at start-up.
    if (auto s = m_form.ApplyScheme(scheme, m_session.folders.SystemFolder); !s)
        dialogs().MsgBox(s.message(), "Colours");
    m_session.palette = m_form.table();
    Refresh();
    m_hub.ColoursChanged();
}

void ColNew::SaveColours() {
    const std::string file = m_session.folders.SystemFolder + "koriclr.dat";
    if (auto s = app::WriteColourFile(file, m_form.table()); !s) {
        dialogs().MsgBox(s.message(), "Colours");
        return;
    }
    m_session.palette = m_form.table();
    m_hub.ColoursChanged();
    m_hub.RebuildChart();
    accept();
}

void ColNew::SaveDefaultColours() {
    const std::string question = "Save the current colours as the default " +
                                 platform::Upper(m_form.scheme()) + " colours ?";
    if (dialogs().MsgBox(question, "Colours", platform::Buttons::YesNo, platform::Icon::Question) !=
        platform::Answer::Yes)
        return;
    if (auto s =
            app::SaveColourScheme(m_form.scheme(), m_session.folders.SystemFolder, m_form.table());
        !s)
        dialogs().MsgBox(s.message(), "Colours");
}

} // namespace kori::gui
