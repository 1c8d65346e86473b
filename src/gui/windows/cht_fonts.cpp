#include "gui/windows/cht_fonts.h"

#include "app/window_rules.h"
#include "platform/text.h"

#include <QFontDatabase>
#include <QFontDialog>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString SizeText(double size) {
    return Q(platform::Trim(platform::Str(size)));
}

QString Describe(const std::string& family, const std::string& size) {
    if (platform::Trim(size) == platform::kUnknown) return Q(family) + QStringLiteral(" (no size)");
    return Q(family) + QStringLiteral(", ") + Q(size);
}
} // namespace

ChtFonts::ChtFonts(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "ChtFonts", QStringLiteral("Fonts Selection"), parent),
      m_fonts(app::ReadFontSettings(session.ini())), m_font1(new QLabel(this)),
      m_font2(new QLabel(this)),
      m_printerOnly(
          new QRadioButton(QStringLiteral("List only fonts supported by your printer"), this)) {
    m_font1->setObjectName(QStringLiteral("lblFont1"));
    m_font2->setObjectName(QStringLiteral("lblFont2"));
    m_font1->setFrameShape(QFrame::StyledPanel);
    m_font2->setFrameShape(QFrame::StyledPanel);
    auto* b1 = Button(QStringLiteral("FONT 1"), "cmdFont1");
    auto* b2 = Button(QStringLiteral("FONT 2"), "cmdFont2");
    connect(b1, &QPushButton::clicked, this, [this] { Choose(1); });
    connect(b2, &QPushButton::clicked, this, [this] { Choose(2); });
    auto* grid = new QGridLayout;
    grid->addWidget(b1, 0, 0);
    grid->addWidget(new QLabel(QStringLiteral("Chart text"), this), 0, 1);
    grid->addWidget(m_font1, 0, 2);
    grid->addWidget(b2, 1, 0);
    grid->addWidget(new QLabel(QStringLiteral("Scales"), this), 1, 1);
    grid->addWidget(m_font2, 1, 2);
    grid->setColumnStretch(2, 1);

    auto* listBox = new QGroupBox(
        QStringLiteral("List all fonts or only those supported by your printer"), this);
    auto* all = new QRadioButton(QStringLiteral("List all fonts available"), listBox);
    all->setChecked(true);
    m_printerOnly->setParent(listBox);
    auto* listLayout = new QVBoxLayout(listBox);
    listLayout->addWidget(all);
    listLayout->addWidget(m_printerOnly);

    auto* buttons = SaveRow([this] { return Save(); }, QStringLiteral("Exit"), "cmdExit");
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(grid);
    layout->addWidget(listBox);
    layout->addLayout(buttons);
    resize(480, sizeHint().height());
    Show();
}

void ChtFonts::Show() {
    m_font1->setText(Describe(m_fonts.CFont, m_fonts.CFontSize));
    m_font2->setText(Describe(m_fonts.SFont, m_fonts.SFontSize));
}

void ChtFonts::SetFont1(const QString& family, double size) {
    m_fonts.CFont = S(family);
    m_fonts.CFontSize = S(SizeText(size));
    Show();
}

void ChtFonts::SetFont2(const QString& family, double size) {
    m_fonts.SFont = S(family);
    m_fonts.SFontSize = S(SizeText(size));
    Show();
}

void ChtFonts::Choose(int which) {
    const std::string& family = which == 1 ? m_fonts.CFont : m_fonts.SFont;
    const double size = platform::Val(which == 1 ? m_fonts.CFontSize : m_fonts.SFontSize);
    QFont initial(Q(family));
    if (size > 0) initial.setPointSizeF(size);
    // Printer fonts are the scalable ones; bitmap screen fonts do not reach paper.
    QFontDialog::FontDialogOptions options;
    if (m_printerOnly->isChecked()) options |= QFontDialog::ScalableFonts;
    bool ok = false;
    const QFont f = QFontDialog::getFont(
        &ok, initial, this,
        which == 1 ? QStringLiteral("Printer Fonts 1") : QStringLiteral("Fonts 2"), options);
    if (!ok) return;
    if (which == 1)
        SetFont1(f.family(), f.pointSizeF());
    else
        SetFont2(f.family(), f.pointSizeF());
}

bool ChtFonts::Save() {
    if (!app::Accept(app::FontsProblem(m_fonts), dialogs())) return false;
    app::SaveFonts(m_session, m_fonts);
    m_hub.FontsChanged();
    m_hub.RebuildChart();
    return true;
}

} // namespace kori::gui
