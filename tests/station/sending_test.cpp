#include <gtest/gtest.h>

#include "base/paths.h"
#include "station/session.h"
#include "station/wholedataset.h"

namespace kdx::test {
namespace {

/// A whole data set is sent where there is no window.
class SendingTest : public ::testing::Test, protected Bench {
protected:
    SendingTest() {
        folder.write("RDS_Allg.INI", kWholeGeneral);
        folder.write("Datenset1.INI", kWholeDataSet);
        visa.answersTo[coder("EON PI?")] = kTwoNetworks;
        session.instrument.onFailure([this](const std::string& text, bool) {
            failures.push_back(text);
            return stopAtFailure;
        });
    }
    void open() {
        session.load();
        EXPECT_EQ(session.open("TCPIP", "10.0.0.1"), 0);
    }

    Session session{visa, state, data, captions, clock, [] {}};
    Lines failures;
    bool stopAtFailure = false;
};

TEST_F(SendingTest, AnOpeningSendsExactlyThis) {
    open();
    EXPECT_TRUE(session.sendOpening());
    EXPECT_EQ(sent(), openingCommands());
}

TEST_F(SendingTest, TheDataSetAloneIsPartOfIt) {
    open();
    EXPECT_TRUE(session.sendDataSet());
    EXPECT_EQ(sent(), kDataSetCommands);
}

TEST_F(SendingTest, EveryCommandWaitsAndTheQuestionOnceMore) {
    open();
    session.sendOpening();
    const auto commands = static_cast<double>(sent().size());
    // All but "*IDN?" and the question wait before they go out; the question waits before its answer is read.
    EXPECT_NEAR(clock.sleptMs(), (commands - 1) * 50, commands * 4);
}

TEST_F(SendingTest, EveryFailingCommandIsToldAndTheNextOneGoesOut) {
    open();
    visa.writeStatus = visa::kTimeout;
    // The failing question is not answered either, so one removal without a network goes out instead of two.
    visa.answersTo.clear();
    EXPECT_TRUE(session.sendDataSet());
    EXPECT_EQ(failures.size(), kDataSetCommands.size());
    EXPECT_EQ(sent().size(), kDataSetCommands.size() - 1);
}

TEST_F(SendingTest, AFailedQuestionForOtherNetworksRemovesOneWithoutAName) {
    open();
    visa.readStatuses = {visa::kTimeout};
    session.sendDataSet();
    EXPECT_EQ(failures.size(), 1U);
    const Lines commands = sent();
    EXPECT_EQ(std::count(commands.begin(), commands.end(), direct("EON-DEL=")), 1);
}

TEST_F(SendingTest, TheRestCanBeStoppedAtTheFirstFailureAndTheNextSequenceTriesAgain) {
    open();
    visa.writeStatus = visa::kConnectionLost;
    stopAtFailure = true;
    for (int i = 0; i < 2; ++i) {
        EXPECT_FALSE(session.sendDataSet());
        EXPECT_EQ(sent().size(), 1U);
    }
}

TEST_F(SendingTest, AnEmptyFirstListKeepsAllAfListsBack) {
    setProfile("Datenset1.INI", "RDS", "AF_LISTE1", "");
    open();
    session.sendOpening();
    for (const std::string& command : sent()) EXPECT_EQ(command.find("\"AF="), std::string::npos);
}

TEST_F(SendingTest, WithoutAGroupSequenceNoneIsSent) {
    setProfile("Datenset1.INI", "RDS", "GR_FOLGE", "");
    open();
    session.sendOpening();
    for (const std::string& command : sent()) EXPECT_EQ(command.find("GS="), std::string::npos);
}

TEST_F(SendingTest, TheLogHoldsALineForEveryCommand) {
    state.LogEnabled = true;
    open();
    session.sendOpening();
    const std::string log = folder.read("RDS_log.txt");
    EXPECT_NE(log.find("             PS= \":STEREO:DIRECT \"PS=FUNK    \"\"\r\n"), std::string::npos) << log;
    EXPECT_NE(log.find("         EON-PI= :STEREO:DIRECT? \"EON PI?\"\r\n"), std::string::npos) << log;
    EXPECT_EQ(log.find("ARI_HUB"), std::string::npos);  // a key without a command leaves no trace
}

TEST_F(SendingTest, ADataSetFromAnotherFileIsSentWithItsOwnLists) {
    folder.write("Anderswo.INI", "[RDS]\r\nPS=FREMD\r\nAF_LISTE1=99.9,100.1\r\nEON_PI=F00D\r\nEON_AFB1=88.8,89.9\r\n");
    session.load(Profile::ofFile(data, utf8Of(folder.data() / "Anderswo.INI")));
    EXPECT_EQ(session.open("TCPIP", "10.0.0.1"), 0);
    EXPECT_TRUE(session.sendDataSet());
    const Lines commands = sent();
    for (const std::string& own :
         {direct("PS=FREMD   "), direct("AF=N,99.9,100.1"), direct("EON-AFB=F00D,N,88.8,89.9")}) {
        EXPECT_EQ(std::count(commands.begin(), commands.end(), own), 1) << own;
    }
    EXPECT_EQ(std::count(commands.begin(), commands.end(), direct("AF=N,87.6,90.1,94.3")), 0);
}

}  // namespace
}  // namespace kdx::test
