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

TEST(ReadLoggedCommandsTest, AnEmptyLogHasNone) {
    EXPECT_TRUE(readLoggedCommands("").commands.empty());
    EXPECT_TRUE(readLoggedCommands("").unreadableLines.empty());
}

}  // namespace
}  // namespace kdx::test
