#include "simserver/portmapper.h"

#include "simserver/portannouncement.h"
#include "simserver/rpcclient.h"
#include "simserver/vxi11fixture.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <rpc/pmap_prot.h>
#include <sys/socket.h>

#include <array>
#include <functional>
#include <map>

namespace kdx::simserver {
namespace {

constexpr std::uint32_t kCore = DEVICE_CORE;
constexpr std::uint32_t kAsync = DEVICE_ASYNC;

std::string question(std::uint32_t program, std::uint32_t version, std::uint32_t protocol, std::uint32_t port = 0) {
    return toXdr<pmap>({program, version, protocol, port}, xdr_pmap);
}

/// A loop that runs in a thread of its own while the object lives.
class RunningLoop {
public:
    explicit RunningLoop(PollLoop& loop) : m_loop(loop), m_thread([&loop] { loop.run(); }) {}
    RunningLoop(const RunningLoop&) = delete;
    RunningLoop& operator=(const RunningLoop&) = delete;
    ~RunningLoop() {
        m_loop.stop();
        m_thread.join();
    }

private:
    PollLoop& m_loop;
    std::thread m_thread;
};

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

/// A port mapper with which others can register, as it runs on many machines.
class RegisteringMapper final : public RpcProgram {
public:
    explicit RegisteringMapper(PollLoop& loop) : RpcProgram(PMAPPROG, PMAPVERS), server(loop, *this, "127.0.0.1", 0) {}

    std::map<u_long, u_long> ports;  ///< by program; to be looked at while the loop stands
    bool refuses = false;
    RpcTcpServer server;

protected:
    void call(std::uint32_t procedure, std::string_view arguments, ConnectionId, const RpcReply& reply) override {
        const XdrDecoded<pmap> asked(arguments, xdr_pmap);
        u_long answer = 0;
        if (procedure == PMAPPROC_SET && !refuses) answer = ports.emplace(asked->pm_prog, asked->pm_port).second;
        if (procedure == PMAPPROC_UNSET) answer = ports.erase(asked->pm_prog);
        if (procedure == PMAPPROC_GETPORT && ports.contains(asked->pm_prog)) answer = ports.at(asked->pm_prog);
        reply({toXdr<u_long>(answer, xdr_u_long)});
    }
};

using Ports = std::map<u_long, u_long>;

class PortAnnouncementTest : public ::testing::Test {
protected:
    // Runs the other port mapper for as long as the action takes.
    void whileOtherRuns(const std::function<void()>& action) {
        const RunningLoop running(m_otherLoop);
        action();
    }
    [[nodiscard]] unsigned short mapperPort() const { return m_other.server.port(); }

    PollLoop m_loop;
    PollLoop m_otherLoop;
    RegisteringMapper m_other{m_otherLoop};
    const std::vector<PortMapping> m_mappings{{kCore, 1, 4711}, {kAsync, 1, 4712}};
};

TEST_F(PortAnnouncementTest, AnswersItselfWhenThePortIsFree) {
    unsigned short freePort = 0;
    {
        const PortMapper probe(m_loop, {}, "127.0.0.1", 0);
        freePort = probe.port();
    }
    const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", freePort);
    EXPECT_EQ(announcement.way(), PortAnnouncement::Way::OwnMapper);
    EXPECT_EQ(announcement.problem(), "");
    const RunningLoop running(m_loop);
    RpcClient client(freePort, PMAPPROG, PMAPVERS);
    EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP)), word(4711));
}

TEST_F(PortAnnouncementTest, RegistersWithTheOneThatRunsAndTakesItBackAtTheEnd) {
    Ports registered;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::Registered);
        EXPECT_EQ(announcement.problem(), "");
        RpcClient client(mapperPort(), PMAPPROG, PMAPVERS);
        EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP)), word(4711));
        EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kAsync, 1, IPPROTO_TCP)), word(4712));
    });
    EXPECT_EQ(m_other.ports, Ports{});
}

TEST_F(PortAnnouncementTest, DoesNotPushOutAnInstrumentThatIsRegisteredAndRuns) {
    const FileDescriptor otherInstrument = listenTcp("127.0.0.1", 0);
    const Ports before{{kAsync, localPort(otherInstrument)}};
    m_other.ports = before;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
        EXPECT_NE(announcement.problem().find("did not take the registration"), std::string::npos);
    });
    EXPECT_EQ(m_other.ports, before) << "nor does half a registration stay behind";
}

TEST_F(PortAnnouncementTest, ReplacesWhatACrashedProgramLeftBehind) {
    unsigned short deadPort = 0;
    {
        const FileDescriptor crashed = listenTcp("127.0.0.1", 0);
        deadPort = localPort(crashed);
    }
    m_other.ports = {{kCore, deadPort}};
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::Registered);
        RpcClient client(mapperPort(), PMAPPROG, PMAPVERS);
        EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP)), word(4711));
    });
}

TEST_F(PortAnnouncementTest, SaysSoWhenTheRunningOneRefuses) {
    m_other.refuses = true;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
        EXPECT_NE(announcement.problem(), "");
    });
}

TEST_F(PortAnnouncementTest, SaysSoWhenNobodyAnswersAndThePortIsTaken) {
    const FileDescriptor taken = bindUdp("127.0.0.1", 0);  // the TCP port of the same number is free
    const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", localPort(taken));
    EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
    EXPECT_NE(announcement.problem().find("no port mapper runs"), std::string::npos);
}

}  // namespace
}  // namespace kdx::simserver
