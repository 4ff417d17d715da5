#include "simserver/mapperclient.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <rpc/pmap_prot.h>
#include <rpc/rpc.h>

namespace kdx::simserver {

MapperClient::MapperClient(const std::string& otherAddress, unsigned short mapperPort, Deadline deadline)
    : m_channel(PMAPPROG, PMAPVERS), m_deadline(deadline) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    m_connected = m_channel.connect(address, mapperPort, deadline) ||
                  (::inet_pton(AF_INET, otherAddress.c_str(), &address.sin_addr) == 1 &&
                   m_channel.connect(address, mapperPort, deadline));
}

std::optional<std::uint32_t> MapperClient::portOf(const PortMapping& mapping) {
    return ask(PMAPPROC_GETPORT, mapping);
}

bool MapperClient::add(const PortMapping& mapping) {
    return ask(PMAPPROC_SET, mapping) == 1U;
}

void MapperClient::remove(const PortMapping& mapping) {
    ask(PMAPPROC_UNSET, mapping);
}

// The answer of all three procedures is a word: a port or a truth value.
std::optional<std::uint32_t> MapperClient::ask(std::uint32_t procedure, const PortMapping& mapping) {
    pmap question{mapping.program, mapping.version, IPPROTO_TCP, mapping.port};
    std::uint32_t answer = 0;
    const RpcOutcome outcome = m_channel.call(
        procedure, 0, [&](XDR* xdr) { return xdr_pmap(xdr, &question); },
        [&](XDR* xdr) { return xdr_uint32_t(xdr, &answer); }, m_deadline);
    if (outcome != RpcOutcome::Done) return std::nullopt;
    return answer;
}

}  // namespace kdx::simserver
