#include "simserver/coreclient.h"

#include <gtest/gtest.h>

#include <ostream>

namespace kdx::simserver {

void PrintTo(const ReadResult& result, std::ostream* out) {
    *out << "error " << result.error << ", reason " << result.reason << ", \"" << result.data << '"';
}

std::unique_ptr<CoreClient> CoreClient::elsewhere(unsigned short port) {
    return std::make_unique<CoreClient>(port, DEVICE_CORE, DEVICE_CORE_VERSION, kAnotherPeer);
}

/// Put together by hand: the XDR routine would end the name at a NUL.
std::string CoreClient::linkArguments(const std::string& name, bool withLock, std::uint32_t lockTimeoutMs) {
    const auto length = static_cast<std::uint32_t>(name.size());
    const std::string filled = name + std::string((4 - name.size() % 4) % 4, '\0');
    return word(1) + word(withLock ? 1 : 0) + word(lockTimeoutMs) + word(length) + filled;
}

std::string CoreClient::writeArguments(long link, std::string text, long flags, u_long lockTimeoutMs) {
    return toXdr<Device_WriteParms>({link, 1000, lockTimeoutMs, flags, {static_cast<u_int>(text.size()), text.data()}},
                                    xdr_Device_WriteParms, text.size());
}

std::string CoreClient::readArguments(long link, u_long size, u_long ioTimeoutMs, long flags, char termChar,
                                      u_long lockTimeoutMs) {
    return toXdr<Device_ReadParms>({link, size, ioTimeoutMs, lockTimeoutMs, flags, termChar}, xdr_Device_ReadParms);
}

std::string CoreClient::lockArguments(long link, long flags, u_long lockTimeoutMs) {
    return toXdr<Device_LockParms>({link, flags, lockTimeoutMs}, xdr_Device_LockParms);
}

std::string CoreClient::genericArguments(long link, long flags, u_long lockTimeoutMs) {
    return toXdr<Device_GenericParms>({link, flags, lockTimeoutMs, 1000}, xdr_Device_GenericParms);
}

std::string CoreClient::linkNumber(long link) {
    return toXdr<Device_Link>(link, xdr_Device_Link);
}

ReadResult CoreClient::readResult(std::string_view bytes) {
    const XdrDecoded<Device_ReadResp> read(bytes, xdr_Device_ReadResp, 8);
    EXPECT_TRUE(static_cast<bool>(read));
    return {read->error, read->reason, std::string(read->data.data_val, read->data.data_len)};
}

Create_LinkResp CoreClient::createLink(const std::string& name, bool withLock, std::uint32_t lockTimeoutMs) {
    const std::string bytes = results(create_link, linkArguments(name, withLock, lockTimeoutMs));
    return *XdrDecoded<Create_LinkResp>(bytes, xdr_Create_LinkResp);
}

long CoreClient::open() {
    const Create_LinkResp link = createLink("inst0");
    EXPECT_EQ(link.error, 0);
    return link.lid;
}

Device_WriteResp CoreClient::write(long link, const std::string& text, long flags) {
    return *XdrDecoded<Device_WriteResp>(results(device_write, writeArguments(link, text, flags)),
                                         xdr_Device_WriteResp);
}

ReadResult CoreClient::read(long link, u_long size, u_long ioTimeoutMs, long flags, char termChar) {
    return readResult(results(device_read, readArguments(link, size, ioTimeoutMs, flags, termChar)));
}

long CoreClient::error(std::uint32_t procedure, const std::string& arguments) {
    const std::string bytes = results(procedure, arguments);
    return *XdrDecoded<Device_ErrorCode>(std::string_view(bytes).substr(0, 4), xdr_Device_ErrorCode);
}

}  // namespace kdx::simserver
