#pragma once
// ChtFonts ("Fonts Selection"): FONT 1 for chart text and FONT 2 for scales, each chosen
// through a font dialog.
#include "app/settings.h"
#include "gui/widgets/settings_dialog.h"

class QLabel;
class QRadioButton;

namespace kori::gui {

class ChtFonts : public SettingsDialog {
    Q_OBJECT
public:
    ChtFonts(app::Session& session, SettingsHub& hub, QWidget* parent = nullptr);

    // What the font dialogs return lands here.
    void SetFont1(const QString& family, double size);
    void SetFont2(const QString& family, double size);
    const app::FontSettings& fonts() const { return m_fonts; }
    bool Save();

private:
    void Choose(int which);
    void Show();

    app::FontSettings m_fonts;
    QLabel* m_font1;
    QLabel* m_font2;
    QRadioButton* m_printerOnly;
};

} // namespace kori::gui
