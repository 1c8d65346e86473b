#include "gui/windows/cht_def.h"

#include "app/window_rules.h"
#include "gui/windows/blank_spc.h"
#include "gui/windows/chart2.h"
#include "gui/windows/cht_fonts.h"
#include "gui/windows/col_new.h"
#include "gui/windows/gl_spaces.h"
#include "gui/windows/mma_set.h"
#include "gui/windows/multi_osc.h"
#include "gui/windows/plw.h"
#include "gui/windows/scales.h"
#include "gui/windows/stp_ls.h"
#include "gui/windows/swing_set.h"
#include "gui/windows/v_height.h"
#include "osc/osc_settings.h"
#include "platform/text.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

#include <memory>

namespace kori::gui {

namespace {
const char* BoolWord(bool b) {
    return b ? "True" : "False";
}

struct SmallWindow {
    const char* name;
    const char* caption;
};
constexpr SmallWindow kSmallWindows[] = {
    {"PLW", "Line Width"},        {"BlankSpc", "Blank Space"}, {"GLSpaces", "Grid Lines"},
    {"VHeight", "Volume Height"}, {"StpLs", "Stop Loss"},      {"MMASet", "MMA Settings"},
    {"SwingSet", "Swing"},        {"Chart2", "Second Chart"},  {"Scales", "Change Scales"},
    {"ColNew", "Colours"},        {"ChtFonts", "Fonts"},       {"MultiOsc", "Multi Oscillators"}};
} // namespace

ChtDef::ChtDef(app::Session& session, SettingsHub& hub, Caller caller, const std::string& code,
               QWidget* parent)
    : SettingsDialog(session, hub, "ChtDef", QStringLiteral("Chart Defaults"), parent),
      m_caller(caller), m_code(code) {
    const auto d = chart::LoadChartDefaults(session.ini());
    const auto osc = osc::ReadOscSettings(session.ini());

    auto* averages = new QGroupBox(QStringLiteral("Moving Averages"), this);
    auto* ag = new QGridLayout(averages);
    ag->addWidget(new QLabel(QStringLiteral("Daily"), this), 0, 1);
    ag->addWidget(new QLabel(QStringLiteral("Wkly/Mthly"), this), 0, 2);
    ag->addWidget(new QLabel(QStringLiteral("Average 1"), this), 1, 0);
    ag->addWidget(Box("Av1D", d.MAPeriod1Daily), 1, 1);
    ag->addWidget(Box("Av1W", d.MAPeriod1Long), 1, 2);
    ag->addWidget(Choice("AvOne", QStringLiteral("ON"), QStringLiteral("OFF"), d.MA1On), 1, 3);
    ag->addWidget(new QLabel(QStringLiteral("Average 2"), this), 2, 0);
    ag->addWidget(Box("Av2D", d.MAPeriod2Daily), 2, 1);
    ag->addWidget(Box("Av2W", d.MAPeriod2Long), 2, 2);
    ag->addWidget(Choice("AvTwo", QStringLiteral("ON"), QStringLiteral("OFF"), d.MA2On), 2, 3);
    ag->addWidget(new QLabel(QStringLiteral("Calculation"), this), 3, 0);
    ag->addWidget(Choice("AvCalc", QStringLiteral("Exponential"), QStringLiteral("Simple Moving"),
                         d.MAExponential),
                  3, 1, 1, 3);

    auto* scaling = new QGroupBox(QStringLiteral("CHART SCALING"), this);
    auto* sf = new QFormLayout(scaling);
    sf->addRow(QStringLiteral("Method"), Choice("ScMethod", QStringLiteral("Automatic"),
                                                QStringLiteral("Name File"), d.AutoScale));
    const QString log = QStringLiteral("Logarithmic"), arith = QStringLiteral("Arithmetic");
    sf->addRow(QStringLiteral("Bar Charts and   Candlestick Charts"),
               Choice("BCCalTp", log, arith, d.LogBars));
    sf->addRow(QStringLiteral("Line Charts"), Choice("LCalTp", log, arith, d.LogLine));
    sf->addRow(QStringLiteral("Volumes"), Choice("VCalTp", log, arith, d.LogVolume));
    sf->addRow(QStringLiteral("Volumes Height"),
               Choice("CutVols", QStringLiteral("Limit Height"), QStringLiteral("Full Height"),
                      d.LimitVolumeHeight));

    auto* oscBox = new QGroupBox(QStringLiteral("Oscillators"), this);
    auto* of = new QFormLayout(oscBox);
    auto* showOsc = new QCheckBox(QStringLiteral("Always show oscillator settings box "), this);
    showOsc->setObjectName(QStringLiteral("ShowOsc"));
    showOsc->setChecked(d.ShowOscSettings);
    m_controls["ShowOsc"] = showOsc;
    auto* classic = new QCheckBox(QStringLiteral("Show Classic Chart with MACD"), this);
    classic->setObjectName(QStringLiteral("NoClassicMACD"));
    classic->setChecked(d.ClassicMACD);
    m_controls["NoClassicMACD"] = classic;
    of->addRow(showOsc);
    of->addRow(classic);
    auto* atr = new QHBoxLayout;
    atr->addWidget(Box("AtrD", osc.AtrD));
    atr->addWidget(new QLabel(QStringLiteral("Wkly/Mthly"), this));
    atr->addWidget(Box("AtrW", osc.AtrW));
    atr->addStretch();
    of->addRow(QStringLiteral("Average True Range"), atr);
    const std::string oscComp = app::CompareFileText(osc.CompFile);
    auto* comp =
        new QLineEdit(Q(oscComp.empty() ? app::CompareFileText(d.CompFile) : oscComp), this);
    comp->setObjectName(QStringLiteral("CompFile"));
    comp->setMaxLength(100);
    m_controls["CompFile"] = comp;
    of->addRow(QStringLiteral("RMO/RMX compare"), comp);

    auto* more = new QGroupBox(QStringLiteral("Chart settings"), this);
    auto* mg = new QGridLayout(more);
    int n = 0;
    for (const auto& w : kSmallWindows) {
        auto* b = Button(QString::fromLatin1(w.caption), w.name);
        b->setObjectName(QStringLiteral("cmd") + QString::fromLatin1(w.name));
        const std::string name = w.name;
        connect(b, &QPushButton::clicked, this, [this, name] { OpenWindow(name); });
        mg->addWidget(b, n / 3, n % 3);
        ++n;
    }

    auto* buttons = SaveRow([this] { return Save(); }, QStringLiteral("Close"), "cmdClose");

    auto* left = new QVBoxLayout;
    left->addWidget(averages);
    left->addWidget(scaling);
    auto* right = new QVBoxLayout;
    right->addWidget(oscBox);
    right->addWidget(more);
    auto* columns = new QHBoxLayout;
    columns->addLayout(left);
    columns->addLayout(right);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(columns);
    layout->addLayout(buttons);
}

QComboBox* ChtDef::Choice(const char* key, const QString& a, const QString& b, bool first) {
    auto* c = new QComboBox(this);
    c->setObjectName(QString::fromLatin1(key));
    c->addItems({a, b});
    c->setCurrentIndex(first ? 0 : 1);
    m_controls[key] = c;
    return c;
}

QLineEdit* ChtDef::Box(const char* key, int value) {
    auto* e = new QLineEdit(value == 0 ? QString() : QString::number(value), this);
    e->setObjectName(QString::fromLatin1(key));
    e->setMaxLength(3);
    e->setFixedWidth(50);
    m_controls[key] = e;
    return e;
}

QWidget* ChtDef::control(const std::string& key) const {
    const auto it = m_controls.find(key);
    return it == m_controls.end() ? nullptr : it->second;
}

bool ChtDef::Save() {
    auto text = [this](const char* key) {
        return S(static_cast<QLineEdit*>(control(key))->text());
    };
    auto first = [this](const char* key) {
        return static_cast<QComboBox*>(control(key))->currentIndex() == 0;
    };
    auto ticked = [this](const char* key) {
        return static_cast<QCheckBox*>(control(key))->isChecked();
    };
    const std::array<std::string, 4> periods = {text("Av1D"), text("Av2D"), text("Av1W"),
                                                text("Av2W")};
    if (!app::Accept(app::AveragePeriodsProblem(periods), dialogs())) return false;
    // An empty ATR box leaves the period unset (0); a value must be 1 to 200.
    std::array<std::int16_t, 2> atr{};
    for (std::size_t i = 0; i < atr.size(); ++i) {
        const std::string t = platform::Trim(text(i == 0 ? "AtrD" : "AtrW"));
        const auto v = app::WholeNumber(t);
        if (!t.empty() && (!v || *v < 1 || *v > 200)) {
            dialogs().MsgBox(" Periods must be between 1 - 200 ", "Oscillator Values");
            return false;
        }
        atr[i] = static_cast<std::int16_t>(v.value_or(0));
    }
    // Start from what is stored: the small windows may have written keys since this opened.
    auto d = chart::LoadChartDefaults(m_session.ini());
    d.MAPeriod1Daily = static_cast<std::int16_t>(*app::WholeNumber(periods[0]));
    d.MAPeriod2Daily = static_cast<std::int16_t>(*app::WholeNumber(periods[1]));
    d.MAPeriod1Long = static_cast<std::int16_t>(*app::WholeNumber(periods[2]));
    d.MAPeriod2Long = static_cast<std::int16_t>(*app::WholeNumber(periods[3]));
    d.MA1On = first("AvOne");
    d.MA2On = first("AvTwo");
    d.MAExponential = first("AvCalc");
    d.AutoScale = first("ScMethod");
    d.LogBars = first("BCCalTp");
    d.LogLine = first("LCalTp");
    d.LogVolume = first("VCalTp");
    d.LimitVolumeHeight = first("CutVols");
    d.ShowOscSettings = ticked("ShowOsc");
    d.ClassicMACD = ticked("NoClassicMACD");
    d.CompFile = platform::Trim(text("CompFile"));
    chart::SaveChartDefaults(m_session.ini(), d);

    // The oscillators read their copy of the shared keys from their own section.
    auto osc = osc::ReadOscSettings(m_session.ini());
    osc.AtrD = atr[0];
    osc.AtrW = atr[1];
    osc.CompFile = d.CompFile;
    osc.ShowOsc = BoolWord(d.ShowOscSettings);
    osc.NoClassicMACD = !d.ClassicMACD;
    osc.BCCalTp = BoolWord(d.LogBars);
    osc.LCalTp = BoolWord(d.LogLine);
    osc.VCalTp = BoolWord(d.LogVolume);
    osc.CutVols = BoolWord(d.LimitVolumeHeight);
    osc.MMASet = m_session.ini().Read("Charts", "MMASet");
    (void)osc::WriteOscSettings(m_session.ini(), osc);
    m_hub.ChartDefaultsSaved();
    return true;
}

void ChtDef::OpenWindow(const std::string& name) {
    std::unique_ptr<QDialog> w;
    auto& s = m_session;
    auto& h = m_hub;
    if (name == "PLW")
        w = std::make_unique<PLW>(s, h, this);
    else if (name == "BlankSpc")
        w = std::make_unique<BlankSpc>(s, h, this);
    else if (name == "GLSpaces")
        w = std::make_unique<GLSpaces>(s, h, this);
    else if (name == "VHeight")
        w = std::make_unique<VHeight>(s, h, this);
    else if (name == "StpLs")
        w = std::make_unique<StpLs>(s, h, this);
    else if (name == "MMASet")
        w = std::make_unique<MMASet>(s, h, this);
    else if (name == "SwingSet")
        w = std::make_unique<SwingSet>(s, h, this);
    else if (name == "Chart2")
        w = std::make_unique<Chart2>(s, h, this);
    else if (name == "Scales")
        w = std::make_unique<Scales>(s, h, m_code, this);
    else if (name == "ColNew")
        w = std::make_unique<ColNew>(s, h, this);
    else if (name == "ChtFonts")
        w = std::make_unique<ChtFonts>(s, h, this);
    else if (name == "MultiOsc")
        w = std::make_unique<MultiOsc>(s, h, this);
    if (w) w->exec();
}

} // namespace kori::gui
