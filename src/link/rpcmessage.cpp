#include "link/rpcmessage.h"

#include <array>

namespace kdx {

namespace {

constexpr std::size_t kFixedCallBytes = 256;          // call header and all fields of fixed length, with room to spare
constexpr std::uint32_t kLargestVerifier = 400;       // of the RPC standard
constexpr std::uint32_t kIsCall = 0, kIsReply = 1;    // message types
constexpr std::uint32_t kAccepted = 0, kSuccess = 0;  // reply and accept states
constexpr std::uint32_t kProgramUnavailable = 1, kProgramMismatch = 2;

}  // namespace

std::optional<std::string> rpcCall(const RpcHead& head, std::size_t variableBytes, const RpcCoder& arguments) {
    std::string message(kFixedCallBytes + variableBytes, '\0');
    XDR xdr;
    xdrmem_create(&xdr, message.data(), static_cast<u_int>(message.size()), XDR_ENCODE);
    // RPC version 2, and neither credentials nor verifier.
    std::array<std::uint32_t, 10> fields = {head.number, kIsCall, 2, head.program, head.version, head.procedure, 0,
                                            0,           0,       0};
    for (std::uint32_t& field : fields) xdr_uint32_t(&xdr, &field);
    if (!arguments(&xdr)) return std::nullopt;
    message.resize(xdr_getpos(&xdr));
    return message;
}

RpcOutcome readRpcReply(std::string& message, const RpcCoder& results) {
    XDR xdr;
    xdrmem_create(&xdr, message.data(), static_cast<u_int>(message.size()), XDR_DECODE);
    std::uint32_t number = 0, type = 0, state = 0, flavour = 0, verifierLength = 0, accepted = 0;
    std::array<char, kLargestVerifier> verifier;
    if (!xdr_uint32_t(&xdr, &number) || !xdr_uint32_t(&xdr, &type) || type != kIsReply || !xdr_uint32_t(&xdr, &state) ||
        state != kAccepted || !xdr_uint32_t(&xdr, &flavour) || !xdr_uint32_t(&xdr, &verifierLength) ||
        verifierLength > kLargestVerifier || !xdr_opaque(&xdr, verifier.data(), verifierLength) ||
        !xdr_uint32_t(&xdr, &accepted)) {
        return RpcOutcome::Failed;
    }
    if (accepted == kProgramUnavailable || accepted == kProgramMismatch) return RpcOutcome::Unavailable;
    return accepted == kSuccess && results(&xdr) ? RpcOutcome::Done : RpcOutcome::Failed;
}

}  // namespace kdx
