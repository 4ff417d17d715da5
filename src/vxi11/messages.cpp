#include "vxi11/messages.h"

#include "vxi11/xdr.h"

namespace kdx::vxi11 {

namespace {

constexpr std::uint32_t kTcp = 6;  // the protocol's number

template <class Result>
std::optional<Result> ifWhole(const XdrReader& reader, const Result& result) {
    return reader ? std::optional(result) : std::nullopt;
}

}  // namespace

std::string getPortArguments() {
    return XdrWriter().word(kCore).word(kCoreVersion).word(kTcp).word(std::uint32_t{0}).bytes();
}

std::optional<std::uint32_t> portResult(std::string_view results) {
    XdrReader reader(results);
    const std::uint32_t port = reader.word();
    return ifWhole(reader, port);
}

std::string argumentsOf(const CreateLink& call) {
    return XdrWriter()
        .word(call.clientId)
        .word(std::uint32_t{call.lockDevice})
        .word(call.lockTimeoutMs)
        .counted(call.device)
        .bytes();
}

std::optional<CreatedLink> createdLink(std::string_view results) {
    XdrReader reader(results);
    CreatedLink result;
    result.error = reader.signedWord();
    result.link = reader.signedWord();
    result.abortPort = static_cast<std::uint16_t>(reader.word());
    result.maxReceive = reader.word();
    return ifWhole(reader, result);
}

std::string argumentsOf(const DeviceWrite& call) {
    return XdrWriter()
        .word(call.link)
        .word(call.ioTimeoutMs)
        .word(call.lockTimeoutMs)
        .word(call.flags)
        .counted(call.data)
        .bytes();
}

std::optional<DeviceWritten> deviceWritten(std::string_view results) {
    XdrReader reader(results);
    DeviceWritten result;
    result.error = reader.signedWord();
    result.size = reader.word();
    return ifWhole(reader, result);
}

std::string argumentsOf(const DeviceRead& call) {
    return XdrWriter()
        .word(call.link)
        .word(call.size)
        .word(call.ioTimeoutMs)
        .word(call.lockTimeoutMs)
        .word(call.flags)
        .word(std::uint32_t{call.termCharacter})
        .bytes();
}

std::optional<DeviceWasRead> deviceWasRead(std::string_view results, std::size_t atMost) {
    XdrReader reader(results);
    DeviceWasRead result;
    result.error = reader.signedWord();
    result.reason = reader.signedWord();
    result.data = reader.counted(atMost);
    return ifWhole(reader, result);
}

std::string destroyLinkArguments(std::int32_t link) {
    return XdrWriter().word(link).bytes();
}

std::optional<std::int32_t> errorResult(std::string_view results) {
    XdrReader reader(results);
    const std::int32_t error = reader.signedWord();
    return ifWhole(reader, error);
}

}  // namespace kdx::vxi11
