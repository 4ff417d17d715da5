#pragma once

#include <gtest/gtest.h>

#include <string>

#include "base/paths.h"
#include "settings/profilefile.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "station/readout.h"
#include "station/session.h"
#include "station/setupfile.h"
#include "support/linkfixture.h"

namespace kdx::test {

/// A virtual instrument with an open session to it.
struct Laboratory {
    Laboratory(DataFolder& data, const Captions& captions) : session(link, state, data, captions, clock, [] {}) {
        session.load();
        EXPECT_EQ(session.open("TCPIP", "10.0.0.1"), 0);
        session.instrument.onFailure([this](const std::string& text, bool) {
            failures.push_back(text);
            return false;
        });
    }
    void send(const std::string& key, const std::string& value) {
        if (key == "EON_PI") state.eonIdentifier = value;
        session.params.SendParam(key, std::string(value));
    }
    void apply(const Profile& source) {
        session.load(source);
        session.station.carrier.outputOn = false;  // as a program that was just started
        session.sendOpening();
    }
    [[nodiscard]] Readout readout() { return readOut(session.instrument); }
    /// Brings the values to the wanted ones.
    void become(const Readout& wanted) {
        for (const auto& [key, command] : commandsFor(differences(wanted, readout()), wanted))
            session.params.sendCommand(key, command);
    }

    FakeClock clock;
    ProgramState state;
    sim::VirtualInstrument instrument{clock};
    sim::SimVisa link{instrument};
    Lines failures;
    Session session;
};

inline std::string names(const Differences& differing) {
    std::string text;
    for (const auto& [key, network, wanted, present] : differing) {
        text.append(key).append(" ").append(network).append(": wanted ").append(wanted.value_or("(none)"));
        text.append(", present ").append(present.value_or("(none)")).append("\n");
    }
    return text;
}

/// The shipped data, and a virtual instrument to read out.
class ReadoutTest : public ::testing::Test, protected Bench {
protected:
    ReadoutTest() { folder.copyShipped(); }

    Profile dataSet(int number) { return Profile::ofFile(data, dataSetFile(std::to_string(number))); }
    /// The file that the read-out makes.
    Profile kept(const Readout& readout, const std::string& before = {}) {
        ProfileText text(before);
        keep(readout, text);
        folder.write("Gelesen.INI", text.bytes());
        return Profile::ofFile(data, utf8Of(folder.data() / "Gelesen.INI"));
    }

    Laboratory lab{data, captions};
};

}  // namespace kdx::test
