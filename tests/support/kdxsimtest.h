#pragma once

#include <algorithm>
#include <chrono>
#include <string>
#include <vector>

#include "link/lanvisa.h"
#include "support/kdxsimprocess.h"
#include "support/virtualtime.h"
#include "support/watchedvisa.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The whole window with the shipped data, over VXI-11 to kdx-sim as a process of its own; boxes and time are scripted.
class KdxSimTest : public WindowTest {
protected:
    KdxSimTest() {
        clock.set(10);  // the first seconds of the day: there the single precision of the waits does not show
        folder.copyShipped();
    }

    ~KdxSimTest() override { end(); }  // before what it works with

    /// Starts the instrument and the window; nothing is opened yet.
    void startBoth(const QStringList& simOptions = {}, LanOptions options = {}) {
        sim.start(simOptions);
        options.corePort = sim.port();
        lan = std::make_unique<LanVisa>(options);
        watched = std::make_unique<WatchedVisa>(*lan);
        start();
        heard = [this](const Traffic& t) { traffic.push_back(t); };
        time = std::make_unique<VirtualTime>(clock, *window);
    }
    Visa& instrumentLink() override { return *watched; }

    /// What the coder answers to a query over the window's own session, without its quotes; "" when it does not.
    std::string ask(const std::string& key) {
        const VisaHandle handle = session->instrument.InstrSession;
        std::int32_t count = 0;
        instrumentLink().viWrite(handle, ":STEREO:DIRECT? \"" + key + '"', count);
        std::string answer(100, ' ');
        if (instrumentLink().viRead(handle, answer, count) < 0 || count < 3) return {};
        return answer.substr(1, static_cast<std::size_t>(count) - 3);
    }
    /// What passed since the last call.
    std::vector<Traffic> takeTraffic() { return std::exchange(traffic, {}); }
    /// The commands among it.
    static Lines commands(const std::vector<Traffic>& passed) {
        Lines lines;
        for (const Traffic& t : passed) {
            if (t.kind == Traffic::Kind::Written) lines.push_back(t.text);
        }
        return lines;
    }
    /// How many writes and reads of it failed.
    static std::ptrdiff_t failures(const std::vector<Traffic>& passed) {
        return std::count_if(passed.begin(), passed.end(), [](const Traffic& t) {
            return t.kind == Traffic::Kind::Read ? t.status < 0 : t.status != 0;
        });
    }
    /// Adds a message to the list, composed of the entries and fields with these indexes.
    void addMessage(int event, int location, int extent, int direction, int duration, bool diversion) {
        select("TMC_Event_Combo", event);
        select("TMC_Loc_Combo", location);
        select("TMC_Var_Combo", extent);
        click(direction == 0 ? "Tmc_richtung_0" : "Tmc_richtung_1");
        select("DurationCombo", duration);
        setFlag("TMC_Div", diversion);
        setFlag("TMC_F_Check", true);
        setFlag("TMC_T_Check", false);
        click("TMC_Gr8_apply");
    }

    KdxSimProcess sim;
    std::unique_ptr<LanVisa> lan;
    std::unique_ptr<WatchedVisa> watched;
    std::unique_ptr<VirtualTime> time;
    std::vector<Traffic> traffic;

private:
    /// Clicks a box until it stands so, at least once.
    void setFlag(const char* name, bool on) {
        click(name);
        if (checked(name) != on) click(name);
    }
};

}  // namespace kdx::test
