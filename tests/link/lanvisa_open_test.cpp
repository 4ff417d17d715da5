#include "link/lanvisatest.h"

#include <dirent.h>

#include <thread>

#include "support/loopbackport.h"

namespace kdx::test {
namespace {

using ::testing::ElementsAre;

std::ptrdiff_t openDescriptors() {
    const std::unique_ptr<DIR, int (*)(DIR*)> folder(opendir("/proc/self/fd"), &closedir);
    std::ptrdiff_t count = 0;
    while (readdir(folder.get()) != nullptr) ++count;
    return count;
}

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
    options.portMapperPort = closedPort();
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
    options.portMapperPort = closedPort();
    makeVisa();
    EXPECT_EQ(open(), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, AHostThatServesNoInstrumentIsNotFound) {
    device.on(ScriptedVxi11::kGetPort, {.number = 0});
    EXPECT_EQ(open(), visa::kResourceNotFound);
}

TEST_F(LanVisaTest, APortMapperThatNamesADeadPortMeansNotFound) {
    device.on(ScriptedVxi11::kGetPort, {.number = closedPort()});
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
    const DeafPort deaf;
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
    const DeafPort deaf;
    useShortTimes();
    device.on(ScriptedVxi11::kGetPort, {.number = deaf.port()});
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(open(), visa::kResourceNotFound);
    EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
}

TEST_F(LanVisaTest, TheCallersOpenTimeOutReplacesOurOwn) {
    const DeafPort deaf;
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
    options.portMapperPort = closedPort();
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

}  // namespace
}  // namespace kdx::test
