#include "link/socket.h"

#include <netdb.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <utility>

namespace kdx {

namespace {

sockaddr_in nameOf(Ipv4Address address, std::uint16_t port) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port);
    name.sin_addr.s_addr = htonl(address);
    return name;
}

Socket::Transfer outcome(ssize_t count, std::size_t& bytes) {
    if (count < 0 && (errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR)) return Socket::Transfer::Later;
    if (count < 0) return Socket::Transfer::Lost;
    bytes = static_cast<std::size_t>(count);
    return Socket::Transfer::Some;
}

int number(std::intptr_t handle) {
    return static_cast<int>(handle);
}

}  // namespace

void Socket::close() {
    if (isOpen()) ::close(number(std::exchange(m_handle, kNone)));
}

Socket Socket::connecting(Ipv4Address address, std::uint16_t port) {
    Socket fresh(::socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, IPPROTO_TCP));
    if (!fresh.isOpen()) return fresh;
    const sockaddr_in peer = nameOf(address, port);
    const int handle = number(fresh.m_handle);
    if (::connect(handle, reinterpret_cast<const sockaddr*>(&peer), sizeof peer) != 0 && errno != EINPROGRESS &&
        errno != EINTR) {
        return {};
    }
    const int on = 1;  // a short question must not wait for the acknowledgement of the command before it
    ::setsockopt(handle, IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
    return fresh;
}

Socket Socket::forDatagrams() {
    Socket fresh(::socket(AF_INET, SOCK_DGRAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
    const int on = 1;
    if (fresh.isOpen() && ::setsockopt(number(fresh.m_handle), SOL_SOCKET, SO_BROADCAST, &on, sizeof on) != 0)
        return {};
    return fresh;
}

bool Socket::waitFor(Ready ready, std::chrono::milliseconds time) const {
    pollfd waiting{number(m_handle), static_cast<short>(ready == Ready::ToRead ? POLLIN : POLLOUT), 0};
    return ::poll(&waiting, 1, static_cast<int>(time.count())) > 0;
}

bool Socket::isConnected() const {
    int failure = 0;
    socklen_t size = sizeof failure;
    return ::getsockopt(number(m_handle), SOL_SOCKET, SO_ERROR, &failure, &size) == 0 && failure == 0;
}

Socket::Transfer Socket::send(std::string_view bytes, std::size_t& sent) {
    return outcome(::send(number(m_handle), bytes.data(), bytes.size(), MSG_NOSIGNAL), sent);
}

Socket::Transfer Socket::receive(std::span<char> room, std::size_t& got) {
    const Transfer transfer = outcome(::recv(number(m_handle), room.data(), room.size(), 0), got);
    return transfer == Transfer::Some && got == 0 ? Transfer::Lost : transfer;
}

bool Socket::sendTo(Ipv4Address address, std::uint16_t port, std::string_view datagram) {
    const sockaddr_in peer = nameOf(address, port);
    return ::sendto(number(m_handle), datagram.data(), datagram.size(), 0, reinterpret_cast<const sockaddr*>(&peer),
                    sizeof peer) >= 0;
}

std::optional<Socket::Datagram> Socket::receiveFrom(std::span<char> room) {
    sockaddr_in sender{};
    socklen_t size = sizeof sender;
    const ssize_t got =
        ::recvfrom(number(m_handle), room.data(), room.size(), 0, reinterpret_cast<sockaddr*>(&sender), &size);
    if (got < 0 || sender.sin_family != AF_INET) return std::nullopt;
    return Datagram{ntohl(sender.sin_addr.s_addr), static_cast<std::size_t>(got)};
}

std::vector<Ipv4Address> hostAddresses(const std::string& host, bool onlyDotted) {
    addrinfo hints{};
    hints.ai_family = AF_INET;  // VXI-11 knows no other
    hints.ai_socktype = SOCK_STREAM;
    hints.ai_flags = onlyDotted ? AI_NUMERICHOST : 0;
    addrinfo* first = nullptr;
    if (::getaddrinfo(host.c_str(), nullptr, &hints, &first) != 0) return {};
    const std::unique_ptr<addrinfo, decltype(&freeaddrinfo)> list(first, &::freeaddrinfo);
    std::vector<Ipv4Address> addresses;
    for (const addrinfo* entry = first; entry != nullptr; entry = entry->ai_next) {
        sockaddr_in name{};
        std::memcpy(&name, entry->ai_addr, sizeof name);
        addresses.push_back(ntohl(name.sin_addr.s_addr));
    }
    return addresses;
}

}  // namespace kdx
