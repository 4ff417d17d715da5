#pragma once

#include <QAction>
#include <QTabWidget>

#include <memory>

#include "support/pagetest.h"
#include "window/hmenue.h"

namespace kdx::test {

/// The whole window on a data folder of its own, with a scripted instrument and boxes and a clock that stands still.
class WindowTest : public ControlTest {
protected:
    WindowTest() {
        visa.answersTo["*IDN?"] = "KDX,TEST\n";
        visa.answersTo[":STEREO:DIRECT? \"EON PI?\""] = "\" \"\n";
    }

    /// Makes the window and runs its start-up; a second call is a second start of the program.
    void start() {
        window.reset();
        state = ProgramState();
        window = std::make_unique<HMenue>(Surroundings{instrumentLink(), state, data, captions, clock, dialogs,
                                                       QStringLiteral("scripted"), [this] { ++ended; }});
        window->startUp();
        window->show();
        QCoreApplication::processEvents();
    }
    /// The same with the data that are shipped.
    void startShipped() {
        folder.copyShipped();
        start();
    }
    void openSession() { click("INIT_Taste"); }

    /// What the window sends through: the scripted instrument unless a test brings a link of its own.
    virtual Visa& instrumentLink() { return visa; }
    QWidget& root() override { return *window; }
    QAction* action(const char* name) {
        auto* found = window->findChild<QAction*>(QString::fromLatin1(name));
        if (found == nullptr) throw std::runtime_error(std::string("no menu entry ") + name);
        return found;
    }
    void showPage(int index) { find<QTabWidget>("SSTab1")->setCurrentIndex(index); }
    Lines sent() { return std::exchange(visa.written, {}); }
    std::string general(const std::string& section, const std::string& key) const {
        return data.ReadIni(section, key, kGeneralSettings);
    }
    void setGeneral(const std::string& section, const std::string& key, const std::string& value) {
        data.WriteIni(section, key, value, kGeneralSettings);
    }
    void setDataSet1(const std::string& section, const std::string& key, const std::string& value) {
        data.WriteIni(section, key, value, dataSetFile("1"));
    }

    TempFolder folder;
    DataFolder data{folder.path()};
    FakeVisa visa;
    FakeClock clock;
    ProgramState state;
    Captions captions{data};
    ScriptedDialogs dialogs;
    int ended = 0;  ///< how often the end of the program was asked for
    std::unique_ptr<HMenue> window;
};

}  // namespace kdx::test
