#include "window/mainmenu.h"

#include <QAction>
#include <QCoreApplication>
#include <QIcon>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>

#include "link/resource.h"
#include "settings/captions.h"
#include "settings/generalsettings.h"
#include "settings/programstate.h"
#include "ui/caption.h"
#include "ui/dialogs.h"

namespace kdx {

MainMenu::MainMenu(const PageContext& with, const QString& linkDescription, QMainWindow* window)
    : QObject(window), m_with(with), m_linkDescription(linkDescription), m_window(window) {
    const auto subMenu = [this, window](const char* name) {
        auto* menu = named<QMenu>(name, window);
        Mnu_Info->addMenu(menu);
        return menu;
    };
    const auto entry = [this](const char* name, QMenu* menu, void (MainMenu::*handler)()) {
        auto* action = named<QAction>(name, menu);
        if (handler != nullptr) connect(action, &QAction::triggered, this, handler);
        menu->addAction(action);
        return action;
    };
    Mnu_Info = named<QMenu>("Mnu_Info", window);
    window->menuBar()->addMenu(Mnu_Info);
    Mnu_Info_Interface = subMenu("Mnu_Info_Interface");
    Mnu_Info_Interface_COM =
        entry("Mnu_Info_Interface_COM", Mnu_Info_Interface, &MainMenu::Mnu_Info_Interface_COM_Click);
    Mnu_Info_Interface_IEC =
        entry("Mnu_Info_Interface_IEC", Mnu_Info_Interface, &MainMenu::Mnu_Info_Interface_IEC_Click);
    Mnu_Info_Ueber = entry("Mnu_Info_Ueber", Mnu_Info, &MainMenu::Mnu_Info_Ueber_Click);
    Mnu_Info_Hinweis = entry("Mnu_Info_Hinweis", Mnu_Info, &MainMenu::Mnu_Info_Hinweis_Click);
    Mnu_Info_Sprache = subMenu("Mnu_Info_Sprache");
    Mnu_Info_Sprache_D = entry("Mnu_Info_Sprache_D", Mnu_Info_Sprache, &MainMenu::Mnu_Info_Sprache_D_Click);
    Mnu_Info_Sprache_E = entry("Mnu_Info_Sprache_E", Mnu_Info_Sprache, &MainMenu::Mnu_Info_Sprache_E_Click);
    Mnu_Info_Sprache_US = entry("Mnu_Info_Sprache_US", Mnu_Info_Sprache, &MainMenu::Mnu_Info_Sprache_US_Click);
    Mnu_Info_RDS_RBDS = entry("Mnu_Info_RDS_RBDS", Mnu_Info, &MainMenu::Mnu_Info_RDS_RBDS_Click);
    Mnu_Info_RS232 = entry("Mnu_Info_RS232", Mnu_Info, nullptr);
    Mnu_TMC_Edit = entry("Mnu_TMC_Edit", Mnu_Info, &MainMenu::listEditorRequested);
    for (QAction* choice : {Mnu_Info_Sprache_D, Mnu_Info_Sprache_E, Mnu_Info_Sprache_US, Mnu_Info_RDS_RBDS}) {
        choice->setCheckable(true);
    }
}

void MainMenu::label() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    Mnu_Info->setTitle(text({0}));
    // Without a title there would be nothing to click; the language is chosen in here.
    Mnu_Info->setIcon(Mnu_Info->title().isEmpty() ? m_window->windowIcon() : QIcon());
    Mnu_Info_Ueber->setText(text({1}));
    Mnu_Info_Sprache->setTitle(text({2}));
    Mnu_Info_Sprache_D->setText(text({3}));
    Mnu_Info_Sprache_E->setText(text({4}));
    Mnu_Info_Sprache_US->setText(text({306, "english US"}));
    Mnu_Info_Interface->setTitle(text({301, "Interface"}));
    Mnu_Info_Interface_COM->setText(text({320, "TCPIP"}));
    Mnu_Info_Interface_IEC->setText(text({321, "IEEE488"}));
    Mnu_Info_Hinweis->setText(text({302, "Hinweis"}));
    Mnu_Info_RDS_RBDS->setText(text({305, "RDS /RBDS"}));
    Mnu_Info_RS232->setText(text({303, "RS232_Set"}));
    Mnu_TMC_Edit->setText(text({304, "TMC Edit"}));
    Mnu_Info_Sprache_D->setChecked(m_with.state.language == "deutsch");
    Mnu_Info_Sprache_E->setChecked(m_with.state.language == "english");
    Mnu_Info_Sprache_US->setChecked(m_with.state.language == "english US");
    Mnu_Info_RDS_RBDS->setChecked(m_with.state.standard == "RBDS");
    Mnu_Info_RDS_RBDS->setEnabled(m_with.state.language != "deutsch");
}

void MainMenu::showInterface(bool lan) {
    Mnu_Info_RS232->setEnabled(lan);
    Mnu_Info_Interface_IEC->setEnabled(lan);
    Mnu_Info_Interface_COM->setEnabled(!lan);
}

void MainMenu::showSessionOpen(bool open) {
    if (open) Mnu_Info_RS232->setEnabled(false);  // stays off when the session is closed again
    Mnu_Info_Interface->setEnabled(!open);
}

void MainMenu::Mnu_Info_Interface_IEC_Click() {
    emit interfaceChosen(kGpibInterface);
}

void MainMenu::Mnu_Info_Interface_COM_Click() {
    emit interfaceChosen(kLanInterface);
}

void MainMenu::Mnu_Info_Ueber_Click() {
    const auto line = [this](const Caption& caption, const QString& what) {
        return captionText(m_with.captions, caption) + QStringLiteral(": ") + what;
    };
    // The link in use comes first; what was tried in vain after it takes lines of its own.
    const bool hasTried = m_linkDescription.contains(QLatin1Char('\n'));
    const QString between = QStringLiteral("; ");
    const QString link = hasTried ? m_linkDescription.section(between, 0, 0) : m_linkDescription;
    const QString tried = hasTried ? m_linkDescription.section(between, 1) : QString();
    const QStringList about{
        QStringLiteral("KDX-RDS %1").arg(QCoreApplication::applicationVersion()),
        line({916, "Lizenz"}, QStringLiteral("MIT")), line({917, "Verbindung"}, link),
        line({918, "Bibliotheken"},
             QStringLiteral("Qt %1, CLI11, yaml-cpp, liquid-dsp, FFTW, libsndfile").arg(QLatin1String(qVersion())))};
    m_with.dialogs.about(QStringLiteral("\nRDS/Stereo Remote Software for KDX-X4\n\n"
                                        "Supported IEEE-Interface: National Instruments\n\n"
                                        "VISA I/O standard\n\n"),
                         about.join(QLatin1Char('\n')), tried);
}

void MainMenu::Mnu_Info_Hinweis_Click() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    m_with.dialogs.message(Dialogs::Icon::Exclamation, text({309, "Hinweis"}),
                           text({310, "Programm soll RDS Parameter einstellen"}) + QLatin1Char('\n') +
                               text({311, "Gedacht für VRN mit Opt. X4"}) + QLatin1Char('\n'));
}

void MainMenu::Mnu_Info_Sprache_D_Click() {
    chooseLanguage("deutsch");
}

void MainMenu::Mnu_Info_Sprache_E_Click() {
    chooseLanguage("english");
}

void MainMenu::Mnu_Info_Sprache_US_Click() {
    chooseLanguage("english US");
}

void MainMenu::chooseLanguage(const char* language) {
    m_with.profile.write(setting::kLanguage, language);
    emit relabelRequested();
}

void MainMenu::Mnu_Info_RDS_RBDS_Click() {
    m_with.profile.write(setting::kStandard, m_with.state.standard == "RBDS" ? "RDS" : "RBDS");
    emit relabelRequested();
}

}  // namespace kdx
