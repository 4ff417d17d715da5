#include <string>
#include <tuple>
#include <utility>

#include "sim/simtest.h"

namespace kdx::sim {
namespace {

class CommandReader : public SimTest {};

TEST_F(CommandReader, TakesLongAndShortFormsOfEveryWord) {
    tell(":STER:PIL:DEV 1KHZ");
    EXPECT_EQ(ask("STEREO:PIL:DEVIATION?"), "1000");
    tell("OUTP:STATE ON;:FREQUENCY 101.7MHZ;POWER 55");
    EXPECT_EQ(ask("OUTPUT:STAT?;:FREQ?;:POW?"), "1;101.7;55");
    tell(":stereo:external:impedance 100000;:SYSTEM:ERROR:NEXT?");
    EXPECT_EQ(ask(":ster:ext:imp?"), "100000");
    EXPECT_EQ(ask("SYSTEM:ERROR?"), "0,\"No error\"");
}

TEST_F(CommandReader, TakesNoFormInBetween) {
    tell(":STERE:PILOT:STATE ON");
    EXPECT_EQ(error(), -113);
    tell(":STEREO:PILOT:STATE:MORE ON");
    EXPECT_EQ(error(), -113);
    tell(":STEREO:PILOT ON");
    EXPECT_EQ(error(), -113);
    EXPECT_EQ(askCoder("PIL"), "\"0\"");
}

TEST_F(CommandReader, ContinuesThePathOfTheCommandBefore) {
    tell(":STEREO:PILOT:STATE ON;DEVIATION 1KHZ;*OPC;PHASE 3");
    EXPECT_EQ(ask(":STEREO:PILOT:STATE?;DEVIATION?;PHASE?"), "1;1000;3");
    EXPECT_EQ(error(), 0);
}

TEST_F(CommandReader, KeepsToThePathWhereItLeadsNowhere) {
    tell(":STEREO:PILOT:STATE ON;STEREO:RDS:STATE ON;DEVIATION 1KHZ");
    EXPECT_EQ(error(), -113);
    EXPECT_EQ(ask(":STEREO:PILOT:STATE?;DEVIATION?;:STEREO:RDS:STATE?"), "1;1000;0");
    EXPECT_EQ(tell("STER:PIL:DEV?;FREQ?"), "1000\n");
    EXPECT_EQ(error(), -113);
}

TEST_F(CommandReader, StartsEveryLineAtTheTop) {
    tell(":STEREO:AUDIO:MODE LEFT\nFREQ 99.9MHZ\n");
    EXPECT_EQ(ask("FREQ?"), "99.9");
}

TEST_F(CommandReader, AnswersEachLineByItself) {
    EXPECT_EQ(tell("*OPC?;*OPC?\n*OPC?"), "1;1\n1\n");
}

TEST_F(CommandReader, TakesAnEmptyMessageQuietly) {
    for (const char* message : {"", "\n", "\r\n", "   ", ";", ";;\n"}) {
        EXPECT_EQ(tell(message), "");
        EXPECT_EQ(error(), 0) << message;
    }
    // The last element is a message of NUL bytes: white space by IEEE 488.2.
    EXPECT_EQ(tell(std::string(3, '\0')), "");
    EXPECT_EQ(error(), 0);
}

TEST_F(CommandReader, TakesASemicolonInsideQuotesAsText) {
    coder("PS=A;B;C");
    EXPECT_EQ(askCoder("PS"), "\"A;B;C   \"");
}

TEST_F(CommandReader, TakesADoubledQuoteForOneAndDoublesItInTheAnswer) {
    coder("RT=10,0,the \"\"big\"\" one");
    EXPECT_EQ(askCoder("RT"), "\"the \"\"big\"\" one\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CommandReader, TakesSingleQuotesToo) {
    tell(":STEREO:DIRECT 'PS=A;B\"C'");
    EXPECT_EQ(askCoder("PS"), "\"A;B\"\"C   \"");
    tell(":STEREO:DIRECT 'RT=10,0,it''s \"on\"'");
    EXPECT_EQ(ask(":STEREO:DIRECT? 'RT'"), "\"it's \"\"on\"\"\"");
    coder("RT=10,0,it's");
    EXPECT_EQ(askCoder("RT"), "\"it's\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CommandReader, TakesTheWordsForTheEndsOfARangeAndTheDefault) {
    for (const auto& [word, frequency, phase] : {std::tuple{"MAX", "1040", "180"},
                                                 {"minimum", "0.1", "-180"},
                                                 {"DEF", "100", "0"},
                                                 {"Maximum", "1040", "180"}}) {
        const std::string text = word;
        EXPECT_EQ(ask("FREQ? " + text), frequency);
        EXPECT_EQ(ask(":STEREO:PILOT:PHASE? " + text), phase);
        std::string both = "FREQ " + text;
        tell(both.append(";:STEREO:PILOT:PHASE ").append(text));
        EXPECT_EQ(ask("FREQ?;:STEREO:PILOT:PHASE?"), std::string(frequency) + ";" + phase);
    }
    EXPECT_EQ(error(), 0);
    tell("FREQ MAXI");
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(tell("FREQ? HIGHEST"), "");
    EXPECT_EQ(error(), -224);
}

TEST_F(CommandReader, TakesTheWordsForTheEndsWhereThereIsAChoiceOfNumbersToo) {
    const std::string impedance = ":STEREO:EXTERNAL:IMP";
    for (const auto& [word, ohms] :
         {std::pair{"MAX", "100000"}, {"DEF", "600"}, {"maximum", "100000"}, {"MIN", "600"}}) {
        EXPECT_EQ(ask(impedance + "? " + word), ohms);
        tell(impedance + " " + word);
        EXPECT_EQ(ask(impedance + "?"), ohms);
    }
    EXPECT_EQ(error(), 0);
    for (const auto& [message, code] : {std::pair{impedance + " MAXI", -224},
                                        {impedance + "? MAXI", -108},
                                        {":STEREO:SOURCE MAX", -224},
                                        {":STEREO:SOURCE? MAX", -108}}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), code) << message;
    }
}

TEST_F(CommandReader, RoundsANumberForASwitch) {
    for (const auto& [number, state] : {std::pair{"1", "1"}, {"0.4", "0"}, {"0.6", "1"}, {"-0.4", "0"}, {"2", "1"}}) {
        tell(std::string(":OUTPUT:STATE ") + number);
        EXPECT_EQ(ask(":OUTPUT:STATE?"), state) << number;
    }
    EXPECT_EQ(error(), 0);
}

TEST_F(CommandReader, TakesANumberTooSmallToBeHeldForZero) {
    tell("STEREO:STAT 1e-400;:STEREO:PILOT:PHASE -1e-400DEG");
    EXPECT_EQ(ask("STEREO:STAT?;PILOT:PHASE?"), "0;0");
    EXPECT_EQ(error(), 0);
}

TEST_F(CommandReader, TakesUnitsWithABlankAndInAnyLetterCase) {
    tell(":STEREO:DEVIATION 67.5 kHz");
    EXPECT_EQ(askCoder("MPX-DEV"), "\"6750\"");
    tell("FREQ +98500000 Hz");
    EXPECT_EQ(ask("FREQ?"), "98.5");
    tell("FREQ 1E2");
    EXPECT_EQ(ask("FREQ?"), "100");
}

TEST_F(CommandReader, RefusesAUnitOfAnotherKind) {
    tell(":STEREO:DEVIATION 5DEG");
    EXPECT_EQ(error(), -131);
    tell(":POW 5HZ");
    EXPECT_EQ(error(), -131);
    tell("FREQ 5XYZ");
    EXPECT_EQ(error(), -131);
    EXPECT_EQ(ask("FREQ?"), "100");
}

TEST_F(CommandReader, AnswersANumberInTheUnitItTakesWithoutOne) {
    for (const char* header : {"FREQ", ":POW", ":STEREO:DEVIATION", ":STEREO:AUDIO:FREQ", ":STEREO:PILOT:PHASE"}) {
        const std::string query = std::string(header) + "?";
        const std::string value = ask(query);
        tell(std::string(header) + " " + value);
        EXPECT_EQ(ask(query), value);
        EXPECT_EQ(error(), 0);
    }
}

}  // namespace
}  // namespace kdx::sim
