#include "simserver/rpcclient.h"

#include "vxi11/rpcrecord.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>

namespace kdx::simserver {
namespace {

std::uint32_t wordAt(std::string_view bytes, std::size_t n) {
    if (bytes.size() < 4 * (n + 1)) {
        ADD_FAILURE() << "too short for word " << n;
        return 0;
    }
    return xdrWord(bytes, 4 * n);
}

bool readable(int socket, int timeoutMs) {
    pollfd waited{socket, POLLIN, 0};
    return ::poll(&waited, 1, timeoutMs) == 1;
}

}  // namespace

int connectTo(unsigned short port, const char* from) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port);
    name.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    const int socket = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_in own{};
    own.sin_family = AF_INET;
    ::inet_pton(AF_INET, from, &own.sin_addr);
    EXPECT_EQ(::bind(socket, reinterpret_cast<const sockaddr*>(&own), sizeof own), 0) << from;
    EXPECT_EQ(::connect(socket, reinterpret_cast<const sockaddr*>(&name), sizeof name), 0) << "port " << port;
    return socket;
}

std::string word(std::uint32_t value) {
    return toXdr<u_int>(value, xdr_u_int);
}

std::uint32_t Reply::word(std::size_t n) const {
    return wordAt(rest, n);
}

Reply parseReply(std::string_view message) {
    Reply reply;
    reply.xid = wordAt(message, 0);
    EXPECT_EQ(wordAt(message, 1), 1U) << "no reply";
    reply.accepted = wordAt(message, 2) == 0;
    const std::size_t statusAt = reply.accepted ? 5 : 3;  // an empty verifier stands before it
    reply.status = wordAt(message, statusAt);
    reply.rest = message.substr(4 * (statusAt + 1));
    return reply;
}

RpcClient::RpcClient(unsigned short port, std::uint32_t program, std::uint32_t version, const char* from)
    : m_socket(connectTo(port, from)), m_program(program), m_version(version) {}

RpcClient::~RpcClient() {
    if (m_socket >= 0) ::close(m_socket);
}

std::string RpcClient::callMessage(std::uint32_t procedure, std::string_view arguments) {
    std::string message;
    for (const std::uint32_t value : {++m_lastXid, 0U, 2U, m_program, m_version, procedure, 0U, 0U, 0U, 0U}) {
        message += simserver::word(value);
    }
    return message.append(arguments);
}

std::uint32_t RpcClient::send(std::uint32_t procedure, std::string_view arguments) {
    sendBytes(framed(callMessage(procedure, arguments)));
    return m_lastXid;
}

void RpcClient::sendBytes(std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::send(m_socket, bytes.data(), bytes.size(), MSG_NOSIGNAL);
        if (count <= 0) return;  // the server has closed; whoever waits for a reply will see
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
}

void RpcClient::endSending() {
    ::shutdown(m_socket, SHUT_WR);
}

std::optional<Reply> RpcClient::receive(int timeoutMs) {
    RecordReader reader(1U << 24U);
    while (readable(m_socket, timeoutMs)) {
        char byte = 0;  // one at a time: what belongs to the next reply stays in the socket
        if (::recv(m_socket, &byte, 1, 0) != 1) return std::nullopt;
        reader.feed({&byte, 1});
        if (const auto record = reader.next()) return parseReply(*record);
    }
    return std::nullopt;
}

bool RpcClient::isClosedByServer() {
    std::array<char, 4096> bytes;
    while (readable(m_socket, 5000)) {
        if (::recv(m_socket, bytes.data(), bytes.size(), 0) <= 0) return true;
    }
    return false;
}

std::string RpcClient::results(std::uint32_t procedure, std::string_view arguments) {
    const std::uint32_t xid = send(procedure, arguments);
    const auto reply = receive();
    if (!reply || reply->xid != xid || !reply->accepted || reply->status != SUCCESS) {
        ADD_FAILURE() << "no success of procedure " << procedure;
        return {};
    }
    return reply->rest;
}

void RpcClient::crash() {
    const linger atOnce{1, 0};
    ::setsockopt(m_socket, SOL_SOCKET, SO_LINGER, &atOnce, sizeof atOnce);
    ::close(m_socket);
    m_socket = -1;
}

}  // namespace kdx::simserver
