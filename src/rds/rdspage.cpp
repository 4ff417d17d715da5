#include "rds/rdspage.h"

#include <utility>

#include "base/clock.h"
#include "coder/sendparam.h"
#include "rds/dynamicps.h"
#include "rds/settings.h"
#include "rds/taframe.h"
#include "settings/captions.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "settings/withoutcontrols.h"
#include "ui/dialogs.h"
#include "ui/entrycounter.h"
#include "ui/keymarks.h"
#include "ui/statusrow.h"
#include "ui/tick.h"

namespace kdx {

namespace {

constexpr int kClockRepeatMs = 20000;

}  // namespace

void RdsPage::label() {
    Page::label();
    m_dynamicPs->label();
    if (m_clockShowsWord) showClock(caption({193}));
    m_ta->label();
    if (m_shownTrafficProgramme) showTrafficProgramme(*m_shownTrafficProgramme);
    if (!m_programme.musicSpeech.empty()) showMusicSpeech();
    fillProgrammeTypes();
    for (SentEntry* entry : {PS_T, PI_T, RT_Text1}) entry->refresh();
    for (EntryCounter* counter : {PS_Zaehler, PI_Zaehler, RT_Zaehler}) counter->count();
}

void RdsPage::fillProgrammeTypes() {
    showProgrammeTypes(PTY_Combo1, setting::kPty.place);
    // The stored type of data set 1 is put in force, unless the user chose a set: its type is in force then.
    if (!m_with.state.dataSetChosen) m_programme.pty = std::to_string(PTY_Combo1->currentIndex());
    m_with.marks.shows(setting::kPty.sendKey, m_programme.pty);
    showProgrammeType();
}

void RdsPage::showProgrammeType() {
    PTY_Combo1->setCurrentIndex(storedEntry(m_programme.pty, kProgrammeTypes));
    if (PTY_Combo1->currentIndex() < 0) return;
    m_with.status.show(StatusSlot::Pty, PTY_Combo1->currentText(), m_sentPty.judge(m_programme.pty));
}

void RdsPage::load() {
    m_ta->load();
    m_dynamicPs->showStopped();
    showProgramme();
    if (!std::exchange(m_loaded, true)) Zeit_Taste_Click();
}

void RdsPage::showDataSet() {
    // What the set says nothing about must not stay from the one before.
    m_with.status.show(StatusSlot::MusicSpeech, QString());
    m_with.status.show(StatusSlot::Pty, QString());
    showProgramme();
    m_with.marks.shows(setting::kMusicSpeech.sendKey, m_programme.musicSpeech);
    m_with.marks.shows(setting::kDecoderInfo.sendKey, m_programme.decoderInfo);
    m_with.marks.shows(setting::kPty.sendKey, m_programme.pty);
}

void RdsPage::showProgramme() {
    PS_T->setText(toText(m_with.profile.read(setting::kPs.place)));  // whole, also what is too long to be sent
    showValue(StatusSlot::Ps, PS_T, m_programme.ps);
    m_dynamicPs->showStopped();
    PI_T->setText(toText(m_programme.pi));
    showValue(StatusSlot::Pi, PI_T, m_programme.pi);
    RT_Text1->setText(toText(m_programme.radiotext));
    // The second text has no entry of its own.
    const std::string second = m_with.profile.read(setting::kSecondRadiotext);
    RT_Text1->setToolTip(second.empty() ? QString() : toText("RTB: " + second));
    const bool chosen = !m_programme.musicSpeech.empty();
    MS_opt.choose(chosen ? (m_programme.musicSpeech == "M" ? 0 : 1) : -1);
    if (chosen) showMusicSpeech();
    DI_Opt.choose(storedOption(m_programme.decoderInfo, 0, static_cast<int>(DI_Opt.size()) - 1));
    showProgrammeType();
}

void RdsPage::stepGoesOut(const Step& step) {
    if (step.key == setting::kTrafficProgramme) setTrafficProgramme(step.value == "1");
    m_ta->stepGoesOut(step);
    if (step.key == setting::kPs.sendKey) {
        PS_T->goesOut(step.value);
        showValue(StatusSlot::Ps, PS_T, step.value);
    } else if (step.key == setting::kPi.sendKey) {
        PI_T->goesOut(step.value);
        showValue(StatusSlot::Pi, PI_T, step.value);
    } else if (step.key == setting::kRadiotext.sendKey) {
        RT_Text1->goesOut(step.value);
    } else if (step.key == setting::kMusicSpeech.sendKey && !step.value.empty()) {
        m_sentMusicSpeech.goesOut(step.value);
        showMusicSpeech();
    } else if (step.key == setting::kPty.sendKey) {
        m_sentPty.goesOut(step.value);
        showProgrammeType();
    }
}

void RdsPage::stepFailed(const Step& step) {
    if (step.key == setting::kPs.sendKey) {
        PS_T->forget();
        showValue(StatusSlot::Ps, PS_T, step.value);
    } else if (step.key == setting::kPi.sendKey) {
        PI_T->forget();
        showValue(StatusSlot::Pi, PI_T, step.value);
    } else if (step.key == setting::kRadiotext.sendKey) {
        RT_Text1->forget();
    } else if (step.key == setting::kMusicSpeech.sendKey && !step.value.empty()) {
        m_sentMusicSpeech.forget();
        showMusicSpeech();
    } else if (step.key == setting::kPty.sendKey) {
        m_sentPty.forget();
        showProgrammeType();
    }
}

void RdsPage::showValue(StatusSlot slot, const SentEntry* entry, const std::string& value) {
    m_with.status.show(slot, value, entry->judge(value));
}

// What a data set holds goes out as it stands with the whole set; the button beside an entry sends what could be typed
// there.
void RdsPage::PS_Taste_Click() {
    m_programme.ps = withoutControls(toBytes(PS_T->text())).substr(0, kPsLength);
    m_with.params.SendParam(setting::kPs.sendKey, std::string(m_programme.ps));
    storeText(setting::kPs, m_programme.ps);
    PS_T->wentOut(m_programme.ps);
    showValue(StatusSlot::Ps, PS_T, m_programme.ps);
}

void RdsPage::Command3_Click() {
    m_programme.pi = withoutControls(m_programme.pi);
    m_with.params.SendParam(setting::kPi.sendKey, m_programme.pi);  // which gives it its four characters
    m_with.profile.write(setting::kPi.place, withoutControls(toBytes(PI_T->text())));
    PI_T->wentOut(m_programme.pi);
    showValue(StatusSlot::Pi, PI_T, toBytes(PI_T->text()));
}

void RdsPage::PTY_Combo1_Click() {
    m_programme.pty = std::to_string(PTY_Combo1->currentIndex());
    sendAndStore(setting::kPty, m_programme.pty);
    m_sentPty.wentOut(m_programme.pty);
    showProgrammeType();
}

void RdsPage::Check1_Click() {
    m_programme.trafficProgramme = Check1->isChecked() ? "1" : "0";
    setTrafficProgramme(Check1->isChecked());
    m_with.params.SendParam(setting::kTrafficProgramme, m_programme.trafficProgramme);
}

void RdsPage::MS_opt_Click(int index) {
    m_programme.musicSpeech = index == 0 ? "M" : "S";
    sendAndStore(setting::kMusicSpeech, m_programme.musicSpeech);
    m_sentMusicSpeech.wentOut(m_programme.musicSpeech);
    showMusicSpeech();
}

void RdsPage::DI_Opt_Click(int index) {
    m_programme.decoderInfo = std::to_string(index);
    sendAndStore(setting::kDecoderInfo, m_programme.decoderInfo);
}

void RdsPage::RT_Taste1_Click() {
    m_programme.radiotext = withoutControls(m_programme.radiotext);
    storeText(setting::kRadiotext, m_programme.radiotext);
    m_with.params.SendParam(setting::kRadiotext.sendKey, m_programme.radiotext);
    RT_Text1->wentOut(m_programme.radiotext);
}

void RdsPage::RT_clear1_Click() {
    m_with.params.SendParam(setting::kRadiotext.sendKey, "   ");
    RT_Text1->clear();
    RT_Text1->wentOut({});
}

void RdsPage::Zeit_Taste_Click() {
    m_clockOn = !m_clockOn;
    Zeit_Taste->showState(m_clockOn);
    // Switching off sends nothing: the coder's clock runs on with the last time it was given.
    Timer1->setPeriod(kClockRepeatMs);
    showClock(caption({193}));
    m_with.marks.forget(setting::kClock);
    m_clockShowsWord = true;
}

void RdsPage::Timer1_Timer() {
    if (!m_clockOn) return;
    showClock(toText(timeText(m_with.clock)));
    m_clockShowsWord = false;
    const Tick tick(m_with, caption({836, "Uhr"}), [this] { Zeit_Taste_Click(); });
    m_with.params.SendParam(setting::kClock, m_with.state.shownClock);
}

void RdsPage::Uhr_Zeit_DblClick() {
    // A harmless prompt: the answer is not used, the time sent is always the PC's.
    m_with.dialogs.input(caption({397, "Uhrzeit: "}), caption({398, "Zeit eingabe"}), toText(timeText(m_with.clock)));
}

void RdsPage::showMusicSpeech() {
    m_with.status.show(StatusSlot::MusicSpeech, caption({m_programme.musicSpeech == "M" ? 56 : 57}),
                       m_sentMusicSpeech.judge(m_programme.musicSpeech));
}

void RdsPage::setTrafficProgramme(bool on) {
    m_ta->setTrafficProgramme(on);
    showTrafficProgramme(on);
}

void RdsPage::showTrafficProgramme(bool on) {
    m_shownTrafficProgramme = on;
    m_with.status.show(StatusSlot::Tp, caption({on ? 192 : 193}), m_with.marks.judge(setting::kTrafficProgramme));
}

void RdsPage::showClock(const QString& text) {
    Uhr_Zeit->setText(text);
    m_with.state.shownClock = toBytes(text);
}

}  // namespace kdx
