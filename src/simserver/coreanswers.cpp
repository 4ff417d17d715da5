#include "simserver/coreanswers.h"

#include "simserver/tirpcxdr.h"

#include <vxi11.h>

namespace kdx::simserver {

RpcAnswer errorOnly(long error) {
    return {toXdr<Device_Error>({error}, xdr_Device_Error)};
}

RpcAnswer createLinkAnswer(const Create_LinkResp& response) {
    return {toXdr(response, xdr_Create_LinkResp)};
}

RpcAnswer writeAnswer(long error, std::size_t size) {
    return {toXdr<Device_WriteResp>({error, size}, xdr_Device_WriteResp)};
}

RpcAnswer readAnswer(long error, long reason, std::string data) {
    const auto size = static_cast<u_int>(data.size());
    return {toXdr<Device_ReadResp>({error, reason, {size, data.data()}}, xdr_Device_ReadResp, size)};
}

RpcAnswer statusByteAnswer(long error, unsigned char status) {
    return {toXdr<Device_ReadStbResp>({error, status}, xdr_Device_ReadStbResp)};
}

RpcAnswer docmdAnswer(long error) {
    return {toXdr<Device_DocmdResp>({error, {0, nullptr}}, xdr_Device_DocmdResp)};
}

}  // namespace kdx::simserver
