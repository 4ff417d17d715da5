#pragma once

#include "simserver/rpcclient.h"

#include <vxi11.h>

#include <cstdint>
#include <iosfwd>
#include <memory>
#include <string>
#include <string_view>

namespace kdx::simserver {

/// What a device_read has brought.
struct ReadResult {
    long error = 0;
    long reason = 0;
    std::string data;
    bool operator==(const ReadResult&) const = default;
};

void PrintTo(const ReadResult& result, std::ostream* out);

/// A client of the core channel with a call for each procedure that tests use.
class CoreClient : public RpcClient {
public:
    static constexpr long kWaitLock = 0x01;
    static constexpr long kEnd = 0x08;
    static constexpr long kTermChar = 0x80;

    using RpcClient::RpcClient;
    /// A client at another address than the others.
    static std::unique_ptr<CoreClient> elsewhere(unsigned short port);

    static std::string linkArguments(const std::string& name, bool withLock = false, std::uint32_t lockTimeoutMs = 0);
    static std::string writeArguments(long link, std::string text, long flags = kEnd, u_long lockTimeoutMs = 0);
    static std::string readArguments(long link, u_long size = 1000, u_long ioTimeoutMs = 1000, long flags = 0,
                                     char termChar = 0, u_long lockTimeoutMs = 0);
    static std::string lockArguments(long link, long flags = 0, u_long lockTimeoutMs = 0);
    static std::string genericArguments(long link, long flags = 0, u_long lockTimeoutMs = 0);
    static std::string linkNumber(long link);
    static ReadResult readResult(std::string_view bytes);

    Create_LinkResp createLink(const std::string& name, bool withLock = false, std::uint32_t lockTimeoutMs = 0);
    /// A link to inst0; fails the test when there is none to be had.
    long open();
    Device_WriteResp write(long link, const std::string& text, long flags = kEnd);
    ReadResult read(long link, u_long size = 1000, u_long ioTimeoutMs = 1000, long flags = 0, char termChar = 0);
    /// The error of a procedure that answers nothing else (or as its first word).
    long error(std::uint32_t procedure, const std::string& arguments);
};

}  // namespace kdx::simserver
