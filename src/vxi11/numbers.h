#pragma once

/// Numbers of the VXI-11 standard that both ends of the wire use: errors, flags of calls, reasons why a read has
/// stopped. Program and procedure numbers come with the generated header.
namespace kdx::vxi11 {

constexpr long kNoError = 0;
constexpr long kDeviceNotAccessible = 3;
constexpr long kInvalidLink = 4;
constexpr long kParameterError = 5;
constexpr long kNotSupported = 8;
constexpr long kOutOfResources = 9;
constexpr long kLockedByAnotherLink = 11;
constexpr long kNoLockHeld = 12;
constexpr long kIoTimeout = 15;
constexpr long kIoError = 17;
constexpr long kInvalidAddress = 21;
constexpr long kAborted = 23;

constexpr long kFlagWaitLock = 0x01;
constexpr long kFlagEnd = 0x08;
constexpr long kFlagTermChar = 0x80;

constexpr long kReasonRequestCount = 1;
constexpr long kReasonTermChar = 2;
constexpr long kReasonEnd = 4;

}  // namespace kdx::vxi11
