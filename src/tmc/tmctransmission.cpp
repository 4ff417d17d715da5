#include "tmc/tmctransmission.h"

#include "settings/datafolder.h"
#include "settings/ownfiles.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "tmc/groupcode.h"
#include "tmc/messagedelegate.h"
#include "tmc/messagefile.h"
#include "tmc/messagelist.h"
#include "tmc/runline.h"
#include "tmc/settings.h"
#include "tmc/tmcbuilder.h"
#include "ui/dialogs.h"
#include "ui/layouts.h"
#include "ui/text.h"
#include "ui/tick.h"

#include <memory>
#include <stdexcept>
#include <utility>

namespace kdx {

namespace {

const QString kName = QStringLiteral("TMC");  // in every language

}  // namespace

TmcTransmission::TmcTransmission(const PageContext& with, const TmcBuilder& builder, QWidget* parent)
    : Page(with, parent),
      m_builder(builder),
      m_cycling(
          with.tickers.automatics(), [] { return kName; }, [this] { Stop_Timer_Click(); }) {
    create();
    arrange();
    optSingleMessage->setChecked(true);
}

void TmcTransmission::create() {
    TMC_List = named<QListWidget>("TMC_List", this);
    TMC_List->setItemDelegate(new MessageDelegate(TMC_List));
    TMC_List->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    TMC_List->setMinimumHeight(3 * fontMetrics().height());
    m_book.spoken(TMC_List, {585, "Meldungen"});
    TMC_Gr8_apply = clicked<QPushButton>("TMC_Gr8_apply", {196}, this, &TmcTransmission::TMC_Gr8_apply_Click);
    TMC_Gr8_Remove = clicked<QPushButton>("TMC_Gr8_Remove", {197}, this, &TmcTransmission::TMC_Gr8_Remove_Click);
    createSending();
}

void TmcTransmission::createSending() {
    optSingleMessage = captioned<QRadioButton>("optSingleMessage", {229}, this);
    connect(optSingleMessage, &QRadioButton::toggled, this, [this](bool chosen) {
        if (chosen) optSingleMessage_Click();
    });
    optMultiMessage = captioned<QRadioButton>("optMultiMessage", {230}, this);
    connect(optMultiMessage, &QRadioButton::toggled, this, [this](bool chosen) {
        if (chosen) optMultiMessage_Click();
    });
    txtCycleTime = named<QLineEdit>("txtCycleTime", QStringLiteral("1"), this);
    txtCycleTime->setFixedWidth(fontMetrics().horizontalAdvance(QStringLiteral("65.5350")) + 8);
    lblCycleTime = heading("lblCycleTime", {200}, txtCycleTime);
    TMC_Senden_Taste = clicked<QPushButton>("TMC_Senden_Taste", {53}, this, &TmcTransmission::TMC_Senden_Taste_Click);
    Stop_Timer = clicked<QPushButton>("Stop_Timer", {584, "stop"}, this, &TmcTransmission::Stop_Timer_Click);
    Stop_Timer->setProperty(kWorksWhileSending, true);
    TMC_Sende_Timer = timer("TMC_Sende_Timer", 0, &TmcTransmission::TMC_Sende_Timer_Timer);
    TMC_Lauf = named<RunLine>("TMC_Lauf", m_with, this);
}

void TmcTransmission::label() {
    Page::label();
    TMC_Lauf->label();
}

void TmcTransmission::arrange() {
    auto* messages = row({{TMC_List, 1}, column({TMC_Gr8_apply, TMC_Gr8_Remove, kRoom})});
    auto* sending = row({optSingleMessage, space(kGap), optMultiMessage, kRoom, lblCycleTime, txtCycleTime, kRoom,
                         TMC_Senden_Taste, Stop_Timer});
    layOut(this, column({{messages, 1}, TMC_Lauf, sending}), 0);
}

void TmcTransmission::TMC_Gr8_apply_Click() {
    const std::string entry =
        messageEntry(toBytes(m_builder.locationText()), toBytes(m_builder.eventText()), toBytes(m_builder.groupCode()));
    TMC_List->addItem(toText(entry));
    keepMessages();
}

void TmcTransmission::load() {
    if (std::exchange(m_loaded, true)) return;  // another data set is no reason to lose what is being sent
    for (const std::string& entry : loadMessages(m_with.data.file(kMessageFile))) TMC_List->addItem(toText(entry));
}

void TmcTransmission::keepMessages() {
    std::vector<std::string> entries;
    entries.reserve(static_cast<std::size_t>(TMC_List->count()));
    for (int row = 0; row < TMC_List->count(); ++row) entries.push_back(toBytes(TMC_List->item(row)->text()));
    const bool kept = !m_with.data.isReadOnly() && storeMessages(m_with.data.file(kMessageFile), entries);
    if (kept || std::exchange(m_lossTold, true)) return;
    m_with.dialogs.message(Dialogs::Icon::Exclamation, caption({585, "Meldungen"}),
                           caption({624, "%1 kann nicht gespeichert werden."}).arg(QLatin1String(kMessageFile)));
}

void TmcTransmission::TMC_Gr8_Remove_Click() {
    const auto selected = TMC_List->selectedItems();
    if (selected.isEmpty()) {
        m_with.dialogs.message(Dialogs::Icon::None, caption({586, "Ungültig"}),
                               caption({587, "Wählen sie einen Eintrag aus !"}));
        return;
    }
    const std::unique_ptr<QListWidgetItem> removed(TMC_List->takeItem(TMC_List->row(selected.front())));
    TMC_List->setCurrentRow(-1);  // the next removal asks for a choice again instead of taking a neighbour
    m_sendPosition = 0;
    keepMessages();
}

void TmcTransmission::TMC_Senden_Taste_Click() {
    if (TMC_List->count() == 0 || !setInterval()) return;
    if (TMC_List->selectedItems().isEmpty()) TMC_List->setCurrentRow(0);
    allowChanges(false);
    TMC_Sende_Timer->setEnabled(true);
    TMC_Lauf->begin(TMC_Sende_Timer->period(), optSingleMessage->isChecked());
    m_cycling.setRunning(true);
}

bool TmcTransmission::setInterval() {
    const auto number = decimalNumber(toBytes(txtCycleTime->text()));
    if (m_with.state.corrections.decimalComma && number) txtCycleTime->setText(toText(*number));
    try {
        TMC_Sende_Timer->setPeriod(cycleTimeMs(toBytes(txtCycleTime->text())));
        return true;
    } catch (const std::out_of_range&) {
        m_with.dialogs.message(Dialogs::Icon::Exclamation, caption({588, "Wechselzeit"}),
                               caption({589, "Die Wechselzeit muss zwischen 0 und 65,535 Sekunden liegen."}));
        return false;
    }
}

void TmcTransmission::TMC_Sende_Timer_Timer() {
    // A failed write shows its box in here; the timer lets no further tick in until it is closed.
    const Tick tick(m_with, kName, [this] { Stop_Timer_Click(); });
    m_sendPosition = nextPosition(m_sendPosition, TMC_List->count());
    sendAndStore(setting::kOpenDataAnnouncement, announcement(m_otherVariant));
    m_otherVariant = !m_otherVariant;
    const bool multi = optMultiMessage->isChecked();
    if (multi) TMC_List->setCurrentRow(m_sendPosition);
    const QListWidgetItem* message = TMC_List->currentItem();
    const std::string code = codeOfMessage(toBytes(message != nullptr ? message->text() : QString()));
    sendAndStore(setting::kTrafficMessage, sentMessage(code));
    TMC_Lauf->sent(code, TMC_List->currentRow() + 1, TMC_List->count());
    if (!multi) Stop_Timer_Click();
}

void TmcTransmission::Stop_Timer_Click() {
    if (TMC_Sende_Timer->isEnabled()) TMC_Lauf->end();
    TMC_Sende_Timer->setEnabled(false);
    m_cycling.setRunning(false);
    allowChanges(true);
}

void TmcTransmission::allowChanges(bool allowed) {
    TMC_Gr8_apply->setEnabled(allowed);
    TMC_Gr8_Remove->setEnabled(allowed);
}

void TmcTransmission::allowCycleTime(bool allowed) {
    txtCycleTime->setEnabled(allowed);
    lblCycleTime->setEnabled(allowed);
}

}  // namespace kdx
