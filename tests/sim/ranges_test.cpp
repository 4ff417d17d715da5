#include <ostream>
#include <string>

#include "sim/simtest.h"

namespace kdx::sim {
namespace {

/// A range: the command up to the value, a query, the last values inside and the first ones outside.
struct RangeCase {
    const char* command;
    const char* query;
    const char* lowest;
    const char* highest;
    const char* tooLow;
    const char* tooHigh;
    friend void PrintTo(const RangeCase& c, std::ostream* out) { *out << c.command << c.lowest; }
};

class Range : public SimTest, public ::testing::WithParamInterface<RangeCase> {
protected:
    Range() { coder("EON-PI=D3C2"); }
    void send(const std::string& value) {
        const std::string command = GetParam().command;
        tell(command.find('"') == std::string::npos ? command + value : command + value + "\"");
    }
};

TEST_P(Range, ReachesFromTheLowestToTheHighestValueAndNoFurther) {
    send(GetParam().lowest);
    const std::string lowest = ask(GetParam().query);
    EXPECT_EQ(error(), 0);
    send(GetParam().tooLow);
    EXPECT_EQ(error(), -222);
    EXPECT_EQ(ask(GetParam().query), lowest);
    send(GetParam().highest);
    const std::string highest = ask(GetParam().query);
    EXPECT_NE(lowest, highest);
    EXPECT_EQ(error(), 0);
    send(GetParam().tooHigh);
    EXPECT_EQ(error(), -222);
    EXPECT_EQ(ask(GetParam().query), highest);
    send("99999999999");
    EXPECT_NE(error(), 0) << "more digits than a number holds";
    EXPECT_EQ(ask(GetParam().query), highest);
}

INSTANTIATE_TEST_SUITE_P(
    Generator, Range,
    ::testing::Values(
        RangeCase{":STEREO:DEVIATION ", ":STEREO:DEVIATION?", "0HZ", "80000HZ", "-1HZ", "80001HZ"},
        RangeCase{":STEREO:PILOT:DEVIATION ", ":STEREO:PILOT:DEVIATION?", "0HZ", "15KHZ", "-1HZ", "15001HZ"},
        RangeCase{":STEREO:RDS:DEVIATION ", ":STEREO:RDS:DEVIATION?", "0", "4000", "-1", "4001"},
        RangeCase{":stereo:ari:deviation ", ":STEREO:ARI:DEVIATION?", "0HZ", "8000HZ", "-1HZ", "8001HZ"},
        RangeCase{":STEREO:PILOT:PHASE ", ":STEREO:PILOT:PHASE?", "-180DEG", "180DEG", "-181DEG", "181DEG"},
        RangeCase{":STEREO:RDS:PHASE ", ":STEREO:RDS:PHASE?", "0", "359", "-1", "360"},
        RangeCase{"FREQ ", "FREQ?", "100KHZ", "1.04GHZ", "99.9KHZ", "1040.1MHZ"},
        RangeCase{":POW ", "POW?", "0DBUV", "120DBUV", "-0.1DBUV", "120.1DBUV"},
        RangeCase{":STEREO:AUDIO:FREQ ", ":STEREO:AUDIO:FREQ?", "20HZ", "80KHZ", "19.9HZ", "80.1KHZ"},
        RangeCase{"*ESE ", "*ESE?", "0", "255", "-1", "256"}, RangeCase{"*SRE ", "*SRE?", "0", "191", "-1", "256"},
        RangeCase{"STAT:OPER:ENAB ", "STAT:OPER:ENAB?", "0", "32767", "-1", "65536"},
        RangeCase{"STAT:QUES:ENAB ", "STAT:QUES:ENAB?", "0", "32767", "-1", "65536"}));

INSTANTIATE_TEST_SUITE_P(
    Coder, Range,
    ::testing::Values(
        RangeCase{R"(:STEREO:DIRECT "MPX-DEV=)", R"(:STEREO:DIRECT? "MPX-DEV")", "0", "8000", "-1", "8001"},
        RangeCase{R"(:STEREO:DIRECT "PIL-DEV=)", R"(:STEREO:DIRECT? "PIL-DEV")", "0", "1500", "-1", "1501"},
        RangeCase{R"(:STEREO:DIRECT "PIL-PH=)", R"(:STEREO:DIRECT? "PIL-PH")", "-180", "180", "-181", "181"},
        RangeCase{R"(:STEREO:DIRECT "RDS-DEV=)", R"(:STEREO:DIRECT? "RDS-DEV")", "0", "400", "-1", "401"},
        RangeCase{R"(:STEREO:DIRECT "RDS-PH=)", R"(:STEREO:DIRECT? "RDS-PH")", "0", "359", "-1", "360"},
        RangeCase{R"(:STEREO:DIRECT "ARI-DEV=)", R"(:STEREO:DIRECT? "ARI-DEV")", "0", "800", "-1", "801"},
        RangeCase{R"(:STEREO:DIRECT "PTY=)", R"(:STEREO:DIRECT? "PTY")", "00", "31", "-1", "32"},
        RangeCase{R"(:STEREO:DIRECT "DI=)", R"(:STEREO:DIRECT? "DI")", "0", "15", "-1", "16"},
        RangeCase{R"(:STEREO:DIRECT "BIN=)", R"(:STEREO:DIRECT? "BIN")", "0", "4", "-1", "5"},
        RangeCase{R"(:STEREO:DIRECT "PIL=)", R"(:STEREO:DIRECT? "PIL")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "RDS=)", R"(:STEREO:DIRECT? "RDS")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "TP=)", R"(:STEREO:DIRECT? "TP")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "TA=)", R"(:STEREO:DIRECT? "TA")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "ARI=)", R"(:STEREO:DIRECT? "ARI")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "SRC=)", R"(:STEREO:DIRECT? "SRC")", "0", "3", "-1", "4"},
        RangeCase{R"(:STEREO:DIRECT "MODE=)", R"(:STEREO:DIRECT? "MODE")", "1", "5", "0", "6"},
        RangeCase{R"(:STEREO:DIRECT "IMP=)", R"(:STEREO:DIRECT? "IMP")", "1", "2", "0", "3"},
        RangeCase{R"(:STEREO:DIRECT "PRE=)", R"(:STEREO:DIRECT? "PRE")", "0", "2", "-1", "3"},
        RangeCase{R"(:STEREO:DIRECT "ARI-ID=)", R"(:STEREO:DIRECT? "ARI-ID")", "0", "3", "-1", "4"},
        RangeCase{R"(:STEREO:DIRECT "STORE=)", R"(:STEREO:DIRECT? "STORE")", "1", "5", "0", "6"},
        RangeCase{R"(:STEREO:DIRECT "RT=)", R"(:STEREO:DIRECT? "RT-N")", "0,7,x", "255,7,x", "-1,7,x", "256,7,x"},
        RangeCase{R"(:STEREO:DIRECT "RT=)", R"(:STEREO:DIRECT? "RT-N")", "7,0,x", "7,255,x", "7,-1,x", "7,256,x"},
        RangeCase{R"(:STEREO:DIRECT "AF=)", R"(:STEREO:DIRECT? "AF1")", "N,86.0", "N,108.0", "N,85.9", "N,108.1"},
        RangeCase{R"(:STEREO:DIRECT "AF=)", R"(:STEREO:DIRECT? "AF1")", "N,90,87.5", "N,90,108.0", "N,90,87.4",
                  "N,90,108.1"}));

INSTANTIATE_TEST_SUITE_P(
    OtherNetworks, Range,
    ::testing::Values(
        RangeCase{R"(:STEREO:DIRECT "EON-PTY=D3C2,)", R"(:STEREO:DIRECT? "EON-PTY,D3C2")", "0", "31", "-1", "32"},
        RangeCase{R"(:STEREO:DIRECT "EON-TP=D3C2,)", R"(:STEREO:DIRECT? "EON-TP,D3C2")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "EON-TA=D3C2,)", R"(:STEREO:DIRECT? "EON-TA,D3C2")", "0", "1", "-1", "2"},
        RangeCase{R"(:STEREO:DIRECT "EON-AFA=D3C2,)", R"(:STEREO:DIRECT? "EON-AFA,D3C2")", "86.0", "108.0", "85.9",
                  "108.1"},
        RangeCase{R"(:STEREO:DIRECT "EON-AFA=D3C2,)", R"(:STEREO:DIRECT? "EON-AFA,D3C2")", "90,87.5", "90,108.0",
                  "90,87.4", "90,108.1"}));

/// A limit that is no range of numbers: what is just taken, what is just not, and the error of that.
struct LimitCase {
    const char* name;
    std::string command;
    std::string last;
    std::string beyond;
    int error;
    std::string query;
    std::string answer = {};  ///< when it is not the value itself
    friend void PrintTo(const LimitCase& c, std::ostream* out) { *out << c.name; }
};

std::string repeated(int count, const std::string& first, const std::string& next) {
    std::string list = first;
    for (int i = 1; i < count; ++i) list += next;
    return list;
}

// As many blanks behind a list as make its text that long.
std::string listOfLength(std::size_t length) {
    const std::string list = "87.6,90.1";
    return list + std::string(length - list.size(), ' ');
}

class Limit : public SimTest, public ::testing::WithParamInterface<LimitCase> {};

TEST_P(Limit, IsTakenAndNothingBeyondIt) {
    const LimitCase& limit = GetParam();
    coder("EON-PI=D3C2");
    coder(limit.command + limit.last);
    EXPECT_EQ(error(), 0);
    const std::string answer = askCoder(limit.query);
    EXPECT_EQ(answer, "\"" + (limit.answer.empty() ? limit.last : limit.answer) + "\"");
    coder(limit.command + limit.beyond);
    EXPECT_EQ(error(), limit.error);
    EXPECT_EQ(askCoder(limit.query), answer);
}

INSTANTIATE_TEST_SUITE_P(
    Coder, Limit,
    ::testing::Values(
        LimitCase{"Ps", "PS=", "ABCDEFGH", "ABCDEFGHI", -223, "PS"},
        LimitCase{"Pi", "PI=", "FFFF", "FFFFF", -224, "PI"}, LimitCase{"PiTooShort", "PI=", "0000", "000", -224, "PI"},
        LimitCase{"PiDigit", "PI=", "ABCF", "ABCG", -224, "PI"},
        LimitCase{"Radiotext", "RT=0,0,", std::string(64, 'x'), std::string(65, 'x'), -223, "RT"},
        LimitCase{"Character", "PS=", "       \x20", "       \x1F", -224, "PS"},
        LimitCase{"Groups", "GS=", repeated(256, "0A", ",2A"), repeated(257, "0A", ",2A"), -223, "GS"},
        LimitCase{"Group", "GS=", "0A,15B", "0A,16A", -224, "GS"},
        LimitCase{"GroupLetter", "GS=", "2B", "2C", -224, "GS"},
        LimitCase{"GroupDigits", "GS=", "02A", "002A", -224, "GS"}, LimitCase{"Area", "BK=", "F", "G", -224, "BK"},
        LimitCase{"Frequencies", "AF=N,", repeated(26, "87.6", ",90"), repeated(27, "87.6", ",90"), -223, "AF1"},
        LimitCase{"ListText", "AF=N,", listOfLength(260), listOfLength(261), -223, "AF1"},
        LimitCase{"TBit", "8A=00,", "1FFFFFFFFF", "2000000000", -224, "8A", "00,1FFFFFFFFF"},
        LimitCase{"MessageTooLong", "8A=00,", "1000000000", "10000000000", -224, "8A", "00,1000000000"},
        LimitCase{"MessageTooShort", "8A=00,", "1000000000", "100000000", -224, "8A", "00,1000000000"},
        LimitCase{"OpenDataTooLong", "3A=00,", "FFFFFFFFFF", "FFFFFFFFFFF", -224, "3A", "00,FFFFFFFFFF"},
        LimitCase{"OpenDataTooShort", "3A=00,", "FFFFFFFFFF", "FFFFFFFFF", -224, "3A", "00,FFFFFFFFFF"},
        LimitCase{"OpenDataNumber", "3A=", "99,0000000000", "100,0000000000", -224, "3A"}));

INSTANTIATE_TEST_SUITE_P(
    Clock, Limit,
    ::testing::Values(LimitCase{"Hour", "CT=", "23:00:00,01.01.09", "24:00:00,01.01.09", -222, "CT"},
                      LimitCase{"Minute", "CT=", "00:59:00,01.01.09", "00:60:00,01.01.09", -222, "CT"},
                      LimitCase{"Second", "CT=", "00:00:59,01.01.09", "00:00:60,01.01.09", -222, "CT"},
                      LimitCase{"Day", "CT=", "00:00:00,31.01.09", "00:00:00,32.01.09", -222, "CT"},
                      LimitCase{"DayOfAShortMonth", "CT=", "00:00:00,30.04.09", "00:00:00,31.04.09", -222, "CT"},
                      LimitCase{"DayOfFebruary", "CT=", "00:00:00,28.02.09", "00:00:00,29.02.09", -222, "CT"},
                      LimitCase{"DayOfALeapYear", "CT=", "00:00:00,29.02.08", "00:00:00,30.02.08", -222, "CT"},
                      LimitCase{"FirstDay", "CT=", "00:00:00,01.01.00", "00:00:00,00.01.00", -222, "CT"},
                      LimitCase{"Month", "CT=", "00:00:00,01.12.99", "00:00:00,01.13.99", -222, "CT"},
                      LimitCase{"FirstMonth", "CT=", "00:00:00,01.01.00", "00:00:00,01.00.00", -222, "CT"}));

INSTANTIATE_TEST_SUITE_P(
    OtherNetworks, Limit,
    ::testing::Values(LimitCase{"Ps", "EON-PS=D3C2,", "ABCDEFGH", "ABCDEFGHI", -223, "EON-PS,D3C2"},
                      LimitCase{"Character", "EON-PS=D3C2,", "       \x20", "       \x1F", -224, "EON-PS,D3C2"},
                      LimitCase{"Frequencies", "EON-AFA=D3C2,", repeated(26, "87.6", ",90"),
                                repeated(27, "87.6", ",90"), -223, "EON-AFA,D3C2"},
                      LimitCase{"ListText", "EON-AFB=D3C2,N,", listOfLength(260), listOfLength(261), -223,
                                "EON-AFB,D3C2,1"},
                      LimitCase{"Networks", "EON-PI=", "D3C2", "D3C", -224, "EON-PI", " D3C2,"}));

class ListNumber : public SimTest {};

TEST_F(ListNumber, ReachesFromOneToFive) {
    coder("EON-PI=D3C2");
    for (const auto& [number, code] : {std::pair{"0", -222}, {"1", 0}, {"5", 0}, {"6", -222}}) {
        EXPECT_EQ(askCoder(std::string("EON-AFB,D3C2,") + number), "\"\"");
        EXPECT_EQ(error(), code) << number;
    }
}

class StatusBits : public SimTest {};

TEST_F(StatusBits, AreRoundedToAWholeNumber) {
    for (const auto& [number, bits] : {std::pair{"1.4", "1"}, {"1.6", "2"}, {"255.4", "255"}, {"-0.4", "0"}}) {
        tell(std::string("*ESE ") + number);
        EXPECT_EQ(ask("*ESE?"), bits) << number;
    }
    EXPECT_EQ(error(), 0);
    tell("*ESE 255.6");
    EXPECT_EQ(error(), -222);
}

TEST_F(StatusBits, ReachToAByteAndAWordThoughNotAllOfThemCount) {
    tell("*SRE 255;:STAT:OPER:ENAB 65535;:STAT:QUES:ENAB 65535");
    EXPECT_EQ(error(), 0);
    EXPECT_EQ(ask("*SRE?;:STAT:OPER:ENAB?;:STAT:QUES:ENAB?"), "191;32767;32767");
}

TEST(LongAnswer, OfSixtyFourKibibytesIsTheLongest) {
    const test::FakeClock clock;
    constexpr std::size_t kLongest = 65536;  // with its line end
    VirtualInstrument longest(clock, std::string(kLongest - 1, 'x'));
    EXPECT_EQ(longest.execute("*IDN?").size(), kLongest);
    VirtualInstrument tooLong(clock, std::string(kLongest, 'x'));
    EXPECT_EQ(tooLong.execute("*IDN?"), "");
    EXPECT_EQ(tooLong.execute("SYST:ERR?"), "-430,\"Query DEADLOCKED\"\n");
}

}  // namespace
}  // namespace kdx::sim
