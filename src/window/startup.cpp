// What the main window does once at the start, and the sending of the whole data set.
#include <QTabWidget>

#include "af/afpage.h"
#include "af/eonpage.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "groups/grouppage.h"
#include "rds/rdspage.h"
#include "rds/testmode.h"
#include "settings/captions.h"
#include "settings/programstate.h"
#include "stereo/rfpage.h"
#include "stereo/stereopage.h"
#include "tmc/tmcpage.h"
#include "window/hmenue.h"
#include "window/progressline.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr QSize kDesignSize{640, 480};  // pixels at 96 dpi

}  // namespace

void HMenue::startUp() {
    // The two blanks before the slash and at the end belong to the title.
    m_s.state.ProgramTitle = "KDX-RDS V 1.0  / Mar. 2009  ";
    setWindowTitle(toText(m_s.state.ProgramTitle));
    // Stated, not left to the layouts: they would still know sizes from before captions were set and parts hidden.
    setMinimumSize(kDesignSize);
    resize(kDesignSize);
    m_s.state.InterfaceKind = generalSetting("BUS", "INTERFACE");
    Schnittstellen_Toggle();
    m_s.state.InstrumentOnline = false;
    m_s.state.LogEnabled = leadingNumber(generalSetting("ADRESSEN", "Log_Key")) == 1;
    showSessionOpen(false);
    m_stereo->hideRdsPhase();
    Beschrifter();
    setUpTmc();
    m_s.state.CurrentDataSet = "1";
    m_stereo->loadSettings();
    m_rds->loadTaSettings();
    m_rds->loadDataSet();
    m_groups->loadDataSet();
    m_eon->loadDataSet();
    m_af->loadDataSet();
    m_rds->loadProgrammeType();
    m_instrument.emptyLog();
    m_testMode->selectFirstPattern();
    m_rds->Zeit_Taste_Click();
    if (upperCase(generalSetting("BUS", "IECBUS")) == "AUTO") INIT_Taste_Click();
}

void HMenue::setUpTmc() {
    try {
        m_tmc->setUp();
    } catch (const std::exception& error) {
        m_startNotice = QString::fromUtf8(error.what());  // the page goes on with empty boxes
    }
    showNotice();
}

int HMenue::commandsOfDataSet() const {
    constexpr int kServiceCommands = 8;  // PI, TP, TA, PS, test mode, MS, RT, PTY
    constexpr int kNetworkCommands = 6;  // the question, one removal, PI, TA, TP, PS
    constexpr int kRfCommands = 2;
    return StereoPage::kSettingsCommands + kServiceCommands + m_af->commandsToSend() + kNetworkCommands +
           m_eon->listsToSend() + (m_groups->hasSequence() ? 1 : 0) + kRfCommands;
}

void HMenue::SetRdsStereo() {
    const CommandSequence sequence(m_instrument);
    const CountedCommands count(*m_lowerEdge, progressPattern(), commandsOfDataSet());
    const std::function<void()> steps[] = {
        [this] { m_stereo->sendSettings(); },   [this] { m_rds->sendPi(); },
        [this] { m_rds->sendTrafficFlags(); },  [this] { m_rds->sendPs(); },
        [this] { m_testMode->toRdsMode(); },    [this] { m_rds->sendMusicSpeech(); },
        [this] { m_rds->sendRadiotext(); },     [this] { m_af->Taste_AF_Senden_Click(); },
        [this] { m_rds->sendProgrammeType(); }, [this] { m_lowerEdge->addToTotal(m_eon->removeNetworks() - 1); },
        [this] { m_eon->sendNetwork(); },       [this] { m_groups->Gruppenfolge(); },
        [this] { m_rf->sendFrequency(); },      [this] { m_rf->sendLevel(); },
    };
    for (const auto& step : steps) {
        if (m_instrument.isSequenceStopped()) return;
        step();
    }
}

}  // namespace kdx
