#include "link/lanvisatest.h"

#include <thread>

#include "support/loopbackport.h"

namespace kdx::test {
namespace {

class AbortTest : public LanVisaTest {
protected:
    AbortTest() { useTimes(60s, 60s); }

    /// Does something that would last for a minute; another thread aborts it as soon as the device has seen the call.
    VisaStatus abortedAt(std::uint32_t procedure, const std::function<VisaStatus()>& action) {
        device.on(procedure, {.kind = Reaction::Kind::Silence});
        std::thread other([this, procedure, before = device.calls().size()] {
            while (device.calls().size() == before || device.calls().back() != procedure) std::this_thread::yield();
            visa->setAborting(true);
        });
        const auto start = std::chrono::steady_clock::now();
        const VisaStatus status = action();
        EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
        other.join();
        visa->setAborting(false);
        return status;
    }
};

TEST_F(AbortTest, AReadEndsAndTheLateAnswerIsPassedOver) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(abortedAt(ScriptedVxi11::kRead, [this] { return read(); }), visa::kAborted);
    device.answer("SECOND\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "SECOND\n");
}

TEST_F(AbortTest, AWriteEnds) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(abortedAt(ScriptedVxi11::kWrite, [this] { return write("*RST"); }), visa::kAborted);
    EXPECT_EQ(write("*RST"), visa::kSuccess);
}

TEST_F(AbortTest, AnOpeningEnds) {
    EXPECT_EQ(abortedAt(ScriptedVxi11::kGetPort, [this] { return open(); }), visa::kAborted);
    EXPECT_EQ(abortedAt(ScriptedVxi11::kCreateLink, [this] { return open(); }), visa::kAborted);
    EXPECT_EQ(open(), visa::kSuccess);
}

TEST_F(AbortTest, AConnectionThatNobodyTakesIsNotWaitedFor) {
    const DeafPort deaf;
    options.corePort = deaf.port();
    makeVisa();
    std::thread other([this] { visa->setAborting(true); });
    EXPECT_EQ(open(), visa::kAborted);
    other.join();
}

TEST_F(AbortTest, WhatIsOverKeepsItsStatus) {
    visa->setAborting(true);
    EXPECT_EQ(open("TCPIP::"), visa::kInvalidResourceName);
    visa->setAborting(false);
    EXPECT_EQ(open(), visa::kSuccess);
}

}  // namespace
}  // namespace kdx::test
