#include "rds/taframe.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>

#include <algorithm>

#include "base/clock.h"
#include "base/numbers.h"
#include "coder/sendparam.h"
#include "rds/programme.h"
#include "rds/settings.h"
#include "ui/dialogs.h"
#include "ui/statusrow.h"
#include "ui/ticker.h"

namespace kdx {

namespace {

constexpr int kShortestDuration = 1;
constexpr int kLongestDuration = 600;
constexpr int kShortestPeriod = 2;
constexpr int kLongestPeriod = 3600;

/// A scroll bar that acts where it comes to rest, not on the way.
QScrollBar* timeBar(const char* name, QWidget* parent, int shortest, int longest) {
    auto* bar = named<QScrollBar>(name, Qt::Horizontal, parent);
    bar->setRange(shortest, longest);
    bar->setPageStep(10);
    bar->setTracking(false);
    bar->setFocusPolicy(Qt::StrongFocus);
    bar->setMinimumWidth(100);
    return bar;
}

}  // namespace

TaFrame::TaFrame(const PageContext& with, Programme& programme, QWidget* parent)
    : Page(with, parent), m_programme(programme) {
    create();
    arrange();
}

void TaFrame::create() {
    Frame1 = captioned<QGroupBox>("Frame1", {47}, this);

    TA_Check = captioned<QCheckBox>("TA_Check", {381, "TA on / off"}, Frame1);
    TA_Check->setEnabled(false);
    connect(TA_Check, &QCheckBox::clicked, this, &TaFrame::TA_Check_Click);
    TA_EON_Hilfe = captioned<QPushButton>("TA_EON_Hilfe", {385, "EON ?"}, Frame1);
    connect(TA_EON_Hilfe, &QPushButton::clicked, this, &TaFrame::TA_EON_Hilfe_Click);

    TA_Option.create("TA_Option", Frame1);
    TA_Option.onClick(this, &TaFrame::TA_Option_Click);
    TA_Option.choose(0);
    TA_Option[1]->setEnabled(false);
    m_book.text(TA_Option[0], {48});
    m_book.tip(TA_Option[0], {382, "TA Single"});
    m_book.text(TA_Option[1], {383, "&Automatisch"});
    m_book.tip(TA_Option[1], {384, "TA Repetition"});

    m_durationTitle = new QLabel(Frame1);
    m_book.text(m_durationTitle, {386, "Dauer"});
    TA_HScroll = timeBar("TA_HScroll", Frame1, kShortestDuration, kLongestDuration);
    m_book.spokenAs(TA_HScroll, m_durationTitle);
    m_durationTitle->setBuddy(TA_HScroll);
    connect(TA_HScroll, &QScrollBar::sliderMoved, this, &TaFrame::showDuration);
    connect(TA_HScroll, &QScrollBar::valueChanged, this, &TaFrame::TA_HScroll_Change);
    TA_Zeit_Label = named<QLabel>("TA_Zeit_Label", Frame1);

    m_periodTitle = new QLabel(Frame1);
    m_book.text(m_periodTitle, {387, "Wiederholung"});
    TA_Rep_HScroll = timeBar("TA_Rep_HScroll", Frame1, kShortestPeriod, kLongestPeriod);
    m_book.spokenAs(TA_Rep_HScroll, m_periodTitle);
    m_periodTitle->setBuddy(TA_Rep_HScroll);
    connect(TA_Rep_HScroll, &QScrollBar::sliderMoved, this, &TaFrame::showPeriod);
    connect(TA_Rep_HScroll, &QScrollBar::valueChanged, this, &TaFrame::TA_Rep_HScroll_Change);
    TA_Rep_Label = named<QLabel>("TA_Rep_Label", Frame1);

    TA_Timer = named<Ticker>("TA_Timer", m_with.tickers, this);
    TA_Timer->setPeriod(333);
    TA_Timer->setEnabled(true);
    connect(TA_Timer, &QTimer::timeout, this, &TaFrame::TA_Timer_Timer);
    TA_Rep_Timer = named<Ticker>("TA_Rep_Timer", m_with.tickers, this);
    TA_Rep_Timer->setPeriod(500);
    connect(TA_Rep_Timer, &QTimer::timeout, this, &TaFrame::TA_Rep_Timer_Timer);
}

void TaFrame::arrange() {
    auto* grid = new QGridLayout(Frame1);
    tighten(grid);
    grid->addWidget(TA_Check, 0, 0);
    grid->addWidget(TA_EON_Hilfe, 0, 1, Qt::AlignRight);
    grid->addWidget(TA_Option[0], 1, 0);
    grid->addWidget(TA_Option[1], 1, 1);
    grid->addWidget(m_durationTitle, 2, 0);
    grid->addWidget(TA_Zeit_Label, 2, 1, Qt::AlignRight);
    grid->addWidget(TA_HScroll, 3, 0, 1, 2);
    grid->addWidget(m_periodTitle, 4, 0);
    grid->addWidget(TA_Rep_Label, 4, 1, Qt::AlignRight);
    grid->addWidget(TA_Rep_HScroll, 5, 0, 1, 2);
    grid->setRowStretch(6, 1);
    auto* whole = new QVBoxLayout(this);
    tighten(whole, 0);
    whole->addWidget(Frame1);
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
    m_automatic = index == 1;
    if (m_automatic) {
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
    if (!m_automatic) return;
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

float TaFrame::now() const {
    return static_cast<float>(m_with.clock.secondsSinceMidnight());
}

void TaFrame::showByHand(bool on) {
    showAnnouncing(on);
    TA_Option[1]->setEnabled(!on);
}

void TaFrame::showAnnouncing(bool announcing) {
    m_statusShown = true;
    m_announcing = announcing;
    m_with.status.show(StatusSlot::Ta, caption({announcing ? 192 : 193}));
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
