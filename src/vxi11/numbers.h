#pragma once

#include <cstdint>

/// Numbers of the VXI-11 standard that both ends of the wire use: errors, flags of calls, reasons why a read has
/// stopped.
namespace kdx::vxi11 {

constexpr std::int32_t kNoError = 0;
constexpr std::int32_t kDeviceNotAccessible = 3;
constexpr std::int32_t kInvalidLink = 4;
constexpr std::int32_t kParameterError = 5;
constexpr std::int32_t kNotSupported = 8;
constexpr std::int32_t kOutOfResources = 9;
constexpr std::int32_t kLockedByAnotherLink = 11;
constexpr std::int32_t kNoLockHeld = 12;
constexpr std::int32_t kIoTimeout = 15;
constexpr std::int32_t kIoError = 17;
constexpr std::int32_t kInvalidAddress = 21;
constexpr std::int32_t kAborted = 23;

constexpr std::int32_t kFlagWaitLock = 0x01;
constexpr std::int32_t kFlagEnd = 0x08;
constexpr std::int32_t kFlagTermChar = 0x80;

constexpr std::int32_t kReasonRequestCount = 1;
constexpr std::int32_t kReasonTermChar = 2;
constexpr std::int32_t kReasonEnd = 4;

}  // namespace kdx::vxi11
