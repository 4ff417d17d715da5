#pragma once

#include <QMainWindow>

#include <memory>
#include <vector>

#include "station/session.h"
#include "ui/keymarks.h"
#include "ui/pagecontext.h"
#include "window/stepoutcome.h"
#include "window/surroundings.h"

class QGroupBox;
class QPushButton;

namespace kdx {

class ConnectionBar;
class Desktop;
class MainMenu;
class Page;
class PageTabs;
class ProgressLine;
class StatusRow;
class Views;
class WaysOut;

/// The one main window: owns the pages and what ties them together.
class HMenue : public QMainWindow, private StepWatcher {
    Q_OBJECT
public:
    explicit HMenue(const Surroundings& surroundings);
    ~HMenue() override;

    /// Brings every control into the state stored in the profile files and, when the general settings say so, opens
    /// the session. Never stops on a missing setting.
    void startUp();
    /// Captions everything in the language and standard of the general settings.
    void Beschrifter();
    /// Brings a page into view.
    void showPage(Page& page);
    /// Sends the whole current state in its fixed order.
    void SetRdsStereo();
    void INIT_Taste_Click();
    void GTL_Taste_Click();

signals:
    void sessionOpened();
    /// Everything is to be asked back.
    void readAllRequested();
    /// The editor of the event and location lists was closed.
    void listsEdited();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void stepGoesOut(const Step& step, std::size_t number, std::size_t total) override;
    void stepLeftOut(const Step& step) override;
    void stepAnswered(const Step& step, const std::string& answer) override;
    void stepsEnded() override;

    void createPages();
    void createMenu();
    void arrange();
    void SSTab1_Click(int page);
    void Mnu_TMC_Edit_Click();
    void loadPages();
    void showSessionOpen(bool open);
    void watchPictures();
    void showNotice();

    Surroundings m_s;
    StatusRow* m_status;
    KeyMarks m_marks;
    PageContext m_context;
    ConnectionBar* m_connection = nullptr;
    QGroupBox* Frame7 = nullptr;  // the parameter controls
    QPushButton* GTL_Taste = nullptr;
    PageTabs* SSTab1 = nullptr;
    std::vector<Page*> m_pages;
    StepOutcome m_outcome{m_s.session.instrument, m_pages};
    ProgressLine* m_lowerEdge = nullptr;  // progress, and what the user should know
    QString m_startNotice;                // what start-up could not read
    WaysOut* m_waysOut = nullptr;
    MainMenu* m_menu = nullptr;
    std::unique_ptr<Views> m_views;
    std::unique_ptr<Desktop> m_desktop;
};

}  // namespace kdx
