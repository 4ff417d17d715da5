#include "af/eonpage.h"

#include "af/aflistenform.h"
#include "af/othernetwork.h"
#include "af/settings.h"
#include "coder/sendparam.h"
#include "link/commandsequence.h"
#include "settings/captions.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "settings/withoutcontrols.h"
#include "ui/dialogs.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"
#include "ui/pictureswitch.h"
#include "ui/sententry.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/tick.h"

#include <QScopedValueRollback>

namespace kdx {

namespace {

constexpr int kAnnouncementMs = 1000;

/// Sets a text box without running its change handler.
void setQuietly(SentEntry* box, const std::string& bytes) {
    const QSignalBlocker quiet(box);
    box->setText(toText(bytes));
    box->refresh();
}

}  // namespace

EonPage::EonPage(const PageContext& with, OtherNetwork& network, QWidget* parent)
    : Page(with, parent),
      m_network(network),
      m_announcing(
          with.tickers.automatics(), [this] { return EON_TA_Label->text(); }, [this] { setAnnouncing(false); },
          [this] {
              if (!m_announcing.runs()) return;
              setAnnouncing(false);
              sendAndStore(setting::kEonTa, m_network.ta);
          }) {
    m_openEditor = [this] { AF_Listenform(m_with, window()).exec(); };
    create();
    arrange();
}

void EonPage::create() {
    createProgramme();
    createLists();
}

void EonPage::createProgramme() {
    m_programme = captioned<QGroupBox>("", {480, "Anderes Programm"}, this);

    EON_PI_Text = wired<SentEntry>("EON_PI_Text", &QLineEdit::textChanged, &EonPage::EON_PI_Text_Change, m_with,
                                   setting::kEonPi.sendKey, m_programme);
    EON_PI_Label = heading("EON_PI_Label", {481, "EON PI"}, EON_PI_Text);
    EON_PI_Taste = clicked<QPushButton>("EON_PI_Taste", {86}, m_programme, &EonPage::EON_PI_Taste_Click);
    m_book.spokenAs(EON_PI_Taste, EON_PI_Label);  // of three of the same text, heard with what it stands at

    EON_PS_Text = wired<SentEntry>("EON_PS_Text", &QLineEdit::textChanged, &EonPage::EON_PS_Text_Change, m_with,
                                   setting::kEonPs.sendKey, m_programme);
    EON_PS_LABEL = heading("EON_PS_LABEL", {482, "EON PS"}, EON_PS_Text);
    EON_PS_Taste = clicked<QPushButton>("EON_PS_Taste", {86}, m_programme, &EonPage::EON_PS_Taste_Click);
    m_book.spokenAs(EON_PS_Taste, EON_PS_LABEL);

    connect(EON_PI_Text, &QLineEdit::returnPressed, EON_PI_Taste, &QPushButton::click);
    connect(EON_PS_Text, &QLineEdit::returnPressed, EON_PS_Taste, &QPushButton::click);

    EON_PTY_Combo =
        wired<QComboBox>("EON_PTY_Combo", &QComboBox::currentIndexChanged, &EonPage::EON_PTY_Combo_Change, m_programme);
    EON_PTY_LAbel = heading("EON_PTY_LAbel", {483, "EON PTY"}, EON_PTY_Combo);

    EON_TP_Check = clicked<QCheckBox>("EON_TP_Check", {484, "    EON TP"}, m_programme, &EonPage::EON_TP_Check_Click);
    m_book.tip(EON_TP_Check, {485, "TP OtherNet"});

    EON_TA_Schalter = wired<PictureSwitch>("EON_TA_Schalter", &PictureSwitch::clicked, &EonPage::EON_TA_Schalter_Click,
                                           m_with.data, m_programme);
    m_book.tip(EON_TA_Schalter, {487, "Gibt den Start EON"});
    m_with.marks.add(setting::kEonType, EON_PTY_Combo);
    m_with.marks.add(setting::kEonTp.sendKey, EON_TP_Check);
    m_with.marks.add(setting::kEonTa.sendKey, EON_TA_Schalter);
    EON_TA_Label = heading("EON_TA_Label", {486, "EON TA"}, EON_TA_Schalter);
    EON_TA_Zeit = timer("EON_TA_Zeit", kAnnouncementMs, &EonPage::EON_TA_Zeit_Timer);
}

void EonPage::createLists() {
    Frame3 = captioned<QGroupBox>("Frame3", {87}, this);
    m_view.createOptions("EON_AFB_Opt", 88, m_book, Frame3);
    m_view.options().onClick(this, &EonPage::EON_AFB_Opt_Click);
    for (const Setting& list : setting::kEonAfLists)
        m_with.marks.watch(list.sendKey, this, [this](const Judgement&) { markList(); });
    EON_AF_Bearbeiten = clicked<QPushButton>("EON_AF_Bearbeiten", {89}, Frame3, &EonPage::EON_AF_Bearbeiten_Click);
    m_view.createContent(named<QLabel>("Tuned_AFB", Frame3), {488, "Sendefrequenz [MHz]"}, "AFB_Liste",
                         {489, "AF [MHz]"}, m_book);
    EON_AFB_Senden = clicked<QPushButton>("EON_AFB_Senden", {86}, Frame3, &EonPage::EON_AFB_Senden_Click);
    m_book.spokenAs(EON_AFB_Senden, Frame3);
}

void EonPage::arrange() {
    auto* programme = grid({{EON_PI_Label, EON_PI_Text, EON_PI_Taste},
                            {EON_PS_LABEL, EON_PS_Text, EON_PS_Taste},
                            {EON_PTY_LAbel, {EON_PTY_Combo, 2}},
                            {{}, {EON_TP_Check, 2}},
                            {EON_TA_Label, {EON_TA_Schalter, 2, Qt::AlignLeft}}});
    programme->setVerticalSpacing(2 * kGap);
    programme->setColumnStretch(1, 1);
    programme->setRowStretch(5, 1);
    layOut(m_programme, programme);

    auto* choice = add(m_view.optionColumn(), {EON_AF_Bearbeiten, EON_AFB_Senden});
    layOut(Frame3, row({{choice, 1}, {m_view.contentColumn(), 1}}));
    // What the network is on the left, where it can be received on the right; there the list takes the room left over.
    layOut(this, row({{m_programme, 1}, {Frame3, 1}}), kPageMargin);
}

void EonPage::label() {
    Page::label();
    showStoredProgrammeType();
    for (SentEntry* entry : {EON_PI_Text, EON_PS_Text}) entry->refresh();
}

void EonPage::showStoredProgrammeType() {
    // The change handler stores the type's name, which reads as the number 0: after such a choice a relabelling and the
    // next start show the first entry, unless that is corrected.
    const Place& shown = m_with.state.dataSetChosen ? setting::kEonPty.place : setting::kEonPtyShown;
    showProgrammeTypes(EON_PTY_Combo, shown);
    if (!m_with.state.corrections.eonType) return;
    const std::string number = programmeTypeNumber(m_with.profile.read(shown), m_with.captions);
    const QSignalBlocker quiet(EON_PTY_Combo);
    if (!number.empty()) EON_PTY_Combo->setCurrentIndex(storedEntry(number, kProgrammeTypes));
}

void EonPage::load() {
    holdPi(m_network.pi);
    setQuietly(EON_PI_Text, m_network.pi);
    setQuietly(EON_PS_Text, m_network.ps);
    EON_TP_Check->setChecked(m_network.tp == "1");
    // The switch shows off even when the held value is on; the next click then ends that announcement.
    EON_TA_Schalter->showState(false);
    EON_TA_Zeit->setEnabled(false);
    showStoredProgrammeType();
    m_view.chooseStored(m_with.profile.read(setting::kShownEonAfList));
    if (const int chosen = m_view.options().chosen(); chosen >= 0) EON_AFB_Opt_Click(chosen);
}

void EonPage::showDataSet() {
    // Still led by the old network's identifier; nothing else would end what was announced there.
    if (EON_TA_Zeit->isEnabled()) m_with.params.SendParam(setting::kEonTa.sendKey, "0");
    EonPage::load();
    m_with.marks.shows(setting::kEonType, m_network.pty);
    m_with.marks.shows(setting::kEonTp.sendKey, m_network.tp);
    m_with.marks.forget(setting::kEonTa.sendKey);
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
    const CommandSequence sequence(m_with.instrument);
    holdPi(withoutControls(m_network.pi));  // the data set may hold what cannot be typed
    const auto& [label, key] = setting::kHeldNetworks;
    m_with.params.SendParam(setting::kEonRemoval, firstNetwork(m_with.instrument.X4_Abfrage(label, key)));
    m_with.params.SendParam(setting::kEonPi.sendKey, m_network.pi);
    EON_PI_Text->wentOut(m_network.pi);
    forgetNetwork();
    if (m_network.tp == "1") m_with.marks.shows(setting::kEonTp.sendKey, m_network.tp);
    judgeLists();
}

void EonPage::forgetNetwork() {
    EON_PS_Text->forget();
    for (const char* key : {setting::kEonType, setting::kEonTp.sendKey, setting::kEonTa.sendKey})
        m_with.marks.forget(key);
    for (const Setting& list : setting::kEonAfLists) m_with.marks.forget(list.sendKey);
}

void EonPage::EON_PS_Text_Change() {
    m_network.ps = toBytes(EON_PS_Text->text());
}

void EonPage::EON_PS_Taste_Click() {
    m_network.ps = withoutControls(m_network.ps);
    storeText(setting::kEonPs, m_network.ps);
    m_with.params.SendParam(setting::kEonPs.sendKey, m_network.ps);
    EON_PS_Text->wentOut(m_network.ps);
}

void EonPage::stepGoesOut(const Step& step) {
    if (step.key == setting::kEonPi.sendKey) {
        EON_PI_Text->goesOut(step.value);
        forgetNetwork();
    } else if (step.key == setting::kEonPs.sendKey) {
        EON_PS_Text->goesOut(step.value);
    }
}

void EonPage::stepFailed(const Step& step) {
    if (step.key == setting::kEonPi.sendKey) EON_PI_Text->forget();
    if (step.key == setting::kEonPs.sendKey) EON_PS_Text->forget();
}

void EonPage::EON_PTY_Combo_Change() {
    const bool corrected = m_with.state.corrections.eonType;
    m_network.pty = corrected ? std::to_string(EON_PTY_Combo->currentIndex()) : toBytes(EON_PTY_Combo->currentText());
    m_with.profile.write(setting::kEonPty.place, m_network.pty);
    m_with.params.SendParam(corrected ? setting::kEonType : setting::kEonPty.sendKey, m_network.pty);
    if (!corrected) m_with.marks.sentUnder(setting::kEonPty.sendKey, setting::kEonType);
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
    setAnnouncing(on);
    sendAndStore(setting::kEonTa, m_network.ta);
}

void EonPage::setAnnouncing(bool on) {
    m_network.ta = on ? "1" : "0";
    EON_TA_Schalter->showState(on);
    EON_TA_Zeit->setEnabled(on);
    m_announcing.setRunning(on);
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
    if (Tick* const tick = m_with.tickers.tick()) {
        tick->tell(Dialogs::Icon::Exclamation, caption({167}), caption({reason}));
    } else {
        m_with.dialogs.message(Dialogs::Icon::Exclamation, caption({167}), caption({reason}));
    }
    return false;
}

void EonPage::EON_TA_Zeit_Timer() {
    // The timer goes on while a box is open; a tick must not open a second box over the first one every second.
    if (m_switchingTa) return;
    const Tick tick(m_with, EON_TA_Label->text(), [this] {
        setAnnouncing(false);
        m_with.profile.write(setting::kEonTa.place, m_network.ta);
    });
    EON_TA_Schalter_Click();
}

void EonPage::EON_AFB_Opt_Click(int index) {
    m_network.loadLists(m_with.profile);
    m_view.show(m_network.lists.at(static_cast<std::size_t>(index)));
    judgeLists();
}

void EonPage::judgeLists() {
    for (std::size_t i = 0; i < m_network.lists.size(); ++i) {
        const std::string& list = m_network.lists[i];
        const char* const key = setting::kEonAfLists.at(i).sendKey;
        if (list.empty()) {
            m_with.marks.forget(key);
        } else {
            m_with.marks.shows(key, newOrFurtherList(static_cast<int>(i) + 1) + list);
        }
    }
    markList();
}

void EonPage::markList() {
    const int chosen = m_view.options().chosen();
    if (chosen >= 0) m_view.mark(m_with.marks.judge(setting::kEonAfLists.at(static_cast<std::size_t>(chosen)).sendKey));
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
    judgeLists();  // not all may have gone out
}

}  // namespace kdx
