#include "simserver/portmappertest.h"

#include <arpa/inet.h>
#include <poll.h>
#include <sys/socket.h>

#include <array>

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

}  // namespace
}  // namespace kdx::simserver
