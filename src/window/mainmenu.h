#pragma once

#include <QObject>

#include "ui/pagecontext.h"

class QAction;
class QMainWindow;
class QMenu;

namespace kdx {

/// The menu of the main window. What an entry does that concerns no other part of the window it does itself; the rest
/// it says.
class MainMenu : public QObject {
    Q_OBJECT
public:
    /// @param linkDescription how instruments are reached, for the about box.
    MainMenu(const PageContext& with, const QString& linkDescription, QMainWindow* window);

    /// Captions the entries and marks language and standard in force.
    void label();
    /// The interface in use is greyed out: only the other one can be chosen.
    void showInterface(bool lan);
    /// While a session is open the interface stays; the serial entry is then off for good.
    void showSessionOpen(bool open);

signals:
    void interfaceChosen(const char* kind);
    /// Language or standard was changed: everything is to be captioned anew.
    void relabelRequested();
    void listEditorRequested();
    void logRequested();
    void onAirRequested();
    void compareRequested();
    void scenarioRequested();

private:
    void Mnu_Info_Interface_IEC_Click();
    void Mnu_Info_Interface_COM_Click();
    void Mnu_Info_Ueber_Click();
    void Mnu_Info_Hinweis_Click();
    void Mnu_Info_Sprache_D_Click();
    void Mnu_Info_Sprache_E_Click();
    void Mnu_Info_Sprache_US_Click();
    void Mnu_Info_RDS_RBDS_Click();
    void chooseLanguage(const char* language);

    PageContext m_with;
    QString m_linkDescription;

    QMenu* Mnu_Info = nullptr;
    QMenu* Mnu_Info_Interface = nullptr;
    QAction* Mnu_Info_Interface_COM = nullptr;
    QAction* Mnu_Info_Interface_IEC = nullptr;
    QAction* Mnu_Info_Ueber = nullptr;
    QAction* Mnu_Info_Hinweis = nullptr;
    QMenu* Mnu_Info_Sprache = nullptr;
    QAction* Mnu_Info_Sprache_D = nullptr;
    QAction* Mnu_Info_Sprache_E = nullptr;
    QAction* Mnu_Info_Sprache_US = nullptr;
    QAction* Mnu_Info_RDS_RBDS = nullptr;
    QAction* Mnu_Info_RS232 = nullptr;  // present without behaviour
    QAction* Mnu_TMC_Edit = nullptr;
    QAction* Mnu_Info_Log = nullptr;  // opens the live view of the commands
    QAction* Mnu_Ansicht_OnAir = nullptr;
    QAction* Mnu_Ansicht_Vergleich = nullptr;
    QAction* Mnu_Ansicht_Ablauf = nullptr;
};

}  // namespace kdx
