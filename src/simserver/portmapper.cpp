#include "simserver/portmapper.h"

#include "simserver/localnetwork.h"
#include "simserver/tirpcxdr.h"

#include <netinet/in.h>
#include <poll.h>
#include <rpc/pmap_prot.h>
#include <sys/socket.h>

#include <array>
#include <cstring>
#include <system_error>
#include <utility>

namespace kdx::simserver {
namespace {

constexpr ConnectionId kNoConnection = 0;
constexpr unsigned kAnyInterface = 0;

// The number of the interface that the datagram came by; 0 when the system has not said it.
unsigned interfaceOf(msghdr& datagram) {
    for (cmsghdr* part = CMSG_FIRSTHDR(&datagram); part != nullptr; part = CMSG_NXTHDR(&datagram, part)) {
        if (part->cmsg_level != IPPROTO_IP || part->cmsg_type != IP_PKTINFO) continue;
        in_pktinfo info{};
        std::memcpy(&info, CMSG_DATA(part), sizeof info);
        return static_cast<unsigned>(info.ipi_ifindex);
    }
    return 0;
}

// A number that is free for one protocol may be taken for the other, so where any will do others are tried.
std::pair<FileDescriptor, FileDescriptor> listenOnBoth(const std::string& address, unsigned short port) {
    constexpr int kMostTries = 100;
    for (int tries = 1;; ++tries) {
        FileDescriptor tcp = listenTcp(address, port);
        try {
            FileDescriptor udp = bindUdp(address, localPort(tcp));
            return {std::move(tcp), std::move(udp)};
        } catch (const std::system_error&) {
            if (port != 0 || tries == kMostTries) throw;
        }
    }
}

}  // namespace

PortMapper::PortMapper(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& address,
                       unsigned short port)
    : PortMapper(loop, std::move(mappings), address, listenOnBoth(address, port)) {}

PortMapper::PortMapper(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& address,
                       std::pair<FileDescriptor, FileDescriptor> sockets)
    : RpcProgram(PMAPPROG, PMAPVERS),
      m_loop(loop),
      m_mappings(std::move(mappings)),
      m_tcp(loop, *this, std::move(sockets.first)),
      m_udp(std::move(sockets.second)) {
    m_loop.watch(m_udp.number(), POLLIN, [this](short) { answerDatagram(m_udp.number(), kAnyInterface); });
    listenForBroadcasts(address);
}

PortMapper::~PortMapper() {
    m_loop.forget(m_udp.number());
    for (const FileDescriptor& socket : m_broadcasts) m_loop.forget(socket.number());
}

// A socket at one address gets nothing that is sent to a broadcast address, by which clients look for instruments.
// Where such a socket cannot be had the instrument is found by its address only.
void PortMapper::listenForBroadcasts(const std::string& address) {
    const auto network = networkOf(address);
    if (!network) return;  // at all addresses at once the broadcasts come with the rest
    const std::array places = {std::pair{network->broadcastAddress, kAnyInterface},
                               std::pair{std::string("255.255.255.255"), network->interfaceIndex}};
    for (const auto& [place, onlyInterface] : places) {
        try {
            FileDescriptor socket = bindUdpBroadcast(place, port());
            const int number = socket.number();
            const int on = 1;
            if (::setsockopt(number, IPPROTO_IP, IP_PKTINFO, &on, sizeof on) != 0) continue;
            m_loop.watch(number, POLLIN, [this, number, only = onlyInterface](short) { answerDatagram(number, only); });
            m_broadcasts.push_back(std::move(socket));
        } catch (const std::system_error&) {
            continue;
        }
    }
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

// Answers come from the address that the instrument has, whatever address was asked.
void PortMapper::answerDatagram(int socket, unsigned onlyInterface) {
    std::array<char, 8192> bytes;
    sockaddr_in client{};
    iovec place{bytes.data(), bytes.size()};
    alignas(cmsghdr) std::array<char, CMSG_SPACE(sizeof(in_pktinfo))> extra{};
    msghdr datagram{};
    datagram.msg_name = &client;
    datagram.msg_namelen = sizeof client;
    datagram.msg_iov = &place;
    datagram.msg_iovlen = 1;
    datagram.msg_control = extra.data();
    datagram.msg_controllen = extra.size();
    const ssize_t count = ::recvmsg(socket, &datagram, 0);
    if (count < 0 || (onlyInterface != kAnyInterface && interfaceOf(datagram) != onlyInterface)) return;
    handle({bytes.data(), static_cast<std::size_t>(count)}, kNoConnection, [&](const std::string& answer) {
        ::sendto(m_udp.number(), answer.data(), answer.size(), 0, reinterpret_cast<const sockaddr*>(&client),
                 sizeof client);
    });
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
