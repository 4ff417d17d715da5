#pragma once

#include <QMainWindow>

#include <array>
#include <functional>
#include <memory>

#include "link/instrument.h"
#include "coder/sendparam.h"
#include "ui/pagecontext.h"

class QAction;
class QGroupBox;
class QLabel;
class QMenu;
class QPushButton;
class QScrollBar;
class QTabWidget;

namespace kdx {

class AfPage;
class ClickableLabel;
class EonPage;
class GroupPage;
class LogView;
class ProgressLine;
class QueryPage;
class RdsPage;
class RfPage;
class StatusRow;
class StereoPage;
class StorePage;
class TestMode;
class TmcPage;
class TrafficLog;

/// What the window works with; everything is borrowed and outlives it.
struct Surroundings {
    Visa& visa;
    ProgramState& state;
    DataFolder& data;
    Captions& captions;
    Clock& clock;
    Dialogs& dialogs;
    QString linkDescription;           ///< how instruments are reached, for the about box
    std::function<void()> endProgram;  ///< ends the program at once
};

/// The one main window: owns the pages and what ties them together, the instrument session and the menu.
class HMenue : public QMainWindow {
    Q_OBJECT
public:
    explicit HMenue(const Surroundings& surroundings);
    ~HMenue() override;

    /// Brings every control into the state stored in the profile files and, when the general settings say so, opens
    /// the session. Never stops on a missing setting.
    void startUp();

    /// Captions everything in the language and standard of the general settings.
    void Beschrifter();
    /// Sends the whole current state in its fixed order.
    void SetRdsStereo();
    void INIT_Taste_Click();
    void GTL_Taste_Click();

    [[nodiscard]] const Instrument& instrument() const { return m_instrument; }

signals:
    /// Something was written, read or logged.
    void trafficPassed(const kdx::Traffic& traffic);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void createConnection();
    void createPages();
    void createMenu();
    void arrange();

    void Adr1_Label_Click();
    void Ende_Taste_Click();
    void Mnu_Info_Interface_IEC_Click();
    void Mnu_Info_Interface_COM_Click();
    void Mnu_Info_Ueber_Click();
    void Mnu_Info_Hinweis_Click();
    void Mnu_Info_Sprache_D_Click();
    void Mnu_Info_Sprache_E_Click();
    void Mnu_Info_Sprache_US_Click();
    void Mnu_Info_RDS_RBDS_Click();
    void Mnu_TMC_Edit_Click();
    void Mnu_Info_Log_Click();
    void SSTab1_Click(int page);
    void Schnittstellen_Toggle();

    void chooseInterface(const char* kind);
    void chooseLanguage(const char* language);
    void showAddress();
    void showSessionOpen(bool open);
    void sendBaseState();
    void labelMenu();
    void setUpTmc();
    void showNotice();
    void watchTraffic(const Traffic& traffic);
    [[nodiscard]] int commandsOfDataSet() const;
    [[nodiscard]] QString progressPattern() const;
    [[nodiscard]] QString missingData() const;
    bool showInterfaceError(const std::string& text, bool sequenceRuns);
    void holdTimers(bool held);
    [[nodiscard]] std::string generalSetting(const char* section, const char* key) const;

    Surroundings m_s;
    StatusRow* m_status = nullptr;
    Instrument m_instrument;
    ParamSender m_params;
    std::unique_ptr<PageContext> m_context;

    QGroupBox* Frame8 = nullptr;  // connection
    QPushButton* INIT_Taste = nullptr;
    QScrollBar* Adr1_VScroll = nullptr;
    ClickableLabel* Adr1_Label = nullptr;
    QLabel* Label6 = nullptr;  // heading of a GPIB address
    QPushButton* Ende_Taste = nullptr;
    QLabel* Image2 = nullptr;     // banner
    QGroupBox* Frame7 = nullptr;  // the parameter controls
    QPushButton* GTL_Taste = nullptr;
    QTabWidget* SSTab1 = nullptr;
    ProgressLine* m_lowerEdge = nullptr;  // progress, and what could not be saved or found
    QString m_startNotice;                // what start-up could not read

    TestMode* m_testMode = nullptr;
    StereoPage* m_stereo = nullptr;
    RdsPage* m_rds = nullptr;
    AfPage* m_af = nullptr;
    GroupPage* m_groups = nullptr;
    EonPage* m_eon = nullptr;
    QueryPage* m_queries = nullptr;
    StorePage* m_store = nullptr;
    TmcPage* m_tmc = nullptr;
    RfPage* m_rf = nullptr;

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
    QAction* Mnu_Info_RS232 = nullptr;
    QAction* Mnu_TMC_Edit = nullptr;
    QAction* Mnu_Info_Log = nullptr;  // opens the live view of the commands

    TrafficLog* m_trafficLog = nullptr;
    LogView* m_logView = nullptr;
};

}  // namespace kdx
