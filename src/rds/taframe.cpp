#include "rds/taframe.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QLabel>
#include <QPushButton>

#include <algorithm>

#include "base/clock.h"
#include "base/numbers.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "ui/dialogs.h"
#include "ui/named.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"

namespace kdx {

namespace {

constexpr int kShortestDuration = 1;
constexpr int kLongestDuration = 600;
constexpr int kShortestPeriod = 2;
constexpr int kLongestPeriod = 3600;

/// A scroll bar that acts where it comes to rest, not on the way; `follow` hears of the way.
template <typename Follow, typename Change>
QScrollBar* timeBar(const char* name, TaFrame* frame, int shortest, int longest, Follow follow, Change change) {
    auto* bar = named<QScrollBar>(name, Qt::Horizontal, frame);
    bar->setRange(shortest, longest);
    bar->setPageStep(10);
    bar->setTracking(false);
    bar->setFocusPolicy(Qt::StrongFocus);
    bar->setMinimumWidth(100);
    QObject::connect(bar, &QScrollBar::sliderMoved, frame, follow);
    QObject::connect(bar, &QScrollBar::valueChanged, frame, change);
    return bar;
}

}  // namespace

TaFrame::TaFrame(const PageContext& with, std::function<bool()> trafficProgramme, QWidget* parent)
    : QGroupBox(parent), m_with(with), m_trafficProgramme(std::move(trafficProgramme)) {
    setObjectName(QStringLiteral("Frame1"));

    TA_Check = named<QCheckBox>("TA_Check", this);
    TA_Check->setEnabled(false);
    connect(TA_Check, &QCheckBox::clicked, this, &TaFrame::TA_Check_Click);

    TA_EON_Hilfe = named<QPushButton>("TA_EON_Hilfe", this);
    connect(TA_EON_Hilfe, &QPushButton::clicked, this, &TaFrame::TA_EON_Hilfe_Click);

    TA_Option.create("TA_Option", this);
    TA_Option.choose(0);
    TA_Option[1]->setEnabled(false);
    for (int i = 0; i < 2; ++i) {
        connect(TA_Option[static_cast<std::size_t>(i)], &QRadioButton::clicked, this,
                [this, i] { TA_Option_Click(i); });
    }

    TA_HScroll = timeBar("TA_HScroll", this, kShortestDuration, kLongestDuration, &TaFrame::showDuration,
                         &TaFrame::TA_HScroll_Change);
    TA_Zeit_Label = named<QLabel>("TA_Zeit_Label", this);
    TA_Rep_HScroll = timeBar("TA_Rep_HScroll", this, kShortestPeriod, kLongestPeriod, &TaFrame::showPeriod,
                             &TaFrame::TA_Rep_HScroll_Change);
    TA_Rep_Label = named<QLabel>("TA_Rep_Label", this);

    TA_Timer = named<Ticker>("TA_Timer", this);
    TA_Timer->setPeriod(333);
    TA_Timer->setEnabled(true);
    connect(TA_Timer, &QTimer::timeout, this, &TaFrame::TA_Timer_Timer);
    TA_Rep_Timer = named<Ticker>("TA_Rep_Timer", this);
    TA_Rep_Timer->setPeriod(500);
    connect(TA_Rep_Timer, &QTimer::timeout, this, &TaFrame::TA_Rep_Timer_Timer);

    m_durationTitle = new QLabel(this);
    m_durationTitle->setBuddy(TA_HScroll);
    m_periodTitle = new QLabel(this);
    m_periodTitle->setBuddy(TA_Rep_HScroll);

    auto* grid = new QGridLayout(this);
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
}

void TaFrame::label() {
    const Captions& captions = m_with.captions;
    setTitle(toText(captions.text(47)));
    TA_Check->setText(toText(captions.own(381, "TA on / off")));
    TA_Option[0]->setText(toText(captions.text(48)));
    TA_Option[0]->setToolTip(toText(captions.own(382, "TA Single")));
    TA_Option[1]->setText(toText(captions.own(383, "&Automatisch")));
    TA_Option[1]->setToolTip(toText(captions.own(384, "TA Repetition")));
    TA_EON_Hilfe->setText(toText(captions.own(385, "EON ?")));
    m_durationTitle->setText(toText(captions.own(386, "Dauer")));
    m_periodTitle->setText(toText(captions.own(387, "Wiederholung")));
    TA_HScroll->setAccessibleName(m_durationTitle->text());
    TA_Rep_HScroll->setAccessibleName(m_periodTitle->text());
    showDuration(TA_HScroll->sliderPosition());
    showPeriod(TA_Rep_HScroll->sliderPosition());
    if (m_statusShown) showAnnouncing(m_announcing);
}

void TaFrame::loadSettings() {
    const auto stored = [this](const char* key) {
        return static_cast<int>(std::clamp(leadingNumber(m_with.data.ReadIni("RDS", key, kGeneralSettings)), 0.0, 1e6));
    };
    const int duration = stored("TA_ON");
    const int period = stored("TA_REP");
    setQuietly(TA_Rep_HScroll, period);  // the period first: the duration must not lie above it
    setQuietly(TA_HScroll, std::min(duration, TA_Rep_HScroll->value()));
    showPeriod(TA_Rep_HScroll->value());
    showDuration(TA_HScroll->value());
}

void TaFrame::setTrafficProgramme(bool on) {
    TA_Option[0]->setEnabled(true);
    TA_Option[1]->setEnabled(on);
    TA_Check->setEnabled(on);
}

void TaFrame::TA_Check_Click() {
    const bool on = TA_Check->isChecked();
    showAnnouncing(on);
    TA_Option[1]->setEnabled(!on);
    sendTa(on ? "1" : "0");
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
    m_with.data.WriteIni("RDS", "TA_ON", std::to_string(TA_HScroll->value()), kGeneralSettings);
}

void TaFrame::TA_Rep_HScroll_Change() {
    if (TA_Rep_HScroll->value() <= TA_HScroll->value()) setQuietly(TA_Rep_HScroll, TA_HScroll->value() + 1);
    showPeriod(TA_Rep_HScroll->value());
    m_with.data.WriteIni("RDS", "TA_REP", std::to_string(TA_Rep_HScroll->value()), kGeneralSettings);
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
    if (!m_trafficProgramme()) {
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
    const Captions& captions = m_with.captions;
    m_with.dialogs.message(Dialogs::Icon::Information, toText(captions.own(388, "EON TA")),
                           toText(captions.own(389,
                                               "EON TA l\xE4sst sich nur geben, solange TP aus und TA ein ist "
                                               "und EON TP angekreuzt ist.")));
}

float TaFrame::now() const {
    return static_cast<float>(m_with.clock.secondsSinceMidnight());
}

void TaFrame::showAnnouncing(bool announcing) {
    m_statusShown = true;
    m_announcing = announcing;
    m_with.status.show(StatusSlot::Ta, m_with.captions.text(announcing ? 192 : 193));
    m_with.status.setAnnouncing(announcing);
}

void TaFrame::showDuration(int seconds) {
    TA_Zeit_Label->setText(QStringLiteral(" %1 %2").arg(seconds).arg(toText(m_with.captions.text(40))));
}

void TaFrame::showPeriod(int seconds) {
    TA_Rep_Label->setText(QStringLiteral("%1 %2").arg(seconds).arg(toText(m_with.captions.text(41))));
}

void TaFrame::sendTa(const char* value) {
    m_with.params.SendParam("TA", std::string(value));
}

}  // namespace kdx
