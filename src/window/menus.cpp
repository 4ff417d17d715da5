// The menu of the main window: its entries, their captions and what they do.
#include <QAction>
#include <QMenu>
#include <QMenuBar>

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "tmc/tmclistedit.h"
#include "tmc/tmcpage.h"
#include "ui/dialogs.h"
#include "window/hmenue.h"
#include "window/logview.h"
#include "ui/named.h"
#include "ui/text.h"
#include "window/trafficlog.h"

namespace kdx {

void HMenue::createMenu() {
    const auto entry = [this](const char* name, const char* caption, QMenu* menu, void (HMenue::*handler)()) {
        auto* action = named<QAction>(name, toText(caption), this);
        if (handler != nullptr) connect(action, &QAction::triggered, this, handler);
        menu->addAction(action);
        return action;
    };
    const auto subMenu = [this](const char* name, const char* caption) {
        auto* menu = named<QMenu>(name, toText(caption), this);
        Mnu_Info->addMenu(menu);
        return menu;
    };
    Mnu_Info = named<QMenu>("Mnu_Info", QStringLiteral("Info"), this);
    menuBar()->addMenu(Mnu_Info);
    Mnu_Info_Interface = subMenu("Mnu_Info_Interface", "Interface");
    Mnu_Info_Interface_COM =
        entry("Mnu_Info_Interface_COM", "TCPIP", Mnu_Info_Interface, &HMenue::Mnu_Info_Interface_COM_Click);
    Mnu_Info_Interface_IEC =
        entry("Mnu_Info_Interface_IEC", "IEEE488", Mnu_Info_Interface, &HMenue::Mnu_Info_Interface_IEC_Click);
    Mnu_Info_Ueber = entry("Mnu_Info_Ueber",
                           "\xDC"
                           "ber",
                           Mnu_Info, &HMenue::Mnu_Info_Ueber_Click);
    Mnu_Info_Hinweis = entry("Mnu_Info_Hinweis", "Hinweis", Mnu_Info, &HMenue::Mnu_Info_Hinweis_Click);
    Mnu_Info_Sprache = subMenu("Mnu_Info_Sprache", "Sprache");
    Mnu_Info_Sprache_D = entry("Mnu_Info_Sprache_D", "deutsch", Mnu_Info_Sprache, &HMenue::Mnu_Info_Sprache_D_Click);
    Mnu_Info_Sprache_E = entry("Mnu_Info_Sprache_E", "english", Mnu_Info_Sprache, &HMenue::Mnu_Info_Sprache_E_Click);
    Mnu_Info_Sprache_US =
        entry("Mnu_Info_Sprache_US", "english US", Mnu_Info_Sprache, &HMenue::Mnu_Info_Sprache_US_Click);
    Mnu_Info_RDS_RBDS = entry("Mnu_Info_RDS_RBDS", "RDS /RBDS", Mnu_Info, &HMenue::Mnu_Info_RDS_RBDS_Click);
    Mnu_Info_RS232 = entry("Mnu_Info_RS232", "RS232_Set", Mnu_Info, nullptr);
    Mnu_TMC_Edit = entry("Mnu_TMC_Edit", "TMC Edit", Mnu_Info, &HMenue::Mnu_TMC_Edit_Click);
    Mnu_Info_Log = entry("Mnu_Info_Log", "Log", Mnu_Info, &HMenue::Mnu_Info_Log_Click);
    for (QAction* choice : {Mnu_Info_Sprache_D, Mnu_Info_Sprache_E, Mnu_Info_Sprache_US, Mnu_Info_RDS_RBDS}) {
        choice->setCheckable(true);
    }
}

void HMenue::labelMenu() {
    const Captions& captions = m_s.captions;
    Mnu_Info->setTitle(toText(captions.text(0)));
    Mnu_Info_Ueber->setText(toText(captions.text(1)));
    Mnu_Info_Sprache->setTitle(toText(captions.text(2)));
    Mnu_Info_Sprache_D->setText(toText(captions.text(3)));
    Mnu_Info_Sprache_E->setText(toText(captions.text(4)));
    Mnu_Info_Sprache_US->setText(toText(captions.own(306, "english US")));
    Mnu_Info_Interface->setTitle(toText(captions.own(301, "Interface")));
    Mnu_Info_Interface_COM->setText(toText(captions.own(320, "TCPIP")));
    Mnu_Info_Interface_IEC->setText(toText(captions.own(321, "IEEE488")));
    Mnu_Info_Hinweis->setText(toText(captions.own(302, "Hinweis")));
    Mnu_Info_RDS_RBDS->setText(toText(captions.own(305, "RDS /RBDS")));
    Mnu_Info_RS232->setText(toText(captions.own(303, "RS232_Set")));
    Mnu_TMC_Edit->setText(toText(captions.own(304, "TMC Edit")));
    Mnu_Info_Log->setText(toText(captions.own(680, "Log")));
    Mnu_Info_Sprache_D->setChecked(m_s.state.language == "deutsch");
    Mnu_Info_Sprache_E->setChecked(m_s.state.language == "english");
    Mnu_Info_Sprache_US->setChecked(m_s.state.language == "english US");
    Mnu_Info_RDS_RBDS->setChecked(m_s.state.standard == "RBDS");
    Mnu_Info_RDS_RBDS->setEnabled(m_s.state.language != "deutsch");
}

void HMenue::Mnu_Info_Ueber_Click() {
    m_s.dialogs.message(Dialogs::Icon::Exclamation, QString(),
                        QStringLiteral("\nRDS/Stereo Remote Software for KDX-X4\n\n"
                                       "Supported IEEE-Interface: National Instruments\n\n"
                                       "VISA I/O standard\n\n"),
                        m_s.linkDescription);
}

void HMenue::Mnu_Info_Hinweis_Click() {
    const Captions& captions = m_s.captions;
    m_s.dialogs.message(Dialogs::Icon::Exclamation, toText(captions.own(309, "Hinweis")),
                        toText(captions.own(310, "Programm soll RDS Parameter einstellen") + "\n" +
                               captions.own(311, "Gedacht f\xFCr VRN mit Opt. X4") + "\n"));
}

void HMenue::Mnu_Info_Sprache_D_Click() {
    chooseLanguage("deutsch");
}

void HMenue::Mnu_Info_Sprache_E_Click() {
    chooseLanguage("english");
}

void HMenue::Mnu_Info_Sprache_US_Click() {
    chooseLanguage("english US");
}

void HMenue::chooseLanguage(const char* language) {
    m_s.data.WriteIni("Sprache", "Sprache", language, kGeneralSettings);
    Beschrifter();
}

void HMenue::Mnu_Info_RDS_RBDS_Click() {
    const char* standard = m_s.state.standard == "RBDS" ? "RDS" : "RBDS";
    m_s.data.WriteIni("Sprache", "RDS_RBDS", standard, kGeneralSettings);
    Beschrifter();
}

void HMenue::Mnu_TMC_Edit_Click() {
    TMC_Listedit editor(*m_context, this);
    editor.exec();
    m_tmc->reloadLists();
}

void HMenue::Mnu_Info_Log_Click() {
    if (m_logView == nullptr) m_logView = new LogView(*m_trafficLog, m_s.captions, this);
    m_logView->show();
    m_logView->raise();
    m_logView->activateWindow();
}

}  // namespace kdx
