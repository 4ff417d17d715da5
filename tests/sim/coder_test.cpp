#include <ostream>

#include "sim/simtest.h"

namespace kdx::sim {
namespace {

using namespace std::chrono_literals;

class CoderTest : public SimTest {};

TEST_F(CoderTest, AnswersEveryQueryOfACoderJustSwitchedOn) {
    const std::pair<const char*, const char*> expected[] = {
        {"PS", "\"KDX-X4  \""}, {"PI", "\"1000\""},      {"PTY", "\"00\""}, {"TP", "\"0\""},
        {"TA", "\"0\""},        {"MS", "\"M\""},         {"DI", "\"1\""},   {"RT", "\"\""},
        {"RT-N", "\"0,0\""},    {"CT", "\"off\""},       {"AF1", "\"\""},   {"AF2", "\"\""},
        {"AF3", "\"\""},        {"AF4", "\"\""},         {"AF5", "\"\""},   {"GS", "\"0A,2A\""},
        {"SRC", "\"0\""},       {"MPX-DEV", "\"4000\""}, {"PRE", "\"0\""},  {"PIL", "\"0\""},
        {"PIL-DEV", "\"675\""}, {"PIL-PH", "\"0\""},     {"MODE", "\"3\""}, {"RDS", "\"0\""},
        {"RDS-DEV", "\"200\""}, {"RDS-PH", "\"0\""},     {"ARI", "\"0\""},  {"ARI-DEV", "\"350\""},
        {"ARI-ID", "\"0\""},    {"BK", "\"A\""},         {"IMP", "\"1\""},  {"BIN", "\"0\""},
        {"EON-PI", "\" \""},    {"3A", "\"\""},          {"3A-N", "\"0\""}, {"8A", "\"\""},
        {"8A-N", "\"0\""},      {"STORE", "\"\""},
    };
    for (const auto& [query, answer] : expected) {
        EXPECT_EQ(askCoder(query), answer) << query;
        EXPECT_EQ(error(), 0) << query;
    }
}

TEST_F(CoderTest, TakesNamesInAnyLetterCaseWithABlankForTheHyphenAndAQuestionMark) {
    coder("pilot=1");
    EXPECT_EQ(error(), -224);
    coder("pil-dev=500");
    EXPECT_EQ(askCoder("Pil-Dev"), "\"500\"");
    EXPECT_EQ(askCoder("PIL DEV?"), "\"500\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CoderTest, PadsThePsToEightCharactersAndTakesNoMore) {
    coder("PS=ABC");
    EXPECT_EQ(askCoder("PS"), "\"ABC     \"");
    coder("PS=");
    EXPECT_EQ(askCoder("PS"), "\"        \"");
    coder("PS=ABCDEFGHI");
    EXPECT_EQ(error(), -223);
    EXPECT_EQ(askCoder("PS"), "\"        \"");
}

TEST_F(CoderTest, KeepsEveryCharacterOfTheCodePageInTheTexts) {
    coder("PS=\xC4\xD6\xDC\xE4\xF6\xFC\xDF\x80");
    EXPECT_EQ(askCoder("PS"), "\"\xC4\xD6\xDC\xE4\xF6\xFC\xDF\x80\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CoderTest, RefusesControlCharactersThatWouldBreakAnAnswer) {
    coder("PS=AB\nCD");
    EXPECT_EQ(error(), -224);
    coder(std::string("RT=10,0,a\0b", 11));
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(askCoder("PS"), "\"KDX-X4  \"");
}

TEST_F(CoderTest, TakesFourHexadecimalDigitsForAPiAndAnswersThemInCapitals) {
    coder("PI=d3c2");
    EXPECT_EQ(askCoder("PI"), "\"D3C2\"");
    // Three digits typed by the user arrive filled up with a blank.
    for (const char* pi : {"d3c ", "", "D3C", "D3C22", "G000", " D3C"}) {
        coder(std::string("PI=") + pi);
        EXPECT_EQ(error(), -224) << pi;
    }
    EXPECT_EQ(askCoder("PI"), "\"D3C2\"");
}

TEST_F(CoderTest, RefusesWhatIsNoNumber) {
    for (const char* command : {"PTY=x", "PTY=1.5", "DI=1x", "TA=y", "MODE=LEFT", "BK=G", "MS=X", "MPX-DEV=5HZ",
                                "MPX-DEV=nan", "MPX-DEV=inf", "MPX-DEV=-", "MPX-DEV=."}) {
        coder(command);
        EXPECT_EQ(error(), -224) << command;
    }
    for (const char* command : {"PTY", "PTY=", "PTY= ", "DI=", "MPX-DEV=", "GS=", "GS", "CT"}) {
        coder(command);
        EXPECT_EQ(error(), -109) << command;
    }
}

TEST_F(CoderTest, ClearsTheRadiotextWithAnEmptyOneAndKeepsBlanks) {
    coder("RT=10,0,Hello");
    EXPECT_EQ(askCoder("RT"), "\"Hello\"");
    EXPECT_EQ(askCoder("RT-N"), "\"10,0\"");
    coder("RT=10,0,   ");
    EXPECT_EQ(askCoder("RT"), "\"   \"");
    coder("RT=0,0,");
    EXPECT_EQ(askCoder("RT"), "\"\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CoderTest, TakesARadiotextOf64CharactersAndNoLongerOne) {
    coder("RT=10,0," + std::string(64, 'x'));
    EXPECT_EQ(error(), 0);
    coder("RT=10,0," + std::string(65, 'y'));
    EXPECT_EQ(error(), -223);
    EXPECT_EQ(askCoder("RT"), "\"" + std::string(64, 'x') + "\"");
    for (const auto& [command, code] :
         {std::pair{"RT=Hello", -109}, {"RT=10,Hello", -109}, {"RT=x,0,Hello", -224}, {"RT=300,0,Hello", -222}}) {
        coder(command);
        EXPECT_EQ(error(), code) << command;
    }
}

TEST_F(CoderTest, RunsTheClockFromTheTimeItWasGiven) {
    coder("CT=23:59:58,31.12.09");
    clock.advance(1s);
    EXPECT_EQ(askCoder("CT"), "\"23:59:59,31.12.09\"");
    clock.advance(999ms);
    EXPECT_EQ(askCoder("CT"), "\"23:59:59,31.12.09\"");
    clock.advance(1ms);
    EXPECT_EQ(askCoder("CT"), "\"00:00:00,01.01.10\"");
}

TEST_F(CoderTest, RunsTheClockOnPastMidnightOfTheClockItRunsBy) {
    clock.set(86399.5);
    coder("CT=08:00:00,28.02.12");
    clock.advance(24h);
    EXPECT_EQ(askCoder("CT"), "\"08:00:00,29.02.12\"");
    clock.advance(1s);
    EXPECT_EQ(askCoder("CT"), "\"08:00:01,29.02.12\"");
}

TEST_F(CoderTest, RefusesATimeThatDoesNotExist) {
    coder("CT=10:00:00,01.02.09");
    for (const char* time : {"24:00:00,01.01.09", "00:60:00,01.01.09", "00:00:60,01.01.09", "00:00:00,30.02.09",
                             "00:00:00,00.01.09", "00:00:00,01.13.09"}) {
        coder(std::string("CT=") + time);
        EXPECT_EQ(error(), -222) << time;
    }
    // The clock label may hold the word "aus" when the time is sent.
    for (const char* time : {"aus,05.03.09", "", "10:00,01.01.09", "10:00:00", "10:00:00,01/01/09", "1a:00:00,01.01.09",
                             "10:00:00,01.01.2009"}) {
        coder(std::string("CT=") + time);
        EXPECT_EQ(error(), -224) << time;
    }
    EXPECT_EQ(askCoder("CT"), "\"10:00:00,01.02.09\"");
}

TEST_F(CoderTest, KeepsFiveAfListsOfMethodAAsTheyWereSent) {
    coder("AF=N,87.6,90.1,94.3");
    coder("AF=+,99.2,101.5");
    coder("AF=+,100.1,87.5,108.0");
    coder("AF=+,86.0,90");
    coder("AF=+,107.9");
    EXPECT_EQ(askCoder("AF1"), "\"87.6,90.1,94.3\"");
    EXPECT_EQ(askCoder("AF2"), "\"99.2,101.5\"");
    EXPECT_EQ(askCoder("AF3"), "\"100.1,87.5,108.0\"");
    EXPECT_EQ(askCoder("AF4"), "\"86.0,90\"");
    EXPECT_EQ(askCoder("AF5"), "\"107.9\"");
    EXPECT_EQ(error(), 0);
    coder("AF=+,99.9");
    EXPECT_EQ(error(), -223);
    coder("AF=N,99.9");
    EXPECT_EQ(error(), 0) << "a new set finds room however many there were";
    EXPECT_EQ(askCoder("AF1"), "\"99.9\"");
    EXPECT_EQ(askCoder("AF5"), "\"\"");
}

TEST_F(CoderTest, KeepsTheChoiceThatItSwitchesOff) {
    coder("SRC=2");
    coder("SRC=0");
    EXPECT_EQ(ask(":STEREO:SOURCE?;STATE?"), "SPEXT;0");
    coder("PRE=2");
    coder("PRE=0");
    EXPECT_EQ(ask(":STEREO:AUDIO:PREEMPHASIS?;PREEMPHASIS:STATE?"), "75US;0");
    coder("ARI-ID=3");
    coder("ARI-ID=0");
    EXPECT_EQ(ask(":STEREO:ARI:TYPE?;TYPE:STATE?"), "BKDK;0");
}

TEST_F(CoderTest, KeepsThePairsOfMethodB) {
    coder("AF=N,86.2,86.2,90.1,86.2,94.3");
    coder("AF=+,99.2,99.2,101.5");
    EXPECT_EQ(askCoder("AF1"), "\"86.2,86.2,90.1,86.2,94.3\"");
    EXPECT_EQ(askCoder("AF2"), "\"99.2,99.2,101.5\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CoderTest, StartsANewSetOfAfListsWithN) {
    coder("AF=N,87.6,90.1");
    coder("AF=+,99.2,101.5");
    coder("AF=N,88.8");
    EXPECT_EQ(askCoder("AF1"), "\"88.8\"");
    EXPECT_EQ(askCoder("AF2"), "\"\"");
}

TEST_F(CoderTest, TakesAFurtherListForTheFirstWhenThereIsNone) {
    coder("AF=+,99.2,101.5");
    EXPECT_EQ(askCoder("AF1"), "\"99.2,101.5\"");
}

TEST_F(CoderTest, RefusesAFrequencyOutsideTheBandAndKeepsTheListsItHas) {
    coder("AF=N,87.6,90.1");
    for (const auto& [list, code] : {std::pair{"AF=N,85.9,90.1", -222},
                                     {"AF=N,87.6,87.4", -222},
                                     {"AF=N,87.6,108.1", -222},
                                     {"AF=N,90,1", -222},  // a decimal comma makes two frequencies of one
                                     {"AF=N,87.6x", -224},
                                     {"AF=N,,90.1", -109},
                                     {"AF=N,90.1,", -109},
                                     {"AF=N", -109},
                                     {"AF=N,", -109},
                                     {"AF=M,87.6", -224},
                                     {"AF=", -224},
                                     {"AF", -109}}) {
        coder(list);
        EXPECT_EQ(error(), code) << list;
    }
    EXPECT_EQ(askCoder("AF1"), "\"87.6,90.1\"");
}

TEST_F(CoderTest, TakesTwentyFiveAlternativesAndNoMore) {
    std::string list = "87.6";
    for (int i = 0; i < 25; ++i) list += "," + std::to_string(88 + i % 20) + ".1";
    coder("AF=N," + list);
    EXPECT_EQ(error(), 0);
    EXPECT_EQ(askCoder("AF1"), "\"" + list + "\"");
    coder("AF=N," + list + ",99.9");
    EXPECT_EQ(error(), -223);
}

TEST_F(CoderTest, TakesAnyGroupsInAnyOrder) {
    coder("GS=15A,0a,2B,0A,14A");
    EXPECT_EQ(askCoder("GS"), "\"15A,0A,2B,0A,14A\"");
    for (const char* sequence : {"16A", "0C", "A", "0A,", ",0A", "0A;2A", "0A 2A", "-0A", "001A", "0"}) {
        coder(std::string("GS=") + sequence);
        EXPECT_EQ(error(), -224) << sequence;
    }
    EXPECT_EQ(askCoder("GS"), "\"15A,0A,2B,0A,14A\"");
}

TEST_F(CoderTest, CountsGroups3AAnd8AAndKeepsTheLastOfEach) {
    coder("3A=01,106100CD46");
    coder("8A=02,0810013039");
    coder("3A=01,100066CD46");
    coder("8A=02,1fffffffff");
    coder("8A=02,0810013039");
    EXPECT_EQ(askCoder("3A"), "\"01,100066CD46\"");
    EXPECT_EQ(askCoder("3A-N"), "\"2\"");
    EXPECT_EQ(askCoder("8A"), "\"02,0810013039\"");
    EXPECT_EQ(askCoder("8A-N"), "\"3\"");
}

TEST_F(CoderTest, RefusesAnIncompleteTrafficMessage) {
    // Fields that the user has not set yet make the code shorter, or leave a hyphen for the T bit.
    for (const char* message : {"02,", "02,-810013039", "02,081001303", "02,08100130390", "02,2810013039", "02",
                                "2,0810013039", "x2,0810013039", "02,081001303G", ""}) {
        coder(std::string("8A=") + message);
        EXPECT_EQ(error(), -224) << message;
    }
    coder("3A=01,106100CD4");
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(askCoder("8A-N"), "\"0\"");
    EXPECT_EQ(askCoder("3A-N"), "\"0\"");
}

TEST_F(CoderTest, StoresAndRecallsFiveSetUps) {
    for (int memory = 1; memory <= 5; ++memory) {
        const std::string number = std::to_string(memory);
        coder("PS=SET " + number);
        coder("EON-PI=000" + number);
        tell(":STEREO:PILOT:DEVIATION " + number + "KHZ");
        coder("STORE=" + number);
    }
    EXPECT_EQ(askCoder("STORE"), "\"1,2,3,4,5\"");
    for (int memory = 5; memory >= 1; --memory) {
        const std::string number = std::to_string(memory);
        coder("DS=" + number);
        EXPECT_EQ(askCoder("PS"), "\"SET " + number + "   \"");
        EXPECT_EQ(askCoder("PIL-DEV"), "\"" + number + "00\"");
    }
    EXPECT_EQ(askCoder("EON-PI"), "\" 0001,\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(CoderTest, LeavesCarrierClockAndMessageCountsAloneWhenASetUpIsRecalled) {
    coder("STORE=2");
    tell("FREQ 99.9MHZ;:POW 50DBUV;:OUTPUT:STAT ON");
    coder("CT=10:00:00,01.02.09");
    coder("8A=02,0810013039");
    coder("DS=2");
    EXPECT_EQ(ask("FREQ?;:POW?;:OUTPUT:STAT?"), "99.9;50;1");
    EXPECT_EQ(askCoder("CT"), "\"10:00:00,01.02.09\"");
    EXPECT_EQ(askCoder("8A-N"), "\"1\"");
}

TEST_F(CoderTest, KeepsItsMemoriesThroughAReset) {
    coder("PS=KEPT");
    coder("STORE=4");
    tell("*RST");
    EXPECT_EQ(askCoder("PS"), "\"KDX-X4  \"");
    EXPECT_EQ(askCoder("STORE"), "\"4\"");
    coder("DS=4");
    EXPECT_EQ(askCoder("PS"), "\"KEPT    \"");
}

TEST_F(CoderTest, RecallsNothingFromAnEmptyMemory) {
    coder("PS=STAYS");
    coder("DS=1");
    EXPECT_EQ(error(), -221);
    for (const char* command : {"STORE=0", "STORE=6", "DS=0", "DS=6"}) {
        coder(command);
        EXPECT_EQ(error(), -222) << command;
    }
    coder("STORE=x");
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(askCoder("PS"), "\"STAYS   \"");
    EXPECT_EQ(askCoder("STORE"), "\"\"");
}

}  // namespace
}  // namespace kdx::sim
