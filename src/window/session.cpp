// The instrument session of the main window: interface choice, address, opening and closing.
#include <QAction>
#include <QGroupBox>
#include <QLabel>
#include <QMenu>
#include <QPushButton>
#include <QScrollBar>
#include <QTabWidget>

#include "base/numbers.h"
#include "rds/querypage.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "stereo/rfpage.h"
#include "stereo/stereopage.h"
#include "ui/clickablelabel.h"
#include "ui/dialogs.h"
#include "window/hmenue.h"
#include "window/progressline.h"
#include "ui/text.h"

namespace kdx {

void HMenue::Mnu_Info_Interface_IEC_Click() {
    chooseInterface("IEC");
}

void HMenue::Mnu_Info_Interface_COM_Click() {
    chooseInterface("TCPIP");
}

void HMenue::chooseInterface(const char* kind) {
    m_s.state.InterfaceKind = kind;
    m_s.data.WriteIni("BUS", "Interface", kind, kGeneralSettings);
    Schnittstellen_Toggle();
}

void HMenue::Schnittstellen_Toggle() {
    const bool lan = m_s.state.InterfaceKind == "TCPIP";
    Adr1_VScroll->hide();
    showAddress();
    Adr1_Label->show();
    Label6->setVisible(!lan);
    // The interface in use is greyed out: only the other one can be chosen.
    Mnu_Info_RS232->setEnabled(lan);
    Mnu_Info_Interface_IEC->setEnabled(lan);
    Mnu_Info_Interface_COM->setEnabled(!lan);
    INIT_Taste->setText(lan ? QStringLiteral("Init TCPIP") : QStringLiteral("Init IEEE"));
}

void HMenue::showAddress() {
    const char* key = m_s.state.InterfaceKind == "TCPIP" ? "KDX_TCPIP" : "KDX_IEEE";
    Adr1_Label->setText(toText(generalSetting("ADRESSEN", key)));
}

void HMenue::Adr1_Label_Click() {
    const bool gpib = m_s.state.InterfaceKind == "IEC";
    if (!gpib && m_s.state.InterfaceKind != "TCPIP") return;
    const QString title = toText(m_s.state.InterfaceKind + " Adress.");
    QString typed = Adr1_Label->text();
    double address = 0;
    do {
        typed = m_s.dialogs.input(QStringLiteral("Please enter here: "), title, typed);
        if (typed.isEmpty()) return;
        address = leadingNumber(toBytes(typed));
    } while (gpib && (address <= 1 || address >= 31));  // 0, 1 and 31 cannot be entered: the program's own limit
    Adr1_Label->setText(typed);
    m_s.data.WriteIni("ADRESSEN", gpib ? "KDX_IEEE" : "KDX_TCPIP", toBytes(typed), kGeneralSettings);
}

void HMenue::INIT_Taste_Click() {
    m_s.state.InterfaceKind = generalSetting("BUS", "INTERFACE");
    Visa& visa = m_instrument.visa();
    VisaStatus& status = m_instrument.LastVisaStatus;
    // A new resource manager at every opening; its description is asked for and not shown.
    status = visa.viOpenDefaultRM(m_instrument.DefaultRm);
    std::string description;
    status = visa.viStatusDesc(m_instrument.DefaultRm, status, description);

    const std::string resource =
        (m_s.state.InterfaceKind == "TCPIP" ? "TCPIP::" : "GPIB0::") + toBytes(Adr1_Label->text()) + "::INSTR";
    status = visa.viOpen(m_instrument.DefaultRm, resource, 0, 0, m_instrument.InstrSession);
    if (status != 0) {
        m_s.dialogs.message(Dialogs::Icon::Critical, QStringLiteral("Interface Error"),
                            QStringLiteral("Please Check Device! %1").arg(status));
        return;
    }
    m_s.state.InstrumentOnline = true;
    const CommandSequence sequence(m_instrument);
    const int ownCommands = 8 + (m_stereo->isFirstImpedanceChosen() ? 0 : 1);  // *IDN?, base state, RF output, audio
    const CountedCommands count(*m_lowerEdge, progressPattern(), ownCommands + commandsOfDataSet());
    m_instrument.Send2Gen("*IDN?");
    setWindowTitle(toText(m_instrument.ReadFromGen()));

    holdTimers(false);
    showSessionOpen(true);
    sendBaseState();
    m_stereo->selectFirstImpedance();
    SetRdsStereo();
    if (m_instrument.isSequenceStopped()) return;
    m_rf->HfOnOffState_Click();
    m_rf->sendAudioFrequency();
}

void HMenue::sendBaseState() {
    for (const char* key : {"AM_AUS", "FM_AUS", "STEREO_EIN"}) m_params.SendParam(key, std::string());
    m_params.SendParam("MPX_HUB", m_stereo->totalDeviation());
    m_params.SendParam("MPX_SOURCE", m_stereo->sourceValue());
}

void HMenue::GTL_Taste_Click() {
    // A failure stays silent. The session counts as open still and keeps its handle: only the switched-off pages and
    // the resting timers keep commands away from it.
    m_instrument.LastVisaStatus = m_instrument.visa().viClose(m_instrument.InstrSession);
    showSessionOpen(false);
    holdTimers(true);
}

void HMenue::showSessionOpen(bool open) {
    if (open) {
        m_queries->Fragen_Schalter(true);
        Mnu_Info_RS232->setEnabled(false);  // stays off when the session is closed again
    }
    SSTab1->setEnabled(open);
    Frame7->setEnabled(open);
    Frame8->setEnabled(!open);
    INIT_Taste->setEnabled(!open);
    Ende_Taste->setEnabled(!open);
    Mnu_Info_Interface->setEnabled(!open);
}

}  // namespace kdx
