#include "simserver/portannouncement.h"

#include "simserver/socket.h"

#include <system_error>

namespace kdx::simserver {
namespace {

// Another address of this machine at which a port mapper of our own could listen; empty when there is none.
std::string freeLoopbackAddress(unsigned short mapperPort) {
    for (const char* address : {"127.0.0.2", "127.0.0.3", "127.0.0.4", "127.0.0.5"}) {
        try {
            listenTcp(address, mapperPort);
            return address;
        } catch (const std::system_error&) {
            continue;
        }
    }
    return {};
}

std::string problemText(const std::string& place, const std::error_code& reason, bool mapperRuns,
                        unsigned short mapperPort, unsigned short instrumentPort) {
    const std::string byPort = "name its port to the client: " + std::to_string(instrumentPort) +
                               ". Registering with a port mapper is tried again every few seconds.";
    std::string text = "Clients that ask for the port will not find this instrument: ";
    if (mapperRuns) {
        text +=
            "the port mapper that runs on this machine did not take the registration (another instrument may be "
            "registered with it). ";
        const std::string other = freeLoopbackAddress(mapperPort);
        if (!other.empty()) {
            text += "Start this program with --bind " + other + " and open TCPIP::" + other + "::INSTR, ";
        } else {
            text += "End the other program, ";
        }
        return text + "or " + byPort;
    }
    text += "no port mapper runs on this machine, and one of our own cannot listen at " + place + " (" +
            reason.message() + "). ";
    if (reason == std::errc::permission_denied) {
        return text + "Either start this program as root, or allow it once by\n" +
               "    sudo setcap cap_net_bind_service=+ep kdx-sim\n" +
               "or by\n    sudo sysctl net.ipv4.ip_unprivileged_port_start=111\nor " + byPort;
    }
    return text + "End the program that uses this port, or " + byPort;
}

}  // namespace

PortAnnouncement::PortAnnouncement(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& bindAddress,
                                   unsigned short mapperPort, std::chrono::milliseconds lookAfterEvery) {
    std::error_code reason;
    try {
        m_mapper = std::make_unique<PortMapper>(loop, mappings, bindAddress, mapperPort);
        m_way = Way::OwnMapper;
        return;
    } catch (const std::system_error& error) {
        reason = error.code();
    }
    m_registration = std::make_unique<Registration>(mappings, bindAddress, mapperPort, lookAfterEvery);
    if (m_registration->succeeded()) {
        m_way = Way::Registered;
    } else {
        m_problem = problemText(bindAddress + ":" + std::to_string(mapperPort), reason, m_registration->mapperRuns(),
                                mapperPort, mappings.empty() ? 0 : mappings.front().port);
    }
}

}  // namespace kdx::simserver
