#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace kdx {

/// What the LAN client needs of the operating system's network; what differs is in socket_posix.cpp and
/// socket_windows.cpp.

/// An IPv4 address as a number in the machine's byte order: 127.0.0.1 is 0x7F000001.
using Ipv4Address = std::uint32_t;
inline constexpr Ipv4Address kLoopbackAddress = 0x7F000001;

/// A socket that never blocks, closed when this goes.
class Socket {
public:
    enum class Ready { ToRead, ToWrite };
    enum class Transfer { Some, Later, Lost };

    Socket() = default;
    Socket(Socket&& other) noexcept;
    Socket& operator=(Socket&& other) noexcept;
    ~Socket() { close(); }

    /// One that asks for a connection to that place; it is there when the socket is ready to be written to and
    /// isConnected(). Not open when it is refused at once. Short messages are sent without delay.
    static Socket connecting(Ipv4Address address, std::uint16_t port);
    /// One for datagrams, also to everybody in a network.
    static Socket forDatagrams();

    [[nodiscard]] bool isOpen() const { return m_handle != kNone; }
    void close();

    /// Waits until that is possible, or has failed; false when the time is over before.
    [[nodiscard]] bool waitFor(Ready ready, std::chrono::milliseconds time) const;
    [[nodiscard]] bool isConnected() const;

    /// Sends what finds room. @param sent so many bytes, when Some
    Transfer send(std::string_view bytes, std::size_t& sent);
    /// Takes what has come. @param got so many bytes, when Some; Lost also when the peer has hung up
    Transfer receive(std::span<char> room, std::size_t& got);

    /// Whether the datagram went out.
    bool sendTo(Ipv4Address address, std::uint16_t port, std::string_view datagram);
    struct Datagram {
        Ipv4Address sender = 0;
        std::size_t size = 0;  ///< so many bytes of the room
    };
    /// One that has come, if any.
    std::optional<Datagram> receiveFrom(std::span<char> room);

private:
    static constexpr std::intptr_t kNone = -1;
    explicit Socket(std::intptr_t handle) : m_handle(handle) {}

    std::intptr_t m_handle = kNone;  ///< the system's own
};

/// The IPv4 addresses of a host, as the system's name service knows them, which may take its time; of a dotted address
/// that one. @param onlyDotted nobody is asked
[[nodiscard]] std::vector<Ipv4Address> hostAddresses(const std::string& host, bool onlyDotted);

}  // namespace kdx
