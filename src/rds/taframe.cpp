#include "rds/taframe.h"

#include <algorithm>

#include "base/numbers.h"
#include "coder/sendparam.h"
#include "rds/programme.h"
#include "rds/settings.h"
#include "ui/dialogs.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"
#include "ui/statusrow.h"
#include "ui/tick.h"
#include "ui/valuescrollbar.h"

namespace kdx {

namespace {

const QString kName = QStringLiteral("TA");  // in every language

}  // namespace

TaFrame::TaFrame(const PageContext& with, Programme& programme, QWidget* parent)
    : Page(with, parent),
      m_programme(programme),
      m_automatic(
          with.tickers.automatics(), [] { return kName; }, [this] { endAutomatic(); }, [this] { endAnnouncement(); }) {
    create();
    arrange();
}

void TaFrame::create() {
    Frame1 = captioned<QGroupBox>("Frame1", {47}, this);
    TA_Check = clicked<QCheckBox>("TA_Check", {381, "TA on / off"}, Frame1, &TaFrame::TA_Check_Click);
    TA_Check->setEnabled(false);
    m_with.marks.add(setting::kAnnouncement, TA_Check);
    m_with.marks.watch(setting::kAnnouncement, this, [this](const Judgement&) {
        if (m_statusShown) showAnnouncing(m_announcing);
    });
    TA_EON_Hilfe = clicked<QPushButton>("TA_EON_Hilfe", {385, "EON ?"}, Frame1, &TaFrame::TA_EON_Hilfe_Click);
    createOptions(TA_Option, "TA_Option", {{48}, {383, "&Automatisch"}}, Frame1, &TaFrame::TA_Option_Click);
    TA_Option.choose(0);
    TA_Option[1]->setEnabled(false);
    m_book.tip(TA_Option[0], {382, "TA Single"});
    m_book.tip(TA_Option[1], {384, "TA Repetition"});

    TA_HScroll = createTime("TA_HScroll", 1, 600, &TaFrame::showDuration, &TaFrame::TA_HScroll_Change);
    m_durationTitle = heading("", {386, "Dauer"}, TA_HScroll);
    TA_Zeit_Label = named<QLabel>("TA_Zeit_Label", Frame1);
    TA_Rep_HScroll = createTime("TA_Rep_HScroll", 2, 3600, &TaFrame::showPeriod, &TaFrame::TA_Rep_HScroll_Change);
    m_periodTitle = heading("", {387, "Wiederholung"}, TA_Rep_HScroll);
    TA_Rep_Label = named<QLabel>("TA_Rep_Label", Frame1);

    TA_Timer = timer("TA_Timer", 333, &TaFrame::TA_Timer_Timer);
    TA_Timer->setEnabled(true);
    TA_Rep_Timer = timer("TA_Rep_Timer", 500, &TaFrame::TA_Rep_Timer_Timer);
}

/// A scroll bar for seconds that acts where it comes to rest, not on the way.
QScrollBar* TaFrame::createTime(const char* name, int shortest, int longest, void (TaFrame::*shown)(int),
                                void (TaFrame::*handler)()) {
    auto* bar = named<ValueScrollBar>(name, Frame1);
    bar->setRange(shortest, longest);
    bar->setPageStep(10);
    bar->setMinimumWidth(100);
    connect(bar, &QScrollBar::sliderMoved, this, shown);
    connect(bar, &QScrollBar::valueChanged, this, handler);
    return bar;
}

void TaFrame::arrange() {
    auto* controls = grid({{TA_Check, {TA_EON_Hilfe, 1, Qt::AlignRight}},
                           {TA_Option[0], TA_Option[1]},
                           {m_durationTitle, {TA_Zeit_Label, 1, Qt::AlignRight}},
                           {{TA_HScroll, 2}},
                           {m_periodTitle, {TA_Rep_Label, 1, Qt::AlignRight}},
                           {{TA_Rep_HScroll, 2}}});
    controls->setRowStretch(6, 1);
    layOut(Frame1, controls);
    layOut(this, column({Frame1}), 0);
}

void TaFrame::label() {
    Page::label();
    showDuration(TA_HScroll->sliderPosition());
    showPeriod(TA_Rep_HScroll->sliderPosition());
    if (m_statusShown) showAnnouncing(m_announcing);
}

void TaFrame::load() {
    const auto stored = [this](const Place& place) {
        return static_cast<int>(std::clamp(leadingNumber(m_with.profile.read(place)), 0.0, 1e6));
    };
    const int duration = stored(setting::kAnnouncementSeconds);
    const int period = stored(setting::kRepetitionSeconds);
    setQuietly(TA_Rep_HScroll, period);  // the period first: the duration must not lie above it
    setQuietly(TA_HScroll, std::min(duration, TA_Rep_HScroll->value()));
    showPeriod(TA_Rep_HScroll->value());
    showDuration(TA_HScroll->value());
}

void TaFrame::stepGoesOut(const Step& step) {
    if (step.key != setting::kAnnouncement) return;
    showByHand(step.value == "1");
    // The end of the announcement frees the automatic; without a traffic programme it stays locked.
    if (m_programme.trafficProgramme != "1") setTrafficProgramme(false);
}

void TaFrame::setTrafficProgramme(bool on) {
    TA_Option[0]->setEnabled(true);
    TA_Option[1]->setEnabled(on);
    TA_Check->setEnabled(on);
}

void TaFrame::TA_Check_Click() {
    m_programme.announcement = TA_Check->isChecked() ? "1" : "0";
    showByHand(TA_Check->isChecked());
    sendTa(m_programme.announcement);
}

void TaFrame::TA_Option_Click(int index) {
    emit optionChosen();
    m_automatic.setRunning(index == 1);
    if (m_automatic.runs()) {
        m_announcementStart = now();
        m_repetitionStart = m_announcementStart;
        TA_Check->setEnabled(false);
        TA_Timer->setPeriod(1000);
    } else {
        TA_Timer->setPeriod(0);
        TA_Check->setEnabled(true);
    }
}

// The two clamps differ on purpose: the duration may come down to the period, the period always stays above the
// duration.
void TaFrame::TA_HScroll_Change() {
    if (TA_HScroll->value() > TA_Rep_HScroll->value()) setQuietly(TA_HScroll, TA_Rep_HScroll->value());
    showDuration(TA_HScroll->value());
    m_with.profile.write(setting::kAnnouncementSeconds, std::to_string(TA_HScroll->value()));
}

void TaFrame::TA_Rep_HScroll_Change() {
    if (TA_Rep_HScroll->value() <= TA_HScroll->value()) setQuietly(TA_Rep_HScroll, TA_HScroll->value() + 1);
    showPeriod(TA_Rep_HScroll->value());
    m_with.profile.write(setting::kRepetitionSeconds, std::to_string(TA_Rep_HScroll->value()));
}

void TaFrame::TA_Timer_Timer() {
    if (!m_automatic.runs()) return;
    const Tick tick(m_with, kName, [this] { endAutomatic(); });
    TA_Rep_Timer->setEnabled(false);
    if (!TA_Option[1]->isChecked()) return;
    if (now() <= m_announcementStart + static_cast<float>(TA_HScroll->value())) {
        showAnnouncing(true);
        m_offSent = false;
        sendTa("1");
        TA_Option[0]->setEnabled(false);
        return;
    }
    showAnnouncing(false);
    if (!m_offSent) {
        sendTa("0");
        m_offSent = true;
    }
    TA_Option[0]->setEnabled(true);
    if (m_programme.trafficProgramme != "1") {
        TA_Option.choose(0);
        TA_Option_Click(0);
    }
    TA_Rep_Timer->setEnabled(true);
}

void TaFrame::TA_Rep_Timer_Timer() {
    if (!TA_Option[1]->isChecked()) return;
    const float time = now();
    if (time > m_repetitionStart + static_cast<float>(TA_Rep_HScroll->value())) {
        m_repetitionStart = time;
        m_announcementStart = time;
    }
}

void TaFrame::TA_EON_Hilfe_Click() {
    m_with.dialogs.message(Dialogs::Icon::Information, caption({388, "EON TA"}),
                           caption({389,
                                    "EON TA lässt sich nur geben, solange TP aus und TA ein ist und EON TP "
                                    "angekreuzt ist."}));
}

/// As a click on "manual", also while an announcement locks that.
void TaFrame::endAutomatic() {
    TA_Option[0]->setEnabled(true);
    TA_Option.choose(0);
    TA_Option_Click(0);
}

void TaFrame::endAnnouncement() {
    if (m_automatic.runs()) endAutomatic();
    if (!m_announcing) return;
    TA_Check->setChecked(false);
    m_programme.announcement = "0";
    showByHand(false);
    if (m_programme.trafficProgramme != "1") setTrafficProgramme(false);
    sendTa(m_programme.announcement);
}

void TaFrame::showByHand(bool on) {
    showAnnouncing(on);
    TA_Option[1]->setEnabled(!on);
}

void TaFrame::showAnnouncing(bool announcing) {
    m_statusShown = true;
    m_announcing = announcing;
    m_with.status.show(StatusSlot::Ta, caption({announcing ? 192 : 193}), m_with.marks.judge(setting::kAnnouncement));
    m_with.status.setAnnouncing(announcing);
}

void TaFrame::showDuration(int seconds) {
    TA_Zeit_Label->setText(QStringLiteral(" %1 %2").arg(seconds).arg(caption({40})));
}

void TaFrame::showPeriod(int seconds) {
    TA_Rep_Label->setText(QStringLiteral("%1 %2").arg(seconds).arg(caption({41})));
}

void TaFrame::sendTa(std::string value) {
    m_with.params.SendParam(setting::kAnnouncement, value);
}

}  // namespace kdx
