#include "station/readout.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/paths.h"
#include "link/commandsequence.h"
#include "readoutfixture.h"
#include "station/comparison.h"

namespace kdx::test {
namespace {

using ::testing::IsEmpty;

std::optional<std::string> valueOf(const Readout& readout, const std::string& key, const std::string& network = {}) {
    for (const Reading& reading : readout) {
        if (reading.key == key && reading.network == network) return reading.value;
    }
    return std::nullopt;
}

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
    Forgetful() {
        instrument.open("TCPIP", "10.0.0.1");
        visa.answersTo["*IDN?"] = "KDX\n";
    }
    std::string asked;  ///< last
};

TEST_F(Forgetful, AQuestionThatTheInstrumentDoesNotKnowStaysWithoutValue) {
    visa.answersTo[coder("PI")] = "\"ABCD\"\n";
    const Readout readout = readOut(instrument);
    EXPECT_EQ(valueOf(readout, "PI"), "ABCD");
    EXPECT_EQ(valueOf(readout, "PS"), std::nullopt);
    EXPECT_EQ(unanswered(readout).size(), readout.size() - 1);
    EXPECT_THAT(failures, IsEmpty());
}

TEST_F(Forgetful, ALineEndOfTwoCharactersIsNoPartOfTheAnswer) {
    visa.answersTo[coder("PI")] = "\"ABCD\"\r\n";
    EXPECT_EQ(valueOf(readOut(instrument), "PI"), "ABCD");
}

TEST_F(Forgetful, AQuestionThatAMomentOfSilenceMetIsPutOnceMore) {
    TrafficListener awake(instrument, [this](const Traffic& traffic) {
        if (traffic.kind == Traffic::Kind::Read && asked == coder("PI")) visa.answersTo[asked] = "\"ABCD\"\n";
        if (traffic.kind == Traffic::Kind::Written) asked = traffic.text;
    });
    const Readout readout = readOut(instrument);
    EXPECT_EQ(valueOf(readout, "PI"), "ABCD");
    EXPECT_EQ(unanswered(readout).size(), readout.size() - 1);
}

TEST_F(Forgetful, AnInstrumentThatNeverAnswersHasFailed) {
    visa.answersTo.clear();
    stopAtFailure = true;
    const CommandSequence sequence(instrument);
    const Readout readout = readOut(instrument);
    EXPECT_EQ(unanswered(readout).size(), readout.size());
    EXPECT_EQ(failures.size(), 1U);
}

TEST_F(Forgetful, AnAnswerThatComesLateIsNotTakenForAnotherOne) {
    visa.answersTo[coder("MODE")] = "\"2\"\n";
    TrafficListener late(instrument, [this](const Traffic& traffic) {
        // What was asked for with the source comes when the instrument is asked for its name.
        if (traffic.text == coder("SRC")) visa.answersTo["*IDN?"] = "\"1\"\n";
    });
    const Readout readout = readOut(instrument);
    EXPECT_EQ(unanswered(readout).size(), readout.size());
}

TEST_F(Forgetful, NetworksThatWereNotToldAreNeitherThereNorGone) {
    const Readout silent = readOut(instrument);
    EXPECT_EQ(valueOf(silent, "EON_PI"), std::nullopt);
    visa.answersTo[coder("EON-PI")] = "\" D3C2,\"\n";
    const Readout told = readOut(instrument);
    EXPECT_EQ(valueOf(told, "EON_PI", "D3C2"), "D3C2");
    EXPECT_THAT(differences(told, silent), IsEmpty());
    EXPECT_THAT(differences(silent, told), IsEmpty());
    ProfileText text("[RDS]\r\nEON_PI=D3C2\r\nEON_PS=NACHBAR\r\n");
    keep(silent, text);
    EXPECT_EQ(text.bytes(), "[RDS]\r\nEON_PI=D3C2\r\nEON_PS=NACHBAR\r\n");
}

TEST_F(ReadoutTest, WhatWasNotReadIsNotTakenForEmpty) {
    lab.send("AF1", "N,98.5,90.1");
    lab.send("AF2", "+,98.5,90.2");
    lab.send("RT", "Hallo");
    Readout wanted = lab.readout();
    for (Reading& reading : wanted) {
        if (reading.key == "AF1" || reading.key == "RT") reading.value.reset();
        if (reading.key == "AF2") reading.value = "+,98.5,90.3";
        if (reading.key == "RT_N") reading.value = "5,1";
    }
    EXPECT_THAT(commandsFor(differences(wanted, lab.readout()), wanted), IsEmpty());
}

TEST_F(ReadoutTest, WhatAFileLacksComesFromTheGeneralSettings) {
    folder.write("Halb.INI", "[FM]\r\nMPX_SOURCE=1\r\n[RDS]\r\nPI=ABCD\r\n");
    setProfile("RDS_Allg.INI", "FM", "MPX_DEV", "06000");
    lab.apply(Profile::ofFile(data, utf8Of(folder.data() / "Halb.INI")));
    EXPECT_EQ(valueOf(lab.readout(), "MPX_SOURCE"), "1");
    EXPECT_EQ(valueOf(lab.readout(), "MPX_HUB"), "6000");
    EXPECT_EQ(valueOf(lab.readout(), "HF-Frequenz"), "98.5");
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
    const auto commands = commandsFor(differences(wanted, lab.readout()), wanted, {.quotes = true});
    ASSERT_EQ(commands.size(), 2U) << "unless quotes are doubled";
    EXPECT_EQ(commands[0].command, direct("PS=A\"\"B     "));
    EXPECT_TRUE(commands[1].command.ends_with(",A\"\"B\"")) << commands[1].command;
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

TEST_F(ReadoutTest, WhatNoInstrumentCanHaveIsNotKept) {
    Readout readout = lab.readout();
    for (Reading& reading : readout) {
        if (reading.key == "PI" || reading.key == "STEREO_MODE") reading.value = "";
        if (reading.key == "HF-Frequenz") reading.value = "A\"B;*RST";
    }
    ProfileText text("[RDS]\r\nPI=D3C2\r\n");
    keep(readout, text);
    EXPECT_EQ(text.value("RDS", "PI"), "D3C2");
    EXPECT_EQ(text.value("FM", "Stereo_Mode"), "");
    EXPECT_EQ(text.value("VRN", "HF_Frequenz"), "");
    EXPECT_EQ(text.value("VRN", "HF_Pegel"), "60");
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

}  // namespace
}  // namespace kdx::test
