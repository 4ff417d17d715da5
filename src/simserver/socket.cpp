#include "simserver/socket.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include <cerrno>
#include <system_error>

namespace kdx::simserver {
namespace {

[[noreturn]] void fail(const std::string& what) {
    throw std::system_error(errno, std::generic_category(), what);
}

FileDescriptor bound(int type, const std::string& address, unsigned short port, bool reuse) {
    const std::string place = address + ":" + std::to_string(port);
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port);
    if (inet_pton(AF_INET, address.c_str(), &name.sin_addr) != 1) {
        errno = EINVAL;
        fail(address);
    }
    FileDescriptor result(::socket(AF_INET, type | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
    if (!result.isOpen()) fail(place);
    const int on = 1;
    if (reuse && setsockopt(result.number(), SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) != 0) fail(place);
    if (::bind(result.number(), reinterpret_cast<const sockaddr*>(&name), sizeof name) != 0) fail(place);
    return result;
}

}  // namespace

FileDescriptor listenTcp(const std::string& address, unsigned short port) {
    // With TCP, reuse lets a restart take the port over from dying connections; with UDP two programs would share it.
    FileDescriptor result = bound(SOCK_STREAM, address, port, true);
    if (::listen(result.number(), SOMAXCONN) != 0) fail(address + ":" + std::to_string(port));
    return result;
}

FileDescriptor bindUdp(const std::string& address, unsigned short port) {
    return bound(SOCK_DGRAM, address, port, false);
}

FileDescriptor bindUdpBroadcast(const std::string& address, unsigned short port) {
    return bound(SOCK_DGRAM, address, port, true);
}

unsigned short localPort(const FileDescriptor& socket) {
    sockaddr_in name{};
    socklen_t length = sizeof name;
    if (::getsockname(socket.number(), reinterpret_cast<sockaddr*>(&name), &length) != 0) fail("getsockname");
    return ntohs(name.sin_port);
}

}  // namespace kdx::simserver
