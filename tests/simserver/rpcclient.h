#pragma once

#include "simserver/tirpcxdr.h"

#include <sys/types.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kdx::simserver {

inline constexpr const char* kThisMachine = "127.0.0.1";
inline constexpr const char* kAnotherPeer = "127.0.0.2";  ///< an address of this machine too

/// Connects to a port of this machine; fails the test when nobody listens. The caller closes the socket.
/// @param from the address that the other end sees.
int connectTo(unsigned short port, const char* from = kThisMachine);

/// A number as it stands in an RPC message.
std::string word(std::uint32_t value);

/// The reply to a call, taken apart.
struct Reply {
    std::uint32_t xid = 0;
    bool accepted = false;
    std::uint32_t status = 0;  ///< accept_stat or reject_stat
    std::string rest;          ///< the results, or the lowest and highest version

    /// The n-th word of the rest.
    [[nodiscard]] std::uint32_t word(std::size_t n) const;
};

/// An RPC client that sends what it is told, also what no proper client would, and waits only when asked to.
class RpcClient {
public:
    explicit RpcClient(unsigned short port, std::uint32_t program = 0x0607AF, std::uint32_t version = 1,
                       const char* from = kThisMachine);
    RpcClient(const RpcClient&) = delete;
    RpcClient& operator=(const RpcClient&) = delete;
    ~RpcClient();

    /// The bytes of a call, without the length in front.
    [[nodiscard]] std::string callMessage(std::uint32_t procedure, std::string_view arguments);
    /// Sends a call and does not wait. @returns its number.
    std::uint32_t send(std::uint32_t procedure, std::string_view arguments);
    /// Sends bytes as they are.
    void sendBytes(std::string_view bytes);
    /// No more is sent; replies are still taken.
    void endSending();
    /// The next reply; nothing when none comes within the time or the server closes the connection.
    std::optional<Reply> receive(int timeoutMs = 5000);
    /// True when the server has closed the connection within some seconds, whatever it sends before.
    bool isClosedByServer();
    /// Sends a call and waits for its reply, which has to be a success. @returns the results.
    std::string results(std::uint32_t procedure, std::string_view arguments);
    /// Closes the connection without a farewell (as a crash of the client does).
    void crash();

private:
    int m_socket = -1;
    std::uint32_t m_program;
    std::uint32_t m_version;
    std::uint32_t m_lastXid = 0;
};

/// Takes a reply message (without the length in front) apart.
Reply parseReply(std::string_view message);

}  // namespace kdx::simserver
