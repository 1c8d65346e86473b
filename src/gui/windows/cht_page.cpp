#include "gui/windows/cht_page.h"

#include "app/settings.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QPushButton>
#include <QSpinBox>

namespace kori::gui {

CHTPage::CHTPage(app::Session& session, QWidget* parent)
    : QDialog(parent), m_session(session), m_left(new QSpinBox(this)), m_top(new QSpinBox(this)),
      m_orient(new QComboBox(this)) {
    setObjectName(QStringLiteral("CHTPage"));
    setWindowTitle(QStringLiteral("Page Setup"));
    auto* form = new QFormLayout(this);
    form->addRow(
        new QLabel(QStringLiteral("Printer origin in printer units; 0 centres the chart."), this));
    for (QSpinBox* s : {m_left, m_top})
        s->setRange(-100000, 100000);
    m_left->setObjectName(QStringLiteral("txtLeft"));
    m_top->setObjectName(QStringLiteral("txtTop"));
    m_left->setValue(session.page.PPLft);
    m_top->setValue(session.page.PPTop);
    m_orient->setObjectName(QStringLiteral("cboOrient"));
    m_orient->addItems({QStringLiteral("Printer default"), QStringLiteral("Portrait"),
                        QStringLiteral("Landscape")});
    m_orient->setCurrentIndex(
        session.page.Orient == 1 || session.page.Orient == 2 ? session.page.Orient : 0);
    form->addRow(QStringLiteral("Left"), m_left);
    form->addRow(QStringLiteral("Top"), m_top);
    form->addRow(QStringLiteral("Orientation"), m_orient);
    auto* centre = new QPushButton(QStringLiteral("Centre on Page"), this);
    connect(centre, &QPushButton::clicked, this, [this] {
        m_left->setValue(0);
        m_top->setValue(0);
    });
    form->addRow(centre);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, [this] {
        Save();
        accept();
    });
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    form->addRow(buttons);
}

void CHTPage::Save() {
    m_session.page.PPLft = m_left->value();
    m_session.page.PPTop = m_top->value();
    m_session.page.Orient = static_cast<std::int16_t>(m_orient->currentIndex());
    app::WritePageSettings(m_session.ini(), m_session.page);
}

} // namespace kori::gui
