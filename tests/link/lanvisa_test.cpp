#include "link/lanvisa.h"

#include "support/scriptedvxi11.h"

#include <dirent.h>
#include <gmock/gmock.h>

#include <chrono>
#include <memory>
#include <string>
#include <thread>

namespace kdx {
namespace {

using namespace std::chrono_literals;
using test::Reaction;
using test::ScriptedVxi11;
using ::testing::ElementsAre;

// Far more than the time-outs below, far less than a hang: the machine may be busy.
constexpr auto kBounded = 5s;

std::string bytesOf(std::size_t count) {
    std::string bytes;
    for (std::size_t i = 0; i < count; ++i) bytes += static_cast<char>('a' + i % 26);
    return bytes;
}

std::ptrdiff_t openDescriptors() {
    const std::unique_ptr<DIR, int (*)(DIR*)> folder(opendir("/proc/self/fd"), &closedir);
    std::ptrdiff_t count = 0;
    while (readdir(folder.get()) != nullptr) ++count;
    return count;
}

class LanVisaTest : public ::testing::Test {
protected:
    LanVisaTest() { useTimes(2s, 2s); }

    void useTimes(std::chrono::milliseconds connectTimeout, std::chrono::milliseconds ioTimeout) {
        options.connectTimeout = connectTimeout;
        options.ioTimeout = ioTimeout;
        options.answerMargin = 50ms;
        options.portMapperPort = device.port();
        makeVisa();
    }
    /// For a test that runs into the time-outs.
    void useShortTimes() { useTimes(150ms, 100ms); }

    void makeVisa() {
        visa = std::make_unique<LanVisa>(options);
        visa->viOpenDefaultRM(manager);
    }
    VisaStatus open(const std::string& resource = "TCPIP::127.0.0.1::INSTR") {
        return visa->viOpen(manager, resource, 0, 0, session);
    }
    VisaStatus write(const std::string& text) { return visa->viWrite(session, text, count); }
    VisaStatus read(std::size_t size = 60) {
        std::string buffer(size, ' ');
        const VisaStatus status = visa->viRead(session, buffer, count);
        got = buffer.substr(0, static_cast<std::size_t>(count));
        rest = buffer.substr(static_cast<std::size_t>(count));
        return status;
    }

    ScriptedVxi11 device;
    LanOptions options;
    std::unique_ptr<LanVisa> visa;
    VisaHandle manager = 0;
    VisaHandle session = 0;
    std::int32_t count = -1;
    std::string got;
    std::string rest;
};

// --- opening ---------------------------------------------------------------------------------------------------

TEST_F(LanVisaTest, OpensTheFirstDeviceOfTheHostThroughThePortMapper) {
    EXPECT_EQ(open(), visa::kSuccess);
    EXPECT_NE(session, 0);
    ASSERT_EQ(device.opened().size(), 1U);
    EXPECT_EQ(device.opened()[0].device, "inst0");
    EXPECT_FALSE(device.opened()[0].locked);
    EXPECT_THAT(device.calls(), ElementsAre(ScriptedVxi11::kGetPort, ScriptedVxi11::kCreateLink));
}

TEST_F(LanVisaTest, OpensTheDeviceThatTheResourceNames) {
    EXPECT_EQ(open("tcpip0::127.0.0.1::gpib0,28::instr"), visa::kSuccess);
    EXPECT_EQ(device.opened()[0].device, "gpib0,28");
}

TEST_F(LanVisaTest, AFixedCorePortNeedsNoPortMapper) {
    options.corePort = device.port();
    options.portMapperPort = test::closedPort();
    makeVisa();
    EXPECT_EQ(open(), visa::kSuccess);
    EXPECT_THAT(device.calls(), ElementsAre(ScriptedVxi11::kCreateLink));
}

TEST_F(LanVisaTest, AccessModeOneAsksForTheLock) {
    EXPECT_EQ(visa->viOpen(manager, "TCPIP::127.0.0.1::INSTR", 1, 0, session), visa::kSuccess);
    EXPECT_TRUE(device.opened()[0].locked);
}

TEST_F(LanVisaTest, AnUnknownDeviceIsNotFound) {
    EXPECT_EQ(open("TCPIP::127.0.0.1::inst7::INSTR"), visa::kResourceNotFound);
    EXPECT_EQ(session, 0);
}

TEST_F(LanVisaTest, AnUnknownHostIsNotFound) {
    EXPECT_EQ(open("TCPIP::no-such-host.invalid::INSTR"), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, BlanksAroundTheAddressAreNotForgiven) {
    EXPECT_EQ(open("TCPIP::127.0.0.1 ::INSTR"), visa::kResourceNotFound);
    EXPECT_EQ(open("TCPIP:: 127.0.0.1::INSTR"), visa::kResourceNotFound);
    EXPECT_EQ(open("TCPIP:: ::INSTR"), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, AHostWithoutPortMapperIsNotFound) {
    options.portMapperPort = test::closedPort();
    makeVisa();
    EXPECT_EQ(open(), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, AHostThatServesNoInstrumentIsNotFound) {
    device.on(ScriptedVxi11::kGetPort, {.number = 0});
    EXPECT_EQ(open(), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, APortMapperThatNamesADeadPortMeansNotFound) {
    device.on(ScriptedVxi11::kGetPort, {.number = test::closedPort()});
    EXPECT_EQ(open(), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, AnImpossiblePortNumberIsATransferError) {
    device.on(ScriptedVxi11::kGetPort, {.number = 70000});
    EXPECT_EQ(open(), visa::kInputOutput);
}

TEST_F(LanVisaTest, AServerOfAnotherProgramIsNotFound) {
    constexpr std::uint32_t kProgramUnavailable = 1;
    constexpr std::uint32_t kProgramMismatch = 2;
    device.on(ScriptedVxi11::kCreateLink, {.acceptState = kProgramUnavailable});
    EXPECT_EQ(open(), visa::kResourceNotFound);
    device.on(ScriptedVxi11::kGetPort, {.acceptState = kProgramMismatch});
    EXPECT_EQ(open(), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, ADeadAddressIsGivenUpAfterTheConnectTimeOut) {
    const test::DeafPort deaf;
    useShortTimes();
    options.portMapperPort = deaf.port();
    makeVisa();
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(open(), visa::kResourceNotFound);
    const auto taken = std::chrono::steady_clock::now() - start;
    EXPECT_GE(taken, 150ms);
    EXPECT_LT(taken, kBounded);
}

TEST_F(LanVisaTest, ADeadCorePortIsGivenUpAfterTheConnectTimeOut) {
    const test::DeafPort deaf;
    useShortTimes();
    device.on(ScriptedVxi11::kGetPort, {.number = deaf.port()});
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(open(), visa::kResourceNotFound);
    EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
}

TEST_F(LanVisaTest, TheCallersOpenTimeOutReplacesOurOwn) {
    const test::DeafPort deaf;
    useTimes(60s, 60s);
    options.portMapperPort = deaf.port();
    makeVisa();
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(visa->viOpen(manager, "TCPIP::127.0.0.1::INSTR", 0, 30, session), visa::kResourceNotFound);
    EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
}

TEST_F(LanVisaTest, APeerThatTakesTheConnectionAndKeepsSilentIsATimeOut) {
    useShortTimes();
    device.on(ScriptedVxi11::kGetPort, {.kind = Reaction::Kind::Silence});
    EXPECT_EQ(open(), visa::kTimeout);
    device.on(ScriptedVxi11::kCreateLink, {.kind = Reaction::Kind::Silence});
    EXPECT_EQ(open(), visa::kTimeout);
}

TEST_F(LanVisaTest, APeerThatHangsUpWhileTheSessionOpensIsALostConnection) {
    device.on(ScriptedVxi11::kGetPort, {.kind = Reaction::Kind::Close});
    EXPECT_EQ(open(), visa::kConnectionLost);
    device.on(ScriptedVxi11::kCreateLink, {.kind = Reaction::Kind::Close});
    EXPECT_EQ(open(), visa::kConnectionLost);
    EXPECT_EQ(open(), visa::kSuccess);
}

TEST_F(LanVisaTest, AnOpenThatFailsLeavesNoConnectionBehind) {
    const std::ptrdiff_t before = openDescriptors();
    for (int i = 0; i < 5; ++i) EXPECT_EQ(open("TCPIP::127.0.0.1::inst7::INSTR"), visa::kResourceNotFound);
    options.portMapperPort = test::closedPort();
    makeVisa();
    for (int i = 0; i < 5; ++i) EXPECT_EQ(open(), visa::kResourceNotFound);
    // The device's own ends of the connections close a moment later.
    const auto giveUp = std::chrono::steady_clock::now() + kBounded;
    while (openDescriptors() > before && std::chrono::steady_clock::now() < giveUp) std::this_thread::yield();
    EXPECT_EQ(openDescriptors(), before);
}

TEST_F(LanVisaTest, GpibNeedsALibrary) {
    EXPECT_EQ(open("GPIB0::28::INSTR"), -1073807202);
}

TEST_F(LanVisaTest, AResourceThatCannotBeReadIsRefused) {
    EXPECT_EQ(open("TCPIP::::INSTR"), visa::kInvalidResourceName);
    EXPECT_TRUE(device.calls().empty());
}

TEST_F(LanVisaTest, OpeningNeedsAResourceManager) {
    EXPECT_EQ(visa->viOpen(manager + 1, "TCPIP::127.0.0.1::INSTR", 0, 0, session), visa::kInvalidObject);
}

struct DeviceError {
    long error;
    VisaStatus status;
    friend void PrintTo(const DeviceError& c, std::ostream* out) { *out << "device error " << c.error; }
};

class LanVisaDeviceError : public LanVisaTest, public ::testing::WithParamInterface<DeviceError> {};

TEST_P(LanVisaDeviceError, GivesTheStatusOfItsCause) {
    const auto [error, status] = GetParam();
    device.on(ScriptedVxi11::kCreateLink, {.error = error});
    EXPECT_EQ(open(), status);
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.error = error});
    EXPECT_EQ(write("*RST"), status);
    EXPECT_EQ(count, 0);
    device.on(ScriptedVxi11::kRead, {.error = error});
    EXPECT_EQ(read(), status);
    EXPECT_EQ(count, 0);
}

INSTANTIATE_TEST_SUITE_P(Values, LanVisaDeviceError,
                         ::testing::Values(DeviceError{1, visa::kInputOutput}, DeviceError{3, visa::kResourceNotFound},
                                           DeviceError{4, visa::kConnectionLost}, DeviceError{5, visa::kInputOutput},
                                           DeviceError{8, visa::kInputOutput}, DeviceError{9, visa::kInputOutput},
                                           DeviceError{11, visa::kResourceLocked}, DeviceError{15, visa::kTimeout},
                                           DeviceError{17, visa::kInputOutput},
                                           DeviceError{21, visa::kResourceNotFound}, DeviceError{23, visa::kAborted},
                                           DeviceError{-1, visa::kInputOutput}));

// --- writing ---------------------------------------------------------------------------------------------------

TEST_F(LanVisaTest, AWriteIsOneCallWithTheEndMark) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(":STEREO:DIRECT \"PS=ABCDEFGH\""), visa::kSuccess);
    EXPECT_EQ(count, 28);
    ASSERT_EQ(device.writes().size(), 1U);
    EXPECT_EQ(device.writes()[0].data, ":STEREO:DIRECT \"PS=ABCDEFGH\"");
    EXPECT_EQ(device.writes()[0].flags, 8);
    EXPECT_LE(device.writes()[0].ioTimeout, 2000U);
    EXPECT_GE(device.writes()[0].ioTimeout, 1000U);
}

TEST_F(LanVisaTest, AllByteValuesAreWrittenAsTheyStand) {
    ASSERT_EQ(open(), visa::kSuccess);
    std::string all;
    for (int c = 0; c < 256; ++c) all += static_cast<char>(c);
    EXPECT_EQ(write(all), visa::kSuccess);
    EXPECT_EQ(device.writes()[0].data, all);
}

TEST_F(LanVisaTest, ALongWriteIsSplitAndOnlyTheLastPartBearsTheEndMark) {
    device.setMaxReceive(1024);
    ASSERT_EQ(open(), visa::kSuccess);
    const std::string text = bytesOf(2500);
    EXPECT_EQ(write(text), visa::kSuccess);
    EXPECT_EQ(count, 2500);
    const auto writes = device.writes();
    ASSERT_EQ(writes.size(), 3U);
    EXPECT_EQ(writes[0].data + writes[1].data + writes[2].data, text);
    EXPECT_EQ(writes[0].data.size(), 1024U);
    EXPECT_EQ(writes[0].flags, 0);
    EXPECT_EQ(writes[1].flags, 0);
    EXPECT_EQ(writes[2].flags, 8);
}

TEST_F(LanVisaTest, AWriteOfExactlyTheLargestSizeIsOneCall) {
    device.setMaxReceive(1024);
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(bytesOf(1024)), visa::kSuccess);
    ASSERT_EQ(device.writes().size(), 1U);
    EXPECT_EQ(device.writes()[0].flags, 8);
}

TEST_F(LanVisaTest, ADeviceThatStatesNoLargestSizeGetsWhatEveryDeviceMustTake) {
    device.setMaxReceive(0);
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(bytesOf(1025)), visa::kSuccess);
    EXPECT_EQ(device.writes().size(), 2U);
}

TEST_F(LanVisaTest, AVeryLongWriteArrivesWhole) {
    device.setMaxReceive(0xFFFFFFFF);
    std::string seen;
    device.answerWith([&seen](long, const std::string& command) { return seen = command; });
    ASSERT_EQ(open(), visa::kSuccess);
    const std::string text = bytesOf(1000000);
    EXPECT_EQ(write(text), visa::kSuccess);
    EXPECT_EQ(count, 1000000);
    EXPECT_EQ(read(1000000), visa::kSuccess);
    EXPECT_TRUE(got == text);
}

TEST_F(LanVisaTest, WhatADeviceTookOnlyInPartIsContinued) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.number = 3});
    EXPECT_EQ(write("*RST;*CLS"), visa::kSuccess);
    EXPECT_EQ(count, 9);
    ASSERT_EQ(device.writes().size(), 2U);
    EXPECT_EQ(device.writes()[1].data, "T;*CLS");
}

TEST_F(LanVisaTest, ADeviceThatClaimsToHaveTakenNothingOrTooMuchIsATransferError) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.number = 0});
    EXPECT_EQ(write("*RST"), visa::kInputOutput);
    device.on(ScriptedVxi11::kWrite, {.number = 5});
    EXPECT_EQ(write("*RST"), visa::kInputOutput);
}

TEST_F(LanVisaTest, WritingNothingSendsNothing) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(""), visa::kSuccess);
    EXPECT_TRUE(device.writes().empty());
}

// --- reading ---------------------------------------------------------------------------------------------------

TEST_F(LanVisaTest, AQueryIsOneWriteCallAndOneReadCall) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("KDX,GEN,1,2\n");
    write("*IDN?");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "KDX,GEN,1,2\n");
    EXPECT_EQ(rest, std::string(48, ' '));
    EXPECT_THAT(device.calls(), ElementsAre(ScriptedVxi11::kGetPort, ScriptedVxi11::kCreateLink, ScriptedVxi11::kWrite,
                                            ScriptedVxi11::kRead));
    EXPECT_THAT(device.readSizes(), ElementsAre(60U));
}

class LanVisaAnswer : public LanVisaTest, public ::testing::WithParamInterface<std::size_t> {};

TEST_P(LanVisaAnswer, IsReadInPiecesOfTheBufferAndEndsWithPlainSuccess) {
    ASSERT_EQ(open(), visa::kSuccess);
    std::string answer;
    for (std::size_t i = 0; i < GetParam(); ++i) answer += static_cast<char>(i * 7);
    device.answer(answer);
    std::string whole;
    while (whole.size() + 60 < answer.size()) {
        ASSERT_EQ(read(), visa::kMaxCountReached);
        ASSERT_EQ(count, 60);
        whole += got;
    }
    EXPECT_EQ(read(), visa::kSuccess);
    whole += got;
    EXPECT_EQ(whole, answer);
    EXPECT_EQ(device.readSizes().size(), std::max<std::size_t>(1, (answer.size() + 59) / 60));
}

INSTANTIATE_TEST_SUITE_P(Lengths, LanVisaAnswer, ::testing::Values(0, 1, 5, 59, 60, 61, 120, 121, 500));

TEST_F(LanVisaTest, AnAnswerThatIsNotReadToItsEndIsContinuedAfterAnotherCommand) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer(bytesOf(70));
    EXPECT_EQ(read(), 1073676294);
    write("*RST");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, bytesOf(70).substr(60));
}

TEST_F(LanVisaTest, ATerminationCharacterEndsTheRead) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("12\n");
    device.on(ScriptedVxi11::kRead, {.reason = 2});
    EXPECT_EQ(read(), 1073676293);
    EXPECT_EQ(got, "12\n");
}

TEST_F(LanVisaTest, TheEndMarkOutweighsTheOtherReasons) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("12\n");
    device.on(ScriptedVxi11::kRead, {.reason = 7});
    EXPECT_EQ(read(3), visa::kSuccess);
}

TEST_F(LanVisaTest, PartsThatADeviceGivesWithoutAReasonAreReadTogether) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = "KDX,"});
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = "GEN"});
    device.answer(",1\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "KDX,GEN,1\n");
    EXPECT_THAT(device.readSizes(), ElementsAre(60U, 56U, 53U));
}

TEST_F(LanVisaTest, NeitherBytesNorAnEndIsATransferError) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = ""});
    EXPECT_EQ(read(), visa::kInputOutput);
    EXPECT_EQ(count, 0);
}

TEST_F(LanVisaTest, MoreBytesThanAskedForAreRefused) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 4, .raw = bytesOf(61)});
    EXPECT_EQ(read(), visa::kInputOutput);
    EXPECT_EQ(count, 0);
}

TEST_F(LanVisaTest, AReplyMayArriveByteByByteOrInManyFragments) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer(bytesOf(59) + "\n");
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::AnswerInPieces});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, bytesOf(59) + "\n");
    device.answer(bytesOf(33));
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::AnswerInFragments});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, bytesOf(33));
}

TEST_F(LanVisaTest, NothingToReadIsTheDevicesTimeOutAndTheSessionGoesOn) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(read(), -1073807339);
    device.answer("1\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, ASilentDeviceIsATimeOutAndTheSessionGoesOn) {
    useShortTimes();
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Silence});
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(read(), visa::kTimeout);
    const auto taken = std::chrono::steady_clock::now() - start;
    EXPECT_GE(taken, 100ms);
    EXPECT_LT(taken, kBounded);
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::Silence});
    EXPECT_EQ(write("*RST"), visa::kTimeout);

    device.answer("1\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, TheLateAnswerToAGivenUpCallIsPassedOver) {
    ASSERT_EQ(open(), visa::kSuccess);
    write("*RST");
    device.answer("1\n");
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::AnswerTwice});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, AReadWithoutRoomTouchesNothing) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(read(0), visa::kMaxCountReached);
    EXPECT_TRUE(device.readSizes().empty());
}

// --- connections that break, answers that are none -----------------------------------------------------------------

TEST_F(LanVisaTest, AConnectionThatBreaksAtAReadIsLostForGood) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Close});
    EXPECT_EQ(read(), -1073807194);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(write("*RST"), visa::kConnectionLost);
        EXPECT_EQ(read(), visa::kConnectionLost);
    }
    EXPECT_EQ(visa->viClose(session), visa::kSuccess);
    EXPECT_EQ(open(), visa::kSuccess);
}

TEST_F(LanVisaTest, AConnectionThatBreaksAtAWriteIsLostForGood) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::Close});
    EXPECT_EQ(write("*RST"), visa::kConnectionLost);
    EXPECT_EQ(count, 0);
    EXPECT_EQ(write("*RST"), visa::kConnectionLost);
}

TEST_F(LanVisaTest, ADeviceThatDiesBetweenTwoCallsIsALostConnectionAndNoSignal) {
    auto mortal = std::make_unique<ScriptedVxi11>();
    options.portMapperPort = mortal->port();
    makeVisa();
    ASSERT_EQ(open(), visa::kSuccess);
    mortal.reset();
    EXPECT_EQ(write(bytesOf(5000)), visa::kConnectionLost);
    EXPECT_EQ(write(bytesOf(5000)), visa::kConnectionLost);
    EXPECT_EQ(read(), visa::kConnectionLost);
}

TEST_F(LanVisaTest, ARequestThatCannotBeSentWholeEndsTheConnection) {
    useTimes(2s, 2s);
    options.ioTimeout = 1ms;
    options.answerMargin = 1ms;
    device.setMaxReceive(0xFFFFFFFF);
    makeVisa();
    VisaStatus status = open();
    for (int attempt = 0; status == visa::kTimeout && attempt < 1000; ++attempt) status = open();  // a busy machine
    ASSERT_EQ(status, visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::StopReading});
    const std::string text = bytesOf(60000);
    int writes = 0;
    do {
        status = write(text);
    } while (status == visa::kTimeout && ++writes < 5000);
    EXPECT_GT(writes, 1);
    EXPECT_EQ(status, visa::kConnectionLost);
}

struct Garbage {
    const char* name;
    std::string bytes;
    VisaStatus status;
    friend void PrintTo(const Garbage& garbage, std::ostream* out) { *out << garbage.name; }
};

class LanVisaGarbage : public LanVisaTest, public ::testing::WithParamInterface<Garbage> {};

TEST_P(LanVisaGarbage, IsReportedAndEndsTheConnection) {
    useShortTimes();
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Raw, .raw = GetParam().bytes});
    EXPECT_EQ(read(), GetParam().status);
    EXPECT_EQ(count, 0);
    if (GetParam().status == visa::kInputOutput) {
        EXPECT_EQ(read(), visa::kConnectionLost);
    }
    device.on(ScriptedVxi11::kCreateLink, {.kind = Reaction::Kind::Raw, .raw = GetParam().bytes});
    EXPECT_LT(open(), 0);
    device.on(ScriptedVxi11::kGetPort, {.kind = Reaction::Kind::Raw, .raw = GetParam().bytes});
    EXPECT_LT(open(), 0);
    EXPECT_EQ(open(), visa::kSuccess);
}

/// A message of these 32-bit words, with its record mark.
std::string message(std::initializer_list<std::uint32_t> words) {
    std::string bytes;
    const auto append = [&bytes](std::uint32_t word) {
        for (const int shift : {24, 16, 8, 0}) bytes += static_cast<char>((word >> shift) & 0xFF);
    };
    append(0x80000000U | static_cast<std::uint32_t>(words.size() * 4));
    for (const std::uint32_t word : words) append(word);
    return bytes;
}

// The read is the second call on its connection, so the number 2 is what its answer bears.
INSTANTIATE_TEST_SUITE_P(
    Replies, LanVisaGarbage,
    ::testing::Values(
        Garbage{"text", "HTTP/1.1 400 Bad Request\r\n\r\n", visa::kInputOutput},
        Garbage{"enormous fragment", std::string("\xFF\xFF\xFF\xFF", 4), visa::kInputOutput},
        Garbage{"empty message", message({}), visa::kInputOutput},
        Garbage{"number of a call never made", message({99, 1, 0, 0, 0, 0, 0, 4, 0}), visa::kInputOutput},
        Garbage{"number zero", message({0, 1, 0, 0, 0, 0, 0, 4, 0}), visa::kInputOutput},
        Garbage{"a call instead of a reply", message({2, 0, 2, 395183, 1, 12, 0, 0, 0, 0}), visa::kInputOutput},
        Garbage{"a reply that is only its number", message({2}), visa::kInputOutput},
        Garbage{"refused", message({2, 1, 1, 0, 2, 2}), visa::kInputOutput},
        Garbage{"unknown reply state", message({2, 1, 77}), visa::kInputOutput},
        Garbage{"verifier too long", message({2, 1, 0, 0, 0x7FFFFFFF, 0}), visa::kInputOutput},
        Garbage{"procedure unknown there", message({2, 1, 0, 0, 0, 3}), visa::kInputOutput},
        Garbage{"unknown accept state", message({2, 1, 0, 0, 0, 0xFFFFFFFF}), visa::kInputOutput},
        Garbage{"no results", message({2, 1, 0, 0, 0, 0}), visa::kInputOutput},
        Garbage{"results cut short", message({2, 1, 0, 0, 0, 0, 0, 4, 8, 0x31320A00}), visa::kInputOutput},
        Garbage{"more data than there is", message({2, 1, 0, 0, 0, 0, 0, 4, 0xFFFFFFF0}), visa::kInputOutput},
        Garbage{"half a record mark", std::string("\x80\x00", 2), visa::kTimeout},
        Garbage{"half a message", std::string("\x80\x00\x00\x40\x00\x00", 6), visa::kTimeout}));

TEST_F(LanVisaTest, AReplyMayBearAVerifier) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Raw,
                                     .raw = message({2, 1, 0, 1, 5, 0x01020304, 0x05000000, 0, 0, 4, 2, 0x310A0000})});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

// --- sessions --------------------------------------------------------------------------------------------------

TEST_F(LanVisaTest, SeveralSessionsDoNotDisturbEachOther) {
    device.answerWith([](long link, const std::string& command) { return std::to_string(link) + command; });
    VisaHandle sessions[3] = {};
    for (VisaHandle& handle : sessions) {
        ASSERT_EQ(open(), visa::kSuccess);
        handle = session;
    }
    for (const VisaHandle handle : sessions) {
        session = handle;
        EXPECT_EQ(write("?"), visa::kSuccess);
    }
    std::string all;
    for (const VisaHandle handle : {sessions[2], sessions[0], sessions[1]}) {
        session = handle;
        EXPECT_EQ(read(), visa::kSuccess);
        all += got;
    }
    EXPECT_EQ(all, "3?1?2?");
}

TEST_F(LanVisaTest, AClosedSessionIsNoSessionAndItsHandleIsNotGivenAgain) {
    ASSERT_EQ(open(), visa::kSuccess);
    const VisaHandle first = session;
    EXPECT_EQ(visa->viClose(first), visa::kSuccess);
    EXPECT_THAT(device.destroyed(), ElementsAre(1));
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(read(), visa::kInvalidObject);
    EXPECT_EQ(visa->viClose(first), visa::kInvalidObject);

    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_NE(session, first);
    EXPECT_EQ(write("*RST"), visa::kSuccess);
    session = first;
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(device.writes().size(), 1U);
}

TEST_F(LanVisaTest, AHandleNeverGivenIsNoSession) {
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(read(), visa::kInvalidObject);
    EXPECT_EQ(visa->viClose(4711), visa::kInvalidObject);
    session = manager;
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
}

TEST_F(LanVisaTest, ClosingAResourceManagerClosesItsSessionsOnly) {
    VisaHandle other = 0;
    visa->viOpenDefaultRM(other);
    ASSERT_EQ(open(), visa::kSuccess);
    const VisaHandle first = session;
    ASSERT_EQ(visa->viOpen(other, "TCPIP::127.0.0.1::INSTR", 0, 0, session), visa::kSuccess);
    EXPECT_EQ(visa->viClose(manager), visa::kSuccess);
    EXPECT_EQ(write("*RST"), visa::kSuccess);
    session = first;
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(open(), visa::kInvalidObject);
}

TEST_F(LanVisaTest, ClosingEndsAlsoWhenTheDeviceNoLongerAnswers) {
    useShortTimes();
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kDestroyLink, {.kind = Reaction::Kind::Silence});
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(visa->viClose(session), visa::kSuccess);
    EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
}

TEST_F(LanVisaTest, StatusesAreDescribed) {
    std::string text;
    EXPECT_EQ(visa->viStatusDesc(manager, visa::kTimeout, text), visa::kSuccess);
    EXPECT_THAT(text, ::testing::HasSubstr("time-out"));
    EXPECT_EQ(visa->viStatusDesc(manager, -4711, text), 1073676421);
    EXPECT_THAT(text, ::testing::HasSubstr("-4711"));
    EXPECT_EQ(visa->viStatusDesc(4711, 0, text), visa::kInvalidObject);
}

}  // namespace
}  // namespace kdx
