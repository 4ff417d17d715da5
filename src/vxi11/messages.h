#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// The calls that a client makes of an instrument and of the port mapper beside it, as the standards lay them out
/// (VXI-11 revision 1.0, clause B.6; RFC 1833, version 2): arguments as they are written, results as they are read.
/// Results are nothing when the bytes are none.
namespace kdx::vxi11 {

inline constexpr std::uint32_t kPortMapper = 100000, kPortMapperVersion = 2;
inline constexpr std::uint32_t kGetPort = 3;

inline constexpr std::uint32_t kCore = 0x0607AF, kCoreVersion = 1;
inline constexpr std::uint32_t kCreateLink = 10, kDeviceWrite = 11, kDeviceRead = 12, kDestroyLink = 23;

/// Asks for the port of the instrument's core channel over TCP.
[[nodiscard]] std::string getPortArguments();
/// 0: nobody serves it.
[[nodiscard]] std::optional<std::uint32_t> portResult(std::string_view results);

struct CreateLink {
    std::int32_t clientId = 0;
    bool lockDevice = false;
    std::uint32_t lockTimeoutMs = 0;
    std::string_view device;
};
struct CreatedLink {
    std::int32_t error = 0;
    std::int32_t link = 0;
    std::uint16_t abortPort = 0;
    std::uint32_t maxReceive = 0;
};
[[nodiscard]] std::string argumentsOf(const CreateLink& call);
[[nodiscard]] std::optional<CreatedLink> createdLink(std::string_view results);

struct DeviceWrite {
    std::int32_t link = 0;
    std::uint32_t ioTimeoutMs = 0;
    std::uint32_t lockTimeoutMs = 0;
    std::int32_t flags = 0;
    std::string_view data;
};
struct DeviceWritten {
    std::int32_t error = 0;
    std::uint32_t size = 0;
};
[[nodiscard]] std::string argumentsOf(const DeviceWrite& call);
[[nodiscard]] std::optional<DeviceWritten> deviceWritten(std::string_view results);

struct DeviceRead {
    std::int32_t link = 0;
    std::uint32_t size = 0;
    std::uint32_t ioTimeoutMs = 0;
    std::uint32_t lockTimeoutMs = 0;
    std::int32_t flags = 0;
    std::uint8_t termCharacter = 0;
};
struct DeviceWasRead {
    std::int32_t error = 0;
    std::int32_t reason = 0;
    std::string_view data;  ///< within the results
};
[[nodiscard]] std::string argumentsOf(const DeviceRead& call);
/// @param atMost more bytes than were asked for are no result
[[nodiscard]] std::optional<DeviceWasRead> deviceWasRead(std::string_view results, std::size_t atMost);

[[nodiscard]] std::string destroyLinkArguments(std::int32_t link);
/// What the device says to the end of a link.
[[nodiscard]] std::optional<std::int32_t> errorResult(std::string_view results);

}  // namespace kdx::vxi11
