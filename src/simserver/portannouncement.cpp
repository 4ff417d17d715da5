#include "simserver/portannouncement.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <rpc/pmap_prot.h>
#include <rpc/rpc.h>
#include <sys/socket.h>

#include <system_error>
#include <utility>

namespace kdx::simserver {
namespace {

constexpr timeval kAnswerTimeout{2, 0};

sockaddr_in onThisMachine(unsigned short port) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port);
    name.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    return name;
}

bool anybodyListens(unsigned short port) {
    const FileDescriptor socket(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0));
    const sockaddr_in name = onThisMachine(port);
    return ::connect(socket.number(), reinterpret_cast<const sockaddr*>(&name), sizeof name) == 0;
}

/// Talks to the port mapper that runs on this machine, by the loopback address: from there they let others register.
class RunningMapper {
public:
    explicit RunningMapper(unsigned short port) {
        sockaddr_in name = onThisMachine(port);
        int socket = RPC_ANYSOCK;
        m_client = clnttcp_create(&name, PMAPPROG, PMAPVERS, &socket, 0, 0);
    }
    RunningMapper(const RunningMapper&) = delete;
    RunningMapper& operator=(const RunningMapper&) = delete;
    ~RunningMapper() {
        if (m_client != nullptr) clnt_destroy(m_client);
    }

    [[nodiscard]] bool runs() const { return m_client != nullptr; }

    bool add(const PortMapping& mapping) {
        if (ask(PMAPPROC_SET, mapping) == TRUE) return true;
        // Somebody is registered already. If he crashed and left that behind, nobody listens there any more.
        const u_long holder = ask(PMAPPROC_GETPORT, mapping);
        if (holder == 0 || anybodyListens(static_cast<unsigned short>(holder))) return false;
        remove(mapping);
        return ask(PMAPPROC_SET, mapping) == TRUE;
    }

    void remove(const PortMapping& mapping) { ask(PMAPPROC_UNSET, mapping); }

private:
    // The answer, which is a number or a truth value; 0 when none came.
    u_long ask(rpcproc_t procedure, const PortMapping& mapping) {
        pmap question{mapping.program, mapping.version, IPPROTO_TCP, mapping.port};
        u_long answer = 0;
        const bool answered =
            clnt_call(m_client, procedure, routine(xdr_pmap), reinterpret_cast<caddr_t>(&question), routine(xdr_u_long),
                      reinterpret_cast<caddr_t>(&answer), kAnswerTimeout) == RPC_SUCCESS;
        return answered ? answer : 0;
    }

    template <class Value>
    static xdrproc_t routine(bool_t (*typed)(XDR*, Value*)) {
        return reinterpret_cast<xdrproc_t>(reinterpret_cast<void (*)()>(typed));
    }

    CLIENT* m_client = nullptr;
};

std::string problemText(const std::string& place, const std::error_code& reason, bool mapperRuns) {
    std::string text = "Clients that ask for the port will not find the instrument: ";
    if (mapperRuns) {
        return text + "the port mapper that runs on this machine did not take the registration (another instrument " +
               "may be registered with it). End the other program, or name the port to the client.";
    }
    text += "no port mapper runs on this machine, and one of our own cannot listen at " + place + " (" +
            reason.message() + "). ";
    if (reason == std::errc::permission_denied) {
        return text + "Either start this program as root, or allow it once by\n" +
               "    sudo setcap cap_net_bind_service=+ep kdx-sim\n" +
               "or by\n    sudo sysctl net.ipv4.ip_unprivileged_port_start=111";
    }
    return text + "End the program that uses this port, or name the instrument's port to the client.";
}

}  // namespace

PortAnnouncement::PortAnnouncement(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& bindAddress,
                                   unsigned short mapperPort)
    : m_mappings(std::move(mappings)), m_mapperPort(mapperPort) {
    std::error_code reason;
    try {
        m_mapper = std::make_unique<PortMapper>(loop, m_mappings, bindAddress, mapperPort);
        m_way = Way::OwnMapper;
        return;
    } catch (const std::system_error& error) {
        reason = error.code();
    }
    RunningMapper running(mapperPort);
    bool added = running.runs();
    for (std::size_t i = 0; added && i < m_mappings.size(); ++i) {
        added = running.add(m_mappings[i]);
        if (added) continue;
        for (std::size_t taken = 0; taken < i; ++taken) running.remove(m_mappings[taken]);
    }
    if (added) {
        m_way = Way::Registered;
    } else {
        m_problem = problemText(bindAddress + ":" + std::to_string(mapperPort), reason, running.runs());
    }
}

PortAnnouncement::~PortAnnouncement() {
    if (m_way != Way::Registered) return;
    RunningMapper running(m_mapperPort);
    if (!running.runs()) return;
    for (const PortMapping& mapping : m_mappings) running.remove(mapping);
}

}  // namespace kdx::simserver
