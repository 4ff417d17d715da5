#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace kdx {

/// How a remote call ended.
enum class RpcOutcome {
    Done,
    TimedOut,     ///< no answer in time
    Lost,         ///< the peer closed the connection, or nobody is there any more
    Unavailable,  ///< the peer does not serve the program
    Failed,       ///< the peer refused the call or answered something that is no answer
};

/// Reads the results of a call; false when the bytes are none.
using RpcResults = std::function<bool(std::string_view)>;

/// What is called; its answer bears the same number.
struct RpcHead {
    std::uint32_t number = 0;
    std::uint32_t program = 0;
    std::uint32_t version = 0;
    std::uint32_t procedure = 0;
};

/// The message of a call (ONC RPC version 2) with neither credentials nor verifier. @param arguments in XDR
[[nodiscard]] std::string rpcCall(const RpcHead& head, std::string_view arguments);

/// Reads the message that answers a call; whose answer it is was looked at before. Done, Unavailable or Failed.
[[nodiscard]] RpcOutcome readRpcReply(std::string_view message, const RpcResults& results);

}  // namespace kdx
