#include "station/readout.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <random>

#include "base/numbers.h"
#include "link/commandsequence.h"
#include "settings/profilefile.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "station/comparison.h"
#include "station/session.h"
#include "station/setupfile.h"
#include "support/linkfixture.h"

namespace kdx::test {
namespace {

using ::testing::IsEmpty;

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

std::string names(const Differences& differing) {
    std::string text;
    for (const auto& [key, network, wanted, present] : differing) {
        text.append(key).append(" ").append(network).append(": wanted ").append(wanted.value_or("(none)"));
        text.append(", present ").append(present.value_or("(none)")).append("\n");
    }
    return text;
}

std::optional<std::string> valueOf(const Readout& readout, const std::string& key, const std::string& network = {}) {
    for (const Reading& reading : readout) {
        if (reading.key == key && reading.network == network) return reading.value;
    }
    return std::nullopt;
}

class ReadoutTest : public ::testing::Test, protected Bench {
protected:
    ReadoutTest() { folder.copyShipped(); }

    Profile dataSet(int number) { return Profile::ofFile(data, dataSetFile(std::to_string(number))); }
    /// The file that the read-out makes.
    Profile kept(const Readout& readout, const std::string& before = {}) {
        ProfileText text(before);
        keep(readout, text);
        folder.write("Gelesen.INI", text.bytes());
        return Profile::ofFile(data, folder.data() / "Gelesen.INI");
    }

    Laboratory lab{data, captions};
};

TEST_F(ReadoutTest, GivesEveryValueAsItsKeyTakesIt) {
    for (const auto& [key, value] : std::map<std::string, std::string>{{"PS", "AB"},
                                                                       {"PTY", "7"},
                                                                       {"RDS_HUB", "220"},
                                                                       {"PILOT_PHASE", "-3"},
                                                                       {"AF1", "N,98.5,90.1"},
                                                                       {"AF2", "+,98.5,91.1"},
                                                                       {"HF:PEGEL:STATE", "ON"},
                                                                       {"HF-Frequenz", "98.50"},
                                                                       {"RTA", "Hallo"}})
        lab.send(key, value);
    const Readout readout = lab.readout();
    EXPECT_EQ(valueOf(readout, "PS"), "AB");
    EXPECT_EQ(valueOf(readout, "PTY"), "7");
    EXPECT_EQ(valueOf(readout, "RDS_HUB"), "220");
    EXPECT_EQ(valueOf(readout, "PILOT_PHASE"), "-3");
    EXPECT_EQ(valueOf(readout, "AF1"), "N,98.5,90.1");
    EXPECT_EQ(valueOf(readout, "AF2"), "+,98.5,91.1");
    EXPECT_EQ(valueOf(readout, "AF3"), "");
    EXPECT_EQ(valueOf(readout, "HF:PEGEL:STATE"), "ON");
    EXPECT_EQ(valueOf(readout, "HF-Frequenz"), "98.5");
    EXPECT_EQ(valueOf(readout, "RT"), "Hallo");
    EXPECT_EQ(valueOf(readout, "RT_N"), "5,1");
    EXPECT_THAT(unanswered(readout), IsEmpty());
    EXPECT_THAT(lab.failures, IsEmpty());
}

TEST_F(ReadoutTest, ReadsAnswersOfAnyLengthToTheirEnd) {
    std::string list = "98.5";
    for (int i = 0; i < 25; ++i) list += ",101." + std::to_string(i % 10);
    lab.send("AF1", "N," + list);
    lab.send("RT", std::string(64, 'x'));
    EXPECT_EQ(valueOf(lab.readout(), "AF1"), "N," + list);
    EXPECT_EQ(valueOf(lab.readout(), "RT"), std::string(64, 'x'));
}

TEST_F(ReadoutTest, ReadsEveryOtherNetwork) {
    for (const char* pi : {"D3C2", "D3C3"}) {
        lab.send("EON_PI", pi);
        lab.send("EON_PS", pi);
        lab.send("EON_AFB1", "N,98.5,90.1");
    }
    const Readout readout = lab.readout();
    EXPECT_EQ(valueOf(readout, "EON_PI", "D3C2"), "D3C2");
    EXPECT_EQ(valueOf(readout, "EON_PS", "D3C3"), "D3C3");
    EXPECT_EQ(valueOf(readout, "EON_AFB1", "D3C3"), "N,98.5,90.1");
    EXPECT_EQ(valueOf(readout, "EON_AFB5", "D3C3"), "");
}

/// Gives answers to the first questions only.
class Forgetful : public ::testing::Test, protected LinkFixture {
protected:
    Forgetful() { instrument.open("TCPIP", "10.0.0.1"); }
};

TEST_F(Forgetful, AQuestionThatTheInstrumentDoesNotKnowStaysWithoutValue) {
    visa.answersTo[coder("SRC")] = "\"3\"\n";
    const Readout readout = readOut(instrument);
    EXPECT_EQ(valueOf(readout, "MPX_SOURCE"), "3");
    EXPECT_EQ(valueOf(readout, "PS"), std::nullopt);
    EXPECT_EQ(unanswered(readout).size(), readout.size() - 1);
    EXPECT_THAT(failures, IsEmpty());
}

TEST_F(Forgetful, AnInstrumentThatNeverAnswersHasFailed) {
    stopAtFailure = true;
    const CommandSequence sequence(instrument);
    const Readout readout = readOut(instrument);
    EXPECT_EQ(unanswered(readout).size(), readout.size());
    EXPECT_EQ(failures.size(), 1U);
}

TEST_F(ReadoutTest, WhatIsTheSameDoesNotDiffer) {
    const Readout readout = lab.readout();
    EXPECT_THAT(differences(readout, readout), IsEmpty());
    Readout silent = readout;
    for (Reading& reading : silent) reading.value.reset();
    EXPECT_THAT(differences(readout, silent), IsEmpty());
}

TEST_F(ReadoutTest, NetworksThatAreMissingOrTooManyAreOneDifferenceEach) {
    const Readout without = lab.readout();
    lab.send("EON_PI", "D3C2");
    const Readout with = lab.readout();
    EXPECT_EQ(names(differences(with, without)), "EON_PI D3C2: wanted D3C2, present (none)\n");
    EXPECT_EQ(names(differences(without, with)), "EON_PI D3C2: wanted (none), present D3C2\n");
}

TEST_F(ReadoutTest, OnlyWhatDiffersIsSent) {
    const Readout before = lab.readout();
    lab.send("PS", "ANDERS");
    lab.send("AM_AUS", "");
    const auto commands = commandsFor(differences(before, lab.readout()), before);
    ASSERT_EQ(commands.size(), 1U);
    EXPECT_EQ(commands[0].key, "PS");
    EXPECT_EQ(commands[0].command, direct("PS=KDX-X4  "));
}

TEST_F(ReadoutTest, AListThatIsTooManyTakesAllListsAnew) {
    lab.send("EON_PI", "D3C2");
    lab.send("EON_PS", "NACHBAR");
    lab.send("EON_AFB1", "N,98.5,90.1");
    const Readout before = lab.readout();
    lab.send("EON_AFB2", "+,98.5,90.2");
    lab.become(before);
    EXPECT_EQ(names(differences(before, lab.readout())), "");
}

TEST_F(ReadoutTest, ATextWithADoubleQuoteIsNotSent) {
    Readout wanted = lab.readout();
    for (Reading& reading : wanted) {
        if (reading.key == "PS" || reading.key == "RT") reading.value = "A\"B";
    }
    EXPECT_THAT(commandsFor(differences(wanted, lab.readout()), wanted), IsEmpty());
}

TEST_F(ReadoutTest, WhatADataSetLeavesAloneIsNoDifference) {
    lab.apply(dataSet(2));
    lab.send("STEREO_MODE", "1");
    lab.send("ARI-BK", "C");
    EXPECT_EQ(names(compared(data, captions, dataSet(2), lab.readout()).differing), "");
    lab.send("TA", "1");
    lab.send("HF-Pegel", "20");
    EXPECT_EQ(names(compared(data, captions, dataSet(2), lab.readout()).differing),
              "TA : wanted 0, present 1\nHF-Pegel : wanted 80, present 20\n");
}

TEST_F(ReadoutTest, TheFileKeepsWhatItHeldBesides) {
    kept(lab.readout(), "; Notiz\r\n[RDS]\r\nRTB=Zweiter\r\nPS=ALT\r\n[Eigenes]\r\nA=1\r\n");
    EXPECT_EQ(profile("Gelesen.INI", "RDS", "RTB"), "Zweiter");
    EXPECT_EQ(profile("Gelesen.INI", "RDS", "PS"), "KDX-X4");
    EXPECT_EQ(profile("Gelesen.INI", "Eigenes", "A"), "1");
    EXPECT_THAT(folder.read("Gelesen.INI"), ::testing::StartsWith("; Notiz\r\n"));
}

TEST_F(ReadoutTest, LineBreaksInAnAnswerBecomeNoSettings) {
    Readout readout = lab.readout();
    for (Reading& reading : readout) {
        if (reading.key == "PS") reading.value = "A\rPI=FFFF";
    }
    kept(readout);
    EXPECT_EQ(profile("Gelesen.INI", "RDS", "PI"), "1000");
}

TEST_F(ReadoutTest, BlanksAtTheEdgeAndQuotesComeBack) {
    for (const char* text : {"  AB", "'AB'", " A' B"}) {
        lab.send("PS", text);
        lab.send("RT", text);
        Laboratory other{data, captions};
        other.apply(kept(lab.readout()));
        EXPECT_EQ(valueOf(other.readout(), "PS"), text);
        EXPECT_EQ(valueOf(other.readout(), "RT"), text);
    }
}

TEST_F(ReadoutTest, WhatDoesNotComeBackIsNamed) {
    lab.send("TA", "1");
    lab.send("PILOT_PHASE", "90");
    lab.send("STEREO_MODE", "5");
    lab.send("EON_PI", "D3C2");
    lab.send("EON_PI", "D3C3");
    const Readout readout = lab.readout();
    const NotKept lost = notKept(data, captions, kept(readout), readout);
    EXPECT_EQ(names(lost.changed),
              "PILOT_PHASE : wanted 5, present 90\nTA : wanted 0, present 1\nRT_N : wanted 10,0, present 0,0\n"
              "HF:PEGEL:STATE : wanted ON, present OFF\nEON_PI D3C3: wanted (none), present D3C3\n");
    EXPECT_EQ(valueOf(lost.unsent, "STEREO_MODE"), "5");
}

TEST_F(ReadoutTest, ASequenceThatIsTooLongForAFileIsNamed) {
    std::string sequence = "10A";
    for (int i = 0; i < 80; ++i) sequence += ",10A";
    lab.send("GROUPSEQ", sequence);
    const Readout readout = lab.readout();
    const NotKept lost = notKept(data, captions, kept(readout), readout);
    ASSERT_FALSE(lost.changed.empty());
    EXPECT_EQ(lost.changed.at(1).key, "GROUPSEQ");
}

class ReadDataSet : public ReadoutTest, public ::testing::WithParamInterface<int> {};

TEST_P(ReadDataSet, ReadThenAppliedDiffersInNothing) {
    lab.apply(dataSet(GetParam()));
    const Readout readout = lab.readout();
    EXPECT_EQ(names(compared(data, captions, dataSet(GetParam()), readout).differing), "");
    const Profile file = kept(readout);
    EXPECT_EQ(names(notKept(data, captions, file, readout).changed), "");
    Laboratory other{data, captions};
    EXPECT_NE(names(compared(data, captions, file, other.readout()).differing), "");
    other.apply(file);
    EXPECT_EQ(names(compared(data, captions, file, other.readout()).differing), "");
    EXPECT_EQ(names(differences(readout, other.readout())), "");
}

INSTANTIATE_TEST_SUITE_P(Shipped, ReadDataSet, ::testing::Range(1, 6));

/// Values within the instrument's limits, other ones each time, the same ones in each run.
class RandomValues {
public:
    explicit RandomValues(unsigned seed) : m_engine(seed) {}

    void sendTo(Laboratory& lab) {
        for (const char* flag : {"PILOT", "ARI", "RDS", "TP", "TA"}) lab.send(flag, whole(0, 1));
        lab.send("MPX_HUB", whole(0, 8000));
        lab.send("MPX_SOURCE", whole(0, 3));
        lab.send("MPX_IMPEDANZ", whole(1, 2));
        lab.send("STEREO_MODE", whole(1, 5));
        lab.send("PREEMPHASIS", whole(0, 2));
        lab.send("PILOT_HUB", whole(0, 1500));
        lab.send("PILOT_PHASE", whole(-180, 180));
        lab.send("ARI-HUB", whole(0, 800));
        lab.send("ARI-ID", whole(0, 3));
        lab.send("ARI-BK", std::string(1, static_cast<char>('A' + number(0, 5))));
        lab.send("RDS_HUB", whole(0, 400));
        lab.send("RDS_PHASE", whole(0, 359));
        lab.send("PI", pi());
        lab.send("PS", text(0, 8));
        lab.send("PTY", whole(0, 31));
        lab.send("MS", number(0, 1) == 0 ? "M" : "S");
        lab.send("DI", whole(0, 15));
        lab.send(number(0, 1) == 0 ? "RT" : "RTA", text(0, 64));
        lab.send("TEST_M", whole(0, 4));
        sendLists(lab, "AF");
        sendNetworks(lab);
        lab.send("GROUPSEQ", groups());
        lab.send("HF-Frequenz", shortestDecimal(number(1, 10400) / 10.0));
        lab.send("HF-Pegel", shortestDecimal(number(0, 1200) / 10.0));
        lab.send("NF-Frequenz", shortestDecimal(number(2, 8000) / 100.0));
        lab.send("HF:PEGEL:STATE", number(0, 1) == 0 ? "OFF" : "ON");
        lab.send(number(0, 1) == 0 ? "FM_EIN" : "FM_AUS", "");
    }

private:
    int number(int lowest, int highest) { return std::uniform_int_distribution<>(lowest, highest)(m_engine); }
    std::string whole(int lowest, int highest) { return std::to_string(number(lowest, highest)); }
    std::string text(int shortest, int longest) {
        std::string result;
        for (int length = number(shortest, longest); length > 0; --length) {
            const int code = number(0x20, 0xFF);
            result += static_cast<char>(code == '"' || code == 0x7F ? ' ' : code);
        }
        return result;
    }
    std::string pi() {
        std::string result;
        for (int i = 0; i < 4; ++i) result += "0123456789ABCDEF"[number(0, 15)];
        return result;
    }
    std::string frequencies() {
        std::string list = shortestDecimal(number(876, 1079) / 10.0);
        for (int count = number(0, 25); count > 0; --count) list += "," + shortestDecimal(number(876, 1079) / 10.0);
        return list;
    }
    void sendLists(Laboratory& lab, const std::string& key) {
        const int lists = number(0, 5);
        for (int list = 1; list <= lists; ++list)
            lab.send(key + std::to_string(list), (list == 1 ? "N," : "+,") + frequencies());
    }
    void sendNetworks(Laboratory& lab) {
        const int networks = number(0, 2);
        for (int network = 0; network < networks; ++network) {
            lab.send("EON_PI", pi());
            lab.send("EON_PS", text(0, 8));
            lab.send("EON_PTY", whole(0, 31));
            lab.send("EON_TP", whole(0, 1));
            lab.send("EON_TA", whole(0, 1));
            if (number(0, 1) == 0) lab.send("EON_AFA", frequencies());
            sendLists(lab, "EON_AFB");
        }
    }
    std::string groups() {
        std::string sequence;
        for (int count = number(1, 60); count > 0; --count)
            sequence += (sequence.empty() ? "" : ",") + whole(0, 15) + (number(0, 1) == 0 ? "A" : "B");
        return sequence;
    }

    std::mt19937 m_engine;
};

/// The read-out with what becomes of it when it is kept in a file.
Readout withChanges(Readout readout, const Differences& changed) {
    for (const auto& [key, network, wanted, present] : changed) {
        for (Reading& reading : readout) {
            if (reading.key == key && reading.network == network && wanted) reading.value = wanted;
        }
        if (!wanted) std::erase_if(readout, [&pi = network](const Reading& reading) { return reading.network == pi; });
    }
    return readout;
}

class RandomSettings : public ReadoutTest, public ::testing::WithParamInterface<unsigned> {};

TEST_P(RandomSettings, ReadThenAppliedDifferInNothing) {
    RandomValues values(GetParam());
    for (int round = 0; round < 125; ++round) {
        SCOPED_TRACE(round);
        Laboratory bench{data, captions};
        values.sendTo(bench);
        const Readout readout = bench.readout();
        ASSERT_THAT(unanswered(readout), IsEmpty());
        const Profile file = kept(readout);
        const NotKept lost = notKept(data, captions, file, readout);
        bench.apply(file);
        const Readout applied = bench.readout();
        ASSERT_EQ(names(compared(data, captions, file, applied).differing), "");
        // What is not named comes back, and what is named becomes what was said.
        ASSERT_EQ(names(differences(withChanges(readout, lost.changed), applied)), "");
        // Whatever the file cannot keep, the way back from it is known.
        bench.become(readout);
        ASSERT_EQ(names(differences(readout, bench.readout())), "");
    }
}

// A thousand in all, in parts that run side by side.
INSTANTIATE_TEST_SUITE_P(Seeds, RandomSettings, ::testing::Range(1U, 9U));

}  // namespace
}  // namespace kdx::test
