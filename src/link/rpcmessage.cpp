#include "link/rpcmessage.h"

#include "vxi11/xdr.h"

namespace kdx {

namespace {

constexpr std::size_t kLargestVerifier = 400;         // of the RPC standard
constexpr std::uint32_t kIsCall = 0, kIsReply = 1;    // message types
constexpr std::uint32_t kAccepted = 0, kSuccess = 0;  // reply and accept states
constexpr std::uint32_t kProgramUnavailable = 1, kProgramMismatch = 2;

}  // namespace

std::string rpcCall(const RpcHead& head, std::string_view arguments) {
    XdrWriter message;
    // RPC version 2, and neither credentials nor verifier.
    for (const std::uint32_t field :
         {head.number, kIsCall, std::uint32_t{2}, head.program, head.version, head.procedure, std::uint32_t{0}}) {
        message.word(field);
    }
    message.counted({}).word(std::uint32_t{0}).counted({});
    return message.bytes().append(arguments);
}

RpcOutcome readRpcReply(std::string_view message, const RpcResults& results) {
    XdrReader reader(message);
    reader.word();  // its number
    const bool accepted = reader.word() == kIsReply && reader.word() == kAccepted;
    reader.word();  // the verifier's kind
    reader.counted(kLargestVerifier);
    const std::uint32_t state = reader.word();
    if (!reader || !accepted) return RpcOutcome::Failed;
    if (state == kProgramUnavailable || state == kProgramMismatch) return RpcOutcome::Unavailable;
    return state == kSuccess && results(reader.rest()) ? RpcOutcome::Done : RpcOutcome::Failed;
}

}  // namespace kdx
