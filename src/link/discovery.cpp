#include "link/discovery.h"

#include "link/deadline.h"
#include "link/rpcmessage.h"
#include "link/socket.h"
#include "vxi11/ipv4networks.h"
#include "vxi11/messages.h"
#include "vxi11/xdr.h"

#include <algorithm>
#include <array>
#include <random>
#include <set>

namespace kdx {

namespace {

using std::chrono::steady_clock;

/// Where everybody in this machine's networks hears a question; and the machine itself, whose port mapper need not
/// hear what is asked of everybody on the loopback interface.
std::set<Ipv4Address> placesToAsk() {
    std::set<Ipv4Address> places{kLoopbackAddress};
    for (const vxi11::Ipv4Network& network : vxi11::ipv4Networks()) {
        if (const auto broadcast = network.broadcast()) places.insert(*broadcast);
    }
    return places;
}

/// Whether the datagram answers our question with a port: whoever serves no instrument says 0.
bool isInstrument(std::string_view message, std::uint32_t question) {
    if (message.size() < 4 || xdrWord(message) != question) return false;
    std::uint32_t port = 0;
    const RpcOutcome outcome = readRpcReply(message, [&](std::string_view results) {
        port = vxi11::portResult(results).value_or(0);
        return true;
    });
    return outcome == RpcOutcome::Done && port > 0 && port <= 0xFFFF;
}

/// Takes the answers that come until then.
void gather(Socket& socket, std::uint32_t question, Deadline deadline, const Discovery& how,
            std::set<Ipv4Address>& found) {
    constexpr std::size_t kMost = 1000;  // no network has so many: somebody makes answers up
    constexpr std::chrono::milliseconds kLookEvery{100};
    std::array<char, 1024> room;
    while (!how.stopped() && found.size() < kMost) {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - steady_clock::now());
        if (left.count() <= 0) return;
        if (!socket.waitFor(Socket::Ready::ToRead, std::min(left, kLookEvery))) continue;
        const auto datagram = socket.receiveFrom(room);
        if (datagram && isInstrument({room.data(), datagram->size}, question)) found.insert(datagram->sender);
    }
}

void ask(Socket& socket, const std::string& call, const Discovery& how) {
    // A network that cannot be asked now is left out; the others may answer.
    for (const Ipv4Address place : placesToAsk()) socket.sendTo(place, how.portMapperPort, call);
}

}  // namespace

std::vector<std::string> discoverLanInstruments(const Discovery& how) {
    Socket socket = Socket::forDatagrams();
    if (!socket.isOpen()) return {};
    const std::uint32_t question = std::random_device()();
    const std::string call =
        rpcCall({question, vxi11::kPortMapper, vxi11::kPortMapperVersion, vxi11::kGetPort}, vxi11::getPortArguments());
    std::set<Ipv4Address> found;
    const Deadline begin = steady_clock::now();
    // Twice: a datagram may get lost.
    ask(socket, call, how);
    gather(socket, question, begin + how.wait / 3, how, found);
    ask(socket, call, how);
    gather(socket, question, begin + how.wait, how, found);
    std::vector<std::string> addresses;
    addresses.reserve(found.size());
    for (const Ipv4Address address : found) addresses.push_back(vxi11::dotted(address));
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
