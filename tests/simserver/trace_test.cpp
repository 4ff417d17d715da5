#include "simserver/trace.h"

#include <gtest/gtest.h>

#include <ostream>

namespace kdx::simserver {
namespace {

struct TraceCase {
    const char* message;
    const char* words;
    friend void PrintTo(const TraceCase& c, std::ostream* out) { *out << c.message; }
};

class Trace : public ::testing::TestWithParam<TraceCase> {};

TEST_P(Trace, SaysInWordsWhatTheCommandAsks) {
    EXPECT_EQ(describe(sim::readUnit(GetParam().message), sim::ScpiError::None), GetParam().words);
}

TEST(TraceOfRefusals, SaysWhyTheInstrumentDidNotTakeTheCommand) {
    const sim::CommandUnit unit = sim::readUnit(R"(:STEREO:DIRECT "PTY=32")");
    EXPECT_EQ(describe(unit, sim::ScpiError::OutOfRange), "refused: -222,\"Data out of range\"");
    EXPECT_EQ(describe(sim::readUnit("NONSENSE?"), sim::ScpiError::UndefinedHeader),
              "refused: -113,\"Undefined header\"");
}

INSTANTIATE_TEST_SUITE_P(
    TrafficMessages, Trace,
    ::testing::Values(
        TraceCase{R"(:STEREO:DIRECT "8A=02,0810013039")",
                  "traffic message: event 1, location 12345, extent 2, direction forward, duration 0, no diversion, "
                  "F 1, T 0"},
        TraceCase{R"(stereo:direct "8a=02,1FFFFFFFFF")",
                  "tuning information for traffic messages, variant 15: FFFF FFFF, T 1"},
        TraceCase{R"(:STEREO:DIRECT "8A=02,0FFFFFFFFF")",
                  "traffic message: event 2047, location 65535, extent 7, direction backward, duration 7, diversion, "
                  "F 1, T 0"},
        TraceCase{R"(:STEREO:DIRECT "8A=02,0000000000")",
                  "administration of encrypted traffic messages: 0000 0000, F 0, T 0"},
        // Bits 0 0 101 | 1 0 100 01101001001 | 0000000000000111, put together by hand: the first of several groups.
        TraceCase{R"(:STEREO:DIRECT "8A=02,05A3490007")",
                  "traffic message of several groups, continuity index 5, first group: event 841, location 7, extent "
                  "4, direction forward, F 0, T 0"},
        // Bits 0 0 101 | 0 1 10 000000000001 | 0000000000000111.
        TraceCase{R"(:STEREO:DIRECT "8A=02,0560010007")",
                  "traffic message of several groups, continuity index 5, second group, 2 to follow, content 0010007, "
                  "F 0, T 0"},
        TraceCase{R"(:STEREO:DIRECT "8A=02,-81001303")", "incomplete traffic message"},
        TraceCase{
            R"(:STEREO:DIRECT "3A=01,106100CD46")",
            "open data in group 8A, application CD46 (traffic messages), gap of 8 groups, service 4, activity 1 s, "
            "window 1 s, delay 0 s"},
        // Bits 01 11 000101 01 10 11.
        TraceCase{R"(:STEREO:DIRECT "3A=01,10715BCD46")",
                  "open data in group 8A, application CD46 (traffic messages), gap of 11 groups, service 5, activity 2 "
                  "s, window 4 s, delay 3 s"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,104000CD47")",
                  "open data in group 8A, application CD47 (traffic messages), gap of 3 groups, service 0, activity 1 "
                  "s, window 1 s, delay 0 s"},
        TraceCase{
            R"(:STEREO:DIRECT "3A=01,10001DCD46")",
            "open data in group 8A, application CD46 (traffic messages), location table 0 (encrypted), alternative "
            "frequencies no, enhanced mode yes, scope international national urban"},
        // Bits 10 1101 00 11100000.
        TraceCase{R"(:STEREO:DIRECT "3A=01,10B4E0CD46")",
                  "open data in group 8A, application CD46 (traffic messages), location table country D, extended "
                  "country code E0"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,10C000CD46")",
                  "open data in group 8A, application CD46 (traffic messages), variant 3"},
        TraceCase{
            R"(:STEREO:DIRECT "3A=01,F00000CD46")",
            "open data in group 8A, application CD46 (traffic messages), location table 0 (encrypted), alternative "
            "frequencies no, enhanced mode no, scope none"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,0000004BD7")", "open data in no group of its own, application 4BD7"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,1F00004BD7")", "open data in no group for now (fault), application 4BD7"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,100066CD46")",
                  "open data in group 8A, application CD46 (traffic messages), location table 1, alternative "
                  "frequencies yes, enhanced mode no, scope national regional"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,1780004BD7")", "open data in group 11B, application 4BD7"},
        TraceCase{R"(:STEREO:DIRECT "3A=01,10")", "incomplete open-data announcement"}));

INSTANTIATE_TEST_SUITE_P(
    OtherCommands, Trace,
    ::testing::Values(TraceCase{R"(:STEREO:DIRECT "PS=RADIO   ")", "programme service name \"RADIO   \""},
                      TraceCase{R"(:STEREO:DIRECT "PI=D3C2")", "programme identification D3C2"},
                      TraceCase{R"(:STEREO:DIRECT "PTY=07")", "programme type 07"},
                      TraceCase{R"(:STEREO:DIRECT "RT=10,0,Hello, you")", "radiotext of 10 characters"},
                      TraceCase{R"(:STEREO:DIRECT "RT=0,0,")", "radiotext cleared"},
                      TraceCase{R"(:STEREO:DIRECT "CT=off")", "clock time no longer sent"},
                      TraceCase{R"(:STEREO:DIRECT "CT=10:00:00,01.02.09")", "clock time set"},
                      TraceCase{R"(:STEREO:DIRECT "AF=N,87.6,90.1,94.3")",
                                "first AF list of a new set, tuned to 87.6 MHz, 2 alternatives, method A"},
                      TraceCase{R"(:STEREO:DIRECT "AF=+,87.6,87.6,90.1,87.6,94.3")",
                                "a further AF list, tuned to 87.6 MHz, 2 alternatives, method B"},
                      TraceCase{R"(:STEREO:DIRECT "AF=N,87.6")",
                                "first AF list of a new set, tuned to 87.6 MHz, 0 alternatives, method A"},
                      TraceCase{R"(:STEREO:DIRECT "GS=0A,2A,8A")", "sequence of 3 groups"},
                      TraceCase{R"(:STEREO:DIRECT "BIN=0")", "normal operation"},
                      TraceCase{R"(:STEREO:DIRECT "BIN=2")", "test pattern 2"},
                      TraceCase{R"(:STEREO:DIRECT "EON-PI=D3C2")", "other network D3C2 added"},
                      TraceCase{R"(:STEREO:DIRECT "EON-PI=News")", "no programme identification: \"News\""},
                      TraceCase{R"(:STEREO:DIRECT "EON-DEL=D3C2")", "other network D3C2 removed"},
                      TraceCase{
                          R"(:STEREO:DIRECT "EON-AFB=D3C2,N,87.6,90.1")",
                          "other network D3C2: first AF list of a new set, tuned to 87.6 MHz, 1 alternatives, mapped"},
                      TraceCase{R"(:STEREO:DIRECT "EON-AFB=D3C2,+,87.6,87.6,90.1")",
                                "other network D3C2: a further AF list, tuned to 87.6 MHz, 2 alternatives, mapped"},
                      TraceCase{R"(:STEREO:DIRECT "STORE=3")", "set-up stored in memory 3"},
                      TraceCase{R"(:STEREO:DIRECT "DS=3")", "set-up recalled from memory 3"},
                      TraceCase{":STEREO:PILOT:STATE ON", ""}, TraceCase{R"(:STEREO:DIRECT? "PS")", ""},
                      TraceCase{R"(:STEREO:DIRECT "TA=1")", ""},
                      TraceCase{R"(:STEREO:DIRECT "AF=")",
                                "first AF list of a new set, tuned to  MHz, 0 "
                                "alternatives, method A"},
                      TraceCase{R"(:STEREO:DIRECT "PS=A)", ""}, TraceCase{"", ""}));

}  // namespace
}  // namespace kdx::simserver
