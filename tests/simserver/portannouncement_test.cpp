#include "simserver/portannouncement.h"

#include "simserver/portmappertest.h"
#include "simserver/rpctcpserver.h"

#include <chrono>
#include <functional>
#include <map>
#include <memory>

namespace kdx::simserver {
namespace {

/// A port mapper with which others can register, as it runs on many machines.
class RegisteringMapper final : public RpcProgram {
public:
    explicit RegisteringMapper(PollLoop& loop, unsigned short port = 0)
        : RpcProgram(PMAPPROG, PMAPVERS), server(loop, *this, "127.0.0.1", port) {}

    std::map<u_long, u_long> ports;  ///< by program; to be looked at and changed while the loop stands
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

using std::chrono::milliseconds;
using Ports = std::map<u_long, u_long>;

class PortAnnouncementTest : public ::testing::Test {
protected:
    // Runs the other port mapper for as long as the action takes.
    void whileOtherRuns(const std::function<void()>& action) {
        const RunningLoop running(m_otherLoop);
        action();
    }
    [[nodiscard]] unsigned short mapperPort() const { return m_other->server.port(); }
    // Ends the other port mapper, so that its successor can have the port.
    unsigned short mapperPortOnceFreed() {
        const unsigned short port = mapperPort();
        m_other.reset();
        return port;
    }

    // Within ten seconds, that is; the abort channel is registered last.
    static bool isRegisteredSoon(unsigned short mapperPort) {
        RpcClient client(mapperPort, PMAPPROG, PMAPVERS);
        for (int i = 0; i < 1000; ++i) {
            if (client.results(PMAPPROC_GETPORT, question(kAsync, 1, IPPROTO_TCP)) == word(4712)) return true;
            std::this_thread::sleep_for(milliseconds(10));
        }
        return false;
    }

    PollLoop m_loop;
    PollLoop m_otherLoop;
    std::unique_ptr<RegisteringMapper> m_other = std::make_unique<RegisteringMapper>(m_otherLoop);
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
    EXPECT_EQ(m_other->ports, Ports{});
}

TEST_F(PortAnnouncementTest, DoesNotPushOutAnInstrumentThatIsRegisteredAndRuns) {
    const FileDescriptor otherInstrument = listenTcp("127.0.0.1", 0);
    const Ports before{{kAsync, localPort(otherInstrument)}};
    m_other->ports = before;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
        EXPECT_NE(announcement.problem().find("did not take the registration"), std::string::npos);
    });
    EXPECT_EQ(m_other->ports, before) << "nor does half a registration stay behind";
}

TEST_F(PortAnnouncementTest, DoesNotPushOutAnInstrumentAtAnotherAddress) {
    const FileDescriptor otherInstrument = listenTcp("127.0.0.2", 0);
    const Ports before{{kCore, localPort(otherInstrument)}};
    m_other->ports = before;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
    });
    EXPECT_EQ(m_other->ports, before);
}

TEST_F(PortAnnouncementTest, SaysHowTheInstrumentIsReachedAllTheSame) {
    m_other->refuses = true;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_NE(announcement.problem().find("4711"), std::string::npos) << announcement.problem();
        EXPECT_NE(announcement.problem().find("--bind 127.0.0.2 "), std::string::npos) << announcement.problem();
    });
}

TEST_F(PortAnnouncementTest, RegistersAgainWithAPortMapperThatHasForgottenEverything) {
    std::unique_ptr<PortAnnouncement> announcement;
    whileOtherRuns([&] {
        announcement =
            std::make_unique<PortAnnouncement>(m_loop, m_mappings, "127.0.0.1", mapperPort(), milliseconds(10));
        EXPECT_EQ(announcement->way(), PortAnnouncement::Way::Registered);
    });
    const Ports everything{{kCore, 4711}, {kAsync, 4712}};
    EXPECT_EQ(m_other->ports, everything);
    m_other->ports.clear();
    PollLoop nextLoop;  // a loop that was stopped runs no more
    RegisteringMapper next(nextLoop, mapperPortOnceFreed());
    {
        const RunningLoop running(nextLoop);
        RpcClient client(next.server.port(), PMAPPROG, PMAPVERS);
        EXPECT_TRUE(isRegisteredSoon(next.server.port()));
        EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP)), word(4711));
        announcement.reset();
    }
    EXPECT_EQ(next.ports, Ports{});
}

TEST_F(PortAnnouncementTest, RegistersWithAPortMapperThatIsStartedLater) {
    const unsigned short port = mapperPortOnceFreed();
    std::unique_ptr<PortAnnouncement> announcement;
    {
        const FileDescriptor taken = bindUdp("127.0.0.1", port);  // so that none of our own can be had
        announcement = std::make_unique<PortAnnouncement>(m_loop, m_mappings, "127.0.0.1", port, milliseconds(10));
    }
    EXPECT_EQ(announcement->way(), PortAnnouncement::Way::None);
    EXPECT_NE(announcement->problem().find("tried again every few seconds"), std::string::npos)
        << announcement->problem();
    PollLoop nextLoop;
    RegisteringMapper next(nextLoop, port);
    {
        const RunningLoop running(nextLoop);
        EXPECT_TRUE(isRegisteredSoon(port));
        announcement.reset();
    }
    EXPECT_EQ(next.ports, Ports{});
}

TEST_F(PortAnnouncementTest, RegistersWhenTheOneThatWasRegisteredHasGone) {
    auto otherInstrument = std::make_unique<FileDescriptor>(listenTcp("127.0.0.1", 0));
    m_other->ports = {{kAsync, localPort(*otherInstrument)}};
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort(), milliseconds(10));
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
        otherInstrument.reset();
        EXPECT_TRUE(isRegisteredSoon(mapperPort()));
    });
    EXPECT_EQ(m_other->ports, Ports{});
}

TEST_F(PortAnnouncementTest, LeavesARegistrationAloneThatIsAnotherOnesByNow) {
    std::unique_ptr<PortAnnouncement> announcement;
    whileOtherRuns(
        [&] { announcement = std::make_unique<PortAnnouncement>(m_loop, m_mappings, "127.0.0.1", mapperPort()); });
    const Ports ofAnother{{kCore, 5711}, {kAsync, 5712}};
    m_other->ports = ofAnother;
    PollLoop nextLoop;
    RegisteringMapper next(nextLoop, mapperPortOnceFreed());
    next.ports = ofAnother;
    {
        const RunningLoop running(nextLoop);
        announcement.reset();
    }
    EXPECT_EQ(next.ports, ofAnother);
}

TEST_F(PortAnnouncementTest, ReplacesWhatACrashedProgramLeftBehind) {
    unsigned short deadPort = 0;
    {
        const FileDescriptor crashed = listenTcp("127.0.0.1", 0);
        deadPort = localPort(crashed);
    }
    m_other->ports = {{kCore, deadPort}};
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::Registered);
        RpcClient client(mapperPort(), PMAPPROG, PMAPVERS);
        EXPECT_EQ(client.results(PMAPPROC_GETPORT, question(kCore, 1, IPPROTO_TCP)), word(4711));
    });
}

TEST_F(PortAnnouncementTest, SaysSoWhenTheRunningOneRefuses) {
    m_other->refuses = true;
    whileOtherRuns([&] {
        const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", mapperPort());
        EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
        EXPECT_NE(announcement.problem(), "");
    });
}

TEST_F(PortAnnouncementTest, AsksTheOneThatRunsAtItsOwnAddressOnly) {
    PollLoop firstLoop;
    const PortMapper first(firstLoop, {{kCore, 1, 5711}, {kAsync, 1, 5712}}, "127.0.0.3", 0);  // it refuses all others
    const RunningLoop running(firstLoop);
    const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.3", first.port());
    EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
    for (const char* words : {"did not take the registration", "--bind 127.0.0.2 ", "4711"})
        EXPECT_NE(announcement.problem().find(words), std::string::npos) << announcement.problem();
}

TEST_F(PortAnnouncementTest, SaysSoWhenNobodyAnswersAndThePortIsTaken) {
    const FileDescriptor taken = bindUdp("127.0.0.1", 0);  // the TCP port of the same number is free
    const PortAnnouncement announcement(m_loop, m_mappings, "127.0.0.1", localPort(taken));
    EXPECT_EQ(announcement.way(), PortAnnouncement::Way::None);
    EXPECT_NE(announcement.problem().find("no port mapper runs"), std::string::npos);
}

}  // namespace
}  // namespace kdx::simserver
