#include "gui/windows/multi_osc.h"

#include "osc/osc_identifiers.h"

#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace kori::gui {

MultiOsc::MultiOsc(app::Session& session, SettingsHub& hub, QWidget* parent)
    : SettingsDialog(session, hub, "MultiOsc", QStringLiteral("MultiOsc Setup"), parent),
      m_choices(new QListWidget(this)) {
    m_choices->setObjectName(QStringLiteral("lstOsc"));
    for (std::string_view n : osc::MultiOscChoices())
        m_choices->addItem(QString::fromUtf8(n.data(), static_cast<int>(n.size())));
    connect(m_choices, &QListWidget::itemDoubleClicked, this,
            [this](QListWidgetItem* item) { Fill(m_choices->row(item)); });

    auto* sets = new QVBoxLayout;
    auto& store = session.services().settings;
    for (int s = 0; s < 2; ++s) {
        auto* box = new QGroupBox(QStringLiteral("Multi Oscillators %1").arg(s + 1), this);
        auto* list = new QListWidget(box);
        list->setObjectName(QStringLiteral("lstSet%1").arg(s + 1));
        for (const auto& slot : osc::LoadMultiOscSet(store, s + 1).Slots)
            list->addItem(Q(slot));
        list->setFixedHeight(list->sizeHintForRow(0) * 5 + 2 * list->frameWidth() + 4);
        connect(list, &QListWidget::itemClicked, this, [this, list] {
            m_activeSet = list;
            for (auto* other : m_sets)
                if (other != list) other->clearSelection();
        });
        auto* l = new QVBoxLayout(box);
        l->addWidget(list);
        sets->addWidget(box);
        m_sets[static_cast<std::size_t>(s)] = list;
    }
    sets->addStretch();
    auto* save = Button(QStringLiteral("Save"), "cmdSave");
    auto* close = Button(QStringLiteral("Close"), "cmdClose");
    connect(save, &QPushButton::clicked, this, [this] {
        Save();
        accept();
    });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(save);
    buttons->addWidget(close);
    auto* top = new QHBoxLayout;
    top->addWidget(m_choices, 1);
    top->addLayout(sets, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(new QLabel(
        QStringLiteral("Click a slot, then double click the oscillator that is to fill it"), this));
    layout->addLayout(top);
    layout->addLayout(buttons);
    resize(480, 400);
}

void MultiOsc::Fill(int choiceRow) {
    if (!m_activeSet || m_activeSet->currentRow() < 0 || choiceRow < 0) return;
    m_activeSet->currentItem()->setText(m_choices->item(choiceRow)->text());
}

void MultiOsc::Save() {
    auto& store = m_session.services().settings;
    for (int s = 0; s < 2; ++s) {
        osc::MultiOscSet set;
        for (int i = 0; i < static_cast<int>(osc::kMultiOscSlots); ++i) {
            const QString t = m_sets[static_cast<std::size_t>(s)]->item(i)->text().trimmed();
            set.Slots[static_cast<std::size_t>(i)] = t.isEmpty() ? "None" : S(t);
        }
        osc::SaveMultiOscSet(store, s + 1, set);
    }
    emit m_hub.MultiOscSaved();
}

} // namespace kori::gui
