#include "link/discovery.h"

#include "base/filedescriptor.h"
#include "link/deadline.h"
#include "link/rpcmessage.h"
#include "vxi11.h"
#include "vxi11/ipv4networks.h"
#include "vxi11/xdr.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <rpc/pmap_prot.h>
#include <sys/socket.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <memory>
#include <random>
#include <set>

namespace kdx {

namespace {

using std::chrono::steady_clock;

/// Where everybody in this machine's networks hears a question; and the machine itself, whose port mapper need not
/// hear what is asked of everybody on the loopback interface.
std::set<std::uint32_t> placesToAsk() {
    std::set<std::uint32_t> places{INADDR_LOOPBACK};
    for (const vxi11::Ipv4Network& network : vxi11::ipv4Networks()) {
        if (const auto broadcast = network.broadcast()) places.insert(*broadcast);
    }
    return places;
}

/// Whether the datagram answers our question with a port: whoever serves no instrument says 0.
bool isInstrument(std::string message, std::uint32_t question) {
    if (message.size() < 4 || xdrWord(message) != question) return false;
    std::uint32_t port = 0;
    const RpcOutcome outcome = readRpcReply(message, [&](XDR* xdr) { return xdr_uint32_t(xdr, &port) != 0; });
    return outcome == RpcOutcome::Done && port > 0 && port <= 0xFFFF;
}

/// Takes the answers that come until then.
void gather(int socket, std::uint32_t question, Deadline deadline, const Discovery& how,
            std::set<std::uint32_t>& found) {
    constexpr std::size_t kMost = 1000;  // no network has so many: somebody makes answers up
    constexpr std::chrono::milliseconds kLookEvery{100};
    std::array<char, 1024> datagram;
    while (!how.stopped() && found.size() < kMost) {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - steady_clock::now());
        if (left.count() <= 0) return;
        pollfd waiting{socket, POLLIN, 0};
        if (poll(&waiting, 1, static_cast<int>(std::min(left, kLookEvery).count())) <= 0) continue;
        sockaddr_in sender{};
        socklen_t size = sizeof sender;
        const ssize_t got =
            recvfrom(socket, datagram.data(), datagram.size(), 0, reinterpret_cast<sockaddr*>(&sender), &size);
        if (got < 0 || sender.sin_family != AF_INET) continue;
        if (isInstrument({datagram.data(), static_cast<std::size_t>(got)}, question))
            found.insert(ntohl(sender.sin_addr.s_addr));
    }
}

void ask(int socket, const std::string& call, const Discovery& how) {
    for (const std::uint32_t place : placesToAsk()) {
        sockaddr_in peer{};
        peer.sin_family = AF_INET;
        peer.sin_port = htons(how.portMapperPort);
        peer.sin_addr.s_addr = htonl(place);
        // A network that cannot be asked now is left out; the others may answer.
        sendto(socket, call.data(), call.size(), 0, reinterpret_cast<const sockaddr*>(&peer), sizeof peer);
    }
}

}  // namespace

std::vector<std::string> discoverLanInstruments(const Discovery& how) {
    const FileDescriptor socket(::socket(AF_INET, SOCK_DGRAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
    const int on = 1;
    if (!socket.isOpen() || setsockopt(socket.number(), SOL_SOCKET, SO_BROADCAST, &on, sizeof on) != 0) return {};
    const std::uint32_t question = std::random_device()();
    pmap wanted{DEVICE_CORE, DEVICE_CORE_VERSION, IPPROTO_TCP, 0};
    const auto call = rpcCall({question, PMAPPROG, PMAPVERS, PMAPPROC_GETPORT}, 0,
                              [&](XDR* xdr) { return xdr_pmap(xdr, &wanted) != 0; });
    if (!call) return {};
    std::set<std::uint32_t> found;
    const Deadline begin = steady_clock::now();
    // Twice: a datagram may get lost.
    ask(socket.number(), *call, how);
    gather(socket.number(), question, begin + how.wait / 3, how, found);
    ask(socket.number(), *call, how);
    gather(socket.number(), question, begin + how.wait, how, found);
    std::vector<std::string> addresses;
    addresses.reserve(found.size());
    for (const std::uint32_t address : found) addresses.push_back(vxi11::dotted(address));
    return addresses;
}

Identification identify(Visa& visa, const std::string& resource) {
    Identification result;
    VisaHandle manager = 0, session = 0;
    result.status = visa.viOpenDefaultRM(manager);
    if (result.status < 0) return result;
    result.status = visa.viOpen(manager, resource, 0, 0, session);
    if (result.status >= 0) {
        constexpr std::string_view kQuestion = "*IDN?";
        std::array<char, 512> answer;
        std::int32_t count = 0;
        result.status = visa.viWrite(session, kQuestion, count);
        if (result.status >= 0) result.status = visa.viRead(session, answer, count);
        if (result.status >= 0) result.text.assign(answer.data(), static_cast<std::size_t>(count));
        result.text.erase(result.text.find_last_not_of(" \r\n") + 1);
        visa.viClose(session);
    }
    visa.viClose(manager);
    return result;
}

}  // namespace kdx
