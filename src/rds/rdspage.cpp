#include "rds/rdspage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>
#include <QTime>

#include "base/clock.h"
#include "base/numbers.h"
#include "rds/dynamicps.h"
#include "coder/sendparam.h"
#include "rds/taframe.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "ui/clickablelabel.h"
#include "ui/dialogs.h"
#include "ui/named.h"
#include "ui/pictureswitch.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"

namespace kdx {

namespace {

constexpr int kPsLength = 8;
constexpr int kClockRepeatMs = 20000;

// Design captions of the decoder information; 6 and 7 carry the same one on purpose.
constexpr std::array<const char*, 8> kDecoderInfo = {"Mono",
                                                     "Stereo",
                                                     "NN",
                                                     "St Kunstkopf",
                                                     "Mono compr.",
                                                     "Stereo compr.",
                                                     "Stereo comp. Kunstkopf",
                                                     "Stereo comp. Kunstkopf"};

/// Which entry of a list a stored number means; -1 when the list has none such.
int positionOf(const std::string& stored, int count) {
    const double number = leadingNumber(stored);
    return number >= 0 && number < count ? static_cast<int>(number) : -1;
}

}  // namespace

RdsPage::RdsPage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    createServiceControls();
    createTraffic();
    createMusicSpeech();
    createClock();
    createDecoderInfo();
    createRadiotext();
    arrange();
}

void RdsPage::createServiceControls() {
    PS_Label = named<QLabel>("PS_Label", this);
    PS_T = named<QLineEdit>("PS_T", this);
    PS_Label->setBuddy(PS_T);
    PS_Taste = named<QPushButton>("PS_Taste", this);
    connect(PS_Taste, &QPushButton::clicked, this, &RdsPage::PS_Taste_Click);
    connect(PS_T, &QLineEdit::returnPressed, PS_Taste, &QPushButton::click);

    PI_Label = named<QLabel>("PI_Label", this);
    PI_T = named<QLineEdit>("PI_T", this);
    PI_Label->setBuddy(PI_T);
    connect(PI_T, &QLineEdit::textChanged, this, &RdsPage::PI_T_Change);
    Command3 = named<QPushButton>("Command3", this);
    connect(Command3, &QPushButton::clicked, this, &RdsPage::Command3_Click);
    connect(PI_T, &QLineEdit::returnPressed, Command3, &QPushButton::click);

    Label1 = named<QLabel>("Label1", this);
    PTY_Combo1 = named<QComboBox>("PTY_Combo1", this);
    Label1->setBuddy(PTY_Combo1);
    connect(PTY_Combo1, &QComboBox::activated, this, &RdsPage::PTY_Combo1_Click);

    m_dynamicPs = new DynamicPs(
        m_with, [this] { return toBytes(PS_T->text()); }, [this] { return toBytes(RT_Text1->text()); }, this);
}

void RdsPage::createTraffic() {
    Check1 = named<QCheckBox>("Check1", this);
    connect(Check1, &QCheckBox::clicked, this, &RdsPage::Check1_Click);
    m_ta = new TaFrame(
        m_with, [this] { return Check1->isChecked(); }, this);
    connect(m_ta, &TaFrame::optionChosen, this, [this] { m_dynamicPs->stopQuietly(); });
}

void RdsPage::createMusicSpeech() {
    Image1 = named<QLabel>("Image1", this);
    Image1->setPixmap(QIcon(QStringLiteral(":/kdx-rds-64.png")).pixmap(QSize(40, 40), devicePixelRatioF()));

    MS_Frame = named<QGroupBox>("MS_Frame", this);
    MS_opt.create("MS_opt", MS_Frame);
    for (int i = 0; i < 2; ++i) {
        connect(MS_opt[static_cast<std::size_t>(i)], &QRadioButton::clicked, this, [this, i] { MS_opt_Click(i); });
    }
}

void RdsPage::createDecoderInfo() {
    DI_Frame = named<QGroupBox>("DI_Frame", this);
    DI_Opt.create("DI_Opt", DI_Frame);
    for (int i = 0; i < 16; ++i) {
        connect(DI_Opt[static_cast<std::size_t>(i)], &QRadioButton::clicked, this, [this, i] { DI_Opt_Click(i); });
    }
}

void RdsPage::createRadiotext() {
    RT_Frame = named<QGroupBox>("RT_Frame", this);
    RT_Text1 = named<QLineEdit>("RT_Text1", RT_Frame);
    RT_Taste1 = named<QPushButton>("RT_Taste1", RT_Frame);
    connect(RT_Taste1, &QPushButton::clicked, this, &RdsPage::RT_Taste1_Click);
    connect(RT_Text1, &QLineEdit::returnPressed, RT_Taste1, &QPushButton::click);
    RT_clear1 = named<QPushButton>("RT_clear1", RT_Frame);
    connect(RT_clear1, &QPushButton::clicked, this, &RdsPage::RT_clear1_Click);
}

void RdsPage::createClock() {
    Time_Frame = named<QGroupBox>("Time_Frame", this);
    Zeit_Taste = named<PictureSwitch>("Zeit_Taste", m_with.data, Time_Frame);
    connect(Zeit_Taste, &PictureSwitch::clicked, this, &RdsPage::Zeit_Taste_Click);
    Uhr_Zeit = named<ClickableLabel>("Uhr_Zeit", Time_Frame);
    Uhr_Zeit->setAlignment(Qt::AlignCenter);
    connect(Uhr_Zeit, &ClickableLabel::doubleClicked, this, &RdsPage::Uhr_Zeit_DblClick);
    Timer1 = named<Ticker>("Timer1", this);
    Timer1->setPeriod(999);
    Timer1->setEnabled(true);
    connect(Timer1, &QTimer::timeout, this, &RdsPage::Timer1_Timer);
}

void RdsPage::label() {
    const Captions& captions = m_with.captions;
    PS_Label->setText(toText(captions.own(393, "PS")));
    PI_Label->setText(toText(captions.own(394, "PI")));
    Label1->setText(toText(captions.own(395, "PTY")));
    for (QPushButton* send : {PS_Taste, Command3, RT_Taste1}) send->setText(toText(captions.text(53)));
    PS_Taste->setAccessibleName(PS_Taste->text() + QStringLiteral(" PS"));
    Command3->setAccessibleName(Command3->text() + QStringLiteral(" PI"));
    RT_Taste1->setAccessibleName(RT_Taste1->text() + QStringLiteral(" RT"));
    Check1->setText(toText(captions.own(380, "TP on/off")));
    MS_Frame->setTitle(toText(captions.text(55)));
    MS_opt[0]->setText(toText(captions.text(56)));
    MS_opt[1]->setText(toText(captions.text(57)));
    DI_Frame->setTitle(toText(captions.own(396, "Decoder Info")));
    for (std::size_t i = 0; i < DI_Opt.size(); ++i) {
        DI_Opt[i]->setText(i < kDecoderInfo.size() ? toText(captions.text(59 + static_cast<int>(i)))
                                                   : QString::number(i));
    }
    RT_Frame->setTitle(toText(captions.text(49)));
    RT_Text1->setAccessibleName(RT_Frame->title());
    RT_clear1->setText(toText(captions.text(52)));
    Time_Frame->setTitle(toText(captions.text(54)));
    Zeit_Taste->setAccessibleName(Time_Frame->title());
    if (m_clockShowsWord) Uhr_Zeit->setText(toText(captions.text(193)));
    m_dynamicPs->label();
    m_ta->label();
    if (m_trafficProgrammeShown) showTrafficProgramme();
    if (!m_with.state.currentMs.empty()) showMusicSpeech();
    fillProgrammeTypes();
}

void RdsPage::fillProgrammeTypes() {
    PTY_Combo1->clear();
    for (std::size_t type = 0; type < 32; ++type) PTY_Combo1->addItem(toText(m_with.captions.programmeType(type)));
    const std::string stored = m_with.data.ReadIni("RDS", "PTY", dataSetFile("1"));
    PTY_Combo1->setCurrentIndex(positionOf(stored, PTY_Combo1->count()));
    if (PTY_Combo1->currentIndex() >= 0) m_with.status.show(StatusSlot::Pty, PTY_Combo1->currentText());
}

void RdsPage::loadTaSettings() {
    m_ta->loadSettings();
}

void RdsPage::loadDataSet() {
    const auto stored = [this](const char* key) { return m_with.data.ReadIni("RDS", key, dataSetFile("1")); };
    m_with.state.currentPs = stored("PS").substr(0, kPsLength);
    PS_T->setText(toText(stored("PS")));
    m_with.status.show(StatusSlot::Ps, m_with.state.currentPs);
    m_dynamicPs->showStopped();
    PI_T->setText(toText(stored("PI")));
    m_with.status.show(StatusSlot::Pi, m_with.state.currentPi);
    RT_Text1->setText(toText(stored("RTA")));
    // The second text has no entry of its own.
    const std::string second = stored("RTB");
    RT_Text1->setToolTip(second.empty() ? QString() : toText("RTB: " + second));
    const std::string musicSpeech = stored("MS");
    MS_opt.choose(musicSpeech.empty() ? -1 : (musicSpeech == "M" ? 0 : 1));
    if (!musicSpeech.empty()) {
        m_with.state.currentMs = musicSpeech == "M" ? "M" : "S";
        showMusicSpeech();
    }
    const std::string decoderInfo = stored("DI");
    DI_Opt.choose(decoderInfo.empty() ? -1 : positionOf(decoderInfo, static_cast<int>(DI_Opt.size())));
}

void RdsPage::loadProgrammeType() {
    fillProgrammeTypes();
}

void RdsPage::sendTrafficFlags() {
    // The boxes keep what the window shows, so that window and coder agree after the session was opened.
    Check1_Click();
    m_ta->TA_Check_Click();
    // The announcement box frees the automatic as well; without a traffic programme it stays locked.
    if (!Check1->isChecked()) m_ta->setTrafficProgramme(false);
}

void RdsPage::sendPi() {
    m_with.params.SendParam("PI", m_with.state.currentPi);
}

void RdsPage::sendPs() {
    m_with.params.SendParam("PS", m_with.state.currentPs);
}

void RdsPage::sendMusicSpeech() {
    m_with.params.SendParam("MS", m_with.state.currentMs);
}

void RdsPage::sendRadiotext() {
    m_with.params.SendParam("RT", toBytes(RT_Text1->text()));
}

void RdsPage::sendProgrammeType() {
    m_with.params.SendParam("PTY", std::to_string(PTY_Combo1->currentIndex()));
}

std::string RdsPage::clockText() const {
    return toBytes(Uhr_Zeit->text());
}

void RdsPage::PS_Taste_Click() {
    m_with.state.currentPs = toBytes(PS_T->text()).substr(0, kPsLength);
    sendPs();
    store("PS", m_with.state.currentPs);
    m_with.status.show(StatusSlot::Ps, m_with.state.currentPs);
}

void RdsPage::PI_T_Change() {
    m_with.state.currentPi = toBytes(PI_T->text());
}

void RdsPage::Command3_Click() {
    sendPi();
    store("PI", toBytes(PI_T->text()));
    m_with.status.show(StatusSlot::Pi, PI_T->text());
}

void RdsPage::PTY_Combo1_Click() {
    const std::string value = std::to_string(PTY_Combo1->currentIndex());
    m_with.params.SendParam("PTY", std::string(value));
    // Data set 1 whatever set is current; start-up reads the type from there too, so the pair must stay together.
    m_with.data.WriteIni("RDS", "PTY", value, dataSetFile("1"));
    m_with.status.show(StatusSlot::Pty, PTY_Combo1->currentText());
}

void RdsPage::Check1_Click() {
    const bool on = Check1->isChecked();
    m_ta->setTrafficProgramme(on);
    showTrafficProgramme();
    m_with.params.SendParam("TP", std::string(on ? "1" : "0"));
}

void RdsPage::MS_opt_Click(int index) {
    m_with.state.currentMs = index == 0 ? "M" : "S";
    showMusicSpeech();
    sendMusicSpeech();
    store("MS", m_with.state.currentMs);
}

void RdsPage::DI_Opt_Click(int index) {
    const std::string value = std::to_string(index);
    m_with.params.SendParam("DI", std::string(value));
    store("DI", value);
}

void RdsPage::RT_Taste1_Click() {
    // Stored as radiotext A, sent under "RT": data sets are kept that way.
    store("RTA", toBytes(RT_Text1->text()));
    sendRadiotext();
}

void RdsPage::RT_clear1_Click() {
    m_with.params.SendParam("RT", std::string("   "));
    RT_Text1->clear();
}

void RdsPage::Zeit_Taste_Click() {
    m_clockOn = !m_clockOn;
    Zeit_Taste->showState(m_clockOn);
    // Switching off sends nothing: the coder's clock runs on with the last time it was given.
    Timer1->setPeriod(kClockRepeatMs);
    Uhr_Zeit->setText(toText(m_with.captions.text(193)));
    m_clockShowsWord = true;
}

void RdsPage::Timer1_Timer() {
    if (!m_clockOn) return;
    Uhr_Zeit->setText(pcTime());
    m_clockShowsWord = false;
    m_with.params.SendParam("UHR", clockText());
}

void RdsPage::Uhr_Zeit_DblClick() {
    // A harmless prompt: the answer is not used, the time sent is always the PC's.
    m_with.dialogs.input(toText(m_with.captions.own(397, "Uhrzeit: ")),
                         toText(m_with.captions.own(398, "Zeit eingabe")), pcTime());
}

void RdsPage::store(const char* key, const std::string& value) {
    m_with.data.WriteIni("RDS", key, value, dataSetFile(m_with.state.CurrentDataSet));
}

void RdsPage::showMusicSpeech() {
    m_with.status.show(StatusSlot::MusicSpeech, m_with.captions.text(m_with.state.currentMs == "M" ? 56 : 57));
}

void RdsPage::showTrafficProgramme() {
    m_trafficProgrammeShown = true;
    m_with.status.show(StatusSlot::Tp, m_with.captions.text(Check1->isChecked() ? 192 : 193));
}

QString RdsPage::pcTime() const {
    return QTime::fromMSecsSinceStartOfDay(static_cast<int>(m_with.clock.secondsSinceMidnight()) * 1000)
        .toString(QStringLiteral("HH:mm:ss"));
}

}  // namespace kdx
