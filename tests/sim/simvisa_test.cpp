#include "sim/simvisa.h"

#include "sim/simtest.h"

namespace kdx::sim {
namespace {

class SimVisaTest : public SimTest {
protected:
    void SetUp() override {
        ASSERT_EQ(library.viOpenDefaultRM(manager), visa::kSuccess);
        ASSERT_EQ(library.viOpen(manager, "GPIB0::28::INSTR", 0, 0, session), visa::kSuccess);
    }
    VisaStatus write(const std::string& text) { return library.viWrite(session, text, count); }
    /// One read of at most `size` bytes, cut to what came.
    std::string read(std::size_t size = 60) {
        std::string buffer(size, ' ');
        status = library.viRead(session, buffer, count);
        return buffer.substr(0, static_cast<std::size_t>(count));
    }

    SimVisa library{instrument};
    VisaHandle manager = 0;
    VisaHandle session = 0;
    VisaStatus status = 0;
    std::int32_t count = 0;
};

TEST_F(SimVisaTest, OpensEveryWellFormedResource) {
    for (const char* resource :
         {"GPIB0::2::INSTR", "GPIB::30::INSTR", "gpib1::5::3::instr", "TCPIP::192.168.0.1::INSTR",
          "TCPIP0::localhost::inst0::INSTR", "TCPIP::some host ::INSTR", "TCPIP::host::gpib0,28::INSTR"}) {
        EXPECT_EQ(library.viOpen(manager, resource, 0, 0, session), visa::kSuccess) << resource;
        EXPECT_NE(session, 0);
    }
}

TEST_F(SimVisaTest, RefusesAResourceThatCannotBeParsed) {
    for (const char* resource : {"", "::", "GPIB0::::INSTR", "TCPIP::::INSTR", "GPIB0::28", "GPIB0::abc::INSTR",
                                 "GPIB0::31::INSTR", "GPIB0::1.5::INSTR", "GPIBx::2::INSTR", "COM1::2::INSTR",
                                 "TCPIP::host::SOCKET", "TCPIP::a::b::c::INSTR", "TCP", "INSTR"}) {
        EXPECT_EQ(library.viOpen(manager, resource, 0, 0, session), visa::kInvalidResourceName) << resource;
        EXPECT_EQ(session, 0);
    }
}

TEST_F(SimVisaTest, NeedsAnOpenResourceManager) {
    EXPECT_EQ(library.viOpen(manager + 100, "GPIB0::28::INSTR", 0, 0, session), visa::kInvalidObject);
    EXPECT_EQ(session, 0);
}

TEST_F(SimVisaTest, CarriesQuestionAndAnswer) {
    EXPECT_EQ(write("*IDN?"), visa::kSuccess);
    EXPECT_EQ(count, 5);
    EXPECT_EQ(read(), "KDX,KDX-X4,100001,1.00\n");
    EXPECT_EQ(status, visa::kSuccess);
}

TEST_F(SimVisaTest, ContinuesALongAnswerWithTheNextRead) {
    write(":STEREO:DIRECT \"RT=10,0," + std::string(64, 'x') + "\"");
    write(":STEREO:DIRECT? \"RT\"");
    EXPECT_EQ(read(), "\"" + std::string(59, 'x'));
    EXPECT_EQ(status, visa::kMaxCountReached);
    EXPECT_EQ(read(), "xxxxx\"\n");
    EXPECT_EQ(status, visa::kSuccess);
}

TEST_F(SimVisaTest, ReportsPlainSuccessForAnAnswerThatFillsTheBuffer) {
    write(":STEREO:DIRECT \"RT=10,0," + std::string(57, 'x') + "\"");
    write(":STEREO:DIRECT? \"RT\"");
    EXPECT_EQ(read().size(), 60U);
    EXPECT_EQ(status, visa::kSuccess);
}

TEST_F(SimVisaTest, QueuesTheAnswersOfSeveralQuestions) {
    write("FREQ?");
    write("POW?");
    EXPECT_EQ(read(), "100\n");
    EXPECT_EQ(read(), "60\n");
}

TEST_F(SimVisaTest, TimesOutAtOnceWithNothingToReadAndQueuesAnError) {
    write("FREQ 98.5MHZ");
    EXPECT_EQ(read(), "");
    EXPECT_EQ(status, visa::kTimeout);
    EXPECT_TRUE(clock.sleeps.empty());
    write("SYST:ERR?");
    EXPECT_EQ(read(), "-420,\"Query UNTERMINATED\"\n");
}

TEST_F(SimVisaTest, TakesAnEmptyWrite) {
    EXPECT_EQ(write(""), visa::kSuccess);
    EXPECT_EQ(error(), 0);
}

TEST_F(SimVisaTest, GivesEachSessionItsOwnAnswersFromOneInstrument) {
    VisaHandle second = 0;
    ASSERT_EQ(library.viOpen(manager, "TCPIP::host::INSTR", 0, 0, second), visa::kSuccess);
    EXPECT_NE(second, session);
    write("FREQ 101.7MHZ");
    const std::string question = "FREQ?";
    library.viWrite(second, question, count);
    read();
    EXPECT_EQ(status, visa::kTimeout);
    session = second;
    EXPECT_EQ(read(), "101.7\n");
}

TEST_F(SimVisaTest, KnowsAClosedSessionNoMore) {
    write("*IDN?");
    EXPECT_EQ(library.viClose(session), visa::kSuccess);
    EXPECT_EQ(write("*IDN?"), visa::kInvalidObject);
    EXPECT_EQ(count, 0);
    EXPECT_EQ(read(), "");
    EXPECT_EQ(status, visa::kInvalidObject);
    EXPECT_EQ(library.viClose(session), visa::kInvalidObject);
    VisaHandle again = 0;
    EXPECT_EQ(library.viOpen(manager, "GPIB0::28::INSTR", 0, 0, again), visa::kSuccess);
    EXPECT_NE(again, session);
}

TEST_F(SimVisaTest, ClosesTheSessionsOfAResourceManagerWithIt) {
    EXPECT_EQ(library.viClose(manager), visa::kSuccess);
    EXPECT_EQ(write("*IDN?"), visa::kInvalidObject);
}

TEST_F(SimVisaTest, DescribesItsStatuses) {
    std::string description;
    EXPECT_EQ(library.viStatusDesc(manager, visa::kSuccess, description), visa::kSuccess);
    EXPECT_FALSE(description.empty());
    EXPECT_EQ(library.viStatusDesc(manager, visa::kTimeout, description), visa::kSuccess);
    EXPECT_NE(description.find("time-out"), std::string::npos);
    EXPECT_EQ(library.viStatusDesc(manager, 12345, description), 1073676421);
    EXPECT_NE(description.find("12345"), std::string::npos);
}

}  // namespace
}  // namespace kdx::sim
