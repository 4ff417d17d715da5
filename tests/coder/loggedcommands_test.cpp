#include "coder/loggedcommands.h"

#include <gtest/gtest.h>

#include "support/linkfixture.h"

namespace kdx::test {
namespace {

using Commands = std::vector<std::pair<std::string, std::string>>;
using Numbers = std::vector<std::size_t>;

class LoggedCommandsTest : public ::testing::Test, protected LinkFixture {};

TEST_F(LoggedCommandsTest, AreWhatTheProgramHasLoggedAsSent) {
    state.LogEnabled = true;
    params.SendParam("PS", "A\"B");
    instrument.X4_Abfrage("PS?", "PS");
    instrument.VRN_Abfrage("Freq?", "FREQ");
    params.SendParam("STEREO_MODE", "0");  // an empty command is logged too
    params.SendParam("HF:PEGEL:STATE", "ON");
    const LoggedCommands logged = readLoggedCommands(folder.read("RDS_log.txt"));
    EXPECT_EQ(logged.unreadableLines, Numbers());
    EXPECT_EQ(logged.commands,
              (Commands{{"PS", R"(:STEREO:DIRECT "PS=A"B     ")"}, {"HF:PEGEL:STATE", ":OUTPUT:STAT ON"}}));
    EXPECT_EQ(logged.quotedLines, Numbers{1});
}

TEST(ReadLoggedCommandsTest, TakesAnAnswerForOneWhateverLineEndItHas) {
    for (const std::string end : {"", "\n", "\r\n"}) {
        const auto logged = readLoggedCommands("            PS?= Answer \"\"RADIO   \"" + end + "        \"\r\n" +
                                               "             TP= \"TP ON\"\r\n");
        EXPECT_EQ(logged.unreadableLines, Numbers());
        EXPECT_EQ(logged.commands, (Commands{{"TP", "TP ON"}}));
    }
}

TEST(ReadLoggedCommandsTest, NamesEachLineThatNoProgramOfOursHasWritten) {
    const std::string good = "             TP= \"TP ON\"\r\n";
    const auto logged = readLoggedCommands(good + "TP= \"x\"\r\n\r\n" + good + "what is this, a letter?\r\nend");
    EXPECT_EQ(logged.unreadableLines, (Numbers{2, 3, 5, 6}));
    EXPECT_EQ(logged.commands.size(), 2U);
}

TEST(ReadLoggedCommandsTest, TakesLinesThatEndWithALineFeedAlone) {
    const auto logged = readLoggedCommands(
        "             PS= \":STEREO:DIRECT \"PS=RADIO   \"\"\n"
        "            PS?= Answer \"\"RADIO   \"\n        \"\n"
        "        Antwort= what ever\n"
        "             TP= \"TP ON\"\n");
    EXPECT_EQ(logged.unreadableLines, Numbers());
    EXPECT_EQ(logged.commands, (Commands{{"PS", R"(:STEREO:DIRECT "PS=RADIO   ")"}, {"TP", "TP ON"}}));
}

TEST(ReadLoggedCommandsTest, NamesEachCommandThatIsNotWhole) {
    const std::string whole = "             PS= \":STEREO:DIRECT \"PS=RADIO   \"\"";
    const std::string key = "             PS= ";
    for (std::size_t length = 1; length < whole.size(); ++length) {
        SCOPED_TRACE(length);
        const auto atEnd = readLoggedCommands(whole + "\r\n" + whole.substr(0, length));
        EXPECT_EQ(atEnd.commands.size(), 1U);
        EXPECT_EQ(atEnd.unreadableLines, Numbers{2});
        if (length == key.size()) continue;  // with a line end that is an empty command
        const auto between = readLoggedCommands(whole.substr(0, length) + "\r\n" + whole + "\r\n");
        EXPECT_EQ(between.commands.size(), 1U);
        EXPECT_EQ(between.unreadableLines, Numbers{1});
    }
    EXPECT_EQ(readLoggedCommands(whole).commands.size(), 1U);
}

TEST(ReadLoggedCommandsTest, AnAnswerThatDoesNotEndIsNamedAndSwallowsNoCommand) {
    for (const std::string end : {"\n", "\r\n"}) {
        const std::string good = "             TP= \"TP ON\"" + end;
        for (const std::string answer : {"Answer \"", "Answer \"98"}) {
            const std::string cut = "           FREQ= " + answer;
            const auto logged = readLoggedCommands(std::string(cut).append(end).append(good));
            EXPECT_EQ(logged.unreadableLines, Numbers{1});
            EXPECT_EQ(logged.commands, (Commands{{"TP", "TP ON"}}));
            EXPECT_EQ(readLoggedCommands(good + cut).unreadableLines, Numbers{2});
        }
    }
}

TEST(ReadLoggedCommandsTest, LinesThatShowWhatEverAreNoCommands) {
    const auto logged =
        readLoggedCommands("             PS= what ever\r\n             PS= a \"b\"\r\n             PS= \r\n");
    EXPECT_EQ(logged.unreadableLines, Numbers());
    EXPECT_EQ(logged.commands, Commands());
}

TEST(ReadLoggedCommandsTest, AnEmptyLogHasNone) {
    EXPECT_TRUE(readLoggedCommands("").commands.empty());
    EXPECT_TRUE(readLoggedCommands("").unreadableLines.empty());
}

}  // namespace
}  // namespace kdx::test
