#pragma once

#include <cstdint>
#include <vector>

namespace kdx::test {

/// Listens on a port of the loopback address. The caller closes the socket.
/// @param backlog how many connections may wait. @param wantedPort 0 for any that is free. @param port which it is.
int listenOnLoopback(int backlog, std::uint16_t wantedPort, std::uint16_t& port);

/// A loopback port where nobody listens.
std::uint16_t closedPort();

/// A loopback port that never takes a connection: its queue of waiting connections is full.
class DeafPort {
public:
    DeafPort();
    ~DeafPort();
    DeafPort(const DeafPort&) = delete;
    DeafPort& operator=(const DeafPort&) = delete;
    [[nodiscard]] std::uint16_t port() const { return m_port; }

private:
    int m_listener = -1;
    std::vector<int> m_waiting;
    std::uint16_t m_port = 0;
};

}  // namespace kdx::test
