#include "gui/windows/adjust_windows.h"

#include "gui/windows/main_window.h"

#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QToolButton>
#include <QVBoxLayout>

namespace kori::gui {

using adjust::AdjType;

namespace {

QString Q(std::string_view s) {
    return QString::fromLatin1(s.data(), static_cast<int>(s.size()));
}
std::string S(const QString& s) {
    return s.toLatin1().toStdString();
}

QPushButton* NamedButton(const QString& caption, const char* name, QWidget* parent) {
    auto* b = new QPushButton(caption, parent);
    b->setObjectName(QString::fromLatin1(name));
    b->setAutoDefault(false);
    return b;
}

QLabel* NamedLabel(const QString& text, const char* name, QWidget* parent) {
    auto* l = new QLabel(text, parent);
    l->setObjectName(QString::fromLatin1(name));
    return l;
}

} // namespace

// ---- AdjDate --------------------------------------------------------------------------------

AdjDate::AdjDate(app::AdjustmentEntry& entry, QWidget* parent)
    : QDialog(parent), m_entry(entry), m_list(new QListWidget(this)) {
    setObjectName(QStringLiteral("AdjDate"));
    setWindowTitle(Q(app::kAdjDateTitle));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(NamedLabel(Q(app::kAdjDateLabel), "Label1", this));
    m_list->setObjectName(QStringLiteral("List1"));
    QFont fixed(QStringLiteral("Monospace"));
    fixed.setStyleHint(QFont::TypeWriter);
    m_list->setFont(fixed);
    for (const auto& line : entry.choice().Lines)
        m_list->addItem(Q(line));
    layout->addWidget(m_list);
    auto* ok = NamedButton(QStringLiteral("OK"), "cmdOK", this);
    layout->addWidget(ok);
    if (entry.choice().Selected >= 0) m_list->setCurrentRow(entry.choice().Selected);
    connect(m_list, &QListWidget::currentRowChanged, this, [this](int row) {
        m_entry.ChooseEntry(row);
        emit chosen();
    });
    connect(ok, &QPushButton::clicked, this, &QDialog::accept);
}

// ---- Entry windows --------------------------------------------------------------------------

AdjustEntry::AdjustEntry(app::Session& session, app::AdjustmentInputs& inputs, AdjType type,
                         QWidget* parent)
    : QDialog(parent), m_model(session, inputs, type) {
    const auto& text = m_model.text();
    setObjectName(Q(text.Window));
    setWindowTitle(Q(text.Title));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(NamedLabel(Q(inputs.Code), "lblCode", this));
    for (std::size_t i = 0; i < text.Help.size(); ++i)
        layout->addWidget(
            NamedLabel(Q(text.Help[i]), ("lblHelp" + std::to_string(i)).c_str(), this));

    auto* grid = new QGridLayout;
    int row = 0;
    if (!text.LabelA.empty()) {
        m_a = Field("txtA");
        m_b = Field("txtB");
        grid->addWidget(new QLabel(Q(text.LabelA), this), row, 0);
        grid->addWidget(m_a, row++, 1);
        if (!text.Between.empty()) grid->addWidget(new QLabel(Q(text.Between), this), row++, 0);
        grid->addWidget(new QLabel(Q(text.LabelB), this), row, 0);
        grid->addWidget(m_b, row++, 1);
        for (QLineEdit* f : {m_a, m_b})
            connect(f, &QLineEdit::textEdited, this, [this] { ShowReadOut(); });
    }
    if (!text.MoneyLabel.empty()) {
        m_money = Field("txtMoney");
        grid->addWidget(new QLabel(Q(text.MoneyLabel), this), row, 0);
        grid->addWidget(m_money, row++, 1);
        connect(m_money, &QLineEdit::textEdited, this, [this] { ShowReadOut(); });
    }
    m_date = Field("txtDate");
    m_dateButton = NamedButton(QStringLiteral("Check Date"), "cmdDate", this);
    grid->addWidget(new QLabel(Q(text.DateLabel), this), row, 0);
    grid->addWidget(m_date, row, 1);
    grid->addWidget(m_dateButton, row++, 2);
    layout->addLayout(grid);

    m_ratio = NamedLabel({}, "lblRatio", this);
    m_close = NamedLabel({}, "lblClose", this);
    m_desc = NamedLabel({}, "lblDesc", this);
    layout->addWidget(m_ratio);
    layout->addWidget(m_close);
    layout->addWidget(m_desc);

    m_adjust = NamedButton(QStringLiteral("Adjust Data"), "cmdAdjust", this);
    m_adjust->setEnabled(false);
    auto* close = NamedButton(QStringLiteral("Close"), "cmdClose", this);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(m_adjust);
    buttons->addWidget(close);
    layout->addLayout(buttons);

    connect(m_date, &QLineEdit::returnPressed, this, [this] { RunDateStep(); });
    connect(m_dateButton, &QPushButton::clicked, this, [this] { RunDateStep(); });
    connect(m_adjust, &QPushButton::clicked, this, [this] { RunAdjustData(); });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
}

QLineEdit* AdjustEntry::Field(const char* name) {
    auto* f = new QLineEdit(this);
    f->setObjectName(QString::fromLatin1(name));
    // Leaving a field checks it: a value that is not a number gives way to the one held.
    connect(f, &QLineEdit::editingFinished, this, [this] { TakeFields(); });
    // Enter moves on to the next field (the date field runs the date step instead).
    if (std::string_view(name) != "txtDate")
        connect(f, &QLineEdit::returnPressed, this, [this] { focusNextChild(); });
    return f;
}

void AdjustEntry::TakeFields() {
    if (m_a) {
        m_model.SetRatioA(S(m_a->text()));
        m_model.SetRatioB(S(m_b->text()));
        m_a->setText(Q(m_model.RatioAText()));
        m_b->setText(Q(m_model.RatioBText()));
    }
    if (m_money) {
        m_model.SetMoney(S(m_money->text()));
        m_money->setText(Q(m_model.MoneyText()));
    }
    ShowReadOut();
}

void AdjustEntry::ShowReadOut() {
    const auto typed = [](QLineEdit* f) { return f ? S(f->text()) : std::string(); };
    switch (m_model.type()) {
    case AdjType::Bonus:
    case AdjType::Split:
        m_ratio->setText(Q(adjust::BonusRatioText(typed(m_a), typed(m_b))));
        break;
    case AdjType::Cash:
        m_ratio->setText(Q(adjust::CashRatioText(typed(m_a), typed(m_b), typed(m_money))));
        break;
    default:
        break;
    }
}

void AdjustEntry::RunDateStep() {
    TakeFields();
    if (!m_model.DateStep(S(m_date->text()))) return;
    m_date->setText(Q(m_model.DateField()));
    m_close->setText(Q(m_model.CloseLabel()));
    m_adjust->setEnabled(m_model.AdjustEnabled());
    if (m_model.choice().Lines.empty()) return;
    if (m_dateWindow) m_dateWindow->close();
    m_dateWindow = new AdjDate(m_model, this);
    m_dateWindow->setAttribute(Qt::WA_DeleteOnClose);
    connect(m_dateWindow, &AdjDate::chosen, this,
            [this] { m_date->setText(Q(m_model.DateField())); });
    m_dateWindow->open();
}

void AdjustEntry::RunAdjustData() {
    TakeFields();
    if (m_model.AdjustData()) {
        m_desc->setText(Q(m_model.DescText()));
        m_adjust->setEnabled(false);
    } else if (!m_model.DescText().empty()) {
        m_desc->setText(Q(m_model.DescText()));
    }
}

// ---- AdjustR --------------------------------------------------------------------------------

AdjustR::AdjustR(app::Session& session, std::string code, QWidget* parent)
    : QDialog(parent), m_session(session), m_code(std::move(code)),
      m_proceed(NamedButton(QStringLiteral("Proceed"), "Proceed", this)) {
    setObjectName(QStringLiteral("AdjustR"));
    setWindowTitle(Q(app::kRemoveTitle));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(NamedLabel(Q(m_code), "lblCode", this));
    for (std::size_t i = 0; i < app::kRemoveHelp.size(); ++i) {
        auto* help =
            NamedLabel(Q(app::kRemoveHelp[i]), ("lblHelp" + std::to_string(i)).c_str(), this);
        help->setWordWrap(true);
        layout->addWidget(help);
    }
    auto* close = NamedButton(QStringLiteral("Close"), "cmdClose", this);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(m_proceed);
    buttons->addWidget(close);
    layout->addLayout(buttons);
    connect(m_proceed, &QPushButton::clicked, this, [this] {
        app::ProceedRemoval(m_session, m_code);
        accept();
    });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
}

// ---- Adjust ---------------------------------------------------------------------------------

Adjust::Adjust(app::Session& session, QWidget* parent)
    : QDialog(parent), m_model(session), m_code(new QLineEdit(this)),
      m_name(NamedLabel({}, "lblName", this)), m_up(new QToolButton(this)),
      m_down(new QToolButton(this)) {
    setObjectName(QStringLiteral("Adjust"));
    setWindowTitle(Q(app::kAdjustCaption));
    m_code->setObjectName(QStringLiteral("txtCode"));
    m_code->setMaxLength(6);
    m_up->setObjectName(QStringLiteral("UpDown1Up"));
    m_up->setArrowType(Qt::UpArrow);
    m_down->setObjectName(QStringLiteral("UpDown1Down"));
    m_down->setArrowType(Qt::DownArrow);

    auto* layout = new QVBoxLayout(this);
    auto* codeRow = new QHBoxLayout;
    codeRow->addWidget(new QLabel(QStringLiteral("Code"), this));
    codeRow->addWidget(m_code);
    auto* arrows = new QVBoxLayout;
    arrows->addWidget(m_up);
    arrows->addWidget(m_down);
    codeRow->addLayout(arrows);
    codeRow->addWidget(m_name, 1);
    layout->addLayout(codeRow);

    struct Kind {
        const char* name;
        AdjType type;
    };
    for (const Kind k : {Kind{"cmdBonus", AdjType::Bonus}, Kind{"cmdCash", AdjType::Cash},
                         Kind{"cmdSplit", AdjType::Split}, Kind{"cmdCall", AdjType::Call},
                         Kind{"cmdDividend", AdjType::Dividend}}) {
        auto* b = NamedButton(Q(app::TextOf(k.type).Title), k.name, this);
        connect(b, &QPushButton::clicked, this, [this, t = k.type] { OpenEntry(t); });
        layout->addWidget(b);
    }
    auto* remove = NamedButton(Q(app::kRemoveTitle), "cmdRemove", this);
    connect(remove, &QPushButton::clicked, this, [this] { OpenRemove(); });
    layout->addWidget(remove);
    auto* close = NamedButton(QStringLiteral("Close"), "cmdClose", this);
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    layout->addWidget(close);

    connect(m_code, &QLineEdit::returnPressed, this, [this] {
        m_model.EnterCode(S(m_code->text()));
        ShowSecurity();
    });
    connect(m_up, &QToolButton::clicked, this, [this] {
        m_model.Step(1);
        ShowSecurity();
    });
    connect(m_down, &QToolButton::clicked, this, [this] {
        m_model.Step(-1);
        ShowSecurity();
    });
    m_model.Load();
    ShowSecurity();
}

void Adjust::ShowSecurity() {
    m_code->setText(Q(m_model.Code()));
    m_name->setText(Q(m_model.Name()));
}

void Adjust::CloseOpen() {
    if (m_open) m_open->close();
    m_open = nullptr;
}

AdjustEntry* Adjust::OpenEntry(AdjType type) {
    CloseOpen();
    if (!m_model.HasSecurity()) return nullptr;
    auto& s = m_model.session();
    auto& in = m_model.inputs();
    AdjustEntry* w = nullptr;
    switch (type) {
    case AdjType::Bonus:
        w = new AdjustB(s, in, this);
        break;
    case AdjType::Cash:
        w = new AdjustC(s, in, this);
        break;
    case AdjType::Split:
        w = new AdjustSS(s, in, this);
        break;
    case AdjType::Call:
        w = new AdjustCC(s, in, this);
        break;
    case AdjType::Dividend:
        w = new AdjustD(s, in, this);
        break;
    }
    w->setAttribute(Qt::WA_DeleteOnClose);
    m_open = w;
    w->open();
    return w;
}

AdjustR* Adjust::OpenRemove() {
    CloseOpen();
    if (!m_model.HasSecurity()) return nullptr;
    auto* w = new AdjustR(m_model.session(), m_model.Code(), this);
    w->setAttribute(Qt::WA_DeleteOnClose);
    m_open = w;
    w->open();
    return w;
}

void RegisterAdjustWindows(MainWindow& main) {
    main.SetAction("Adjust", [&main] {
        if (auto* open = main.findChild<Adjust*>(QStringLiteral("Adjust"))) {
            open->raise();
            open->activateWindow();
            return;
        }
        auto* w = new Adjust(main.session(), &main);
        w->setAttribute(Qt::WA_DeleteOnClose);
        w->open();
    });
}

} // namespace kori::gui
