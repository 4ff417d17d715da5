#include "link/socket.h"

#include <winsock2.h>

#include <ws2tcpip.h>

#include <algorithm>
#include <climits>
#include <cstring>
#include <memory>
#include <utility>

namespace kdx {

namespace {

/// The network has to be asked for once a program.
void startNetwork() {
    static const int started = [] {
        WSADATA ignored;
        return WSAStartup(MAKEWORD(2, 2), &ignored);
    }();
    (void)started;  // where it failed, no socket opens
}

sockaddr_in nameOf(Ipv4Address address, std::uint16_t port) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port);
    name.sin_addr.s_addr = htonl(address);
    return name;
}

SOCKET number(std::intptr_t handle) {
    return static_cast<SOCKET>(handle);
}

int length(std::size_t bytes) {
    return static_cast<int>(std::min<std::size_t>(bytes, INT_MAX));
}

Socket::Transfer outcome(int count, std::size_t& bytes) {
    if (count == SOCKET_ERROR)
        return WSAGetLastError() == WSAEWOULDBLOCK ? Socket::Transfer::Later : Socket::Transfer::Lost;
    bytes = static_cast<std::size_t>(count);
    return Socket::Transfer::Some;
}

/// A socket that never blocks and that no program started from here gets; none when that cannot be had.
std::intptr_t freshSocket(int type, int protocol) {
    startNetwork();
    const SOCKET fresh =
        WSASocketW(AF_INET, type, protocol, nullptr, 0, WSA_FLAG_OVERLAPPED | WSA_FLAG_NO_HANDLE_INHERIT);
    u_long on = 1;
    if (fresh != INVALID_SOCKET && ioctlsocket(fresh, FIONBIO, &on) != 0) {
        closesocket(fresh);
        return -1;
    }
    return fresh == INVALID_SOCKET ? -1 : static_cast<std::intptr_t>(fresh);
}

}  // namespace

void Socket::close() {
    if (isOpen()) closesocket(number(std::exchange(m_handle, kNone)));
}

Socket Socket::connecting(Ipv4Address address, std::uint16_t port) {
    Socket fresh(freshSocket(SOCK_STREAM, IPPROTO_TCP));
    if (!fresh.isOpen()) return fresh;
    const sockaddr_in peer = nameOf(address, port);
    const SOCKET handle = number(fresh.m_handle);
    if (::connect(handle, reinterpret_cast<const sockaddr*>(&peer), sizeof peer) != 0 &&
        WSAGetLastError() != WSAEWOULDBLOCK) {
        return {};
    }
    const BOOL on = TRUE;  // a short question must not wait for the acknowledgement of the command before it
    setsockopt(handle, IPPROTO_TCP, TCP_NODELAY, reinterpret_cast<const char*>(&on), sizeof on);
    return fresh;
}

Socket Socket::forDatagrams() {
    Socket fresh(freshSocket(SOCK_DGRAM, IPPROTO_UDP));
    const BOOL on = TRUE;
    if (fresh.isOpen() && setsockopt(number(fresh.m_handle), SOL_SOCKET, SO_BROADCAST,
                                     reinterpret_cast<const char*>(&on), sizeof on) != 0) {
        return {};
    }
    return fresh;
}

bool Socket::waitFor(Ready ready, std::chrono::milliseconds time) const {
    // Not WSAPoll: for years it kept silent about connections that were refused. Here they count as failed ones.
    fd_set wanted, failed;
    FD_ZERO(&wanted);
    FD_ZERO(&failed);
    FD_SET(number(m_handle), &wanted);
    FD_SET(number(m_handle), &failed);
    const auto whole = std::chrono::duration_cast<std::chrono::seconds>(time);
    const auto rest = std::chrono::duration_cast<std::chrono::microseconds>(time - whole);
    timeval most{static_cast<long>(whole.count()), static_cast<long>(rest.count())};
    return select(0, ready == Ready::ToRead ? &wanted : nullptr, ready == Ready::ToWrite ? &wanted : nullptr, &failed,
                  &most) > 0;
}

bool Socket::isConnected() const {
    // The error may be fetched but once, and by whom the system does not say: a peer with a name is one that answered.
    sockaddr_in peer{};
    int size = sizeof peer;
    return getpeername(number(m_handle), reinterpret_cast<sockaddr*>(&peer), &size) == 0;
}

Socket::Transfer Socket::send(std::string_view bytes, std::size_t& sent) {
    return outcome(::send(number(m_handle), bytes.data(), length(bytes.size()), 0), sent);
}

Socket::Transfer Socket::receive(std::span<char> room, std::size_t& got) {
    const Transfer transfer = outcome(::recv(number(m_handle), room.data(), length(room.size()), 0), got);
    return transfer == Transfer::Some && got == 0 ? Transfer::Lost : transfer;
}

bool Socket::sendTo(Ipv4Address address, std::uint16_t port, std::string_view datagram) {
    const sockaddr_in peer = nameOf(address, port);
    return ::sendto(number(m_handle), datagram.data(), length(datagram.size()), 0,
                    reinterpret_cast<const sockaddr*>(&peer), sizeof peer) != SOCKET_ERROR;
}

std::optional<Socket::Datagram> Socket::receiveFrom(std::span<char> room) {
    sockaddr_in sender{};
    int size = sizeof sender;
    const int got =
        ::recvfrom(number(m_handle), room.data(), length(room.size()), 0, reinterpret_cast<sockaddr*>(&sender), &size);
    if (got == SOCKET_ERROR || sender.sin_family != AF_INET) return std::nullopt;
    return Datagram{ntohl(sender.sin_addr.s_addr), static_cast<std::size_t>(got)};
}

std::vector<Ipv4Address> hostAddresses(const std::string& host, bool onlyDotted) {
    startNetwork();
    addrinfo hints{};
    hints.ai_family = AF_INET;  // VXI-11 knows no other
    hints.ai_socktype = SOCK_STREAM;
    hints.ai_flags = onlyDotted ? AI_NUMERICHOST : 0;
    addrinfo* first = nullptr;
    if (getaddrinfo(host.c_str(), nullptr, &hints, &first) != 0) return {};
    const std::unique_ptr<addrinfo, decltype(&freeaddrinfo)> list(first, &freeaddrinfo);
    std::vector<Ipv4Address> addresses;
    for (const addrinfo* entry = first; entry != nullptr; entry = entry->ai_next) {
        sockaddr_in name{};
        std::memcpy(&name, entry->ai_addr, sizeof name);
        addresses.push_back(ntohl(name.sin_addr.s_addr));
    }
    return addresses;
}

}  // namespace kdx
