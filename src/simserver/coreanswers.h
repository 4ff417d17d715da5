#pragma once

#include "simserver/rpcprogram.h"

#include <cstddef>
#include <string>

struct Create_LinkResp;

namespace kdx::simserver {

/// The answers of the core channel in XDR, as its procedures give them.
RpcAnswer errorOnly(long error);
RpcAnswer createLinkAnswer(const Create_LinkResp& response);
RpcAnswer writeAnswer(long error, std::size_t size);
RpcAnswer readAnswer(long error, long reason, std::string data);
RpcAnswer statusByteAnswer(long error, unsigned char status);
RpcAnswer docmdAnswer(long error);

}  // namespace kdx::simserver
