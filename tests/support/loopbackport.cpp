#include "support/loopbackport.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <stdexcept>

namespace kdx::test {

namespace {

sockaddr_in loopbackAddress(std::uint16_t port) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    address.sin_port = htons(port);
    return address;
}

}  // namespace

int listenOnLoopback(int backlog, std::uint16_t wantedPort, std::uint16_t& port) {
    const int listener = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_in address = loopbackAddress(wantedPort);
    const int on = 1;
    setsockopt(listener, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on);
    socklen_t size = sizeof address;
    if (bind(listener, reinterpret_cast<sockaddr*>(&address), size) != 0 || listen(listener, backlog) != 0 ||
        getsockname(listener, reinterpret_cast<sockaddr*>(&address), &size) != 0) {
        close(listener);
        throw std::runtime_error("no loopback port to listen on");
    }
    port = ntohs(address.sin_port);
    return listener;
}

std::uint16_t closedPort() {
    std::uint16_t port = 0;
    close(listenOnLoopback(1, 0, port));
    return port;
}

DeafPort::DeafPort() {
    m_listener = listenOnLoopback(0, 0, m_port);
    const sockaddr_in address = loopbackAddress(m_port);
    // Fill the queue until a connection has to wait.
    for (;;) {
        m_waiting.push_back(socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
        if (connect(m_waiting.back(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0) continue;
        pollfd waiting{m_waiting.back(), POLLOUT, 0};
        if (poll(&waiting, 1, 20) == 0) return;
    }
}

DeafPort::~DeafPort() {
    for (const int descriptor : m_waiting) close(descriptor);
    close(m_listener);
}

}  // namespace kdx::test
