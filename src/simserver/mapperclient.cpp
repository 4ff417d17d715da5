#include "simserver/mapperclient.h"

#include "simserver/tirpcxdr.h"
#include "vxi11/messages.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <rpc/pmap_prot.h>

namespace kdx::simserver {

MapperClient::MapperClient(const std::string& otherAddress, unsigned short mapperPort, Deadline deadline)
    : m_channel(PMAPPROG, PMAPVERS), m_deadline(deadline) {
    in_addr other{};
    m_connected = m_channel.connect(kLoopbackAddress, mapperPort, deadline) ||
                  (::inet_pton(AF_INET, otherAddress.c_str(), &other) == 1 &&
                   m_channel.connect(ntohl(other.s_addr), mapperPort, deadline));
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
    const pmap question{mapping.program, mapping.version, IPPROTO_TCP, mapping.port};
    std::optional<std::uint32_t> answer;
    const auto read = [&](std::string_view results) { return (answer = vxi11::portResult(results)).has_value(); };
    const RpcOutcome outcome = m_channel.call(procedure, toXdr(question, xdr_pmap), read, m_deadline);
    if (outcome != RpcOutcome::Done) return std::nullopt;
    return answer;
}

}  // namespace kdx::simserver
