#pragma once

#include <rpc/types.h>
#include <rpc/xdr.h>

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace kdx {

/// How a remote call ended.
enum class RpcOutcome {
    Done,
    TimedOut,     ///< no answer in time
    Lost,         ///< the peer closed the connection, or nobody is there any more
    Unavailable,  ///< the peer does not serve the program
    Failed,       ///< the peer refused the call or answered something that is no answer
};

/// Writes (or reads) the fields of a message; false when they do not fit.
using RpcCoder = std::function<bool(XDR*)>;

/// What is called; its answer bears the same number.
struct RpcHead {
    std::uint32_t number = 0;
    std::uint32_t program = 0;
    std::uint32_t version = 0;
    std::uint32_t procedure = 0;
};

/// The message of a call (ONC RPC version 2) with neither credentials nor verifier; nothing when the arguments do not
/// fit. @param variableBytes how many bytes of texts and data are among the arguments
[[nodiscard]] std::optional<std::string> rpcCall(const RpcHead& head, std::size_t variableBytes,
                                                 const RpcCoder& arguments);

/// Reads the message that answers a call; whose answer it is was looked at before. Done, Unavailable or Failed.
[[nodiscard]] RpcOutcome readRpcReply(std::string& message, const RpcCoder& results);

}  // namespace kdx
