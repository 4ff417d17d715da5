// Pauses beside a window.
#include "link/patientclock.h"

#include <gtest/gtest.h>

#include "link/workervisa.h"
#include "support/hangingvisa.h"

namespace kdx::test {
namespace {

using namespace std::chrono_literals;

class Impatient final : public CallWaiter {
public:
    void waitUntil(const std::function<bool()>& over) override {
        ++waits;
        while (!givesUp && !over()) std::this_thread::yield();
    }
    void wake() override {}
    bool givesUp = false;
    int waits = 0;
};

class PatientClockTest : public ::testing::Test {
protected:
    PatientClockTest() { worker.setWaiter(&waiter); }
    ~PatientClockTest() override { worker.setWaiter(nullptr); }

    std::shared_ptr<HangingVisa> link = std::make_shared<HangingVisa>();
    WorkerVisa worker{link};
    Impatient waiter;
    PatientClock clock{worker};
};

TEST_F(PatientClockTest, AShortPauseTroublesNobody) {
    clock.sleep(1ms);
    EXPECT_EQ(waiter.waits, 0);
    EXPECT_FALSE(clock.wasGivenUp());
}

TEST_F(PatientClockTest, ALongPauseIsSpentWithTheWaiterAndCanBeGivenUp) {
    waiter.givesUp = true;
    clock.sleep(24h);
    EXPECT_EQ(waiter.waits, 1);
    EXPECT_TRUE(clock.wasGivenUp());
    waiter.givesUp = false;
    VisaHandle manager = 0;
    EXPECT_EQ(worker.viOpenDefaultRM(manager), visa::kSuccess) << "what comes after it does not wait for it";
    clock.sleep(1ms);
    EXPECT_FALSE(clock.wasGivenUp());
}

TEST_F(PatientClockTest, AWaitThatIsGivenUpIsOverAtOnce) {
    waiter.givesUp = true;
    const auto before = clock.steadyNow();
    WaitMs(clock, 30000);
    EXPECT_LT(clock.steadyNow() - before, 10s);
    EXPECT_EQ(waiter.waits, 1);
}

}  // namespace
}  // namespace kdx::test
