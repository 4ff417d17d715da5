#pragma once

#include <QAction>
#include <QTabWidget>

#include <memory>

#include "settings/folderlock.h"
#include "support/controltest.h"
#include "support/linkfixture.h"
#include "support/scripteddialogs.h"
#include "ui/ticker.h"
#include "window/hmenue.h"

namespace kdx::test {

/// The whole window on a data folder of its own, with a scripted instrument and boxes and a clock that stands still.
class WindowTest : public ControlTest, protected Bench {
protected:
    WindowTest() {
        visa.answersTo["*IDN?"] = "KDX,TEST\n";
        visa.answersTo[":STEREO:DIRECT? \"EON PI?\""] = "\" \"\n";
    }

    /// Makes the window and runs its start-up; a second call is a second start of the program.
    void start() {
        end();
        state = ProgramState();
        const auto ask = [this] { ++ended; };
        session = std::make_unique<Session>(instrumentLink(), state, data, captions, clock, ask);
        tickers.setHeld(false);
        window = std::make_unique<HMenue>(
            Surroundings{*session, state, data, captions, clock, boxesOfWindow(), tickers, claim, linkDescription,
                         QString(), ask, worker(), std::chrono::seconds{2}, simulated, shipped, placeFile, keptFiles});
        m_listener = std::make_unique<TrafficListener>(session->instrument, [this](const Traffic& traffic) {
            if (heard) heard(traffic);
        });
        window->startUp();
        window->show();
        QCoreApplication::processEvents();
    }
    /// Ends the program. Who brings a link of its own calls it before that goes.
    void end() {
        window.reset();
        m_listener.reset();
        session.reset();
    }
    /// The same as start() with the data that are shipped.
    void startShipped() {
        folder.copyShipped();
        start();
    }
    void openSession() { click("INIT_Taste"); }

    /// What the window sends through: the scripted instrument unless a test brings a link of its own.
    virtual Visa& instrumentLink() { return visa; }
    /// The link where it runs in a thread of its own.
    virtual WorkerVisa* worker() { return nullptr; }
    /// What its boxes go through: the scripted ones unless a test brings its own.
    virtual Dialogs& boxesOfWindow() { return dialogs; }
    QWidget& root() override { return *window; }
    QAction* action(const char* name) {
        auto* found = window->findChild<QAction*>(QString::fromLatin1(name));
        if (found == nullptr) throw std::runtime_error(std::string("no menu entry ") + name);
        return found;
    }
    void showPage(int index) { find<QTabWidget>("SSTab1")->setCurrentIndex(index); }
    std::string general(const std::string& section, const std::string& key) const {
        return data.ReadIni(section, key, kGeneralSettings);
    }
    void setGeneral(const std::string& section, const std::string& key, const std::string& value) {
        data.WriteIni(section, key, value, kGeneralSettings);
    }
    void setDataSet1(const std::string& section, const std::string& key, const std::string& value) {
        data.WriteIni(section, key, value, dataSetFile("1"));
    }

    ScriptedDialogs dialogs;
    QString linkDescription = QStringLiteral("scripted");
    bool simulated = false;                        ///< what the next start tells of the instrument
    std::filesystem::path shipped;                 ///< the folder that the next start takes for the shipped one
    std::filesystem::path placeFile;               ///< where it keeps its page and place; nowhere when empty
    std::vector<std::filesystem::path> keptFiles;  ///< what the next start tells of files that were not renewed
    int ended = 0;                                 ///< how often the end of the program was asked for
    TickerGroup tickers;
    std::unique_ptr<Session> session;
    FolderClaim claim{folder.data()};
    std::unique_ptr<HMenue> window;
    std::function<void(const Traffic&)> heard;  ///< hears everything that passes, from the next start on

private:
    std::unique_ptr<TrafficListener> m_listener;
};

}  // namespace kdx::test
