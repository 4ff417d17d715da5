#include "af/eonpage.h"

#include "af/aflistenform.h"
#include "af/othernetwork.h"
#include "af/settings.h"
#include "coder/sendparam.h"
#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "ui/dialogs.h"
#include "ui/pictureswitch.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"

#include <QBoxLayout>
#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>
#include <QScopedValueRollback>

namespace kdx {

namespace {

constexpr int kAnnouncementMs = 1000;

/// Sets a text box without running its change handler.
void setQuietly(QLineEdit* box, const std::string& bytes) {
    const QSignalBlocker quiet(box);
    box->setText(toText(bytes));
}

}  // namespace

EonPage::EonPage(const PageContext& with, OtherNetwork& network, QWidget* parent)
    : Page(with, parent), m_network(network) {
    m_openEditor = [this] { AF_Listenform(m_with, window()).exec(); };
    create();
    arrange();
}

void EonPage::create() {
    createProgramme();
    createLists();
    for (QLabel* label : findChildren<QLabel*>()) label->setTextFormat(Qt::PlainText);
}

void EonPage::createProgramme() {
    m_programme = new QGroupBox(this);
    m_book.text(m_programme, {480, "Anderes Programm"});
    const auto heads = [this](QLabel* heading, QWidget* control) {
        heading->setBuddy(control);
        m_book.spokenAs(control, heading);
    };

    EON_PI_Label = captioned<QLabel>("EON_PI_Label", {481, "EON PI"}, m_programme);
    EON_PI_Text = named<QLineEdit>("EON_PI_Text", m_programme);
    heads(EON_PI_Label, EON_PI_Text);
    connect(EON_PI_Text, &QLineEdit::textChanged, this, &EonPage::EON_PI_Text_Change);
    EON_PI_Taste = captioned<QPushButton>("EON_PI_Taste", {86}, m_programme);
    m_book.spokenAs(EON_PI_Taste, EON_PI_Label);  // of three of the same text, heard with what it stands at
    connect(EON_PI_Taste, &QPushButton::clicked, this, &EonPage::EON_PI_Taste_Click);

    EON_PS_LABEL = captioned<QLabel>("EON_PS_LABEL", {482, "EON PS"}, m_programme);
    EON_PS_Text = named<QLineEdit>("EON_PS_Text", m_programme);
    heads(EON_PS_LABEL, EON_PS_Text);
    connect(EON_PS_Text, &QLineEdit::textChanged, this, &EonPage::EON_PS_Text_Change);
    EON_PS_Taste = captioned<QPushButton>("EON_PS_Taste", {86}, m_programme);
    m_book.spokenAs(EON_PS_Taste, EON_PS_LABEL);
    connect(EON_PS_Taste, &QPushButton::clicked, this, &EonPage::EON_PS_Taste_Click);

    EON_PTY_LAbel = captioned<QLabel>("EON_PTY_LAbel", {483, "EON PTY"}, m_programme);
    EON_PTY_Combo = named<QComboBox>("EON_PTY_Combo", m_programme);
    heads(EON_PTY_LAbel, EON_PTY_Combo);
    connect(EON_PTY_Combo, &QComboBox::currentIndexChanged, this, &EonPage::EON_PTY_Combo_Change);

    EON_TP_Check = captioned<QCheckBox>("EON_TP_Check", {484, "    EON TP"}, m_programme);
    m_book.tip(EON_TP_Check, {485, "TP OtherNet"});
    connect(EON_TP_Check, &QCheckBox::clicked, this, &EonPage::EON_TP_Check_Click);

    EON_TA_Label = captioned<QLabel>("EON_TA_Label", {486, "EON TA"}, m_programme);
    EON_TA_Schalter = named<PictureSwitch>("EON_TA_Schalter", m_with.data, m_programme);
    m_book.tip(EON_TA_Schalter, {487, "Gibt den Start EON"});
    heads(EON_TA_Label, EON_TA_Schalter);
    connect(EON_TA_Schalter, &PictureSwitch::clicked, this, &EonPage::EON_TA_Schalter_Click);
    EON_TA_Zeit = named<Ticker>("EON_TA_Zeit", m_with.tickers, this);
    EON_TA_Zeit->setPeriod(kAnnouncementMs);
    connect(EON_TA_Zeit, &Ticker::timeout, this, &EonPage::EON_TA_Zeit_Timer);
}

void EonPage::createLists() {
    Frame3 = captioned<QGroupBox>("Frame3", {87}, this);
    m_view.createOptions("EON_AFB_Opt", 88, m_book, Frame3);
    m_view.options().onClick(this, &EonPage::EON_AFB_Opt_Click);
    EON_AF_Bearbeiten = captioned<QPushButton>("EON_AF_Bearbeiten", {89}, Frame3);
    connect(EON_AF_Bearbeiten, &QPushButton::clicked, this, &EonPage::EON_AF_Bearbeiten_Click);
    m_view.createContent({"Tuned_AFB", {488, "Sendefrequenz [MHz]"}}, {"AFB_Liste", {489, "AF [MHz]"}}, m_book, Frame3);
    EON_AFB_Senden = captioned<QPushButton>("EON_AFB_Senden", {86}, Frame3);
    m_book.spokenAs(EON_AFB_Senden, Frame3);
    connect(EON_AFB_Senden, &QPushButton::clicked, this, &EonPage::EON_AFB_Senden_Click);
}

void EonPage::arrange() {
    arrangeProgramme();
    arrangeLists();

    // What the network is on the left, where it can be received on the right; there the list takes the room left over.
    auto* page = new QHBoxLayout(this);
    tighten(page, kPageMargin);
    page->addWidget(m_programme, 1);
    page->addWidget(Frame3, 1);
}

void EonPage::arrangeProgramme() {
    auto* programme = new QGridLayout(m_programme);
    tighten(programme);
    programme->setVerticalSpacing(2 * kGap);
    programme->addWidget(EON_PI_Label, 0, 0);
    programme->addWidget(EON_PI_Text, 0, 1);
    programme->addWidget(EON_PI_Taste, 0, 2);
    programme->addWidget(EON_PS_LABEL, 1, 0);
    programme->addWidget(EON_PS_Text, 1, 1);
    programme->addWidget(EON_PS_Taste, 1, 2);
    programme->addWidget(EON_PTY_LAbel, 2, 0);
    programme->addWidget(EON_PTY_Combo, 2, 1, 1, 2);
    programme->addWidget(EON_TP_Check, 3, 1, 1, 2);
    programme->addWidget(EON_TA_Label, 4, 0);
    programme->addWidget(EON_TA_Schalter, 4, 1, 1, 2, Qt::AlignLeft);
    programme->setColumnStretch(1, 1);
    programme->setRowStretch(5, 1);
}

void EonPage::arrangeLists() {
    auto* choice = new QVBoxLayout;
    choice->setSpacing(kGap);
    m_view.arrangeOptions(choice);
    choice->addWidget(EON_AF_Bearbeiten);
    choice->addWidget(EON_AFB_Senden);

    auto* shown = new QVBoxLayout;
    shown->setSpacing(kGap);
    m_view.arrangeContent(shown);

    auto* lists = new QHBoxLayout(Frame3);
    tighten(lists);
    lists->addLayout(choice, 1);
    lists->addLayout(shown, 1);
}

void EonPage::label() {
    Page::label();
    const QSignalBlocker quiet(EON_PTY_Combo);
    EON_PTY_Combo->clear();
    for (std::size_t type = 0; type < kProgrammeTypes; ++type) {
        EON_PTY_Combo->addItem(toText(m_with.captions.programmeType(type)));
    }
    chooseStoredProgrammeType();
}

void EonPage::chooseStoredProgrammeType() {
    // The change handler stores the type's name, which reads as the number 0: after such a choice a relabelling and the
    // next start show the first entry.
    const QSignalBlocker quiet(EON_PTY_Combo);
    EON_PTY_Combo->setCurrentIndex(storedEntry(m_with.profile.read(setting::kEonPtyShown), kProgrammeTypes));
}

void EonPage::load() {
    holdPi(m_network.pi);
    setQuietly(EON_PI_Text, m_network.pi);
    setQuietly(EON_PS_Text, m_network.ps);
    EON_TP_Check->setChecked(m_network.tp == "1");
    // The switch shows off even when the held value is on; the next click then ends that announcement.
    EON_TA_Schalter->showState(false);
    EON_TA_Zeit->setEnabled(false);
    chooseStoredProgrammeType();
    m_view.chooseStored(m_with.profile.read(setting::kShownEonAfList));
    if (const int chosen = m_view.options().chosen(); chosen >= 0) EON_AFB_Opt_Click(chosen);
}

/// Every EON command is led by the program-wide identifier, which is this network's PI always.
void EonPage::holdPi(const std::string& pi) {
    m_network.pi = pi;
    m_with.state.eonIdentifier = m_network.pi;
}

void EonPage::EON_PI_Text_Change() {
    holdPi(toBytes(EON_PI_Text->text()));
    m_with.profile.write(setting::kEonPi.place, m_network.pi);
}

void EonPage::EON_PI_Taste_Click() {
    m_with.params.SendParam(setting::kEonRemoval, firstNetwork(m_with.instrument.X4_Abfrage("EON-PI", "EON PI?")));
    m_with.params.SendParam(setting::kEonPi.sendKey, m_network.pi);
}

void EonPage::EON_PS_Text_Change() {
    m_network.ps = toBytes(EON_PS_Text->text());
}

void EonPage::EON_PS_Taste_Click() {
    m_with.profile.write(setting::kEonPs.place, m_network.ps);
    m_with.params.SendParam(setting::kEonPs.sendKey, m_network.ps);
}

void EonPage::EON_PTY_Combo_Change() {
    m_network.pty = toBytes(EON_PTY_Combo->currentText());
    m_with.profile.write(setting::kEonPty.place, m_network.pty);
    m_with.params.SendParam(setting::kEonPty.sendKey, m_network.pty);
}

void EonPage::EON_TP_Check_Click() {
    m_network.tp = EON_TP_Check->isChecked() ? "1" : "0";
    m_with.profile.write(setting::kEonTp.place, m_network.tp);
    m_with.params.SendParam(setting::kEonTp.sendKey, m_network.tp);
}

void EonPage::EON_TA_Schalter_Click() {
    const QScopedValueRollback<bool> switching(m_switchingTa, true);
    if (!mayAnnounce() || m_network.tp != "1") return;
    const bool on = m_network.ta != "1";
    m_network.ta = on ? "1" : "0";
    EON_TA_Schalter->showState(on);
    EON_TA_Zeit->setEnabled(on);
    m_with.params.SendParam(setting::kEonTa.sendKey, m_network.ta);
    m_with.profile.write(setting::kEonTa.place, m_network.ta);
}

/// Whether the own programme's indicators allow an announcement of the other network; tells the user why not. They are
/// compared by the words they read.
bool EonPage::mayAnnounce() {
    const bool german = m_with.state.language == "deutsch";
    const QString on = german ? QStringLiteral("ein") : QStringLiteral("on");
    const QString off = german ? QStringLiteral("aus") : QStringLiteral("off");
    int reason = 0;
    if (m_with.status.text(StatusSlot::Tp) == on) {
        reason = 168;
    } else if (m_with.status.text(StatusSlot::Ta) == off) {
        reason = 169;
    }
    if (reason == 0) return true;
    m_with.dialogs.message(Dialogs::Icon::Exclamation, caption({167}), caption({reason}));
    return false;
}

void EonPage::EON_TA_Zeit_Timer() {
    // The timer goes on while a box is open; a tick must not open a second box over the first one every second.
    if (!m_switchingTa) EON_TA_Schalter_Click();
}

void EonPage::EON_AFB_Opt_Click(int index) {
    m_network.loadLists(m_with.profile);
    m_view.show(m_network.lists.at(static_cast<std::size_t>(index)));
}

void EonPage::EON_AF_Bearbeiten_Click() {
    m_with.state.afEditorKind = kEonAfKind;
    m_openEditor();
    if (const int chosen = m_view.options().chosen(); chosen >= 0) EON_AFB_Opt_Click(chosen);
}

void EonPage::EON_AFB_Senden_Click() {
    m_network.loadLists(m_with.profile);
    Steps steps;
    m_network.appendListSteps(steps);
    send(steps);
}

}  // namespace kdx
