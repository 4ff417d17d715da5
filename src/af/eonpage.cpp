#include "af/eonpage.h"

#include "af/aflist.h"
#include "af/aflistenform.h"
#include "af/eonlist.h"
#include "af/modul2.h"
#include "base/numbers.h"
#include "link/instrument.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
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
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QScopedValueRollback>

namespace kdx {

namespace {

constexpr int kProgrammeTypes = 32;
constexpr int kAnnouncementMs = 1000;

/// Sets a text box without running its change handler.
void setQuietly(QLineEdit* box, const std::string& bytes) {
    const QSignalBlocker quiet(box);
    box->setText(toText(bytes));
}

}  // namespace

EonPage::EonPage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    m_openEditor = [this] { AF_Listenform(m_with, window()).exec(); };
    create();
    arrange();
}

void EonPage::create() {
    m_programme = new QGroupBox(this);
    EON_PI_Label = named<QLabel>("EON_PI_Label", m_programme);
    EON_PI_Text = named<QLineEdit>("EON_PI_Text", m_programme);
    connect(EON_PI_Text, &QLineEdit::textChanged, this, &EonPage::EON_PI_Text_Change);
    EON_PI_Taste = named<QPushButton>("EON_PI_Taste", m_programme);
    connect(EON_PI_Taste, &QPushButton::clicked, this, &EonPage::EON_PI_Taste_Click);
    EON_PS_LABEL = named<QLabel>("EON_PS_LABEL", m_programme);
    EON_PS_Text = named<QLineEdit>("EON_PS_Text", m_programme);
    connect(EON_PS_Text, &QLineEdit::textChanged, this, &EonPage::EON_PS_Text_Change);
    EON_PS_Taste = named<QPushButton>("EON_PS_Taste", m_programme);
    connect(EON_PS_Taste, &QPushButton::clicked, this, &EonPage::EON_PS_Taste_Click);
    EON_PTY_LAbel = named<QLabel>("EON_PTY_LAbel", m_programme);
    EON_PTY_Combo = named<QComboBox>("EON_PTY_Combo", m_programme);
    connect(EON_PTY_Combo, &QComboBox::currentIndexChanged, this, &EonPage::EON_PTY_Combo_Change);

    EON_TP_Check = named<QCheckBox>("EON_TP_Check", m_programme);
    connect(EON_TP_Check, &QCheckBox::clicked, this, &EonPage::EON_TP_Check_Click);
    EON_TA_Label = named<QLabel>("EON_TA_Label", m_programme);
    EON_TA_Schalter = named<PictureSwitch>("EON_TA_Schalter", m_with.data, m_programme);
    connect(EON_TA_Schalter, &PictureSwitch::clicked, this, &EonPage::EON_TA_Schalter_Click);
    EON_TA_Zeit = named<Ticker>("EON_TA_Zeit", this);
    EON_TA_Zeit->setPeriod(kAnnouncementMs);
    connect(EON_TA_Zeit, &Ticker::timeout, this, &EonPage::EON_TA_Zeit_Timer);

    Frame3 = named<QGroupBox>("Frame3", this);
    EON_AFB_Opt.create("EON_AFB_Opt", Frame3);
    for (int i = 0; i < kAfLists; ++i) {
        connect(EON_AFB_Opt[static_cast<std::size_t>(i)], &QRadioButton::clicked, this,
                [this, i] { EON_AFB_Opt_Click(i); });
    }
    EON_AF_Bearbeiten = named<QPushButton>("EON_AF_Bearbeiten", Frame3);
    connect(EON_AF_Bearbeiten, &QPushButton::clicked, this, &EonPage::EON_AF_Bearbeiten_Click);
    m_tunedHeading = new QLabel(Frame3);
    Tuned_AFB = named<QLabel>("Tuned_AFB", Frame3);
    Tuned_AFB->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    m_listHeading = new QLabel(Frame3);
    AFB_Liste = named<QListWidget>("AFB_Liste", Frame3);
    EON_AFB_Senden = named<QPushButton>("EON_AFB_Senden", Frame3);
    connect(EON_AFB_Senden, &QPushButton::clicked, this, &EonPage::EON_AFB_Senden_Click);

    EON_PI_Label->setBuddy(EON_PI_Text);
    EON_PS_LABEL->setBuddy(EON_PS_Text);
    EON_PTY_LAbel->setBuddy(EON_PTY_Combo);
    EON_TA_Label->setBuddy(EON_TA_Schalter);
    m_listHeading->setBuddy(AFB_Liste);
    for (QLabel* label : findChildren<QLabel*>()) label->setTextFormat(Qt::PlainText);
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
    for (QRadioButton* option : EON_AFB_Opt) choice->addWidget(option);
    choice->addStretch();
    choice->addWidget(EON_AF_Bearbeiten);
    choice->addWidget(EON_AFB_Senden);

    auto* shown = new QVBoxLayout;
    shown->setSpacing(kGap);
    shown->addWidget(m_tunedHeading);
    shown->addWidget(Tuned_AFB);
    shown->addWidget(m_listHeading);
    shown->addWidget(AFB_Liste, 1);

    auto* lists = new QHBoxLayout(Frame3);
    tighten(lists);
    lists->addLayout(choice, 1);
    lists->addLayout(shown, 1);
}

void EonPage::label() {
    const Captions& captions = m_with.captions;
    const QString send = toText(captions.text(86));
    EON_PI_Taste->setText(send);
    EON_PS_Taste->setText(send);
    EON_AFB_Senden->setText(send);
    Frame3->setTitle(toText(captions.text(87)));
    for (std::size_t i = 0; i < EON_AFB_Opt.size(); ++i) {
        EON_AFB_Opt[i]->setText(toText(captions.text(88) + " " + std::to_string(i + 1)));
    }
    EON_AF_Bearbeiten->setText(toText(captions.text(89)));

    m_programme->setTitle(toText(captions.own(480, "Anderes Programm")));
    EON_PI_Label->setText(toText(captions.own(481, "EON PI")));
    EON_PS_LABEL->setText(toText(captions.own(482, "EON PS")));
    EON_PTY_LAbel->setText(toText(captions.own(483, "EON PTY")));
    EON_TP_Check->setText(toText(captions.own(484, "    EON TP")));
    EON_TP_Check->setToolTip(toText(captions.own(485, "TP OtherNet")));
    EON_TA_Label->setText(toText(captions.own(486, "EON TA")));
    EON_TA_Schalter->setToolTip(toText(captions.own(487, "Gibt den Start EON")));
    m_tunedHeading->setText(toText(captions.own(488, "Sendefrequenz [MHz]")));
    m_listHeading->setText(toText(captions.own(489, "AF [MHz]")));

    EON_PI_Text->setAccessibleName(EON_PI_Label->text());
    EON_PS_Text->setAccessibleName(EON_PS_LABEL->text());
    EON_PTY_Combo->setAccessibleName(EON_PTY_LAbel->text());
    EON_TA_Schalter->setAccessibleName(EON_TA_Label->text());
    Tuned_AFB->setAccessibleName(m_tunedHeading->text());
    AFB_Liste->setAccessibleName(m_listHeading->text());
    // Three buttons of the same text: who cannot see what they stand beside hears it.
    EON_PI_Taste->setAccessibleName(EON_PI_Label->text() + QLatin1Char(' ') + send);
    EON_PS_Taste->setAccessibleName(EON_PS_LABEL->text() + QLatin1Char(' ') + send);
    EON_AFB_Senden->setAccessibleName(Frame3->title() + QLatin1Char(' ') + send);

    const QSignalBlocker quiet(EON_PTY_Combo);
    EON_PTY_Combo->clear();
    for (std::size_t type = 0; type < kProgrammeTypes; ++type) {
        EON_PTY_Combo->addItem(toText(captions.programmeType(type)));
    }
    chooseStoredProgrammeType();
}

void EonPage::chooseStoredProgrammeType() {
    // Data set 1 whatever set is current. The change handler stores the type's name, which reads as the number 0: after
    // such a choice a relabelling and the next start show the first entry.
    const double type = leadingNumber(m_with.data.ReadIni("RDS", "EON_PTY", dataSetFile("1")));
    const QSignalBlocker quiet(EON_PTY_Combo);
    EON_PTY_Combo->setCurrentIndex(type >= 0 && type < kProgrammeTypes ? static_cast<int>(type) : -1);
}

void EonPage::loadDataSet() {
    const auto stored = [this](const char* key) { return m_with.data.ReadIni("RDS", key, dataSetFile("1")); };
    EON_TA_Zeit->setEnabled(false);
    m_with.state.eonIdentifier = stored("EON_PI");
    setQuietly(EON_PI_Text, m_with.state.eonIdentifier);
    // The switch shows off even when the held value is on; the next click then ends that announcement.
    m_eonTa = stored("EON_TA") == "1" ? "1" : "0";
    EON_TA_Schalter->showState(false);
    m_eonPs = stored("EON_PS");
    setQuietly(EON_PS_Text, m_eonPs);
    m_eonTp = stored("EON_TP") == "1" ? "1" : "0";
    EON_TP_Check->setChecked(m_eonTp == "1");
    m_eonPty = stored("EON_PTY");
    chooseStoredProgrammeType();
    const double list = leadingNumber(stored("EON_AFB"));
    EON_AFB_Opt.choose(-1);
    for (int i = 0; i < kAfLists; ++i) {
        if (list != i + 1) continue;
        EON_AFB_Opt.choose(i);
        EON_AFB_Opt_Click(i);
    }
    // "EON_DEL", which is written by hand only, belongs to this page too, but no control shows it and nothing uses it.
}

void EonPage::EON_PI_Text_Change() {
    m_with.state.eonIdentifier = toBytes(EON_PI_Text->text());
    store("EON_PI", m_with.state.eonIdentifier);
}

void EonPage::EON_PI_Taste_Click() {
    m_with.params.SendParam("EON_DEL", firstNetwork(m_with.instrument.X4_Abfrage("EON-PI", "EON PI?")));
    m_with.params.SendParam("EON_PI", m_with.state.eonIdentifier);
}

void EonPage::EON_PS_Text_Change() {
    m_eonPs = toBytes(EON_PS_Text->text());
}

void EonPage::EON_PS_Taste_Click() {
    store("EON_PS", m_eonPs);
    m_with.params.SendParam("EON_PS", m_eonPs);
}

void EonPage::EON_PTY_Combo_Change() {
    m_eonPty = toBytes(EON_PTY_Combo->currentText());
    store("EON_PTY", m_eonPty);
    // Under the key of the PI, so that the coder gets the name's first 4 characters as one: the type itself never
    // reaches it. It is left so on purpose, for set-ups that live with it.
    m_with.params.SendParam("EON_PI", m_eonPty);
}

void EonPage::EON_TP_Check_Click() {
    m_eonTp = EON_TP_Check->isChecked() ? "1" : "0";
    store("EON_TP", m_eonTp);
    m_with.params.SendParam("EON_TP", m_eonTp);
}

void EonPage::EON_TA_Schalter_Click() {
    const QScopedValueRollback<bool> switching(m_switchingTa, true);
    if (!mayAnnounce() || m_eonTp != "1") return;
    const bool on = m_eonTa != "1";
    m_eonTa = on ? "1" : "0";
    EON_TA_Schalter->showState(on);
    EON_TA_Zeit->setEnabled(on);
    m_with.params.SendParam("EON_TA", m_eonTa);
    store("EON_TA", m_eonTa);
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
    m_with.dialogs.message(Dialogs::Icon::Exclamation, toText(m_with.captions.text(167)),
                           toText(m_with.captions.text(reason)));
    return false;
}

void EonPage::EON_TA_Zeit_Timer() {
    // The timer goes on while a box is open; a tick must not open a second box over the first one every second.
    if (!m_switchingTa) EON_TA_Schalter_Click();
}

void EonPage::EON_AFB_Opt_Click(int index) {
    FillAfLists(*AFB_Liste, *Tuned_AFB, storedList(index + 1));
}

void EonPage::EON_AF_Bearbeiten_Click() {
    m_with.state.afEditorKind = kEonAfKind;
    m_openEditor();
    if (EON_AFB_Opt.chosen() >= 0) EON_AFB_Opt_Click(EON_AFB_Opt.chosen());
}

void EonPage::EON_AFB_Senden_Click() {
    for (int number = 1; number <= kAfLists; ++number) {
        const std::string list = storedList(number);
        if (list.empty()) continue;
        m_with.params.SendParam("EON_AFB" + std::to_string(number), eonAfValue(list, number));
    }
}

int EonPage::removeNetworks() {
    std::vector<std::string> networks = networksToDelete(m_with.instrument.X4_Abfrage("EON-PI", "EON PI?"));
    for (std::string& network : networks) m_with.params.SendParam("EON_DEL", network);
    return static_cast<int>(networks.size());
}

int EonPage::listsToSend() const {
    int lists = 0;
    for (int number = 1; number <= kAfLists; ++number) lists += storedList(number).empty() ? 0 : 1;
    return lists;
}

void EonPage::sendNetwork() {
    m_with.params.SendParam("EON_PI", m_with.state.eonIdentifier);
    m_with.params.SendParam("EON_TA", m_eonTa);
    m_with.params.SendParam("EON_TP", m_eonTp);
    m_with.params.SendParam("EON_PS", m_eonPs);
    EON_AFB_Senden_Click();
}

void EonPage::store(const char* key, const std::string& value) {
    m_with.data.WriteIni("RDS", key, value, dataSetFile(m_with.state.CurrentDataSet));
}

std::string EonPage::storedList(int number) const {
    return m_with.data.ReadIni("RDS", afListKey(kEonAfKind, number), dataSetFile(m_with.state.CurrentDataSet));
}

}  // namespace kdx
