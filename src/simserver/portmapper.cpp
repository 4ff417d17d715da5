#include "simserver/portmapper.h"

#include "vxi11/xdr.h"

#include <netinet/in.h>
#include <poll.h>
#include <rpc/pmap_prot.h>
#include <sys/socket.h>

#include <array>
#include <utility>

namespace kdx::simserver {
namespace {

constexpr ConnectionId kNoConnection = 0;

}  // namespace

PortMapper::PortMapper(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& address,
                       unsigned short port)
    : RpcProgram(PMAPPROG, PMAPVERS),
      m_loop(loop),
      m_mappings(std::move(mappings)),
      m_tcp(loop, *this, address, port),
      m_udp(bindUdp(address, m_tcp.port())) {
    m_loop.watch(m_udp.number(), POLLIN, [this](short) { answerDatagram(); });
}

PortMapper::~PortMapper() {
    m_loop.forget(m_udp.number());
}

void PortMapper::call(std::uint32_t procedure, std::string_view arguments, ConnectionId, const RpcReply& reply) {
    if (procedure == PMAPPROC_DUMP) return reply({dump()});
    if (procedure != PMAPPROC_GETPORT && procedure != PMAPPROC_SET && procedure != PMAPPROC_UNSET) {
        return reply({{}, PROC_UNAVAIL});
    }
    const XdrDecoded<pmap> asked(arguments, xdr_pmap);
    if (!asked) return reply({{}, GARBAGE_ARGS});
    if (procedure != PMAPPROC_GETPORT) return reply({toXdr<bool_t>(FALSE, xdr_bool)});
    reply({toXdr<u_long>(findPort(asked->pm_prog, asked->pm_prot), xdr_u_long)});
}

void PortMapper::answerDatagram() {
    std::array<char, 8192> bytes;
    sockaddr_in client{};
    socklen_t length = sizeof client;
    auto* name = reinterpret_cast<sockaddr*>(&client);
    const ssize_t count = ::recvfrom(m_udp.number(), bytes.data(), bytes.size(), 0, name, &length);
    if (count < 0) return;
    handle({bytes.data(), static_cast<std::size_t>(count)}, kNoConnection,
           [&](const std::string& answer) { ::sendto(m_udp.number(), answer.data(), answer.size(), 0, name, length); });
}

// The version is not compared: whoever asks for another one learns from the program itself which it has.
unsigned long PortMapper::findPort(unsigned long program, unsigned long protocol) const {
    if (program == PMAPPROG && (protocol == IPPROTO_TCP || protocol == IPPROTO_UDP)) return port();
    if (protocol != IPPROTO_TCP) return 0;
    for (const PortMapping& mapping : m_mappings) {
        if (mapping.program == program) return mapping.port;
    }
    return 0;
}

std::string PortMapper::dump() const {
    std::vector<pmap> entries{{PMAPPROG, PMAPVERS, IPPROTO_TCP, port()}, {PMAPPROG, PMAPVERS, IPPROTO_UDP, port()}};
    for (const PortMapping& mapping : m_mappings) {
        entries.push_back({mapping.program, mapping.version, IPPROTO_TCP, mapping.port});
    }
    std::string list;
    for (const pmap& entry : entries) list += toXdr<bool_t>(TRUE, xdr_bool) + toXdr<pmap>(entry, xdr_pmap);
    return list + toXdr<bool_t>(FALSE, xdr_bool);
}

}  // namespace kdx::simserver
