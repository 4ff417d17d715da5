#include "simserver/portmappertest.h"

#include "simserver/localnetwork.h"

#include <arpa/inet.h>
#include <ifaddrs.h>
#include <net/if.h>
#include <poll.h>
#include <sys/resource.h>
#include <sys/socket.h>

#include <algorithm>
#include <array>
#include <memory>
#include <optional>

namespace kdx::simserver {
namespace {

class PortMapperTest : public ::testing::Test {
protected:
    PollLoop m_loop;
    PortMapper m_mapper{m_loop, {{kCore, 1, 4711}, {kAsync, 1, 4712}}, "127.0.0.1", 0};
    RunningLoop m_running{m_loop};
};

TEST_F(PortMapperTest, TellsThePortsOfItsProgramsAndItself) {
    RpcClient client(m_mapper.port(), PMAPPROG, PMAPVERS);
    const auto port = [&](std::uint32_t program, std::uint32_t version, std::uint32_t protocol) {
        return client.results(PMAPPROC_GETPORT, question(program, version, protocol));
    };
    EXPECT_EQ(client.results(NULLPROC, {}), "");
    EXPECT_EQ(port(kCore, 1, IPPROTO_TCP), word(4711));
    EXPECT_EQ(port(kAsync, 1, IPPROTO_TCP), word(4712));
    EXPECT_EQ(port(kCore, 9, IPPROTO_TCP), word(4711)) << "the program itself tells which version it has";
    EXPECT_EQ(port(kCore, 1, IPPROTO_UDP), word(0));
    EXPECT_EQ(port(12345, 1, IPPROTO_TCP), word(0));
    EXPECT_EQ(port(PMAPPROG, 2, IPPROTO_TCP), word(m_mapper.port()));
    EXPECT_EQ(port(PMAPPROG, 2, IPPROTO_UDP), word(m_mapper.port()));
}

TEST_F(PortMapperTest, ListsThemAll) {
    RpcClient client(m_mapper.port(), PMAPPROG, PMAPVERS);
    const std::uint32_t own = m_mapper.port();
    EXPECT_EQ(client.results(PMAPPROC_DUMP, {}), word(1) + question(PMAPPROG, 2, IPPROTO_TCP, own) + word(1) +
                                                     question(PMAPPROG, 2, IPPROTO_UDP, own) + word(1) +
                                                     question(kCore, 1, IPPROTO_TCP, 4711) + word(1) +
                                                     question(kAsync, 1, IPPROTO_TCP, 4712) + word(0));
}

TEST_F(PortMapperTest, TakesNoRegistrationsOfOthers) {
    RpcClient client(m_mapper.port(), PMAPPROG, PMAPVERS);
    EXPECT_EQ(client.results(PMAPPROC_SET, question(12345, 1, IPPROTO_TCP, 5000)), word(0));
    EXPECT_EQ(client.results(PMAPPROC_UNSET, question(kCore, 1, IPPROTO_TCP)), word(0));
    EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(12345, 1, IPPROTO_TCP)), word(0));
    EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP)), word(4711));
}

TEST_F(PortMapperTest, TurnsDownWhatItCannotDo) {
    RpcClient client(m_mapper.port(), PMAPPROG, PMAPVERS);
    client.send(PMAPPROC_CALLIT, {});
    EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(PROC_UNAVAIL));
    client.send(PMAPPROC_GETPORT, word(kCore));
    EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(GARBAGE_ARGS));
    for (const std::uint32_t version : {3U, 4U}) {
        RpcClient newer(m_mapper.port(), PMAPPROG, version);
        newer.send(PMAPPROC_GETPORT, {});
        const auto reply = newer.receive();
        ASSERT_TRUE(reply);
        EXPECT_EQ(reply->status, static_cast<std::uint32_t>(PROG_MISMATCH));
        EXPECT_EQ(reply->rest, word(2) + word(2));
    }
}

TEST_F(PortMapperTest, AnswersOverUdpToo) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(m_mapper.port());
    name.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    const FileDescriptor socket(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    ASSERT_EQ(::connect(socket.number(), reinterpret_cast<const sockaddr*>(&name), sizeof name), 0);
    const auto ask = [&](const std::string& datagram) {
        ::send(socket.number(), datagram.data(), datagram.size(), 0);
        std::array<char, 1000> bytes;
        pollfd waited{socket.number(), POLLIN, 0};
        EXPECT_EQ(::poll(&waited, 1, 5000), 1);
        const ssize_t count = ::recv(socket.number(), bytes.data(), bytes.size(), MSG_DONTWAIT);
        return parseReply({bytes.data(), static_cast<std::size_t>(std::max<ssize_t>(count, 0))});
    };
    RpcClient writer(m_mapper.port(), PMAPPROG, PMAPVERS);
    RpcClient newWriter(m_mapper.port(), PMAPPROG, 4);
    ::send(socket.number(), "nonsense", 8, 0);  // gets no answer and does no harm
    EXPECT_EQ(ask(writer.callMessage(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP))).rest, word(4711));
    EXPECT_EQ(ask(newWriter.callMessage(3, {})).status, static_cast<std::uint32_t>(PROG_MISMATCH));
}

/// Addresses of this machine that no client takes: closed connections would hold their ports for a minute. The test
/// that takes thousands of ports has one to itself, for tests run side by side.
constexpr const char* kQuietAddress = "127.0.0.77";
constexpr const char* kOtherQuietAddress = "127.0.0.78";
constexpr const char* kCrowdedAddress = "127.0.0.79";

/// Asks by UDP whoever is at the place for the port of the core channel.
std::optional<Reply> askAt(const std::string& place, unsigned short port, int timeoutMs) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port);
    ::inet_pton(AF_INET, place.c_str(), &name.sin_addr);
    const FileDescriptor socket(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    const int on = 1;
    ::setsockopt(socket.number(), SOL_SOCKET, SO_BROADCAST, &on, sizeof on);
    std::string call;
    for (const std::uint32_t value : {7U, 0U, 2U, 100000U, 2U, 3U, 0U, 0U, 0U, 0U}) call += word(value);
    call += question(kCore, 1, IPPROTO_TCP);
    ::sendto(socket.number(), call.data(), call.size(), 0, reinterpret_cast<const sockaddr*>(&name), sizeof name);
    std::array<char, 1000> bytes;
    pollfd waited{socket.number(), POLLIN, 0};
    if (::poll(&waited, 1, timeoutMs) != 1) return std::nullopt;
    const ssize_t count = ::recv(socket.number(), bytes.data(), bytes.size(), MSG_DONTWAIT);
    return parseReply({bytes.data(), static_cast<std::size_t>(std::max<ssize_t>(count, 0))});
}

TEST_F(PortMapperTest, AnswersWhatIsAskedOfEverybodyInItsNetwork) {
    const auto reply = askAt("127.255.255.255", m_mapper.port(), 5000);
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->rest, word(4711));
}

TEST(PortMapper, TakesAPortThatIsFreeForBothProtocols) {
    constexpr rlim_t kSocketsAndMore = 6000;
    constexpr std::size_t kInTheWay = 5000;
    constexpr std::size_t kMappers = 40;
    rlimit files{};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &files), 0);
    files.rlim_cur = std::max(files.rlim_cur, std::min(files.rlim_max, kSocketsAndMore));
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &files), 0);
    if (files.rlim_cur < kSocketsAndMore) GTEST_SKIP() << "this machine allows too few open sockets";
    PollLoop loop;
    std::vector<std::unique_ptr<PortMapper>> mappers;
    mappers.reserve(kMappers);
    std::vector<FileDescriptor> inTheWay;
    inTheWay.reserve(kInTheWay);
    for (std::size_t count = 0; count < kInTheWay; ++count) inTheWay.push_back(bindUdp(kCrowdedAddress, 0));
    for (std::size_t count = 0; count < kMappers; ++count) {
        mappers.push_back(std::make_unique<PortMapper>(loop, std::vector<PortMapping>(), kCrowdedAddress, 0));
    }
}

TEST(PortMapper, TwoInOneNetworkBothAnswer) {
    PollLoop loop;
    const PortMapper one(loop, {{kCore, 1, 4711}}, kOtherQuietAddress, 0);
    const PortMapper two(loop, {{kCore, 1, 4712}}, kQuietAddress, one.port());
    const RunningLoop running(loop);
    EXPECT_TRUE(askAt("127.255.255.255", one.port(), 5000));
    EXPECT_EQ(askAt(kQuietAddress, one.port(), 5000).value_or(Reply{}).rest, word(4712));
}

/// An address of this machine in a network with others; empty when it has none.
std::string addressInANetwork() {
    ifaddrs* first = nullptr;
    if (::getifaddrs(&first) != 0) return {};
    const std::unique_ptr<ifaddrs, decltype(&freeifaddrs)> list(first, &freeifaddrs);
    for (const ifaddrs* entry = first; entry != nullptr; entry = entry->ifa_next) {
        constexpr unsigned kWanted = IFF_UP | IFF_BROADCAST;
        const bool fits = (entry->ifa_flags & kWanted) == kWanted && (entry->ifa_flags & IFF_LOOPBACK) == 0;
        if (!fits || entry->ifa_addr == nullptr || entry->ifa_addr->sa_family != AF_INET) continue;
        std::array<char, INET_ADDRSTRLEN> text{};
        const auto* const name = reinterpret_cast<const sockaddr_in*>(entry->ifa_addr);
        return ::inet_ntop(AF_INET, &name->sin_addr, text.data(), text.size());
    }
    return {};
}

TEST(PortMapper, AnswersWhatIsAskedOfEverybodyByItsInterfaceOnly) {
    const std::string address = addressInANetwork();
    if (address.empty()) GTEST_SKIP() << "this machine is in no network";
    PollLoop loop;
    const PortMapper there(loop, {{kCore, 1, 4711}}, address, 0);
    const PortMapper here(loop, {{kCore, 1, 4712}}, "127.0.0.1", 0);
    const RunningLoop running(loop);
    for (const std::string& place :
         {std::string("255.255.255.255"), networkOf(address).value_or(LocalNetwork{}).broadcastAddress}) {
        EXPECT_EQ(askAt(place, there.port(), 5000).value_or(Reply{}).rest, word(4711)) << place;
        EXPECT_FALSE(askAt(place, here.port(), 50)) << "nobody beyond this machine learns of it: " << place;
    }
}

TEST(LocalNetwork, IsThatOfTheAddress) {
    EXPECT_EQ(networkOf("127.0.0.1").value_or(LocalNetwork{}).broadcastAddress, "127.255.255.255");
    EXPECT_EQ(networkOf("127.1.2.3").value_or(LocalNetwork{}).interfaceIndex, ::if_nametoindex("lo"));
    EXPECT_FALSE(networkOf("0.0.0.0"));
    EXPECT_FALSE(networkOf("198.51.100.1")) << "no address of this machine";
    EXPECT_FALSE(networkOf("nonsense"));
}

}  // namespace
}  // namespace kdx::simserver
