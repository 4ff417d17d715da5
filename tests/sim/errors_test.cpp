#include <array>
#include <random>

#include "sim/simtest.h"

namespace kdx::sim {
namespace {

class ErrorsTest : public SimTest {};

TEST_F(ErrorsTest, AreReadOldestFirstWithTheirWords) {
    tell("NONSENSE");
    tell(":STEREO:DEVIATION 99KHZ");
    tell(":STEREO:AUDIO:MODE SIDEWAYS");
    tell("FREQ");
    EXPECT_EQ(tell("SYST:ERR?"), "-113,\"Undefined header\"\n");
    EXPECT_EQ(tell(":syst:err?"), "-222,\"Data out of range\"\n");
    EXPECT_EQ(tell("SYSTEM:ERROR?"), "-224,\"Illegal parameter value\"\n");
    EXPECT_EQ(tell("SYST:ERR:NEXT?"), "-109,\"Missing parameter\"\n");
    EXPECT_EQ(tell("SYST:ERR?"), "0,\"No error\"\n");
}

TEST_F(ErrorsTest, EndInQueueOverflowWhenTheyAreTooMany) {
    for (std::size_t i = 0; i < ErrorQueue::kCapacity + 5; ++i) tell("NONSENSE");
    for (std::size_t i = 1; i < ErrorQueue::kCapacity; ++i) EXPECT_EQ(error(), -113);
    EXPECT_EQ(tell("SYST:ERR?"), "-350,\"Queue overflow\"\n");
    EXPECT_EQ(error(), 0);
}

TEST_F(ErrorsTest, OfOneCommandDoNotKeepTheOthersFromBeingCarriedOut) {
    tell(":STEREO:STATE ON;NONSENSE;:STEREO:RDS:STATE ON");
    EXPECT_EQ(ask(":STEREO:STATE?;RDS:STATE?"), "1;1");
    EXPECT_EQ(error(), -113);
    EXPECT_EQ(error(), 0);
}

TEST_F(ErrorsTest, AreQueuedForQueriesThatDoNotExistAndForTheWrongWayRound) {
    for (const char* message : {"NONSENSE?", "*IDN", "*RST?", "SYST:ERR", "?", "*", ":", "*WAI?", "*TST", "STAT:PRES?",
                                "STAT:OPER:COND 1", "NONSENSE=1"}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), -113) << message;
    }
}

TEST_F(ErrorsTest, AreQueuedForNamesThatTheCoderDoesNotKnow) {
    for (const char* message : {":STEREO:DIRECT? \"XYZ\"", ":STEREO:DIRECT \"XYZ=1\"", ":STEREO:DIRECT \"AF1=99.9\"",
                                ":STEREO:DIRECT? \"AF\"", ":STEREO:DIRECT? \"DS\""}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), -224) << message;
    }
}

TEST_F(ErrorsTest, AreQueuedForAWrongSeparator) {
    for (const char* message :
         {":STEREO:DIRECT\"PS=A\"", ":STEREO:DIRECT \"PS=A\" B", ":STEREO:DIRECT \"PS=A\" 'PS=B'", "FREQ=99.9MHZ",
          "FREQ,99.9MHZ", "FREQ 99.9MHZ:POW 5", "FREQ 99.9 50", "FREQ 99.9MHZ 50", "FREQ?MAX", ":OUTPUT:STATE ON OFF",
          ":OUTPUT:STATE 1 1", ":STEREO:AUDIO:MODE LEFT RIGHT", "*ESE 1 2", "*ESE=1", "*CLS,1"}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), -103) << message;
        EXPECT_EQ(error(), 0) << message;
    }
    EXPECT_EQ(ask("FREQ?;:OUTPUT:STATE?;:STEREO:AUDIO:MODE?;*ESE?"), "100;0;REL;0");
}

TEST_F(ErrorsTest, AreQueuedForParametersWhereNoneBelongs) {
    for (const char* message :
         {"*IDN? 1", "*RST 1", "SYST:ERR? 2", ":OUTPUT:STATE? MAX", "*ESE? 1", "*WAI 1", "FREQ 5,6", "FREQ? MIN,MAX",
          ":OUTPUT:STATE ON,OFF", "*ESE 1,2", ":STEREO:DIRECT \"PS=A\",\"PS=B\"", ":STEREO:AUDIO:MODE LEFT,RIGHT"}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), -108) << message;
    }
    EXPECT_EQ(askCoder("PS,1"), "\"KDX-X4  \"");
    EXPECT_EQ(error(), -108);
}

TEST_F(ErrorsTest, AreQueuedForQuotesThatAreMissingOrDoNotClose) {
    for (const char* message : {":STEREO:DIRECT PS=RADIO", ":STEREO:DIRECT \"PS=RADIO", ":STEREO:DIRECT PS=RADIO\"",
                                ":STEREO:DIRECT \"PS=\"RADIO\"", ":STEREO:DIRECT \"", ":STEREO:DIRECT \"\"\"",
                                ":STEREO:DIRECT? PS", ":STEREO:DIRECT 'PS=A\"", ":STEREO:DIRECT \"PS=A;*IDN?\n"}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), -151) << message;
        EXPECT_EQ(error(), 0) << message;
    }
    EXPECT_EQ(askCoder("PS"), "\"KDX-X4  \"");
}

TEST_F(ErrorsTest, AreQueuedForACoderTextThatSaysNothing) {
    for (const char* message : {":STEREO:DIRECT", ":STEREO:DIRECT?", ":STEREO:DIRECT \"\"", ":STEREO:DIRECT? \"\"",
                                ":STEREO:DIRECT \"=1\"", ":STEREO:DIRECT? \"?\"", ":STEREO:DIRECT \"  \""}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), -109) << message;
    }
}

TEST_F(ErrorsTest, AreQueuedForSwitchesAndNumbersThatAreNone) {
    for (const auto& [message, code] : {std::pair{":OUTPUT:STAT MAYBE", -224},
                                        {":OUTPUT:STAT 2V", -131},
                                        {":OUTPUT:STAT", -109},
                                        {":STEREO:PILOT:PHASE DEG", -224},
                                        {"FREQ nanMHZ", -224},
                                        {"FREQ infMHZ", -224},
                                        {"FREQ -infMHZ", -224},
                                        {"FREQ --5MHZ", -224},
                                        {"FREQ +-5MHZ", -224},
                                        {"FREQ 1,5MHZ", -108},
                                        {"FREQ 1e-400MHZ", -222},
                                        {":STEREO:EXTERNAL:IMP 50", -224},
                                        {":stereo:ari:bk ", -109}}) {
        tell(message);
        EXPECT_EQ(error(), code) << message;
    }
    EXPECT_EQ(ask("FREQ?;:OUTPUT:STAT?"), "100;0");
}

TEST_F(ErrorsTest, AreQueuedWhenAClientReadsThoughNothingWasAsked) {
    instrument.report(ScpiError::QueryUnterminated);
    EXPECT_EQ(tell("SYST:ERR?"), "-420,\"Query UNTERMINATED\"\n");
}

class BadInputTest : public SimTest {};

TEST_F(BadInputTest, OfAMegabyteIsRefusedWithOneError) {
    const std::string huge(1 << 20, 'A');
    for (const std::string& message :
         {huge, huge + "?", ":STEREO:DIRECT \"PS=" + huge + "\"", ":STEREO:DIRECT \"" + huge,
          ":STEREO:DIRECT \"" + huge + "=1\"", "FREQ " + huge, "FREQ " + std::string(1 << 20, '9')}) {
        EXPECT_EQ(tell(message), "");
        EXPECT_LT(error(), 0);
        EXPECT_EQ(error(), 0);
    }
    EXPECT_EQ(tell(std::string(1 << 20, ';')), "");
    EXPECT_EQ(error(), 0);
    EXPECT_EQ(askCoder("PS"), "\"KDX-X4  \"");
}

TEST_F(BadInputTest, AsksForMoreThanAnAnswerHoldsAndGetsNothing) {
    std::string message = "FREQ 99.9MHZ";
    while (message.size() < 64000) message += ";:STEREO:DIRECT? \"RT\";*IDN?";
    coder("RT=0,0," + std::string(64, 'x'));
    EXPECT_EQ(tell(message + ";:FREQ 98.5MHZ"), "");
    EXPECT_EQ(error(), -430);
    EXPECT_EQ(error(), 0);
    EXPECT_EQ(ask("FREQ?"), "98.5") << "the commands are carried out all the same";
}

TEST_F(BadInputTest, OfALongListIsRefused) {
    std::string groups = "0A";
    for (int i = 1; i < 256; ++i) groups += ",2A";
    coder("GS=" + groups);
    EXPECT_EQ(error(), 0);
    coder("GS=" + groups + ",2A");
    EXPECT_EQ(error(), -223);
    EXPECT_EQ(askCoder("GS"), "\"" + groups + "\"");
    coder("AF=N,87.6,90.1" + std::string(1000, '0'));
    EXPECT_EQ(error(), -223);
    coder("EON-PI=D3C2");
    coder("EON-AFA=D3C2,87.6," + std::string(1000, ' ') + "90.1");
    EXPECT_EQ(error(), -223);
}

TEST_F(BadInputTest, WithNulBytesInACommandIsRefused) {
    tell(std::string("FR\0EQ 99MHZ", 11));
    EXPECT_EQ(error(), -113);
    EXPECT_EQ(ask("FREQ?"), "100");
}

// Pieces of real commands in random order, and plain random bytes: whatever comes, the instrument goes on answering,
// and what it answers is whole.
TEST_F(BadInputTest, OfAnyKindNeverStopsTheInstrument) {
    constexpr std::array kPieces = {":STEREO:DIRECT ",
                                    ":STEREO:DIRECT? ",
                                    "\"",
                                    "PS=",
                                    "AF=N,",
                                    "AF=+,",
                                    "EON-PI=",
                                    "EON-AFB=",
                                    "D3C2",
                                    "EON-DEL=",
                                    "CT=",
                                    "RT=10,0",
                                    "GS=",
                                    "8A=02,",
                                    "3A=01,",
                                    "STORE=",
                                    "DS=",
                                    ",",
                                    ";",
                                    "\n",
                                    "?",
                                    ":",
                                    "FREQ ",
                                    "1e999",
                                    "-",
                                    "87.6",
                                    "0A",
                                    "*RST",
                                    "*OPC?",
                                    "SYST:",
                                    "ERR?",
                                    "=",
                                    " ",
                                    "108.0",
                                    "EON PI?",
                                    "MPX-DEV",
                                    "STEREO:",
                                    "PILOT:",
                                    "STATE ",
                                    "ON",
                                    "15",
                                    "99KHZ",
                                    "\r",
                                    "0810013039"};
    std::mt19937 random(20090305);
    const auto below = [&random](std::size_t limit) { return random() % limit; };
    for (int round = 0; round < 6000; ++round) {
        std::string message;
        for (std::size_t n = below(12); n > 0; --n) {
            if (below(4) == 0) {
                message += static_cast<char>(below(256));
            } else {
                message += kPieces[below(kPieces.size())];
            }
        }
        const std::string answer = tell(message);
        EXPECT_TRUE(answer.empty() || answer.back() == '\n') << ::testing::PrintToString(message);
        ASSERT_EQ(tell("*OPC?"), "1\n") << ::testing::PrintToString(message);
    }
    for (int round = 0; round < 4000; ++round) {
        std::string message(below(80), '\0');
        for (char& c : message) c = static_cast<char>(below(256));
        tell(message);
        ASSERT_EQ(tell("*OPC?"), "1\n") << ::testing::PrintToString(message);
    }
    tell("*RST;*CLS");
    EXPECT_EQ(askCoder("PS"), "\"KDX-X4  \"");
}

}  // namespace
}  // namespace kdx::sim
