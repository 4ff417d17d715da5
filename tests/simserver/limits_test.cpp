#include "simserver/vxi11fixture.h"
#include "vxi11/rpcrecord.h"

#include <netinet/in.h>
#include <poll.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <unistd.h>

#include <chrono>
#include <ctime>
#include <set>

namespace kdx::simserver {
namespace {

using namespace std::chrono_literals;
using namespace std::string_literals;

constexpr u_long kForever = 0xFFFFFFFF;

using LimitsTest = Vxi11Test;

TEST_F(LimitsTest, OnePeerLeavesConnectionsForOthers) {
    std::vector<std::unique_ptr<CoreClient>> clients;
    for (int i = 0; i < 96; ++i) {
        clients.push_back(std::make_unique<CoreClient>(port()));
        clients.back()->results(NULLPROC, {});
    }
    EXPECT_TRUE(CoreClient(port()).isClosedByServer());
    EXPECT_EQ(CoreClient::elsewhere(port())->results(NULLPROC, {}), "");
    clients.back()->endSending();
    EXPECT_TRUE(clients.back()->isClosedByServer());
    EXPECT_EQ(CoreClient(port()).results(NULLPROC, {}), "");
}

class LinkLimitTest : public Vxi11Test {
    void adjust(Vxi11Options& options) override { options.maxLinksOfOnePeer = 2; }
};

TEST_F(LinkLimitTest, OnePeerLeavesLinksForOthers) {
    CoreClient one(port());
    CoreClient another(port());
    const long link = one.open();
    another.open();
    EXPECT_EQ(one.createLink("inst0").error, 9);
    EXPECT_EQ(another.createLink("inst0").error, 9);
    EXPECT_EQ(CoreClient::elsewhere(port())->createLink("inst0").error, 0);
    one.error(destroy_link, CoreClient::linkNumber(link));
    EXPECT_EQ(another.createLink("inst0").error, 0);
}

TEST_F(LimitsTest, OnePeerLeavesRoomForTheWaitingCallsOfOthers) {
    const auto isRefused = [](CoreClient& client) {
        const auto reply = client.receive();
        return reply && CoreClient::readResult(reply->rest).error == 9;
    };
    const auto other = CoreClient::elsewhere(port());
    CoreClient one(port());
    for (CoreClient* client : {&one, other.get()}) {
        const std::string arguments = CoreClient::readArguments(client->open(), 100, 60000);
        for (int i = 0; i < 128; ++i) client->send(device_read, arguments);
        EXPECT_FALSE(client->receive(50));
        client->send(device_read, arguments);
        EXPECT_TRUE(isRefused(*client));
    }
    CoreClient third(port(), DEVICE_CORE, DEVICE_CORE_VERSION, "127.0.0.3");
    third.send(device_read, CoreClient::readArguments(third.open(), 100, 60000));
    EXPECT_TRUE(isRefused(third)) << "nor may all of them together have more than 256";
}

class LongestWaitTest : public Vxi11Test {
    void adjust(Vxi11Options& options) override { options.longestWait = 50ms; }
};

TEST_F(LongestWaitTest, EndsACallThatWantsToWaitForever) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.read(link, 100, kForever).error, 15);
    CoreClient holder(port());
    ASSERT_EQ(holder.error(device_lock, CoreClient::lockArguments(holder.open())), 0);
    EXPECT_EQ(client.error(device_lock, CoreClient::lockArguments(link, CoreClient::kWaitLock, kForever)), 11);
}

class PatienceTest : public Vxi11Test {
    void adjust(Vxi11Options& options) override { options.patience = 200ms; }
};

TEST_F(PatienceTest, EndsWithAConnectionThatIsNotUsed) {
    CoreClient client(port());
    RpcClient abort(m_server->abortPort(), DEVICE_ASYNC, DEVICE_ASYNC_VERSION);
    EXPECT_TRUE(client.isClosedByServer());
    EXPECT_TRUE(abort.isClosedByServer());
}

TEST_F(PatienceTest, LastsForAClientThatHasALinkOrWaitsForOne) {
    CoreClient client(port());
    RpcClient abort(m_server->abortPort(), DEVICE_ASYNC, DEVICE_ASYNC_VERSION);
    const long link = client.open();
    ASSERT_EQ(client.error(device_lock, CoreClient::lockArguments(link)), 0);
    const auto waiting = CoreClient::elsewhere(port());
    waiting->send(create_link, CoreClient::linkArguments("inst0", true, 60000));
    CoreClient idle(port());
    EXPECT_TRUE(idle.isClosedByServer());
    EXPECT_EQ(abort.results(NULLPROC, {}), "");
    EXPECT_EQ(client.error(device_unlock, CoreClient::linkNumber(link)), 0);
    EXPECT_EQ(waiting->receive().value_or(Reply{}).rest.substr(0, 4), word(0));
}

class SilenceTest : public PatienceTest {
protected:
    std::atomic<std::chrono::hours> m_passed = 0h;

private:
    void adjust(Vxi11Options& options) override {
        options.patience = 400ms;  // it looks four times as often
        options.now = [this] { return std::chrono::steady_clock::now() + m_passed.load(); };
    }
};

TEST_F(SilenceTest, LastsForHoursThoughNotForEver) {
    CoreClient client(port());
    RpcClient abort(m_server->abortPort(), DEVICE_ASYNC, DEVICE_ASYNC_VERSION);
    ASSERT_EQ(client.error(device_lock, CoreClient::lockArguments(client.open())), 0);
    m_passed = 11h;
    std::this_thread::sleep_for(250ms);
    EXPECT_EQ(client.results(NULLPROC, {}), "") << "which begins anew with it";
    std::this_thread::sleep_for(250ms);  // the server takes note of it behind its answer
    m_passed = 22h;
    std::this_thread::sleep_for(250ms);
    const auto waiting = CoreClient::elsewhere(port());
    waiting->send(create_link, CoreClient::linkArguments("inst0", true, 60000));
    EXPECT_FALSE(waiting->receive(100));
    m_passed = 24h;
    EXPECT_TRUE(client.isClosedByServer());
    EXPECT_TRUE(abort.isClosedByServer());
    EXPECT_EQ(waiting->receive().value_or(Reply{}).rest.substr(0, 4), word(0)) << "the lock has gone with the link";
}

TEST_F(PatienceTest, EndsWithACallThatTricklesIn) {
    CoreClient client(port());
    client.open();
    client.sendBytes(framed(std::string(100000, 'x')).substr(0, 10));
    std::atomic<bool> over = false;
    std::thread trickle([&] {
        while (!over) {
            std::this_thread::sleep_for(20ms);
            client.sendBytes("x");
        }
    });
    EXPECT_TRUE(client.isClosedByServer()) << "though it is never silent and has a link";
    over = true;
    trickle.join();
}

TEST_F(LimitsTest, NobodyCanGuessTheLinkOfAnother) {
    CoreClient client(port());
    FakeDevice device;
    Vxi11Server another(device);
    std::thread thread([&another] { another.run(); });
    std::set<long> links{client.open(), client.open(), client.open(), CoreClient(another.corePort()).open()};
    another.stop();
    thread.join();
    EXPECT_EQ(links.size(), 4U);
    EXPECT_GT(*links.begin(), 0);
    EXPECT_GT(*links.rbegin() - *links.begin(), 1000);
}

std::clock_t processorTimeOf(std::chrono::milliseconds span) {
    const std::clock_t before = std::clock();
    std::this_thread::sleep_for(span);
    return std::clock() - before;
}

TEST_F(LimitsTest, WithoutADescriptorLeftItRestsAndGoesOn) {
    CoreClient client(port());
    const long link = client.open();
    rlimit usual{};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &usual), 0);
    const int late = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    const rlimit none{static_cast<rlim_t>(late) + 1, usual.rlim_max};
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &none), 0);
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port());
    name.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    EXPECT_EQ(::connect(late, reinterpret_cast<const sockaddr*>(&name), sizeof name), 0);
    EXPECT_LT(processorTimeOf(200ms), CLOCKS_PER_SEC / 20) << "a quarter of a core";
    client.write(link, "NAME?");
    EXPECT_EQ(client.read(link).data, "NAME\n");
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &usual), 0);
    const std::string call = framed(client.callMessage(NULLPROC, {}));
    ::send(late, call.data(), call.size(), MSG_NOSIGNAL);
    pollfd waited{late, POLLIN, 0};
    EXPECT_EQ(::poll(&waited, 1, 5000), 1);
    ::close(late);
}

}  // namespace
}  // namespace kdx::simserver
