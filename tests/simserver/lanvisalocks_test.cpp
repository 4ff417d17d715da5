#include "link/lanvisa.h"

#include "simserver/vxi11fixture.h"

#include <chrono>

namespace kdx::simserver {
namespace {

using namespace std::chrono_literals;

/// The LAN client beside another client that holds the lock.
class LanVisaLockTest : public Vxi11Test {
protected:
    void SetUp() override {
        Vxi11Test::SetUp();
        m_other = std::make_unique<CoreClient>(port());
        m_otherLink = m_other->open();
    }
    void open(std::chrono::milliseconds ioTimeout) {
        m_visa = std::make_unique<LanVisa>(LanOptions{.ioTimeout = ioTimeout, .corePort = port()});
        m_visa->viOpenDefaultRM(m_manager);
        ASSERT_EQ(m_visa->viOpen(m_manager, "TCPIP::127.0.0.1::INSTR", 0, 0, m_session), visa::kSuccess);
        ASSERT_EQ(m_other->error(device_lock, CoreClient::lockArguments(m_otherLink)), 0);
    }
    VisaStatus write(const std::string& text) { return m_visa->viWrite(m_session, text, m_count); }
    void unlock() { m_other->error(device_unlock, CoreClient::linkNumber(m_otherLink)); }
    std::thread unlockSoon() {
        return std::thread([this] {
            std::this_thread::sleep_for(50ms);
            unlock();
        });
    }

    std::unique_ptr<CoreClient> m_other;
    long m_otherLink = 0;
    std::unique_ptr<LanVisa> m_visa;
    VisaHandle m_manager = 0;
    VisaHandle m_session = 0;
    std::int32_t m_count = 0;
};

TEST_F(LanVisaLockTest, ALockOfSomebodyElseThatEndsInTimeLosesNoCommand) {
    open(10s);
    std::thread unlocking = unlockSoon();
    EXPECT_EQ(write("NAME?"), visa::kSuccess);
    unlocking.join();
    EXPECT_EQ(m_device.got(), std::vector<std::string>{"NAME?"});

    ASSERT_EQ(m_other->error(device_lock, CoreClient::lockArguments(m_otherLink)), 0);
    unlocking = unlockSoon();
    std::string answer(60, ' ');
    EXPECT_EQ(m_visa->viRead(m_session, answer, m_count), visa::kSuccess);
    unlocking.join();
    EXPECT_EQ(answer.substr(0, 5), "NAME\n");
}

TEST_F(LanVisaLockTest, ALongLockOfSomebodyElseIsReportedAfterTheTimeOut) {
    open(50ms);
    EXPECT_EQ(write("A"), visa::kResourceLocked);
    unlock();
    EXPECT_EQ(write("B"), visa::kSuccess) << "the session goes on";
    EXPECT_EQ(m_device.got(), std::vector<std::string>{"B"});
}

}  // namespace
}  // namespace kdx::simserver
