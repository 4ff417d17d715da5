#pragma once

#include "simserver/rpcprogram.h"

#include <cstddef>
#include <string>

struct Create_LinkResp;

namespace kdx::simserver {

// Numbers of the VXI-11 standard: errors, flags of calls, reasons why a read has stopped.

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
constexpr long kAbort = 23;

constexpr long kFlagWaitLock = 0x01;
constexpr long kFlagEnd = 0x08;
constexpr long kFlagTermChar = 0x80;

constexpr long kReasonRequestCount = 1;
constexpr long kReasonTermChar = 2;
constexpr long kReasonEnd = 4;

constexpr unsigned char kMessageAvailable = 0x10;  // bit of the status byte

/// The answers of the core channel in XDR, as its procedures give them.
RpcAnswer errorOnly(long error);
RpcAnswer createLinkAnswer(const Create_LinkResp& response);
RpcAnswer writeAnswer(long error, std::size_t size);
RpcAnswer readAnswer(long error, long reason, std::string data);
RpcAnswer statusByteAnswer(long error, unsigned char status);
RpcAnswer docmdAnswer(long error);

}  // namespace kdx::simserver
