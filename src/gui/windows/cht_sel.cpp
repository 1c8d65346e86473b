#include "gui/windows/cht_sel.h"

#include "gui/windows/cht_bands.h"
#include "gui/windows/cht_options.h"
#include "gui/windows/class_window.h"
#include "gui/windows/fin_date.h"
#include "gui/windows/search.h"
#include "platform/palette.h"
#include "store/chart_list.h"

#include <QCheckBox>
#include <QComboBox>
#include <QEvent>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QIntValidator>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPushButton>
#include <QScrollBar>
#include <QToolButton>
#include <QVBoxLayout>

namespace kori::gui {

namespace {
QString Q(const std::string& s) {
    return QString::fromStdString(s);
}
QColor ToQColor(platform::Colour c) {
    return QColor(static_cast<int>(c & 0xFF), static_cast<int>((c >> 8) & 0xFF),
                  static_cast<int>((c >> 16) & 0xFF));
}
} // namespace

ChtSel::ChtSel(app::Session& session, app::ChartState& state, QWidget* parent)
    : QWidget(parent), m_session(session), m_sel(session, state) {
    setObjectName(QStringLiteral("ChtSel"));
    setWindowTitle(QStringLiteral("Chart Selection Menu"));
    auto* outer = new QVBoxLayout(this);

    m_listCaption = new QLabel(this);
    m_listCaption->setObjectName(QStringLiteral("lblList"));
    QFont bold = m_listCaption->font();
    bold.setBold(true);
    m_listCaption->setFont(bold);
    outer->addWidget(m_listCaption);

    auto* security = new QGroupBox(QStringLiteral("Security"), this);
    auto* sg = new QGridLayout(security);
    m_code = new QLineEdit(security);
    m_code->setObjectName(QStringLiteral("txtCode"));
    m_code->setMaxLength(6);
    m_name = new QLineEdit(security);
    m_name->setObjectName(QStringLiteral("txtName"));
    m_total = new QLabel(security);
    m_total->setObjectName(QStringLiteral("lblTotal"));
    m_this = new QLabel(security);
    m_this->setObjectName(QStringLiteral("lblThis"));
    m_scroll = new QScrollBar(Qt::Horizontal, security);
    m_scroll->setObjectName(QStringLiteral("HScroll1"));
    sg->addWidget(new QLabel(QStringLiteral("Code"), security), 0, 0);
    sg->addWidget(m_code, 0, 1);
    sg->addWidget(new QLabel(QStringLiteral("Name"), security), 0, 2);
    sg->addWidget(m_name, 0, 3);
    sg->addWidget(new QLabel(QStringLiteral("Total Charts"), security), 1, 0);
    sg->addWidget(m_total, 1, 1);
    sg->addWidget(new QLabel(QStringLiteral("This Chart"), security), 1, 2);
    sg->addWidget(m_this, 1, 3);
    sg->addWidget(m_scroll, 2, 0, 1, 4);
    m_classBox = new QCheckBox(QStringLiteral("Industry Class"), security);
    m_classBox->setObjectName(QStringLiteral("chkClass"));
    m_classCode = new QLineEdit(security);
    m_classCode->setObjectName(QStringLiteral("txtClass"));
    m_classCode->setMaxLength(3);
    m_classCode->setPlaceholderText(QStringLiteral("class, Enter"));
    m_classCode->setToolTip(QStringLiteral("Double-click to pick from the industry classes"));
    m_gicsBox = new QCheckBox(QStringLiteral("GICS"), security);
    m_gicsBox->setObjectName(QStringLiteral("chkGics"));
    m_gicsCode = new QLineEdit(security);
    m_gicsCode->setObjectName(QStringLiteral("txtGics"));
    m_gicsCode->setMaxLength(4);
    m_gicsCode->setPlaceholderText(QStringLiteral("sector, Enter"));
    m_gicsCode->setToolTip(QStringLiteral("Double-click to pick from the GICS sectors"));
    auto* classes = new QHBoxLayout;
    classes->addWidget(m_classBox);
    classes->addWidget(m_classCode);
    classes->addSpacing(20);
    classes->addWidget(m_gicsBox);
    classes->addWidget(m_gicsCode);
    classes->addStretch();
    sg->addLayout(classes, 3, 0, 1, 4);
    sg->setColumnStretch(3, 1);
    outer->addWidget(security);

    auto* chart = new QGroupBox(QStringLiteral("Chart"), this);
    auto* cg = new QGridLayout(chart);
    m_style = new QComboBox(chart);
    m_style->setObjectName(QStringLiteral("Combo1"));
    for (const char* c : app::kStyleCaptions)
        m_style->addItem(QString::fromLatin1(c));
    m_osc = new QComboBox(chart);
    m_osc->setObjectName(QStringLiteral("Combo2"));
    for (const auto& row : app::OscChoices())
        m_osc->addItem(QString::fromLatin1(row.Caption.c_str()));
    m_bands = new QComboBox(chart);
    m_bands->setObjectName(QStringLiteral("Combo3"));
    for (const char* c : app::kBandCaptions)
        m_bands->addItem(QString::fromLatin1(c));
    m_period = new QComboBox(chart);
    m_period->setObjectName(QStringLiteral("Combo4"));
    for (int i = 0; i < 3; ++i)
        m_period->addItem(QString::fromLatin1(app::kPeriodCaptions[static_cast<std::size_t>(i)]));
    m_spacingCaption = new QLabel(chart);
    m_spacing = new QLineEdit(chart);
    m_spacing->setObjectName(QStringLiteral("txtSpacing"));
    m_spacing->setValidator(new QIntValidator(-99, 999, m_spacing));
    m_spacing->setMaximumWidth(50);
    m_up = new QToolButton(chart);
    m_up->setObjectName(QStringLiteral("UpDownUp"));
    m_up->setArrowType(Qt::UpArrow);
    m_down = new QToolButton(chart);
    m_down->setObjectName(QStringLiteral("UpDownDown"));
    m_down->setArrowType(Qt::DownArrow);
    auto* spin = new QHBoxLayout;
    spin->addWidget(m_spacing);
    spin->addWidget(m_up);
    spin->addWidget(m_down);
    spin->addStretch();
    m_finish = new QLineEdit(chart);
    m_finish->setObjectName(QStringLiteral("txtFinish"));
    m_finish->setReadOnly(true);
    m_finish->installEventFilter(this);
    m_classCode->installEventFilter(this);
    m_gicsCode->installEventFilter(this);
    m_volume = new QPushButton(chart);
    m_volume->setObjectName(QStringLiteral("Text7"));
    m_av1 = new QCheckBox(chart);
    m_av1->setObjectName(QStringLiteral("chkAv1"));
    m_av2 = new QCheckBox(chart);
    m_av2->setObjectName(QStringLiteral("chkAv2"));
    cg->addWidget(new QLabel(QStringLiteral("Chart Style"), chart), 0, 0);
    cg->addWidget(m_style, 0, 1);
    cg->addWidget(new QLabel(QStringLiteral("Period"), chart), 0, 2);
    cg->addWidget(m_period, 0, 3);
    cg->addWidget(new QLabel(QStringLiteral("Oscillator"), chart), 1, 0);
    cg->addWidget(m_osc, 1, 1);
    cg->addWidget(new QLabel(QStringLiteral("Bands"), chart), 1, 2);
    cg->addWidget(m_bands, 1, 3);
    cg->addWidget(m_spacingCaption, 2, 0);
    cg->addLayout(spin, 2, 1);
    cg->addWidget(new QLabel(QStringLiteral("Finish Date"), chart), 2, 2);
    cg->addWidget(m_finish, 2, 3);
    cg->addWidget(new QLabel(QStringLiteral("Volumes"), chart), 3, 0);
    cg->addWidget(m_volume, 3, 1);
    auto* avs = new QHBoxLayout;
    avs->addWidget(m_av1);
    avs->addWidget(m_av2);
    cg->addLayout(avs, 3, 2, 1, 2);
    outer->addWidget(chart);

    auto* buttons = new QHBoxLayout;
    auto* show = new QPushButton(QStringLiteral("SHOW CHART"), this);
    show->setObjectName(QStringLiteral("cmdShow"));
    show->setDefault(true);
    auto* close = new QPushButton(QStringLiteral("Close"), this);
    close->setObjectName(QStringLiteral("cmdClose"));
    auto* list = new QPushButton(QStringLiteral("Change List"), this);
    list->setObjectName(QStringLiteral("cmdList"));
    m_folder = new QPushButton(QStringLiteral("Change Folder"), this);
    m_folder->setObjectName(QStringLiteral("cmdFolder"));
    m_defaults = new QPushButton(QStringLiteral("Set Defaults"), this);
    m_defaults->setObjectName(QStringLiteral("cmdDefaults"));
    for (QPushButton* b : {show, list, m_folder, m_defaults, close})
        buttons->addWidget(b);
    outer->addLayout(buttons);
    m_folder->hide();
    m_defaults->hide();
    setMinimumWidth(660);

    connect(m_code, &QLineEdit::returnPressed, this, &ChtSel::CodeEntered);
    connect(m_name, &QLineEdit::returnPressed, this, &ChtSel::NameEntered);
    connect(m_scroll, &QScrollBar::valueChanged, this, [this](int v) {
        if (m_updating) return;
        m_sel.ScrollTo(v);
        Refresh();
    });
    connect(m_up, &QToolButton::clicked, this, [this] {
        m_sel.StepSpacing(1);
        Refresh();
    });
    connect(m_down, &QToolButton::clicked, this, [this] {
        m_sel.StepSpacing(-1);
        Refresh();
    });
    connect(m_spacing, &QLineEdit::editingFinished, this, [this] {
        if (m_updating) return;
        m_sel.TypeSpacingValue(m_spacing->text().toInt());
        Refresh();
    });
    connect(m_style, &QComboBox::activated, this, [this](int i) {
        m_sel.ChooseStyle(i);
        Refresh();
    });
    connect(m_period, &QComboBox::activated, this, [this](int i) {
        m_sel.ChoosePeriod(i);
        Refresh();
    });
    connect(m_osc, &QComboBox::activated, this, [this](int i) {
        m_sel.ChooseOscillator(i);
        Refresh();
    });
    connect(m_bands, &QComboBox::activated, this, &ChtSel::BandsChosen);
    connect(m_volume, &QPushButton::clicked, this, [this] {
        m_sel.SetVolume(!m_sel.form().VolumeOn);
        Refresh();
    });
    connect(m_av1, &QCheckBox::clicked, this, [this](bool on) {
        m_sel.SetAverage(1, on);
        Refresh();
    });
    connect(m_av2, &QCheckBox::clicked, this, [this](bool on) {
        m_sel.SetAverage(2, on);
        Refresh();
    });
    connect(m_classBox, &QCheckBox::clicked, this, [this](bool on) { ClassBoxTicked(false, on); });
    connect(m_gicsBox, &QCheckBox::clicked, this, [this](bool on) { ClassBoxTicked(true, on); });
    connect(m_classCode, &QLineEdit::returnPressed, this, [this] { ClassCodeEntered(false); });
    connect(m_gicsCode, &QLineEdit::returnPressed, this, [this] { ClassCodeEntered(true); });
    connect(show, &QPushButton::clicked, this, &ChtSel::ShowChart);
    connect(close, &QPushButton::clicked, this, &ChtSel::CloseWindow);
    connect(list, &QPushButton::clicked, this, &ChtSel::ChangeList);
    connect(m_folder, &QPushButton::clicked, this, &ChtSel::ChangeFolderRequested);
    connect(m_defaults, &QPushButton::clicked, this, &ChtSel::SetDefaultsRequested);
}

bool ChtSel::Load() {
    const bool ok = m_sel.Load();
    Refresh();
    return ok;
}

void ChtSel::Activate() {
    m_sel.Activate();
    Refresh();
}

void ChtSel::SetFolderButton(bool shown) {
    m_folder->setVisible(shown);
}
void ChtSel::SetDefaultsButton(bool shown) {
    m_defaults->setVisible(shown);
}

void ChtSel::Refresh() {
    m_updating = true;
    const auto& f = m_sel.form();
    m_listCaption->setText(Q(f.ListCaption));
    m_code->setText(Q(f.Code));
    m_name->setText(Q(f.Name));
    m_total->setText(QString::number(f.Count));
    m_this->setText(QString::number(f.Position));
    // One past the count so that the last step wraps to the first with a beep.
    m_scroll->setRange(1, std::max(1, f.Count + 1));
    m_scroll->setValue(f.Position);
    m_style->setCurrentIndex(f.StyleIndex);
    m_period->setCurrentIndex(f.PeriodIndex);
    m_bands->setCurrentIndex(f.BandIndex);
    m_osc->setCurrentIndex(f.OscIndex);
    m_spacingCaption->setText(Q(f.SpacingCaption));
    m_spacing->setText(QString::number(f.Spacing));
    m_finish->setText(Q(f.FinishText));
    m_volume->setText(f.VolumeOn ? QStringLiteral("ON") : QStringLiteral("OFF"));
    m_av1->setText(QStringLiteral("Average 1 (%1)").arg(f.AvOnePeriod));
    m_av2->setText(QStringLiteral("Average 2 (%1)").arg(f.AvTwoPeriod));
    m_av1->setChecked(f.AvOne);
    m_av2->setChecked(f.AvTwo);
    const QColor on = ToQColor(m_session.palette[20]);
    m_av1->setStyleSheet(f.AvOne ? QStringLiteral("color: %1").arg(on.name())
                                 : QStringLiteral("color: black"));
    m_av2->setStyleSheet(f.AvTwo ? QStringLiteral("color: %1").arg(on.name())
                                 : QStringLiteral("color: black"));
    for (QWidget* w : std::initializer_list<QWidget*>{m_osc, m_bands, m_av1, m_av2})
        w->setEnabled(f.ChoosersEnabled);
    m_period->setEnabled(f.ChoosersEnabled);
    const auto& st = m_sel.state();
    const bool fullList = st.Request.ListMode == 1;
    m_classBox->setChecked(st.ClassWalk);
    m_gicsBox->setChecked(st.GicsWalk);
    m_classBox->setEnabled(fullList && !st.GicsWalk);
    m_gicsBox->setEnabled(fullList && !st.ClassWalk);
    m_classCode->setEnabled(st.ClassWalk);
    m_gicsCode->setEnabled(st.GicsWalk);
    m_classCode->setText(Q(st.ClassCode));
    m_gicsCode->setText(Q(st.GicsCode));
    m_updating = false;
}

void ChtSel::CodeEntered() {
    if (m_sel.TypeCode(m_code->text().toStdString())) {
        Refresh();
        ShowChart();
        return;
    }
    Refresh();
}

void ChtSel::NameEntered() {
    if (m_sel.state().Request.ListMode != 1) {
        m_session.dialogs().MsgBox("You have " + m_sel.state().Request.ListName + " selected." +
                                       "Search by NAME only available when using FULL LIST",
                                   "Search by Name");
        return;
    }
    Search s(
        m_sel.walk().names(), m_sel.form().Position, m_session.dialogs(),
        [this](int pos) {
            m_sel.ScrollTo(pos);
            Refresh();
        },
        this);
    s.field()->setText(m_name->text());
    s.exec();
}

void ChtSel::ClassBoxTicked(bool gics, bool on) {
    m_sel.SetClassWalk(gics, on);
    Refresh();
    if (on) (gics ? m_gicsCode : m_classCode)->setFocus();
}

void ChtSel::PickClassCode(bool gics) {
    // A row picked in the class window starts the walk; nothing picked ends it with the
    // "invalid" message.
    const auto code = PickClass(m_session, gics, this);
    (gics ? m_gicsCode : m_classCode)->setText(Q(code.value_or(std::string())));
    ClassCodeEntered(gics);
}

void ChtSel::ClassCodeEntered(bool gics) {
    // A code may also be typed and entered.
    m_sel.SetClassCode(gics, (gics ? m_gicsCode : m_classCode)->text().toStdString());
    Refresh();
}

void ChtSel::BandsChosen(int index) {
    if (index == 0) {
        m_sel.ChooseBands(0, std::nullopt);
        Refresh();
        return;
    }
    const auto rec = m_sel.Current();
    for (;;) {
        const auto values =
            ChtBands::Ask(this, rec ? rec->PercentBandUp : 0, rec ? rec->PercentBandDown : 0);
        if (m_sel.ChooseBands(index, values)) break;
    }
    Refresh();
}

bool ChtSel::eventFilter(QObject* watched, QEvent* event) {
    if (watched == m_finish && event->type() == QEvent::MouseButtonPress) {
        if (m_sel.FinishDateClicked()) {
            for (;;) {
                if (m_sel.SetFinishDate(FinDate::Ask(this))) break;
            }
        }
        Refresh();
        return true;
    }
    if ((watched == m_classCode || watched == m_gicsCode) &&
        event->type() == QEvent::MouseButtonDblClick &&
        static_cast<QWidget*>(watched)->isEnabled()) {
        PickClassCode(watched == m_gicsCode);
        return true;
    }
    return QWidget::eventFilter(watched, event);
}

void ChtSel::ShowChart() {
    if (!m_spacing->text().isEmpty()) m_sel.TypeSpacingValue(m_spacing->text().toInt());
    m_sel.ShowChart();
    emit ShowChartRequested();
}

void ChtSel::CloseWindow() {
    m_sel.Close();
    emit CloseRequested();
}

void ChtSel::ChangeList() {
    ChtOptions options(store::GetSubLists(m_session.services().settings), this);
    if (options.exec() != QDialog::Accepted) return;
    if (const auto picked = options.Picked()) {
        m_sel.ChangeList(picked->first, picked->second);
        Activate();
    }
}

} // namespace kori::gui
