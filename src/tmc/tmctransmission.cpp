#include "tmc/tmctransmission.h"

#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "tmc/messagedelegate.h"
#include "tmc/messagelist.h"
#include "tmc/tmcbuilder.h"
#include "ui/controls.h"
#include "ui/dialogs.h"
#include "ui/text.h"

#include <QHBoxLayout>
#include <QVBoxLayout>

#include <memory>
#include <stdexcept>

namespace kdx {

namespace {

// Group type 8A, the two system information words in turn, the identifier of the TMC application.
constexpr const char* kFirstAnnouncement = "01,106100CD46";
constexpr const char* kSecondAnnouncement = "01,100066CD46";
constexpr const char* kMessagePrefix = "02,";

}  // namespace

TmcTransmission::TmcTransmission(const PageContext& with, const TmcBuilder& builder, QWidget* parent)
    : QWidget(parent), m_with(with), m_builder(builder) {
    place();
    wire();
    optSingleMessage->setChecked(true);
    label();
}

void TmcTransmission::place() {
    TMC_List = named<QListWidget>("TMC_List", this);
    TMC_List->setItemDelegate(new MessageDelegate(TMC_List));
    TMC_List->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    TMC_List->setMinimumHeight(3 * fontMetrics().height());
    TMC_Gr8_apply = named<QPushButton>("TMC_Gr8_apply", this);
    TMC_Gr8_Remove = named<QPushButton>("TMC_Gr8_Remove", this);
    optSingleMessage = named<QRadioButton>("optSingleMessage", this);
    optMultiMessage = named<QRadioButton>("optMultiMessage", this);
    lblCycleTime = named<QLabel>("lblCycleTime", this);
    txtCycleTime = named<QLineEdit>("txtCycleTime", QStringLiteral("1"), this);
    txtCycleTime->setFixedWidth(fontMetrics().horizontalAdvance(QStringLiteral("65.5350")) + 8);
    lblCycleTime->setBuddy(txtCycleTime);
    TMC_Senden_Taste = named<QPushButton>("TMC_Senden_Taste", this);
    Stop_Timer = named<QPushButton>("Stop_Timer", this);
    TMC_Sende_Timer = named<Ticker>("TMC_Sende_Timer", this);

    auto* changes = new QVBoxLayout;
    tighten(changes, 0);
    changes->addWidget(TMC_Gr8_apply);
    changes->addWidget(TMC_Gr8_Remove);
    changes->addStretch(1);
    auto* messages = new QHBoxLayout;
    tighten(messages, 0);
    messages->addWidget(TMC_List, 1);
    messages->addLayout(changes);

    auto* sending = new QHBoxLayout;
    tighten(sending, 0);
    sending->addWidget(optSingleMessage);
    sending->addSpacing(kGap);
    sending->addWidget(optMultiMessage);
    sending->addStretch(1);
    sending->addWidget(lblCycleTime);
    sending->addWidget(txtCycleTime);
    sending->addStretch(1);
    sending->addWidget(TMC_Senden_Taste);
    sending->addWidget(Stop_Timer);
    auto* layout = new QVBoxLayout(this);
    tighten(layout, 0);
    layout->addLayout(messages, 1);
    layout->addLayout(sending);
}

void TmcTransmission::wire() {
    connect(TMC_Gr8_apply, &QPushButton::clicked, this, &TmcTransmission::TMC_Gr8_apply_Click);
    connect(TMC_Gr8_Remove, &QPushButton::clicked, this, &TmcTransmission::TMC_Gr8_Remove_Click);
    connect(TMC_Senden_Taste, &QPushButton::clicked, this, &TmcTransmission::TMC_Senden_Taste_Click);
    connect(Stop_Timer, &QPushButton::clicked, this, &TmcTransmission::Stop_Timer_Click);
    connect(TMC_Sende_Timer, &Ticker::timeout, this, &TmcTransmission::TMC_Sende_Timer_Timer);
    connect(optMultiMessage, &QRadioButton::toggled, this, [this](bool chosen) {
        if (chosen) optMultiMessage_Click();
    });
    connect(optSingleMessage, &QRadioButton::toggled, this, [this](bool chosen) {
        if (chosen) optSingleMessage_Click();
    });
}

void TmcTransmission::label() {
    const Captions& captions = m_with.captions;
    TMC_Gr8_apply->setText(toText(captions.text(196)));
    TMC_Gr8_Remove->setText(toText(captions.text(197)));
    lblCycleTime->setText(toText(captions.text(200)));
    optSingleMessage->setText(toText(captions.text(229)));
    optMultiMessage->setText(toText(captions.text(230)));
    TMC_Senden_Taste->setText(toText(captions.text(53)));
    Stop_Timer->setText(toText(captions.own(584, "stop")));
    TMC_List->setAccessibleName(toText(captions.own(585, "Meldungen")));
}

void TmcTransmission::TMC_Gr8_apply_Click() {
    const std::string entry =
        messageEntry(toBytes(m_builder.locationText()), toBytes(m_builder.eventText()), toBytes(m_builder.groupCode()));
    TMC_List->addItem(toText(entry));
}

void TmcTransmission::TMC_Gr8_Remove_Click() {
    const auto selected = TMC_List->selectedItems();
    if (selected.isEmpty()) {
        m_with.dialogs.message(Dialogs::Icon::None, toText(m_with.captions.own(586, "Ung\xfcltig")),
                               toText(m_with.captions.own(587, "W\xe4hlen sie einen Eintrag aus !")));
        return;
    }
    const std::unique_ptr<QListWidgetItem> removed(TMC_List->takeItem(TMC_List->row(selected.front())));
    TMC_List->setCurrentRow(-1);  // the next removal asks for a choice again instead of taking a neighbour
    m_sendPosition = 0;
}

void TmcTransmission::TMC_Senden_Taste_Click() {
    if (TMC_List->count() == 0 || !setInterval()) return;
    if (TMC_List->selectedItems().isEmpty()) TMC_List->setCurrentRow(0);
    allowChanges(false);
    TMC_Sende_Timer->setEnabled(true);
}

bool TmcTransmission::setInterval() {
    try {
        TMC_Sende_Timer->setPeriod(cycleTimeMs(toBytes(txtCycleTime->text())));
        return true;
    } catch (const std::out_of_range&) {
        m_with.dialogs.message(
            Dialogs::Icon::Exclamation, toText(m_with.captions.own(588, "Wechselzeit")),
            toText(m_with.captions.own(589, "Die Wechselzeit muss zwischen 0 und 65.535 Sekunden liegen.")));
        return false;
    }
}

void TmcTransmission::TMC_Sende_Timer_Timer() {
    // A failed write shows its box in here; the timer lets no further tick in until it is closed.
    m_sendPosition = nextPosition(m_sendPosition, TMC_List->count());
    sendAndStore("ODA", m_otherVariant ? kSecondAnnouncement : kFirstAnnouncement);
    m_otherVariant = !m_otherVariant;
    const bool multi = optMultiMessage->isChecked();
    if (multi) TMC_List->setCurrentRow(m_sendPosition);
    const QListWidgetItem* message = TMC_List->currentItem();
    sendAndStore("TMC", kMessagePrefix + codeOfMessage(toBytes(message != nullptr ? message->text() : QString())));
    if (!multi) Stop_Timer_Click();
}

void TmcTransmission::sendAndStore(const char* key, const std::string& value) {
    m_with.params.SendParam(key, std::string(value));
    // Both go to the same key, so the message is what the data set keeps.
    m_with.data.WriteIni("RDS", "TMC", value, dataSetFile(m_with.state.CurrentDataSet));
}

void TmcTransmission::Stop_Timer_Click() {
    TMC_Sende_Timer->setEnabled(false);
    allowChanges(true);
}

void TmcTransmission::allowChanges(bool allowed) {
    TMC_Gr8_apply->setEnabled(allowed);
    TMC_Gr8_Remove->setEnabled(allowed);
}

void TmcTransmission::optMultiMessage_Click() {
    txtCycleTime->setEnabled(true);
    lblCycleTime->setEnabled(true);
}

void TmcTransmission::optSingleMessage_Click() {
    txtCycleTime->setEnabled(false);
    lblCycleTime->setEnabled(false);
}

}  // namespace kdx
