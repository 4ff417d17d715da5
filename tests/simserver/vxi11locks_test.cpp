#include "simserver/vxi11fixture.h"

namespace kdx::simserver {
namespace {

using Lines = std::vector<std::string>;

constexpr long kWaitLock = CoreClient::kWaitLock;
constexpr u_long kLong = 100000;

/// Two clients with a link each.
class Vxi11LockTest : public Vxi11Test {
protected:
    void SetUp() override {
        Vxi11Test::SetUp();
        m_one = std::make_unique<CoreClient>(port());
        m_two = std::make_unique<CoreClient>(port());
        m_linkOne = m_one->open();
        m_linkTwo = m_two->open();
    }
    long lockOne() { return m_one->error(device_lock, CoreClient::lockArguments(m_linkOne)); }
    long unlockOne() { return m_one->error(device_unlock, CoreClient::linkNumber(m_linkOne)); }

    std::unique_ptr<CoreClient> m_one;
    std::unique_ptr<CoreClient> m_two;
    long m_linkOne = 0;
    long m_linkTwo = 0;
};

TEST_F(Vxi11LockTest, ALockKeepsEveryOtherLinkOut) {
    EXPECT_EQ(lockOne(), 0);
    EXPECT_EQ(m_two->write(m_linkTwo, "A").error, 11);
    EXPECT_EQ(m_two->read(m_linkTwo).error, 11);
    for (const auto procedure : {device_readstb, device_trigger, device_clear, device_remote, device_local}) {
        EXPECT_EQ(m_two->error(procedure, CoreClient::genericArguments(m_linkTwo)), 11) << procedure;
    }
    EXPECT_EQ(m_two->error(device_lock, CoreClient::lockArguments(m_linkTwo)), 11);
    EXPECT_EQ(m_device.got(), Lines{});
    EXPECT_EQ(m_device.clears, 0);
    EXPECT_EQ(m_one->write(m_linkOne, "B").error, 0);
    EXPECT_EQ(unlockOne(), 0);
    EXPECT_EQ(m_two->write(m_linkTwo, "C").error, 0);
    EXPECT_EQ(m_device.got(), (Lines{"B", "C"}));
}

TEST_F(Vxi11LockTest, TheLockHoldsForTheDeviceUnderAllItsNames) {
    lockOne();
    const Create_LinkResp other = m_two->createLink("gpib0,28");
    ASSERT_EQ(other.error, 0);
    EXPECT_EQ(m_two->write(other.lid, "A").error, 11);
}

TEST_F(Vxi11LockTest, OnlyTheHolderCanUnlock) {
    EXPECT_EQ(unlockOne(), 12);
    lockOne();
    EXPECT_EQ(m_two->error(device_unlock, CoreClient::linkNumber(m_linkTwo)), 12);
    EXPECT_EQ(unlockOne(), 0);
    EXPECT_EQ(unlockOne(), 12);
}

TEST_F(Vxi11LockTest, TheHolderCannotLockASecondTime) {
    EXPECT_EQ(lockOne(), 0);
    EXPECT_EQ(lockOne(), 11);
    EXPECT_EQ(m_one->error(device_lock, CoreClient::lockArguments(m_linkOne, kWaitLock, kLong)), 11) << "at once";
    EXPECT_EQ(unlockOne(), 0);
    EXPECT_EQ(m_two->write(m_linkTwo, "A").error, 0);
}

TEST_F(Vxi11LockTest, WhoWaitsForTheLockGetsItWhenItIsFree) {
    lockOne();
    m_two->send(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, kLong));
    EXPECT_FALSE(m_two->receive(20));
    unlockOne();
    const auto reply = m_two->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->word(0), 0U);
    EXPECT_EQ(m_one->write(m_linkOne, "A").error, 11);
}

TEST_F(Vxi11LockTest, OfManyThatWaitTheFirstGetsTheLock) {
    lockOne();
    CoreClient third(port());
    const long linkThree = third.open();
    m_two->send(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, kLong));
    EXPECT_FALSE(m_two->receive(20));
    third.send(device_lock, CoreClient::lockArguments(linkThree, kWaitLock, kLong));
    EXPECT_FALSE(third.receive(20));
    unlockOne();
    ASSERT_TRUE(m_two->receive());
    EXPECT_FALSE(third.receive(20));
    m_two->error(device_unlock, CoreClient::linkNumber(m_linkTwo));
    ASSERT_TRUE(third.receive());
}

TEST_F(Vxi11LockTest, WaitingForTheLockEndsWithItsTimeOut) {
    lockOne();
    EXPECT_EQ(m_two->error(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, 20)), 11);
    EXPECT_EQ(m_two->error(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, 0)), 11);
    EXPECT_EQ(m_two->error(device_clear, CoreClient::genericArguments(m_linkTwo, kWaitLock, 20)), 11);
    EXPECT_EQ(m_device.clears, 0);
}

TEST_F(Vxi11LockTest, AWriteCanWaitForTheLock) {
    lockOne();
    m_two->send(device_write, CoreClient::writeArguments(m_linkTwo, "LATER", CoreClient::kEnd | kWaitLock, kLong));
    EXPECT_FALSE(m_two->receive(20));
    EXPECT_EQ(m_device.got(), Lines{});
    unlockOne();
    const auto reply = m_two->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->rest, word(0) + word(5));
    EXPECT_EQ(m_device.got(), Lines{"LATER"});
}

TEST_F(Vxi11LockTest, AReadWaitsForTheLockFirstAndThenForData) {
    lockOne();
    m_two->send(device_read, CoreClient::readArguments(m_linkTwo, 100, 20, kWaitLock, 0, kLong));
    EXPECT_FALSE(m_two->receive(40)) << "the time-out for data has not begun yet";
    unlockOne();
    const auto reply = m_two->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(CoreClient::readResult(reply->rest).error, 15);
}

TEST_F(Vxi11LockTest, ALinkCanBeMadeWithTheLock) {
    CoreClient third(port());
    const Create_LinkResp link = third.createLink("inst0", true);
    ASSERT_EQ(link.error, 0);
    EXPECT_EQ(m_one->write(m_linkOne, "A").error, 11);
    EXPECT_EQ(third.error(destroy_link, CoreClient::linkNumber(link.lid)), 0);
    EXPECT_EQ(m_one->write(m_linkOne, "A").error, 0) << "the lock goes with its link";
}

TEST_F(Vxi11LockTest, ALinkWithTheLockWaitsForItAndIsNotMadeWithoutIt) {
    lockOne();
    EXPECT_EQ(m_two->createLink("inst0", true, 20).error, 11);
    m_two->send(create_link, CoreClient::linkArguments("inst0", true, kLong));
    EXPECT_FALSE(m_two->receive(20));
    unlockOne();
    const auto reply = m_two->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->word(0), 0U) << "the third link of three: the one that failed takes no place";
    EXPECT_EQ(lockOne(), 11);
}

TEST_F(Vxi11LockTest, ALinkWithoutTheLockCanBeMadeWhileAnotherHasIt) {
    lockOne();
    EXPECT_EQ(m_two->createLink("inst0").error, 0);
}

TEST_F(Vxi11LockTest, ALostConnectionFreesItsLockAndItsLinks) {
    lockOne();
    m_two->send(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, kLong));
    EXPECT_FALSE(m_two->receive(20));
    m_one->crash();
    const auto reply = m_two->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->word(0), 0U);
    CoreClient next(port());
    EXPECT_EQ(next.createLink("inst0").error, 0);
    EXPECT_EQ(next.createLink("inst0").error, 0) << "the lost client's place is free";
    EXPECT_EQ(next.createLink("inst0").error, 9);
}

TEST_F(Vxi11LockTest, AClientThatIsLostWhileItWaitsGetsNoLock) {
    lockOne();
    m_two->send(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, kLong));
    EXPECT_FALSE(m_two->receive(20));
    m_two->crash();
    CoreClient third(port());
    const long linkThree = third.open();
    unlockOne();
    EXPECT_EQ(third.error(device_lock, CoreClient::lockArguments(linkThree, kWaitLock, kLong)), 0);
}

class Vxi11AbortTest : public Vxi11LockTest {
protected:
    long abort(long link) {
        RpcClient client(m_server->abortPort(), DEVICE_ASYNC, DEVICE_ASYNC_VERSION);
        const std::string bytes = client.results(device_abort, CoreClient::linkNumber(link));
        return *XdrDecoded<Device_ErrorCode>(bytes, xdr_Device_ErrorCode);
    }
};

TEST_F(Vxi11AbortTest, EndsAReadThatWaits) {
    m_one->send(device_read, CoreClient::readArguments(m_linkOne, 100, kLong));
    EXPECT_FALSE(m_one->receive(20));
    EXPECT_EQ(abort(m_linkOne), 0);
    const auto reply = m_one->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(CoreClient::readResult(reply->rest), (ReadResult{23, 0, ""}));
    m_one->write(m_linkOne, "NAME?");
    EXPECT_EQ(m_one->read(m_linkOne).data, "NAME\n") << "the link stays in use";
}

TEST_F(Vxi11AbortTest, EndsAWaitForTheLock) {
    lockOne();
    m_two->send(device_lock, CoreClient::lockArguments(m_linkTwo, kWaitLock, kLong));
    EXPECT_FALSE(m_two->receive(20));
    EXPECT_EQ(abort(m_linkTwo), 0);
    const auto reply = m_two->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->word(0), 23U);
    unlockOne();
    EXPECT_EQ(lockOne(), 0) << "the aborted client does not get the lock later";
}

TEST_F(Vxi11AbortTest, LeavesOtherLinksWaiting) {
    m_one->send(device_read, CoreClient::readArguments(m_linkOne, 100, kLong));
    EXPECT_FALSE(m_one->receive(20));
    EXPECT_EQ(abort(m_linkTwo), 0);
    EXPECT_FALSE(m_one->receive(20));
}

TEST_F(Vxi11AbortTest, KnowsOnlyLinksThatAreThere) {
    EXPECT_EQ(abort(99), 4);
}

TEST_F(Vxi11AbortTest, TurnsDownOtherProceduresAndBadArguments) {
    RpcClient client(m_server->abortPort(), DEVICE_ASYNC, DEVICE_ASYNC_VERSION);
    client.send(2, CoreClient::linkNumber(1));
    EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(PROC_UNAVAIL));
    client.send(device_abort, {});
    EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(GARBAGE_ARGS));
}

TEST_F(Vxi11LockTest, ALinkThatIsDestroyedEndsItsWaitingRead) {
    const auto read = m_one->send(device_read, CoreClient::readArguments(m_linkOne, 100, kLong));
    m_one->send(destroy_link, CoreClient::linkNumber(m_linkOne));
    ASSERT_TRUE(m_one->receive());
    const auto reply = m_one->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->xid, read);
    EXPECT_EQ(CoreClient::readResult(reply->rest).error, 4);
}

}  // namespace
}  // namespace kdx::simserver
